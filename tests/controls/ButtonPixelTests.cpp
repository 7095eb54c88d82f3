// The looks of the buttons, drawn by their stateless Draw routines with no
// control, in each state, in the dark and the light theme, compared with
// reference images.
#include <algorithm>
#include <cstdlib>
#include <functional>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "controls/UI_ButtonBar.h"
#include "controls/UI_Checkbox.h"
#include "controls/UI_DisclosureTriangleButton.h"
#include "controls/UI_RadioButton.h"
#include "controls/UI_TextButton.h"
#include "drawbot/Drawbot.h"
#include "support/drawbot/PixelCompare.h"
#include "ui/KeyframeThemeEditor.h"

namespace norvik::controls::test {
namespace {

using drawbot::testing::MatchesReference;
using drawbot::testing::PixelCanvas;
using RectF = tarsel::geom::RectT<float>;
using StateFlags = DrawParameters::StateFlags;

constexpr int kCellWidth = 96;
constexpr int kCellHeight = 26;

struct Look {
  const char* name;
  unsigned long state;
};
constexpr Look kLooks[] = {{"normal", 0},
                           {"rollover", UI_ControlView::kStateRollover},
                           {"down", UI_ControlView::kStateDown | UI_ControlView::kStateRollover},
                           {"disabled", UI_ControlView::kStateDisabled},
                           {"focused", UI_ControlView::kStateFocused}};
constexpr int kLookCount = sizeof(kLooks) / sizeof(kLooks[0]);

// Draws one cell; inVariant is 0 for the off look, 1 for the on look.
using CellPainter = std::function<void(const ui::ThemeP&, StateFlags, int, const RectF&, drawbot::Drawbot&)>;

class ButtonPixelTest : public ::testing::TestWithParam<bool> {
 protected:
  ButtonPixelTest() : theme(ui::MakeDefaultKeyframeTheme()) { theme->SetBrightness(GetParam() ? 0.85f : 0.25f); }

  // Two columns (off, on) of the five looks over the theme's background.
  drawbot::testing::PixelImage Render(const CellPainter& inPaint) {
    PixelCanvas canvas(2 * kCellWidth, kLookCount * kCellHeight);
    canvas.Clear(theme->GetColor(4).ToPacked() & 0xFFFFFF);
    drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
    for (int variant = 0; variant < 2; ++variant)
      for (int i = 0; i < kLookCount; ++i)
        inPaint(theme, StateFlags(kLooks[i].state), variant,
                RectF(static_cast<float>(variant * kCellWidth + 4), static_cast<float>(i * kCellHeight + 2),
                      kCellWidth - 8, kCellHeight - 4),
                drawbot);
    return canvas.Snapshot();
  }
  std::string Name(const char* inKind) const {
    return std::string("controls/") + inKind + (GetParam() ? "_light" : "_dark");
  }

