#include "app/Resources.h"

#include <filesystem>

namespace molvar {
namespace {

namespace fs = std::filesystem;

// Through a temporary name, so a copy cut short never stands as the file; the rename happens only
// while the target is still missing.
void CopyMissing(const fs::path& from, const fs::path& to) {
  std::error_code ec;
  if (fs::exists(fs::symlink_status(to, ec))) return;
  fs::create_directories(to.parent_path(), ec);
  if (ec) return;
  fs::path part = to;
  part += ".part";
  fs::remove(part, ec);
  if (!fs::copy_file(from, part, ec) || ec) {
    fs::remove(part, ec);
    return;
  }
  if (!fs::exists(fs::symlink_status(to, ec))) fs::rename(part, to, ec);
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
    CopyMissing(it->path(), target / fs::relative(it->path(), source, ec));
  }
}

}  // namespace molvar
