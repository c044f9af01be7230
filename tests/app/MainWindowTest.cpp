#include "app/MainWindow.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <type_traits>
#include <variant>

#include "app/Options.h"
#include "support/Peers.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::ReadFile;
using testing::TestProgram;

const char* const kIconHint =
    "In NMEA mode, the icon is rotated to indicate heading.\r\nChoose an arrow for an icon (palettes 3 or 4)."
    "\r\n\r\nShow this message next time?";

std::vector<Control*> CommonControls(MainForm& f) {
  return {&f.chkAuto,          &f.chkCollapse,   &f.chkDetailed,      &f.txtHeading,        &f.cmdSetColor,
          &f.chkUseThreshold,  &f.txtSpeedThreshold, &f.chkUseSplit,  &f.txtSpltCount,      &f.chkSplitColor(0),
          &f.chkSplitColor(1), &f.chkSplitColor(2),  &f.chkSplitIfStopped, &f.sldrWidth,    &f.chkStartFinish,
          &f.chkFastest,       &f.cmdDisplayArray,   &f.cmdRefresh,   &f.OptionsFrame};
}

// Everything the common part of a mode change resets, set the other way.
void Dirty(Molvar& m) {
  MainForm& f = m.frmMain;
  m.Aprs.NearestMode = 1;
  f.txtTest.Text = "old test";
  f.txtInfo.Text = "old info";
  f.TrkTimer.Enabled = true;
  f.cmdOpen.Enabled = true;
  for (Control* c : CommonControls(f)) c->Enabled = false;
  f.AltLabel.Visible = true;
  f.cmdViewInBrowser.Enabled = true;
  f.optNorthUp(0).Enabled = true;
  f.optNorthUp(1).Enabled = true;
  f.cmdSetColor.ToolTipText = " Track color is fixed in NMEA mode ";
  for (auto& [i, item] : f.mnuModeItem.Items()) item.Checked = true;
}

std::vector<std::string> Disabled(MainForm& f) {
  std::vector<std::string> names;
  for (const auto& e : f.Controls()) {
    std::visit(
        [&](auto* c) {
          if constexpr (std::is_base_of_v<Control, std::remove_pointer_t<decltype(c)>>) {
            if (!c->Enabled) names.push_back(e.index == kNoIndex ? e.name : e.name + std::to_string(e.index));
          }
        },
        e.control);
  }
  return names;
}

void ExpectOnlyFront(MainForm& f, const Frame& front) {
  for (const Frame* frame : {&f.TrackFrame, &f.WptFrame, &f.GpsTrackFrame, &f.GpsNmeaFrame, &f.WebpageFrame,
                             &f.AgwFrame})
    EXPECT_EQ(frame->InFront, frame == &front) << frame->Caption;
}

void ExpectCommonReset(Molvar& m, int mode) {
  MainForm& f = m.frmMain;
  EXPECT_EQ(m.ProgramMode, mode);
  EXPECT_EQ(m.Aprs.NearestMode, 0);
  EXPECT_EQ(f.txtTest.Text, "");
  EXPECT_EQ(f.txtInfo.Text, "");
  EXPECT_FALSE(f.TrkTimer.Enabled);
  EXPECT_FALSE(f.cmdOpen.Enabled);
  EXPECT_FALSE(f.cmdViewInBrowser.Enabled);
  for (const auto& [i, item] : f.mnuModeItem.Items()) EXPECT_EQ(item.Checked, i == mode) << i;
}

TEST(ProgramMode, ConvertTracksResetsEverythingCommon) {
  TestProgram t;
  MainForm& f = t->frmMain;
  Dirty(*t);
  mnuModeItem_Click(*t, 0);
  ExpectCommonReset(*t, 0);
  EXPECT_EQ(f.window.Caption, " Molvar - Convert Tracks ");
  ExpectOnlyFront(f, f.TrackFrame);
  EXPECT_FALSE(f.AltLabel.Visible);
  EXPECT_EQ(f.cmdSetColor.ToolTipText, " Also starting color if either \"Vary\" checked ");
  for (Control* c : CommonControls(f)) EXPECT_TRUE(c->Enabled);
  EXPECT_FALSE(f.optNorthUp(0).Enabled);
  EXPECT_FALSE(f.optNorthUp(1).Enabled);
}

