#pragma once
// What the fuzz targets share: a program over a platform that answers every question, in one
// temporary folder kept for the whole run, and a way to cut an input into parts.
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

#include "app/Molvar.h"
#include "platform/ScriptedPlatform.h"
#include "support/TestProgram.h"

namespace molvar::fuzz {

// Answers every box (Yes, OK, the proposed text), cancels dialogs without a queued path, and
// stops the run when an error message shows an exception the program does not raise itself
// (a caught std::out_of_range in a reader is a bug, not a "snag").
class FuzzPlatform : public ScriptedPlatform {
 public:
  int MsgBox(std::string_view text, std::string_view title, MsgButtons buttons, MsgIcon icon) override;
  std::string InputBox(std::string_view prompt, std::string_view title, std::string_view defaultText) override;
  std::optional<std::string> OpenFileDialog(const FileDialogRequest& request) override;
  std::optional<std::string> SaveFileDialog(const FileDialogRequest& request) override;
};

// The folder of the whole run (created once, emptied at exit).
const testing::TempFolder& RunFolder();

// A fresh program per input; the folder is the run's.
struct FuzzProgram {
  FuzzPlatform platform;
  std::unique_ptr<Molvar> m;

  FuzzProgram();
  Molvar& operator*() { return *m; }
  Molvar* operator->() { return m.get(); }
  std::string File(std::string_view name) const { return RunFolder().File(name); }
};

// Sets the options that change what the readers and writers do from the bits of `bits`: colour by
// segment/date/speed, split if stopped, collapse, details, Google Maps output, the test box, a GMT
// offset. Each goes through its control and handler, as a click would.
void ApplyOptions(Molvar& m, uint8_t bits);

// Writes `content` to `path`, replacing it (no fsync).
void WriteFuzzFile(const std::string& path, std::string_view content);

// Input bytes consumed from the front.
struct FuzzInput {
  std::string_view rest;
  FuzzInput(const uint8_t* data, std::size_t size) : rest(reinterpret_cast<const char*>(data), size) {}
  // The next byte (0 when none is left).
  uint8_t Byte();
  // Everything up to the first `separator` (all when absent); the separator is dropped.
  std::string_view Until(char separator) { return Cut(rest, separator); }
  // The same on any text.
  static std::string_view Cut(std::string_view& text, char separator);
};

}  // namespace molvar::fuzz
