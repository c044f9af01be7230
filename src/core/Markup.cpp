#include "core/Markup.h"

namespace molvar {
namespace {

bool IsNameChar(char c) {
  return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '_' ||
         c == '-' || c == '.';
}

bool IsHexDigit(char c) { return (c >= '0' && c <= '9') || (c >= 'a' && c <= 'f') || (c >= 'A' && c <= 'F'); }

// Length of the entity reference ("&name;", "&#123;", "&#x1F;") at the start of `s`, 0 if none.
std::size_t EntityLength(std::string_view s) {
  if (s.size() < 3 || s[0] != '&') return 0;
  std::size_t i = 1;
  if (s[1] == '#') {
    i = 2;
    const bool hex = i < s.size() && (s[i] == 'x' || s[i] == 'X');
    if (hex) ++i;
    const std::size_t digitsStart = i;
    while (i < s.size() && (hex ? IsHexDigit(s[i]) : (s[i] >= '0' && s[i] <= '9'))) ++i;
    if (i == digitsStart) return 0;
  } else {
    const char first = s[1];
    if (!((first >= 'a' && first <= 'z') || (first >= 'A' && first <= 'Z') || first == '_')) return 0;
    while (i < s.size() && IsNameChar(s[i])) ++i;
  }
  return (i < s.size() && s[i] == ';') ? i + 1 : 0;
}

// Length of the well-formed UTF-8 sequence at the start of `s`, 0 if the first byte does not begin one.
std::size_t Utf8SequenceLength(std::string_view s) {
  const auto b0 = static_cast<unsigned char>(s[0]);
  std::size_t n = 0;
  if (b0 >= 0xC2 && b0 <= 0xDF) n = 2;
  else if (b0 >= 0xE0 && b0 <= 0xEF) n = 3;
  else if (b0 >= 0xF0 && b0 <= 0xF4) n = 4;
  else return 0;
  if (s.size() < n) return 0;
  for (std::size_t k = 1; k < n; ++k) {
    if ((static_cast<unsigned char>(s[k]) & 0xC0) != 0x80) return 0;
  }
  const auto b1 = static_cast<unsigned char>(s[1]);
  if (b0 == 0xE0 && b1 < 0xA0) return 0;  // overlong
  if (b0 == 0xED && b1 >= 0xA0) return 0;  // surrogates
  if (b0 == 0xF0 && b1 < 0x90) return 0;
  if (b0 == 0xF4 && b1 >= 0x90) return 0;
  return n;
}

bool IsForbiddenControl(unsigned char c) { return c < 0x20 && c != '\t' && c != '\n' && c != '\r'; }

enum class Context { Text, Attribute, Cdata };

std::string Escape(std::string_view text, Context context, MarkupEncoding encoding) {
  std::string out;
  out.reserve(text.size() + 8);
  for (std::size_t i = 0; i < text.size();) {
    const char c = text[i];
    const auto u = static_cast<unsigned char>(c);
    if (u >= 0x80 && encoding == MarkupEncoding::Utf8) {
      const std::size_t n = Utf8SequenceLength(text.substr(i));
      if (n > 0) {
        out.append(text.substr(i, n));
        i += n;
      } else {
        out += static_cast<char>(0xC0 | (u >> 6));
        out += static_cast<char>(0x80 | (u & 0x3F));
        ++i;
      }
      continue;
    }
    if (IsForbiddenControl(u)) {
      ++i;
      continue;
    }
    if (context == Context::Cdata) {
      if (text.substr(i, 3) == "]]>") {
        out += "]]]]><![CDATA[>";
        i += 3;
      } else {
        out += c;
        ++i;
      }
      continue;
    }
    if (c == '&') {
      const std::size_t n = EntityLength(text.substr(i));
      if (n > 0) {
        out.append(text.substr(i, n));
        i += n;
      } else {
        out += "&amp;";
        ++i;
      }
      continue;
    }
    if (c == '<') out += "&lt;";
    else if (c == '"' && context == Context::Attribute) out += "&quot;";
    else out += c;
    ++i;
  }
  return out;
}

}  // namespace

std::string MarkupText(std::string_view text, MarkupEncoding encoding) {
  return Escape(text, Context::Text, encoding);
}
std::string MarkupAttribute(std::string_view text, MarkupEncoding encoding) {
  return Escape(text, Context::Attribute, encoding);
}
std::string MarkupCdata(std::string_view text, MarkupEncoding encoding) {
  return Escape(text, Context::Cdata, encoding);
}

}  // namespace molvar
