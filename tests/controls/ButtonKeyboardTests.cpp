// Keyboard activation of a focused button: Space (and Ctrl+Return) press on
// key down and act on key up, Escape gives up focus when the setting asks for
// it, and losing focus with the key held undoes the press.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "controls/UI_Button.h"
#include "support/controls/ControlTestSupport.h"
#include "support/ui/KeyCodes.h"
#include "ui/CustomSettingsManager.h"

namespace norvik::controls::test {
namespace {

using namespace ui::test::keys;

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class ButtonKeyboardTest : public ControlTest {
 protected:
  ButtonKeyboardTest() : button(Add(new UI_Button, RectF(10, 10, 80, 24))) {
    button->SetWantsKeyboardFocus(true);
    button->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  }
  UI_ButtonP button;
};

TEST_F(ButtonKeyboardTest, SpaceDownPressesAndSpaceUpPerformsAsOneTransaction) {
  log.Listen(*button);
  EXPECT_TRUE(KeyDown(button.get(), kSpace, ' '));
  EXPECT_TRUE(button->GetDownState());
  EXPECT_TRUE(button->IsKeyDownPending());
  EXPECT_THAT(log.entries, IsEmpty());
  EXPECT_TRUE(KeyUp(button.get(), kSpace, ' '));
  EXPECT_FALSE(button->GetDownState());
  EXPECT_THAT(log.entries, ElementsAre("begin", "changed", "continue", "finish"));
}

TEST_F(ButtonKeyboardTest, CtrlReturnActivatesButPlainReturnDoesNot) {
  log.ListenChanged(*button);
  EXPECT_FALSE(KeyDown(button.get(), kReturn, 13));
  EXPECT_FALSE(button->GetDownState());
  EXPECT_TRUE(KeyDown(button.get(), kReturn, 13, ModKeys(ui::kModKeyCtrl)));
  EXPECT_TRUE(button->GetDownState());
  KeyUp(button.get(), kReturn, 13, ModKeys(ui::kModKeyCtrl));
  EXPECT_THAT(log.entries, ElementsAre("changed"));
}

TEST_F(ButtonKeyboardTest, AToggleButtonFlipsOnKeyDownAndKeepsItOnKeyUp) {
  button->SetSpringLoaded(false);
  KeyDown(button.get(), kSpace, ' ');
  EXPECT_TRUE(button->GetDownState());
  KeyUp(button.get(), kSpace, ' ');
  EXPECT_TRUE(button->GetDownState());
  EXPECT_EQ(button->GetValue(), UI_Button::kButtonOn);
}

TEST_F(ButtonKeyboardTest, TabbingAwayWithTheKeyHeldLeavesTheButtonUpAndPerformsNothing) {
  auto other = Add(new UI_Button, RectF(10, 50, 80, 24));
  other->SetWantsKeyboardFocus(true);
  log.Listen(*button);
  KeyDown(button.get(), kSpace, ' ');
  other->UI_GainKeyboardFocus(ui::kFocusChangeAdvance);
  EXPECT_FALSE(button->GetDownState());
  EXPECT_FALSE(button->IsKeyDownPending());
  EXPECT_FALSE(KeyUp(button.get(), kSpace, ' '));
  EXPECT_THAT(log.entries, IsEmpty());
}

TEST_F(ButtonKeyboardTest, EscapeGivesUpFocusAndTravelsOnUnlessTheSettingKeepsIt) {
  manager.SetCustomSettingsManager(std::make_unique<ui::CustomSettingsManager>());
  manager.GetCustomSettingsManager()->Set("norvik.controls.UI_Button.LoseFocusOnESC", false);
  button->UI_DoKeyboardEvent(button.get(), ui::test::KeyDownEvent(kEscape, 27));
  EXPECT_TRUE(button->UI_HasKeyboardFocus(false));
  manager.GetCustomSettingsManager()->Set("norvik.controls.UI_Button.LoseFocusOnESC", true);
  EXPECT_FALSE(button->UI_DoKeyboardEvent(button.get(), ui::test::KeyDownEvent(kEscape, 27)));
  EXPECT_FALSE(button->UI_HasKeyboardFocus(false));
}

TEST_F(ButtonKeyboardTest, ADisabledButtonIgnoresTheActivationKey) {
  button->SetEnabled(false);
  EXPECT_FALSE(button->UI_DoKeyboardEvent(button.get(), ui::test::KeyDownEvent(kSpace, ' ')));
  EXPECT_FALSE(button->GetDownState());
}

TEST_F(ButtonKeyboardTest, FocusByMnemonicPressesTheButtonWithAFullTransaction) {
  button->UI_LoseKeyboardFocus();
  log.Listen(*button);
  EXPECT_TRUE(button->UI_GainKeyboardFocus(ui::kFocusChangeMnemonic));
  EXPECT_THAT(log.entries, ElementsAre("changed", "begin", "continue", "finish"));
}

TEST_F(ButtonKeyboardTest, AListenerThatThrowsOnKeyUpReachesTheCallerAndTheChangeIsCancelled) {
  log.Listen(*button);
  button->NotifyWhenChanged(ui::MakeNotification<void(UI_ControlChangedMessage*)>(
      [](UI_ControlChangedMessage*) { throw std::runtime_error("listener failed"); }));
  KeyDown(button.get(), kSpace, ' ');
  EXPECT_THROW(KeyUp(button.get(), kSpace, ' '), std::runtime_error);
  EXPECT_FALSE(button->IsChangePending());
  EXPECT_THAT(log.entries, ElementsAre("begin", "changed", "cancel"));
}

}  // namespace
}  // namespace norvik::controls::test
