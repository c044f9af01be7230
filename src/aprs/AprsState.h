#pragma once
// APRS values that the writers read.
#include <cstdint>
#include <string>

namespace molvar {

struct AprsState {
  std::string StationCallSign;
  int16_t NearestMode = 0;
  std::string QrzLink;
  int32_t StationCount = 0;  // stations of the AGW station store
  // Set by the AGW writer for the station being written (placemark description).
  std::string AgwTimeText;
  double AgwSpeed = 0;
  std::string AgwHeading;
};

}  // namespace molvar
