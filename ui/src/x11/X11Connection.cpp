// The connection to the X server: opening it, atoms, the visual used for
// painting, XSETTINGS, and the reporting of X errors.
#include <fcntl.h>
#include <unistd.h>

#include <cstdlib>
#include <cstring>

#include <xcb/xcb_cursor.h>

#include "drawbot/SupplierInterface.h"
#include "tarsel/ErrorManager.h"
#include "tarsel/ThrowError.h"
#include "ui/src/x11/OS_NativeLayer_X11.h"
#include "ui/src/x11/X11GLContexts.h"
#include "ui/src/x11/X11Keyboard.h"

namespace norvik::ui::x11 {

X11Window::~X11Window() {
  if (damage) cairo_region_destroy(damage);
  if (backBuffer) cairo_surface_destroy(backBuffer);
}

namespace {
void DestroySupplier(drawbot::SupplierInterface* inSupplier) {
  if (inSupplier) inSupplier->Release();
}
}  // namespace

OS_NativeLayer_X11::OS_NativeLayer_X11(const char* inDisplay)
    : mStart(std::chrono::steady_clock::now()), mSupplier(nullptr, &DestroySupplier),
      mDisplayName(inDisplay ? inDisplay : "") {
  Connect(inDisplay);
  FindVisual();
  SetUpKeyboard();
  ReadXSettings();
  xcb_cursor_context_t* context = nullptr;
  if (xcb_cursor_context_new(mConnection, mScreen, &context) == 0) mCursorContext = context;
  if (pipe2(mWakePipe, O_CLOEXEC | O_NONBLOCK) != 0) mWakePipe[0] = mWakePipe[1] = -1;
  mExecutor = tarsel::threads::GetMainThreadExecutor();
  if (mExecutor && mWakePipe[1] >= 0) {
    int fd = mWakePipe[1];
    mExecutor->SetWakeUpFunction([fd] {
      char c = 1;
      ssize_t ignored = write(fd, &c, 1);
      (void)ignored;
    });
  }
  drawbot::SupplierInterface* supplier = drawbot::NewOSSupplier();
  if (supplier) supplier->AddRef();
  mSupplier.reset(supplier);
}

OS_NativeLayer_X11::~OS_NativeLayer_X11() {
  if (mExecutor) mExecutor->SetWakeUpFunction(nullptr);
  std::vector<OS_WindowHandle> tops;
  for (auto& [handle, window] : mWindows)
    if (window->parent == 0) tops.push_back(handle);
  for (OS_WindowHandle h : tops)
    if (Find(h)) DestroyWindow(h);
  for (auto& [id, cursor] : mSystemCursors) xcb_free_cursor(mConnection, static_cast<xcb_cursor_t>(cursor));
  if (mCursorContext) xcb_cursor_context_free(static_cast<xcb_cursor_context_t*>(mCursorContext));
  mLayout.reset();
  if (mComposeState) xkb_compose_state_unref(mComposeState);
  if (mComposeTable) xkb_compose_table_unref(mComposeTable);
  if (mXkbState) xkb_state_unref(mXkbState);
  if (mKeymap) xkb_keymap_unref(mKeymap);
  if (mXkbContext) xkb_context_unref(mXkbContext);
  for (int fd : mWakePipe)
    if (fd >= 0) close(fd);
  if (mConnection) xcb_disconnect(mConnection);
}

void OS_NativeLayer_X11::Connect(const char* inDisplay) {
  int screenNumber = 0;
  mConnection = xcb_connect(inDisplay, &screenNumber);
  if (!mConnection || xcb_connection_has_error(mConnection)) {
    if (mConnection) xcb_disconnect(mConnection);
    mConnection = nullptr;
    const char* name = inDisplay ? inDisplay : std::getenv("DISPLAY");
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                               "$$$/norvik/ui/x11/Error/NoDisplay=Cannot open the X display ^0.",
                               tarsel::config::kErrorGroupResources, 2, false, name ? name : "(none)");
  }
  xcb_screen_iterator_t it = xcb_setup_roots_iterator(xcb_get_setup(mConnection));
  for (int i = 0; i < screenNumber && it.rem; ++i) xcb_screen_next(&it);
  mScreen = it.data;
}

