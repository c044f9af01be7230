#pragma once
// The main window's event handlers: program and output modes, option clicks, menus, the edit,
// clear and help actions, and the start and shutdown sequences. The window only forwards its
// events here and renders the model afterwards.
#include <string>

namespace molvar {

struct Molvar;

// Program modes and output modes.
void mnuModeItem_Click(Molvar& m, int index);
void mnuOutputMode_Click(Molvar& m, int index);

// Option controls, called after the control's value changed.
void comboAltitude_Click(Molvar& m);
void comboTrackFileType_Click(Molvar& m);
void chkAuto_Click(Molvar& m);
void chkCollapse_Click(Molvar& m);
void chkSplitIfStopped_Click(Molvar& m);
void chkDetailed_Click(Molvar& m);
void chkUseFilename_Click(Molvar& m);
void chkSplitColor_Click(Molvar& m, int index);
void optWptTitle_Click(Molvar& m, int index);
void optNorthUp_Click(Molvar& m, int index);
void optWptFileType_Click(Molvar& m, int index);
void sldrGain_Change(Molvar& m);
void sldrFade_Change(Molvar& m);
void txtGMT_Change(Molvar& m);
// Every edit of the refresh rate rewrites gps.kml; in real-time output Google Earth reopens it.
void txtGErefresh_Change(Molvar& m);

// Menus.
void mnuOnTop_Click(Molvar& m);
void mnuIgnore_Click(Molvar& m);
void mnuComNumber_Click(Molvar& m, int number);
void mnuComBaud_Click(Molvar& m, int index);
void mnuUnitsItem_Click(Molvar& m, int index);
void mnuDistItem_Click(Molvar& m, int index);
void mnuHelpItem_Click(Molvar& m, int index);

// Buttons.
void cmdReadTrackFile_Click(Molvar& m);
void cmdReadWptFile_Click(Molvar& m);
void cmdOpen_Click(Molvar& m);
void cmdRefresh_Click(Molvar& m);
// 0 the last input file, 1 the last output file, in the text editor.
void cmdEdit_Click(Molvar& m, int index);
void cmdClearTrack_Click(Molvar& m);

// Start (window load) and shutdown (window unload).
void Form_Load(Molvar& m);
void Form_Unload(Molvar& m);

inline constexpr const char* kHomePage = "https://molvar.org/";
inline constexpr const char* kOnlineHelpPage = "https://molvar.org/help/";
inline constexpr const char* kKmlTutorialPage = "https://developers.google.com/kml/documentation/kml_tut";
inline constexpr const char* kNoEditorText = "put path to a text editor here";

}  // namespace molvar
