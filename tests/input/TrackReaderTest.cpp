// Whole files through "Read track file": header skipping, the test-box echo, the APRS split, the
// speed bands, the drop rules and the hand-over to the dispatcher.
#include <gtest/gtest.h>

#include <filesystem>

#include "core/Text.h"
#include "input/TrackReader.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::ReadFile;
using testing::TestProgram;
using testing::WriteFile;

const char* kPltHeader =
    "OziExplorer Track Point File Version 2.1\r\nWGS 84\r\nAltitude is in Feet\r\nReserved 3\r\n"
    "0,2,255,Track,0,0,2,8421376\r\n3\r\n";

struct Reader : TestProgram {
  Reader() { m->frmMain.chkAuto.Value = 0; }
  // Answers both dialogs and reads `content` as a file of `type`.
  void Read(int16_t type, std::string_view content, const std::string& inName = "in.txt",
            const std::string& outName = "out.kml") {
    m->TrackFileType = type;
    WriteFile(folder.File(inName), content);
    platform.dialogAnswers.push_back(folder.File(inName));
    platform.dialogAnswers.push_back(folder.File(outName));
    ReadTrackFile(*m, false);
  }
  const TrackPoint& P(int32_t i) { return m->Track.at(i); }
};

TEST(ReadTrackFile, PltWithOnlyItsHeaderStoresNothingAndWritesNothing) {
  Reader r;
  r->Track.PointCount = 7;  // a previous track
  r.Read(0, kPltHeader, "in.plt");
  EXPECT_EQ(r->Track.PointCount, 0);
  EXPECT_EQ(r->frmMain.txtInfo.Text, " No track data found - no file saved.");
  EXPECT_FALSE(std::filesystem::exists(r.folder.File("out.kml")));
}

TEST(ReadTrackFile, PltPointsReachTheStoreAndTheKml) {
  Reader r;
  r.Read(0,
         std::string(kPltHeader) +
             "45.1,-75.2,1,328,39155.5,14-Mar-07,12:00:00\r\n"
             "45.2,-75.3,0,-777,39155.50069444,14-Mar-07,12:01:00\r\n"
             "45.3,-75.4,0,656,39155.50138889,14-Mar-07,12:02:00\r\n",
         "in.plt");
  ASSERT_EQ(r->Track.PointCount, 3);
  EXPECT_DOUBLE_EQ(r.P(1).Latitude, 45.1);
  EXPECT_DOUBLE_EQ(r.P(3).Longitude, -75.4);
  EXPECT_EQ(r.P(1).DateTime.view(), "2007-03-14 12:00:00 PM");
  EXPECT_EQ(r.P(1).Altitude, 100);
  EXPECT_EQ(r.P(2).Altitude, 100) << "no altitude takes the last good one";
  EXPECT_EQ(r.P(3).Altitude, 200);
  EXPECT_EQ(r->frmMain.txtInfo.Text, " Processed 3 trackpoints. (1 segments) Output: out.kml");
  const std::string kml = ReadFile(r.folder.File("out.kml"));
  EXPECT_NE(kml.find("-75.2,45.1,"), std::string::npos);
  EXPECT_NE(kml.find("-75.4,45.3,"), std::string::npos);
}

TEST(ReadTrackFile, ViewSettingsAreMadeValidBeforeReading) {
  Reader r;
  r->frmMain.txtEyeAlt.Text = "5";
  r->frmMain.txtTilt.Text = "120";
  r->frmMain.txtHeading.Text = "400";
  r.Read(0, std::string(kPltHeader) + "45.1,-75.2,1,0,39155.5\r\n", "in.plt");
  EXPECT_EQ(r->frmMain.txtEyeAlt.Text, "100");
  EXPECT_EQ(r->frmMain.txtTilt.Text, "45");
  EXPECT_EQ(r->frmMain.txtHeading.Text, "0");
}

TEST(ReadTrackFile, KmlWithoutLineStringReadsNothingAndDropsStartFinishAndFastest) {
  Reader r;
  r.Read(6, "<kml>\n<Placemark><Point><coordinates>-75.2,45.1,0</coordinates></Point></Placemark>\n</kml>\n",
         "in.kml", "out2.kml");
  EXPECT_EQ(r->Track.PointCount, 0);
  EXPECT_EQ(r->frmMain.chkStartFinish.Value, 0);
  EXPECT_EQ(r->frmMain.chkFastest.Value, 0);
}

