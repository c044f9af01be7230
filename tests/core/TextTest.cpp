#include "core/Text.h"

#include <gtest/gtest.h>

namespace molvar {
namespace {

TEST(Substrings, AreSafeAtEveryBoundary) {
  EXPECT_EQ(Mid("abcdef", 3), "cdef");
  EXPECT_EQ(Mid("abcdef", 3, 2), "cd");
  EXPECT_EQ(Mid("abcdef", 0, 2), "ab");
  EXPECT_EQ(Mid("abcdef", -5), "abcdef");
  EXPECT_EQ(Mid("abcdef", 7), "");
  EXPECT_EQ(Mid("abcdef", 100, 3), "");
  EXPECT_EQ(Mid("abcdef", 5, 100), "ef");
  EXPECT_EQ(Mid("abcdef", 2, -1), "");
  EXPECT_EQ(Mid("", 1, 1), "");
  EXPECT_EQ(Left("abc", 2), "ab");
  EXPECT_EQ(Left("abc", 9), "abc");
  EXPECT_EQ(Left("abc", -1), "");
  EXPECT_EQ(Right("abc", 2), "bc");
  EXPECT_EQ(Right("abc", 9), "abc");
  EXPECT_EQ(Right("", 3), "");
}

TEST(Find, OneBasedPositionsAndZeroWhenAbsent) {
  EXPECT_EQ(InStr("hello world", "o"), 5);
  EXPECT_EQ(InStr(6, "hello world", "o"), 8);
  EXPECT_EQ(InStr(0, "hello", "h"), 1);
  EXPECT_EQ(InStr(99, "hello", "h"), 0);
  EXPECT_EQ(InStr("hello", "z"), 0);
  EXPECT_EQ(InStr("", "z"), 0);
  EXPECT_EQ(InStr("abc", ""), 1);
  EXPECT_EQ(InStrNoCase("<TrkPt lat=", "<trkpt"), 1);
  EXPECT_EQ(InStrNoCase(2, "xTxT", "t"), 2);
  EXPECT_EQ(InStrRev("a/b/c", "/"), 4);
  EXPECT_EQ(InStrRev("abc", "/"), 0);
  EXPECT_EQ(InStrRev("", "/"), 0);
}

TEST(TrimAndCase, BlanksOnlyAndAsciiOnly) {
  EXPECT_EQ(Trim("  a b  "), "a b");
  EXPECT_EQ(Trim("\tx\t"), "\tx\t");
  EXPECT_EQ(Trim("   "), "");
  EXPECT_EQ(LTrim("  a "), "a ");
  EXPECT_EQ(RTrim("  a "), "  a");
  EXPECT_EQ(UCase("abc-\xe9"), "ABC-\xe9");
  EXPECT_EQ(LCase("ABC"), "abc");
  EXPECT_TRUE(EqualsNoCase("GPRMC", "gprmc"));
  EXPECT_FALSE(EqualsNoCase("GPRMC", "gprm"));
  EXPECT_EQ(ProperCase("hELLO wORLD"), "Hello World");
}

TEST(ReplaceAndSplitAt, CountsAndAbsentSeparators) {
  EXPECT_EQ(Replace("a,b,c", ",", ";"), "a;b;c");
  EXPECT_EQ(Replace("a,b,c", ",", ";", 1), "a;b,c");
  EXPECT_EQ(Replace("aaa", "", "x"), "aaa");
  EXPECT_EQ(Replace("aa", "a", "aa"), "aaaa");
  EXPECT_EQ(TextBefore("2007-03-14 12:00:00", " "), "2007-03-14");
  EXPECT_EQ(TextBefore("nospace", " "), "nospace");
  EXPECT_EQ(TextAfter("key=value=x", "="), "value=x");
  EXPECT_EQ(TextAfter("nokey", "="), "");
  EXPECT_EQ(FileNameOf("/home/u/track.gpx"), "track.gpx");
  EXPECT_EQ(FileNameOf("C:\\gps\\t.plt"), "t.plt");
  EXPECT_EQ(FileNameOf("plain"), "plain");
  EXPECT_EQ(FolderOf("/home/u/track.gpx"), "/home/u");
  EXPECT_EQ(FolderOf("plain"), "");
}

TEST(SplitFields, EmptyFieldsLimitAndTabRuns) {
  Fields f = SplitFields("a,,c,", ",");
  EXPECT_EQ(f.count, 4);
  EXPECT_EQ(f[1], "a");
  EXPECT_EQ(f[2], "");
  EXPECT_EQ(f[3], "c");
  EXPECT_EQ(f[4], "");
  EXPECT_EQ(f[5], "");
  EXPECT_EQ(f[0], "");
  EXPECT_EQ(f[-3], "");

  EXPECT_EQ(SplitFields("", ",").count, 0);
  EXPECT_EQ(SplitFields("", ",")[1], "");

  std::string many;
  for (int i = 1; i <= 40; ++i) many += std::to_string(i) + ",";
  Fields big = SplitFields(many, ",");
  EXPECT_EQ(big.count, Fields::kMaxFields);
  EXPECT_EQ(big[25], "25");
  EXPECT_EQ(big[26], "");

  Fields mixed = SplitFields("a;b c", ";, ");
  EXPECT_EQ(mixed.count, 3);
  EXPECT_EQ(mixed[3], "c");

  Fields tabs = SplitFields("2007-03-14\t\t12:00:00\t 45.5\t \tx", "\t ", true);
  EXPECT_EQ(tabs[1], "2007-03-14");
  EXPECT_EQ(tabs[2], "12:00:00");
  EXPECT_EQ(tabs[3], "45.5");
  EXPECT_EQ(tabs[4], "");  // the blank after a tab joins, the tab after the blank does not
  EXPECT_EQ(tabs[5], "x");
  EXPECT_EQ(SplitFields("a\t\tb", "\t ", false)[2], "");
}

}  // namespace
}  // namespace molvar
