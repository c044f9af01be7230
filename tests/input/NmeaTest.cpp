#include "input/Nmea.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <numeric>
#include <sstream>

#include "core/Text.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::TestProgram;

// Public example sentences with their published checksums.
constexpr const char* kRmc = "$GPRMC,123519,A,4807.038,N,01131.000,E,022.4,084.4,230394,003.1,W*6A";
constexpr const char* kGga = "$GPGGA,123519,4807.038,N,01131.000,E,1,08,0.9,545.4,M,46.9,M,,*47";

// Appends "*hh" for the characters after "$".
std::string Signed(std::string body) {
  const unsigned x = std::accumulate(body.begin() + 1, body.end(), 0u,
                                     [](unsigned a, char c) { return a ^ static_cast<unsigned char>(c); });
  char hex[4];
  std::snprintf(hex, sizeof hex, "*%02X", x);
  return body + hex;
}

// A program reading an NMEA text file, so that accepted sentences become points.
struct NmeaFile : TestProgram {
  NmeaFile() {
    m->ProgramMode = kModeConvertTracks;
    m->TrackFileType = 3;
  }
  int16_t Parse(std::string s) {
    ParseNMEA(*m, s);
    return m->Nmea.NmeaValid;
  }
  void Ignore(bool on) { m->frmMain.mnuIgnore.Checked = on; }
};

TEST(ParseNMEA, RmcFieldsAndStoredPoint) {
  NmeaFile p;
  ASSERT_EQ(p.Parse(kRmc), 1);
  const NmeaFields& n = p->Nmea.Fields;
  EXPECT_EQ(n.SentenceName, "$GPRMC");
  EXPECT_EQ(n.UtcTime, "123519");
  EXPECT_EQ(n.Status, "A");
  EXPECT_EQ(n.LatitudeText, "4807.038");
  EXPECT_EQ(n.LongitudeHemisphere, "E");
  EXPECT_EQ(n.CourseText, "084.4");
  EXPECT_EQ(n.DateText, "230394");
  EXPECT_EQ(n.MagneticVariation, "003.1");
  EXPECT_EQ(n.MagneticVariationDirection, "W");
  EXPECT_EQ(n.ChecksumText, "*6A");
  EXPECT_DOUBLE_EQ(p->Nmea.NmeaLatitude, 48.1173);
  EXPECT_DOUBLE_EQ(p->Nmea.NmeaLongitude, 11.51666667);

  ASSERT_EQ(p->Track.PointCount, 1);
  const TrackPoint& pt = p->Track.at(1);
  EXPECT_DOUBLE_EQ(pt.Latitude, 48.1173);
  EXPECT_EQ(pt.DateTime, "2094-03-23 12:35:19 PM");  // the year is always "20" + yy
  EXPECT_DOUBLE_EQ(pt.Speed, 41.5);                   // 22.4 knots
  EXPECT_EQ(pt.Flag, 1);
  EXPECT_EQ(pt.Altitude, 1);  // an RMC sentence starting a track sets the altitude to 1
  EXPECT_EQ(n.SpeedText, "0");
  EXPECT_TRUE(p.platform.Messages().empty());
}

TEST(ParseNMEA, GgaFieldsAndAltitude) {
  NmeaFile p;
  ASSERT_EQ(p.Parse(kGga), 1);
  const NmeaFields& n = p->Nmea.Fields;
  EXPECT_EQ(n.FixQuality, "1");
  EXPECT_EQ(n.Satellites, "08");
  EXPECT_EQ(n.Hdop, "0.9");
  EXPECT_EQ(n.AltitudeText, "545");
  EXPECT_EQ(n.AltitudeUnit, "M");
  EXPECT_EQ(n.GeoidSeparation, "46.9");
  EXPECT_EQ(n.GeoidUnit, "M");
  EXPECT_EQ(n.ChecksumText, "*47");
  EXPECT_EQ(p->Nmea.NmeaAltitude, 545);
  ASSERT_EQ(p->Track.PointCount, 1);
  EXPECT_EQ(p->Track.at(1).Altitude, 545);
  // No date seen yet: the no-date placeholder, shifted by the GMT offset.
  EXPECT_EQ(p->Track.at(1).DateTime, "2006-01-01 12:35:19 PM");
}

