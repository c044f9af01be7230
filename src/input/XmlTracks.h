#pragma once
// Markup track files read one line at a time: GPX, the simple XML track format, and the
// coordinate lines of a KML track. Tags are found by searching the line, so a value must stand
// on the line of its opening tag.
#include <cstdint>
#include <string>
#include <string_view>

namespace molvar {

struct Molvar;

// Track mode (ProgramMode "Convert track files") stores a TrackPoint when a point element ends;
// waypoint mode (ProgramMode "Convert waypoint files") stores a waypoint and writes its placemark.
void ReadGpxLine(Molvar& m, std::string_view line);
void ReadXmlLine(Molvar& m, std::string_view line);

// One upper-cased line after the "<LINESTRING>" line: "lon,lat,alt" tuples, one or more, separated
// by white space or by the comma after an altitude.
void ReadKmlCoordinateLine(Molvar& m, std::string_view line);

// The text without its CDATA wrapper.
std::string StripCdata(std::string_view text);

// The placemark of a waypoint read in waypoint mode (white, general marker). Defined in
// WaypointPlacemark.cpp; it is where the KML placemark writer is called from.
void WriteWaypointPlacemark(Molvar& m, std::string& label, double& longitude, double& latitude,
                            int32_t& altitude);

}  // namespace molvar
