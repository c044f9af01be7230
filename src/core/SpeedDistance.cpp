#include "core/SpeedDistance.h"

#include <cmath>

#include "app/Molvar.h"
#include "core/Numbers.h"
#include "core/Text.h"

namespace molvar {

std::optional<TimeSeconds> ParsedTimeCache::Parse(std::string_view t) {
  if (!valid || text != t) {
    text.assign(t);
    value = ParseDateTime(t);
    valid = true;
  }
  return value;
}

namespace {

bool HasUsableTime(std::string_view t) { return !t.empty() && t != kDefaultTimestamp; }

bool SourceCarriesSpeed(const Molvar& m) {
  if (m.ProgramMode == kModeConvertTracks && (m.TrackFileType == 4 || m.TrackFileType == 5)) return true;
  return m.ProgramMode == kModeRealTimeNmea;
}

// The day key: the text before the first blank; `fallback` when there is none.
std::string_view DayKey(std::string_view dateTime, std::string_view fallback) {
  const auto p = dateTime.find(' ');
  return p == std::string_view::npos ? fallback : dateTime.substr(0, p);
}

constexpr std::string_view kNoTimeDay = "2006-01-01";

}  // namespace

void CalcSpeedDistance(Molvar& m, int32_t n) {
  try {
    TrackStore& track = m.Track;
    TrackPoint& p2 = track.at(n);
    if (n == 1) {
      p2.Speed = 0;
      p2.Distance = 0;
      return;
    }
    const TrackPoint& p1 = track.at(n - 1);
    if (p1.Latitude == 0 || p1.Longitude == 0 || p2.Latitude == 0 || p2.Longitude == 0) return;
    const double toRadians = kPi / 180;
    const double lat1 = p1.Latitude * toRadians;
    const double lat2 = p2.Latitude * toRadians;
    const double lon1 = p1.Longitude * toRadians;
    const double lon2 = p2.Longitude * toRadians;
    const double mid = (lat1 + lat2) / 2;
    const double dx = (lon2 - lon1) * std::cos(mid);
    const double dy = lat2 - lat1;
    const double d = std::sqrt(dx * dx + dy * dy) * 180 / kPi * kKmPerDegree;
    p2.Distance = RoundAtDecimals(d + p1.Distance, 7);
    if (p2.Speed > 0) return;
    if (SourceCarriesSpeed(m)) return;
    if (!HasUsableTime(p1.DateTime) || !HasUsableTime(p2.DateTime)) {
      p2.Speed = 0;
      return;
    }
    // Consecutive calls read the same text twice: the new point becomes the previous one.
    std::swap(m.Speed.previousTime, m.Speed.currentTime);
    const auto t1 = m.Speed.previousTime.Parse(p1.DateTime.view());
    const auto t2 = m.Speed.currentTime.Parse(p2.DateTime.view());
    if (!t1 || !t2) throw RuntimeError(kErrTypeMismatch);
    const auto t = *t2 - *t1;
    if (t == 0) {
      p2.Speed = 0;
      return;
    }
    p2.Speed = RoundAtDecimals(d / static_cast<double>(t) * 3600, 0);
  } catch (const std::exception& e) {
    ShowSnag(m, "CalcSpeedDistance", e, MsgIcon::Critical);
  }
}

void AssignSpeedBand(Molvar& m, int32_t n) {
  TrackPoint& p = m.Track.at(n);
  double s = p.Speed;
  if (m.SpeedUnits == 1) s *= kMphPerKmh;
  if (m.SpeedUnits == 2) s *= kKnotsPerKmh;
  int16_t band = 9;
  for (int16_t b = 0; b < 9; ++b) {
    if (s < 10.0 * (b + 1)) {
      band = b;
      break;
    }
  }
  p.ColorBand = band;
  if (n != 1 && band == m.Speed.LastBand) {
    p.Flag = 0;
  } else {
    p.Flag = 1;
    m.Speed.LastBand = band;
  }
}

void MarkDays(Molvar& m) {
  TrackStore& track = m.Track;
  const int32_t count = track.StoredCount();
  if (count < 1) return;
  std::string_view prev = DayKey(track[count].DateTime.view(), std::string_view{});
  int32_t counter = 1;
  for (int32_t i = count; i >= 1; --i) {
    const std::string_view day = DayKey(track[i].DateTime.view(), prev);
    if (day != kNoTimeDay && prev != kNoTimeDay && day != prev) {
      track.at(i + 1).Flag = 1;
      counter = 1;
    }
    track[i].DayCtr = counter;
    ++counter;
    prev = day;
  }
}

void MarkSegments(Molvar& m) {
  TrackStore& track = m.Track;
  const int32_t count = track.StoredCount();
  if (count < 1) return;
  if (m.frmMain.chkUseSplit.Checked()) {
    const int32_t k = RoundToInt32Or(Val(m.frmMain.txtSpltCount.Text), 0);
    if (k >= 1 && k < count) track[k].Flag = 1;
  }
  track[1].Flag = 1;
  const bool splitIfStopped = m.frmMain.chkSplitIfStopped.Checked();
  int32_t counter = 0;
  for (int32_t i = count; i >= 1; --i) {
    TrackPoint& p = track[i];
    if (splitIfStopped && p.Speed == 0) p.Flag = 1;
    ++counter;
    p.SegCtr = counter;
    if (p.Flag == 1) counter = 0;
  }
}

int32_t FindFastestPoint(const Molvar& m) {
  const TrackStore& track = m.Track;
  int32_t best = 1;
  for (int32_t i = 2, count = track.StoredCount(); i <= count; ++i) {
    if (track[i].Speed > track[best].Speed) best = i;
  }
  return best;
}

}  // namespace molvar
