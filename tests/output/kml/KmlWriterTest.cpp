// Whole KML documents against hand-written files, read back by real peers.
#include <gtest/gtest.h>

#include <array>
#include <initializer_list>
#include <string>
#include <vector>

#include "output/kml/KmlFrame.h"
#include "output/kml/Placemarks.h"
#include "support/KmlTesting.h"

namespace molvar {
namespace {

using testing::Coord;
using testing::ExpectWellFormedXml;
using testing::ExpectPeersRead;
using testing::KmlGolden;
using testing::ReadFile;
using testing::TestProgram;
using testing::WriteTrack;

void AddThreePoints(TestProgram& t, std::array<double, 3> speeds = {0, 0, 0}) {
  t.AddPoint(45.0, -75.0, "2007-05-01 10:00:00 AM", speeds[0]);
  t.AddPoint(45.01, -75.0, "2007-05-01 10:01:00 AM", speeds[1]);
  t.AddPoint(45.02, -75.0, "2007-05-01 10:02:00 AM", speeds[2]);
}

// Three points 100, 120 and 140 m high, 67 km/h between them.
void AddThreeHighPoints(TestProgram& t) {
  AddThreePoints(t);
  t->Track.at(1).Altitude = 100;
  t->Track.at(2).Altitude = 120;
  t->Track.at(3).Altitude = 140;
}

void SetAltitudeMode(Molvar& m, int mode) {
  m.AltitudeMode = static_cast<int16_t>(mode);
  m.frmMain.comboAltitude.ListIndex = mode;
}

TEST(KmlWriter, DefaultOptionsWriteTheHandWrittenDocumentAndOpenIt) {
  TestProgram t;
  Molvar& m = *t;
  m.frmMain.chkDetailed.Value = 0;
  AddThreePoints(t);
  WriteTrack(t, "trip.kml");
  const std::string path = t.folder.File("trip.kml");
  EXPECT_EQ(ReadFile(path), KmlGolden("track_default.kml", t.folder.path().string()));
  EXPECT_EQ(m.frmMain.txtInfo.Text, " Processed 3 trackpoints. (1 segments) Output: trip.kml");
  const auto starts = t.platform.CallsOf("StartProgram");
  ASSERT_EQ(starts.size(), 1u);
  EXPECT_EQ(starts[0].text, "/opt/google/earth/pro/google-earth-pro \"" + path + "\"");
  EXPECT_TRUE(t.platform.Messages().empty());
  EXPECT_TRUE(m.frmMain.cmdRefresh.Enabled);
  ExpectPeersRead(path, {{-75, 45, 0}, {-75, 45.02, 0}, {-75, 45.01, 0}},
                  {{{-75, 45, 0}, {-75, 45.01, 0}, {-75, 45.02, 0}}});
}

TEST(KmlWriter, SpeedColoursAltitudeAsSpeedAndDetailsWithThreshold) {
  TestProgram t;
  Molvar& m = *t;
  auto& f = m.frmMain;
  AddThreePoints(t, {0, 55, 65});
  m.Track.at(2).Flag = 1;
  m.Track.at(3).Altitude = 100;
  m.Track.at(2).ColorBand = 5;
  m.Track.at(3).ColorBand = 6;
  m.ColorVaryMode = 3;
  SetAltitudeMode(m, 3);
  m.SpeedGain = 20;
  f.chkUseThreshold.Value = 1;
  f.txtSpeedThreshold.Text = "50";
  f.chkStartFinish.Value = 0;
  f.chkFastest.Value = 0;
  f.chkAuto.Value = 0;
  f.chkUseFilename.Value = 0;
  f.txtTitle.Text = "Ride & Run <1>";
  WriteTrack(t, "ride.kml");
  const std::string path = t.folder.File("ride.kml");
  EXPECT_EQ(ReadFile(path), KmlGolden("track_speed_details.kml", t.folder.path().string()));
  EXPECT_EQ(f.txtInfo.Text, " Processed 3 trackpoints. (2 segments) Output: ride.kml");
  EXPECT_TRUE(t.platform.CallsOf("StartProgram").empty());
  EXPECT_TRUE(f.cmdOpen.Enabled);
  EXPECT_TRUE(f.cmdOpen.HasFocus);
  ExpectPeersRead(path, {{-75, 45, 0}, {-75, 45.01, 1100}, {-75, 45.02, 1300}},
                  {{{-75, 45, 0}, {-75, 45.01, 1100}}, {{-75, 45.01, 1100}, {-75, 45.02, 1300}}});
}

TEST(KmlWriter, AbsoluteAltitudeInMetresWithViewFromTheTextBoxes) {
  TestProgram t;
  Molvar& m = *t;
  auto& f = m.frmMain;
  AddThreeHighPoints(t);
  SetAltitudeMode(m, 1);
  m.AltitudeFactor = 1.0;
  m.AltitudeUnitLabel = " meters";
  f.chkDetailed.Value = 0;
  f.chkAuto.Value = 0;
  f.txtHeading.Text = "15";
  f.txtTilt.Text = "60";
  WriteTrack(t, "hill.kml");
  const std::string path = t.folder.File("hill.kml");
  EXPECT_EQ(ReadFile(path), KmlGolden("track_absolute.kml", t.folder.path().string()));
  EXPECT_TRUE(t.platform.Messages().empty());
  ExpectPeersRead(path, {{-75, 45, 100}, {-75, 45.02, 140}, {-75, 45.01, 120}},
                  {{{-75, 45, 100}, {-75, 45.01, 120}, {-75, 45.02, 140}}});
}

TEST(KmlWriter, ExtrudedTrackWithTransparencyWidthAndChosenColour) {
  TestProgram t;
  Molvar& m = *t;
  auto& f = m.frmMain;
  AddThreeHighPoints(t);
  SetAltitudeMode(m, 2);
  m.TransparencyLevel = 128;
  m.UserColorPointer = 3;
  f.sldrWidth.Value = 5;
  f.chkDetailed.Value = 0;
  f.chkStartFinish.Value = 0;
  f.chkAuto.Value = 0;
  f.chkUseFilename.Value = 0;
  f.txtTitle.Text = "Ridge walk";
  WriteTrack(t, "ridge.kml");
  const std::string path = t.folder.File("ridge.kml");
  EXPECT_EQ(ReadFile(path), KmlGolden("track_extrude.kml", t.folder.path().string()));
  EXPECT_TRUE(t.platform.Messages().empty());
  ExpectPeersRead(path, {{-75, 45.01, 120}}, {{{-75, 45, 100}, {-75, 45.01, 120}, {-75, 45.02, 140}}});
}

TEST(KmlWriter, SpeedAsAltitudeInMilesRoundsPlacemarkHeightsToEven) {
  TestProgram t;
  Molvar& m = *t;
  auto& f = m.frmMain;
  // Speeds from the file: 30.25 and 12.25 km/h, scaled by 10 to 302.5 and 122.5.
  AddThreePoints(t, {0, 30.25, 12.25});
  SetAltitudeMode(m, 3);
  m.SpeedGain = 10;
  m.UnitFactor = 0.6213712;
  m.SpeedUnitLabel = " mph";
  m.DistanceUnitLabel = " miles";
  f.chkDetailed.Value = 0;
  f.chkAuto.Value = 0;
  f.chkUseFilename.Value = 0;
  f.txtTitle.Text = "Speed as height";
  WriteTrack(t, "height.kml");
  const std::string path = t.folder.File("height.kml");
  EXPECT_EQ(ReadFile(path), KmlGolden("track_speed_altitude.kml", t.folder.path().string()));
  ExpectPeersRead(path, {{-75, 45, 0}, {-75, 45.02, 122}, {-75, 45.01, 302}},
                  {{{-75, 45, 0}, {-75, 45.01, 302.5}, {-75, 45.02, 122.5}}});
}

// Points 0.01 degree apart along the meridian, one minute apart from 10:00 AM.
void AddMeridianPoints(TestProgram& t, int count) {
  for (int i = 0; i < count; ++i) {
    t.AddPoint(45.0 + 0.01 * i, -75.0, "2007-05-01 10:0" + std::to_string(i) + ":00 AM");
  }
}

std::vector<Coord> Meridian(std::initializer_list<int> steps) {
  std::vector<Coord> line;
  for (const int i : steps) line.push_back({-75, 45.0 + 0.01 * i, 0});
  return line;
}

TEST(KmlWriter, VaryBySegmentStartsAtTheUserColourAndWrapsAroundThePalette) {
  TestProgram t;
  Molvar& m = *t;
  auto& f = m.frmMain;
  AddMeridianPoints(t, 5);
  for (const int i : {2, 3, 4}) m.Track.at(i).Flag = 1;
  m.ColorVaryMode = 1;
  m.UserColorPointer = 7;
  m.TransparencyLevel = 10;
  f.chkHalfSize.Value = 1;
  f.sldrWidth.Value = 4;
  f.chkDetailed.Value = 0;
  f.chkStartFinish.Value = 0;
  f.chkFastest.Value = 0;
  f.chkAuto.Value = 0;
  f.chkUseFilename.Value = 0;
  f.txtTitle.Text = "Four segments";
  WriteTrack(t, "segs.kml");
  const std::string path = t.folder.File("segs.kml");
  EXPECT_EQ(ReadFile(path), KmlGolden("track_vary_segment.kml", t.folder.path().string()));
  EXPECT_EQ(f.txtInfo.Text, " Processed 5 trackpoints. (4 segments) Output: segs.kml");
  ExpectPeersRead(path, {}, {Meridian({0, 1}), Meridian({1, 2}), Meridian({2, 3}), Meridian({3, 4})});
}

TEST(KmlWriter, VaryByDateColoursEachDayAndCountsTheDays) {
  TestProgram t;
  Molvar& m = *t;
  auto& f = m.frmMain;
  t.AddPoint(45.00, -75.0, "2007-05-01 11:00:00 PM");
  t.AddPoint(45.01, -75.0, "2007-05-01 11:01:00 PM");
  t.AddPoint(45.02, -75.0, "2007-05-02 01:00:00 AM");
  t.AddPoint(45.03, -75.0, "2007-05-02 01:01:00 AM");
  m.ColorVaryMode = 2;
  f.chkDetailed.Value = 0;
  f.chkFastest.Value = 0;
  f.chkAuto.Value = 0;
  WriteTrack(t, "days.kml");
  const std::string path = t.folder.File("days.kml");
  EXPECT_EQ(ReadFile(path), KmlGolden("track_vary_date.kml", t.folder.path().string()));
  EXPECT_EQ(f.txtInfo.Text, " Processed 4 trackpoints. (2 segments) (2 days) Output: days.kml");
  ExpectPeersRead(path, {{-75, 45, 0}, {-75, 45.03, 0}}, {Meridian({0, 1, 2}), Meridian({2, 3})});
}

TEST(KmlWriter, CollapsedSegmentsJoinEachDayIntoOneLine) {
  TestProgram t;
  Molvar& m = *t;
  auto& f = m.frmMain;
  t.AddPoint(45.00, -75.0, "2007-05-01 11:00:00 PM");
  t.AddPoint(45.01, -75.0, "2007-05-01 11:01:00 PM");
  t.AddPoint(45.02, -75.0, "2007-05-01 11:02:00 PM");
  t.AddPoint(45.03, -75.0, "2007-05-02 01:00:00 AM");
  t.AddPoint(45.04, -75.0, "2007-05-02 01:01:00 AM");
  m.Track.at(2).Flag = 1;  // a break inside the first day, which collapsing ignores
  m.ColorVaryMode = 2;
  f.chkCollapse.Value = 1;
  f.chkDetailed.Value = 0;
  f.chkStartFinish.Value = 0;
  f.chkFastest.Value = 0;
  f.chkAuto.Value = 0;
  WriteTrack(t, "collapsed.kml");
  const std::string path = t.folder.File("collapsed.kml");
  EXPECT_EQ(ReadFile(path), KmlGolden("track_collapsed.kml", t.folder.path().string()));
  EXPECT_EQ(f.txtInfo.Text, " Processed 5 trackpoints. (2 days) Output: collapsed.kml");
  ExpectPeersRead(path, {}, {Meridian({0, 1, 2, 3}), Meridian({3, 4})});
}

TEST(KmlWriter, GoogleMapsOutputAsksForEachSegmentNameAndUsesTheMapsIcon) {
  TestProgram t;
  Molvar& m = *t;
  auto& f = m.frmMain;
  AddMeridianPoints(t, 4);
  m.Track.at(3).Flag = 1;
  m.OutputMode = kOutputGoogleMaps;
  m.TrackFileType = 2;
  m.WptFileType = 1;
  m.IconPalette = 1;
  m.IconX = 64;
  m.IconY = 224;
  f.chkDetailed.Value = 1;  // no details in Google Maps output
  f.chkAuto.Value = 0;
  t.platform.inputAnswers = {"Morning loop & back", ""};
  WriteTrack(t, "gmaps.kml");
  const std::string path = t.folder.File("gmaps.kml");
  EXPECT_EQ(ReadFile(path), KmlGolden("gmaps_track.kml", t.folder.path().string()));
  const auto asked = t.platform.CallsOf("InputBox");
  ASSERT_EQ(asked.size(), 2u);
  for (const auto& call : asked) {
    EXPECT_EQ(call.text, "Overwrite the segment title for Google Maps if you wish...");
    EXPECT_EQ(call.title, "Track title");
  }
  EXPECT_EQ(asked[0].parameters, "#1 10:00:00 AM (2)");
  EXPECT_EQ(asked[1].parameters, "#2 10:02:00 AM (2)");
  EXPECT_TRUE(t.platform.Messages().empty());
  EXPECT_EQ(f.txtInfo.Text, " Processed 4 trackpoints. (2 segments) Output: gmaps.kml");
  ExpectPeersRead(path, {{-75, 45, 0}, {-75, 45.03, 0}, {-75, 45.01, 0}}, {Meridian({0, 1, 2}), Meridian({2, 3})});
}

TEST(KmlWriter, WaypointPlacemarksCarryTheirOwnViewAndNoTrackExtras) {
  TestProgram t;
  Molvar& m = *t;
  auto& f = m.frmMain;
  m.ProgramMode = kModeConvertWaypoints;
  m.WptFileType = 1;
  SetAltitudeMode(m, 1);
  f.txtHeading.Text = "30";
  f.AltLabel.Visible = false;
  m.OutputPath = t.folder.File("wpts.kml");
  m.OutputName = "wpts.kml";
  struct {
    const char* name;
    double lon, lat;
    int32_t alt;
  } const waypoints[] = {{"Summit", -75.5, 45.25, 250}, {"Car park", -75.4875, 45.2, 0},
                         {"Hut & Spring", -75.12345678901234, 45.3, 1200}};
  ASSERT_EQ(WriteKmlHeader(m), 0);
  for (const auto& w : waypoints) {
    m.Waypoints.Add();
    int32_t alt = w.alt;
    WriteKmlPlacemark(m, w.name, w.lon, w.lat, alt, "FFFFFF", kPlacemarkGeneral);
  }
  WriteKmlFooter(m);
  const std::string path = t.folder.File("wpts.kml");
  EXPECT_EQ(ReadFile(path), KmlGolden("waypoints.kml", t.folder.path().string()));
  // A waypoint without height raises no altitude warning in waypoint mode.
  EXPECT_TRUE(t.platform.Messages().empty());
  EXPECT_TRUE(f.AltLabel.Visible);
  EXPECT_EQ(f.txtInfo.Text, " Created 3 placemarks. Output: wpts.kml");
  ASSERT_EQ(t.platform.CallsOf("StartProgram").size(), 1u);
  ExpectPeersRead(path, {{-75.5, 45.25, 250}, {-75.4875, 45.2, 0}, {-75.1234567890123, 45.3, 1200}}, {});
}

TEST(KmlWriter, DetailsWithSpeedThresholdMarkStoppedFastAndTooFastPoints) {
  TestProgram t;
  Molvar& m = *t;
  auto& f = m.frmMain;
  t.AddPoint(45.00, -75.0, "2006-01-01 10:00:00 AM");
  t.AddPoint(45.01, -75.0, "2006-01-01 10:01:00 AM", 55);
  t.AddPoint(45.02, -75.0, "2006-01-01 00:00:00", 65);
  t.AddPoint(45.03, -75.0, "2007-05-01 10:03:00 AM", 60);
  t.AddPoint(45.04, -75.0, "2007-05-01 10:04:00 AM", 50.04);
  m.Track.at(2).PointText = "Rest stop & caf\xC3\xA9";
  m.Track.at(3).Altitude = 350;
  m.Track.at(4).Flag = 1;
  m.Track.at(5).PointText = "odd ]]> text";
  m.TransparencyLevel = 200;
  f.chkHalfSize.Value = 1;
  f.chkUseThreshold.Value = 1;
  f.txtSpeedThreshold.Text = "50";
  f.chkStartFinish.Value = 0;
  f.chkFastest.Value = 0;
  f.chkAuto.Value = 0;
  f.chkUseFilename.Value = 0;
  f.txtTitle.Text = "Threshold ride";
  WriteTrack(t, "threshold.kml");
  const std::string path = t.folder.File("threshold.kml");
  EXPECT_EQ(ReadFile(path), KmlGolden("details_threshold.kml", t.folder.path().string()));
  EXPECT_TRUE(t.platform.Messages().empty());
  EXPECT_EQ(f.txtInfo.Text, " Processed 5 trackpoints. (2 segments) Output: threshold.kml");
  std::vector<Coord> dots = Meridian({0, 1, 2, 3, 4});
  dots[2].alt = 350;
  std::vector<Coord> first = Meridian({0, 1, 2, 3});
  first[2].alt = 350;
  ExpectPeersRead(path, dots, {first, Meridian({3, 4})});
}

}  // namespace
}  // namespace molvar
