// The library's numbered cursors on a real X server: displaying one through
// the resource manager puts its picture and hot spot on the window under the
// pointer, as the server reports through XFixes.
#include <xcb/xcb.h>
#include <xcb/xfixes.h>

#include <cstdlib>
#include <vector>

#include "drawbot/DrawbotWrappers.h"
#include "support/drawbot/PixelCompare.h"
#include "utility/CursorUtils.h"
#include "utility/OS_ResourceManager.h"
#include "x11/X11Fixture.h"

namespace norvik::test {
namespace {

using namespace norvik::ui;

// The cursor the server shows now, as XFixes reports it.
struct ServerCursor {
  int width = 0;
  int height = 0;
  int hotX = 0;
  int hotY = 0;
  std::vector<std::uint32_t> pixels;  // premultiplied ARGB
};

class X11NumberedCursors : public X11Fixture {
 protected:
  void SetUp() override {
    X11Fixture::SetUp();
    if (IsSkipped() || HasFatalFailure()) return;
    xcb_xfixes_query_version_reply_t* version =
        xcb_xfixes_query_version_reply(mUser, xcb_xfixes_query_version(mUser, 4, 0), nullptr);
    ASSERT_NE(version, nullptr) << "the X server offers no XFixes: the cursor in force cannot be read back";
    std::free(version);
    // The window answers no cursor question of its own, so only the
    // resource manager sets the cursor.
    mHandler = [](const RecordedMessage& m) { return m.message == kOSMsgSetCursor; };
    SetNativeLayer(mLayer.get());
  }

  void TearDown() override {
    SetNativeLayer(nullptr);
    X11Fixture::TearDown();
  }

  ServerCursor Read() {
    ServerCursor cursor;
    xcb_xfixes_get_cursor_image_reply_t* image =
        xcb_xfixes_get_cursor_image_reply(mUser, xcb_xfixes_get_cursor_image(mUser), nullptr);
    if (!image) return cursor;
    cursor.width = image->width;
    cursor.height = image->height;
    cursor.hotX = image->xhot;
    cursor.hotY = image->yhot;
    const std::uint32_t* data = xcb_xfixes_get_cursor_image_cursor_image(image);
    cursor.pixels.assign(data, data + xcb_xfixes_get_cursor_image_cursor_image_length(image));
    std::free(image);
    return cursor;
  }

  // The artwork of a numbered cursor, decoded the ordinary way.
  drawbot::testing::PixelImage Artwork(int inID) {
    UTF16String png, data;
    utility::GetNativeCursorResourceNames(inID, png, data);
    std::vector<char> bytes;
    mResources.GetBinary(png, u"png", &bytes);
    drawbot::FileImageP probe(drawbot::NewOSSupplier(), drawbot::kImageFileTypePNG, bytes.data(),
                              static_cast<unsigned long>(bytes.size()));
    drawbot::testing::PixelCanvas canvas(static_cast<int>(probe->GetWidth()), static_cast<int>(probe->GetHeight()));
    drawbot::FileImageP image(canvas.GetSupplier(), drawbot::kImageFileTypePNG, bytes.data(),
                              static_cast<unsigned long>(bytes.size()));
    canvas.GetSurface()->DrawImage(*image, tarsel::geom::PointT<float>(0, 0), 1);
    return canvas.Snapshot();
  }

  // Puts the pointer inside a window of ours.
  void PointerIntoWindow() {
    MakeShownWindow(OS_Rect(100, 100, 200, 150), 0x406080);
    MovePointer(180, 160);
    ASSERT_TRUE(WaitFor([&] { return Received(kOSMsgMouseMove); })) << "the pointer never reached the window";
  }

  utility::OS_ResourceManager mResources;
};

TEST_F(X11NumberedCursors, DisplayingANumberedCursorShowsItsPictureAndHotSpot) {
  PointerIntoWindow();
  const ServerCursor before = Read();
  for (int id : {utility::kCursorClosedHand, utility::kCursorEyedropper, utility::kCursorTextInsert}) {
    SCOPED_TRACE(id);
    mResources.DisplayCursor(id);
    const utility::OS_ResourceManager::BigCursorInfo* info = mResources.FindCursorInfo(id);
    ASSERT_NE(info, nullptr);
    const drawbot::testing::PixelImage artwork = Artwork(id);
    ServerCursor shown;
    EXPECT_TRUE(WaitFor([&] {
      shown = Read();
      return shown.width == artwork.width && shown.hotX == info->hotX && shown.hotY == info->hotY;
    })) << "the server shows a " << shown.width << "x" << shown.height << " cursor with hot spot (" << shown.hotX
        << ", " << shown.hotY << ")";
    EXPECT_EQ(shown.height, artwork.height);
    EXPECT_EQ(shown.pixels, artwork.pixels);
    EXPECT_NE(shown.pixels, before.pixels);
  }
}

}  // namespace
}  // namespace norvik::test
