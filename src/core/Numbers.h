#pragma once
// Number helpers: reading numbers from text, whole-number conversions and the number-to-text forms
// that the files are written in. No locale is consulted anywhere: "." is the decimal point.
#include <cstdint>
#include <string>
#include <string_view>

namespace molvar {

// The leading number of a text: leading blanks and tabs are skipped, then an optional sign,
// digits, a "." fraction and an exponent are read as far as they go ("12abc" is 12, "abc" is 0,
// " -4.5x" is -4.5). Never fails; a value too large for a double reads as 0.
double Val(std::string_view s);

// The whole text (blanks around it allowed) as a number; false when it is not one.
bool TryParseNumber(std::string_view s, double& value);
// The same, raising "Type mismatch" (13) when the text is not a number.
double ToNumber(std::string_view s);

// Whole-number conversion: nearest integer, ties to even (2.5 -> 2, 3.5 -> 4, -0.5 -> 0);
// "Overflow" (6) outside the type's range or for a value that is not a number.
int16_t RoundToInt16(double v);
int32_t RoundToInt32(double v);
// The same without the error: `fallback` where the conversion would fail.
int32_t RoundToInt32Or(double v, int32_t fallback);
// Truncation toward minus infinity into 16 bits (12.7 -> 12, -0.5 -> -1); "Overflow" when out of
// range.
int16_t FloorToInt16(double v);

// Digit-pattern formatting: `pattern` is "0", "0.0", "000", "000.0", ".000000" and the like:
// the zeros before the point give the least number of integer digits, those after it the exact
// number of decimals. The value is rounded at the last decimal half away from zero, reading it
// with 15 significant digits first (so 0.15 gives "0.2" with "0.0"). The sign stands in front.
std::string FormatPattern(double v, std::string_view pattern);
void AppendPattern(std::string& out, double v, int minIntegerDigits, int decimals);
// The value after rounding the way FormatPattern does, read back as a number.
double RoundAtDecimals(double v, int decimals);

// The general double-to-text form: up to 15 significant digits, no trailing zeros, no exponent
// for magnitudes from 1e-15 to below 1e15 ("45.1", "-75.2", "1000", "0.0001").
std::string DoubleToText(double v);
void AppendDouble(std::string& out, double v);

void AppendInt(std::string& out, long long v);
std::string IntToText(long long v);

// Two upper-case hexadecimal digits of 0..255 ("0A", "FF"); values outside are clamped.
std::string Hex2(int v);

}  // namespace molvar
