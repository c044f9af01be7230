#include "app/Options.h"

#include "app/Molvar.h"
#include "core/DateTime.h"
#include "core/Numbers.h"

namespace molvar {

void SelectSpeedUnits(Molvar& m, int index) {
  if (index < 0 || index > 2) return;
  CheckOnly(m.frmMain.mnuUnitsItem, index);
  m.SpeedUnits = static_cast<int16_t>(index);
  switch (index) {
    case 0:
      m.UnitFactor = 1.0;
      m.SpeedUnitLabel = " kph";
      m.DistanceUnitLabel = " km";
      break;
    case 1:
      m.UnitFactor = 0.6213712;
      m.SpeedUnitLabel = " mph";
      m.DistanceUnitLabel = " miles";
      break;
    default:
      m.UnitFactor = 0.5399568;
      m.SpeedUnitLabel = " kts";
      m.DistanceUnitLabel = " nm";
      break;
  }
}

void SelectAltitudeUnits(Molvar& m, int index) {
  if (index < 0 || index > 1) return;
  CheckOnly(m.frmMain.mnuDistItem, index);
  m.AltitudeUnits = static_cast<int16_t>(index);
  if (index == 0) {
    m.AltitudeFactor = 3.28083;
    m.AltitudeUnitLabel = " feet";
    m.frmMain.Label2.Caption = "Feet";
  } else {
    m.AltitudeFactor = 1.0;
    m.AltitudeUnitLabel = " meters";
    m.frmMain.Label2.Caption = "Meters";
  }
}

void SelectComPort(Molvar& m, int number) {
  if (!m.frmMain.mnuComNumber.Has(number)) return;
  CheckOnly(m.frmMain.mnuComNumber, number);
  m.ComPortNumber = static_cast<int16_t>(number);
}

void SelectBaudRate(Molvar& m, int index) {
  if (!m.frmMain.mnuComBaud.Has(index)) return;
  CheckOnly(m.frmMain.mnuComBaud, index);
  m.BaudRateIndex = static_cast<int16_t>(index);
}

void SelectOutputMode(Molvar& m, int index) {
  if (index < 0 || index > 1) return;
  auto& f = m.frmMain;
  m.OutputMode = static_cast<int16_t>(index);
  CheckOnly(f.mnuOutputMode, index);
  if (index == kOutputGoogleEarth) {
    f.cmdOpen.Caption = "Open in GE";
    f.cmdOpen.ToolTipText = " Open last output file in GoogleEarth ";
    if (m.ProgramMode != kModeAgw) f.chkDetailed.Enabled = true;
  } else {
    if (f.chkCollapse.Value != 1) {
      f.chkCollapse.Value = 1;
      ApplyCollapse(m);
    }
    f.cmdOpen.Caption = "FTP for Gmap";
    f.cmdOpen.ToolTipText = " FTP file to server for GoogleMaps (see help) ";
    f.chkDetailed.Enabled = false;
  }
}

void CheckProgramModeItem(Molvar& m, int index) {
  if (!m.frmMain.mnuModeItem.Has(index)) return;
  m.ProgramMode = static_cast<int16_t>(index);
  CheckOnly(m.frmMain.mnuModeItem, index);
}

void ApplyCollapse(Molvar& m) {
  auto& f = m.frmMain;
  m.CollapseSegments = static_cast<int16_t>(f.chkCollapse.Value);
  if (f.chkCollapse.Checked()) {
    f.chkUseSplit.Value = 0;
    f.chkUseSplit.Enabled = false;
    if (f.chkSplitIfStopped.Value != 0) {
      f.chkSplitIfStopped.Value = 0;
      ApplySplitIfStopped(m);
    }
    f.chkSplitIfStopped.Enabled = false;
    f.txtSpltCount.Enabled = false;
    f.txtSpltCount.Text.clear();
  } else {
    f.chkUseSplit.Enabled = true;
    f.txtSpltCount.Enabled = true;
    f.chkSplitIfStopped.Enabled = true;
  }
}

void ApplySplitColor(Molvar& m, int index) {
  auto& boxes = m.frmMain.chkSplitColor;
  if (!boxes.Has(index)) return;
  if (boxes(index).Checked()) {
    for (auto& [i, box] : boxes.Items()) {
      if (i != index) box.Value = 0;
    }
  }
  m.ColorVaryMode = 0;
  for (const auto& [i, box] : boxes.Items()) {
    if (box.Checked()) m.ColorVaryMode = static_cast<int16_t>(i + 1);
  }
}

void ApplySplitIfStopped(Molvar& m) { m.SplitIfStopped = static_cast<int16_t>(m.frmMain.chkSplitIfStopped.Value); }

void ApplyDetailed(Molvar& m) {
  auto& f = m.frmMain;
  const bool on = f.chkDetailed.Checked();
  f.chkUseThreshold.Enabled = on;
  f.txtSpeedThreshold.Enabled = on;
  if (!on) f.txtSpeedThreshold.Text.clear();
}

void ApplyUseFilename(Molvar& m) { m.frmMain.txtTitle.Enabled = !m.frmMain.chkUseFilename.Checked(); }

// Opening the last output at once when the box becomes checked is the window's business (it needs
// the dispatcher); at start-up no output is known yet, so only the button state matters here.
void ApplyAutoOpen(Molvar& m) {
  auto& f = m.frmMain;
  m.AutoOpen = static_cast<int16_t>(f.chkAuto.Value);
  if (f.chkAuto.Checked()) {
    f.cmdOpen.Enabled = false;
  } else if (!m.OutputPath.empty() && m.ProgramMode != kModeAgw) {
    f.cmdOpen.Enabled = true;
  }
}

void SelectWptFileType(Molvar& m, int index) {
  auto& f = m.frmMain;
  if (!f.optWptFileType.Has(index)) return;
  SelectOnly(f.optWptFileType, index);
  m.WptFileType = static_cast<int16_t>(index);
  if (index == 1) {
    f.optWptTitle(2).Enabled = true;
  } else {
    f.optWptTitle(2).Enabled = false;
    if (f.optWptTitle(2).Value) SelectWptTitle(m, 1);
  }
}

void SelectWptTitle(Molvar& m, int index) {
  if (!m.frmMain.optWptTitle.Has(index)) return;
  SelectOnly(m.frmMain.optWptTitle, index);
  m.PlacemarkLabelSource = static_cast<int16_t>(index);
}

void SelectNorthUp(Molvar& m, int index) {
  if (!m.frmMain.optNorthUp.Has(index)) return;
  SelectOnly(m.frmMain.optNorthUp, index);
  m.NorthUp = static_cast<int16_t>(index);
}

void SelectAltitudeMode(Molvar& m, int index) {
  auto& f = m.frmMain;
  if (index < 0 || index >= static_cast<int>(f.comboAltitude.List.size())) return;
  if (m.ProgramMode == kModeConvertWaypoints && index == 3) index = 2;
  f.comboAltitude.ListIndex = index;
  m.AltitudeMode = static_cast<int16_t>(index);
  if (m.ProgramMode == kModeConvertWaypoints) f.AltLabel.Visible = index == 1 || index == 2;
  const bool gain = index == 3;
  f.sldrGain.Enabled = gain;
  f.lblGain.Enabled = gain;
}

void SelectTrackFileType(Molvar& m, int index) {
  auto& f = m.frmMain;
  if (index < 0 || index >= static_cast<int>(f.comboTrackFileType.List.size())) return;
  f.comboTrackFileType.ListIndex = index;
  m.TrackFileType = static_cast<int16_t>(index);
}

void ApplyGain(Molvar& m) { m.SpeedGain = static_cast<int16_t>(m.frmMain.sldrGain.Value); }

void ApplyFade(Molvar& m) { m.TransparencyLevel = static_cast<int16_t>(m.frmMain.sldrFade.Value); }

void PaintColorSample(Molvar& m) {
  const int i = m.UserColorPointer >= 0 && m.UserColorPointer <= 9 ? m.UserColorPointer : 0;
  m.frmMain.ColorSample.BackColor = m.DisplayColorTable[static_cast<std::size_t>(i)];
}

void ApplyGmtText(Molvar& m) {
  m.GmtHours = Val(m.frmMain.txtGMT.Text);
  try {
    m.GmtMinutes = GmtMinutesFromHours(m.GmtHours);
  } catch (const RuntimeError&) {
    // An offset beyond the 16-bit minute range is no offset at all; no message for a bad value.
    m.GmtHours = 0;
    m.GmtMinutes = 0;
  }
}

}  // namespace molvar
