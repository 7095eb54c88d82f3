#pragma once
// OS_Window is a node bound to one native window. Native messages come in
// through the toolkit's window procedure and become tree events (mouse,
// keyboard, focus, activation, paint, timers); tree operations (show, move,
// invalidate, capture, focus) become native calls. Everything else in the
// toolkit knows the platform only through this class, OS_Event and the view
// containers built on it.
//
// The tie from a native handle to its node is a window property; the node
// holds the handle. A node whose native window was destroyed from outside
// keeps living with a null handle, and the operations that need one do
// nothing.
#include <cstdint>
#include <functional>
#include <vector>

#include "ui/MouseEvent.h"
#include "ui/KeyboardEvent.h"
#include "ui/OS_NativeLayer.h"
#include "ui/UI_Node.h"
#include "ui/UI_NodeTimerManager.h"
#include "ui/UI_Window.h"

namespace norvik::ui {

class OS_Window;
using OS_WindowP = boost::intrusive_ptr<OS_Window>;

// A node timer backed by a native timer on its window: created with the
// record, killed when the record goes. The record's key is the native id.
class OS_NodeTimerData : public UI_NodeTimerData {
 public:
  OS_NodeTimerData(OS_Window* inWindow, UI_Node* inNode, long inTimerID, float inSeconds);
  ~OS_NodeTimerData() override;

 private:
  OS_WindowHandle mWindow;
};

class OS_Window : public UI_Node, public UI_Window {
 public:
  // The native class of the toolkit's windows and the property that ties a
  // handle to its node.
  static const UTF16String& GetWindowClassName();
  static const char* const kWindowProperty;

  OS_Window();
  ~OS_Window() override;

  // Installs the toolkit's window procedure on the native layer; idempotent
  // per layer. Creating a window does this on its own.
  static void UI_Initialize();

  // ---- statics that find windows ----
  static OS_Window* UI_GetWindow(OS_WindowHandle inHandle);
  static OS_Window* GetWindowFromMouse(const PointL& inGlobalPoint);
  static bool UI_IsOSWindowType(OS_WindowHandle inHandle);
  static void UI_EnumerateAllWindows(const std::function<void(OS_Window*)>& inFunction);
  static void UI_FindAllWindowsMatchingID(const UTF8String& inID, std::vector<OS_Window*>& outResult);
  static OS_Window* UI_FindWindowFromID(const UTF8String& inID);
  static PointL GetGlobalMousePosition();

  // The toolkit's window procedure, as the native layer calls it.
  static std::intptr_t WindowProcedure(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                       std::intptr_t inLParam);

  OS_WindowHandle GetHandle() const { return mPlatformWindow; }

  // ---- UI_Window ----
  std::uintptr_t GetPlatformWindow(bool inMayBeNull) const override;
  void UI_SetTitle(const UTF16String& inTitle) override;
  bool UI_IsMinimized() const override;
  void UI_Minimize() override;
  RectL UI_GetGlobalStructureRect() const override;
  void UI_SetGlobalStructureRect(const RectL& inRect) override;
  void UI_Move(const PointL& inPoint) override;
  void UI_Activate() override;

  // ---- overrides of UI_Node ----
  Matrix UI_GetSelfToParentMatrix() const override;
  RectL UI_GetLocalRect() const override;
  RectF UI_GetLocalRectF(bool inInParent) const override;
  void UI_SetLocalRect(const RectL& inRect) override;
  void UI_SetLocalRectF(const RectF& inRect) override;
  void UI_Show(bool inShow) override;
  bool UI_IsShown() const override;
  bool UI_AreAllParentsVisible() const override;
  void UI_Invalidate(const RectL* inRect, unsigned long inFlags) override;
  void UI_UpdateNow(unsigned long inFlags) override;
  void UI_SetOpacity(float inOpacity) override;
  void UI_SetParent(UI_Container* inParent) override;
  drawbot::SupplierInterface* UI_GetDrawSupplier() const override;
  void UI_SetCapture() override;
  void UI_ReleaseCapture() override;
  bool UI_ReceivesEventsFromOS() const override { return true; }
  void UI_DisabledStateChanged() override;
  void UI_HandleOSEvent(OS_Event* inEvent) override;
  bool UI_DispatchEvent(OS_Event* inEvent) override;
  void UI_SetKeyboardFocusWithOS() override;
  UI_NodeTimerManager* UI_GetTimerManager(bool inFlag) override;
  const UI_NodeTimerManager* UI_GetTimerManager(bool inFlag) const override;
  void ChildAdded(UI_Node* inChild) override;
  void ChildRemoved(UI_Node* inChild) override;

