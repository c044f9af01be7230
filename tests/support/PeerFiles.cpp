#include "support/PeerFiles.h"

#include "input/LineReader.h"
#include "support/Peers.h"

namespace molvar::testing {

std::string WriteWithGpsbabel(const TempFolder& folder, std::string_view csv, std::string_view output,
                              std::string_view name, bool asTrack) {
  const std::string in = folder.File("peer-in.csv");
  WriteFile(in, csv);
  const std::string out = folder.File(name);
  std::string cmd = "gpsbabel -i unicsv -f '" + in + "'";
  if (asTrack) cmd += " -x transform,trk=wpt,del";
  cmd += " -o " + std::string(output) + " -F '" + out + "' >/dev/null 2>&1";
  int status = -1;
  RunCommand(cmd, &status);
  if (status != 0) return {};
  return out;
}

std::vector<std::string> FileLines(const std::string& path) {
  LineReader reader(path);
  std::vector<std::string> lines;
  std::string line;
  while (reader.Next(line)) lines.push_back(line);
  return lines;
}

}  // namespace molvar::testing
