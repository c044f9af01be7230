#include "app/Settings.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <array>
#include <filesystem>
#include <string>
#include <tuple>
#include <vector>

#include "app/Options.h"
#include "core/Text.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::ReadFile;
using testing::TestProgram;
using testing::WriteFile;

std::string Golden(const std::string& name) { return ReadFile(std::string(MOLVAR_GOLDEN_DIR) + "/settings/" + name); }

std::vector<std::string> LinesOf(const std::string& text) {
  std::vector<std::string> lines;
  std::size_t start = 0;
  for (std::size_t p; (p = text.find("\r\n", start)) != std::string::npos; start = p + 2) {
    lines.push_back(text.substr(start, p - start));
  }
  return lines;
}

std::string JoinLines(const std::vector<std::string>& lines) {
  std::string s;
  for (const auto& l : lines) s += l + "\r\n";
  return s;
}

// The defaults file with line `k` given a new value.
std::string DefaultsWith(int k, const std::string& value) {
  auto lines = LinesOf(Golden("defaults.ini"));
  lines[static_cast<std::size_t>(k)] = SettingsLabel(k) + value;
  return JoinLines(lines);
}

const char* const kIniErrorText =
    "Ini file contains errors.\r\nError number: {N}\r\nIt should fix itself next time you run the program.\r\n"
    "If not, look at the ini file for any pathname errors.\r\n If that doesn't work, send me an email.";

void ExpectIniError(const TestProgram& t, int number) {
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_EQ(boxes[0].title, " No big deal, but...");
  EXPECT_EQ(boxes[0].text, Replace(kIniErrorText, "{N}", std::to_string(number)));
}

TEST(LoadSettings, FirstRunWelcomesAndSavesTheDefaults) {
  TestProgram t;
  LoadSettings(*t);
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_EQ(boxes[0].title, " Welcome to Molvar...");
  EXPECT_EQ(boxes[0].text,
            "Please read the help file before you use the program.\r\n"
            "(The help file is web-based and is under the \"Help\" menu.)\r\n"
            "Also, positioning the cursor over any control will pop up a help box.\r\n"
            "If there's something you still can't figure out, email me.\r\n"
            " (there is an email link in the help file)");
  EXPECT_EQ(boxes[0].icon, MsgIcon::Information);
  // No track data either: refresh is off and no information text.
  EXPECT_FALSE(t->frmMain.cmdRefresh.Enabled);
  EXPECT_EQ(t->frmMain.txtInfo.Text, "");
  EXPECT_TRUE(std::filesystem::exists(t.folder.File("agwpe.txt")));

  ASSERT_TRUE(SaveSettings(*t));
  const std::string ini = t.folder.File("Molvar.ini");
  EXPECT_EQ(ReadFile(ini), Replace(Golden("defaults.ini"), "{FOLDER}", t->ProgramFolder));
  struct stat st {};
  ASSERT_EQ(::stat(ini.c_str(), &st), 0);
  EXPECT_EQ(st.st_mode & 0777, 0600u);
}

