#pragma once
// The native layer over X11: one xcb connection on the UI thread, real windows
// with EWMH and ICCCM hints, X events translated into the toolkit's messages,
// keys through xkbcommon, painting double-buffered through Cairo.
//
// Window handles are X window ids. State that X does not keep for us (styles,
// properties of the node bridge, focus inside a top level, damage, timers) is
// kept here per window. Where a window manager runs, it moves and activates
// top levels; without one (a bare Xvfb) this layer activates on click itself.
#include <cairo.h>
#include <xcb/xcb.h>
#include <xkbcommon/xkbcommon-compose.h>
#include <xkbcommon/xkbcommon.h>

#include <array>
#include <chrono>
#include <deque>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "tarsel/Threads.h"
#include "ui/KeyboardLayout.h"
#include "ui/OS_NativeLayer.h"

namespace norvik::ui::x11 {

struct X11Window {
  xcb_window_t id = 0;
  UTF16String className;
  UTF16String text;
  OS_WindowHandle parent = 0;  // child windows
  OS_WindowHandle owner = 0;   // top levels
  std::vector<OS_WindowHandle> children;  // z-order, topmost first
  OS_Rect rect;                // in the parent's client coordinates, or on the screen
  std::uint32_t style = 0;
  std::uint32_t exStyle = 0;
  std::uint32_t classStyle = 0;
  bool overrideRedirect = false;
  bool ours = true;
  std::map<std::string, void*> properties;
  cairo_region_t* damage = nullptr;
  cairo_surface_t* backBuffer = nullptr;  // what the last paints left, the client's size
  xcb_gcontext_t gc = 0;                  // for presenting the back buffer
  int caretCount = 0;
  bool trackLeave = false;
  bool destroying = false;
  unsigned char alpha = 255;
  bool colorKeyed = false;     // pixels of colorKey (0x00BBGGRR) are cut out with SHAPE
  std::uint32_t colorKey = 0;
  bool shaped = false;
  OS_Rect normalRect;
  bool minimized = false;
  bool maximized = false;
  bool positioned = false;         // placed by the program, not left to the window manager
  OS_MinMaxInfo limits;            // the client sizes the user may give it, as the window last said
  bool viewable = false;           // exposed since it was last mapped
  bool focusWhenViewable = false;  // activated before it could take the focus
  bool reparented = false;  // a window manager framed it: its configure positions are frame-relative
  OS_CursorHandle cursor = 0;
  std::uint32_t netStates = 0;  // the _NET_WM_STATE changes last told, as bits

  X11Window() = default;
  X11Window(const X11Window&) = delete;
  X11Window& operator=(const X11Window&) = delete;
  ~X11Window();
};

struct X11Message {
  OS_Event event;
  std::array<std::uint8_t, 256> keyStates{};
  bool hasKeyStates = false;
};

struct X11Timer {
  unsigned interval = 1;
  std::chrono::steady_clock::time_point due;
};

class X11KeyboardLayout;
class X11GLContexts;

// Whether a top level of these styles bypasses the window manager
// (override-redirect).
bool BypassesWindowManager(std::uint32_t inStyle, std::uint32_t inExStyle);

class OS_NativeLayer_X11 : public OS_NativeLayer {
 public:
  // Connects to inDisplay (null: $DISPLAY). Throws the toolkit's exception when
  // no display can be opened.
  explicit OS_NativeLayer_X11(const char* inDisplay);
  ~OS_NativeLayer_X11() override;
  OS_NativeLayer_X11(const OS_NativeLayer_X11&) = delete;
  OS_NativeLayer_X11& operator=(const OS_NativeLayer_X11&) = delete;

