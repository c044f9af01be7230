// Molvar.ini and TrackData.txt under faults: a full disk at every stage of the rewrite, a program
// folder that takes no new file, and settings files that cannot be read.
#include <gtest/gtest.h>

#include <filesystem>

#include "app/Settings.h"
#include "core/Text.h"
#include "support/Faults.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

namespace fs = std::filesystem;
using testing::CutPoints;
using testing::FileSizeLimit;
using testing::NamesIn;
using testing::ReadFile;
using testing::TestProgram;
using testing::WriteFile;

std::string Golden(const std::string& name) { return ReadFile(std::string(MOLVAR_GOLDEN_DIR) + "/settings/" + name); }

// A program that has read the user's settings and last track, with one option changed since.
struct Session : TestProgram {
  Session() {
    WriteFile(Ini(), Golden("changed.ini"));
    WriteFile(TrackData(), Golden("TrackData.txt"));
    LoadSettings(*m);
    m->frmMain.txtTitle.Text = "Changed while running";
    AddPoint(45.5, -75.5, "2007-06-01 11:00:00 AM");
    platform.calls.clear();
  }
  std::string Ini() const { return folder.File(kSettingsFileName); }
  std::string TrackData() const { return folder.File(kTrackDataFileName); }
  // Everything the program folder holds after the start: no temporary file may join it.
  std::vector<std::string> names = {kSettingsFileName, kTrackDataFileName, kAgwpeFileName};  // sorted
};

TEST(SettingsFault, DiskFullAtEveryStageOfTheSettingsFile) {
  Session s;
  const std::string previous = ReadFile(s.Ini());
  ASSERT_TRUE(SaveSettings(*s));
  const std::string complete = ReadFile(s.Ini());
  ASSERT_NE(complete, previous);
  for (const std::size_t cut : CutPoints(complete.size())) {
    WriteFile(s.Ini(), previous);
    s.platform.calls.clear();
    bool saved = true;
    {
      FileSizeLimit full(cut);
      saved = SaveSettings(*s);
    }
    EXPECT_FALSE(saved) << cut;
    const auto boxes = s.platform.Messages();
    ASSERT_EQ(boxes.size(), 1u) << cut;
    EXPECT_EQ(boxes[0].title, "Error");
    EXPECT_EQ(boxes[0].text, "SaveSettings bug Path/File access error (" + s.Ini() + ": File too large)");
    EXPECT_EQ(ReadFile(s.Ini()), previous) << cut;
    EXPECT_EQ(NamesIn(s.folder.path()), s.names) << cut;
  }
  EXPECT_TRUE(SaveSettings(*s));
  EXPECT_EQ(ReadFile(s.Ini()), complete);
}

// Errors while writing TrackData.txt are not reported; they only must not cost the last file.
TEST(SettingsFault, DiskFullAtEveryStageOfTheTrackData) {
  Session s;
  const std::string previous = ReadFile(s.TrackData());
  SaveTrackData(*s);
  const std::string complete = ReadFile(s.TrackData());
  ASSERT_NE(complete, previous);
  for (const std::size_t cut : CutPoints(complete.size())) {
    WriteFile(s.TrackData(), previous);
    s.platform.calls.clear();
    {
      FileSizeLimit full(cut);
      SaveTrackData(*s);
    }
    EXPECT_TRUE(s.platform.calls.empty()) << cut;
    EXPECT_EQ(ReadFile(s.TrackData()), previous) << cut;
    EXPECT_EQ(NamesIn(s.folder.path()), s.names) << cut;
  }
  SaveTrackData(*s);
  EXPECT_EQ(ReadFile(s.TrackData()), complete);
}

TEST(SettingsFault, ProgramFolderThatTakesNoNewFile) {
  Session s;
  const std::string ini = ReadFile(s.Ini());
  const std::string track = ReadFile(s.TrackData());
  bool saved = true;
  std::string reason;
  if (testing::RunningAsRoot()) {
    // No folder mode stops root: the program folder is a plain file instead.
    WriteFile(s.folder.File("plain"), "a file, not a folder");
    s->ProgramFolder = s.folder.File("plain");
    saved = SaveSettings(*s);
    SaveTrackData(*s);
    reason = "Path not found (" + s.folder.File("plain") + "/Molvar.ini: Not a directory)";
    s.names.push_back("plain");
  } else {
    testing::ReadOnlyFolder readOnly(s.folder.path());
    saved = SaveSettings(*s);
    SaveTrackData(*s);
    reason = "Permission denied (" + s.Ini() + ": Permission denied)";
  }
  EXPECT_FALSE(saved);
  const auto boxes = s.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u) << "only the settings failure is shown";
  EXPECT_EQ(boxes[0].text, "SaveSettings bug " + reason);
  EXPECT_EQ(ReadFile(s.Ini()), ini);
  EXPECT_EQ(ReadFile(s.TrackData()), track);
  EXPECT_EQ(NamesIn(s.folder.path()), s.names);
}

