// Showing cursors on the headless system: the platform's cursors by number,
// the toolkit's drawn cursors with the pixels and hot spot of their
// pictures, registered pictures made on first display, and disposal.
#include <filesystem>
#include <string>

#include <gtest/gtest.h>

#include "drawbot/DrawbotWrappers.h"
#include "support/drawbot/PixelCompare.h"
#include "support/utility/ResourcePixels.h"
#include "tarsel/ThrowError.h"
#include "ui/HeadlessWindowSystem.h"
#include "ui/OS_WindowConstants.h"
#include "utility/CursorUtils.h"
#include "utility/OS_ResourceManager.h"

namespace norvik::utility {
namespace {

using drawbot::testing::PixelImage;

struct CursorPicture {
  std::vector<std::uint32_t> pixels;
  ui::OS_Point size{0, 0};
  ui::OS_Point hotSpot{0, 0};
};

class CursorDisplay : public ::testing::Test {
 protected:
  void SetUp() override { mSystem.Install(); }

  ui::OS_CursorHandle InForce() { return mSystem.GetLayer().GetCursor(); }

  bool PictureOf(ui::OS_CursorHandle inCursor, CursorPicture& outPicture) {
    return mSystem.GetCursorImage(inCursor, outPicture.pixels, outPicture.size, outPicture.hotSpot);
  }

  // The pixels of a library picture, decoded and drawn the ordinary way.
  PixelImage Decoded(const char16_t* inName) {
    return testing::DecodedResourcePNG(mResources, inName);
  }

