#include "core/TrackStore.h"

#include "core/Errors.h"

namespace molvar {

void TrackStore::Resize(int32_t n) {
  if (n < 0) throw RuntimeError(kErrSubscript);
  const auto blocksNeeded = static_cast<std::size_t>((static_cast<int64_t>(n) + kBlockSize - 1) >> kBlockShift);
  while (blocks_.size() < blocksNeeded) {
    blocks_.push_back(std::make_unique<TrackPoint[]>(kBlockSize));
  }
  // Elements beyond the old bound may hold values from before a shrink: they start fresh.
  for (int32_t i = bound_ + 1; i <= n; ++i) Slot(i) = TrackPoint{};
  bound_ = n;
}

void TrackStore::Restart() {
  PointCount = 0;
  if (bound_ >= 1) Slot(1) = TrackPoint{};
}

TrackPoint& TrackStore::at(int32_t i) {
  if (!Exists(i)) throw RuntimeError(kErrSubscript);
  return Slot(i);
}

const TrackPoint& TrackStore::at(int32_t i) const {
  if (!Exists(i)) throw RuntimeError(kErrSubscript);
  return (*this)[i];
}

Waypoint& WaypointStore::Add() {
  ++WptCount;
  if (items_.size() < static_cast<std::size_t>(WptCount)) items_.resize(static_cast<std::size_t>(WptCount));
  Waypoint& w = items_[static_cast<std::size_t>(WptCount - 1)];
  w = Waypoint{};
  return w;
}

Waypoint& WaypointStore::at(int32_t i) {
  if (i < 1 || i > WptCount) throw RuntimeError(kErrSubscript);
  return items_[static_cast<std::size_t>(i - 1)];
}

const Waypoint& WaypointStore::at(int32_t i) const {
  if (i < 1 || i > WptCount) throw RuntimeError(kErrSubscript);
  return items_[static_cast<std::size_t>(i - 1)];
}

void ClearTrackStore(TrackStore& track, NmeaFix& nmea) {
  track.Restart();
  nmea = NmeaFix{};
}

}  // namespace molvar
