#include "core/Numbers.h"

#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstring>

#include "core/Errors.h"

namespace molvar {
namespace {

bool IsDigit(char c) { return c >= '0' && c <= '9'; }

// Length of the number at the start of `s` (sign, digits, fraction, exponent), 0 when none.
std::size_t NumberSpan(std::string_view s, bool& hasDigits) {
  std::size_t i = 0;
  hasDigits = false;
  if (i < s.size() && (s[i] == '+' || s[i] == '-')) ++i;
  while (i < s.size() && IsDigit(s[i])) {
    ++i;
    hasDigits = true;
  }
  if (i < s.size() && s[i] == '.') {
    ++i;
    while (i < s.size() && IsDigit(s[i])) {
      ++i;
      hasDigits = true;
    }
  }
  if (!hasDigits) return 0;
  if (i < s.size() && (s[i] == 'e' || s[i] == 'E')) {
    std::size_t k = i + 1;
    if (k < s.size() && (s[k] == '+' || s[k] == '-')) ++k;
    if (k < s.size() && IsDigit(s[k])) {
      while (k < s.size() && IsDigit(s[k])) ++k;
      i = k;
    }
  }
  return i;
}

// A plain decimal of at most 15 digits: the digits are an exact integer and 10^fraction an exact
// power, so their quotient is the correctly rounded value (Clinger's fast path), as from_chars
// would give it. False for anything else.
bool ParseShortDecimal(std::string_view span, double& value) {
  static constexpr std::array<double, 16> kTens = {1e0, 1e1, 1e2,  1e3,  1e4,  1e5,  1e6,  1e7,
                                                   1e8, 1e9, 1e10, 1e11, 1e12, 1e13, 1e14, 1e15};
  uint64_t digits = 0;
  int count = 0, fraction = 0;
  bool point = false;
  for (const char c : span) {
    if (c == '.' && !point) {
      point = true;
      continue;
    }
    if (!IsDigit(c) || ++count > 15) return false;
    digits = digits * 10 + static_cast<uint64_t>(c - '0');
    if (point) ++fraction;
  }
  if (count == 0) return false;
  value = static_cast<double>(digits) / kTens[static_cast<std::size_t>(fraction)];
  return true;
}

// Parses a span found by NumberSpan; from_chars rejects a leading "+" and a bare leading ".".
bool ParseSpan(std::string_view span, double& value) {
  bool negative = false;
  if (!span.empty() && (span[0] == '+' || span[0] == '-')) {
    negative = span[0] == '-';
    span.remove_prefix(1);
  }
  if (double quick = 0; ParseShortDecimal(span, quick)) {
    value = negative ? -quick : quick;
    return true;
  }
  std::array<char, 64> small{};
  std::string big;
  const char* first = span.data();
  const char* last = span.data() + span.size();
  if (!span.empty() && span[0] == '.') {
    // "0" in front, so from_chars sees a plain decimal.
    if (span.size() + 1 < small.size()) {
      small[0] = '0';
      std::memcpy(small.data() + 1, span.data(), span.size());
      first = small.data();
      last = small.data() + span.size() + 1;
    } else {
      big = "0" + std::string(span);
      first = big.data();
      last = big.data() + big.size();
    }
  }
  double v = 0;
  const auto result = std::from_chars(first, last, v, std::chars_format::general);
  if (result.ec == std::errc::result_out_of_range) {
    // Underflow reads as 0; overflow cannot be represented and reads as 0 too.
    value = 0;
    return true;
  }
  if (result.ec != std::errc{} || result.ptr != last) return false;
  value = negative ? -v : v;
  return true;
}

}  // namespace

double Val(std::string_view s) {
  std::size_t i = 0;
  while (i < s.size() && (s[i] == ' ' || s[i] == '\t' || s[i] == '\n' || s[i] == '\r')) ++i;
  s.remove_prefix(i);
  bool hasDigits = false;
  const std::size_t n = NumberSpan(s, hasDigits);
  if (n == 0) return 0;
  double v = 0;
  return ParseSpan(s.substr(0, n), v) ? v : 0;
}

bool TryParseNumber(std::string_view s, double& value) {
  while (!s.empty() && (s.front() == ' ' || s.front() == '\t')) s.remove_prefix(1);
  while (!s.empty() && (s.back() == ' ' || s.back() == '\t')) s.remove_suffix(1);
  bool hasDigits = false;
  const std::size_t n = NumberSpan(s, hasDigits);
  if (n == 0 || n != s.size()) return false;
  return ParseSpan(s, value);
}

double ToNumber(std::string_view s) {
  double v = 0;
  if (!TryParseNumber(s, v)) throw RuntimeError(kErrTypeMismatch);
  return v;
}

namespace {
template <typename Int>
bool RoundInto(double v, Int& out) {
  if (!std::isfinite(v)) return false;
  const double r = std::nearbyint(v);  // default rounding mode: nearest, ties to even
  if (r < static_cast<double>(INT64_MIN) || r > static_cast<double>(INT64_MAX)) return false;
  const auto wide = static_cast<long long>(r);
  if (wide < std::numeric_limits<Int>::min() || wide > std::numeric_limits<Int>::max()) return false;
  out = static_cast<Int>(wide);
  return true;
}
}  // namespace

int16_t RoundToInt16(double v) {
  int16_t out = 0;
  if (!RoundInto(v, out)) throw RuntimeError(kErrOverflow);
  return out;
}

int32_t RoundToInt32(double v) {
  int32_t out = 0;
  if (!RoundInto(v, out)) throw RuntimeError(kErrOverflow);
  return out;
}

int32_t RoundToInt32Or(double v, int32_t fallback) {
  int32_t out = 0;
  return RoundInto(v, out) ? out : fallback;
}

int16_t FloorToInt16(double v) {
  if (!std::isfinite(v)) throw RuntimeError(kErrOverflow);
  const double f = std::floor(v);
  if (f < -32768.0 || f > 32767.0) throw RuntimeError(kErrOverflow);
  return static_cast<int16_t>(f);
}

namespace {

// The value as 15 significant decimal digits d1..d15 and the exponent of d1.
struct Decimal15 {
  std::array<char, 15> digits{};
  int exponent = 0;
  bool negative = false;
};

Decimal15 ToDecimal15(double v) {
  Decimal15 d;
  d.negative = std::signbit(v);
  std::array<char, 40> buf{};
  const auto r = std::to_chars(buf.data(), buf.data() + buf.size(), std::fabs(v),
                               std::chars_format::scientific, 14);
  // Layout: d.dddddddddddddde±XX
  const char* p = buf.data();
  d.digits[0] = p[0];
  std::memcpy(d.digits.data() + 1, p + 2, 14);
  const char* e = p + 16;  // 'e'
  int exponent = 0;
  std::from_chars(e + 2, r.ptr, exponent);
  d.exponent = e[1] == '-' ? -exponent : exponent;
  return d;
}

}  // namespace

namespace {

constexpr std::array<double, 16> kPowersOfTen = {1e0, 1e1, 1e2,  1e3,  1e4,  1e5,  1e6,  1e7,
                                                 1e8, 1e9, 1e10, 1e11, 1e12, 1e13, 1e14, 1e15};

// |v| × 10^decimals rounded as the digit route below rounds it (15 significant digits, then half
// up), for the common case where that is plain arithmetic: at least one and at most 13 digits
// kept (so the 15-digit step moves the value by under 0.005 of the last kept unit), and the
// scaled value not within 0.01 of a half, where the two roundings could disagree. The digit
// route handles everything else.
bool RoundScaledFast(double v, int decimals, uint64_t& scaled) {
  if (!std::isfinite(v) || decimals < 0 || decimals >= static_cast<int>(kPowersOfTen.size())) return false;
  const double x = std::fabs(v) * kPowersOfTen[static_cast<std::size_t>(decimals)];
  if (x < 1 || x >= 1e13) return false;
  const double whole = static_cast<double>(static_cast<int64_t>(x));  // floor: x is positive and small
  const double fraction = x - whole;
  if (std::fabs(fraction - 0.5) <= 0.01) return false;
  scaled = static_cast<uint64_t>(fraction < 0.5 ? whole : whole + 1);
  return true;
}

}  // namespace

void AppendPattern(std::string& out, double v, int minIntegerDigits, int decimals) {
  if (uint64_t scaled = 0; RoundScaledFast(v, decimals, scaled)) {
    std::array<char, 24> text{};
    const auto end = std::to_chars(text.data(), text.data() + text.size(), scaled).ptr;
    const int length = static_cast<int>(end - text.data());
    const int integerDigits = length > decimals ? length - decimals : 0;
    if (std::signbit(v)) out.push_back('-');
    for (int k = integerDigits; k < minIntegerDigits; ++k) out.push_back('0');
    out.append(text.data(), static_cast<std::size_t>(integerDigits));
    if (decimals > 0) {
      out.push_back('.');
      for (int k = length - integerDigits; k < decimals; ++k) out.push_back('0');
      out.append(text.data() + integerDigits, static_cast<std::size_t>(length - integerDigits));
    }
    return;
  }
  if (!std::isfinite(v)) v = 0;
  // Digits of the rounded magnitude, most significant first, with `decimals` digits after the
  // implied point: value = digits × 10^-decimals.
  std::array<char, 352> digits{};  // room for the 309 integer digits of the largest double
  int count = 0;
  bool negative = false;
  if (v != 0) {
    const Decimal15 d = ToDecimal15(v);
    negative = d.negative;
    // Digit k (0-based) of d has weight 10^(exponent - k); keep those with weight >= 10^-decimals.
    const int keep = d.exponent + decimals + 1;
    if (keep > 0) {
      const int fromDigits = keep < 15 ? keep : 15;
      for (int k = 0; k < fromDigits; ++k) digits[static_cast<std::size_t>(count++)] = d.digits[static_cast<std::size_t>(k)];
      for (int k = 15; k < keep && count < 340; ++k) digits[static_cast<std::size_t>(count++)] = '0';
      if (keep < 15 && d.digits[static_cast<std::size_t>(keep)] >= '5') {
        int k = count - 1;
        while (k >= 0 && digits[static_cast<std::size_t>(k)] == '9') digits[static_cast<std::size_t>(k--)] = '0';
        if (k >= 0) {
          ++digits[static_cast<std::size_t>(k)];
        } else {
          std::memmove(digits.data() + 1, digits.data(), static_cast<std::size_t>(count));
          digits[0] = '1';
          ++count;
        }
      }
    } else if (keep == 0 && d.digits[0] >= '5') {
      digits[0] = '1';
      count = 1;
    }
  }
  // Leading zeros carry no value.
  int first = 0;
  while (first < count && digits[static_cast<std::size_t>(first)] == '0') ++first;
  const bool isZero = first == count;
  if (negative && !isZero) out.push_back('-');
  const int significant = count - first;  // digits of the value from its first non-zero digit
  const int integerDigits = significant > decimals ? significant - decimals : 0;
  for (int k = integerDigits; k < minIntegerDigits; ++k) out.push_back('0');
  const char* base = digits.data() + first;
  out.append(base, static_cast<std::size_t>(integerDigits));
  if (decimals > 0) {
    out.push_back('.');
    const int fractionDigits = significant - integerDigits;
    for (int k = fractionDigits; k < decimals; ++k) out.push_back('0');
    out.append(base + integerDigits, static_cast<std::size_t>(fractionDigits));
  }
}

std::string FormatPattern(double v, std::string_view pattern) {
  const auto point = pattern.find('.');
  const int minInt = static_cast<int>(point == std::string_view::npos ? pattern.size() : point);
  const int decimals =
      point == std::string_view::npos ? 0 : static_cast<int>(pattern.size() - point - 1);
  std::string out;
  AppendPattern(out, v, minInt, decimals);
  return out;
}

double RoundAtDecimals(double v, int decimals) {
  // N / 10^d is the correctly rounded double of the decimal N × 10^-d, which is what reading the
  // formatted text gives.
  if (uint64_t scaled = 0; RoundScaledFast(v, decimals, scaled)) {
    const double r = static_cast<double>(scaled) / kPowersOfTen[static_cast<std::size_t>(decimals)];
    return std::signbit(v) ? -r : r;
  }
  std::string text;
  AppendPattern(text, v, 1, decimals);
  double out = 0;
  ParseSpan(text, out);
  return out;
}

void AppendDouble(std::string& out, double v) {
  if (v == 0 || !std::isfinite(v)) {
    out.push_back('0');
    return;
  }
  // Shortest round-trip digits first; they equal the 15-digit form whenever there are at most 15.
  std::array<char, 40> buf{};
  auto r = std::to_chars(buf.data(), buf.data() + buf.size(), v, std::chars_format::scientific);
  const char* p = buf.data();
  const bool negative = *p == '-';
  if (negative) ++p;
  std::array<char, 20> digits{};
  int count = 0;
  const char* q = p;
  for (; q < r.ptr && *q != 'e'; ++q) {
    if (*q != '.') digits[static_cast<std::size_t>(count++)] = *q;
  }
  int exponent = 0;
  if (count > 15) {
    const Decimal15 d = ToDecimal15(v);
    std::memcpy(digits.data(), d.digits.data(), 15);
    count = 15;
    exponent = d.exponent;
  } else {
    const char* e = q + 1;
    std::from_chars(e[0] == '+' ? e + 1 : e, r.ptr, exponent);
  }
  while (count > 1 && digits[static_cast<std::size_t>(count - 1)] == '0') --count;
  if (negative) out.push_back('-');
  if (exponent >= 15 || exponent < -15) {
    out.push_back(digits[0]);
    if (count > 1) {
      out.push_back('.');
      out.append(digits.data() + 1, static_cast<std::size_t>(count - 1));
    }
    out.push_back('E');
    out.push_back(exponent < 0 ? '-' : '+');
    const int a = exponent < 0 ? -exponent : exponent;
    if (a < 10) out.push_back('0');
    AppendInt(out, a);
    return;
  }
  if (exponent < 0) {
    out.append("0.");
    out.append(static_cast<std::size_t>(-exponent - 1), '0');
    out.append(digits.data(), static_cast<std::size_t>(count));
    return;
  }
  const int integerDigits = exponent + 1;
  if (count <= integerDigits) {
    out.append(digits.data(), static_cast<std::size_t>(count));
    out.append(static_cast<std::size_t>(integerDigits - count), '0');
  } else {
    out.append(digits.data(), static_cast<std::size_t>(integerDigits));
    out.push_back('.');
    out.append(digits.data() + integerDigits, static_cast<std::size_t>(count - integerDigits));
  }
}

std::string DoubleToText(double v) {
  std::string out;
  AppendDouble(out, v);
  return out;
}

void AppendInt(std::string& out, long long v) {
  std::array<char, 24> buf{};
  const auto r = std::to_chars(buf.data(), buf.data() + buf.size(), v);
  out.append(buf.data(), r.ptr);
}

std::string IntToText(long long v) {
  std::string out;
  AppendInt(out, v);
  return out;
}

std::string Hex2(int v) {
  if (v < 0) v = 0;
  if (v > 255) v = 255;
  static constexpr char kHex[] = "0123456789ABCDEF";
  return std::string{kHex[v >> 4], kHex[v & 15]};
}

}  // namespace molvar
