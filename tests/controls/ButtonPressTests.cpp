// The press gesture of a button: the look follows the cursor during the
// press, a release inside performs and a release outside cancels, held
// buttons repeat on the clock, and the transaction messages come in order.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "controls/UI_Button.h"
#include "support/controls/ControlTestSupport.h"

namespace norvik::controls::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class ButtonPressTest : public ControlTest {
 protected:
  ButtonPressTest() : button(Add(new UI_Button, RectF(10, 10, 80, 24))) {}
  UI_ButtonP button;
};

TEST_F(ButtonPressTest, AClickSendsBeginChangedContinueFinishAndLeavesASpringLoadedButtonUp) {
  log.Listen(*button);
  EXPECT_TRUE(Press(PointF(20, 20)));
  EXPECT_TRUE(button->GetDownState());
  EXPECT_TRUE(button->IsButtonCaptured());
  EXPECT_TRUE(button->IsChangePending());
  EXPECT_THAT(log.entries, ElementsAre("begin"));
  Release(PointF(20, 20), ModKeys(ui::kModKeyShift));
  EXPECT_THAT(log.entries, ElementsAre("begin", "changed", "continue", "finish"));
  ASSERT_EQ(log.changedKeys.size(), 1u);
  EXPECT_EQ(log.changedKeys[0], ModKeys(ui::kModKeyShift));
  EXPECT_FALSE(button->GetDownState());
  EXPECT_EQ(button->GetValue(), UI_Button::kButtonOff);
  EXPECT_FALSE(button->IsChangePending());
  EXPECT_FALSE(button->IsButtonCaptured());
}

TEST_F(ButtonPressTest, DraggingOffRestoresTheLookAndDraggingBackPressesAgainAndPerformsOnRelease) {
  log.Listen(*button);
  Press(PointF(20, 20));
  Drag(PointF(150, 150));
  EXPECT_FALSE(button->GetDownState());
  Drag(PointF(30, 15));
  EXPECT_TRUE(button->GetDownState());
  Release(PointF(30, 15));
  EXPECT_THAT(log.entries, ElementsAre("begin", "changed", "continue", "finish"));
}

TEST_F(ButtonPressTest, ANodeCoveringPartOfTheButtonLiftsThePressLook) {
  Add(new UI_Button, RectF(60, 10, 30, 24));
  Press(PointF(20, 20));
  Drag(PointF(70, 20));
  EXPECT_FALSE(button->GetDownState()) << "inside the rectangle, but the cover is under the pointer";
  Drag(PointF(30, 20));
  EXPECT_TRUE(button->GetDownState());
}

TEST_F(ButtonPressTest, ReleasingOutsideCancelsSendsNoChangedMessageAndLeavesAToggleAsItWas) {
  log.Listen(*button);
  for (bool toggle : {false, true}) {
    button->SetSpringLoaded(!toggle);
    log.entries.clear();
    Press(PointF(20, 20));
    Drag(PointF(150, 150));
    Release(PointF(150, 150));
    EXPECT_THAT(log.entries, ElementsAre("begin", "cancel")) << toggle;
    EXPECT_FALSE(button->GetDownState()) << toggle;
    EXPECT_EQ(button->GetValue(), UI_Button::kButtonOff) << toggle;
    EXPECT_FALSE(button->IsChangePending()) << toggle;
  }
}

TEST_F(ButtonPressTest, AToggleButtonStaysDownAfterOneClickAndComesUpAfterTheNext) {
  button->SetSpringLoaded(false);
  log.ListenChanged(*button);
  Press(PointF(20, 20));
  Release(PointF(20, 20));
  EXPECT_TRUE(button->GetDownState());
  EXPECT_EQ(button->GetValue(), UI_Button::kButtonOn);
  Press(PointF(20, 20));
  EXPECT_FALSE(button->GetDownState()) << "the press shows the toggled look";
  Release(PointF(20, 20));
  EXPECT_EQ(button->GetValue(), UI_Button::kButtonOff);
  EXPECT_THAT(log.entries, ElementsAre("changed", "changed"));
}

TEST_F(ButtonPressTest, ADisabledButtonIgnoresThePress) {
  log.Listen(*button);
  button->SetEnabled(false);
  EXPECT_FALSE(Press(PointF(20, 20)));
  EXPECT_FALSE(button->GetDownState());
  EXPECT_THAT(log.entries, IsEmpty());
}

TEST_F(ButtonPressTest, NotificationOnMouseDownActsAtThePressWithoutCapture) {
  button->SetNotificationOnMouseDown(true);
  log.Listen(*button);
  Press(PointF(20, 20));
  EXPECT_FALSE(button->IsButtonCaptured());
  EXPECT_THAT(log.entries, ElementsAre("changed"));
  Release(PointF(20, 20));
  EXPECT_THAT(log.entries, ElementsAre("changed"));
}

