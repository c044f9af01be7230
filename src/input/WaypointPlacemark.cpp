#include "input/XmlTracks.h"

namespace molvar {

// The one place where a waypoint read from a markup file meets the KML placemark writer:
// WriteKmlPlacemark(m, label, longitude, latitude, altitude, "FFFFFF", kind 0).
// Until that writer is part of the program the waypoint is only stored.
void WriteWaypointPlacemark(Molvar&, std::string&, double&, double&, int32_t&) {}

}  // namespace molvar
