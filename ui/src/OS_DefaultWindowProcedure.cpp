#include "ui/OS_DefaultWindowProcedure.h"

namespace norvik::ui {
namespace {
constexpr std::uintptr_t kKeyF4 = 115;
constexpr std::intptr_t kAltDownBit = std::intptr_t(1) << 29;
}  // namespace

OS_WindowHandle TopLevelWindowOf(const OS_NativeLayer& inLayer, OS_WindowHandle inWindow) {
  OS_WindowHandle window = inWindow;
  for (OS_WindowHandle parent = inLayer.GetParent(window); parent != 0; parent = inLayer.GetParent(window))
    window = parent;
  return window;
}

std::intptr_t DefaultWindowProcedureOver(OS_NativeLayer& inLayer, OS_WindowHandle inWindow, unsigned inMessage,
                                         std::uintptr_t inWParam, std::intptr_t inLParam) {
  if (!inLayer.IsWindow(inWindow)) return 0;
  const OS_WindowHandle parent = inLayer.GetParent(inWindow);
  switch (inMessage) {
    case kOSMsgNCCreate:
      return 1;
    case kOSMsgClose:
      inLayer.DestroyWindow(inWindow);
      return 0;
    case kOSMsgActivate:
      if (LowWord(inWParam) != kOSActivationInactive && HighWord(inWParam) == 0) inLayer.SetFocus(inWindow);
      return 0;
    case kOSMsgSetCursor:
      if (parent != 0)
        if (std::intptr_t handled = inLayer.SendMessage(parent, inMessage, inWParam, inLParam)) return handled;
      if (LowWord(static_cast<std::uintptr_t>(inLParam)) == kOSHitClient)
        inLayer.SetCursor(inLayer.LoadSystemCursor(kOSCursorArrow));
      return 0;
    case kOSMsgMouseActivate:
      if (parent != 0)
        if (std::intptr_t answer = inLayer.SendMessage(parent, inMessage, inWParam, inLParam)) return answer;
      return kOSMouseActivate;
    case kOSMsgPaint: {
      const OS_PaintContext context = inLayer.BeginPaint(inWindow);
      inLayer.EndPaint(inWindow, context);
      return 0;
    }
    case kOSMsgMouseWheel:
    case kOSMsgMouseHorizontalWheel:
      return parent != 0 ? inLayer.SendMessage(parent, inMessage, inWParam, inLParam) : 0;
    case kOSMsgSysKeyDown:
      if (inWParam == kKeyF4 && (inLParam & kAltDownBit) != 0)
        inLayer.SendMessage(TopLevelWindowOf(inLayer, inWindow), kOSMsgSysCommand, kOSSysCommandClose, 0);
      return 0;
    case kOSMsgSysCommand:
      switch (inWParam & ~std::uintptr_t(0xF)) {
        case kOSSysCommandMinimize: inLayer.ShowWindow(inWindow, kOSShowMinimize); break;
        case kOSSysCommandMaximize: inLayer.ShowWindow(inWindow, kOSShowMaximized); break;
        case kOSSysCommandRestore: inLayer.ShowWindow(inWindow, kOSShowRestore); break;
        case kOSSysCommandClose: inLayer.SendMessage(inWindow, kOSMsgClose, 0, 0); break;
        default: break;
      }
      return 0;
    default:
      return 0;
  }
}

}  // namespace norvik::ui
