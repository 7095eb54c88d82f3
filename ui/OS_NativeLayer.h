#pragma once
// The native layer: everything the toolkit asks of a window system, in one
// interface. The bridge of native windows (OS_Window and the containers) is
// written once against it; each platform implements it in its own folder:
// ui/src/x11/ over xcb, ui/src/headless/ in memory for tests and off-screen
// rendering. No portable code reaches a platform any other way.
//
// The vocabulary is the toolkit's own message numbers (OS_Event.h) and window
// numbers (OS_WindowConstants.h). A platform translates its native events into
// those messages and delivers them, on the UI thread, to the window procedure
// installed with SetWindowProcedure. Coordinates are pixels: "screen" means
// the virtual desktop, "client" a window's client area.
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "tarsel/PointT.h"
#include "tarsel/RectT.h"
#include "tarsel/UTFString.h"
#include "ui/OS_Event.h"
#include "ui/OS_WindowConstants.h"

namespace norvik::drawbot {
class SupplierInterface;
}

namespace norvik::ui {

class KeyboardLayoutInterface;

using OS_Point = tarsel::geom::PointT<long>;
using OS_Rect = tarsel::geom::RectT<long>;

// The toolkit's window procedure: handles one message and answers its result.
// The platform calls it for every window created through CreateWindow and for
// every window handed to SubclassWindow.
using OS_WindowProcedure = std::intptr_t (*)(OS_WindowHandle inWindow, unsigned inMessage,
                                             std::uintptr_t inWParam, std::intptr_t inLParam);

struct OS_WindowCreateParams {
  UTF16String title;
  OS_WindowHandle parent = 0;  // a native parent (child windows) or owner (top levels)
  OS_Rect rect;                // in the parent's client coordinates, or screen coordinates
  std::uint32_t style = 0;
  std::uint32_t exStyle = 0;
  std::uint32_t classStyle = kOSClassStyleDoubleClicks;
  // Delivered as the second parameter of kOSMsgNCCreate, the first message
  // the new window receives.
  void* createParam = nullptr;
};

struct OS_WindowPlacement {
  unsigned flags = 0;
  int showCommand = kOSShowNormal;
  OS_Rect normalRect;  // the rectangle of the window when restored, in screen coordinates
};

// The second parameter of kOSMsgGetMinMaxInfo points at one of these, which
// the platform fills with its own limits (0: none) before asking: the window
// answers the smallest and largest client sizes the user may give it.
struct OS_MinMaxInfo {
  OS_Point minTrackSize;
  OS_Point maxTrackSize;
};

// A region in a window's client coordinates. Regions are the platform's (the
// Cairo back end's regions on both ports); portable code only combines them
// through these operations.
using OS_RegionHandle = void*;

// What BeginPaint gives: the target to draw on and the part to repaint.
struct OS_PaintContext {
  void* target = nullptr;          // a drawbot::NativeDrawTarget for the supplier's NewSurface
  OS_RegionHandle updateRegion = nullptr;  // the platform's; EndPaint releases it
  OS_Rect updateBounds;
};

// Monitors: the whole rectangle and the work area of each, primary first.
struct OS_Monitor {
  OS_Rect bounds;
  OS_Rect workArea;
};

// Special places of SetWindowPos's inInsertAfter: the top or bottom of the
// window's band, or moving a top level into or out of the topmost band.
constexpr OS_WindowHandle kOSInsertTop = 0;
constexpr OS_WindowHandle kOSInsertBottom = 1;
constexpr OS_WindowHandle kOSInsertTopmost = static_cast<OS_WindowHandle>(-1);
constexpr OS_WindowHandle kOSInsertNoTopmost = static_cast<OS_WindowHandle>(-2);

using OS_CursorHandle = std::uintptr_t;
using OS_TimerCallback = std::function<void()>;

// OpenGL. A GL surface is what GL draws on inside a native window (a device
// on some platforms, a drawable on others); a GL context holds the GL state
// and draws on a surface of its pixel format. Both are the platform's
// handles, 0 meaning none.
using OS_GLSurfaceHandle = std::uintptr_t;
using OS_GLContextHandle = std::uintptr_t;

// What a GL surface is made with: RGBA colour of colorBits bits (alpha not
// counted), a depth buffer of depthBits bits, and a back buffer that
// SwapGLBuffers presents when doubleBuffered.
struct OS_GLPixelFormat {
  bool doubleBuffered = true;
  int colorBits = 24;
  int depthBits = 16;
};

// The surface and context current on the calling thread, whoever made them
// current: the toolkit or the host. connection is the platform's own (the
// display a context belongs to, where that matters), for putting them back.
struct OS_GLCurrent {
  void* connection = nullptr;
  OS_GLSurfaceHandle surface = 0;
  OS_GLContextHandle context = 0;
};

class OS_NativeLayer {
 public:
  virtual ~OS_NativeLayer() = default;

