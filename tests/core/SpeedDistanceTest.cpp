#include "core/SpeedDistance.h"

#include <gtest/gtest.h>

#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::TestProgram;

TEST(CalcSpeedDistance, FlatEarthStepAndWholeKmh) {
  TestProgram p;
  p.AddPoint(45.00, -75.0, "2007-03-14 12:00:00 PM");
  p.AddPoint(45.01, -75.0, "2007-03-14 12:01:00 PM");
  EXPECT_EQ(p->Track.at(1).Distance, 0);
  EXPECT_EQ(p->Track.at(1).Speed, 0);
  EXPECT_DOUBLE_EQ(p->Track.at(2).Distance, 1.1119892);
  EXPECT_EQ(p->Track.at(2).Speed, 67);
  p.AddPoint(45.01, -74.99, "2007-03-14 12:02:00 PM");
  // dx = 0.01 * cos(45.01 deg) degrees
  EXPECT_DOUBLE_EQ(p->Track.at(3).Distance, 1.8981471);
  EXPECT_EQ(p->Track.at(3).Speed, 47);
  EXPECT_EQ(p.platform.Messages().size(), 0u);
}

TEST(CalcSpeedDistance, ZeroCoordinatesAndUnknownTimes) {
  TestProgram p;
  p.AddPoint(45.00, -75.0, "2007-03-14 12:00:00 PM");
  p.AddPoint(0, -75.0, "2007-03-14 12:01:00 PM");
  p.AddPoint(45.01, -75.0, "2007-03-14 12:02:00 PM");
  p.AddPoint(45.02, -75.0, "2007-03-14 12:02:00 PM");  // same time
  p.AddPoint(45.03, -75.0, "2006-01-01 00:00:00");
  p.AddPoint(45.04, -75.0, "");
  p.AddPoint(45.05, -75.0, "2007-03-14 12:01:00 PM");
  p.AddPoint(45.06, -75.0, "2007-03-14 12:00:00 PM");  // out of sequence
  const auto& t = p->Track;
  EXPECT_EQ(t.at(2).Distance, 0);
  EXPECT_EQ(t.at(3).Distance, 0);  // point 2 is at latitude 0: nothing computed
  EXPECT_DOUBLE_EQ(t.at(4).Distance, 1.1119892);
  EXPECT_EQ(t.at(4).Speed, 0);
  EXPECT_EQ(t.at(5).Speed, 0);
  EXPECT_EQ(t.at(6).Speed, 0);
  EXPECT_EQ(t.at(7).Speed, 0);
  EXPECT_EQ(t.at(8).Speed, -67);
}

TEST(CalcSpeedDistance, KeepsReaderSpeedsAndSkipsSelfTimedSources) {
  TestProgram p;
  p.AddPoint(45.00, -75.0, "2007-03-14 12:00:00 PM");
  p.AddPoint(45.01, -75.0, "2007-03-14 12:01:00 PM", 12);
  EXPECT_EQ(p->Track.at(2).Speed, 12);

  for (int16_t type : {4, 5}) {
    TestProgram csv;
    csv->TrackFileType = type;
    csv.AddPoint(45.00, -75.0, "2007-03-14 12:00:00 PM");
    csv.AddPoint(45.01, -75.0, "2007-03-14 12:01:00 PM");
    EXPECT_EQ(csv->Track.at(2).Speed, 0);
    EXPECT_DOUBLE_EQ(csv->Track.at(2).Distance, 1.1119892);
  }
  TestProgram live;
  live->ProgramMode = kModeRealTimeNmea;
  live.AddPoint(45.00, -75.0, "2007-03-14 12:00:00 PM");
  live.AddPoint(45.01, -75.0, "2007-03-14 12:01:00 PM");
  EXPECT_EQ(live->Track.at(2).Speed, 0);
}

TEST(CalcSpeedDistance, UnreadableTimeIsASnag) {
  TestProgram p;
  p.AddPoint(45.00, -75.0, "2007-03-14 12:00:00 PM");
  p.AddPoint(45.01, -75.0, "not a time");
  EXPECT_DOUBLE_EQ(p->Track.at(2).Distance, 1.1119892);
  EXPECT_EQ(p->Track.at(2).Speed, 0);
  auto messages = p.platform.Messages();
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_EQ(messages[0].text, "CalcSpeedDistance snag Type mismatch");
  EXPECT_EQ(messages[0].title, " Whoa! An error!");
}

