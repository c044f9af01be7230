#include "support/Sentences.h"

#include <cstdio>

namespace molvar::testing {

std::string Rmc(const std::string& time, const std::string& latitude, const std::string& knots,
                const std::string& course) {
  const std::string body = "GPRMC," + time + ",A," + latitude + ",N,07500.0000,W," + knots + "," + course + ",061226,,";
  int x = 0;
  for (char c : body) x ^= static_cast<unsigned char>(c);
  char hex[3];
  std::snprintf(hex, sizeof hex, "%02X", x);
  return "$" + body + "*" + hex + "\r\n";
}

}  // namespace molvar::testing
