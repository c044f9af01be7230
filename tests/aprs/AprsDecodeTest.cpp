#include "aprs/AprsDecode.h"

#include <gtest/gtest.h>

#include <cmath>

#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::TestProgram;

struct AprsProgram : TestProgram {
  AprsProgram() { m->ProgramMode = kModeAgw; }
  const NmeaFix& fix() { return m->Nmea; }
};

// Mic-E information-field characters for values 0..99 (value + 28), after the data-type character.
std::string MicEData(char type, int lonDegrees, int lonMinutes, int lonHundredths, int sp, int dc, int se) {
  std::string s(1, type);
  for (int v : {lonDegrees, lonMinutes, lonHundredths, sp, dc, se}) s.push_back(static_cast<char>(v + 28));
  return s + ">/";  // symbol: car, primary table
}

// 33 25.64 N, bits "100", no longitude offset, West.
constexpr const char* kDest = "S32U6T,WIDE1-1:";

// A TM-D700 style report built by the APRS 1.0 rules: 33 25.64 N 112 07.74 W, "In Service",
// 20 knots, course 251, altitude 61 m ("]" type byte, then the base-91 altitude and "}").
constexpr const char* kTmD700 = "S3RUVT,WIDE1-1,WIDE2-1:`(_fn\"Oj/]\"4T}";

TEST(ParseAprsPosition, PlainReportWithAltitude) {
  AprsProgram p;
  ParseAprsPosition(*p, "APRS,TCPIP*,qAC,T2TORONTO:=4530.12N/07530.45W-PHG2360/A=000328 Ottawa");
  ASSERT_EQ(p.fix().NmeaValid, 1);
  const NmeaFields& n = p.fix().Fields;
  EXPECT_EQ(n.LatitudeText, "4530.12");
  EXPECT_EQ(n.LatitudeHemisphere, "N");
  EXPECT_EQ(n.LongitudeText, "07530.45");
  EXPECT_EQ(n.LongitudeHemisphere, "W");
  EXPECT_EQ(n.UtcTime, "000000");
  EXPECT_EQ(n.DateText, "010106");
  EXPECT_EQ(p.fix().NmeaAltitude, 100);  // 328 feet
  EXPECT_DOUBLE_EQ(p.fix().NmeaLatitude, 45.502);
  EXPECT_DOUBLE_EQ(p.fix().NmeaLongitude, -75.5075);
  ASSERT_EQ(p->Track.PointCount, 1);
  const TrackPoint& pt = p->Track.at(1);
  EXPECT_DOUBLE_EQ(pt.Latitude, 45.502);
  EXPECT_DOUBLE_EQ(pt.Longitude, -75.5075);
  EXPECT_EQ(pt.Altitude, 100);
  EXPECT_EQ(pt.DateTime, "2006-01-01 00:00:00");
  EXPECT_EQ(pt.Speed, 0);
  EXPECT_EQ(pt.Flag, 1);
}

TEST(ParseAprsPosition, PositionsAndRejections) {
  struct Case {
    const char* packet;
    int16_t valid;
    double lat, lon;
    int32_t altitude;
  } cases[] = {
      {"!4903.50N/07201.75W-Test 001234", 1, 49.05833333, -72.02916667, 0},
      {"@092345z4903.50S\\07201.75E>088/036/A=001234", 1, -49.05833333, 72.02916667, 376},
      {"4530.12N/07530.45W", 1, 45.502, -75.5075, 0},     // exactly 14 characters from the "."
      {"4530.  N/07530.  W-", 1, 45.5, -75.5, 0},         // position ambiguity: blanks read as 0
      {"4530.12N/07530.45", 0, 0, 0, 0},                  // no longitude hemisphere
      {"530.12N/07530.45W-comment", 0, 0, 0, 0},          // "." at position 4
      {"APRS:>status only. nothing here at all", 0, 0, 0, 0},
      {"4530.12X/07530.45W-", 0, 0, 0, 0},
      {"4530.12N/07530.45Q-", 0, 0, 0, 0},
      {"45a0.12N/07530.45W-", 0, 0, 0, 0},
      {"4530.12N/0753x.45W-", 0, 0, 0, 0},
      {"  30.12N/07530.45W-", 0, 0, 0, 0},                // no degrees
      {"9130.00N/07530.45W-", 0, 0, 0, 0},
      {"4560.00N/07530.45W-", 0, 0, 0, 0},
      {"4530.12N/18100.00W-", 0, 0, 0, 0},
      {"", 0, 0, 0, 0},
  };
  for (const Case& c : cases) {
    AprsProgram p;
    ParseAprsPosition(*p, c.packet);
    EXPECT_EQ(p.fix().NmeaValid, c.valid) << c.packet;
    EXPECT_EQ(p->Track.PointCount, c.valid) << c.packet;
    EXPECT_DOUBLE_EQ(p.fix().NmeaLatitude, c.lat) << c.packet;
    EXPECT_DOUBLE_EQ(p.fix().NmeaLongitude, c.lon) << c.packet;
    EXPECT_EQ(p.fix().NmeaAltitude, c.altitude) << c.packet;
  }
}

