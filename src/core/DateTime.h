#pragma once
// Dates and times. A point in time is held as whole seconds from 30 December 1899 00:00:00 (the
// epoch of Ozi day numbers); the stored text form is "yyyy-mm-dd hh:nn:ss AM/PM".
#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "core/CompactString.h"

namespace molvar {

using TimeSeconds = int64_t;

inline constexpr std::string_view kDefaultTimestamp = "2006-01-01 00:00:00";
inline constexpr std::string_view kAmDesignator = "AM";
inline constexpr std::string_view kPmDesignator = "PM";

struct CivilTime {
  int year = 1899, month = 12, day = 30, hour = 0, minute = 0, second = 0;
};

TimeSeconds ToSeconds(const CivilTime& c);
CivilTime ToCivil(TimeSeconds t);
bool IsValidCivil(const CivilTime& c);
// Years 100 to 9999 are representable.
bool InDateRange(TimeSeconds t);

// Reads a date and time text. Accepted: "yyyy-mm-dd hh:nn:ss" on the 24-hour clock or with an
// AM/PM designator; "/" or "." between the date parts; "1-Jan-1900 00:00:00"; "1989 Dec 31
// 00:00:00"; "Dec 31 1989"; "m/d/yyyy" (day first when the first number is above 12); ISO 8601
// with "T", fractional seconds (dropped) and "Z" or a numeric offset (converted to GMT); a date
// alone (midnight) or a time alone (on the epoch day). Anything else gives nothing.
std::optional<TimeSeconds> ParseDateTime(std::string_view text);
// The same, raising "Type mismatch" (13) for text that is not a date.
TimeSeconds ParseDateTimeOrThrow(std::string_view text);

// "yyyy-mm-dd hh:nn:ss AM/PM", in a buffer of its own (the years are always four digits).
struct TimestampText {
  std::array<char, 22> chars{};
  std::string_view view() const { return {chars.data(), chars.size()}; }
};
TimestampText MakeTimestamp(TimeSeconds t);
std::string FormatTimestamp(TimeSeconds t);
void AppendTimestamp(std::string& out, TimeSeconds t);
// "yyyy-mm-dd" and "Thh:nn:ssZ" joined: the GPX time form.
void AppendIsoUtc(std::string& out, TimeSeconds t);

// Whole seconds from `from` to `to` (negative when `to` is earlier); "Type mismatch" when either
// text is not a date.
int64_t SecondsBetween(std::string_view from, std::string_view to);

// The text read as a date plus `minutes`, in the stored form; empty when it is not a date or the
// result is out of range.
std::string ShiftedTimestamp(std::string_view text, int minutes);

// An Ozi day-number field (days since the epoch with a decimal fraction) in local time.
// Empty text gives empty text.
CompactString OziDateToText(std::string_view field, int gmtMinutes);

// The Ozi day number (six decimals) of a stored timestamp, and its GMT form for the date and time
// fields; nothing when the text is not a date.
struct OziDate {
  double dayNumber = 0;
  TimestampText gmtForm;
};
std::optional<OziDate> TextToOziDate(std::string_view text, int gmtMinutes);

// Count bytes (1..4) from 1-based `start`, lowest first, into a signed 32-bit integer or a float;
// "Invalid procedure call" (5) when the bytes are not all there.
int32_t ReadBytesAsLong(std::string_view bytes, long start, int count);
float ReadBytesAsSingle(std::string_view bytes, long start);

// The time of a Garmin track record (seconds since 1989-12-31 00:00:00 GMT at bytes 12..15)
// in local time; "Invalid procedure call" (5) for a short record, "Overflow" (6) out of range.
std::string GarminRecordTime(std::string_view record, int gmtMinutes);

// The text of a GPX/XML <time> element as a local timestamp; empty when unreadable.
CompactString IsoTimeToTimestamp(std::string_view elementText, int gmtMinutes);

// NMEA time (hhmmss) and date (ddmmyy) fields as a local timestamp; empty fields count as
// "000000" and "010106"; empty result when unreadable.
CompactString NmeaTimeToTimestamp(std::string_view time, std::string_view date, int gmtMinutes);

// GmtMinutes of a GMT offset in hours: hours × 60 to the nearest minute, ties to even.
int16_t GmtMinutesFromHours(double hours);

}  // namespace molvar
