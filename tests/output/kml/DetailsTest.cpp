// The details folder: one dot per track point, grouped by segment.
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "core/Errors.h"
#include "core/SpeedDistance.h"
#include "output/kml/Details.h"
#include "support/KmlTesting.h"

namespace molvar {
namespace {

using testing::TestProgram;
using molvar::ScriptedPlatform;
using testing::WrittenLines;

std::vector<std::string> StartingWith(const std::vector<std::string>& lines, const std::string& prefix) {
  std::vector<std::string> found;
  for (const auto& l : lines) {
    if (l.rfind(prefix, 0) == 0) found.push_back(l);
  }
  return found;
}

std::size_t IndexOf(const std::vector<std::string>& lines, const std::string& line) {
  for (std::size_t i = 0; i < lines.size(); ++i) {
    if (lines[i] == line) return i;
  }
  return lines.size();
}

std::vector<std::string> Details(TestProgram& t) {
  MarkDays(*t);
  MarkSegments(*t);
  return WrittenLines(t, [](Molvar& m) { WriteDetailedData(m); });
}

// Two points a day on three days, with a break inside the first day.
void AddThreeDays(TestProgram& t) {
  const char* times[] = {"2007-05-01 10:00:00 AM", "2007-05-01 10:01:00 AM", "2007-05-01 10:02:00 AM",
                         "2007-05-02 10:00:00 AM", "2007-05-03 10:00:00 AM", "2007-05-03 10:01:00 AM"};
  for (int i = 0; i < 6; ++i) t.AddPoint(45.0 + 0.01 * i, -75.0, times[i]);
  t->Track.at(2).Flag = 1;
}

TEST(Details, OneDocumentPerSegmentNumberedFromOne) {
  TestProgram t;
  AddThreeDays(t);
  const auto lines = Details(t);
  EXPECT_EQ(StartingWith(lines, "<name>"),
            (std::vector<std::string>{"<name>Details</name>", "<name>Segment #1</name>", "<name>Segment #2</name>",
                                      "<name>Segment #3</name>", "<name>Segment #4</name>"}));
  // A new segment document opens after the comment of its first point.
  const std::size_t at = IndexOf(lines, "<!--  Detailed data #2  -->");
  ASSERT_LT(at + 4, lines.size());
  EXPECT_EQ(lines[at + 1], "</Document>");
  EXPECT_EQ(lines[at + 2], "");
  EXPECT_EQ(lines[at + 3], "<Document>");
  EXPECT_EQ(lines[at + 4], "<name>Segment #2</name>");
  EXPECT_EQ(std::vector<std::string>(lines.end() - 5, lines.end()),
            (std::vector<std::string>{"</Document>", "</Document>", "<!--  End of detailed data  -->", "", ""}));
}

TEST(Details, CollapsedSegmentsAreNumberedByDay) {
  TestProgram t;
  AddThreeDays(t);
  t->frmMain.chkCollapse.Value = 1;
  const auto lines = Details(t);
  EXPECT_EQ(StartingWith(lines, "<name>Segment"),
            (std::vector<std::string>{"<name>Segment #1</name>", "<name>Segment #2</name>", "<name>Segment #3</name>"}));
  EXPECT_EQ(IndexOf(lines, "<name>Segment #2</name>"), IndexOf(lines, "<!--  Detailed data #4  -->") + 4);
  EXPECT_EQ(IndexOf(lines, "<name>Segment #3</name>"), IndexOf(lines, "<!--  Detailed data #5  -->") + 4);
}

TEST(Details, RealTimeModeDetailsOnlyTheLastPoints) {
  TestProgram t;
  for (int i = 0; i < 100; ++i) t.AddPoint(45.0 + 0.0001 * i, -75.0, "2007-05-01 10:00:00 AM");
  t->ProgramMode = kModeRealTimeNmea;
  t->frmMain.txtTrkLimit.Text = "20";
  const auto comments = StartingWith(Details(t), "<!--  Detailed data #");
  ASSERT_EQ(comments.size(), 20u);
  EXPECT_EQ(comments.front(), "<!--  Detailed data #81  -->");
  EXPECT_EQ(comments.back(), "<!--  Detailed data #100  -->");

  struct {
    const char* limit;
    int32_t start;
  } const limits[] = {{"1", 1}, {"0", 100}, {"100", 1}, {"500", 1}, {"abc", 100}, {"99", 2}};
  for (const auto& l : limits) {
    t->frmMain.txtTrkLimit.Text = l.limit;
    DetailStartIndex(*t);
    EXPECT_EQ(t->Detail.DetailStart, l.start) << l.limit;
  }
  t->ProgramMode = kModeConvertTracks;
  t->frmMain.txtTrkLimit.Text = "20";
  DetailStartIndex(*t);
  EXPECT_EQ(t->Detail.DetailStart, 1);
}

TEST(Details, GoogleMapsOutputHasNoDetails) {
  TestProgram t;
  AddThreeDays(t);
  t->OutputMode = kOutputGoogleMaps;
  EXPECT_TRUE(Details(t).empty());
}

TEST(Details, SpeedColouringAddsTheStatusOfEachPointAfterItsCharacterData) {
  TestProgram t;
  t.AddPoint(45.00, -75.0, "2007-05-01 10:00:00 AM");
  t.AddPoint(45.01, -75.0, "2007-05-01 10:01:00 AM");
  t->Track.at(1).ColorBand = 9;
  t->Track.at(2).ColorBand = 12;
  t->ColorVaryMode = 3;
  auto lines = Details(t);
  std::size_t at = IndexOf(lines, "  <br></br>Distance from start: 0.00 km]]>");
  ASSERT_LT(at + 3, lines.size());
  EXPECT_EQ(lines[at + 1], "    <br></br>GPS quality: EGNOS");
  EXPECT_EQ(lines[at + 2], " (9)");
  EXPECT_EQ(lines[at + 3], "  </description>");
  at = IndexOf(lines, "  <br></br>Distance from start: 1.11 km]]>");
  ASSERT_LT(at + 2, lines.size());
  EXPECT_EQ(lines[at + 1], " (12)");
  EXPECT_EQ(lines[at + 2], "  </description>");

  // KEL files carry no fix status.
  t->TrackFileType = 8;
  lines = Details(t);
  EXPECT_TRUE(StartingWith(lines, " (").empty());
  EXPECT_TRUE(StartingWith(lines, "    <br></br>GPS quality").empty());
}

TEST(Details, StatusTableNamesAllTenBands) {
  const char* names[] = {"Invalid",   "GPS fix (SPS)", "DGPS fix", "PPS fix",    "Fixed RTK",
                         "Float RTK", "Estimated",     "Manual",   "Simulation", "EGNOS"};
  TestProgram t;
  for (int i = 0; i < 10; ++i) t.AddPoint(45.0 + 0.01 * i, -75.0, "2007-05-01 10:00:00 AM");
  for (int i = 0; i < 10; ++i) t->Track.at(i + 1).ColorBand = static_cast<int16_t>(i);
  t->ColorVaryMode = 3;
  const auto status = StartingWith(Details(t), "    <br></br>GPS quality: ");
  ASSERT_EQ(status.size(), 10u);
  for (int i = 0; i < 10; ++i) EXPECT_EQ(status[static_cast<std::size_t>(i)], std::string("    <br></br>GPS quality: ") + names[i]);
}

TEST(Details, CsvStatusPicksTheDotColourAndSpeedAsAltitudeLiftsTheDots) {
  TestProgram t;
  t.AddPoint(45.00, -75.0, "2007-05-01 10:00:00 AM");
  t.AddPoint(45.01, -75.0, "2007-05-01 10:01:00 AM", 12.5);
  t->Track.at(2).ColorBand = 3;
  t->TrackFileType = 4;
  t->AltitudeMode = 3;
  t->SpeedGain = 9;
  const auto lines = Details(t);
  const auto icons = StartingWith(lines, "      <Icon><href>");
  ASSERT_EQ(icons.size(), 1u);
  EXPECT_EQ(icons[0], "      <Icon><href>" + t.folder.path().string() + "/Icons/2.png</href></Icon>");
  const auto coords = StartingWith(lines, "    <coordinates>");
  EXPECT_EQ(coords, (std::vector<std::string>{"    <coordinates>-75,45,0</coordinates>",
                                              "    <coordinates>-75,45.01,112.5</coordinates>"}));
}

TEST(Details, ThresholdBoundariesUseTheSpeedAsShown) {
  TestProgram t;
  t->UnitFactor = 0.6213712;  // mph
  t->SpeedUnitLabel = " mph";
  t.AddPoint(45.00, -75.0, "2007-05-01 10:00:00 AM");
  const double speeds[] = {80.4, 80.54, 96.6, 96.7};  // 50.0, 50.0, 60.0, 60.1 mph as shown
  for (int i = 0; i < 4; ++i) t.AddPoint(45.01 + 0.01 * i, -75.0, "2007-05-01 10:01:00 AM", speeds[i]);
  t->frmMain.chkUseThreshold.Value = 1;
  t->frmMain.txtSpeedThreshold.Text = "50";
  const auto lines = Details(t);
  const auto icons = StartingWith(lines, "      <Icon><href>");
  const std::string dir = "      <Icon><href>" + t.folder.path().string() + "/Icons/";
  // Stopped first point, then 50.0 (none), 50.0 (none), 60.0 (orange), 60.1 (red).
  EXPECT_EQ(icons, (std::vector<std::string>{dir + "2.png</href></Icon>", dir + "6.png</href></Icon>",
                                             dir + "0.png</href></Icon>"}));
  EXPECT_EQ(StartingWith(lines, "  <br></br>Speed: "),
            (std::vector<std::string>{"  <br></br>Speed: 0.0 mph", "  <br></br>Speed: 50.0 mph", "  <br></br>Speed: 50.0 mph",
                                      "  <br></br>Speed: 60.0 mph", "  <br></br>Speed: 60.1 mph"}));
  // A threshold of 0 turns the check off.
  t->frmMain.txtSpeedThreshold.Text = "0";
  EXPECT_TRUE(StartingWith(Details(t), "      <Icon><href>").empty());
}

// A platform whose palette warning box fails, as a broken desktop might.
class FailingPaletteBox : public ScriptedPlatform {
 public:
  int MsgBox(std::string_view text, std::string_view title, MsgButtons buttons, MsgIcon icon) override {
    const int answer = ScriptedPlatform::MsgBox(text, title, buttons, icon);
    if (text.rfind("VaryColorPtr", 0) == 0) throw RuntimeError(kErrOverflow);
    return answer;
  }
};

TEST(Details, AnErrorEndsTheBlockWithTheBugBox) {
  FailingPaletteBox platform;  // outlives the program that uses it
  TestProgram t;
  t.m = std::make_unique<Molvar>(platform, t.folder.path().string());
  t.AddPoint(45.00, -75.0, "2007-05-01 10:00:00 AM");
  t.AddPoint(45.01, -75.0, "2007-05-01 10:01:00 AM");
  t->Track.at(2).ColorBand = 12;  // a CSV status beyond the palette
  t->TrackFileType = 4;
  const auto lines = Details(t);
  const auto boxes = platform.Messages();
  ASSERT_EQ(boxes.size(), 2u);
  EXPECT_EQ(boxes[0].text, "VaryColorPtr out of range: \r\n11");
  EXPECT_EQ(boxes[1].text, "WriteDetailedData bug " + RuntimeError::StandardDescription(kErrOverflow));
  EXPECT_EQ(boxes[1].title, "Error");
  EXPECT_EQ(boxes[1].buttons, MsgButtons::OK);
  EXPECT_EQ(boxes[1].icon, MsgIcon::Exclamation);
  // The block stops where the error struck.
  ASSERT_FALSE(lines.empty());
  EXPECT_EQ(lines.back(), "    <IconStyle>");
}

}  // namespace
}  // namespace molvar
