// Whole KML documents against hand-written files, read back by real peers.
#include <gtest/gtest.h>

#include <array>

#include "core/Numbers.h"
#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "output/kml/KmlFrame.h"
#include "output/kml/Segments.h"
#include "support/Peers.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::ExpectInOrder;
using testing::ExpectWellFormedXml;
using testing::ReadFile;
using testing::RunCommand;
using testing::TestProgram;

std::string Golden(const std::string& name, const std::string& folder) {
  return Replace(ReadFile(std::string(MOLVAR_GOLDEN_DIR) + "/kml/" + name), "{FOLDER}", folder);
}

// What the dispatcher does for a KML track.
void WriteTrack(TestProgram& t, const std::string& name) {
  Molvar& m = *t;
  m.OutputPath = t.folder.File(name);
  m.OutputName = name;
  MarkDays(m);
  MarkSegments(m);
  m.Speed.FastestIndex = FindFastestPoint(m);
  m.Kml.SegmentCount = 1;
  ASSERT_EQ(WriteKmlHeader(m), 0);
  WriteKmlSegments(m);
  WriteKmlFooter(m);
}

// xmllint, GDAL and gpsbabel all read the file, and the coordinates come back in order.
void ExpectPeersRead(const std::string& path, const std::vector<std::string>& lonLatInOrder) {
  ExpectWellFormedXml(path);

  int rc = -1;
  const std::string ogr = RunCommand("ogrinfo -ro -al '" + path + "' 2>&1", &rc);
  EXPECT_EQ(rc, 0) << ogr;
  ExpectInOrder(ogr, lonLatInOrder);

  const std::string babel = RunCommand("gpsbabel -i kml -f '" + path + "' -o unicsv -F - 2>&1", &rc);
  EXPECT_EQ(rc, 0) << babel;
  EXPECT_NE(babel.find("Latitude"), std::string::npos) << babel;
}

void AddThreePoints(TestProgram& t, std::array<double, 3> speeds = {0, 0, 0}) {
  t.AddPoint(45.0, -75.0, "2007-05-01 10:00:00 AM", speeds[0]);
  t.AddPoint(45.01, -75.0, "2007-05-01 10:01:00 AM", speeds[1]);
  t.AddPoint(45.02, -75.0, "2007-05-01 10:02:00 AM", speeds[2]);
}

TEST(KmlWriter, DefaultOptionsWriteTheHandWrittenDocumentAndOpenIt) {
  TestProgram t;
  Molvar& m = *t;
  m.frmMain.chkDetailed.Value = 0;
  AddThreePoints(t);
  WriteTrack(t, "trip.kml");
  const std::string path = t.folder.File("trip.kml");
  EXPECT_EQ(ReadFile(path), Golden("track_default.kml", t.folder.path().string()));
  EXPECT_EQ(m.frmMain.txtInfo.Text, " Processed 3 trackpoints. (1 segments) Output: trip.kml");
  const auto starts = t.platform.CallsOf("StartProgram");
  ASSERT_EQ(starts.size(), 1u);
  EXPECT_EQ(starts[0].text, "/opt/google/earth/pro/google-earth-pro \"" + path + "\"");
  EXPECT_TRUE(t.platform.Messages().empty());
  EXPECT_TRUE(m.frmMain.cmdRefresh.Enabled);
  ExpectPeersRead(path, {"-75 45 0", "-75 45.02 0", "-75 45.01 0", "-75 45 0", "-75 45.01 0", "-75 45.02 0"});
}

TEST(KmlWriter, SpeedColoursAltitudeAsSpeedAndDetailsWithThreshold) {
  TestProgram t;
  Molvar& m = *t;
  auto& f = m.frmMain;
  AddThreePoints(t, {0, 55, 65});
  m.Track.at(2).Flag = 1;
  m.Track.at(3).Altitude = 100;
  m.Track.at(2).ColorBand = 5;
  m.Track.at(3).ColorBand = 6;
  m.ColorVaryMode = 3;
  m.AltitudeMode = 3;
  f.comboAltitude.ListIndex = 3;
  m.SpeedGain = 20;
  f.chkUseThreshold.Value = 1;
  f.txtSpeedThreshold.Text = "50";
  f.chkStartFinish.Value = 0;
  f.chkFastest.Value = 0;
  f.chkAuto.Value = 0;
  f.chkUseFilename.Value = 0;
  f.txtTitle.Text = "Ride & Run <1>";
  WriteTrack(t, "ride.kml");
  const std::string path = t.folder.File("ride.kml");
  EXPECT_EQ(ReadFile(path), Golden("track_speed_details.kml", t.folder.path().string()));
  EXPECT_EQ(f.txtInfo.Text, " Processed 3 trackpoints. (2 segments) Output: ride.kml");
  EXPECT_TRUE(t.platform.CallsOf("StartProgram").empty());
  EXPECT_TRUE(f.cmdOpen.Enabled);
  EXPECT_TRUE(f.cmdOpen.HasFocus);
  ExpectPeersRead(path, {"-75 45 0", "-75 45.01 1100", "-75 45.02 1300"});
}

}  // namespace
}  // namespace molvar
