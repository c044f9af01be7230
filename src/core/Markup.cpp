#include "core/Markup.h"

#include <cstdint>

#include "core/Text.h"

namespace molvar {
namespace {

bool IsLegalXmlChar(uint32_t c) {
  return c == 0x9 || c == 0xA || c == 0xD || (c >= 0x20 && c <= 0xD7FF) || (c >= 0xE000 && c <= 0xFFFD) ||
         (c >= 0x10000 && c <= 0x10FFFF);
}

// Whether `ref` (the text between "&" and ";") is a reference a reader resolves without a DTD:
// the five predefined entities and character references to legal characters.
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

// Length of the resolvable reference ("&amp;", "&#176;") at the start of `s`, 0 if none.
std::size_t EntityLength(std::string_view s) {
  const std::size_t semicolon = s.find(';');
  if (s.empty() || s[0] != '&' || semicolon == std::string_view::npos || semicolon > 12) return 0;
  return IsResolvableReference(s.substr(1, semicolon - 1)) ? semicolon + 1 : 0;
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

// Bytes that always pass unchanged; runs of them are copied at once.
bool IsPlain(char c) {
  const auto u = static_cast<unsigned char>(c);
  return u >= 0x20 && u < 0x80 && c != '&' && c != '<' && c != '>' && c != '"' && c != ']';
}

void EscapeInto(std::string& out, std::string_view text, Context context, MarkupEncoding encoding) {
  const std::size_t begin = out.size();
  for (std::size_t i = 0; i < text.size();) {
    std::size_t run = i;
    while (run < text.size() && IsPlain(text[run])) ++run;
    if (run > i) {
      out.append(text.data() + i, run - i);
      i = run;
      continue;
    }
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
    else if (c == '>' && out.size() - begin >= 2 && out.compare(out.size() - 2, 2, "]]") == 0) out += "&gt;";
    else if (c == '"' && context == Context::Attribute) out += "&quot;";
    else out += c;
    ++i;
  }
}

std::string Escape(std::string_view text, Context context, MarkupEncoding encoding) {
  std::string out;
  out.reserve(text.size() + 8);
  EscapeInto(out, text, context, encoding);
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

void AppendMarkupText(std::string& out, std::string_view text, MarkupEncoding encoding) {
  EscapeInto(out, text, Context::Text, encoding);
}
void AppendMarkupCdata(std::string& out, std::string_view text, MarkupEncoding encoding) {
  EscapeInto(out, text, Context::Cdata, encoding);
}

std::string MarkupComment(std::string_view text) {
  // "]]>" is harmless in a comment, so it is kept rather than split the way CDATA needs.
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
