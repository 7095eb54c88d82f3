// Button bars: a row of toggle buttons with one selection and a number for
// a value. Clicks arrive as real mouse events through the root, keys through
// the keyboard dispatch, and the bar's listeners hear one change per change
// of the number.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "controls/UI_ButtonBar.h"
#include "controls/UI_PictureButton.h"
#include "drawbot/Drawbot.h"
#include "support/drawbot/PixelCompare.h"
#include "support/controls/ControlTestSupport.h"
#include "support/ui/KeyCodes.h"

namespace norvik::controls::test {
namespace {

using namespace ui::test::keys;

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class ButtonBarTest : public ControlTest {
 protected:
  ButtonBarTest() {
    bar = Add(new UI_ButtonBar, RectF(5, 20, 195, 40));
    bar->AddTextButton(u"Low", 0.25);
    bar->AddTextButton(u"Medium", 0.5);
    bar->AddTextButton(u"High", 1.0);
    bar->NotifyWhenChanged(ui::MakeNotification<void(UI_ControlChangedMessage*)>(
        [this](UI_ControlChangedMessage* inMessage) {
          heard.push_back(inMessage->GetControl());
          valuesHeard.push_back(bar->GetValue());
        }));
  }
  // A real press and release in the middle of button inIndex.
  void Click(int inIndex) { ClickIn(*bar, inIndex); }
  void ClickIn(const UI_ButtonBar& inBar, int inIndex) {
    const RectF r = inBar.GetButton(inIndex)->UI_GetLocalRectF(true);
    const RectF inRoot = inBar.UI_GetLocalRectF(true);
    const PointF centre(inRoot.left + r.left + r.width / 2, inRoot.top + r.top + r.height / 2);
    Press(centre);
    Release(centre);
  }
  std::vector<int> Values() const {
    std::vector<int> out;
    for (int i = 0; i < static_cast<int>(bar->GetButtonCount()); ++i) out.push_back(bar->GetButton(i)->GetValue());
    return out;
  }

  UI_ButtonBarP bar;
  std::vector<UI_ControlView*> heard;
  std::vector<double> valuesHeard;
};

// ---- layout ----

TEST_F(ButtonBarTest, ButtonsStandSideBySideWithEqualWidths) {
  const RectF first = bar->GetButton(0)->UI_GetLocalRectF(true);
  const RectF second = bar->GetButton(1)->UI_GetLocalRectF(true);
  const RectF third = bar->GetButton(2)->UI_GetLocalRectF(true);
  EXPECT_EQ(first.left, 0);
  EXPECT_EQ(second.left, first.left + first.width);
  EXPECT_EQ(third.left, second.left + second.width);
  EXPECT_EQ(first.width, second.width);
  EXPECT_EQ(second.width, third.width);
  EXPECT_GE(second.width, bar->GetButton(1)->UI_GetRecommendedSize().x) << "the widest label fits";
  EXPECT_GT(second.width, 0);
  EXPECT_EQ(bar->GetButtonbarWidth(), third.left + third.width);
  EXPECT_EQ(bar->GetButtonbarHeight(), first.height);
  EXPECT_EQ(bar->UI_GetRecommendedSize(), PointF(bar->GetButtonbarWidth(), bar->GetButtonbarHeight()));
}

TEST_F(ButtonBarTest, ImageSegmentsTakeTheRowsHeightAndAStandardWidth) {
  UI_ButtonBarP icons(Add(new UI_ButtonBar, RectF(0, 100, 100, 30)));
  EXPECT_EQ(icons->GetButtonbarWidth(), 0);
  EXPECT_EQ(icons->GetButtonbarHeight(), 0);
  icons->AddImageButton("RV4_Locked_Sm_N", 1, u"Locked");
  icons->AddImageButton("RV4_Unlocked_Sm_N", 2);
  EXPECT_NE(dynamic_cast<UI_PictureButton*>(icons->GetButton(1)), nullptr);
  EXPECT_EQ(icons->GetButton(0)->UI_GetToolTip(), u"Locked");
  EXPECT_EQ(icons->GetButtonbarWidth(), 2 * icons->GetButton(0)->UI_GetLocalRectF(true).width);
  EXPECT_EQ(icons->GetButtonbarHeight(), bar->GetButtonbarHeight());
}

TEST_F(ButtonBarTest, ButtonNamesCarryTheBarsNameAndTheirIndex) {
  EXPECT_EQ(bar->GetButton(0)->UI_GetNodeID(), "UI_ButtonBar_TextButton_0");
  EXPECT_EQ(bar->GetButton(2)->UI_GetNodeID(), "UI_ButtonBar_TextButton_2");
  EXPECT_EQ(bar->UI_ChildGetFromID("UI_ButtonBar_TextButton_1"), bar->GetButton(1));
  EXPECT_EQ(bar->GetButton(3), nullptr);
  EXPECT_EQ(bar->GetButton(-1), nullptr);
}

// Paints the bar as the draw traversal does: the bar, then its buttons.
drawbot::testing::PixelImage PaintBar(UI_ButtonBar& inBar, int inWidth, int inHeight) {
  drawbot::testing::PixelCanvas canvas(inWidth, inHeight);
  drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
  inBar.UI_Draw(&drawbot);
  return canvas.Snapshot();
}

// Whether the pixels of two images agree inside the columns [inLeft, inRight).
bool SameColumns(const drawbot::testing::PixelImage& inA, const drawbot::testing::PixelImage& inB, int inLeft,
                 int inRight) {
  for (int y = 0; y < inA.height; ++y)
    for (int x = inLeft; x < inRight; ++x)
      if (inA.At(x, y) != inB.At(x, y)) return false;
  return true;
}

TEST_F(ButtonBarTest, TheFramePaintsTheRowOfButtonsAndNothingBeyond) {
  const auto image = PaintBar(*bar, 200, 40);
  const int width = static_cast<int>(bar->GetButtonbarWidth());
  const int height = static_cast<int>(bar->GetButtonbarHeight());
  ASSERT_LT(width, 200);
  ASSERT_LT(height, 40);
  // The bevel is drawn inside the rectangle shrunk by half a stroke on each
  // side, so its last column and row stay free, and so does its top row.
  EXPECT_EQ(drawbot::testing::RowCoverage(image, height / 2),
            std::string(width - 1, '#') + std::string(200 - width + 1, '.'));
  EXPECT_EQ(drawbot::testing::ColumnCoverage(image, width / 2),
            "." + std::string(height - 2, '#') + std::string(40 - height + 1, '.'));

  UI_ButtonBarP none(new UI_ButtonBar);
  none->UI_SetLocalRectF(RectF(0, 0, 50, 20));
  EXPECT_EQ(drawbot::testing::RowCoverage(PaintBar(*none, 50, 20), 10), std::string(50, '.'))
      << "no buttons, no frame";
}

TEST_F(ButtonBarTest, ANarrowBarSharesItsWidthAndItsFrameEndsWithTheLastButton) {
  const float natural = bar->GetButtonbarWidth();
  bar->UI_SetLocalRectF(RectF(5, 20, natural - 20, 40));
  const RectF first = bar->GetButton(0)->UI_GetLocalRectF(true);
  const RectF last = bar->GetButton(2)->UI_GetLocalRectF(true);
  const int right = static_cast<int>(last.left + last.width);
  EXPECT_LE(right, natural - 20) << "the row keeps inside the bar";
  EXPECT_GT(right, natural - 20 - 3) << "and fills it but for the rounding";
  EXPECT_EQ(first.width, last.width);
  EXPECT_EQ(bar->GetButtonbarWidth(), natural) << "the recommended width does not shrink";
  // The frame and the buttons end in the same column: no sliver of frame
  // beside the last button, and no button beyond the frame.
  const auto image = PaintBar(*bar, 200, 40);
  const std::string row = drawbot::testing::RowCoverage(image, static_cast<int>(last.height / 2));
  EXPECT_EQ(row, std::string(right - 1, '#') + std::string(200 - right + 1, '.'));

  // Wide again, the segments take back their common width.
  bar->UI_SetLocalRectF(RectF(5, 20, 195, 40));
  const RectF wide = bar->GetButton(2)->UI_GetLocalRectF(true);
  EXPECT_EQ(wide.left + wide.width, natural);
}

TEST_F(ButtonBarTest, TheButtonsPaintOverTheFrameAndTheSelectedOneLooksDown) {
  const auto unselected = PaintBar(*bar, 200, 40);
  bar->SetValue(0.5);
  const auto selected = PaintBar(*bar, 200, 40);
  const RectF middle = bar->GetButton(1)->UI_GetLocalRectF(true);
  const int left = static_cast<int>(middle.left), right = static_cast<int>(middle.left + middle.width);
  EXPECT_FALSE(SameColumns(unselected, selected, left, right)) << "the middle segment changed its look";
  EXPECT_TRUE(SameColumns(unselected, selected, 0, left)) << "the first segment did not";
  EXPECT_TRUE(SameColumns(unselected, selected, right, 200)) << "nor did the last";
}

// ---- the selection rule ----

TEST_F(ButtonBarTest, ANewBarShowsNoSelectionAndAClickSelectsOneButtonAndTellsTheBarsListenersOnce) {
  EXPECT_TRUE(bar->IsValueUnknown());
  EXPECT_EQ(bar->GetSelectedIndex(), -1);
  EXPECT_THAT(Values(), ElementsAre(0, 0, 0));
  Click(1);
  EXPECT_THAT(Values(), ElementsAre(0, 1, 0));
  EXPECT_EQ(bar->GetValue(), 0.5);
  EXPECT_TRUE(bar->IsValueKnown());
  Click(2);
  EXPECT_THAT(Values(), ElementsAre(0, 0, 1));
  EXPECT_EQ(bar->GetSelectedIndex(), 2);
  EXPECT_THAT(heard, ElementsAre(bar.get(), bar.get())) << "the message names the bar, not the button";
  EXPECT_THAT(valuesHeard, ElementsAre(0.5, 1.0)) << "listeners read the new value";
}

TEST_F(ButtonBarTest, ClickingTheSelectedButtonAgainKeepsItOnAndSaysNothing) {
  Click(0);
  heard.clear();
  Click(0);
  EXPECT_THAT(Values(), ElementsAre(1, 0, 0));
  EXPECT_TRUE(bar->GetButton(0)->GetDownState()) << "the toggle does not pop up";
  EXPECT_EQ(bar->GetSelectedIndex(), 0);
  EXPECT_THAT(heard, IsEmpty());
}

TEST_F(ButtonBarTest, AnUnknownBarTellsEvenWhenTheNumberIsTheSame) {
  bar->SetValue(0.25);
  bar->SetValueUnknown();
  EXPECT_THAT(Values(), ElementsAre(0, 0, 0));
  EXPECT_EQ(bar->GetSelectedIndex(), -1);
  Click(0);
  EXPECT_THAT(valuesHeard, ElementsAre(0.25));
  EXPECT_TRUE(bar->IsValueKnown());
}

TEST_F(ButtonBarTest, MovingBetweenButtonsOfTheSameNumberSelectsButSaysNothing) {
  UI_ButtonBarP twins(Add(new UI_ButtonBar, RectF(0, 120, 200, 30)));
  twins->AddTextButton(u"A", 1.0);
  twins->AddTextButton(u"B", 2.0);
  twins->AddTextButton(u"C", 2.0);
  MessageLog twinsLog;
  twinsLog.ListenChanged(*twins);
  ClickIn(*twins, 1);
  ClickIn(*twins, 2);
  EXPECT_EQ(twins->GetButton(1)->GetValue(), UI_Button::kButtonOff);
  EXPECT_EQ(twins->GetButton(2)->GetValue(), UI_Button::kButtonOn);
  EXPECT_EQ(twins->GetSelectedIndex(), 2);
  EXPECT_THAT(twinsLog.entries, ElementsAre("changed")) << "only the first click moved the number";
}

TEST_F(ButtonBarTest, SetValueSelectsTheMatchingButtonWithoutTellingAnyone) {
  bar->SetValue(1.0);
  EXPECT_THAT(Values(), ElementsAre(0, 0, 1));
  EXPECT_EQ(bar->GetSelectedIndex(), 2);
  bar->SetValue(0.75);
  EXPECT_THAT(Values(), ElementsAre(0, 0, 0)) << "no button has that number";
  EXPECT_EQ(bar->GetValue(), 0.75);
  EXPECT_TRUE(bar->IsValueKnown());
  EXPECT_THAT(heard, IsEmpty());
  Click(2);
  EXPECT_THAT(valuesHeard, ElementsAre(1.0));
}

TEST_F(ButtonBarTest, ARemovedButtonLeavesTheRow) {
  bar->SetValue(1.0);
  bar->ChildRemove(bar->GetButton(0));
  EXPECT_EQ(bar->GetButtonCount(), 2u);
  EXPECT_EQ(bar->GetSelectedIndex(), 1) << "the selection follows its button";
  EXPECT_EQ(bar->GetButtonValue(1), 1.0);
  bar->ChildRemove(bar->GetButton(1));
  EXPECT_EQ(bar->GetSelectedIndex(), -1);
}

TEST_F(ButtonBarTest, AListenerMayDeleteTheBar) {
  UI_ButtonBarP doomed(Add(new UI_ButtonBar, RectF(0, 120, 150, 30)));
  doomed->AddTextButton(u"A", 1);
  doomed->AddTextButton(u"B", 2);
  doomed->NotifyWhenChanged(ui::MakeNotification<void(UI_ControlChangedMessage*)>(
      [this](UI_ControlChangedMessage* inMessage) { root->ChildRemove(inMessage->GetControl()); }));
  UI_ButtonBar* raw = doomed.get();
  const RectF r = raw->GetButton(1)->UI_GetLocalRectF(true);
  doomed.reset();
  const PointF centre(r.left + r.width / 2, 120 + r.height / 2);
  Press(centre);
  Release(centre);
  EXPECT_EQ(root->ChildSize(), 1u) << "only the fixture's bar is left";
}

// ---- keyboard ----

TEST_F(ButtonBarTest, ArrowsMoveTheSelectionLikeClicks) {
  Click(0);
  EXPECT_TRUE(KeyDown(bar.get(), kRight, 0));
  EXPECT_THAT(Values(), ElementsAre(0, 1, 0));
  EXPECT_TRUE(KeyDown(bar.get(), kDown, 0));
  EXPECT_THAT(Values(), ElementsAre(0, 0, 1));
  EXPECT_TRUE(KeyDown(bar.get(), kUp, 0));
  EXPECT_THAT(Values(), ElementsAre(0, 1, 0));
  EXPECT_THAT(valuesHeard, ElementsAre(0.25, 0.5, 1.0, 0.5));
}

TEST_F(ButtonBarTest, ArrowsStartFromTheirEndStopAtTheEndsSilentlyAndSkipDisabledButtons) {
  KeyDown(bar.get(), kRight, 0);
  EXPECT_THAT(Values(), ElementsAre(1, 0, 0)) << "with no selection, from the first";
  bar->SetValueUnknown();
  KeyDown(bar.get(), kLeft, 0);
  EXPECT_THAT(Values(), ElementsAre(0, 0, 1)) << "with no selection, from the last";
  heard.clear();
  EXPECT_TRUE(KeyDown(bar.get(), kRight, 0)) << "the key is taken even at the end";
  EXPECT_THAT(Values(), ElementsAre(0, 0, 1));
  EXPECT_THAT(heard, IsEmpty());
  bar->UI_SetButtonEnabled(1, false);
  KeyDown(bar.get(), kLeft, 0);
  EXPECT_THAT(Values(), ElementsAre(1, 0, 0));
  KeyDown(bar.get(), kRight, 0);
  EXPECT_THAT(Values(), ElementsAre(0, 0, 1));
  bar->UI_SetButtonEnabled(2, false);
  bar->SetValue(0.25);
  KeyDown(bar.get(), kRight, 0);
  EXPECT_THAT(Values(), ElementsAre(1, 0, 0)) << "no enabled button after the first";
}

TEST_F(ButtonBarTest, ArrowsWithCtrlAndOnADisabledBarAreNotTaken) {
  bar->SetValue(0.25);
  EXPECT_FALSE(KeyDown(bar.get(), kRight, 0, ModKeys(ui::kModKeyCtrl)));
  bar->SetEnabled(false);
  EXPECT_FALSE(KeyDown(bar.get(), kRight, 0));
  EXPECT_THAT(Values(), ElementsAre(1, 0, 0));
}

}  // namespace
}  // namespace norvik::controls::test
