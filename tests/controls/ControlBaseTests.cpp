// What every control shares: the unknown value state, the state bits and the
// capture rule for rollover, mnemonics, the transaction guard, and drawing
// parameters built with and without a control.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "controls/DrawParameters.h"
#include "controls/UI_Button.h"
#include "controls/UI_TextControlBase.h"
#include "drawbot/Drawbot.h"
#include "support/drawbot/RecordingSupplier.h"
#include "support/controls/ControlTestSupport.h"

namespace norvik::controls::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

using ControlBaseTest = ControlTest;

TEST_F(ControlBaseTest, ANewControlIsUnknownAndSettingUnknownAgainDoesNothing) {
  auto control = Add(new UI_InteractiveControlView, RectF(0, 0, 10, 10));
  int calls = 0;
  control->NotifyWhenUnknownStateChanged([&](UI_ControlView*) { ++calls; });
  EXPECT_TRUE(control->IsValueUnknown());
  control->SetValueUnknown();
  EXPECT_EQ(calls, 0);
  control->SetValueKnown();
  EXPECT_TRUE(control->IsValueKnown());
  control->SetValueUnknown();
  EXPECT_EQ(calls, 2);
}

TEST_F(ControlBaseTest, StateBitsReflectDownDisabledAndFocusAndSuppressedFocusDrawingClearsFocusWhenAskedWithCapture) {
  auto control = Add(new UI_ControlView, RectF(0, 0, 10, 10));
  control->SetDownState(true);
  EXPECT_EQ(control->GetControlState(true), UI_ControlView::StateFlags(UI_ControlView::kStateDown));
  root->UI_SetDisabled(true);
  EXPECT_TRUE(control->GetControlState(true).Test(UI_ControlView::kStateDisabled)) << "a disabled parent counts";
  root->UI_SetDisabled(false);
  control->SetWantsKeyboardFocus(true);
  ASSERT_TRUE(control->UI_GainKeyboardFocus(ui::kFocusChangeMouse));
  EXPECT_TRUE(control->GetControlState(true).Test(UI_ControlView::kStateFocused));
  control->SetSuppressFocusDrawing(true);
  EXPECT_TRUE(control->GetControlState(false).Test(UI_ControlView::kStateFocused));
  EXPECT_FALSE(control->GetControlState(true).Test(UI_ControlView::kStateFocused));
}

TEST_F(ControlBaseTest, FocusLostToNothingIsRefused) {
  auto control = Add(new UI_ControlView, RectF(0, 0, 10, 10));
  control->SetWantsKeyboardFocus(true);
  EXPECT_FALSE(control->UI_GainKeyboardFocus(ui::kFocusChangeLoss));
  EXPECT_FALSE(control->UI_HasKeyboardFocus(false));
}

TEST_F(ControlBaseTest, DuringAnotherControlsPressNoOtherControlLightsUp) {
  auto a = Add(new UI_Button, RectF(10, 10, 50, 20));
  auto b = Add(new UI_Button, RectF(10, 50, 50, 20));
  Press(PointF(20, 20));
  b->UI_SetStateFlags(b->UI_GetStateFlags() | UI_ControlView::StateFlags(ui::UI_Node::kStateMouseOver));
  a->UI_SetStateFlags(a->UI_GetStateFlags() | UI_ControlView::StateFlags(ui::UI_Node::kStateMouseOver));
  EXPECT_FALSE(b->GetControlState(true).Test(UI_ControlView::kStateRollover));
  EXPECT_TRUE(b->GetControlState(false).Test(UI_ControlView::kStateRollover));
  EXPECT_TRUE(a->GetControlState(true).Test(UI_ControlView::kStateRollover));
}

TEST_F(ControlBaseTest, ASingleAmpersandMarksTheMnemonicAndADoubledOneIsALiteral) {
  manager.EnableMnemonics();
  auto control = Add(new UI_ControlView, RectF(0, 0, 10, 10));
  UTF16String out;
  EXPECT_TRUE(control->UI_ProcessStringAndSetMnemonic(u"Op&en", out));
  EXPECT_EQ(out, UTF16String(u"Open"));
  EXPECT_EQ(control->GetMnemonicLocation(), 2);
  EXPECT_EQ(control->GetMnemonicKey(), ui::KeyboardCode::CreateFromKeyboardChar('E'));
  EXPECT_FALSE(control->UI_ProcessStringAndSetMnemonic(u"Salt && Pepper", out));
  EXPECT_EQ(out, UTF16String(u"Salt & Pepper"));
  EXPECT_FALSE(control->GetMnemonicKey().IsValid());
}

