// The KML head and tail, the altitude-mode line with its warning, the camera view and the error
// boxes, against a scripted platform.
#include <gtest/gtest.h>

#include <vector>

#include "core/Errors.h"
#include "output/kml/KmlFrame.h"
#include "output/kml/Segments.h"
#include "support/KmlTesting.h"

namespace molvar {
namespace {

using testing::ExpectPeersRead;
using testing::ReadFile;
using testing::TestProgram;
using testing::WriteTrack;
using testing::WrittenLines;

constexpr const char* kAltitudeWarning =
    "There is no altitude information present.\r\n"
    "Do you want me to select \"Clamped to ground\" altitude mode instead?\r\n"
    "If you select \"No\" then GoogleEarth may plot the track incorrectly.";

void AddTwoPoints(TestProgram& t) {
  t.AddPoint(45.0, -75.0, "2007-05-01 10:00:00 AM");
  t.AddPoint(45.01, -75.0, "2007-05-01 10:01:00 AM");
}

bool Has(const std::string& text, const std::string& part) { return text.find(part) != std::string::npos; }

// The peers read a document of AddTwoPoints: its detail dots when there are any, then start,
// finish and fastest (point 2) placemarks when there are any, and the one line.
void ExpectTwoPointsRead(const std::string& path, bool details, bool markers) {
  std::vector<testing::Coord> points;
  if (details) points = {{-75, 45, 0}, {-75, 45.01, 0}};
  if (markers) points.insert(points.end(), {{-75, 45, 0}, {-75, 45.01, 0}, {-75, 45.01, 0}});
  ExpectPeersRead(path, points, {{{-75, 45, 0}, {-75, 45.01, 0}}});
}

std::size_t CountOf(const std::string& text, const std::string& part) {
  std::size_t n = 0;
  for (std::size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1)) ++n;
  return n;
}

TEST(KmlFrame, EmptyTitleWarnsOnceAndNamesTheDocumentEnterTitleHere) {
  TestProgram t;
  Molvar& m = *t;
  AddTwoPoints(t);
  m.frmMain.chkUseFilename.Value = 0;
  m.frmMain.txtTitle.Text = "";
  m.frmMain.chkAuto.Value = 0;
  WriteTrack(t, "untitled.kml");
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_EQ(boxes[0].text,
            "You should enter a title in the track title box or \r\n"
            "check the \"Use filename as title\" checkbox.");
  EXPECT_EQ(boxes[0].title, " No track title entered");
  EXPECT_EQ(boxes[0].buttons, MsgButtons::OK);
  EXPECT_EQ(boxes[0].icon, MsgIcon::Exclamation);
  EXPECT_EQ(m.frmMain.txtTitle.Text, "Enter title here!");
  const std::string doc = ReadFile(t.folder.File("untitled.kml"));
  EXPECT_TRUE(Has(doc, "<Folder>\r\n<name>Enter title here!</name>\r\n\r\n"));
  ExpectTwoPointsRead(t.folder.File("untitled.kml"), true, true);

  // The box put a title in place: the next write does not ask again.
  WriteTrack(t, "untitled2.kml");
  EXPECT_EQ(t.platform.Messages().size(), 1u);
  ExpectTwoPointsRead(t.folder.File("untitled2.kml"), true, true);
}

TEST(KmlFrame, AutoNameTakesTheFileNameUpToItsLastDotAndNeverWarns) {
  TestProgram t;
  Molvar& m = *t;
  m.frmMain.txtTitle.Text = "";
  m.OutputName = "my.trip.kml";
  EXPECT_EQ(TitleFromFileName(m), "my.trip");
  EXPECT_EQ(GetTrackTitle(m), "my.trip");
  m.OutputName = "noextension";
  EXPECT_EQ(TitleFromFileName(m), "filename");
  m.OutputName = ".kml";
  EXPECT_EQ(TitleFromFileName(m), "");
  AddTwoPoints(t);
  WriteTrack(t, "x.kml");
  EXPECT_TRUE(t.platform.Messages().empty());
  ExpectTwoPointsRead(t.folder.File("x.kml"), true, true);
}

TEST(KmlFrame, TitlesOfTheLiveAndStationModes) {
  TestProgram t;
  Molvar& m = *t;
  m.frmMain.chkUseFilename.Value = 0;
  m.frmMain.txtTitle.Text = "Typed";
  m.ProgramMode = kModeRealTimeNmea;
  EXPECT_EQ(GetTrackTitle(m), "NMEA data");
  m.ProgramMode = kModeAgw;
  m.Aprs.StationCount = 12;
  EXPECT_EQ(GetTrackTitle(m), "AGW data (12)");
  m.ProgramMode = kModeAprsWeb;
  m.Aprs.StationCallSign = "VE3XYZ-9";
  EXPECT_EQ(GetTrackTitle(m), "VE3XYZ-9");
  m.ProgramMode = kModeGarmin;
  EXPECT_EQ(GetTrackTitle(m), "Typed");
}

TEST(KmlFrame, AltitudeWarningYesSwitchesToClampedForTheRestOfTheRun) {
  TestProgram t;
  Molvar& m = *t;
  AddTwoPoints(t);
  m.AltitudeMode = 1;
  m.frmMain.comboAltitude.ListIndex = 1;
  m.frmMain.chkDetailed.Value = 0;
  m.frmMain.chkAuto.Value = 0;
  t.platform.msgAnswers = {kAnswerYes};
  WriteTrack(t, "flat.kml");
  auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_EQ(boxes[0].text, kAltitudeWarning);
  EXPECT_EQ(boxes[0].title, " Altitude warning...");
  EXPECT_EQ(boxes[0].buttons, MsgButtons::YesNo);
  EXPECT_EQ(boxes[0].icon, MsgIcon::Exclamation);
  EXPECT_EQ(m.AltitudeMode, 0);
  EXPECT_EQ(m.frmMain.comboAltitude.ListIndex, 0);
  const std::string doc = ReadFile(t.folder.File("flat.kml"));
  EXPECT_FALSE(Has(doc, "absolute"));
  EXPECT_EQ(CountOf(doc, "    <tessellate>1</tessellate><altitudeMode>clampedToGround</altitudeMode>\r\n"), 4u);
  ExpectTwoPointsRead(t.folder.File("flat.kml"), false, true);

  // Never again in this run, even with a mode that would ask.
  m.AltitudeMode = 2;
  m.frmMain.comboAltitude.ListIndex = 2;
  WriteTrack(t, "flat2.kml");
  EXPECT_EQ(t.platform.Messages().size(), 1u);
  EXPECT_TRUE(Has(ReadFile(t.folder.File("flat2.kml")), "    <altitudeMode>absolute</altitudeMode> <extrude>1</extrude>\r\n"));
  ExpectTwoPointsRead(t.folder.File("flat2.kml"), false, true);
}

TEST(KmlFrame, AltitudeWarningNoKeepsTheModeAndNeverAsksAgain) {
  TestProgram t;
  Molvar& m = *t;
  AddTwoPoints(t);
  m.AltitudeMode = 2;
  m.frmMain.comboAltitude.ListIndex = 2;
  m.frmMain.chkAuto.Value = 0;
  t.platform.msgAnswers = {kAnswerNo};
  WriteTrack(t, "kept.kml");
  WriteTrack(t, "kept2.kml");
  EXPECT_EQ(t.platform.Messages().size(), 1u);
  EXPECT_EQ(m.AltitudeMode, 2);
  EXPECT_EQ(m.frmMain.comboAltitude.ListIndex, 2);
  const std::string doc = ReadFile(t.folder.File("kept.kml"));
  EXPECT_FALSE(Has(doc, "clampedToGround"));
  EXPECT_TRUE(Has(doc, "    <altitudeMode>absolute</altitudeMode> <extrude>1</extrude>\r\n"));
  ExpectTwoPointsRead(t.folder.File("kept.kml"), true, true);
  ExpectTwoPointsRead(t.folder.File("kept2.kml"), true, true);
}

TEST(KmlFrame, AltitudeWarningOnlyForRecordedTracksWithoutHeightInAbsoluteModes) {
  struct Case {
    int16_t programMode;
    int16_t altitudeMode;
    int32_t altitude;
    bool warns;
  };
  const Case cases[] = {
      {kModeConvertTracks, 1, 0, true},     {kModeGarmin, 2, 0, true},         {kModeConvertTracks, 1, 5, false},
      {kModeConvertTracks, 0, 0, false},    {kModeConvertTracks, 3, 0, false}, {kModeConvertWaypoints, 1, 0, false},
      {kModeRealTimeNmea, 1, 0, false},     {kModeAprsWeb, 2, 0, false},       {kModeAgw, 1, 0, false},
  };
  for (const Case& c : cases) {
    TestProgram t;
    Molvar& m = *t;
    m.ProgramMode = c.programMode;
    m.AltitudeMode = c.altitudeMode;
    t.platform.msgAnswers = {kAnswerNo};
    WrittenLines(t, [&](Molvar& mv) { InsertAltitudeMode(mv, c.altitude); });
    EXPECT_EQ(t.platform.Messages().size(), c.warns ? 1u : 0u)
        << "mode " << c.programMode << " altitude mode " << c.altitudeMode << " altitude " << c.altitude;
  }
}

TEST(KmlFrame, AltitudeModeLinesAndTheAboveGroundLabel) {
  const char* const lines[] = {
      "    <tessellate>1</tessellate><altitudeMode>clampedToGround</altitudeMode>",
      "    <altitudeMode>absolute</altitudeMode>",
      "    <altitudeMode>absolute</altitudeMode> <extrude>1</extrude>",
      "    <altitudeMode>relativeToGround</altitudeMode> <extrude>1</extrude>",
  };
  for (int mode = 0; mode < 4; ++mode) {
    TestProgram t;
    t->AltitudeMode = static_cast<int16_t>(mode);
    t->ProgramMode = kModeConvertWaypoints;
    t->frmMain.AltLabel.Visible = true;
    EXPECT_EQ(WrittenLines(t, [](Molvar& m) { InsertAltitudeMode(m, 10); }), std::vector<std::string>{lines[mode]});
    EXPECT_EQ(t->frmMain.AltLabel.Visible, mode > 0) << mode;
  }
  TestProgram t;
  t->AltitudeMode = 4;
  t->frmMain.AltLabel.Visible = true;
  EXPECT_TRUE(WrittenLines(t, [](Molvar& m) { InsertAltitudeMode(m, 10); }).empty());
  EXPECT_FALSE(t->frmMain.AltLabel.Visible);
  // Outside waypoint mode the label stays hidden.
  t->AltitudeMode = 2;
  WrittenLines(t, [](Molvar& m) { InsertAltitudeMode(m, 10); });
  EXPECT_FALSE(t->frmMain.AltLabel.Visible);
}

TEST(KmlFrame, InsertAltitudeModeReportsItsOwnErrors) {
  TestProgram t;
  t->AltitudeMode = 1;
  // The warning's question finds no answer: the handler reports and writes nothing.
  EXPECT_TRUE(WrittenLines(t, [](Molvar& m) { InsertAltitudeMode(m, 0); }).empty());
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 2u);
  EXPECT_EQ(boxes[1].text.rfind("InsertAltitudeMode bug ", 0), 0u) << boxes[1].text;
  EXPECT_EQ(boxes[1].title, "Error");
  EXPECT_EQ(boxes[1].icon, MsgIcon::Exclamation);
}

