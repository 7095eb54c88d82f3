// Picture buttons ask their supply function for the image of their state,
// centre it on whole pixels and fade it when disabled; owner-drawn buttons
// leave all painting to their owner; lock and link buttons pick their images
// by state, and a missing image raises its resource error.
#include <vector>

#include <gtest/gtest.h>

#include "controls/UI_LockButton.h"
#include "controls/UI_PictureButton.h"
#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "support/controls/ControlTestSupport.h"
#include "support/drawbot/PixelCompare.h"
#include "support/utility/MemoryResourceManager.h"
#include "tarsel/ThrowError.h"
#include "ui/DrawbotImageResourceCache.h"
#include "ui/HeadlessWindowSystem.h"
#include "ui/OS_NodeManager.h"

namespace norvik::controls::test {
namespace {

using drawbot::testing::PixelCanvas;

class PictureButtonTest : public ControlTest {
 protected:
  PictureButtonTest() : canvas(40, 30), pixels(16, 0xFFFF0000u) {
    image = drawbot::BufferImageP(canvas.GetSupplier(), 4, 4, 16, drawbot::kPixelLayoutBGRAPremul, pixels.data(),
                                  nullptr);
  }
  PixelCanvas canvas;
  std::vector<std::uint32_t> pixels;
  drawbot::BufferImageP image;
};

TEST_F(PictureButtonTest, TheSupplyFunctionSeesTheStateAndAnswersTheImage) {
  auto button = Add(new UI_PictureButton, RectF(0, 0, 20, 20));
  EXPECT_EQ(button->GetImage(), nullptr) << "no supply function, no image";
  DrawParameters::StateFlags seen;
  button->SetImageSupplyFunction([&](UI_PictureSupplyMessage* inMessage) {
    seen = inMessage->GetStateFlags();
    EXPECT_EQ(inMessage->GetControl(), button.get());
    inMessage->SetImage(image.Get());
  });
  button->SetDownState(true);
  EXPECT_EQ(button->GetImage(), image.Get());
  EXPECT_TRUE(seen.Test(UI_ControlView::kStateDown));
}

TEST_F(PictureButtonTest, ThePictureIsCentredOnWholePixels) {
  canvas.Clear(0xFFFFFF);
  drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
  DrawParameters params;
  UI_PictureButton::DrawPicture(params, *image, RectF(0, 0, 11, 11), 1, 1, drawbot);
  const auto snapshot = canvas.Snapshot();
  // 11 - 4 = 7, halved to 3.5 and truncated to 3: the image covers 3 to 6.
  EXPECT_EQ(snapshot.At(3, 3), 0xFFFF0000u);
  EXPECT_EQ(snapshot.At(6, 6), 0xFFFF0000u);
  EXPECT_EQ(snapshot.At(2, 2), 0xFFFFFFFFu);
  EXPECT_EQ(snapshot.At(7, 7), 0xFFFFFFFFu);
}

TEST_F(PictureButtonTest, ADisabledButtonThatIsUpShowsNoBorderEvenUnderTheMouse) {
  auto button = Add(new UI_PictureButton, RectF(0, 0, 20, 20));
  button->UI_SetMouseOverLeafNode(nullptr);
  button->UI_SetDisabled(true);
  ASSERT_TRUE(button->GetControlState(true).Test(UI_ControlView::kStateRollover));
  canvas.Clear(0xFFFFFF);
  drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
  button->UI_Draw(&drawbot);
  const auto shot = canvas.Snapshot();
  for (int y = 0; y < 20; ++y)
    for (int x = 0; x < 20; ++x) ASSERT_EQ(shot.At(x, y), 0xFFFFFFFFu) << x << "," << y;
}

TEST_F(PictureButtonTest, TheImageBorderKeepsSpaceAroundTheImageAndWidensTheRecommendedSize) {
  auto button = Add(new UI_PictureButton, RectF(0, 0, 20, 20));
  button->SetImageSupplyFunction([&](UI_PictureSupplyMessage* inMessage) { inMessage->SetImage(image.Get()); });
  button->SetScale(5);
  button->SetImageBorder(5);
  EXPECT_EQ(button->UI_GetRecommendedSize(), PointF(30, 30)) << "4 x 4 at scale 5, and 5 on each side";
  drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
  button->UI_Draw(&drawbot);
  EXPECT_EQ(canvas.Snapshot().Alpha(3, 10), 0) << "the image is as wide as the button, but not drawn in the border";
  EXPECT_EQ(canvas.Snapshot().At(10, 10), 0xFFFF0000u);
}

TEST_F(PictureButtonTest, AnOwnerDrawnButtonPaintsOnlyThroughItsFunction) {
  auto button = Add(new UI_OwnerDrawButton, RectF(0, 0, 20, 20));
  int calls = 0;
  button->SetOwnerDrawFunction([&](UI_OwnerDrawButton& inButton, drawbot::Drawbot&) {
    EXPECT_EQ(&inButton, button.get());
    ++calls;
  });
  canvas.Clear(0xFFFFFF);
  drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
  button->UI_Draw(&drawbot);
  EXPECT_EQ(calls, 1);
  EXPECT_EQ(canvas.Snapshot().At(5, 5), 0xFFFFFFFFu) << "nothing else painted";
}


TEST(LockAndLinkImageNames, FollowTheStateRolloverAndIconType) {
  EXPECT_EQ(UI_LockButton::ImageName(true, false, 0), UTF8String("RV4_Locked_Sm_N"));
  EXPECT_EQ(UI_LockButton::ImageName(false, true, 0), UTF8String("RV4_Unlocked_Sm_R"));
  EXPECT_EQ(UI_LockButton::ImageName(true, true, 1), UTF8String("RV4_Locked_Sm_R_D"));
  EXPECT_EQ(UI_LinkButton::ImageName(true, 0), UTF8String("RV4_ConstrainedProportions"));
  EXPECT_EQ(UI_LinkButton::ImageName(false, 1), UTF8String("RV4_UnconstrainedProportions_D"));
}

TEST_F(PictureButtonTest, ALockReadsThroughTheCacheItIsBoundToForTheDrawingsSupplierAndAMissingImageRaises) {
  auto lock = Add(new UI_LockButton, RectF(0, 0, 20, 20));
  utility::testing::MemoryResourceManager resources;
  ui::DrawbotImageResourceCache cache;
  lock->SetResourceManagerImageCache(nullptr, &cache);
  lock->BindResourceManager(&resources);
  Press(PointF(5, 5));
  Release(PointF(5, 5));
  EXPECT_EQ(lock->GetValue(), UI_Button::kButtonOn);
  drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
  const UTF8String name = UI_LockButton::ImageName(true, false, lock->UI_GetCurrentTheme()->GetIconType());
  try {
    lock->UI_Draw(&drawbot);
    ADD_FAILURE() << "a missing image drew";
  } catch (const tarsel::config::Exception& e) {
    EXPECT_EQ(std::string(e.what()), "Unable to access resource '" + std::string(name.c_str()) + "' (type png)");
  }
  cache.CacheImage(canvas.GetSupplier(), name, drawbot::kImageFileTypePNG, image.GetPtr());
  canvas.Clear(0xFFFFFF);
  lock->UI_Draw(&drawbot);
  EXPECT_EQ(canvas.Snapshot().At(10, 10), 0xFFFF0000u) << "the image decoded for the canvas's supplier";
}

// The manager an application makes carries the toolkit's pictures: the lock
// shows its artwork for each state.
TEST(LockButtonArtwork, UnderThePlatformManagerTheLockShowsAPictureForEachState) {
  ui::OS_NodeManager manager;
  ui::HeadlessWindowSystem system;
  system.Install();
  boost::intrusive_ptr<UI_LockButton> lock(new UI_LockButton);
  lock->UI_SetLocalRectF(RectF(0, 0, 20, 20));
  lock->UI_Show(true);
  PixelCanvas canvas(20, 20);
  auto paint = [&] {
    canvas.Clear(0x808080);
    drawbot::Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
    lock->UI_Draw(&drawbot);
    return canvas.Snapshot();
  };
  auto differing = [](const drawbot::testing::PixelImage& inA, const drawbot::testing::PixelImage& inB) {
    int count = 0;
    for (int y = 0; y < inA.height; ++y)
      for (int x = 0; x < inA.width; ++x) count += inA.At(x, y) != inB.At(x, y) ? 1 : 0;
    return count;
  };
  const int iconType = lock->UI_GetCurrentTheme()->GetIconType();

  const drawbot::ImageInterface* unlocked = lock->GetImage();
  ASSERT_NE(unlocked, nullptr);
  EXPECT_EQ(unlocked, manager.GetImage(manager.GetOSDrawSupplier(), UI_LockButton::ImageName(false, false, iconType),
                                       drawbot::kImageFileTypePNG));
  const auto unlockedPixels = paint();

  lock->SetValue(UI_Button::kButtonOn);
  const drawbot::ImageInterface* locked = lock->GetImage();
  ASSERT_NE(locked, nullptr);
  EXPECT_NE(locked, unlocked);
  const auto lockedPixels = paint();
  EXPECT_GT(differing(lockedPixels, unlockedPixels), 4) << "the locked picture is another picture";

  system.Uninstall();
}

}  // namespace
}  // namespace norvik::controls::test
