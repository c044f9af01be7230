#pragma once
// Where the program keeps its settings, track data, live files and resources.
#include <string>

namespace molvar {

// $XDG_DATA_HOME/molvar, else ~/.local/share/molvar, else ./molvar; created when missing.
std::string DefaultProgramFolder();

}  // namespace molvar
