// Cursors: the desktop's themed cursors by name through xcb-cursor, and cursors
// made from pixels as render cursors.
#include <xcb/render.h>
#include <xcb/xcb_cursor.h>

#include <cstdlib>
#include <cstring>

#include "ui/src/x11/OS_NativeLayer_X11.h"

namespace norvik::ui::x11 {
namespace {

const char* CursorName(int inSystemCursor) {
  switch (inSystemCursor) {
    case kOSCursorIBeam: return "xterm";
    case kOSCursorWait: return "watch";
    case kOSCursorCross: return "crosshair";
    case kOSCursorUpArrow: return "sb_up_arrow";
    case kOSCursorSizeNWSE: return "bottom_right_corner";
    case kOSCursorSizeNESW: return "bottom_left_corner";
    case kOSCursorSizeWE: return "sb_h_double_arrow";
    case kOSCursorSizeNS: return "sb_v_double_arrow";
    case kOSCursorSizeAll: return "fleur";
    case kOSCursorNo: return "crossed_circle";
    case kOSCursorHand: return "hand2";
    case kOSCursorAppStarting: return "left_ptr_watch";
    case kOSCursorHelp: return "question_arrow";
    default: return "left_ptr";
  }
}

xcb_render_pictformat_t FindArgbFormat(xcb_connection_t* inConnection) {
  xcb_render_query_pict_formats_reply_t* reply =
      xcb_render_query_pict_formats_reply(inConnection, xcb_render_query_pict_formats(inConnection), nullptr);
  if (!reply) return 0;
  xcb_render_pictformat_t found = 0;
  for (auto it = xcb_render_query_pict_formats_formats_iterator(reply); it.rem; xcb_render_pictforminfo_next(&it)) {
    const xcb_render_pictforminfo_t* f = it.data;
    if (f->type == XCB_RENDER_PICT_TYPE_DIRECT && f->depth == 32 && f->direct.alpha_shift == 24 &&
        f->direct.alpha_mask == 0xff && f->direct.red_shift == 16 && f->direct.green_shift == 8 &&
        f->direct.blue_shift == 0) {
      found = f->id;
      break;
    }
  }
  std::free(reply);
  return found;
}

}  // namespace

OS_CursorHandle OS_NativeLayer_X11::LoadSystemCursor(int inSystemCursor) {
  auto it = mSystemCursors.find(inSystemCursor);
  if (it != mSystemCursors.end()) return it->second;
  xcb_cursor_t cursor = XCB_NONE;
  if (mCursorContext)
    cursor = xcb_cursor_load_cursor(static_cast<xcb_cursor_context_t*>(mCursorContext), CursorName(inSystemCursor));
  mSystemCursors[inSystemCursor] = cursor;
  return cursor;
}

OS_CursorHandle OS_NativeLayer_X11::CreateCursorFromPixels(const std::uint32_t* inPixels, int inWidth, int inHeight,
                                                           int inHotX, int inHotY) {
  if (!inPixels || inWidth <= 0 || inHeight <= 0 || inWidth > 256 || inHeight > 256) return 0;
  const xcb_render_pictformat_t format = FindArgbFormat(mConnection);
  if (!format) return 0;
  xcb_pixmap_t pixmap = xcb_generate_id(mConnection);
  xcb_create_pixmap(mConnection, 32, pixmap, mScreen->root, static_cast<uint16_t>(inWidth),
                    static_cast<uint16_t>(inHeight));
  xcb_gcontext_t gc = xcb_generate_id(mConnection);
  xcb_create_gc(mConnection, gc, pixmap, 0, nullptr);
  xcb_put_image(mConnection, XCB_IMAGE_FORMAT_Z_PIXMAP, pixmap, gc, static_cast<uint16_t>(inWidth),
                static_cast<uint16_t>(inHeight), 0, 0, 0, 32,
                static_cast<std::uint32_t>(inWidth * inHeight * 4), reinterpret_cast<const std::uint8_t*>(inPixels));
  xcb_render_picture_t picture = xcb_generate_id(mConnection);
  xcb_render_create_picture(mConnection, picture, pixmap, format, 0, nullptr);
  xcb_cursor_t cursor = xcb_generate_id(mConnection);
  xcb_render_create_cursor(mConnection, cursor, picture, static_cast<uint16_t>(inHotX),
                           static_cast<uint16_t>(inHotY));
  xcb_render_free_picture(mConnection, picture);
  xcb_free_gc(mConnection, gc);
  xcb_free_pixmap(mConnection, pixmap);
  xcb_flush(mConnection);
  return cursor;
}

void OS_NativeLayer_X11::DestroyCursor(OS_CursorHandle inCursor) {
  for (const auto& [id, cursor] : mSystemCursors)
    if (cursor == inCursor) return;  // system cursors live as long as the layer
  if (inCursor) xcb_free_cursor(mConnection, static_cast<xcb_cursor_t>(inCursor));
}

// X keeps a cursor per window; the cursor in force is set on the window under
// the pointer, whose children inherit it.
void OS_NativeLayer_X11::SetCursor(OS_CursorHandle inCursor) {
  mCursor = inCursor;
  const OS_WindowHandle target = mCapture ? mCapture : mPointerWindow;
  X11Window* window = Find(target);
  if (!window || window->cursor == inCursor) return;
  window->cursor = inCursor;
  const std::uint32_t value = static_cast<std::uint32_t>(inCursor);
  xcb_change_window_attributes(mConnection, window->id, XCB_CW_CURSOR, &value);
  xcb_flush(mConnection);
}

}  // namespace norvik::ui::x11
