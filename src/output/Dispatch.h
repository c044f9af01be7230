#pragma once
// From the data held to the output file, and from a written file to the program that shows it.
namespace molvar {

struct Molvar;

// Writes the file for the current track store: KML, GPX or Ozi PLT as OutputFormat says.
void WriteOutputFile(Molvar& m);
// "Refresh output": rewrites the last output from the data held (waypoints at the eye altitude).
void RefreshOutput(Molvar& m);

// "Open in GE": the last output in Google Earth, or its upload for Google Maps.
void OpenOutput(Molvar& m);
// Asks for the Google Earth program and tries again.
void LocateGoogleEarth(Molvar& m);

}  // namespace molvar
