// A whole waypoint file through "Read waypoint file": Ozi WPT or GPX, each waypoint written at
// once as KML, GPX or Ozi. Byte 1: file type, output format and label source; the rest is the file.
#include <cstdint>

#include "FuzzProgram.h"
#include "app/Options.h"
#include "input/FileChoice.h"
#include "input/Waypoints.h"

using namespace molvar;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
  fuzz::FuzzInput in(data, size);
  const uint8_t choice = in.Byte();
  fuzz::FuzzProgram p;
  Molvar& m = *p;
  m.ProgramMode = kModeConvertWaypoints;
  m.frmMain.chkAuto.Value = 0;
  ApplyAutoOpen(m);
  SelectWptFileType(m, choice & 1);
  SelectWptTitle(m, (choice >> 3) % 3);
  SelectAltitudeMode(m, (choice >> 5) & 3);
  m.OutputFormat = static_cast<int16_t>(((choice >> 1) & 3) % 3);
  // The save dialog refuses these combinations; KML is always possible.
  if (!RefusedCombination(m).empty()) m.OutputFormat = kFormatKml;

  m.LastSourceFile = p.File(m.WptFileType == 1 ? "in.gpx" : "in.wpt");
  m.InputName = m.WptFileType == 1 ? "in.gpx" : "in.wpt";
  m.OutputName = m.OutputFormat == kFormatKml ? "out.kml" : m.OutputFormat == kFormatGpx ? "out.gpx" : "out.wpt";
  m.OutputPath = p.File(m.OutputName);
  fuzz::WriteFuzzFile(m.LastSourceFile, in.rest);
  ReadWaypointFile(m, true);
  return 0;
}
