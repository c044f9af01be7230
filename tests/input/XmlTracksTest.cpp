#include "input/XmlTracks.h"

#include <gtest/gtest.h>

#include <initializer_list>
#include <string>
#include <vector>

#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "support/PeerFiles.h"
#include "support/Peers.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::Bytes;
using testing::TestProgram;

// Three points a minute apart, written by gpsbabel in the tests below.
constexpr const char* kPeerCsv =
    "lat,lon,alt,date,time,name,comment\n"
    "45.1,-75.2,101.6,2007/03/14,13:45:12,P1,first\n"
    "45.11,-75.21,110,2007/03/14,13:46:12,P2,second\n"
    "45.12,-75.22,120.4,2007/03/14,13:47:12,P3,third\n";

struct MarkupFile : TestProgram {
  explicit MarkupFile(int16_t type = 1) {
    m->ProgramMode = kModeConvertTracks;
    m->TrackFileType = type;
  }
  void Gpx(std::initializer_list<std::string_view> lines) {
    for (const auto line : lines) ReadGpxLine(*m, line);
  }
  void Xml(std::initializer_list<std::string_view> lines) {
    for (const auto line : lines) ReadXmlLine(*m, line);
  }
  // The lines of a KML file as the driver passes them: after the first "<LINESTRING>" line,
  // upper-cased.
  void KmlFile(const std::vector<std::string>& lines) {
    std::size_t i = 0;
    while (i < lines.size() && !Contains(UCase(lines[i]), "<LINESTRING>")) ++i;
    for (++i; i < lines.size(); ++i) ReadKmlCoordinateLine(*m, UCase(lines[i]));
  }
  const TrackPoint& At(int32_t i) { return m->Track.at(i); }
  const Waypoint& Wpt(int32_t i) { return m->Waypoints.at(i); }
};

// ---- GPX track lines

TEST(ReadGpxLine, ElevationOnTheLineAfterTheStartTag) {
  MarkupFile f;
  f.Gpx({"<trkseg>", "<trkpt lat=\"45.1\" lon=\"-75.2\">", "  <ele>101.6</ele>", "</trkpt>"});
  ASSERT_EQ(f->Track.PointCount, 1);
  const TrackPoint& p = f.At(1);
  EXPECT_DOUBLE_EQ(p.Latitude, 45.1);
  EXPECT_DOUBLE_EQ(p.Longitude, -75.2);
  EXPECT_EQ(p.Altitude, 102);
  EXPECT_EQ(p.Flag, 1);
  EXPECT_TRUE(p.DateTime.empty());
  EXPECT_DOUBLE_EQ(p.Speed, 0);
  EXPECT_TRUE(f.platform.Messages().empty());
}

void ExpectPeerTrack(MarkupFile& f) {
  ASSERT_EQ(f->Track.PointCount, 3);
  const TrackStore& t = f->Track;
  EXPECT_DOUBLE_EQ(t.at(1).Latitude, 45.1);
  EXPECT_DOUBLE_EQ(t.at(1).Longitude, -75.2);
  EXPECT_EQ(t.at(1).Altitude, 102);
  EXPECT_EQ(t.at(1).DateTime, "2007-03-14 08:45:12 AM");
  EXPECT_EQ(t.at(1).Flag, 1);
  EXPECT_DOUBLE_EQ(t.at(2).Latitude, 45.11);
  EXPECT_DOUBLE_EQ(t.at(2).Longitude, -75.21);
  EXPECT_EQ(t.at(2).Altitude, 110);
  EXPECT_EQ(t.at(2).DateTime, "2007-03-14 08:46:12 AM");
  EXPECT_EQ(t.at(2).Flag, 0);
  EXPECT_NEAR(t.at(2).Distance, 1.3610709, 1e-7);
  EXPECT_DOUBLE_EQ(t.at(2).Speed, 82);
  EXPECT_DOUBLE_EQ(t.at(3).Latitude, 45.12);
  EXPECT_DOUBLE_EQ(t.at(3).Longitude, -75.22);
  EXPECT_EQ(t.at(3).Altitude, 120);
  EXPECT_EQ(t.at(3).DateTime, "2007-03-14 08:47:12 AM");
  EXPECT_EQ(t.at(3).Flag, 0);
  EXPECT_TRUE(f.platform.Messages().empty());
}