TEST(ParseNMEA, CleansTheCallersText) {
  NmeaFile p;
  std::string s = std::string("  noise $gprmc") + (kRmc + 6) + "\r\n$GPGGA,1";
  s.replace(s.find("*6A"), 3, "*6a");  // a lower-case checksum passes once upper-cased
  ParseNMEA(*p, s);
  EXPECT_EQ(s, kRmc);
  EXPECT_EQ(p->Nmea.NmeaValid, 1);
}

TEST(ParseNMEA, ChecksumGoodBadMissing) {
  struct Case {
    std::string sentence;
    int16_t valid;
  } cases[] = {
      {kRmc, 1},
      {"$GPRMC,123519,A,4807.038,N,01131.000,E,022.4,084.4,230394,003.1,W*6B", 0},
      {"$GPRMC,123519,A,4807.038,N,01131.000,E,022.4,084.4,230394,003.1,W", 0},     // no "*"
      {"$GPRMC,123519,A,4807.038,N,01131.000,E,022.4,084.4,230394,003.1,W*6", 0},   // one digit
      {"$GPRMC,123519,A,4807.039,N,01131.000,E,022.4,084.4,230394,003.1,W*6A", 0},  // changed body
  };
  for (const Case& c : cases) {
    NmeaFile p;
    EXPECT_EQ(p.Parse(c.sentence), c.valid) << c.sentence;
    EXPECT_EQ(p->Track.PointCount, c.valid) << c.sentence;
    EXPECT_EQ(VerifyChecksum(*p, c.sentence), c.valid) << c.sentence;
  }
}

TEST(ParseNMEA, RejectedSentenceLeavesTrackAndPosition) {
  NmeaFile p;
  ASSERT_EQ(p.Parse(kRmc), 1);
  EXPECT_EQ(p.Parse(Signed("$GPRMC,130000,V,4900.000,N,01200.000,E,010.0,000.0,240394,,")), 0);
  EXPECT_EQ(p->Track.PointCount, 1);
  EXPECT_EQ(p.Parse("$GPRMC,130000,A,4900.000,N,01200.000,E,010.0,000.0,240394,,*00"), 0);
  EXPECT_EQ(p->Nmea.Fields.UtcTime, "130000");  // the status is checked after the fields are stored
  EXPECT_EQ(p->Track.PointCount, 1);
  EXPECT_EQ(p->Nmea.Fields.LatitudeText, "4900.000");
  EXPECT_DOUBLE_EQ(p->Nmea.NmeaLatitude, 48.1173);
}

TEST(ParseNMEA, EmptyAndForeignText) {
  NmeaFile p;
  ASSERT_EQ(p.Parse(kRmc), 1);
  EXPECT_EQ(p.Parse(""), 1);  // empty text changes nothing
  for (const std::string& s : std::initializer_list<std::string>{"GPRMC,123519,A*6A", "$GPGSV,3,1,11,03,03,111,00*74", "$GPVTG,054.7,T*00",
                              "$", std::string("\x00\xff$\x01\x80", 5)}) {
    EXPECT_EQ(p.Parse(s), 0) << s;
  }
  EXPECT_EQ(p->Track.PointCount, 1);
  EXPECT_TRUE(p.platform.Messages().empty());
}

TEST(ParseNMEA, FieldCountRules) {
  // 11 fields: the variation direction and checksum field is missing.
  const std::string rmc11 = Signed("$GPRMC,123519,A,4807.038,N,01131.000,E,022.4,084.4,230394,003.1");
  const std::string gga13 = Signed("$GPGGA,123519,4807.038,N,01131.000,E,1,08,0.9,545.4,M,46.9,M");
  {
    NmeaFile p;
    EXPECT_EQ(p.Parse(rmc11), 0);
    EXPECT_EQ(p.Parse(gga13), 0);
    EXPECT_EQ(p->Track.PointCount, 0);
  }
  {
    NmeaFile p;
    p.Ignore(true);
    EXPECT_EQ(p.Parse(rmc11), 1);
    EXPECT_TRUE(StartsWith(p->Nmea.Fields.MagneticVariation, "003.1*"));
    EXPECT_EQ(p.Parse(gga13), 1);
    EXPECT_EQ(p->Track.PointCount, 2);
  }
  {
    // NMEA 2.3 adds a mode field: the fields after the 11th comma run together.
    NmeaFile p;
    EXPECT_EQ(p.Parse(Signed("$GPRMC,123519,A,4807.038,N,01131.000,E,022.4,084.4,230394,003.1,W,A")), 1);
    EXPECT_EQ(p->Nmea.Fields.MagneticVariationDirection, "WA");
    EXPECT_EQ(p->Nmea.Fields.ChecksumText.size(), 3u);
  }
}

