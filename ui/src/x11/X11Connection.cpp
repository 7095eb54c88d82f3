// The connection to the X server: opening it, atoms, the visual used for
// painting, and the reporting of X errors.
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
  WatchXSettings();
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

}  // namespace norvik::ui::x11