void ReadPeerGpx(std::string_view format) {
  MarkupFile f;
  f->GmtMinutes = -300;
  const std::string path = testing::WriteWithGpsbabel(f.folder, kPeerCsv, format, "track.gpx");
  if (path.empty()) GTEST_SKIP() << "gpsbabel is not available";
  for (const std::string& line : testing::FileLines(path)) ReadGpxLine(*f, line);
  ExpectPeerTrack(f);
}

TEST(ReadGpxLine, ReadsGpx10WrittenByGpsbabel) { ReadPeerGpx("gpx"); }

TEST(ReadGpxLine, ReadsGpx11WrittenByGpsbabel) { ReadPeerGpx("gpx,gpxver=1.1"); }

TEST(ReadGpxLine, EachSegmentStartsWithFlag1) {
  MarkupFile f;
  f.Gpx({"<gpx>", "<trk>", "<trkseg>",
         "<trkpt lat=\"45.1\" lon=\"-75.2\"></trkpt>",
         "<trkpt lat=\"45.2\" lon=\"-75.2\"></trkpt>",
         "</trkseg>", "<trkseg>",
         "<trkpt lat=\"45.3\" lon=\"-75.2\"></trkpt>",
         "<trkpt lat=\"45.4\" lon=\"-75.2\"></trkpt>",
         "</trkseg>", "</trk>", "</gpx>"});
  ASSERT_EQ(f->Track.PointCount, 4);
  EXPECT_EQ(f.At(1).Flag, 1);
  EXPECT_EQ(f.At(2).Flag, 0);
  EXPECT_EQ(f.At(3).Flag, 1);
  EXPECT_DOUBLE_EQ(f.At(3).Latitude, 45.3);
  EXPECT_EQ(f.At(4).Flag, 0);
}

TEST(ReadGpxLine, PointWithoutTimeHasNoTimeAndNoSpeed) {
  MarkupFile f;
  f.Gpx({"<trkseg>",
         "<trkpt lat=\"45.00\" lon=\"-75\">", "<time>2007-03-14T12:00:00Z</time>", "</trkpt>",
         "<trkpt lat=\"45.01\" lon=\"-75\">", "</trkpt>"});
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_TRUE(f.At(2).DateTime.empty());
  EXPECT_NEAR(f.At(2).Distance, 1.1119892, 1e-9);
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 0);
}

TEST(ReadGpxLine, TimeTexts) {
  MarkupFile f;
  f->GmtMinutes = -300;
  const char* times[] = {
      "<time>2007-03-14T13:45:12Z</time>",       "<time>2007-03-14T13:45:12.75Z</time>",
      "<time>2007-03-14t13:45:12z</time>",       "<time>2007-03-14T13:45:12</time>",
      "<time>2007-03-14T13:45:12+01:00</time>",  "<TIME>2007-03-14 13:45:12</TIME>",
      "<time>2007-03-14T13:45:12Z",              "<time>yesterday</time>",
      "<time></time>",                           "<time>2007-02-30T13:45:12Z</time>"};
  const char* expected[] = {"2007-03-14 08:45:12 AM", "2007-03-14 08:45:12 AM", "2007-03-14 08:45:12 AM",
                            "2007-03-14 08:45:12 AM", "2007-03-14 07:45:12 AM", "2007-03-14 08:45:12 AM",
                            "2007-03-14 08:45:12 AM", "",                       "",
                            ""};
  for (const char* t : times) f.Gpx({"<trkpt lat=\"45.1\" lon=\"-75.2\">", t, "</trkpt>"});
  ASSERT_EQ(f->Track.PointCount, 10);
  for (int i = 0; i < 10; ++i) EXPECT_EQ(f.At(i + 1).DateTime, expected[i]) << times[i];
}

