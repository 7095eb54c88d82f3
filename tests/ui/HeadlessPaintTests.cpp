// Painting in the headless window system: damage merged into paint messages,
// the update region, the window surfaces, the region algebra, and the
// composited screen.
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <map>

#include <gmock/gmock.h>

#include "drawbot/DrawbotWrappers.h"
#include "drawbot/SurfaceInterface.h"
#include "support/ui/HeadlessTestSupport.h"

namespace norvik::ui::test {
namespace {

constexpr std::uint32_t kRed = 0xFFFF0000;
constexpr std::uint32_t kBlue = 0xFF0000FF;
constexpr std::uint32_t kGreen = 0xFF00FF00;
constexpr std::uint32_t kBlack = 0xFF000000;

drawbot::ColorRGBA ColorOf(std::uint32_t inPixel) {
  return drawbot::ColorRGBA(((inPixel >> 16) & 0xFF) / 255.0f, ((inPixel >> 8) & 0xFF) / 255.0f,
                            (inPixel & 0xFF) / 255.0f, ((inPixel >> 24) & 0xFF) / 255.0f);
}

class HeadlessPaintTest : public HeadlessFixture {
 protected:
  // Paints fill the whole client area with the window's colour through the
  // drawing supplier, clipped by the update region; each paint records its
  // update bounds and whether a probe point was inside the update region.
  void PaintWindowsInColours() {
    mHandler = [this](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
      if (inMessage.message != kOSMsgPaint) return std::nullopt;
      const OS_PaintContext context = mLayer.BeginPaint(inMessage.window);
      mUpdateBounds.push_back(context.updateBounds);
      OS_RegionHandle probe = mLayer.CreateRegion(mProbe);
      mProbeInside.push_back(mLayer.IntersectRegions(probe, context.updateRegion));
      mLayer.DestroyRegion(probe);
      const drawbot::SupplierInterface* supplier = mLayer.GetDrawSupplier();
      {
        drawbot::OSSurfaceP surface(supplier, context.target, context.updateRegion);
        drawbot::BrushP brush(supplier, ColorOf(mColours[inMessage.window]));
        drawbot::PathP path(supplier);
        path->AddRect(mLayer.GetClientRect(inMessage.window));
        surface->FillPath(*brush, *path, drawbot::kFillWinding);
        surface->Flush();
      }
      mLayer.EndPaint(inMessage.window, context);
      return 0;
    };
  }

  std::map<OS_WindowHandle, std::uint32_t> mColours;
  std::vector<OS_Rect> mUpdateBounds;
  std::vector<bool> mProbeInside;
  OS_Rect mProbe = OS_Rect(0, 0, 1, 1);
};

// ---- damage and paint messages ----

TEST_F(HeadlessPaintTest, DamageIsMergedIntoOnePaintWithTheUnionRegion) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(0, 0, 100, 100));
  mColours[window] = kRed;
  PaintWindowsInColours();
  mSystem.Pump();
  Clear();
  mUpdateBounds.clear();
  mProbeInside.clear();
  const OS_Rect first(10, 10, 10, 10);
  const OS_Rect second(50, 60, 10, 10);
  mLayer.InvalidateRect(window, &first);
  mLayer.InvalidateRect(window, &second);
  mProbe = OS_Rect(30, 30, 1, 1);  // inside the bounds, outside both rectangles
  mSystem.Pump();
  ASSERT_EQ(Messages(kOSMsgPaint).size(), 1u);
  ASSERT_EQ(mUpdateBounds.size(), 1u);
  EXPECT_EQ(mUpdateBounds[0], OS_Rect(10, 10, 50, 60));
  EXPECT_FALSE(mProbeInside[0]);
}

TEST_F(HeadlessPaintTest, PaintsWaitUntilTheQueueIsOtherwiseEmptyAndParentsPaintBeforeTheirChildren) {
  const OS_WindowHandle parent = MakeWindow(OS_Rect(0, 0, 100, 100));
  const OS_WindowHandle child = MakeChild(parent, OS_Rect(10, 10, 20, 20));
  mSystem.Pump();
  Clear();
  mLayer.InvalidateRect(child, nullptr);
  mLayer.InvalidateRect(parent, nullptr);
  mLayer.PostMessage(parent, kOSMsgCommand, 1, 0);
  mLayer.PostMessage(parent, kOSMsgCommand, 2, 0);
  mSystem.Pump();
  EXPECT_THAT(NumbersOf(parent), ::testing::ElementsAre(kOSMsgCommand, kOSMsgCommand));
  ASSERT_EQ(mMessages.size(), 4u);
  EXPECT_EQ(mMessages[2].message, kOSMsgPaint);
  EXPECT_EQ(mMessages[2].window, parent);
  EXPECT_EQ(mMessages[3].message, kOSMsgPaint);
  EXPECT_EQ(mMessages[3].window, child);
}

