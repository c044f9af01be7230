#pragma once
// The three windows as data: every control with its caption, tooltip, initial text and state.
// Forms can list their controls by name, so the window binds widgets by objectName and the
// command line sets options by control name.
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "app/Controls.h"

namespace molvar {

using ControlRef = std::variant<CheckBox*, OptionButton*, TextBox*, ComboBox*, CommandButton*, Label*, Frame*,
                                PictureBox*, Slider*, ProgressBar*, MenuItem*, Timer*>;

struct ControlEntry {
  std::string name;
  int index = -1;  // element index of a control array, -1 for a single control
  ControlRef control;
};

inline constexpr int kNoIndex = -1;

struct MainForm {
  MainForm();
  MainForm(const MainForm&) = delete;
  MainForm& operator=(const MainForm&) = delete;

  WindowState window;

  // Track conversion
  ComboBox comboTrackFileType;
  CommandButton cmdReadTrackFile;
  // Waypoint conversion
  ControlArray<OptionButton> optWptFileType;
  ControlArray<OptionButton> optWptTitle;
  CommandButton cmdReadWptFile;

  // Track options
  CheckBox chkSplitIfStopped;
  ControlArray<OptionButton> optNorthUp;
  CheckBox chkDetailed;
  CheckBox chkUseSplit;
  TextBox txtSpltCount;
  CheckBox chkUseThreshold;
  TextBox txtSpeedThreshold;
  CheckBox chkCollapse;
  ControlArray<CheckBox> chkSplitColor;
  CommandButton cmdSetColor;
  Slider sldrWidth;
  Slider sldrFade;
  PictureBox picSample;
  PictureBox ColorSample;
  CheckBox chkBalloon;
  CheckBox chkHalfSize;
  CheckBox chkFastest;
  CheckBox chkStartFinish;
  PictureBox picAll2;
  PictureBox picMask2;
  TextBox txtEyeAlt;
  TextBox txtHeading;
  TextBox txtTilt;
  Label Label2;
  ComboBox comboAltitude;
  Slider sldrGain;
  Label lblGain;
  Label AltLabel;
  CheckBox chkUseFilename;
  TextBox txtTitle;
  CheckBox chkAuto;
  TextBox txtGMT;

  // Real-time NMEA and Garmin
  CheckBox chkGPGGA;
  TextBox txtTrkLimit;
  TextBox txtGErefresh;
  ControlArray<CommandButton> cmdConnect;
  ControlArray<TextBox> txtComStatus;
  TextBox txtGpsNmeaInfo;
  TextBox txtGpsTrkInfo;
  CommandButton cmdID;
  CommandButton cmdTurnOff;
  ProgressBar SatelliteBar;
  ProgressBar Gauge;

  // APRS web lookup
  TextBox txtCallSign;
  CheckBox chkPollInternet;
  ControlArray<OptionButton> optURL;
  CommandButton cmdGrabNow;
  CommandButton cmdGrabAll;
  CommandButton cmdGrabNearest;
  CommandButton cmdQRZlookup;
  CommandButton cmdViewInBrowser;
  CommandButton cmdOpenBrowser;
  TextBox txtIstatus;
  ProgressBar progressBar;

  // AGW Packet Engine
  CheckBox chkMoreInfo;
  CheckBox chkMoving;
  ComboBox cmbFarCallSign;
  ControlArray<CheckBox> chkPort;
  TextBox txtAGW;
  CommandButton cmdClearData;

  // Common buttons and displays
  CommandButton cmdOpen;
  CommandButton cmdRefresh;
  ControlArray<CommandButton> cmdEdit;
  CommandButton cmdClearTrack;
  CommandButton cmdDisplayArray;
  CommandButton cmdClearTestBox;
  CommandButton SendMail;
  TextBox txtInfo;
  TextBox txtTest;
  Label lblTest;

  // Timers
  Timer TrkTimer;
  Timer NmeaTimer;
  Timer tmrWebTimer;
  Timer tmrAgwTimer;
  Timer ColorTimer;

  // Mode frames and option frames
  Frame TrackFrame;
  Frame WptFrame;
  Frame GpsTrackFrame;
  Frame GpsNmeaFrame;
  Frame WebpageFrame;
  Frame AgwFrame;
  Frame OptionsFrame;
  Frame TrkPropertiesFrame;
  Frame TransparencyFrame;
  Frame GePlacemarkFrame;
  Frame ViewFrame;
  Frame AltFrame;
  Frame FolderNameFrame;

  // Menus
  ControlArray<MenuItem> mnuModeItem;
  ControlArray<MenuItem> mnuOutputMode;
  MenuItem mnuTestItem;
  MenuItem mnuOnTop;
  MenuItem mnuIgnore;
  ControlArray<MenuItem> mnuComNumber;
  ControlArray<MenuItem> mnuComBaud;
  MenuItem mnuFTPsetup;
  ControlArray<MenuItem> mnuAutoFtp;
  MenuItem mnuEmail;
  MenuItem mnuSig;
  ControlArray<MenuItem> mnuUnitsItem;
  ControlArray<MenuItem> mnuDistItem;
  ControlArray<MenuItem> mnuHelpItem;

  std::vector<ControlEntry> Controls();
};

struct IconSelectForm {
  IconSelectForm();
  IconSelectForm(const IconSelectForm&) = delete;
  IconSelectForm& operator=(const IconSelectForm&) = delete;

  WindowState window;
  ControlArray<OptionButton> optPalette;
  CheckBox chkCustomIcon;
  PictureBox picBig;
  // Cell marker of the chosen and of the hovered cell, in palette pixels.
  int MarkerX = 0, MarkerY = 0, HoverX = 0, HoverY = 0;

  std::vector<ControlEntry> Controls();
};

struct FtpSetupForm {
  FtpSetupForm();
  FtpSetupForm(const FtpSetupForm&) = delete;
  FtpSetupForm& operator=(const FtpSetupForm&) = delete;

  WindowState window;
  TextBox txtFtpInfo;  // the window's information line

  std::vector<ControlEntry> Controls();
};

// The control of that name and index, or nullptr.
const ControlEntry* FindControl(const std::vector<ControlEntry>& controls, std::string_view name, int index);

}  // namespace molvar
