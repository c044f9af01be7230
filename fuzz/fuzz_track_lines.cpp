// One track line reader over the lines of the input, split as LineReader splits a file (CR, LF or
// CR LF), with the driver's speed banding. Byte 1 chooses the reader, byte 2 the options.
#include <cstdint>

#include "FuzzProgram.h"
#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "input/CsvTracks.h"
#include "input/KelTrack.h"
#include "input/Nmea.h"
#include "input/OziTrack.h"
#include "input/TrackReader.h"
#include "input/XmlTracks.h"

namespace {

using namespace molvar;

// Track file types as the type box numbers them.
void ReadLine(Molvar& m, int type, std::string& line) {
  switch (type) {
    case 0: ReadOziTrackLine(m, line); break;
    case 1: ReadGpxLine(m, line); break;
    case 2: ReadXmlLine(m, line); break;
    case 3: ParseNMEA(m, line); break;
    case 4: ReadOrionCsvLine(m, line); break;
    case 5: ReadCsv2Line(m, line); break;
    case 6: ReadKmlCoordinateLine(m, UCase(line)); break;
    case 7: ReadAprsFileLine(m, line); break;
    default: ReadKelLine(m, line); break;
  }
}

// The next line without its end; false when nothing is left.
bool NextLine(std::string_view& rest, std::string& line) {
  if (rest.empty()) return false;
  const std::size_t end = rest.find_first_of("\r\n");
  line.assign(rest.substr(0, end));
  if (end == std::string_view::npos) {
    rest = {};
  } else {
    const bool crlf = rest[end] == '\r' && end + 1 < rest.size() && rest[end + 1] == '\n';
    rest.remove_prefix(end + (crlf ? 2 : 1));
  }
  return true;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
  fuzz::FuzzInput in(data, size);
  const int type = in.Byte() % 9;
  fuzz::FuzzProgram p;
  Molvar& m = *p;
  fuzz::ApplyOptions(m, in.Byte());
  m.ProgramMode = kModeConvertTracks;
  m.TrackFileType = static_cast<int16_t>(type);
  m.InputName = "in.txt";
  std::string line;
  while (NextLine(in.rest, line)) {
    const int32_t before = m.Track.PointCount;
    ReadLine(m, type, line);
    // The GPX and XML readers band their own points.
    if (m.ColorVaryMode == 3 && m.Track.PointCount > before && type != 1 && type != 2)
      AssignSpeedBand(m, m.Track.PointCount);
  }
  return 0;
}