TEST(ParseNMEA, IgnoreChecksumAndValidFlag) {
  NmeaFile p;
  p.Ignore(true);
  EXPECT_EQ(p.Parse("$GPRMC,123519,V,4807.038,N,01131.000,E,022.4,084.4,230394,003.1,W*00"), 1);
  EXPECT_EQ(p->Track.PointCount, 1);
  EXPECT_EQ(p.Parse(Signed("$GPGGA,123520,4807.038,N,01131.000,E,0,00,,545.4,M,46.9,M,,")), 1);
  EXPECT_EQ(p->Track.PointCount, 2);
  // Without any "*" a sentence is still refused.
  EXPECT_EQ(p.Parse("$GPRMC,123521,A,4807.038,N,01131.000,E,022.4,084.4,230394,003.1,W"), 0);
  // Nothing to place: no point.
  EXPECT_EQ(p.Parse("$GPGGA,123522,4807.038,N*00"), 0);
  EXPECT_EQ(p->Track.PointCount, 2);
  EXPECT_TRUE(p.platform.Messages().empty());
}

TEST(ParseNMEA, HemispheresAndEmptyFields) {
  struct Case {
    const char* body;
    int16_t valid;
    double lat, lon;
  } cases[] = {
      {"$GPRMC,010203,A,4530.1234,S,07530.4500,W,,,140307,,", 1, -45.50205667, -75.5075},
      {"$GPRMC,010203,A,4530.1234,N,07530.4500,E,,,140307,,", 1, 45.50205667, 75.5075},
      {"$GPRMC,010203,A,4530.1234,X,07530.4500,E,,,140307,,", 0, 0, 0},
      {"$GPRMC,010203,A,4530.1234,N,07530.4500,,,,140307,,", 0, 0, 0},
      {"$GPRMC,010203,A,,N,07530.4500,E,,,140307,,", 0, 0, 0},
      {"$GPRMC,010203,A,4530.1234,N,,E,,,140307,,", 0, 0, 0},
      {"$GPGGA,010203,,,,,0,00,,,M,,M,,", 0, 0, 0},  // a receiver without a fix
  };
  for (const Case& c : cases) {
    NmeaFile p;
    EXPECT_EQ(p.Parse(Signed(c.body)), c.valid) << c.body;
    EXPECT_EQ(p->Track.PointCount, c.valid) << c.body;
    if (c.valid) {
      EXPECT_DOUBLE_EQ(p->Track.at(1).Latitude, c.lat);
      EXPECT_DOUBLE_EQ(p->Track.at(1).Longitude, c.lon);
      EXPECT_EQ(p->Track.at(1).Speed, 0);  // empty speed field
    }
  }
}

TEST(ParseNMEA, FixQualityChangeStartsSegment) {
  NmeaFile p;
  auto gga = [&](const char* time, const char* quality) {
    return p.Parse(Signed(std::string("$GPGGA,") + time + ",4807.038,N,01131.000,E," + quality +
                          ",08,0.9,545.4,M,46.9,M,,"));
  };
  ASSERT_EQ(gga("120000", "1"), 1);
  ASSERT_EQ(gga("120001", "1"), 1);
  EXPECT_EQ(p->Track.at(1).Flag, 1);  // point 1 keeps its segment start
  ASSERT_EQ(gga("120002", "1"), 1);
  ASSERT_EQ(gga("120003", "2"), 1);  // DGPS from here: the last GPS point is marked
  EXPECT_EQ(p->Track.at(3).Flag, 1);
  ASSERT_EQ(gga("120004", "2"), 1);
  EXPECT_EQ(p->Track.at(4).Flag, 0);
  EXPECT_EQ(gga("120005", "0"), 0);  // lost fix: marked, not stored
  EXPECT_EQ(p->Track.at(5).Flag, 1);
  EXPECT_EQ(p->Track.PointCount, 5);
  EXPECT_EQ(p->NmeaParser.LastFixQuality, 0);
  EXPECT_EQ(p->Track.at(2).Flag, 0);
}