  // ---- windows ----
  virtual void SetWindowProcedure(OS_WindowProcedure inProcedure) = 0;
  // Creates a window; the procedure receives kOSMsgNCCreate (with createParam)
  // before this returns. 0 when creation was refused.
  virtual OS_WindowHandle CreateWindow(const OS_WindowCreateParams& inParams) = 0;
  // Sends kOSMsgDestroy and then kOSMsgNCDestroy to the window and its
  // children, then forgets it.
  virtual void DestroyWindow(OS_WindowHandle inWindow) = 0;
  virtual bool IsWindow(OS_WindowHandle inWindow) const = 0;
  // Routes the messages of a window not created here through our procedure.
  virtual bool SubclassWindow(OS_WindowHandle inWindow) = 0;
  // True when the window's messages go through our procedure.
  virtual bool UsesOurProcedure(OS_WindowHandle inWindow) const = 0;
  virtual UTF16String GetClassName(OS_WindowHandle inWindow) const = 0;
  // True when the window was made by this thread.
  virtual bool IsWindowOfThisThread(OS_WindowHandle inWindow) const = 0;

  virtual void SetProperty(OS_WindowHandle inWindow, const std::string& inName, void* inValue) = 0;
  virtual void* GetProperty(OS_WindowHandle inWindow, const std::string& inName) const = 0;
  virtual void RemoveProperty(OS_WindowHandle inWindow, const std::string& inName) = 0;

  virtual void SetWindowText(OS_WindowHandle inWindow, const UTF16String& inText) = 0;
  virtual UTF16String GetWindowText(OS_WindowHandle inWindow) const = 0;

  virtual std::uint32_t GetStyle(OS_WindowHandle inWindow) const = 0;
  virtual void SetStyle(OS_WindowHandle inWindow, std::uint32_t inStyle) = 0;
  virtual std::uint32_t GetExStyle(OS_WindowHandle inWindow) const = 0;
  virtual void SetExStyle(OS_WindowHandle inWindow, std::uint32_t inExStyle) = 0;

  // ---- visibility, geometry, hierarchy ----
  virtual void ShowWindow(OS_WindowHandle inWindow, int inShowCommand) = 0;
  virtual bool IsWindowVisible(OS_WindowHandle inWindow) const = 0;  // itself and all native ancestors
  virtual bool IsMinimized(OS_WindowHandle inWindow) const = 0;
  virtual bool IsMaximized(OS_WindowHandle inWindow) const = 0;
  virtual void SetWindowPos(OS_WindowHandle inWindow, OS_WindowHandle inInsertAfter, const OS_Rect& inRect,
                            std::uint32_t inFlags) = 0;
  virtual OS_Rect GetWindowRect(OS_WindowHandle inWindow) const = 0;  // screen coordinates, frame included
  virtual OS_Rect GetClientRect(OS_WindowHandle inWindow) const = 0;  // origin 0, 0
  virtual OS_Point ClientToScreen(OS_WindowHandle inWindow, OS_Point inPoint) const = 0;
  virtual OS_Point ScreenToClient(OS_WindowHandle inWindow, OS_Point inPoint) const = 0;
  virtual bool GetWindowPlacement(OS_WindowHandle inWindow, OS_WindowPlacement& outPlacement) const = 0;
  virtual void SetWindowPlacement(OS_WindowHandle inWindow, const OS_WindowPlacement& inPlacement) = 0;
  virtual void SetParent(OS_WindowHandle inWindow, OS_WindowHandle inParent) = 0;
  virtual OS_WindowHandle GetParent(OS_WindowHandle inWindow) const = 0;  // child windows only
  virtual OS_WindowHandle GetOwner(OS_WindowHandle inWindow) const = 0;
  virtual bool IsChild(OS_WindowHandle inParent, OS_WindowHandle inWindow) const = 0;  // any depth
  // Walks the top-level windows in z-order, topmost first: GetTopWindow(0),
  // then GetWindow(h, kOSWindowNext).
  virtual OS_WindowHandle GetTopWindow(OS_WindowHandle inParent) const = 0;
  virtual OS_WindowHandle GetNextWindow(OS_WindowHandle inWindow, int inRelation) const = 0;
  // The deepest visible, enabled window of ours under a screen point.
  virtual OS_WindowHandle WindowFromPoint(OS_Point inScreenPoint) const = 0;
  // Every window of this thread, top levels and children.
  virtual std::vector<OS_WindowHandle> EnumerateWindows() const = 0;