TEST(LoadSettings, EveryValueChangedIsRestoredAndWrittenBackUnchanged) {
  TestProgram t;
  const std::string changed = Golden("changed.ini");
  WriteFile(t.folder.File("Molvar.ini"), changed);
  LoadSettings(*t);
  EXPECT_TRUE(t.platform.Messages().empty());

  Molvar& m = *t;
  auto& f = m.frmMain;
  EXPECT_EQ(m.InputTrackPath, "/home/ham/tracks");
  EXPECT_EQ(m.InputWaypointPath, "/home/ham/waypoints");
  EXPECT_EQ(m.OutputTrackPath, "/home/ham/out");
  EXPECT_EQ(m.OutputPlacemarkPath, "/home/ham/placemarks");
  EXPECT_EQ(m.TextEditorPath, "/usr/bin/gedit");
  EXPECT_EQ(m.GoogleEarthPath, "/usr/local/bin/google-earth");
  EXPECT_EQ(f.chkSplitColor(0).Value, 0);  // the colour choices exclude each other
  EXPECT_EQ(f.chkSplitColor(1).Value, 1);
  EXPECT_EQ(m.ColorVaryMode, 2);
  EXPECT_EQ(m.UserColorPointer, 7);
  EXPECT_EQ(f.ColorSample.BackColor, m.DisplayColorTable[7]);
  EXPECT_EQ(f.txtTitle.Text, "Trip = fun");
  EXPECT_TRUE(f.txtTitle.Enabled);  // auto name is off
  EXPECT_EQ(m.AltitudeMode, 3);
  EXPECT_EQ(f.comboAltitude.ListIndex, 3);
  EXPECT_TRUE(f.sldrGain.Enabled);
  EXPECT_EQ(m.PlacemarkLabelSource, 2);
  EXPECT_TRUE(f.optWptTitle(2).Value);
  EXPECT_EQ(f.chkUseFilename.Value, 0);
  EXPECT_EQ(m.frmIconSelect.chkCustomIcon.Value, 1);
  EXPECT_EQ(f.txtEyeAlt.Text, "3500");
  EXPECT_EQ(f.txtHeading.Text, "90");
  EXPECT_EQ(f.txtTilt.Text, "60");
  EXPECT_EQ(m.ComPortNumber, 4);
  EXPECT_TRUE(f.mnuComNumber(4).Checked);
  EXPECT_FALSE(f.mnuComNumber(1).Checked);
  EXPECT_EQ(m.BaudRateIndex, 3);
  EXPECT_TRUE(f.mnuComBaud(3).Checked);
  EXPECT_EQ(f.txtGErefresh.Text, "5");
  EXPECT_EQ(m.IconPalette, 3);
  EXPECT_EQ(m.IconX, 64);
  EXPECT_EQ(m.IconY, 128);
  EXPECT_EQ(m.ProgramMode, 2);
  EXPECT_TRUE(f.mnuModeItem(2).Checked);
  EXPECT_FALSE(f.mnuModeItem(0).Checked);
  EXPECT_EQ(f.window.Left, 1500);
  EXPECT_EQ(f.window.Top, 900);
  EXPECT_EQ(m.NorthUp, 1);
  EXPECT_TRUE(f.optNorthUp(1).Value);
  EXPECT_EQ(m.IconHintAnswer, 7);
  EXPECT_EQ(f.txtGMT.Text, "-5.5");
  EXPECT_EQ(m.GmtHours, -5.5);
  EXPECT_EQ(m.GmtMinutes, -330);
  EXPECT_EQ(f.chkCollapse.Value, 1);
  EXPECT_EQ(m.CollapseSegments, 1);
  // Collapsing cleared the split box; the mode replay that follows enables it again, as every
  // mode change does.
  EXPECT_EQ(f.chkUseSplit.Value, 0);
  EXPECT_EQ(f.chkFastest.Value, 0);
  EXPECT_EQ(f.chkAuto.Value, 0);
  EXPECT_EQ(m.AutoOpen, 0);
  EXPECT_EQ(f.chkStartFinish.Value, 0);
  EXPECT_EQ(f.sldrWidth.Value, 5);
  EXPECT_EQ(m.TransparencyLevel, 128);
  EXPECT_EQ(f.sldrFade.Value, 128);
  EXPECT_EQ(f.chkDetailed.Value, 0);
  EXPECT_TRUE(f.txtSpeedThreshold.Text.empty());
  EXPECT_EQ(f.sldrGain.Value, 33);
  EXPECT_EQ(m.SpeedGain, 33);
  EXPECT_EQ(f.txtCallSign.Text, "VE3ABC");
  EXPECT_EQ(m.SpeedUnits, 1);
  EXPECT_EQ(m.UnitFactor, 0.6213712);
  EXPECT_EQ(m.SpeedUnitLabel, " mph");
  EXPECT_EQ(m.DistanceUnitLabel, " miles");
  EXPECT_TRUE(f.mnuUnitsItem(1).Checked);
  EXPECT_EQ(m.AltitudeUnits, 1);
  EXPECT_EQ(m.AltitudeFactor, 1.0);
  EXPECT_EQ(m.AltitudeUnitLabel, " meters");
  EXPECT_EQ(f.Label2.Caption, "Meters");
  EXPECT_EQ(f.chkHalfSize.Value, 1);
  EXPECT_EQ(m.TrackFileType, 7);
  EXPECT_EQ(f.comboTrackFileType.ListIndex, 7);
  EXPECT_EQ(m.WptFileType, 1);
  EXPECT_TRUE(f.optWptFileType(1).Value);
  EXPECT_TRUE(f.optWptTitle(2).Enabled);
  EXPECT_EQ(f.chkSplitIfStopped.Value, 1);
  EXPECT_EQ(m.SplitIfStopped, 1);
  EXPECT_EQ(f.txtTrkLimit.Text, "500");
  EXPECT_TRUE(f.mnuOnTop.Checked);
  EXPECT_TRUE(f.mnuIgnore.Checked);
  EXPECT_EQ(f.chkBalloon.Value, 1);
  EXPECT_EQ(f.chkMoving.Value, 1);
  EXPECT_EQ(m.OutputMode, 1);
  EXPECT_EQ(f.cmdOpen.Caption, "FTP for Gmap");
  EXPECT_FALSE(f.chkDetailed.Enabled);
  EXPECT_EQ(m.FtpUserName, "pilot");
  EXPECT_EQ(m.FtpPassword, "pa=ss=word");
  EXPECT_EQ(m.FtpServer, "ftp.example.org");
  EXPECT_EQ(m.FtpDirectory, "/www/tracks");
  EXPECT_EQ(m.FtpHttpPath, "http://www.example.org/tracks/");
  EXPECT_TRUE(f.mnuAutoFtp(0).Checked);
  EXPECT_TRUE(f.mnuAutoFtp(1).Enabled);
  EXPECT_EQ(m.FtpUploadRate, 12.5);
  EXPECT_EQ(m.EmailSignature, "73 de VE3ABC");
  EXPECT_EQ(f.chkMoreInfo.Value, 1);
  EXPECT_EQ(f.chkPort(0).Value, 1);
  EXPECT_EQ(f.chkPort(1).Value, 1);
  EXPECT_EQ(f.chkSplitColor(2).Value, 0);
  EXPECT_EQ(f.chkGPGGA.Value, 1);

  // Every line goes back out exactly as it came in.
  ASSERT_TRUE(SaveSettings(m));
  EXPECT_EQ(ReadFile(t.folder.File("Molvar.ini")), changed);

  // And a second program reading that file sees the same settings.
  TestProgram again;
  WriteFile(again.folder.File("Molvar.ini"), ReadFile(t.folder.File("Molvar.ini")));
  LoadSettings(*again);
  ASSERT_TRUE(SaveSettings(*again));
  EXPECT_EQ(ReadFile(again.folder.File("Molvar.ini")), changed);
}

