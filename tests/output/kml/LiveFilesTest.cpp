// The live files of real-time mode against hand-written files, the per-fix rewrite with its
// guards, the automatic upload decisions, and the old nmea.kml surviving a failed rewrite.
#include <gtest/gtest.h>
#include <sys/resource.h>

#include <csignal>
#include <cstdio>
#include <filesystem>
#include <tuple>
#include <vector>

#include "core/Text.h"
#include "input/Nmea.h"
#include "output/kml/LiveFiles.h"
#include "support/Peers.h"
#include "support/Sentences.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::ExpectInOrder;
using testing::ExpectWellFormedXml;
using testing::ReadFile;
using testing::Rmc;
using testing::RunCommand;
using testing::TestProgram;

std::string Golden(const std::string& name, const std::string& folder) {
  return Replace(ReadFile(std::string(MOLVAR_GOLDEN_DIR) + "/live/" + name), "{FOLDER}", folder);
}

// Latitude text of 45 degrees and `hundredths` hundredths of a degree north.
std::string Latitude(int hundredths) {
  char text[32];
  std::snprintf(text, sizeof text, "45%02d.%04d", hundredths * 60 / 100, (hundredths * 60 % 100) * 100);
  return text;
}

struct Live : TestProgram {
  Live() {
    Molvar& p = *m;
    p.ProgramMode = kModeRealTimeNmea;
    p.frmMain.chkDetailed.Value = 0;
    p.frmMain.chkStartFinish.Value = 0;
    p.frmMain.chkFastest.Value = 0;
  }
  std::string NmeaKml() const { return folder.File("nmea.kml"); }

  // What the real-time handler does with an accepted sentence: parse, count, rewrite.
  void Fix(std::string sentence) {
    ParseNMEA(*m, sentence);
    ASSERT_EQ(m->Nmea.NmeaValid, 1) << sentence;
    m->Track.PointCount += 1;
    WriteNmeaKmlFile(*m);
  }
  // `n` more fixes, each 0.01 degrees north of the last and 10 seconds later, at 18.5 km/h heading east.
  void Fixes(int n) {
    for (int i = 0; i < n; ++i, ++sent) {
      char time[32];
      std::snprintf(time, sizeof time, "10%02d%02d", sent * 10 / 60, sent * 10 % 60);
      Fix(Rmc(time, Latitude(sent), "010.0", "090.0"));
    }
  }
  int sent = 0;
};

size_t CountOf(const std::string& text, const std::string& what) {
  size_t n = 0;
  for (size_t at = text.find(what); at != std::string::npos; at = text.find(what, at + 1)) ++n;
  return n;
}

// The href of a network-link file, as an XML reader sees it.
std::string LinkTarget(const std::string& path) {
  int rc = -1;
  std::string href =
      RunCommand("xmllint --xpath \"string(//*[local-name()='Link']/*[local-name()='href'])\" '" + path + "'", &rc);
  EXPECT_EQ(rc, 0) << href;
  while (!href.empty() && href.back() == '\n') href.pop_back();
  return href;
}

TEST(LiveLinkFiles, GpsLinkIsTheHandWrittenFileAndPointsAtNmeaKml) {
  Live t;
  WriteGpsLinkFile(*t);
  const std::string path = t.folder.File("gps.kml");
  EXPECT_EQ(ReadFile(path), Golden("gps.kml", t.folder.path().string()));
  ExpectWellFormedXml(path);
  EXPECT_EQ(LinkTarget(path), t.NmeaKml());
  EXPECT_TRUE(t.platform.Messages().empty());
}

TEST(LiveLinkFiles, WebLinkIsTheHandWrittenFileWithoutRefreshModeAtZero) {
  Live t;
  t->FtpHttpPath = "http://example.org/live/";
  t->frmMain.txtGErefresh.Text = "0";
  WriteWebLinkFile(*t);
  const std::string path = t.folder.File("gpslink.kml");
  EXPECT_EQ(ReadFile(path), Golden("gpslink.kml", t.folder.path().string()));
  ExpectWellFormedXml(path);
  EXPECT_EQ(LinkTarget(path), "http://example.org/live/nmea.kml");
}

