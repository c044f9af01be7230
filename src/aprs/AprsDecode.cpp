#include "aprs/AprsDecode.h"

#include <array>
#include <optional>

#include "app/Molvar.h"
#include "core/Numbers.h"
#include "core/Text.h"
#include "input/Nmea.h"

namespace molvar {
namespace {

constexpr double kFeetPerMetre = 3.28083;
constexpr double kKmhPerKnot = 1.852;

bool IsDigit(char c) { return c >= '0' && c <= '9'; }

// A "ddmm.mm" / "dddmm.mm" text of a plain report. The degrees must be digits; the other digits
// may be blanks (position ambiguity), read as 0 so that "49  .  N" still means 49 degrees.
// Nothing when the text is not of that form or the degrees or minutes are out of range.
std::optional<std::string> PlainCoordinate(std::string_view field, std::size_t degreeDigits, int maxDegrees) {
  if (field.size() != degreeDigits + 5 || field[degreeDigits + 2] != '.') return std::nullopt;
  std::string text(field);
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (i == degreeDigits + 2) continue;
    if (text[i] == ' ' && i >= degreeDigits) {
      text[i] = '0';
    } else if (!IsDigit(text[i])) {
      return std::nullopt;
    }
  }
  const double v = Val(text);
  const double degrees = static_cast<double>(static_cast<int>(v / 100));
  if (degrees > maxDegrees || v - degrees * 100 >= 60 || v > maxDegrees * 100.0) return std::nullopt;
  return text;
}

// What one Mic-E destination character carries.
struct DestinationCode {
  int digit = -1;  // -1: a blank (position ambiguity)
  char bit = '0';
  bool custom = false;
  char latitudeHemisphere = 0;  // 0: not set by this character
  int longitudeOffset = 0;
  char longitudeHemisphere = 'E';
};

std::optional<DestinationCode> ReadDestinationChar(char c) {
  DestinationCode d;
  if (c >= '0' && c <= '9') {
    d.digit = c - '0';
    d.latitudeHemisphere = 'S';
  } else if (c >= 'A' && c <= 'K') {
    d.digit = c == 'K' ? -1 : c - 'A';
    d.bit = '1';
    d.custom = true;
  } else if (c == 'L') {
    d.latitudeHemisphere = 'S';
  } else if (c >= 'P' && c <= 'Z') {
    d.digit = c == 'Z' ? -1 : c - 'P';
    d.bit = '1';
    d.latitudeHemisphere = 'N';
    d.longitudeOffset = 100;
    d.longitudeHemisphere = 'W';
  } else {
    return std::nullopt;
  }
  return d;
}

constexpr std::array<std::string_view, 8> kStandardMessages = {"Emergency", "Priority",   "Special",  "Committed",
                                                                "Returning", "In Service", "En Route", "Off Duty"};
constexpr std::array<std::string_view, 8> kCustomMessages = {"Emergency", "Custom 6", "Custom 5", "Custom 4",
                                                              "Custom 3",  "Custom 2", "Custom 1", "Custom 0"};

std::string_view MessageText(std::string_view bits, bool custom) {
  std::size_t index = 0;
  for (const char b : bits) index = index * 2 + (b == '1' ? 1 : 0);
  return custom ? kCustomMessages[index] : kStandardMessages[index];
}

// An information-field character carrying a value 0..99 (code minus 28); nothing outside.
std::optional<int> MicEValue(std::string_view info, std::size_t position) {
  const int v = static_cast<unsigned char>(info[position - 1]) - 28;
  if (v < 0 || v > 99) return std::nullopt;
  return v;
}

// The base-91 altitude of info characters 11 to 13 when "}" stands at 14; 0 otherwise.
int32_t MicEAltitude(std::string_view info) {
  if (info.size() < 14 || info[13] != '}') return 0;
  int32_t value = 0;
  for (std::size_t i = 10; i < 13; ++i) {
    const int digit = static_cast<unsigned char>(info[i]) - 33;
    if (digit < 0 || digit > 90) return 0;
    value = value * 91 + digit;
  }
  return value - 10000;
}

struct Position {
  std::string latitude, latitudeHemisphere, longitude, longitudeHemisphere;
  std::string speedText, courseText;
  int32_t altitude = 0;
};

// The decoded position becomes the last fix (placeholder time and date) and the next point.
void StorePosition(Molvar& m, Position&& pos, bool micE) {
  NmeaFix& fix = m.Nmea;
  NmeaFields& n = fix.Fields;
  if (micE) {
    n.SentenceName = "$GPRMC";
    n.CourseText = std::move(pos.courseText);
  }
  // A plain report's speed is not decoded: its point must not inherit the speed of an earlier
  // Mic-E report, possibly of another station.
  n.SpeedText = micE ? std::move(pos.speedText) : std::string(1, '0');
  n.LatitudeText = std::move(pos.latitude);
  n.LatitudeHemisphere = std::move(pos.latitudeHemisphere);
  n.LongitudeText = std::move(pos.longitude);
  n.LongitudeHemisphere = std::move(pos.longitudeHemisphere);
  n.UtcTime = "000000";
  n.DateText = "010106";
  n.AltitudeText = IntToText(pos.altitude);
  fix.NmeaAltitude = pos.altitude;
  fix.NmeaLatitude = ConvertNmeaLocation(n.LatitudeText, n.LatitudeHemisphere);
  fix.NmeaLongitude = ConvertNmeaLocation(n.LongitudeText, n.LongitudeHemisphere);
  fix.NmeaValid = 1;
  AddParsedPoint(m);
}

void NoMicEPosition(NmeaFix& fix) {
  fix.NmeaValid = 0;
  fix.NmeaLatitude = 0;
  fix.NmeaLongitude = 0;
}

}  // namespace

