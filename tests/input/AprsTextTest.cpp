#include "input/AprsText.h"

#include <gtest/gtest.h>

#include <string>

#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::Bytes;
using testing::TestProgram;

struct AprsFile : TestProgram {
  AprsFile() {
    m->ProgramMode = kModeConvertTracks;
    m->TrackFileType = 7;
    m->InputName = "aprs.txt";
  }
  void Short(std::string_view line) { ReadAprsLine(*m, line, kAprsShortLine, ""); }
  void Packet(std::string_view text, std::string_view time) { ReadAprsLine(*m, text, kAprsPacketText, time); }
  const TrackPoint& At(int32_t i) { return m->Track.at(i); }
  // A last fix that a failing line must clear.
  void SetFix() {
    m->Nmea.NmeaValid = 1;
    m->Nmea.NmeaLatitude = 1;
    m->Nmea.NmeaLongitude = 1;
  }
  void ExpectNoFix() {
    EXPECT_EQ(m->Nmea.NmeaValid, 0);
    EXPECT_DOUBLE_EQ(m->Nmea.NmeaLatitude, 0);
    EXPECT_DOUBLE_EQ(m->Nmea.NmeaLongitude, 0);
  }
};

TEST(ReadAprsLine, PositionInDegreesAndMinutes) {
  AprsFile f;
  f.Short("VE3XYZ-9>APRS,WIDE2-1:!4530.00N/07530.00W>Mobile");
  ASSERT_EQ(f->Track.PointCount, 1);
  const TrackPoint& p = f.At(1);
  EXPECT_DOUBLE_EQ(p.Latitude, 45.5);
  EXPECT_DOUBLE_EQ(p.Longitude, -75.5);
  EXPECT_TRUE(p.DateTime.empty());
  EXPECT_EQ(p.Altitude, 0);
  EXPECT_EQ(p.Flag, 1);
  EXPECT_EQ(f->Nmea.NmeaValid, 1);
  EXPECT_DOUBLE_EQ(f->Nmea.NmeaLatitude, 45.5);
  EXPECT_DOUBLE_EQ(f->Nmea.NmeaLongitude, -75.5);
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadAprsLine, DegreesAreRoundedToEightDecimals) {
  AprsFile f;
  f.Short("=3352.01S/15112.56E-");
  f.Short("=4530.01N/00030.01E-");
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, -33.86683333);
  EXPECT_DOUBLE_EQ(f.At(1).Longitude, 151.20933333);
  EXPECT_DOUBLE_EQ(f.At(2).Latitude, 45.50016667);
  EXPECT_DOUBLE_EQ(f.At(2).Longitude, 0.50016667);
  EXPECT_EQ(f.At(2).Flag, 0);
}

TEST(ReadAprsLine, StationLineNamesTheStation) {
  AprsFile f;
  f.SetFix();
  f.Short("VE3XYZ-9*4530.00N/07530.00W");
  EXPECT_EQ(f->Aprs.StationCallSign, "VE3XYZ-9");
  EXPECT_EQ(f->Track.PointCount, 0);
  EXPECT_EQ(f->Nmea.NmeaValid, 1);  // the last fix is not touched

  // Only a short line names a station; a packet text with "*" is searched for a position.
  f.Packet("APRS,WIDE1-1*:!4530.00N/07530.00W>", "2007-03-14 13:45:12");
  EXPECT_EQ(f->Aprs.StationCallSign, "VE3XYZ-9");
  ASSERT_EQ(f->Track.PointCount, 1);
  EXPECT_EQ(f.At(1).DateTime, "2007-03-14 13:45:12");
}

TEST(ReadAprsLine, AltitudeInFeetAfterAEquals) {
  AprsFile f;
  f.Short("!4530.00N/07530.00W>/A=001234 going home");
  f.Short("!4530.00N/07530.00W>/A=-00050");
  f.Short("!4530.00N/07530.00W>/A=");
  f.Short("!4530.00N/07530.00W>/A=abc");
  f.Short("!4530.00N/07530.00W>/A=3280.83");
  ASSERT_EQ(f->Track.PointCount, 5);
  EXPECT_EQ(f.At(1).Altitude, 376);
  EXPECT_EQ(f.At(2).Altitude, 0);
  EXPECT_EQ(f.At(3).Altitude, 0);
  EXPECT_EQ(f.At(4).Altitude, 0);
  EXPECT_EQ(f.At(5).Altitude, 1000);
}

TEST(ReadAprsLine, PacketTimeIsKeptAndGivesSpeed) {
  AprsFile f;
  f->GmtMinutes = 300;
  f.Packet("APRS:!4530.00N/07500.00W>", "2007-03-14 12:00:00");
  f.Packet("APRS:!4530.60N/07500.00W>", "2007-03-14 12:01:00");  // 0.01 degree north
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_EQ(f.At(1).DateTime, "2007-03-14 12:00:00");  // no GMT offset
  EXPECT_EQ(f.At(2).DateTime, "2007-03-14 12:01:00");
  EXPECT_DOUBLE_EQ(f.At(2).Latitude, 45.51);
  EXPECT_NEAR(f.At(2).Distance, 1.1119892, 1e-6);
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 67);
}

TEST(ReadAprsLine, PositionIsFoundAtTheFirstPoint) {
  AprsFile f;
  // "4530.00N/07530.00W": the point is at 5 and the text is p + 13 long, the least that holds one.
  f.Short("4530.00N/07530.00W");
  EXPECT_EQ(f->Track.PointCount, 1);

  f.SetFix();
  f.Short("4530.00N/07530.00");  // one character short
  f.ExpectNoFix();
  f.SetFix();
  f.Short("530.00N/07530.00W>");  // the point at 4
  f.ExpectNoFix();
  f.SetFix();
  f.Short("v1.2 !4530.00N/07530.00W");  // an earlier point hides the position
  f.ExpectNoFix();
  f.SetFix();
  f.Short("no position here at all, none");
  f.ExpectNoFix();
  EXPECT_EQ(f->Track.PointCount, 1);
}

TEST(ReadAprsLine, HemispheresAndZeroPositionsAreChecked) {
  AprsFile f;
  const char* bad[] = {"!4530.00X/07530.00W>", "!4530.00n/07530.00W>", "!4530.00N/07530.00w>",
                       "!4530.00N/07530.00Q>", "!0000.00N/07530.00W>", "!4530.00N/00000.00W>",
                       "!abcd.efN/ghijk.lmW>"};
  for (const char* line : bad) {
    f.SetFix();
    f.Short(line);
    f.ExpectNoFix();
  }
  EXPECT_EQ(f->Track.PointCount, 0);
  EXPECT_EQ(f->Track.Bound(), 0);
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadAprsLine, BadTextAddsNothing) {
  AprsFile f;
  f.SetFix();
  f.Short("");
  f.Packet("", "2007-03-14 12:00:00");
  EXPECT_EQ(f->Nmea.NmeaValid, 1);  // empty text is not looked at
  f.Short(Bytes("\x00\xff\x80\x01.\x02\x03\x04\x05\x06\x07\x08\x09\x0a\x0b\x0c\x0d\x0e"));
  f.ExpectNoFix();
  std::string huge(1 << 20, '.');
  f.Packet(huge, "");
  f.ExpectNoFix();
  std::string tail = "!4530.00N/07530.00W>";
  tail.append(1 << 20, 'x');
  f.Packet(tail, "x");
  ASSERT_EQ(f->Track.PointCount, 1);
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 45.5);
  EXPECT_EQ(f.At(1).DateTime, "x");
  EXPECT_TRUE(f.platform.Messages().empty());
}

}  // namespace
}  // namespace molvar