TEST(LoadSettings, WindowsPathsAreKeptAsText) {
  TestProgram t;
  WriteFile(t.folder.File("Molvar.ini"), Golden("windows-paths.ini"));
  LoadSettings(*t);
  EXPECT_TRUE(t.platform.Messages().empty());
  EXPECT_EQ(t->InputTrackPath, "C:\\Program Files\\Molvar\\Samples");
  EXPECT_EQ(t->OutputTrackPath, "D:\\GPS\\Out put");
  EXPECT_EQ(t->OutputPlacemarkPath, "\\\\server\\share\\placemarks");
  EXPECT_EQ(t->TextEditorPath, "C:\\Program Files\\Textpad 4\\Textpad.exe");
  EXPECT_EQ(t->GoogleEarthPath, "C:\\Program Files\\Google\\Google Earth\\GoogleEarth.exe");
  EXPECT_EQ(t->UserColorPointer, 3);  // lines after the paths still count
  // The reserved line's label and value were read over; it is written in its own form.
  ASSERT_TRUE(SaveSettings(*t));
  EXPECT_EQ(LinesOf(ReadFile(t.folder.File("Molvar.ini")))[45], "45 reserved              = 1");
}

TEST(LoadSettings, AMissingLineLeavesEveryLaterLineAtItsDefault) {
  TestProgram t;
  auto lines = LinesOf(Golden("changed.ini"));
  lines.erase(lines.begin() + 10);
  WriteFile(t.folder.File("Molvar.ini"), JoinLines(lines));
  LoadSettings(*t);
  ExpectIniError(t, 62);
  // Lines 00 to 09 are read...
  EXPECT_EQ(t->GoogleEarthPath, "/usr/local/bin/google-earth");
  EXPECT_EQ(t->frmMain.chkSplitColor(1).Value, 1);
  EXPECT_EQ(t->UserColorPointer, 7);
  // ...and everything after is compared with the wrong number.
  EXPECT_EQ(t->frmMain.txtTitle.Text, "");
  EXPECT_EQ(t->AltitudeMode, 0);
  EXPECT_EQ(t->ComPortNumber, 1);
  EXPECT_EQ(t->FtpPassword, "");
  EXPECT_EQ(t->frmMain.chkSplitColor(2).Value, 0);
  EXPECT_EQ(t->frmMain.chkGPGGA.Value, 0);
  EXPECT_EQ(t->frmMain.txtCallSign.Text, "NOCALL");
}

