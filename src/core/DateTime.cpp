#include "core/DateTime.h"

#include <array>
#include <cmath>
#include <cstring>

#include "core/Errors.h"
#include "core/Numbers.h"
#include "core/Text.h"

namespace molvar {
namespace {

constexpr int64_t kSecondsPerDay = 86400;

// Days from 1970-01-01 (proleptic Gregorian), after H. Hinnant's days_from_civil.
int64_t DaysFromCivil(int64_t y, int m, int d) {
  y -= m <= 2;
  const int64_t era = (y >= 0 ? y : y - 399) / 400;
  const int64_t yoe = y - era * 400;
  const int64_t doy = (153 * (m + (m > 2 ? -3 : 9)) + 2) / 5 + d - 1;
  const int64_t doe = yoe * 365 + yoe / 4 - yoe / 100 + doy;
  return era * 146097 + doe - 719468;
}

constexpr int64_t kEpochDaysFrom1970 = -25569;  // 1899-12-30

bool IsLeap(int y) { return (y % 4 == 0 && y % 100 != 0) || y % 400 == 0; }

int DaysInMonth(int y, int m) {
  static constexpr std::array<int, 12> kDays = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
  return m == 2 && IsLeap(y) ? 29 : kDays[static_cast<std::size_t>(m - 1)];
}

const TimeSeconds kMinTime = (DaysFromCivil(100, 1, 1) - kEpochDaysFrom1970) * kSecondsPerDay;
const TimeSeconds kMaxTime =
    (DaysFromCivil(9999, 12, 31) - kEpochDaysFrom1970) * kSecondsPerDay + kSecondsPerDay - 1;

bool IsDigit(char c) { return c >= '0' && c <= '9'; }
bool IsAlpha(char c) { return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z'); }

int MonthFromName(std::string_view name) {
  static constexpr std::array<std::string_view, 12> kMonths = {
      "january", "february", "march",     "april",   "may",      "june",
      "july",    "august",   "september", "october", "november", "december"};
  if (name.size() < 3) return 0;
  for (std::size_t i = 0; i < kMonths.size(); ++i) {
    const std::string_view full = kMonths[i];
    if (name.size() > full.size()) continue;
    if (EqualsNoCase(name, full.substr(0, name.size())) && (name.size() == 3 || name.size() == full.size() ||
                                                             (name.size() == 4 && i == 8))) {
      return static_cast<int>(i) + 1;
    }
  }
  return 0;
}

// A small scanner over the text being parsed.
struct Scanner {
  std::string_view s;
  std::size_t i = 0;

  bool AtEnd() const { return i >= s.size(); }
  char Peek(std::size_t ahead = 0) const { return i + ahead < s.size() ? s[i + ahead] : '\0'; }
  void SkipBlanks() {
    while (i < s.size() && (s[i] == ' ' || s[i] == '\t')) ++i;
  }
  // Up to `maxDigits` digits; the count read goes to `digits`.
  bool Number(int& value, int& digits, int maxDigits = 9) {
    value = 0;
    digits = 0;
    while (i < s.size() && IsDigit(s[i]) && digits < maxDigits) {
      value = value * 10 + (s[i] - '0');
      ++i;
      ++digits;
    }
    return digits > 0;
  }
  std::string_view Word() {
    const std::size_t from = i;
    while (i < s.size() && IsAlpha(s[i])) ++i;
    return s.substr(from, i - from);
  }
  bool Accept(char c) {
    if (Peek() != c) return false;
    ++i;
    return true;
  }
};

int ExpandYear(int year, int digits) {
  if (digits > 2) return year;
  return year < 30 ? 2000 + year : 1900 + year;
}

bool IsDateSeparator(char c) { return c == '-' || c == '/' || c == '.' || c == ' '; }

// The date part; leaves the scanner after it. `found` is false when the text starts with a time.
bool ParseDatePart(Scanner& sc, CivilTime& c, bool& found) {
  found = false;
  const std::size_t start = sc.i;
  if (IsAlpha(sc.Peek())) {
    // "Dec 31 1989", "December 31, 1989"
    const int month = MonthFromName(sc.Word());
    if (month == 0) return false;
    if (!sc.Accept(' ') && !sc.Accept('-')) return false;
    sc.SkipBlanks();
    int day = 0, dayDigits = 0, year = 0, yearDigits = 0;
    if (!sc.Number(day, dayDigits, 2)) return false;
    sc.Accept(',');
    if (!sc.Accept(' ') && !sc.Accept('-') && sc.s[sc.i - 1] != ',') return false;
    sc.SkipBlanks();
    if (!sc.Number(year, yearDigits, 4)) return false;
    c.year = ExpandYear(year, yearDigits);
    c.month = month;
    c.day = day;
    found = true;
    return true;
  }
  int first = 0, firstDigits = 0;
  if (!sc.Number(first, firstDigits, 4)) return false;
  if (sc.Peek() == ':' && firstDigits <= 2) {
    sc.i = start;  // a time alone
    return true;
  }
  const char sep = sc.Peek();
  if (!IsDateSeparator(sep)) return false;
  ++sc.i;
  if (sep == ' ') sc.SkipBlanks();
  if (IsAlpha(sc.Peek())) {
    // "1-Jan-1900" or "1989 Dec 31"
    const int month = MonthFromName(sc.Word());
    if (month == 0) return false;
    const char sep2 = sc.Peek();
    if (!IsDateSeparator(sep2)) return false;
    ++sc.i;
    if (sep2 == ' ') sc.SkipBlanks();
    int third = 0, thirdDigits = 0;
    if (!sc.Number(third, thirdDigits, 4)) return false;
    c.month = month;
    if (firstDigits == 4) {
      c.year = first;
      c.day = third;
    } else {
      c.day = first;
      c.year = ExpandYear(third, thirdDigits);
    }
    found = true;
    return true;
  }
  int second = 0, secondDigits = 0, third = 0, thirdDigits = 0;
  if (!sc.Number(second, secondDigits, 2)) return false;
  if (sc.Peek() != sep) return false;
  ++sc.i;
  if (!sc.Number(third, thirdDigits, 4)) return false;
  if (firstDigits == 4) {
    c.year = first;
    c.month = second;
    c.day = third;
  } else if (firstDigits <= 2) {
    c.year = ExpandYear(third, thirdDigits);
    if (first > 12 && second <= 12) {
      c.day = first;
      c.month = second;
    } else {
      c.month = first;
      c.day = second;
    }
  } else {
    return false;
  }
  found = true;
  return true;
}

// The time part with its designator and zone; `offsetMinutes` is the zone's offset from GMT.
bool ParseTimePart(Scanner& sc, CivilTime& c, int& offsetMinutes) {
  int hour = 0, hourDigits = 0, minute = 0, minuteDigits = 0, second = 0, secondDigits = 0;
  if (!sc.Number(hour, hourDigits, 2)) return false;
  if (!sc.Accept(':')) return false;
  if (!sc.Number(minute, minuteDigits, 2) || minuteDigits != 2) return false;
  if (sc.Accept(':')) {
    if (!sc.Number(second, secondDigits, 2) || secondDigits != 2) return false;
    if (sc.Accept('.') || sc.Accept(',')) {
      while (IsDigit(sc.Peek())) ++sc.i;  // fractions of a second are dropped
    }
  }
  sc.SkipBlanks();
  if (IsAlpha(sc.Peek()) && sc.Peek() != 'Z' && sc.Peek() != 'z') {
    const std::string_view designator = sc.Word();
    const bool am = EqualsNoCase(designator, kAmDesignator) || EqualsNoCase(designator, "A");
    const bool pm = EqualsNoCase(designator, kPmDesignator) || EqualsNoCase(designator, "P");
    if (!am && !pm) return false;
    if (hour > 12) return false;
    if (hour == 12) hour = 0;
    if (pm) hour += 12;
    sc.SkipBlanks();
  }
  if (sc.Accept('Z') || sc.Accept('z')) {
    offsetMinutes = 0;
  } else if (sc.Peek() == '+' || sc.Peek() == '-') {
    const int sign = sc.Peek() == '-' ? -1 : 1;
    ++sc.i;
    int zh = 0, zhDigits = 0, zm = 0, zmDigits = 0;
    if (!sc.Number(zh, zhDigits, 2) || zhDigits != 2) return false;
    sc.Accept(':');
    if (IsDigit(sc.Peek()) && (!sc.Number(zm, zmDigits, 2) || zmDigits != 2)) return false;
    if (zh > 14 || zm > 59) return false;
    offsetMinutes = sign * (zh * 60 + zm);
  }
  c.hour = hour;
  c.minute = minute;
  c.second = second;
  return true;
}

void AppendTwo(std::string& out, int v) {
  out.push_back(static_cast<char>('0' + v / 10));
  out.push_back(static_cast<char>('0' + v % 10));
}

void AppendDate(std::string& out, const CivilTime& c) {
  AppendTwo(out, c.year / 100);
  AppendTwo(out, c.year % 100);
  out.push_back('-');
  AppendTwo(out, c.month);
  out.push_back('-');
  AppendTwo(out, c.day);
}

}  // namespace

TimeSeconds ToSeconds(const CivilTime& c) {
  const int64_t days = DaysFromCivil(c.year, c.month, c.day) - kEpochDaysFrom1970;
  return days * kSecondsPerDay + c.hour * 3600 + c.minute * 60 + c.second;
}

CivilTime ToCivil(TimeSeconds t) {
  int64_t days = t / kSecondsPerDay;
  int64_t secs = t % kSecondsPerDay;
  if (secs < 0) {
    secs += kSecondsPerDay;
    --days;
  }
  // civil_from_days
  int64_t z = days + kEpochDaysFrom1970 + 719468;
  const int64_t era = (z >= 0 ? z : z - 146096) / 146097;
  const int64_t doe = z - era * 146097;
  const int64_t yoe = (doe - doe / 1460 + doe / 36524 - doe / 146096) / 365;
  const int64_t doy = doe - (365 * yoe + yoe / 4 - yoe / 100);
  const int64_t mp = (5 * doy + 2) / 153;
  CivilTime c;
  c.day = static_cast<int>(doy - (153 * mp + 2) / 5 + 1);
  c.month = static_cast<int>(mp < 10 ? mp + 3 : mp - 9);
  c.year = static_cast<int>(yoe + era * 400 + (c.month <= 2));
  c.hour = static_cast<int>(secs / 3600);
  c.minute = static_cast<int>(secs / 60 % 60);
  c.second = static_cast<int>(secs % 60);
  return c;
}

bool IsValidCivil(const CivilTime& c) {
  return c.year >= 100 && c.year <= 9999 && c.month >= 1 && c.month <= 12 && c.day >= 1 &&
         c.day <= DaysInMonth(c.year, c.month) && c.hour >= 0 && c.hour <= 23 && c.minute >= 0 &&
         c.minute <= 59 && c.second >= 0 && c.second <= 59;
}

bool InDateRange(TimeSeconds t) { return t >= kMinTime && t <= kMaxTime; }

namespace {

// The number of the two digits at `at`, or -1.
int TwoDigitsAt(std::string_view s, std::size_t at) {
  if (!IsDigit(s[at]) || !IsDigit(s[at + 1])) return -1;
  return (s[at] - '0') * 10 + (s[at + 1] - '0');
}

// "yyyy-mm-dd?hh:nn:ss" at the start of `s` (any character at "?"), the layout of every stored
// timestamp and of GPX times; false for anything else, which the general parser then reads.
bool ReadFixedLayout(std::string_view s, CivilTime& c) {
  if (s.size() < 19 || s[4] != '-' || s[7] != '-' || s[13] != ':' || s[16] != ':') return false;
  const int century = TwoDigitsAt(s, 0), year = TwoDigitsAt(s, 2), month = TwoDigitsAt(s, 5),
            day = TwoDigitsAt(s, 8), hour = TwoDigitsAt(s, 11), minute = TwoDigitsAt(s, 14),
            second = TwoDigitsAt(s, 17);
  if (century < 0 || year < 0 || month < 0 || day < 0 || hour < 0 || minute < 0 || second < 0) return false;
  c = CivilTime{century * 100 + year, month, day, hour, minute, second};
  return true;
}

// The stored forms "yyyy-mm-dd hh:nn:ss" and "yyyy-mm-dd hh:nn:ss AM/PM" without the general
// scanner; nullopt when `text` has another layout.
std::optional<std::optional<TimeSeconds>> ParseStoredForm(std::string_view text) {
  CivilTime c;
  if ((text.size() != 19 && text.size() != 22) || text[10] != ' ' || !ReadFixedLayout(text, c)) return std::nullopt;
  if (text.size() == 22) {
    const std::string_view designator = text.substr(20);
    const bool pm = designator == kPmDesignator;
    if (text[19] != ' ' || (!pm && designator != kAmDesignator)) return std::nullopt;
    if (c.hour > 12) return std::optional<TimeSeconds>{};
    if (c.hour == 12) c.hour = 0;
    if (pm) c.hour += 12;
  }
  if (!IsValidCivil(c)) return std::optional<TimeSeconds>{};
  const TimeSeconds t = ToSeconds(c);
  if (!InDateRange(t)) return std::optional<TimeSeconds>{};
  return std::optional<TimeSeconds>{t};
}

}  // namespace

std::optional<TimeSeconds> ParseDateTime(std::string_view text) {
  text = Trim(text);
  if (text.empty()) return std::nullopt;
  if (const auto stored = ParseStoredForm(text)) return *stored;
  Scanner sc{text};
  CivilTime c;
  bool hasDate = false;
  if (!ParseDatePart(sc, c, hasDate)) return std::nullopt;
  int offsetMinutes = 0;
  if (!sc.AtEnd()) {
    if (hasDate) {
      if (sc.Peek() == 'T' || sc.Peek() == 't') {
        ++sc.i;
      } else if (sc.Peek() == ' ' || sc.Peek() == '\t') {
        sc.SkipBlanks();
      } else {
        return std::nullopt;
      }
    }
    if (!sc.AtEnd() && !ParseTimePart(sc, c, offsetMinutes)) return std::nullopt;
    sc.SkipBlanks();
    if (!sc.AtEnd()) return std::nullopt;
  }
  if (!IsValidCivil(c)) return std::nullopt;
  const TimeSeconds t = ToSeconds(c) - offsetMinutes * 60;
  if (!InDateRange(t)) return std::nullopt;
  return t;
}

TimeSeconds ParseDateTimeOrThrow(std::string_view text) {
  const auto t = ParseDateTime(text);
  if (!t) throw RuntimeError(kErrTypeMismatch);
  return *t;
}

TimestampText MakeTimestamp(TimeSeconds t) {
  const CivilTime c = ToCivil(t);
  TimestampText text;
  char* p = text.chars.data();
  const auto two = [&p](int v) {
    *p++ = static_cast<char>('0' + v / 10);
    *p++ = static_cast<char>('0' + v % 10);
  };
  two(c.year / 100);
  two(c.year % 100);
  *p++ = '-';
  two(c.month);
  *p++ = '-';
  two(c.day);
  *p++ = ' ';
  two(c.hour % 12 == 0 ? 12 : c.hour % 12);
  *p++ = ':';
  two(c.minute);
  *p++ = ':';
  two(c.second);
  *p++ = ' ';
  const std::string_view designator = c.hour < 12 ? kAmDesignator : kPmDesignator;
  std::memcpy(p, designator.data(), designator.size());
  return text;
}

void AppendTimestamp(std::string& out, TimeSeconds t) { out.append(MakeTimestamp(t).view()); }

std::string FormatTimestamp(TimeSeconds t) { return std::string(MakeTimestamp(t).view()); }

void AppendIsoUtc(std::string& out, TimeSeconds t) {
  const CivilTime c = ToCivil(t);
  AppendDate(out, c);
  out.push_back('T');
  AppendTwo(out, c.hour);
  out.push_back(':');
  AppendTwo(out, c.minute);
  out.push_back(':');
  AppendTwo(out, c.second);
  out.push_back('Z');
}

int64_t SecondsBetween(std::string_view from, std::string_view to) {
  return ParseDateTimeOrThrow(to) - ParseDateTimeOrThrow(from);
}

namespace {

std::optional<TimestampText> ShiftedStamp(std::string_view text, int minutes) {
  const auto t = ParseDateTime(text);
  if (!t) return std::nullopt;
  const TimeSeconds shifted = *t + static_cast<TimeSeconds>(minutes) * 60;
  if (!InDateRange(shifted)) return std::nullopt;
  return MakeTimestamp(shifted);
}

}  // namespace

std::string ShiftedTimestamp(std::string_view text, int minutes) {
  const auto stamp = ShiftedStamp(text, minutes);
  return stamp ? std::string(stamp->view()) : std::string();
}

CompactString OziDateToText(std::string_view field, int gmtMinutes) {
  field = Trim(field);
  if (field.empty()) return {};
  // Whole days before the point, the fraction of a day after it.
  const auto point = field.find('.');
  const double days = std::floor(Val(field.substr(0, point)));
  const double fraction = point == std::string_view::npos ? 0.0 : Val(field.substr(point));
  const double seconds = std::nearbyint(fraction * kSecondsPerDay);
  if (!std::isfinite(days) || std::fabs(days) > 4.0e6) return {};
  // An exponent in the fraction (".5e40") can carry it past any date, and past what converts.
  if (!std::isfinite(seconds) || std::fabs(seconds) > 1.0e15) return {};
  const TimeSeconds t = static_cast<TimeSeconds>(days) * kSecondsPerDay +
                        static_cast<TimeSeconds>(gmtMinutes) * 60 + static_cast<TimeSeconds>(seconds);
  if (!InDateRange(t)) return {};
  return CompactString(MakeTimestamp(t).view());
}

std::optional<OziDate> TextToOziDate(std::string_view text, int gmtMinutes) {
  const auto t = ParseDateTime(text);
  if (!t) return std::nullopt;
  const TimeSeconds gmt = *t - static_cast<TimeSeconds>(gmtMinutes) * 60;
  if (!InDateRange(gmt)) return std::nullopt;
  OziDate d;
  d.gmtForm = MakeTimestamp(gmt);
  static const TimeSeconds k1900 = ToSeconds(CivilTime{1900, 1, 1, 0, 0, 0});
  const double s = static_cast<double>(gmt - k1900);
  d.dayNumber = RoundAtDecimals(s / kSecondsPerDay + 2, 6);
  return d;
}

int32_t ReadBytesAsLong(std::string_view bytes, long start, int count) {
  if (start < 1 || count < 1 || count > 4 || static_cast<std::size_t>(start - 1 + count) > bytes.size()) {
    throw RuntimeError(kErrInvalidCall);
  }
  uint32_t value = 0;
  for (int i = 0; i < count; ++i) {
    const auto b = static_cast<unsigned char>(bytes[static_cast<std::size_t>(start - 1 + i)]);
    value |= static_cast<uint32_t>(b) << (8 * i);
  }
  return static_cast<int32_t>(value);
}

float ReadBytesAsSingle(std::string_view bytes, long start) {
  const uint32_t raw = static_cast<uint32_t>(ReadBytesAsLong(bytes, start, 4));
  float f = 0;
  std::memcpy(&f, &raw, sizeof f);
  return f;
}

std::string GarminRecordTime(std::string_view record, int gmtMinutes) {
  static const TimeSeconds kGarminEpoch = ToSeconds(CivilTime{1989, 12, 31, 0, 0, 0});
  const int32_t s = ReadBytesAsLong(record, 12, 4);
  const TimeSeconds t = kGarminEpoch + s + static_cast<TimeSeconds>(gmtMinutes) * 60;
  if (!InDateRange(t)) throw RuntimeError(kErrOverflow);
  return FormatTimestamp(t);
}

CompactString IsoTimeToTimestamp(std::string_view elementText, int gmtMinutes) {
  // The usual "yyyy-mm-ddThh:nn:ss[.fff]Z" is read in place; it means what the general path
  // below makes of it.
  CivilTime c;
  if (ReadFixedLayout(elementText, c) && (elementText[10] == 'T' || elementText[10] == 't')) {
    std::size_t z = 19;
    if (z < elementText.size() && elementText[z] == '.') {
      ++z;
      while (z < elementText.size() && IsDigit(elementText[z])) ++z;
    }
    if (z < elementText.size() && elementText[z] == 'Z') {
      if (!IsValidCivil(c)) return {};
      const TimeSeconds t = ToSeconds(c) + static_cast<TimeSeconds>(gmtMinutes) * 60;
      if (!InDateRange(ToSeconds(c)) || !InDateRange(t)) return {};
      return CompactString(MakeTimestamp(t).view());
    }
  }
  const long t = InStrNoCase(elementText, "T");
  if (t == 0) return CompactString(ShiftedTimestamp(elementText, gmtMinutes));
  const std::string_view date = Left(elementText, t - 1);
  const std::string_view rest = Mid(elementText, t + 1);
  const auto z = rest.find('Z');
  if (z == std::string_view::npos) return CompactString(ShiftedTimestamp(elementText, gmtMinutes));
  std::string joined;
  joined.reserve(date.size() + 1 + z);
  joined.append(date);
  joined.push_back(' ');
  joined.append(rest.substr(0, z));
  return CompactString(ShiftedTimestamp(joined, gmtMinutes));
}

CompactString NmeaTimeToTimestamp(std::string_view time, std::string_view date, int gmtMinutes) {
  if (time.empty()) time = "000000";
  if (date.empty()) date = "010106";
  // "20yy-mm-dd hh:nn:ss" from the fields, built without an allocation.
  std::array<char, 32> text{};
  std::size_t n = 0;
  const auto put = [&](std::string_view part) {
    for (const char c : part) text[n++] = c;
  };
  put("20");
  put(Mid(date, 5, 2));
  put("-");
  put(Mid(date, 3, 2));
  put("-");
  put(Mid(date, 1, 2));
  put(" ");
  put(Mid(time, 1, 2));
  put(":");
  put(Mid(time, 3, 2));
  put(":");
  put(Mid(time, 5, 2));
  const auto stamp = ShiftedStamp(std::string_view(text.data(), n), gmtMinutes);
  return stamp ? CompactString(stamp->view()) : CompactString();
}

int16_t GmtMinutesFromHours(double hours) { return RoundToInt16(hours * 60); }

}  // namespace molvar
