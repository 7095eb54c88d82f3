// A small tree painted through the image back end: theme colours in the dark
// and the light look, caches that show the same pixels as drawing, clipping
// to a view and around hosted native controls.
#include <cstdlib>

#include <gtest/gtest.h>

#include "support/drawbot/PixelCompare.h"
#include "support/ui/DrawTestNodes.h"
#include "support/ui/NodeTestSupport.h"
#include "support/ui/ThemeTestSupport.h"
#include "ui/KeyframeThemeEditor.h"

namespace norvik::ui::test {
namespace {

using drawbot::ColorRGBA;
using drawbot::testing::PixelCanvas;
using drawbot::testing::PixelImage;
using RectF = tarsel::geom::RectT<float>;

// Each channel of an opaque pixel within one step of the colour.
::testing::AssertionResult PixelIs(const PixelImage& inImage, int inX, int inY, const ColorRGBA& inColor) {
  const std::uint32_t actual = inImage.At(inX, inY);
  const std::uint32_t expected = inColor.ToPacked();
  for (int shift = 0; shift < 32; shift += 8) {
    const int a = static_cast<int>((actual >> shift) & 0xFF), e = static_cast<int>((expected >> shift) & 0xFF);
    if (std::abs(a - e) > 1)
      return ::testing::AssertionFailure() << "pixel (" << inX << ", " << inY << ") is " << std::hex << actual
                                           << ", expected " << expected;
  }
  return ::testing::AssertionSuccess();
}

int Red(const PixelImage& inImage, int inX, int inY) { return static_cast<int>((inImage.At(inX, inY) >> 16) & 0xFF); }

class DrawPixels : public ManagerTest {
 protected:
  void SetUp() override {
    theme = MakeDefaultKeyframeTheme();
    Theme::Initialize(theme);
    root = AddPaintingView("root", 0, 0, 40, 30, 2, nullptr, nullptr);
    panel = AddPaintingView("panel", 5, 5, 30, 20, 7, nullptr, root.get());
    leaf = AddPaintingView("leaf", 10, 5, 10, 10, 1, nullptr, panel.get());
  }
  void TearDown() override { Theme::Terminate(); }

  PixelImage Paint(bool inUseBuffer = false) {
    drawbot::Drawbot bot(canvas.GetSupplier(), canvas.GetSurface());
    const ColorRGBA background = theme->GetColor(2);
    root->UI_DispatchDrawFromRoot(&background, &bot, inUseBuffer);
    return canvas.Snapshot();
  }
  void SetLook(float inBrightness) {
    theme->SetBrightness(inBrightness);
    theme->NotifyThemeChanged();
  }

  ScPrivateConfigDir config;
  KeyframeThemeEditorP theme;
  PixelCanvas canvas{40, 30};
  PaintingViewP root, panel, leaf;
};

// One image per look: the fills and the text in the look's own colours, dark
// fills under light text or the other way round, the same pixels through
// the paint buffer, and the stored reference.
TEST_F(DrawPixels, EachLookPaintsItsThemeColoursBufferedOrNotAsItsReference) {
  const struct {
    float brightness;
    const char* reference;
  } looks[] = {{0, "ui/DrawTreeDark"}, {1, "ui/DrawTreeLight"}};
  for (const auto& look : looks) {
    SCOPED_TRACE(look.reference);
    SetLook(look.brightness);
    PixelImage image = Paint();
    EXPECT_TRUE(PixelIs(image, 1, 1, theme->GetColor(2)));
    EXPECT_TRUE(PixelIs(image, 6, 6, theme->GetColor(7)));
    EXPECT_TRUE(PixelIs(image, 16, 12, theme->GetColor(1)));
    const bool dark = look.brightness < 0.5f;
    EXPECT_EQ(Red(image, 1, 1) < 0x30, dark);
    EXPECT_EQ(Red(image, 16, 12) > 0xB0, dark);
    EXPECT_TRUE(drawbot::testing::MatchesReference(image, look.reference));
    canvas.Clear(0x00FF00);
    EXPECT_EQ(Paint(true).pixels, image.pixels) << "through the paint buffer";
  }
}

TEST_F(DrawPixels, CachedViewsFollowTheSwitchFromDarkToLight) {
  panel->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  leaf->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  SetLook(0);
  Paint();
  SetLook(1);
  PixelImage image = Paint();
  EXPECT_TRUE(PixelIs(image, 6, 6, ColorRGBA(0x9E / 255.0f, 0x9E / 255.0f, 0x9E / 255.0f, 1)));
  EXPECT_TRUE(PixelIs(image, 16, 12, ColorRGBA(0x26 / 255.0f, 0x26 / 255.0f, 0x26 / 255.0f, 1)));
}

TEST_F(DrawPixels, ACacheShowsTheSamePixelsAsDrawingAfterAWholePixelScroll) {
  SetLook(0);
  panel->UI_SetMatrixOnlyForChildren(true);
  panel->UI_SetMatrix(UI_Node::Matrix::Translation(2, 3));
  const PixelImage direct = Paint();
  panel->UI_SetMatrix(UI_Node::Matrix());
  leaf->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  Paint();
  panel->UI_SetMatrix(UI_Node::Matrix::Translation(2, 3));
  const PixelImage cached = Paint();
  EXPECT_EQ(leaf->draws, 2);  // the last paint of the leaf came from its cache
  EXPECT_EQ(cached.pixels, direct.pixels);
}

TEST_F(DrawPixels, AViewThatClipsToItselfKeepsItsChildrenInside) {
  SetLook(1);
  const RectF large(-10, -10, 60, 60);
  leaf->paintRect = &large;
  PixelImage unclipped = Paint();
  EXPECT_TRUE(PixelIs(unclipped, 6, 1, theme->GetColor(1)));
  panel->UI_SetClipToSelfEnabled(true);
  PixelImage clipped = Paint();
  EXPECT_TRUE(PixelIs(clipped, 6, 1, theme->GetColor(2)));
  EXPECT_TRUE(PixelIs(clipped, 6, 6, theme->GetColor(1)));
  EXPECT_TRUE(PixelIs(clipped, 34, 24, theme->GetColor(1)));
  EXPECT_TRUE(PixelIs(clipped, 35, 25, theme->GetColor(2)));
}

TEST_F(DrawPixels, HostedNativeControlsAreCutOutOfThePaintedArea) {
  SetLook(1);
  const RectF control(2, 2, 6, 4);  // local to the leaf, which sits at (15, 10) in the root
  leaf->hostedControl = &control;
  canvas.Clear(0x00FF00);
  PixelImage image = Paint();
  EXPECT_TRUE(PixelIs(image, 17, 12, ColorRGBA(0, 1, 0, 1)));
  EXPECT_TRUE(PixelIs(image, 22, 15, ColorRGBA(0, 1, 0, 1)));
  EXPECT_TRUE(PixelIs(image, 16, 11, theme->GetColor(1)));
  EXPECT_TRUE(PixelIs(image, 23, 16, theme->GetColor(1)));
  EXPECT_TRUE(PixelIs(image, 1, 1, theme->GetColor(2)));
}

}  // namespace
}  // namespace norvik::ui::test