  virtual void EnableWindow(OS_WindowHandle inWindow, bool inEnable) = 0;
  virtual bool IsWindowEnabled(OS_WindowHandle inWindow) const = 0;

  // ---- activation, focus, capture ----
  virtual void SetActiveWindow(OS_WindowHandle inWindow) = 0;
  virtual OS_WindowHandle GetActiveWindow() const = 0;
  virtual void SetForegroundWindow(OS_WindowHandle inWindow) = 0;
  virtual OS_WindowHandle GetForegroundWindow() const = 0;
  virtual void SetFocus(OS_WindowHandle inWindow) = 0;
  virtual OS_WindowHandle GetFocus() const = 0;
  virtual void SetCapture(OS_WindowHandle inWindow) = 0;
  virtual void ReleaseCapture() = 0;
  virtual OS_WindowHandle GetCapture() const = 0;
  // Asks for one kOSMsgMouseLeave when the pointer leaves the window.
  virtual void TrackMouseLeave(OS_WindowHandle inWindow) = 0;

  // ---- painting ----
  // Adds to the window's damage; inRect null means the whole client area.
  virtual void InvalidateRect(OS_WindowHandle inWindow, const OS_Rect* inRect) = 0;
  // Delivers kOSMsgPaint now if the window has damage.
  virtual void UpdateWindow(OS_WindowHandle inWindow) = 0;
  virtual OS_PaintContext BeginPaint(OS_WindowHandle inWindow) = 0;
  virtual void EndPaint(OS_WindowHandle inWindow, const OS_PaintContext& inContext) = 0;
  // The drawing supplier for this platform's paint targets.
  virtual const drawbot::SupplierInterface* GetDrawSupplier() const = 0;
  virtual void SetLayeredAttributes(OS_WindowHandle inWindow, std::uint32_t inColorKey, unsigned char inAlpha,
                                    unsigned inFlags) = 0;

  // Region algebra on the platform's regions.
  virtual OS_RegionHandle CreateRegion(const OS_Rect& inRect) = 0;
  virtual void DestroyRegion(OS_RegionHandle inRegion) = 0;
  // inOut becomes its intersection with inRect; answers whether it is non-empty.
  virtual bool IntersectRegion(OS_RegionHandle inOutRegion, const OS_Rect& inRect) = 0;
  virtual bool IntersectRegions(OS_RegionHandle inOutRegion, OS_RegionHandle inOther) = 0;
  virtual bool IsRegionEmpty(OS_RegionHandle inRegion) const = 0;
  virtual OS_Rect GetRegionBounds(OS_RegionHandle inRegion) const = 0;

  // ---- messages and the loop ----
  // Sends a message straight to the window procedure and answers its result.
  virtual std::intptr_t SendMessage(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                    std::intptr_t inLParam) = 0;
  virtual void PostMessage(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                           std::intptr_t inLParam) = 0;
  // Looks at, and optionally removes, the oldest queued message for inWindow
  // (0: any window) whose number lies in [inFirst, inLast].
  virtual bool PeekMessage(OS_Event& outEvent, OS_WindowHandle inWindow, unsigned inFirst, unsigned inLast,
                           bool inRemove) = 0;
  // The platform's default handling of a message (closing destroys the window,
  // the arrow cursor, activation moves native focus, ...), answering its result.
  virtual std::intptr_t DefaultWindowProcedure(OS_WindowHandle inWindow, unsigned inMessage,
                                               std::uintptr_t inWParam, std::intptr_t inLParam) = 0;
  // Runs the loop until Quit is called at this nesting depth; loops nest.
  virtual int RunLoop() = 0;
  virtual void QuitLoop(int inExitCode) = 0;
  // Handles everything pending now, without waiting; answers how many
  // messages were delivered.
  virtual int ProcessPendingEvents() = 0;
  // The time of the message being handled, in milliseconds.
  virtual OS_EventTime GetMessageTime() const = 0;
  virtual OS_EventTime GetTickCount() const = 0;