TEST(LoadSettings, WholeNumberLinesTruncateDownward) {
  {
    TestProgram t;
    WriteFile(t.folder.File("Molvar.ini"), DefaultsWith(22, "12.7"));
    LoadSettings(*t);
    EXPECT_TRUE(t.platform.Messages().empty());
    EXPECT_EQ(t->IconX, 12);
  }
  {
    TestProgram t;
    WriteFile(t.folder.File("Molvar.ini"), DefaultsWith(28, "-0.5"));
    LoadSettings(*t);
    EXPECT_TRUE(t.platform.Messages().empty());
    EXPECT_EQ(t->IconHintAnswer, -1);
  }
}

TEST(LoadSettings, BadNumbersStopReadingWithTheirErrorNumber) {
  struct Case {
    int line;
    const char* value;
    int error;
  };
  for (const Case c : {Case{18, "", 13}, Case{18, "four", 13}, Case{28, "40000", 6}, Case{35, "-32769", 6},
                       Case{47, "maybe", 13}, Case{49, "x", 13}}) {
    SCOPED_TRACE(c.line);
    TestProgram t;
    auto lines = LinesOf(Golden("changed.ini"));
    lines[static_cast<std::size_t>(c.line)] = SettingsLabel(c.line) + c.value;
    WriteFile(t.folder.File("Molvar.ini"), JoinLines(lines));
    LoadSettings(*t);
    ExpectIniError(t, c.error);
    EXPECT_EQ(t->frmMain.chkUseFilename.Value, 0);      // line 13, before every failing line
    EXPECT_EQ(t->frmMain.chkGPGGA.Value, 0);            // line 64, after every failing line
    EXPECT_EQ(t->frmMain.txtTrkLimit.Text, c.line < 46 ? "1" : "500");
  }
}

TEST(LoadSettings, LeadingNumberLinesNeverFail) {
  TestProgram t;
  auto lines = LinesOf(Golden("defaults.ini"));
  lines[58] = SettingsLabel(58) + "often";
  lines[60] = SettingsLabel(60) + "1st";
  WriteFile(t.folder.File("Molvar.ini"), JoinLines(lines));
  LoadSettings(*t);
  EXPECT_TRUE(t.platform.Messages().empty());
  EXPECT_EQ(t->FtpUploadRate, 0);
  EXPECT_EQ(t->frmMain.chkMoreInfo.Value, 1);
}

TEST(LoadSettings, ValueStartsAfterTheFirstEqualsSign) {
  TestProgram t;
  auto lines = LinesOf(Golden("defaults.ini"));
  lines[53] = "53 FTP setup - password  = a=b = c";
  lines[56] = "56 path=http://x.org/?q=1";  // a shorter label still works
  lines[10] = "10 no equals sign here";     // value from the second character on
  WriteFile(t.folder.File("Molvar.ini"), JoinLines(lines));
  LoadSettings(*t);
  EXPECT_TRUE(t.platform.Messages().empty());
  EXPECT_EQ(t->FtpPassword, "a=b = c");
  EXPECT_EQ(t->FtpHttpPath, "ttp://x.org/?q=1");
  EXPECT_EQ(t->frmMain.txtTitle.Text, "0 no equals sign here");

  TestProgram n;
  auto nl = LinesOf(Golden("defaults.ini"));
  nl[18] = "18 four";  // no "=": "8 four" is no number
  WriteFile(n.folder.File("Molvar.ini"), JoinLines(nl));
  LoadSettings(*n);
  ExpectIniError(n, 13);
}