TEST_F(HeadlessPaintTest, AWindowThatDoesNotPaintIsNotAskedAgainAndAgain) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(0, 0, 100, 100));
  mHandler = [](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message == kOSMsgPaint) return 0;  // neither begins nor ends
    return std::nullopt;
  };
  mSystem.Pump();
  mSystem.Pump();
  EXPECT_EQ(Messages(kOSMsgPaint, window).size(), 1u);
}

TEST_F(HeadlessPaintTest, HiddenWindowsKeepTheirDamageUntilShown) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(0, 0, 100, 100), 0);
  mLayer.InvalidateRect(window, nullptr);
  mSystem.Pump();
  EXPECT_TRUE(Messages(kOSMsgPaint).empty());
  mLayer.ShowWindow(window, kOSShowNA);
  mSystem.Pump();
  EXPECT_EQ(Messages(kOSMsgPaint, window).size(), 1u);
}

TEST_F(HeadlessPaintTest, UpdateWindowPaintsAtOnceAndOnlyWhenDamagedInsideTheClientArea) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(0, 0, 100, 100));
  mSystem.Pump();
  Clear();
  const OS_Rect outside(200, 200, 10, 10);
  mLayer.InvalidateRect(window, &outside);
  mLayer.UpdateWindow(window);
  EXPECT_TRUE(Messages(kOSMsgPaint).empty());
  const OS_Rect rect(0, 0, 5, 5);
  mLayer.InvalidateRect(window, &rect);
  mLayer.UpdateWindow(window);
  EXPECT_EQ(Messages(kOSMsgPaint).size(), 1u);
  mSystem.Pump();
  EXPECT_EQ(Messages(kOSMsgPaint).size(), 1u);
}

// ---- surfaces and pixels ----

TEST_F(HeadlessPaintTest, PaintedPixelsAreReadBackAndKeptAcrossPartialPaints) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(0, 0, 40, 30));
  mColours[window] = kRed;
  PaintWindowsInColours();
  mSystem.Pump();
  HeadlessPixels pixels = mSystem.ReadWindowPixels(window);
  ASSERT_EQ(pixels.width, 40);
  ASSERT_EQ(pixels.height, 30);
  EXPECT_EQ(pixels.At(0, 0), kRed);
  EXPECT_EQ(pixels.At(39, 29), kRed);

  mColours[window] = kBlue;
  const OS_Rect corner(0, 0, 10, 10);
  mLayer.InvalidateRect(window, &corner);
  mSystem.Pump();
  pixels = mSystem.ReadWindowPixels(window);
  EXPECT_EQ(pixels.At(5, 5), kBlue);
  EXPECT_EQ(pixels.At(20, 20), kRed);  // outside the update region: what was there stays
}

TEST_F(HeadlessPaintTest, TheSurfaceFollowsTheWindowSizeKeepingItsPixelsAndAResizeDamagesItAll) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(0, 0, 40, 30));
  mColours[window] = kGreen;
  PaintWindowsInColours();
  mSystem.Pump();
  mLayer.SetWindowPos(window, 0, OS_Rect(0, 0, 60, 50), kOSPosNoMove | kOSPosNoZOrder | kOSPosNoRedraw);
  const HeadlessPixels pixels = mSystem.ReadWindowPixels(window);
  EXPECT_EQ(pixels.width, 60);
  EXPECT_EQ(pixels.height, 50);
  EXPECT_EQ(pixels.At(10, 10), kGreen);
  EXPECT_EQ(pixels.At(50, 40), 0u);  // new area, not painted yet
  mUpdateBounds.clear();
  mLayer.SetWindowPos(window, 0, OS_Rect(0, 0, 70, 55), kOSPosNoMove | kOSPosNoZOrder);
  mSystem.Pump();
  ASSERT_EQ(mUpdateBounds.size(), 1u);
  EXPECT_EQ(mUpdateBounds[0], OS_Rect(0, 0, 70, 55));
}

TEST_F(HeadlessPaintTest, PNGFilesAreWrittenForAWindowAndForTheScreen) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(0, 0, 16, 16));
  mColours[window] = kRed;
  PaintWindowsInColours();
  mSystem.Pump();
  const std::string path = std::string(NORVIK_TEST_OUTPUT_DIR) + "/headless_window.png";
  std::filesystem::create_directories(NORVIK_TEST_OUTPUT_DIR);
  std::remove(path.c_str());
  ASSERT_TRUE(mSystem.WriteWindowPNG(window, path));
  std::ifstream file(path, std::ios::binary);
  char signature[4] = {};
  file.read(signature, 4);
  EXPECT_EQ(std::string(signature + 1, 3), "PNG");
  EXPECT_TRUE(mSystem.WriteScreenPNG(std::string(NORVIK_TEST_OUTPUT_DIR) + "/headless_screen.png"));
  EXPECT_FALSE(mSystem.WriteWindowPNG(window, "/nonexistent-directory/x.png"));
}

// ---- the screen ----