TEST(KmlFrame, LookAtRangeIsTheEyeAltitudeInMetresAndTiltAsTyped) {
  TestProgram t;
  t->frmMain.txtEyeAlt.Text = "1000";
  t->frmMain.txtTilt.Text = "12.5";
  const auto lines = WrittenLines(t, [](Molvar& m) { WriteLookAt(m, -0.000125, 51.4778, -20); });
  EXPECT_EQ(lines, (std::vector<std::string>{"<LookAt>", "  <longitude>-0.000125</longitude>",
                                             "  <latitude>51.4778</latitude>", "  <range>305</range>",
                                             "  <tilt>12.5</tilt>", "  <heading>-20</heading>", "</LookAt>", ""}));
}

TEST(KmlFrame, HeaderThatCannotOpenItsFileReportsAndReturnsTheErrorNumber) {
  TestProgram t;
  Molvar& m = *t;
  AddTwoPoints(t);
  m.OutputPath = t.folder.File("missing/folder/x.kml");
  m.OutputName = "x.kml";
  const int16_t result = WriteKmlHeader(m);
  EXPECT_NE(result, 0);
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_EQ(boxes[0].text.rfind("WriteKmlHeader bug " + RuntimeError::StandardDescription(result), 0), 0u)
      << boxes[0].text;
  EXPECT_EQ(boxes[0].title, "Error");
  EXPECT_EQ(boxes[0].buttons, MsgButtons::OK);
  EXPECT_EQ(boxes[0].icon, MsgIcon::Exclamation);
}

