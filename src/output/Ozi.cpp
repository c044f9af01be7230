#include "output/Ozi.h"

#include "app/Molvar.h"
#include "core/DateTime.h"
#include "core/Numbers.h"
#include "core/Text.h"
#include "output/kml/KmlFrame.h"

namespace molvar {
namespace {

constexpr double kFeetPerMetre = 3.28083;
constexpr int32_t kOziNoAltitude = -777;
constexpr char kOziComma = static_cast<char>(209);

// Whole feet, or the format's "no altitude" for 0 (the store's unknown altitude).
long long OziFeet(int32_t metres) {
  const long long feet = std::stoll(FormatPattern(metres * kFeetPerMetre, "0"));
  return feet == 0 ? kOziNoAltitude : feet;
}

// Six decimals at most, written without trailing zeros.
void AppendOziDegrees(std::string& line, double degrees) { AppendDouble(line, RoundAtDecimals(degrees, 6)); }

}  // namespace

std::string_view OziDateTimePart(std::string_view text, int16_t part) {
  const long blank = InStr(text, " ");
  if (blank == 0) return {};
  return part == 0 ? Left(text, blank - 1) : Mid(text, blank + 1);
}

std::string OziFieldText(std::string_view text) {
  std::string out(text);
  for (char& c : out) {
    if (c == ',') c = kOziComma;
    else if (static_cast<unsigned char>(c) < 0x20 || c == 0x7F) c = ' ';
  }
  return out;
}

void WriteOziHeader(Molvar& m, int16_t kind) {
  OutputFile& out = m.Out;
  out.Open(m.OutputPath);
  if (kind == kOziWaypoints) {
    out.Line("OziExplorer Waypoint File Version 1.1");
    out.Line("WGS 84");
    out.Line("Reserved 2");
    out.Line("garmin");
    return;
  }
  out.Line("TrackPlot Track Point File Version 1.0");
  out.Line("WGS 84");
  out.Line("Altitude in feet, time in UTM");
  out.Line("Reserved 3");
  const int16_t colour = m.UserColorPointer >= 0 && m.UserColorPointer <= 9 ? m.UserColorPointer : 0;
  out.Line("0," + IntToText(m.frmMain.sldrWidth.Value) + "," +
           IntToText(m.DisplayColorTable[static_cast<std::size_t>(colour)]) + "," + OziFieldText(GetTrackTitle(m)) +
           ",1,0,0,0");
  // The number as a print item: a blank stands where a minus sign would.
  out.Line(" " + IntToText(m.Track.PointCount));
}

void WriteOziTrackPoint(Molvar& m, int32_t i) {
  const TrackPoint& p = m.Track.at(i);
  std::string& line = m.Out.Text();
  AppendOziDegrees(line, p.Latitude);
  line.append(", ");
  AppendOziDegrees(line, p.Longitude);
  line.append(", ");
  AppendInt(line, p.Flag);
  line.append(", ");
  AppendInt(line, OziFeet(p.Altitude));
  line.append(", ");
  // A point without a readable time gets empty time fields, which read back as "no time".
  if (const auto date = TextToOziDate(p.DateTime.view(), m.GmtMinutes)) {
    AppendDouble(line, date->dayNumber);
    line.append(", ");
    line.append(OziDateTimePart(date->gmtForm.view(), 0));
    line.append(", ");
    line.append(OziDateTimePart(date->gmtForm.view(), 1));
  } else {
    line.append(", , ");
  }
  m.Out.EndLine();
}

void WriteOziWaypoint(Molvar& m, int32_t k) {
  const Waypoint& w = m.Waypoints.at(k);
  // An Ozi waypoint has one description; waypoints read from Ozi files keep theirs as comment.
  const std::string& description = w.WptDescription.empty() ? w.WptComment : w.WptDescription;
  std::string& line = m.Out.Text();
  AppendInt(line, k);
  line.push_back(',');
  line.append(OziFieldText(w.WptName));
  line.push_back(',');
  AppendOziDegrees(line, w.WptLatitude);
  line.push_back(',');
  AppendOziDegrees(line, w.WptLongitude);
  // No date is stored with a waypoint; Ozi puts its own in an empty date field.
  line.append(",,0,1,3,0,65535,");
  line.append(OziFieldText(description));
  line.append(",0,0,0,");
  AppendInt(line, OziFeet(w.WptAltitude));
  line.append(",6,0,17");
  m.Out.EndLine();
}

}  // namespace molvar