TEST(ReadGpxLine, ElevationIsAWholeNumberOfMetres) {
  MarkupFile f;
  const char* elevations[] = {"<ele>100.5</ele>", "<ele>101.5</ele>", "<ele>-3.7</ele>", "<ele>abc</ele>",
                              "<ele></ele>",      "<ele> 12 </ele>",  "<ele>1e12</ele>", "<ELE>7</ELE>"};
  const int32_t expected[] = {100, 102, -4, 0, 0, 12, 0, 7};
  for (const char* e : elevations) f.Gpx({"<trkpt lat=\"45.1\" lon=\"-75.2\">", e, "</trkpt>"});
  f.Gpx({"<trkpt lat=\"45.1\" lon=\"-75.2\">", "</trkpt>"});
  ASSERT_EQ(f->Track.PointCount, 9);
  for (int i = 0; i < 8; ++i) EXPECT_EQ(f.At(i + 1).Altitude, expected[i]) << elevations[i];
  EXPECT_EQ(f.At(9).Altitude, 0);
  EXPECT_DOUBLE_EQ(f.At(4).Latitude, 45.1);  // a bad elevation does not lose the point
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadGpxLine, TagsAreFoundInAnyCaseAndValuesKeptAsWritten) {
  MarkupFile f;
  f.Gpx({"<TRKSEG><TRKPT LAT=\"45.1\" LON=\"-75.2\"><ELE>12</ELE><TIME>2007-03-14T13:45:12Z</TIME></TRKPT>"});
  ASSERT_EQ(f->Track.PointCount, 1);
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 45.1);
  EXPECT_DOUBLE_EQ(f.At(1).Longitude, -75.2);
  EXPECT_EQ(f.At(1).Altitude, 12);
  EXPECT_EQ(f.At(1).DateTime, "2007-03-14 01:45:12 PM");
  EXPECT_EQ(f.At(1).Flag, 1);
}

TEST(ReadGpxLine, LatitudeAndLongitudeInSingleQuotes) {
  MarkupFile f;
  f.Gpx({"<trkpt lat='45.1' lon='-75.2'>", "</trkpt>",
         "<trkpt lat='45.2' lon=\"-75.3\">", "</trkpt>",
         "<trkpt lon = '-75.4' lat='45.3'>", "</trkpt>"});  // blank before the quote: not a value
  ASSERT_EQ(f->Track.PointCount, 3);
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 45.1);
  EXPECT_DOUBLE_EQ(f.At(1).Longitude, -75.2);
  EXPECT_DOUBLE_EQ(f.At(2).Latitude, 45.2);
  EXPECT_DOUBLE_EQ(f.At(2).Longitude, -75.3);
  EXPECT_DOUBLE_EQ(f.At(3).Latitude, 45.3);
  EXPECT_DOUBLE_EQ(f.At(3).Longitude, 0);
}

TEST(ReadGpxLine, OnlyEndedPointsAreStored) {
  MarkupFile f;
  f.Gpx({"<metadata><name>Trip</name><time>2007-03-14T10:00:00Z</time></metadata>",
         "<ele>55</ele>",
         "</trkpt>",  // no point has started
         "<trkpt lat=\"1\" lon=\"2\">", "<ele>5</ele>", "<name>lost</name>",
         "<trkpt lat=\"45.1\" lon=\"-75.2\">", "<ele>6</ele>", "</trkpt>"});
  ASSERT_EQ(f->Track.PointCount, 1);
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 45.1);
  EXPECT_DOUBLE_EQ(f.At(1).Longitude, -75.2);
  EXPECT_EQ(f.At(1).Altitude, 6);
  EXPECT_TRUE(f.At(1).DateTime.empty());  // the metadata time belongs to no point
  f.Gpx({"<trkpt lat=\"45.2\" lon=\"-75.2\">", "</trkpt>"});
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_EQ(f.At(2).Altitude, 0);  // nothing is left over from the stored point
  EXPECT_EQ(f.At(2).Flag, 0);
}

TEST(ReadGpxLine, ValueMustStandOnTheLineOfItsTag) {
  MarkupFile f;
  f.Gpx({"<trkpt lat=\"45.1\" lon=\"-75.2\">", "<ele>", "101.6", "</ele>", "</trkpt>"});
  ASSERT_EQ(f->Track.PointCount, 1);
  EXPECT_EQ(f.At(1).Altitude, 0);
}

TEST(ReadGpxLine, BadLinesLeaveTheStoreUnchanged) {
  MarkupFile f;
  f.Gpx({"<trkpt lat=\"45.1\" lon=\"-75.2\">", "</trkpt>"});
  ASSERT_EQ(f->Track.PointCount, 1);
  std::string huge = "<trkpt lat=\"";
  huge.append(1 << 20, '4');
  std::string hugeTime = "<time>";
  hugeTime.append(1 << 20, 'T');
  f.Gpx({"", "garbage", "<<<>>>\"\"''", Bytes("\x00\xff<tr\x80kpt\x01\x1b"), std::string(1 << 20, '<'),
         "<trkpt", huge, hugeTime, "<ele>", "<time>", "lat=\"\"", "lon="});
  EXPECT_EQ(f->Track.PointCount, 1);
  EXPECT_EQ(f->Track.Bound(), 1);
  EXPECT_TRUE(f.platform.Messages().empty());
  // The point those lines began ends with the values they left.
  f.Gpx({"</trkpt>"});
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_DOUBLE_EQ(f.At(2).Latitude, 0);
  EXPECT_DOUBLE_EQ(f.At(2).Longitude, 0);
  EXPECT_EQ(f.At(2).Altitude, 0);
  EXPECT_TRUE(f.At(2).DateTime.empty());
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadGpxLine, WaypointTagsAreNotTrackPoints) {
  MarkupFile f;
  f.Gpx({"<wpt lat=\"45.1\" lon=\"-75.2\">", "<name>W</name>", "</wpt>"});
  EXPECT_EQ(f->Track.PointCount, 0);
  EXPECT_EQ(f->Waypoints.WptCount, 0);
}