TEST(ParseAprsPosition, RejectedPacketKeepsTheLastFix) {
  AprsProgram p;
  ParseAprsPosition(*p, "!4903.50N/07201.75W-/A=001234");
  ASSERT_EQ(p.fix().NmeaValid, 1);
  ParseAprsPosition(*p, "!9999.99N/07201.75W-/A=000100");
  EXPECT_EQ(p.fix().NmeaValid, 0);
  EXPECT_EQ(p.fix().Fields.LatitudeText, "4903.50");
  EXPECT_EQ(p.fix().NmeaAltitude, 376);
  EXPECT_EQ(p->Track.PointCount, 1);
  // A later report without altitude does not inherit this one's.
  ParseAprsPosition(*p, "!4904.50N/07201.75W-");
  EXPECT_EQ(p.fix().NmeaAltitude, 0);
  EXPECT_EQ(p->Track.at(2).Altitude, 0);
  EXPECT_EQ(p->Track.at(1).Altitude, 376);
}

TEST(DecodeMicE, DestinationAndBothReductions) {
  AprsProgram p;
  // Speed pair 80/4 gives 800 knots (-> 0), course 445 (-> 45).
  const std::string status = DecodeMicE(*p, kDest + MicEData('`', 75, 30, 45, 80, 4, 45));
  EXPECT_EQ(status, " Mic-E: OK data Msg: Returning Speed: 0.0 Alt: 0M Hdg: 45");
  ASSERT_EQ(p.fix().NmeaValid, 1);
  const NmeaFields& n = p.fix().Fields;
  EXPECT_EQ(n.SentenceName, "$GPRMC");
  EXPECT_EQ(n.LatitudeText, "3325.6400");
  EXPECT_EQ(n.LatitudeHemisphere, "N");
  EXPECT_EQ(n.LongitudeText, "7530.4500");
  EXPECT_EQ(n.LongitudeHemisphere, "W");
  EXPECT_EQ(n.CourseText, "45");
  EXPECT_EQ(n.AltitudeText, "0");
  EXPECT_DOUBLE_EQ(p.fix().NmeaLatitude, 33.42733333);
  EXPECT_DOUBLE_EQ(p.fix().NmeaLongitude, -75.5075);
  EXPECT_EQ(p->Track.PointCount, 1);
}

TEST(DecodeMicE, RealWorldReportWithAltitude) {
  AprsProgram p;
  p->GmtMinutes = 120;
  EXPECT_EQ(DecodeMicE(*p, kTmD700), " Mic-E: OK data Msg: In Service Speed: 37.0 Alt: 61M Hdg: 251");
  ASSERT_EQ(p.fix().NmeaValid, 1);
  EXPECT_EQ(p.fix().Fields.LongitudeText, "11207.7400");
  EXPECT_EQ(p.fix().NmeaAltitude, 61);
  EXPECT_DOUBLE_EQ(p.fix().NmeaLongitude, -112.129);
  ASSERT_EQ(p->Track.PointCount, 1);
  const TrackPoint& pt = p->Track.at(1);
  EXPECT_EQ(pt.Altitude, 61);
  EXPECT_DOUBLE_EQ(pt.Speed, 37.0);                // stored in km/h
  EXPECT_EQ(pt.DateTime, "2006-01-01 00:00:00");  // no time: not shifted by the GMT offset
}

TEST(DecodeMicE, SpeedAndCourse) {
  struct Case {
    int sp, dc, se;
    const char* speed;  // km/h in the status
    const char* course;
  } cases[] = {
      {7, 70, 52, "142.6", "52"},   // 77 knots
      {80, 20, 51, "3.7", "51"},    // 802 knots -> 2
      {79, 99, 0, "1479.7", "500"},  // 799 knots stays; course 900 loses 400
      {8, 9, 99, "148.2", "599"},   // course 999 loses 400 once
      {0, 0, 0, "0.0", "0"},
  };
  for (const Case& c : cases) {
    AprsProgram p;
    const std::string status = DecodeMicE(*p, kDest + MicEData('`', 75, 30, 45, c.sp, c.dc, c.se));
    EXPECT_NE(status.find(std::string(" Speed: ") + c.speed + " "), std::string::npos) << status;
    EXPECT_EQ(p.fix().Fields.CourseText, c.course) << status;
    EXPECT_EQ(p.fix().Fields.SpeedText, c.speed);
  }
}

