#include "core/Markup.h"

#include <gtest/gtest.h>

namespace molvar {
namespace {

TEST(MarkupText, EscapesOnlyWhatBreaksTheDocument) {
  EXPECT_EQ(MarkupText("Tom & Jerry <trip>"), "Tom &amp; Jerry &lt;trip>");
  EXPECT_EQ(MarkupText("already &amp; &lt; &#176; &#xB0;"), "already &amp; &lt; &#176; &#xB0;");
  // Without a DTD a reader cannot resolve these, so they are text, not references.
  EXPECT_EQ(MarkupText("&nbsp; &#0; &#xD800;"), "&amp;nbsp; &amp;#0; &amp;#xD800;");
  EXPECT_EQ(MarkupText("a ]]> b"), "a ]]&gt; b");
  EXPECT_EQ(MarkupText("&; &#; &#x; &1a; & end &"), "&amp;; &amp;#; &amp;#x; &amp;1a; &amp; end &amp;");
  EXPECT_EQ(MarkupText("say \"hi\" 'x' >"), "say \"hi\" 'x' >");
  EXPECT_EQ(MarkupText(""), "");
}

TEST(MarkupText, BytesAndControls) {
  EXPECT_EQ(MarkupText("45\xC2\xB0N"), "45\xC2\xB0N");  // UTF-8 kept
  EXPECT_EQ(MarkupText("45\xB0N"), "45\xC2\xB0N");       // Latin-1 degree sign converted
  EXPECT_EQ(MarkupText("caf\xE9"), "caf\xC3\xA9");
  EXPECT_EQ(MarkupText("\xE2\x82"), "\xC3\xA2\xC2\x82");  // truncated sequence
  EXPECT_EQ(MarkupText("caf\xE9 & \xC2", MarkupEncoding::Latin1), "caf\xE9 &amp; \xC2");
  EXPECT_EQ(MarkupText(std::string("a\0b\x01\x1f\tc\r\n", 9)), "ab\tc\r\n");
}

TEST(MarkupAttribute, QuotesToo) {
  EXPECT_EQ(MarkupAttribute("a\"b&c"), "a&quot;b&amp;c");
}

TEST(MarkupCdata, OnlyTheClosingMark) {
  EXPECT_EQ(MarkupCdata("<b>x & y</b>"), "<b>x & y</b>");
  EXPECT_EQ(MarkupCdata("a]]>b"), "a]]]]><![CDATA[>b");
}

}  // namespace
}  // namespace molvar
