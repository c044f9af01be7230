// molvar-convert: converts one track or waypoint file to KML, GPX or Ozi PLT without a window.
#include <iostream>
#include <string>
#include <string_view>
#include <vector>

#include "app/Conversion.h"
#include "app/Molvar.h"
#include "app/ProgramFolder.h"
#include "app/Resources.h"
#include "platform/ConsolePlatform.h"

namespace {

constexpr const char* kUsage =
    "Usage: molvar-convert [--folder DIR] [--type NAME] [--set CONTROL=VALUE]... INPUT OUTPUT\n"
    "\n"
    "Converts a track or waypoint file into KML, GPX 1.0 or OziExplorer PLT. OUTPUT's name chooses\n"
    "the format: .kml, .gpx, .plt (or .wpt, written in the PLT format for tracks).\n"
    "\n"
    "  --folder DIR        program folder holding Molvar.ini and the icons\n"
    "                      (default $XDG_DATA_HOME/molvar or ~/.local/share/molvar)\n"
    "  --type NAME         input type: ozi gpx xml nmea csv1 csv2 kml aprs kel (tracks),\n"
    "                      ozi-wpt gpx-wpt (waypoints). Without it: .plt ozi, .gpx gpx,\n"
    "                      .xml xml, .kml kml, .wpt ozi-wpt, otherwise the settings' track type\n"
    "  --set CONTROL=VALUE set an option by its control name after Molvar.ini is read, e.g.\n"
    "                      chkDetailed=0, txtGMT=-5, comboAltitude=2, mnuUnitsItem=1,\n"
    "                      txtTitle=\"Lake run\", chkSplitColor(2)=1; may be repeated\n"
    "  --help              this text\n"
    "\n"
    "Messages go to stderr as \"title: text\"; the summary line goes to stdout. Molvar.ini and\n"
    "TrackData.txt are never written.\n"
    "Exit status: 0 output written, 1 usage error, 2 nothing written.\n";

struct Arguments {
  molvar::ConversionRequest request;
  std::string folder;
  bool help = false;
  std::string error;
};

Arguments ParseArguments(const std::vector<std::string_view>& args) {
  Arguments a;
  std::vector<std::string> files;
  for (std::size_t i = 0; i < args.size(); ++i) {
    const std::string_view arg = args[i];
    auto value = [&](std::string_view option) -> std::string {
      if (i + 1 >= args.size()) {
        a.error = std::string(option) + " needs a value";
        return {};
      }
      return std::string(args[++i]);
    };
    if (arg == "--help" || arg == "-h") {
      a.help = true;
    } else if (arg == "--folder") {
      a.folder = value(arg);
    } else if (arg == "--type") {
      a.request.type = value(arg);
    } else if (arg == "--set") {
      a.request.assignments.push_back(value(arg));
    } else if (arg.size() > 1 && arg.front() == '-' && arg != "--") {
      a.error = "unknown option " + std::string(arg);
    } else {
      files.emplace_back(arg);
    }
    if (!a.error.empty()) return a;
  }
  if (a.help) return a;
  if (files.size() != 2) {
    a.error = files.size() < 2 ? "INPUT and OUTPUT are needed" : "only one INPUT and one OUTPUT can be given";
    return a;
  }
  a.request.input = files[0];
  a.request.output = files[1];
  return a;
}

int UsageError(const std::string& error) {
  std::cerr << "molvar-convert: " << error << "\nTry 'molvar-convert --help'.\n";
  return molvar::kConversionUsage;
}

}  // namespace

int main(int argc, char** argv) {
  const std::vector<std::string_view> args(argv + 1, argv + argc);
  const Arguments a = ParseArguments(args);
  if (a.help) {
    std::cout << kUsage;
    return 0;
  }
  if (!a.error.empty()) return UsageError(a.error);
  try {
    molvar::ConsolePlatform platform(std::cerr);
    const std::string folder = a.folder.empty() ? molvar::DefaultProgramFolder() : a.folder;
    // The KML refers to the icons and the legend in the program folder.
    molvar::InstallResources(folder);
    molvar::Molvar m(platform, folder);
    const molvar::ConversionResult result = molvar::RunConversion(m, platform, a.request);
    if (result.exitCode == molvar::kConversionUsage) return UsageError(result.usageError);
    std::cout << result.info << '\n';
    return result.exitCode;
  } catch (const std::exception& e) {
    std::cerr << "molvar-convert: " << e.what() << '\n';
    return molvar::kConversionNothingWritten;
  }
}
