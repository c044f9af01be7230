#include "support/KmlTesting.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cstdio>
#include <memory>
#include <regex>

#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "output/kml/KmlFrame.h"
#include "output/kml/Segments.h"

namespace molvar::testing {
namespace {

std::vector<std::string> SplitOn(const std::string& s, char separator) {
  std::vector<std::string> parts;
  std::size_t from = 0;
  while (true) {
    const std::size_t at = s.find(separator, from);
    parts.push_back(s.substr(from, at == std::string::npos ? std::string::npos : at - from));
    if (at == std::string::npos) return parts;
    from = at + 1;
  }
}

std::string Quoted(const std::string& path) { return "'" + Replace(path, "'", "'\\''") + "'"; }

// A geometry as comparable text, 7 decimals (what every peer keeps of our coordinates).
std::string Canonical(const std::vector<Coord>& coords) {
  std::string s;
  std::array<char, 96> buf{};
  for (const Coord& c : coords) {
    std::snprintf(buf.data(), buf.size(), "(%.7f %.7f %.3f)", c.lon, c.lat, c.alt);
    s += buf.data();
  }
  return s;
}

std::vector<Coord> ParseOgrCoords(const std::string& inside) {
  std::vector<Coord> coords;
  for (const std::string& tuple : SplitOn(inside, ',')) {
    Coord c;
    const int n = std::sscanf(tuple.c_str(), "%lf %lf %lf", &c.lon, &c.lat, &c.alt);
    if (n >= 2) coords.push_back(c);
  }
  return coords;
}

}  // namespace

std::string KmlGolden(const std::string& name, const std::string& folder) {
  return Replace(ReadFile(std::string(MOLVAR_GOLDEN_DIR) + "/kml/" + name), "{FOLDER}", folder);
}

void WriteTrack(TestProgram& t, const std::string& name) {
  Molvar& m = *t;
  m.OutputPath = t.folder.File(name);
  m.OutputName = name;
  MarkDays(m);
  MarkSegments(m);
  m.Speed.FastestIndex = FindFastestPoint(m);
  m.Kml.SegmentCount = 1;
  ASSERT_EQ(WriteKmlHeader(m), 0);
  WriteKmlSegments(m);
  WriteKmlFooter(m);
}

std::vector<std::string> WrittenLines(TestProgram& t, const std::function<void(Molvar&)>& write) {
  const std::string path = t.folder.File("part.txt");
  t->Out.Open(path);
  write(*t);
  t->Out.Close();
  std::string text = ReadFile(path);
  std::vector<std::string> lines;
  std::size_t from = 0;
  while (from < text.size()) {
    const std::size_t end = text.find("\r\n", from);
    if (end == std::string::npos) {
      lines.push_back(text.substr(from));
      break;
    }
    lines.push_back(text.substr(from, end - from));
    from = end + 2;
  }
  return lines;
}

void ExpectPeersRead(const std::string& path, const std::vector<Coord>& points, const std::vector<LineCoords>& lines) {
  ExpectWellFormedXml(path);

  int rc = -1;
  const std::string babel = RunCommand("gpsbabel -w -r -t -i kml -f " + Quoted(path) + " -o gpx -F - 2>&1", &rc);
  EXPECT_EQ(rc, 0) << babel;
  std::vector<Coord> wpts, trkpts;
  static const std::regex point(R"re(<(wpt|trkpt) lat="([-0-9.]+)" lon="([-0-9.]+)">\s*(?:<ele>([-0-9.]+)</ele>)?)re");
  for (auto it = std::sregex_iterator(babel.begin(), babel.end(), point); it != std::sregex_iterator(); ++it) {
    Coord c{std::stod((*it)[3]), std::stod((*it)[2]), (*it)[4].matched ? std::stod((*it)[4]) : 0.0};
    ((*it)[1] == "wpt" ? wpts : trkpts).push_back(c);
  }
  LineCoords allLinePoints;
  for (const auto& line : lines) allLinePoints.insert(allLinePoints.end(), line.begin(), line.end());
  EXPECT_EQ(Canonical(wpts), Canonical(points)) << babel;
  EXPECT_EQ(Canonical(trkpts), Canonical(allLinePoints)) << babel;

  const std::string ogr = RunCommand("ogrinfo -ro -al " + Quoted(path) + " 2>&1", &rc);
  EXPECT_EQ(rc, 0) << ogr;
  std::vector<std::string> ogrPoints, ogrLines, wantPoints, wantLines;
  static const std::regex geometry(R"re(^\s*(POINT|LINESTRING)(?: Z)? \(([^)]*)\))re");
  for (const std::string& row : SplitOn(ogr, '\n')) {
    std::smatch g;
    if (!std::regex_search(row, g, geometry)) continue;
    (g[1] == "POINT" ? ogrPoints : ogrLines).push_back(Canonical(ParseOgrCoords(g[2])));
  }
  for (const Coord& c : points) wantPoints.push_back(Canonical({c}));
  for (const auto& line : lines) wantLines.push_back(Canonical(line));
  for (auto* v : {&ogrPoints, &ogrLines, &wantPoints, &wantLines}) std::sort(v->begin(), v->end());
  EXPECT_EQ(ogrPoints, wantPoints) << ogr;
  EXPECT_EQ(ogrLines, wantLines) << ogr;
}

}  // namespace molvar::testing
