#include "core/Numbers.h"

#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <random>
#include <string>
#include <gtest/gtest.h>

#include "core/Errors.h"

namespace molvar {
namespace {

TEST(Val, ReadsTheLeadingNumber) {
  EXPECT_EQ(Val("12abc"), 12);
  EXPECT_EQ(Val("abc"), 0);
  EXPECT_EQ(Val(" -4.5x"), -4.5);
  EXPECT_EQ(Val(""), 0);
  EXPECT_EQ(Val("."), 0);
  EXPECT_EQ(Val(".5"), 0.5);
  EXPECT_EQ(Val("-.25"), -0.25);
  EXPECT_EQ(Val("+7"), 7);
  EXPECT_EQ(Val("1e3"), 1000);
  EXPECT_EQ(Val("2e"), 2);
  EXPECT_EQ(Val("3,5"), 3);  // only "." is a decimal point
  EXPECT_EQ(Val("45.1"), 45.1);
  EXPECT_EQ(Val("1e999"), 0);
  EXPECT_EQ(Val("\t 8"), 8);
}

TEST(ToNumber, WholeTextMustBeANumber) {
  EXPECT_EQ(ToNumber(" 12.7 "), 12.7);
  EXPECT_EQ(ToNumber("-0.5"), -0.5);
  for (const char* bad : {"", "abc", "12abc", "1 2", "-", "."}) {
    try {
      ToNumber(bad);
      ADD_FAILURE() << "accepted " << bad;
    } catch (const RuntimeError& e) {
      EXPECT_EQ(e.Number(), kErrTypeMismatch) << bad;
    }
  }
}

TEST(RoundToInt, TiesGoToEven) {
  EXPECT_EQ(RoundToInt16(2.5), 2);
  EXPECT_EQ(RoundToInt16(3.5), 4);
  EXPECT_EQ(RoundToInt16(-0.5), 0);
  EXPECT_EQ(RoundToInt16(-1.5), -2);
  EXPECT_EQ(RoundToInt16(101.6), 102);
  EXPECT_EQ(RoundToInt32(2147483647.0), 2147483647);
  EXPECT_EQ(RoundToInt16(32767.4), 32767);
  EXPECT_EQ(RoundToInt16(-32768.5), -32768);
}

TEST(RoundToInt, ReportsOverflow) {
  for (double v : {32767.5, -32769.0, 1e10, std::nan("")}) {
    try {
      RoundToInt16(v);
      ADD_FAILURE() << v;
    } catch (const RuntimeError& e) {
      EXPECT_EQ(e.Number(), kErrOverflow);
    }
  }
  EXPECT_THROW(RoundToInt32(2147483647.5), RuntimeError);
  EXPECT_THROW(RoundToInt32(-3e9), RuntimeError);
  EXPECT_EQ(RoundToInt32Or(1e20, -1), -1);
}

TEST(FloorToInt16, TruncatesTowardMinusInfinity) {
  EXPECT_EQ(FloorToInt16(12.7), 12);
  EXPECT_EQ(FloorToInt16(-0.5), -1);
  EXPECT_EQ(FloorToInt16(-32768.0), -32768);
  EXPECT_THROW(FloorToInt16(32768.0), RuntimeError);
  EXPECT_THROW(FloorToInt16(-32768.5), RuntimeError);
}

TEST(FormatPattern, EveryPatternInUse) {
  EXPECT_EQ(FormatPattern(7.6, "0"), "8");
  EXPECT_EQ(FormatPattern(67.2, "0"), "67");
  EXPECT_EQ(FormatPattern(2.5, "0"), "3");  // half away from zero
  EXPECT_EQ(FormatPattern(-2.5, "0"), "-3");
  EXPECT_EQ(FormatPattern(12.34, "0.0"), "12.3");
  EXPECT_EQ(FormatPattern(0.15, "0.0"), "0.2");
  EXPECT_EQ(FormatPattern(18.52, "0.0"), "18.5");
  EXPECT_EQ(FormatPattern(3.14159, "0.00"), "3.14");
  EXPECT_EQ(FormatPattern(1.005, "0.00"), "1.01");
  EXPECT_EQ(FormatPattern(7.6, "000"), "008");
  EXPECT_EQ(FormatPattern(1234.5, "000"), "1235");
  EXPECT_EQ(FormatPattern(12, "0000"), "0012");
  EXPECT_EQ(FormatPattern(0.04, "000.0"), "000.0");
  EXPECT_EQ(FormatPattern(0.05, "000.0"), "000.1");
  EXPECT_EQ(FormatPattern(1.11198920000001, "0.0000000"), "1.1119892");
  EXPECT_EQ(FormatPattern(-45.502056666, "0.00000000"), "-45.50205667");
  EXPECT_EQ(FormatPattern(-45.5, "0.000000000000"), "-45.500000000000");
  EXPECT_EQ(FormatPattern(45.123456789012345, "0.000000000000"), "45.123456789012");
  EXPECT_EQ(FormatPattern(39155.5, ".000000"), "39155.500000");
  EXPECT_EQ(FormatPattern(0.25, ".000000"), ".250000");
  EXPECT_EQ(FormatPattern(0, "0.0"), "0.0");
  EXPECT_EQ(FormatPattern(0, ".000000"), ".000000");
  EXPECT_EQ(FormatPattern(-0.04, "0.0"), "0.0");  // no sign on a zero
  EXPECT_EQ(FormatPattern(9.96, "0.0"), "10.0");
  EXPECT_EQ(FormatPattern(999.96, "000.0"), "1000.0");
  EXPECT_EQ(FormatPattern(0.0004, "0.000"), "0.000");
  EXPECT_EQ(FormatPattern(0.0005, "0.000"), "0.001");
  EXPECT_EQ(FormatPattern(0.4, "0"), "0");
  EXPECT_EQ(FormatPattern(0.5, "0"), "1");
  EXPECT_EQ(FormatPattern(1e20, "0"), "100000000000000000000");
}

TEST(DoubleToText, GeneralForm) {
  EXPECT_EQ(DoubleToText(45.1), "45.1");
  EXPECT_EQ(DoubleToText(-75.2), "-75.2");
  EXPECT_EQ(DoubleToText(1000), "1000");
  EXPECT_EQ(DoubleToText(0.0001), "0.0001");
  EXPECT_EQ(DoubleToText(0.00001), "0.00001");
  EXPECT_EQ(DoubleToText(0), "0");
  EXPECT_EQ(DoubleToText(-0.0), "0");
  EXPECT_EQ(DoubleToText(0.1 + 0.2), "0.3");  // 15 significant digits
  EXPECT_EQ(DoubleToText(1.0 / 3), "0.333333333333333");
  EXPECT_EQ(DoubleToText(2.0 / 3), "0.666666666666667");
  EXPECT_EQ(DoubleToText(123456789012345.0), "123456789012345");
  EXPECT_EQ(DoubleToText(1e15), "1E+15");
  EXPECT_EQ(DoubleToText(-1.5e-20), "-1.5E-20");
  EXPECT_EQ(DoubleToText(160), "160");
  EXPECT_EQ(DoubleToText(-45.50205667), "-45.50205667");
  EXPECT_EQ(DoubleToText(20 * 67.0), "1340");
}

TEST(Hex2, TwoUpperCaseDigits) {
  EXPECT_EQ(Hex2(255), "FF");
  EXPECT_EQ(Hex2(10), "0A");
  EXPECT_EQ(Hex2(0), "00");
  EXPECT_EQ(Hex2(171), "AB");
  EXPECT_EQ(Hex2(300), "FF");
  EXPECT_EQ(Hex2(-3), "00");
}

TEST(RoundAtDecimals, MatchesTheFormattedValue) {
  EXPECT_EQ(RoundAtDecimals(1.11198920004, 7), 1.1119892);
  EXPECT_EQ(RoundAtDecimals(66.7, 0), 67);
  EXPECT_EQ(RoundAtDecimals(-66.5, 0), -67);
}

// An independent model of the rounding rule: 15 significant digits (printf, correctly rounded),
// then half up at the last kept decimal, as text.
std::string ReferencePattern(double v, int decimals) {
  char buf[64];
  std::snprintf(buf, sizeof buf, "%.14e", std::fabs(v));
  std::string digits;
  digits += buf[0];
  digits.append(buf + 2, 14);
  const int exponent = std::atoi(buf + 17);
  const int keep = exponent + decimals + 1;
  std::string kept;  // the rounded magnitude times 10^decimals, as digits
  if (keep > 0) {
    kept = digits.substr(0, static_cast<std::size_t>(keep < 15 ? keep : 15));
    while (static_cast<int>(kept.size()) < keep) kept += '0';
    if (keep < 15 && digits[static_cast<std::size_t>(keep)] >= '5') {
      int k = static_cast<int>(kept.size()) - 1;
      while (k >= 0 && kept[static_cast<std::size_t>(k)] == '9') kept[static_cast<std::size_t>(k--)] = '0';
      if (k >= 0) ++kept[static_cast<std::size_t>(k)];
      else kept.insert(kept.begin(), '1');
    }
  } else if (keep == 0 && digits[0] >= '5') {
    kept = "1";
  }
  kept.erase(0, kept.find_first_not_of('0') == std::string::npos ? kept.size() : kept.find_first_not_of('0'));
  while (static_cast<int>(kept.size()) <= decimals) kept.insert(kept.begin(), '0');
  std::string out = (std::signbit(v) && kept.find_first_not_of('0') != std::string::npos) ? "-" : "";
  out += kept.substr(0, kept.size() - static_cast<std::size_t>(decimals));
  if (decimals > 0) out += "." + kept.substr(kept.size() - static_cast<std::size_t>(decimals));
  return out;
}

// The quick arithmetic path and the digit path must agree everywhere, near halves above all.
TEST(RoundAtDecimals, AgreesWithTheDigitRuleOnRandomAndHalfwayValues) {
  std::mt19937_64 random(20261207);
  std::uniform_real_distribution<double> unit(0, 1);
  std::uniform_int_distribution<int> magnitude(-8, 14);
  std::uniform_int_distribution<int> places(0, 8);
  int checked = 0;
  for (int i = 0; i < 200000; ++i) {
    const int d = places(random);
    double v = unit(random) * std::pow(10.0, magnitude(random));
    if (i % 3 == 0) v = (std::floor(v) + 0.5) / std::pow(10.0, d);              // exact-looking halves
    if (i % 3 == 1) v = (std::floor(v * 1e3) + 0.5) / std::pow(10.0, d) + 1e-13;  // just above a half
    if (i % 2 == 0) v = -v;
    const std::string expected = ReferencePattern(v, d);
    std::string text;
    AppendPattern(text, v, 1, d);
    ASSERT_EQ(text, expected) << "v=" << v << " decimals=" << d;
    ASSERT_EQ(RoundAtDecimals(v, d), std::strtod(expected.c_str(), nullptr)) << "v=" << v << " decimals=" << d;
    ++checked;
  }
  EXPECT_EQ(checked, 200000);
}

// Short decimals take a quick path; every one must read as the C library reads it.
TEST(Val, ShortDecimalsReadAsTheLibraryReadsThem) {
  std::mt19937_64 random(7);
  std::uniform_int_distribution<int> length(1, 17);
  std::uniform_int_distribution<int> digit(0, 9);
  for (int i = 0; i < 200000; ++i) {
    std::string text = i % 2 ? "-" : "";
    const int n = length(random);
    const int point = std::uniform_int_distribution<int>(0, n)(random);
    for (int k = 0; k < n; ++k) {
      if (k == point) text += '.';
      text += static_cast<char>('0' + digit(random));
    }
    ASSERT_EQ(Val(text), std::strtod(text.c_str(), nullptr)) << text;
  }
  EXPECT_EQ(Val(".5"), 0.5);
  EXPECT_EQ(Val("5."), 5.0);
  EXPECT_TRUE(std::signbit(Val("-0.0")));
  EXPECT_EQ(Val("45.4215001"), 45.4215001);
}

TEST(FormatPattern, PadsIntegerDigitsOnBothPaths) {
  EXPECT_EQ(FormatPattern(5.25, "000.0"), "005.3");       // a half: the digit rule
  EXPECT_EQ(FormatPattern(5.26, "000.0"), "005.3");       // plain arithmetic
  EXPECT_EQ(FormatPattern(-0.04, "0.0"), "0.0");          // rounds to zero: no sign
  EXPECT_EQ(FormatPattern(-0.06, "0.0"), "-0.1");
  EXPECT_EQ(FormatPattern(0.000123, "0.000000"), "0.000123");
  EXPECT_EQ(FormatPattern(123456.7, "0"), "123457");
  // Every integer digit of a huge value (a speed field can hold one).
  EXPECT_EQ(FormatPattern(1e64, "0.0"), "1" + std::string(64, '0') + ".0");
  EXPECT_EQ(FormatPattern(-1.5e300, "0").size(), 302u);
  EXPECT_EQ(FormatPattern(1.7976931348623157e308, "0").substr(0, 15), "179769313486232");
}

}  // namespace
}  // namespace molvar