TEST(ReadTrackFile, KmlCoordinatesAfterTheLineStringAreRead) {
  Reader r;
  r.Read(6,
         "<kml><Document>\r\n<Placemark><name>t</name>\r\n<LineString>\r\n<coordinates>\r\n"
         "-75.2,45.1,10 -75.3,45.2,20\r\n-75.4,45.3,30\r\n</coordinates>\r\n</LineString></Placemark>\r\n",
         "in.kml", "out2.kml");
  ASSERT_EQ(r->Track.PointCount, 3);
  EXPECT_DOUBLE_EQ(r.P(2).Longitude, -75.3);
  EXPECT_EQ(r.P(3).Altitude, 30);
}

TEST(ReadTrackFile, TestModeEchoesOnlyWhileFewerThan500PointsAreStored) {
  Reader r;
  r->TestMode = 1;
  r->frmMain.txtTest.Text = "old text";
  std::string file = kPltHeader;
  for (int i = 1; i <= 505; ++i) file += "45." + std::to_string(i) + ",-75.2,0,0,39155.5\r\n";
  r.Read(0, file, "in.plt");
  ASSERT_EQ(r->Track.PointCount, 505);
  const std::string& box = r->frmMain.txtTest.Text;
  EXPECT_FALSE(StartsWith(box, "old")) << "the box is emptied first";
  EXPECT_TRUE(StartsWith(box, "45.1,-75.2,0,0,39155.5\r\n")) << "header lines are not echoed";
  EXPECT_NE(box.find("45.500,-75.2"), std::string::npos);
  EXPECT_EQ(box.find("45.501,-75.2"), std::string::npos);
  long lines = 0;
  for (char c : box) lines += c == '\n';
  EXPECT_EQ(lines, 500);
}

TEST(ReadTrackFile, SpeedBandsFollowEachPointWhenVaryingBySpeed) {
  Reader r;
  r->ColorVaryMode = 3;
  // CSV type 2 at 25 mph and 70 mph: 40.2 km/h and 112.7 km/h.
  r.Read(5,
         "header\r\n1,2007-03-14,12:00:00,45.1,-75.2,x,Moving,25mph\r\n"
         "2,2007-03-14,12:01:00,45.2,-75.3,x,Moving,70mph\r\n",
         "in.csv");
  ASSERT_EQ(r->Track.PointCount, 2);
  EXPECT_NE(r.P(1).ColorBand, r.P(2).ColorBand);
  EXPECT_GT(r.P(2).ColorBand, 0);
}

TEST(ReadTrackFile, AprsLongLinesAreSplitAtTheirPacket) {
  Reader r;
  const std::string packetTail = std::string(60, ' ');
  r.Read(7,
         // A short station line names the station; no point.
         "VE3XYZ*\r\n"
         // Long, time in the first 19 characters.
         "2007-03-14 12:00:00 VE3XYZ-9>APRS,WIDE2-2:!4530.00N/07530.00W>comment" + packetTail + "\r\n"
         // Long, starting with "#": the time is 8 characters from position 26.
         "#12345 123456 1234567890 12:01:00 VE3XYZ-9>APRS,WIDE:!4531.00N/07531.00W>" + packetTail + "\r\n"
         // Long without ">" after the start: skipped.
         "2007-03-14 12:02:00 no packet here 4532.00N/07532.00W" + packetTail + "\r\n");
  ASSERT_EQ(r->Track.PointCount, 2);
  EXPECT_EQ(r->Aprs.StationCallSign, "VE3XYZ");
  EXPECT_EQ(r.P(1).DateTime.view(), "2007-03-14 12:00:00");
  EXPECT_DOUBLE_EQ(r.P(1).Latitude, 45.5);
  EXPECT_DOUBLE_EQ(r.P(1).Longitude, -75.5);
  EXPECT_EQ(r.P(2).DateTime.view(), "12:01:00");
}

TEST(ReadTrackFile, BareLineFeedNmeaFileIsRepairedAndRead) {
  Reader r;
  std::string file;
  for (int i = 0; i < 6; ++i) {
    file += "$GPRMC,12000" + std::to_string(i) + ",A,4530.0000,N,07530.0000,W,0.0,0.0,140307,,*00\n";
  }
  r->frmMain.mnuIgnore.Checked = true;  // the made-up checksums are not the point here
  r.Read(3, file, "in.txt");
  EXPECT_EQ(r->Track.PointCount, 6);
  EXPECT_EQ(ReadFile(r.folder.File("in.txt")).find("\n$"), ReadFile(r.folder.File("in.txt")).find("\r\n$") + 1);
}

TEST(ReadTrackFile, UnreadableInputShowsTheErrorAndWritesNothing) {
  Reader r;
  r->TrackFileType = 0;
  r.platform.dialogAnswers.push_back(r.folder.File("missing.plt"));
  r.platform.dialogAnswers.push_back(r.folder.File("out.kml"));
  ReadTrackFile(*r, false);
  const auto messages = r.platform.Messages();
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_TRUE(StartsWith(messages[0].text, "ReadTrackFile snag ")) << messages[0].text;
  EXPECT_EQ(messages[0].title, " Whoa! An error!");
  EXPECT_FALSE(std::filesystem::exists(r.folder.File("out.kml")));
}

