// GPX documents against hand-written files, read back by xmllint, GDAL and gpsbabel.
#include "output/Gpx.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "core/Errors.h"
#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "output/kml/KmlFrame.h"
#include "output/kml/Segments.h"
#include "output/Dispatch.h"
#include "support/Peers.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::ExpectInOrder;
using testing::ExpectWellFormedXml;
using testing::ReadFile;
using testing::RunCommand;
using testing::TestProgram;

std::string Golden(const std::string& name) { return ReadFile(std::string(MOLVAR_GOLDEN_DIR) + "/gpx/" + name); }

// A GPX track through the dispatcher.
void WriteTrack(TestProgram& t, const std::string& name) {
  Molvar& m = *t;
  m.OutputPath = t.folder.File(name);
  m.OutputName = name;
  m.OutputFormat = kFormatGpx;
  WriteOutputFile(m);
}

void AddPoint(TestProgram& t, double lat, double lon, const char* time, int32_t altitude) {
  t.AddPoint(lat, lon, time);
  t->Track.at(t->Track.PointCount).Altitude = altitude;
}

// Six points in two segments of three, local time two hours ahead of GMT.
void AddTwoSegments(TestProgram& t) {
  t->GmtMinutes = 120;
  AddPoint(t, 45.0, -75.0, "2007-06-01 02:05:09 PM", 100);
  AddPoint(t, 45.01, -75.01, "2007-06-01 02:06:09 PM", 110);
  AddPoint(t, 45.02, -75.02, "2007-06-01 02:07:09 PM", 0);
  AddPoint(t, 45.03, -74.99, "2007-06-01 02:08:09 PM", 120);
  AddPoint(t, 44.99, -75.03, "2007-06-01 02:09:09 PM", 130);
  AddPoint(t, 45.005, -75.015, "2007-06-01 02:10:09 PM", 140);
  t->Track.at(4).Flag = 1;
}

// gpsbabel and GDAL read the points of a GPX file back; `unicsvInOrder` are the lines gpsbabel's
// unicsv output must hold in order ("lat,lon,ele,date,time").
void ExpectTrackRead(const std::string& path, const std::vector<std::string>& unicsvInOrder,
                     const std::vector<std::string>& ogrInOrder) {
  ExpectWellFormedXml(path);
  int rc = -1;
  const std::string babel = RunCommand("gpsbabel -t -i gpx -f '" + path + "' -o unicsv,utc=0 -F - 2>&1", &rc);
  EXPECT_EQ(rc, 0) << babel;
  ExpectInOrder(babel, unicsvInOrder);
  const std::string ogr = RunCommand("ogrinfo -ro -al '" + path + "' track_points 2>&1", &rc);
  EXPECT_EQ(rc, 0) << ogr;
  ExpectInOrder(ogr, ogrInOrder);
}

TEST(GpxWriter, TrackOfTwoSegmentsWithBoundsMatchesTheHandWrittenDocument) {
  TestProgram t;
  Molvar& m = *t;
  AddTwoSegments(t);
  m.frmMain.txtInfo.Text = " Processed 6 trackpoints.";
  WriteTrack(t, "trip.gpx");
  const std::string path = t.folder.File("trip.gpx");
  EXPECT_EQ(ReadFile(path), Golden("track_two_segments.gpx"));
  EXPECT_EQ(m.frmMain.txtInfo.Text, " Processed 6 trackpoints. Output: trip.gpx");
  EXPECT_FALSE(m.Out.IsOpen());
  EXPECT_TRUE(t.platform.Messages().empty());
  ExpectTrackRead(path,
                  {"45.000000,-75.000000,100.0,2007/06/01,12:05:09", "45.010000,-75.010000,110.0,2007/06/01,12:06:09",
                   "45.020000,-75.020000,0.0,2007/06/01,12:07:09", "45.030000,-74.990000,120.0,2007/06/01,12:08:09",
                   "44.990000,-75.030000,130.0,2007/06/01,12:09:09", "45.005000,-75.015000,140.0,2007/06/01,12:10:09"},
                  {"track_seg_id (Integer) = 0", "ele (Real) = 100", "2007/06/01 12:05:09+00", "POINT (-75 45)",
                   "track_seg_id (Integer) = 0", "ele (Real) = 0", "POINT (-75.02 45.02)",
                   "track_seg_id (Integer) = 1", "ele (Real) = 120", "2007/06/01 12:08:09+00", "POINT (-74.99 45.03)",
                   "track_seg_id (Integer) = 1", "2007/06/01 12:10:09+00", "POINT (-75.015 45.005)"});
  // GDAL takes the head's bounds as the layer extent.
  const std::string summary = RunCommand("ogrinfo -ro -so '" + path + "' track_points 2>&1");
  EXPECT_NE(summary.find("Extent: (-75.030000, 44.990000) - (-74.990000, 45.030000)"), std::string::npos) << summary;
}

