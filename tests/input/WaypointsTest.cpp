// Waypoint files through "Read waypoint file": Ozi and GPX input into KML, GPX and Ozi output.
#include <gtest/gtest.h>

#include <filesystem>

#include "core/Text.h"
#include "input/Waypoints.h"
#include "support/Peers.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::ExpectInOrder;
using testing::ExpectWellFormedXml;
using testing::ReadFile;
using testing::RunCommand;
using testing::TestProgram;
using testing::WriteFile;

const char* kWptHeader = "OziExplorer Waypoint File Version 1.1\r\nWGS 84\r\nReserved 2\r\ngarmin\r\n";

struct WaypointReader : TestProgram {
  WaypointReader() {
    m->ProgramMode = kModeConvertWaypoints;
    m->frmMain.chkAuto.Value = 0;
  }
  void Read(int16_t wptType, std::string_view content, const std::string& inName, const std::string& outName) {
    m->WptFileType = wptType;
    WriteFile(folder.File(inName), content);
    platform.dialogAnswers.push_back(folder.File(inName));
    platform.dialogAnswers.push_back(folder.File(outName));
    ReadWaypointFile(*m, false);
  }
  const Waypoint& W(int32_t i) { return m->Waypoints.at(i); }
};

TEST(ReadOziWaypointLine, FieldsCaseAndAltitude) {
  WaypointReader r;
  r->OutputFormat = kFormatGpx;  // any output; only the store is looked at here
  r->Out.Open(r.folder.File("w.gpx"));
  r->SpeedUnits = 0;
  r->frmMain.txtEyeAlt.Text = "3000";
  r->AltitudeFactor = 1.0;  // eye altitude given in metres
  ReadOziWaypointLine(*r, "1, Camp ,45.5,-75.25,39155.5,0,1,3,0,65535, FISH & CHIPS ,0,0,0,-777,6,0,17");
  ReadOziWaypointLine(*r, "");
  ReadOziWaypointLine(*r, "2,Peak,46,-76,,0,1,3,0,65535,top,0,0,0,3280.83");
  r->Out.Abandon();
  ASSERT_EQ(r->Waypoints.WptCount, 2);
  EXPECT_EQ(r.W(1).WptName, "Camp");
  EXPECT_DOUBLE_EQ(r.W(1).WptLatitude, 45.5);
  EXPECT_DOUBLE_EQ(r.W(1).WptLongitude, -75.25);
  EXPECT_EQ(r.W(1).WptAltitude, 3000) << "no altitude: the eye altitude";
  EXPECT_EQ(r.W(1).WptComment, "Fish  And  Chips");
  EXPECT_EQ(r.W(1).WptDescription, "");
  EXPECT_EQ(r.W(2).WptAltitude, 1000);
  EXPECT_EQ(r.W(2).WptComment, "Top");
}

TEST(ReadOziWaypointLine, EyeAltitudeInFeetBecomesMetres) {
  WaypointReader r;
  r->OutputFormat = kFormatGpx;
  r->Out.Open(r.folder.File("w.gpx"));
  r->frmMain.txtEyeAlt.Text = "3280.83";
  ReadOziWaypointLine(*r, "1,A,1,2,,,,,,,,,,,0");
  r->Out.Abandon();
  EXPECT_EQ(r.W(1).WptAltitude, 1000);
}

TEST(ReadWaypointFile, OziHeaderOnlyGivesHeadAndTailAndNoPlacemark) {
  WaypointReader r;
  r.Read(0, kWptHeader, "in.wpt", "out.kml");
  EXPECT_EQ(r->Waypoints.WptCount, 0);
  const std::string kml = ReadFile(r.folder.File("out.kml"));
  EXPECT_TRUE(StartsWith(kml, "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\r\n"));
  EXPECT_EQ(kml.find("<Placemark>"), std::string::npos);
  EXPECT_NE(kml.find("</Folder>\r\n</kml>\r\n"), std::string::npos);
  EXPECT_EQ(r->frmMain.txtInfo.Text, " Created 0 placemarks. Output: out.kml");
}

TEST(ReadWaypointFile, OziToKmlLabelsBySource) {
  for (int16_t source = 0; source <= 2; ++source) {
    WaypointReader r;
    r->PlacemarkLabelSource = source;
    r.Read(0,
           std::string(kWptHeader) + "1,Camp,45.5,-75.25,,0,1,3,0,65535,lake shore,0,0,0,328\r\n"
                                     "2,Peak,46.5,-76.25,,0,1,3,0,65535,summit,0,0,0,656\r\n",
           "in.wpt", "out.kml");
    ASSERT_EQ(r->Waypoints.WptCount, 2);
    const std::string kml = ReadFile(r.folder.File("out.kml"));
    ExpectWellFormedXml(r.folder.File("out.kml"));
    const char* first[] = {"<name>Camp</name>", "<name>Lake Shore</name>", "<name></name>"};
    EXPECT_NE(kml.find(first[source]), std::string::npos) << source;
    EXPECT_EQ(r->frmMain.txtInfo.Text, " Created 2 placemarks. Output: out.kml");
    if (source == 0) {
      const std::string babel = RunCommand("gpsbabel -i kml -f '" + r.folder.File("out.kml") + "' -o unicsv -F - 2>&1");
      ExpectInOrder(babel, {"45.500000,-75.250000", "Camp", "46.500000,-76.250000", "Peak"});
    }
  }
}

