// The date and time readers. Bytes 1-2: a GMT offset in minutes; the rest is the text, also cut
// at its first line feed into two dates (SecondsBetween) and at its first comma into NMEA time and
// date. A parsed date must read back from its stored form as the same second.
#include <cstdint>
#include <cstdio>
#include <cstdlib>

#include "FuzzProgram.h"
#include "core/DateTime.h"
#include "core/Errors.h"

using namespace molvar;

namespace {

void CheckRoundTrip(std::string_view text) {
  const auto t = ParseDateTime(text);
  if (!t) return;
  const std::string stored = FormatTimestamp(*t);
  const auto back = ParseDateTime(stored);
  if (back && *back == *t) return;
  std::fprintf(stderr, "==fuzz== \"%.*s\" is %lld s, stored \"%s\" reads back differently\n",
               static_cast<int>(text.size()), text.data(), static_cast<long long>(*t), stored.c_str());
  std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
  fuzz::FuzzInput in(data, size);
  const int gmt = static_cast<int16_t>(in.Byte() | (in.Byte() << 8));
  const std::string_view text = in.rest;

  CheckRoundTrip(text);
  ParseDateTime(text);
  IsoTimeToTimestamp(text, gmt);
  OziDateToText(text, gmt);
  TextToOziDate(text, gmt);
  ShiftedTimestamp(text, gmt);

  std::string_view nmea = text;
  const std::string_view time = fuzz::FuzzInput::Cut(nmea, ',');
  NmeaTimeToTimestamp(time, nmea, gmt);

  std::string_view pair = text;
  const std::string_view from = fuzz::FuzzInput::Cut(pair, '\n');
  try {
    SecondsBetween(from, pair);
  } catch (const RuntimeError& e) {
    // Not a date: the program raises "Type mismatch" and its callers report it.
    if (e.Number() != kErrTypeMismatch) throw;
  }
  return 0;
}
