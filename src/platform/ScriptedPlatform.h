#pragma once
// A Platform for tests: records every call and answers from queues filled by the test. A question
// without a queued answer is a test error (UnscriptedCall), so no test passes by accident.
#include <deque>
#include <stdexcept>
#include <string>
#include <vector>

#include "platform/Platform.h"

namespace molvar {

class UnscriptedCall : public std::logic_error {
 public:
  using std::logic_error::logic_error;
};

struct RecordedCall {
  std::string service;  // "MsgBox", "InputBox", "OpenFileDialog", "SaveFileDialog", "ShellOpen", ...
  std::string text;     // message or prompt text, shell target, command line
  std::string title;    // box or dialog title, shell verb
  MsgButtons buttons = MsgButtons::OK;
  MsgIcon icon = MsgIcon::None;
  FileDialogRequest dialog;
  std::string parameters;  // shell parameters, input box default
};

class ScriptedPlatform : public Platform {
 public:
  // Answers, consumed in order.
  std::deque<int> msgAnswers;                        // for OKCancel and YesNo boxes
  std::deque<std::string> inputAnswers;              // input boxes
  std::deque<std::optional<std::string>> dialogAnswers;  // open and save dialogs (nullopt = cancel)
  std::deque<long> shellResults;                     // shell open (default: 42, started)
  std::deque<bool> startResults;                     // program start (default: true, started)
  bool internet = false;
  std::string programDate = "2026-12-01";
  int64_t now = 0;
  uint32_t tick = 0;
  uint32_t tickStep = 10;  // each TickCount() call advances the clock

  std::vector<RecordedCall> calls;

  // Only the calls of one service, in order.
  std::vector<RecordedCall> CallsOf(std::string_view service) const;
  std::vector<RecordedCall> Messages() const { return CallsOf("MsgBox"); }

  int MsgBox(std::string_view text, std::string_view title, MsgButtons buttons, MsgIcon icon) override;
  std::string InputBox(std::string_view prompt, std::string_view title, std::string_view defaultText) override;
  std::optional<std::string> OpenFileDialog(const FileDialogRequest& request) override;
  std::optional<std::string> SaveFileDialog(const FileDialogRequest& request) override;
  long ShellOpen(std::string_view verb, std::string_view target, std::string_view parameters,
                 std::string_view folder) override;
  void StartProgram(std::string_view commandLine) override;
  void StartTextEditor(std::string_view file) override;
  std::string ProgramFileDate() override { return programDate; }
  bool InternetAvailable() override;
  void SetTopMost(WindowId window, bool topMost) override;
  void Beep(int frequencyHz, int durationMs) override;
  uint32_t TickCount() override;
  void ProcessEvents() override;
  int64_t Now() override;

 private:
  std::optional<std::string> Dialog(const char* service, const FileDialogRequest& request);
};

}  // namespace molvar