  // ---- timers: kOSMsgTimer with the id as first parameter ----
  virtual void SetTimer(OS_WindowHandle inWindow, std::uintptr_t inId, unsigned inMilliseconds) = 0;
  virtual void KillTimer(OS_WindowHandle inWindow, std::uintptr_t inId) = 0;

  // ---- pointer and cursor ----
  virtual OS_Point GetCursorPos() const = 0;
  virtual OS_CursorHandle LoadSystemCursor(int inSystemCursor) = 0;
  // A cursor from premultiplied ARGB pixels, stride = width * 4.
  virtual OS_CursorHandle CreateCursorFromPixels(const std::uint32_t* inPixels, int inWidth, int inHeight,
                                                 int inHotX, int inHotY) = 0;
  virtual void DestroyCursor(OS_CursorHandle inCursor) = 0;
  virtual void SetCursor(OS_CursorHandle inCursor) = 0;
  virtual OS_CursorHandle GetCursor() const = 0;
  virtual unsigned GetDoubleClickTime() const = 0;         // milliseconds
  virtual OS_Point GetDoubleClickSize() const = 0;         // width and height of the double-click rectangle

  // ---- keyboard ----
  // Virtual key state: bit 15 set while down, bit 0 the toggle.
  virtual short GetKeyState(int inVirtualKey) const = 0;        // as of the message being handled
  virtual short GetAsyncKeyState(int inVirtualKey) const = 0;   // now
  // The active keyboard layout's answers to shortcut questions; null keeps the
  // built-in US layout.
  virtual const KeyboardLayoutInterface* GetKeyboardLayout() const { return nullptr; }
  // The virtual key of a hardware scan code (the bits 16 to 23 of a key
  // message's second parameter), 0 when unknown. The default knows the set-1
  // codes of a US keyboard.
  virtual int ScanCodeToVirtualKey(unsigned inScanCode) const;

  // ---- monitors and preferences ----
  virtual std::vector<OS_Monitor> GetMonitors() const = 0;
  // A platform preference by name ("windows.MnemonicsAlwaysOn", ...); false
  // when the platform does not answer it.
  virtual bool GetPreference(const std::string& inName, bool& outValue) const = 0;

  // ---- caret (for hosted text fields) ----
  virtual void ShowCaret(OS_WindowHandle inWindow, bool inShow) = 0;

  // ---- OpenGL (views that draw with GL) ----
  // A platform without GL keeps these defaults: nothing is made, and every
  // operation answers 0 or false.
  //
  // A surface covering the client area of inWindow, following its size, made
  // with inFormat; 0 when the window or a matching format is missing.
  virtual OS_GLSurfaceHandle CreateGLSurface(OS_WindowHandle inWindow, const OS_GLPixelFormat& inFormat);
  virtual void DestroyGLSurface(OS_GLSurfaceHandle inSurface);
  // A context for drawing on inSurface (and on surfaces of its format).
  virtual OS_GLContextHandle CreateGLContext(OS_GLSurfaceHandle inSurface);
  // Destroys a context; one that is current stops being current first.
  virtual void DestroyGLContext(OS_GLContextHandle inContext);
  virtual OS_GLCurrent GetCurrentGLContext() const;
  // Makes the surface and context current; an answer of GetCurrentGLContext
  // puts back what was current, and an empty one leaves no context current.
  // False when the pair is unknown or refused.
  virtual bool MakeGLContextCurrent(const OS_GLCurrent& inCurrent);
  // Fills the colour buffer of the current context with the colour (and its
  // depth buffer with the far plane).
  virtual void ClearGLContext(float inRed, float inGreen, float inBlue, float inAlpha);
  // Presents the back buffer of a double-buffered surface.
  virtual bool SwapGLBuffers(OS_GLSurfaceHandle inSurface);
};

// The layer the toolkit uses. The host (or the application loop) installs one
// at start-up; the caller keeps ownership and uninstalls it (null) before
// destroying it. Null when none is installed.
OS_NativeLayer* GetNativeLayer();
void SetNativeLayer(OS_NativeLayer* inLayer);

class OS_FocusPlatform;
// Makes inLayer the toolkit's platform (null uninstalls): the native layer,
// the input answers that read it, and the focus questions of the current
// node manager. Create the manager first, or install again after creating it.
void InstallNativeLayer(OS_NativeLayer* inLayer);
// The focus questions answered through whatever native layer is installed.
OS_FocusPlatform& GetNativeFocusPlatform();

}  // namespace norvik::ui
