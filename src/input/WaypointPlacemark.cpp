#include "app/Molvar.h"
#include "input/XmlTracks.h"
#include "output/Gpx.h"
#include "output/Ozi.h"
#include "output/kml/Placemarks.h"

namespace molvar {

// The one place where a waypoint just read meets the writer of the chosen output.
void WriteWaypointPlacemark(Molvar& m, std::string& label, double& longitude, double& latitude,
                            int32_t& altitude) {
  switch (m.OutputFormat) {
    case kFormatKml: WriteKmlPlacemark(m, label, longitude, latitude, altitude, "FFFFFF", kPlacemarkGeneral); return;
    case kFormatGpx: WriteGpxWaypoint(m, m.Waypoints.WptCount); return;
    default: WriteOziWaypoint(m, m.Waypoints.WptCount); return;
  }
}

}  // namespace molvar