TEST_F(ControlBaseTest, AltWithTheMnemonicLetterFocusesAndPressesTheButton) {
  manager.EnableMnemonics();
  auto button = Add(new UI_Button, RectF(0, 0, 10, 10));
  UTF16String out;
  button->UI_ProcessStringAndSetMnemonic(u"&Go", out);
  log.ListenChanged(*button);
  EXPECT_TRUE(KeyDown(root.get(), 'G', 'G', ModKeys(ui::kModKeyAlt)));
  EXPECT_TRUE(button->UI_HasKeyboardFocus(false));
  EXPECT_THAT(log.entries, ElementsAre("changed"));
}

TEST_F(ControlBaseTest, AltAloneTurnsTheUnderlinesOn) {
  manager.EnableMnemonics();
  auto button = Add(new UI_Button, RectF(0, 0, 10, 10));
  UTF16String out;
  button->UI_ProcessStringAndSetMnemonic(u"&Go", out);
  EXPECT_FALSE(KeyDown(root.get(), 18, 0, ModKeys(ui::kModKeyAlt)));
  EXPECT_TRUE(button->GetDisplayMnemonic());
}

TEST_F(ControlBaseTest, TheGuardCancelsWhenLeftWithoutFinishAndSendsNothingMoreAfterFinish) {
  auto control = Add(new UI_InteractiveControlView, RectF(0, 0, 10, 10));
  log.Listen(*control);
  { ScBeginAndEndInteractiveChange change(control.get()); }
  EXPECT_THAT(log.entries, ElementsAre("begin", "cancel"));
  log.entries.clear();
  {
    ScBeginAndEndInteractiveChange change(control.get());
    EXPECT_TRUE(control->IsChangePending());
    control->ContinueInteractiveChange();
    change.Finish();
    change.Finish();
  }
  EXPECT_THAT(log.entries, ElementsAre("begin", "continue", "finish"));
  EXPECT_FALSE(control->IsChangePending());
}

TEST_F(ControlBaseTest, EmptyListenerEntriesAreSkipped) {
  auto control = Add(new UI_ControlView, RectF(0, 0, 10, 10));
  control->NotifyWhenChanged(ControlChangedFunctionP());
  control->NotifyWhenChanged(ControlChangedFunctionP(new ControlChangedFunction));
  log.ListenChanged(*control);
  control->SendValueChangedMessage();
  EXPECT_THAT(log.entries, ElementsAre("changed"));
}

TEST_F(ControlBaseTest, ParametersWithoutAControlTakeTheDefaults) {
  const DrawParameters params(nullptr);
  EXPECT_EQ(params.GetControlState(), DrawParameters::StateFlags());
  EXPECT_EQ(params.GetRectF(), RectF());
  EXPECT_EQ(params.GetMnemonicLocation(), 0);
  EXPECT_EQ(params.GetColorChangeMap(), nullptr);
  EXPECT_EQ(params.GetTheme(), ui::Theme::GetTheme(ui::GetDefaultThemeName()));
}

TEST_F(ControlBaseTest, ParametersFromAButtonCarryItsStateRectangleAndColourMap) {
  auto button = Add(new UI_Button, RectF(5, 6, 40, 20));
  button->ReplaceColor(20, 18);
  button->SetDownState(true);
  const DrawButtonParameters params(button.get());
  EXPECT_EQ(params.GetRectF(), RectF(0, 0, 40, 20));
  EXPECT_TRUE(params.GetControlState().Test(UI_ControlView::kStateDown));
  ASSERT_NE(params.GetColorChangeMap(), nullptr);
  EXPECT_EQ(UI_GetColorFromChangeMap(20, params.GetColorChangeMap()), 18u);
  EXPECT_EQ(UI_GetColorFromChangeMap(21, params.GetColorChangeMap()), 21u);
  EXPECT_EQ(params.GetMnemonicLocation(), -1);
}

TEST_F(ControlBaseTest, LabelsSitOnTheSizeBaselineUnlessTheSettingAsksForTheFontsOwn) {
  drawbot::testing::RecordingSupplier supplier;
  boost::intrusive_ptr<drawbot::SurfaceInterface> surface(supplier.NewOffscreenSurface(60, 21, false));
  drawbot::Drawbot drawbot(&supplier, surface.get());
  DrawTextButtonParameters label;
  label.SetText(u"Gain");
  label.SetFontSize(10);  // the recording font's ascent is 8, its descent 2
  auto baseline = [&] {
    supplier.ClearCalls();
    DrawControlLabel(label, label, RectF(0, 0, 60, 21), drawbot);
    return supplier.GetCalls().empty() ? -1.0f : supplier.GetCalls().back().point.y;
  };
  EXPECT_EQ(baseline(), 15.0f) << "10 * 0.9 + 5.5, rounded";
  manager.GetCustomSettingsManager()->Set("norvik.utils.FontDependentBaselines", true);
  EXPECT_EQ(baseline(), 13.5f) << "5.5 + 8, not rounded";
}

}  // namespace
}  // namespace norvik::controls::test
