#include "input/FileChoice.h"

#include <array>
#include <cerrno>
#include <fstream>
#include <string_view>
#include <vector>

#include "app/Molvar.h"
#include "core/Numbers.h"
#include "core/Text.h"
#include "output/OutputFile.h"
#include "output/kml/KmlFrame.h"

namespace molvar {
namespace {

constexpr std::array<std::string_view, kTrackFileTypeCount> kTrackFilters = {
    "Ozi track Files (*.plt)|*.plt",
    "GPX track Files (*.gpx)|*.gpx",
    "XML track Files (*.xml)|*.xml",
    "Text Files - NMEA only! (*.txt)|*.txt",
    "Text Files - CSV type 1 only! (*.csv)|*.csv",
    "Text Files - CSV type 2 only! (*.csv)|*.csv",
    "KML Files - track only! (*.kml)|*.kml",
    "Text Files - APRS only! (*.txt)|*.txt",
    "Text Files - custom (*.txt)|*.txt",
};

constexpr std::size_t kLongFirstLine = 300;

// The same message the line reader gives: the file and the system's reason.
[[noreturn]] void ThrowOpenFailure(const std::string& path) {
  const int err = errno != 0 ? errno : ENOENT;
  const int number = err == ENOENT ? kErrFileNotFound : kErrPathFileAccess;
  throw FileError(number, path, err);
}

bool InWaypointMode(const Molvar& m) { return m.ProgramMode == kModeConvertWaypoints; }

// Whether the text before the first CR (or the end) is longer than kLongFirstLine.
bool FirstLineIsLong(const std::string& path) {
  errno = 0;
  std::ifstream in(path, std::ios::binary);
  if (!in) ThrowOpenFailure(path);
  std::string head(kLongFirstLine + 1, '\0');
  in.read(head.data(), static_cast<std::streamsize>(head.size()));
  head.resize(static_cast<std::size_t>(in.gcount()));
  return head.size() > kLongFirstLine && head.find('\r') == std::string::npos;
}

}  // namespace

std::string_view TrackFileFilter(int trackFileType) {
  if (trackFileType < 0 || trackFileType >= kTrackFileTypeCount) return {};
  return kTrackFilters[static_cast<std::size_t>(trackFileType)];
}

std::string_view WaypointFileFilter(int wptFileType) {
  return wptFileType == 1 ? "GPX Waypoint Files (*.gpx)|*.gpx" : "Ozi Waypoint Files (*.wpt)|*.wpt";
}

int16_t ChooseInputFile(Molvar& m) {
  const bool waypoints = InWaypointMode(m);
  FileDialogRequest request;
  request.title = waypoints ? "Open waypoint file" : "Open track file";
  request.filter = std::string(waypoints ? WaypointFileFilter(m.WptFileType) : TrackFileFilter(m.TrackFileType));
  request.initialFolder = waypoints ? m.InputWaypointPath : m.InputTrackPath;
  const auto chosen = m.platform.OpenFileDialog(request);
  if (!chosen || chosen->empty()) return 1;

  m.LastSourceFile = *chosen;
  m.InputName = std::string(FileNameOf(m.LastSourceFile));
  const std::string folder(FolderOf(m.LastSourceFile));
  if (!folder.empty()) (waypoints ? m.InputWaypointPath : m.InputTrackPath) = folder;
  const long dot = InStrRev(m.InputName, ".");
  if (dot > 0) m.OutputName = std::string(Left(m.InputName, dot)) + "kml";
  return 0;
}

int16_t OutputFormatOfName(std::string_view name, int16_t previous) {
  // Upper-case names ("TRACK.GPX") select their format too.
  const std::string lower = LCase(name);
  int16_t format = previous;
  if (Contains(lower, ".kml")) format = kFormatKml;
  if (Contains(lower, ".gpx")) format = kFormatGpx;
  if (Contains(lower, ".wpt") || Contains(lower, ".plt")) format = kFormatOzi;
  return format;
}

std::string_view RefusedCombination(const Molvar& m) {
  if (m.ProgramMode == kModeConvertTracks && m.TrackFileType == 1 && m.OutputFormat == kFormatGpx)
    return "You cannot write an output GPX track file when the input file is GPX.";
  if (m.ProgramMode == kModeConvertWaypoints && m.WptFileType == 1 && m.OutputFormat == kFormatGpx)
    return "You cannot write an output GPX waypoint file when the input file is GPX.";
  if (m.ProgramMode == kModeConvertWaypoints && m.WptFileType == 0 && m.OutputFormat == kFormatOzi)
    return "You cannot write an output OZI waypoint file when the input file is OZI.";
  return {};
}

int16_t ChooseOutputFile(Molvar& m) {
  const bool waypoints = InWaypointMode(m);
  FileDialogRequest request;
  request.title = "Save output file";
  request.filter = waypoints ? "Save to GE (*.kml)|*.kml|Save to GPX (*.gpx)|*.gpx"
                             : "Save to GE (*.kml)|*.kml|Save to GPX (*.gpx)|*.gpx|Save to Ozi (*.plt)|*.plt";
  request.initialFolder = waypoints ? m.OutputPlacemarkPath : m.OutputTrackPath;
  request.proposedName = TitleFromFileName(m);
  const auto chosen = m.platform.SaveFileDialog(request);
  if (!chosen || chosen->empty()) return 1;

  m.OutputPath = *chosen;
  m.OutputName = std::string(FileNameOf(m.OutputPath));
  m.OutputFormat = OutputFormatOfName(m.OutputPath, m.OutputFormat);
  if (const auto refusal = RefusedCombination(m); !refusal.empty()) {
    m.platform.MsgBox(refusal, " Error!...", MsgButtons::OK, MsgIcon::Information);
    return 1;
  }
  const std::string folder(FolderOf(m.OutputPath));
  switch (m.ProgramMode) {
    case kModeConvertTracks:
    case kModeGarmin:
    case kModeAprsWeb: m.OutputTrackPath = folder; break;
    case kModeConvertWaypoints: m.OutputPlacemarkPath = folder; break;
    default: break;
  }
  return 0;
}

void FixLineEnds(Molvar& m) {
  const std::string& path = m.LastSourceFile;
  // Only a long first line asks for a look at the whole file.
  if (!FirstLineIsLong(path)) return;
  errno = 0;
  std::ifstream in(path, std::ios::binary);
  if (!in) ThrowOpenFailure(path);
  // Streamed into the replacement, so a large file costs no more memory than a small one.
  OutputFile out;
  out.SetDurable(true);
  out.Open(path);
  std::vector<char> chunk(1 << 20);
  bool changed = false;
  char last = 0;
  while (in.read(chunk.data(), static_cast<std::streamsize>(chunk.size())) || in.gcount() > 0) {
    const std::string_view data(chunk.data(), static_cast<std::size_t>(in.gcount()));
    std::size_t from = 0;
    for (std::size_t lf = data.find('\n'); lf != std::string_view::npos; lf = data.find('\n', from)) {
      const char before = lf > 0 ? data[lf - 1] : last;
      out.Raw(data.substr(from, lf - from));
      if (before != '\r') {
        out.Raw("\r");
        changed = true;
      }
      out.Raw("\n");
      from = lf + 1;
    }
    out.Raw(data.substr(from));
    last = data.back();
  }
  if (in.bad()) throw FileError(kErrPathFileAccess, path, errno != 0 ? errno : EIO);
  // Only the line ends change; a long first line with proper line ends is left as it is.
  if (!changed) return;  // the untouched replacement is dropped
  if (last != '\n') out.Raw("\r\n");
  out.Close();
}

void NormaliseViewSettings(Molvar& m) {
  auto& f = m.frmMain;
  if (Val(f.txtEyeAlt.Text) < 100) f.txtEyeAlt.Text = "100";
  const double tilt = Val(f.txtTilt.Text);
  if (tilt < 0 || tilt > 90) f.txtTilt.Text = "45";
  const double heading = Val(f.txtHeading.Text);
  if (heading < 0 || heading > 360) f.txtHeading.Text = "0";
}

}  // namespace molvar
