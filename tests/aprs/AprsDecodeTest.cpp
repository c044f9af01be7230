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
      // Report forms of the APRS protocol: without and with timestamp, with messaging.
      {"!4903.50N/07201.75W-Test 001234", 1, 49.05833333, -72.02916667, 0},
      {"=4903.50N/07201.75W-Test 001234", 1, 49.05833333, -72.02916667, 0},
      {"/092345z4903.50N/07201.75W>Test1234", 1, 49.05833333, -72.02916667, 0},
      {"@092345/4903.50N/07201.75W>Test1234", 1, 49.05833333, -72.02916667, 0},
      {"/234517h4903.50N/07201.75W>", 1, 49.05833333, -72.02916667, 0},
      {"@092345z4903.50S\\07201.75E>088/036/A=001234", 1, -49.05833333, 72.02916667, 376},
      {"APRS,WIDE2-1,qAR,W1ABC:!4903.50N/07201.75W>088/036/A=-00012", 1, 49.05833333, -72.02916667, -4},
      {"!4903.50N\\07201.75W#PHG5132 overlay", 1, 49.05833333, -72.02916667, 0},
      {"!4903.50NS07201.75W#", 1, 49.05833333, -72.02916667, 0},  // overlay "S" as table
      {"!4903.50N/07201.75W_220/004g005t077r000p000P000h50b09900wRSW", 1, 49.05833333, -72.02916667, 0},
      {"!4903.5 N/07201.7 W-", 1, 49.05833333, -72.02833333, 0},  // ambiguity 1 to 4
      {"!4903.  N/07201.  W-", 1, 49.05, -72.01666667, 0},
      {"!490 .  N/0720 .  W-", 1, 49, -72, 0},
      {"!49  .  N/072  .  W-", 1, 49, -72, 0},
      {"!/5L!!<*e7>7P[ compressed", 0, 0, 0, 0},  // compressed reports are not decoded
      {"!/5L.!<*e7>7P[ compressed with a dot", 0, 0, 0, 0},
      {"=/5L!!<*e7OS]S   comment. text", 0, 0, 0, 0},
      {"S3RUVT,WIDE1-1:`(_fn\"Oj/]\"4T} Mic-E. status", 0, 0, 0, 0},
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
  for (const char* rejected : {"!9999.99N/07201.75W-/A=000100", "!4903.50N/07201.75", "", "."}) {
    ParseAprsPosition(*p, rejected);
    EXPECT_EQ(p.fix().NmeaValid, 0) << rejected;
    EXPECT_EQ(p.fix().Fields.LatitudeText, "4903.50") << rejected;
    EXPECT_EQ(p.fix().NmeaAltitude, 376) << rejected;
    EXPECT_DOUBLE_EQ(p.fix().NmeaLatitude, 49.05833333) << rejected;
    EXPECT_DOUBLE_EQ(p.fix().NmeaLongitude, -72.02916667) << rejected;
    EXPECT_EQ(p->Track.PointCount, 1) << rejected;
  }
  // A later report without altitude does not inherit this one's.
  ParseAprsPosition(*p, "!4904.50N/07201.75W-");
  EXPECT_EQ(p.fix().NmeaAltitude, 0);
  EXPECT_EQ(p->Track.at(2).Altitude, 0);
  EXPECT_EQ(p->Track.at(1).Altitude, 376);
}