TEST(ProgramMode, ConvertWaypointsDisablesTheTrackOptions) {
  TestProgram t;
  MainForm& f = t->frmMain;
  Dirty(*t);
  mnuModeItem_Click(*t, 1);
  ExpectCommonReset(*t, 1);
  EXPECT_EQ(f.window.Caption, " Molvar - Convert Waypoints ");
  ExpectOnlyFront(f, f.WptFrame);
  for (Control* c : std::initializer_list<Control*>{&f.cmdSetColor, &f.chkSplitColor(0), &f.chkSplitColor(1),
                                                    &f.chkSplitColor(2), &f.chkUseThreshold, &f.txtSpeedThreshold,
                                                    &f.chkUseSplit, &f.txtSpltCount, &f.chkCollapse, &f.sldrWidth,
                                                    &f.chkDetailed, &f.chkStartFinish, &f.chkFastest})
    EXPECT_FALSE(c->Enabled);
  // No waypoints held: nothing to refresh.
  EXPECT_FALSE(f.cmdRefresh.Enabled);
  for (Control* c : std::initializer_list<Control*>{&f.chkAuto, &f.txtHeading, &f.chkSplitIfStopped,
                                                    &f.cmdDisplayArray, &f.OptionsFrame})
    EXPECT_TRUE(c->Enabled);
  EXPECT_FALSE(f.AltLabel.Visible);  // clamped to ground

  t->Waypoints.Add();
  SelectAltitudeMode(*t, 1);
  mnuModeItem_Click(*t, 1);
  EXPECT_TRUE(f.cmdRefresh.Enabled);
  EXPECT_TRUE(f.AltLabel.Visible);
}

TEST(ProgramMode, WaypointsTurnSpeedAsAltitudeIntoExtrude) {
  TestProgram t;
  MainForm& f = t->frmMain;
  comboAltitude_Click(*t);  // defaults to clamp
  f.comboAltitude.ListIndex = 3;
  comboAltitude_Click(*t);
  EXPECT_EQ(t->AltitudeMode, 3);
  EXPECT_TRUE(f.sldrGain.Enabled);
  mnuModeItem_Click(*t, 1);
  EXPECT_EQ(t->AltitudeMode, 2);
  EXPECT_EQ(f.comboAltitude.ListIndex, 2);
  EXPECT_EQ(f.comboAltitude.Text(), " Extrude track to ground");
  EXPECT_FALSE(f.sldrGain.Enabled);
  EXPECT_FALSE(f.lblGain.Enabled);
  EXPECT_TRUE(f.AltLabel.Visible);

  // In waypoint mode the list refuses the speed entry.
  f.comboAltitude.ListIndex = 3;
  comboAltitude_Click(*t);
  EXPECT_EQ(f.comboAltitude.ListIndex, 2);
  EXPECT_EQ(t->AltitudeMode, 2);
  f.comboAltitude.ListIndex = 0;
  comboAltitude_Click(*t);
  EXPECT_FALSE(f.AltLabel.Visible);
}

TEST(ProgramMode, GarminAndAprsWeb) {
  TestProgram t;
  MainForm& f = t->frmMain;
  Dirty(*t);
  mnuModeItem_Click(*t, 2);
  ExpectCommonReset(*t, 2);
  EXPECT_EQ(f.window.Caption, " Molvar - Download Garmin Track ");
  ExpectOnlyFront(f, f.GpsTrackFrame);
  EXPECT_FALSE(f.optNorthUp(1).Enabled);
  for (Control* c : CommonControls(f)) EXPECT_TRUE(c->Enabled);

  Dirty(*t);
  mnuModeItem_Click(*t, 4);
  ExpectCommonReset(*t, 4);
  EXPECT_EQ(f.window.Caption, " Molvar - Download Track from Findu ");
  ExpectOnlyFront(f, f.WebpageFrame);
  EXPECT_TRUE(f.optNorthUp(0).Enabled);
  EXPECT_TRUE(f.optNorthUp(1).Enabled);
  for (Control* c : CommonControls(f)) EXPECT_TRUE(c->Enabled);
}

