#include "app/MainWindow.h"

#include <filesystem>

#include "app/Molvar.h"
#include "app/Options.h"
#include "app/Settings.h"
#include "input/TrackReader.h"
#include "input/Waypoints.h"
#include "output/Dispatch.h"
#include "output/kml/LiveFiles.h"

namespace molvar {
namespace {

void BringToFront(MainForm& f, Frame& front) {
  for (Frame* frame : {&f.TrackFrame, &f.WptFrame, &f.GpsTrackFrame, &f.GpsNmeaFrame, &f.WebpageFrame, &f.AgwFrame})
    frame->InFront = frame == &front;
}

void EnableSplitColors(MainForm& f, bool enabled) {
  for (auto& [i, box] : f.chkSplitColor.Items()) box.Enabled = enabled;
}

void EnableNorthUp(MainForm& f, bool enabled) {
  for (auto& [i, option] : f.optNorthUp.Items()) option.Enabled = enabled;
}

// What every mode starts from, so no state of the previous mode survives but the option values.
void ResetModeControls(Molvar& m) {
  MainForm& f = m.frmMain;
  m.Aprs.NearestMode = 0;
  f.txtTest.Text.clear();
  f.txtInfo.Text.clear();
  f.TrkTimer.Enabled = false;
  f.cmdOpen.Enabled = false;
  for (Control* c : std::initializer_list<Control*>{
           &f.chkAuto, &f.chkCollapse, &f.chkDetailed, &f.txtHeading, &f.cmdSetColor, &f.chkUseThreshold,
           &f.txtSpeedThreshold, &f.chkUseSplit, &f.txtSpltCount, &f.chkSplitIfStopped, &f.sldrWidth,
           &f.chkStartFinish, &f.chkFastest, &f.cmdDisplayArray, &f.cmdRefresh, &f.OptionsFrame})
    c->Enabled = true;
  EnableSplitColors(f, true);
  f.AltLabel.Visible = false;
  f.cmdViewInBrowser.Enabled = false;
  EnableNorthUp(f, false);
  // The serial port of the GPS modes closes here once it exists (step of the GPS link).
  f.cmdSetColor.ToolTipText = " Also starting color if either \"Vary\" checked ";
}

void EnterWaypointMode(Molvar& m) {
  MainForm& f = m.frmMain;
  // Through the list's own handler, so the speed-gain slider follows the new mode.
  if (m.AltitudeMode == 3) SelectAltitudeMode(m, 2);
  f.window.Caption = " Molvar - Convert Waypoints ";
  if (m.Waypoints.WptCount == 0) f.cmdRefresh.Enabled = false;
  for (Control* c : std::initializer_list<Control*>{&f.cmdSetColor, &f.chkUseThreshold, &f.txtSpeedThreshold,
                                                    &f.chkUseSplit, &f.txtSpltCount, &f.chkCollapse, &f.sldrWidth,
                                                    &f.chkDetailed, &f.chkStartFinish, &f.chkFastest})
    c->Enabled = false;
  EnableSplitColors(f, false);
  BringToFront(f, f.WptFrame);
  if (m.AltitudeMode > 0) f.AltLabel.Visible = true;
}

void EnterRealTimeMode(Molvar& m) {
  MainForm& f = m.frmMain;
  f.cmdDisplayArray.Enabled = false;
  f.window.Caption = " Molvar - Real-time Location (NMEA mode) ";
  f.cmdSetColor.ToolTipText = " Track color is fixed in NMEA mode ";
  BringToFront(f, f.GpsNmeaFrame);
  EnableSplitColors(f, false);
  f.chkCollapse.Enabled = false;
  for (auto& [i, box] : f.chkSplitColor.Items()) box.Value = 0;
  f.chkCollapse.Value = 0;
  ApplySplitColor(m, 0);
  ApplyCollapse(m);
  for (Control* c : std::initializer_list<Control*>{&f.chkSplitIfStopped, &f.txtHeading, &f.chkAuto, &f.chkUseSplit,
                                                    &f.txtSpltCount})
    c->Enabled = false;
  EnableNorthUp(f, true);
  if (m.IconHintAnswer != kAnswerNo) {
    m.IconHintAnswer = static_cast<int16_t>(m.platform.MsgBox(
        "In NMEA mode, the icon is rotated to indicate heading.\r\nChoose an arrow for an icon (palettes 3 or "
        "4).\r\n\r\nShow this message next time?",
        " Icon selection...", MsgButtons::YesNo, MsgIcon::Information));
  }
}

void EnterAgwMode(Molvar& m) {
  MainForm& f = m.frmMain;
  f.window.Caption = " AGW Packet Engine ";
  BringToFront(f, f.AgwFrame);
  // The AGW station tracking starts here once the engine link exists.
  for (CheckBox* box : {&f.chkDetailed, &f.chkCollapse, &f.chkSplitIfStopped, &f.chkAuto}) box->Value = 0;
  ApplyDetailed(m);
  ApplyCollapse(m);
  ApplySplitIfStopped(m);
  ApplyAutoOpen(m);
  for (Control* c : std::initializer_list<Control*>{&f.cmdOpen, &f.chkAuto, &f.OptionsFrame, &f.chkDetailed})
    c->Enabled = false;
}

}  // namespace

void mnuModeItem_Click(Molvar& m, int index) {
  MainForm& f = m.frmMain;
  if (!f.mnuModeItem.Has(index)) return;
  m.ProgramMode = static_cast<int16_t>(index);
  ResetModeControls(m);
  CheckProgramModeItem(m, index);
  switch (index) {
    case kModeConvertTracks:
      f.window.Caption = " Molvar - Convert Tracks ";
      BringToFront(f, f.TrackFrame);
      break;
    case kModeConvertWaypoints: EnterWaypointMode(m); break;
    case kModeGarmin:
      f.window.Caption = " Molvar - Download Garmin Track ";
      BringToFront(f, f.GpsTrackFrame);
      break;
    case kModeRealTimeNmea: EnterRealTimeMode(m); break;
    case kModeAprsWeb:
      f.window.Caption = " Molvar - Download Track from Findu ";
      BringToFront(f, f.WebpageFrame);
      EnableNorthUp(f, true);
      break;
    default: EnterAgwMode(m); break;
  }
}

void mnuOutputMode_Click(Molvar& m, int index) { SelectOutputMode(m, index); }

void comboAltitude_Click(Molvar& m) { SelectAltitudeMode(m, m.frmMain.comboAltitude.ListIndex); }
void comboTrackFileType_Click(Molvar& m) { SelectTrackFileType(m, m.frmMain.comboTrackFileType.ListIndex); }

void chkAuto_Click(Molvar& m) {
  ApplyAutoOpen(m);
  if (m.frmMain.chkAuto.Checked() && !m.OutputPath.empty()) OpenOutput(m);
}

void chkCollapse_Click(Molvar& m) { ApplyCollapse(m); }
void chkSplitIfStopped_Click(Molvar& m) { ApplySplitIfStopped(m); }
void chkDetailed_Click(Molvar& m) { ApplyDetailed(m); }
void chkUseFilename_Click(Molvar& m) { ApplyUseFilename(m); }
void chkSplitColor_Click(Molvar& m, int index) { ApplySplitColor(m, index); }
void optWptTitle_Click(Molvar& m, int index) { SelectWptTitle(m, index); }
void optNorthUp_Click(Molvar& m, int index) { SelectNorthUp(m, index); }
void optWptFileType_Click(Molvar& m, int index) { SelectWptFileType(m, index); }
void sldrGain_Change(Molvar& m) { ApplyGain(m); }
void sldrFade_Change(Molvar& m) { ApplyFade(m); }
void txtGMT_Change(Molvar& m) { ApplyGmtText(m); }

void txtGErefresh_Change(Molvar& m) {
  WriteGpsLinkFile(m);
  if (m.OutputName != "nmea.kml") return;
  try {
    m.platform.StartProgram(m.GoogleEarthPath + " \"" + m.ProgramPath("gps.kml") + "\"");
  } catch (const std::exception&) {
    // Google Earth not found: the link file is written and "Open in GE" can locate the program.
  }
}

void mnuOnTop_Click(Molvar& m) {
  MenuItem& item = m.frmMain.mnuOnTop;
  item.Checked = !item.Checked;
  m.frmMain.window.TopMost = item.Checked;
  m.frmFtpSetup.window.TopMost = item.Checked;
  m.platform.SetTopMost(WindowId::Main, item.Checked);
  m.platform.SetTopMost(WindowId::FtpSetup, item.Checked);
}

void mnuIgnore_Click(Molvar& m) { m.frmMain.mnuIgnore.Checked = !m.frmMain.mnuIgnore.Checked; }
void mnuComNumber_Click(Molvar& m, int number) { SelectComPort(m, number); }
void mnuComBaud_Click(Molvar& m, int index) { SelectBaudRate(m, index); }
void mnuUnitsItem_Click(Molvar& m, int index) { SelectSpeedUnits(m, index); }
void mnuDistItem_Click(Molvar& m, int index) { SelectAltitudeUnits(m, index); }

void mnuHelpItem_Click(Molvar& m, int index) {
  std::string buildDate = m.platform.ProgramFileDate();
  if (buildDate.empty()) buildDate = "not found";
  switch (index) {
    case 0:
      if (m.platform.InternetAvailable()) {
        m.platform.ShellOpen("open", kOnlineHelpPage, "", "");
      } else {
        // A file address needs an absolute path; the program folder may be given relative.
        const std::string local = m.ProgramPath("Help/MolvarHelp.html");
        std::error_code error;
        const auto file = std::filesystem::absolute(local, error);
        m.platform.ShellOpen("open", "file://" + (error ? local : file.string()), "", "");
      }
      return;
    case 2: m.platform.ShellOpen("open", kHomePage, "", ""); return;
    case 3: m.platform.ShellOpen("open", kKmlTutorialPage, "", ""); return;
    case 5:
      m.platform.MsgBox("Molvar - " + buildDate + "\n\nVersion number " + m.VersionText +
                            "\n\nPerfecting software - one glitch at a time!",
                        " Molvar", MsgButtons::OK, MsgIcon::Information);
      return;
    default: return;
  }
}

void cmdReadTrackFile_Click(Molvar& m) { ReadTrackFile(m, false); }
void cmdReadWptFile_Click(Molvar& m) { ReadWaypointFile(m, false); }
void cmdOpen_Click(Molvar& m) { OpenOutput(m); }
void cmdRefresh_Click(Molvar& m) { RefreshOutput(m); }

void cmdEdit_Click(Molvar& m, int index) {
  const std::string& file = index == 0 ? m.LastSourceFile : m.OutputPath;
  // An editor of the user's choice first; without one (or when it fails) the desktop's own.
  const bool chosen = !m.TextEditorPath.empty() && m.TextEditorPath != kNoEditorText;
  if (chosen && m.platform.ShellOpen("open", m.TextEditorPath, file, file) > kShellStarted) return;
  try {
    m.platform.StartTextEditor(file);
  } catch (const std::exception&) {
    // No message: the edit simply does not happen.
  }
  if (chosen) m.TextEditorPath = kNoEditorText;
}

void cmdClearTrack_Click(Molvar& m) {
  if (m.platform.MsgBox("Are you sure?", " Delete track data", MsgButtons::OKCancel, MsgIcon::Exclamation) ==
      kAnswerOK)
    ClearTrackStore(m.Track, m.Nmea);
}

void Form_Load(Molvar& m) {
  m.VersionText = kVersionText;
  LoadSettings(m);
}

void Form_Unload(Molvar& m) {
  SaveSettings(m);
  m.AgwpeFile.close();
  SaveTrackData(m);
  // The AGW connection, the serial port and the FTP session close here once they exist.
}

}  // namespace molvar