  // ---- virtual operations added here, in slot order ----
  virtual void UI_AttachOSWindow(OS_WindowHandle inHandle);
  virtual void UI_SetTransparentColorKey(std::uint32_t inColorKey);
  virtual void UI_SetOpacityAndTransparentColorKey(float inOpacity, std::uint32_t inColorKey);
  // Creates a native window of the toolkit's class with this node as its
  // creation parameter; answers the handle (0 when refused).
  virtual OS_WindowHandle UI_CreateWindow(const UTF16String& inTitle, OS_WindowHandle inParent, const RectL& inRect,
                                          std::uint32_t inStyle, std::uint32_t inExStyle,
                                          std::uint32_t inClassStyle = kOSClassStyleDoubleClicks);
  // Takes over a window made elsewhere: its messages now come here.
  virtual void UI_AttachWindow(OS_WindowHandle inHandle);
  // Makes the native parent the window of the nearest ancestor that receives
  // events from the platform.
  virtual void UI_SynchronizeParent();
  virtual bool UI_Paint(OS_Event* inEvent);
  virtual bool UI_PaintBackground(OS_Event* /*inEvent*/) { return false; }
  virtual bool UI_DispatchMouseEventFromOS(OS_Event* inEvent);
  virtual bool UI_DispatchKeyboardEventFromOS(OS_Event* inEvent);

  // ---- plain operations ----
  void UI_DetachOSWindow();
  // Removes the property and forgets the handle without destroying the window.
  void DetachPlatformWindowPreDelete();
  void UI_SynchronizeParentForPopupBornWindow();
  void UI_InstallMouseLeavingMessage();
  // Layered attributes: opacity in [0, 1] (1 removes the layering), and a
  // colour key when inColorKey is given.
  void SetExWindowAttributes(float inOpacity, const std::uint32_t* inColorKey);
  // Runs the platform's answer (or the client's function) for a message the
  // tree did not handle.
  void UI_DefaultHandleOSEvent(OS_Event* inEvent);
  // The click count of a mouse message, extending the platform's double
  // click to three and more.
  int UI_GetClickCount(int inGivenCount, int inAction, int inButtons, const PointF& inPosition);
  // The keyboard event of a key or character message.
  KeyboardEvent UI_GetKeyboardEventFromOSEvent(const OS_Event& inEvent) const;

  // Raises the structure-rectangle depth for its lifetime, with the
  // rectangle being set; the old values come back at the end.
  class SetGlobalStructureRect {
   public:
    SetGlobalStructureRect(OS_Window& inWindow, const RectL& inRect);
    ~SetGlobalStructureRect();
    SetGlobalStructureRect(const SetGlobalStructureRect&) = delete;
    SetGlobalStructureRect& operator=(const SetGlobalStructureRect&) = delete;

   private:
    OS_Window& mWindow;
    RectL mOldRect;
  };

 protected:
  OS_WindowHandle mPlatformWindow = 0;
  UI_NodeTimerManager mTimerManager;
  bool mWasShownBeforeDetach = false;
  int mSettingStructureRect = 0;
  RectL mStructureRect;
  OS_EventTime mLastClickTime = -1;  // below 0: no click yet
  int mLastMouseAction = 0;
  int mLastButtons = 0;
  PointF mLastClickPoint;
  int mLastClickCount = 0;

 private:
  static std::intptr_t InnerWindowProcedure(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                            std::intptr_t inLParam);
  void HandleActivate(OS_Event* inEvent);
  bool HandleSetCursor(OS_Event* inEvent);
  bool HandleMouseActivate(OS_Event* inEvent);
  void HandleCommand(OS_Event* inEvent);
  bool HandleSize(OS_Event* inEvent);
  bool HandlePrintClient(OS_Event* inEvent);
  bool DispatchWheel(OS_Event* inEvent, int inAxis);
  bool DispatchMouseLeave(OS_Event* inEvent);
  void PaintRun(drawbot::SupplierInterface* inSupplier, void* inTarget, void* inRegion);
};

}  // namespace norvik::ui
