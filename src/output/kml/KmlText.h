#pragma once
// Outside text (titles, names, descriptions, typed values, paths) on its way into a KML document.
// On top of the shared markup escaping, element content must not hold "]]>" and may keep only the
// references an XML reader resolves without a DTD ("&amp;", "&lt;", "&gt;", "&quot;", "&apos;" and
// character references to legal characters): Google Earth, GDAL and gpsbabel reject the rest.
#include <string>
#include <string_view>

namespace molvar {

// Element content: "A & B <1>" gives "A &amp; B &lt;1>", "&amp;" stays, "&nbsp;" becomes
// "&amp;nbsp;", "]]>" becomes "]]&gt;".
std::string KmlText(std::string_view text);
// Text inside a comment, between fixed text that neither starts nor ends with "-": legal
// characters and no "--" (written "- -").
std::string CommentText(std::string_view text);

}  // namespace molvar