TEST(LiveLinkFiles, RefreshIntervalIsTheLeadingWholeNumberOfTheBox) {
  Live t;
  const std::string path = t.folder.File("gps.kml");
  for (const auto& [text, interval, onInterval] : std::vector<std::tuple<std::string, std::string, bool>>{
           {"0", "0", false}, {"abc", "0", false}, {"15 s", "15", true}, {"-3", "-3", false}, {"1", "1", true}}) {
    t->frmMain.txtGErefresh.Text = text;
    WriteGpsLinkFile(*t);
    const std::string kml = ReadFile(path);
    EXPECT_NE(kml.find("\r\n    <refreshInterval>" + interval + "</refreshInterval>\r\n"), std::string::npos)
        << text << "\n"
        << kml;
    EXPECT_EQ(kml.find("<refreshMode>onInterval</refreshMode>") != std::string::npos, onInterval) << text;
  }
}

TEST(LiveLinkFiles, ServerAddressIsEscapedAndLinksAreWrittenWhileTheOutputIsOpen) {
  Live t;
  t->FtpHttpPath = "http://example.org/cgi?user=a&dir=<live>/";
  t->Out.Open(t.folder.File("other.kml"));
  t->Out.Line("<kml/>");
  WriteWebLinkFile(*t);
  WriteGpsLinkFile(*t);
  ASSERT_TRUE(t->Out.IsOpen());
  t->Out.Close();
  EXPECT_EQ(ReadFile(t.folder.File("other.kml")), "<kml/>\r\n");
  const std::string path = t.folder.File("gpslink.kml");
  EXPECT_NE(ReadFile(path).find("<href>http://example.org/cgi?user=a&amp;dir=&lt;live>/nmea.kml</href>"),
            std::string::npos);
  ExpectWellFormedXml(path);
  EXPECT_EQ(LinkTarget(path), "http://example.org/cgi?user=a&dir=<live>/nmea.kml");
  ExpectWellFormedXml(t.folder.File("gps.kml"));
}

TEST(LiveLinkFiles, AFolderThatCannotBeWrittenIsReported) {
  Live t;
  t->ProgramFolder = t.folder.File("missing");
  WriteGpsLinkFile(*t);
  WriteWebLinkFile(*t);
  const auto messages = t.platform.Messages();
  ASSERT_EQ(messages.size(), 2u);
  EXPECT_TRUE(StartsWith(messages[0].text, "WriteGpsLinkFile bug ")) << messages[0].text;
  EXPECT_TRUE(StartsWith(messages[1].text, "WriteWebLinkFile bug ")) << messages[1].text;
  EXPECT_EQ(messages[0].title, "Error");
  EXPECT_EQ(messages[0].icon, MsgIcon::Exclamation);
}

TEST(LiveNmeaKml, ThreeFixesWriteTheHandWrittenDocument) {
  Live t;
  Molvar& m = *t;
  m.frmMain.chkStartFinish.Value = 1;
  m.frmMain.chkFastest.Value = 1;
  t.Fix("$GPRMC,100000,A,4500.0000,N,07500.0000,W,000.0,000.0,061226,,*0C\r\n");
  t.Fix("$GPRMC,100010,A,4500.6000,N,07500.0000,W,010.0,000.0,061226,,*0A\r\n");
  t.Fix("$GPRMC,100020,A,4501.2000,N,07500.0000,W,006.663,045.0,061226,,*09\r\n");
  const std::string path = t.NmeaKml();
  EXPECT_EQ(ReadFile(path), Golden("nmea.kml", t.folder.path().string()));
  EXPECT_TRUE(t.platform.Messages().empty());
  EXPECT_EQ(m.Live.LastWrittenCount, 3);
  EXPECT_EQ(m.OutputPath, path);
  EXPECT_EQ(m.OutputName, "nmea.kml");
  EXPECT_TRUE(m.LastSourceFile.empty());
  EXPECT_EQ(m.Speed.FastestIndex, 2);
  EXPECT_DOUBLE_EQ(m.Track.at(3).Distance, 2.2239784);
  EXPECT_TRUE(m.frmMain.cmdOpen.Enabled);
  // Real-time mode never starts Google Earth on the data file; it follows the link file.
  EXPECT_TRUE(t.platform.CallsOf("StartProgram").empty());

  ExpectWellFormedXml(path);
  int rc = -1;
  const std::string ogr = RunCommand("ogrinfo -ro -al '" + path + "' 2>&1", &rc);
  EXPECT_EQ(rc, 0) << ogr;
  EXPECT_EQ(ogr.find("ERROR"), std::string::npos) << ogr;
  ExpectInOrder(ogr,
                {"Start  10:00:00 AM", "POINT Z (-75 45 0)", "Finish  10:00:20 AM 2.22 km", "POINT Z (-75 45.02 0)",
                 "Fastest (18.5 kph at point 2)", "12.3 kph  Alt: 3 feet  Hdg: 45\xC2\xB0", "Track - 3 points",
                 "LINESTRING Z (-75 45 1,-75 45.01 1,-75 45.02 1)"});
}

