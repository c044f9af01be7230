// OziExplorer track and waypoint files against hand-written files, read back by gpsbabel and by
// the field rules of our own Ozi readers.
#include "output/Ozi.h"

#include <gtest/gtest.h>

#include "core/Errors.h"
#include "core/Numbers.h"
#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "input/OziTrack.h"
#include "output/Dispatch.h"
#include "support/Peers.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::ExpectInOrder;
using testing::ReadFile;
using testing::RunCommand;
using testing::TestProgram;

std::string_view TrimCr(std::string_view line) {
  return !line.empty() && line.back() == '\r' ? line.substr(0, line.size() - 1) : line;
}

std::string Golden(const std::string& name) { return ReadFile(std::string(MOLVAR_GOLDEN_DIR) + "/ozi/" + name); }

// A Ozi track through the dispatcher.
void WriteTrack(TestProgram& t, const std::string& name) {
  Molvar& m = *t;
  m.OutputPath = t.folder.File(name);
  m.OutputName = name;
  m.OutputFormat = kFormatOzi;
  WriteOutputFile(m);
}

// Three points over local midnight, two hours ahead of GMT, titled Lake.
void AddLakeTrack(TestProgram& t) {
  Molvar& m = *t;
  m.GmtMinutes = 120;
  m.frmMain.chkUseFilename.Value = 0;
  m.frmMain.txtTitle.Text = "Lake";
  m.frmMain.sldrWidth.Value = 2;
  m.UserColorPointer = 0;
  t.AddPoint(45.0000004, -75.1234567, "2007-06-01 02:05:09 PM");
  t.AddPoint(45.1, -75.2, "2007-06-01 02:06:09 PM");
  t.AddPoint(-12.3456789, 130.0000001, "2007-06-02 12:30:00 AM");
  m.Track.at(2).Altitude = 100;
  m.Track.at(3).Altitude = 1000;
}

TEST(OziWriter, TrackMatchesTheHandWrittenFile) {
  TestProgram t;
  AddLakeTrack(t);
  WriteTrack(t, "lake.plt");
  const std::string path = t.folder.File("lake.plt");
  EXPECT_EQ(ReadFile(path), Golden("track.plt"));
  EXPECT_TRUE(t.platform.Messages().empty());

  int rc = -1;
  const std::string babel = RunCommand("gpsbabel -t -i ozi -f '" + path + "' -o unicsv,utc=0 -F - 2>&1", &rc);
  EXPECT_EQ(rc, 0) << babel;
  // Six decimals of a day are within a second of the time written.
  const auto lines = SplitFields(babel, "\n");
  ASSERT_GE(lines.count, 4) << babel;
  EXPECT_EQ(TrimCr(lines[1]), "No,Latitude,Longitude,Altitude,Date,Time");
  struct Expected {
    std::string_view start;
    double seconds;
  };
  const Expected expected[] = {{"1,45.000000,-75.123457,,2007/06/01,", 12 * 3600 + 5 * 60 + 9},
                               {"2,45.100000,-75.200000,100.0,2007/06/01,", 12 * 3600 + 6 * 60 + 9},
                               {"3,-12.345679,130.000000,1000.0,2007/06/01,", 22 * 3600 + 30 * 60}};
  for (int n = 0; n < 3; ++n) {
    const std::string_view line = TrimCr(lines[n + 2]);
    const Expected& e = expected[n];
    ASSERT_TRUE(StartsWith(line, e.start)) << line;
    const std::string_view time = line.substr(e.start.size());  // hh:mm:ss.fff
    const double seconds = Val(Mid(time, 1, 2)) * 3600 + Val(Mid(time, 4, 2)) * 60 + Val(Mid(time, 7));
    EXPECT_NEAR(seconds, e.seconds, 1.0) << line;
  }
}