  ui::HeadlessWindowSystem mSystem;
  OS_ResourceManager mResources;
};

TEST_F(CursorDisplay, PlatformNumbersShowThePlatformsCursorsAndNumbersWithoutAPictureTheArrow) {
  const std::pair<int, int> expected[] = {{0, ui::kOSCursorArrow}, {2, ui::kOSCursorWait}, {3, ui::kOSCursorCross},
                                          {4, ui::kOSCursorNo},    {5, ui::kOSCursorArrow}, {6, ui::kOSCursorArrow},
                                          {7, ui::kOSCursorArrow}, {8, ui::kOSCursorArrow}, {9, ui::kOSCursorArrow}, {28, ui::kOSCursorArrow},
                                          {1000, ui::kOSCursorArrow}};
  for (auto const& [id, system] : expected) {
    SCOPED_TRACE(id);
    mResources.DisplayCursor(id == 2 ? 3 : 2);  // another cursor first, so each check sees a change
    mResources.DisplayCursor(id);
    EXPECT_EQ(InForce(), mSystem.GetLayer().LoadSystemCursor(system));
    if (id > 6) {
      EXPECT_EQ(mResources.FindCursorInfo(id), nullptr);
    }
  }
}

TEST_F(CursorDisplay, ADrawnCursorCarriesThePixelsAndHotSpotOfItsPicture) {
  mResources.DisplayCursor(26);
  CursorPicture picture;
  ASSERT_TRUE(PictureOf(InForce(), picture));
  const PixelImage expected = Decoded(u"CursorID-26");
  EXPECT_EQ(picture.size.x, expected.width);
  EXPECT_EQ(picture.size.y, expected.height);
  EXPECT_EQ(picture.pixels, expected.pixels);
  EXPECT_EQ(picture.hotSpot.x, 0);
  EXPECT_EQ(picture.hotSpot.y, 0);
  // The tip of the arrow is drawn, and the far corner is clear.
  EXPECT_NE(picture.pixels.front() >> 24, 0u);
  EXPECT_EQ(picture.pixels[static_cast<std::size_t>(picture.size.x) - 1] >> 24, 0u);
}

TEST_F(CursorDisplay, ARegisteredPictureIsMadeOnlyWhenFirstShown) {
  const std::string path = std::string(NORVIK_TEST_OUTPUT_DIR) + "/cursor-3x2.png";
  std::filesystem::create_directories(NORVIK_TEST_OUTPUT_DIR);
  const PixelImage picture{3, 2, {0xff0000ffu, 0x80800000u, 0x00000000u, 0xffffffffu, 0xff000000u, 0x40004000u}};
  ASSERT_TRUE(drawbot::testing::SavePNG(picture, path));

  mResources.DisplayCursor(0);
  const ui::OS_CursorHandle before = InForce();
  mResources.MakeCursorFromPNG(40, tarsel::utility::UTF8to16(path), 2, 1, ui::LoadByPolicy::kByPath);
  EXPECT_EQ(InForce(), before);
  ASSERT_NE(mResources.FindCursorInfo(40), nullptr);
  EXPECT_FALSE(mResources.FindCursorInfo(40)->loaded);

  mResources.DisplayCursor(40);
  CursorPicture shown;
  ASSERT_TRUE(PictureOf(InForce(), shown));
  EXPECT_EQ(shown.pixels, picture.pixels);
  EXPECT_EQ(shown.hotSpot.x, 2);
  EXPECT_EQ(shown.hotSpot.y, 1);
}

TEST_F(CursorDisplay, AMissingRegisteredPictureRaisesAndLeavesTheCursorInForce) {
  mResources.DisplayCursor(2);
  const ui::OS_CursorHandle before = InForce();
  mResources.MakeCursorFromPNG(42, u"NoSuchCursorPicture", 0, 0, ui::LoadByPolicy::kByResource);
  try {
    mResources.DisplayCursor(42);
    ADD_FAILURE() << "no error";
  } catch (tarsel::config::Exception const& e) {
    EXPECT_STREQ(e.what(), "Unable to access resource 'NoSuchCursorPicture' (type png)");
  }
  EXPECT_EQ(InForce(), before);
  mResources.MakeCursorFromPNG(43, u"/no/such/dir/cursor.png", 0, 0, ui::LoadByPolicy::kByPath);
  EXPECT_THROW(mResources.DisplayCursor(43), tarsel::config::Exception);
  EXPECT_EQ(InForce(), before);
}

TEST_F(CursorDisplay, ACursorFromAnImageKeepsItsHotSpotInsideThePicture) {
  const PixelImage decoded = Decoded(u"CursorID-27");
  std::vector<char> bytes;
  mResources.GetBinary(u"CursorID-27", u"png", &bytes);
  drawbot::FileImageP image(drawbot::NewOSSupplier(), drawbot::kImageFileTypePNG, bytes.data(),
                            static_cast<unsigned long>(bytes.size()));
  const ui::OS_CursorHandle inside = DisplayCursorFromImage(image.GetPtr(), 4, 9);
  EXPECT_EQ(InForce(), inside);
  CursorPicture picture;
  ASSERT_TRUE(PictureOf(inside, picture));
  EXPECT_EQ(picture.pixels, decoded.pixels);
  EXPECT_EQ(picture.hotSpot.x, 4);
  EXPECT_EQ(picture.hotSpot.y, 9);

  const ui::OS_CursorHandle outside = GetCursorFromImage(image.GetPtr(), 500, -3);
  ASSERT_TRUE(PictureOf(outside, picture));
  EXPECT_EQ(picture.hotSpot.x, decoded.width - 1);
  EXPECT_EQ(picture.hotSpot.y, 0);
  DisposeCursor(outside);
  EXPECT_FALSE(PictureOf(outside, picture));
  EXPECT_EQ(GetCursorFromImage(nullptr, 0, 0), 0u);
}

TEST(CursorWithoutPlatform, NothingIsShownAndNothingFails) {
  ASSERT_EQ(ui::GetNativeLayer(), nullptr);
  OS_ResourceManager resources;
  EXPECT_NO_THROW(resources.DisplayCursor(26));
  EXPECT_NO_THROW(resources.DisplayCursor(0));
  EXPECT_EQ(resources.FindCursorInfo(26), nullptr);
}

}  // namespace
}  // namespace norvik::utility