TEST(GpxWriter, BoundsEncloseEveryPointOfAOneSegmentTrack) {
  TestProgram t;
  Molvar& m = *t;
  t.AddPoint(-10.5, 20.25, "2007-06-01 10:00:00 AM");
  t.AddPoint(-10.75, 20.5, "2007-06-01 10:01:00 AM");
  t.AddPoint(-10.25, 20.125, "2007-06-01 10:02:00 AM");
  WriteTrack(t, "one.gpx");
  const std::string text = ReadFile(t.folder.File("one.gpx"));
  EXPECT_EQ(m.Gpx.GpxMinLat, -10.75);
  EXPECT_EQ(m.Gpx.GpxMaxLat, -10.25);
  EXPECT_EQ(m.Gpx.GpxMinLon, 20.125);
  EXPECT_EQ(m.Gpx.GpxMaxLon, 20.5);
  EXPECT_NE(text.find("<bounds minlat=\"-10.75\" minlon=\"20.125\" maxlat=\"-10.25\" maxlon=\"20.5\"/>\r\n"),
            std::string::npos);
  std::size_t trkpts = 0;
  for (std::size_t at = text.find("<trkpt"); at != std::string::npos; at = text.find("<trkpt", at + 1)) ++trkpts;
  EXPECT_EQ(trkpts, 3u);
  EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), std::count(text.begin(), text.end(), '\r'));
  ExpectTrackRead(t.folder.File("one.gpx"), {"-10.500000,20.250000", "-10.750000,20.500000", "-10.250000,20.125000"},
                  {"POINT (20.25 -10.5)", "POINT (20.5 -10.75)", "POINT (20.125 -10.25)"});
}

TEST(GpxWriter, BoundsStartInvertedAndMoveOnlyForStrictlyOutsidePoints) {
  TestProgram t;
  Molvar& m = *t;
  GpxBounds(m);
  EXPECT_EQ(m.Gpx.GpxMinLat, 180);
  EXPECT_EQ(m.Gpx.GpxMinLon, 180);
  EXPECT_EQ(m.Gpx.GpxMaxLat, -180);
  EXPECT_EQ(m.Gpx.GpxMaxLon, -180);
  t.AddPoint(180, -180, "");
  GpxBounds(m);  // equal to the starting values: nothing moves
  EXPECT_EQ(m.Gpx.GpxMinLat, 180);
  EXPECT_EQ(m.Gpx.GpxMaxLon, -180);
  EXPECT_EQ(m.Gpx.GpxMaxLat, 180);
  EXPECT_EQ(m.Gpx.GpxMinLon, -180);
}

