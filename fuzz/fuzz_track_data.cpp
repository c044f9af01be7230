// TrackData.txt made of the input through LoadTrackData, then written back.
#include <cstdint>

#include "FuzzProgram.h"
#include "app/Settings.h"

using namespace molvar;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
  fuzz::FuzzInput in(data, size);
  fuzz::FuzzProgram p;
  Molvar& m = *p;
  fuzz::WriteFuzzFile(p.File(kTrackDataFileName), in.rest);
  LoadTrackData(m);
  SaveTrackData(m);
  return 0;
}
