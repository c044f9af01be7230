#include "core/Errors.h"

#include <cstring>
#include <new>

namespace molvar {

std::string RuntimeError::StandardDescription(int number) {
  switch (number) {
    case kErrInvalidCall: return "Invalid procedure call or argument";
    case kErrOverflow: return "Overflow";
    case kErrSubscript: return "Subscript out of range";
    case kErrDivisionByZero: return "Division by zero";
    case kErrTypeMismatch: return "Type mismatch";
    case kErrBadFileName: return "Bad file name or number";
    case kErrFileNotFound: return "File not found";
    case kErrDiskFull: return "Disk full";
    case kErrPastEndOfFile: return "Input past end of file";
    case kErrPermissionDenied: return "Permission denied";
    case kErrPathFileAccess: return "Path/File access error";
    case kErrPathNotFound: return "Path not found";
    case kErrNoControlElement: return "Control array element does not exist";
    default: return "Application-defined or object-defined error";
  }
}

RuntimeError FileError(int number, const std::string& path, int err) {
  return RuntimeError(number, RuntimeError::StandardDescription(number) + " (" + path + ": " + std::strerror(err) + ")");
}

std::string ErrorDescription(const std::exception& e) {
  if (dynamic_cast<const std::bad_alloc*>(&e) != nullptr) return "Out of memory";
  return e.what();
}

int ErrorNumberOf(const std::exception& e) {
  if (const auto* rt = dynamic_cast<const RuntimeError*>(&e)) return rt->Number();
  if (dynamic_cast<const std::bad_alloc*>(&e) != nullptr) return 7;
  return 51;  // internal error
}

}  // namespace molvar