TEST(LoadSettings, OutOfRangeValuesAreBroughtBack) {
  TestProgram t;
  auto lines = LinesOf(Golden("defaults.ini"));
  lines[25] = SettingsLabel(25) + "-200";
  lines[26] = SettingsLabel(26) + "9000";
  lines[21] = SettingsLabel(21) + "4";
  lines[22] = SettingsLabel(22) + "257";
  lines[23] = SettingsLabel(23) + "256";
  lines[9] = SettingsLabel(9) + "10";   // no such colour
  lines[39] = SettingsLabel(39) + "3";  // no such units
  lines[34] = SettingsLabel(34) + "12";
  WriteFile(t.folder.File("Molvar.ini"), JoinLines(lines));
  LoadSettings(*t);
  EXPECT_TRUE(t.platform.Messages().empty());
  EXPECT_EQ(t->frmMain.window.Left, 0);
  EXPECT_EQ(t->frmMain.window.Top, 5000);
  EXPECT_EQ(t->IconPalette, 0);
  EXPECT_EQ(t->IconX, 0);
  EXPECT_EQ(t->IconY, 256);
  EXPECT_EQ(t->UserColorPointer, 0);
  EXPECT_EQ(t->SpeedUnits, 0);
  EXPECT_TRUE(t->frmMain.mnuUnitsItem(0).Checked);
  EXPECT_EQ(t->frmMain.sldrWidth.Value, 8);

  TestProgram u;
  auto more = LinesOf(Golden("defaults.ini"));
  more[25] = SettingsLabel(25) + "8001";
  more[26] = SettingsLabel(26) + "-1";
  WriteFile(u.folder.File("Molvar.ini"), JoinLines(more));
  LoadSettings(*u);
  EXPECT_EQ(u->frmMain.window.Left, 8000);
  EXPECT_EQ(u->frmMain.window.Top, 0);
}

TEST(LoadSettings, EmptyOrUnreadableFiles) {
  {
    TestProgram t;
    WriteFile(t.folder.File("Molvar.ini"), "");
    LoadSettings(*t);
    ExpectIniError(t, 62);
  }
  {
    TestProgram t;
    std::filesystem::create_directory(t.folder.File("Molvar.ini"));
    LoadSettings(*t);
    ExpectIniError(t, 75);
    EXPECT_EQ(t->frmMain.txtCallSign.Text, "NOCALL");
  }
  {
    // Binary garbage: line 00 does not match, and the file runs out long before line 64.
    TestProgram t;
    std::string junk(3000, '\0');
    for (std::size_t i = 0; i < junk.size(); ++i) junk[i] = static_cast<char>((i * 37) % 256);
    WriteFile(t.folder.File("Molvar.ini"), junk);
    LoadSettings(*t);
    ASSERT_EQ(t.platform.Messages().size(), 1u);
    EXPECT_EQ(t.platform.Messages()[0].title, " No big deal, but...");
  }
}

TEST(LoadSettings, BareLineFeedsAreLineEndsToo) {
  TestProgram t;
  WriteFile(t.folder.File("Molvar.ini"), Replace(Golden("changed.ini"), "\r\n", "\n"));
  LoadSettings(*t);
  EXPECT_TRUE(t.platform.Messages().empty());
  EXPECT_EQ(t->frmMain.chkGPGGA.Value, 1);
}

TEST(SaveSettings, TextValuesStayOnTheirLine) {
  TestProgram t;
  LoadSettings(*t);
  t->EmailSignature = "73\r\nde VE3ABC";
  ASSERT_TRUE(SaveSettings(*t));
  const auto lines = LinesOf(ReadFile(t.folder.File("Molvar.ini")));
  ASSERT_EQ(lines.size(), 65u);
  EXPECT_EQ(lines[59], "59 Email signature       = 73  de VE3ABC");
  EXPECT_EQ(lines[64], "64 use GPGGA flag?       = 0");
}

TEST(SaveSettings, CallSignIsUpperCasedAndTrimmed) {
  TestProgram t;
  LoadSettings(*t);
  t->frmMain.txtCallSign.Text = "  ve3abc-9 ";
  ASSERT_TRUE(SaveSettings(*t));
  EXPECT_EQ(LinesOf(ReadFile(t.folder.File("Molvar.ini")))[38], "38 Ham radio callsign    = VE3ABC-9");
}

TEST(SaveSettings, FailureIsReported) {
  TestProgram t;
  LoadSettings(*t);
  t->ProgramFolder = t.folder.File("no-such-folder");
  EXPECT_FALSE(SaveSettings(*t));
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 2u);  // the welcome box, then the failure
  EXPECT_EQ(boxes[1].title, "Error");
  EXPECT_EQ(boxes[1].text.rfind("SaveSettings bug ", 0), 0u);
}