TEST(ProgramMode, RealTimeNmeaFixesColourAndAsksAboutIcons) {
  TestProgram t;
  MainForm& f = t->frmMain;
  f.chkSplitColor(1).Value = 1;
  chkSplitColor_Click(*t, 1);
  f.chkCollapse.Value = 1;
  chkCollapse_Click(*t);
  ASSERT_EQ(t->ColorVaryMode, 2);
  Dirty(*t);
  t.platform.msgAnswers = {kAnswerYes};
  mnuModeItem_Click(*t, 3);
  ExpectCommonReset(*t, 3);
  EXPECT_EQ(f.window.Caption, " Molvar - Real-time Location (NMEA mode) ");
  EXPECT_EQ(f.cmdSetColor.ToolTipText, " Track color is fixed in NMEA mode ");
  ExpectOnlyFront(f, f.GpsNmeaFrame);
  for (int i = 0; i < 3; ++i) {
    EXPECT_FALSE(f.chkSplitColor(i).Enabled);
    EXPECT_EQ(f.chkSplitColor(i).Value, 0);
  }
  EXPECT_EQ(f.chkCollapse.Value, 0);
  EXPECT_EQ(t->CollapseSegments, 0);
  EXPECT_EQ(t->ColorVaryMode, 0);
  EXPECT_EQ(Disabled(f), (std::vector<std::string>{
                             "chkSplitIfStopped", "chkUseSplit", "txtSpltCount", "chkCollapse", "chkSplitColor0",
                             "chkSplitColor1", "chkSplitColor2", "txtHeading", "chkAuto", "cmdViewInBrowser",
                             "cmdOpen", "cmdDisplayArray", "mnuAutoFtp1"}));
  EXPECT_TRUE(f.optNorthUp(0).Enabled);
  EXPECT_TRUE(f.optNorthUp(1).Enabled);

  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 1u);
  EXPECT_EQ(boxes[0].text, kIconHint);
  EXPECT_EQ(boxes[0].title, " Icon selection...");
  EXPECT_EQ(boxes[0].buttons, MsgButtons::YesNo);
  EXPECT_EQ(boxes[0].icon, MsgIcon::Information);
  EXPECT_EQ(t->IconHintAnswer, kAnswerYes);
}

TEST(ProgramMode, IconHintAnsweredNoIsNotAskedAgain) {
  TestProgram t;
  t.platform.msgAnswers = {kAnswerYes, kAnswerNo};
  mnuModeItem_Click(*t, 3);
  mnuModeItem_Click(*t, 0);
  mnuModeItem_Click(*t, 3);
  EXPECT_EQ(t->IconHintAnswer, 7);
  mnuModeItem_Click(*t, 3);  // no answer queued: a third box would be an unscripted call
  EXPECT_EQ(t.platform.Messages().size(), 2u);
  EXPECT_EQ(t->IconHintAnswer, 7);
}

TEST(ProgramMode, LeavingNmeaLeavesColourAndCollapseUnchecked) {
  TestProgram t;
  MainForm& f = t->frmMain;
  for (int i = 0; i < 3; ++i) f.chkSplitColor(i).Value = 1;
  f.chkCollapse.Value = 1;
  t->IconHintAnswer = kAnswerNo;
  mnuModeItem_Click(*t, 3);
  mnuModeItem_Click(*t, 0);
  for (int i = 0; i < 3; ++i) {
    EXPECT_EQ(f.chkSplitColor(i).Value, 0) << i;
    EXPECT_TRUE(f.chkSplitColor(i).Enabled) << i;
  }
  EXPECT_EQ(f.chkCollapse.Value, 0);
  EXPECT_TRUE(f.chkCollapse.Enabled);
  EXPECT_TRUE(t.platform.Messages().empty());
}

