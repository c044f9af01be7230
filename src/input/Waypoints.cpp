#include "input/Waypoints.h"

#include "app/Molvar.h"
#include "app/TestBox.h"
#include "core/Numbers.h"
#include "core/Text.h"
#include "input/FileChoice.h"
#include "input/LineReader.h"
#include "input/TrackReader.h"
#include "input/XmlTracks.h"
#include "output/Gpx.h"
#include "output/Ozi.h"
#include "output/kml/KmlFrame.h"
#include "output/kml/Placemarks.h"

namespace molvar {
namespace {

constexpr double kFeetPerMetre = 3.28083;
constexpr int kOziWaypointHeaderLines = 4;
constexpr int32_t kNoOziAltitude = -777;
constexpr int32_t kTestBoxWaypointLimit = 500;

// False when the output could not be started (its writer has shown why).
bool StartOutput(Molvar& m) {
  switch (m.OutputFormat) {
    case kFormatKml: return WriteKmlHeader(m) == 0;
    case kFormatGpx: WriteGpxHeader(m); return true;
    default: WriteOziHeader(m, kOziWaypoints); return true;
  }
}

void EndOutput(Molvar& m) {
  switch (m.OutputFormat) {
    case kFormatKml: WriteKmlFooter(m); return;
    case kFormatGpx: WriteGpxFooter(m); return;
    default:
      m.Out.Close();
      m.frmMain.txtInfo.Text = " Created " + IntToText(m.Waypoints.WptCount) + " waypoints. Output: " + m.OutputName;
      return;
  }
}

int32_t OziWaypointAltitude(const Molvar& m, std::string_view feetField) {
  int32_t feet = RoundToInt32Or(Val(Trim(feetField)), 0);
  if (feet == kNoOziAltitude) feet = 0;
  const int32_t metres = RoundToInt32Or(feet / kFeetPerMetre, 0);
  if (metres != 0) return metres;
  // No altitude: the eye altitude (display unit) in metres.
  return RoundToInt32Or(Val(m.frmMain.txtEyeAlt.Text) / m.AltitudeFactor, 0);
}

void ReadLines(Molvar& m, LineReader& in) {
  const bool ozi = m.WptFileType == 0;
  std::string line;
  for (int i = 0; ozi && i < kOziWaypointHeaderLines && in.Next(line); ++i) {
  }
  while (in.Next(line)) {
    if (m.TestMode == 1 && m.Waypoints.WptCount < kTestBoxWaypointLimit) AppendToTestBox(m, line);
    if (ozi) {
      ReadOziWaypointLine(m, line);
    } else {
      ReadGpxLine(m, line);
    }
  }
}

}  // namespace

void ReadOziWaypointLine(Molvar& m, std::string_view line) {
  if (line.empty()) return;
  const Fields f = SplitFields(line, ",");
  Waypoint& w = m.Waypoints.Add();
  w.WptName = std::string(Trim(f[2]));
  w.WptLatitude = Val(Trim(f[3]));
  w.WptLongitude = Val(Trim(f[4]));
  w.WptAltitude = OziWaypointAltitude(m, f[15]);
  w.WptComment = ProperCase(Replace(Trim(f[11]), "&", " and ", 1));
  w.WptDescription.clear();
  std::string& label = w.Label(m.PlacemarkLabelSource);
  WriteWaypointPlacemark(m, label, w.WptLongitude, w.WptLatitude, w.WptAltitude);
}

void ReadWaypointFile(Molvar& m, bool fromDrop) {
  NormaliseViewSettings(m);
  if (!fromDrop) {
    if (ChooseInputFile(m) == 1) return;
    if (ChooseOutputFile(m) == 1) return;
  }
  if (m.TestMode == 1) m.frmMain.txtTest.Text.clear();
  try {
    FixLineEnds(m);
    LineReader in(m.LastSourceFile);
    m.Waypoints.Restart();
    m.GpxReader.Reset();
    if (!StartOutput(m)) return;
    ReadLines(m, in);
    EndOutput(m);
  } catch (const std::exception& e) {
    m.Out.Abandon();
    ShowSnag(m, "ReadWaypointFile", e);
  }
}

void WptFrame_Drop(Molvar& m, const std::string& path) {
  const std::string extension = TakeDroppedFile(m, path);
  if (extension != (m.WptFileType == 1 ? "GPX" : "WPT")) {
    m.platform.MsgBox("Incorrect file type!\r\nChange the file type button\r\nto agree with the input file type.",
                      "Whoops!", MsgButtons::OK, MsgIcon::Exclamation);
    return;
  }
  ReadWaypointFile(m, true);
}

}  // namespace molvar
