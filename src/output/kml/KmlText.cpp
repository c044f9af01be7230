#include "output/kml/KmlText.h"

#include <cstdint>

#include "core/Markup.h"
#include "core/Text.h"

namespace molvar {
namespace {

bool IsLegalXmlChar(uint32_t c) {
  return c == 0x9 || c == 0xA || c == 0xD || (c >= 0x20 && c <= 0xD7FF) || (c >= 0xE000 && c <= 0xFFFD) ||
         (c >= 0x10000 && c <= 0x10FFFF);
}

// Whether `ref` (the text between "&" and ";") is a reference that needs no DTD.
bool IsResolvableReference(std::string_view ref) {
  if (ref == "amp" || ref == "lt" || ref == "gt" || ref == "quot" || ref == "apos") return true;
  if (ref.size() < 2 || ref[0] != '#') return false;
  const bool hex = ref[1] == 'x' || ref[1] == 'X';
  const std::string_view digits = ref.substr(hex ? 2 : 1);
  if (digits.empty() || digits.size() > 8) return false;
  uint32_t value = 0;
  for (const char c : digits) {
    uint32_t d = 0;
    if (c >= '0' && c <= '9') d = static_cast<uint32_t>(c - '0');
    else if (hex && c >= 'a' && c <= 'f') d = static_cast<uint32_t>(c - 'a' + 10);
    else if (hex && c >= 'A' && c <= 'F') d = static_cast<uint32_t>(c - 'A' + 10);
    else return false;
    value = value * (hex ? 16u : 10u) + d;
  }
  return IsLegalXmlChar(value);
}

}  // namespace

std::string KmlText(std::string_view text) {
  // The shared escaping leaves every "&" at the start of a reference; only those a reader cannot
  // resolve are escaped again here.
  const std::string escaped = MarkupText(text);
  std::string out;
  out.reserve(escaped.size() + 8);
  for (std::size_t i = 0; i < escaped.size(); ++i) {
    const char c = escaped[i];
    if (c == '&') {
      const std::size_t semicolon = escaped.find(';', i);
      const bool keep =
          semicolon != std::string::npos && IsResolvableReference(std::string_view(escaped).substr(i + 1, semicolon - i - 1));
      out += keep ? "&" : "&amp;";
    } else if (c == '>' && i >= 2 && escaped[i - 1] == ']' && escaped[i - 2] == ']') {
      out += "&gt;";
    } else {
      out += c;
    }
  }
  return out;
}

std::string CommentText(std::string_view text) {
  // Character data rules give legal characters; "]]>" is harmless in a comment, so it is kept
  // rather than split the way character data needs.
  std::string s;
  std::size_t from = 0;
  while (true) {
    const std::size_t at = text.find("]]>", from);
    s += MarkupCdata(text.substr(from, at == std::string_view::npos ? std::string_view::npos : at - from));
    if (at == std::string_view::npos) break;
    s += "]]>";
    from = at + 3;
  }
  // "- -" may meet a following "-" again ("---").
  while (Contains(s, "--")) s = Replace(s, "--", "- -");
  return s;
}

}  // namespace molvar
