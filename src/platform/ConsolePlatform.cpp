#include "platform/ConsolePlatform.h"

#include <chrono>
#include <ctime>
#include <filesystem>
#include <ostream>

#include "core/DateTime.h"
#include "core/Errors.h"

namespace molvar {

int ConsolePlatform::MsgBox(std::string_view text, std::string_view title, MsgButtons buttons, MsgIcon) {
  messages_ << title << ": " << text << '\n';
  // A "No" never changes an option; an OK lets the job go on as asked on the command line.
  return buttons == MsgButtons::YesNo ? kAnswerNo : kAnswerOK;
}

std::string ConsolePlatform::InputBox(std::string_view prompt, std::string_view title, std::string_view defaultText) {
  messages_ << title << ": " << prompt << " [" << defaultText << "]\n";
  return std::string(defaultText);
}

std::optional<std::string> ConsolePlatform::OpenFileDialog(const FileDialogRequest&) { return NextPath(); }
std::optional<std::string> ConsolePlatform::SaveFileDialog(const FileDialogRequest&) { return NextPath(); }

std::optional<std::string> ConsolePlatform::NextPath() {
  if (dialogPaths.empty()) return std::nullopt;
  std::string path = std::move(dialogPaths.front());
  dialogPaths.pop_front();
  return path;
}

long ConsolePlatform::ShellOpen(std::string_view, std::string_view, std::string_view, std::string_view) {
  return 0;  // not started
}

void ConsolePlatform::StartProgram(std::string_view) { throw RuntimeError(kErrFileNotFound); }
void ConsolePlatform::StartTextEditor(std::string_view) { throw RuntimeError(kErrFileNotFound); }

std::string ConsolePlatform::ProgramFileDate() {
  std::error_code error;
  const auto written = std::filesystem::last_write_time("/proc/self/exe", error);
  if (error) return {};
  const auto seconds = std::chrono::file_clock::to_sys(written);
  const std::time_t t = std::chrono::system_clock::to_time_t(seconds);
  std::tm local{};
  localtime_r(&t, &local);
  char text[16];
  std::strftime(text, sizeof text, "%Y-%m-%d", &local);
  return text;
}

uint32_t ConsolePlatform::TickCount() {
  using namespace std::chrono;
  return static_cast<uint32_t>(duration_cast<milliseconds>(steady_clock::now().time_since_epoch()).count());
}

int64_t ConsolePlatform::Now() {
  const std::time_t now = std::time(nullptr);
  std::tm local{};
  localtime_r(&now, &local);
  return ToSeconds(CivilTime{local.tm_year + 1900, local.tm_mon + 1, local.tm_mday, local.tm_hour, local.tm_min,
                             local.tm_sec});
}

}  // namespace molvar