TEST(DecodeMicE, LongitudeOffsetsAndMinutes) {
  struct Case {
    const char* dest;
    int degrees, minutes;
    const char* lon;
  } cases[] = {
      {"S32U6T:", 75, 30, "7530.4500"},
      {"S32UVT:", 12, 7, "11207.4500"},   // offset 100
      {"S32UVT:", 85, 7, "10507.4500"},   // 185 -> 105
      {"S32UVT:", 92, 7, "207.4500"},     // 192 -> 2
      {"S32UVT:", 79, 67, "17907.4500"},  // minutes 67 -> 7
      {"S32U60:", 75, 30, "7530.4500"},   // East
  };
  for (const Case& c : cases) {
    AprsProgram p;
    DecodeMicE(*p, c.dest + MicEData('`', c.degrees, c.minutes, 45, 7, 70, 52));
    ASSERT_EQ(p.fix().NmeaValid, 1) << c.dest;
    EXPECT_EQ(p.fix().Fields.LongitudeText, c.lon) << c.dest << " " << c.degrees;
    EXPECT_EQ(p.fix().Fields.LongitudeHemisphere, c.dest[5] == '0' ? "E" : "W");
  }
}

TEST(DecodeMicE, MessageTable) {
  struct Case {
    const char* first3;
    const char* message;
  } cases[] = {
      {"PPP", "Off Duty"},  {"PP0", "En Route"}, {"P0P", "In Service"}, {"P00", "Returning"},
      {"0PP", "Committed"}, {"0P0", "Special"},  {"00P", "Priority"},   {"000", "Emergency"},
      {"AAA", "Custom 0"},  {"AA0", "Custom 1"}, {"A0A", "Custom 2"},   {"A00", "Custom 3"},
      {"0AA", "Custom 4"},  {"0A0", "Custom 5"}, {"00A", "Custom 6"},   {"K00", "Custom 3"},
      {"P0A", "Custom 2"},  {"SL2", "Returning"},
  };
  for (const Case& c : cases) {
    AprsProgram p;
    const std::string status = DecodeMicE(*p, c.first3 + std::string("U6T:") + MicEData('`', 75, 30, 45, 0, 0, 0));
    EXPECT_EQ(status, std::string(" Mic-E: OK data Msg: ") + c.message + " Speed: 0.0 Alt: 0M Hdg: 0") << c.first3;
  }
}

TEST(DecodeMicE, AmbiguityAndHemisphereCharacters) {
  struct Case {
    const char* dest;
    int16_t valid;
    const char* lat;
    const char* ns;
  } cases[] = {
      {"SL2U6T:", 1, "3025.6400", "N"},  // "L" adds a "0" bit and a blank digit
      {"S32L6T:", 1, "3320.6400", "S"},  // "L" in the fourth place: South
      {"S3200T:", 1, "3320.0400", "S"},
      {"S32UZZ:", 1, "3325.0000", "N"},  // "Z": blank digits, offset and West
      {"S32M6T:", 0, "", ""},            // fourth character outside every group
      {"S32a6T:", 0, "", ""},
      {"S32-6T:", 0, "", ""},
      {"S32A6T:", 0, "", ""},            // "A" to "K" do not give a hemisphere
      {"S32K6T:", 0, "", ""},
      {"S3!U6T:", 0, "", ""},            // garbage elsewhere in the destination
      {"Y9PU6T:", 0, "", ""},            // 99 degrees
      {"S36U6T:", 0, "", ""},            // 63 minutes
  };
  for (const Case& c : cases) {
    AprsProgram p;
    const std::string status = DecodeMicE(*p, c.dest + MicEData('`', 75, 30, 45, 0, 0, 0));
    EXPECT_EQ(p.fix().NmeaValid, c.valid) << c.dest;
    EXPECT_EQ(p->Track.PointCount, c.valid) << c.dest;
    if (c.valid) {
      EXPECT_EQ(p.fix().Fields.LatitudeText, c.lat) << c.dest;
      EXPECT_EQ(p.fix().Fields.LatitudeHemisphere, c.ns) << c.dest;
    } else {
      EXPECT_EQ(status, "  ** Can't decode binary data. **") << c.dest;
      EXPECT_EQ(p.fix().Fields.LatitudeText, "") << c.dest;
    }
  }
}

