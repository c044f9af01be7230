// Input files that go wrong after they were chosen: gone before the read, or not readable as a
// file at all. The user hears why, the store gets nothing invented, and the previous output stays.
#include <gtest/gtest.h>

#include <filesystem>

#include "core/Text.h"
#include "input/FileChoice.h"
#include "input/TrackReader.h"
#include "input/Waypoints.h"
#include "support/Faults.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

namespace fs = std::filesystem;
using testing::NamesIn;
using testing::ReadFile;
using testing::TestProgram;
using testing::WriteFile;

constexpr const char* kPrevious = "the previous output\r\n";
const char* const kPlt =
    "OziExplorer Track Point File Version 2.1\r\nWGS 84\r\nAltitude is in Feet\r\nReserved 3\r\n"
    "0,2,255,Track,0,0,2,8421376\r\n2\r\n"
    "45.1,-75.2,1,328,39155.5,14-Mar-07,12:00:00\r\n"
    "45.2,-75.3,0,328,39155.50069444,14-Mar-07,12:01:00\r\n";

struct Chosen : TestProgram {
  Chosen() {
    m->frmMain.chkAuto.Value = 0;
    m->TrackFileType = 0;
    WriteFile(In(), kPlt);
    WriteFile(Out(), kPrevious);
    platform.dialogAnswers.push_back(In());
    platform.dialogAnswers.push_back(Out());
    // The choice as "Read track file" makes it; the read follows separately below.
    ChooseInputFile(*m);
    ChooseOutputFile(*m);
  }
  std::string In() const { return folder.File("in.plt"); }
  std::string Out() const { return folder.File("out.kml"); }
  void ExpectSnag(const std::string& procedure, const std::string& reason) {
    const auto boxes = platform.Messages();
    ASSERT_EQ(boxes.size(), 1u);
    EXPECT_EQ(boxes[0].title, " Whoa! An error!");
    EXPECT_EQ(boxes[0].text, procedure + " snag " + reason);
    EXPECT_EQ(ReadFile(Out()), kPrevious);
    EXPECT_EQ(m->Out.CompletedCount(), 0);
  }
};

TEST(TrackReaderFault, InputGoneBetweenChoiceAndRead) {
  Chosen c;
  fs::remove(c.In());
  ReadTrackFile(*c, true);
  c.ExpectSnag("ReadTrackFile", "File not found (" + c.In() + ": No such file or directory)");
  EXPECT_EQ(NamesIn(c.folder.path()), std::vector<std::string>{"out.kml"});
  // Back again, the same choice converts.
  WriteFile(c.In(), kPlt);
  ReadTrackFile(*c, true);
  EXPECT_EQ(c->Track.PointCount, 2);
  EXPECT_TRUE(StartsWith(ReadFile(c.Out()), "<?xml"));
}

// A folder opens like a file but every read fails: that failure is not the end of an empty file.
TEST(TrackReaderFault, InputThatCannotBeRead) {
  Chosen c;
  fs::remove(c.In());
  fs::create_directory(c.In());
  c->Track.PointCount = 0;
  ReadTrackFile(*c, true);
  c.ExpectSnag("ReadTrackFile", "Path/File access error (" + c.In() + ": Is a directory)");
  EXPECT_NE(c->frmMain.txtInfo.Text, " No track data found - no file saved.");
}

TEST(TrackReaderFault, WaypointInputThatCannotBeRead) {
  TestProgram t;
  t->frmMain.chkAuto.Value = 0;
  t->ProgramMode = kModeConvertWaypoints;
  t->WptFileType = 0;
  const std::string in = t.folder.File("in.wpt"), out = t.folder.File("out.kml");
  fs::create_directory(in);
  WriteFile(out, kPrevious);
  t.platform.dialogAnswers.push_back(in);
  t.platform.dialogAnswers.push_back(out);
  ReadWaypointFile(*t, false);
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_EQ(boxes[0].text, "ReadWaypointFile snag Path/File access error (" + in + ": Is a directory)");
  EXPECT_EQ(ReadFile(out), kPrevious);
  EXPECT_EQ(NamesIn(t.folder.path()), (std::vector<std::string>{"in.wpt", "out.kml"}));
}

// Root reads a file of any mode; everybody else is told the file and the reason.
TEST(TrackReaderFault, InputWithoutReadPermission) {
  Chosen c;
  fs::permissions(c.In(), fs::perms::none);
  ReadTrackFile(*c, true);
  if (testing::RunningAsRoot()) {
    EXPECT_TRUE(c.platform.Messages().empty());
    EXPECT_EQ(c->Track.PointCount, 2);
  } else {
    c.ExpectSnag("ReadTrackFile", "Path/File access error (" + c.In() + ": Permission denied)");
  }
}

}  // namespace
}  // namespace molvar
