#pragma once
// Text helpers with the 1-based semantics the procedures are written in. Every function is safe at
// every boundary: a position below 1 counts as 1, a position past the end gives empty text, a
// negative length counts as 0. Text is 8-bit; case mapping touches ASCII letters only.
#include <array>
#include <cstddef>
#include <string>
#include <string_view>

namespace molvar {

// Characters from 1-based `start` to the end, or `length` characters from `start`.
std::string_view Mid(std::string_view s, long start);
std::string_view Mid(std::string_view s, long start, long length);
std::string_view Left(std::string_view s, long count);
std::string_view Right(std::string_view s, long count);

// 1-based position of `find` in `s` at or after `start`, 0 when absent. An empty `find` is found
// at `start` (when `start` is within the text or just past it).
long InStr(std::string_view s, std::string_view find);
long InStr(long start, std::string_view s, std::string_view find);
// The same, comparing ASCII letters without regard to case.
long InStrNoCase(std::string_view s, std::string_view find);
long InStrNoCase(long start, std::string_view s, std::string_view find);
// 1-based position of the last occurrence, 0 when absent.
long InStrRev(std::string_view s, std::string_view find);

bool Contains(std::string_view s, std::string_view find);
bool StartsWith(std::string_view s, std::string_view prefix);

// Trim removes blanks (the space character) only, as the file formats expect.
std::string_view Trim(std::string_view s);
std::string_view LTrim(std::string_view s);
std::string_view RTrim(std::string_view s);

std::string UCase(std::string_view s);
std::string LCase(std::string_view s);
inline char UpperChar(char c) { return (c >= 'a' && c <= 'z') ? static_cast<char>(c - 32) : c; }
inline char LowerChar(char c) { return (c >= 'A' && c <= 'Z') ? static_cast<char>(c + 32) : c; }
bool EqualsNoCase(std::string_view a, std::string_view b);

// Replaces at most `count` occurrences (all when count < 0).
std::string Replace(std::string_view s, std::string_view find, std::string_view with,
                    long count = -1);

// First letter of every blank-separated word upper-case, the others lower-case.
std::string ProperCase(std::string_view s);

// The text before the first `sep` (all of it when absent) and the text after it (empty when absent).
std::string_view TextBefore(std::string_view s, std::string_view sep);
std::string_view TextAfter(std::string_view s, std::string_view sep);

// Text after the last path separator ("/" or "\"), and the folder before it (empty when none).
std::string_view FileNameOf(std::string_view path);
std::string_view FolderOf(std::string_view path);

// Fields of a delimited line, numbered from 1. At most kMaxFields are kept; a separator moves to
// the next field (consecutive separators give empty fields). When `tabJoins` is set, a separator
// right after a TAB does not move to the next field. An empty line has no fields.
struct Fields {
  static constexpr int kMaxFields = 25;
  std::array<std::string_view, kMaxFields + 1> field{};  // index 0 unused
  int count = 0;

  // Field i (1-based); empty when it does not exist.
  std::string_view operator[](int i) const {
    const auto k = static_cast<std::size_t>(i);
    return (i >= 1 && i <= count && k < field.size()) ? field[k] : std::string_view{};
  }
};
Fields SplitFields(std::string_view line, std::string_view separators, bool tabJoins = false);

}  // namespace molvar