const char* const kIniErrorStart = "Ini file contains errors.\r\nError number: ";

// A Molvar.ini that is a folder: start-up goes on with the defaults after the error box, and the
// shutdown cannot put a file in its place, which it reports; the folder stays as it was.
TEST(SettingsFault, SettingsFileThatIsAFolder) {
  TestProgram t;
  fs::create_directory(t.folder.File(kSettingsFileName));
  WriteFile(t.folder.File("Molvar.ini/keep"), "user data");
  LoadSettings(*t);
  auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_EQ(boxes[0].text.substr(0, std::string(kIniErrorStart).size() + 2), std::string(kIniErrorStart) + "75");
  EXPECT_EQ(t->frmMain.txtEyeAlt.Text, "2000");
  EXPECT_FALSE(SaveSettings(*t));
  boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 2u);
  EXPECT_TRUE(StartsWith(boxes[1].text, "SaveSettings bug ")) << boxes[1].text;
  EXPECT_TRUE(Contains(boxes[1].text, t.folder.File(kSettingsFileName))) << boxes[1].text;
  EXPECT_EQ(ReadFile(t.folder.File("Molvar.ini/keep")), "user data");
  EXPECT_EQ(NamesIn(t.folder.path()), (std::vector<std::string>{kSettingsFileName, kAgwpeFileName}));
}

// A Molvar.ini the program may not read: as the settings file is rewritten at every close, the
// error box is the user's only warning before the defaults replace it. Root reads it anyway.
TEST(SettingsFault, SettingsFileWithoutReadPermission) {
  TestProgram t;
  WriteFile(t.folder.File(kSettingsFileName), Golden("changed.ini"));
  fs::permissions(t.folder.File(kSettingsFileName), fs::perms::none);
  LoadSettings(*t);
  if (testing::RunningAsRoot()) {
    EXPECT_TRUE(t.platform.Messages().empty());
    EXPECT_EQ(t->frmMain.chkGPGGA.Value, 1) << "the file was read";
  } else {
    const auto boxes = t.platform.Messages();
    ASSERT_EQ(boxes.size(), 1u);
    EXPECT_TRUE(StartsWith(boxes[0].text, std::string(kIniErrorStart) + "75\r\n")) << boxes[0].text;
    EXPECT_EQ(t->frmMain.chkGPGGA.Value, 0) << "defaults";
  }
}

// Garbage after a readable start: the values before the damage are kept, the rest are defaults,
// and the close writes a complete file from them, so what was readable is not lost.
TEST(SettingsFault, GarbageKeepsTheReadablePartAndTheCloseRepairsTheFile) {
  TestProgram t;
  const std::string good = Golden("changed.ini");
  std::size_t tenth = 0;
  for (int line = 0; line < 10; ++line) tenth = good.find("\r\n", tenth) + 2;
  std::string junk = good.substr(0, tenth);
  for (int i = 0; i < 4000; ++i) junk.push_back(static_cast<char>((i * 131 + 7) % 256));
  WriteFile(t.folder.File(kSettingsFileName), junk);
  LoadSettings(*t);
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_TRUE(StartsWith(boxes[0].text, kIniErrorStart)) << boxes[0].text;
  ASSERT_TRUE(SaveSettings(*t));
  const std::string written = ReadFile(t.folder.File(kSettingsFileName));
  const std::string defaults = Golden("defaults.ini");
  EXPECT_EQ(written.substr(0, tenth), good.substr(0, tenth)) << "lines 00 to 09 as the user had them";
  // Line 00 carries the version and the default paths name the program folder in both.
  std::size_t defaultsTenth = 0;
  for (int line = 0; line < 10; ++line) defaultsTenth = defaults.find("\r\n", defaultsTenth) + 2;
  EXPECT_EQ(written.substr(tenth), Replace(defaults.substr(defaultsTenth), "{FOLDER}", t.folder.path().string()));
}

}  // namespace
}  // namespace molvar