void OS_NativeLayer_X11::FindVisual() {
  for (xcb_depth_iterator_t d = xcb_screen_allowed_depths_iterator(mScreen); d.rem; xcb_depth_next(&d)) {
    for (xcb_visualtype_iterator_t v = xcb_depth_visuals_iterator(d.data); v.rem; xcb_visualtype_next(&v)) {
      if (v.data->visual_id == mScreen->root_visual) {
        mVisual = v.data;
        return;
      }
    }
  }
}

xcb_atom_t OS_NativeLayer_X11::Atom(const char* inName) {
  auto it = mAtoms.find(inName);
  if (it != mAtoms.end()) return it->second;
  xcb_intern_atom_reply_t* reply = xcb_intern_atom_reply(
      mConnection, xcb_intern_atom(mConnection, 0, static_cast<uint16_t>(std::strlen(inName)), inName), nullptr);
  xcb_atom_t atom = reply ? reply->atom : xcb_atom_t(XCB_ATOM_NONE);
  std::free(reply);
  mAtoms[inName] = atom;
  return atom;
}

void OS_NativeLayer_X11::ReportXError(const xcb_generic_error_t* inError, const char* inWhat) {
  tarsel::config::ErrorReport report;
  report.mLevel = tarsel::config::ErrorLevel::kWarning;
  report.mKeyPath = "norvik/ui/x11/Error/Protocol";
  report.mMessage = tarsel::config::FormatErrorMessage(
      "$$$/norvik/ui/x11/Error/Protocol=The X server refused a request (^0: error ^1, major code ^2).", inWhat,
      static_cast<int>(inError->error_code), static_cast<int>(inError->major_code));
  report.mGroup = tarsel::config::kErrorGroupResources;
  report.mCode = static_cast<int>(inError->error_code);
  tarsel::config::ErrorManager::Get(true)->ReportError(report);
}

// XSETTINGS: the settings manager of the desktop, when one runs, owns the
// selection _XSETTINGS_S<screen> and keeps its settings in a property of the
// owner window. Only the double-click time is read.
void OS_NativeLayer_X11::ReadXSettings() {
  xcb_get_selection_owner_reply_t* owner = xcb_get_selection_owner_reply(
      mConnection, xcb_get_selection_owner(mConnection, Atom("_XSETTINGS_S0")), nullptr);
  xcb_window_t window = owner ? owner->owner : xcb_window_t(XCB_WINDOW_NONE);
  std::free(owner);
  if (window == XCB_WINDOW_NONE) return;
  xcb_atom_t settings = Atom("_XSETTINGS_SETTINGS");
  xcb_get_property_reply_t* reply = xcb_get_property_reply(
      mConnection, xcb_get_property(mConnection, 0, window, settings, settings, 0, 16384), nullptr);
  if (!reply) return;
  const auto* data = static_cast<const std::uint8_t*>(xcb_get_property_value(reply));
  std::size_t size = static_cast<std::size_t>(xcb_get_property_value_length(reply));
  if (size >= 12 && data[0] == 0) {  // little-endian data only
    auto read32 = [&](std::size_t at) {
      return static_cast<std::uint32_t>(data[at] | (data[at + 1] << 8) | (data[at + 2] << 16) |
                                        (static_cast<std::uint32_t>(data[at + 3]) << 24));
    };
    std::uint32_t count = read32(8);
    std::size_t at = 12;
    for (std::uint32_t i = 0; i < count && at + 4 <= size; ++i) {
      std::uint8_t type = data[at];
      std::size_t nameLength = static_cast<std::size_t>(data[at + 2] | (data[at + 3] << 8));
      std::size_t nameAt = at + 4;
      std::size_t padded = (nameLength + 3) & ~std::size_t(3);
      std::size_t valueAt = nameAt + padded + 4;  // the serial follows the name
      if (valueAt > size) break;
      std::string name(reinterpret_cast<const char*>(data + nameAt), nameLength);
      if (type == 0) {  // integer
        if (valueAt + 4 > size) break;
        if (name == "Net/DoubleClickTime") {
          std::uint32_t value = read32(valueAt);
          if (value > 0 && value < 5000) mDoubleClickTime = value;
        }
        at = valueAt + 4;
      } else if (type == 1) {  // string
        if (valueAt + 4 > size) break;
        std::size_t length = read32(valueAt);
        at = valueAt + 4 + ((length + 3) & ~std::size_t(3));
      } else if (type == 2) {  // colour
        at = valueAt + 8;
      } else {
        break;
      }
    }
  }
  std::free(reply);
}

}  // namespace norvik::ui::x11
