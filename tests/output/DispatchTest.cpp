// The track dispatcher, "Refresh output" and "Open in GE" with its search for Google Earth.
#include <gtest/gtest.h>

#include <sys/resource.h>

#include <csignal>
#include <filesystem>

#include "core/Text.h"
#include "output/Dispatch.h"
#include "support/Peers.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::ExpectInOrder;
using testing::ReadFile;
using testing::RunCommand;
using testing::TestProgram;
using testing::WriteFile;

struct Dispatch : TestProgram {
  Dispatch() {
    m->frmMain.chkAuto.Value = 0;
    AddPoint(45.0, -75.0, "2007-06-01 10:00:00 AM");
    AddPoint(45.01, -75.0, "2007-06-01 10:01:00 AM");
    AddPoint(45.02, -75.01, "2007-06-01 10:02:00 AM");
  }
  void WriteTo(const std::string& name, int16_t format) {
    m->OutputPath = folder.File(name);
    m->OutputName = name;
    m->OutputFormat = format;
    WriteOutputFile(*m);
  }
};

TEST(WriteOutputFile, NoPointsNoFile) {
  TestProgram t;
  t->OutputPath = t.folder.File("none.kml");
  WriteOutputFile(*t);
  EXPECT_EQ(t->frmMain.txtInfo.Text, " No track data found - no file saved.");
  EXPECT_FALSE(std::filesystem::exists(t->OutputPath));
}

TEST(WriteOutputFile, EachFormatIsReadBackByGpsbabel) {
  struct Case {
    const char* name;
    int16_t format;
    const char* babelFormat;
  };
  const Case cases[] = {{"t.kml", kFormatKml, "kml"}, {"t.gpx", kFormatGpx, "gpx"}, {"t.plt", kFormatOzi, "ozi"}};
  for (const auto& c : cases) {
    Dispatch d;
    d.WriteTo(c.name, c.format);
    const std::string out = RunCommand(std::string("gpsbabel -t -i ") + c.babelFormat + " -f '" + d.folder.File(c.name) +
                                       "' -o unicsv,utc=0 -F - 2>&1");
    ExpectInOrder(out, {"45.000000,-75.000000", "45.010000,-75.000000", "45.020000,-75.010000"});
  }
}

TEST(WriteOutputFile, WptNameInTrackModeGetsThePltFormat) {
  Dispatch d;
  d.WriteTo("track.wpt", kFormatOzi);
  const std::string text = ReadFile(d.folder.File("track.wpt"));
  EXPECT_TRUE(StartsWith(text, "TrackPlot Track Point File Version 1.0\r\nWGS 84\r\n")) << text;
  EXPECT_NE(text.find("\r\n 3\r\n45, -75, 1, -777, "), std::string::npos) << text;
}

TEST(WriteOutputFile, GpxSummaryAndSegmentsMarked) {
  Dispatch d;
  d.WriteTo("t.gpx", kFormatGpx);
  EXPECT_EQ(d->frmMain.txtInfo.Text, " Output: t.gpx");
  EXPECT_EQ(d->Track.at(1).SegCtr, 3) << "the segment pass ran";
  EXPECT_EQ(d->Speed.FastestIndex, FindFastestPoint(*d));
}

TEST(WriteOutputFile, AprsWebOutputIsNamedAfterTheStation) {
  Dispatch d;
  d->ProgramMode = kModeAprsWeb;
  d->Aprs.StationCallSign = "VE3XYZ";
  d->OutputTrackPath = d.folder.path().string();
  d->OutputFormat = kFormatKml;
  WriteOutputFile(*d);
  EXPECT_EQ(d->OutputName, "VE3XYZ.kml");
  EXPECT_EQ(d->OutputPath, d.folder.File("VE3XYZ.kml"));
  EXPECT_TRUE(std::filesystem::exists(d->OutputPath));
}

// A write that fails part-way (the file size limit stands in for a full disk) reports the error
// and leaves the file that was there.
TEST(WriteOutputFile, FailedWriteKeepsThePreviousFile) {
  for (const int16_t format : {kFormatGpx, kFormatOzi}) {
    Dispatch d;
    for (int i = 0; i < 20000; ++i) d.AddPoint(45.0 + i * 1e-5, -75.0, "2007-06-01 10:03:00 AM");
    const std::string path = d.folder.File(format == kFormatGpx ? "big.gpx" : "big.plt");
    WriteFile(path, "previous content\r\n");
    rlimit old{};
    getrlimit(RLIMIT_FSIZE, &old);
    rlimit small = old;
    small.rlim_cur = 64 * 1024;
    std::signal(SIGXFSZ, SIG_IGN);
    setrlimit(RLIMIT_FSIZE, &small);
    d.WriteTo(std::string(FileNameOf(path)), format);
    setrlimit(RLIMIT_FSIZE, &old);
    EXPECT_EQ(ReadFile(path), "previous content\r\n");
    const auto messages = d.platform.Messages();
    ASSERT_EQ(messages.size(), 1u);
    EXPECT_TRUE(StartsWith(messages[0].text, "WriteOutputFile bug ")) << messages[0].text;
    EXPECT_EQ(messages[0].title, "Error");
    for (const auto& entry : std::filesystem::directory_iterator(d.folder.path())) {
      EXPECT_EQ(entry.path().string().find(".tmp"), std::string::npos) << "temporary file left: " << entry.path();
    }
  }
}