  // ---- windows ----
  void SetWindowProcedure(OS_WindowProcedure inProcedure) override { mProcedure = inProcedure; }
  OS_WindowHandle CreateWindow(const OS_WindowCreateParams& inParams) override;
  void DestroyWindow(OS_WindowHandle inWindow) override;
  bool IsWindow(OS_WindowHandle inWindow) const override;
  bool SubclassWindow(OS_WindowHandle inWindow) override;
  bool UsesOurProcedure(OS_WindowHandle inWindow) const override;
  UTF16String GetClassName(OS_WindowHandle inWindow) const override;
  bool IsWindowOfThisThread(OS_WindowHandle inWindow) const override { return Find(inWindow) != nullptr; }
  void SetProperty(OS_WindowHandle inWindow, const std::string& inName, void* inValue) override;
  void* GetProperty(OS_WindowHandle inWindow, const std::string& inName) const override;
  void RemoveProperty(OS_WindowHandle inWindow, const std::string& inName) override;
  void SetWindowText(OS_WindowHandle inWindow, const UTF16String& inText) override;
  UTF16String GetWindowText(OS_WindowHandle inWindow) const override;
  std::uint32_t GetStyle(OS_WindowHandle inWindow) const override;
  void SetStyle(OS_WindowHandle inWindow, std::uint32_t inStyle) override;
  std::uint32_t GetExStyle(OS_WindowHandle inWindow) const override;
  void SetExStyle(OS_WindowHandle inWindow, std::uint32_t inExStyle) override;

  // ---- visibility, geometry, hierarchy ----
  void ShowWindow(OS_WindowHandle inWindow, int inShowCommand) override;
  bool IsWindowVisible(OS_WindowHandle inWindow) const override;
  bool IsMinimized(OS_WindowHandle inWindow) const override;
  bool IsMaximized(OS_WindowHandle inWindow) const override;
  void SetWindowPos(OS_WindowHandle inWindow, OS_WindowHandle inInsertAfter, const OS_Rect& inRect,
                    std::uint32_t inFlags) override;
  OS_Rect GetWindowRect(OS_WindowHandle inWindow) const override;
  OS_Rect GetClientRect(OS_WindowHandle inWindow) const override;
  OS_Point ClientToScreen(OS_WindowHandle inWindow, OS_Point inPoint) const override;
  OS_Point ScreenToClient(OS_WindowHandle inWindow, OS_Point inPoint) const override;
  bool GetWindowPlacement(OS_WindowHandle inWindow, OS_WindowPlacement& outPlacement) const override;
  void SetWindowPlacement(OS_WindowHandle inWindow, const OS_WindowPlacement& inPlacement) override;
  void SetParent(OS_WindowHandle inWindow, OS_WindowHandle inParent) override;
  OS_WindowHandle GetParent(OS_WindowHandle inWindow) const override;
  OS_WindowHandle GetOwner(OS_WindowHandle inWindow) const override;
  bool IsChild(OS_WindowHandle inParent, OS_WindowHandle inWindow) const override;
  OS_WindowHandle GetTopWindow(OS_WindowHandle inParent) const override;
  OS_WindowHandle GetNextWindow(OS_WindowHandle inWindow, int inRelation) const override;
  OS_WindowHandle WindowFromPoint(OS_Point inScreenPoint) const override;
  std::vector<OS_WindowHandle> EnumerateWindows() const override;
  void EnableWindow(OS_WindowHandle inWindow, bool inEnable) override;
  bool IsWindowEnabled(OS_WindowHandle inWindow) const override;

  // ---- activation, focus, capture ----
  void SetActiveWindow(OS_WindowHandle inWindow) override;
  OS_WindowHandle GetActiveWindow() const override { return mActive; }
  void SetForegroundWindow(OS_WindowHandle inWindow) override { SetActiveWindow(inWindow); }
  OS_WindowHandle GetForegroundWindow() const override { return mActive; }
  void SetFocus(OS_WindowHandle inWindow) override;
  OS_WindowHandle GetFocus() const override { return mFocus; }
  void SetCapture(OS_WindowHandle inWindow) override;
  void ReleaseCapture() override;
  OS_WindowHandle GetCapture() const override { return mCapture; }
  void TrackMouseLeave(OS_WindowHandle inWindow) override;

  // ---- painting ----
  void InvalidateRect(OS_WindowHandle inWindow, const OS_Rect* inRect) override;
  void UpdateWindow(OS_WindowHandle inWindow) override;
  OS_PaintContext BeginPaint(OS_WindowHandle inWindow) override;
  void EndPaint(OS_WindowHandle inWindow, const OS_PaintContext& inContext) override;
  const drawbot::SupplierInterface* GetDrawSupplier() const override;
  void SetLayeredAttributes(OS_WindowHandle inWindow, std::uint32_t inColorKey, unsigned char inAlpha,
                            unsigned inFlags) override;
  OS_RegionHandle CreateRegion(const OS_Rect& inRect) override;
  void DestroyRegion(OS_RegionHandle inRegion) override;
  bool IntersectRegion(OS_RegionHandle inOutRegion, const OS_Rect& inRect) override;
  bool IntersectRegions(OS_RegionHandle inOutRegion, OS_RegionHandle inOther) override;
  bool IsRegionEmpty(OS_RegionHandle inRegion) const override;
  OS_Rect GetRegionBounds(OS_RegionHandle inRegion) const override;

