#include "app/ProgramFolder.h"

#include <cstdlib>
#include <filesystem>

namespace molvar {

std::string DefaultProgramFolder() {
  namespace fs = std::filesystem;
  fs::path folder;
  if (const char* xdg = std::getenv("XDG_DATA_HOME"); xdg != nullptr && *xdg == '/') {
    folder = fs::path(xdg) / "molvar";
  } else if (const char* home = std::getenv("HOME"); home != nullptr && *home != '\0') {
    folder = fs::path(home) / ".local" / "share" / "molvar";
  } else {
    folder = fs::current_path() / "molvar";
  }
  std::error_code ignored;  // a folder that cannot be made shows up when a file is written there
  fs::create_directories(folder, ignored);
  return folder.string();
}

}  // namespace molvar
