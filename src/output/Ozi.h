#pragma once
// OziExplorer output: the track-point file (PLT, one line per stored point, segment starts in the
// break field) and the waypoint file (WPT).
#include <cstdint>
#include <string>
#include <string_view>

namespace molvar {

struct Molvar;

enum OziFileKinds : int16_t { kOziTrack = 0, kOziWaypoints = 1 };

// Opens OutputPath and writes the head of a track (kind 0) or waypoint file (kind 1). The caller
// closes the file after the last line.
void WriteOziHeader(Molvar& m, int16_t kind);
// "lat, lon, break, feet, day number, date, time" of point i.
void WriteOziTrackPoint(Molvar& m, int32_t i);
// Waypoint k of m.Waypoints as one WPT line: number, name, lat, lon, date, symbol, status, map
// display, colours, description, pointer direction, Garmin display, proximity, feet, font size,
// font style, symbol size.
void WriteOziWaypoint(Molvar& m, int32_t k);
// The date (selector 0) or the time (selector 1) of a timestamp: the text before or after its
// first blank; both empty when it has no blank.
std::string_view OziDateTimePart(std::string_view text, int16_t part);
// A text as one comma-separated field: commas become the character Ozi reads as a comma inside a
// field (209), line breaks and other control characters become blanks.
std::string OziFieldText(std::string_view text);

}  // namespace molvar