// ---- GPX waypoint mode

struct WaypointFile : MarkupFile {
  WaypointFile() {
    m->ProgramMode = kModeConvertWaypoints;
    m->WptFileType = 1;
    m->OutputFormat = kFormatKml;
    m->AltitudeMode = 1;  // absolute: the placemark writer keeps the altitude
    m->Out.Open(folder.File("waypoints.kml"));
  }
  std::string Output() {
    m->Out.Close();
    return testing::ReadFile(folder.File("waypoints.kml"));
  }
};

TEST(ReadGpxLineWaypoints, ReadsWaypointsWrittenByGpsbabel) {
  WaypointFile f;
  const std::string path = testing::WriteWithGpsbabel(f.folder, kPeerCsv, "gpx", "waypoints.gpx", false);
  if (path.empty()) GTEST_SKIP() << "gpsbabel is not available";
  for (const std::string& line : testing::FileLines(path)) ReadGpxLine(*f, line);
  EXPECT_EQ(f->Track.PointCount, 0);
  ASSERT_EQ(f->Waypoints.WptCount, 3);
  EXPECT_DOUBLE_EQ(f.Wpt(1).WptLatitude, 45.1);
  EXPECT_DOUBLE_EQ(f.Wpt(1).WptLongitude, -75.2);
  EXPECT_EQ(f.Wpt(1).WptAltitude, 102);
  EXPECT_EQ(f.Wpt(1).WptName, "P1");
  EXPECT_EQ(f.Wpt(1).WptComment, "first");
  EXPECT_DOUBLE_EQ(f.Wpt(2).WptLatitude, 45.11);
  EXPECT_EQ(f.Wpt(2).WptAltitude, 110);
  EXPECT_EQ(f.Wpt(2).WptName, "P2");
  EXPECT_DOUBLE_EQ(f.Wpt(3).WptLongitude, -75.22);
  EXPECT_EQ(f.Wpt(3).WptAltitude, 120);
  EXPECT_EQ(f.Wpt(3).WptComment, "third");
  // One placemark per waypoint, labelled with its name.
  const std::string kml = f.Output();
  testing::ExpectInOrder(kml, {"<name>P1</name>", "<name>P2</name>", "<name>P3</name>"});
  EXPECT_NE(kml.find("<longitude>-75.21</longitude>"), std::string::npos);
  EXPECT_NE(kml.find("<color>FFFFFFFF</color>"), std::string::npos);  // white label
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadGpxLineWaypoints, CdataIsStrippedFromTheLabelOnly) {
  const char* lines[] = {"<wpt lat=\"45.1\" lon=\"-75.2\">", "<name><![CDATA[Fish & Chips]]></name>",
                         "<cmt><![CDATA[open late]]></cmt>", "<desc><![cdata[by the pier]]></desc>", "</wpt>"};
  for (int16_t source = 0; source <= 2; ++source) {
    WaypointFile f;
    f->PlacemarkLabelSource = source;
    for (const char* line : lines) ReadGpxLine(*f, line);
    ASSERT_EQ(f->Waypoints.WptCount, 1);
    const Waypoint& w = f.Wpt(1);
    EXPECT_EQ(w.WptName, source == 0 ? "Fish & Chips" : "<![CDATA[Fish & Chips]]>");
    EXPECT_EQ(w.WptComment, source == 1 ? "open late" : "<![CDATA[open late]]>");
    EXPECT_EQ(w.WptDescription, source == 2 ? "by the pier" : "<![cdata[by the pier]]>");
    const std::string kml = f.Output();
    const char* label[] = {"<name>Fish &amp; Chips</name>", "<name>open late</name>", "<name>by the pier</name>"};
    EXPECT_NE(kml.find(label[source]), std::string::npos) << kml;
  }
}