TEST(DecodeMicE, OldDataAndInformationType) {
  AprsProgram p;
  EXPECT_EQ(DecodeMicE(*p, kDest + MicEData('\'', 75, 30, 45, 80, 4, 45)),
            " Mic-E: Old data Msg: Returning Speed: 0.0 Alt: 0M Hdg: 45");
  EXPECT_EQ(p.fix().NmeaValid, 1);
  for (char type : {'!', '=', '"', '\x1c'}) {
    EXPECT_EQ(DecodeMicE(*p, kDest + MicEData(type, 75, 30, 45, 80, 4, 45)), "  ** Can't decode binary data. **");
    EXPECT_EQ(p.fix().NmeaValid, 0);
    EXPECT_EQ(p.fix().NmeaLatitude, 0);
  }
  EXPECT_EQ(DecodeMicE(*p, "S32U6T,WIDE1-1`g;Il I>/"), "  ** Can't decode binary data. **");  // no ":"
  EXPECT_EQ(p->Track.PointCount, 1);
}

TEST(DecodeMicE, AltitudeOnlyWithBraceAt14) {
  struct Case {
    std::string tail;
    int32_t altitude;
  } cases[] = {
      {"]\"4T}", 61},
      {"]!!!}", -10000},
      {"]\"4T} more text", 61},
      {"\"4T}", 0},    // "}" at 13
      {"]]\"4T}", 0},  // "}" at 15
      {"]\"4T", 0},
      {"]\"4\x7f}", 0},  // not a base-91 digit
  };
  for (const Case& c : cases) {
    AprsProgram p;
    DecodeMicE(*p, kDest + MicEData('`', 75, 30, 45, 0, 0, 0) + c.tail);
    ASSERT_EQ(p.fix().NmeaValid, 1) << c.tail;
    EXPECT_EQ(p.fix().NmeaAltitude, c.altitude) << c.tail;
    EXPECT_EQ(p.fix().Fields.AltitudeText, std::to_string(c.altitude)) << c.tail;
  }
}

TEST(DecodeMicE, StoredPointsOfAStation) {
  AprsProgram p;
  DecodeMicE(*p, kDest + MicEData('`', 75, 30, 45, 0, 0, 0));
  DecodeMicE(*p, kTmD700);
  ASSERT_EQ(p->Track.PointCount, 2);
  EXPECT_EQ(p->Track.at(1).Altitude, 61);  // the first point takes the second one's altitude
  EXPECT_EQ(p->Track.at(1).Flag, 1);
  EXPECT_EQ(p->Track.at(2).Flag, 0);
  EXPECT_EQ(p->Track.at(2).SegCtr, 0);
  EXPECT_TRUE(p.platform.Messages().empty());
}

TEST(DecodeMicE, TruncatedPackets) {
  const std::string full = kTmD700;
  const std::size_t infoStart = full.find(':') + 1;
  int decoded = 0;
  for (std::size_t n = 0; n < full.size(); ++n) {
    AprsProgram p;
    DecodeMicE(*p, full.substr(0, n));
    const int16_t expected = n >= infoStart + 9 ? 1 : 0;  // type, 6 data characters, symbol
    EXPECT_EQ(p.fix().NmeaValid, expected) << n;
    EXPECT_EQ(p.fix().NmeaAltitude, 0) << n;  // the "}" is the last character
    decoded += expected;
    ParseAprsPosition(*p, full.substr(0, n));
    EXPECT_EQ(p.fix().NmeaValid, 0) << n;
    EXPECT_EQ(p->Track.PointCount, expected) << n;
  }
  EXPECT_GT(decoded, 0);
}

TEST(AprsDecode, RandomPacketsAreSafe) {
  AprsProgram p;
  uint32_t seed = 2024;
  auto next = [&seed] {
    seed = seed * 1664525u + 1013904223u;
    return seed >> 24;
  };
  int32_t accepted = 0;
  for (int i = 0; i < 20000; ++i) {
    std::string packet = i % 2 ? std::string("S32U6T:`") : std::string();
    const unsigned length = next() % 40;
    for (unsigned k = 0; k < length; ++k) {
      char c = static_cast<char>(next());
      if (i % 3 == 0) c = "0123456789.NSEW/PZKL:`' "[next() % 24];
      packet.push_back(c);
    }
    ParseAprsPosition(*p, packet);
    if (p.fix().NmeaValid == 0) DecodeMicE(*p, packet);
    if (p.fix().NmeaValid == 1) {
      ++accepted;
      EXPECT_LE(std::fabs(p.fix().NmeaLatitude), 90.0) << packet;
      EXPECT_LE(std::fabs(p.fix().NmeaLongitude), 180.0) << packet;
    }
  }
  EXPECT_EQ(p->Track.PointCount, accepted);
  EXPECT_GT(accepted, 0);
  EXPECT_TRUE(p.platform.Messages().empty());
}

}  // namespace
}  // namespace molvar
