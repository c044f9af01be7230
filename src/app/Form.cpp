#include "app/Form.h"

namespace molvar {
namespace {

template <typename T>
T& Init(T& c, std::string caption, std::string tip) {
  c.Caption = std::move(caption);
  c.ToolTipText = std::move(tip);
  return c;
}

template <typename T>
void AddEntries(std::vector<ControlEntry>& out, const char* name, ControlArray<T>& array) {
  for (auto& [i, c] : array.Items()) out.push_back({name, i, &c});
}

template <typename T>
void AddEntry(std::vector<ControlEntry>& out, const char* name, T& c) {
  out.push_back({name, kNoIndex, &c});
}

}  // namespace

MainForm::MainForm() {
  window.Width = 11320;
  window.Height = 6600;

  comboTrackFileType.ToolTipText = " Select the file type for track conversion ";
  comboTrackFileType.List = {" Ozi Explorer",      " GPX",
                             " XML",               " NMEA (text file)",
                             " CSV (Orion Tracker - see help)", " CSV (type 2 - see help)",
                             " KML (modify existing files)",    " APRS (text file)",
                             " KEL (custom format)"};
  comboTrackFileType.ListIndex = 0;
  Init(cmdReadTrackFile, "Read track file", "");

  Init(optWptFileType.Add(0), "OziExplorer", " Select waypoint file type ").Value = true;
  Init(optWptFileType.Add(1), "GPX", " Select waypoint file type ");
  Init(optWptTitle.Add(0), "Name", " Use wpt name for placemark label ").Value = true;
  Init(optWptTitle.Add(1), "Comment", " Use wpt comment for placemark label (see help) ");
  Init(optWptTitle.Add(2), "Description", " Use wpt description for placemark label (see help) ");
  Init(cmdReadWptFile, "Read waypoint file", "");

  Init(chkSplitIfStopped, "Split if stopped", " Split track if stopped (see help) ");
  Init(optNorthUp.Add(0), "Heading up", " Rotate map so heading is up ").Value = true;
  Init(optNorthUp.Add(1), "North up", " Keep north up ");
  Init(chkDetailed, "Show details", " Show detail balloon for each track point ").Value = 1;
  Init(chkUseSplit, "Check1", " Check to enable splitting track ");
  Init(txtSpltCount, "", " Split track at this point (use \"Vary by seg.\") ");
  Init(chkUseThreshold, "Check1", " Check to enable speed threhold ");
  Init(txtSpeedThreshold, "", " Display red icon when speed exceeded ");
  Init(chkCollapse, "Collapse segments", " Make a single segment per day (see help) ");
  Init(chkSplitColor.Add(0), "Vary by seg.", " Make each track segment a different color ");
  Init(chkSplitColor.Add(1), "Vary by date", " Change track color each day ");
  Init(chkSplitColor.Add(2), "Vary by spd.", " Change track color based on status flag ");
  Init(cmdSetColor, "Track color", " Also starting color if either \"Vary\" checked ");
  Init(sldrWidth, "", " Track width in pixels ");
  sldrWidth.Min = 1;
  sldrWidth.Max = 8;
  sldrWidth.Value = 2;
  Init(sldrFade, "", " Icon and track transparency ");
  sldrFade.Min = 0;
  sldrFade.Max = 255;
  sldrFade.Value = 255;
  Init(chkBalloon, "Balloon", " Add balloon data to Finish icon (if selected) ");
  Init(chkHalfSize, "Small", " Make all icons half size ");
  Init(chkFastest, "Fastest icon", " Add an icon to the track at fastest speed ").Value = 1;
  Init(chkStartFinish, "Start/Finish", " Add a start and finish icon to the track ").Value = 1;
  Init(picAll2, "", " Click to choose an icon for the placemark ");
  Init(picMask2, "", " Click to choose an icon for the placemark ");
  Init(txtEyeAlt, "", " Eye altitude (feet or meters) ").Text = "2000";
  Init(txtHeading, "", " Heading angle (degrees) ").Text = "0";
  Init(txtTilt, "", " Tilt angle (degrees) ").Text = "45";
  Label2.Caption = "Feet";
  comboAltitude.ToolTipText = " Set how altitude is displayed relative to ground ";
  comboAltitude.List = {" Clamp track to ground", " Display track above ground", " Extrude track to ground",
                        " Show speed as altitude (extruded)"};
  comboAltitude.ListIndex = 0;
  Init(sldrGain, "", " Set gain of speed display as altitude ");
  sldrGain.Min = 1;
  sldrGain.Max = 40;
  sldrGain.Value = 20;
  lblGain.Caption = "Set speed gain";
  AltLabel.Caption = "Placemarks will appear above ground";
  AltLabel.Visible = false;
  Init(chkUseFilename, "Auto name", " Use filename for folder name ").Value = 1;
  Init(txtTitle, "", " Title of track file or folder ");
  Init(chkAuto, "Auto", " Open files automatically ").Value = 1;
  Init(txtGMT, "", " GMT offset in hours ").Text = "0";

  Init(chkGPGGA, "", "Use only GPGGA data ");
  Init(txtTrkLimit, "", " Max track length (0 for no track, 1 for no limit, see help) ").Text = "1";
  Init(txtGErefresh, "", " GE refresh rate (seconds) - 0 for never - see help ").Text = "2";
  Init(cmdConnect.Add(0), "Get track", "");
  Init(cmdConnect.Add(1), "Connect", "");
  txtComStatus.Add(0).Text = " COM status - off";
  txtComStatus.Add(1).Text = " COM status - off";
  Init(cmdID, "Garmin information", " Get Garmin device information ");
  Init(cmdTurnOff, "Turn off gps", " Turn the gps receiver off ");
  SatelliteBar.ToolTipText = " Number of satellites received ";
  SatelliteBar.Max = 12;

  Init(txtCallSign, "", " Ham radio callsign to search for ").Text = "NOCALL";
  Init(chkPollInternet, "Poll Internet", " Get latest location every 10 to 30 sec. ");
  Init(optURL.Add(0), "Findu", " Select which URL to use ").Value = true;
  Init(optURL.Add(1), "Jfindu", " Select which URL to use ");
  Init(cmdGrabNow, "Location", " Get last known position ");
  Init(cmdGrabAll, "Track", " Get track data for last 24 hrs. ");
  Init(cmdGrabNearest, "Nearest", " Display the nearest stations ");
  Init(cmdQRZlookup, "QRZ lookup", " Lookup the callsign in QRZ database ");
  Init(cmdViewInBrowser, "View in browser", "");
  Init(txtIstatus, "", " Internet status ");
  progressBar.Visible = false;

  Init(chkMoreInfo, "Add timestamp", " Add timestamp (and speed, if available) to placemark ");
  Init(chkMoving, "Moving only", " Show only those stations that are moving ");
  cmbFarCallSign.ToolTipText = " Call sign to center on in GE (leave blank to not center) ";
  Init(chkPort.Add(0), "1   Port  2", " Select one or both ports to receive on ");
  Init(chkPort.Add(1), "", " Select one or both ports to receive on ");
  Init(cmdClearData, "Clear", "");

  Init(cmdOpen, "Open in GE", " Open last output file in GoogleEarth ").Enabled = false;
  Init(cmdRefresh, "Refresh output", " Rewrite output file using current data ");
  Init(cmdEdit.Add(0), "Edit source file", "");
  Init(cmdEdit.Add(1), "Edit output file", "");
  Init(cmdClearTrack, "Clear track", " Erase all track data ");
  Init(cmdDisplayArray, "Show track array", " Display the track data array in the list box ");
  Init(cmdClearTestBox, "Clear test box", " Delete the contents of the test box ");
  Init(SendMail, "Email me", " I'm desperate for mail! ");
  txtTest.Text = "Test data appears here";
  txtTest.Visible = false;
  lblTest.Visible = false;
  cmdClearTestBox.Visible = false;
  SendMail.Visible = false;

  TrkTimer.Interval = 2000;
  NmeaTimer.Interval = 2000;
  tmrWebTimer.Interval = 100;
  tmrAgwTimer.Interval = 1000;
  ColorTimer.Interval = 20;

  TrackFrame.Caption = " Convert Tracks ";
  WptFrame.Caption = " Convert Waypoints ";
  GpsTrackFrame.Caption = " Download Garmin track ";
  GpsNmeaFrame.Caption = " Real-time Location (NMEA) ";
  WebpageFrame.Caption = " Findu ";
  AgwFrame.Caption = " Data source - AGW Packet Engine (144.390MHz) ";
  OptionsFrame.Caption = " Track options ";
  TrkPropertiesFrame.Caption = "Track Properties";
  TransparencyFrame.Caption = " Transparency ";
  GePlacemarkFrame.Caption = " Placemark and Track Icons ";
  ViewFrame.Caption = " View ";
  AltFrame.Caption = " Altitude (track and placemarks) ";
  FolderNameFrame.Caption = " Folder Name ";
  TrackFrame.InFront = true;

  const char* modes[] = {"Convert track files",       "Convert waypoint files",      "Download Garmin Track",
                         "Real-time Location (NMEA)", "Get track from Findu (APRS)", "AGW packet engine (APRS)"};
  for (int i = 0; i < 6; ++i) {
    MenuItem& m = mnuModeItem.Add(i);
    m.Caption = modes[i];
    m.Shortcut = "F" + std::to_string(i + 1);
  }
  mnuModeItem(0).Checked = true;
  mnuOutputMode.Add(0).Caption = "Output to Google Earth";
  mnuOutputMode(0).Shortcut = "F9";
  mnuOutputMode(0).Checked = true;
  mnuOutputMode.Add(1).Caption = "Send link to Google Maps";
  mnuOutputMode(1).Shortcut = "F11";
  mnuTestItem.Caption = "Enable debug mode (view input data)";
  mnuTestItem.Shortcut = "F12";
  mnuOnTop.Caption = "Keep application on top";
  mnuOnTop.Shortcut = "Ctrl+T";
  mnuIgnore.Caption = "Ignore NMEA checksum / valid flag";
  mnuIgnore.Shortcut = "Ctrl+I";
  for (int i = 1; i <= 10; ++i) mnuComNumber.Add(i).Caption = std::to_string(i);
  mnuComNumber(1).Checked = true;
  const char* bauds[] = {"4800", "9600", "19200", "38400", "57600", "115200"};
  for (int i = 0; i < 6; ++i) mnuComBaud.Add(i).Caption = bauds[i];
  mnuComBaud(0).Checked = true;
  mnuFTPsetup.Caption = "FTP setup and upload";
  mnuAutoFtp.Add(0).Caption = "Auto-ftp track data (see help)";
  mnuAutoFtp.Add(1).Caption = "Set Auto-ftp send rate";
  mnuAutoFtp(1).Enabled = false;
  mnuEmail.Caption = "Email a link to a kml file";
  mnuSig.Caption = "Set email signature";
  mnuUnitsItem.Add(0).Caption = "Metric (km/kph)";
  mnuUnitsItem.Add(1).Caption = "Imperial (miles/mph)";
  mnuUnitsItem.Add(2).Caption = "Nautical (nm/kts)";
  mnuUnitsItem(0).Checked = true;
  mnuDistItem.Add(0).Caption = "Altitude in feet";
  mnuDistItem.Add(1).Caption = "Altitude in meters";
  mnuDistItem(0).Checked = true;
  mnuHelpItem.Add(0).Caption = "Help me!";
  mnuHelpItem(0).Shortcut = "Ctrl+H";
  mnuHelpItem.Add(2).Caption = "Check for updates";
  mnuHelpItem.Add(3).Caption = "KML tutorial";
  mnuHelpItem.Add(4).Caption = "-";
  mnuHelpItem.Add(5).Caption = "About";
}

std::vector<ControlEntry> MainForm::Controls() {
  std::vector<ControlEntry> c;
  AddEntry(c, "comboTrackFileType", comboTrackFileType);
  AddEntry(c, "cmdReadTrackFile", cmdReadTrackFile);
  AddEntries(c, "optWptFileType", optWptFileType);
  AddEntries(c, "optWptTitle", optWptTitle);
  AddEntry(c, "cmdReadWptFile", cmdReadWptFile);
  AddEntry(c, "chkSplitIfStopped", chkSplitIfStopped);
  AddEntries(c, "optNorthUp", optNorthUp);
  AddEntry(c, "chkDetailed", chkDetailed);
  AddEntry(c, "chkUseSplit", chkUseSplit);
  AddEntry(c, "txtSpltCount", txtSpltCount);
  AddEntry(c, "chkUseThreshold", chkUseThreshold);
  AddEntry(c, "txtSpeedThreshold", txtSpeedThreshold);
  AddEntry(c, "chkCollapse", chkCollapse);
  AddEntries(c, "chkSplitColor", chkSplitColor);
  AddEntry(c, "cmdSetColor", cmdSetColor);
  AddEntry(c, "sldrWidth", sldrWidth);
  AddEntry(c, "sldrFade", sldrFade);
  AddEntry(c, "picSample", picSample);
  AddEntry(c, "ColorSample", ColorSample);
  AddEntry(c, "chkBalloon", chkBalloon);
  AddEntry(c, "chkHalfSize", chkHalfSize);
  AddEntry(c, "chkFastest", chkFastest);
  AddEntry(c, "chkStartFinish", chkStartFinish);
  AddEntry(c, "picAll2", picAll2);
  AddEntry(c, "picMask2", picMask2);
  AddEntry(c, "txtEyeAlt", txtEyeAlt);
  AddEntry(c, "txtHeading", txtHeading);
  AddEntry(c, "txtTilt", txtTilt);
  AddEntry(c, "Label2", Label2);
  AddEntry(c, "comboAltitude", comboAltitude);
  AddEntry(c, "sldrGain", sldrGain);
  AddEntry(c, "lblGain", lblGain);
  AddEntry(c, "AltLabel", AltLabel);
  AddEntry(c, "chkUseFilename", chkUseFilename);
  AddEntry(c, "txtTitle", txtTitle);
  AddEntry(c, "chkAuto", chkAuto);
  AddEntry(c, "txtGMT", txtGMT);
  AddEntry(c, "chkGPGGA", chkGPGGA);
  AddEntry(c, "txtTrkLimit", txtTrkLimit);
  AddEntry(c, "txtGErefresh", txtGErefresh);
  AddEntries(c, "cmdConnect", cmdConnect);
  AddEntries(c, "txtComStatus", txtComStatus);
  AddEntry(c, "txtGpsNmeaInfo", txtGpsNmeaInfo);
  AddEntry(c, "txtGpsTrkInfo", txtGpsTrkInfo);
  AddEntry(c, "cmdID", cmdID);
  AddEntry(c, "cmdTurnOff", cmdTurnOff);
  AddEntry(c, "SatelliteBar", SatelliteBar);
  AddEntry(c, "Gauge", Gauge);
  AddEntry(c, "txtCallSign", txtCallSign);
  AddEntry(c, "chkPollInternet", chkPollInternet);
  AddEntries(c, "optURL", optURL);
  AddEntry(c, "cmdGrabNow", cmdGrabNow);
  AddEntry(c, "cmdGrabAll", cmdGrabAll);
  AddEntry(c, "cmdGrabNearest", cmdGrabNearest);
  AddEntry(c, "cmdQRZlookup", cmdQRZlookup);
  AddEntry(c, "cmdViewInBrowser", cmdViewInBrowser);
  AddEntry(c, "cmdOpenBrowser", cmdOpenBrowser);
  AddEntry(c, "txtIstatus", txtIstatus);
  AddEntry(c, "progressBar", progressBar);
  AddEntry(c, "chkMoreInfo", chkMoreInfo);
  AddEntry(c, "chkMoving", chkMoving);
  AddEntry(c, "cmbFarCallSign", cmbFarCallSign);
  AddEntries(c, "chkPort", chkPort);
  AddEntry(c, "txtAGW", txtAGW);
  AddEntry(c, "cmdClearData", cmdClearData);
  AddEntry(c, "cmdOpen", cmdOpen);
  AddEntry(c, "cmdRefresh", cmdRefresh);
  AddEntries(c, "cmdEdit", cmdEdit);
  AddEntry(c, "cmdClearTrack", cmdClearTrack);
  AddEntry(c, "cmdDisplayArray", cmdDisplayArray);
  AddEntry(c, "cmdClearTestBox", cmdClearTestBox);
  AddEntry(c, "SendMail", SendMail);
  AddEntry(c, "txtInfo", txtInfo);
  AddEntry(c, "txtTest", txtTest);
  AddEntry(c, "lblTest", lblTest);
  AddEntry(c, "TrkTimer", TrkTimer);
  AddEntry(c, "NmeaTimer", NmeaTimer);
  AddEntry(c, "tmrWebTimer", tmrWebTimer);
  AddEntry(c, "tmrAgwTimer", tmrAgwTimer);
  AddEntry(c, "ColorTimer", ColorTimer);
  AddEntry(c, "TrackFrame", TrackFrame);
  AddEntry(c, "WptFrame", WptFrame);
  AddEntry(c, "GpsTrackFrame", GpsTrackFrame);
  AddEntry(c, "GpsNmeaFrame", GpsNmeaFrame);
  AddEntry(c, "WebpageFrame", WebpageFrame);
  AddEntry(c, "AgwFrame", AgwFrame);
  AddEntry(c, "OptionsFrame", OptionsFrame);
  AddEntry(c, "TrkPropertiesFrame", TrkPropertiesFrame);
  AddEntry(c, "TransparencyFrame", TransparencyFrame);
  AddEntry(c, "GePlacemarkFrame", GePlacemarkFrame);
  AddEntry(c, "ViewFrame", ViewFrame);
  AddEntry(c, "AltFrame", AltFrame);
  AddEntry(c, "FolderNameFrame", FolderNameFrame);
  AddEntries(c, "mnuModeItem", mnuModeItem);
  AddEntries(c, "mnuOutputMode", mnuOutputMode);
  AddEntry(c, "mnuTestItem", mnuTestItem);
  AddEntry(c, "mnuOnTop", mnuOnTop);
  AddEntry(c, "mnuIgnore", mnuIgnore);
  AddEntries(c, "mnuComNumber", mnuComNumber);
  AddEntries(c, "mnuComBaud", mnuComBaud);
  AddEntry(c, "mnuFTPsetup", mnuFTPsetup);
  AddEntries(c, "mnuAutoFtp", mnuAutoFtp);
  AddEntry(c, "mnuEmail", mnuEmail);
  AddEntry(c, "mnuSig", mnuSig);
  AddEntries(c, "mnuUnitsItem", mnuUnitsItem);
  AddEntries(c, "mnuDistItem", mnuDistItem);
  AddEntries(c, "mnuHelpItem", mnuHelpItem);
  return c;
}

IconSelectForm::IconSelectForm() {
  window.Caption = "Choose a palette, then an icon...";
  for (int i = 0; i < 4; ++i) optPalette.Add(i).Caption = "Palette " + std::to_string(i + 2);
  optPalette(2).Value = true;
  chkCustomIcon.Caption = "Use custom icon";
}

std::vector<ControlEntry> IconSelectForm::Controls() {
  std::vector<ControlEntry> c;
  AddEntries(c, "optPalette", optPalette);
  AddEntry(c, "chkCustomIcon", chkCustomIcon);
  AddEntry(c, "picBig", picBig);
  return c;
}

FtpSetupForm::FtpSetupForm() {}

std::vector<ControlEntry> FtpSetupForm::Controls() {
  std::vector<ControlEntry> c;
  AddEntry(c, "txtFtpInfo", txtFtpInfo);
  return c;
}

const ControlEntry* FindControl(const std::vector<ControlEntry>& controls, std::string_view name, int index) {
  for (const auto& e : controls) {
    if (e.name == name && e.index == index) return &e;
  }
  return nullptr;
}

}  // namespace molvar
