#include "app/Resources.h"

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>

namespace molvar {
namespace {

namespace fs = std::filesystem;

// The help pages are the program's own and follow its version; every other file there may be the
// user's (a custom icon) and is never replaced.
bool IsProgramOwned(const fs::path& relative) { return !relative.empty() && *relative.begin() == "Help"; }

bool SameContent(const fs::path& a, const fs::path& b) {
  std::error_code ec;
  if (fs::file_size(a, ec) != fs::file_size(b, ec) || ec) return false;
  std::ifstream x(a, std::ios::binary), y(b, std::ios::binary);
  return std::equal(std::istreambuf_iterator<char>(x), std::istreambuf_iterator<char>(),
                    std::istreambuf_iterator<char>(y));
}

// Through a temporary name, so a copy cut short never stands as the file; unless `replace`, the
// rename happens only while the target is still missing.
void Install(const fs::path& from, const fs::path& to, bool replace) {
  std::error_code ec;
  const bool exists = fs::exists(fs::symlink_status(to, ec));
  if (exists && (!replace || SameContent(from, to))) return;
  fs::create_directories(to.parent_path(), ec);
  if (ec) return;
  fs::path part = to;
  part += ".part";
  fs::remove(part, ec);
  if (!fs::copy_file(from, part, ec) || ec) {
    fs::remove(part, ec);
    return;
  }
  if (replace || !fs::exists(fs::symlink_status(to, ec))) fs::rename(part, to, ec);
  fs::remove(part, ec);
}

}  // namespace

void InstallResources(const std::string& programFolder, const std::string& resourceDir) {
  std::error_code ec;
  const fs::path source(resourceDir);
  const fs::path target(programFolder);
  if (programFolder.empty() || !fs::is_directory(source, ec)) return;
  if (fs::equivalent(source, target, ec)) return;
  for (auto it = fs::recursive_directory_iterator(source, fs::directory_options::skip_permission_denied, ec);
       !ec && it != fs::recursive_directory_iterator(); it.increment(ec)) {
    if (!it->is_regular_file(ec)) continue;
    const fs::path relative = fs::relative(it->path(), source, ec);
    Install(it->path(), target / relative, IsProgramOwned(relative));
  }
}

}  // namespace molvar
