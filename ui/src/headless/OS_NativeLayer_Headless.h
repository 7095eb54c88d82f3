#pragma once
// The headless window system: a complete window system kept in memory, behind
// the same native layer as the X11 port. Windows have handles, z-order,
// parent and owner links, activation, focus and capture; input is injected
// at screen coordinates and routed the way a desktop routes it; messages go
// through a queue; damage becomes paint messages when the queue is empty;
// each window paints into a Cairo image surface of its client area; timers
// run on a virtual clock that only moves when it is told to.
//
// Windows have no frame in this system: the window rectangle and the client
// area coincide.
//
// Everything runs on the UI thread, except the executor's wake-up, which
// other threads may call.
#include <cairo.h>

#include <array>
#include <condition_variable>
#include <cstdint>
#include <deque>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include "drawbot/SupplierInterface.h"
#include "tarsel/Threads.h"
#include "ui/OS_NativeLayer.h"


namespace norvik::ui::headless {

// One byte per virtual key: bit 7 held, bit 0 toggled.
using KeyStates = std::array<std::uint8_t, 256>;
constexpr std::uint8_t kKeyHeld = 0x80;
constexpr std::uint8_t kKeyToggled = 0x01;

// The class name of the windows the toolkit creates through CreateWindow.
extern const char16_t kToolkitWindowClass[];
// The class name of foreign windows made by CreateForeignWindow.
extern const char16_t kForeignWindowClass[];

enum class ShowState { kNormal, kMinimized, kMaximized };

struct HeadlessWindow {
  OS_WindowHandle handle = 0;
  UTF16String className;
  UTF16String text;
  OS_WindowHandle parent = 0;  // child windows
  OS_WindowHandle owner = 0;   // top levels
  std::vector<OS_WindowHandle> children;  // z-order, topmost first
  OS_Rect rect;  // in the parent's client coordinates, or on the screen
  std::uint32_t style = 0;
  std::uint32_t exStyle = 0;
  std::uint32_t classStyle = 0;
  bool ours = true;  // messages go through the installed procedure
  std::thread::id thread;
  int application = 0;
  std::map<std::string, void*> properties;
  ShowState show = ShowState::kNormal;
  OS_Rect normalRect;  // screen rectangle when restored
  unsigned placementFlags = 0;
  cairo_region_t* damage = nullptr;
  cairo_surface_t* surface = nullptr;
  unsigned char alpha = 255;
  std::uint32_t colorKey = 0;
  unsigned layeredFlags = 0;
  int caretCount = 0;
  bool destroying = false;

  HeadlessWindow() = default;
  HeadlessWindow(const HeadlessWindow&) = delete;
  HeadlessWindow& operator=(const HeadlessWindow&) = delete;
  ~HeadlessWindow();
};

struct QueuedMessage {
  OS_Event event;
  bool hasKeyStates = false;  // input messages carry the keyboard as it was
  KeyStates keyStates{};
  bool clickInInactiveWindow = false;  // ask the window whether the click activates
};

struct HeadlessTimer {
  OS_WindowHandle window = 0;
  std::uintptr_t id = 0;
  unsigned interval = 1;
  OS_EventTime due = 0;
  std::uint64_t order = 0;  // ties at one instant fire in the order they were set
};

class OS_NativeLayer_Headless : public OS_NativeLayer {
 public:
  // RunLoop's answer when it stopped because nothing was left to do.
  static constexpr int kIdleExitCode = -1;

  OS_NativeLayer_Headless();
  ~OS_NativeLayer_Headless() override;
  OS_NativeLayer_Headless(const OS_NativeLayer_Headless&) = delete;
  OS_NativeLayer_Headless& operator=(const OS_NativeLayer_Headless&) = delete;

  // ---- windows ----
  void SetWindowProcedure(OS_WindowProcedure inProcedure) override { mProcedure = inProcedure; }
  OS_WindowHandle CreateWindow(const OS_WindowCreateParams& inParams) override;
  void DestroyWindow(OS_WindowHandle inWindow) override;
  bool IsWindow(OS_WindowHandle inWindow) const override;
  bool SubclassWindow(OS_WindowHandle inWindow) override;
  bool UsesOurProcedure(OS_WindowHandle inWindow) const override;
  UTF16String GetClassName(OS_WindowHandle inWindow) const override;
  bool IsWindowOfThisThread(OS_WindowHandle inWindow) const override;
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
  void SetForegroundWindow(OS_WindowHandle inWindow) override;
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
  OS_EventTime GetTickCount() const override { return mNow; }

