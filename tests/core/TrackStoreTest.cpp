#include "core/TrackStore.h"

#include <gtest/gtest.h>

#include "core/Errors.h"

namespace molvar {
namespace {

TEST(TrackStore, FirstPointStartsEmpty) {
  TrackStore t;
  t.PointCount = 1;
  t.GrowTrackStore(1);
  const TrackPoint& p = t.at(1);
  EXPECT_EQ(p.Latitude, 0);
  EXPECT_EQ(p.Speed, 0);
  EXPECT_EQ(p.Distance, 0);
  EXPECT_EQ(p.DateTime, "");
  EXPECT_EQ(p.PointText, "");
  EXPECT_EQ(p.Flag, 0);
  EXPECT_EQ(p.ColorBand, 0);
  EXPECT_THROW(t.at(0), RuntimeError);
  EXPECT_THROW(t.at(2), RuntimeError);
}

TEST(TrackStore, GrowthKeepsContentsAcrossBlocks) {
  TrackStore t;
  const int32_t n = 10000;  // spans several storage blocks
  for (int32_t i = 1; i <= n; ++i) {
    t.PointCount = i;
    t.GrowTrackStore(i);
    t.at(i).Latitude = i;
    t.at(i).DateTime = "2007-03-14 12:00:00 PM and a text too long for the inline buffer";
  }
  EXPECT_EQ(t.Bound(), n);
  for (int32_t i : {1, 4096, 4097, 8192, n}) {
    EXPECT_EQ(t.at(i).Latitude, i);
    EXPECT_EQ(t.at(i).DateTime, "2007-03-14 12:00:00 PM and a text too long for the inline buffer");
  }
}

TEST(TrackStore, ShrinkThenRegrowGivesFreshElements) {
  TrackStore t;
  t.GrowTrackStore(5);
  t.at(5).Latitude = 9;
  t.GrowTrackStore(3);
  EXPECT_THROW(t.at(5), RuntimeError);
  t.GrowTrackStore(5);
  EXPECT_EQ(t.at(5).Latitude, 0);
}

TEST(ClearTrackStore, ResetsCountAndFixButKeepsLaterPoints) {
  TrackStore t;
  NmeaFix fix;
  t.PointCount = 3;
  t.GrowTrackStore(3);
  t.at(1).PointText = "old";
  t.at(2).Latitude = 45;
  fix.NmeaValid = 1;
  fix.NmeaAltitude = 120;
  fix.Fields.SentenceName = "$GPGGA";
  fix.Fields.AltitudeText = "120.5";
  ClearTrackStore(t, fix);
  EXPECT_EQ(t.PointCount, 0);
  EXPECT_EQ(fix.NmeaValid, 0);
  EXPECT_EQ(fix.NmeaAltitude, 0);
  EXPECT_EQ(fix.Fields.SentenceName, "");
  EXPECT_EQ(fix.Fields.AltitudeText, "0");
  EXPECT_EQ(t.at(2).Latitude, 45);  // contents stay until overwritten
  EXPECT_EQ(t.at(1).PointText, "");  // point 1 starts fresh for the next reader
}

TEST(WaypointStore, AddsFromOneAndRestarts) {
  WaypointStore w;
  w.Add().WptName = "A";
  w.Add().WptName = "B";
  EXPECT_EQ(w.WptCount, 2);
  EXPECT_EQ(w.at(2).WptName, "B");
  w.Restart();
  EXPECT_EQ(w.WptCount, 0);
  EXPECT_THROW(w.at(1), RuntimeError);
  Waypoint& again = w.Add();
  EXPECT_EQ(again.WptName, "");
}

}  // namespace
}  // namespace molvar
