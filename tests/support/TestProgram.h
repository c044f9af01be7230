#pragma once
// A program state over a scripted platform, in a fresh temporary folder, for tests.
#include <filesystem>
#include <memory>
#include <string>

#include "app/Molvar.h"
#include "platform/ScriptedPlatform.h"

namespace molvar::testing {

// A folder under the system temp folder, removed with everything in it on destruction.
class TempFolder {
 public:
  TempFolder();
  ~TempFolder();
  TempFolder(const TempFolder&) = delete;
  TempFolder& operator=(const TempFolder&) = delete;
  const std::filesystem::path& path() const { return path_; }
  std::string File(std::string_view name) const { return (path_ / name).string(); }

 private:
  std::filesystem::path path_;
};

struct TestProgram {
  TempFolder folder;
  ScriptedPlatform platform;
  std::unique_ptr<Molvar> m = std::make_unique<Molvar>(platform, folder.path().string());

  Molvar& operator*() { return *m; }
  Molvar* operator->() { return m.get(); }

  // Appends a point the way a reader does: count, grow, fill, then speed and distance.
  void AddPoint(double lat, double lon, std::string_view time, double speed = 0);
};

// Text with NUL and other bytes, without the literal's closing NUL.
template <std::size_t N>
std::string Bytes(const char (&s)[N]) {
  return std::string(s, N - 1);
}

std::string ReadFile(const std::string& path);
void WriteFile(const std::string& path, std::string_view content);

}  // namespace molvar::testing
