#pragma once
// Point markers (start, finish, fastest, waypoints, stations, the live position) and the icon
// chooser's choice.
#include <cstdint>
#include <string>
#include <string_view>

namespace molvar {

struct Molvar;

enum PlacemarkKind : int16_t { kPlacemarkGeneral = 0, kPlacemarkStart = 1, kPlacemarkFinish = 2, kPlacemarkFastest = 3 };

// One Placemark. `altitude` becomes 0 when AltitudeMode is 0.
void WriteKmlPlacemark(Molvar& m, std::string_view name, double longitude, double latitude, int32_t& altitude,
                       std::string_view colour, int16_t kind);

// Google Maps icon file for the current choice: "pal<IconPalette+2>/icon<cell>.png".
std::string GoogleMapsIconFile(const Molvar& m);

// Icon chooser (frmIconSelect).
void ShowIconPalette(Molvar& m, int16_t choice);
void optPalette_Click(Molvar& m, int index);
void chkCustomIcon_Click(Molvar& m);
inline constexpr int kLeftButton = 1;
// A press on picBig at (x, y) pixels; the left button chooses that cell, the others do nothing.
void picBig_MouseDown(Molvar& m, int button, double x, double y);
void picBig_MouseMove(Molvar& m, double x, double y);

}  // namespace molvar
