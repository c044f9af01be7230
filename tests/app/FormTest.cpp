#include "app/Form.h"

#include <gtest/gtest.h>

#include <set>

#include "support/TestProgram.h"

namespace molvar {
namespace {

TEST(MainFormRegistry, NamesAreUniqueAndReachTheControls) {
  MainForm form;
  auto controls = form.Controls();
  std::set<std::pair<std::string, int>> seen;
  for (const auto& c : controls) {
    EXPECT_TRUE(seen.insert({c.name, c.index}).second) << c.name << "(" << c.index << ")";
  }
  const ControlEntry* split = FindControl(controls, "chkUseSplit", kNoIndex);
  ASSERT_NE(split, nullptr);
  ASSERT_TRUE(std::holds_alternative<CheckBox*>(split->control));
  std::get<CheckBox*>(split->control)->Value = 1;
  EXPECT_TRUE(form.chkUseSplit.Checked());

  const ControlEntry* count = FindControl(controls, "txtSpltCount", kNoIndex);
  ASSERT_NE(count, nullptr);
  EXPECT_EQ(std::get<TextBox*>(count->control), &form.txtSpltCount);

  EXPECT_EQ(FindControl(controls, "noSuchControl", kNoIndex), nullptr);
  EXPECT_NE(FindControl(controls, "optWptTitle", 2), nullptr);
  EXPECT_EQ(FindControl(controls, "optWptTitle", 3), nullptr);
}

TEST(ControlArrays, MissingElementIsAnError) {
  MainForm form;
  EXPECT_NO_THROW(form.optWptTitle(0));
  try {
    form.optWptTitle(7);
    ADD_FAILURE();
  } catch (const RuntimeError& e) {
    EXPECT_EQ(e.Number(), kErrNoControlElement);
  }
}

TEST(SliderSet, ClampsToRange) {
  Slider s;
  s.Min = 0;
  s.Max = 255;
  s.Set(300);
  EXPECT_EQ(s.Value, 255);
  s.Set(-1);
  EXPECT_EQ(s.Value, 0);
}

TEST(ScriptedPlatform, RecordsCallsAndAnswersFromQueues) {
  testing::TestProgram p;
  auto& platform = p.platform;
  EXPECT_EQ(platform.MsgBox("Done", "Title", MsgButtons::OK, MsgIcon::Information), kAnswerOK);
  platform.msgAnswers = {kAnswerNo};
  EXPECT_EQ(platform.MsgBox("Overwrite?", "Q", MsgButtons::YesNo, MsgIcon::None), kAnswerNo);
  EXPECT_THROW(platform.MsgBox("Again?", "Q", MsgButtons::YesNo, MsgIcon::None), UnscriptedCall);
  platform.inputAnswers = {"typed"};
  EXPECT_EQ(platform.InputBox("Name?", "T", "default"), "typed");
  platform.dialogAnswers = {std::nullopt};
  EXPECT_FALSE(platform.OpenFileDialog(FileDialogRequest{}).has_value());

  auto messages = platform.Messages();
  ASSERT_EQ(messages.size(), 3u);
  EXPECT_EQ(messages[0].text, "Done");
  EXPECT_EQ(messages[0].title, "Title");
  EXPECT_EQ(messages[0].icon, MsgIcon::Information);
  EXPECT_EQ(messages[1].buttons, MsgButtons::YesNo);
  EXPECT_EQ(platform.CallsOf("InputBox").at(0).parameters, "default");
}

TEST(ProgramState, SnagAndBugMessages) {
  testing::TestProgram p;
  ShowSnag(*p, "ReadOziTrack", RuntimeError(kErrTypeMismatch));
  ShowBug(*p, "WriteGpxTrack", RuntimeError(kErrDiskFull));
  auto messages = p.platform.Messages();
  ASSERT_EQ(messages.size(), 2u);
  EXPECT_EQ(messages[0].text, "ReadOziTrack snag Type mismatch");
  EXPECT_EQ(messages[0].title, " Whoa! An error!");
  EXPECT_EQ(messages[1].text, "WriteGpxTrack bug Disk full");
  EXPECT_EQ(messages[1].title, "Error");
  EXPECT_EQ(p->ProgramPath("Molvar.ini"), p.folder.File("Molvar.ini"));
}

}  // namespace
}  // namespace molvar
