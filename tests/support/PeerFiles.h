#pragma once
// Track files written by gpsbabel from our own CSV points, and the lines of a file as the track
// reading driver hands them to a line reader.
#include <string>
#include <string_view>
#include <vector>

#include "support/TestProgram.h"

namespace molvar::testing {

// Writes `csv` (gpsbabel's unicsv columns) to the folder and converts it with gpsbabel's output
// options `output` ("gpx", "gpx,gpxver=1.1", "kml", "ozi") into `name` in the same folder. With
// `asTrack` the points become one track, otherwise waypoints. The path of the written file, or
// empty when gpsbabel is not available or failed.
std::string WriteWithGpsbabel(const TempFolder& folder, std::string_view csv, std::string_view output,
                              std::string_view name, bool asTrack = true);

// Every line of the file, split at CR, LF or CR LF by the program's own line reader.
std::vector<std::string> FileLines(const std::string& path);

}  // namespace molvar::testing
