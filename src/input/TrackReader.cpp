#include "input/TrackReader.h"

#include <array>

#include "app/Molvar.h"
#include "app/TestBox.h"
#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "input/AprsText.h"
#include "input/CsvTracks.h"
#include "input/FileChoice.h"
#include "input/KelTrack.h"
#include "input/LineReader.h"
#include "input/Nmea.h"
#include "input/OziTrack.h"
#include "input/XmlTracks.h"
#include "output/Dispatch.h"

namespace molvar {
namespace {

enum TrackFileTypes : int16_t {
  kTypeOzi = 0,
  kTypeGpx = 1,
  kTypeXml = 2,
  kTypeNmea = 3,
  kTypeCsv1 = 4,
  kTypeCsv2 = 5,
  kTypeKml = 6,
  kTypeAprs = 7,
  kTypeKel = 8,
};

constexpr std::array<int, kTrackFileTypeCount> kHeaderLines = {6, 0, 0, 0, 1, 1, 0, 0, 1};
constexpr std::array<std::string_view, kTrackFileTypeCount> kDropExtensions = {"PLT", "GPX", "XML", "TXT", "CSV",
                                                                               "CSV", "",    "TXT", "TXT"};
constexpr std::size_t kAprsShortLineLength = 100;
constexpr int32_t kTestBoxPointLimit = 500;

void SkipHeader(Molvar& m, LineReader& in, int16_t type) {
  std::string line;
  if (type == kTypeKml) {
    m.frmMain.chkStartFinish.Value = 0;
    m.frmMain.chkFastest.Value = 0;
    while (in.Next(line)) {
      if (Contains(UCase(line), "<LINESTRING>")) return;
    }
    return;
  }
  for (int i = 0; i < kHeaderLines[static_cast<std::size_t>(type)] && in.Next(line); ++i) {
  }
}

void ReadLine(Molvar& m, int16_t type, std::string_view line, std::string& sentence) {
  switch (type) {
    case kTypeOzi: ReadOziTrackLine(m, line); break;
    case kTypeGpx: ReadGpxLine(m, line); break;
    case kTypeXml: ReadXmlLine(m, line); break;
    case kTypeNmea:
      sentence.assign(line);  // the parser edits its sentence
      ParseNMEA(m, sentence);
      break;
    case kTypeCsv1: ReadOrionCsvLine(m, line); break;
    case kTypeCsv2: ReadCsv2Line(m, line); break;
    case kTypeKml: ReadKmlCoordinateLine(m, UCase(line)); break;
    case kTypeAprs: ReadAprsFileLine(m, line); break;
    case kTypeKel: ReadKelLine(m, line); break;
    default: break;
  }
}

// The GPX and XML readers assign the speed band of each point they add themselves.
bool DriverAssignsSpeedBand(int16_t type) { return type != kTypeGpx && type != kTypeXml; }

void ResetReaders(Molvar& m) {
  m.GpxReader.Reset();
  m.XmlReader.Reset();
}

void ReadLines(Molvar& m, LineReader& in, int16_t type) {
  TrackStore& track = m.Track;
  track.PointCount = 0;
  ResetReaders(m);
  std::string_view line;
  std::string sentence;
  while (in.Next(line)) {
    if (m.TestMode == 1 && track.PointCount < kTestBoxPointLimit) AppendToTestBox(m, line);
    const int32_t before = track.PointCount;
    ReadLine(m, type, line, sentence);
    if (m.ColorVaryMode == 3 && track.PointCount > before && DriverAssignsSpeedBand(type))
      AssignSpeedBand(m, track.PointCount);
  }
}

}  // namespace

void ReadAprsFileLine(Molvar& m, std::string_view line) {
  if (line.size() <= kAprsShortLineLength) {
    ReadAprsLine(m, line, kAprsShortLine, "");
    return;
  }
  std::string_view timeText = line.front() == '#' ? Mid(line, 26, 8) : Left(line, 19);
  if (Contains(timeText, ">")) timeText = {};
  const long p = InStr(line, ">");
  if (p > 1) ReadAprsLine(m, Mid(line, p + 1), kAprsPacketText, timeText);
}

void ReadTrackFile(Molvar& m, bool fromDrop) {
  if (!fromDrop) {
    if (ChooseInputFile(m) == 1) return;
    if (ChooseOutputFile(m) == 1) return;
  }
  if (m.TestMode == 1) m.frmMain.txtTest.Text.clear();
  try {
    FixLineEnds(m);
    NormaliseViewSettings(m);
    const int16_t type = m.TrackFileType;
    if (type >= 0 && type < kTrackFileTypeCount) {
      LineReader in(m.LastSourceFile);
      SkipHeader(m, in, type);
      ReadLines(m, in, type);
    }
  } catch (const std::exception& e) {
    ShowSnag(m, "ReadTrackFile", e);
    return;
  }
  WriteOutputFile(m);
}

std::string TakeDroppedFile(Molvar& m, const std::string& path) {
  m.LastSourceFile = path;
  m.InputName = std::string(FileNameOf(path));
  const long nameDot = InStrRev(m.InputName, ".");
  // A name without a dot keeps the last output and has no extension.
  if (nameDot == 0) return {};
  const long pathDot = static_cast<long>(path.size() - m.InputName.size()) + nameDot;
  m.OutputPath = std::string(Left(path, pathDot)) + "kml";
  m.OutputName = std::string(Left(m.InputName, nameDot)) + "kml";
  return UCase(Mid(m.InputName, nameDot + 1));
}

void TrackFrame_Drop(Molvar& m, const std::string& path) {
  const std::string extension = TakeDroppedFile(m, path);
  if (extension == "KML") {
    m.platform.MsgBox(
        "Cannot convert a kml file by dragging it.\r\nUse File type of KML, press Read track file button and save to "
        "a different folder. ",
        "Whoops!", MsgButtons::OK, MsgIcon::Exclamation);
    return;
  }
  if (m.LastSourceFile == m.OutputPath) {
    m.platform.MsgBox("Attempting to overwrite file.\r\nUse the Read track file button and save to a different folder. ",
                      "Whoops!", MsgButtons::OK, MsgIcon::Exclamation);
    return;
  }
  const int16_t type = m.TrackFileType;
  const bool accepted = type >= 0 && type < kTrackFileTypeCount && !extension.empty() &&
                        kDropExtensions[static_cast<std::size_t>(type)] == extension;
  if (!accepted) {
    m.platform.MsgBox("Incorrect file type!\r\nChange the file type selection box\r\nto agree with the input file type.",
                      "Whoops!", MsgButtons::OK, MsgIcon::Exclamation);
    return;
  }
  ReadTrackFile(m, true);
}

}  // namespace molvar
