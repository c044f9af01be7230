#pragma once
// Text from outside (titles, names, descriptions, file names) on its way into XML. Only what would
// break the document is changed: a bare "&", "<", a quote inside an attribute, control characters
// XML forbids, bytes that are not UTF-8 (taken as Latin-1), and "]]>" inside CDATA. Entity
// references already in the text ("&amp;", "&#176;") stay as they are.
#include <string>
#include <string_view>

namespace molvar {

// Element content.
std::string MarkupText(std::string_view text);
// A double-quoted attribute value.
std::string MarkupAttribute(std::string_view text);
// The inside of <![CDATA[ ... ]]>.
std::string MarkupCdata(std::string_view text);

}  // namespace molvar