TEST_F(HeadlessPaintTest, TheScreenShowsWindowsInZOrder) {
  mSystem.SetMonitors({OS_Monitor{OS_Rect(0, 0, 200, 200), OS_Rect(0, 0, 200, 200)}});
  const OS_WindowHandle red = MakeWindow(OS_Rect(10, 10, 100, 100));
  const OS_WindowHandle blue = MakeWindow(OS_Rect(60, 60, 100, 100));
  mColours[red] = kRed;
  mColours[blue] = kBlue;
  PaintWindowsInColours();
  mSystem.Pump();
  HeadlessPixels screen = mSystem.ReadScreenPixels();
  ASSERT_EQ(screen.width, 200);
  EXPECT_EQ(screen.At(5, 5), kBlack);
  EXPECT_EQ(screen.At(20, 20), kRed);
  EXPECT_EQ(screen.At(80, 80), kBlue);
  EXPECT_EQ(screen.At(150, 150), kBlue);
  mLayer.SetActiveWindow(red);
  screen = mSystem.ReadScreenPixels();
  EXPECT_EQ(screen.At(80, 80), kRed);
  mLayer.ShowWindow(red, kOSShowHide);
  screen = mSystem.ReadScreenPixels();
  EXPECT_EQ(screen.At(20, 20), kBlack);
  EXPECT_EQ(screen.At(80, 80), kBlue);
}

TEST_F(HeadlessPaintTest, ChildrenAreCompositedOverTheirParentAndClippedToIt) {
  mSystem.SetMonitors({OS_Monitor{OS_Rect(0, 0, 200, 200), OS_Rect(0, 0, 200, 200)}});
  const OS_WindowHandle parent = MakeWindow(OS_Rect(10, 10, 100, 100));
  const OS_WindowHandle child = MakeChild(parent, OS_Rect(80, 80, 50, 50));
  mColours[parent] = kRed;
  mColours[child] = kGreen;
  PaintWindowsInColours();
  mSystem.Pump();
  const HeadlessPixels screen = mSystem.ReadScreenPixels();
  EXPECT_EQ(screen.At(50, 50), kRed);
  EXPECT_EQ(screen.At(100, 100), kGreen);
  EXPECT_EQ(screen.At(120, 120), kBlack);  // the child's part outside its parent
}

TEST_F(HeadlessPaintTest, LayeredWindowsAreCompositedWithTheirOpacityAndColourKey) {
  mSystem.SetMonitors({OS_Monitor{OS_Rect(0, 0, 200, 200), OS_Rect(0, 0, 200, 200)}});
  const OS_WindowHandle back = MakeWindow(OS_Rect(0, 0, 200, 200));
  const OS_WindowHandle veil = MakeWindow(OS_Rect(0, 0, 100, 100), kOSStyleVisible, kOSExStyleLayered);
  const OS_WindowHandle keyed = MakeWindow(OS_Rect(100, 100, 100, 100), kOSStyleVisible, kOSExStyleLayered);
  mColours[back] = kRed;
  mColours[veil] = kBlue;
  mColours[keyed] = kGreen;
  PaintWindowsInColours();
  mSystem.Pump();
  mLayer.SetLayeredAttributes(veil, 0, 128, kOSLayeredAlpha);
  mLayer.SetLayeredAttributes(keyed, 0x0000FF00, 0, kOSLayeredColorKey);  // green as 0x00BBGGRR
  const HeadlessPixels screen = mSystem.ReadScreenPixels();
  const std::uint32_t blended = screen.At(50, 50);
  EXPECT_NEAR(static_cast<int>((blended >> 16) & 0xFF), 127, 2);
  EXPECT_NEAR(static_cast<int>(blended & 0xFF), 128, 2);
  EXPECT_EQ(screen.At(150, 150), kRed);  // the key colour lets the back window show
}

// ---- regions ----

TEST_F(HeadlessPaintTest, RegionsIntersectAndReportTheirBounds) {
  OS_RegionHandle region = mLayer.CreateRegion(OS_Rect(0, 0, 100, 100));
  EXPECT_FALSE(mLayer.IsRegionEmpty(region));
  EXPECT_TRUE(mLayer.IntersectRegion(region, OS_Rect(50, 40, 100, 100)));
  EXPECT_EQ(mLayer.GetRegionBounds(region), OS_Rect(50, 40, 50, 60));
  OS_RegionHandle other = mLayer.CreateRegion(OS_Rect(0, 0, 10, 10));
  EXPECT_FALSE(mLayer.IntersectRegions(region, other));
  EXPECT_TRUE(mLayer.IsRegionEmpty(region));
  OS_RegionHandle empty = mLayer.CreateRegion(OS_Rect(5, 5, 0, 10));
  EXPECT_TRUE(mLayer.IsRegionEmpty(empty));
  mLayer.DestroyRegion(region);
  mLayer.DestroyRegion(other);
  mLayer.DestroyRegion(empty);
}

}  // namespace
}  // namespace norvik::ui::test
