#pragma once
// "Read waypoint file": every waypoint goes to the output as it is read.
#include <string>
#include <string_view>

namespace molvar {

struct Molvar;

// `fromDrop`: the file names were set by the drop handler, no dialogs.
void ReadWaypointFile(Molvar& m, bool fromDrop);
// One OziExplorer waypoint line: stored and written at once.
void ReadOziWaypointLine(Molvar& m, std::string_view line);
// A file dropped on the waypoint frame.
void WptFrame_Drop(Molvar& m, const std::string& path);

}  // namespace molvar
