#include "app/Settings.h"

#include <array>
#include <filesystem>
#include <initializer_list>
#include <cerrno>
#include <cstdio>
#include <memory>
#include <string_view>
#include <vector>

#include "app/MainWindow.h"
#include "app/Molvar.h"
#include "app/Options.h"
#include "core/Numbers.h"
#include "core/Text.h"

namespace molvar {
namespace {

const std::array<std::string, kSettingsLineCount> kLabels = {
    "00 program version no.   = ", "01 input track path      = ", "02 input waypoint path   = ",
    "03 output track path     = ", "04 output placemark path = ", "05 text editor path      = ",
    "06 GoogleEarth path      = ", "07 random color per seg? = ", "08 random color per day? = ",
    "09 user color pointer    = ", "10 track title           = ", "11 altitude mode         = ",
    "12 comment for title?    = ", "13 filename for title?   = ", "14 use custom icon?      = ",
    "15 eye altitude          = ", "16 heading               = ", "17 tilt angle            = ",
    "18 com port number       = ", "19 Baud rate index       = ", "20 refresh rate          = ",
    "21 icon palette number   = ", "22 icon X                = ", "23 icon Y                = ",
    "24 mode selection        = ", "25 window pos. (left)    = ", "26 window pos. (top)     = ",
    "27 keep north up?        = ", "28 show icon info box?   = ", "29 GMT offset (hours)    = ",
    "30 collapse track seg.?  = ", "31 display fastest icon? = ", "32 auto open files?      = ",
    "33 start/finish icons?   = ", "34 track width in pixels = ", "35 transparency level    = ",
    "36 show track detail?    = ", "37 speed/altitude gain   = ", "38 Ham radio callsign    = ",
    "39 Units (kph/mph/kts)   = ", "40 Units (feet/meters)   = ", "41 Icon half size        = ",
    "42 Track file type       = ", "43 Waypoint file type    = ", "44 Split if stopped      = ",
    "45 reserved              = ", "46 track length limit    = ", "47 keep program on top   = ",
    "48 ignore checksum/flag  = ", "49 balloon data?         = ", "50 AGW plot moving only  = ",
    "51 output mode (GE/Gmap) = ", "52 FTP setup - username  = ", "53 FTP setup - password  = ",
    "54 FTP setup - URL       = ", "55 FTP setup - directory = ", "56 FTP setup - HTTP path = ",
    "57 FTP auto-ftp NMEA?    = ", "58 FTP upload rate       = ", "59 Email signature       = ",
    "60 AGW timestamp         = ", "61 AGW port 1            = ", "62 AGW port 2            = ",
    "63 diff. color per flag? = ", "64 use GPGGA flag?       = ",
};

constexpr const char* kCrLf = "\r\n";

// Reads a whole file. 0 when read, else the errno of the failure (ENOENT for a missing file).
int ReadWholeFile(const std::string& path, std::string& content) {
  content.clear();
  std::unique_ptr<std::FILE, int (*)(std::FILE*)> f(std::fopen(path.c_str(), "rb"), &std::fclose);
  if (!f) return errno != 0 ? errno : EIO;
  std::array<char, 65536> buf{};
  for (;;) {
    const std::size_t n = std::fread(buf.data(), 1, buf.size(), f.get());
    content.append(buf.data(), n);
    if (n < buf.size()) break;
  }
  if (std::ferror(f.get())) return errno != 0 ? errno : EIO;
  return 0;
}

// Lines end in CR LF, a bare LF or a bare CR; a last line without an end still counts.
std::vector<std::string_view> SplitLines(std::string_view s) {
  std::vector<std::string_view> lines;
  std::size_t start = 0;
  for (std::size_t i = 0; i < s.size(); ++i) {
    if (s[i] != '\r' && s[i] != '\n') continue;
    lines.push_back(s.substr(start, i - start));
    if (s[i] == '\r' && i + 1 < s.size() && s[i + 1] == '\n') ++i;
    start = i + 1;
  }
  if (start < s.size()) lines.push_back(s.substr(start));
  return lines;
}

// The value of a settings line: from two characters after its first "=" (the blank of the label
// is skipped). Without "=" it is the line from its second character on.
std::string_view SettingValueOf(std::string_view line) {
  const std::size_t eq = line.find('=');
  const std::size_t from = eq == std::string_view::npos ? 1 : eq + 2;
  return from < line.size() ? line.substr(from) : std::string_view{};
}

int16_t ReadInt(std::string_view v) {
  double d = 0;
  if (!TryParseNumber(v, d)) throw RuntimeError(kErrTypeMismatch);
  return FloorToInt16(d);
}

int16_t ReadRound(std::string_view v) { return RoundToInt16(ToNumber(v)); }

bool ReadBool(std::string_view v) {
  const std::string t = LCase(Trim(std::string(v)));
  if (t == "true") return true;
  if (t == "false") return false;
  double d = 0;
  if (!TryParseNumber(v, d)) throw RuntimeError(kErrTypeMismatch);
  return d != 0;
}

// An index is kept only inside its range; outside it the line counts as not there.
void StoreIndex(int16_t v, int lo, int hi, int16_t& target) {
  if (v >= lo && v <= hi) target = v;
}

// A check box line: 0 or 1 is restored (anything else leaves the default) and the box's own
// handler runs when the value changed, as a click would.
// Returns whether the value changed.
bool StoreCheck(Molvar& m, double v, CheckBox& box, void (*onClick)(Molvar&) = nullptr) {
  if (v != 0 && v != 1) return false;
  const int value = v == 1 ? 1 : 0;
  if (box.Value == value) return false;
  box.Value = value;
  if (onClick) onClick(m);
  return true;
}

void StoreSplitColor(Molvar& m, double v, int index) {
  if (StoreCheck(m, v, m.frmMain.chkSplitColor(index))) ApplySplitColor(m, index);
}

std::string_view BoolText(bool b) { return b ? "True" : "False"; }

// A text value must stay on its own line, or every later setting would be read at the wrong line.
std::string OneLine(std::string s) {
  for (char& c : s) {
    if (c == '\r' || c == '\n') c = ' ';
  }
  return s;
}

// Out of line: GCC 12 warns falsely (-Wrestrict) about literal assignments to strings once they
// are inlined.
[[gnu::noinline]] void SetText(std::string& s, std::string_view v) { s.assign(v); }

void ApplySettingDefaults(Molvar& m) {
  auto& f = m.frmMain;
  const std::string samples = m.ProgramPath("Samples");
  m.InputTrackPath = samples;
  m.InputWaypointPath = samples;
  m.OutputTrackPath = samples;
  m.OutputPlacemarkPath = samples;
  SetText(m.TextEditorPath, "");
  SetText(m.GoogleEarthPath, "/opt/google/earth/pro/google-earth-pro");
  SetText(m.AgwProgramPath, "C:\\Program Files\\Agw\\AGW Packet Engine.exe");
  f.chkSplitColor(0).Value = 0;
  f.chkSplitColor(1).Value = 0;
  f.chkSplitColor(2).Value = 0;
  m.ColorVaryMode = 0;
  m.UserColorPointer = 0;
  f.txtTitle.Text.clear();
  m.AltitudeMode = 0;
  m.PlacemarkLabelSource = 0;
  f.chkUseFilename.Value = 1;
  ApplyUseFilename(m);
  m.frmIconSelect.chkCustomIcon.Value = 0;
  SetText(f.txtEyeAlt.Text, "2000");
  SetText(f.txtHeading.Text, "0");
  SetText(f.txtTilt.Text, "45");
  m.ComPortNumber = 1;
  m.BaudRateIndex = 0;
  SetText(f.txtGErefresh.Text, "2");
  m.IconPalette = 2;
  m.IconX = 192;
  m.IconY = 32;
  m.ProgramMode = kModeConvertTracks;
  f.window.Left = 0;
  f.window.Top = 0;
  m.NorthUp = 0;
  m.IconHintAnswer = 0;
  SetText(f.txtGMT.Text, "0");
  ApplyGmtText(m);
  f.chkCollapse.Value = 0;
  ApplyCollapse(m);
  f.chkFastest.Value = 1;
  f.chkAuto.Value = 1;
  m.AutoOpen = 1;
  f.chkStartFinish.Value = 1;
  f.sldrWidth.Set(2);
  m.TransparencyLevel = 255;
  f.chkDetailed.Value = 1;
  ApplyDetailed(m);
  f.sldrGain.Set(20);
  SetText(f.txtCallSign.Text, "NOCALL");
  m.SpeedUnits = 0;
  m.AltitudeUnits = 0;
  f.chkHalfSize.Value = 0;
  m.TrackFileType = 0;
  m.WptFileType = 0;
  f.chkSplitIfStopped.Value = 0;
  ApplySplitIfStopped(m);
  SetText(f.txtTrkLimit.Text, "1");
  f.mnuOnTop.Checked = false;
  f.mnuIgnore.Checked = false;
  f.chkBalloon.Value = 0;
  f.chkMoving.Value = 0;
  m.OutputMode = kOutputGoogleEarth;
  m.FtpUserName.clear();
  m.FtpPassword.clear();
  m.FtpServer.clear();
  m.FtpDirectory.clear();
  m.FtpHttpPath.clear();
  f.mnuAutoFtp(0).Checked = false;
  m.FtpUploadRate = 0;
  m.EmailSignature.clear();
  f.chkMoreInfo.Value = 0;
  f.chkPort(0).Value = 0;
  f.chkPort(1).Value = 0;
  f.chkGPGGA.Value = 0;
}

// Converts and stores the value of settings line k; throws RuntimeError (13, 6) for a value that
// its line cannot hold.
void StoreSetting(Molvar& m, int k, std::string_view v) {
  auto& f = m.frmMain;
  const std::string text(v);
  switch (k) {
    case 0: break;  // version of the program that wrote the file
    case 1: m.InputTrackPath = text; break;
    case 2: m.InputWaypointPath = text; break;
    case 3: m.OutputTrackPath = text; break;
    case 4: m.OutputPlacemarkPath = text; break;
    case 5: m.TextEditorPath = text; break;
    case 6: m.GoogleEarthPath = text; break;
    case 7: StoreSplitColor(m, ReadInt(v), 0); break;
    case 8: StoreSplitColor(m, ReadInt(v), 1); break;
    case 9: StoreIndex(ReadInt(v), 0, 9, m.UserColorPointer); break;
    case 10: f.txtTitle.Text = text; break;
    case 11: StoreIndex(ReadInt(v), 0, 3, m.AltitudeMode); break;
    case 12: StoreIndex(ReadInt(v), 0, 2, m.PlacemarkLabelSource); break;
    case 13: StoreCheck(m, ReadInt(v), f.chkUseFilename, &ApplyUseFilename); break;
    case 14: StoreCheck(m, ReadInt(v), m.frmIconSelect.chkCustomIcon); break;
    case 15: f.txtEyeAlt.Text = text; break;
    case 16: f.txtHeading.Text = text; break;
    case 17: f.txtTilt.Text = text; break;
    case 18: StoreIndex(ReadInt(v), 1, 10, m.ComPortNumber); break;
    case 19: StoreIndex(ReadInt(v), 0, 5, m.BaudRateIndex); break;
    case 20: f.txtGErefresh.Text = text; break;
    case 21: m.IconPalette = ReadInt(v); break;
    case 22: m.IconX = ReadInt(v); break;
    case 23: m.IconY = ReadInt(v); break;
    case 24: StoreIndex(ReadInt(v), 0, 5, m.ProgramMode); break;
    case 25: f.window.Left = ReadInt(v); break;
    case 26: f.window.Top = ReadInt(v); break;
    case 27: StoreIndex(ReadInt(v), 0, 1, m.NorthUp); break;
    case 28: m.IconHintAnswer = ReadInt(v); break;
    case 29:
      f.txtGMT.Text = text;
      ApplyGmtText(m);
      break;
    case 30: StoreCheck(m, ReadInt(v), f.chkCollapse, &ApplyCollapse); break;
    case 31: StoreCheck(m, ReadInt(v), f.chkFastest); break;
    case 32: StoreCheck(m, ReadInt(v), f.chkAuto); break;
    case 33: StoreCheck(m, ReadInt(v), f.chkStartFinish); break;
    case 34: f.sldrWidth.Set(ReadInt(v)); break;
    case 35: m.TransparencyLevel = ReadRound(v); break;
    case 36: StoreCheck(m, ReadInt(v), f.chkDetailed, &ApplyDetailed); break;
    case 37: f.sldrGain.Set(ReadInt(v)); break;
    case 38: f.txtCallSign.Text = text; break;
    case 39: StoreIndex(ReadInt(v), 0, 2, m.SpeedUnits); break;
    case 40: StoreIndex(ReadInt(v), 0, 1, m.AltitudeUnits); break;
    case 41: StoreCheck(m, ReadInt(v), f.chkHalfSize); break;
    case 42: StoreIndex(ReadInt(v), 0, 8, m.TrackFileType); break;
    case 43: StoreIndex(ReadInt(v), 0, 1, m.WptFileType); break;
    case 44: StoreCheck(m, ReadInt(v), f.chkSplitIfStopped, &ApplySplitIfStopped); break;
    case 45: break;  // reserved
    case 46: f.txtTrkLimit.Text = text; break;
    case 47: f.mnuOnTop.Checked = ReadBool(v); break;
    case 48: f.mnuIgnore.Checked = ReadBool(v); break;
    case 49: StoreCheck(m, ReadRound(v), f.chkBalloon); break;
    case 50: StoreCheck(m, ReadInt(v), f.chkMoving); break;
    case 51: StoreIndex(ReadInt(v), 0, 1, m.OutputMode); break;
    case 52: m.FtpUserName = text; break;
    case 53: m.FtpPassword = text; break;
    case 54: m.FtpServer = text; break;
    case 55: m.FtpDirectory = text; break;
    case 56: m.FtpHttpPath = text; break;
    case 57: f.mnuAutoFtp(0).Checked = ReadBool(v); break;
    case 58: m.FtpUploadRate = Val(v); break;
    case 59: m.EmailSignature = text; break;
    case 60: StoreCheck(m, Val(v), f.chkMoreInfo); break;
    case 61: StoreCheck(m, Val(v), f.chkPort(0)); break;
    case 62: StoreCheck(m, Val(v), f.chkPort(1)); break;
    case 63: StoreSplitColor(m, Val(v), 2); break;
    case 64: StoreCheck(m, Val(v), f.chkGPGGA); break;
    default: break;
  }
}

// The value of line k as it is written.
std::string SettingText(Molvar& m, int k) {
  auto& f = m.frmMain;
  auto check = [](const CheckBox& b) { return IntToText(b.Value); };
  switch (k) {
    case 0: return m.VersionText;
    case 1: return m.InputTrackPath;
    case 2: return m.InputWaypointPath;
    case 3: return m.OutputTrackPath;
    case 4: return m.OutputPlacemarkPath;
    case 5: return m.TextEditorPath;
    case 6: return m.GoogleEarthPath;
    case 7: return check(f.chkSplitColor(0));
    case 8: return check(f.chkSplitColor(1));
    case 9: return IntToText(m.UserColorPointer);
    case 10: return f.txtTitle.Text;
    case 11: return IntToText(m.AltitudeMode);
    case 12: return IntToText(m.PlacemarkLabelSource);
    case 13: return check(f.chkUseFilename);
    case 14: return check(m.frmIconSelect.chkCustomIcon);
    case 15: return f.txtEyeAlt.Text;
    case 16: return f.txtHeading.Text;
    case 17: return f.txtTilt.Text;
    case 18: return IntToText(m.ComPortNumber);
    case 19: return IntToText(m.BaudRateIndex);
    case 20: return f.txtGErefresh.Text;
    case 21: return IntToText(m.IconPalette);
    case 22: return IntToText(m.IconX);
    case 23: return IntToText(m.IconY);
    case 24: return IntToText(m.ProgramMode);
    case 25: return DoubleToText(static_cast<float>(f.window.Left));
    case 26: return DoubleToText(static_cast<float>(f.window.Top));
    case 27: return IntToText(m.NorthUp);
    case 28: return IntToText(m.IconHintAnswer);
    case 29: return f.txtGMT.Text;
    case 30: return check(f.chkCollapse);
    case 31: return check(f.chkFastest);
    case 32: return check(f.chkAuto);
    case 33: return check(f.chkStartFinish);
    case 34: return IntToText(f.sldrWidth.Value);
    case 35: return IntToText(m.TransparencyLevel);
    case 36: return check(f.chkDetailed);
    case 37: return IntToText(f.sldrGain.Value);
    case 38: return UCase(Trim(f.txtCallSign.Text));
    case 39: return IntToText(m.SpeedUnits);
    case 40: return IntToText(m.AltitudeUnits);
    case 41: return check(f.chkHalfSize);
    case 42: return IntToText(m.TrackFileType);
    case 43: return IntToText(m.WptFileType);
    case 44: return IntToText(m.SplitIfStopped);
    case 45: return "1";
    case 46: return f.txtTrkLimit.Text;
    case 47: return std::string(BoolText(f.mnuOnTop.Checked));
    case 48: return std::string(BoolText(f.mnuIgnore.Checked));
    case 49: return check(f.chkBalloon);
    case 50: return check(f.chkMoving);
    case 51: return IntToText(m.OutputMode);
    case 52: return m.FtpUserName;
    case 53: return m.FtpPassword;
    case 54: return m.FtpServer;
    case 55: return m.FtpDirectory;
    case 56: return m.FtpHttpPath;
    case 57: return std::string(BoolText(f.mnuAutoFtp(0).Checked));
    case 58: return DoubleToText(m.FtpUploadRate);
    case 59: return m.EmailSignature;
    case 60: return check(f.chkMoreInfo);
    case 61: return check(f.chkPort(0));
    case 62: return check(f.chkPort(1));
    case 63: return check(f.chkSplitColor(2));
    case 64: return check(f.chkGPGGA);
    default: return {};
  }
}

std::string JoinCrLf(std::initializer_list<std::string_view> lines) {
  std::string text;
  for (std::string_view l : lines) {
    if (!text.empty()) text += kCrLf;
    text += l;
  }
  return text;
}

void ShowWelcome(Molvar& m) {
  m.platform.MsgBox(JoinCrLf({"Please read the help file before you use the program.",
                              "(The help file is web-based and is under the \"Help\" menu.)",
                              "Also, positioning the cursor over any control will pop up a help box.",
                              "If there's something you still can't figure out, email me.",
                              " (there is an email link in the help file)"}),
                    " Welcome to Molvar...", MsgButtons::OK, MsgIcon::Information);
}

void ShowIniError(Molvar& m, int number) {
  const std::string numberLine = "Error number: " + IntToText(number);
  m.platform.MsgBox(JoinCrLf({"Ini file contains errors.", numberLine,
                              "It should fix itself next time you run the program.",
                              "If not, look at the ini file for any pathname errors.",
                              " If that doesn't work, send me an email."}),
                    " No big deal, but...", MsgButtons::OK, MsgIcon::Information);
}

// Reads Molvar.ini over the defaults; reports a missing or faulty file.
void ReadSettingsFile(Molvar& m) {
  std::string content;
  const int err = ReadWholeFile(m.ProgramPath(kSettingsFileName), content);
  if (err == ENOENT) {
    ShowWelcome(m);
    return;
  }
  if (err != 0) {
    ShowIniError(m, kErrPathFileAccess);
    return;
  }
  const std::vector<std::string_view> lines = SplitLines(content);
  try {
    for (int k = 0; k < kSettingsLineCount; ++k) {
      if (static_cast<std::size_t>(k) >= lines.size()) throw RuntimeError(kErrPastEndOfFile);
      const std::string_view line = lines[static_cast<std::size_t>(k)];
      const char number[3] = {static_cast<char>('0' + k / 10), static_cast<char>('0' + k % 10), '\0'};
      if (line.substr(0, 2) != number) continue;
      StoreSetting(m, k, SettingValueOf(line));
    }
  } catch (const RuntimeError& e) {
    ShowIniError(m, e.Number());
  }
}

void OpenAgwpeFile(Molvar& m) {
  m.AgwpeFile.close();
  m.AgwpeFile.clear();
  m.AgwpeFile.open(m.ProgramPath(kAgwpeFileName), std::ios::out | std::ios::trunc | std::ios::binary);
}

// `selectMode` is the program-mode menu handler: the window's full one at start-up, only the
// check mark for the converter, which shows no window.
void ApplyLoadedSettings(Molvar& m, void (*selectMode)(Molvar&, int)) {
  auto& f = m.frmMain;
  f.window.Left = f.window.Left < 0 ? 0 : (f.window.Left > 8000 ? 8000 : f.window.Left);
  f.window.Top = f.window.Top < 0 ? 0 : (f.window.Top > 5000 ? 5000 : f.window.Top);

  // A negative value is no more a palette or a cell than one too large.
  if (m.IconPalette >= 4 || m.IconPalette < 0) m.IconPalette = 0;
  if (m.IconX >= 257 || m.IconX < 0) m.IconX = 0;
  if (m.IconY >= 257 || m.IconY < 0) m.IconY = 0;

  if (f.mnuAutoFtp(0).Checked) f.mnuAutoFtp(1).Enabled = true;

  SelectWptFileType(m, m.WptFileType);
  SelectAltitudeMode(m, m.AltitudeMode);
  SelectTrackFileType(m, m.TrackFileType);

  selectMode(m, m.ProgramMode);
  SelectOutputMode(m, m.OutputMode);
  SelectComPort(m, m.ComPortNumber);
  SelectBaudRate(m, m.BaudRateIndex);
  SelectSpeedUnits(m, m.SpeedUnits);
  SelectAltitudeUnits(m, m.AltitudeUnits);

  f.sldrFade.Set(m.TransparencyLevel);
  ApplyFade(m);

  SelectWptTitle(m, m.PlacemarkLabelSource);
  SelectNorthUp(m, m.NorthUp);

  PaintColorSample(m);

  ApplyAutoOpen(m);
  ApplyGain(m);
}

// One point line of TrackData.txt into `p`; false when the line is not a complete point.
bool ParsePointLine(std::string_view line, TrackPoint& p) {
  std::vector<std::string> fields;
  std::string field;
  for (char c : line) {
    if (c == ',') {
      fields.push_back(std::move(field));
      field.clear();
      if (fields.size() >= 10) return false;  // an 11th field follows
    } else if (static_cast<unsigned char>(c) < 128) {
      field.push_back(c);
    }
  }
  fields.push_back(std::move(field));
  if (fields.size() < 9) return false;
  try {
    p.Latitude = ToNumber(fields[0]);
    p.Longitude = ToNumber(fields[1]);
    p.DateTime = fields[2];
    p.Altitude = RoundToInt32(ToNumber(fields[3]));
    p.Speed = ToNumber(fields[4]);
    p.Distance = ToNumber(fields[5]);
    p.Flag = RoundToInt16(ToNumber(fields[6]));
    p.SegCtr = RoundToInt32(ToNumber(fields[7]));
    p.DayCtr = RoundToInt32(ToNumber(fields[8]));
  } catch (const RuntimeError&) {
    return false;
  }
  return true;
}

}  // namespace

const std::string& SettingsLabel(int k) { return kLabels.at(static_cast<std::size_t>(k)); }

void LoadSettings(Molvar& m) {
  ApplySettingDefaults(m);
  ReadSettingsFile(m);
  OpenAgwpeFile(m);
  ApplyLoadedSettings(m, &mnuModeItem_Click);
  LoadTrackData(m);
}

void LoadOptionsOnly(Molvar& m) {
  ApplySettingDefaults(m);
  if (std::filesystem::exists(m.ProgramPath(kSettingsFileName))) ReadSettingsFile(m);
  ApplyLoadedSettings(m, &CheckProgramModeItem);
}

bool SaveSettings(Molvar& m) {
  std::string content;
  for (int k = 0; k < kSettingsLineCount; ++k) {
    content += kLabels[static_cast<std::size_t>(k)];
    content += OneLine(SettingText(m, k));
    content += kCrLf;
  }
  try {
    // The FTP password is in it: owner only.
    WriteFileAtomically(m.ProgramPath(kSettingsFileName), content, true, true);
  } catch (const std::exception& e) {
    ShowBug(m, "SaveSettings", e);
    return false;
  }
  return true;
}

void SaveTrackData(Molvar& m) {
  const TrackStore& t = m.Track;
  if (t.PointCount < 2) return;
  std::string content;
  content += OneLine(m.LastSourceFile) + kCrLf;
  content += OneLine(m.OutputPath) + kCrLf;
  content += OneLine(m.OutputName) + kCrLf;
  const int32_t n = t.StoredCount();
  for (int32_t i = 1; i <= n; ++i) {
    const TrackPoint& p = t[i];
    AppendDouble(content, p.Latitude);
    content += ',';
    AppendDouble(content, p.Longitude);
    content += ',';
    content += p.DateTime.view();
    content += ',';
    AppendInt(content, p.Altitude);
    content += ',';
    AppendDouble(content, p.Speed);
    content += ',';
    AppendDouble(content, p.Distance);
    content += ',';
    AppendInt(content, p.Flag);
    content += ',';
    AppendInt(content, p.SegCtr);
    content += ',';
    AppendInt(content, p.DayCtr);
    content += kCrLf;
  }
  try {
    WriteFileAtomically(m.ProgramPath(kTrackDataFileName), content, true, false);
  } catch (const std::exception&) {
    // Not worth a message at shutdown; the previous file stays complete.
  }
}

void LoadTrackData(Molvar& m) {
  auto fail = [&m] { m.frmMain.cmdRefresh.Enabled = false; };
  std::string content;
  if (ReadWholeFile(m.ProgramPath(kTrackDataFileName), content) != 0) return fail();
  const std::vector<std::string_view> lines = SplitLines(content);
  if (lines.empty()) return fail();
  m.LastSourceFile = std::string(lines[0]);
  if (lines.size() < 2) return fail();
  m.OutputPath = std::string(lines[1]);
  if (m.OutputPath.empty() || lines.size() < 3) return fail();
  m.OutputName = std::string(lines[2]);
  if (m.OutputName.empty()) return fail();

  TrackStore& t = m.Track;
  for (std::size_t i = 3; i < lines.size(); ++i) {
    TrackPoint p;
    if (!ParsePointLine(lines[i], p)) return fail();
    if (t.PointCount >= INT32_MAX) return fail();
    t.PointCount += 1;
    t.GrowTrackStore(t.PointCount);
    t[t.PointCount] = p;
  }
  if (t.PointCount < 2) return fail();
  m.frmMain.txtInfo.Text =
      " Last saved track file was " + m.OutputName + ", with " + IntToText(t.PointCount) + " points.";
}

}  // namespace molvar
