// The library's numbered cursors (1 and 10 to 25) on the headless system:
// each is drawn from artwork of its own, differs from every other cursor,
// keeps its hot spot on what it draws, and is made once.
#include <algorithm>
#include <map>
#include <set>
#include <vector>

#include <gtest/gtest.h>

#include "support/drawbot/PixelCompare.h"
#include "support/utility/ResourcePixels.h"
#include "ui/HeadlessWindowSystem.h"
#include "ui/OS_WindowConstants.h"
#include "utility/CursorUtils.h"
#include "utility/OS_ResourceManager.h"

namespace norvik::utility {
namespace {

using drawbot::testing::PixelImage;

struct Shown {
  ui::OS_CursorHandle handle = 0;
  std::vector<std::uint32_t> pixels;
  ui::OS_Point size{0, 0};
  ui::OS_Point hotSpot{0, 0};

  std::uint32_t At(long inX, long inY) const {
    return pixels[static_cast<std::size_t>(inY * size.x + inX)];
  }
  bool Opaque(long inX, long inY) const {
    return inX >= 0 && inY >= 0 && inX < size.x && inY < size.y && (At(inX, inY) >> 24) != 0;
  }
};

class NativeCursors : public ::testing::Test {
 protected:
  void SetUp() override { mSystem.Install(); }

  Shown Display(int inID) {
    mResources.DisplayCursor(inID);
    Shown shown;
    shown.handle = mSystem.GetLayer().GetCursor();
    EXPECT_TRUE(mSystem.GetCursorImage(shown.handle, shown.pixels, shown.size, shown.hotSpot))
        << "cursor " << inID << " is not made from a picture";
    return shown;
  }

  PixelImage Decoded(const UTF16String& inName) {
    return testing::DecodedResourcePNG(mResources, inName);
  }

  ui::HeadlessWindowSystem mSystem;
  OS_ResourceManager mResources;
};

// The numbers with artwork are 1 and 10 to 25; each shows its own picture,
// distinct from every other cursor, with its hot spot inside the picture on or
// beside a drawn pixel.
TEST_F(NativeCursors, EachNumberShowsItsOwnPictureDistinctFromEveryOtherCursorWithItsHotSpotOnIt) {
  std::vector<int> numbers{1};
  for (int id = 10; id <= 25; ++id) numbers.push_back(id);
  EXPECT_EQ(GetNativeCursorNumbers(), numbers);
  UTF16String png13, data13;
  GetNativeCursorResourceNames(13, png13, data13);
  EXPECT_EQ(png13 + u" " + data13, u"NativeCursor-13 NativeCursorData-13");
  std::set<ui::OS_CursorHandle> handles;
  std::set<std::vector<std::uint32_t>> pictures;
  ui::OS_NativeLayer& layer = mSystem.GetLayer();
  const std::set<ui::OS_CursorHandle> platform = {
      layer.LoadSystemCursor(ui::kOSCursorArrow), layer.LoadSystemCursor(ui::kOSCursorWait),
      layer.LoadSystemCursor(ui::kOSCursorCross), layer.LoadSystemCursor(ui::kOSCursorNo)};
  for (int id : {26, 27}) pictures.insert(Display(id).pixels);
  for (int id : GetNativeCursorNumbers()) {
    SCOPED_TRACE(id);
    mResources.DisplayCursor(0);
    const Shown shown = Display(id);
    EXPECT_EQ(platform.count(shown.handle), 0u) << "not a platform cursor";
    EXPECT_TRUE(handles.insert(shown.handle).second) << "a cursor of its own";
    EXPECT_TRUE(pictures.insert(shown.pixels).second) << "a picture of its own";
    UTF16String png, data;
    GetNativeCursorResourceNames(id, png, data);
    const PixelImage artwork = Decoded(png);
    EXPECT_EQ(shown.size.x, artwork.width);
    EXPECT_EQ(shown.size.y, artwork.height);
    EXPECT_EQ(shown.pixels, artwork.pixels);
    ASSERT_TRUE(shown.hotSpot.x >= 0 && shown.hotSpot.y >= 0 && shown.hotSpot.x < shown.size.x &&
                shown.hotSpot.y < shown.size.y);
    bool drawnNearby = false;
    for (long dy = -1; dy <= 1; ++dy)
      for (long dx = -1; dx <= 1; ++dx) drawnNearby |= shown.Opaque(shown.hotSpot.x + dx, shown.hotSpot.y + dy);
    EXPECT_TRUE(drawnNearby) << "hot spot (" << shown.hotSpot.x << ", " << shown.hotSpot.y << ") points at nothing";
  }
}

TEST_F(NativeCursors, ANumberedCursorIsMadeOnceAndKeptUntilDisposed) {
  const Shown first = Display(kCursorClosedHand);
  Display(kCursorZoomIn);
  const Shown again = Display(kCursorClosedHand);
  EXPECT_EQ(again.handle, first.handle);
  ASSERT_NE(mResources.FindCursorInfo(kCursorClosedHand), nullptr);
  EXPECT_TRUE(mResources.FindCursorInfo(kCursorClosedHand)->loaded);
  mResources.DisposeCursor(kCursorClosedHand);
  std::vector<std::uint32_t> pixels;
  ui::OS_Point size, hot;
  EXPECT_FALSE(mSystem.GetCursorImage(first.handle, pixels, size, hot));
  const Shown remade = Display(kCursorClosedHand);
  EXPECT_EQ(remade.pixels, first.pixels);
}

}  // namespace
}  // namespace norvik::utility
