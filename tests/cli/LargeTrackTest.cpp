// Large generated tracks convert to exactly the bytes the converter wrote before any of its speed
// work: a guard that making it faster never changes what it writes. The reference hashes were
// taken from the converter as it stood before that work (its output is what the hand-written
// goldens check in detail); the bench generator makes the inputs.
#include <gtest/gtest.h>

#include <cstdint>
#include <string>

#include "core/Text.h"
#include "support/Peers.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::ReadFile;
using testing::RunCommand;
using testing::TempFolder;

constexpr int kPoints = 45000;  // crosses one of the generator's day breaks (every 40,000 points)

uint64_t Fnv1a(std::string_view bytes) {
  uint64_t h = 14695981039346656037ULL;
  for (const char c : bytes) {
    h ^= static_cast<unsigned char>(c);
    h *= 1099511628211ULL;
  }
  return h;
}

struct Conversion {
  const char* input;      // generated file
  const char* arguments;  // before INPUT OUTPUT
  const char* output;
  std::size_t size;       // bytes written
  uint64_t hash;          // FNV-1a of the output with the program folder written as {FOLDER}
};

const Conversion kConversions[] = {
    {"track.gpx", "", "gpx-details.kml", 21379208, 0xbb49b9453ffe089dULL},
    {"track.gpx", "--set chkDetailed=0", "gpx-lines.kml", 1377824, 0x614ba313bbaa5efaULL},
    {"track.gpx", "", "gpx.plt", 3129751, 0xb363dc9cd39ccd66ULL},
    {"track.nmea", "--type nmea", "nmea.kml", 21369170, 0x344123f1fd547c6eULL},
    {"track.nmea", "--type nmea", "nmea.gpx", 5187067, 0x2baefd9a68e68937ULL},
    {"track.plt", "", "plt.kml", 21380092, 0x37f46532688f16c6ULL},
    {"track.plt", "", "plt.gpx", 5143333, 0xe96ba934642fff2cULL},
};

TEST(LargeTrack, ConvertsToTheSameBytesAsBeforeTheSpeedWork) {
  TempFolder folder;
  const std::string generator = std::string(MOLVAR_SOURCE_DIR) + "/bench/make-track.py";
  for (const char* type : {"gpx", "nmea", "plt"}) {
    int status = -1;
    RunCommand("python3 '" + generator + "' " + type + " " + std::to_string(kPoints) + " '" +
                   folder.File(std::string("track.") + type) + "'",
               &status);
    ASSERT_EQ(status, 0) << type;
  }
  const std::string program = folder.File("program");
  for (const Conversion& c : kConversions) {
    int status = -1;
    RunCommand(std::string(MOLVAR_CONVERT_EXE) + " --folder '" + program + "' " + c.arguments + " '" +
                   folder.File(c.input) + "' '" + folder.File(c.output) + "' >/dev/null 2>&1",
               &status);
    ASSERT_EQ(status, 0) << c.output;
    const std::string written = Replace(ReadFile(folder.File(c.output)), program, "{FOLDER}");
    EXPECT_EQ(written.size(), c.size) << c.output;
    EXPECT_EQ(Fnv1a(written), c.hash) << c.output;
  }
}

}  // namespace
}  // namespace molvar
