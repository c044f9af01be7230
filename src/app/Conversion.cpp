#include "app/Conversion.h"

#include <iterator>

#include "app/ControlSettings.h"
#include "app/Molvar.h"
#include "app/Options.h"
#include "app/Settings.h"
#include "core/Text.h"
#include "input/TrackReader.h"
#include "input/Waypoints.h"
#include "platform/ConsolePlatform.h"

namespace molvar {
namespace {

constexpr int kFirstWaypointType = 9;
constexpr int kTypeCount = static_cast<int>(std::size(kConversionTypes));

int TypeOfName(std::string_view name) {
  for (int i = 0; i < kTypeCount; ++i) {
    if (name == kConversionTypes[i]) return i;
  }
  return -1;
}

// The type an input file's extension implies, or -1 (the settings' track type then holds).
int TypeOfExtension(std::string_view path) {
  const std::string name = LCase(FileNameOf(path));
  const long dot = InStrRev(name, ".");
  if (dot == 0) return -1;
  const std::string_view ext = Mid(name, dot + 1);
  if (ext == "plt") return 0;
  if (ext == "gpx") return 1;
  if (ext == "xml") return 2;
  if (ext == "kml") return 6;
  if (ext == "wpt") return kFirstWaypointType;
  return -1;
}

ConversionResult Usage(std::string error) {
  ConversionResult r;
  r.exitCode = kConversionUsage;
  r.usageError = std::move(error);
  return r;
}

void EnterMode(Molvar& m, int type) {
  if (type >= kFirstWaypointType) {
    CheckProgramModeItem(m, kModeConvertWaypoints);
    SelectWptFileType(m, type - kFirstWaypointType);
    // Speed as altitude has no meaning for waypoints.
    if (m.AltitudeMode == 3) SelectAltitudeMode(m, 2);
  } else {
    CheckProgramModeItem(m, kModeConvertTracks);
    if (type >= 0) SelectTrackFileType(m, type);
  }
}

}  // namespace

ConversionResult RunConversion(Molvar& m, ConsolePlatform& platform, const ConversionRequest& request) {
  int type = -1;
  if (!request.type.empty()) {
    type = TypeOfName(request.type);
    if (type < 0) return Usage("unknown type " + request.type);
  } else {
    type = TypeOfExtension(request.input);
  }

  LoadOptionsOnly(m);
  EnterMode(m, type);
  for (const std::string& text : request.assignments) {
    const auto assignment = ParseControlAssignment(text);
    if (!assignment) return Usage("bad option " + text + " (expected CONTROL=VALUE or CONTROL(INDEX)=VALUE)");
    if (std::string error = ApplyControlAssignment(m, *assignment); !error.empty()) return Usage(error);
  }
  // A converter never opens what it wrote.
  m.frmMain.chkAuto.Value = 0;
  ApplyAutoOpen(m);

  platform.dialogPaths = {request.input, request.output};
  const int writtenBefore = m.Out.CompletedCount();
  if (m.ProgramMode == kModeConvertWaypoints) {
    ReadWaypointFile(m, false);
  } else {
    ReadTrackFile(m, false);
  }
  ConversionResult result;
  result.exitCode = m.Out.CompletedCount() > writtenBefore ? kConversionWritten : kConversionNothingWritten;
  result.info = m.frmMain.txtInfo.Text;
  return result;
}

}  // namespace molvar
