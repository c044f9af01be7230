#include "input/XmlTracks.h"

#include <array>
#include <bit>
#include <cstdint>

#include "app/Molvar.h"
#include "core/DateTime.h"
#include "core/Numbers.h"
#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "input/ReaderCommon.h"

namespace molvar {

namespace {

struct ValueTag {
  std::string_view open;   // found in any letter case
  std::string_view close;  // closing mark of the value; empty for an attribute
};

enum MarkupTag { kSegmentTag, kStartTag, kEndTag, kLatTag, kLonTag, kEleTag, kNameTag, kCmtTag,
                 kDescTag, kTimeTag, kMarkupTagCount };
// The lower-case opening marks looked for on each line, by MarkupTag; empty ones are not wanted.
using TagMarks = std::array<std::string_view, kMarkupTagCount>;
// Where each tag of one line first opens (0-based; npos when absent).
using TagPlaces = std::array<std::size_t, kMarkupTagCount>;

struct MarkupVocabulary {
  const char* procedure;
  std::string_view segment;
  std::string_view trackStart;
  std::string_view trackEnd;
  std::string_view waypointStart;
  std::string_view waypointEnd;
  ValueTag lat, lon, ele, name, cmt, desc, time;

  // Waypoint files have no segments.
  constexpr TagMarks Marks(bool waypoints) const {
    return {waypoints ? std::string_view{} : segment, waypoints ? waypointStart : trackStart,
            waypoints ? waypointEnd : trackEnd, lat.open, lon.open, ele.open, name.open, cmt.open,
            desc.open, time.open};
  }
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

// The marks of one reading, with the tags that open with "<" indexed by the (lower-case)
// character after it, so a "<" on the line is compared with the few tags it can begin.
struct TagIndex {
  TagMarks marks;
  std::array<uint16_t, 256> bySecondChar{};  // bit t: tag t
  uint16_t angleTags = 0;
};

constexpr TagIndex IndexTags(const TagMarks& marks) {
  TagIndex index{marks};
  for (std::size_t t = 0; t < kMarkupTagCount; ++t) {
    const std::string_view mark = marks[t];
    if (mark.size() < 2 || mark.front() != '<') continue;
    const auto bit = static_cast<uint16_t>(1U << t);
    index.angleTags |= bit;
    index.bySecondChar[static_cast<unsigned char>(mark[1])] |= bit;
  }
  return index;
}

// For tracks [0] and waypoints [1].
constexpr std::array<TagIndex, 2> kGpxMarks = {IndexTags(kGpx.Marks(false)), IndexTags(kGpx.Marks(true))};
constexpr std::array<TagIndex, 2> kXmlMarks = {IndexTags(kXml.Marks(false)), IndexTags(kXml.Marks(true))};


// The tags that open with "<" are all found in one pass over the line's "<" characters; the
// others (the GPX attributes) are searched on their own.
bool OpensAt(std::string_view line, std::size_t at, std::string_view mark) {
  if (mark.size() > line.size() - at) return false;
  for (std::size_t k = 1; k < mark.size(); ++k) {
    if (LowerChar(line[at + k]) != mark[k]) return false;
  }
  return true;
}

TagPlaces FindTags(std::string_view line, const TagIndex& index) {
  TagPlaces place;
  place.fill(std::string_view::npos);
  const TagMarks& marks = index.marks;
  const bool hasEquals = line.find('=') != std::string_view::npos;  // every attribute mark holds one
  for (std::size_t t = 0; t < kMarkupTagCount; ++t) {
    const std::string_view mark = marks[t];
    if (mark.empty() || (index.angleTags >> t & 1U) != 0) continue;
    if (!hasEquals && mark.find('=') != std::string_view::npos) continue;
    const long p = InStrNoCase(line, mark);
    if (p != 0) place[t] = static_cast<std::size_t>(p - 1);
  }
  unsigned wanted = index.angleTags;  // not found yet
  for (std::size_t at = line.find('<'); wanted != 0 && at != std::string_view::npos && at + 1 < line.size();
       at = line.find('<', at + 1)) {
    unsigned candidates = index.bySecondChar[static_cast<unsigned char>(LowerChar(line[at + 1]))] & wanted;
    while (candidates != 0) {
      const auto t = static_cast<std::size_t>(std::countr_zero(candidates));
      candidates &= candidates - 1;
      if (OpensAt(line, at, marks[t])) {
        place[t] = at;
        wanted &= ~(1U << t);
      }
    }
  }
  return place;
}

// The value of the tag opening at `at` with `tag.open`, cut before its closing mark (the rest of
// the line when the mark is not on it).
void TagValue(std::string_view line, std::size_t at, const ValueTag& tag, std::string& value) {
  if (at == std::string_view::npos) return;
  const long start = static_cast<long>(at + tag.open.size()) + 1;
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
                    const std::array<TagIndex, 2>& marks, std::string_view line) {
  if (line.empty()) return;
  try {
    const bool waypoints = m.ProgramMode == kModeConvertWaypoints;
    const TagPlaces place = FindTags(line, marks[waypoints ? 1 : 0]);
    const auto has = [&place](MarkupTag t) { return place[t] != std::string_view::npos; };
    if (has(kSegmentTag)) s.NewSegment = true;
    if (has(kStartTag)) s.InPoint = true;
    if (s.InPoint) {
      TagValue(line, place[kLatTag], tags.lat, s.lat);
      TagValue(line, place[kLonTag], tags.lon, s.lon);
      TagValue(line, place[kEleTag], tags.ele, s.ele);
      TagValue(line, place[kNameTag], tags.name, s.name);
      TagValue(line, place[kCmtTag], tags.cmt, s.cmt);
      TagValue(line, place[kDescTag], tags.desc, s.desc);
      TagValue(line, place[kTimeTag], tags.time, s.time);
    }
    if (has(kEndTag)) s.EndPoint = true;
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

void ReadGpxLine(Molvar& m, std::string_view line) { ReadMarkupLine(m, m.GpxReader, kGpx, kGpxMarks, line); }

void ReadXmlLine(Molvar& m, std::string_view line) { ReadMarkupLine(m, m.XmlReader, kXml, kXmlMarks, line); }

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