TEST(KmlFrame, FooterWithoutAnOpenFileReportsTheBug) {
  TestProgram t;
  AddTwoPoints(t);
  t->OutputName = "x.kml";
  WriteKmlFooter(*t);
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_EQ(boxes[0].text, "WriteKmlFooter bug " + RuntimeError::StandardDescription(kErrBadFileName));
  EXPECT_EQ(boxes[0].title, "Error");
  EXPECT_EQ(boxes[0].icon, MsgIcon::Exclamation);
  // The tail stopped at the close: no summary.
  EXPECT_EQ(t->frmMain.txtInfo.Text, "");
}

TEST(KmlFrame, DateTimesWithoutABlankGiveBareStartAndFinishNames) {
  TestProgram t;
  Molvar& m = *t;
  t.AddPoint(45.0, -75.0, "");
  t.AddPoint(45.01, -75.0, "");
  m.frmMain.chkDetailed.Value = 0;
  m.frmMain.chkAuto.Value = 0;
  WriteTrack(t, "bare.kml");
  const std::string doc = ReadFile(t.folder.File("bare.kml"));
  EXPECT_TRUE(Has(doc, "  <name>Start </name>\r\n"));
  EXPECT_TRUE(Has(doc, "  <name>Finish </name>\r\n"));
  // Without times there is no speed: the fastest point is the first.
  ExpectPeersRead(t.folder.File("bare.kml"), {{-75, 45, 0}, {-75, 45.01, 0}, {-75, 45, 0}},
                  {{{-75, 45, 0}, {-75, 45.01, 0}}});
}