TEST(ReadWaypointFile, OziToGpxIsReadBackByGpsbabel) {
  WaypointReader r;
  r.Read(0, std::string(kWptHeader) + "1,Camp,45.5,-75.25,,0,1,3,0,65535,fish & chips,0,0,0,328\r\n", "in.wpt",
         "out.gpx");
  const std::string gpx = ReadFile(r.folder.File("out.gpx"));
  ExpectWellFormedXml(r.folder.File("out.gpx"));
  ExpectInOrder(gpx, {"<wpt lat=\"45.5\" lon=\"-75.25\">\r\n  <name><![CDATA[Camp]]></name>\r\n"
                      "  <cmt><![CDATA[Fish  And  Chips]]></cmt>\r\n",
                      "</gpx>\r\n"});
  EXPECT_NE(r->frmMain.txtInfo.Text.find(" Output: out.gpx"), std::string::npos);
  const std::string babel = RunCommand("gpsbabel -i gpx -f '" + r.folder.File("out.gpx") + "' -o unicsv -F - 2>&1");
  ExpectInOrder(babel, {"45.500000,-75.250000,\"Camp\""});
}

TEST(ReadWaypointFile, GpxToOziWritesWaypointLines) {
  WaypointReader r;
  r.Read(1,
         "<?xml version=\"1.0\"?>\r\n<gpx version=\"1.1\">\r\n<wpt lat=\"45.5\" lon=\"-75.25\">\r\n"
         "<name>Camp, north</name>\r\n<desc>lake shore</desc>\r\n</wpt>\r\n"
         "<wpt lat='46.5' lon='-76.25'>\r\n<name>Peak</name>\r\n</wpt>\r\n</gpx>\r\n",
         "in.gpx", "out.wpt");
  ASSERT_EQ(r->Waypoints.WptCount, 2);
  const std::string wpt = ReadFile(r.folder.File("out.wpt"));
  EXPECT_TRUE(StartsWith(wpt, kWptHeader));
  EXPECT_NE(wpt.find("\r\n1,Camp\xD1 north,45.5,-75.25,"), std::string::npos) << wpt;
  EXPECT_NE(wpt.find("\r\n2,Peak,46.5,-76.25,"), std::string::npos) << wpt;
  EXPECT_EQ(r->frmMain.txtInfo.Text, " Created 2 waypoints. Output: out.wpt");
  const std::string babel = RunCommand("gpsbabel -i ozi -f '" + r.folder.File("out.wpt") + "' -o unicsv -F - 2>&1");
  ExpectInOrder(babel, {"45.500000,-75.250000", "46.500000,-76.250000,\"Peak\""});
}

TEST(ReadWaypointFile, GpxWaypointsFromGpsbabelBecomePlacemarks) {
  WaypointReader r;
  WriteFile(r.folder.File("pts.csv"), "lat,lon,name\n45.5,-75.25,Camp\n-33.8568,151.2153,Opera\n");
  int rc = -1;
  RunCommand("gpsbabel -i unicsv -f '" + r.folder.File("pts.csv") + "' -o gpx -F '" + r.folder.File("in.gpx") + "'",
             &rc);
  ASSERT_EQ(rc, 0);
  r->WptFileType = 1;
  r.platform.dialogAnswers.push_back(r.folder.File("in.gpx"));
  r.platform.dialogAnswers.push_back(r.folder.File("out.kml"));
  ReadWaypointFile(*r, false);
  ASSERT_EQ(r->Waypoints.WptCount, 2);
  EXPECT_EQ(r.W(2).WptName, "Opera");
  EXPECT_DOUBLE_EQ(r.W(2).WptLatitude, -33.8568);
  const std::string babel = RunCommand("gpsbabel -i kml -f '" + r.folder.File("out.kml") + "' -o unicsv -F - 2>&1");
  ExpectInOrder(babel, {"45.500000,-75.250000", "Camp", "-33.856800,151.215300", "Opera"});
}

TEST(WptFrameDrop, ExtensionMustAgreeWithTheWaypointType) {
  WaypointReader r;
  r->WptFileType = 0;
  WriteFile(r.folder.File("a.gpx"), "");
  WptFrame_Drop(*r, r.folder.File("a.gpx"));
  auto messages = r.platform.Messages();
  ASSERT_EQ(messages.size(), 1u);
  EXPECT_EQ(messages[0].text, "Incorrect file type!\r\nChange the file type button\r\nto agree with the input file type.");
  EXPECT_EQ(messages[0].title, "Whoops!");
  EXPECT_EQ(messages[0].icon, MsgIcon::Exclamation);
  EXPECT_EQ(r->LastSourceFile, r.folder.File("a.gpx"));

  WriteFile(r.folder.File("b.WPT"), std::string(kWptHeader) + "1,Camp,45.5,-75.25\r\n");
  WptFrame_Drop(*r, r.folder.File("b.WPT"));
  EXPECT_EQ(r.platform.Messages().size(), 1u);
  EXPECT_EQ(r->Waypoints.WptCount, 1);
  EXPECT_TRUE(std::filesystem::exists(r.folder.File("b.kml")));
}

TEST(ReadWaypointFile, CancelOrRefusalOpensNoFile) {
  WaypointReader r;
  r->WptFileType = 0;
  WriteFile(r.folder.File("in.wpt"), kWptHeader);
  r.platform.dialogAnswers.push_back(r.folder.File("in.wpt"));
  r.platform.dialogAnswers.push_back(r.folder.File("out.wpt"));
  ReadWaypointFile(*r, false);
  EXPECT_FALSE(std::filesystem::exists(r.folder.File("out.wpt")));
  EXPECT_EQ(r.platform.Messages().at(0).text,
            "You cannot write an output OZI waypoint file when the input file is OZI.");
}

}  // namespace
}  // namespace molvar
