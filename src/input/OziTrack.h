#pragma once
// OziExplorer PLT track lines: "lat,lon,break,altitude feet,day number,...".
#include <string_view>

namespace molvar {

struct Molvar;

// Adds one point for every non-empty line; the state it keeps is Molvar::OziTrack.
void ReadOziTrackLine(Molvar& m, std::string_view line);

}  // namespace molvar
