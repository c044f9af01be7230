#pragma once
// Helpers of the fault tests: a file-size limit standing in for a full disk, a folder that cannot
// be written to, the names in a folder.
#include <sys/resource.h>

#include <csignal>
#include <filesystem>
#include <string>
#include <vector>

namespace molvar::testing {

// Root writes into any folder whatever its mode, so a read-only folder is no obstacle then.
bool RunningAsRoot();

// While it lives, no file of this process grows past `bytes`: writes beyond fail with EFBIG as
// they would on a full disk (SIGXFSZ ignored). Restores the limit and the signal's handling.
class FileSizeLimit {
 public:
  explicit FileSizeLimit(rlim_t bytes);
  ~FileSizeLimit();
  FileSizeLimit(const FileSizeLimit&) = delete;
  FileSizeLimit& operator=(const FileSizeLimit&) = delete;

 private:
  rlimit old_{};
  void (*oldHandler_)(int) = SIG_DFL;
};

// Removes write permission from a folder while it lives (no effect on root).
class ReadOnlyFolder {
 public:
  explicit ReadOnlyFolder(std::filesystem::path folder);
  ~ReadOnlyFolder();
  ReadOnlyFolder(const ReadOnlyFolder&) = delete;
  ReadOnlyFolder& operator=(const ReadOnlyFolder&) = delete;

 private:
  std::filesystem::path folder_;
  std::filesystem::perms old_;
};

// The names in `folder`, sorted.
std::vector<std::string> NamesIn(const std::filesystem::path& folder);

// Sizes of a file at which a write of `size` bytes is cut: nothing, one byte, a little, the
// middle, one byte short.
std::vector<std::size_t> CutPoints(std::size_t size);

}  // namespace molvar::testing
