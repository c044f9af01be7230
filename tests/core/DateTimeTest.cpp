#include "core/DateTime.h"

#include <gtest/gtest.h>

#include "core/Errors.h"

namespace molvar {
namespace {

TimeSeconds At(int y, int mo, int d, int h = 0, int mi = 0, int s = 0) {
  return ToSeconds(CivilTime{y, mo, d, h, mi, s});
}

TEST(Timestamp, TwelveHourClockWithDesignators) {
  EXPECT_EQ(FormatTimestamp(At(2007, 3, 14, 13, 5, 9)), "2007-03-14 01:05:09 PM");
  EXPECT_EQ(FormatTimestamp(At(2007, 3, 14, 0, 0, 0)), "2007-03-14 12:00:00 AM");
  EXPECT_EQ(FormatTimestamp(At(2007, 3, 14, 12, 0, 0)), "2007-03-14 12:00:00 PM");
  EXPECT_EQ(FormatTimestamp(At(2007, 3, 14, 11, 59, 59)), "2007-03-14 11:59:59 AM");
  EXPECT_EQ(FormatTimestamp(At(1899, 12, 30)), "1899-12-30 12:00:00 AM");
}

TEST(CivilDays, RoundTripAcrossLeapYearsAndCenturies) {
  for (TimeSeconds t : {At(1900, 2, 28, 23, 59, 59), At(1900, 3, 1), At(2000, 2, 29, 6),
                        At(2100, 12, 31, 23), At(100, 1, 1), At(9999, 12, 31, 23, 59, 59)}) {
    EXPECT_EQ(ToSeconds(ToCivil(t)), t);
  }
  EXPECT_EQ(At(1900, 3, 1) - At(1900, 2, 28), 86400);  // 1900 is no leap year
  EXPECT_EQ(At(2000, 3, 1) - At(2000, 2, 28), 2 * 86400);
}

TEST(ParseDateTime, EveryFormTheProgramStoresOrReads) {
  const TimeSeconds noon = At(2007, 3, 14, 12, 0, 0);
  EXPECT_EQ(ParseDateTime("2007-03-14 12:00:00 PM"), noon);
  EXPECT_EQ(ParseDateTime("2007-03-14 12:00:00 AM"), At(2007, 3, 14));
  EXPECT_EQ(ParseDateTime("2007-03-14 01:05:09 pm"), At(2007, 3, 14, 13, 5, 9));
  EXPECT_EQ(ParseDateTime("2007-03-14 12:00:00"), noon);
  EXPECT_EQ(ParseDateTime("2007-03-14 23:59:59"), At(2007, 3, 14, 23, 59, 59));
  EXPECT_EQ(ParseDateTime("1-Jan-1900 00:00:00"), At(1900, 1, 1));
  EXPECT_EQ(ParseDateTime("1989 Dec 31 00:00:00"), At(1989, 12, 31));
  EXPECT_EQ(ParseDateTime("Dec 31 1989"), At(1989, 12, 31));
  EXPECT_EQ(ParseDateTime("3/14/2007 12:00:00"), noon);
  EXPECT_EQ(ParseDateTime("14/3/2007"), At(2007, 3, 14));
  EXPECT_EQ(ParseDateTime("2007/03/14"), At(2007, 3, 14));
  EXPECT_EQ(ParseDateTime("2007-03-14"), At(2007, 3, 14));
  EXPECT_EQ(ParseDateTime("12:30:00"), At(1899, 12, 30, 12, 30));
  EXPECT_EQ(ParseDateTime("2007-03-14T13:45:12Z"), At(2007, 3, 14, 13, 45, 12));
}

TEST(ParseDateTime, IsoFractionsAndOffsetsBecomeGmt) {
  EXPECT_EQ(ParseDateTime("2007-03-14T13:45:12.250Z"), At(2007, 3, 14, 13, 45, 12));
  EXPECT_EQ(ParseDateTime("2007-03-14T15:45:12+02:00"), At(2007, 3, 14, 13, 45, 12));
  EXPECT_EQ(ParseDateTime("2007-03-14T08:45:12-05:00"), At(2007, 3, 14, 13, 45, 12));
  EXPECT_EQ(ParseDateTime("2007-03-14T00:30:00+0100"), At(2007, 3, 13, 23, 30));
}

TEST(ParseDateTime, RejectsWhatIsNotADate) {
  for (const char* bad : {"", "   ", "abc", "2007-13-01", "2007-02-30", "2007-03-14 25:00:00",
                          "2007-03-14 12:60:00", "13:00:00 PM", "2007-03-14 12:00:00 XM",
                          "99999-01-01", "2007-03-14 12:00:00 trailing", "\xff\xfe\x01"}) {
    EXPECT_FALSE(ParseDateTime(bad).has_value()) << bad;
  }
  try {
    ParseDateTimeOrThrow("nonsense");
    ADD_FAILURE();
  } catch (const RuntimeError& e) {
    EXPECT_EQ(e.Number(), kErrTypeMismatch);
  }
}

TEST(SecondsBetween, SignedWholeSeconds) {
  EXPECT_EQ(SecondsBetween("2007-03-14 12:00:00 PM", "2007-03-14 12:01:00 PM"), 60);
  EXPECT_EQ(SecondsBetween("2007-03-14 12:01:00 PM", "2007-03-14 12:00:00 PM"), -60);
  EXPECT_EQ(SecondsBetween("2007-03-14 11:59:59 PM", "2007-03-15 12:00:00 AM"), 1);
  EXPECT_THROW(SecondsBetween("x", "2007-03-14"), RuntimeError);
}

TEST(GmtMinutes, NearestMinuteTiesToEven) {
  EXPECT_EQ(GmtMinutesFromHours(5.5), 330);
  EXPECT_EQ(GmtMinutesFromHours(-4), -240);
  EXPECT_EQ(GmtMinutesFromHours(1.5 / 60), 2);
  EXPECT_EQ(GmtMinutesFromHours(2.5 / 60), 2);
  EXPECT_EQ(GmtMinutesFromHours(-2.5 / 60), -2);
  EXPECT_EQ(GmtMinutesFromHours(0), 0);
  EXPECT_EQ(GmtMinutesFromHours(9.75), 585);
}

TEST(OziDates, DayNumbersBothWays) {
  EXPECT_EQ(OziDateToText("39155.5", 0), "2007-03-14 12:00:00 PM");
  EXPECT_EQ(OziDateToText("39155.5000000", 60), "2007-03-14 01:00:00 PM");
  EXPECT_EQ(OziDateToText("39155.0", -300), "2007-03-13 07:00:00 PM");
  EXPECT_EQ(OziDateToText("39155", 0), "2007-03-14 12:00:00 AM");
  EXPECT_EQ(OziDateToText("", 0), "");
  // A fraction with a huge exponent is no time of day; converting its seconds was undefined
  // (the sanitizer build reports it).
  EXPECT_EQ(OziDateToText("39155.4e44", 0), "");
  EXPECT_EQ(OziDateToText("-2.4e30", 0), "");

  auto jan1 = TextToOziDate("1900-01-01 00:00:00", 0);
  ASSERT_TRUE(jan1);
  EXPECT_DOUBLE_EQ(jan1->dayNumber, 2.0);
  EXPECT_EQ(jan1->gmtForm.view(), "1900-01-01 12:00:00 AM");

  auto noon = TextToOziDate("2007-03-14 01:00:00 PM", 60);
  ASSERT_TRUE(noon);
  EXPECT_DOUBLE_EQ(noon->dayNumber, 39155.5);
  EXPECT_EQ(noon->gmtForm.view(), "2007-03-14 12:00:00 PM");

  auto second = TextToOziDate("2007-03-14 12:00:01 PM", 0);
  ASSERT_TRUE(second);
  EXPECT_DOUBLE_EQ(second->dayNumber, 39155.500012);  // six decimals kept

  EXPECT_FALSE(TextToOziDate("", 0));
  EXPECT_FALSE(TextToOziDate("not a time", 0));
}

TEST(IsoTime, GpxTimesWithOffsetApplied) {
  EXPECT_EQ(IsoTimeToTimestamp("2007-03-14T13:45:12Z", -300), "2007-03-14 08:45:12 AM");
  EXPECT_EQ(IsoTimeToTimestamp("2007-03-14t13:45:12z", 0), "2007-03-14 01:45:12 PM");
  EXPECT_EQ(IsoTimeToTimestamp("2007-03-14T13:45:12.250Z", 0), "2007-03-14 01:45:12 PM");
  EXPECT_EQ(IsoTimeToTimestamp("2007-03-14T15:45:12+02:00", 60), "2007-03-14 02:45:12 PM");
  EXPECT_EQ(IsoTimeToTimestamp("2007-03-14T23:30:00Z", 60), "2007-03-15 12:30:00 AM");
  EXPECT_EQ(IsoTimeToTimestamp("garbage", 0), "");
  EXPECT_EQ(IsoTimeToTimestamp("", 0), "");
}

TEST(NmeaTime, FieldPairsAndDefaults) {
  EXPECT_EQ(NmeaTimeToTimestamp("134512", "140307", 0), "2007-03-14 01:45:12 PM");
  EXPECT_EQ(NmeaTimeToTimestamp("134512.250", "140307", -300), "2007-03-14 08:45:12 AM");
  EXPECT_EQ(NmeaTimeToTimestamp("", "", 0), "2006-01-01 12:00:00 AM");
  EXPECT_EQ(NmeaTimeToTimestamp("", "", 90), "2006-01-01 01:30:00 AM");
  EXPECT_EQ(NmeaTimeToTimestamp("99", "140307", 0), "");
  EXPECT_EQ(NmeaTimeToTimestamp("134512", "xx", 0), "");
}

TEST(GarminTime, SecondsFrom1989InLocalTime) {
  std::string record(20, '\0');
  // 1 day + 1 hour = 90000 s = 0x00015F90, little-endian at positions 12..15
  record[11] = '\x90';
  record[12] = '\x5f';
  record[13] = '\x01';
  record[14] = '\x00';
  EXPECT_EQ(GarminRecordTime(record, 0), "1990-01-01 01:00:00 AM");
  EXPECT_EQ(GarminRecordTime(record, -120), "1989-12-31 11:00:00 PM");
  EXPECT_THROW(GarminRecordTime(std::string(14, '\0'), 0), RuntimeError);
}

TEST(ReadBytes, LittleEndianSignedAndBounds) {
  EXPECT_EQ(ReadBytesAsLong(std::string("\x01\x02\x03\x04", 4), 1, 4), 0x04030201);
  EXPECT_EQ(ReadBytesAsLong(std::string("\xff\xff\xff\xff", 4), 1, 4), -1);
  EXPECT_EQ(ReadBytesAsLong(std::string("\x00\x34\x12", 3), 2, 2), 0x1234);
  EXPECT_EQ(ReadBytesAsLong(std::string("\xff", 1), 1, 1), 255);
  EXPECT_THROW(ReadBytesAsLong(std::string("\x01\x02", 2), 2, 2), RuntimeError);
  EXPECT_THROW(ReadBytesAsLong(std::string("\x01\x02", 2), 0, 1), RuntimeError);
  EXPECT_FLOAT_EQ(ReadBytesAsSingle(std::string("\x00\x00\x80\x3f", 4), 1), 1.0f);
  EXPECT_THROW(ReadBytesAsSingle(std::string("\x00\x00\x80", 3), 1), RuntimeError);
}

TEST(ShiftedTimestamp, AddsMinutesOrGivesEmpty) {
  EXPECT_EQ(ShiftedTimestamp("2007-03-14 11:30:00 PM", 60), "2007-03-15 12:30:00 AM");
  EXPECT_EQ(ShiftedTimestamp("2007-03-14 23:30:00", -60), "2007-03-14 10:30:00 PM");
  EXPECT_EQ(ShiftedTimestamp("junk", 60), "");
}

}  // namespace
}  // namespace molvar
