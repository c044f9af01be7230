#pragma once
// Molvar.ini (every persisted option, one numbered line each) and TrackData.txt (the last track
// and the last input and output files), both in the program folder.
#include <string>

namespace molvar {

struct Molvar;

inline constexpr const char* kSettingsFileName = "Molvar.ini";
inline constexpr const char* kTrackDataFileName = "TrackData.txt";
inline constexpr const char* kAgwpeFileName = "agwpe.txt";
inline constexpr int kSettingsLineCount = 65;

// The label of settings line k (0-64), "NN name...   = ", 27 characters.
const std::string& SettingsLabel(int k);

// Start-up: defaults, then Molvar.ini, then applying the values to the window the way user clicks
// would, then LoadTrackData. Problems are reported in a message box and start-up goes on.
void LoadSettings(Molvar& m);
// The options of Molvar.ini (or the defaults when there is none) without touching any file and
// without the welcome message or the last track: for the command-line converter.
void LoadOptionsOnly(Molvar& m);
// Shutdown: rewrites Molvar.ini in full. Returns false (and leaves the old file) when it could not
// be written.
bool SaveSettings(Molvar& m);

// Writes TrackData.txt when 2 or more points are held; errors leave the previous file in place.
void SaveTrackData(Molvar& m);
// Fills the track store and the three last-file values from TrackData.txt; a missing or damaged
// file disables "Refresh output" and keeps whatever was read before the damage.
void LoadTrackData(Molvar& m);

}  // namespace molvar
