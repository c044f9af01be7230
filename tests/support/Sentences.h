#pragma once
// NMEA sentences the way a receiver sends them, for the live-mode tests.
#include <string>

namespace molvar::testing {

// A $GPRMC sentence with its checksum and line end; the longitude is 75 degrees west.
std::string Rmc(const std::string& time, const std::string& latitude, const std::string& knots,
                const std::string& course);

}  // namespace molvar::testing
