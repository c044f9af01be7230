#pragma once
// $GPRMC and $GPGGA sentences: checking, splitting into the last fix (m.Nmea) and storing the fix
// as a track point.
#include <cstdint>
#include <string>
#include <string_view>

namespace molvar {

struct Molvar;

// Checks and decodes one sentence. `sentence` is replaced by its cleaned form (from the first "$",
// trimmed, upper-cased, cut at the first CR LF). Sets m.Nmea.NmeaValid; when the sentence is
// accepted, NmeaLatitude/NmeaLongitude too, and in the modes that build a track from sentences the
// fix is stored as a new point.
void ParseNMEA(Molvar& m, std::string& sentence);

// 1 when the two hex digits after "*" match the exclusive-or of the characters between "$" and
// "*" (or mnuIgnore is checked), else 0; NmeaValid gets the same value.
int16_t VerifyChecksum(Molvar& m, std::string_view sentence);

// "ddmm.mmmm" (or "dddmm.mmmm") and a hemisphere letter to signed decimal degrees, 8 decimals.
double ConvertNmeaLocation(std::string_view text, std::string_view hemisphere);

// Appends the last fix as a point of a track read from sentences (file, AGW, APRS track page),
// with speed and distance.
void AddNmeaTrackPoint(Molvar& m);

// Appends the last fix for the live and APRS paths. In real-time mode the caller has already
// counted the point. Speed and distance are left to the caller.
void AddParsedPoint(Molvar& m);

}  // namespace molvar
