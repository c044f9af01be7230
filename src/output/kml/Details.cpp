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
    for (int32_t i = m.Detail.DetailStart; i <= count; ++i) {
      const TrackPoint& p = track[i];
      const int16_t n = NextDetailSegment(m, i);
      out.Line("<!--  Detailed data #" + IntToText(i) + "  -->");
      if (n > 0 && i > 1) {
        out.Line("</Document>");
        out.Line("");
        out.Line("<Document>");
        out.Line("<name>Segment #" + IntToText(n) + "</name>");
      }
      out.Line("<Placemark>");
      out.Line("  <description><![CDATA[Point no. " + IntToText(i));
      const std::string_view time = p.DateTime.view();
      if (time != kNoTime) {
        if (Contains(time, "2006-01-01")) out.Line("  <br></br>Time: " + MarkupCdata(Mid(time, 12)));
        else out.Line("  <br></br>" + MarkupCdata(time));
      }
      out.Line("  <br></br>Speed: " + FormatPattern(p.Speed * m.UnitFactor, "0.0") + m.SpeedUnitLabel);
      if (!p.PointText.view().empty()) out.Line("   <br></br>" + MarkupCdata(p.PointText.view()));
      const std::string distance =
          "  <br></br>Distance from start: " + FormatPattern(p.Distance * m.UnitFactor, "0.00") + m.DistanceUnitLabel;
      if (p.Altitude > 0) {
        out.Line(distance);
        out.Line("  <br></br>Altitude: " + FormatPattern(p.Altitude * m.AltitudeFactor, "0") + m.AltitudeUnitLabel +
                 "]]>");
      } else {
        out.Line(distance + "]]>");
      }
      if (m.ColorVaryMode == 3 && m.TrackFileType != 8) {
        if (p.ColorBand >= 0 && p.ColorBand <= 9) {
          out.Line(std::string("    <br></br>GPS quality: ") + kQuality[static_cast<std::size_t>(p.ColorBand)]);
        }
        out.Line(" (" + IntToText(p.ColorBand) + ")");
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
      std::string& line = out.Text();
      line.append("    <coordinates>");
      AppendKmlCoordinate(m, p, line);
      line.append("</coordinates>");
      out.EndLine();
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
