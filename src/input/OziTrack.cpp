#include "input/OziTrack.h"

#include "app/Molvar.h"
#include "core/DateTime.h"
#include "core/Numbers.h"
#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "input/ReaderCommon.h"

namespace molvar {

namespace {
constexpr double kFeetPerMetre = 3.28083;
constexpr int32_t kOziNoAltitude = -777;
}  // namespace

void ReadOziTrackLine(Molvar& m, std::string_view line) {
  if (line.empty()) return;
  try {
    const Fields f = SplitFields(line, ",");
    TrackPoint& p = AppendTrackPoint(m);
    // Numbers out of range for the stored types are unusable and read as 0, like non-numbers.
    int32_t feet = RoundToInt32Or(Val(Trim(f[4])), 0);
    if (feet == kOziNoAltitude) feet = 0;
    p.Altitude = RoundToInt32Or(feet / kFeetPerMetre, 0);
    p.DateTime = OziDateToText(f[5], m.GmtMinutes);
    p.Latitude = Val(Trim(f[1]));
    p.Longitude = Val(Trim(f[2]));
    const int32_t flag = RoundToInt32Or(Val(Trim(f[3])), 0);
    p.Flag = static_cast<int16_t>(flag >= INT16_MIN && flag <= INT16_MAX ? flag : 0);
    // Ozi writes -777 for a missing altitude: carry the last known one over the gap.
    int32_t& lastGood = m.OziTrack.LastGoodAltitude;
    if (p.Altitude <= 0 && m.Track.PointCount >= 2 && lastGood >= 1) p.Altitude = lastGood;
    lastGood = p.Altitude;
    CalcSpeedDistance(m, m.Track.PointCount);
  } catch (const std::exception& e) {
    ShowSnag(m, "ReadOziTrackLine", e);
  }
}

}  // namespace molvar
