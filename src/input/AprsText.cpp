#include "input/AprsText.h"

#include "app/Molvar.h"
#include "core/Numbers.h"
#include "core/SpeedDistance.h"
#include "core/Text.h"
#include "input/Nmea.h"
#include "input/ReaderCommon.h"

namespace molvar {

namespace {

constexpr double kFeetPerMetre = 3.28083;

// The position of a report, or false when the text holds none.
bool FindAprsPosition(Molvar& m, std::string_view text) {
  const long p = InStr(text, ".");
  if (p < 5 || static_cast<long>(text.size()) <= p + 12) return false;
  const std::string_view latHemisphere = Mid(text, p + 3, 1);
  m.Nmea.NmeaLatitude = ConvertNmeaLocation(Mid(text, p - 4, 7), latHemisphere);
  if (m.Nmea.NmeaLatitude == 0 || (latHemisphere != "N" && latHemisphere != "S")) return false;
  const std::string_view lonHemisphere = Mid(text, p + 13, 1);
  m.Nmea.NmeaLongitude = ConvertNmeaLocation(Mid(text, p + 5, 8), lonHemisphere);
  return m.Nmea.NmeaLongitude != 0 && (lonHemisphere == "E" || lonHemisphere == "W");
}

}  // namespace

void ReadAprsLine(Molvar& m, std::string_view text, int kind, std::string_view timeText) {
  if (text.empty()) return;
  try {
    if (kind == kAprsShortLine && Contains(text, "*")) {
      m.Aprs.StationCallSign = TextBefore(text, "*");
      return;
    }
    m.Nmea.NmeaLatitude = 0;
    m.Nmea.NmeaLongitude = 0;
    if (!FindAprsPosition(m, text)) {
      m.Nmea.NmeaValid = 0;
      m.Nmea.NmeaLatitude = 0;
      m.Nmea.NmeaLongitude = 0;
      return;
    }
    std::string_view altitude;
    if (Contains(text, "A=")) {
      altitude = TextAfter(text, "A=");
      if (Val(altitude) <= 0) altitude = {};
    }
    TrackPoint& p = AppendTrackPoint(m);
    p.DateTime = timeText;
    p.Latitude = m.Nmea.NmeaLatitude;
    p.Longitude = m.Nmea.NmeaLongitude;
    CalcSpeedDistance(m, m.Track.PointCount);
    if (!altitude.empty()) p.Altitude = RoundToInt32Or(Val(altitude) / kFeetPerMetre, 0);
    m.Nmea.NmeaValid = 1;
  } catch (const std::exception& e) {
    ShowSnag(m, "ReadAprsLine", e);
  }
}

}  // namespace molvar