  // ---- timers ----
  void SetTimer(OS_WindowHandle inWindow, std::uintptr_t inId, unsigned inMilliseconds) override;
  void KillTimer(OS_WindowHandle inWindow, std::uintptr_t inId) override;

  // ---- pointer and cursor ----
  OS_Point GetCursorPos() const override { return mPointer; }
  OS_CursorHandle LoadSystemCursor(int inSystemCursor) override;
  OS_CursorHandle CreateCursorFromPixels(const std::uint32_t* inPixels, int inWidth, int inHeight, int inHotX,
                                         int inHotY) override;
  void DestroyCursor(OS_CursorHandle inCursor) override;
  void SetCursor(OS_CursorHandle inCursor) override { mCursor = inCursor; }
  OS_CursorHandle GetCursor() const override { return mCursor; }
  unsigned GetDoubleClickTime() const override { return 500; }
  OS_Point GetDoubleClickSize() const override { return OS_Point(4, 4); }

  // ---- keyboard ----
  short GetKeyState(int inVirtualKey) const override;
  short GetAsyncKeyState(int inVirtualKey) const override;

  // ---- monitors and preferences ----
  std::vector<OS_Monitor> GetMonitors() const override { return mMonitors; }
  bool GetPreference(const std::string& inName, bool& outValue) const override;

  void ShowCaret(OS_WindowHandle inWindow, bool inShow) override;

  // ---- driving (HeadlessWindowSystem) ----
  void InjectPointerMove(OS_Point inScreenPoint);
  void InjectButton(int inButton, bool inDown);
  void InjectWheel(int inRawDelta, bool inHorizontal);
  void InjectKey(int inVirtualKey, bool inDown, bool inExtended);
  void InjectCharacter(char16_t inCharacter);
  void AdvanceClock(OS_EventTime inMilliseconds);
  int PumpUntilIdle();
  void SetMonitors(std::vector<OS_Monitor> inMonitors) { mMonitors = std::move(inMonitors); }
  // Stores the answer and tells every top level, as a desktop does.
  void SetPreference(const std::string& inName, bool inValue);
  void SetKeyToggled(int inVirtualKey, bool inToggled);
  OS_WindowHandle CreateForeignWindow(const OS_WindowCreateParams& inParams, bool inOtherThread);
  void SetApplication(OS_WindowHandle inWindow, int inApplication);
  void DeactivateApplication();
  void SetIdleWaitLimit(unsigned inMilliseconds) { mIdleWaitLimit = inMilliseconds; }
  std::size_t GetQueueLength() const { return mQueue.size(); }
  int GetCaretCount(OS_WindowHandle inWindow) const;
  unsigned char GetOpacity(OS_WindowHandle inWindow) const;
  bool GetCursorImage(OS_CursorHandle inCursor, std::vector<std::uint32_t>& outPixels, OS_Point& outSize,
                      OS_Point& outHotSpot) const;
  // The window's client pixels; null without a surface. Not a new reference.
  cairo_surface_t* GetWindowSurface(OS_WindowHandle inWindow) const;
  // The virtual screen (the union of the monitors) with every visible window
  // composited bottom to top; the caller destroys it.
  cairo_surface_t* ComposeScreen() const;

  HeadlessWindow* Find(OS_WindowHandle inWindow) const;

 private:
  // windows
  OS_WindowHandle MakeWindow(const OS_WindowCreateParams& inParams, bool inOurs, bool inOtherThread);
  void CollectSubtree(OS_WindowHandle inWindow, std::vector<OS_WindowHandle>& outWindows) const;
  void ForgetWindow(OS_WindowHandle inWindow);
  std::vector<OS_WindowHandle>& SiblingList(const HeadlessWindow& inWindow);
  const std::vector<OS_WindowHandle>& SiblingList(const HeadlessWindow& inWindow) const;
  OS_WindowHandle TopLevelOf(OS_WindowHandle inWindow) const;