TEST(LiveNmeaKml, GoogleEarthFollowsTheLinkToAReadableFile) {
  Live t;
  WriteGpsLinkFile(*t);
  t.Fixes(3);
  const std::string link = t.folder.File("gps.kml");
  ExpectWellFormedXml(link);
  // GDAL keeps only containers of placemarks and cannot open a file whose root is a NetworkLink,
  // so the link is followed the way Google Earth does and the target is read instead.
  const std::string target = LinkTarget(link);
  ASSERT_EQ(target, t.NmeaKml());
  int rc = -1;
  const std::string ogr = RunCommand("ogrinfo -ro -al '" + target + "' 2>&1", &rc);
  EXPECT_EQ(rc, 0) << ogr;
  EXPECT_EQ(ogr.find("ERROR"), std::string::npos) << ogr;
  ExpectInOrder(ogr, {"18.5 kph  Alt: 3 feet  Hdg: 90\xC2\xB0", "POINT Z (-75 45.02 0)", "Track - 3 points",
                      "LINESTRING Z (-75 45 1,-75 45.01 1,-75 45.02 1)"});
  const std::string babel = RunCommand("gpsbabel -i kml -f '" + target + "' -o unicsv -F - 2>&1", &rc);
  EXPECT_EQ(rc, 0) << babel;
  EXPECT_NE(babel.find("45.020000"), std::string::npos) << babel;
}

TEST(LiveLabel, SpeedAltitudeAndHeadingOfTheFix) {
  Live t;
  Molvar& m = *t;
  NmeaFields& n = m.Nmea.Fields;
  n.CourseText = "0";
  n.SpeedText = "0.4";
  EXPECT_EQ(LivePlacemarkLabel(m), "Stationary");
  n.SpeedText = "0.99";
  EXPECT_EQ(LivePlacemarkLabel(m), "Stationary");
  n.SpeedText = "";
  EXPECT_EQ(LivePlacemarkLabel(m), "Stationary");
  n.SpeedText = "1";
  EXPECT_EQ(LivePlacemarkLabel(m), "1.0 kph");
  n.SpeedText = "12.34";
  EXPECT_EQ(LivePlacemarkLabel(m), "12.3 kph");
  m.UnitFactor = 0.6213712;
  m.SpeedUnitLabel = " mph";
  n.SpeedText = "18.5";
  EXPECT_EQ(LivePlacemarkLabel(m), "11.5 mph");
  m.Nmea.NmeaAltitude = 100;
  EXPECT_EQ(LivePlacemarkLabel(m), "11.5 mph  Alt: 328 feet");
  m.AltitudeFactor = 1.0;
  m.AltitudeUnitLabel = " meters";
  n.CourseText = "359.6";
  EXPECT_EQ(LivePlacemarkLabel(m), "11.5 mph  Alt: 100 meters  Hdg: 360\xC2\xB0");
  m.Nmea.NmeaAltitude = -5;
  n.SpeedText = "0.2";
  n.CourseText = "7";
  EXPECT_EQ(LivePlacemarkLabel(m), "Stationary  Hdg: 7\xC2\xB0");
}

TEST(LiveLabel, ASlowFixFromTheReceiverIsStationaryInTheFile) {
  Live t;
  // 0.2 knots are 0.4 km/h.
  t.Fix(Rmc("100000", "4500.0000", "000.2", "000.0"));
  EXPECT_EQ(t->Nmea.Fields.SpeedText, "0.4");
  const std::string kml = ReadFile(t.NmeaKml());
  EXPECT_NE(kml.find("\r\n  <name>Stationary  Alt: 3 feet</name>\r\n"), std::string::npos) << kml;
  // The degree sign is UTF-8 in the file, not a Latin-1 byte and not converted twice.
  t.Fix(Rmc("100010", "4500.6000", "006.663", "123.4"));
  const std::string next = ReadFile(t.NmeaKml());
  EXPECT_NE(next.find("<name>12.3 kph  Alt: 3 feet  Hdg: 123\xC2\xB0</name>"), std::string::npos) << next;
  EXPECT_EQ(next.find("\xC3\x82"), std::string::npos);
}

