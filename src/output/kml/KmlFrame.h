#pragma once
// The frame every track KML shares: head, tail, the altitude-mode line of a geometry and the
// camera view.
#include <cstdint>
#include <string>
#include <string_view>

#include "core/Markup.h"

namespace molvar {

struct Molvar;

// Opens OutputPath and writes the head with its placemarks and details. 0 when written, else the
// number of the error that stopped it (the caller then writes nothing more).
int16_t WriteKmlHeader(Molvar& m);
// Camera view, "</Folder></kml>", close, summary, buttons and the automatic open.
void WriteKmlFooter(Molvar& m);
// One altitude-mode line; `altitude` 0 means the data has no altitude.
void InsertAltitudeMode(Molvar& m, int32_t altitude);
void WriteLookAt(Molvar& m, double longitude, double latitude, int heading);

std::string GetTrackTitle(Molvar& m);
std::string TitleFromFileName(const Molvar& m);

// The leading whole number of a text box, 0 when there is none or it is out of range.
int32_t TextBoxInt(std::string_view text);

}  // namespace molvar