TEST(ProgramMode, AgwUnchecksAndLocksOptions) {
  TestProgram t;
  MainForm& f = t->frmMain;
  f.chkCollapse.Value = 1;
  chkCollapse_Click(*t);
  f.chkSplitIfStopped.Value = 1;
  t->SplitIfStopped = 1;
  f.txtSpeedThreshold.Text = "50";
  t->OutputPath = t.folder.File("out.kml");
  Dirty(*t);
  mnuModeItem_Click(*t, 5);
  ExpectCommonReset(*t, 5);
  EXPECT_EQ(f.window.Caption, " AGW Packet Engine ");
  ExpectOnlyFront(f, f.AgwFrame);
  for (CheckBox* box : {&f.chkDetailed, &f.chkCollapse, &f.chkSplitIfStopped, &f.chkAuto}) EXPECT_EQ(box->Value, 0);
  EXPECT_EQ(t->CollapseSegments, 0);
  EXPECT_EQ(t->SplitIfStopped, 0);
  EXPECT_EQ(t->AutoOpen, 0);
  EXPECT_EQ(f.txtSpeedThreshold.Text, "");  // details off empties the threshold
  for (Control* c : std::initializer_list<Control*>{&f.cmdOpen, &f.chkAuto, &f.OptionsFrame, &f.chkDetailed})
    EXPECT_FALSE(c->Enabled);
  EXPECT_TRUE(f.chkCollapse.Enabled);
  EXPECT_TRUE(f.sldrWidth.Enabled);
}

TEST(ProgramMode, UnknownIndexChangesNothing) {
  TestProgram t;
  t->frmMain.txtInfo.Text = "kept";
  mnuModeItem_Click(*t, 6);
  mnuModeItem_Click(*t, -1);
  EXPECT_EQ(t->ProgramMode, 0);
  EXPECT_EQ(t->frmMain.txtInfo.Text, "kept");
}

TEST(OutputMode, GoogleMapsChecksCollapseAndBackKeepsIt) {
  TestProgram t;
  MainForm& f = t->frmMain;
  f.chkUseSplit.Value = 1;
  f.txtSpltCount.Text = "12";
  mnuOutputMode_Click(*t, 1);
  EXPECT_EQ(t->OutputMode, 1);
  EXPECT_FALSE(f.mnuOutputMode(0).Checked);
  EXPECT_TRUE(f.mnuOutputMode(1).Checked);
  EXPECT_EQ(f.chkCollapse.Value, 1);
  EXPECT_EQ(t->CollapseSegments, 1);
  EXPECT_EQ(f.chkUseSplit.Value, 0);
  EXPECT_FALSE(f.chkUseSplit.Enabled);
  EXPECT_EQ(f.txtSpltCount.Text, "");
  EXPECT_EQ(f.cmdOpen.Caption, "FTP for Gmap");
  EXPECT_EQ(f.cmdOpen.ToolTipText, " FTP file to server for GoogleMaps (see help) ");
  EXPECT_FALSE(f.chkDetailed.Enabled);

  mnuOutputMode_Click(*t, 0);
  EXPECT_EQ(t->OutputMode, 0);
  EXPECT_TRUE(f.mnuOutputMode(0).Checked);
  EXPECT_FALSE(f.mnuOutputMode(1).Checked);
  EXPECT_EQ(f.cmdOpen.Caption, "Open in GE");
  EXPECT_EQ(f.cmdOpen.ToolTipText, " Open last output file in GoogleEarth ");
  EXPECT_TRUE(f.chkDetailed.Enabled);
  EXPECT_EQ(f.chkCollapse.Value, 1);
  EXPECT_EQ(t->CollapseSegments, 1);
}

TEST(OutputMode, GoogleEarthInAgwModeKeepsDetailsLocked) {
  TestProgram t;
  mnuModeItem_Click(*t, 5);
  mnuOutputMode_Click(*t, 0);
  EXPECT_FALSE(t->frmMain.chkDetailed.Enabled);
}

