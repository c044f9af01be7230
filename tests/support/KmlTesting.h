#pragma once
// Writing whole KML documents in tests and having real peers read them back.
#include <functional>
#include <string>
#include <vector>

#include "support/Peers.h"
#include "support/TestProgram.h"

namespace molvar::testing {

struct Coord {
  double lon = 0, lat = 0, alt = 0;
};
using LineCoords = std::vector<Coord>;

// The hand-written file tests/golden/kml/<name> with "{FOLDER}" replaced by the program folder.
std::string KmlGolden(const std::string& name, const std::string& folder);

// What the dispatcher does for a KML track: days, segments and fastest point, then head,
// segments and tail into the program folder's `name`.
void WriteTrack(TestProgram& t, const std::string& name);

// The lines (without CR LF) that `write` puts into a fresh output file of the program folder.
std::vector<std::string> WrittenLines(TestProgram& t, const std::function<void(Molvar&)>& write);

// xmllint, GDAL (ogrinfo) and gpsbabel all read the file. gpsbabel gives the Point placemarks
// in document order and the line strings' points in order; GDAL, which groups placemarks by
// folder, gives the same points and the same line strings point for point.
void ExpectPeersRead(const std::string& path, const std::vector<Coord>& points, const std::vector<LineCoords>& lines);

}  // namespace molvar::testing
