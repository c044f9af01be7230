#pragma once
// What the writers keep while one file is written, and between live rewrites.
#include <cstdint>

namespace molvar {

struct KmlState {
  bool AltitudeWarned = false;  // lives for the whole run
  int16_t SegmentCount = 0;
  int16_t DayCount = 0;
  int32_t CurrentPoint = 0;
};

struct DetailState {
  int16_t DetailDayNumber = 0;
  int16_t DetailSegmentNumber = 0;
  int32_t DetailStart = 1;
};

struct GpxState {
  double GpxMinLat = 180, GpxMinLon = 180, GpxMaxLat = -180, GpxMaxLon = -180;
};

struct LiveState {
  int32_t LastWrittenCount = 0;
  int32_t UploadCount = 0;
  int64_t LastUploadTime = 0;  // seconds, as Platform::Now()
  bool GmapsWarned = false;
  bool FtpSetupShown = false;
};

}  // namespace molvar