TEST(AutoOpen, CheckingOpensTheLastOutputAtOnce) {
  TestProgram t;
  MainForm& f = t->frmMain;
  f.chkAuto.Value = 0;
  chkAuto_Click(*t);
  EXPECT_TRUE(t.platform.CallsOf("StartProgram").empty());  // nothing written yet
  EXPECT_EQ(t->AutoOpen, 0);

  t->OutputPath = t.folder.File("trip.kml");
  f.chkAuto.Value = 1;
  chkAuto_Click(*t);
  EXPECT_EQ(t->AutoOpen, 1);
  EXPECT_FALSE(f.cmdOpen.Enabled);
  const auto starts = t.platform.CallsOf("StartProgram");
  ASSERT_EQ(starts.size(), 1u);
  EXPECT_EQ(starts[0].text, t->GoogleEarthPath + " \"" + t->OutputPath + "\"");

  f.chkAuto.Value = 0;
  chkAuto_Click(*t);
  EXPECT_TRUE(f.cmdOpen.Enabled);
  EXPECT_EQ(t.platform.CallsOf("StartProgram").size(), 1u);
}

TEST(Menus, OnTopAndIgnoreToggle) {
  TestProgram t;
  MainForm& f = t->frmMain;
  mnuOnTop_Click(*t);
  EXPECT_TRUE(f.mnuOnTop.Checked);
  EXPECT_TRUE(f.window.TopMost);
  EXPECT_TRUE(t->frmFtpSetup.window.TopMost);
  mnuOnTop_Click(*t);
  EXPECT_FALSE(f.mnuOnTop.Checked);
  EXPECT_FALSE(t->frmFtpSetup.window.TopMost);
  const auto calls = t.platform.CallsOf("SetTopMost");
  ASSERT_EQ(calls.size(), 4u);
  EXPECT_EQ(calls[0].title + calls[0].text + calls[1].title + calls[1].text, "Main1FtpSetup1");
  EXPECT_EQ(calls[2].title + calls[2].text + calls[3].title + calls[3].text, "Main0FtpSetup0");

  mnuIgnore_Click(*t);
  EXPECT_TRUE(f.mnuIgnore.Checked);
  mnuIgnore_Click(*t);
  EXPECT_FALSE(f.mnuIgnore.Checked);
  EXPECT_EQ(t.platform.calls.size(), 4u);
}

TEST(Menus, ImperialUnitsScaleSpeeds) {
  TestProgram t;
  mnuUnitsItem_Click(*t, 1);
  EXPECT_DOUBLE_EQ(100 * t->UnitFactor, 62.13712);
  EXPECT_EQ(t->SpeedUnitLabel, " mph");
  mnuDistItem_Click(*t, 1);
  EXPECT_EQ(t->frmMain.Label2.Caption, "Meters");
}

TEST(EditInTextEditor, ChosenEditorOpensTheFile) {
  TestProgram t;
  t->TextEditorPath = "/usr/bin/kate";
  t->LastSourceFile = "/data/in.gpx";
  t->OutputPath = "/data/in.kml";
  t.platform.shellResults = {42};
  cmdEdit_Click(*t, 1);
  const auto shell = t.platform.CallsOf("ShellOpen");
  ASSERT_EQ(shell.size(), 1u);
  EXPECT_EQ(shell[0].title, "open");
  EXPECT_EQ(shell[0].text, "/usr/bin/kate");
  EXPECT_EQ(shell[0].parameters, "/data/in.kml");
  EXPECT_EQ(shell[0].dialog.initialFolder, "/data/in.kml");
  EXPECT_TRUE(t.platform.CallsOf("StartTextEditor").empty());
  EXPECT_EQ(t->TextEditorPath, "/usr/bin/kate");
}

