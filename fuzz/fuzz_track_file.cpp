// A whole track file through "Read track file" (line-end repair, header, readers, dispatch) and
// the writer of the chosen output. Byte 1: input type; byte 2: output format and altitude mode;
// byte 3: options; the rest is the file.
#include <array>
#include <cstdint>

#include "FuzzProgram.h"
#include "app/Options.h"
#include "input/FileChoice.h"
#include "input/TrackReader.h"

namespace {

using namespace molvar;

constexpr std::array<const char*, 9> kInputNames = {"in.plt", "in.gpx", "in.xml", "in.txt", "in.csv",
                                                    "in.csv", "in.kml", "in.txt", "in.txt"};
constexpr std::array<const char*, 3> kOutputNames = {"out.kml", "out.gpx", "out.plt"};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
  fuzz::FuzzInput in(data, size);
  const int type = in.Byte() % 9;
  const uint8_t output = in.Byte();
  fuzz::FuzzProgram p;
  Molvar& m = *p;
  fuzz::ApplyOptions(m, in.Byte());
  m.ProgramMode = kModeConvertTracks;
  SelectTrackFileType(m, type);
  SelectAltitudeMode(m, (output >> 2) & 3);
  m.OutputFormat = static_cast<int16_t>(output % 3);
  // The save dialog refuses a GPX track from a GPX track.
  if (!RefusedCombination(m).empty()) m.OutputFormat = kFormatKml;

  m.LastSourceFile = p.File(kInputNames[static_cast<std::size_t>(type)]);
  m.InputName = kInputNames[static_cast<std::size_t>(type)];
  m.OutputName = kOutputNames[static_cast<std::size_t>(m.OutputFormat)];
  m.OutputPath = p.File(m.OutputName);
  fuzz::WriteFuzzFile(m.LastSourceFile, in.rest);
  ReadTrackFile(m, true);
  return 0;
}
