// Buttons with a value rule: check boxes cycle (two or three states), radio
// buttons only turn on, and the disclosure triangle tells its listeners only
// once its twirl has run. Also the label rules of text buttons.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "controls/UI_Checkbox.h"
#include "controls/UI_DisclosureTriangleButton.h"
#include "controls/UI_RadioButton.h"
#include "controls/UI_TextButton.h"
#include "support/controls/ControlTestSupport.h"

namespace norvik::controls::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

using ToggleButtonTest = ControlTest;

TEST_F(ToggleButtonTest, ACheckboxCyclesOffOnOffOrWithThreeStatesOffOnMixedOff) {
  for (bool triState : {false, true}) {
    auto box = Add(new UI_Checkbox(u"Loop"), RectF(10, 10, 100, 16));
    box->SetTriState(triState);
    std::vector<int> seen;
    box->NotifyWhenChanged(ui::MakeNotification<void(UI_ControlChangedMessage*)>(
        [&](UI_ControlChangedMessage*) { seen.push_back(box->GetValue()); }));
    for (int i = 0; i < 4; ++i) {
      Press(PointF(15, 15));
      Release(PointF(15, 15));
    }
    const std::vector<int> expected = triState ? std::vector<int>{1, 2, 0, 1} : std::vector<int>{1, 0, 1, 0};
    EXPECT_EQ(seen, expected) << "listeners read the new value";
    root->ChildRemove(box.get());
  }
}

TEST_F(ToggleButtonTest, SettingACheckboxsValueSendsNothing) {
  auto box = Add(new UI_Checkbox, RectF(10, 10, 100, 16));
  log.ListenChanged(*box);
  box->SetChecked(true);
  EXPECT_TRUE(box->IsChecked());
  box->ToggleState();
  EXPECT_FALSE(box->IsChecked());
  EXPECT_THAT(log.entries, IsEmpty());
}

TEST_F(ToggleButtonTest, TheCheckboxSplitsItsRectangleIntoBoxAndLabel) {
  const auto [box, text] = UI_Checkbox::GetButtonTextRects(14, RectF(10, 0, 100, 20));
  EXPECT_EQ(box, RectF(10, 0, 14, 20));
  EXPECT_EQ(text, RectF(27, 0, 83, 20));
}

TEST_F(ToggleButtonTest, ARadioButtonTurnsOnByClickOrKeyAndStaysOnButStillSends) {
  auto radio = Add(new UI_RadioButton(u"Mono"), RectF(10, 10, 100, 16));
  radio->SetWantsKeyboardFocus(true);
  log.ListenChanged(*radio);
  Press(PointF(15, 15));
  Release(PointF(15, 15));
  EXPECT_EQ(radio->GetValue(), UI_Button::kButtonOn);
  Press(PointF(15, 15));
  Release(PointF(15, 15));
  EXPECT_EQ(radio->GetValue(), UI_Button::kButtonOn);
  EXPECT_THAT(log.entries, ElementsAre("changed", "changed"));
  radio->SetValue(UI_Button::kButtonOff);
  radio->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  for (int i = 0; i < 2; ++i) {
    KeyDown(radio.get(), 32, ' ');
    KeyUp(radio.get(), 32, ' ');
    EXPECT_EQ(radio->GetValue(), UI_Button::kButtonOn) << "key press " << i;
  }
}

TEST_F(ToggleButtonTest, TheDisclosureMessageArrivesOnlyAfterTheTwirl) {
  auto triangle = Add(new UI_DisclosureTriangleButton(u"Effects"), RectF(10, 10, 100, 16));
  log.ListenChanged(*triangle);
  Press(PointF(15, 15));
  Release(PointF(15, 15));
  EXPECT_TRUE(triangle->GetDownState());
  EXPECT_THAT(log.entries, IsEmpty());
  EXPECT_GE(triangle->GetAnimationTime(), 0.0);
  ASSERT_EQ(triangle->UI_GetTimerIDs().size(), 1u);
  AdvanceAndFireTimers(triangle.get(), 40);
  EXPECT_THAT(log.entries, IsEmpty()) << "still turning";
  EXPECT_EQ(root->mUpdateNowCalls, 1) << "each frame of the twirl is painted at once";
  AdvanceAndFireTimers(triangle.get(), 40);
  EXPECT_THAT(log.entries, ElementsAre("changed"));
  EXPECT_EQ(triangle->GetValue(), UI_Button::kButtonOn);
  EXPECT_EQ(triangle->GetAnimationTime(), -1.0);
  EXPECT_TRUE(triangle->UI_GetTimerIDs().empty());
}

TEST_F(ToggleButtonTest, TheDisclosureTriangleClosesAgainOnTheSecondClick) {
  auto triangle = Add(new UI_DisclosureTriangleButton, RectF(10, 10, 100, 16));
  for (int i = 0; i < 2; ++i) {
    Press(PointF(15, 15));
    Release(PointF(15, 15));
    AdvanceAndFireTimers(triangle.get(), 100);
  }
  EXPECT_EQ(triangle->GetValue(), UI_Button::kButtonOff);
  EXPECT_FALSE(triangle->GetDownState());
}

TEST_F(ToggleButtonTest, TheRecommendedTextButtonSizeAddsMarginsAndRoundsHalfAway) {
  EXPECT_EQ(UI_TextButton::RecommendedSize(40.5f, 11), PointF(61, 20));
  EXPECT_EQ(UI_TextButton::RecommendedSize(40.4f, 11.5f), PointF(60, 21));
  EXPECT_EQ(UI_TextButton::RecommendedSize(0, 11).x, 0);
}

TEST_F(ToggleButtonTest, ATextButtonIsMeasuredWithoutASupplierInTheManager) {
  ASSERT_EQ(manager.GetOSDrawSupplier(), nullptr);
  UI_TextButtonP shortLabel(new UI_TextButton(u"OK"));
  UI_TextButtonP longLabel(new UI_TextButton(u"Render the whole sequence"));
  UI_TextButtonP empty(new UI_TextButton);
  EXPECT_GT(shortLabel->UI_GetRecommendedSize().x, 20) << "the label's width and the two margins";
  EXPECT_GT(longLabel->UI_GetRecommendedSize().x, shortLabel->UI_GetRecommendedSize().x + 50);
  EXPECT_EQ(empty->UI_GetRecommendedSize().x, 0);
}

TEST_F(ToggleButtonTest, ReturnActivatesOnlyWithTheLegacyActivationOn) {
  auto button = Add(new UI_TextButton(u"OK"), RectF(10, 10, 60, 20));
  log.ListenChanged(*button);
  button->SetWantsKeyboardFocus(true);
  button->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
  KeyDown(button.get(), 13, 13);
  KeyUp(button.get(), 13, 13);
  EXPECT_THAT(log.entries, IsEmpty());
  button->SetSupportLegacyWindowsKeyboardActivation(true);
  KeyDown(button.get(), 13, 13);
  KeyUp(button.get(), 13, 13);
  EXPECT_THAT(log.entries, ElementsAre("changed"));
}

}  // namespace
}  // namespace norvik::controls::test
