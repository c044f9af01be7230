#pragma once
// What the line readers keep between the lines of one file.
#include <cstdint>
#include <initializer_list>
#include <string>

namespace molvar {

struct OziTrackState {
  int32_t LastGoodAltitude = 0;
};

struct TextReaderState {
  int16_t Csv1TimestampWarned = 0;
  int16_t Csv2TimestampWarned = 0;
  int16_t KelTimestampWarned = 0;
};

// The GPX and XML readers each keep one of these.
struct MarkupReaderState {
  bool InPoint = false;
  bool EndPoint = false;
  bool NewSegment = false;
  std::string lat, lon, ele, time, name, cmt, desc;
  // Keeps the strings' storage: a point's texts need no allocation once the first is read.
  void Reset() {
    InPoint = EndPoint = NewSegment = false;
    for (std::string* text : {&lat, &lon, &ele, &time, &name, &cmt, &desc}) text->clear();
  }
};

struct NmeaParserState {
  int16_t LastFixQuality = 0;
  int32_t PreviousAltitude = 0;
  // Set by the APRS web lookup while it reads a track page: each accepted sentence becomes a point.
  int16_t AprsWebAddsPoints = 0;
};

}  // namespace molvar
