#include "support/Faults.h"

#include <unistd.h>

#include <algorithm>
#include <stdexcept>

namespace molvar::testing {

bool RunningAsRoot() { return ::geteuid() == 0; }

FileSizeLimit::FileSizeLimit(rlim_t bytes) {
  if (::getrlimit(RLIMIT_FSIZE, &old_) != 0) throw std::runtime_error("getrlimit failed");
  rlimit limit = old_;
  limit.rlim_cur = bytes;
  oldHandler_ = std::signal(SIGXFSZ, SIG_IGN);
  if (::setrlimit(RLIMIT_FSIZE, &limit) != 0) throw std::runtime_error("setrlimit failed");
}

FileSizeLimit::~FileSizeLimit() {
  ::setrlimit(RLIMIT_FSIZE, &old_);
  std::signal(SIGXFSZ, oldHandler_);
}

ReadOnlyFolder::ReadOnlyFolder(std::filesystem::path folder)
    : folder_(std::move(folder)), old_(std::filesystem::status(folder_).permissions()) {
  std::filesystem::permissions(folder_, std::filesystem::perms::owner_read | std::filesystem::perms::owner_exec);
}

ReadOnlyFolder::~ReadOnlyFolder() {
  std::error_code ignored;
  std::filesystem::permissions(folder_, old_, ignored);
}

std::vector<std::string> NamesIn(const std::filesystem::path& folder) {
  std::vector<std::string> names;
  for (const auto& entry : std::filesystem::directory_iterator(folder)) names.push_back(entry.path().filename().string());
  std::sort(names.begin(), names.end());
  return names;
}

std::vector<std::size_t> CutPoints(std::size_t size) {
  if (size < 2) throw std::invalid_argument("a file of at least 2 bytes is needed");
  return {0, 1, std::min<std::size_t>(100, size - 1), size / 2, size - 1};
}

}  // namespace molvar::testing
