// Plain APRS position reports, one per input line, as the AGW and web paths hand them over.
#include <cstdint>

#include "FuzzProgram.h"
#include "aprs/AprsDecode.h"

using namespace molvar;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
  fuzz::FuzzInput in(data, size);
  const uint8_t options = in.Byte();
  fuzz::FuzzProgram p;
  Molvar& m = *p;
  m.ProgramMode = (options & 1) ? kModeAprsWeb : kModeAgw;
  while (!in.rest.empty()) ParseAprsPosition(m, in.Until('\n'));
  return 0;
}
