#include "FuzzProgram.h"

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>

#include "app/Options.h"
#include "core/Errors.h"

// Durability is not under test, and a disk flush per input (settings, track data, the rewrite of
// a file with bare line feeds) would slow the runs a hundredfold. The definition in the executable
// takes the place of the C library's for every call the program makes.
extern "C" int fsync(int) { return 0; }

namespace molvar::fuzz {
namespace {

// The descriptions of the errors the program raises itself (RuntimeError) and of running out of
// memory. A message with any other description shows an exception from a bug.
bool IsProgramErrorDescription(std::string_view description) {
  static constexpr int kNumbers[] = {kErrInvalidCall,      kErrOverflow,      kErrSubscript,      kErrDivisionByZero,
                                     kErrTypeMismatch,     kErrBadFileName,   kErrFileNotFound,   kErrDiskFull,
                                     kErrPastEndOfFile,    kErrPermissionDenied, kErrPathFileAccess, kErrPathNotFound,
                                     kErrNoControlElement, 0};
  if (description.starts_with("Out of memory")) return true;
  for (const int n : kNumbers) {
    if (description.starts_with(RuntimeError::StandardDescription(n))) return true;
  }
  return false;
}

// "<procedure> snag <description>" (input side) and "<procedure> bug <description>" (output side).
void CheckErrorMessage(std::string_view text, std::string_view title) {
  std::string_view marker;
  if (title == " Whoa! An error!") marker = " snag ";
  else if (title == "Error") marker = " bug ";
  else return;
  const std::size_t at = text.find(marker);
  if (at == std::string_view::npos) return;
  const std::string_view description = text.substr(at + marker.size());
  if (IsProgramErrorDescription(description)) return;
  std::fprintf(stderr, "==fuzz== unexpected exception reached an error box: %.*s\n", static_cast<int>(text.size()),
               text.data());
  std::abort();
}

}  // namespace

int FuzzPlatform::MsgBox(std::string_view text, std::string_view title, MsgButtons buttons, MsgIcon icon) {
  CheckErrorMessage(text, title);
  if (msgAnswers.empty()) msgAnswers.push_back(buttons == MsgButtons::YesNo ? kAnswerYes : kAnswerOK);
  return ScriptedPlatform::MsgBox(text, title, buttons, icon);
}

std::string FuzzPlatform::InputBox(std::string_view prompt, std::string_view title, std::string_view defaultText) {
  if (inputAnswers.empty()) inputAnswers.emplace_back(defaultText);
  return ScriptedPlatform::InputBox(prompt, title, defaultText);
}

std::optional<std::string> FuzzPlatform::OpenFileDialog(const FileDialogRequest& request) {
  if (dialogAnswers.empty()) dialogAnswers.emplace_back(std::nullopt);
  return ScriptedPlatform::OpenFileDialog(request);
}

std::optional<std::string> FuzzPlatform::SaveFileDialog(const FileDialogRequest& request) {
  if (dialogAnswers.empty()) dialogAnswers.emplace_back(std::nullopt);
  return ScriptedPlatform::SaveFileDialog(request);
}

const testing::TempFolder& RunFolder() {
  static const testing::TempFolder folder;
  return folder;
}

// Each input starts in an empty folder, so no file of an earlier input changes what it does. Files
// are removed rather than truncated or renamed over: on ext4 both of those start a write-back of
// the old data, and on a busy disk that stalled an input past the 1 s hang limit.
static void EmptyRunFolder() {
  std::error_code ec;
  for (const auto& entry : std::filesystem::directory_iterator(RunFolder().path(), ec)) {
    std::error_code ignored;
    std::filesystem::remove_all(entry.path(), ignored);
  }
}

FuzzProgram::FuzzProgram() : m(std::make_unique<Molvar>(platform, RunFolder().path().string())) { EmptyRunFolder(); }

void ApplyOptions(Molvar& m, uint8_t bits) {
  auto& f = m.frmMain;
  if (const int colour = bits & 3; colour != 0) {
    f.chkSplitColor(colour - 1).Value = 1;
    ApplySplitColor(m, colour - 1);
  }
  f.chkSplitIfStopped.Value = (bits >> 2) & 1;
  ApplySplitIfStopped(m);
  f.chkCollapse.Value = (bits >> 3) & 1;
  ApplyCollapse(m);
  f.chkDetailed.Value = (bits >> 4) & 1;
  ApplyDetailed(m);
  SelectOutputMode(m, (bits >> 5) & 1);
  m.TestMode = static_cast<int16_t>((bits >> 6) & 1);
  f.chkAuto.Value = 0;
  ApplyAutoOpen(m);
  if ((bits >> 7) & 1) {
    f.txtGMT.Text = "-5.5";
    ApplyGmtText(m);
  }
}

void WriteFuzzFile(const std::string& path, std::string_view content) {
  std::error_code ignored;
  std::filesystem::remove(path, ignored);
  std::ofstream out(path, std::ios::binary);
  out.write(content.data(), static_cast<std::streamsize>(content.size()));
  if (!out) {
    std::fprintf(stderr, "==fuzz== cannot write %s\n", path.c_str());
    std::abort();
  }
}

uint8_t FuzzInput::Byte() {
  if (rest.empty()) return 0;
  const auto b = static_cast<uint8_t>(rest.front());
  rest.remove_prefix(1);
  return b;
}

std::string_view FuzzInput::Cut(std::string_view& text, char separator) {
  const std::size_t at = text.find(separator);
  const std::string_view part = text.substr(0, at);
  text = at == std::string_view::npos ? std::string_view{} : text.substr(at + 1);
  return part;
}

}  // namespace molvar::fuzz
