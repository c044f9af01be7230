#include "output/kml/Segments.h"

#include "app/Molvar.h"
#include "core/Markup.h"
#include "core/Numbers.h"
#include "core/Text.h"
#include "output/kml/KmlFrame.h"

namespace molvar {

void ForEachSegment(Molvar& m, const std::function<void(int32_t, int32_t)>& segment) {
  KmlState& k = m.Kml;
  const TrackStore& track = m.Track;
  const bool collapsed = m.frmMain.chkCollapse.Checked();
  const int32_t count = track.StoredCount();
  for (int32_t i = 1; i <= count; ++i) {
    const bool dayEnded = i > 1 && track[i - 1].DayCtr == 1;
    if (i == 1) {
      k.DayCount = 1;
      k.SegmentCount = 1;
    } else if (dayEnded) {
      ++k.DayCount;
    }
    if (!collapsed) {
      k.CurrentPoint = i;
      if (i == 1 || track[i].Flag == 1) {
        if (i > 1) ++k.SegmentCount;
        segment(i, track[i].SegCtr);
      }
    } else if (i == 1 || dayEnded) {
      if (i > 1) k.SegmentCount = k.DayCount;
      segment(i, track[i].DayCtr);
    }
  }
}

void WriteKmlSegments(Molvar& m) {
  ForEachSegment(m, [&m](int32_t start, int32_t count) { WriteKmlTrackSegment(m, start, count); });
}

std::string SegmentTitle(Molvar& m, int32_t startIndex) {
  const TrackPoint& p = m.Track.at(startIndex);
  std::string name = "#" + IntToText(m.Kml.SegmentCount) + " " + std::string(Mid(p.DateTime.view(), 12)) + " (" +
                     IntToText(m.frmMain.chkCollapse.Checked() ? p.DayCtr : p.SegCtr) + ")";
  if (m.OutputMode == kOutputGoogleMaps) {
    name = m.platform.InputBox("Overwrite the segment title for Google Maps if you wish...", "Track title", name);
  }
  return name;
}

int16_t VaryColorPtr(Molvar& m, int16_t selector) {
  long result = 0;
  if (selector > 0) {
    result = selector - 1;
  } else {
    switch (m.ColorVaryMode) {
      case 1: result = (m.Kml.SegmentCount - 1L + m.UserColorPointer) % 10; break;
      case 2: result = (m.Kml.DayCount - 1L + m.UserColorPointer) % 10; break;
      case 3: {
        const int32_t next = m.Kml.CurrentPoint + 1;
        // A one-point track has no following point; its own band stands in.
        const int32_t k = m.Track.Exists(next) ? next : m.Kml.CurrentPoint;
        result = m.Track.Exists(k) ? m.Track[k].ColorBand : 0;
        break;
      }
      default: result = m.UserColorPointer; break;
    }
  }
  if (result < 0 || result > 9) {
    m.platform.MsgBox("VaryColorPtr out of range: \r\n" + IntToText(result), " Error!", MsgButtons::OK,
                      MsgIcon::Exclamation);
    result = 0;
  }
  return static_cast<int16_t>(result);
}

std::string TrackColorString(Molvar& m, int16_t selector, int16_t entry) {
  int16_t index = 0;
  if (m.ColorVaryMode == 3 || selector <= 0) {
    index = VaryColorPtr(m, 0);
  } else {
    index = entry >= 0 && entry <= 9 ? entry : VaryColorPtr(m, entry + 1);
  }
  return Hex2(m.TransparencyLevel) + m.ColorTable[static_cast<std::size_t>(index)];
}

void WriteKmlStyle(Molvar& m, int16_t selector) {
  OutputFile& out = m.Out;
  out.Line("  <Style>");
  if (m.OutputMode == kOutputGoogleEarth) {
    out.Line("    <IconStyle>");
    if (m.frmMain.chkHalfSize.Checked()) out.Line("      <scale>0.5</scale>");
    out.Line("      <Icon><href>" + MarkupText(m.ProgramPath("Icons/" + IntToText(VaryColorPtr(m, selector)) + ".png")) +
             "</href></Icon>");
    out.Line("    </IconStyle>");
  }
  const std::string colour = TrackColorString(m, selector, 0);
  out.Line("    <LineStyle>");
  out.Line("      <color>" + colour + "</color>");
  out.Line("      <width>" + IntToText(m.frmMain.sldrWidth.Value) + "</width>");
  out.Line("    </LineStyle>");
  if (m.AltitudeMode == 2 || m.AltitudeMode == 3) {
    out.Line("    <PolyStyle id=\"khPolyStyle566\"> <color>" + colour + "</color> </PolyStyle>");
  }
  out.Line("  </Style>");
}

void AppendKmlCoordinate(const Molvar& m, const TrackPoint& p, std::string& line) {
  AppendDouble(line, p.Longitude);
  line.push_back(',');
  AppendDouble(line, p.Latitude);
  line.push_back(',');
  if (m.AltitudeMode == 3) {
    AppendDouble(line, m.SpeedGain * p.Speed);
  } else {
    AppendInt(line, p.Altitude);
  }
}

void WriteKmlTrackSegment(Molvar& m, int32_t startIndex, int32_t count) {
  try {
    OutputFile& out = m.Out;
    const TrackStore& track = m.Track;
    out.Line("<!--  Write segment number " + IntToText(m.Kml.SegmentCount) + "  -->");
    out.Line("<Placemark>");
    out.Line("  <name>" + MarkupText(SegmentTitle(m, startIndex)) + "</name>");
    if (m.OutputMode == kOutputGoogleEarth) out.Line("  <styleUrl>root://styles#default</styleUrl>");
    WriteKmlStyle(m, 0);
    out.Line("  <LineString>");
    InsertAltitudeMode(m, track.at(startIndex).Altitude);
    out.Line("    <coordinates>");
    const int64_t end = static_cast<int64_t>(startIndex) + count;
    const int32_t last = track.StoredCount();
    for (int64_t j64 = startIndex; j64 <= end && j64 <= last; ++j64) {
      const TrackPoint& p = track[static_cast<int32_t>(j64)];
      std::string& line = out.Text();
      line.append("    ");
      AppendKmlCoordinate(m, p, line);
      line.push_back(' ');
      out.EndLine();
    }
    out.Line("    </coordinates>");
    out.Line("  </LineString>");
    out.Line("</Placemark>");
    out.Line("");
  } catch (const std::exception& e) {
    ShowBug(m, "WriteKmlTrackSegment", e);
  }
}

}  // namespace molvar
