#include "support/TestProgram.h"

#include <cstdlib>
#include <fstream>
#include <sstream>
#include <stdexcept>
#include <unistd.h>

#include "core/SpeedDistance.h"

namespace molvar::testing {

TempFolder::TempFolder() {
  std::string pattern = (std::filesystem::temp_directory_path() / "molvar-test-XXXXXX").string();
  if (::mkdtemp(pattern.data()) == nullptr) throw std::runtime_error("mkdtemp failed");
  path_ = pattern;
}

TempFolder::~TempFolder() {
  std::error_code ignored;
  std::filesystem::remove_all(path_, ignored);
}

void TestProgram::AddPoint(double lat, double lon, std::string_view time, double speed) {
  auto& track = m->Track;
  track.PointCount += 1;
  track.GrowTrackStore(track.PointCount);
  auto& p = track.at(track.PointCount);
  p.Latitude = lat;
  p.Longitude = lon;
  p.DateTime = time;
  p.Speed = speed;
  CalcSpeedDistance(*m, track.PointCount);
}

std::string ReadFile(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  if (!in) throw std::runtime_error("cannot read " + path);
  std::ostringstream s;
  s << in.rdbuf();
  return s.str();
}

void WriteFile(const std::string& path, std::string_view content) {
  std::ofstream out(path, std::ios::binary);
  out.write(content.data(), static_cast<std::streamsize>(content.size()));
  if (!out) throw std::runtime_error("cannot write " + path);
}

}  // namespace molvar::testing
