#pragma once
// Shows a gallery page in a top-level native window of any native layer
// (the X11 one or the headless one): paints the page into the window's
// paint surface, turns mouse and key messages into node events, resizes the
// page with the window, and quits the loop when the window is closed.
#include <cstdint>

#include "GalleryPage.h"
#include "ui/ModifierKeys.h"
#include "ui/OS_NativeLayer.h"

namespace norvik::gallery {

class GalleryWindow {
 public:
  // Creates and shows the window, inWidth x inHeight client pixels, titled
  // with the gallery's title. The layer must be installed.
  GalleryWindow(ui::OS_NativeLayer& inLayer, GalleryPageP inPage, long inWidth, long inHeight);
  // Destroys the window if it is still open.
  ~GalleryWindow();
  GalleryWindow(const GalleryWindow&) = delete;
  GalleryWindow& operator=(const GalleryWindow&) = delete;

  ui::OS_WindowHandle GetHandle() const { return mHandle; }
  bool IsOpen() const { return mHandle != 0; }
  GalleryPage& GetPage() const { return *mPage; }
  // Paints whatever is damaged now.
  void Update();
  // Runs the layer's loop until the window closes; answers the exit code.
  int Run();

 private:
  static std::intptr_t Procedure(ui::OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                 std::intptr_t inLParam);
  std::intptr_t Handle(unsigned inMessage, std::uintptr_t inWParam, std::intptr_t inLParam);
  void Paint();
  void MouseMessage(unsigned inMessage, std::uintptr_t inWParam, std::intptr_t inLParam);
  ui::ModifierKeys CurrentModifiers() const;
  void KeyMessage(unsigned inMessage, std::uintptr_t inWParam, std::intptr_t inLParam);

  ui::OS_NativeLayer& mLayer;
  GalleryPageP mPage;
  ui::OS_WindowHandle mHandle = 0;
  bool mTrackingLeave = false;
};

}  // namespace norvik::gallery
