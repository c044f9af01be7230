#include "input/Nmea.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "app/Molvar.h"
#include "core/DateTime.h"
#include "core/Numbers.h"
#include "core/SpeedDistance.h"
#include "core/Text.h"

namespace molvar {
namespace {

constexpr std::string_view kRmc = "$GPRMC";
constexpr std::string_view kGga = "$GPGGA";
constexpr double kKmhPerKnot = 1.852;
// The time and date texts of a fix without a known time.
constexpr std::string_view kNoTime = "000000";
constexpr std::string_view kNoDate = "010106";

// A sentence cut at its commas: parts 1..last-1 as they stand; part `last` holds the rest of the
// sentence with its commas dropped, so a trailing "*hh" always lands in it. Nothing is copied but
// that rest, so a huge line costs one pass.
struct SentenceParts {
  static constexpr int kMaxLast = 14;
  std::array<std::string_view, kMaxLast> head{};  // index 0 unused
  std::string rest;
  int last = 0;
  long count = 1;  // parts in the whole sentence

  std::string_view operator[](int i) const {
    if (i < 1 || i > last) return {};
    return i == last ? std::string_view(rest) : head[static_cast<std::size_t>(i)];
  }
};

SentenceParts SplitSentence(std::string_view text, int last) {
  SentenceParts p;
  p.last = last;
  std::size_t start = 0;
  for (int field = 1; field < last; ++field) {
    const std::size_t comma = text.find(',', start);
    if (comma == std::string_view::npos) {
      p.head[static_cast<std::size_t>(field)] = text.substr(start);
      return p;
    }
    p.head[static_cast<std::size_t>(field)] = text.substr(start, comma - start);
    ++p.count;
    start = comma + 1;
  }
  const std::string_view rest = text.substr(start);
  p.rest.reserve(rest.size());
  for (const char c : rest) {
    if (c == ',') {
      ++p.count;
    } else {
      p.rest.push_back(c);
    }
  }
  return p;
}

// "*" and the two characters after it, when the field has a "*".
std::string ChecksumTextOf(std::string_view field) {
  const long p = InStr(field, "*");
  return p == 0 ? std::string{} : std::string(Mid(field, p, 3));
}

int16_t FixQualityValue(std::string_view text) {
  const int32_t q = RoundToInt32Or(Val(text), 0);
  return static_cast<int16_t>(std::clamp<int32_t>(q, -32768, 32767));
}

bool IsHemisphere(std::string_view h, char a, char b) { return h.size() == 1 && (h[0] == a || h[0] == b); }

void StoreRmc(NmeaFields& n, const SentenceParts& f) {
  n.SentenceName = f[1];
  n.UtcTime = f[2];
  n.Status = f[3];
  n.LatitudeText = f[4];
  n.LatitudeHemisphere = f[5];
  n.LongitudeText = f[6];
  n.LongitudeHemisphere = f[7];
  const std::string_view knots = f[8];
  n.SpeedText = knots.empty() ? std::string{} : FormatPattern(Val(knots) * kKmhPerKnot, "0.0");
  n.CourseText = f[9];
  n.DateText = f[10];
  n.MagneticVariation = f[11];
  const std::string_view tail = f[12];
  const long star = InStr(tail, "*");
  n.MagneticVariationDirection = star == 0 ? tail : Left(tail, star - 1);
  n.ChecksumText = ChecksumTextOf(tail);
}

void StoreGga(Molvar& m, NmeaFields& n, const SentenceParts& f) {
  n.SentenceName = f[1];
  n.UtcTime = f[2];
  n.LatitudeText = f[3];
  n.LatitudeHemisphere = f[4];
  n.LongitudeText = f[5];
  n.LongitudeHemisphere = f[6];
  n.FixQuality = f[7];
  n.Satellites = f[8];
  n.Hdop = f[9];
  n.AltitudeText = TextBefore(f[10], ".");
  n.AltitudeUnit = f[11];
  n.GeoidSeparation = f[12];
  n.GeoidUnit = f[13];
  n.ChecksumText = ChecksumTextOf(f[14]);

  // A change of fix quality (GPS to DGPS and back) starts a new segment at the last stored point.
  // Point 1 always starts one.
  TrackStore& track = m.Track;
  const int16_t quality = FixQualityValue(n.FixQuality);
  const bool stored = track.PointCount >= 1 && track.Exists(track.PointCount);
  if (quality != m.NmeaParser.LastFixQuality) {
    if (stored) track.at(track.PointCount).Flag = 1;
    m.NmeaParser.LastFixQuality = quality;
  } else if (stored && track.PointCount > 1) {
    track.at(track.PointCount).Flag = 0;
  }
  m.Nmea.NmeaAltitude = RoundToInt32Or(Val(n.AltitudeText), 0);
}

bool StoresSentencePoints(const Molvar& m) {
  switch (m.ProgramMode) {
    case kModeConvertTracks:
      return m.TrackFileType == 3;
    case kModeAgw:
      return true;
    case kModeAprsWeb:
      return m.NmeaParser.AprsWebAddsPoints != 0;
    default:
      return false;
  }
}

// The time of a parsed fix: the converted time and date texts, or DefaultTimestamp when either is
// missing or holds the no-time placeholders (the placeholders are not shifted by the GMT offset).
CompactString ParsedPointTime(const NmeaFields& n, int gmtMinutes) {
  if (n.UtcTime.empty() || n.DateText.empty() || (n.UtcTime == kNoTime && n.DateText == kNoDate)) {
    return CompactString(kDefaultTimestamp);
  }
  CompactString t = NmeaTimeToTimestamp(n.UtcTime, n.DateText, gmtMinutes);
  return t.empty() ? CompactString(kDefaultTimestamp) : t;
}

}  // namespace

void ParseNMEA(Molvar& m, std::string& sentence) {
  try {
    NmeaFix& fix = m.Nmea;
    if (sentence.empty()) return;
    fix.NmeaValid = 1;
    const long dollar = InStr(sentence, "$");
    if (dollar == 0) {
      fix.NmeaValid = 0;
      return;
    }
    // Cut and upper-cased in place: the caller's buffer keeps its storage from line to line.
    std::string_view text = Trim(Mid(sentence, dollar));
    const long lineEnd = InStr(text, "\r\n");
    if (lineEnd > 1) text = text.substr(0, static_cast<std::size_t>(lineEnd - 1));
    if (text.empty()) {
      sentence.clear();
    } else {
      const auto offset = static_cast<std::size_t>(text.data() - sentence.data());
      sentence.erase(offset + text.size());
      sentence.erase(0, offset);
    }
    for (char& c : sentence) c = UpperChar(c);

    const bool rmc = StartsWith(sentence, kRmc);
    if (!rmc && !StartsWith(sentence, kGga)) {
      fix.NmeaValid = 0;
      return;
    }
    if (VerifyChecksum(m, sentence) == 0) return;

    const SentenceParts f = SplitSentence(sentence, rmc ? 12 : 14);
    NmeaFields& n = fix.Fields;
    if (rmc) {
      StoreRmc(n, f);
    } else {
      StoreGga(m, n, f);
    }

    if (n.ChecksumText.size() != 3 && !StartsWith(n.ChecksumText, "*") && !Contains(sentence, "*")) {
      fix.NmeaValid = 0;
      return;
    }
    if (!m.frmMain.mnuIgnore.Checked) {
      const bool complete = rmc ? (n.Status == "A" && f.count >= 12) : (n.FixQuality != "0" && f.count >= 14);
      // An unknown E/W letter would silently turn a west longitude east.
      const bool located = IsHemisphere(n.LatitudeHemisphere, 'N', 'S') &&
                           IsHemisphere(n.LongitudeHemisphere, 'E', 'W') && !n.LatitudeText.empty() &&
                           !n.LongitudeText.empty();
      if (!complete || !located) {
        fix.NmeaValid = 0;
        return;
      }
    }
    if (rmc && m.Track.PointCount == 0) {
      n.AltitudeText.assign(1, '1');
      fix.NmeaAltitude = 1;
    }
    fix.NmeaLatitude = ConvertNmeaLocation(n.LatitudeText, n.LatitudeHemisphere);
    fix.NmeaLongitude = ConvertNmeaLocation(n.LongitudeText, n.LongitudeHemisphere);
    if (StoresSentencePoints(m)) AddNmeaTrackPoint(m);
  } catch (const std::exception& e) {
    ShowSnag(m, "ParseNMEA", e);
  }
}

int16_t VerifyChecksum(Molvar& m, std::string_view sentence) {
  try {
    NmeaFix& fix = m.Nmea;
    if (m.frmMain.mnuIgnore.Checked) {
      fix.NmeaValid = 1;
      return 1;
    }
    const long star = InStr(sentence, "*");
    if (star == 0 || static_cast<long>(sentence.size()) < star + 2) {
      fix.NmeaValid = 0;
      return 0;
    }
    unsigned x = 0;
    for (const char c : Mid(Left(sentence, star - 1), 2)) x ^= static_cast<unsigned char>(c);
    fix.NmeaValid = Hex2(static_cast<int>(x)) == Mid(sentence, star + 1, 2) ? 1 : 0;
    return fix.NmeaValid;
  } catch (const std::exception& e) {
    ShowSnag(m, "VerifyChecksum", e);
    return 0;
  }
}

double ConvertNmeaLocation(std::string_view text, std::string_view hemisphere) {
  const double v = Val(text) / 100;
  const double degrees = std::floor(v);
  const double minutes = (v - degrees) * 100;
  double result = degrees + minutes / 60;
  if (hemisphere == "S" || hemisphere == "W") result = -result;
  return RoundAtDecimals(result, 8);
}

void AddNmeaTrackPoint(Molvar& m) {
  try {
    NmeaFix& fix = m.Nmea;
    NmeaFields& n = fix.Fields;
    const double lat = ConvertNmeaLocation(n.LatitudeText, n.LatitudeHemisphere);
    const double lon = ConvertNmeaLocation(n.LongitudeText, n.LongitudeHemisphere);
    if (lat == 0 || lon == 0) {
      fix.NmeaValid = 0;
      return;
    }
    TrackStore& track = m.Track;
    // The real-time sentence handler counts the point before it has the live file written.
    if (m.ProgramMode != kModeRealTimeNmea) track.PointCount += 1;
    const int32_t i = track.PointCount;
    track.GrowTrackStore(i);
    TrackPoint& p = track.at(i);
    p.DateTime = NmeaTimeToTimestamp(n.UtcTime, n.DateText, m.GmtMinutes);
    p.Latitude = lat;
    p.Longitude = lon;
    p.Flag = i == 1 ? 1 : 0;
    // GGA altitudes come with every other sentence only; an RMC point keeps the last one.
    int32_t altitude = RoundToInt32Or(Val(n.AltitudeText), 0);
    if (altitude <= 0 && i >= 2 && m.NmeaParser.PreviousAltitude >= 1) altitude = m.NmeaParser.PreviousAltitude;
    p.Altitude = altitude;
    m.NmeaParser.PreviousAltitude = altitude;
    CalcSpeedDistance(m, i);
    const double speed = Val(n.SpeedText);
    if (speed != 0) p.Speed = speed;
    // A following GGA sentence carries no speed: it gets the speed derived from the positions.
    n.SpeedText.assign(1, '0');
  } catch (const std::exception& e) {
    ShowSnag(m, "AddNmeaTrackPoint", e);
  }
}

void AddParsedPoint(Molvar& m) {
  try {
    NmeaFix& fix = m.Nmea;
    NmeaFields& n = fix.Fields;
    TrackStore& track = m.Track;
    const bool live = m.ProgramMode == kModeRealTimeNmea;
    if (!live) track.PointCount += 1;
    const int32_t i = track.PointCount;
    track.GrowTrackStore(i);
    TrackPoint& p = track.at(i);
    p.Latitude = ConvertNmeaLocation(n.LatitudeText, n.LatitudeHemisphere);
    p.Longitude = ConvertNmeaLocation(n.LongitudeText, n.LongitudeHemisphere);
    p.Altitude = fix.NmeaAltitude;
    p.DateTime = ParsedPointTime(n, m.GmtMinutes);
    if (n.SpeedText.empty()) n.SpeedText.assign(1, '0');
    p.Speed = Val(n.SpeedText);
    if (i == 2 && track.at(1).Altitude == 0) track.at(1).Altitude = p.Altitude;
    p.Flag = 0;
    track.at(1).Flag = 1;
    p.SegCtr = 0;
    p.DayCtr = 0;
    if (live) {
      std::string info = " Data received ";
      info.append(p.DateTime.view());
      info.append(" Speed: ");
      info.append(FormatPattern(p.Speed * m.UnitFactor, "0.0"));
      info.append(m.SpeedUnitLabel);
      info.append("  Alt: ");
      info.append(FormatPattern(p.Altitude * m.AltitudeFactor, "0"));
      info.append(m.AltitudeUnitLabel);
      m.frmMain.txtGpsNmeaInfo.Text = std::move(info);
    }
  } catch (const std::exception& e) {
    ShowSnag(m, "AddParsedPoint", e);
  }
}

}  // namespace molvar
