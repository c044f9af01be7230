#include "output/kml/Details.h"

#include <array>

#include "app/Molvar.h"
#include "core/DateTime.h"
#include "core/Markup.h"
#include "core/Numbers.h"
#include "core/Text.h"
#include "output/kml/KmlFrame.h"
#include "output/kml/Segments.h"

namespace molvar {
namespace {

constexpr std::array<const char*, 10> kQuality = {"Invalid",  "GPS fix (SPS)", "DGPS fix", "PPS fix",    "Fixed RTK",
                                                  "Float RTK", "Estimated",     "Manual",   "Simulation", "EGNOS"};
constexpr std::string_view kNoTime = "2006-01-01 00:00:00";

}  // namespace

void DetailStartIndex(Molvar& m) {
  const int32_t count = m.Track.StoredCount();
  int32_t start = 1;
  if (m.ProgramMode == kModeRealTimeNmea) {
    const int32_t limit = TextBoxInt(m.frmMain.txtTrkLimit.Text);
    start = limit == 1 ? 1 : static_cast<int32_t>(static_cast<int64_t>(count) - limit + 1);
    if (start > count) start = count;
    if (start < 1) start = 1;
  }
  m.Detail.DetailStart = start;
}

int16_t NextDetailSegment(Molvar& m, int32_t i) {
  DetailState& d = m.Detail;
  const TrackStore& track = m.Track;
  const bool dayEnded = i > 1 && track.Exists(i - 1) && track[i - 1].DayCtr == 1;
  if (i == 1) {
    d.DetailDayNumber = 1;
    d.DetailSegmentNumber = 1;
  } else if (dayEnded) {
    ++d.DetailDayNumber;
  }
  if (i == 1) return 1;
  if (m.frmMain.chkCollapse.Checked()) {
    if (!dayEnded) return 0;
    d.DetailSegmentNumber = d.DetailDayNumber;
    return d.DetailSegmentNumber;
  }
  if (track.Exists(i) && track[i].Flag == 1) return ++d.DetailSegmentNumber;
  return 0;
}

void WriteDetailedData(Molvar& m) {
  if (m.OutputMode == kOutputGoogleMaps) return;
  auto& f = m.frmMain;
  try {
    OutputFile& out = m.Out;
    const std::string alpha = Hex2(m.TransparencyLevel);
    out.Line("<!--  Beginning of detailed data  -->");
    out.Line("<Document>");
    out.Line("<name>Details</name>");
    out.Line("<Style id=\"dot\">");
    out.Line("  <IconStyle>");
    if (f.chkHalfSize.Checked()) out.Line("  <scale>0.5</scale>");
    out.Line("  <color>" + alpha + "FFFFFF</color>");
    out.Line("    <Icon>");
    out.Line("    <href>root://icons/palette-4.png</href>");
    out.Line("      <x>32</x>");
    out.Line("      <y>128</y>");
    out.Line("      <w>32</w>");
    out.Line("      <h>32</h>");
    out.Line("    </Icon>");
    out.Line("  </IconStyle>");
    out.Line("  <BalloonStyle>");
    out.Line("   <text>&lt;b&gt;");
    out.Line("File " + MarkupText(m.OutputName) + " details");
    out.Line("&lt;/b&gt;&lt;br /&gt;$[description]</text>");
    out.Line("  </BalloonStyle>");
    out.Line("</Style>");
    out.Line("");
    out.Line("<Document>");
    out.Line("<name>Segment #" + IntToText(NextDetailSegment(m, 1)) + "</name>");

    DetailStartIndex(m);
    const bool threshold = f.chkUseThreshold.Checked();
    const int32_t limit = TextBoxInt(f.txtSpeedThreshold.Text);
    const TrackStore& track = m.Track;
    const int32_t count = track.StoredCount();
    // Each line is built in the output buffer itself: a point costs no allocation.
    std::string& line = out.Text();
    const auto endLine = [&out] { out.EndLine(); };
    for (int32_t i = m.Detail.DetailStart; i <= count; ++i) {
      const TrackPoint& p = track[i];
      const int16_t n = NextDetailSegment(m, i);
      line.append("<!--  Detailed data #");
      AppendInt(line, i);
      line.append("  -->");
      endLine();
      if (n > 0 && i > 1) {
        out.Line("</Document>");
        out.Line("");
        out.Line("<Document>");
        line.append("<name>Segment #");
        AppendInt(line, n);
        line.append("</name>");
        endLine();
      }
      out.Line("<Placemark>");
      line.append("  <description><![CDATA[Point no. ");
      AppendInt(line, i);
      endLine();
      const std::string_view time = p.DateTime.view();
      if (time != kNoTime) {
        if (Contains(time, "2006-01-01")) {
          line.append("  <br></br>Time: ");
          AppendMarkupCdata(line, Mid(time, 12));
        } else {
          line.append("  <br></br>");
          AppendMarkupCdata(line, time);
        }
        endLine();
      }
      line.append("  <br></br>Speed: ");
      AppendPattern(line, p.Speed * m.UnitFactor, 1, 1);
      line.append(m.SpeedUnitLabel);
      endLine();
      if (!p.PointText.view().empty()) {
        line.append("   <br></br>");
        AppendMarkupCdata(line, p.PointText.view());
        endLine();
      }
      line.append("  <br></br>Distance from start: ");
      AppendPattern(line, p.Distance * m.UnitFactor, 1, 2);
      line.append(m.DistanceUnitLabel);
      if (p.Altitude > 0) {
        endLine();
        line.append("  <br></br>Altitude: ");
        AppendPattern(line, p.Altitude * m.AltitudeFactor, 1, 0);
        line.append(m.AltitudeUnitLabel);
      }
      line.append("]]>");
      endLine();
      if (m.ColorVaryMode == 3 && m.TrackFileType != 8) {
        if (p.ColorBand >= 0 && p.ColorBand <= 9) {
          line.append("    <br></br>GPS quality: ");
          line.append(kQuality[static_cast<std::size_t>(p.ColorBand)]);
          endLine();
        }
        line.append(" (");
        AppendInt(line, p.ColorBand);
        line.append(")");
        endLine();
      }
      out.Line("  </description>");
      out.Line("  <styleUrl>#dot</styleUrl>");
      if (threshold && limit > 0) {
        const double shown = Val(FormatPattern(p.Speed * m.UnitFactor, "0.0"));
        if (p.Speed == 0) WriteKmlStyle(m, 3);
        else if (shown > limit) WriteKmlStyle(m, shown > limit + 10.0 ? 1 : 7);
      }
      if (m.TrackFileType == 4 && p.ColorBand > 0) WriteKmlStyle(m, p.ColorBand);
      out.Line("  <Point>");
      InsertAltitudeMode(m, p.Altitude);
      line.append("    <coordinates>");
      AppendKmlCoordinate(m, p, line);
      line.append("</coordinates>");
      endLine();
      out.Line("  </Point>");
      out.Line("</Placemark>");
      out.Line("");
    }
    out.Line("</Document>");
    out.Line("</Document>");
    out.Line("<!--  End of detailed data  -->");
    out.Line("");
    out.Line("");
  } catch (const std::exception& e) {
    ShowBug(m, "WriteDetailedData", e);
  }
}

}  // namespace molvar
