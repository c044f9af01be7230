#include "input/KelTrack.h"

#include "app/Molvar.h"
#include "core/Numbers.h"
#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "input/CsvTracks.h"
#include "input/ReaderCommon.h"

namespace molvar {

namespace {
constexpr double kKmPerMile = 1.609344;
}  // namespace

void ReadKelLine(Molvar& m, std::string_view line) {
  if (line.empty()) return;
  try {
    const Fields f = SplitFields(line, "\t ", true);
    // "---" in any column marks a line without a fix.
    for (int i = 1; i <= f.count; ++i) {
      if (StartsWith(f[i], "---")) return;
    }
    std::string time(Trim(f[1]));
    time.push_back(' ');
    time.append(Trim(f[2]));
    CheckTimestampOrder(m, time, false, m.TextReaders.KelTimestampWarned);
    TrackPoint& p = AppendTrackPoint(m);
    p.DateTime = time;
    p.Latitude = Val(Trim(f[3]));
    p.Longitude = Val(Trim(f[4]));
    if (!f[5].empty()) p.Speed = RoundToInt32Or(Val(f[5]), 0) * kKmPerMile;
    std::string text;
    for (int i = 7; i <= 12; ++i) {
      if (i > 7) text.push_back(' ');
      text.append(f[i]);
    }
    p.PointText = text;
    CalcSpeedDistance(m, m.Track.PointCount);
  } catch (const std::exception& e) {
    ShowSnag(m, "ReadKelLine", e);
  }
}

}  // namespace molvar
