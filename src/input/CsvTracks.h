#pragma once
// CSV track lines: type 1 as the Orion Tracker writes it, and type 2.
#include <cstdint>
#include <string_view>

namespace molvar {

struct Molvar;

void ReadOrionCsvLine(Molvar& m, std::string_view line);
void ReadCsv2Line(Molvar& m, std::string_view line);

// Warns once per file and reader (through `warned`) when `newTime` is earlier than the time of
// the last stored point. `dropLastFour` cuts the last four characters of both texts first.
void CheckTimestampOrder(Molvar& m, std::string_view newTime, bool dropLastFour, int16_t& warned);

}  // namespace molvar
