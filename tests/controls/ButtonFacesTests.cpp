// What stands on the buttons' bevels and around it: the picture record and
// its face, the check box mark, the disclosure triangle's turn, the block of
// picture and label, the chromeless rest look, and Return as activation of
// picture buttons.
#include <algorithm>
#include <cmath>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <memory>
#include <sstream>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tarsel/ThrowError.h"

#include "controls/DrawButtonFaces.h"
#include "controls/UI_Checkbox.h"
#include "controls/UI_DisclosureTriangleButton.h"
#include "controls/UI_PictureButton.h"
#include "controls/UI_PictureTextButton.h"
#include "controls/UI_TextButton.h"
#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "support/controls/ControlTestSupport.h"
#include "support/ui/KeyCodes.h"
#include "support/drawbot/PixelCompare.h"
#include "support/utility/MemoryResourceManager.h"
#include "ui/DrawbotImageResourceCache.h"
#include "ui/UI_DialogHost.h"

namespace norvik::controls::test {
namespace {

using namespace ui::test::keys;

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using drawbot::testing::PixelCanvas;
using drawbot::testing::PixelImage;
using StateFlags = DrawParameters::StateFlags;

int PaintedPixels(const PixelImage& inImage) {
  return static_cast<int>(
      std::count_if(inImage.pixels.begin(), inImage.pixels.end(), [](std::uint32_t p) { return (p >> 24) != 0; }));
}

// ---- picture buttons ----

TEST(PictureButtonDrawing, ScaleAndNoImage) {
  PixelCanvas canvas(20, 20);
  std::uint32_t blue[4];
  std::fill(std::begin(blue), std::end(blue), 0xFF0000FFu);
  drawbot::BufferImageP image(canvas.GetSupplier(), 2, 2, 8, drawbot::kPixelLayoutBGRAPremul, blue,
                              nullptr);
  DrawPictureButtonParameters params;
  params.SetRectF(RectF(0, 0, 20, 20));
  params.SetDrawContainer(false);
  params.SetImage(image.Get());
  params.SetScale(3);
  drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
  UI_PictureButton::Draw(params, drawbot);
  EXPECT_EQ(PaintedPixels(canvas.Snapshot()), 36) << "a 2 x 2 image at scale 3";

  PixelCanvas bare(20, 20);
  drawbot::Drawbot bareBot(bare.GetSupplier(), bare.GetSurface());
  params.SetImage(nullptr);
  params.SetDrawContainer(true);
  UI_PictureButton::Draw(params, bareBot);
  EXPECT_GT(PaintedPixels(bare.Snapshot()), 200) << "without an image the bevel is still painted";
}

TEST(ButtonFaces, APublicFaceDrawsWithNoButtonAtTheOffsetTheBevelGives) {
  PixelCanvas canvas(20, 20);
  std::uint32_t blue[4];
  std::fill(std::begin(blue), std::end(blue), 0xFF0000FFu);
  drawbot::BufferImageP image(canvas.GetSupplier(), 2, 2, 8, drawbot::kPixelLayoutBGRAPremul, blue, nullptr);
  const DrawParameters params;
  drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
  const DrawButtonPicture picture(params, *image.Get(), 2, 1);
  picture(StateFlags(), RectF(0, 0, 10, 10), PointF(5, 1), drawbot, *params.GetTheme(), nullptr);
  const PixelImage shot = canvas.Snapshot();
  EXPECT_EQ(PaintedPixels(shot), 16);
  EXPECT_NE(shot.At(8, 4), 0u) << "centred at (3, 3) and moved by the offset";
  EXPECT_EQ(shot.At(7, 4), 0u);
}

class PictureButtonKeys : public ControlTest {
 protected:
  PictureButtonKeys() : button(Add(new UI_PictureButton, RectF(10, 10, 24, 24))) {
    button->SetWantsKeyboardFocus(true);
    button->UI_GainKeyboardFocus(ui::kFocusChangeMouse);
    log.ListenChanged(*button);
  }
  boost::intrusive_ptr<UI_PictureButton> button;
};

TEST_F(PictureButtonKeys, ReturnActivatesOnlyWhenAskedTo) {
  KeyDown(button.get(), kReturn, 13);
  KeyUp(button.get(), kReturn, 13);
  EXPECT_THAT(log.entries, IsEmpty());
  button->SetSupportLegacyWindowsKeyboardActivation(true);
  EXPECT_TRUE(KeyDown(button.get(), kReturn, 13));
  EXPECT_TRUE(button->GetDownState()) << "pressed while the key is held";
  EXPECT_TRUE(KeyUp(button.get(), kReturn, 13));
  EXPECT_THAT(log.entries, ElementsAre("changed"));
  EXPECT_FALSE(button->GetDownState());
}

// ---- the chromeless rest look ----

class ChromelessTest : public ControlTest {
 protected:
  int Painted(UI_TextButton& inButton) {
    PixelCanvas canvas(60, 24);
    drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
    inButton.UI_Draw(&drawbot);
    return PaintedPixels(canvas.Snapshot());
  }
};

TEST_F(ChromelessTest, AButtonAtRestPaintsNoChromeUntilItIsDown) {
  auto button = Add(new UI_TextButton, RectF(0, 0, 60, 24));
  button->SetSpringLoaded(false);
  EXPECT_GT(Painted(*button), 0) << "a plain button at rest paints its fill";
  button->SetDisplayChromelessNormalState(true);
  EXPECT_TRUE(button->GetDisplayChromelessNormalState());
  EXPECT_EQ(Painted(*button), 0);
  button->SetValue(UI_Button::kButtonOn);
  EXPECT_GT(Painted(*button), 0) << "down is not at rest";
}

TEST_F(ChromelessTest, AtRestWithoutTheUndrawnInsetTheFillGrowsByTheSkippedBevelOnly) {
  auto button = Add(new UI_TextButton, RectF(0, 0, 60, 24));
  auto firstPaintedColumn = [&] {
    PixelCanvas canvas(60, 24);
    drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
    button->UI_Draw(&drawbot);
    const PixelImage shot = canvas.Snapshot();
    for (int x = 0; x < shot.width; ++x)
      if (shot.At(x, 12) != 0u) return x;
    return -1;
  };
  const int inset = firstPaintedColumn();
  button->SetInsetUndrawnSpace(false);
  EXPECT_EQ(firstPaintedColumn(), inset - 2) << "no outer bevel drawn, so no step inward for it";
}

TEST_F(ChromelessTest, TheTextIndentMovesTheLabelRight) {
  auto button = Add(new UI_TextButton(u"Mute"), RectF(0, 0, 60, 24));
  button->SetDisplayChromelessNormalState(true);
  button->SetTextAlignment(drawbot::kTextAlignLeft);
  auto firstInkedColumn = [&] {
    PixelCanvas canvas(60, 24);
    drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
    button->UI_Draw(&drawbot);
    const PixelImage shot = canvas.Snapshot();
    for (int x = 0; x < shot.width; ++x)
      for (int y = 0; y < shot.height; ++y)
        if (shot.At(x, y) != 0u) return x;
    return -1;
  };
  const int plain = firstInkedColumn();
  ASSERT_GE(plain, 0) << "the label paints";
  button->SetTextIndent(12);
  EXPECT_EQ(firstInkedColumn(), plain + 12);
}

class DialogContent : public ui::UI_SubView, public ui::UI_DialogHost {};

TEST_F(ChromelessTest, AFocusedTextOrPictureButtonInsideADialogDrawsAsTheDefaultButton) {
  for (UI_ButtonP button : {UI_ButtonP(new UI_TextButton(u"OK")), UI_ButtonP(new UI_PictureButton)}) {
    auto focusedShot = [&] {
      EXPECT_TRUE(button->UI_GainKeyboardFocus(ui::kFocusChangeMouse));
      PixelCanvas canvas(60, 24);
      drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
      button->UI_Draw(&drawbot);
      return canvas.Snapshot().pixels;
    };
    Add(button.get(), RectF(0, 0, 60, 24))->SetWantsKeyboardFocus(true);
    Add(new DialogContent, RectF(0, 0, 100, 40))->ChildPushBack(root->ChildRemove(button.get()));
    const auto inDialog = focusedShot();
    button->SetDefaultAppearance(true);
    EXPECT_EQ(focusedShot(), inDialog) << button->UI_GetNodeID() << ": inside, focus made it the default button";
  }
}

// ---- the check box mark ----

int MarkPixels(int inValue, bool inUnknown, PixelImage* outImage = nullptr) {
  PixelCanvas canvas(14, 14);
  drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
  DrawCheckBoxParams params;
  params.SetValue(inValue);
  params.SetValueUnknown(inUnknown);
  const DrawCheckbox mark(params);
  mark(StateFlags(), RectF(0, 0, 14, 14), PointF(), drawbot, *params.GetTheme(), nullptr);
  const PixelImage shot = canvas.Snapshot();
  if (outImage) *outImage = shot;
  return PaintedPixels(shot);
}

TEST(CheckboxMark, OffIsBlankOnIsATickMixedAndUnknownAreABar) {
  PixelImage on, mixed, unknown;
  EXPECT_EQ(MarkPixels(UI_Checkbox::kOff, false), 0);
  EXPECT_GT(MarkPixels(UI_Checkbox::kOn, false, &on), 0);
  EXPECT_GT(MarkPixels(UI_Checkbox::kMixed, false, &mixed), 0);
  MarkPixels(UI_Checkbox::kOff, true, &unknown);
  EXPECT_NE(on.pixels, mixed.pixels);
  EXPECT_EQ(mixed.pixels, unknown.pixels) << "an unknown value shows the mixed mark";
  EXPECT_EQ(drawbot::testing::RowCoverage(mixed, 3), "..............") << "the bar is level, mid-box";
  EXPECT_NE(drawbot::testing::RowCoverage(on, 3), "..............") << "the tick rises to the top right";
}

// ---- the disclosure triangle ----

TEST(DisclosureTriangleFace, DuringTheTwirlItTurnsTowardsTheValueAndWhileHeldFollowsThePressLook) {
  const DrawParameters params;
  EXPECT_FLOAT_EQ(DrawTrianglePicture(params, 0.025, 0.1, true, false, 1).GetAngle(StateFlags()), 22.5f);
  EXPECT_FLOAT_EQ(DrawTrianglePicture(params, 0.025, 0.1, false, false, 1).GetAngle(StateFlags()), 67.5f);
  EXPECT_FLOAT_EQ(DrawTrianglePicture(params, 0.5, 0.1, true, false, 1).GetAngle(StateFlags()), 90.0f)
      << "past the duration it rests";
  const DrawTrianglePicture held(params, -1, 0.075, false, true, 1);
  EXPECT_EQ(held.GetAngle(StateFlags(UI_ControlView::kStateDown)), 90.0f) << "while held it follows the press look";
  EXPECT_EQ(held.GetAngle(StateFlags()), 0.0f);
}

TEST(DisclosureTriangleFace, TheTriangleKeepsItsScaledSizeInALargerRectangle) {
  auto paint = [](float inScale) {
    PixelCanvas canvas(40, 40);
    drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
    const DrawParameters params;
    const DrawTrianglePicture face(params, -1, 0.075, false, false, inScale);
    face(StateFlags(), RectF(0, 0, 40, 40), PointF(), drawbot, *params.GetTheme(), nullptr);
    return PaintedPixels(canvas.Snapshot());
  };
  const int small = paint(1), large = paint(2);
  EXPECT_GT(small, 0);
  EXPECT_NEAR(static_cast<double>(large) / small, 4.0, 0.8) << "twice the side, four times the area";
}

// ---- picture and label ----

class PictureTextLayout : public ControlTest {
 protected:
  PictureTextLayout() {
    button = Add(new UI_PictureTextButton(u"Tracks"), RectF(0, 0, 150, 24));
    labelWidth = button->UI_GetRecommendedSize().x - 20;
  }
  boost::intrusive_ptr<UI_PictureTextButton> button;
  float labelWidth = 0;
};

TEST_F(PictureTextLayout, LeftAlignedThePictureStartsAtTheInsetAndTheLabelFollows) {
  const auto [picture, text] = button->ComputeTextAndImageOffset(RectF(0, 0, 150, 24));
  EXPECT_EQ(picture, RectF(2, 6, 12, 12));
  EXPECT_EQ(text.left, 2 + 12 + 4);
  EXPECT_EQ(text.left + text.width, 150);
}

TEST_F(PictureTextLayout, CentredAndRightAlignedTheBlockMovesAcross) {
  ASSERT_GT(labelWidth, 10);
  const float block = 12 + 4 + labelWidth;
  button->SetImageAndTextAlignment(drawbot::kTextAlignCenter);
  auto [picture, text] = button->ComputeTextAndImageOffset(RectF(0, 0, 150, 24));
  EXPECT_NEAR(picture.left, (150 - block) / 2, 1.0);
  EXPECT_EQ(text.left, picture.left + 16);
  button->SetImageAndTextAlignment(drawbot::kTextAlignRight);
  std::tie(picture, text) = button->ComputeTextAndImageOffset(RectF(0, 0, 150, 24));
  EXPECT_NEAR(picture.left + block, 148, 0.01);
  std::tie(picture, text) = button->ComputeTextAndImageOffset(RectF(0, 0, 30, 24));
  EXPECT_EQ(picture.left, 2) << "a block wider than the button stays at the inset";
}

TEST_F(PictureTextLayout, TheStyleHidesOneOfTheParts) {
  button->SetStyle(UI_PictureTextButton::kStyleTextOnly);
  auto [picture, text] = button->ComputeTextAndImageOffset(RectF(0, 0, 150, 24));
  EXPECT_EQ(picture.width, 0);
  EXPECT_EQ(text.left, 2) << "no picture, no spacing";
  button->SetStyle(UI_PictureTextButton::kStylePictureOnly);
  button->SetImageAndTextAlignment(drawbot::kTextAlignCenter);
  std::tie(picture, text) = button->ComputeTextAndImageOffset(RectF(0, 0, 150, 24));
  EXPECT_EQ(picture, RectF(69, 6, 12, 12)) << "the picture alone is centred";
  EXPECT_EQ(text.width, 0);
}

// The bytes of a PNG of one opaque colour.
std::string SolidPNG(int inSize, std::uint32_t inARGB) {
  PixelImage image;
  image.width = image.height = inSize;
  image.pixels.assign(static_cast<std::size_t>(inSize * inSize), inARGB);
  const std::string path = ::testing::TempDir() + "controls_solid.png";
  EXPECT_TRUE(drawbot::testing::SavePNG(image, path));
  std::ifstream in(path, std::ios::binary);
  std::string bytes((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
  std::remove(path.c_str());
  return bytes;
}

TEST_F(PictureTextLayout, ThePictureIsTheResourceImageOfTheBaseName) {
  auto resources = std::make_unique<utility::testing::MemoryResourceManager>();
  resources->Put("Star", "png", SolidPNG(6, 0xFF00FF00u));
  manager.SetResourceManager(std::move(resources));
  manager.SetDrawbotImageResourceCache(std::make_unique<ui::DrawbotImageResourceCache>());
  auto paint = [this] {
    PixelCanvas canvas(150, 24);
    drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
    button->UI_Draw(&drawbot);
    return canvas.Snapshot();
  };
  EXPECT_NE(paint().At(8, 12), 0xFF00FF00u) << "no base name, no picture";
  button->SetImageBaseName("Star");
  const PixelImage shot = paint();
  // The picture's rectangle is 2..14 across and 6..18 down; the 6-pixel image is centred in it.
  EXPECT_EQ(shot.At(5, 9), 0xFF00FF00u);
  EXPECT_EQ(shot.At(10, 14), 0xFF00FF00u);
  EXPECT_NE(shot.At(4, 9), 0xFF00FF00u);
  EXPECT_NE(shot.At(11, 14), 0xFF00FF00u);
  button->SetImageBaseName("Missing");
  EXPECT_THROW(paint(), tarsel::config::Exception) << "a name the resources lack raises its error";
}

}  // namespace
}  // namespace norvik::controls::test