TEST(AssignSpeedBand, BandsInDisplayUnitsAndSegmentStarts) {
  TestProgram p;
  const double speeds[] = {5, 9.99, 10, 40, 95};
  for (double s : speeds) {
    p.AddPoint(45, -75, "", s);
    AssignSpeedBand(*p, p->Track.PointCount);
  }
  const auto& t = p->Track;
  EXPECT_EQ(t.at(1).ColorBand, 0);
  EXPECT_EQ(t.at(1).Flag, 1);
  EXPECT_EQ(t.at(2).ColorBand, 0);
  EXPECT_EQ(t.at(2).Flag, 0);
  EXPECT_EQ(t.at(3).ColorBand, 1);
  EXPECT_EQ(t.at(3).Flag, 1);
  EXPECT_EQ(t.at(4).ColorBand, 4);
  EXPECT_EQ(t.at(5).ColorBand, 9);

  TestProgram mph;
  mph->SpeedUnits = 1;
  mph.AddPoint(45, -75, "");
  mph.AddPoint(45, -75, "", 40);
  AssignSpeedBand(*mph, 2);
  EXPECT_EQ(mph->Track.at(2).ColorBand, 2);
  TestProgram knots;
  knots->SpeedUnits = 2;
  knots.AddPoint(45, -75, "");
  knots.AddPoint(45, -75, "", 40);
  AssignSpeedBand(*knots, 2);
  EXPECT_EQ(knots->Track.at(2).ColorBand, 2);  // 21.6 knots
}

TEST(MarkDays, EachNewDayStartsASegment) {
  TestProgram p;
  for (const char* t : {"2007-03-14 10:00:00 PM", "2007-03-14 11:00:00 PM", "2007-03-15 01:00:00 AM",
                        "2007-03-15 02:00:00 AM", "2007-03-15 03:00:00 AM", "2007-03-16 09:00:00 AM"}) {
    p.AddPoint(45, -75, t);
  }
  MarkDays(*p);
  const auto& t = p->Track;
  EXPECT_EQ(t.at(3).Flag, 1);
  EXPECT_EQ(t.at(6).Flag, 1);
  EXPECT_EQ(t.at(2).Flag, 0);
  EXPECT_EQ(t.at(4).Flag, 0);
  int expected[] = {2, 1, 3, 2, 1, 1};
  for (int i = 1; i <= 6; ++i) EXPECT_EQ(t.at(i).DayCtr, expected[i - 1]) << i;
}

TEST(MarkDays, DefaultDateAndSpacelessTimesNeverStartADay) {
  TestProgram p;
  for (const char* t : {"2007-03-14 10:00:00 PM", "2006-01-01 00:00:00", "2007-03-15 01:00:00 AM", "nospace",
                        "2007-03-15 02:00:00 AM"}) {
    p.AddPoint(45, -75, t);
  }
  MarkDays(*p);
  for (int i = 1; i <= 5; ++i) EXPECT_EQ(p->Track.at(i).Flag, 0) << i;
  EXPECT_EQ(p->Track.at(1).DayCtr, 5);
}

TEST(MarkSegments, SplitPointStopsAndCounters) {
  TestProgram p;
  for (int i = 0; i < 6; ++i) p.AddPoint(45, -75, "", 10);
  p->frmMain.chkUseSplit.Value = 1;
  p->frmMain.txtSpltCount.Text = "4";
  MarkSegments(*p);
  const auto& t = p->Track;
  EXPECT_EQ(t.at(1).Flag, 1);
  EXPECT_EQ(t.at(4).Flag, 1);
  int expected[] = {3, 2, 1, 3, 2, 1};
  for (int i = 1; i <= 6; ++i) EXPECT_EQ(t.at(i).SegCtr, expected[i - 1]) << i;

  for (const char* k : {"6", "0", "-1", "abc", "99999999999"}) {
    TestProgram q;
    for (int i = 0; i < 6; ++i) q.AddPoint(45, -75, "", 10);
    q->frmMain.chkUseSplit.Value = 1;
    q->frmMain.txtSpltCount.Text = k;
    MarkSegments(*q);
    for (int i = 2; i <= 6; ++i) EXPECT_EQ(q->Track.at(i).Flag, 0) << k << " " << i;
    EXPECT_EQ(q->Track.at(1).SegCtr, 6);
  }
}

TEST(MarkSegments, SplitIfStoppedMakesOnePointSegments) {
  TestProgram p;
  for (double s : {10.0, 0.0, 0.0, 12.0, 14.0}) p.AddPoint(45, -75, "", s);
  p->frmMain.chkSplitIfStopped.Value = 1;
  MarkSegments(*p);
  const auto& t = p->Track;
  int flags[] = {1, 1, 1, 0, 0};
  int counters[] = {1, 1, 3, 2, 1};
  for (int i = 1; i <= 5; ++i) {
    EXPECT_EQ(t.at(i).Flag, flags[i - 1]) << i;
    EXPECT_EQ(t.at(i).SegCtr, counters[i - 1]) << i;
  }
}

TEST(FindFastestPoint, EarliestOfEqualMaxima) {
  TestProgram p;
  for (double s : {0.0, 30.0, 50.0, 20.0, 50.0}) p.AddPoint(45, -75, "", s);
  EXPECT_EQ(FindFastestPoint(*p), 3);
  TestProgram flat;
  for (int i = 0; i < 3; ++i) flat.AddPoint(45, -75, "", 0);
  EXPECT_EQ(FindFastestPoint(*flat), 1);
}

}  // namespace
}  // namespace molvar
