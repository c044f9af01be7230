#pragma once
// KEL custom track lines: date, time, latitude, longitude, speed in mph, ..., free text in
// columns 7 to 12, separated by TABs or blanks.
#include <string_view>

namespace molvar {

struct Molvar;

void ReadKelLine(Molvar& m, std::string_view line);

}  // namespace molvar
