#include "core/Text.h"

#include <algorithm>
#include <cstring>

namespace molvar {

std::string_view Mid(std::string_view s, long start) {
  if (start < 1) start = 1;
  const auto from = static_cast<std::size_t>(start - 1);
  if (from >= s.size()) return {};
  return s.substr(from);
}

std::string_view Mid(std::string_view s, long start, long length) {
  if (length <= 0) return {};
  if (start < 1) start = 1;
  const auto from = static_cast<std::size_t>(start - 1);
  if (from >= s.size()) return {};
  return s.substr(from, static_cast<std::size_t>(length));
}

std::string_view Left(std::string_view s, long count) {
  if (count <= 0) return {};
  return s.substr(0, std::min(s.size(), static_cast<std::size_t>(count)));
}

std::string_view Right(std::string_view s, long count) {
  if (count <= 0) return {};
  const auto n = std::min(s.size(), static_cast<std::size_t>(count));
  return s.substr(s.size() - n);
}

long InStr(std::string_view s, std::string_view find) { return InStr(1, s, find); }

long InStr(long start, std::string_view s, std::string_view find) {
  if (start < 1) start = 1;
  const auto from = static_cast<std::size_t>(start - 1);
  if (from > s.size()) return 0;
  const auto p = s.find(find, from);
  return p == std::string_view::npos ? 0 : static_cast<long>(p) + 1;
}


long InStrNoCase(std::string_view s, std::string_view find) { return InStrNoCase(1, s, find); }

long InStrNoCase(long start, std::string_view s, std::string_view find) {
  if (start < 1) start = 1;
  const auto from = static_cast<std::size_t>(start - 1);
  if (from > s.size()) return 0;
  if (find.empty()) return start;
  if (find.size() > s.size() - from) return 0;
  // A character without case (the "<" of a tag, the "=" of an attribute) is found with memchr;
  // every occurrence of `find` holds it at the same offset, so they come in order.
  std::size_t anchor = 0;
  while (anchor < find.size() && LowerChar(find[anchor]) != UpperChar(find[anchor])) ++anchor;
  const auto matchesAt = [&](std::size_t i) {
    for (std::size_t k = 0; k < find.size(); ++k) {
      if (LowerChar(s[i + k]) != LowerChar(find[k])) return false;
    }
    return true;
  };
  const std::size_t last = s.size() - find.size();  // the last place a match can start
  if (anchor == find.size()) {
    for (std::size_t i = from; i <= last; ++i) {
      if (matchesAt(i)) return static_cast<long>(i) + 1;
    }
    return 0;
  }
  const char mark = find[anchor];
  std::size_t scan = from + anchor;
  while (scan <= last + anchor) {
    const auto* hit = static_cast<const char*>(std::memchr(s.data() + scan, mark, last + anchor + 1 - scan));
    if (!hit) return 0;
    const auto i = static_cast<std::size_t>(hit - s.data()) - anchor;
    if (matchesAt(i)) return static_cast<long>(i) + 1;
    scan = i + anchor + 1;
  }
  return 0;
}

long InStrRev(std::string_view s, std::string_view find) {
  const auto p = s.rfind(find);
  return p == std::string_view::npos ? 0 : static_cast<long>(p) + 1;
}

bool Contains(std::string_view s, std::string_view find) {
  return s.find(find) != std::string_view::npos;
}

bool StartsWith(std::string_view s, std::string_view prefix) {
  return s.substr(0, prefix.size()) == prefix;
}

std::string_view LTrim(std::string_view s) {
  const auto p = s.find_first_not_of(' ');
  return p == std::string_view::npos ? std::string_view{} : s.substr(p);
}

std::string_view RTrim(std::string_view s) {
  const auto p = s.find_last_not_of(' ');
  return p == std::string_view::npos ? std::string_view{} : s.substr(0, p + 1);
}

std::string_view Trim(std::string_view s) { return RTrim(LTrim(s)); }

std::string UCase(std::string_view s) {
  std::string out(s);
  for (char& c : out) c = UpperChar(c);
  return out;
}

std::string LCase(std::string_view s) {
  std::string out(s);
  for (char& c : out) c = LowerChar(c);
  return out;
}

bool EqualsNoCase(std::string_view a, std::string_view b) {
  if (a.size() != b.size()) return false;
  for (std::size_t i = 0; i < a.size(); ++i) {
    if (LowerChar(a[i]) != LowerChar(b[i])) return false;
  }
  return true;
}

std::string Replace(std::string_view s, std::string_view find, std::string_view with, long count) {
  if (find.empty()) return std::string(s);
  std::string out;
  out.reserve(s.size());
  std::size_t pos = 0;
  long done = 0;
  while (count < 0 || done < count) {
    const auto p = s.find(find, pos);
    if (p == std::string_view::npos) break;
    out.append(s.substr(pos, p - pos));
    out.append(with);
    pos = p + find.size();
    ++done;
  }
  out.append(s.substr(pos));
  return out;
}

std::string ProperCase(std::string_view s) {
  std::string out(s);
  bool wordStart = true;
  for (char& c : out) {
    if (c == ' ' || c == '\t') {
      wordStart = true;
      continue;
    }
    c = wordStart ? UpperChar(c) : LowerChar(c);
    wordStart = false;
  }
  return out;
}

std::string_view TextBefore(std::string_view s, std::string_view sep) {
  const auto p = s.find(sep);
  return p == std::string_view::npos ? s : s.substr(0, p);
}

std::string_view TextAfter(std::string_view s, std::string_view sep) {
  const auto p = s.find(sep);
  return p == std::string_view::npos ? std::string_view{} : s.substr(p + sep.size());
}

std::string_view FileNameOf(std::string_view path) {
  const auto p = path.find_last_of("/\\");
  return p == std::string_view::npos ? path : path.substr(p + 1);
}

std::string_view FolderOf(std::string_view path) {
  const auto p = path.find_last_of("/\\");
  return p == std::string_view::npos ? std::string_view{} : path.substr(0, p);
}

Fields SplitFields(std::string_view line, std::string_view separators, bool tabJoins) {
  Fields f;
  if (line.empty()) return f;
  std::size_t fieldStart = 0;
  int index = 1;
  char previous = '\0';
  auto close = [&](std::size_t end) {
    if (index <= Fields::kMaxFields) {
      f.field[static_cast<std::size_t>(index)] = line.substr(fieldStart, end - fieldStart);
      f.count = index;
    }
  };
  for (std::size_t i = 0; i < line.size(); ++i) {
    const char c = line[i];
    if (separators.find(c) != std::string_view::npos) {
      if (tabJoins && previous == '\t') {
        // Joined separator: it belongs to neither field.
        if (fieldStart == i) fieldStart = i + 1;
      } else {
        close(i);
        ++index;
        fieldStart = i + 1;
        if (index > Fields::kMaxFields) return f;
      }
    }
    previous = c;
  }
  close(line.size());
  return f;
}

}  // namespace molvar