TEST(OziWriter, OurTrackReaderReadsTheTrackBack) {
  TestProgram t;
  AddLakeTrack(t);
  WriteTrack(t, "lake.plt");
  const std::string text = ReadFile(t.folder.File("lake.plt"));
  const std::vector<std::string> written{"2007-06-01 02:05:09 PM", "2007-06-01 02:06:09 PM", "2007-06-02 12:30:00 AM"};
  TestProgram back;
  back->GmtMinutes = 120;
  const auto lines = SplitFields(text, "\n");
  ASSERT_EQ(lines.count, 10);  // six head lines, three points, nothing after the last line end
  for (int n = 7; n <= 9; ++n) ReadOziTrackLine(*back, TrimCr(lines[n]));
  ASSERT_EQ(back->Track.PointCount, 3);
  EXPECT_EQ(back->Track.at(1).Latitude, 45.0);
  EXPECT_EQ(back->Track.at(1).Longitude, -75.123457);
  EXPECT_EQ(back->Track.at(1).Altitude, 0);  // -777
  EXPECT_EQ(back->Track.at(2).Altitude, 100);
  EXPECT_EQ(back->Track.at(3).Altitude, 1000);
  EXPECT_EQ(back->Track.at(3).Flag, 1);
  for (int i = 1; i <= 3; ++i) EXPECT_EQ(back->Track.at(i).DateTime.view(), written[static_cast<std::size_t>(i - 1)]);
}

TEST(OziWriter, AltitudeFeetWithNoAltitudeValue) {
  TestProgram t;
  Molvar& m = *t;
  m.OutputPath = t.folder.File("alt.plt");
  const int32_t metres[] = {0, 100, -10, 1};
  for (int32_t alt : metres) {
    t.AddPoint(45.1, -75.2, "");
    m.Track.at(m.Track.PointCount).Altitude = alt;
  }
  WriteOziHeader(m, kOziTrack);
  for (int32_t i = 1; i <= 4; ++i) WriteOziTrackPoint(m, i);
  m.Out.Close();
  const std::string text = ReadFile(m.OutputPath);
  // A point without a readable time has empty time fields.
  ExpectInOrder(text, {" 4\r\n", "45.1, -75.2, 0, -777, , , \r\n", "45.1, -75.2, 0, 328, , , \r\n",
                       "45.1, -75.2, 0, -33, , , \r\n", "45.1, -75.2, 0, 3, , , \r\n"});
}

TEST(OziWriter, HeadOfTrackAndWaypointFiles) {
  TestProgram t;
  Molvar& m = *t;
  m.frmMain.chkUseFilename.Value = 0;
  m.frmMain.txtTitle.Text = "Big, wet\r\nlake";
  m.frmMain.sldrWidth.Value = 5;
  m.UserColorPointer = 6;  // orange, 4DABFB in blue-green-red order
  m.OutputPath = t.folder.File("head.plt");
  WriteOziHeader(m, kOziTrack);
  m.Out.Close();
  EXPECT_EQ(ReadFile(m.OutputPath),
            "TrackPlot Track Point File Version 1.0\r\nWGS 84\r\nAltitude in feet, time in UTM\r\nReserved 3\r\n"
            "0,5,5090299,Big\xD1 wet  lake,1,0,0,0\r\n 0\r\n");

  m.OutputPath = t.folder.File("head.wpt");
  WriteOziHeader(m, kOziWaypoints);
  m.Out.Close();
  EXPECT_EQ(ReadFile(m.OutputPath), "OziExplorer Waypoint File Version 1.1\r\nWGS 84\r\nReserved 2\r\ngarmin\r\n");
}

TEST(OziWriter, DateTimeParts) {
  EXPECT_EQ(OziDateTimePart("2007-06-01 12:05:09 PM", 0), "2007-06-01");
  EXPECT_EQ(OziDateTimePart("2007-06-01 12:05:09 PM", 1), "12:05:09 PM");
  EXPECT_EQ(OziDateTimePart("2007-06-01", 0), "");
  EXPECT_EQ(OziDateTimePart("2007-06-01", 1), "");
  EXPECT_EQ(OziDateTimePart(" x", 0), "");
  EXPECT_EQ(OziDateTimePart(" x", 1), "x");
  EXPECT_EQ(OziDateTimePart("", 1), "");
}

void AddLakeWaypoints(Molvar& m) {
  Waypoint& a = m.Waypoints.Add();
  a.WptName = "P1";
  a.WptLatitude = 45.4215;
  a.WptLongitude = -75.6972;
  a.WptAltitude = 70;
  a.WptComment = "Parliament";
  a.WptDescription = "Parliament, Ottawa";  // the description wins over the comment
  Waypoint& b = m.Waypoints.Add();
  b.WptName = "Lake, north";
  b.WptLatitude = -33.85680049;
  b.WptLongitude = 151.2153;
  b.WptComment = "Fish  And  Chips";  // as read from an Ozi file: the description became the comment
}