TEST(LiveTrack, LimitZeroWritesNoLineOneWritesEveryPoint) {
  Live t;
  t->frmMain.txtTrkLimit.Text = "0";
  t.Fixes(4);
  std::string kml = ReadFile(t.NmeaKml());
  EXPECT_EQ(kml.find("<LineString>"), std::string::npos);
  EXPECT_EQ(CountOf(kml, "<Placemark>"), 1u);
  ExpectWellFormedXml(t.NmeaKml());

  t->frmMain.txtTrkLimit.Text = "1";
  t.Fixes(1);
  kml = ReadFile(t.NmeaKml());
  EXPECT_NE(kml.find("<name>Track - 5 points</name>"), std::string::npos);
  EXPECT_EQ(CountOf(kml, "    -75,"), 5u);
  ExpectInOrder(kml, {"    <coordinates>\r\n    -75,45,1 \r\n", "    -75,45.04,1 \r\n    </coordinates>\r\n"});
}

TEST(LiveTrack, LimitTwentyShowsTheLastTwentyPoints) {
  Live t;
  t->frmMain.txtTrkLimit.Text = "20";
  t.Fixes(5);
  std::string kml = ReadFile(t.NmeaKml());
  EXPECT_NE(kml.find("<name>Track - 5 points</name>"), std::string::npos) << kml;
  EXPECT_EQ(CountOf(kml, "    -75,"), 5u);

  t.Fixes(20);
  kml = ReadFile(t.NmeaKml());
  EXPECT_NE(kml.find("<name>Track - displaying 20 of 25 points</name>"), std::string::npos) << kml;
  EXPECT_EQ(CountOf(kml, "    -75,"), 20u);
  // Points 6 to 25 are 45.05 to 45.24 degrees north.
  ExpectInOrder(kml, {"    <coordinates>\r\n    -75,45.05,1 \r\n", "    -75,45.24,1 \r\n    </coordinates>\r\n"});
  EXPECT_EQ(kml.find("-75,45.04,"), std::string::npos);
  ExpectWellFormedXml(t.NmeaKml());
}

TEST(LiveTrack, TitleOfTheBoxWhenAutoNameIsOffAndNoLineForOnePoint) {
  Live t;
  t->frmMain.chkUseFilename.Value = 0;
  t->frmMain.txtTitle.Text = "Drive & back";
  t.Fixes(1);
  EXPECT_EQ(ReadFile(t.NmeaKml()).find("<LineString>"), std::string::npos);
  t.Fixes(1);
  const std::string kml = ReadFile(t.NmeaKml());
  EXPECT_NE(kml.find("<Placemark>\r\n  <name>Drive &amp; back</name>\r\n  <Style>"), std::string::npos) << kml;
  // The document keeps its real-time title.
  EXPECT_NE(kml.find("<name>NMEA data</name>"), std::string::npos);
  ExpectWellFormedXml(t.NmeaKml());
}

TEST(LiveTrack, DetailsCoverOnlyTheTail) {
  Live t;
  t->frmMain.chkDetailed.Value = 1;
  t->frmMain.txtTrkLimit.Text = "3";
  t.Fixes(5);
  const std::string kml = ReadFile(t.NmeaKml());
  EXPECT_EQ(kml.find("Detailed data #2 "), std::string::npos);
  ExpectInOrder(kml, {"Detailed data #3 ", "Detailed data #5 ", "Track - displaying 3 of 5 points"});
  ExpectWellFormedXml(t.NmeaKml());
}

TEST(LiveRewrite, NothingIsWrittenWithoutANewPoint) {
  Live t;
  Molvar& m = *t;
  // No sentence accepted yet.
  m.Track.PointCount = 1;
  WriteNmeaKmlFile(m);
  EXPECT_FALSE(std::filesystem::exists(t.NmeaKml()));
  m.Track.PointCount = 0;

  t.Fixes(1);
  ASSERT_TRUE(std::filesystem::exists(t.NmeaKml()));
  const int written = m.Out.CompletedCount();
  std::filesystem::remove(t.NmeaKml());
  WriteNmeaKmlFile(m);
  EXPECT_FALSE(std::filesystem::exists(t.NmeaKml()));
  EXPECT_EQ(m.Out.CompletedCount(), written);
  EXPECT_EQ(m.Track.PointCount, 1);
  EXPECT_TRUE(t.platform.Messages().empty());
}

