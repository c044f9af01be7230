#pragma once
// Run-time errors carry the classic error numbers, because the program's own messages show them
// (" No big deal, but..." prints the number, the "snag"/"bug" boxes print the description).
#include <stdexcept>
#include <string>

namespace molvar {

enum ErrorNumber : int {
  kErrInvalidCall = 5,
  kErrOverflow = 6,
  kErrSubscript = 9,
  kErrDivisionByZero = 11,
  kErrTypeMismatch = 13,
  kErrBadFileName = 52,
  kErrFileNotFound = 53,
  kErrDiskFull = 61,
  kErrPastEndOfFile = 62,
  kErrPermissionDenied = 70,
  kErrPathFileAccess = 75,
  kErrPathNotFound = 76,
  kErrNoControlElement = 340,
};

class RuntimeError : public std::runtime_error {
 public:
  RuntimeError(int number, const std::string& description)
      : std::runtime_error(description), number_(number) {}
  explicit RuntimeError(int number) : RuntimeError(number, StandardDescription(number)) {}

  int Number() const { return number_; }
  std::string Description() const { return what(); }

  static std::string StandardDescription(int number);

 private:
  int number_;
};

// A failed file operation: error `number` with its standard description, the file and the
// system's reason for `err` (an errno value): "Disk full (/data/out.kml: No space left on device)".
RuntimeError FileError(int number, const std::string& path, int err);

// The description a handler shows for any exception that reached it.
std::string ErrorDescription(const std::exception& e);
int ErrorNumberOf(const std::exception& e);

}  // namespace molvar
