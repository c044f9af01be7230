#pragma once
// GPX 1.0 output: a track as segments (inside one trk when converting track files) or waypoints.
// The document is declared ISO-8859-1, so outside text goes in as 8-bit characters.
#include <cstdint>
#include <string>
#include <string_view>

namespace molvar {

struct Molvar;

// Opens OutputPath and writes the head; when converting track files also the first point's time,
// the bounds and the trk start.
void WriteGpxHeader(Molvar& m);
// The four bounds of every stored point into m.Gpx.
void GpxBounds(Molvar& m);
// Points startIndex..startIndex+count-1 as one trkseg; nothing for fewer than two points. Takes
// the values the KML segment writer gets, which also draws point startIndex+count, so GPX
// segments do not share their boundary point.
void WriteGpxSegment(Molvar& m, int32_t startIndex, int32_t count);
// The GPX body of a track: one WriteGpxSegment per segment of the shared segment loop.
void WriteGpxSegments(Molvar& m);
// Waypoint k of m.Waypoints as one wpt element.
void WriteGpxWaypoint(Molvar& m, int32_t k);
// The tail; closes the file and adds the output name to the status box.
void WriteGpxFooter(Molvar& m);
// A stored (local) timestamp as GPX UTC time "yyyy-mm-ddThh:mm:ssZ"; empty when the text is not
// a date.
std::string GpxTime(const Molvar& m, std::string_view timestamp);
// The same appended to `out`; false, with nothing appended, when there is no time to write.
bool AppendGpxTime(std::string& out, const Molvar& m, std::string_view timestamp);

}  // namespace molvar
