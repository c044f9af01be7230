#pragma once
// The platform of the command line: messages go to stderr as "title: text", questions take the
// answer that leaves the user's options as they are, and nothing is ever opened or started.
#include <deque>
#include <iosfwd>
#include <string>

#include "platform/Platform.h"

namespace molvar {

class ConsolePlatform : public Platform {
 public:
  explicit ConsolePlatform(std::ostream& messages) : messages_(messages) {}

  // The files the open and save dialogs "choose", in order; a dialog with none left is cancelled.
  std::deque<std::string> dialogPaths;

  int MsgBox(std::string_view text, std::string_view title, MsgButtons buttons, MsgIcon icon) override;
  std::string InputBox(std::string_view prompt, std::string_view title, std::string_view defaultText) override;
  std::optional<std::string> OpenFileDialog(const FileDialogRequest& request) override;
  std::optional<std::string> SaveFileDialog(const FileDialogRequest& request) override;
  long ShellOpen(std::string_view verb, std::string_view target, std::string_view parameters,
                 std::string_view folder) override;
  void StartProgram(std::string_view commandLine) override;
  void StartTextEditor(std::string_view file) override;
  std::string ProgramFileDate() override;
  bool InternetAvailable() override { return false; }
  void SetTopMost(WindowId, bool) override {}
  void Beep(int, int) override {}
  uint32_t TickCount() override;
  void ProcessEvents() override {}
  int64_t Now() override;

 private:
  std::optional<std::string> NextPath();
  std::ostream& messages_;
};

}  // namespace molvar
