#include "input/CsvTracks.h"

#include "app/Molvar.h"
#include "core/DateTime.h"
#include "core/Numbers.h"
#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "input/ReaderCommon.h"

namespace molvar {

namespace {

constexpr double kKmPerMile = 1.609344;

std::string_view DropLastFour(std::string_view s) {
  return Left(s, static_cast<long>(s.size()) - 4);
}

}  // namespace

void CheckTimestampOrder(Molvar& m, std::string_view newTime, bool dropLastFour, int16_t& warned) {
  const int32_t count = m.Track.PointCount;
  if (count == 0) {
    warned = 0;
    return;
  }
  if (warned != 0 || !m.Track.Exists(count)) return;
  std::string_view previous = m.Track.at(count).DateTime.view();
  if (dropLastFour) {
    previous = DropLastFour(previous);
    newTime = DropLastFour(newTime);
  }
  // A time that cannot be read is no evidence of disorder.
  const auto from = ParseDateTime(previous);
  const auto to = ParseDateTime(newTime);
  if (!from || !to || *to >= *from) return;
  std::string text = "Timestamp out of sequence (near line ";
  text.append(IntToText(count));
  text.append(") in file ");
  text.append(m.InputName);
  text.append(". \r\nPlease check your input file for this, and possibly other, errors.\r\n"
              "Consider deleting the bad line and loading the file again.");
  m.platform.MsgBox(text, " Bad timestamp in input file", MsgButtons::OK, MsgIcon::Exclamation);
  warned = 1;
}

void ReadOrionCsvLine(Molvar& m, std::string_view line) {
  if (line.empty()) return;
  try {
    const Fields f = SplitFields(line, ",");
    const std::string_view time = Trim(f[2]);
    CheckTimestampOrder(m, time, true, m.TextReaders.Csv1TimestampWarned);
    TrackPoint& p = AppendTrackPoint(m);
    p.Latitude = Val(Trim(f[7]));
    p.Longitude = Val(Trim(f[6]));
    p.DateTime = time;
    if (m.frmMain.chkSplitIfStopped.Checked() && Trim(f[5]) == "MOTION DETECTED") p.Flag = 1;
    const std::string_view speed = Trim(f[9]);
    p.Speed = speed.empty() ? 0 : Val(speed) * kKmPerMile;
    if (!f[8].empty()) {
      const int32_t band = RoundToInt32Or(Val(f[8]), 0);
      p.ColorBand = static_cast<int16_t>(band >= 0 && band <= 9 ? band : 0);
    }
    CalcSpeedDistance(m, m.Track.PointCount);
  } catch (const std::exception& e) {
    ShowSnag(m, "ReadOrionCsvLine", e);
  }
}

void ReadCsv2Line(Molvar& m, std::string_view line) {
  if (line.empty()) return;
  try {
    const Fields f = SplitFields(line, ", ");
    std::string time(Trim(f[2]));
    time.push_back(' ');
    time.append(Trim(f[3]));
    CheckTimestampOrder(m, time, false, m.TextReaders.Csv2TimestampWarned);
    TrackPoint& p = AppendTrackPoint(m);
    p.Latitude = Val(Trim(f[4]));
    p.Longitude = Val(Trim(f[5]));
    p.DateTime = time;
    if (m.frmMain.chkSplitIfStopped.Checked() && Trim(f[7]) == "Moving") p.Flag = 1;
    const std::string_view speed = f[8];
    if (Contains(speed, "mph")) {
      const std::string_view trimmed = Trim(speed);
      p.Speed = Val(Left(trimmed, static_cast<long>(trimmed.size()) - 3)) * kKmPerMile;
    }
    CalcSpeedDistance(m, m.Track.PointCount);
  } catch (const std::exception& e) {
    ShowSnag(m, "ReadCsv2Line", e);
  }
}

}  // namespace molvar