TEST(ParseNMEA, SpeedAltitudeAndTimeCarry) {
  NmeaFile p;
  p->GmtMinutes = -300;
  ASSERT_EQ(p.Parse(Signed("$GPGGA,120000.00,4807.038,N,01131.000,E,1,08,0.9,545.4,M,46.9,M,,")), 1);
  ASSERT_EQ(p.Parse(Signed("$GPRMC,120010.00,A,4807.038,N,01131.500,E,10.0,90.0,140307,,")), 1);
  const TrackPoint& rmc = p->Track.at(2);
  EXPECT_EQ(rmc.DateTime, "2007-03-14 07:00:10 AM");
  EXPECT_DOUBLE_EQ(rmc.Speed, 18.5);  // 10 knots, as received, not derived
  EXPECT_EQ(rmc.Altitude, 545);
  // A GGA sentence without altitude keeps the last one; its speed comes from the positions.
  ASSERT_EQ(p.Parse(Signed("$GPGGA,120020.00,4807.038,N,01132.000,E,1,08,0.9,-3.5,M,46.9,M,,")), 1);
  const TrackPoint& gga = p->Track.at(3);
  EXPECT_EQ(p->Nmea.NmeaAltitude, -3);
  EXPECT_EQ(gga.Altitude, 545);
  EXPECT_EQ(gga.DateTime, "2007-03-14 07:00:20 AM");
  EXPECT_GT(gga.Distance, rmc.Distance);
  EXPECT_DOUBLE_EQ(gga.Speed, 223);  // 0.619 km in 10 s
}

TEST(ParseNMEA, ProgramModesThatStorePoints) {
  struct Case {
    int16_t mode, fileType, aprsSwitch;
    int32_t points;
  } cases[] = {
      {kModeConvertTracks, 3, 0, 1}, {kModeConvertTracks, 4, 0, 0}, {kModeAgw, 0, 0, 1},
      {kModeAprsWeb, 0, 0, 0},       {kModeAprsWeb, 0, 1, 1},       {kModeRealTimeNmea, 3, 0, 0},
  };
  for (const Case& c : cases) {
    TestProgram p;
    p->ProgramMode = c.mode;
    p->TrackFileType = c.fileType;
    p->NmeaParser.AprsWebAddsPoints = c.aprsSwitch;
    std::string s = kRmc;
    ParseNMEA(*p, s);
    EXPECT_EQ(p->Nmea.NmeaValid, 1);
    EXPECT_EQ(p->Track.PointCount, c.points) << c.mode << " " << c.fileType;
  }
}

TEST(ParseNMEA, GarbageAndHugeLines) {
  NmeaFile p;
  std::string noise;
  uint32_t seed = 12345;
  for (int i = 0; i < 20000; ++i) {
    seed = seed * 1103515245u + 12345u;
    noise.push_back(static_cast<char>(seed >> 24));
  }
  for (std::size_t start = 0; start + 200 <= noise.size(); start += 97) {
    std::string s = "$GPRMC," + noise.substr(start, 200);
    ParseNMEA(*p, s);
    s = "$GPGGA," + noise.substr(start, 200);
    ParseNMEA(*p, s);
  }
  EXPECT_EQ(p->Track.PointCount, 0);

  const std::string commas(2'000'000, ',');
  EXPECT_EQ(p.Parse("$GPRMC" + commas + "*00"), 0);
  // A valid but huge sentence: the extra fields run into the variation direction.
  EXPECT_EQ(p.Parse(Signed(std::string(kRmc).substr(0, std::string(kRmc).size() - 3) + commas + "Z")), 1);
  EXPECT_EQ(p->Nmea.Fields.MagneticVariationDirection, "WZ");
  EXPECT_EQ(p.Parse(Signed("$GPGGA,120000,4807.038,N,01131.000,E,99999999999,08,0.9,1E300,M,46.9,M,,")), 1);
  EXPECT_EQ(p->Nmea.NmeaAltitude, 0);
  EXPECT_TRUE(p.platform.Messages().empty());
}

TEST(ParseNMEA, TruncatedSentences) {
  const std::string full = Signed("$GPGGA,120000,4807.038,N,01131.000,E,1,08,0.9,545.4,M,46.9,M,,");
  for (std::size_t n = 1; n < full.size(); ++n) {
    NmeaFile p;
    EXPECT_EQ(p.Parse(full.substr(0, n)), 0) << n;
    EXPECT_EQ(p->Track.PointCount, 0);
  }
}