TEST(EditInTextEditor, FailingEditorFallsBackAndMarksTheSetting) {
  TestProgram t;
  t->TextEditorPath = "/no/such/editor";
  t->LastSourceFile = "/data/in.gpx";
  t.platform.shellResults = {2};
  t.platform.startResults = {false};  // even the desktop's editor fails: still no message
  cmdEdit_Click(*t, 0);
  const auto editor = t.platform.CallsOf("StartTextEditor");
  ASSERT_EQ(editor.size(), 1u);
  EXPECT_EQ(editor[0].text, "/data/in.gpx");
  EXPECT_EQ(t->TextEditorPath, kNoEditorText);
  EXPECT_TRUE(t.platform.Messages().empty());

  // The marker text is no editor: straight to the desktop's one.
  cmdEdit_Click(*t, 0);
  EXPECT_EQ(t.platform.CallsOf("ShellOpen").size(), 1u);
  EXPECT_EQ(t.platform.CallsOf("StartTextEditor").size(), 2u);
}

TEST(EditInTextEditor, EmptyPathMeansTheDesktopDefault) {
  TestProgram t;
  t->TextEditorPath = "";
  t->LastSourceFile = "/data/in.gpx";
  cmdEdit_Click(*t, 0);
  EXPECT_TRUE(t.platform.CallsOf("ShellOpen").empty());
  const auto editor = t.platform.CallsOf("StartTextEditor");
  ASSERT_EQ(editor.size(), 1u);
  EXPECT_EQ(editor[0].text, "/data/in.gpx");
  EXPECT_EQ(t->TextEditorPath, "");
}

TEST(ClearTrack, AsksFirst) {
  TestProgram t;
  t.AddPoint(1, 2, "2026-12-01T10:00:00Z");
  t.AddPoint(1.1, 2, "2026-12-01T10:01:00Z");
  t.platform.msgAnswers = {kAnswerCancel, kAnswerOK};
  cmdClearTrack_Click(*t);
  EXPECT_EQ(t->Track.PointCount, 2);
  cmdClearTrack_Click(*t);
  EXPECT_EQ(t->Track.PointCount, 0);
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 2u);
  EXPECT_EQ(boxes[0].text, "Are you sure?");
  EXPECT_EQ(boxes[0].title, " Delete track data");
  EXPECT_EQ(boxes[0].buttons, MsgButtons::OKCancel);
  EXPECT_EQ(boxes[0].icon, MsgIcon::Exclamation);
}

TEST(HelpMenu, HelpOnlineOrLocal) {
  TestProgram t;
  t.platform.internet = true;
  mnuHelpItem_Click(*t, 0);
  t.platform.internet = false;
  mnuHelpItem_Click(*t, 0);
  const auto shell = t.platform.CallsOf("ShellOpen");
  ASSERT_EQ(shell.size(), 2u);
  EXPECT_EQ(shell[0].title, "open");
  EXPECT_EQ(shell[0].text, kOnlineHelpPage);
  EXPECT_EQ(shell[1].title, "open");
  const std::string folder = std::filesystem::absolute(t.folder.path()).string();
  EXPECT_EQ(shell[1].text, "file://" + folder + "/Help/MolvarHelp.html");
}

TEST(HelpMenu, LocalGuideIsShippedAndParses) {
  const std::string guide = std::string(MOLVAR_RESOURCE_DIR) + "/Help/MolvarHelp.html";
  ASSERT_TRUE(std::filesystem::exists(guide));
  int rc = -1;
  const std::string complaints = testing::RunCommand("xmllint --html --noout '" + guide + "' 2>&1", &rc);
  EXPECT_EQ(rc, 0);
  EXPECT_EQ(complaints, "");
  const std::string text = ReadFile(guide);
  EXPECT_NE(text.find("not yet available in this version"), std::string::npos);
  EXPECT_NE(text.find("molvar-convert"), std::string::npos);
}

TEST(HelpMenu, UpdatesTutorialAndSeparator) {
  TestProgram t;
  mnuHelpItem_Click(*t, 2);
  mnuHelpItem_Click(*t, 3);
  mnuHelpItem_Click(*t, 4);
  const auto shell = t.platform.CallsOf("ShellOpen");
  ASSERT_EQ(shell.size(), 2u);
  EXPECT_EQ(shell[0].text, kHomePage);
  EXPECT_EQ(shell[1].text, kKmlTutorialPage);
  EXPECT_EQ(shell[0].title, "open");
  EXPECT_EQ(t.platform.calls.size(), 2u);
}