TEST(OziWriter, WaypointsMatchTheHandWrittenFileAndGpsbabelReadsThem) {
  TestProgram t;
  Molvar& m = *t;
  AddLakeWaypoints(m);
  m.OutputPath = t.folder.File("lake.wpt");
  WriteOziHeader(m, kOziWaypoints);
  WriteOziWaypoint(m, 1);
  WriteOziWaypoint(m, 2);
  m.Out.Close();
  EXPECT_EQ(ReadFile(m.OutputPath), Golden("waypoints.wpt"));

  int rc = -1;
  const std::string babel = RunCommand("gpsbabel -i ozi -f '" + m.OutputPath + "' -o unicsv -F - 2>&1", &rc);
  EXPECT_EQ(rc, 0) << babel;
  ExpectInOrder(babel, {"1,45.421500,-75.697200,\"P1\",70.1,\"Parliament\xC3\x91 Ottawa\"",
                        "2,-33.856800,151.215300,\"Lake\xC3\x91 north\",,\"Fish  And  Chips\""});
  EXPECT_EQ(babel.find("-777"), std::string::npos) << babel;  // read as no altitude
}

// The fields our Ozi waypoint reader takes: 2 name, 3 latitude, 4 longitude, 11 description,
// 15 altitude in feet (-777 none), each trimmed.
TEST(OziWriter, WaypointFieldsAreWhereOurReaderTakesThem) {
  TestProgram t;
  Molvar& m = *t;
  AddLakeWaypoints(m);
  Waypoint& c = m.Waypoints.Add();
  c.WptName = "x,y,z,";
  c.WptLatitude = 1.5;
  c.WptLongitude = -2.25;
  c.WptAltitude = 2000;
  c.WptDescription = "a,b\nc";
  m.OutputPath = t.folder.File("fields.wpt");
  WriteOziHeader(m, kOziWaypoints);
  for (int32_t k = 1; k <= 3; ++k) WriteOziWaypoint(m, k);
  m.Out.Close();
  const std::string text = ReadFile(m.OutputPath);
  const auto lines = SplitFields(text, "\n");
  ASSERT_EQ(lines.count, 8);
  struct Expected {
    std::string name, description;
    double lat, lon;
    int32_t metres;
  };
  const Expected expected[] = {{"P1", "Parliament\xD1 Ottawa", 45.4215, -75.6972, 70},
                               {"Lake\xD1 north", "Fish  And  Chips", -33.8568, 151.2153, 0},
                               {"x\xD1y\xD1z\xD1", "a\xD1" "b c", 1.5, -2.25, 2000}};
  for (int k = 1; k <= 3; ++k) {
    const std::string line(TrimCr(lines[4 + k]));
    const Fields f = SplitFields(line, ",");
    const Expected& e = expected[k - 1];
    EXPECT_EQ(f.count, 18) << line;
    EXPECT_EQ(Val(f[1]), k);
    EXPECT_EQ(Trim(f[2]), e.name);
    EXPECT_EQ(Val(Trim(f[3])), e.lat);
    EXPECT_EQ(Val(Trim(f[4])), e.lon);
    EXPECT_EQ(Trim(f[11]), e.description);
    int32_t feet = RoundToInt32(Val(Trim(f[15])));
    if (feet == -777) feet = 0;
    EXPECT_EQ(RoundToInt32(feet / 3.28083), e.metres) << line;
  }
}

TEST(OziWriter, MissingPointOrWaypointAndUnwritablePathReachTheCaller) {
  TestProgram t;
  Molvar& m = *t;
  m.OutputPath = t.folder.File("no/such/folder/x.plt");
  EXPECT_THROW(WriteOziHeader(m, kOziTrack), RuntimeError);
  m.OutputPath = t.folder.File("x.plt");
  WriteOziHeader(m, kOziTrack);
  EXPECT_THROW(WriteOziTrackPoint(m, 1), RuntimeError);
  EXPECT_THROW(WriteOziWaypoint(m, 1), RuntimeError);
  m.Out.Abandon();
}

}  // namespace
}  // namespace molvar