TEST(TrackData, LoadsTheGoldenFileAndWritesItBack) {
  TestProgram t;
  const std::string golden = Golden("TrackData.txt");
  WriteFile(t.folder.File("TrackData.txt"), golden);
  LoadTrackData(*t);
  const TrackStore& s = t->Track;
  ASSERT_EQ(s.PointCount, 3);
  EXPECT_EQ(t->LastSourceFile, "C:\\GPS\\day one.plt");
  EXPECT_EQ(t->OutputPath, "/home/ham/out/day one.kml");
  EXPECT_EQ(t->OutputName, "day one.kml");
  EXPECT_EQ(s[1].Latitude, 45.1);
  EXPECT_EQ(s[1].Longitude, -75.2);
  EXPECT_EQ(s[1].DateTime.view(), "2007-03-04 01:02:03 PM");
  EXPECT_EQ(s[1].Altitude, 120);
  EXPECT_EQ(s[1].Speed, 12.5);
  EXPECT_EQ(s[1].Distance, 0.25);
  EXPECT_EQ(s[1].Flag, 1);
  EXPECT_EQ(s[1].SegCtr, 2);
  EXPECT_EQ(s[1].DayCtr, 3);
  EXPECT_EQ(s[2].Altitude, -15);
  EXPECT_EQ(s[3].Flag, -2);
  EXPECT_EQ(s[3].Distance, 2000.75);
  EXPECT_EQ(t->frmMain.txtInfo.Text, " Last saved track file was day one.kml, with 3 points.");
  EXPECT_TRUE(t->frmMain.cmdRefresh.Enabled);

  std::filesystem::remove(t.folder.File("TrackData.txt"));
  SaveTrackData(*t);
  EXPECT_EQ(ReadFile(t.folder.File("TrackData.txt")), golden);
}

TEST(TrackData, RoundTripKeepsEveryField) {
  TestProgram t;
  t.AddPoint(51.477928, -0.001545, "2010-06-01 11:59:59 PM", 3.0000000000001);
  t.AddPoint(-89.999999, 179.999999, "2010-06-02 00:00:01 AM", 1234.5678);
  t->Track[2].Altitude = 8848;
  t->Track[2].Flag = 32767;
  t->Track[2].SegCtr = 2147483647;
  t->Track[2].DayCtr = -2147483647 - 1;
  t->LastSourceFile = "/data/in.plt";
  t->OutputPath = "/data/out.kml";
  t->OutputName = "out.kml";
  SaveTrackData(*t);

  TestProgram u;
  WriteFile(u.folder.File("TrackData.txt"), ReadFile(t.folder.File("TrackData.txt")));
  LoadTrackData(*u);
  ASSERT_EQ(u->Track.PointCount, 2);
  for (int i = 1; i <= 2; ++i) {
    const TrackPoint& a = t->Track[i];
    const TrackPoint& b = u->Track[i];
    EXPECT_EQ(a.Latitude, b.Latitude);
    EXPECT_EQ(a.Longitude, b.Longitude);
    EXPECT_EQ(a.DateTime.view(), b.DateTime.view());
    EXPECT_EQ(a.Altitude, b.Altitude);
    EXPECT_EQ(a.Speed, b.Speed);
    EXPECT_EQ(a.Distance, b.Distance);
    EXPECT_EQ(a.Flag, b.Flag);
    EXPECT_EQ(a.SegCtr, b.SegCtr);
    EXPECT_EQ(a.DayCtr, b.DayCtr);
  }
  EXPECT_EQ(u->LastSourceFile, "/data/in.plt");
}

TEST(TrackData, FewerThanTwoPointsLeaveTheOldFile) {
  TestProgram t;
  WriteFile(t.folder.File("TrackData.txt"), "old\r\n");
  t.AddPoint(1, 2, "2010-06-01 11:59:59 PM");
  t->OutputPath = "/x.kml";
  t->OutputName = "x.kml";
  SaveTrackData(*t);
  EXPECT_EQ(ReadFile(t.folder.File("TrackData.txt")), "old\r\n");
}

