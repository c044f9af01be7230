#include "platform/ScriptedPlatform.h"

#include "core/Errors.h"

namespace molvar {

std::vector<RecordedCall> ScriptedPlatform::CallsOf(std::string_view service) const {
  std::vector<RecordedCall> out;
  for (const auto& c : calls) {
    if (c.service == service) out.push_back(c);
  }
  return out;
}

int ScriptedPlatform::MsgBox(std::string_view text, std::string_view title, MsgButtons buttons,
                             MsgIcon icon) {
  RecordedCall c{"MsgBox", std::string(text), std::string(title), buttons, icon, {}, {}};
  calls.push_back(c);
  if (buttons == MsgButtons::OK) return kAnswerOK;
  if (msgAnswers.empty()) throw UnscriptedCall("no answer queued for the question: " + std::string(text));
  const int answer = msgAnswers.front();
  msgAnswers.pop_front();
  return answer;
}

std::string ScriptedPlatform::InputBox(std::string_view prompt, std::string_view title,
                                       std::string_view defaultText) {
  calls.push_back({"InputBox", std::string(prompt), std::string(title), MsgButtons::OK, MsgIcon::None, {},
                   std::string(defaultText)});
  if (inputAnswers.empty()) throw UnscriptedCall("no answer queued for the input box: " + std::string(prompt));
  std::string answer = inputAnswers.front();
  inputAnswers.pop_front();
  return answer;
}

std::optional<std::string> ScriptedPlatform::Dialog(const char* service, const FileDialogRequest& request) {
  RecordedCall c;
  c.service = service;
  c.title = request.title;
  c.dialog = request;
  calls.push_back(c);
  if (dialogAnswers.empty()) throw UnscriptedCall(std::string("no answer queued for ") + service);
  auto answer = dialogAnswers.front();
  dialogAnswers.pop_front();
  return answer;
}

std::optional<std::string> ScriptedPlatform::OpenFileDialog(const FileDialogRequest& request) {
  return Dialog("OpenFileDialog", request);
}

std::optional<std::string> ScriptedPlatform::SaveFileDialog(const FileDialogRequest& request) {
  return Dialog("SaveFileDialog", request);
}

long ScriptedPlatform::ShellOpen(std::string_view verb, std::string_view target,
                                 std::string_view parameters, std::string_view folder) {
  RecordedCall c{"ShellOpen", std::string(target), std::string(verb), MsgButtons::OK, MsgIcon::None, {},
                 std::string(parameters)};
  c.dialog.initialFolder = std::string(folder);
  calls.push_back(c);
  if (shellResults.empty()) return 42;
  const long r = shellResults.front();
  shellResults.pop_front();
  return r;
}

void ScriptedPlatform::StartProgram(std::string_view commandLine) {
  calls.push_back({"StartProgram", std::string(commandLine), {}, MsgButtons::OK, MsgIcon::None, {}, {}});
  bool ok = true;
  if (!startResults.empty()) {
    ok = startResults.front();
    startResults.pop_front();
  }
  if (!ok) throw RuntimeError(kErrFileNotFound);
}

void ScriptedPlatform::StartTextEditor(std::string_view file) {
  calls.push_back({"StartTextEditor", std::string(file), {}, MsgButtons::OK, MsgIcon::None, {}, {}});
  bool ok = true;
  if (!startResults.empty()) {
    ok = startResults.front();
    startResults.pop_front();
  }
  if (!ok) throw RuntimeError(kErrFileNotFound);
}

bool ScriptedPlatform::InternetAvailable() {
  calls.push_back({"InternetAvailable", {}, {}, MsgButtons::OK, MsgIcon::None, {}, {}});
  return internet;
}

void ScriptedPlatform::SetTopMost(WindowId window, bool topMost) {
  RecordedCall c{"SetTopMost", topMost ? "1" : "0", {}, MsgButtons::OK, MsgIcon::None, {}, {}};
  c.title = window == WindowId::Main ? "Main" : window == WindowId::FtpSetup ? "FtpSetup" : "IconSelect";
  calls.push_back(c);
}

void ScriptedPlatform::Beep(int frequencyHz, int durationMs) {
  calls.push_back({"Beep", std::to_string(frequencyHz), std::to_string(durationMs), MsgButtons::OK,
                   MsgIcon::None, {}, {}});
}

uint32_t ScriptedPlatform::TickCount() {
  tick += tickStep;
  return tick;
}

void ScriptedPlatform::ProcessEvents() {}

int64_t ScriptedPlatform::Now() { return now; }

}  // namespace molvar
