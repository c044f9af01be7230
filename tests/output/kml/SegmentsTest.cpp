// Segment cutting, colour rules and the style block.
#include <gtest/gtest.h>

#include <utility>
#include <vector>

#include "core/Errors.h"
#include "core/SpeedDistance.h"
#include "output/kml/Segments.h"
#include "support/KmlTesting.h"

namespace molvar {
namespace {

using testing::TestProgram;
using testing::WrittenLines;

void AddPoints(TestProgram& t, int count) {
  for (int i = 0; i < count; ++i) t.AddPoint(45.0 + 0.01 * i, -75.0, "2007-05-01 10:0" + std::to_string(i) + ":00 AM");
}

std::vector<std::pair<int32_t, int32_t>> Segments(Molvar& m) {
  std::vector<std::pair<int32_t, int32_t>> calls;
  ForEachSegment(m, [&calls](int32_t start, int32_t count) { calls.emplace_back(start, count); });
  return calls;
}

TEST(Segments, LoopStartsASegmentAtEveryFlagWithItsPointCount) {
  TestProgram t;
  Molvar& m = *t;
  AddPoints(t, 6);
  m.Track.at(3).Flag = 1;
  m.Track.at(6).Flag = 1;
  MarkDays(m);
  MarkSegments(m);
  EXPECT_EQ(Segments(m), (std::vector<std::pair<int32_t, int32_t>>{{1, 2}, {3, 3}, {6, 1}}));
  EXPECT_EQ(m.Kml.SegmentCount, 3);
  EXPECT_EQ(m.Kml.CurrentPoint, 6);
  EXPECT_EQ(m.Kml.DayCount, 1);
}

TEST(Segments, CollapsedLoopStartsOnlyAtNewDaysAndLeavesCurrentPoint) {
  TestProgram t;
  Molvar& m = *t;
  t.AddPoint(45.00, -75.0, "2007-05-01 11:00:00 PM");
  t.AddPoint(45.01, -75.0, "2007-05-01 11:01:00 PM");
  t.AddPoint(45.02, -75.0, "2007-05-02 01:00:00 AM");
  t.AddPoint(45.03, -75.0, "2007-05-03 01:00:00 AM");
  m.Track.at(2).Flag = 1;
  m.frmMain.chkCollapse.Value = 1;
  MarkDays(m);
  MarkSegments(m);
  m.Kml.CurrentPoint = 0;
  EXPECT_EQ(Segments(m), (std::vector<std::pair<int32_t, int32_t>>{{1, 2}, {3, 1}, {4, 1}}));
  EXPECT_EQ(m.Kml.SegmentCount, 3);
  EXPECT_EQ(m.Kml.DayCount, 3);
  EXPECT_EQ(m.Kml.CurrentPoint, 0);
}

TEST(Segments, ColourStringsCarryTheTransparencyAsTwoHexDigits) {
  TestProgram t;
  Molvar& m = *t;
  EXPECT_EQ(TrackColorString(m, 0, 0), "FF0000FF");
  m.TransparencyLevel = 10;
  EXPECT_EQ(TrackColorString(m, 1, 1), "0A00FF00");
  m.TransparencyLevel = 0;
  m.UserColorPointer = 9;
  EXPECT_EQ(TrackColorString(m, 0, 0), "00800080");
  // A non-zero selector takes the entry, not the user's colour.
  EXPECT_EQ(TrackColorString(m, 4, 6), "004DABFB");
}

TEST(Segments, SpeedColourFollowsTheBandOfThePointAfterTheSegmentStart) {
  TestProgram t;
  Molvar& m = *t;
  AddPoints(t, 3);
  m.Track.at(1).ColorBand = 2;
  m.Track.at(2).ColorBand = 7;
  m.Track.at(3).ColorBand = 4;
  m.ColorVaryMode = 3;
  m.Kml.CurrentPoint = 1;
  EXPECT_EQ(VaryColorPtr(m, 0), 7);
  // Speed colouring overrides the entry of a selector for the line colour.
  EXPECT_EQ(TrackColorString(m, 5, 1), "FFFFC0C0");
  // The last point starts a segment of its own: no point follows it.
  m.Kml.CurrentPoint = 3;
  EXPECT_EQ(VaryColorPtr(m, 0), 4);
  EXPECT_TRUE(t.platform.Messages().empty());
}

TEST(Segments, VaryColorPtrReportsAnIndexOutsideThePaletteAndUsesEntryZero) {
  TestProgram t;
  Molvar& m = *t;
  m.UserColorPointer = 12;
  EXPECT_EQ(VaryColorPtr(m, 0), 0);
  EXPECT_EQ(VaryColorPtr(m, 11), 0);
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 2u);
  EXPECT_EQ(boxes[0].text, "VaryColorPtr out of range: \r\n12");
  EXPECT_EQ(boxes[0].title, " Error!");
  EXPECT_EQ(boxes[0].buttons, MsgButtons::OK);
  EXPECT_EQ(boxes[0].icon, MsgIcon::Exclamation);
  EXPECT_EQ(boxes[1].text, "VaryColorPtr out of range: \r\n10");
  // Segment and day colours wrap around the ten entries.
  m.UserColorPointer = 7;
  m.ColorVaryMode = 1;
  m.Kml.SegmentCount = 4;
  EXPECT_EQ(VaryColorPtr(m, 0), 0);
  m.ColorVaryMode = 2;
  m.Kml.DayCount = 2;
  EXPECT_EQ(VaryColorPtr(m, 0), 8);
}

TEST(Segments, StyleWithASelectorShowsThatIconButKeepsEntryZeroForTheLine) {
  TestProgram t;
  Molvar& m = *t;
  m.UserColorPointer = 5;
  m.AltitudeMode = 2;
  m.frmMain.sldrWidth.Value = 3;
  const auto lines = WrittenLines(t, [](Molvar& mv) { WriteKmlStyle(mv, 7); });
  EXPECT_EQ(lines, (std::vector<std::string>{
                       "  <Style>", "    <IconStyle>",
                       "      <Icon><href>" + t.folder.path().string() + "/Icons/6.png</href></Icon>",
                       "    </IconStyle>", "    <LineStyle>", "      <color>FF0000FF</color>", "      <width>3</width>",
                       "    </LineStyle>", "    <PolyStyle id=\"khPolyStyle566\"> <color>FF0000FF</color> </PolyStyle>",
                       "  </Style>"}));
  m.OutputMode = kOutputGoogleMaps;
  m.AltitudeMode = 1;
  const auto maps = WrittenLines(t, [](Molvar& mv) { WriteKmlStyle(mv, 0); });
  EXPECT_EQ(maps, (std::vector<std::string>{"  <Style>", "    <LineStyle>", "      <color>FF00FFFF</color>",
                                            "      <width>3</width>", "    </LineStyle>", "  </Style>"}));
}

TEST(Segments, SegmentPastTheLastPointReportsTheBug) {
  TestProgram t;
  AddPoints(t, 2);
  WrittenLines(t, [](Molvar& mv) { WriteKmlTrackSegment(mv, 5, 1); });
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_EQ(boxes[0].text, "WriteKmlTrackSegment bug " + RuntimeError::StandardDescription(kErrSubscript));
  EXPECT_EQ(boxes[0].title, "Error");
  EXPECT_EQ(boxes[0].icon, MsgIcon::Exclamation);
}

TEST(Segments, TitleUsesTheDayCountWhenCollapsed) {
  TestProgram t;
  Molvar& m = *t;
  AddPoints(t, 2);
  m.Track.at(1).SegCtr = 4;
  m.Track.at(1).DayCtr = 9;
  m.Kml.SegmentCount = 3;
  EXPECT_EQ(SegmentTitle(m, 1), "#3 10:00:00 AM (4)");
  m.frmMain.chkCollapse.Value = 1;
  EXPECT_EQ(SegmentTitle(m, 1), "#3 10:00:00 AM (9)");
  EXPECT_TRUE(t.platform.CallsOf("InputBox").empty());
}

}  // namespace
}  // namespace molvar