  // ---- messages and the loop ----
  std::intptr_t SendMessage(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                            std::intptr_t inLParam) override;
  void PostMessage(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                   std::intptr_t inLParam) override;
  bool PeekMessage(OS_Event& outEvent, OS_WindowHandle inWindow, unsigned inFirst, unsigned inLast,
                   bool inRemove) override;
  std::intptr_t DefaultWindowProcedure(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                       std::intptr_t inLParam) override;
  int RunLoop() override;
  void QuitLoop(int inExitCode) override;
  int ProcessPendingEvents() override;
  OS_EventTime GetMessageTime() const override { return mMessageTime; }
  OS_EventTime GetTickCount() const override;

  // ---- timers ----
  void SetTimer(OS_WindowHandle inWindow, std::uintptr_t inId, unsigned inMilliseconds) override;
  void KillTimer(OS_WindowHandle inWindow, std::uintptr_t inId) override;

  // ---- pointer and cursor ----
  OS_Point GetCursorPos() const override;
  OS_CursorHandle LoadSystemCursor(int inSystemCursor) override;
  OS_CursorHandle CreateCursorFromPixels(const std::uint32_t* inPixels, int inWidth, int inHeight, int inHotX,
                                         int inHotY) override;
  void DestroyCursor(OS_CursorHandle inCursor) override;
  void SetCursor(OS_CursorHandle inCursor) override;
  OS_CursorHandle GetCursor() const override { return mCursor; }
  unsigned GetDoubleClickTime() const override { return mDoubleClickTime; }
  OS_Point GetDoubleClickSize() const override { return mDoubleClickSize; }

  // ---- keyboard ----
  short GetKeyState(int inVirtualKey) const override;
  short GetAsyncKeyState(int inVirtualKey) const override;
  const KeyboardLayoutInterface* GetKeyboardLayout() const override;
  // Through the keymap in force: the key's unshifted symbol in the active layout.
  int ScanCodeToVirtualKey(unsigned inScanCode) const override;

  // ---- monitors and preferences ----
  std::vector<OS_Monitor> GetMonitors() const override;
  bool GetPreference(const std::string& inName, bool& outValue) const override;
  void ShowCaret(OS_WindowHandle inWindow, bool inShow) override;

  // ---- OpenGL (X11OpenGL.cpp) ----
  OS_GLSurfaceHandle CreateGLSurface(OS_WindowHandle inWindow, const OS_GLPixelFormat& inFormat) override;
  void DestroyGLSurface(OS_GLSurfaceHandle inSurface) override;
  OS_GLContextHandle CreateGLContext(OS_GLSurfaceHandle inSurface) override;
  void DestroyGLContext(OS_GLContextHandle inContext) override;
  OS_GLCurrent GetCurrentGLContext() const override;
  bool MakeGLContextCurrent(const OS_GLCurrent& inCurrent) override;
  void ClearGLContext(float inRed, float inGreen, float inBlue, float inAlpha) override;
  bool SwapGLBuffers(OS_GLSurfaceHandle inSurface) override;

  // ---- for tests and tools ----
  xcb_connection_t* GetConnection() const { return mConnection; }
  xcb_window_t GetRootWindow() const { return mScreen->root; }
  // Handles every X event and message that is pending, waiting at most
  // inMilliseconds for the first one; answers how many messages were delivered.
  int WaitAndProcess(int inMilliseconds);

  // Used by the parts of this layer in other files.
  X11Window* Find(OS_WindowHandle inWindow) const;
  xcb_atom_t Atom(const char* inName);
  void ReportXError(const xcb_generic_error_t* inError, const char* inWhat);