TEST(ParseAprsPosition, DoesNotInheritTheSpeedOfAMicEReport) {
  AprsProgram p;
  DecodeMicE(*p, kTmD700);
  ASSERT_EQ(p.fix().NmeaValid, 1);
  ParseAprsPosition(*p, "!3325.00N/11207.00W-");
  ASSERT_EQ(p->Track.PointCount, 2);
  EXPECT_DOUBLE_EQ(p->Track.at(1).Speed, 37.0);
  EXPECT_EQ(p->Track.at(2).Speed, 0);
  EXPECT_EQ(p->Track.at(2).Altitude, 0);
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
      {80, 0, 0, "0.0", "0"},      // exactly 800 knots
      {0, 4, 0, "0.0", "0"},       // exactly 400 degrees
      {0, 3, 99, "0.0", "399"},
      {79, 93, 59, "1479.7", "359"},
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
      {"S32UVT:", 80, 7, "10007.4500"},   // 180 -> 100
      {"S32UVT:", 89, 7, "10907.4500"},   // 189 -> 109
      {"S32UVT:", 90, 7, "7.4500"},       // 190 -> 0
      {"S32UVT:", 99, 7, "907.4500"},     // 199 -> 9
      {"S32UVT:", 79, 59, "17959.4500"},
      {"S32UVT:", 10, 0, "11000.4500"},
      {"S32U6T:", 99, 30, "9930.4500"},   // no offset: nothing to reduce
      {"S32U6T:", 75, 60, "7500.4500"},   // minutes 60 -> 0
      {"S32U6T:", 75, 69, "7509.4500"},
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
      {"P0A", "Custom 2"},  {"SL2", "Returning"}, {"SPL", "En Route"},   {"LS2", "Special"},
      {"LLL", "Emergency"}, {"ZZZ", "Off Duty"},  {"KKK", "Custom 0"},
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
      {"S32ZZZ:", 1, "3320.0000", "N"},  // a blank is the low end of its digit: 33 2x minutes
      {"S32LLL:", 1, "3320.0000", "S"},
      {"SZZZZZ:", 1, "3000.0000", "N"},
      {"S32M6T:", 0, "", ""},            // fourth character outside every group
      {"S32a6T:", 0, "", ""},
      {"S32-6T:", 0, "", ""},
      {"S32A6T:", 0, "", ""},            // "A" to "K" do not give a hemisphere
      {"S32K6T:", 0, "", ""},
      {"S3!U6T:", 0, "", ""},            // garbage elsewhere in the destination
      {"Y00P0P:", 1, "9000.0000", "N"},  // the pole
      {"Y00P1P:", 0, "", ""},            // 90 degrees 00.10
      {"Y00Q0P:", 0, "", ""},            // 90 degrees 01
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

TEST(DecodeMicE, RealWorldReports) {
  struct Case {
    std::string packet;
    const char* lat;
    const char* ns;
    const char* lon;
    const char* ew;
    double latitude, longitude;
    const char* status;
  } cases[] = {
      // The destination and information-field examples of the APRS protocol: 33 25.64 N,
      // 112 07.74 W, 20 knots (speed pair with the 800 offset), course 251 (with the 400 offset).
      {kTmD700, "3325.6400", "N", "11207.7400", "W", 33.42733333, -112.129,
       " Mic-E: OK data Msg: In Service Speed: 37.0 Alt: 61M Hdg: 251"},
      // South and east: 34 54.39 S with the longitude offset, 138 35.50 E, 45 knots at 270.
      {"ST54S9,VK5RHO-1,WIDE1*,WIDE2-2,qAR,VK5THB-5:`B?NpPb>/]", "3454.3900", "S", "13835.5000", "E",
       -34.9065, 138.59166667, " Mic-E: OK data Msg: En Route Speed: 83.3 Alt: 0M Hdg: 270"},
      // A logged satellite report: 35 23.05 N 139 36.61 E, message bits "011"; its speed and course
      // bytes read 646 knots and 464 degrees (reduced to 64).
      {"3URSP5,PCSAT-1*,qAO,JF1AJE-13:`C@Y\\\\\\-/test MIC-E", "3523.0500", "N", "13936.6100", "E",
       35.38416667, 139.61016667, " Mic-E: OK data Msg: Committed Speed: 1196.4 Alt: 0M Hdg: 64"},
      // Old data, a destination SSID, a blank last digit, and degrees 0 to 9 written with the
      // offset (195 -> 5).
      {"TTSQRZ-2:'{&+l\x1c\x1c[/", "4431.2000", "N", "510.1500", "W", 44.52, -5.16916667,
       " Mic-E: Old data Msg: Off Duty Speed: 0.0 Alt: 0M Hdg: 0"},
  };
  for (const Case& c : cases) {
    AprsProgram p;
    EXPECT_EQ(DecodeMicE(*p, c.packet), c.status) << c.packet;
    ASSERT_EQ(p.fix().NmeaValid, 1) << c.packet;
    const NmeaFields& n = p.fix().Fields;
    EXPECT_EQ(n.LatitudeText, c.lat) << c.packet;
    EXPECT_EQ(n.LatitudeHemisphere, c.ns) << c.packet;
    EXPECT_EQ(n.LongitudeText, c.lon) << c.packet;
    EXPECT_EQ(n.LongitudeHemisphere, c.ew) << c.packet;
    EXPECT_DOUBLE_EQ(p.fix().NmeaLatitude, c.latitude) << c.packet;
    EXPECT_DOUBLE_EQ(p.fix().NmeaLongitude, c.longitude) << c.packet;
    ASSERT_EQ(p->Track.PointCount, 1) << c.packet;
    EXPECT_DOUBLE_EQ(p->Track.at(1).Latitude, c.latitude) << c.packet;
    EXPECT_DOUBLE_EQ(p->Track.at(1).Longitude, c.longitude) << c.packet;
  }
}

// What a decoder left behind, to compare before and after a packet.
struct Snapshot {
  int32_t count;
  double lat1, lon1;
  int32_t alt1;
  std::string latitudeText;
  double latitude;
};

Snapshot Take(AprsProgram& p) {
  const TrackPoint& pt = p->Track.at(1);
  return {p->Track.PointCount, pt.Latitude, pt.Longitude, pt.Altitude, p.fix().Fields.LatitudeText,
          p.fix().NmeaLatitude};
}

enum class Decoder { Plain, MicE };

void Decode(AprsProgram& p, Decoder d, std::string_view packet) {
  if (d == Decoder::Plain) {
    ParseAprsPosition(*p, packet);
  } else {
    DecodeMicE(*p, packet);
  }
}

// A station already on the track, so that "unchanged" means something.
void Prime(AprsProgram& p) {
  ParseAprsPosition(*p, "!1000.00S/02000.00E-/A=003281");
  ASSERT_EQ(p->Track.PointCount, 1);
}

// Every prefix of a valid packet either gives nothing (NmeaValid 0, store and plain fix unchanged)
// or, from the first length that holds the whole position, the full packet's position.
TEST(AprsDecode, EveryTruncationOfAValidPacket) {
  struct Case {
    Decoder decoder;
    std::string packet;
    std::size_t firstDecodable;
  } cases[] = {
      {Decoder::Plain, "!4903.50N/07201.75W-Test 001234", 19},
      {Decoder::Plain, "APRS,qAR,W1ABC:@092345z4903.50S\\07201.75E>088/036/A=001234", 41},
      {Decoder::Plain, "=4530.12N/07530.45W-PHG2360/A=000328 Ottawa", 19},
      {Decoder::MicE, kTmD700, 32},  // destination, path, ":", type, six data characters, symbol
      {Decoder::MicE, "ST54S9,VK5RHO-1,WIDE1*,WIDE2-2,qAR,VK5THB-5:`B?NpPb>/]", 53},
      {Decoder::MicE, "TTSQRZ-2:'{&+l\x1c\x1c[/", 18},
  };
  for (const Case& c : cases) {
    AprsProgram whole;
    Decode(whole, c.decoder, c.packet);
    ASSERT_EQ(whole.fix().NmeaValid, 1) << c.packet;
    for (std::size_t n = 0; n <= c.packet.size(); ++n) {
      const std::string prefix = c.packet.substr(0, n);
      AprsProgram p;
      Prime(p);
      const Snapshot before = Take(p);
      Decode(p, c.decoder, prefix);
      if (n < c.firstDecodable) {
        EXPECT_EQ(p.fix().NmeaValid, 0) << prefix;
        EXPECT_EQ(p->Track.PointCount, 1) << prefix;
        const Snapshot after = Take(p);
        EXPECT_EQ(after.lat1, before.lat1) << prefix;
        EXPECT_EQ(after.lon1, before.lon1) << prefix;
        EXPECT_EQ(after.alt1, before.alt1) << prefix;
        EXPECT_EQ(after.latitudeText, before.latitudeText) << prefix;
        if (c.decoder == Decoder::Plain) {
          EXPECT_EQ(after.latitude, before.latitude) << prefix;
        }
      } else {
        EXPECT_EQ(p.fix().NmeaValid, 1) << prefix;
        ASSERT_EQ(p->Track.PointCount, 2) << prefix;
        EXPECT_EQ(p->Track.at(2).Latitude, whole->Track.at(1).Latitude) << prefix;
        EXPECT_EQ(p->Track.at(2).Longitude, whole->Track.at(1).Longitude) << prefix;
      }
    }
  }
}

TEST(AprsDecode, NulCharacters) {
  using namespace std::string_literals;
  struct Case {
    Decoder decoder;
    std::string packet;
    int16_t valid;
  } cases[] = {
      {Decoder::Plain, "!4903.50N/07201.75W-\0comment\0"s, 1},
      {Decoder::Plain, "\0\0!4903.50N/07201.75W-"s, 1},
      {Decoder::Plain, "!4903.5\0N/07201.75W-"s, 0},
      {Decoder::Plain, "!4903.50\0/07201.75W-"s, 0},
      {Decoder::Plain, "!4903.50N/0720\0.75W-"s, 0},
      {Decoder::Plain, std::string(64, '\0') + "."s + std::string(64, '\0'), 0},
      {Decoder::MicE, "S32U6T:`(_fn\"Oj/\0\0\0}"s, 1},
      {Decoder::MicE, "S32U6T:`(_\0\"Oj/"s, 0},  // below code 28: not a data character
      {Decoder::MicE, "S32\0" "6T:`(_fn\"Oj/"s, 0},
      {Decoder::MicE, "S32U6T\0:`(_fn\"Oj/"s, 1},
      {Decoder::MicE, std::string(64, '\0'), 0},
  };
  for (const Case& c : cases) {
    AprsProgram p;
    Prime(p);
    Decode(p, c.decoder, c.packet);
    EXPECT_EQ(p.fix().NmeaValid, c.valid) << c.packet.size();
    EXPECT_EQ(p->Track.PointCount, 1 + c.valid) << c.packet.size();
    EXPECT_DOUBLE_EQ(p->Track.at(1).Latitude, -10.0);
  }
}

TEST(AprsDecode, MegabytePackets) {
  const std::size_t mb = 1 << 20;
  std::string noise(mb, '\0');
  uint32_t seed = 7;
  for (char& ch : noise) {
    seed = seed * 1664525u + 1013904223u;
    ch = static_cast<char>(seed >> 24);
  }
  struct Case {
    Decoder decoder;
    std::string packet;
    int16_t valid;
    double lat;
    int32_t altitude;
  } cases[] = {
      {Decoder::Plain, "!4903.50N/07201.75W-" + std::string(mb, 'x') + "/A=000328", 1, 49.05833333, 100},
      {Decoder::Plain, std::string(mb, '.'), 0, 0, 0},
      {Decoder::Plain, std::string(mb, '\0'), 0, 0, 0},
      {Decoder::Plain, std::string(mb, '4'), 0, 0, 0},
      {Decoder::Plain, std::string(mb, 'x') + "!4903.50N/07201.75W-", 1, 49.05833333, 0},
      {Decoder::MicE, kTmD700 + std::string(mb, '}'), 1, 33.42733333, 61},
      {Decoder::MicE, "S32U6T" + std::string(mb, ','), 0, 0, 0},
      {Decoder::MicE, "S32U6T:" + std::string(mb, '`'), 1, 33.42733333, 0},
      {Decoder::MicE, "S32U6T:`" + std::string(mb, '\xff'), 0, 0, 0},
  };
  for (const Case& c : cases) {
    AprsProgram p;
    Prime(p);
    Decode(p, c.decoder, c.packet);
    EXPECT_EQ(p.fix().NmeaValid, c.valid) << c.packet.substr(0, 40);
    ASSERT_EQ(p->Track.PointCount, 1 + c.valid) << c.packet.substr(0, 40);
    if (c.valid) {
      EXPECT_DOUBLE_EQ(p->Track.at(2).Latitude, c.lat);
      EXPECT_EQ(p->Track.at(2).Altitude, c.altitude);
    }
  }
  // Noise: whatever it gives, the store grows only with a valid fix and never holds nonsense.
  for (const Decoder d : {Decoder::Plain, Decoder::MicE}) {
    AprsProgram p;
    Prime(p);
    Decode(p, d, noise);
    EXPECT_EQ(p->Track.PointCount, 1 + p.fix().NmeaValid);
    EXPECT_LE(std::fabs(p->Track.at(p->Track.PointCount).Latitude), 90.0);
  }
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