TEST(LiveRewrite, AReaderInTheMiddleOfTheFileKeepsReadingTheOldOne) {
  Live t;
  t.Fixes(2);
  const std::string before = ReadFile(t.NmeaKml());
  // Google Earth has started reading when the next fix arrives.
  std::FILE* reader = std::fopen(t.NmeaKml().c_str(), "rb");
  ASSERT_NE(reader, nullptr);
  std::string seen(100, '\0');
  ASSERT_EQ(std::fread(seen.data(), 1, seen.size(), reader), seen.size());
  t.Fixes(1);
  char chunk[4096];
  for (size_t n; (n = std::fread(chunk, 1, sizeof chunk, reader)) > 0;) seen.append(chunk, n);
  std::fclose(reader);
  EXPECT_EQ(seen, before);
  const std::string after = ReadFile(t.NmeaKml());
  EXPECT_NE(after, before);
  EXPECT_NE(after.find("<name>Track - 3 points</name>"), std::string::npos);
  EXPECT_TRUE(after.ends_with("</Folder>\r\n</kml>\r\n"));
}

TEST(LiveRewrite, AFailedHeadIsReportedAndTheSameCountIsTriedAgain) {
  Live t;
  Molvar& m = *t;
  const std::string folder = m.ProgramFolder;
  m.ProgramFolder = t.folder.File("missing");
  t.Fixes(1);
  const auto messages = t.platform.Messages();
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_TRUE(StartsWith(messages[0].text, "WriteKmlHeader bug ")) << messages[0].text;
  EXPECT_EQ(m.Live.LastWrittenCount, 0);
  m.ProgramFolder = folder;
  WriteNmeaKmlFile(m);
  EXPECT_EQ(m.Live.LastWrittenCount, 1);
  EXPECT_NE(ReadFile(t.NmeaKml()).find("<coordinates>-75,45,0</coordinates>"), std::string::npos);
}

TEST(LiveRewrite, AFailedWriteLeavesThePreviousFileWhole) {
  Live t;
  Molvar& m = *t;
  m.frmMain.mnuAutoFtp(0).Checked = true;
  m.FtpReady = 1;
  m.FtpUploadRate = 10;
  std::vector<int32_t> uploads;
  m.UploadLastFile = [&](Molvar&, int32_t count) { uploads.push_back(count); };
  t.platform.now = 1000;
  t.Fixes(2);
  ASSERT_EQ(uploads, std::vector<int32_t>{1});
  const std::string before = ReadFile(t.NmeaKml());
  for (int i = 0; i < 20000; ++i) t.AddPoint(45.1 + i * 1e-5, -75.0, "2026-12-06 10:05:00 AM");
  t.platform.now = 100000;

  rlimit old{};
  getrlimit(RLIMIT_FSIZE, &old);
  rlimit small = old;
  small.rlim_cur = 64 * 1024;
  std::signal(SIGXFSZ, SIG_IGN);
  setrlimit(RLIMIT_FSIZE, &small);
  t.Fix(Rmc("101000", "4503.0000", "010.0", "090.0"));
  setrlimit(RLIMIT_FSIZE, &old);

  EXPECT_EQ(ReadFile(t.NmeaKml()), before);
  const auto messages = t.platform.Messages();
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_TRUE(StartsWith(messages[0].text, "WriteKmlFooter bug ")) << messages[0].text;
  EXPECT_EQ(messages[0].title, "Error");
  // The old file is not uploaded again, and the next fix tries again.
  EXPECT_EQ(uploads, std::vector<int32_t>{1});
  EXPECT_EQ(m.Live.LastWrittenCount, 2);
  for (const auto& entry : std::filesystem::directory_iterator(t.folder.path())) {
    EXPECT_EQ(entry.path().filename().string().find(".tmp"), std::string::npos) << entry.path();
  }
  t.Fix(Rmc("101010", "4503.6000", "010.0", "090.0"));
  EXPECT_EQ(m.Live.LastWrittenCount, 20004);
  EXPECT_EQ(uploads, (std::vector<int32_t>{1, 2}));
  const std::string after = ReadFile(t.NmeaKml());
  EXPECT_NE(after.find("<name>Track - 20004 points</name>"), std::string::npos);
  EXPECT_TRUE(after.ends_with("</Folder>\r\n</kml>\r\n"));
}

