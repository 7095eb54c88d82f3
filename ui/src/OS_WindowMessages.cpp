// The message table of OS_Window: which native messages the tree treats and
// how. A handled message gets its result here and answers false; every other
// message goes to the default handling.
#include <memory>

#include "drawbot/Drawbot.h"
#include "drawbot/SupplierInterface.h"
#include "drawbot/SurfaceInterface.h"
#include "ui/InputPlatform.h"
#include "ui/ActionRecorder.h"
#include "ui/OS_Window.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {

namespace {

// The minimise logic: the window last minimised, and the client size it had
// when the minimise command came. Restoring it to that size is no size change.
OS_WindowHandle sMinimizedWindow = 0;
long sMinimizedWidth = -1;
long sMinimizedHeight = -1;

}  // namespace

bool OS_Window::UI_DispatchEvent(OS_Event* inEvent) {
  UI_NodeManager* manager = UI_NodeManager::Get();
  switch (inEvent->GetMsg()) {
    case kOSMsgSize:
      return HandleSize(inEvent);
    case kOSMsgActivate:
      HandleActivate(inEvent);
      return false;
    case kOSMsgSetFocus:
      UI_OSSetFocus(this, false);
      return true;
    case kOSMsgKillFocus:
      UI_OSKillFocus(this, inEvent->GetWParam());
      return true;
    case kOSMsgPaint:
      return !UI_Paint(inEvent);
    case kOSMsgEraseBackground:
      if (!UI_SupportsDrawbot()) return true;
      inEvent->SetResult(UI_PaintBackground(inEvent) ? 1 : 0);
      return false;
    case kOSMsgActivateApp:
      UI_DefaultHandleOSEvent(inEvent);
      if (manager) manager->SetApplicationFrontmost(inEvent->GetWParam() != 0);
      return false;
    case kOSMsgSettingChange:
      if (manager && manager->GetCustomSettingsManager()) manager->GetCustomSettingsManager()->ReloadOSPreferences();
      return true;
    case kOSMsgSetCursor:
      return HandleSetCursor(inEvent);
    case kOSMsgMouseActivate:
      return HandleMouseActivate(inEvent);
    case kOSMsgGetMinMaxInfo:
      // While a structure rectangle is being set it may be larger than the
      // screen.
      if (mSettingStructureRect <= 0 || inEvent->GetLParam() == 0) return true;
      reinterpret_cast<OS_MinMaxInfo*>(inEvent->GetLParam())->maxTrackSize =
          OS_Point(mStructureRect.width, mStructureRect.height);
      inEvent->SetResult(0);
      return false;
    case kOSMsgKeyDown:
    case kOSMsgKeyUp:
    case kOSMsgChar:
    case kOSMsgSysKeyDown:
    case kOSMsgSysKeyUp:
    case kOSMsgSysChar:
      return !UI_DispatchKeyboardEventFromOS(inEvent);
    case kOSMsgCommand:
      HandleCommand(inEvent);
      return true;
    case kOSMsgSysCommand:
      if ((inEvent->GetWParam() & 0xFFF0) == kOSSysCommandMinimize) {
        const RectL client = UI_GetLocalRect();
        sMinimizedWidth = client.width;
        sMinimizedHeight = client.height;
      }
      return true;
    case kOSMsgTimer:
      return !UI_DispatchPossibleTimer(static_cast<long>(inEvent->GetWParam()));
    case kOSMsgCaptureChanged:
      if (manager) manager->EndInputCapture(true);
      return true;
    case kOSMsgEnterSizeMove:
      if (manager) manager->BeginUserResizing(this, true);
      return true;
    case kOSMsgExitSizeMove:
      if (manager) manager->EndUserResizing(this, true);
      return true;
    case kOSMsgMouseLeave:
      UI_DispatchMouseEventFromOS(inEvent);
      return true;
    case kOSMsgPrintClient:
      return HandlePrintClient(inEvent);
    default:
      break;
  }
  const unsigned message = inEvent->GetMsg();
  if ((message >= kOSMsgMouseMove && message <= kOSMsgMouseWheel) || message == kOSMsgMouseHorizontalWheel)
    return !UI_DispatchMouseEventFromOS(inEvent);
  return true;
}

bool OS_Window::HandleSize(OS_Event* inEvent) {
  const OS_WindowHandle handle = inEvent->GetHWnd();
  if (inEvent->GetWParam() == kOSSizeMinimized) {
    sMinimizedWindow = handle;
    return true;
  }
  const long width = static_cast<long>(LowWord(static_cast<std::uintptr_t>(inEvent->GetLParam())));
  const long height = static_cast<long>(HighWord(static_cast<std::uintptr_t>(inEvent->GetLParam())));
  if (sMinimizedWindow == handle) {
    sMinimizedWindow = 0;
    if (width == sMinimizedWidth && height == sMinimizedHeight) return true;
  }
  UI_SizeChanged(RectF(0, 0, static_cast<float>(width), static_cast<float>(height)));
  inEvent->SetResult(0);
  return true;
}

