// Choosing input and output files, the refused format combinations and the line-end repair.
#include <gtest/gtest.h>

#include <filesystem>
#include <iterator>

#include "input/FileChoice.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::ReadFile;
using testing::TestProgram;
using testing::WriteFile;

TEST(ChooseInputFile, SetsNamesFolderAndProposedOutput) {
  TestProgram t;
  t->TrackFileType = 4;
  t->InputTrackPath = "/data/in";
  t.platform.dialogAnswers.push_back("/home/u/tracks/lake.run.csv");
  ASSERT_EQ(ChooseInputFile(*t), 0);
  const auto dialog = t.platform.CallsOf("OpenFileDialog").at(0).dialog;
  EXPECT_EQ(dialog.filter, "Text Files - CSV type 1 only! (*.csv)|*.csv");
  EXPECT_EQ(dialog.initialFolder, "/data/in");
  EXPECT_EQ(t->LastSourceFile, "/home/u/tracks/lake.run.csv");
  EXPECT_EQ(t->InputName, "lake.run.csv");
  EXPECT_EQ(t->InputTrackPath, "/home/u/tracks");
  EXPECT_EQ(t->OutputName, "lake.run.kml");
}

TEST(ChooseInputFile, WaypointModeUsesItsFilterAndFolder) {
  TestProgram t;
  t->ProgramMode = kModeConvertWaypoints;
  t->WptFileType = 1;
  t->InputWaypointPath = "/w";
  t->OutputName = "before.kml";
  t.platform.dialogAnswers.push_back("/x/points");
  ASSERT_EQ(ChooseInputFile(*t), 0);
  const auto dialog = t.platform.CallsOf("OpenFileDialog").at(0).dialog;
  EXPECT_EQ(dialog.filter, "GPX Waypoint Files (*.gpx)|*.gpx");
  EXPECT_EQ(dialog.initialFolder, "/w");
  EXPECT_EQ(t->InputWaypointPath, "/x");
  EXPECT_EQ(t->OutputName, "before.kml") << "a name without a dot proposes nothing new";
}

TEST(ChooseInputFile, CancelChangesNothing) {
  TestProgram t;
  t->LastSourceFile = "/old.plt";
  t.platform.dialogAnswers.push_back(std::nullopt);
  EXPECT_EQ(ChooseInputFile(*t), 1);
  EXPECT_EQ(t->LastSourceFile, "/old.plt");
}

TEST(OutputFormatOfName, LastMatchWinsAndNoMatchKeepsPrevious) {
  EXPECT_EQ(OutputFormatOfName("/a/b.kml", kFormatOzi), kFormatKml);
  EXPECT_EQ(OutputFormatOfName("/a/b.GPX", kFormatKml), kFormatGpx);
  EXPECT_EQ(OutputFormatOfName("/a/b.wpt", kFormatKml), kFormatOzi);
  EXPECT_EQ(OutputFormatOfName("/a/b.plt", kFormatKml), kFormatOzi);
  EXPECT_EQ(OutputFormatOfName("/a/b.kml.gpx", kFormatKml), kFormatGpx);
  EXPECT_EQ(OutputFormatOfName("/a/b.txt", kFormatGpx), kFormatGpx);
}

TEST(ChooseOutputFile, SetsPathNameFormatAndFolder) {
  TestProgram t;
  t->OutputName = "lake.kml";
  t->OutputTrackPath = "/out";
  t.platform.dialogAnswers.push_back("/res/lake.plt");
  ASSERT_EQ(ChooseOutputFile(*t), 0);
  const auto dialog = t.platform.CallsOf("SaveFileDialog").at(0).dialog;
  EXPECT_EQ(dialog.filter, "Save to GE (*.kml)|*.kml|Save to GPX (*.gpx)|*.gpx|Save to Ozi (*.plt)|*.plt");
  EXPECT_EQ(dialog.initialFolder, "/out");
  EXPECT_EQ(dialog.proposedName, "lake");
  EXPECT_EQ(t->OutputPath, "/res/lake.plt");
  EXPECT_EQ(t->OutputName, "lake.plt");
  EXPECT_EQ(t->OutputFormat, kFormatOzi);
  EXPECT_EQ(t->OutputTrackPath, "/res");
}

TEST(ChooseOutputFile, WaypointModeOffersNoOziAndKeepsPlacemarkFolder) {
  TestProgram t;
  t->ProgramMode = kModeConvertWaypoints;
  t->WptFileType = 1;
  t->OutputPlacemarkPath = "/pm";
  t.platform.dialogAnswers.push_back("/new/w.kml");
  ASSERT_EQ(ChooseOutputFile(*t), 0);
  EXPECT_EQ(t.platform.CallsOf("SaveFileDialog").at(0).dialog.filter,
            "Save to GE (*.kml)|*.kml|Save to GPX (*.gpx)|*.gpx");
  EXPECT_EQ(t.platform.CallsOf("SaveFileDialog").at(0).dialog.initialFolder, "/pm");
  EXPECT_EQ(t->OutputPlacemarkPath, "/new");
}

struct Refusal {
  int16_t mode, trackType, wptType;
  const char* path;
  const char* text;
};

