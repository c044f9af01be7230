// NMEA sentences, one per input line: ParseNMEA as a track file's reader (or with the checksum
// ignored), VerifyChecksum on the raw line, ConvertNmeaLocation on "value,hemisphere".
#include <cstdint>
#include <string>

#include "FuzzProgram.h"
#include "input/Nmea.h"

using namespace molvar;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
  fuzz::FuzzInput in(data, size);
  const uint8_t options = in.Byte();
  fuzz::FuzzProgram p;
  Molvar& m = *p;
  m.ProgramMode = (options & 1) ? kModeAgw : kModeConvertTracks;
  m.TrackFileType = 3;
  m.frmMain.mnuIgnore.Checked = (options & 2) != 0;
  m.GmtMinutes = static_cast<int16_t>((options >> 2) * 37 - 600);
  while (!in.rest.empty()) {
    const std::string_view raw = in.Until('\n');
    VerifyChecksum(m, raw);
    std::string_view location = raw;
    const std::string_view value = fuzz::FuzzInput::Cut(location, ',');
    ConvertNmeaLocation(value, location);
    std::string sentence(raw);
    ParseNMEA(m, sentence);
  }
  return 0;
}
