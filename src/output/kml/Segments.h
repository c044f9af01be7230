#pragma once
// The track as styled line-string placemarks, one per segment, and the colour rules.
#include <cstdint>
#include <functional>
#include <string>

namespace molvar {

struct Molvar;
struct TrackPoint;

// Walks points 1..PointCount keeping SegmentCount, DayCount and CurrentPoint, and calls `segment`
// with the start index and count of every segment (by day when segments are collapsed). The KML
// and GPX writers share it.
void ForEachSegment(Molvar& m, const std::function<void(int32_t start, int32_t count)>& segment);
// The KML body: one WriteKmlTrackSegment per segment.
void WriteKmlSegments(Molvar& m);

// "lon,lat,alt" of a point; with speed as altitude the height is the gained speed.
void AppendKmlCoordinate(const Molvar& m, const TrackPoint& p, std::string& line);
// One Placemark with points start..start+count (stopping at the last point).
void WriteKmlTrackSegment(Molvar& m, int32_t startIndex, int32_t count);
std::string SegmentTitle(Molvar& m, int32_t startIndex);
// 0: colour by the vary mode; k in 1..10: icon k-1 (line colour stays entry 0).
void WriteKmlStyle(Molvar& m, int16_t selector);
int16_t VaryColorPtr(Molvar& m, int16_t selector);
std::string TrackColorString(Molvar& m, int16_t selector, int16_t entry);

}  // namespace molvar
