// Radio groups: one button on at a time, the group's listeners hear the
// children's changes as the group's, and arrows move the selection without
// wrapping at either end.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "controls/UI_RadioGroup.h"
#include "drawbot/Drawbot.h"
#include "support/drawbot/PixelCompare.h"
#include "support/controls/ControlTestSupport.h"
#include "support/ui/KeyCodes.h"

namespace norvik::controls::test {
namespace {

using namespace ui::test::keys;

using ::testing::ElementsAre;

class RadioGroupTest : public ControlTest {
 protected:
  RadioGroupTest() : group(Add(new UI_RadioGroup, RectF(0, 0, 200, 100))) {
    for (int i = 0; i < 3; ++i) {
      UI_RadioButtonP radio(new UI_RadioButton(u"Option"));
      radio->UI_SetLocalRectF(RectF(10, 10 + 20.0f * i, 100, 16));
      radio->UI_Show(true);
      radio->SetWantsKeyboardFocus(true);
      group->ChildPushBack(radio);
      radios.push_back(radio);
    }
  }
  void Click(int inIndex) {
    Press(PointF(15, 15 + 20.0f * inIndex));
    Release(PointF(15, 15 + 20.0f * inIndex));
  }
  std::vector<int> Values() const {
    std::vector<int> out;
    for (const auto& radio : radios) out.push_back(radio->GetValue());
    return out;
  }

  boost::intrusive_ptr<UI_RadioGroup> group;
  std::vector<UI_RadioButtonP> radios;
};

TEST_F(RadioGroupTest, ClickingAButtonTurnsTheOthersOff) {
  Click(0);
  Click(2);
  EXPECT_THAT(Values(), ElementsAre(0, 0, 1));
  EXPECT_EQ(group->GetIndex(), 2);
  EXPECT_EQ(group->GetSelectedRadioButton(), radios[2].get());
}

TEST_F(RadioGroupTest, TheGroupsListenersHearTheChildsChangeAsTheGroups) {
  std::vector<UI_ControlView*> controls;
  group->NotifyWhenChanged(ui::MakeNotification<void(UI_ControlChangedMessage*)>(
      [&](UI_ControlChangedMessage* inMessage) { controls.push_back(inMessage->GetControl()); }));
  Click(1);
  EXPECT_THAT(controls, ElementsAre(group.get()));
}

TEST_F(RadioGroupTest, ArrowsMoveTheSelectionAndTheFocusSkippingDisabledButtonsWithoutWrapping) {
  group->SetIndex(0);
  radios[0]->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  EXPECT_TRUE(KeyDown(radios[0].get(), kRight, 0));
  EXPECT_THAT(Values(), ElementsAre(0, 1, 0));
  EXPECT_TRUE(radios[1]->UI_HasKeyboardFocus(false));
  KeyDown(radios[1].get(), kRight, 0);
  KeyDown(radios[2].get(), kRight, 0);
  EXPECT_THAT(Values(), ElementsAre(0, 0, 1)) << "no wrap at the end";
  radios[1]->SetEnabled(false);
  KeyDown(radios[2].get(), kLeft, 0);
  EXPECT_THAT(Values(), ElementsAre(1, 0, 0)) << "past the disabled button";
  KeyDown(radios[0].get(), kLeft, 0);
  EXPECT_THAT(Values(), ElementsAre(1, 0, 0)) << "no wrap at the start";
}

TEST_F(RadioGroupTest, ARemovedButtonLeavesTheGroup) {
  group->ChildRemove(radios[2].get());
  group->SetIndex(2);
  EXPECT_EQ(group->GetIndex(), -1);
  EXPECT_EQ(radios[2]->GetValue(), UI_Button::kButtonOff);
}

TEST_F(RadioGroupTest, ClickingButtonsThatDoNotTakeFocusLeavesFocusAlone) {
  for (const auto& radio : radios) radio->SetWantsKeyboardFocus(false);
  Click(1);
  Click(2);
  EXPECT_THAT(Values(), ElementsAre(0, 0, 1));
  EXPECT_FALSE(radios[2]->UI_HasKeyboardFocus(false));
  EXPECT_FALSE(group->UI_GainKeyboardFocus(ui::kFocusChangeMouse)) << "the group itself does not take focus either";
}

TEST_F(RadioGroupTest, TheBorderIsAThinOutlineAroundTheGroupAndNothingInside) {
  auto paint = [this] {
    drawbot::testing::PixelCanvas canvas(200, 100);
    drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
    group->UI_Draw(&drawbot);
    return canvas.Snapshot();
  };
  // Column 150 and row 80 lie right of and below the buttons.
  EXPECT_EQ(drawbot::testing::ColumnCoverage(paint(), 150), std::string(100, '.'));
  group->SetDrawBorder(true);
  const auto bordered = paint();
  // The outline lies where every button's outline lies: inside the free top
  // row and the half-stroke inset.
  EXPECT_EQ(drawbot::testing::ColumnCoverage(bordered, 150), "..#" + std::string(94, '.') + "#..");
  EXPECT_EQ(drawbot::testing::RowCoverage(bordered, 80), ".#" + std::string(195, '.') + "#..");
  EXPECT_EQ(drawbot::testing::RowCoverage(bordered, 15).substr(10, 5), "#####") << "the buttons still paint";
}

// The group stands between two views that take focus, so that Tab has
// somewhere to go on either side.
class RadioGroupTabTest : public RadioGroupTest {
 protected:
  RadioGroupTabTest() {
    root->ChildRemove(group.get());
    before = ui::test::AddView(*root, "before");
    root->ChildPushBack(group);
    after = ui::test::AddView(*root, "after");
    group->SetIndex(0);
    radios[1]->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  }
  static ui::UI_Node* FocusLeaf() { return ui::UI_Node::UI_GetKeyboardFocusLeafNode(); }

  ui::test::FocusableViewP before, after;
};

TEST_F(RadioGroupTabTest, TabAndShiftTabLeaveTheGroupPastItsOtherButtons) {
  ASSERT_EQ(FocusLeaf(), radios[1].get());
  EXPECT_TRUE(KeyDown(radios[1].get(), kTab, 9));
  EXPECT_EQ(FocusLeaf(), after.get());
  radios[1]->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  EXPECT_TRUE(KeyDown(radios[1].get(), kTab, 9, ModKeys(ui::kModKeyShift)));
  EXPECT_EQ(FocusLeaf(), before.get());
}

TEST_F(RadioGroupTabTest, OtherTabsAndOtherTargetsAreLeftAlone) {
  EXPECT_FALSE(KeyDown(radios[1].get(), kTab, 9, ModKeys(ui::kModKeyCtrl)));
  EXPECT_FALSE(KeyUp(radios[1].get(), kTab, 9));
  EXPECT_EQ(FocusLeaf(), radios[1].get());
  before->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  EXPECT_FALSE(KeyDown(before.get(), kTab, 9)) << "a node outside the group is not the group's business";
  EXPECT_EQ(FocusLeaf(), before.get());
}

TEST_F(RadioGroupTabTest, WithNothingOutsideTabComesBackToTheSelectedButton) {
  before->mWantsFocus = false;
  after->mWantsFocus = false;
  root->mWantsFocus = false;
  EXPECT_TRUE(KeyDown(radios[1].get(), kTab, 9));
  EXPECT_EQ(FocusLeaf(), radios[0].get()) << "the group hands focus to its selection";
}

}  // namespace
}  // namespace norvik::controls::test
