#pragma once
// APRS position reports turned into the last fix (m.Nmea), as if an NMEA sentence had been read.
#include <string>
#include <string_view>

namespace molvar {

struct Molvar;

inline constexpr std::string_view kMicEUndecodable = "  ** Can't decode binary data. **";

// A plain report ("4530.12N/07530.45W-...", anywhere after the destination) with an optional
// "A=" altitude in feet. On success NmeaValid is 1 and the position is appended to the track;
// otherwise NmeaValid is 0 and neither the fix nor the track changes.
void ParseAprsPosition(Molvar& m, std::string_view packet);

// A Mic-E report: destination address, optional path after a comma, ":" and the information field.
// Fills the fix and appends the point like ParseAprsPosition. Returns the status line for the
// lookup's status box: " Mic-E: OK data Msg: ..." or kMicEUndecodable.
std::string DecodeMicE(Molvar& m, std::string_view packet);

}  // namespace molvar
