// Molvar.ini made of the input through the start-up load (defaults, file, replay of the options
// as clicks), then written back.
#include <cstdint>

#include "FuzzProgram.h"
#include "app/Settings.h"

using namespace molvar;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
  fuzz::FuzzInput in(data, size);
  fuzz::FuzzProgram p;
  Molvar& m = *p;
  fuzz::WriteFuzzFile(p.File(kSettingsFileName), in.rest);
  LoadSettings(m);
  SaveSettings(m);
  return 0;
}