TEST(TrackData, DamagedFilesKeepWhatWasReadBefore) {
  const std::string head = "in.plt\r\n/o/out.kml\r\nout.kml\r\n";
  const std::string p1 = "1,2,2007-01-01 00:00:00 AM,3,4,5,6,7,8\r\n";
  const std::string p2 = "1.5,2.5,2007-01-01 00:00:10 AM,3,4,5,6,7,8\r\n";
  struct Case {
    const char* name;
    std::string content;
    int points;
  };
  const std::vector<Case> cases = {
      {"single point", head + p1, 1},
      {"eleven fields", head + p1 + p2 + "1,2,3,4,5,6,7,8,9,10,11\r\n" + p1, 2},
      {"ten fields are fine", head + p1 + "1,2,t,4,5,6,7,8,9,extra\r\n", 2},
      {"letters in a number", head + p1 + "1,x,t,4,5,6,7,8,9\r\n" + p2, 1},
      {"truncated point", head + p1 + p2 + "1.5,2.5,2007-01-0", 2},
      {"flag out of range", head + p1 + "1,2,t,4,5,6,40000,8,9\r\n", 1},
      {"binary garbage", head + std::string("\x01\xff\xfe,\x80\x81\r\n\0\0\0", 12), 0},
      {"no output name", "in.plt\r\n/o/out.kml\r\n\r\n" + p1 + p2, 0},
      {"no output path", "in.plt\r\n\r\nout.kml\r\n" + p1 + p2, 0},
      {"empty", "", 0},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    TestProgram t;
    WriteFile(t.folder.File("TrackData.txt"), c.content);
    LoadTrackData(*t);
    EXPECT_EQ(t->Track.PointCount, c.points);
    if (c.points < 2 || std::string(c.name) == "eleven fields" || std::string(c.name) == "truncated point") {
      EXPECT_FALSE(t->frmMain.cmdRefresh.Enabled);
      EXPECT_EQ(t->frmMain.txtInfo.Text, "");
    } else {
      EXPECT_TRUE(t->frmMain.cmdRefresh.Enabled);
      EXPECT_EQ(t->frmMain.txtInfo.Text, " Last saved track file was out.kml, with 2 points.");
    }
    // Every point that was stored is whole: no half-filled point from a bad line.
    for (int i = 1; i <= t->Track.PointCount; ++i) {
      EXPECT_NE(t->Track[i].DateTime.view(), "");
      EXPECT_NE(t->Track[i].DayCtr, 0);
    }
  }
}

TEST(TrackData, HighCharactersAreDroppedFromFields) {
  TestProgram t;
  WriteFile(t.folder.File("TrackData.txt"),
            "in.plt\r\n/o/out.kml\r\nout.kml\r\n4\xb0" "5,2,t\xe9,3,4,5,6,7,8\r\n1,2,u,3,4,5,6,7,8\r\n");
  LoadTrackData(*t);
  ASSERT_EQ(t->Track.PointCount, 2);
  EXPECT_EQ(t->Track[1].Latitude, 45);
  EXPECT_EQ(t->Track[1].DateTime.view(), "t");
}

TEST(LoadSettings, RestoresTheLastTrack) {
  TestProgram t;
  WriteFile(t.folder.File("Molvar.ini"), Replace(Golden("defaults.ini"), "{FOLDER}", t->ProgramFolder));
  WriteFile(t.folder.File("TrackData.txt"), Golden("TrackData.txt"));
  LoadSettings(*t);
  EXPECT_TRUE(t.platform.Messages().empty());
  EXPECT_EQ(t->Track.PointCount, 3);
  EXPECT_EQ(t->frmMain.txtInfo.Text, " Last saved track file was day one.kml, with 3 points.");
}

TEST(Options, UnitChoicesSetFactorsAndLabels) {
  TestProgram t;
  SelectSpeedUnits(*t, 2);
  EXPECT_EQ(t->UnitFactor, 0.5399568);
  EXPECT_EQ(t->SpeedUnitLabel, " kts");
  EXPECT_EQ(t->DistanceUnitLabel, " nm");
  EXPECT_TRUE(t->frmMain.mnuUnitsItem(2).Checked);
  EXPECT_FALSE(t->frmMain.mnuUnitsItem(0).Checked);
  SelectSpeedUnits(*t, 0);
  EXPECT_EQ(t->UnitFactor, 1.0);
  EXPECT_EQ(t->SpeedUnitLabel, " kph");
  SelectAltitudeUnits(*t, 1);
  SelectAltitudeUnits(*t, 0);
  EXPECT_EQ(t->AltitudeFactor, 3.28083);
  EXPECT_EQ(t->AltitudeUnitLabel, " feet");
  EXPECT_EQ(t->frmMain.Label2.Caption, "Feet");
}

TEST(Options, GmtTextGivesHoursAndMinutes) {
  TestProgram t;
  for (const auto& [text, hours, minutes] :
       std::vector<std::tuple<std::string, double, int>>{{"5.75", 5.75, 345}, {"-3.5h", -3.5, -210},
                                                         {"east", 0, 0}, {"", 0, 0}, {"1e9", 0, 0}}) {
    SCOPED_TRACE(text);
    t->frmMain.txtGMT.Text = text;
    ApplyGmtText(*t);
    EXPECT_EQ(t->GmtHours, hours);
    EXPECT_EQ(t->GmtMinutes, minutes);
  }
  EXPECT_TRUE(t.platform.Messages().empty());
}