TEST_F(ButtonPressTest, NotificationOnMouseUpPerformsOnABareReleaseAlsoWhileACancelledCaptureIsStored) {
  button->SetNotificationOnMouseUp(true);
  log.ListenChanged(*button);
  Release(PointF(20, 20));
  EXPECT_THAT(log.entries, ElementsAre("changed"));
  auto other = Add(new UI_Button, RectF(100, 100, 40, 20));
  Press(PointF(110, 110));
  ASSERT_TRUE(other->IsButtonCaptured());
  manager.GetInputCapture()->Cancel();
  EXPECT_FALSE(other->IsButtonCaptured()) << "a cancelled capture is stored but not active";
  Release(PointF(20, 20));
  EXPECT_THAT(log.entries, ElementsAre("changed", "changed"));
  manager.EndInputCapture(true);
}

TEST_F(ButtonPressTest, AHeldButtonRepeatsOnlyAfterAQuarterSecondAndSkipsTheReleaseContinue) {
  log.Listen(*button);
  Press(PointF(20, 20));
  ASSERT_EQ(button->UI_GetTimerIDs().size(), 1u);
  AdvanceAndFireTimers(button.get(), 200);
  EXPECT_THAT(log.entries, ElementsAre("begin")) << "no repeat before the delay";
  AdvanceAndFireTimers(button.get(), 100);
  AdvanceAndFireTimers(button.get(), 50);
  EXPECT_THAT(log.entries, ElementsAre("begin", "continue", "continue"));
  Release(PointF(20, 20));
  EXPECT_THAT(log.entries, ElementsAre("begin", "continue", "continue", "changed", "finish"));
  EXPECT_TRUE(button->UI_GetTimerIDs().empty()) << "the repeat timer ends with the press";
}

TEST_F(ButtonPressTest, RepeatsPauseWhileTheCursorIsOutside) {
  log.Listen(*button);
  Press(PointF(20, 20));
  AdvanceAndFireTimers(button.get(), 300);
  Drag(PointF(150, 150));
  AdvanceAndFireTimers(button.get(), 50);
  AdvanceAndFireTimers(button.get(), 50);
  EXPECT_THAT(log.entries, ElementsAre("begin", "continue"));
  Drag(PointF(20, 20));
  AdvanceAndFireTimers(button.get(), 50);
  EXPECT_THAT(log.entries, ElementsAre("begin", "continue", "continue"));
}

TEST_F(ButtonPressTest, AListenerThatThrowsReachesTheCallerAndLeavesTheChangeCancelled) {
  log.Listen(*button);
  button->NotifyWhenChanged(ui::MakeNotification<void(UI_ControlChangedMessage*)>(
      [](UI_ControlChangedMessage*) { throw std::runtime_error("listener failed"); }));
  Press(PointF(20, 20));
  EXPECT_THROW(Release(PointF(20, 20)), std::runtime_error);
  EXPECT_FALSE(button->IsChangePending());
  EXPECT_THAT(log.entries, ElementsAre("begin", "changed", "cancel"));
}

TEST_F(ButtonPressTest, EscapeDuringThePressCancelsAndRestoresTheLook) {
  button->SetSpringLoaded(false);
  log.Listen(*button);
  Press(PointF(20, 20));
  EXPECT_TRUE(button->GetDownState());
  KeyDown(root.get(), 27, 27);
  EXPECT_FALSE(button->GetDownState());
  EXPECT_FALSE(button->IsButtonCaptured());
  EXPECT_THAT(log.entries, ElementsAre("begin", "cancel"));
  Release(PointF(20, 20));
  EXPECT_THAT(log.entries, ElementsAre("begin", "cancel")) << "the release after a cancel does nothing";
}

TEST_F(ButtonPressTest, ARemovedButtonSurvivesItsOwnListenerDroppingIt) {
  button->NotifyWhenChanged(ui::MakeNotification<void(UI_ControlChangedMessage*)>(
      [this](UI_ControlChangedMessage*) { root->ChildRemove(button.get()); button.reset(); }));
  Press(PointF(20, 20));
  Release(PointF(20, 20));
  EXPECT_EQ(button, nullptr);
  EXPECT_EQ(root->ChildSize(), 0u);
}

TEST_F(ButtonPressTest, HoverListenersHearMovesButNotPresses) {
  int hovers = 0;
  button->NotifyHover(ui::MakeNotification<void(UI_HoverMessage*)>([&](UI_HoverMessage* inMessage) {
    EXPECT_TRUE(inMessage->IsAction(ui::MouseEvent::kActionMove));
    ++hovers;
  }));
  Drag(PointF(20, 20));
  Press(PointF(20, 20));
  EXPECT_EQ(hovers, 1);
}

}  // namespace
}  // namespace norvik::controls::test
