#pragma once
// The services the program asks of the desktop and of outside programs. The GUI, the command
// line and the tests each provide their own.
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace molvar {

enum class MsgButtons { OK, OKCancel, YesNo };
enum class MsgIcon { None, Information, Exclamation, Critical };

inline constexpr int kAnswerOK = 1;
inline constexpr int kAnswerCancel = 2;
inline constexpr int kAnswerYes = 6;
inline constexpr int kAnswerNo = 7;

// A shell-open result above this means the target was started.
inline constexpr long kShellStarted = 32;

struct FileDialogRequest {
  std::string title;
  std::string filter;  // "description|pattern|description|pattern..."
  std::string initialFolder;
  std::string proposedName;
};

enum class WindowId { Main, FtpSetup, IconSelect };

class Platform {
 public:
  virtual ~Platform() = default;

  // Returns kAnswerOK, kAnswerCancel, kAnswerYes or kAnswerNo.
  virtual int MsgBox(std::string_view text, std::string_view title, MsgButtons buttons,
                     MsgIcon icon) = 0;
  // The typed text; empty when cancelled.
  virtual std::string InputBox(std::string_view prompt, std::string_view title,
                               std::string_view defaultText) = 0;
  // The chosen full path; nothing when cancelled.
  virtual std::optional<std::string> OpenFileDialog(const FileDialogRequest& request) = 0;
  virtual std::optional<std::string> SaveFileDialog(const FileDialogRequest& request) = 0;

  // Opens a file, a web address or a "mailto:" text in its associated program (or, for a
  // program target, starts it with `parameters`); above kShellStarted means started.
  virtual long ShellOpen(std::string_view verb, std::string_view target,
                         std::string_view parameters, std::string_view folder) = 0;
  // Starts a program by command line: program path, a blank, the arguments. A program that
  // cannot be started raises RuntimeError "File not found" (53).
  virtual void StartProgram(std::string_view commandLine) = 0;
  // Opens a file in the desktop's default text editor (the program registered for plain text);
  // raises RuntimeError "File not found" (53) when there is none.
  virtual void StartTextEditor(std::string_view file) = 0;
  // The date of the running program's file, "yyyy-mm-dd"; empty when it cannot be read.
  virtual std::string ProgramFileDate() = 0;

  virtual bool InternetAvailable() = 0;
  virtual void SetTopMost(WindowId window, bool topMost) = 0;
  virtual void Beep(int frequencyHz, int durationMs) = 0;
  // Milliseconds since an arbitrary start, for short waits.
  virtual uint32_t TickCount() = 0;
  // Lets pending window events run (a no-op where there are none).
  virtual void ProcessEvents() = 0;
  // The local date and time as seconds from 1899-12-30 00:00:00.
  virtual int64_t Now() = 0;
};

}  // namespace molvar
