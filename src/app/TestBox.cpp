#include "app/TestBox.h"

#include "app/Molvar.h"
#include "core/Numbers.h"

namespace molvar {
namespace {

constexpr int32_t kListedPoints = 500;
constexpr int kTestWidth = 11320, kTestHeight = 12380;

void SwitchOn(Molvar& m) {
  MainForm& f = m.frmMain;
  m.TestBoxState.SavedWidth = f.window.Width;
  m.TestBoxState.SavedHeight = f.window.Height;
  m.TestMode = 1;
  f.window.Width = kTestWidth;
  f.window.Height = kTestHeight;
  f.txtTest.Left = 120;
  f.txtTest.Top = 6360;
  f.txtTest.Width = 11000;
  f.txtTest.Height = 5320;
  f.txtTest.Visible = true;
  f.lblTest.Caption =
      "You are in test mode. All input data is sent to the textbox below.\r\n"
      "Select the text, copy it, and email it to me if there is a problem.\r\n"
      "Also email the source and output files, if applicable.\r\n"
      "\r\n"
      "Note: Only the first 500 data points are shown!";
  f.lblTest.Visible = true;
  f.cmdClearTestBox.Visible = true;
  f.SendMail.Visible = true;
}

void SwitchOff(Molvar& m) {
  MainForm& f = m.frmMain;
  m.TestMode = 0;
  f.window.Width = m.TestBoxState.SavedWidth;
  f.window.Height = m.TestBoxState.SavedHeight;
  f.txtTest.Visible = false;
  f.txtTest.Text.clear();
  f.lblTest.Visible = false;
  f.cmdClearTestBox.Visible = false;
  f.SendMail.Visible = false;
}

void AppendRow(std::string& box, int32_t i, const TrackPoint& p) {
  constexpr const char* kGap = "     ";
  box.append(FormatPattern(i, "000")).append(kGap);
  box.append(FormatPattern(p.Latitude, "0.000000000000")).append(kGap);
  box.append(FormatPattern(p.Longitude, "0.000000000000")).append(kGap);
  box.append(p.DateTime.view()).append(kGap);
  box.append(FormatPattern(p.Altitude, "0000")).append(kGap);
  box.append(FormatPattern(p.Speed, "000")).append(kGap);
  box.append(FormatPattern(p.Distance, "000.0")).append(kGap);
  AppendInt(box, p.Flag);
  box.append(kGap).append(FormatPattern(p.SegCtr, "0000")).append(kGap);
  box.append(FormatPattern(p.DayCtr, "0000")).append("\r\n");
}

}  // namespace

void AppendToTestBox(Molvar& m, std::string_view text) {
  std::string& box = m.frmMain.txtTest.Text;
  box.append(text).append("\r\n");
  if (box.size() <= kTestBoxLimit) return;
  const std::size_t excess = box.size() - kTestBoxLimit;
  std::size_t cut = box.find('\n', excess);
  cut = cut == std::string::npos ? box.size() : cut + 1;
  box.erase(0, cut);
}

void mnuTestItem_Click(Molvar& m) {
  MenuItem& item = m.frmMain.mnuTestItem;
  item.Checked = !item.Checked;
  if (item.Checked) {
    SwitchOn(m);
  } else {
    SwitchOff(m);
  }
}

void cmdClearTestBox_Click(Molvar& m) { m.frmMain.txtTest.Text.clear(); }

void DisplayTrackArray(Molvar& m) {
  std::string& box = m.frmMain.txtTest.Text;
  box =
      "Ctr        Latitude            Longitude               Date/Time           Alt(m) Spd(kph)  Dist(km)  Flag  "
      "SegCtr   DayCtr\r\n\r\n";
  const int32_t count = m.Track.StoredCount();
  for (int32_t i = 1; i <= count && i <= kListedPoints; ++i) AppendRow(box, i, m.Track[i]);
  if (m.Track.PointCount >= kListedPoints) {
    AppendToTestBox(m, "\r\nNote: There are " + IntToText(m.Track.PointCount) +
                           " trackpoints. Only the first 500 data points are shown!");
  }
}

void cmdDisplayArray_Click(Molvar& m) { DisplayTrackArray(m); }

}  // namespace molvar