TEST(RefreshOutput, WaypointsAreRedrawnAtTheEyeAltitude) {
  TestProgram t;
  t->ProgramMode = kModeConvertWaypoints;
  t->frmMain.chkAuto.Value = 0;
  t->AltitudeMode = 1;
  t->frmMain.txtEyeAlt.Text = "3280.83";  // feet
  auto& w = t->Waypoints.Add();
  w.WptName = "Camp";
  w.WptLatitude = 45.5;
  w.WptLongitude = -75.25;
  w.WptAltitude = 12;
  t->OutputPath = t.folder.File("w.kml");
  t->OutputName = "w.kml";
  RefreshOutput(*t);
  EXPECT_EQ(t->Waypoints.at(1).WptAltitude, 1000);
  const std::string kml = ReadFile(t.folder.File("w.kml"));
  EXPECT_NE(kml.find("-75.25,45.5,1000"), std::string::npos) << kml;
  EXPECT_EQ(t->frmMain.txtInfo.Text, " Created 1 placemarks. Output: w.kml");
}

TEST(RefreshOutput, NoWaypointsSaysSo) {
  TestProgram t;
  t->ProgramMode = kModeConvertWaypoints;
  RefreshOutput(*t);
  const auto messages = t.platform.Messages();
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_EQ(messages[0].text, "No waypoint data available.\r\nPlease load a waypoint file first.");
  EXPECT_EQ(messages[0].title, " Sorry!...");
  EXPECT_EQ(messages[0].icon, MsgIcon::Information);
}

TEST(RefreshOutput, TrackModesRewriteTheLastOutput) {
  Dispatch d;
  d.WriteTo("t.plt", kFormatOzi);
  d.AddPoint(45.03, -75.02, "2007-06-01 10:03:00 AM");
  RefreshOutput(*d);
  EXPECT_NE(ReadFile(d.folder.File("t.plt")).find("\r\n 4\r\n"), std::string::npos);
}

TEST(OpenOutput, NothingWrittenYet) {
  TestProgram t;
  OpenOutput(*t);
  const auto messages = t.platform.Messages();
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_EQ(messages[0].text, "You must create a file first before you can open it.");
  EXPECT_EQ(messages[0].title, " Whoopsie!...");
  EXPECT_TRUE(t.platform.CallsOf("StartProgram").empty());
}

TEST(OpenOutput, GpxOrPltCannotBeOpened) {
  TestProgram t;
  t->OutputPath = "/x/t.gpx";
  t->OutputName = "t.gpx";
  t->OutputFormat = kFormatGpx;
  OpenOutput(*t);
  t->OutputMode = kOutputGoogleMaps;
  OpenOutput(*t);
  const auto messages = t.platform.Messages();
  ASSERT_EQ(messages.size(), 2u);
  EXPECT_EQ(messages[0].text, "File t.gpx cannot  be opened in Google Earth.");
  EXPECT_EQ(messages[1].text, "File t.gpx cannot  be opened in Google Map.");
  EXPECT_EQ(messages[1].title, " Whoopsie!...");
}

TEST(OpenOutput, StartsGoogleEarthWithTheQuotedFile) {
  TestProgram t;
  t->OutputPath = "/x/my track.kml";
  t->OutputName = "my track.kml";
  OpenOutput(*t);
  ASSERT_EQ(t.platform.CallsOf("StartProgram").size(), 1u);
  EXPECT_EQ(t.platform.CallsOf("StartProgram")[0].text,
            "/opt/google/earth/pro/google-earth-pro \"/x/my track.kml\"");
}

TEST(OpenOutput, RealTimeModeOpensTheNetworkLink) {
  TestProgram t;
  t->ProgramMode = kModeRealTimeNmea;
  t->OutputPath = "/x/last.kml";
  OpenOutput(*t);
  EXPECT_EQ(t.platform.CallsOf("StartProgram").at(0).text,
            t->GoogleEarthPath + " \"" + t->ProgramPath("gps.kml") + "\"");
}

TEST(OpenOutput, MissingGoogleEarthAsksUntilOneStartsOrCancel) {
  TestProgram t;
  t->OutputPath = "/x/t.kml";
  t.platform.startResults = {false, false, true};
  t.platform.dialogAnswers = {std::string("/wrong/ge"), std::string("/right/ge")};
  OpenOutput(*t);
  const auto starts = t.platform.CallsOf("StartProgram");
  ASSERT_EQ(starts.size(), 3u);
  EXPECT_EQ(starts[2].text, "/right/ge \"/x/t.kml\"");
  EXPECT_EQ(t->GoogleEarthPath, "/right/ge");
  const auto messages = t.platform.Messages();
  ASSERT_EQ(messages.size(), 2u);
  EXPECT_EQ(messages[0].text,
            "GoogleEarth not found. Close this window. In the file dialog box that opens, find Google Earth and open "
            "it.\r\nThe location will be saved for the next time.");
  EXPECT_EQ(messages[0].title, " Whoops!...");
  EXPECT_EQ(t.platform.CallsOf("OpenFileDialog").at(0).dialog.filter, "GE executable (google-earth*)|google-earth*|All files (*)|*");

  TestProgram c;
  c->OutputPath = "/x/t.kml";
  c.platform.startResults = {false};
  c.platform.dialogAnswers = {std::nullopt};
  OpenOutput(*c);
  EXPECT_EQ(c.platform.CallsOf("StartProgram").size(), 1u);
  EXPECT_EQ(c->GoogleEarthPath, "/opt/google/earth/pro/google-earth-pro");
}

TEST(OpenOutput, GoogleMapsModeWithoutFtpShowsTheFtpWindow) {
  TestProgram t;
  t->OutputMode = kOutputGoogleMaps;
  t->OutputPath = "/x/t.kml";
  OpenOutput(*t);
  EXPECT_TRUE(t->frmFtpSetup.window.Visible);
  EXPECT_TRUE(t.platform.CallsOf("StartProgram").empty());
}

}  // namespace
}  // namespace molvar
