#include "output/Gpx.h"

#include "app/Molvar.h"
#include "core/DateTime.h"
#include "core/Markup.h"
#include "core/Numbers.h"
#include "output/kml/KmlFrame.h"
#include "output/kml/Segments.h"

namespace molvar {
namespace {

// The host is the format's owner; the paths are the ones GPX 1.0 readers know.
constexpr const char* kGpxNamespace = "http://www.topografix.com/GPX/1/0";
constexpr const char* kXsiNamespace = "http://www.w3.org/2001/XMLSchema-instance";
constexpr MarkupEncoding kGpxEncoding = MarkupEncoding::Latin1;

// Every track goes into one trk, the only place GPX allows segments (peers read nothing else);
// only a track conversion also writes the time and bounds.
bool InTrackElement(const Molvar& m) { return m.ProgramMode != kModeConvertWaypoints; }

// ` lat="…" lon="…">` closing a trkpt or wpt start tag.
void AppendLatLon(std::string& line, double latitude, double longitude) {
  line.append(" lat=\"");
  AppendDouble(line, latitude);
  line.append("\" lon=\"");
  AppendDouble(line, longitude);
  line.append("\">");
}

void CdataLine(OutputFile& out, std::string_view element, std::string_view text) {
  out.Line("  <" + std::string(element) + "><![CDATA[" + MarkupCdata(text, kGpxEncoding) + "]]></" +
           std::string(element) + ">");
}

}  // namespace

bool AppendGpxTime(std::string& out, const Molvar& m, std::string_view timestamp) {
  const auto local = ParseDateTime(timestamp);
  if (!local) return false;
  const TimeSeconds utc = *local - static_cast<TimeSeconds>(m.GmtMinutes) * 60;
  if (!InDateRange(utc)) return false;
  AppendIsoUtc(out, utc);
  return true;
}

std::string GpxTime(const Molvar& m, std::string_view timestamp) {
  std::string out;
  AppendGpxTime(out, m, timestamp);
  return out;
}

void GpxBounds(Molvar& m) {
  GpxState& b = m.Gpx;
  b.GpxMinLat = 180;
  b.GpxMinLon = 180;
  b.GpxMaxLat = -180;
  b.GpxMaxLon = -180;
  const TrackStore& track = m.Track;
  const int32_t count = track.StoredCount();
  for (int32_t i = 1; i <= count; ++i) {
    const TrackPoint& p = track[i];
    if (p.Latitude < b.GpxMinLat) b.GpxMinLat = p.Latitude;
    if (p.Longitude < b.GpxMinLon) b.GpxMinLon = p.Longitude;
    if (p.Latitude > b.GpxMaxLat) b.GpxMaxLat = p.Latitude;
    if (p.Longitude > b.GpxMaxLon) b.GpxMaxLon = p.Longitude;
  }
}

void WriteGpxHeader(Molvar& m) {
  const bool track = m.ProgramMode == kModeConvertTracks;
  if (track) GpxBounds(m);
  OutputFile& out = m.Out;
  out.Open(m.OutputPath);
  out.Line("<?xml version=\"1.0\" encoding=\"ISO-8859-1\" standalone=\"yes\"?>");
  out.Line(std::string("<gpx creator=\"Molvar\" version=\"1.0\" xmlns=\"") + kGpxNamespace + "\" xmlns:xsi=\"" +
           kXsiNamespace + "\" xsi:schemaLocation=\"" + kGpxNamespace + " " + kGpxNamespace + "/gpx.xsd\">");
  if (track) {
    // A first point without a readable time leaves the optional time element out.
    const std::string time = m.Track.StoredCount() >= 1 ? GpxTime(m, m.Track[1].DateTime.view()) : std::string();
    if (!time.empty()) out.Line("<time>" + time + "</time>");
    const GpxState& b = m.Gpx;
    out.Line("<bounds minlat=\"" + DoubleToText(b.GpxMinLat) + "\" minlon=\"" + DoubleToText(b.GpxMinLon) +
             "\" maxlat=\"" + DoubleToText(b.GpxMaxLat) + "\" maxlon=\"" + DoubleToText(b.GpxMaxLon) + "\"/>");
  }
  if (InTrackElement(m)) out.Line("<trk>");
  out.Line("<name>" + MarkupText(GetTrackTitle(m), kGpxEncoding) + "</name>");
  out.Line("");
}

void WriteGpxSegment(Molvar& m, int32_t startIndex, int32_t count) {
  if (count < 2) return;
  OutputFile& out = m.Out;
  const TrackStore& track = m.Track;
  out.Line("<!--  Write segment number " + IntToText(m.Kml.SegmentCount) + "  -->");
  out.Line("<trkseg>");
  const int64_t end = static_cast<int64_t>(startIndex) + count - 1;
  const int32_t last = track.StoredCount();
  for (int64_t i64 = startIndex < 1 ? 1 : startIndex; i64 <= end && i64 <= last; ++i64) {
    const TrackPoint& p = track[static_cast<int32_t>(i64)];
    std::string& line = out.Text();
    line.append("  <trkpt");
    AppendLatLon(line, p.Latitude, p.Longitude);
    out.EndLine();
    line.append("    <ele>");
    AppendInt(line, p.Altitude);
    line.append("</ele>");
    out.EndLine();
    const std::size_t before = line.size();
    line.append("    <time>");
    if (AppendGpxTime(line, m, p.DateTime.view())) {
      line.append("</time>");
      out.EndLine();
    } else {
      line.resize(before);  // no time element for a point without a readable time
    }
    out.Line("  </trkpt>");
  }
  out.Line("</trkseg>");
  out.Line("");
}

void WriteGpxSegments(Molvar& m) {
  ForEachSegment(m, [&m](int32_t start, int32_t count) { WriteGpxSegment(m, start, count); });
}

void WriteGpxWaypoint(Molvar& m, int32_t k) {
  const Waypoint& w = m.Waypoints.at(k);
  OutputFile& out = m.Out;
  std::string& line = out.Text();
  line.append("<wpt");
  AppendLatLon(line, w.WptLatitude, w.WptLongitude);
  out.EndLine();
  CdataLine(out, "name", w.WptName);
  CdataLine(out, "cmt", w.WptComment);
  CdataLine(out, "desc", w.WptDescription);
  out.Line("  <sym></sym>");
  out.Line("  <type><![CDATA[]]></type>");
  out.Line("</wpt>");
  out.Line("");
}

void WriteGpxFooter(Molvar& m) {
  OutputFile& out = m.Out;
  if (InTrackElement(m)) out.Line("</trk>");
  out.Line("</gpx>");
  out.Close();
  m.frmMain.txtInfo.Text += " Output: " + m.OutputName;
}

}  // namespace molvar
