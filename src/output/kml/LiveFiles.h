#pragma once
// The files of real-time mode: nmea.kml, rewritten for every stored fix, and the two network-link
// files through which Google Earth reloads it, from the program folder (gps.kml) or from the web
// server the automatic upload feeds (gpslink.kml).
#include <string>

namespace molvar {

struct Molvar;

// gps.kml in the program folder: a NetworkLink to nmea.kml beside it, reloaded every txtGErefresh
// seconds. Uses its own file, so it can run while the KML output is open.
void WriteGpsLinkFile(Molvar& m);
// gpslink.kml in the program folder: the same link to FtpHttpPath + "nmea.kml", for the server.
void WriteWebLinkFile(Molvar& m);

// Stores the last accepted fix as point PointCount (the caller has counted it), rewrites nmea.kml
// and hands it to the automatic upload when one is due. Does nothing when no sentence has been
// accepted yet or no point was counted since the last rewrite.
void WriteNmeaKmlFile(Molvar& m);
// The live track line: the last txtTrkLimit points (all for 1, none for 0).
void WriteKmlNmeaTrack(Molvar& m);

// Name of the live position placemark: speed or "Stationary", altitude and heading of the fix.
std::string LivePlacemarkLabel(const Molvar& m);

}  // namespace molvar