 private:
  // connection and atoms (X11Connection.cpp)
  void Connect(const char* inDisplay);
  void FindVisual();
  // others' doings to our windows (X11WindowState.cpp)
  std::uint32_t ReadWmState(xcb_window_t inWindow);
  void TranslateUnmap(const xcb_unmap_notify_event_t* inEvent);
  void TranslateMap(const xcb_map_notify_event_t* inEvent);
  // The first exposure after a map: the window is viewable, and may take the focus.
  void ExposedFirst(X11Window& ioWindow);
  void NoticeGrabEnd(const xcb_enter_notify_event_t* inEvent);
  // XSETTINGS (X11Settings.cpp)
  void WatchXSettings();
  // Reads the daemon's settings, or the defaults without one; with inAnnounce,
  // tells our top levels when what the toolkit sees of them changed.
  void ReadXSettings(bool inAnnounce);
  void ApplyXSettings(const std::uint8_t* inData, std::size_t inSize);
  // Answers true when inEvent concerned the settings daemon and was handled.
  bool TranslateSettingsEvent(const xcb_generic_event_t* inEvent);
  // window manager hints (X11Hints.cpp)
  void ApplyTopLevelHints(X11Window& ioWindow);
  void ApplyIcccmHints(X11Window& ioWindow);
  void ApplySizeHints(X11Window& ioWindow);
  void ApplyWindowState(X11Window& ioWindow);
  void RequestStateChanges(X11Window& ioWindow);
  // After a style change: bypassing the window manager or not, and the hints.
  void UpdateTopLevelKind(X11Window& ioWindow);
  // windows (X11Windows.cpp)
  void DestroySubtree(OS_WindowHandle inWindow);
  // Sends the destroy messages to a window and its children and forgets them.
  void ForgetDestroyedWindow(OS_WindowHandle inWindow);
  std::vector<OS_WindowHandle>& SiblingsOf(const X11Window& inWindow);
  OS_WindowHandle TopLevelOf(OS_WindowHandle inWindow) const;
  OS_WindowHandle DeepestAt(OS_WindowHandle inWindow, OS_Point inScreen) const;
  std::intptr_t CallProcedure(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                              std::intptr_t inLParam);
  void SendSize(OS_WindowHandle inWindow);
  // Asks the server for the window's size, and for its position when inMove.
  void Configure(X11Window& ioWindow, bool inMove);
  // Asks the window for its size limits (kOSMsgGetMinMaxInfo) and publishes them.
  void UpdateSizeLimits(OS_WindowHandle inWindow);
  // To the top of its siblings, here and on the server.
  void Raise(OS_WindowHandle inWindow);
  // events (X11Events.cpp)
  void DrainConnection();
  void TranslateEvent(xcb_generic_event_t* inEvent);
  void TranslateButton(const xcb_button_press_event_t* inEvent, bool inPress);
  void TranslateMotion(const xcb_motion_notify_event_t* inEvent);
  void TranslateCrossing(const xcb_enter_notify_event_t* inEvent, bool inEnter);
  void TranslateFocus(const xcb_focus_in_event_t* inEvent, bool inIn);
  void TranslateConfigure(const xcb_configure_notify_event_t* inEvent);
  void TranslateClientMessage(const xcb_client_message_event_t* inEvent);
  void Queue(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam, std::intptr_t inLParam,
             bool inWithKeys);
  OS_WindowHandle MouseTarget(OS_WindowHandle inEventWindow, OS_Point inScreen) const;
  bool ClickActivates(OS_WindowHandle inTarget, unsigned inMessage);
  void NotifyPointerWindow(OS_WindowHandle inWindow);
  void Activate(OS_WindowHandle inTopLevel, int inActivationCode);
  // To every top level: the application came forward (or went back) as
  // activation moved from (or to) inOther.
  void SendActivateApp(bool inActive, OS_WindowHandle inOther);
  OS_Point PointerOnScreen(xcb_window_t inEventWindow, std::int16_t inX, std::int16_t inY, std::int16_t inRootX,
                           std::int16_t inRootY) const;
  // A window manager moving or sizing a top level while the user holds a
  // button opens a size-move loop; it ends when the buttons come up.
  void NoticeUserSizeMove(OS_WindowHandle inWindow);
  void CheckUserSizeMoveEnd();
  bool PointerButtonsDown();
  bool DeliverOne();
  bool DeliverPaint();
  bool FireDueTimers();
  int NextTimeout() const;
  // keyboard (X11Keyboard.cpp)
  void SetUpKeyboard();
  void LoadKeymap();
  // The layout in force (the effective XKB group).
  xkb_layout_index_t ActiveLayoutIndex() const;
  // A new keymap, or the state (modifiers, the locked layout) changed.
  void TranslateXkbEvent(const xcb_generic_event_t* inEvent);
  void TranslateKey(const xcb_key_press_event_t* inEvent, bool inPress);
  void QueueCharacters(OS_WindowHandle inTarget, const std::u32string& inText, bool inSystem, std::intptr_t inLParam);
  // paint (X11Paint.cpp)
  void Damage(X11Window& ioWindow, const OS_Rect* inRect);
  void Present(X11Window& ioWindow, cairo_region_t* inRegion);
  // colour key (X11Shape.cpp): cuts the key's pixels out of the window's shape.
  void ApplyColorKeyShape(X11Window& ioWindow);
  // monitors (X11Monitors.cpp)
  OS_Rect ReadWorkArea();
  // OpenGL (X11OpenGL.cpp): the GL connection, opened on first use, and the
  // window that a GL surface lies in (0 for other windows).
  X11GLContexts& GL() const;
  OS_WindowHandle GLSurfaceOwner(std::uint32_t inWindow) const;