TEST(HelpMenu, AboutShowsBuildDateAndVersion) {
  TestProgram t;
  t.platform.programDate = "2026-11-30";
  mnuHelpItem_Click(*t, 5);
  t.platform.programDate = "";
  mnuHelpItem_Click(*t, 5);
  const auto boxes = t.platform.Messages();
  ASSERT_EQ(boxes.size(), 2u);
  EXPECT_EQ(boxes[0].title, " Molvar");
  EXPECT_EQ(boxes[0].buttons, MsgButtons::OK);
  EXPECT_EQ(boxes[0].text,
            "Molvar - 2026-11-30\n\nVersion number 17.0\n\nPerfecting software - one glitch at a time!");
  EXPECT_EQ(boxes[1].text,
            "Molvar - not found\n\nVersion number 17.0\n\nPerfecting software - one glitch at a time!");
}

TEST(Shutdown, WritesSettingsAndTrackData) {
  TestProgram t;
  t.AddPoint(-45.5, 170.25, "2026-12-01T10:00:00Z");
  t.AddPoint(-45.6, 170.25, "2026-12-01T10:05:00Z");
  t->OutputPath = t.folder.File("trip.kml");
  Form_Unload(*t);
  const std::string ini = ReadFile(t.folder.File("Molvar.ini"));
  EXPECT_NE(ini.find("NOCALL"), std::string::npos);
  const std::string data = ReadFile(t.folder.File("TrackData.txt"));
  EXPECT_NE(data.find("2026-12-01T10:00:00Z"), std::string::npos);
  EXPECT_EQ(data.substr(0, 2), "\r\n");  // no source file yet: an empty first line
  EXPECT_NE(data.find(t->OutputPath + "\r\n"), std::string::npos);
  EXPECT_NE(data.find("-45.5,170.25,"), std::string::npos);
  EXPECT_NE(data.find("-45.6,170.25,"), std::string::npos);
}

TEST(Start, LoadsTheStoredModeAndVersion) {
  TestProgram t;
  t->VersionText = "";
  t->frmMain.mnuUnitsItem(2).Checked = false;
  mnuUnitsItem_Click(*t, 2);
  t->IconHintAnswer = kAnswerNo;
  mnuModeItem_Click(*t, 2);
  Form_Unload(*t);

  TestProgram again;
  std::filesystem::copy_file(t.folder.File("Molvar.ini"), again.folder.File("Molvar.ini"));
  again->VersionText = "";
  Form_Load(*again);
  EXPECT_EQ(again->VersionText, "17.0");
  EXPECT_EQ(again->ProgramMode, 2);
  EXPECT_TRUE(again->frmMain.mnuModeItem(2).Checked);
  EXPECT_TRUE(again->frmMain.mnuUnitsItem(2).Checked);
  EXPECT_EQ(again->SpeedUnitLabel, " kts");
}

TEST(RefreshRate, RewritesTheLinkFileAndReopensLiveOutput) {
  TestProgram t;
  t->frmMain.txtGErefresh.Text = "7";
  txtGErefresh_Change(*t);
  const std::string link = ReadFile(t.folder.File("gps.kml"));
  EXPECT_NE(link.find("<refreshInterval>7</refreshInterval>"), std::string::npos);
  EXPECT_TRUE(t.platform.CallsOf("StartProgram").empty());

  t->OutputName = "nmea.kml";
  t->frmMain.txtGErefresh.Text = "15";
  t.platform.startResults = {false};  // Google Earth missing: no message, the file is written
  txtGErefresh_Change(*t);
  EXPECT_NE(ReadFile(t.folder.File("gps.kml")).find("<refreshInterval>15</refreshInterval>"), std::string::npos);
  const auto starts = t.platform.CallsOf("StartProgram");
  ASSERT_EQ(starts.size(), 1u);
  EXPECT_EQ(starts[0].text, t->GoogleEarthPath + " \"" + t.folder.File("gps.kml") + "\"");
  EXPECT_TRUE(t.platform.Messages().empty());
}

}  // namespace
}  // namespace molvar
