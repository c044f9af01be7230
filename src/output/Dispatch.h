#pragma once
// From a written file to the program that shows it.
namespace molvar {

struct Molvar;

// "Open in GE": the last output in Google Earth, or its upload for Google Maps.
void OpenOutput(Molvar& m);
// Asks for the Google Earth program and tries again.
void LocateGoogleEarth(Molvar& m);

}  // namespace molvar
