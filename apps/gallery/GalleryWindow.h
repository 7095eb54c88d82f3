#pragma once
// The gallery's main window: a top-level view container of the toolkit with
// the page as its one child. Everything a user does reaches the page through
// the toolkit's own window bridge (mouse, keys, capture, focus, Tab, timers,
// hover, painting); the window only makes the container a main window, lays
// the page out when the client area changes size, and ends the loop when the
// native window is closed. It works on whatever native layer is installed:
// the X11 one on a display, the headless one for screenshots and tests.
#include <functional>

#include "GalleryPage.h"
#include "ui/OS_ViewContainer.h"

namespace norvik::gallery {

class GalleryWindow;
using GalleryWindowP = boost::intrusive_ptr<GalleryWindow>;

class GalleryWindow : public ui::OS_TopLevelViewContainer {
 public:
  // Creates the window with inWidth x inHeight client pixels, titled with the
  // gallery's title, puts inPage in it, shows and activates it. A native
  // layer must be installed.
  GalleryWindow(GalleryPageP inPage, long inWidth, long inHeight);

  bool IsOpen() const { return GetHandle() != 0; }
  GalleryPage& GetPage() const { return *mPage; }
  // Runs the layer's loop until the window closes (or someone quits the
  // loop); answers the exit code. Answers 0 at once when already closed.
  int Run();
  // Called once, after the first paint of the shown window has been handed
  // to the platform.
  void SetFirstFrameFunction(std::function<void()> inF) { mFirstFrame = std::move(inF); }

  bool UI_DispatchEvent(ui::OS_Event* inEvent) override;
  void UI_SizeChanged(const RectF& inLocalRect) override;
  bool UI_Paint(ui::OS_Event* inEvent) override;
  void UI_PostClose() override;

 private:
  GalleryPageP mPage;
  std::function<void()> mFirstFrame;
};

}  // namespace norvik::gallery
