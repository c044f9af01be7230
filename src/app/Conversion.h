#pragma once
// One headless conversion of a track or waypoint file: the options of the settings file and the
// command line, the readers and writers of the window, no window.
#include <string>
#include <utility>
#include <vector>

namespace molvar {

struct Molvar;
class ConsolePlatform;

struct ConversionRequest {
  std::string input;
  std::string output;
  std::string type;                      // a name of kConversionTypes; empty: by extension
  std::vector<std::string> assignments;  // "CONTROL=VALUE", applied in order
};

enum ConversionExit : int { kConversionWritten = 0, kConversionUsage = 1, kConversionNothingWritten = 2 };

struct ConversionResult {
  int exitCode = kConversionNothingWritten;
  std::string usageError;  // for kConversionUsage
  std::string info;        // txtInfo at the end
};

// Track types 0 to 8, then the two waypoint types.
inline constexpr const char* kConversionTypes[] = {"ozi", "gpx", "xml",  "nmea",    "csv1",   "csv2",
                                                   "kml", "aprs", "kel", "ozi-wpt", "gpx-wpt"};

// `m` runs on `platform`, whose dialogs the conversion answers with the two file names.
ConversionResult RunConversion(Molvar& m, ConsolePlatform& platform, const ConversionRequest& request);

}  // namespace molvar