TEST(ReadGpxLineWaypoints, TrackPointsAreNotWaypoints) {
  WaypointFile f;
  f.Gpx({"<trkseg>", "<trkpt lat=\"45.1\" lon=\"-75.2\">", "<name>T</name>", "</trkpt>"});
  EXPECT_EQ(f->Waypoints.WptCount, 0);
  EXPECT_EQ(f->Track.PointCount, 0);
  f.Gpx({"<wpt lat='45.3' lon='-75.4'><ele>10.5</ele><name>A</name></wpt>"});
  ASSERT_EQ(f->Waypoints.WptCount, 1);
  EXPECT_DOUBLE_EQ(f.Wpt(1).WptLatitude, 45.3);
  EXPECT_DOUBLE_EQ(f.Wpt(1).WptLongitude, -75.4);
  EXPECT_EQ(f.Wpt(1).WptAltitude, 10);
  EXPECT_EQ(f.Wpt(1).WptName, "A");
}

// ---- XML track format

TEST(ReadXmlLine, TrackPointsAndSegments) {
  MarkupFile f(2);
  f.Xml({"<tracks>", "<track>", "<trackpoint>", "<latitude>45.1</latitude>", "<longitude>-75.2</longitude>",
         "<altitude>101.6</altitude>", "<time>2007-03-14T13:45:12Z</time>", "<name>a</name>", "</trackpoint>",
         "<trackpoint><latitude>45.11</latitude><longitude>-75.21</longitude><time>2007-03-14T13:46:12Z</time>"
         "</trackpoint>",
         "</track>", "<track>",
         "<TRACKPOINT><LATITUDE>45.2</LATITUDE><LONGITUDE>-75.3</LONGITUDE><ALTITUDE>7</ALTITUDE></TRACKPOINT>",
         "</track>", "</tracks>"});
  ASSERT_EQ(f->Track.PointCount, 3);
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 45.1);
  EXPECT_DOUBLE_EQ(f.At(1).Longitude, -75.2);
  EXPECT_EQ(f.At(1).Altitude, 102);
  EXPECT_EQ(f.At(1).DateTime, "2007-03-14 01:45:12 PM");
  EXPECT_EQ(f.At(1).Flag, 1);
  EXPECT_EQ(f.At(2).Flag, 0);
  EXPECT_EQ(f.At(2).Altitude, 0);
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 82);
  EXPECT_DOUBLE_EQ(f.At(3).Latitude, 45.2);
  EXPECT_EQ(f.At(3).Altitude, 7);
  EXPECT_EQ(f.At(3).Flag, 1);
  EXPECT_TRUE(f.At(3).DateTime.empty());
}

TEST(ReadXmlLine, GpxTagsAreNotXmlTags) {
  MarkupFile f(2);
  f.Xml({"<trkseg>", "<trkpt lat=\"45.1\" lon=\"-75.2\">", "</trkpt>", "<trackpoint lat=\"1\">", "</trackpoint>"});
  ASSERT_EQ(f->Track.PointCount, 0);  // "<trackpoint " with attributes is not a point start
}

TEST(ReadXmlLine, Waypoints) {
  WaypointFile f;
  f->PlacemarkLabelSource = 2;
  f.Xml({"<waypoint>", "<latitude>45.1</latitude>", "<longitude>-75.2</longitude>", "<altitude>99.5</altitude>",
         "<name>N</name>", "<comment>C</comment>", "<description><![CDATA[D & E]]></description>", "</waypoint>",
         "<trackpoint><latitude>1</latitude></trackpoint>"});
  ASSERT_EQ(f->Waypoints.WptCount, 1);
  const Waypoint& w = f.Wpt(1);
  EXPECT_DOUBLE_EQ(w.WptLatitude, 45.1);
  EXPECT_DOUBLE_EQ(w.WptLongitude, -75.2);
  EXPECT_EQ(w.WptAltitude, 100);
  EXPECT_EQ(w.WptName, "N");
  EXPECT_EQ(w.WptComment, "C");
  EXPECT_EQ(w.WptDescription, "D & E");
  EXPECT_EQ(f->Track.PointCount, 0);
  EXPECT_NE(f.Output().find("<name>D &amp; E</name>"), std::string::npos);
}