TEST(LiveFtp, GoogleMapsIsRefusedOnceAndNeverUploaded) {
  Live t;
  Molvar& m = *t;
  m.OutputMode = kOutputGoogleMaps;
  m.frmMain.mnuAutoFtp(0).Checked = true;
  m.FtpReady = 1;
  int uploads = 0;
  m.UploadLastFile = [&](Molvar&, int32_t) { ++uploads; };
  t.Fixes(3);
  const auto messages = t.platform.Messages();
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_EQ(messages[0].text,
            "You cannot auto-ftp a GoogleMap file, as GoogleMap\r\ndoes not support live network links.\r\n"
            "Use Program Mode / Output to Google Earth instead.");
  EXPECT_EQ(messages[0].title, "Sorry!");
  EXPECT_EQ(messages[0].icon, MsgIcon::Exclamation);
  EXPECT_EQ(messages[0].buttons, MsgButtons::OK);
  EXPECT_EQ(uploads, 0);
  EXPECT_TRUE(m.Live.GmapsWarned);
  EXPECT_EQ(m.Live.UploadCount, 0);
  EXPECT_EQ(m.Live.LastWrittenCount, 3);
  EXPECT_FALSE(m.frmFtpSetup.window.Visible);
}

TEST(LiveFtp, WithoutAServerTheFtpWindowIsShownOnce) {
  Live t;
  Molvar& m = *t;
  m.frmMain.mnuAutoFtp(0).Checked = true;
  int uploads = 0;
  m.UploadLastFile = [&](Molvar&, int32_t) { ++uploads; };
  t.Fixes(1);
  EXPECT_TRUE(m.frmFtpSetup.window.Visible);
  EXPECT_TRUE(m.Live.FtpSetupShown);
  // The user closes it; later fixes do not bring it back.
  m.frmFtpSetup.window.Visible = false;
  t.Fixes(2);
  EXPECT_FALSE(m.frmFtpSetup.window.Visible);
  EXPECT_EQ(uploads, 0);
  EXPECT_EQ(m.Live.LastWrittenCount, 3);
  EXPECT_TRUE(t.platform.Messages().empty());
}

TEST(LiveFtp, UploadsTheFinishedFileAtTheUploadRate) {
  Live t;
  Molvar& m = *t;
  m.frmMain.mnuAutoFtp(0).Checked = true;
  m.FtpReady = 1;
  m.FtpUploadRate = 10;
  struct Upload {
    int32_t count;
    int64_t at;
    std::string file;
  };
  std::vector<Upload> uploads;
  m.UploadLastFile = [&](Molvar& p, int32_t count) {
    uploads.push_back({count, p.platform.Now(), ReadFile(p.OutputPath)});
  };
  const int64_t start = 45000LL * 86400;
  for (const int64_t at : {0, 5, 9, 10, 19, 25}) {
    t.platform.now = start + at;
    t.Fixes(1);
  }
  ASSERT_EQ(uploads.size(), 3u);
  EXPECT_EQ(uploads[0].count, 1);
  EXPECT_EQ(uploads[0].at, start);
  EXPECT_EQ(uploads[1].count, 2);
  EXPECT_EQ(uploads[1].at, start + 10);
  EXPECT_EQ(uploads[2].count, 3);
  EXPECT_EQ(uploads[2].at, start + 25);
  // The upload gets the complete new file: point 4 is in the file uploaded second.
  EXPECT_TRUE(uploads[1].file.ends_with("</kml>\r\n"));
  EXPECT_NE(uploads[1].file.find("<name>Track - 4 points</name>"), std::string::npos);
  EXPECT_EQ(m.Live.UploadCount, 3);
  EXPECT_EQ(m.Live.LastUploadTime, start + 25);
  EXPECT_EQ(m.Live.LastWrittenCount, 6);
  EXPECT_FALSE(m.frmFtpSetup.window.Visible);
  EXPECT_TRUE(t.platform.Messages().empty());
}

TEST(LiveFtp, NoUploadUnlessTickedInRealTimeModeAndAnUploaderIsPresent) {
  Live t;
  Molvar& m = *t;
  m.FtpReady = 1;
  int uploads = 0;
  m.UploadLastFile = [&](Molvar&, int32_t) { ++uploads; };
  t.Fixes(2);
  EXPECT_EQ(uploads, 0);
  EXPECT_FALSE(m.frmFtpSetup.window.Visible);

  m.frmMain.mnuAutoFtp(0).Checked = true;
  m.UploadLastFile = nullptr;
  t.Fixes(1);
  EXPECT_EQ(m.Live.UploadCount, 0);
  EXPECT_EQ(m.Live.LastUploadTime, 0);
  EXPECT_EQ(m.Live.LastWrittenCount, 3);
  EXPECT_TRUE(t.platform.Messages().empty());
}

}  // namespace
}  // namespace molvar
