#pragma once
// What every line reader does to store a point: count it, grow the arrays, and hand back the new
// element with the flag a first point gets. The caller fills it and then calls CalcSpeedDistance.
#include <cstdint>

#include "app/Molvar.h"

namespace molvar {

inline TrackPoint& AppendTrackPoint(Molvar& m) {
  TrackStore& track = m.Track;
  track.PointCount += 1;
  const bool fresh = track.PointCount > track.Bound();  // growing starts new elements empty
  track.GrowTrackStore(track.PointCount);
  TrackPoint& p = track[track.PointCount];
  // A new read restarts at point 1, which still holds the last read's values.
  if (!fresh) p = TrackPoint{};
  p.Flag = track.PointCount == 1 ? 1 : 0;
  return p;
}

}  // namespace molvar