// Speeds 67, 13 and 67 km/h: bands 6, 1, 6, each one starting a segment.
TEST(ReadXmlLine, SpeedBandsLikeGpx) {
  const char* lat[] = {"45.000", "45.010", "45.012", "45.022", "45.032"};
  const char* time[] = {"12:00:00", "12:01:00", "12:02:00", "12:03:00", "12:04:00"};
  MarkupFile gpx(1);
  MarkupFile xml(2);
  for (MarkupFile* f : {&gpx, &xml}) (*f)->ColorVaryMode = 3;
  for (int i = 0; i < 5; ++i) {
    const std::string t = std::string("<time>2007-03-14T") + time[i] + "Z</time>";
    gpx.Gpx({"<trkpt lat=\"" + std::string(lat[i]) + "\" lon=\"-75\">", t, "</trkpt>"});
    xml.Xml({"<trackpoint>", "<latitude>" + std::string(lat[i]) + "</latitude>", "<longitude>-75</longitude>", t,
             "</trackpoint>"});
  }
  const int16_t bands[] = {0, 6, 1, 6, 6};
  const int16_t flags[] = {1, 1, 1, 1, 0};
  for (MarkupFile* f : {&gpx, &xml}) {
    ASSERT_EQ((*f)->Track.PointCount, 5);
    for (int i = 0; i < 5; ++i) {
      EXPECT_EQ(f->At(i + 1).ColorBand, bands[i]) << "point " << i + 1;
      EXPECT_EQ(f->At(i + 1).Flag, flags[i]) << "point " << i + 1;
    }
  }
}

TEST(ReadXmlLine, BadLinesLeaveTheStoreUnchanged) {
  MarkupFile f(2);
  std::string huge = "<trackpoint><latitude>";
  huge.append(1 << 20, '9');
  f.Xml({"", "garbage", Bytes("\x00\xff<trackp\x80oint>\x01"), huge, std::string(1 << 20, '>'),
         "<latitude>", "</latitude>"});
  EXPECT_EQ(f->Track.PointCount, 0);
  EXPECT_EQ(f->Track.Bound(), 0);
  EXPECT_TRUE(f.platform.Messages().empty());
}

// ---- KML coordinate lines

TEST(ReadKmlCoordinateLine, OneTuple) {
  MarkupFile f(6);
  ReadKmlCoordinateLine(*f, "-75.1,45.2,0");
  ASSERT_EQ(f->Track.PointCount, 1);
  EXPECT_DOUBLE_EQ(f.At(1).Longitude, -75.1);
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 45.2);
  EXPECT_EQ(f.At(1).Altitude, 0);
  EXPECT_EQ(f.At(1).Flag, 1);
  EXPECT_TRUE(f.At(1).DateTime.empty());
  ReadKmlCoordinateLine(*f, "  -75.1 , 45.21 , 101.5  ");
  ASSERT_EQ(f->Track.PointCount, 2);
  EXPECT_DOUBLE_EQ(f.At(2).Latitude, 45.21);
  EXPECT_EQ(f.At(2).Altitude, 102);
  EXPECT_EQ(f.At(2).Flag, 0);
  EXPECT_NEAR(f.At(2).Distance, 1.1119892, 1e-9);
  EXPECT_DOUBLE_EQ(f.At(2).Speed, 0);
}

TEST(ReadKmlCoordinateLine, SeveralTuplesSplitAtWhiteSpace) {
  MarkupFile f(6);
  ReadKmlCoordinateLine(*f, "\t\t-75.1,45.2,0 -75.2,45.3,10\t-75.3,45.4,20.5   -75.4,45.5,30\t");
  ASSERT_EQ(f->Track.PointCount, 4);
  const double lon[] = {-75.1, -75.2, -75.3, -75.4};
  const double lat[] = {45.2, 45.3, 45.4, 45.5};
  const int32_t alt[] = {0, 10, 20, 30};
  for (int i = 0; i < 4; ++i) {
    EXPECT_DOUBLE_EQ(f.At(i + 1).Longitude, lon[i]);
    EXPECT_DOUBLE_EQ(f.At(i + 1).Latitude, lat[i]);
    EXPECT_EQ(f.At(i + 1).Altitude, alt[i]);
    EXPECT_EQ(f.At(i + 1).Flag, i == 0 ? 1 : 0);
  }
  EXPECT_GT(f.At(4).Distance, f.At(3).Distance);
}

