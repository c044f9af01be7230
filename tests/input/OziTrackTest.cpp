#include "input/OziTrack.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "support/PeerFiles.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::TestProgram;

struct PltFile : TestProgram {
  PltFile() {
    m->ProgramMode = kModeConvertTracks;
    m->TrackFileType = 0;
    m->InputName = "track.plt";
  }
  void Read(std::string_view line) { ReadOziTrackLine(*m, line); }
  const TrackPoint& At(int32_t i) { return m->Track.at(i); }
};

TEST(ReadOziTrackLine, StoresTheFieldsOfALine) {
  PltFile f;
  f.Read("45.1,-75.2,1,3280.83,39155.5,,");
  ASSERT_EQ(f->Track.PointCount, 1);
  const TrackPoint& p = f.At(1);
  EXPECT_DOUBLE_EQ(p.Latitude, 45.1);
  EXPECT_DOUBLE_EQ(p.Longitude, -75.2);
  EXPECT_EQ(p.Flag, 1);
  EXPECT_EQ(p.Altitude, 1000);  // 3281 feet
  EXPECT_EQ(p.DateTime, "2007-03-14 12:00:00 PM");
  EXPECT_DOUBLE_EQ(p.Speed, 0);
  EXPECT_DOUBLE_EQ(p.Distance, 0);
  EXPECT_TRUE(p.PointText.empty());
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadOziTrackLine, FieldsAreTrimmedAndTheFileFlagIsKept) {
  PltFile f;
  f.Read(" 45.1 , -75.2 , 0 , 100 , 39155.5 ");
  f.Read("45.2,-75.3, 1 ,200,39155.6");
  f.Read("45.3,-75.4,0,300,39155.7");
  ASSERT_EQ(f->Track.PointCount, 3);
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 45.1);
  EXPECT_DOUBLE_EQ(f.At(1).Longitude, -75.2);
  EXPECT_EQ(f.At(1).Flag, 0);  // the file's own break flag, even on point 1
  EXPECT_EQ(f.At(1).Altitude, 30);
  EXPECT_EQ(f.At(1).DateTime, "2007-03-14 12:00:00 PM");
  EXPECT_EQ(f.At(2).Flag, 1);
  EXPECT_EQ(f.At(2).Altitude, 61);
  EXPECT_EQ(f.At(2).DateTime, "2007-03-14 02:24:00 PM");
  EXPECT_EQ(f.At(3).Flag, 0);
  EXPECT_EQ(f.At(3).Altitude, 91);
}

TEST(ReadOziTrackLine, MissingAltitudeTakesTheLastGoodOne) {
  PltFile f;
  f.Read("45.0,-75.0,1,-777,39155.5");  // point 1 has no previous altitude
  EXPECT_EQ(f.At(1).Altitude, 0);
  f.Read("45.1,-75.2,1,-777,39155.5");  // previous one was 0: nothing to carry
  EXPECT_EQ(f.At(2).Altitude, 0);
  EXPECT_EQ(f.At(2).Flag, 1);
  f.Read("45.1,-75.2,0,1000,39155.5");
  EXPECT_EQ(f.At(3).Altitude, 305);
  f.Read("45.1,-75.2,1,-777,39155.5");
  EXPECT_EQ(f.At(4).Altitude, 305);
  EXPECT_EQ(f.At(4).Flag, 1);
  f.Read("45.1,-75.2,0,0,39155.5");
  EXPECT_EQ(f.At(5).Altitude, 305);
  f.Read("45.1,-75.2,0,-100,39155.5");  // below sea level counts as no altitude
  EXPECT_EQ(f.At(6).Altitude, 305);
  f.Read("45.1,-75.2,0,3,39155.5");  // 1 m is a good altitude
  EXPECT_EQ(f.At(7).Altitude, 1);
  f.Read("45.1,-75.2,0,-777,39155.5");
  EXPECT_EQ(f.At(8).Altitude, 1);
}

TEST(ReadOziTrackLine, LastGoodAltitudeDoesNotReachIntoTheNextFile) {
  PltFile f;
  f.Read("45.0,-75.0,1,1000,39155.5");
  f->Track.PointCount = 0;  // the driver starts the next file
  f.Read("45.0,-75.0,1,-777,39155.5");
  EXPECT_EQ(f.At(1).Altitude, 0);
  f.Read("45.0,-75.0,0,-777,39155.5");
  EXPECT_EQ(f.At(2).Altitude, 0);
}

TEST(ReadOziTrackLine, WholeFeetRoundToEven) {
  PltFile f;
  f.Read("45,-75,0,328.5,39155.5");  // 328 feet (ties to even) = 99.97 m
  f.Read("45,-75,0,329.5,39155.5");  // 330 feet = 100.58 m
  EXPECT_EQ(f.At(1).Altitude, 100);
  EXPECT_EQ(f.At(2).Altitude, 101);
}

TEST(ReadOziTrackLine, DayNumberGetsTheGmtOffset) {
  PltFile f;
  f->GmtMinutes = -300;
  f.Read("45.1,-75.2,1,0,39155.5730556");
  EXPECT_EQ(f.At(1).DateTime, "2007-03-14 08:45:12 AM");
}

