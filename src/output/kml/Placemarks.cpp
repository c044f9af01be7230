#include "output/kml/Placemarks.h"

#include <cmath>

#include "app/Molvar.h"
#include "core/Markup.h"
#include "core/Numbers.h"
#include "core/Text.h"
#include "core/DateTime.h"
#include "output/kml/KmlFrame.h"

namespace molvar {
namespace {

constexpr const char* kGoogleMapsIconBase = "http://maps.google.com/mapfiles/kml/";

std::string PaletteLine(int palette) {
  return "        <href>root://icons/palette-" + IntToText(palette + 2) + ".png</href>";
}

void WriteIconLines(Molvar& m, int16_t kind) {
  OutputFile& out = m.Out;
  if (m.frmIconSelect.chkCustomIcon.Checked()) {
    out.Line("        <href>" + MarkupText(m.ProgramPath("Icons/Custom.png")) + "</href>");
    return;
  }
  int palette = m.IconPalette, x = m.IconX, y = m.IconY;
  switch (kind) {
    case kPlacemarkStart: palette = 2, x = 128, y = 0; break;
    case kPlacemarkFinish: palette = 2, x = 128, y = 32; break;
    case kPlacemarkFastest: palette = 1, x = 64, y = 96; break;
    default: break;
  }
  out.Line(PaletteLine(palette));
  out.Line("        <x>" + IntToText(x) + "</x>");
  out.Line("        <y>" + IntToText(y) + "</y>");
  out.Line("        <w>32</w>");
  out.Line("        <h>32</h>");
}

void WriteSummaryBalloon(Molvar& m) {
  const TrackStore& track = m.Track;
  const int32_t n = track.StoredCount();
  const TrackPoint& first = track.at(1);
  const TrackPoint& last = track.at(n);
  const double hours = static_cast<double>(SecondsBetween(first.DateTime.view(), last.DateTime.view())) / 3600.0;
  if (!(hours > 0)) return;
  OutputFile& out = m.Out;
  out.Line("  <description><![CDATA[Point no.  " + IntToText(n));
  out.Line("    <br></br>Speed: " + FormatPattern(last.Speed * m.UnitFactor, "0.0") + m.SpeedUnitLabel);
  if (last.Altitude > 0) {
    out.Line("    <br></br>Altitude: " + FormatPattern(last.Altitude * m.AltitudeFactor, "0") + m.AltitudeUnitLabel);
  }
  out.Line("    <br></br>Total time: " + FormatPattern(hours, "0.0") + " hours");
  out.Line("    <br></br>Total distance: " + FormatPattern(last.Distance * m.UnitFactor, "0.00") + m.DistanceUnitLabel);
  out.Line("    <br></br>Average speed: " + FormatPattern(last.Distance / hours * m.UnitFactor, "0.0") +
           m.SpeedUnitLabel + "]]>");
  out.Line("  </description>");
}

// Cells are 32 pixels; the chooser picture is 256 by 256.
int CellOf(double pixels) {
  const double cell = std::floor(pixels / 32.0);
  return cell < 0 ? 0 : (cell > 7 ? 7 : static_cast<int>(cell));
}

}  // namespace

std::string GoogleMapsIconFile(const Molvar& m) {
  const int32_t row = RoundToInt32(7.0 - m.IconY / 32.0);
  const int32_t column = RoundToInt32(m.IconX / 32.0);
  return "pal" + IntToText(m.IconPalette + 2) + "/icon" + IntToText(row * 8 + column) + ".png";
}

void WriteKmlPlacemark(Molvar& m, std::string_view name, double longitude, double latitude, int32_t& altitude,
                       std::string_view colour, int16_t kind) {
  auto& f = m.frmMain;
  try {
    OutputFile& out = m.Out;
    const bool northUp = SelectedIndex(f.optNorthUp) == 1;
    const int viewHeading = m.ProgramMode == kModeRealTimeNmea && northUp ? 0 : TextBoxInt(f.txtHeading.Text);

    out.Line("<!--  Write \"" + MarkupComment(name) + "\" Placemark  -->");
    out.Line("<Placemark>");

    if (m.Aprs.NearestMode == 1) {
      out.Line("  <description>");
      out.Line("    <![CDATA[QRZ lookup: " + MarkupCdata(m.Aprs.QrzLink) + "]]>");
      out.Line("  </description>");
    } else if (m.ProgramMode == kModeAgw && f.chkMoreInfo.Checked()) {
      out.Line("  <description>");
      if (m.Aprs.AgwSpeed < 1) {
        out.Line("    <![CDATA[" + MarkupCdata(m.Aprs.AgwTimeText) + "]]>");
      } else {
        out.Line("    <![CDATA[Time: " + MarkupCdata(m.Aprs.AgwTimeText) + "<br></br>Speed: " +
                 DoubleToText(m.Aprs.AgwSpeed) + m.SpeedUnitLabel + "<br></br>Heading: " +
                 MarkupCdata(m.Aprs.AgwHeading) + " deg.]]>");
      }
      out.Line("  </description>");
    } else if (f.chkBalloon.Checked() && colour == "0000FF" && m.Track.StoredCount() >= 1 &&
               !m.Track.at(m.Track.StoredCount()).DateTime.view().empty()) {
      WriteSummaryBalloon(m);
    }

    out.Line("  <name>" + MarkupText(name) + "</name>");
    if (m.ProgramMode == kModeConvertWaypoints) {
      out.Line("");
      WriteLookAt(m, longitude, latitude, viewHeading);
    }

    if (m.OutputMode == kOutputGoogleEarth) {
      out.Line("  <styleUrl>root://styleMaps#default?iconId=0x307</styleUrl>");
      out.Line("  <Style>");
      out.Line("    <LabelStyle>");
      out.Line("      <color>" + Hex2(m.TransparencyLevel) + MarkupText(colour) + "</color>");
      out.Line("    </LabelStyle>");
      out.Line("    <IconStyle>");
      if (f.chkHalfSize.Checked()) out.Line("      <scale>0.5</scale>");
      if (m.TransparencyLevel < 255) out.Line("      <color>" + Hex2(m.TransparencyLevel) + "FFFFFF</color>");
      if (m.ProgramMode == kModeRealTimeNmea) {
        const int rotation = m.IconPalette == 2 && m.IconX == 128 && (m.IconY == 128 || m.IconY == 160) ? 180 : 0;
        int heading = TextBoxInt(m.Nmea.Fields.CourseText) + rotation;
        if (heading > 360) heading -= 360;
        out.Line("      <heading>" + IntToText(heading) + "</heading>");
      }
      out.Line("      <Icon>");
      WriteIconLines(m, kind);
      out.Line("      </Icon>");
      out.Line("    </IconStyle>");
      out.Line("  </Style>");
    } else {
      out.Line("  <Style id=\"default12442531244255\">");
      out.Line("    <IconStyle id=\"khIconStyle560_copy00\">");
      out.Line("      <Icon>");
      out.Line(std::string("        <href>") + kGoogleMapsIconBase + GoogleMapsIconFile(m) + "</href>");
      out.Line("      </Icon>");
      out.Line("    </IconStyle>");
      out.Line("  </Style>");
    }

    if (m.AltitudeMode == 0) altitude = 0;
    out.Line("  <Point>");
    InsertAltitudeMode(m, altitude);
    out.Line("    <coordinates>" + DoubleToText(longitude) + "," + DoubleToText(latitude) + "," + IntToText(altitude) +
             "</coordinates>");
    out.Line("  </Point>");
    out.Line("</Placemark>");
    out.Line("");
  } catch (const std::exception& e) {
    ShowBug(m, "WriteKmlPlacemark", e);
  }
}

void ShowIconPalette(Molvar& m, int16_t choice) {
  const std::string picture =
      choice == 4 ? m.ProgramPath("Icons/Custom.jpg") : m.ProgramPath("Icons/palette-" + IntToText(choice + 2) + ".jpg");
  // A missing image only leaves the picture empty.
  std::error_code ec;
  const std::string shown = std::filesystem::exists(picture, ec) ? picture : std::string();
  m.frmIconSelect.picBig.Picture = shown;
  m.frmMain.picAll2.Picture = shown;
  m.frmIconSelect.MarkerX = m.IconX;
  m.frmIconSelect.MarkerY = m.IconY;
}

void optPalette_Click(Molvar& m, int index) {
  if (!m.frmIconSelect.optPalette.Has(index)) return;
  SelectOnly(m.frmIconSelect.optPalette, index);
  m.IconPalette = static_cast<int16_t>(index);
  ShowIconPalette(m, m.IconPalette);
}

void chkCustomIcon_Click(Molvar& m) {
  ShowIconPalette(m, m.frmIconSelect.chkCustomIcon.Checked() ? 4 : m.IconPalette);
}

void picBig_MouseDown(Molvar& m, int button, double x, double y) {
  if (button != kLeftButton) return;
  m.IconX = static_cast<int16_t>(32 * CellOf(x));
  m.IconY = static_cast<int16_t>(224 - 32 * CellOf(y));
  m.frmIconSelect.MarkerX = m.IconX;
  m.frmIconSelect.MarkerY = m.IconY;
}

void picBig_MouseMove(Molvar& m, double x, double y) {
  m.frmIconSelect.HoverX = 32 * CellOf(x);
  m.frmIconSelect.HoverY = 224 - 32 * CellOf(y);
}

}  // namespace molvar
