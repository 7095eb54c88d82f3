#pragma once
// The headless window system, seen from outside: it owns an in-memory native
// layer, installs it as the toolkit's platform, and drives it the way a user
// and a clock would. Tests, off-screen rendering and the gallery use it where
// no display is available.
//
// Input is injected at screen coordinates and queued as the desktop would
// queue it; nothing is delivered until the queue is pumped (Pump, the loop,
// or AdvanceClock, which pumps as it goes). The clock is virtual: it stands
// still until AdvanceClock moves it, or until an idle loop jumps it to the
// next timer.
//
// The system belongs to the UI thread. Other threads reach that thread
// through the main thread's executor (tarsel/Threads.h), whose posts wake a
// loop waiting in RunLoop; they never call the layer themselves.
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "ui/OS_NativeLayer.h"

namespace norvik::ui {

namespace headless {
class OS_NativeLayer_Headless;
}

// Mouse buttons in the toolkit's numbering.
enum HeadlessButton : int {
  kHeadlessButtonLeft = 1,
  kHeadlessButtonMiddle = 2,
  kHeadlessButtonRight = 4,
};

// Pixels read back: premultiplied ARGB, one 32-bit value a pixel, row after row.
struct HeadlessPixels {
  int width = 0;
  int height = 0;
  std::vector<std::uint32_t> pixels;

  std::uint32_t At(int inX, int inY) const {
    return pixels[static_cast<std::size_t>(inY) * static_cast<std::size_t>(width) + static_cast<std::size_t>(inX)];
  }
};

class HeadlessWindowSystem {
 public:
  // RunLoop's answer when it stopped because nothing was left to do: no
  // message, no timer, and no post from another thread within the idle
  // wait limit.
  static constexpr int kIdleExitCode = -1;

  HeadlessWindowSystem();
  // Uninstalls itself first if it is installed.
  ~HeadlessWindowSystem();
  HeadlessWindowSystem(const HeadlessWindowSystem&) = delete;
  HeadlessWindowSystem& operator=(const HeadlessWindowSystem&) = delete;

  OS_NativeLayer& GetLayer();
  // InstallNativeLayer with this system's layer; Uninstall puts back
  // whatever layer was installed before.
  void Install();
  void Uninstall();
  bool IsInstalled() const { return mInstalled; }

  // ---- pointer ----
  void MovePointer(OS_Point inScreenPoint);
  void PressButton(int inButton);
  void ReleaseButton(int inButton);
  // Moves to the point, presses and releases.
  void Click(OS_Point inScreenPoint, int inButton = kHeadlessButtonLeft);
  // Raw deltas, one notch being 120.
  void TurnWheel(int inRawDelta);
  void TurnHorizontalWheel(int inRawDelta);

  // ---- keyboard (virtual keys, US layout) ----
  void PressKey(int inVirtualKey, bool inExtended = false);
  void ReleaseKey(int inVirtualKey, bool inExtended = false);
  void TypeKey(int inVirtualKey, bool inExtended = false);
  // A character without a key, to the focus window.
  void TypeCharacter(char16_t inCharacter);
  void SetKeyToggled(int inVirtualKey, bool inToggled);

  // ---- time and the queue ----
  // Moves the virtual clock on, pumping the queue and firing each timer that
  // falls due, in order of their deadlines.
  void AdvanceClock(OS_EventTime inMilliseconds);
  // Delivers everything pending (messages, then paints, then due timers)
  // until nothing is left; answers how many were delivered.
  int Pump();
  std::size_t GetQueueLength() const;
  // How long an idle RunLoop waits, on the real clock, for another thread to
  // post to the executor before it gives up.
  void SetIdleWaitLimit(unsigned inMilliseconds);

  // ---- the environment ----
  void SetMonitors(const std::vector<OS_Monitor>& inMonitors);
  void SetPreference(const std::string& inName, bool inValue);
  // A window of someone else's: its messages get the default handling until
  // it is subclassed; with inOtherThread it belongs to no thread of ours.
  OS_WindowHandle CreateForeignWindow(const OS_WindowCreateParams& inParams, bool inOtherThread = false);
  // Windows belong to application 0 unless put in another; activation
  // moving between applications sends kOSMsgActivateApp to both.
  void SetApplication(OS_WindowHandle inWindow, int inApplication);
  // Another program takes the foreground: nothing of ours stays active.
  void DeactivateApplication();
  int GetCaretCount(OS_WindowHandle inWindow) const;
  // The opacity the window is composited with, 0 to 255.
  unsigned char GetOpacity(OS_WindowHandle inWindow) const;
  // The pixels of a cursor made from pixels; false for system cursors.
  bool GetCursorImage(OS_CursorHandle inCursor, std::vector<std::uint32_t>& outPixels, OS_Point& outSize,
                      OS_Point& outHotSpot) const;

  // ---- pixels ----
  // A window's client area as last painted (empty without a surface).
  HeadlessPixels ReadWindowPixels(OS_WindowHandle inWindow) const;
  // The virtual screen: black, with every visible window composited in
  // z-order, children over parents, each with its opacity.
  HeadlessPixels ReadScreenPixels() const;
  bool WriteWindowPNG(OS_WindowHandle inWindow, const std::string& inPath) const;
  bool WriteScreenPNG(const std::string& inPath) const;

 private:
  std::unique_ptr<headless::OS_NativeLayer_Headless> mLayer;
  bool mInstalled = false;
  OS_NativeLayer* mPrevious = nullptr;
};

}  // namespace norvik::ui