  // geometry and z-order
  void PlaceInZOrder(OS_WindowHandle inWindow, OS_WindowHandle inInsertAfter);
  void RaiseOwnedAbove(OS_WindowHandle inOwner);
  void SetVisible(OS_WindowHandle inWindow, bool inVisible, bool inActivate);
  void MoveAndSize(OS_WindowHandle inWindow, const OS_Rect& inRect, int inSizeKind, bool inRedraw);
  OS_WindowHandle ChildFromPoint(OS_WindowHandle inWindow, OS_Point inScreenPoint) const;
  OS_Rect ScreenRectOf(const HeadlessWindow& inWindow) const;
  OS_Rect WorkAreaFor(const OS_Rect& inScreenRect) const;
  void MinimizeWindow(OS_WindowHandle inWindow, bool inActivate);
  void MaximizeWindow(OS_WindowHandle inWindow, bool inActivate);
  void RestoreWindow(OS_WindowHandle inWindow, bool inActivate);

  // activation and focus
  bool CanActivate(OS_WindowHandle inWindow) const;
  void Activate(OS_WindowHandle inWindow, int inCode);
  void ActivateNextAfterLoss(OS_WindowHandle inLeaving);
  void SendActivateApp(int inApplication, bool inActive, OS_WindowHandle inOther);
  void CheckMouseLeave();

  // input
  OS_WindowHandle PointerTarget() const;
  void PostInput(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam, std::intptr_t inLParam,
                 bool inClickInInactiveWindow = false);
  std::uintptr_t MouseKeyBits() const;
  bool HandleClickActivation(const QueuedMessage& inMessage);
  void SendSetCursor(OS_WindowHandle inWindow, unsigned inMouseMessage);

  // queue
  bool DeliverOne();
  int DeliverPaints();
  std::intptr_t CallProcedure(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                              std::intptr_t inLParam);
  int RunTasksAndMessages();
  // Waits for another thread's post; false when none came in time.
  bool WaitForWakeUp();

  // painting
  void EnsureSurface(HeadlessWindow& inWindow);
  bool HasVisibleDamage(const HeadlessWindow& inWindow) const;
  void ComposeWindow(cairo_t* inContext, const HeadlessWindow& inWindow, OS_Point inOrigin) const;

  // timers
  bool FireDueTimer(OS_EventTime inUntil);

  OS_WindowProcedure mProcedure = nullptr;
  std::map<OS_WindowHandle, std::unique_ptr<HeadlessWindow>> mWindows;
  std::vector<OS_WindowHandle> mTopLevels;  // z-order, topmost first
  OS_WindowHandle mNextHandle = 0x1000;

  OS_WindowHandle mActive = 0;
  int mActiveApplication = -1;  // none until something activates
  OS_WindowHandle mFocus = 0;
  OS_WindowHandle mCapture = 0;
  OS_WindowHandle mMouseLeaveWindow = 0;

  std::deque<QueuedMessage> mQueue;
  OS_EventTime mNow = 0;
  OS_EventTime mMessageTime = 0;
  KeyStates mKeys{};         // now
  KeyStates mMessageKeys{};  // as of the message being handled

  OS_Point mPointer;
  int mButtons = 0;  // 1 left, 2 middle, 4 right
  OS_WindowHandle mLastClickWindow = 0;
  unsigned mLastClickMessage = 0;
  OS_EventTime mLastClickTime = 0;
  OS_Point mLastClickPoint;
  bool mLastClickWasDouble = false;

  std::vector<HeadlessTimer> mTimers;
  std::uint64_t mTimerOrder = 0;

  struct LoopLevel {
    bool quit = false;
    int exitCode = 0;
  };
  std::vector<LoopLevel> mLoops;
  unsigned mIdleWaitLimit = 2000;
  std::mutex mWakeMutex;
  std::condition_variable mWakeCondition;
  bool mWoken = false;
  tarsel::threads::AsyncEventLoopAdaptorPtr mExecutor;

  struct Cursor {
    std::vector<std::uint32_t> pixels;
    OS_Point size;
    OS_Point hotSpot;
  };
  std::map<OS_CursorHandle, Cursor> mCursors;
  OS_CursorHandle mNextCursor = 0x10000;
  OS_CursorHandle mCursor = 0;

  std::vector<OS_Monitor> mMonitors;
  std::map<std::string, bool> mPreferences;
  mutable boost::intrusive_ptr<drawbot::SupplierInterface> mSupplier;
};

// US keyboard layout, for the characters that keys type.
std::uint8_t ScanCodeOf(int inVirtualKey);
bool IsExtendedByDefault(int inVirtualKey);
// The character a key down types with the given keyboard, 0 when none.
char16_t CharacterOf(int inVirtualKey, const KeyStates& inKeys);

}  // namespace norvik::ui::headless