TEST(GpxWriter, OnePointSegmentIsLeftOutButDrawnInKml) {
  TestProgram t;
  Molvar& m = *t;
  t.AddPoint(45.0, -75.0, "2007-06-01 10:00:00 AM");
  t.AddPoint(45.01, -75.0, "2007-06-01 10:01:00 AM");
  t.AddPoint(45.02, -75.0, "2007-06-01 10:02:00 AM");
  t.AddPoint(45.03, -75.0, "2007-06-01 10:03:00 AM");
  t.AddPoint(45.04, -75.0, "2007-06-01 10:04:00 AM");
  m.Track.at(3).Flag = 1;  // segments 1-2, 3 alone, 4-5
  m.Track.at(4).Flag = 1;
  WriteTrack(t, "gap.gpx");
  const std::string gpx = ReadFile(t.folder.File("gap.gpx"));
  EXPECT_NE(gpx.find("<!--  Write segment number 1  -->"), std::string::npos);
  EXPECT_EQ(gpx.find("<!--  Write segment number 2  -->"), std::string::npos);
  EXPECT_NE(gpx.find("<!--  Write segment number 3  -->"), std::string::npos);
  EXPECT_EQ(gpx.find("lat=\"45.02\""), std::string::npos);
  ExpectInOrder(gpx, {"<trkseg>", "lat=\"45\"", "lat=\"45.01\"", "</trkseg>", "<trkseg>", "lat=\"45.03\"",
                      "lat=\"45.04\"", "</trkseg>"});

  // The KML writer draws the lone point as a segment joined to the next point.
  m.OutputPath = t.folder.File("gap.kml");
  m.OutputName = "gap.kml";
  m.frmMain.chkAuto.Value = 0;
  m.Kml.SegmentCount = 1;
  ASSERT_EQ(WriteKmlHeader(m), 0);
  WriteKmlSegments(m);
  WriteKmlFooter(m);
  const std::string kml = ReadFile(t.folder.File("gap.kml"));
  ExpectInOrder(kml, {"<!--  Write segment number 2  -->", "    -75,45.02,0 \r\n    -75,45.03,0 \r\n    </coordinates>"});
}

TEST(GpxWriter, WaypointsFollowTheNameLineWithEscapedTextsInLatin1) {
  TestProgram t;
  Molvar& m = *t;
  m.ProgramMode = kModeConvertWaypoints;
  m.frmMain.chkUseFilename.Value = 0;
  m.frmMain.txtTitle.Text = "Fish & Chips <caf\xE9>";
  m.OutputPath = t.folder.File("places.gpx");
  m.OutputName = "places.gpx";
  Waypoint& a = m.Waypoints.Add();
  a.WptLatitude = 45.4215;
  a.WptLongitude = -75.6972;
  a.WptAltitude = 70;  // not written
  a.WptName = "P1";
  a.WptComment = "First stop";
  a.WptDescription = "Parliament & hill";
  Waypoint& b = m.Waypoints.Add();
  b.WptLatitude = -33.8568;
  b.WptLongitude = 151.2153;
  b.WptName = "Odd ]]> name";
  b.WptDescription = "caf\xE9";
  WriteGpxHeader(m);
  WriteGpxWaypoint(m, 1);
  WriteGpxWaypoint(m, 2);
  WriteGpxFooter(m);
  const std::string path = t.folder.File("places.gpx");
  EXPECT_EQ(ReadFile(path), Golden("waypoints.gpx"));
  EXPECT_EQ(m.frmMain.txtInfo.Text, " Output: places.gpx");
  ExpectWellFormedXml(path);

  int rc = -1;
  const std::string babel = RunCommand("gpsbabel -i gpx -f '" + path + "' -o unicsv,utc=0 -F - 2>&1", &rc);
  EXPECT_EQ(rc, 0) << babel;
  // gpsbabel reads the document as Latin-1 and prints UTF-8.
  ExpectInOrder(babel, {"1,45.421500,-75.697200,\"P1\",\"First stop\",\"Parliament & hill\"",
                        "2,-33.856800,151.215300,\"Odd ]]> name\",\"caf\xC3\xA9\""});
  const std::string ogr = RunCommand("ogrinfo -ro -al '" + path + "' waypoints 2>&1", &rc);
  EXPECT_EQ(rc, 0) << ogr;
  ExpectInOrder(ogr, {"name (String) = P1", "cmt (String) = First stop", "POINT (-75.6972 45.4215)",
                      "name (String) = Odd ]]> name", "desc (String) = caf\xC3\xA9", "POINT (151.2153 -33.8568)"});
}

