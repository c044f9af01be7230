#pragma once
// Text from outside (titles, names, descriptions, file names) on its way into XML. Only what would
// break the document is changed: a bare "&", "<", a quote inside an attribute, control characters
// XML forbids, bytes that are not UTF-8 (taken as Latin-1), and "]]>". References a reader resolves
// without a DTD ("&amp;", "&#176;") stay as they are; any other "&" ("&nbsp;") is escaped.
#include <string>
#include <string_view>

namespace molvar {

// The document's declared encoding: in a UTF-8 document a byte that does not begin a UTF-8
// sequence is taken as Latin-1 and converted; in a Latin-1 document every byte is a character.
enum class MarkupEncoding { Utf8, Latin1 };

// Element content.
std::string MarkupText(std::string_view text, MarkupEncoding encoding = MarkupEncoding::Utf8);
// A double-quoted attribute value.
std::string MarkupAttribute(std::string_view text, MarkupEncoding encoding = MarkupEncoding::Utf8);
// The inside of <![CDATA[ ... ]]>.
std::string MarkupCdata(std::string_view text, MarkupEncoding encoding = MarkupEncoding::Utf8);
// The same, appended to `out` (a line being built) without a string of its own.
void AppendMarkupText(std::string& out, std::string_view text, MarkupEncoding encoding = MarkupEncoding::Utf8);
void AppendMarkupCdata(std::string& out, std::string_view text, MarkupEncoding encoding = MarkupEncoding::Utf8);
// Text inside a comment between fixed text that neither starts nor ends with "-": legal
// characters and no "--" (written "- -").
std::string MarkupComment(std::string_view text);

}  // namespace molvar
