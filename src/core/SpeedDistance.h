#pragma once
// Cumulative distance and speed of each stored point, speed bands, and the passes that mark days,
// segments and the fastest point before a track is written.
#include <cstdint>
#include <string>

#include "core/DateTime.h"

namespace molvar {

struct Molvar;

inline constexpr double kPi = 3.14159265358979;
inline constexpr double kKmPerDegree = 111.19892;
inline constexpr double kMphPerKmh = 0.6213712;
inline constexpr double kKnotsPerKmh = 0.5399568;

// One parsed timestamp remembered, since consecutive calls read the same text twice.
struct ParsedTimeCache {
  std::string text;
  std::optional<TimeSeconds> value;
  bool valid = false;
  std::optional<TimeSeconds> Parse(std::string_view t);
};

struct SpeedState {
  int16_t LastBand = 0;
  int32_t FastestIndex = 0;
  ParsedTimeCache previousTime;
  ParsedTimeCache currentTime;
};

void CalcSpeedDistance(Molvar& m, int32_t n);
void AssignSpeedBand(Molvar& m, int32_t n);
void MarkDays(Molvar& m);
void MarkSegments(Molvar& m);
int32_t FindFastestPoint(const Molvar& m);

}  // namespace molvar
