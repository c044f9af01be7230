#include "output/kml/LiveFiles.h"

#include "app/Molvar.h"
#include "core/Markup.h"
#include "core/Numbers.h"
#include "core/SpeedDistance.h"
#include "input/Nmea.h"
#include "output/OutputFile.h"
#include "output/kml/Details.h"
#include "output/kml/KmlFrame.h"
#include "output/kml/Placemarks.h"
#include "output/kml/Segments.h"

namespace molvar {
namespace {

// Hosts are ours; the paths are the ones these link files have always carried.
constexpr const char* kLinkNamespace22 = "http://www.google.com/earth/kml/2.2";
constexpr const char* kLinkNamespace20 = "http://www.google.com/earth/kml/2.0";

// The degree sign in UTF-8, the document's encoding.
constexpr const char* kDegreeSign = "\xC2\xB0";

struct LinkFileText {
  const char* fileName;
  const char* xmlNamespace;
  bool openLine;
  std::string href;
  int versionPadding;  // blanks between the version and "-->"
  const char* comments[3];
};

// Both link files go through a file of their own, never m.Out, which may be open.
void WriteLinkFile(Molvar& m, const LinkFileText& t) {
  const int32_t refresh = TextBoxInt(m.frmMain.txtGErefresh.Text);
  OutputFile file;
  file.Open(m.ProgramPath(t.fileName));
  file.Line("<?xml version=\"1.0\" encoding=\"UTF-8\"?>");
  file.Line(std::string("<kml xmlns=\"") + t.xmlNamespace + "\">");
  file.Line("<NetworkLink>");
  file.Line("  <name>GPS Link</name>");
  if (t.openLine) file.Line("  <open>1</open>");
  file.Line("  <visibility>1</visibility>");
  file.Line("  <flyToView>1</flyToView>");
  file.Line("  <Link>");
  file.Line("    <href>" + MarkupText(t.href) + "</href>");
  if (refresh > 0) file.Line("    <refreshMode>onInterval</refreshMode>");
  file.Line("    <refreshInterval>" + IntToText(refresh) + "</refreshInterval>");
  file.Line("  </Link>");
  file.Line("</NetworkLink>");
  file.Line("</kml>");
  file.Line("");
  file.Line("<!--  File created with Molvar version " + MarkupComment(m.VersionText) +
            std::string(static_cast<std::size_t>(t.versionPadding), ' ') + "-->");
  for (const char* comment : t.comments) file.Line(comment);
  file.Close();
}

// The automatic upload of the fresh nmea.kml, in real-time mode with "Auto-ftp track data" ticked.
// Google Maps cannot follow a live link, and without a server connection the FTP window is offered
// once; otherwise the file goes up at most every FtpUploadRate seconds.
void AutoUploadLiveFile(Molvar& m) {
  if (m.ProgramMode != kModeRealTimeNmea || !m.frmMain.mnuAutoFtp(0).Checked) return;
  LiveState& live = m.Live;
  if (m.OutputMode == kOutputGoogleMaps) {
    if (!live.GmapsWarned) {
      m.platform.MsgBox(
          "You cannot auto-ftp a GoogleMap file, as GoogleMap\r\n"
          "does not support live network links.\r\n"
          "Use Program Mode / Output to Google Earth instead.",
          "Sorry!", MsgButtons::OK, MsgIcon::Exclamation);
    }
    live.GmapsWarned = true;
    return;
  }
  if (m.FtpReady == 0) {
    if (!live.FtpSetupShown) m.frmFtpSetup.window.Visible = true;
    live.FtpSetupShown = true;
    return;
  }
  if (!m.UploadLastFile) return;
  const int64_t now = m.platform.Now();
  if (static_cast<double>(now - live.LastUploadTime) < m.FtpUploadRate) return;
  live.UploadCount += 1;
  m.UploadLastFile(m, live.UploadCount);
  live.LastUploadTime = now;
}

}  // namespace

void WriteGpsLinkFile(Molvar& m) {
  try {
    WriteLinkFile(m, {"gps.kml",
                      kLinkNamespace22,
                      true,
                      m.ProgramPath("nmea.kml"),
                      41,
                      {"<!--  This file may be modified to suit your own preferences.                       -->",
                       "<!--  If you modify it, save it as a different name, else it will get overwritten.  -->",
                       "<!--  The <href> line must stay the same. See the help file for <refreshInterval>.  -->"}});
  } catch (const std::exception& e) {
    ShowBug(m, "WriteGpsLinkFile", e);
  }
}

void WriteWebLinkFile(Molvar& m) {
  try {
    WriteLinkFile(m,
                  {"gpslink.kml",
                   kLinkNamespace20,
                   false,
                   m.FtpHttpPath + "nmea.kml",
                   38,
                   {"<!--  This file may be modified to suit your own preferences.                    -->",
                    "<!--  If you modify it, save it as a different name, else it will get overwritten.        -->",
                    "<!--  The <href> line must point to your server. See the help file for <refreshInterval>. -->"}});
  } catch (const std::exception& e) {
    ShowBug(m, "WriteWebLinkFile", e);
  }
}

std::string LivePlacemarkLabel(const Molvar& m) {
  const NmeaFields& fields = m.Nmea.Fields;
  const double speed = Val(fields.SpeedText);
  std::string label = speed >= 1 ? FormatPattern(speed * m.UnitFactor, "0.0") + m.SpeedUnitLabel : "Stationary";
  if (m.Nmea.NmeaAltitude > 0) {
    label += "  Alt: " + FormatPattern(m.Nmea.NmeaAltitude * m.AltitudeFactor, "0") + m.AltitudeUnitLabel;
  }
  const double course = Val(fields.CourseText);
  if (course != 0) label += "  Hdg: " + FormatPattern(course, "0") + kDegreeSign;
  return label;
}

void WriteNmeaKmlFile(Molvar& m) {
  try {
    TrackStore& track = m.Track;
    if (m.Nmea.Fields.SentenceName.empty() || track.PointCount == m.Live.LastWrittenCount) return;
    // The label shows the fix as received, before storing it fills an empty speed text.
    const std::string label = LivePlacemarkLabel(m);
    AddParsedPoint(m);
    CalcSpeedDistance(m, track.PointCount);
    m.Speed.FastestIndex = FindFastestPoint(m);

    m.LastSourceFile.clear();
    m.OutputPath = m.ProgramPath("nmea.kml");
    m.OutputName = "nmea.kml";
    if (WriteKmlHeader(m) != 0) return;
    const int completedBefore = m.Out.CompletedCount();
    const TrackPoint& last = track.at(track.PointCount);
    int32_t altitude = last.Altitude;
    WriteKmlPlacemark(m, label, last.Longitude, last.Latitude, altitude, "FFFFFF", kPlacemarkGeneral);
    WriteKmlNmeaTrack(m);
    // A track line that failed has dropped the file; the previous nmea.kml stays in place.
    if (!m.Out.IsOpen()) return;
    WriteKmlFooter(m);
    // Nothing to upload when the new file did not replace the old one; the next fix tries again.
    if (m.Out.CompletedCount() == completedBefore) return;

    AutoUploadLiveFile(m);
    m.Live.LastWrittenCount = track.PointCount;
  } catch (const std::exception& e) {
    m.Out.Abandon();
    ShowBug(m, "WriteNmeaKmlFile", e);
  }
}

void WriteKmlNmeaTrack(Molvar& m) {
  auto& f = m.frmMain;
  try {
    const TrackStore& track = m.Track;
    const int32_t count = track.PointCount;
    if (count < 2 || TextBoxInt(f.txtTrkLimit.Text) == 0) return;
    DetailStartIndex(m);
    const int32_t first = m.Detail.DetailStart;

    std::string name;
    if (!f.chkUseFilename.Checked()) {
      name = f.txtTitle.Text;
    } else if (first == 1) {
      name = "Track - " + IntToText(count) + " points";
    } else {
      name = "Track - displaying " + f.txtTrkLimit.Text + " of " + IntToText(count) + " points";
    }

    OutputFile& out = m.Out;
    out.Line("<Placemark>");
    out.Line("  <name>" + MarkupText(name) + "</name>");
    WriteKmlStyle(m, 0);
    out.Line("  <LineString>");
    InsertAltitudeMode(m, m.Nmea.NmeaAltitude);
    out.Line("    <coordinates>");
    for (int32_t i = first, stored = track.StoredCount(); i <= stored; ++i) {
      const TrackPoint& p = track[i];
      std::string& line = out.Text();
      line.append("    ");
      AppendDouble(line, p.Longitude);
      line.push_back(',');
      AppendDouble(line, p.Latitude);
      line.push_back(',');
      AppendInt(line, p.Altitude);
      line.push_back(' ');
      out.EndLine();
    }
    out.Line("    </coordinates>");
    out.Line("  </LineString>");
    out.Line("</Placemark>");
  } catch (const std::exception& e) {
    // A half-written line would make the whole document unreadable: drop the file instead.
    m.Out.Abandon();
    ShowBug(m, "WriteKmlNmeaTrack", e);
  }
}

}  // namespace molvar