TEST(Options, GoogleMapsOutputCollapsesSegments) {
  TestProgram t;
  t->frmMain.chkSplitIfStopped.Value = 1;
  ApplySplitIfStopped(*t);
  SelectOutputMode(*t, 1);
  EXPECT_EQ(t->frmMain.chkCollapse.Value, 1);
  EXPECT_EQ(t->CollapseSegments, 1);
  EXPECT_EQ(t->frmMain.chkSplitIfStopped.Value, 0);
  EXPECT_EQ(t->SplitIfStopped, 0);
  EXPECT_EQ(t->frmMain.cmdOpen.ToolTipText, " FTP file to server for GoogleMaps (see help) ");
  SelectOutputMode(*t, 0);
  EXPECT_EQ(t->frmMain.cmdOpen.Caption, "Open in GE");
  EXPECT_EQ(t->frmMain.cmdOpen.ToolTipText, " Open last output file in GoogleEarth ");
  EXPECT_EQ(t->frmMain.chkCollapse.Value, 1);  // stays checked
  EXPECT_TRUE(t->frmMain.chkDetailed.Enabled);
}

TEST(Options, WaypointChoicesKeepTheirRules) {
  TestProgram t;
  t->ProgramMode = kModeConvertWaypoints;
  SelectAltitudeMode(*t, 3);  // speed as altitude means nothing for waypoints
  EXPECT_EQ(t->AltitudeMode, 2);
  EXPECT_EQ(t->frmMain.comboAltitude.ListIndex, 2);
  EXPECT_TRUE(t->frmMain.AltLabel.Visible);
  EXPECT_FALSE(t->frmMain.sldrGain.Enabled);

  SelectWptFileType(*t, 1);
  SelectWptTitle(*t, 2);
  SelectWptFileType(*t, 0);  // OziExplorer files have no description
  EXPECT_FALSE(t->frmMain.optWptTitle(2).Enabled);
  EXPECT_TRUE(t->frmMain.optWptTitle(1).Value);
  EXPECT_EQ(t->PlacemarkLabelSource, 1);
}

TEST(LoadSettings, ColourChoicesExcludeEachOther) {
  struct Case {
    const char* seg;
    const char* date;
    const char* speed;
    int mode;
    std::array<int, 3> boxes;
  };
  for (const Case c : {Case{"1", "0", "0", 1, {1, 0, 0}}, Case{"1", "1", "0", 2, {0, 1, 0}},
                       Case{"1", "1", "1", 3, {0, 0, 1}}, Case{"0", "0", "1x", 3, {0, 0, 1}},
                       Case{"0", "0", "0", 0, {0, 0, 0}}}) {
    SCOPED_TRACE(std::string(c.seg) + c.date + c.speed);
    TestProgram t;
    auto lines = LinesOf(Golden("defaults.ini"));
    lines[7] = SettingsLabel(7) + c.seg;
    lines[8] = SettingsLabel(8) + c.date;
    lines[63] = SettingsLabel(63) + c.speed;
    WriteFile(t.folder.File("Molvar.ini"), JoinLines(lines));
    LoadSettings(*t);
    EXPECT_EQ(t->ColorVaryMode, c.mode);
    for (int i = 0; i < 3; ++i) EXPECT_EQ(t->frmMain.chkSplitColor(i).Value, c.boxes[static_cast<std::size_t>(i)]);
  }
}

TEST(LoadSettings, StoredWaypointModeRefusesSpeedAsAltitude) {
  TestProgram t;
  auto lines = LinesOf(Golden("defaults.ini"));
  lines[11] = SettingsLabel(11) + "3";
  lines[24] = SettingsLabel(24) + "1";
  WriteFile(t.folder.File("Molvar.ini"), JoinLines(lines));
  LoadSettings(*t);
  EXPECT_EQ(t->ProgramMode, 1);
  EXPECT_EQ(t->AltitudeMode, 2);
  EXPECT_EQ(t->frmMain.comboAltitude.Text(), " Extrude track to ground");
  // The mode menu handler ran: the window shows the waypoint mode.
  EXPECT_EQ(t->frmMain.window.Caption, " Molvar - Convert Waypoints ");
  EXPECT_TRUE(t->frmMain.WptFrame.InFront);
  EXPECT_FALSE(t->frmMain.TrackFrame.InFront);
  EXPECT_FALSE(t->frmMain.chkStartFinish.Enabled);
}

}  // namespace
}  // namespace molvar