TEST(ReadKmlCoordinateLine, CommaAfterTheAltitudeEndsATuple) {
  MarkupFile f(6);
  ReadKmlCoordinateLine(*f, "1,2,3,4,5,6,");
  ReadKmlCoordinateLine(*f, "-75.1,45.2 -75.2,45.3");  // two-dimensional tuples
  ReadKmlCoordinateLine(*f, "7,8,9 ,10,11,12");
  ASSERT_EQ(f->Track.PointCount, 6);
  EXPECT_DOUBLE_EQ(f.At(1).Longitude, 1);
  EXPECT_DOUBLE_EQ(f.At(1).Latitude, 2);
  EXPECT_EQ(f.At(1).Altitude, 3);
  EXPECT_DOUBLE_EQ(f.At(2).Longitude, 4);
  EXPECT_EQ(f.At(2).Altitude, 6);
  EXPECT_DOUBLE_EQ(f.At(3).Longitude, -75.1);
  EXPECT_DOUBLE_EQ(f.At(4).Latitude, 45.3);
  EXPECT_EQ(f.At(4).Altitude, 0);
  EXPECT_EQ(f.At(5).Altitude, 9);
  EXPECT_DOUBLE_EQ(f.At(6).Longitude, 10);
  EXPECT_EQ(f.At(6).Altitude, 12);
}

TEST(ReadKmlCoordinateLine, LinesWithTagsOrWithoutPositionsAddNothing) {
  MarkupFile f(6);
  std::string spaces(1 << 20, ' ');
  std::string commas(1 << 20, ',');
  for (std::string_view line :
       {std::string_view(""), std::string_view("<COORDINATES>-75.1,45.2,0"), std::string_view("-75.1,45.2,0</COORDINATES>"),
        std::string_view("    "), std::string_view("ABC,DEF,GHI"), std::string_view("-75.1"),
        std::string_view(",45.2,0"), std::string_view("-75.1X,45.2,0"), std::string_view(spaces),
        std::string_view(commas)}) {
    ReadKmlCoordinateLine(*f, line);
  }
  const std::string binary = Bytes("\x00\xff,\x80,\x01 \x1b\x7f\x0b\x0c");
  ReadKmlCoordinateLine(*f, binary);
  EXPECT_EQ(f->Track.PointCount, 0);
  EXPECT_EQ(f->Track.Bound(), 0);
  // A position with an unreadable altitude is a point at altitude 0.
  ReadKmlCoordinateLine(*f, "-75.1,45.2,XYZ");
  ASSERT_EQ(f->Track.PointCount, 1);
  EXPECT_EQ(f.At(1).Altitude, 0);
  EXPECT_TRUE(f.platform.Messages().empty());
}

TEST(ReadKmlCoordinateLine, HugeLineOfTuples) {
  MarkupFile f(6);
  std::string line;
  for (int i = 0; i < 100000; ++i) line += i % 2 == 0 ? "-75.1,45.2,1 " : "-75.2,45.3,2\t";
  ReadKmlCoordinateLine(*f, line);
  ASSERT_EQ(f->Track.PointCount, 100000);
  EXPECT_DOUBLE_EQ(f.At(100000).Longitude, -75.2);
  EXPECT_EQ(f.At(99999).Altitude, 1);
}

// Several points from one line: the reader bands all but the last, which the driver bands, so each
// point is banded once.
TEST(ReadKmlCoordinateLine, SpeedBandsOfSeveralTuplesPerLine) {
  MarkupFile f(6);
  f->ColorVaryMode = 3;
  f->Speed.LastBand = 4;
  for (const char* line : {"-75.1,45.2,0 -75.2,45.3,0 -75.3,45.4,0", "-75.4,45.5,0", "ABC -75.5,45.6,0 DEF"}) {
    const int32_t before = f->Track.PointCount;
    ReadKmlCoordinateLine(*f, line);
    if (f->Track.PointCount > before) AssignSpeedBand(*f, f->Track.PointCount);
  }
  ASSERT_EQ(f->Track.PointCount, 5);
  EXPECT_EQ(f->Speed.LastBand, 0);
  for (int i = 1; i <= 5; ++i) {
    EXPECT_EQ(f.At(i).ColorBand, 0);
    EXPECT_EQ(f.At(i).Flag, i == 1 ? 1 : 0);
  }
}