TEST(KmlFrame, RealTimeTailLooksFromTheLastPointAlongTheCourseUnlessNorthUp) {
  for (const int northUp : {0, 1}) {
    TestProgram t;
    Molvar& m = *t;
    AddTwoPoints(t);
    m.ProgramMode = kModeRealTimeNmea;
    m.Nmea.Fields.CourseText = "123.6";
    SelectOnly(m.frmMain.optNorthUp, northUp);
    m.frmMain.txtInfo.Text = " kept";
    m.frmMain.chkDetailed.Value = 0;
    m.frmMain.chkStartFinish.Value = 0;
    m.frmMain.chkFastest.Value = 0;
    WriteTrack(t, "nmea.kml");
    const std::string doc = ReadFile(t.folder.File("nmea.kml"));
    EXPECT_TRUE(Has(doc, "<name>NMEA data</name>"));
    EXPECT_TRUE(Has(doc, "<LookAt>\r\n  <longitude>-75</longitude>\r\n  <latitude>45.01</latitude>\r\n"));
    EXPECT_TRUE(Has(doc, northUp == 1 ? "  <heading>0</heading>" : "  <heading>124</heading>"));
    EXPECT_EQ(m.frmMain.txtInfo.Text, " kept");
    EXPECT_TRUE(m.frmMain.cmdOpen.Enabled);
    EXPECT_TRUE(t.platform.CallsOf("StartProgram").empty());
    EXPECT_TRUE(m.frmMain.cmdRefresh.Enabled);
    ExpectTwoPointsRead(t.folder.File("nmea.kml"), false, false);
  }
}

TEST(KmlFrame, AgwDocumentOpensItsFolderAndHasNoView) {
  TestProgram t;
  Molvar& m = *t;
  AddTwoPoints(t);
  m.ProgramMode = kModeAgw;
  m.Aprs.StationCount = 2;
  m.frmMain.txtInfo.Text = " kept";
  m.frmMain.chkDetailed.Value = 0;
  m.frmMain.chkStartFinish.Value = 0;
  m.frmMain.chkFastest.Value = 0;
  m.frmMain.chkAuto.Value = 0;
  WriteTrack(t, "agw.kml");
  const std::string path = t.folder.File("agw.kml");
  const std::string doc = ReadFile(path);
  EXPECT_EQ(doc.rfind("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\r\n"
                      "<kml xmlns=\"http://earth.google.com/kml/2.0\">\r\n"
                      "<!--  File type 5-0-0-0 created with Molvar version 17.0  -->\r\n"
                      "<Folder>\r\n<name>AGW data (2)</name>\r\n  <open>1</open>\r\n\r\n",
                      0),
            0u)
      << doc;
  EXPECT_FALSE(Has(doc, "<LookAt>"));
  EXPECT_EQ(m.frmMain.txtInfo.Text, " kept");
  ExpectTwoPointsRead(path, false, false);
}

TEST(KmlFrame, AprsLookupMarksTheStationAtTheLastPointAndLooksFromThere) {
  TestProgram t;
  Molvar& m = *t;
  AddTwoPoints(t);
  m.Track.at(2).Altitude = 300;
  m.ProgramMode = kModeAprsWeb;
  m.AltitudeMode = 1;
  m.Aprs.StationCallSign = "VE3XYZ-9";
  m.frmMain.chkStartFinish.Value = 0;
  m.frmMain.chkDetailed.Value = 0;
  m.frmMain.chkFastest.Value = 0;
  m.frmMain.chkAuto.Value = 0;
  WriteTrack(t, "aprs.kml");
  const std::string path = t.folder.File("aprs.kml");
  const std::string doc = ReadFile(path);
  EXPECT_TRUE(Has(doc, "<name>VE3XYZ-9</name>\r\n\r\n<!--  Write \"VE3XYZ-9\" Placemark  -->\r\n<Placemark>\r\n"
                       "  <name>VE3XYZ-9</name>\r\n"));
  EXPECT_TRUE(Has(doc, "    <coordinates>-75,45.01,300</coordinates>\r\n"));
  EXPECT_TRUE(Has(doc, "<LookAt>\r\n  <longitude>-75</longitude>\r\n  <latitude>45.01</latitude>\r\n"));
  EXPECT_EQ(m.frmMain.txtInfo.Text, " Processed 2 trackpoints. (1 segments) Output: aprs.kml");
  ExpectPeersRead(path, {{-75, 45.01, 300}}, {{{-75, 45, 0}, {-75, 45.01, 300}}});
}

}  // namespace
}  // namespace molvar
