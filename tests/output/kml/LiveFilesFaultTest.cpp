// The per-fix rewrite of nmea.kml when the disk is full at any stage of the new file, or the
// program folder takes no new file: Google Earth keeps the previous file, the fix is kept, and the
// next rewrite puts the complete file in place.
#include <gtest/gtest.h>

#include <filesystem>

#include "core/Text.h"
#include "input/Nmea.h"
#include "output/kml/LiveFiles.h"
#include "support/Faults.h"
#include "support/Sentences.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::CutPoints;
using testing::FileSizeLimit;
using testing::NamesIn;
using testing::ReadFile;
using testing::Rmc;
using testing::TestProgram;

const char* const kFixes[] = {"100000", "100010", "100020"};
const char* const kLatitudes[] = {"4500.0000", "4500.6000", "4501.2000"};

struct Live : TestProgram {
  Live() {
    m->ProgramMode = kModeRealTimeNmea;
    m->frmMain.chkDetailed.Value = 0;
  }
  std::string NmeaKml() const { return folder.File("nmea.kml"); }
  // Fix number `i` of kFixes as the real-time handler takes it.
  void Fix(int i) {
    std::string sentence = Rmc(kFixes[i], kLatitudes[i], "010.0", "090.0");
    ParseNMEA(*m, sentence);
    m->Track.PointCount += 1;
    WriteNmeaKmlFile(*m);
  }
  // nmea.kml with this program's folder written as {FOLDER}.
  std::string Written() const { return Replace(ReadFile(NmeaKml()), folder.path().string(), "{FOLDER}"); }
};

TEST(LiveFault, DiskFullAtEveryStageOfTheRewrite) {
  Live reference;
  for (int i = 0; i < 3; ++i) reference.Fix(i);
  const std::string third = reference.Written();

  for (const std::size_t cut : CutPoints(third.size())) {
    Live t;
    t.Fix(0);
    t.Fix(1);
    const std::string previous = ReadFile(t.NmeaKml());
    {
      FileSizeLimit full(cut);
      t.Fix(2);
    }
    const auto boxes = t.platform.Messages();
    ASSERT_EQ(boxes.size(), 1u) << cut;
    EXPECT_EQ(boxes[0].text, "WriteKmlFooter bug Path/File access error (" + t.NmeaKml() + ": File too large)");
    EXPECT_EQ(ReadFile(t.NmeaKml()), previous) << cut;
    EXPECT_EQ(NamesIn(t.folder.path()), std::vector<std::string>{"nmea.kml"}) << cut;
    EXPECT_EQ(t->Live.LastWrittenCount, 2) << cut;
    EXPECT_EQ(t->Track.PointCount, 3) << "the fix is kept";
    // With room again the same count is written, as complete as if nothing had happened.
    WriteNmeaKmlFile(*t);
    EXPECT_EQ(t->Live.LastWrittenCount, 3) << cut;
    EXPECT_EQ(t.Written(), third) << cut;
  }
}

TEST(LiveFault, ProgramFolderThatTakesNoNewFile) {
  Live t;
  t.Fix(0);
  const std::string previous = ReadFile(t.NmeaKml());
  std::string reason;
  if (testing::RunningAsRoot()) {
    testing::WriteFile(t.folder.File("plain"), "a file, not a folder");
    t->ProgramFolder = t.folder.File("plain");
    t.Fix(1);
    reason = "Path not found (" + t.folder.File("plain") + "/nmea.kml: Not a directory)";
  } else {
    testing::ReadOnlyFolder readOnly(t.folder.path());
    t.Fix(1);
    reason = "Permission denied (" + t.NmeaKml() + ": Permission denied)";
  }
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_EQ(boxes[0].text, "WriteKmlHeader bug " + reason);
  EXPECT_EQ(ReadFile(t.NmeaKml()), previous);
  EXPECT_EQ(t->Live.LastWrittenCount, 1);
  t->ProgramFolder = t.folder.path().string();
  WriteNmeaKmlFile(*t);
  EXPECT_EQ(t->Live.LastWrittenCount, 2);
  EXPECT_TRUE(Contains(ReadFile(t.NmeaKml()), "<name>Track - 2 points</name>"));
}

}  // namespace
}  // namespace molvar
