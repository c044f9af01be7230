// Options set by control name run the handler a click would run.
#include <gtest/gtest.h>

#include "app/ControlSettings.h"
#include "support/TestProgram.h"

namespace molvar {
namespace {

using testing::TestProgram;

std::string Set(Molvar& m, std::string_view text) {
  const auto a = ParseControlAssignment(text);
  if (!a) return "unparsed";
  return ApplyControlAssignment(m, *a);
}

TEST(ParseControlAssignment, NameIndexAndValue) {
  auto a = ParseControlAssignment("chkSplitColor(2)=1");
  ASSERT_TRUE(a);
  EXPECT_EQ(a->name, "chkSplitColor");
  EXPECT_EQ(a->index, 2);
  EXPECT_EQ(a->value, "1");
  a = ParseControlAssignment("txtTitle=Lake = run");
  ASSERT_TRUE(a);
  EXPECT_EQ(a->index, -1);
  EXPECT_EQ(a->value, "Lake = run");
  a = ParseControlAssignment("txtTitle=");
  ASSERT_TRUE(a);
  EXPECT_EQ(a->value, "");
  for (const char* bad : {"", "=1", "noequals", "chk(=1", "chk(x)=1", "chk(-1)=1", "(1)=1", "chk(1=1"}) {
    EXPECT_FALSE(ParseControlAssignment(bad)) << bad;
  }
}

TEST(ApplyControlAssignment, RunsTheClickHandlers) {
  TestProgram t;
  Molvar& m = *t;
  EXPECT_EQ(Set(m, "chkSplitIfStopped=1"), "");
  EXPECT_EQ(m.SplitIfStopped, 1);
  EXPECT_EQ(Set(m, "chkCollapse=1"), "");
  EXPECT_EQ(m.CollapseSegments, 1);
  EXPECT_EQ(m.frmMain.chkSplitIfStopped.Value, 0) << "collapsing clears split-if-stopped";
  EXPECT_EQ(m.SplitIfStopped, 0);

  EXPECT_EQ(Set(m, "chkSplitColor(0)=1"), "");
  EXPECT_EQ(Set(m, "chkSplitColor(2)=1"), "");
  EXPECT_EQ(m.ColorVaryMode, 3);
  EXPECT_EQ(m.frmMain.chkSplitColor(0).Value, 0);

  EXPECT_EQ(Set(m, "txtGMT=5.5"), "");
  EXPECT_EQ(m.GmtMinutes, 330);
  EXPECT_EQ(Set(m, "mnuDistItem=1"), "");
  EXPECT_DOUBLE_EQ(m.AltitudeFactor, 1.0);
  EXPECT_EQ(m.frmMain.Label2.Caption, "Meters");
  EXPECT_EQ(Set(m, "mnuUnitsItem(2)=1"), "");
  EXPECT_EQ(m.SpeedUnitLabel, " kts");
  EXPECT_EQ(Set(m, "sldrFade=128"), "");
  EXPECT_EQ(m.TransparencyLevel, 128);
  EXPECT_EQ(Set(m, "comboAltitude=3"), "");
  EXPECT_EQ(m.AltitudeMode, 3);
  EXPECT_TRUE(m.frmMain.sldrGain.Enabled);
  EXPECT_EQ(Set(m, "mnuOutputMode=1"), "");
  EXPECT_EQ(m.frmMain.cmdOpen.Caption, "FTP for Gmap");
  EXPECT_EQ(Set(m, "mnuIgnore=1"), "");
  EXPECT_TRUE(m.frmMain.mnuIgnore.Checked);
}

TEST(ApplyControlAssignment, WaypointTypeMovesTheLabelOffDescription) {
  TestProgram t;
  Molvar& m = *t;
  EXPECT_EQ(Set(m, "optWptFileType=1"), "");
  EXPECT_EQ(Set(m, "optWptTitle(2)=1"), "");
  EXPECT_EQ(m.PlacemarkLabelSource, 2);
  EXPECT_EQ(Set(m, "optWptFileType(0)=1"), "");
  EXPECT_EQ(m.WptFileType, 0);
  EXPECT_EQ(m.PlacemarkLabelSource, 1);
}

TEST(ApplyControlAssignment, ExplainsWhatIsWrong) {
  TestProgram t;
  Molvar& m = *t;
  EXPECT_EQ(Set(m, "chkNone=1"), "unknown control chkNone");
  EXPECT_EQ(Set(m, "chkSplitColor(7)=1"), "unknown control chkSplitColor(7)");
  EXPECT_EQ(Set(m, "chkAuto=yes"), "bad value \"yes\" for chkAuto (0 or 1)");
  EXPECT_EQ(Set(m, "sldrGain=41"), "bad value \"41\" for sldrGain (1 to 40)");
  EXPECT_EQ(Set(m, "comboTrackFileType=1.5"), "bad value \"1.5\" for comboTrackFileType (0 to 8)");
  EXPECT_EQ(Set(m, "mnuUnitsItem=3"), "bad value \"3\" for mnuUnitsItem (an element number of the group)");
  EXPECT_EQ(Set(m, "optNorthUp(1)=0"), "bad value \"0\" for optNorthUp (1 selects the element)");
  EXPECT_EQ(Set(m, "mnuModeItem=2"), "mnuModeItem is chosen by the file type, not set");
  EXPECT_EQ(Set(m, "txtInfo=x"), "");  // a text box takes any text
  EXPECT_EQ(m.SpeedUnits, 0) << "a refused value changes nothing";
}

}  // namespace
}  // namespace molvar
