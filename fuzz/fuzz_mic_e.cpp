// Mic-E reports. Each one: a length byte, that many bytes of destination address (with its
// optional path), then the information field up to the next line feed; DecodeMicE gets them
// joined by ":" as the AGW path hands them over.
#include <cstdint>
#include <string>

#include "FuzzProgram.h"
#include "aprs/AprsDecode.h"

using namespace molvar;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
  fuzz::FuzzInput in(data, size);
  const uint8_t options = in.Byte();
  fuzz::FuzzProgram p;
  Molvar& m = *p;
  m.ProgramMode = (options & 1) ? kModeAprsWeb : kModeAgw;
  std::string packet;
  while (!in.rest.empty()) {
    const std::size_t length = in.Byte() % 32;
    const std::string_view destination = in.rest.substr(0, length);
    in.rest.remove_prefix(destination.size());
    packet.assign(destination);
    packet.push_back(':');
    packet.append(in.Until('\n'));
    DecodeMicE(m, packet);
  }
  return 0;
}
