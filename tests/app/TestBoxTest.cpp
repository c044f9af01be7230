#include "app/TestBox.h"

#include <gtest/gtest.h>

#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::TestProgram;

const std::string kHeader =
    "Ctr        Latitude            Longitude               Date/Time           Alt(m) Spd(kph)  Dist(km)  Flag  "
    "SegCtr   DayCtr\r\n\r\n";

TrackPoint& Point(TestProgram& t) {
  auto& track = t->Track;
  track.PointCount += 1;
  track.GrowTrackStore(track.PointCount);
  return track.at(track.PointCount);
}

std::size_t Count(const std::string& text, std::string_view what) {
  std::size_t n = 0;
  for (std::size_t at = text.find(what); at != std::string::npos; at = text.find(what, at + what.size())) ++n;
  return n;
}

TEST(TestModeSwitch, OnGrowsTheWindowOffRestoresAndEmpties) {
  TestProgram t;
  MainForm& f = t->frmMain;
  f.window.Width = 9000;
  f.window.Height = 6000;
  EXPECT_EQ(f.txtTest.Text, "Test data appears here");
  EXPECT_FALSE(f.txtTest.Visible);

  mnuTestItem_Click(*t);
  EXPECT_TRUE(f.mnuTestItem.Checked);
  EXPECT_EQ(t->TestMode, 1);
  EXPECT_EQ(f.window.Width, 11320);
  EXPECT_EQ(f.window.Height, 12380);
  EXPECT_EQ(f.txtTest.Left, 120);
  EXPECT_EQ(f.txtTest.Top, 6360);
  EXPECT_EQ(f.txtTest.Width, 11000);
  EXPECT_EQ(f.txtTest.Height, 5320);
  EXPECT_TRUE(f.txtTest.Visible);
  EXPECT_EQ(f.lblTest.Caption,
            "You are in test mode. All input data is sent to the textbox below.\r\n"
            "Select the text, copy it, and email it to me if there is a problem.\r\n"
            "Also email the source and output files, if applicable.\r\n\r\n"
            "Note: Only the first 500 data points are shown!");

  AppendToTestBox(*t, "$GPGGA,1");
  mnuTestItem_Click(*t);
  EXPECT_FALSE(f.mnuTestItem.Checked);
  EXPECT_EQ(t->TestMode, 0);
  EXPECT_EQ(f.window.Width, 9000);
  EXPECT_EQ(f.window.Height, 6000);
  EXPECT_FALSE(f.txtTest.Visible);
  EXPECT_EQ(f.txtTest.Text, "");

  mnuTestItem_Click(*t);
  EXPECT_EQ(f.txtTest.Text, "");
  EXPECT_EQ(f.window.Height, 12380);
}

TEST(TestModeSwitch, ClearButtonEmptiesTheBox) {
  TestProgram t;
  AppendToTestBox(*t, "line");
  cmdClearTestBox_Click(*t);
  EXPECT_EQ(t->frmMain.txtTest.Text, "");
}

TEST(AppendToTestBox, AddsLineEndAndKeepsTheNewestMebibyte) {
  TestProgram t;
  std::string& box = t->frmMain.txtTest.Text;
  box.clear();
  AppendToTestBox(*t, "first");
  AppendToTestBox(*t, "");
  EXPECT_EQ(box, "first\r\n\r\n");

  // 1024 lines of 1024 characters with their CR LF fill the box exactly.
  box.clear();
  for (int i = 0; i < 1024; ++i) {
    std::string line = "L" + std::to_string(1000 + i);
    line.resize(1022, '.');
    AppendToTestBox(*t, line);
  }
  ASSERT_EQ(box.size(), kTestBoxLimit);
  EXPECT_EQ(box.substr(0, 5), "L1000");

  AppendToTestBox(*t, "x");
  EXPECT_EQ(box.size(), kTestBoxLimit - 1024 + 3);
  EXPECT_EQ(box.substr(0, 5), "L1001");
  EXPECT_EQ(box.substr(box.size() - 3), "x\r\n");

  // A long line pushes out as many whole lines as it needs.
  AppendToTestBox(*t, std::string(3000, 'y'));
  EXPECT_LE(box.size(), kTestBoxLimit);
  EXPECT_EQ(box.substr(0, 5), "L1003");
  EXPECT_EQ(box.substr(box.size() - 5), "yyy\r\n");
}

TEST(DisplayTrackArray, EmptyStoreListsOnlyTheHeader) {
  TestProgram t;
  t->frmMain.txtTest.Text = "old";
  DisplayTrackArray(*t);
  EXPECT_EQ(t->frmMain.txtTest.Text, kHeader);
}

TEST(DisplayTrackArray, RowsUseTheDigitPatternsInStoredUnits) {
  TestProgram t;
  t->UnitFactor = 0.6213712;  // listing ignores the unit menus
  TrackPoint& a = Point(t);
  a.Latitude = -45.5;
  a.Longitude = 170.25;
  a.DateTime = "12/01/2026 10:00:00";
  a.Altitude = 12;
  a.Speed = 7.6;
  a.Distance = 0.04;
  a.Flag = 3;
  a.SegCtr = 1;
  a.DayCtr = 2;
  TrackPoint& b = Point(t);
  b.Latitude = 0.1234567890126;
  b.Longitude = -0.5;
  b.DateTime = "";
  b.Altitude = -5;
  b.Speed = 1234.4;
  b.Distance = 1234.56;
  b.Flag = -1;
  b.SegCtr = 12345;
  b.DayCtr = 0;
  cmdDisplayArray_Click(*t);
  EXPECT_EQ(t->frmMain.txtTest.Text,
            kHeader +
                "001     -45.500000000000     170.250000000000     12/01/2026 10:00:00     0012     008     000.0     "
                "3     0001     0002\r\n"
                "002     0.123456789013     -0.500000000000          -0005     1234     1234.6     -1     12345     "
                "0000\r\n");
}

TEST(DisplayTrackArray, CapsAtFiveHundredWithNote) {
  TestProgram t;
  for (int i = 0; i < 499; ++i) Point(t);
  DisplayTrackArray(*t);
  EXPECT_EQ(Count(t->frmMain.txtTest.Text, "\r\n"), 2u + 499u);
  EXPECT_EQ(t->frmMain.txtTest.Text.find("Note:"), std::string::npos);

  Point(t);
  DisplayTrackArray(*t);
  const std::string& box = t->frmMain.txtTest.Text;
  const std::string note = "\r\nNote: There are 500 trackpoints. Only the first 500 data points are shown!\r\n";
  ASSERT_GE(box.size(), note.size());
  EXPECT_EQ(box.substr(box.size() - note.size()), note);
  EXPECT_EQ(Count(box, "\r\n"), 2u + 500u + 2u);
  EXPECT_NE(box.find("\r\n500     0.000000000000"), std::string::npos);

  Point(t);
  Point(t);
  DisplayTrackArray(*t);
  EXPECT_EQ(Count(t->frmMain.txtTest.Text, "\r\n"), 2u + 500u + 2u);
  EXPECT_EQ(t->frmMain.txtTest.Text.find("501     "), std::string::npos);
  EXPECT_NE(t->frmMain.txtTest.Text.find("There are 502 trackpoints."), std::string::npos);
}

}  // namespace
}  // namespace molvar
