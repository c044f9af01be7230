#pragma once
// The effects of the main window's option choices on the program-wide values. The window's
// handlers and the start-up replay of the stored settings both go through these, so a restored
// option behaves exactly like a user's click.
#include <string_view>

namespace molvar {

struct Molvar;

// Units menu (0 metric, 1 imperial, 2 nautical): checks the item, sets SpeedUnits, UnitFactor and
// the speed and distance labels. An index outside 0-2 is ignored.
void SelectSpeedUnits(Molvar& m, int index);
// Altitude units menu (0 feet, 1 metres): checks the item, sets AltitudeUnits, AltitudeFactor,
// AltitudeUnitLabel and the eye-altitude label Label2.
void SelectAltitudeUnits(Molvar& m, int index);
// COM port (1-10) and baud rate (0-5) menus: check the item and store the index.
void SelectComPort(Molvar& m, int number);
void SelectBaudRate(Molvar& m, int index);
// Output mode menu (0 Google Earth, 1 Google Maps link): the open button's caption and tooltip,
// chkDetailed, and for Google Maps a checked chkCollapse.
void SelectOutputMode(Molvar& m, int index);
// The program mode's stored index and its checked menu item (the per-mode window layout belongs
// to the mode handler).
void CheckProgramModeItem(Molvar& m, int index);

// Check box effects, run after the box's value changed.
// The three colour choices exclude each other: a checked one clears the other two; ColorVaryMode
// follows (1 by segment, 2 by date, 3 by speed, 0 none).
void ApplySplitColor(Molvar& m, int index);
void ApplyCollapse(Molvar& m);
void ApplySplitIfStopped(Molvar& m);
void ApplyDetailed(Molvar& m);
void ApplyUseFilename(Molvar& m);
void ApplyAutoOpen(Molvar& m);

// Option buttons and lists: select the element and store its index.
void SelectWptFileType(Molvar& m, int index);
void SelectWptTitle(Molvar& m, int index);
void SelectNorthUp(Molvar& m, int index);
void SelectAltitudeMode(Molvar& m, int index);
void SelectTrackFileType(Molvar& m, int index);

// Slider effects.
void ApplyGain(Molvar& m);
void ApplyFade(Molvar& m);
// The sample box shows the track colour UserColorPointer. (The width has no value of its own: the
// writers read the slider.)
void PaintColorSample(Molvar& m);

// txtGMT holds new text: GmtHours is its leading number, GmtMinutes that in whole minutes.
void ApplyGmtText(Molvar& m);

}  // namespace molvar