TEST(ReadOziTrackLine, SpeedAndDistanceFromPositionsAndTimes) {
  PltFile f;
  f.Read("45.00,-75,1,0,39155.5");
  f.Read("45.01,-75,0,0,39155.5006944");  // one minute later
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_EQ(f.At(2).DateTime, "2007-03-14 12:01:00 PM");
  EXPECT_NEAR(f.At(2).Distance, 1.1119892, 1e-9);
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 67);
}

TEST(ReadOziTrackLine, EmptyLineAddsNothing) {
  PltFile f;
  f.Read("45.1,-75.2,1,100,39155.5");
  f.Read("");
  EXPECT_EQ(f->Track.PointCount, 1);
  EXPECT_EQ(f->Track.Bound(), 1);
}

TEST(ReadOziTrackLine, EveryOtherLineAddsAPointOfWhatItsNumbersSay) {
  PltFile f;
  f.Read("this is no track line");
  ASSERT_EQ(f->Track.PointCount, 1);
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 0);
  EXPECT_DOUBLE_EQ(f.At(1).Longitude, 0);
  EXPECT_EQ(f.At(1).Altitude, 0);
  EXPECT_EQ(f.At(1).Flag, 0);
  EXPECT_TRUE(f.At(1).DateTime.empty());

  f.Read("45.1");  // missing fields read as empty
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_DOUBLE_EQ(f.At(2).Latitude, 45.1);
  EXPECT_DOUBLE_EQ(f.At(2).Longitude, 0);
  EXPECT_TRUE(f.At(2).DateTime.empty());

  f.Read(std::string("\x00\xff,\x80\x01\x02,\x1b[0m,\xfe", 13));
  ASSERT_EQ(f->Track.PointCount, 3);
  EXPECT_DOUBLE_EQ(f.At(3).Latitude, 0);
  EXPECT_EQ(f.At(3).Altitude, 0);

  // Numbers too large for the stored whole numbers read as 0.
  f.Read("45.1,-75.2,99999,1e300,39155.5");
  ASSERT_EQ(f->Track.PointCount, 4);
  EXPECT_EQ(f.At(4).Flag, 0);
  EXPECT_EQ(f.At(4).Altitude, 0);
  EXPECT_EQ(f.At(4).DateTime, "2007-03-14 12:00:00 PM");

  f.Read("45.1,-75.2,1,100,99999999999999999999.5");  // no representable date
  ASSERT_EQ(f->Track.PointCount, 5);
  EXPECT_TRUE(f.At(5).DateTime.empty());
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadOziTrackLine, HugeLineIsOnePoint) {
  PltFile f;
  std::string line = "45.1,-75.2,1,100,39155.5";
  line.append(1 << 20, ',');
  line.append(1 << 20, '7');
  f.Read(line);
  ASSERT_EQ(f->Track.PointCount, 1);
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 45.1);
  EXPECT_EQ(f.At(1).Altitude, 30);
  EXPECT_TRUE(f.platform.Messages().empty());
}

// gpsbabel writes an Ozi PLT from our points; the lines after its six header lines come back.
TEST(ReadOziTrackLine, ReadsWhatGpsbabelWrites) {
  PltFile f;
  const std::string path = testing::WriteWithGpsbabel(f.folder,
                                                      "lat,lon,alt,date,time\n"
                                                      "45.1,-75.2,101.6,2007/03/14,13:45:12\n"
                                                      "45.11,-75.21,110,2007/03/14,13:46:12\n"
                                                      "-33.8688,151.2093,-12,2007/03/15,02:00:00\n",
                                                      "ozi", "track.plt");
  if (path.empty()) GTEST_SKIP() << "gpsbabel is not available";
  const std::vector<std::string> lines = testing::FileLines(path);
  ASSERT_GT(lines.size(), 6u);
  for (std::size_t i = 6; i < lines.size(); ++i) f.Read(lines[i]);
  ASSERT_EQ(f->Track.PointCount, 3);
  const TrackStore& t = f->Track;
  EXPECT_DOUBLE_EQ(t.at(1).Latitude, 45.1);
  EXPECT_DOUBLE_EQ(t.at(1).Longitude, -75.2);
  EXPECT_EQ(t.at(1).Altitude, 101);  // written as 333.3 feet
  EXPECT_EQ(t.at(1).DateTime, "2007-03-14 01:45:12 PM");
  EXPECT_EQ(t.at(1).Flag, 1);
  EXPECT_DOUBLE_EQ(t.at(2).Latitude, 45.11);
  EXPECT_DOUBLE_EQ(t.at(2).Longitude, -75.21);
  EXPECT_EQ(t.at(2).Altitude, 110);
  EXPECT_EQ(t.at(2).DateTime, "2007-03-14 01:46:12 PM");
  EXPECT_EQ(t.at(2).Flag, 0);
  EXPECT_NEAR(t.at(2).Distance, 1.3610709, 1e-7);
  EXPECT_DOUBLE_EQ(t.at(2).Speed, 82);
  EXPECT_DOUBLE_EQ(t.at(3).Latitude, -33.8688);
  EXPECT_DOUBLE_EQ(t.at(3).Longitude, 151.2093);
  EXPECT_EQ(t.at(3).Altitude, 110);  // below sea level: the last good altitude
  EXPECT_EQ(t.at(3).DateTime, "2007-03-15 02:00:00 AM");
  EXPECT_TRUE(f.platform.Messages().empty());
}

}  // namespace
}  // namespace molvar