TEST(ReadTrackFile, CancelledDialogsLeaveTheStore) {
  Reader r;
  r.AddPoint(1, 2, "2007-03-14 12:00:00 PM");
  r.platform.dialogAnswers.push_back(std::nullopt);
  ReadTrackFile(*r, false);
  r.platform.dialogAnswers.push_back(r.folder.File("in.plt"));
  r.platform.dialogAnswers.push_back(std::nullopt);
  ReadTrackFile(*r, false);
  EXPECT_EQ(r->Track.PointCount, 1);
  EXPECT_TRUE(r.platform.Messages().empty());
}

TEST(ReadTrackFile, BinaryGarbageNeverStopsTheDriver) {
  for (int16_t type = 0; type < 9; ++type) {
    Reader r;
    std::string junk;
    for (int i = 0; i < 4096; ++i) junk.push_back(static_cast<char>((i * 131 + type) % 256));
    r.Read(type, junk, "junk.bin", "junk.kml");
    EXPECT_GE(r->Track.PointCount, 0);
    for (const auto& call : r.platform.Messages()) {
      EXPECT_EQ(call.text.find(" snag "), std::string::npos) << "type " << type << ": " << call.text;
    }
  }
}

struct DropCase {
  int16_t type;
  const char* file;
  const char* message;  // nullptr: accepted
};

TEST(TrackFrameDrop, ChecksExtensionAgainstTheTypeAndRefusesKml) {
  const char* kIncorrect =
      "Incorrect file type!\r\nChange the file type selection box\r\nto agree with the input file type.";
  const char* kKml =
      "Cannot convert a kml file by dragging it.\r\nUse File type of KML, press Read track file button and save to a "
      "different folder. ";
  const DropCase cases[] = {
      {1, "track.plt", kIncorrect}, {7, "log.txt", nullptr},     {8, "log.TXT", nullptr},
      {4, "a.csv", nullptr},        {5, "a.csv", nullptr},       {6, "a.kml", kKml},
      {0, "a.Kml", kKml},           {6, "a.txt", kIncorrect},    {0, "noextension", kIncorrect},
  };
  for (const auto& c : cases) {
    Reader r;
    r->TrackFileType = c.type;
    r->OutputPath = "/previous/out.gpx";
    r->OutputName = "out.gpx";
    WriteFile(r.folder.File(c.file), "");
    TrackFrame_Drop(*r, r.folder.File(c.file));
    const auto messages = r.platform.Messages();
    if (c.message == nullptr) {
      EXPECT_TRUE(messages.empty()) << c.file;
      EXPECT_EQ(r->frmMain.txtInfo.Text, " No track data found - no file saved.") << "the driver ran: " << c.file;
    } else {
      ASSERT_EQ(messages.size(), 1u) << c.file;
      EXPECT_EQ(messages[0].text, c.message);
      EXPECT_EQ(messages[0].title, "Whoops!");
      EXPECT_EQ(messages[0].icon, MsgIcon::Exclamation);
    }
    EXPECT_EQ(r->LastSourceFile, r.folder.File(c.file));
    if (std::string_view(c.file) == "noextension") {
      EXPECT_EQ(r->OutputPath, "/previous/out.gpx");
      EXPECT_EQ(r->OutputName, "out.gpx");
    }
  }
}

TEST(TrackFrameDrop, OutputBesideTheInputNamedKml) {
  Reader r;
  r->TrackFileType = 0;
  const std::string path = r.folder.File("my.trip.plt");
  WriteFile(path, std::string(kPltHeader) + "45.1,-75.2,1,0,39155.5\r\n45.2,-75.3,0,0,39155.6\r\n");
  TrackFrame_Drop(*r, path);
  EXPECT_EQ(r->OutputPath, r.folder.File("my.trip.kml"));
  EXPECT_EQ(r->OutputName, "my.trip.kml");
  EXPECT_EQ(r->InputName, "my.trip.plt");
  EXPECT_EQ(r->Track.PointCount, 2);
  EXPECT_TRUE(std::filesystem::exists(r.folder.File("my.trip.kml")));
}

TEST(TrackFrameDrop, NameEndingInADotGetsKmlAppended) {
  Reader r;
  const std::string path = r.folder.File("odd.");
  TakeDroppedFile(*r, path);
  EXPECT_EQ(r->OutputPath, path + "kml");
}

}  // namespace
}  // namespace molvar
