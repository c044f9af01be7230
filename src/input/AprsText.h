#pragma once
// APRS position logs: station lines ("CALL*...") and position reports in degrees and minutes
// ("4530.00N/07530.00W..."), found by pattern rather than by fields.
#include <string_view>

namespace molvar {

struct Molvar;

inline constexpr int kAprsShortLine = 1;   // a whole line of at most 100 characters
inline constexpr int kAprsPacketText = 2;  // the text after ">" of a longer line

// Adds at most one point; sets the last fix (NmeaValid, NmeaLatitude, NmeaLongitude) as it goes.
void ReadAprsLine(Molvar& m, std::string_view text, int kind, std::string_view timeText);

}  // namespace molvar
