#include "output/kml/KmlFrame.h"

#include "app/Molvar.h"
#include "core/Markup.h"
#include "core/Numbers.h"
#include "core/Text.h"
#include "output/Dispatch.h"
#include "output/kml/Details.h"
#include "output/kml/Placemarks.h"

namespace molvar {
namespace {

// Hosts are ours; the paths are the ones Google Earth, GDAL and gpsbabel know.
constexpr const char* kKmlNamespace = "http://earth.google.com/kml/2.0";

// The placemark altitude for `mode`: ground, the point's altitude, or speed as height.
int32_t PlacemarkAltitude(const Molvar& m, const TrackPoint& p, int mode) {
  switch (mode) {
    case 1:
    case 2: return p.Altitude;
    case 3: return RoundToInt32(m.SpeedGain * p.Speed);
    default: return 0;
  }
}

// The text from the first blank on (blank included), empty when there is none.
std::string FromFirstBlank(std::string_view dateTime) {
  const long at = InStr(dateTime, " ");
  return at > 0 ? std::string(Mid(dateTime, at)) : std::string();
}

}  // namespace

int32_t TextBoxInt(std::string_view text) { return RoundToInt32Or(Val(text), 0); }

std::string TitleFromFileName(const Molvar& m) {
  const long dot = InStrRev(m.OutputName, ".");
  if (dot == 0) return "filename";
  return std::string(Left(m.OutputName, dot - 1));
}

std::string GetTrackTitle(Molvar& m) {
  switch (m.ProgramMode) {
    case kModeRealTimeNmea: return "NMEA data";
    case kModeAgw: return "AGW data (" + IntToText(m.Aprs.StationCount) + ")";
    case kModeAprsWeb: return m.Aprs.StationCallSign;
    default:
      if (m.frmMain.chkUseFilename.Checked()) return TitleFromFileName(m);
      return m.frmMain.txtTitle.Text;
  }
}

int16_t WriteKmlHeader(Molvar& m) {
  auto& f = m.frmMain;
  try {
    if (!f.chkUseFilename.Checked() && f.txtTitle.Text.empty()) {
      m.platform.MsgBox(
          "You should enter a title in the track title box or \r\n"
          "check the \"Use filename as title\" checkbox.",
          " No track title entered", MsgButtons::OK, MsgIcon::Exclamation);
      f.txtTitle.Text = "Enter title here!";
    }
    m.Kml.DayCount = 1;
    OutputFile& out = m.Out;
    out.Open(m.OutputPath);
    out.Line("<?xml version=\"1.0\" encoding=\"UTF-8\"?>");
    out.Line(std::string("<kml xmlns=\"") + kKmlNamespace + "\">");
    out.Line("<!--  File type " + IntToText(m.ProgramMode) + "-" + IntToText(m.TrackFileType) + "-" +
             IntToText(m.WptFileType) + "-" + IntToText(m.OutputMode) + " created with Molvar version " +
             MarkupComment(m.VersionText) + "  -->");
    out.Line("<Folder>");
    out.Line("<name>" + MarkupText(GetTrackTitle(m)) + "</name>");
    if (m.ProgramMode == kModeAgw) out.Line("  <open>1</open>");
    out.Line("");

    if (m.ColorVaryMode == 3) {
      out.Line("<ScreenOverlay>");
      out.Line("<name>Legend</name>");
      out.Line("<Icon>");
      out.Line("<href>" + MarkupText(m.ProgramPath("SpeedLegend.jpg")) + "</href>");
      out.Line("</Icon>");
      out.Line("<overlayXY x= \"0\" y=\"1\" xunits=\"fraction\" yunits=\" fraction\"/>");
      out.Line("<screenXY x=\"0\" y=\" 1\" xunits=\" fraction\" yunits=\" fraction\"/>");
      out.Line("<rotationXY x=\"0\" y=\"0\" xunits=\" fraction\" yunits=\" fraction\"/>");
      out.Line("<size x=\"0\" y=\"0\" xunits=\" fraction\" yunits=\" fraction\"/>");
      out.Line("</ScreenOverlay>");
      out.Line("<open>1</open>");
    }

    const TrackStore& track = m.Track;
    const int32_t count = track.StoredCount();
    if (m.ProgramMode == kModeAprsWeb && !f.chkStartFinish.Checked() && count >= 1) {
      const TrackPoint& last = track.at(count);
      int32_t alt = last.Altitude;
      WriteKmlPlacemark(m, m.Aprs.StationCallSign, last.Longitude, last.Latitude, alt, "FFFFFF", 0);
    }

    if (m.ProgramMode != kModeConvertWaypoints && count >= 1) {
      if (f.chkDetailed.Checked()) WriteDetailedData(m);
      if (f.chkStartFinish.Checked()) {
        const TrackPoint& first = track.at(1);
        int32_t alt = PlacemarkAltitude(m, first, m.AltitudeMode);
        WriteKmlPlacemark(m, "Start " + FromFirstBlank(first.DateTime.view()), first.Longitude, first.Latitude,
                          alt, "00FF00", 1);
        const TrackPoint& last = track.at(count);
        std::string name = "Finish ";
        const std::string time = FromFirstBlank(last.DateTime.view());
        if (!time.empty()) {
          name += time + " " + FormatPattern(last.Distance * m.UnitFactor, "0.00") + m.DistanceUnitLabel;
        }
        alt = PlacemarkAltitude(m, last, m.AltitudeMode);
        WriteKmlPlacemark(m, name, last.Longitude, last.Latitude, alt, "0000FF", 2);
      }
      if (f.chkFastest.Checked()) {
        const int32_t k = m.Speed.FastestIndex >= 1 && m.Speed.FastestIndex <= count ? m.Speed.FastestIndex : 1;
        const TrackPoint& p = track.at(k);
        int32_t alt = PlacemarkAltitude(m, p, f.comboAltitude.ListIndex);
        WriteKmlPlacemark(m,
                          "Fastest (" + FormatPattern(p.Speed * m.UnitFactor, "0.0") + m.SpeedUnitLabel +
                              " at point " + IntToText(k) + ")",
                          p.Longitude, p.Latitude, alt, "FFFFFF", 3);
      }
    }
    return 0;
  } catch (const std::exception& e) {
    ShowBug(m, "WriteKmlHeader", e);
    m.Out.Abandon();
    return static_cast<int16_t>(ErrorNumberOf(e));
  }
}

void InsertAltitudeMode(Molvar& m, int32_t altitude) {
  auto& f = m.frmMain;
  try {
    f.AltLabel.Visible = false;
    if (altitude == 0 && (m.ProgramMode == kModeConvertTracks || m.ProgramMode == kModeGarmin) &&
        (m.AltitudeMode == 1 || m.AltitudeMode == 2) && !m.Kml.AltitudeWarned) {
      const int answer = m.platform.MsgBox(
          "There is no altitude information present.\r\n"
          "Do you want me to select \"Clamped to ground\" altitude mode instead?\r\n"
          "If you select \"No\" then GoogleEarth may plot the track incorrectly.",
          " Altitude warning...", MsgButtons::YesNo, MsgIcon::Exclamation);
      m.Kml.AltitudeWarned = true;
      if (answer == kAnswerYes) {
        m.AltitudeMode = 0;
        f.comboAltitude.ListIndex = 0;
      }
    }
    switch (m.AltitudeMode) {
      case 0: m.Out.Line("    <tessellate>1</tessellate><altitudeMode>clampedToGround</altitudeMode>"); return;
      case 1: m.Out.Line("    <altitudeMode>absolute</altitudeMode>"); break;
      case 2: m.Out.Line("    <altitudeMode>absolute</altitudeMode> <extrude>1</extrude>"); break;
      case 3: m.Out.Line("    <altitudeMode>relativeToGround</altitudeMode> <extrude>1</extrude>"); break;
      default: return;
    }
    if (m.ProgramMode == kModeConvertWaypoints) f.AltLabel.Visible = true;
  } catch (const std::exception& e) {
    ShowBug(m, "InsertAltitudeMode", e);
  }
}

void WriteLookAt(Molvar& m, double longitude, double latitude, int heading) {
  OutputFile& out = m.Out;
  out.Line("<LookAt>");
  out.Line("  <longitude>" + DoubleToText(longitude) + "</longitude>");
  out.Line("  <latitude>" + DoubleToText(latitude) + "</latitude>");
  out.Line("  <range>" + FormatPattern(Val(m.frmMain.txtEyeAlt.Text) / m.AltitudeFactor, "0") + "</range>");
  out.Line("  <tilt>" + MarkupText(m.frmMain.txtTilt.Text) + "</tilt>");
  out.Line("  <heading>" + IntToText(heading) + "</heading>");
  out.Line("</LookAt>");
  out.Line("");
}

void WriteKmlFooter(Molvar& m) {
  auto& f = m.frmMain;
  try {
    int heading = 0;
    if (m.ProgramMode == kModeRealTimeNmea) {
      heading = SelectedIndex(f.optNorthUp) == 1 ? 0 : TextBoxInt(m.Nmea.Fields.CourseText);
    } else {
      heading = TextBoxInt(f.txtHeading.Text);
    }
    const int32_t count = m.Track.StoredCount();
    if (m.ProgramMode != kModeConvertWaypoints && m.ProgramMode != kModeAgw && count >= 1) {
      const bool atLast = m.ProgramMode == kModeRealTimeNmea || m.ProgramMode == kModeAprsWeb;
      const TrackPoint& p = m.Track.at(atLast ? count : 1);
      WriteLookAt(m, p.Longitude, p.Latitude, heading);
    }
    m.Out.Line("</Folder>");
    m.Out.Line("</kml>");
    m.Out.Close();

    std::string& info = f.txtInfo.Text;
    if (m.ProgramMode == kModeConvertWaypoints) {
      info = " Created " + IntToText(m.Waypoints.WptCount) + " placemarks.";
    } else if (m.ProgramMode == kModeConvertTracks || m.ProgramMode == kModeGarmin ||
               m.ProgramMode == kModeAprsWeb) {
      info = " Processed " + IntToText(m.Track.PointCount) + " trackpoints.";
      if (!f.chkCollapse.Checked()) info += " (" + IntToText(m.Kml.SegmentCount) + " segments)";
      if (m.Kml.DayCount > 1) info += " (" + IntToText(m.Kml.DayCount) + " days)";
    }
    if (m.ProgramMode != kModeRealTimeNmea && m.ProgramMode != kModeAgw) info += " Output: " + m.OutputName;

    if (m.ProgramMode == kModeRealTimeNmea) {
      f.cmdOpen.Enabled = true;
    } else if (!f.chkAuto.Checked()) {
      f.cmdOpen.Enabled = true;
      f.cmdOpen.HasFocus = true;
    } else {
      OpenOutput(m);
    }
    f.cmdRefresh.Enabled = true;
  } catch (const std::exception& e) {
    m.Out.Abandon();
    ShowBug(m, "WriteKmlFooter", e);
  }
}

}  // namespace molvar
