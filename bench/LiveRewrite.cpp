// Times one nmea.kml rewrite (what every accepted fix costs in real-time mode) for stores of
// growing size, with details off and the whole track written (txtTrkLimit 1). Prints the median
// of many rewrites per size and the cost per stored point, which stays flat when the cost is
// linear.
#include <algorithm>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <string>
#include <vector>

#include "app/Molvar.h"
#include "core/SpeedDistance.h"
#include "input/Nmea.h"
#include "output/kml/LiveFiles.h"
#include "platform/ScriptedPlatform.h"

namespace {

using namespace molvar;

void FillStore(Molvar& m, int32_t points) {
  TrackStore& track = m.Track;
  track.PointCount = 0;
  for (int32_t i = 1; i <= points; ++i) {
    track.PointCount = i;
    track.GrowTrackStore(i);
    TrackPoint& p = track[i];
    p = TrackPoint{};
    p.Flag = i == 1 ? 1 : 0;
    p.Latitude = 45.0 + i * 1e-5;
    p.Longitude = -75.0 - i * 1e-5;
    p.Altitude = 70 + i % 50;
    p.DateTime = MakeTimestamp(3'382'000'000 + i).view();  // one fix a second
    CalcSpeedDistance(m, i);
  }
}

// "$body*hh" with its checksum and line end.
std::string Sentence(const std::string& body) {
  unsigned x = 0;
  for (const char c : body) x ^= static_cast<unsigned char>(c);
  char tail[8];
  std::snprintf(tail, sizeof tail, "*%02X\r\n", x);
  return "$" + body + tail;
}

double MedianMilliseconds(Molvar& m, int rewrites) {
  std::vector<double> ms;
  for (int r = 0; r < rewrites; ++r) {
    m.Track.PointCount += 1;  // the handler counts the fix before the rewrite stores it
    const auto start = std::chrono::steady_clock::now();
    WriteNmeaKmlFile(m);
    const auto end = std::chrono::steady_clock::now();
    ms.push_back(std::chrono::duration<double, std::milli>(end - start).count());
  }
  std::sort(ms.begin(), ms.end());
  return ms[ms.size() / 2];
}

}  // namespace

int main(int argc, char** argv) {
  const std::filesystem::path folder =
      argc > 1 ? std::filesystem::path(argv[1]) : std::filesystem::temp_directory_path() / "molvar-live-bench";
  std::filesystem::create_directories(folder);
  std::printf("%-30s %10s %14s\n", "nmea.kml rewrite, points", "median ms", "ns per point");
  for (const int32_t points : {2'500, 5'000, 10'000, 20'000, 40'000}) {
    ScriptedPlatform platform;
    Molvar m(platform, folder.string());
    m.ProgramMode = kModeRealTimeNmea;
    m.frmMain.chkDetailed.Value = 0;
    m.frmMain.txtTrkLimit.Text = "1";
    FillStore(m, points);
    std::string sentence = Sentence("GPRMC,120000,A,4500.0000,N,07500.0000,W,010.0,090.0,061226,,");
    ParseNMEA(m, sentence);
    if (m.Nmea.NmeaValid != 1) {
      std::fprintf(stderr, "the fix was not accepted\n");
      return 1;
    }
    const double ms = MedianMilliseconds(m, 31);
    std::printf("%-30d %10.3f %14.1f\n", points, ms, ms * 1e6 / points);
  }
  return 0;
}