  ui::KeyframeThemeEditorP theme;
};

TEST_P(ButtonPixelTest, TextButtonsInEachState) {
  const auto image = Render([](const ui::ThemeP& inTheme, StateFlags inState, int inVariant, const RectF& inRect,
                               drawbot::Drawbot& inDrawbot) {
    DrawTextButtonParameters params;
    params.SetTheme(inTheme);
    params.SetRectF(inRect);
    params.SetControlState(inState);
    params.SetText(u"Render");
    params.SetDefaultAppearance(inVariant == 1);
    UI_TextButton::Draw(params, inDrawbot);
  });
  EXPECT_TRUE(MatchesReference(image, Name("text_button")));
}

TEST_P(ButtonPixelTest, CheckboxesInEachState) {
  const auto image = Render([](const ui::ThemeP& inTheme, StateFlags inState, int inVariant, const RectF& inRect,
                               drawbot::Drawbot& inDrawbot) {
    DrawCheckBoxParams params;
    params.SetTheme(inTheme);
    params.SetRectF(inRect);
    params.SetControlState(inState);
    params.SetText(u"Loop");
    params.SetTextAlignment(drawbot::kTextAlignLeft);
    params.SetValue(inVariant == 1 ? UI_Checkbox::kOn : UI_Checkbox::kOff);
    UI_Checkbox::Draw(params, inDrawbot);
  });
  EXPECT_TRUE(MatchesReference(image, Name("checkbox")));
}

TEST_P(ButtonPixelTest, RadioButtonsInEachState) {
  const auto image = Render([](const ui::ThemeP& inTheme, StateFlags inState, int inVariant, const RectF& inRect,
                               drawbot::Drawbot& inDrawbot) {
    DrawRadioButtonParams params;
    params.SetTheme(inTheme);
    params.SetRectF(inRect);
    params.SetControlState(inState);
    params.SetText(u"Stereo");
    params.SetOn(inVariant == 1);
    UI_RadioButton::Draw(params, inDrawbot);
  });
  EXPECT_TRUE(MatchesReference(image, Name("radio_button")));
}

TEST_P(ButtonPixelTest, DisclosureTrianglesClosedAndOpen) {
  const auto image = Render([](const ui::ThemeP& inTheme, StateFlags inState, int inVariant, const RectF& inRect,
                               drawbot::Drawbot& inDrawbot) {
    DrawParameters params;
    params.SetTheme(inTheme);
    params.SetControlState(inState);
    UI_DisclosureTriangleButton::DrawTriangle(params, RectF(inRect.left, inRect.top + 5, 12, 12),
                                              inVariant == 1 ? 90.0f : 0.0f, inDrawbot);
  });
  EXPECT_TRUE(MatchesReference(image, Name("disclosure_triangle")));
}

// The bar's frame in the look's state, with three segments on it painted as
// the bar's text buttons paint themselves: the focus ring belongs to the bar,
// and the on look shows the middle segment selected (down).
TEST_P(ButtonPixelTest, ButtonBarsInEachState) {
  const auto image = Render([](const ui::ThemeP& inTheme, StateFlags inState, int inVariant, const RectF& inRect,
                               drawbot::Drawbot& inDrawbot) {
    const std::vector<RectF> segments = UI_ButtonBar::LayoutRow(3, tarsel::geom::PointT<float>(28, inRect.height));
    DrawButtonParameters frame;
    frame.SetTheme(inTheme);
    frame.SetControlState(inState);
    frame.SetRectF(RectF(inRect.left, inRect.top, segments.back().left + segments.back().width, inRect.height));
    UI_ButtonBar::DrawFrame(frame, inDrawbot);
    const char16_t* labels[] = {u"L", u"M", u"H"};
    for (std::size_t i = 0; i < segments.size(); ++i) {
      StateFlags state = inState;
      state.Clear(UI_ControlView::kStateFocused | UI_ControlView::kStateDown);
      if (inVariant == 1 && i == 1) state.Set(UI_ControlView::kStateDown);
      DrawTextButtonParameters params;
      params.SetTheme(inTheme);
      params.SetControlState(state);
      params.SetRectF(RectF(inRect.left + segments[i].left, inRect.top, segments[i].width, segments[i].height));
      params.SetDrawOutline(state.TestAny(UI_ControlView::kStateRollover | UI_ControlView::kStateDown) &&
                            !state.Test(UI_ControlView::kStateDisabled));
      params.SetText(labels[i]);
      UI_TextButton::Draw(params, inDrawbot);
    }
  });
  EXPECT_TRUE(MatchesReference(image, Name("button_bar")));
}

// ---- disabled looks against each other ----

// How many pixels differ between two images of one size.
int CountDifferences(const drawbot::testing::PixelImage& inA, const drawbot::testing::PixelImage& inB) {
  int count = 0;
  for (int y = 0; y < inA.height; ++y)
    for (int x = 0; x < inA.width; ++x) count += inA.At(x, y) != inB.At(x, y) ? 1 : 0;
  return count;
}

class DisabledLookTest : public ButtonPixelTest {
 protected:
  // One cell of kCellWidth x kCellHeight over the theme's background.
  drawbot::testing::PixelImage Cell(const std::function<void(const RectF&, drawbot::Drawbot&)>& inPaint) {
    PixelCanvas canvas(kCellWidth, kCellHeight);
    canvas.Clear(theme->GetColor(4).ToPacked() & 0xFFFFFF);
    drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
    inPaint(RectF(4, 2, kCellWidth - 8, kCellHeight - 4), drawbot);
    return canvas.Snapshot();
  }
  drawbot::testing::PixelImage TextButton(unsigned long inState) {
    return Cell([&](const RectF& inRect, drawbot::Drawbot& inDrawbot) {
      DrawTextButtonParameters params;
      params.SetTheme(theme);
      params.SetRectF(inRect);
      params.SetControlState(StateFlags(inState));
      params.SetDrawOutline(true);
      params.SetText(u"Render");
      UI_TextButton::Draw(params, inDrawbot);
    });
  }
};

// A disabled button that is down has its own outline, fill and ring, so a
// disabled toggle that is on never reads as one that is off.
TEST_P(DisabledLookTest, DisabledAndDownDrawsOtherwiseThanDisabled) {
  const auto up = TextButton(UI_ControlView::kStateDisabled);
  const auto down = TextButton(UI_ControlView::kStateDisabled | UI_ControlView::kStateDown);
  EXPECT_GT(CountDifferences(up, down), 200) << "the face of the bevel differs";
  // The outline alone: the column just inside the left edge of the bevel.
  int outlineDifferences = 0;
  for (int y = 6; y < kCellHeight - 6; ++y) outlineDifferences += up.At(5, y) != down.At(5, y) ? 1 : 0;
  EXPECT_GT(outlineDifferences, 8) << "the outline differs";
}

INSTANTIATE_TEST_SUITE_P(Themes, DisabledLookTest, ::testing::Values(false, true),
                         [](const ::testing::TestParamInfo<bool>& inInfo) { return inInfo.param ? "Light" : "Dark"; });

INSTANTIATE_TEST_SUITE_P(Themes, ButtonPixelTest, ::testing::Values(false, true),
                         [](const ::testing::TestParamInfo<bool>& inInfo) { return inInfo.param ? "Light" : "Dark"; });

}  // namespace
}  // namespace norvik::controls::test