  friend class X11KeyboardLayout;

  xcb_connection_t* mConnection = nullptr;
  xcb_screen_t* mScreen = nullptr;
  xcb_visualtype_t* mVisual = nullptr;
  std::map<std::string, xcb_atom_t> mAtoms;
  OS_WindowProcedure mProcedure = nullptr;
  std::map<OS_WindowHandle, std::unique_ptr<X11Window>> mWindows;
  std::vector<OS_WindowHandle> mStacking;  // top levels, topmost first
  std::deque<X11Message> mQueue;
  std::map<std::pair<OS_WindowHandle, std::uintptr_t>, X11Timer> mTimers;
  OS_WindowHandle mActive = 0;
  bool mApplicationActive = false;  // one of our windows has the activation, or had it last
  OS_WindowHandle mSizeMoveWindow = 0;
  std::chrono::steady_clock::time_point mSizeMoveCheck;
  OS_WindowHandle mFocus = 0;
  OS_WindowHandle mCapture = 0;
  unsigned mGrabSequence = 0;  // of the pointer grab that stands for mCapture
  OS_WindowHandle mPointerWindow = 0;
  OS_Point mPointer;
  bool mPointerInside = false;  // over one of our windows: mPointer is current
  OS_CursorHandle mCursor = 0;
  std::map<int, OS_CursorHandle> mSystemCursors;
  void* mCursorContext = nullptr;
  unsigned mDoubleClickTime = 500;
  OS_Point mDoubleClickSize{4, 4};                // the rectangle a second click may stray in
  std::map<std::string, bool> mPreferences;      // the desktop's answers to GetPreference
  xcb_window_t mXSettingsWindow = 0;  // the settings daemon's window, 0 when none runs
  OS_EventTime mMessageTime = 0;
  std::chrono::steady_clock::time_point mStart;
  // double clicks
  OS_WindowHandle mLastClickWindow = 0;
  int mLastClickButton = 0;
  OS_EventTime mLastClickTime = -100000;
  OS_Point mLastClickPoint;
  bool mLastWasDoubleClick = false;
  // keyboard
  xkb_context* mXkbContext = nullptr;
  xkb_keymap* mKeymap = nullptr;
  xkb_state* mXkbState = nullptr;
  xkb_compose_table* mComposeTable = nullptr;
  xkb_compose_state* mComposeState = nullptr;
  std::int32_t mKeyboardDevice = -1;
  std::uint8_t mXkbEventBase = 0;
  std::array<std::uint8_t, 256> mKeyStates{};
  std::array<std::uint8_t, 256> mMessageKeyStates{};
  std::unique_ptr<X11KeyboardLayout> mLayout;
  // loop
  std::vector<bool> mQuitRequests;
  std::vector<int> mExitCodes;
  int mWakePipe[2] = {-1, -1};
  tarsel::threads::AsyncEventLoopAdaptorPtr mExecutor;
  std::unique_ptr<drawbot::SupplierInterface, void (*)(drawbot::SupplierInterface*)> mSupplier;
  // OpenGL
  std::string mDisplayName;  // as given, empty for $DISPLAY
  mutable std::unique_ptr<X11GLContexts> mGL;
};

}  // namespace norvik::ui::x11
