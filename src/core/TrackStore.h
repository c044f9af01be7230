#pragma once
// The track store (points 1..PointCount), the waypoint store and the last NMEA fix.
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "core/CompactString.h"

namespace molvar {

struct TrackPoint {
  double Latitude = 0;   // decimal degrees, south negative
  double Longitude = 0;  // decimal degrees, west negative
  double Speed = 0;      // km/h
  double Distance = 0;   // cumulative km from point 1
  CompactString DateTime;
  CompactString PointText;
  int32_t Altitude = 0;  // whole metres, 0 = unknown
  int32_t SegCtr = 0;
  int32_t DayCtr = 0;
  int16_t Flag = 0;
  int16_t ColorBand = 0;
};

// Points live in fixed-size blocks, so growing never copies what is stored and a point's address
// never changes. Indexes are 1-based. `bound` is the upper bound of the arrays (the last element
// that exists); the readers keep it equal to PointCount.
class TrackStore {
 public:
  int32_t PointCount = 0;

  // Makes elements 1..n exist: elements up to the old bound keep their values, new ones start as
  // 0 or empty; elements beyond n are dropped.
  void GrowTrackStore(int32_t n) {
    // One more point into a block that exists: what every reader does for every point.
    if (n == bound_ + 1 && static_cast<std::size_t>(bound_ >> kBlockShift) < blocks_.size()) {
      Slot(n) = TrackPoint{};
      bound_ = n;
      return;
    }
    Resize(n);
  }
  // PointCount 0 and a fresh point 1; the other elements stay until they are dropped or regrown.
  void Restart();

  int32_t Bound() const { return bound_; }
  // The points that exist of 1..PointCount (PointCount may run ahead of the arrays while a live
  // fix is being counted).
  int32_t StoredCount() const { return PointCount < bound_ ? PointCount : bound_; }
  bool Exists(int32_t i) const { return i >= 1 && i <= bound_; }

  // Checked access: "Subscript out of range" (9) outside 1..Bound().
  TrackPoint& at(int32_t i);
  const TrackPoint& at(int32_t i) const;
  // Unchecked access for loops already bounded by PointCount.
  TrackPoint& operator[](int32_t i) { return Slot(i); }
  const TrackPoint& operator[](int32_t i) const { return const_cast<TrackStore*>(this)->Slot(i); }

 private:
  static constexpr int32_t kBlockShift = 12;
  static constexpr int32_t kBlockSize = 1 << kBlockShift;

  TrackPoint& Slot(int32_t i) {
    const auto k = static_cast<std::size_t>(i - 1);
    return blocks_[k >> kBlockShift][k & (kBlockSize - 1)];
  }

  void Resize(int32_t n);

  std::vector<std::unique_ptr<TrackPoint[]>> blocks_;
  int32_t bound_ = 0;
};

struct Waypoint {
  double WptLatitude = 0;
  double WptLongitude = 0;
  int32_t WptAltitude = 0;  // whole metres
  std::string WptName;
  std::string WptComment;
  std::string WptDescription;
  // The text a placemark is labelled with: 0 name, 1 comment, 2 description.
  std::string& Label(int16_t source) {
    return source == 1 ? WptComment : source == 2 ? WptDescription : WptName;
  }
};

class WaypointStore {
 public:
  int32_t WptCount = 0;

  // WptCount += 1 and room for the new waypoint (fields empty); returns it.
  Waypoint& Add();
  void Restart() { WptCount = 0; }

  Waypoint& at(int32_t i);
  const Waypoint& at(int32_t i) const;

 private:
  std::vector<Waypoint> items_;
};

// Text fields of the last accepted $GPRMC/$GPGGA sentence (field numbers of the sentence).
struct NmeaFields {
  std::string SentenceName;
  std::string UtcTime;
  std::string Status;
  std::string LatitudeText;
  std::string LatitudeHemisphere;
  std::string LongitudeText;
  std::string LongitudeHemisphere;
  std::string SpeedText;  // km/h once converted from knots
  std::string CourseText;
  std::string DateText;
  std::string MagneticVariation;
  std::string MagneticVariationDirection;
  std::string ChecksumText;
  std::string FixQuality;
  std::string Satellites;
  std::string Hdop;
  std::string AltitudeText = "0";
  std::string AltitudeUnit;
  std::string GeoidSeparation;
  std::string GeoidUnit;
};

// The last fix: its text fields and the values derived from them.
struct NmeaFix {
  NmeaFields Fields;
  int16_t NmeaValid = 0;
  double NmeaLatitude = 0;
  double NmeaLongitude = 0;
  int32_t NmeaAltitude = 0;
};

// Empties the track (the arrays keep their contents until overwritten) and forgets the last fix;
// the GGA altitude text becomes "0".
void ClearTrackStore(TrackStore& track, NmeaFix& nmea);

}  // namespace molvar