void OS_Window::HandleActivate(OS_Event* inEvent) {
  UI_NodeProtector protect(this);
  const unsigned code = LowWord(inEvent->GetWParam());
  if (code <= kOSActivationClickActive) {
    static const WindowActivation kActivations[] = {kWindowInactive, kWindowActive, kWindowActivatedByClick};
    UI_ActivationChanged(kActivations[code]);
  }
  // The platform moves focus to the top window on activation; a focus that
  // was inside this window is put back where it was.
  const UI_NodeP focus(UI_GetKeyboardFocusLeafNode());
  const bool wasInside = focus && focus.get() != this && focus->UI_IsChildOf(*this);
  UI_DefaultHandleOSEvent(inEvent);
  if (!wasInside) return;
  if (focus->UI_GetParentNode() && focus->UI_IsShown()) {
    focus->UI_GainKeyboardFocus(kFocusChangeRestore);
  } else {
    UI_GainKeyboardFocus(kFocusChangeRestore);
  }
}

bool OS_Window::HandleSetCursor(OS_Event* inEvent) {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || !mPlatformWindow) return true;
  if (UI_NodeManager* manager = UI_NodeManager::Get(); manager && manager->HasModalWindow()) {
    UI_Node* modal = manager->GetModalWindow();
    if (!modal) return true;
    if (modal != this && !modal->UI_IsChild(UI_NodeP(this))) return true;
  }
  const PointL point = layer->ScreenToClient(mPlatformWindow, layer->GetCursorPos());
  // Outside the client area the caption and borders keep their own cursors.
  if (!UI_GetLocalRect().Contains(point)) return true;
  if (UI_DispatchCursor(PointF(point), utility::GetRecentEventModKeys(), true)) {
    inEvent->SetResult(0);
    return false;
  }
  if (UI_GetParentNode()) return true;
  layer->SetCursor(layer->LoadSystemCursor(kOSCursorArrow));
  inEvent->SetResult(0);
  return false;
}

bool OS_Window::HandleMouseActivate(OS_Event* inEvent) {
  UI_NodeManager* manager = UI_NodeManager::Get();
  OS_NativeLayer* layer = GetNativeLayer();
  if (!manager || !layer || !manager->IsSuspendingOSMouseActivates()) {
    const PointL global = layer ? layer->GetCursorPos() : PointL();
    const MouseEvent event(MouseEvent::kActionButtonDown, MouseEvent::kButtonNone, 1,
                           UI_GlobalToLocalF(PointF(global)), utility::GetRecentEventModKeys(), *inEvent);
    if (!UI_DoMouseActivate(event)) return true;
    inEvent->SetResult(0);
    return false;
  }
  const auto wParamWindow = static_cast<OS_WindowHandle>(inEvent->GetWParam());
  if (layer->GetForegroundWindow() == wParamWindow) {
    inEvent->SetResult(0);
    return false;
  }
  if (!manager->IsApplicationFrontmost()) {
    auto top = reinterpret_cast<OS_WindowHandle>(manager->GetSuspendOSMouseActivatePlatformWindow());
    if (top == 0) {
      for (OS_WindowHandle w = layer->GetTopWindow(0); w != 0; w = layer->GetNextWindow(w, kOSWindowNext)) {
        if (layer->IsWindowOfThisThread(w) == layer->IsWindowOfThisThread(wParamWindow) &&
            layer->IsWindowVisible(w)) {
          top = w;
          break;
        }
      }
    }
    if (top != 0) layer->SetForegroundWindow(top);
  }
  inEvent->SetResult(kOSMouseNoActivateAndEat);
  return false;
}

void OS_Window::HandleCommand(OS_Event* inEvent) {
  const unsigned code = HighWord(inEvent->GetWParam());
  if (code == 0) automateui::ActionRecorder::GetInstance().RecordMenuItemEvent(this, LowWord(inEvent->GetWParam()));
  if (code != kOSEditSetFocus && code != kOSEditKillFocus) return;
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer) return;
  const auto control = static_cast<OS_WindowHandle>(inEvent->GetLParam());
  OS_Window* window = this;
  if (control != 0 && UI_IsOSWindowType(control))
    if (OS_Window* found = UI_GetWindow(control)) window = found;
  UI_NodeProtector protect(window);
  const OS_WindowHandle caretWindow = control != 0 ? control : mPlatformWindow;
  const bool readOnly = control != 0 && (layer->GetStyle(control) & kOSEditStyleReadOnly) != 0;
  // A read-only field never shows a caret while it has focus.
  if (code == kOSEditKillFocus) {
    UI_OSKillFocus(window, 0);
    if (readOnly) layer->ShowCaret(caretWindow, true);
  } else {
    UI_OSSetFocus(window, window == this);
    if (readOnly) layer->ShowCaret(caretWindow, false);
  }
}

bool OS_Window::HandlePrintClient(OS_Event* inEvent) {
  const RectL local = UI_GetLocalRect();
  if (!UI_SupportsDrawbot() || local.width <= 0 || local.height <= 0) return true;
  drawbot::SupplierInterface* supplier = UI_GetDrawSupplier();
  if (!supplier) return true;
  drawbot::SurfaceInterfaceP surface(
      supplier->NewSurface(reinterpret_cast<drawbot::NativeDrawTarget>(inEvent->GetWParam()), nullptr, false));
  if (!surface) return true;
  drawbot::Drawbot drawbot(supplier, surface.get());
  UI_Draw(&drawbot);
  surface->Flush();
  inEvent->SetResult(0);
  return false;
}

}  // namespace norvik::ui
