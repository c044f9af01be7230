#include "input/XmlTracks.h"

#include <array>

#include "app/Molvar.h"
#include "core/DateTime.h"
#include "core/Numbers.h"
#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "input/ReaderCommon.h"

namespace molvar {

namespace {

struct ValueTag {
  std::string_view open;   // searched in the lower-cased line
  std::string_view close;  // closing mark of the value; empty for an attribute
};

struct MarkupVocabulary {
  const char* procedure;
  std::string_view segment;
  std::string_view trackStart;
  std::string_view trackEnd;
  std::string_view waypointStart;
  std::string_view waypointEnd;
  ValueTag lat, lon, ele, name, cmt, desc, time;
};

constexpr MarkupVocabulary kGpx{
    "ReadGpxLine", "<trkseg>", "<trkpt", "</trkpt>", "<wpt", "</wpt>",
    {"lat=", {}}, {"lon=", {}}, {"<ele>", "</ele>"}, {"<name>", "</name>"},
    {"<cmt>", "</cmt>"}, {"<desc>", "</desc>"}, {"<time>", "</time>"}};

constexpr MarkupVocabulary kXml{
    "ReadXmlLine", "<track>", "<trackpoint>", "</trackpoint>", "<waypoint", "</waypoint>",
    {"<latitude>", "</latitude>"}, {"<longitude>", "</longitude>"},
    {"<altitude>", "</altitude>"}, {"<name>", "</name>"}, {"<comment>", "</comment>"},
    {"<description>", "</description>"}, {"<time>", "</time>"}};

// The value of `tag` on the line, cut before its closing mark (the rest of the line when the
// mark is not on it); false when the tag is absent.
bool TagValue(std::string_view line, std::string_view lower, const ValueTag& tag,
              std::string& value) {
  const long p = InStr(lower, tag.open);
  if (p == 0) return false;
  const long start = p + static_cast<long>(tag.open.size());
  std::string_view v;
  if (tag.close.empty()) {
    // Attribute: the quote after "=" is skipped and the value ends at the matching quote.
    const std::string_view quote = Mid(line, start, 1) == "'" ? "'" : "\"";
    v = Mid(line, start + 1);
    const long end = InStr(v, quote);
    if (end > 0) v = Left(v, end - 1);
  } else {
    v = Mid(line, start);
    const long end = InStrNoCase(v, tag.close);
    if (end > 0) v = Left(v, end - 1);
  }
  value.assign(v);
  return true;
}

// The whole text as a rounded whole number; 0 when it is not a number or out of range.
int32_t WholeNumberOr0(std::string_view text) {
  double v = 0;
  return TryParseNumber(text, v) ? RoundToInt32Or(v, 0) : 0;
}

void StoreTrackPoint(Molvar& m, MarkupReaderState& s) {
  TrackPoint& p = AppendTrackPoint(m);
  p.Flag = s.NewSegment ? 1 : 0;
  p.Latitude = Val(s.lat);
  p.Longitude = Val(s.lon);
  if (!s.time.empty()) p.DateTime = IsoTimeToTimestamp(s.time, m.GmtMinutes);
  p.Altitude = WholeNumberOr0(s.ele.empty() ? std::string_view("0") : std::string_view(s.ele));
  CalcSpeedDistance(m, m.Track.PointCount);
  if (m.ColorVaryMode == 3) AssignSpeedBand(m, m.Track.PointCount);
}

void StoreWaypoint(Molvar& m, MarkupReaderState& s) {
  Waypoint& w = m.Waypoints.Add();
  w.WptLatitude = Val(s.lat);
  w.WptLongitude = Val(s.lon);
  w.WptAltitude = RoundToInt32Or(Val(s.ele), 0);
  w.WptName = s.name;
  w.WptComment = s.cmt;
  w.WptDescription = s.desc;
  // Only the label text loses its CDATA wrapper.
  std::string& text = w.Label(m.PlacemarkLabelSource);
  text = StripCdata(text);
  WriteWaypointPlacemark(m, text, w.WptLongitude, w.WptLatitude, w.WptAltitude);
}

void ReadMarkupLine(Molvar& m, MarkupReaderState& s, const MarkupVocabulary& tags,
                    std::string_view line) {
  if (line.empty()) return;
  try {
    const bool waypoints = m.ProgramMode == kModeConvertWaypoints;
    const std::string lower = LCase(line);
    if (!waypoints && Contains(lower, tags.segment)) s.NewSegment = true;
    if (Contains(lower, waypoints ? tags.waypointStart : tags.trackStart)) s.InPoint = true;
    if (s.InPoint) {
      TagValue(line, lower, tags.lat, s.lat);
      TagValue(line, lower, tags.lon, s.lon);
      TagValue(line, lower, tags.ele, s.ele);
      TagValue(line, lower, tags.name, s.name);
      TagValue(line, lower, tags.cmt, s.cmt);
      TagValue(line, lower, tags.desc, s.desc);
      TagValue(line, lower, tags.time, s.time);
    }
    if (Contains(lower, waypoints ? tags.waypointEnd : tags.trackEnd)) s.EndPoint = true;
    if (!s.EndPoint) return;
    // An end tag without its start tag ends nothing.
    if (s.InPoint) {
      if (waypoints) {
        StoreWaypoint(m, s);
      } else {
        StoreTrackPoint(m, s);
      }
    }
    s.Reset();
  } catch (const std::exception& e) {
    s.Reset();
    ShowSnag(m, tags.procedure, e);
  }
}

bool IsWhite(char c) { return c == ' ' || c == '\t' || c == '\r' || c == '\n'; }

std::string_view TrimWhite(std::string_view s) {
  while (!s.empty() && IsWhite(s.front())) s.remove_prefix(1);
  while (!s.empty() && IsWhite(s.back())) s.remove_suffix(1);
  return s;
}

struct KmlTuple {
  double longitude = 0;
  double latitude = 0;
  int32_t altitude = 0;
};

// A tuple with a real position; false for anything else (white space only, words).
bool ParseKmlTuple(const std::array<std::string_view, 3>& field, KmlTuple& tuple) {
  if (!TryParseNumber(TrimWhite(field[0]), tuple.longitude)) return false;
  if (!TryParseNumber(TrimWhite(field[1]), tuple.latitude)) return false;
  tuple.altitude = WholeNumberOr0(TrimWhite(field[2]));
  return true;
}

void StoreKmlTuple(Molvar& m, const KmlTuple& tuple) {
  TrackPoint& p = AppendTrackPoint(m);
  p.Longitude = tuple.longitude;
  p.Latitude = tuple.latitude;
  p.Altitude = tuple.altitude;
  CalcSpeedDistance(m, m.Track.PointCount);
}

// Calls `take` for each "lon,lat,alt" tuple of the line. A comma moves to the next field and, after
// the altitude, ends the tuple; white space after a value ends it too unless a comma comes next
// (blanks around the commas of one tuple). One pass, so no line is too long for it.
template <typename Take>
void SplitKmlTuples(std::string_view line, Take take) {
  std::array<std::string_view, 3> field{};
  std::size_t index = 0;       // field being collected
  std::size_t fieldStart = 0;
  bool tupleHasValue = false;  // a character other than white space since the tuple began
  bool fieldHasValue = false;
  bool gap = false;            // white space after a value
  auto closeTuple = [&](std::size_t end) {
    field[index] = line.substr(fieldStart, end - fieldStart);
    if (tupleHasValue) take(field);
    field = {};
    index = 0;
    tupleHasValue = fieldHasValue = gap = false;
  };
  for (std::size_t i = 0; i < line.size(); ++i) {
    const char c = line[i];
    if (c == ',') {
      gap = false;
      if (index == 2) {
        closeTuple(i);
      } else {
        field[index] = line.substr(fieldStart, i - fieldStart);
        ++index;
        fieldHasValue = false;
      }
      fieldStart = i + 1;
    } else if (IsWhite(c)) {
      if (fieldHasValue) gap = true;
    } else {
      if (gap) {
        closeTuple(i);
        fieldStart = i;
      }
      tupleHasValue = fieldHasValue = true;
    }
  }
  closeTuple(line.size());
}

}  // namespace

void ReadGpxLine(Molvar& m, std::string_view line) { ReadMarkupLine(m, m.GpxReader, kGpx, line); }

void ReadXmlLine(Molvar& m, std::string_view line) { ReadMarkupLine(m, m.XmlReader, kXml, line); }

void ReadKmlCoordinateLine(Molvar& m, std::string_view line) {
  if (line.empty() || Contains(line, "<")) return;
  try {
    // Each point is stored when the next one is found: the driver bands the last point a line
    // adds, the others are banded here.
    bool pending = false;
    KmlTuple last;
    SplitKmlTuples(line, [&](const std::array<std::string_view, 3>& field) {
      KmlTuple tuple;
      if (!ParseKmlTuple(field, tuple)) return;
      if (pending) {
        StoreKmlTuple(m, last);
        if (m.ColorVaryMode == 3) AssignSpeedBand(m, m.Track.PointCount);
      }
      last = tuple;
      pending = true;
    });
    if (pending) StoreKmlTuple(m, last);
  } catch (const std::exception& e) {
    ShowSnag(m, "ReadKmlCoordinateLine", e);
  }
}

std::string StripCdata(std::string_view text) {
  constexpr std::string_view kOpen = "<![CDATA[";
  const long p = InStr(UCase(text), kOpen);
  if (p == 0) return std::string(text);
  std::string_view inner = Mid(text, p + static_cast<long>(kOpen.size()));
  const long end = InStr(inner, "]]>");
  if (end > 0) inner = Left(inner, end - 1);
  return std::string(inner);
}

}  // namespace molvar