TEST(ChooseOutputFile, RefusesTheThreeCombinations) {
  const Refusal cases[] = {
      {kModeConvertTracks, 1, 0, "/o/t.gpx", "You cannot write an output GPX track file when the input file is GPX."},
      {kModeConvertWaypoints, 0, 1, "/o/w.gpx",
       "You cannot write an output GPX waypoint file when the input file is GPX."},
      {kModeConvertWaypoints, 0, 0, "/o/w.wpt",
       "You cannot write an output OZI waypoint file when the input file is OZI."},
  };
  for (const auto& c : cases) {
    TestProgram t;
    t->ProgramMode = c.mode;
    t->TrackFileType = c.trackType;
    t->WptFileType = c.wptType;
    t->OutputTrackPath = t->OutputPlacemarkPath = "/kept";
    t.platform.dialogAnswers.push_back(c.path);
    EXPECT_EQ(ChooseOutputFile(*t), 1) << c.path;
    const auto messages = t.platform.Messages();
    ASSERT_EQ(messages.size(), 1u);
    EXPECT_EQ(messages[0].text, c.text);
    EXPECT_EQ(messages[0].title, " Error!...");
    EXPECT_EQ(messages[0].icon, MsgIcon::Information);
    EXPECT_EQ(t->OutputTrackPath, "/kept");
    EXPECT_EQ(t->OutputPlacemarkPath, "/kept");
  }
}

TEST(FixLineEnds, BareLineFeedsBecomeCrLfWithNothingLost) {
  TestProgram t;
  std::string text;
  for (int i = 0; i < 40; ++i) text += "45.1000,-75.2000,line " + std::to_string(i) + "\n";
  const std::string path = t.folder.File("lf.txt");
  WriteFile(path, text);
  t->LastSourceFile = path;
  FixLineEnds(*t);
  std::string expected;
  for (int i = 0; i < 40; ++i) expected += "45.1000,-75.2000,line " + std::to_string(i) + "\r\n";
  EXPECT_EQ(ReadFile(path), expected);
}

TEST(FixLineEnds, MissingFinalLineEndIsAdded) {
  TestProgram t;
  const std::string path = t.folder.File("lf.txt");
  const std::string body(310, 'x');
  WriteFile(path, body + "\nlast");
  t->LastSourceFile = path;
  FixLineEnds(*t);
  EXPECT_EQ(ReadFile(path), body + "\r\nlast\r\n");
}

TEST(FixLineEnds, ShortFirstLineOrProperLineEndsLeaveTheFileAlone) {
  TestProgram t;
  const std::string path = t.folder.File("ok.txt");
  // First line under 300 characters: not looked at further.
  WriteFile(path, "short\nline two\n");
  t->LastSourceFile = path;
  FixLineEnds(*t);
  EXPECT_EQ(ReadFile(path), "short\nline two\n");
  // A long first line with CR LF ends keeps every later line.
  const std::string longLine(500, 'y');
  WriteFile(path, longLine + "\r\nsecond\r\nthird\r\n");
  FixLineEnds(*t);
  EXPECT_EQ(ReadFile(path), longLine + "\r\nsecond\r\nthird\r\n");
}

// The file is converted in pieces: a CR LF or a bare LF that meets a piece boundary is handled
// as anywhere else, and nothing is left beside the file.
TEST(FixLineEnds, LargeFilesAreConvertedAcrossEveryBoundary) {
  TestProgram t;
  const std::string path = t.folder.File("big.txt");
  constexpr std::size_t kPiece = 1 << 20;
  std::string text(kPiece - 1, 'a');  // no CR anywhere in the first line
  text += "\r\nb";                    // CR the last byte of the first piece, LF the first of the next
  text.append(kPiece - 3, 'c');
  text += "\n\nd";                    // a bare LF ends the second piece, another begins the third
  WriteFile(path, text);
  t->LastSourceFile = path;
  FixLineEnds(*t);
  std::string expected(kPiece - 1, 'a');
  expected += "\r\nb";
  expected.append(kPiece - 3, 'c');
  expected += "\r\n\r\nd\r\n";
  EXPECT_EQ(ReadFile(path), expected);
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(t.folder.path()), {}), 1);
}

TEST(FixLineEnds, MissingFileRaises) {
  TestProgram t;
  t->LastSourceFile = t.folder.File("none.plt");
  EXPECT_THROW(FixLineEnds(*t), RuntimeError);
}

TEST(NormaliseViewSettings, BringsViewValuesIntoRange) {
  TestProgram t;
  auto& f = t->frmMain;
  f.txtEyeAlt.Text = "99.9";
  f.txtTilt.Text = "90.5";
  f.txtHeading.Text = "-1";
  NormaliseViewSettings(*t);
  EXPECT_EQ(f.txtEyeAlt.Text, "100");
  EXPECT_EQ(f.txtTilt.Text, "45");
  EXPECT_EQ(f.txtHeading.Text, "0");
  f.txtEyeAlt.Text = "100";
  f.txtTilt.Text = "90";
  f.txtHeading.Text = "360";
  NormaliseViewSettings(*t);
  EXPECT_EQ(f.txtEyeAlt.Text, "100");
  EXPECT_EQ(f.txtTilt.Text, "90");
  EXPECT_EQ(f.txtHeading.Text, "360");
}

}  // namespace
}  // namespace molvar