TEST(ConvertNmeaLocation, DegreesMinutesAndHemisphere) {
  EXPECT_DOUBLE_EQ(ConvertNmeaLocation("4530.1234", "S"), -45.50205667);
  EXPECT_DOUBLE_EQ(ConvertNmeaLocation("07530.45", "W"), -75.5075);
  EXPECT_DOUBLE_EQ(ConvertNmeaLocation("01131.000", "E"), 11.51666667);
  EXPECT_DOUBLE_EQ(ConvertNmeaLocation("0000.6", "N"), 0.01);
  EXPECT_EQ(ConvertNmeaLocation("", "N"), 0);
  EXPECT_EQ(ConvertNmeaLocation("garbage", "S"), 0);
}

TEST(AddParsedPoint, RealTimeModeAfterTheCallerCounted) {
  TestProgram p;
  p->ProgramMode = kModeRealTimeNmea;
  std::string s = kRmc;
  ParseNMEA(*p, s);
  ASSERT_EQ(p->Nmea.NmeaValid, 1);
  ASSERT_EQ(p->Track.PointCount, 0);
  p->Track.PointCount = 1;  // the sentence handler counts before the live file is written
  AddParsedPoint(*p);
  ASSERT_EQ(p->Track.PointCount, 1);
  const TrackPoint& pt = p->Track.at(1);
  EXPECT_DOUBLE_EQ(pt.Longitude, 11.51666667);
  EXPECT_DOUBLE_EQ(pt.Speed, 41.5);
  EXPECT_EQ(pt.Altitude, 1);
  EXPECT_EQ(pt.DateTime, "2094-03-23 12:35:19 PM");
  EXPECT_EQ(pt.Flag, 1);
  EXPECT_EQ(p->frmMain.txtGpsNmeaInfo.Text, " Data received 2094-03-23 12:35:19 PM Speed: 41.5 kph  Alt: 3 feet");
}

std::string RunGpsbabel(const testing::TempFolder& folder, const std::string& csv) {
  testing::WriteFile(folder.File("in.csv"), csv);
  const std::string out = folder.File("out.nmea");
  const std::string cmd = "gpsbabel -i unicsv -f '" + folder.File("in.csv") +
                          "' -x transform,trk=wpt,del -o nmea,gpvtg=0,gpgsa=0 -F '" + out + "' 2>/dev/null";
  if (std::system(cmd.c_str()) != 0) return {};
  return testing::ReadFile(out);
}

TEST(ParseNMEA, ReadsWhatGpsbabelWrites) {
  NmeaFile p;
  // Speeds in m/s; fix kinds give GGA fix qualities 1 and 2.
  const std::string nmea = RunGpsbabel(p.folder,
                                       "lat,lon,alt,date,time,speed,fix,sat,hdop\n"
                                       "45.5020567,-75.5075,123.4,2007/03/14,13:45:12,5.0,3d,7,1.2\n"
                                       "-33.8688,151.2093,-12,2007/03/14,13:45:22,0,dgps,9,0.9\n");
  if (nmea.empty()) GTEST_SKIP() << "gpsbabel is not available";
  std::istringstream lines(nmea);
  std::string line;
  int sentences = 0;
  while (std::getline(lines, line)) {
    ParseNMEA(*p, line);
    EXPECT_EQ(p->Nmea.NmeaValid, 1) << line;
    ++sentences;
  }
  ASSERT_EQ(sentences, 4);  // RMC and GGA for each position
  ASSERT_EQ(p->Track.PointCount, 4);
  const TrackStore& t = p->Track;
  EXPECT_DOUBLE_EQ(t.at(1).Latitude, 45.50205);  // written with three decimals of minutes
  EXPECT_DOUBLE_EQ(t.at(1).Longitude, -75.5075);
  EXPECT_EQ(t.at(1).DateTime, "2007-03-14 01:45:12 PM");
  EXPECT_DOUBLE_EQ(t.at(1).Speed, 18.0);  // 9.72 knots
  EXPECT_EQ(t.at(2).Altitude, 123);
  EXPECT_DOUBLE_EQ(t.at(3).Latitude, -33.8688);
  EXPECT_DOUBLE_EQ(t.at(3).Longitude, 151.2093);
  EXPECT_EQ(t.at(3).DateTime, "2007-03-14 01:45:22 PM");
  EXPECT_EQ(t.at(3).Flag, 1);       // DGPS from the second GGA on
  EXPECT_EQ(t.at(4).Altitude, 123);  // below sea level reads as no altitude
  EXPECT_EQ(p->Nmea.NmeaAltitude, -12);
  EXPECT_TRUE(p.platform.Messages().empty());
}

}  // namespace
}  // namespace molvar