TEST(ReadKmlCoordinateLine, ReadsKmlWrittenByGpsbabel) {
  MarkupFile f(6);
  const std::string path = testing::WriteWithGpsbabel(f.folder, kPeerCsv, "kml", "track.kml");
  if (path.empty()) GTEST_SKIP() << "gpsbabel is not available";
  f.KmlFile(testing::FileLines(path));
  ASSERT_EQ(f->Track.PointCount, 3);
  const TrackStore& t = f->Track;
  EXPECT_DOUBLE_EQ(t.at(1).Longitude, -75.2);
  EXPECT_DOUBLE_EQ(t.at(1).Latitude, 45.1);
  EXPECT_EQ(t.at(1).Altitude, 102);
  EXPECT_EQ(t.at(1).Flag, 1);
  EXPECT_DOUBLE_EQ(t.at(2).Longitude, -75.21);
  EXPECT_DOUBLE_EQ(t.at(2).Latitude, 45.11);
  EXPECT_EQ(t.at(2).Altitude, 110);
  EXPECT_EQ(t.at(2).Flag, 0);
  EXPECT_NEAR(t.at(2).Distance, 1.3610709, 1e-7);
  EXPECT_DOUBLE_EQ(t.at(3).Longitude, -75.22);
  EXPECT_DOUBLE_EQ(t.at(3).Latitude, 45.12);
  EXPECT_EQ(t.at(3).Altitude, 120);
  for (int i = 1; i <= 3; ++i) {
    EXPECT_TRUE(t.at(i).DateTime.empty());
    EXPECT_DOUBLE_EQ(t.at(i).Speed, 0);
  }
  EXPECT_TRUE(f.platform.Messages().empty());
}

// A Google Earth style file: all tuples of the track on one line, between tags on their own lines.
TEST(ReadKmlCoordinateLine, ReadsOneLineTracks) {
  MarkupFile f(6);
  f.KmlFile({"<?xml version=\"1.0\" encoding=\"UTF-8\"?>", "<kml xmlns=\"http://www.opengis.net/kml/2.2\">",
             "<Placemark>", "<Point><coordinates>1,1,1</coordinates></Point>", "<LineString>", "<tessellate>1</tessellate>",
             "<coordinates>", "\t\t\t-75.2,45.1,101.6 -75.21,45.11,110 -75.22,45.12,120.4 ", "</coordinates>",
             "</LineString>", "</Placemark>", "</kml>"});
  ASSERT_EQ(f->Track.PointCount, 3);
  EXPECT_DOUBLE_EQ(f.At(1).Longitude, -75.2);
  EXPECT_DOUBLE_EQ(f.At(3).Latitude, 45.12);
  EXPECT_EQ(f.At(3).Altitude, 120);
}

// Our own KML writer's track, from its hand-written expected file: each segment repeats the point
// where the previous one ended, and that point is read again.
TEST(ReadKmlCoordinateLine, ReadsOurOwnSegments) {
  MarkupFile f(6);
  f.KmlFile(testing::FileLines(std::string(MOLVAR_GOLDEN_DIR) + "/kml/track_speed_details.kml"));
  ASSERT_EQ(f->Track.PointCount, 4);
  const double lat[] = {45, 45.01, 45.01, 45.02};
  const int32_t alt[] = {0, 1100, 1100, 1300};
  for (int i = 0; i < 4; ++i) {
    EXPECT_DOUBLE_EQ(f.At(i + 1).Longitude, -75);
    EXPECT_DOUBLE_EQ(f.At(i + 1).Latitude, lat[i]);
    EXPECT_EQ(f.At(i + 1).Altitude, alt[i]);
  }
  EXPECT_NEAR(f.At(4).Distance, 2.2239784, 1e-9);
}

// ---- CDATA

TEST(StripCdata, RemovesTheWrapper) {
  EXPECT_EQ(StripCdata("<![CDATA[Fish & Chips]]>"), "Fish & Chips");
  EXPECT_EQ(StripCdata("<![cdata[lower]]>"), "lower");
  EXPECT_EQ(StripCdata("before<![CDATA[inside]]>after"), "inside");
  EXPECT_EQ(StripCdata("<![CDATA[no end"), "no end");
  EXPECT_EQ(StripCdata("<![CDATA[]]>"), "");
  EXPECT_EQ(StripCdata("<![CDATA[a]]>b]]>"), "a");
  EXPECT_EQ(StripCdata("plain & simple"), "plain & simple");
  EXPECT_EQ(StripCdata("]]>"), "]]>");
  EXPECT_EQ(StripCdata(""), "");
}

}  // namespace
}  // namespace molvar
