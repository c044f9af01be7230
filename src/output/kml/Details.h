#pragma once
// One dot placemark per track point with its data in the balloon, in a folder per segment.
#include <cstdint>

namespace molvar {

struct Molvar;

void WriteDetailedData(Molvar& m);
void DetailStartIndex(Molvar& m);
// The new segment number when point i starts a segment, else 0 (i = 1 resets the counters).
int16_t NextDetailSegment(Molvar& m, int32_t i);

}  // namespace molvar
