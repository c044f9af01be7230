#include "output/Dispatch.h"

#include "app/Molvar.h"
#include "core/Numbers.h"
#include "core/SpeedDistance.h"
#include "output/Gpx.h"
#include "output/Ozi.h"
#include "output/kml/KmlFrame.h"
#include "output/kml/Placemarks.h"
#include "output/kml/Segments.h"

namespace molvar {
namespace {

// Each failed start asks for the program again; a cancel ends it. The loop replaces the
// recursion between the two procedures so a long series of wrong choices cannot exhaust the stack.
bool StartGoogleEarth(Molvar& m, const std::string& file) {
  try {
    m.platform.StartProgram(m.GoogleEarthPath + " \"" + file + "\"");
    return true;
  } catch (const std::exception&) {
    m.platform.MsgBox(
        "GoogleEarth not found. Close this window. In the file dialog box that opens, find Google Earth and open "
        "it.\r\nThe location will be saved for the next time.",
        " Whoops!...", MsgButtons::OK, MsgIcon::Information);
    return false;
  }
}

bool AskGoogleEarthPath(Molvar& m) {
  FileDialogRequest request;
  request.title = "Locate Google Earth";
  request.filter = "GE executable (google-earth*)|google-earth*|All files (*)|*";
  request.initialFolder = std::string(m.GoogleEarthPath.substr(0, m.GoogleEarthPath.find_last_of('/') == std::string::npos ? 0 : m.GoogleEarthPath.find_last_of('/')));
  request.proposedName = m.GoogleEarthPath;
  const auto chosen = m.platform.OpenFileDialog(request);
  if (!chosen || chosen->empty()) return false;
  m.GoogleEarthPath = *chosen;
  return true;
}

void OpenInGoogleEarth(Molvar& m, bool retrying) {
  const std::string file = m.ProgramMode == kModeRealTimeNmea ? m.ProgramPath("gps.kml") : m.OutputPath;
  if (retrying && !AskGoogleEarthPath(m)) return;
  while (!StartGoogleEarth(m, file)) {
    if (!AskGoogleEarthPath(m)) return;
  }
  if (m.ProgramMode == kModeAgw) {
    // Lets Google Earth come up before the engine's next burst; no events run meanwhile.
    const uint32_t start = m.platform.TickCount();
    while (m.platform.TickCount() - start < 2000) {
    }
  }
}

}  // namespace

void OpenOutput(Molvar& m) {
  if (m.OutputPath.empty()) {
    m.platform.MsgBox("You must create a file first before you can open it.", " Whoopsie!...", MsgButtons::OK,
                      MsgIcon::Information);
    return;
  }
  if (m.OutputMode == kOutputGoogleEarth) {
    if (m.OutputFormat != kFormatKml) {
      m.platform.MsgBox("File " + m.OutputName + " cannot  be opened in Google Earth.", " Whoopsie!...",
                        MsgButtons::OK, MsgIcon::Information);
      return;
    }
    OpenInGoogleEarth(m, false);
    return;
  }
  if (m.OutputFormat != kFormatKml) {
    m.platform.MsgBox("File " + m.OutputName + " cannot  be opened in Google Map.", " Whoopsie!...", MsgButtons::OK,
                      MsgIcon::Information);
    return;
  }
  if (m.FtpReady == 0) {
    m.frmFtpSetup.window.Visible = true;
  } else if (m.UploadLastFile) {
    m.UploadLastFile(m, 0);
  }
}

void LocateGoogleEarth(Molvar& m) { OpenInGoogleEarth(m, true); }

void WriteOutputFile(Molvar& m) {
  if (m.Track.PointCount == 0) {
    m.frmMain.txtInfo.Text = " No track data found - no file saved.";
    return;
  }
  MarkDays(m);
  MarkSegments(m);
  m.Speed.FastestIndex = FindFastestPoint(m);
  if (m.ProgramMode == kModeAprsWeb) {
    m.OutputName = m.Aprs.StationCallSign + ".kml";
    // Without a remembered track folder the file goes to the program folder, not the root.
    m.OutputPath = m.OutputTrackPath.empty() ? m.ProgramPath(m.OutputName) : m.OutputTrackPath + "/" + m.OutputName;
  }
  m.Kml.SegmentCount = 1;
  if (m.OutputFormat == kFormatKml) {
    if (WriteKmlHeader(m) != 0) return;
    WriteKmlSegments(m);
    WriteKmlFooter(m);
    return;
  }
  try {
    if (m.OutputFormat == kFormatGpx) {
      WriteGpxHeader(m);
      WriteGpxSegments(m);
      WriteGpxFooter(m);
    } else {
      WriteOziHeader(m, kOziTrack);
      for (int32_t i = 1; i <= m.Track.StoredCount(); ++i) WriteOziTrackPoint(m, i);
      m.Out.Close();
      // As the GPX tail does, so the status line names what was written.
      m.frmMain.txtInfo.Text += " Output: " + m.OutputName;
    }
  } catch (const std::exception& e) {
    // The previous file at OutputPath stays as it was.
    m.Out.Abandon();
    ShowBug(m, "WriteOutputFile", e);
  }
}

void RefreshOutput(Molvar& m) {
  if (m.ProgramMode != kModeConvertWaypoints) {
    WriteOutputFile(m);
    return;
  }
  WaypointStore& waypoints = m.Waypoints;
  if (waypoints.WptCount == 0) {
    m.platform.MsgBox("No waypoint data available.\r\nPlease load a waypoint file first.", " Sorry!...",
                      MsgButtons::OK, MsgIcon::Information);
    return;
  }
  // Waypoints are always redrawn as KML.
  m.OutputFormat = kFormatKml;
  if (WriteKmlHeader(m) != 0) return;
  const int32_t altitude = RoundToInt32Or(Val(m.frmMain.txtEyeAlt.Text) / m.AltitudeFactor, 0);
  for (int32_t i = 1; i <= waypoints.WptCount; ++i) {
    Waypoint& w = waypoints.at(i);
    w.WptAltitude = altitude;
    const std::string& label = w.Label(m.PlacemarkLabelSource);
    WriteKmlPlacemark(m, label, w.WptLongitude, w.WptLatitude, w.WptAltitude, "FFFFFF", kPlacemarkGeneral);
  }
  WriteKmlFooter(m);
}

}  // namespace molvar