void ParseAprsPosition(Molvar& m, std::string_view packet) {
  m.Nmea.NmeaValid = 0;
  const long d = InStr(packet, ".");
  if (d < 5 || static_cast<long>(packet.size()) <= d + 12) return;
  const std::string_view s = Mid(packet, d - 4);
  Position pos;
  pos.latitudeHemisphere = Mid(s, 8, 1);
  pos.longitudeHemisphere = Mid(s, 18, 1);
  if ((pos.longitudeHemisphere != "W" && pos.longitudeHemisphere != "E") ||
      (pos.latitudeHemisphere != "S" && pos.latitudeHemisphere != "N")) {
    return;
  }
  auto lat = PlainCoordinate(Mid(s, 1, 7), 2, 90);
  auto lon = PlainCoordinate(Mid(s, 10, 8), 3, 180);
  if (!lat || !lon) return;
  pos.latitude = std::move(*lat);
  pos.longitude = std::move(*lon);
  // Without "A=" the altitude is unknown; it must not be taken over from an earlier packet.
  const long a = InStr(packet, "A=");
  if (a > 0) pos.altitude = RoundToInt32Or(Val(Mid(packet, a + 2, 6)) / kFeetPerMetre, 0);
  StorePosition(m, std::move(pos), false);
}

std::string DecodeMicE(Molvar& m, std::string_view packet) {
  NoMicEPosition(m.Nmea);
  if (packet.size() < 12) return std::string(kMicEUndecodable);

  std::array<int, 6> digits{};
  std::string bits;
  bool custom = false;
  char latitudeHemisphere = 0;
  int offset = 0;
  char longitudeHemisphere = 'E';
  for (std::size_t i = 0; i < 6; ++i) {
    const auto code = ReadDestinationChar(packet[i]);
    if (!code) return std::string(kMicEUndecodable);
    // A blank (position ambiguity) reads as 0, the low end of the range it hides.
    digits[i] = code->digit < 0 ? 0 : code->digit;
    if (i < 3) {
      bits.push_back(code->bit);
      custom = custom || code->custom;
    }
    if (i == 3) latitudeHemisphere = code->latitudeHemisphere;
    if (i == 4) offset = code->longitudeOffset;
    if (i == 5) longitudeHemisphere = code->longitudeHemisphere;
  }
  // "A" to "K" in the fourth place leave the hemisphere unset: no usable latitude.
  if (latitudeHemisphere == 0) return std::string(kMicEUndecodable);
  const int latDegrees = digits[0] * 10 + digits[1];
  const int latMinutes = digits[2] * 10 + digits[3];
  const int latHundredths = digits[4] * 10 + digits[5];
  if (latMinutes >= 60 || latDegrees * 6000 + latMinutes * 100 + latHundredths > 90 * 6000) {
    return std::string(kMicEUndecodable);
  }
  const double latitude = latDegrees * 100 + latMinutes + latHundredths / 100.0;

  const long colon = InStr(packet, ":");
  const std::string_view info = colon == 0 ? std::string_view{} : Mid(packet, colon + 1);
  // Type, longitude, speed and course, symbol code and symbol table.
  if (info.size() < 9 || (info[0] != '`' && info[0] != '\'')) return std::string(kMicEUndecodable);
  const std::string_view status = info[0] == '`' ? " Mic-E: OK data" : " Mic-E: Old data";
  std::array<int, 8> v{};
  for (std::size_t k = 2; k <= 7; ++k) {
    const auto value = MicEValue(info, k);
    if (!value) return std::string(kMicEUndecodable);
    v[k] = *value;
  }
  int lonDegrees = v[2] + offset;
  if (lonDegrees >= 180 && lonDegrees <= 189) {
    lonDegrees -= 80;
  } else if (lonDegrees >= 190 && lonDegrees <= 199) {
    lonDegrees -= 190;
  }
  int lonMinutes = v[3];
  if (lonMinutes >= 60) lonMinutes -= 60;
  const double longitude = lonDegrees * 100 + lonMinutes + v[4] / 100.0;

  int speed = v[5] * 10 + v[6] / 10;
  int course = (v[6] % 10) * 100 + v[7];
  if (speed >= 800) speed -= 800;
  if (course >= 400) course -= 400;

  Position pos;
  pos.latitude = FormatPattern(latitude, "0.0000");
  pos.latitudeHemisphere = std::string(1, latitudeHemisphere);
  pos.longitude = FormatPattern(longitude, "0.0000");
  pos.longitudeHemisphere = std::string(1, longitudeHemisphere);
  // The speed text holds km/h, as after an RMC sentence, so the stored Speed is in km/h.
  const std::string kmh = FormatPattern(speed * kKmhPerKnot, "0.0");
  pos.speedText = kmh;
  pos.courseText = IntToText(course);
  pos.altitude = MicEAltitude(info);

  std::string line(status);
  line.append(" Msg: ");
  line.append(MessageText(bits, custom));
  line.append(" Speed: ");
  line.append(kmh);
  line.append(" Alt: ");
  AppendInt(line, pos.altitude);
  line.append("M Hdg: ");
  AppendInt(line, course);
  StorePosition(m, std::move(pos), true);
  return line;
}

}  // namespace molvar