TEST(GpxWriter, OtherTrackSourcesHaveATrackWithoutTimeOrBounds) {
  TestProgram t;
  Molvar& m = *t;
  m.ProgramMode = kModeGarmin;
  t.AddPoint(45.0, -75.0, "2007-06-01 10:00:00 AM");
  t.AddPoint(45.01, -75.0, "2007-06-01 10:01:00 AM");
  m.frmMain.chkUseFilename.Value = 0;
  m.frmMain.txtTitle.Text = "Garmin";
  WriteTrack(t, "garmin.gpx");
  const std::string text = ReadFile(t.folder.File("garmin.gpx"));
  EXPECT_EQ(text.find("<bounds"), std::string::npos);
  EXPECT_EQ(text.find("<time>2007-06-01T10:00:00Z</time>\r\n<"), std::string::npos);
  ExpectInOrder(text, {"gpx.xsd\">\r\n<trk>\r\n<name>Garmin</name>\r\n\r\n<!--  Write segment number 1  -->\r\n"
                       "<trkseg>\r\n",
                       "</trkseg>\r\n\r\n</trk>\r\n</gpx>\r\n"});
  ExpectWellFormedXml(t.folder.File("garmin.gpx"));
  const std::string babel = RunCommand("gpsbabel -t -i gpx -f '" + t.folder.File("garmin.gpx") + "' -o unicsv -F - 2>&1");
  ExpectInOrder(babel, {"45.000000,-75.000000", "45.010000,-75.000000"});
  const std::string ogr = RunCommand("ogrinfo -ro -al '" + t.folder.File("garmin.gpx") + "' track_points 2>&1");
  ExpectInOrder(ogr, {"Feature Count: 2", "2007/06/01 10:00:00+00", "POINT (-75 45)", "POINT (-75 45.01)"});
}

TEST(GpxWriter, PointsWithoutAReadableTimeHaveNoTimeElement) {
  TestProgram t;
  t.AddPoint(45.0, -75.0, "");
  t.AddPoint(45.01, -75.0, "garbage");  // without a blank: no day of its own either
  t.AddPoint(45.02, -75.0, "2007-06-01 10:02:00 AM");
  WriteTrack(t, "times.gpx");
  const std::string text = ReadFile(t.folder.File("times.gpx"));
  ExpectInOrder(text, {"<trk>", "lat=\"45\"", "<ele>0</ele>\r\n  </trkpt>", "lat=\"45.01\"", "<ele>0</ele>\r\n  </trkpt>",
                       "lat=\"45.02\"", "<ele>0</ele>\r\n    <time>2007-06-01T10:02:00Z</time>"});
  // The head's time is the first point's, which has none.
  EXPECT_EQ(text.find("<time>", 0), text.find("    <time>") + 4);
  ExpectTrackRead(t.folder.File("times.gpx"), {"45.000000,-75.000000", "45.020000,-75.000000,0.0,2007/06/01,10:02:00"},
                  {"POINT (-75 45)", "2007/06/01 10:02:00+00", "POINT (-75 45.02)"});
}

TEST(GpxWriter, TimeIsLocalTimeMinusTheGmtOffset) {
  TestProgram t;
  Molvar& m = *t;
  m.GmtMinutes = 120;
  EXPECT_EQ(GpxTime(m, "2007-06-01 02:05:09 PM"), "2007-06-01T12:05:09Z");
  m.GmtMinutes = 60;
  EXPECT_EQ(GpxTime(m, "2007-03-01 12:30:00 AM"), "2007-02-28T23:30:00Z");  // previous day
  EXPECT_EQ(GpxTime(m, "2008-01-01 00:30:00"), "2007-12-31T23:30:00Z");     // 24-hour form, previous year
  m.GmtMinutes = -330;
  EXPECT_EQ(GpxTime(m, "2007-06-01 11:45:00 PM"), "2007-06-02T05:15:00Z");
  EXPECT_EQ(GpxTime(m, ""), "");
  EXPECT_EQ(GpxTime(m, "12:3x"), "");
  EXPECT_EQ(GpxTime(m, std::string(100000, '9')), "");
}

TEST(GpxWriter, UnwritablePathReachesTheCaller) {
  TestProgram t;
  Molvar& m = *t;
  t.AddPoint(45.0, -75.0, "2007-06-01 10:00:00 AM");
  m.OutputPath = t.folder.File("no/such/folder/x.gpx");
  EXPECT_THROW(WriteGpxHeader(m), RuntimeError);
  EXPECT_FALSE(m.Out.IsOpen());
}

}  // namespace
}  // namespace molvar
