// Point placemarks and the icon chooser's choice.
#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "core/Errors.h"
#include "output/kml/Placemarks.h"
#include "support/KmlTesting.h"

namespace molvar {
namespace {

using testing::TestProgram;
using testing::WriteFile;
using testing::WrittenLines;

std::vector<std::string> Placemark(TestProgram& t, const std::string& colour, int16_t kind, int32_t altitude = 0) {
  return WrittenLines(t, [&](Molvar& m) {
    int32_t alt = altitude;
    WriteKmlPlacemark(m, "Here", -75.5, 45.25, alt, colour, kind);
  });
}

bool HasLine(const std::vector<std::string>& lines, const std::string& line) {
  for (const auto& l : lines) {
    if (l == line) return true;
  }
  return false;
}

// The lines from `first` up to the one before `next`.
std::vector<std::string> Between(const std::vector<std::string>& lines, const std::string& first,
                                 const std::string& next) {
  std::vector<std::string> part;
  bool in = false;
  for (const auto& l : lines) {
    if (l == first) in = true;
    else if (l == next && in) break;
    if (in) part.push_back(l);
  }
  return part;
}

void MakeIcons(TestProgram& t) {
  std::filesystem::create_directories(t.folder.path() / "Icons");
  for (const char* name : {"palette-2.jpg", "palette-3.jpg", "palette-4.jpg", "palette-5.jpg", "Custom.jpg"}) {
    WriteFile(t.folder.File(std::string("Icons/") + name), "jpg");
  }
}

TEST(Placemarks, GoogleEarthPlacemarkLinesInOrder) {
  TestProgram t;
  t->AltitudeMode = 1;
  const auto lines = Placemark(t, "00FF00", kPlacemarkGeneral, 250);
  EXPECT_EQ(lines, (std::vector<std::string>{"<!--  Write \"Here\" Placemark  -->",
                                             "<Placemark>",
                                             "  <name>Here</name>",
                                             "  <styleUrl>root://styleMaps#default?iconId=0x307</styleUrl>",
                                             "  <Style>",
                                             "    <LabelStyle>",
                                             "      <color>FF00FF00</color>",
                                             "    </LabelStyle>",
                                             "    <IconStyle>",
                                             "      <Icon>",
                                             "        <href>root://icons/palette-4.png</href>",
                                             "        <x>192</x>",
                                             "        <y>32</y>",
                                             "        <w>32</w>",
                                             "        <h>32</h>",
                                             "      </Icon>",
                                             "    </IconStyle>",
                                             "  </Style>",
                                             "  <Point>",
                                             "    <altitudeMode>absolute</altitudeMode>",
                                             "    <coordinates>-75.5,45.25,250</coordinates>",
                                             "  </Point>",
                                             "</Placemark>",
                                             ""}));
}

TEST(Placemarks, ClampedModeZeroesTheCallersAltitude) {
  TestProgram t;
  int32_t alt = 1234;
  const auto lines = WrittenLines(t, [&](Molvar& m) { WriteKmlPlacemark(m, "x", 1, 2, alt, "FFFFFF", 0); });
  EXPECT_EQ(alt, 0);
  EXPECT_TRUE(HasLine(lines, "    <coordinates>1,2,0</coordinates>"));
}

TEST(Placemarks, FixedKindsUseTheirCellsAndTheCustomIconReplacesEveryKind) {
  TestProgram t;
  const auto start = Placemark(t, "00FF00", kPlacemarkStart);
  EXPECT_EQ(Between(start, "      <Icon>", "      </Icon>"),
            (std::vector<std::string>{"      <Icon>", "        <href>root://icons/palette-4.png</href>", "        <x>128</x>",
                                      "        <y>0</y>", "        <w>32</w>", "        <h>32</h>"}));
  const auto finish = Placemark(t, "0000FF", kPlacemarkFinish);
  EXPECT_TRUE(HasLine(finish, "        <y>32</y>"));
  EXPECT_TRUE(HasLine(finish, "        <x>128</x>"));
  const auto fastest = Placemark(t, "FFFFFF", kPlacemarkFastest);
  EXPECT_TRUE(HasLine(fastest, "        <href>root://icons/palette-3.png</href>"));
  EXPECT_TRUE(HasLine(fastest, "        <x>64</x>"));
  EXPECT_TRUE(HasLine(fastest, "        <y>96</y>"));

  t->frmIconSelect.chkCustomIcon.Value = 1;
  for (int16_t kind = 0; kind <= 3; ++kind) {
    const auto lines = Placemark(t, "FFFFFF", kind);
    EXPECT_EQ(Between(lines, "      <Icon>", "      </Icon>"),
              (std::vector<std::string>{"      <Icon>", "        <href>" + t.folder.path().string() + "/Icons/Custom.png</href>"}))
        << kind;
  }
}

TEST(Placemarks, IconColourOnlyBelowFullOpacityAfterTheHalfSizeScale) {
  TestProgram t;
  t->frmMain.chkHalfSize.Value = 1;
  const auto opaque = Placemark(t, "FFFFFF", 0);
  EXPECT_EQ(Between(opaque, "    <IconStyle>", "      <Icon>"),
            (std::vector<std::string>{"    <IconStyle>", "      <scale>0.5</scale>"}));
  t->TransparencyLevel = 7;
  const auto faded = Placemark(t, "0000FF", 0);
  EXPECT_TRUE(HasLine(faded, "      <color>070000FF</color>"));
  EXPECT_EQ(Between(faded, "    <IconStyle>", "      <Icon>"),
            (std::vector<std::string>{"    <IconStyle>", "      <scale>0.5</scale>", "      <color>07FFFFFF</color>"}));
}

TEST(Placemarks, LivePositionIconTurnsWithTheCourseAndArrowCellsTurnAround) {
  TestProgram t;
  t->ProgramMode = kModeRealTimeNmea;
  t->Nmea.Fields.CourseText = "350";
  t->IconPalette = 2;
  t->IconX = 128;
  t->IconY = 160;
  EXPECT_EQ(Between(Placemark(t, "FFFFFF", 0), "    <IconStyle>", "      <Icon>"),
            (std::vector<std::string>{"    <IconStyle>", "      <heading>170</heading>"}));
  t->IconY = 128;
  EXPECT_TRUE(HasLine(Placemark(t, "FFFFFF", 0), "      <heading>170</heading>"));
  t->IconY = 96;
  EXPECT_TRUE(HasLine(Placemark(t, "FFFFFF", 0), "      <heading>350</heading>"));
  t->Nmea.Fields.CourseText = "180";
  t->IconY = 160;
  EXPECT_TRUE(HasLine(Placemark(t, "FFFFFF", 0), "      <heading>360</heading>"));
  // Outside the live mode there is no heading line.
  t->ProgramMode = kModeConvertTracks;
  EXPECT_EQ(Between(Placemark(t, "FFFFFF", 0), "    <IconStyle>", "      <Icon>"),
            (std::vector<std::string>{"    <IconStyle>"}));
}

TEST(Placemarks, GoogleMapsStyleNamesTheMapsIconOfTheChosenCell) {
  TestProgram t;
  t->OutputMode = kOutputGoogleMaps;
  t->IconPalette = 3;
  t->IconX = 224;
  t->IconY = 0;
  const auto lines = Placemark(t, "0000FF", kPlacemarkFinish);
  EXPECT_EQ(Between(lines, "  <Style id=\"default12442531244255\">", "  <Point>"),
            (std::vector<std::string>{"  <Style id=\"default12442531244255\">",
                                      "    <IconStyle id=\"khIconStyle560_copy00\">", "      <Icon>",
                                      "        <href>http://maps.google.com/mapfiles/kml/pal5/icon63.png</href>",
                                      "      </Icon>", "    </IconStyle>", "  </Style>"}));
  EXPECT_FALSE(HasLine(lines, "  <styleUrl>root://styleMaps#default?iconId=0x307</styleUrl>"));
}

TEST(Placemarks, GoogleMapsIconCellsRoundHalfToEven) {
  TestProgram t;
  Molvar& m = *t;
  m.IconPalette = 0;
  m.IconX = 0;
  m.IconY = 224;
  EXPECT_EQ(GoogleMapsIconFile(m), "pal2/icon0.png");
  m.IconX = 16;  // column 0.5 -> 0
  m.IconY = 16;  // row 6.5 -> 6
  EXPECT_EQ(GoogleMapsIconFile(m), "pal2/icon48.png");
  m.IconX = 48;  // column 1.5 -> 2
  m.IconY = 48;  // row 5.5 -> 6
  EXPECT_EQ(GoogleMapsIconFile(m), "pal2/icon50.png");
}

void AddSpan(TestProgram& t, const char* end) {
  t.AddPoint(45.0, -75.0, "2007-05-01 10:00:00 AM");
  t.AddPoint(45.01, -75.0, end, 12);
}

TEST(Placemarks, FinishBalloonSummarisesATrackThatTakesTime) {
  TestProgram t;
  AddSpan(t, "2007-05-01 12:00:00 PM");
  t->Track.at(2).Altitude = 500;
  t->frmMain.chkBalloon.Value = 1;
  const auto lines = Placemark(t, "0000FF", kPlacemarkFinish);
  EXPECT_EQ(Between(lines, "  <description><![CDATA[Point no.  2", "  <name>Here</name>"),
            (std::vector<std::string>{"  <description><![CDATA[Point no.  2", "    <br></br>Speed: 12.0 kph",
                                      "    <br></br>Altitude: 1640 feet", "    <br></br>Total time: 2.0 hours",
                                      "    <br></br>Total distance: 1.11 km", "    <br></br>Average speed: 0.6 kph]]>",
                                      "  </description>"}));
  // Only the finish colour gets it.
  EXPECT_FALSE(HasLine(Placemark(t, "00FF00", kPlacemarkStart), "  <description><![CDATA[Point no.  2"));
}

TEST(Placemarks, NoBalloonWhenTheTrackTakesNoTimeOrAltitudeIsZero) {
  TestProgram t;
  AddSpan(t, "2007-05-01 10:00:00 AM");
  t->frmMain.chkBalloon.Value = 1;
  EXPECT_EQ(Placemark(t, "0000FF", kPlacemarkFinish)[2], "  <name>Here</name>");
  TestProgram u;
  AddSpan(u, "2007-05-01 10:30:00 AM");
  u->frmMain.chkBalloon.Value = 1;
  const auto lines = Placemark(u, "0000FF", kPlacemarkFinish);
  EXPECT_EQ(lines[3], "    <br></br>Speed: 12.0 kph");
  EXPECT_EQ(lines[4], "    <br></br>Total time: 0.5 hours");
}

TEST(Placemarks, UnreadableTimeInTheBalloonReportsTheBug) {
  TestProgram t;
  AddSpan(t, "later");
  t->frmMain.chkBalloon.Value = 1;
  Placemark(t, "0000FF", kPlacemarkFinish);
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_EQ(boxes[0].text, "WriteKmlPlacemark bug " + RuntimeError::StandardDescription(kErrTypeMismatch));
  EXPECT_EQ(boxes[0].title, "Error");
  EXPECT_EQ(boxes[0].icon, MsgIcon::Exclamation);
}

TEST(Placemarks, StationDescriptions) {
  TestProgram t;
  t->Aprs.NearestMode = 1;
  t->Aprs.QrzLink = "http://qrz.example/detail/VE3XYZ";
  auto lines = Placemark(t, "FFFFFF", 0);
  EXPECT_EQ(std::vector<std::string>(lines.begin() + 2, lines.begin() + 5),
            (std::vector<std::string>{"  <description>", "    <![CDATA[QRZ lookup: http://qrz.example/detail/VE3XYZ]]>",
                                      "  </description>"}));
  t->Aprs.NearestMode = 0;
  t->ProgramMode = kModeAgw;
  t->frmMain.chkMoreInfo.Value = 1;
  t->Aprs.AgwTimeText = "10:15:00";
  t->Aprs.AgwSpeed = 0;
  lines = Placemark(t, "FFFFFF", 0);
  EXPECT_EQ(lines[3], "    <![CDATA[10:15:00]]>");
  t->Aprs.AgwSpeed = 25;
  t->Aprs.AgwHeading = "270";
  lines = Placemark(t, "FFFFFF", 0);
  EXPECT_EQ(lines[3], "    <![CDATA[Time: 10:15:00<br></br>Speed: 25 kph<br></br>Heading: 270 deg.]]>");
}

TEST(IconChooser, PaletteButtonsShowTheirPaletteAndStoreTheChoice) {
  TestProgram t;
  Molvar& m = *t;
  MakeIcons(t);
  optPalette_Click(m, 3);
  EXPECT_EQ(m.IconPalette, 3);
  EXPECT_TRUE(m.frmIconSelect.optPalette(3).Value);
  EXPECT_FALSE(m.frmIconSelect.optPalette(2).Value);
  EXPECT_EQ(m.frmIconSelect.picBig.Picture, t.folder.File("Icons/palette-5.jpg"));
  EXPECT_EQ(m.frmMain.picAll2.Picture, t.folder.File("Icons/palette-5.jpg"));
  EXPECT_EQ(m.frmIconSelect.MarkerX, 192);
  EXPECT_EQ(m.frmIconSelect.MarkerY, 32);
  optPalette_Click(m, 0);
  EXPECT_EQ(m.frmIconSelect.picBig.Picture, t.folder.File("Icons/palette-2.jpg"));
  // There are four palettes only.
  optPalette_Click(m, 4);
  EXPECT_EQ(m.IconPalette, 0);
}

TEST(IconChooser, CustomIconSwitchesThePreviewBackAndForth) {
  TestProgram t;
  Molvar& m = *t;
  MakeIcons(t);
  m.IconPalette = 1;
  m.frmIconSelect.chkCustomIcon.Value = 1;
  chkCustomIcon_Click(m);
  EXPECT_EQ(m.frmIconSelect.picBig.Picture, t.folder.File("Icons/Custom.jpg"));
  EXPECT_EQ(m.frmMain.picAll2.Picture, t.folder.File("Icons/Custom.jpg"));
  m.frmIconSelect.chkCustomIcon.Value = 0;
  chkCustomIcon_Click(m);
  EXPECT_EQ(m.frmIconSelect.picBig.Picture, t.folder.File("Icons/palette-3.jpg"));
}

TEST(IconChooser, MissingPictureLeavesThePreviewEmpty) {
  TestProgram t;
  Molvar& m = *t;
  m.frmIconSelect.picBig.Picture = "old";
  ShowIconPalette(m, 2);
  EXPECT_EQ(m.frmIconSelect.picBig.Picture, "");
  EXPECT_EQ(m.frmMain.picAll2.Picture, "");
}

TEST(IconChooser, LeftPressChoosesTheCellCountedFromTheBottom) {
  TestProgram t;
  Molvar& m = *t;
  m.IconPalette = 2;
  picBig_MouseDown(m, kLeftButton, 10, 5);
  EXPECT_EQ(m.IconX, 0);
  EXPECT_EQ(m.IconY, 224);
  EXPECT_EQ(GoogleMapsIconFile(m), "pal4/icon0.png");
  EXPECT_EQ(m.frmIconSelect.MarkerX, 0);
  EXPECT_EQ(m.frmIconSelect.MarkerY, 224);
  picBig_MouseDown(m, kLeftButton, 100.7, 200.2);
  EXPECT_EQ(m.IconX, 96);
  EXPECT_EQ(m.IconY, 32);
  EXPECT_EQ(GoogleMapsIconFile(m), "pal4/icon51.png");
  picBig_MouseDown(m, kLeftButton, 255.9, 255.9);
  EXPECT_EQ(m.IconX, 224);
  EXPECT_EQ(m.IconY, 0);
  EXPECT_EQ(GoogleMapsIconFile(m), "pal4/icon63.png");
  // Cell edges: 32 is the second cell.
  picBig_MouseDown(m, kLeftButton, 32, 31.99);
  EXPECT_EQ(m.IconX, 32);
  EXPECT_EQ(m.IconY, 224);
  // Other buttons choose nothing.
  picBig_MouseDown(m, 2, 200, 200);
  EXPECT_EQ(m.IconX, 32);
  EXPECT_EQ(m.IconY, 224);
}

TEST(IconChooser, MovingShowsTheCellUnderThePointerWithoutChoosingIt) {
  TestProgram t;
  Molvar& m = *t;
  picBig_MouseMove(m, 70, 40);
  EXPECT_EQ(m.frmIconSelect.HoverX, 64);
  EXPECT_EQ(m.frmIconSelect.HoverY, 192);
  EXPECT_EQ(m.IconX, 192);
  EXPECT_EQ(m.IconY, 32);
}

}  // namespace
}  // namespace molvar
