// Mouse and keyboard messages of OS_Window turned into tree events: button
// and wheel translation, click counting past two, mouse-over upkeep, and the
// keyboard rules (character of a key, AltGr, Ctrl characters, extended keys,
// the keypad under Num Lock).
#include "ui/InputPlatform.h"
#include "ui/KeyboardLayout.h"
#include "ui/OS_Window.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {

namespace {

struct ButtonMessage {
  unsigned message;
  MouseEvent::Action action;
  int button;
  int givenCount;
};

constexpr ButtonMessage kButtonMessages[] = {
    {kOSMsgLeftButtonDown, MouseEvent::kActionButtonDown, MouseEvent::kButtonLeft, 1},
    {kOSMsgLeftButtonUp, MouseEvent::kActionButtonUp, MouseEvent::kButtonLeft, 1},
    {kOSMsgLeftButtonDoubleClick, MouseEvent::kActionButtonDown, MouseEvent::kButtonLeft, 2},
    {kOSMsgRightButtonDown, MouseEvent::kActionButtonDown, MouseEvent::kButtonRight, 1},
    {kOSMsgRightButtonUp, MouseEvent::kActionButtonUp, MouseEvent::kButtonRight, 1},
    {kOSMsgRightButtonDoubleClick, MouseEvent::kActionButtonDown, MouseEvent::kButtonRight, 2},
    {kOSMsgMiddleButtonDown, MouseEvent::kActionButtonDown, MouseEvent::kButtonMiddle, 1},
    {kOSMsgMiddleButtonUp, MouseEvent::kActionButtonUp, MouseEvent::kButtonMiddle, 1},
    {kOSMsgMiddleButtonDoubleClick, MouseEvent::kActionButtonDown, MouseEvent::kButtonMiddle, 2},
};

int ButtonsOf(std::uintptr_t inWParam) {
  int buttons = 0;
  if (inWParam & kOSMouseKeyLeft) buttons |= MouseEvent::kButtonLeft;
  if (inWParam & kOSMouseKeyMiddle) buttons |= MouseEvent::kButtonMiddle;
  if (inWParam & kOSMouseKeyRight) buttons |= MouseEvent::kButtonRight;
  return buttons;
}

// Notches of a raw wheel delta: whole notches truncate; a fraction of a
// notch still moves by one, in its direction.
int WheelNotches(int inRaw) {
  const int notches = inRaw / 120;
  if (notches == 0 && inRaw != 0) return inRaw > 1 ? 1 : -1;
  return notches;
}

// The keypad under Num Lock: the platform reports Shift with a keypad key as
// the navigation key without Shift; this gives the digit back.
struct KeypadRewrite {
  short code;
  short newCode;
  unsigned short newCharacter;
};

constexpr KeypadRewrite kKeypadRewrites[] = {
    {12, 101, 53}, {33, 105, 57}, {34, 99, 51},  {35, 97, 49},  {36, 103, 55}, {37, 100, 52},
    {38, 104, 56}, {39, 102, 54}, {40, 98, 50},  {45, 96, 48},  {46, 110, 46},
};

bool IsDown(const OS_NativeLayer& inLayer, int inKey) { return (inLayer.GetKeyState(inKey) & 0x8000) != 0; }

}  // namespace

bool OS_Window::UI_DispatchMouseEventFromOS(OS_Event* inEvent) {
  UI_NodeProtector protect(this);
  const unsigned message = inEvent->GetMsg();
  const PointF position(static_cast<float>(PointParamX(inEvent->GetLParam())),
                        static_cast<float>(PointParamY(inEvent->GetLParam())));
  const ModifierKeys mods = utility::GetRecentEventModKeys();

  if (message == kOSMsgMouseWheel || message == kOSMsgMouseHorizontalWheel)
    return DispatchWheel(inEvent, message == kOSMsgMouseWheel ? MouseEvent::kWheelAxisVertical
                                                              : MouseEvent::kWheelAxisHorizontal);
  if (message == kOSMsgMouseLeave) return DispatchMouseLeave(inEvent);

  MouseEvent::Action action = MouseEvent::kActionMove;
  int buttons = 0;
  int given = 0;
  if (message == kOSMsgMouseMove) {
    buttons = ButtonsOf(inEvent->GetWParam());
    const MouseEvent over(MouseEvent::kActionMouseOver, buttons, 0, position, mods, *inEvent);
    UI_InstallMouseLeavingMessage();
    UI_UpdateMouseOverState(over);
    if (mPlatformWindow == 0) return true;
    // Moves are coalesced: a later one already waits, so this one only
    // updated the mouse-over state.
    OS_Event pending;
    if (OS_NativeLayer* layer = GetNativeLayer();
        layer && layer->PeekMessage(pending, mPlatformWindow, kOSMsgMouseMove, kOSMsgMouseMove, false))
      return false;
  } else {
    bool known = false;
    for (const ButtonMessage& entry : kButtonMessages) {
      if (entry.message != message) continue;
      action = entry.action;
      buttons = entry.button;
      given = entry.givenCount;
      known = true;
    }
    if (!known) return false;
  }
  const int clicks = UI_GetClickCount(given, action, buttons, position);
  const MouseEvent event(action, buttons, clicks, position, mods, *inEvent);
  return UI_DispatchMouseEvent(event, true);
}

bool OS_Window::DispatchWheel(OS_Event* inEvent, int inAxis) {
  const PointF global(static_cast<float>(PointParamX(inEvent->GetLParam())),
                      static_cast<float>(PointParamY(inEvent->GetLParam())));
  // The wheel goes to the window under the pointer when it is one of ours
  // and enabled, not to the one with focus.
  UI_NodeP target(this);
  if (OS_Window* under = GetWindowFromMouse(PointL(static_cast<long>(global.x), static_cast<long>(global.y))))
    if (under->UI_IsEnabled()) target = under;
  const auto raw = static_cast<std::int16_t>(HighWord(inEvent->GetWParam()));
  int delta = WheelNotches(raw);
  if (inAxis == MouseEvent::kWheelAxisHorizontal) delta = -delta;
  const MouseEvent event(MouseEvent::kActionWheel, ButtonsOf(inEvent->GetWParam() & 0xFFFF), 0,
                         target->UI_GlobalToLocalF(global), utility::GetRecentEventModKeys(), *inEvent, delta, inAxis);
  return target->UI_DispatchMouseEvent(event, false);
}

bool OS_Window::DispatchMouseLeave(OS_Event* inEvent) {
  OS_NativeLayer* layer = GetNativeLayer();
  const PointL cursor = layer ? layer->GetCursorPos() : PointL();
  OS_Window* under = GetWindowFromMouse(cursor);
  UI_Node* converter = under ? static_cast<UI_Node*>(under) : this;
  const MouseEvent event(MouseEvent::kActionMouseOver, MouseEvent::kButtonNone, 0,
                         converter->UI_GlobalToLocalF(PointF(cursor)), utility::GetRecentEventModKeys(), *inEvent);
  if (under) {
    UI_NodeProtector protect(under);
    under->UI_UpdateMouseOverState(event);
  } else {
    UI_MouseExited(&event, this);
  }
  return true;
}

int OS_Window::UI_GetClickCount(int inGivenCount, int inAction, int inButtons, const PointF& inPosition) {
  OS_NativeLayer* layer = GetNativeLayer();
  const OS_EventTime now = layer ? layer->GetMessageTime() : 0;
  const bool timeValid = mLastClickTime >= 0;
  const OS_EventTime elapsed = timeValid ? now - mLastClickTime : 0;
  const unsigned doubleClickTime = layer ? layer->GetDoubleClickTime() : 500;
  int count = inGivenCount;
  const bool lastWasButton = mLastMouseAction == MouseEvent::kActionButtonDown ||
                             mLastMouseAction == MouseEvent::kActionButtonUp;
  if (timeValid && static_cast<double>(doubleClickTime) * 0.001 > static_cast<double>(elapsed) * 0.001) {
    if (lastWasButton && inAction == MouseEvent::kActionMove) {
      // A move inside the double-click rectangle keeps the count of the click
      // it follows; one beyond it counts as given and leaves the state alone.
      if (mLastClickCount < 3) return mLastClickCount;
      const OS_Point size = layer ? layer->GetDoubleClickSize() : OS_Point(4, 4);
      const float halfX = static_cast<float>(size.x / 2), halfY = static_cast<float>(size.y / 2);
      const float dx = inPosition.x - mLastClickPoint.x, dy = inPosition.y - mLastClickPoint.y;
      if (dx >= -halfX && dx <= halfX && dy >= -halfY && dy <= halfY) return mLastClickCount;
      return inGivenCount;
    }
    if ((inAction == MouseEvent::kActionButtonDown || inAction == MouseEvent::kActionButtonUp) && lastWasButton &&
        inButtons == mLastButtons && mLastClickCount != 1) {
      count = mLastClickCount + (inAction == MouseEvent::kActionButtonDown ? 1 : 0);
    }
  }
  mLastMouseAction = inAction;
  mLastButtons = inButtons;
  mLastClickTime = now;
  if (inAction == MouseEvent::kActionButtonDown) {
    mLastClickPoint = inPosition;
    mLastClickCount = count;
  }
  return count;
}

KeyboardEvent OS_Window::UI_GetKeyboardEventFromOSEvent(const OS_Event& inEvent) const {
  OS_NativeLayer* layer = GetNativeLayer();
  ModifierKeys mods = utility::GetRecentEventModKeys();
  const unsigned message = inEvent.GetMsg();
  const auto lParam = static_cast<std::uintptr_t>(inEvent.GetLParam());
  const bool keyMessage = message == kOSMsgKeyDown || message == kOSMsgKeyUp || message == kOSMsgSysKeyDown ||
                          message == kOSMsgSysKeyUp;
  int osCode = 0;
  unsigned short character = 0;
  if (keyMessage) {
    osCode = static_cast<int>(inEvent.GetWParam());
    const KeyboardLayoutInterface& keyboard = GetKeyboardLayout();
    character = keyboard.KeyToCharacter(keyboard.GetActiveLayout(), static_cast<short>(osCode));
  } else {
    character = static_cast<unsigned short>(inEvent.GetWParam());
    osCode = layer ? layer->ScanCodeToVirtualKey((lParam >> 16) & 0xFF) : 0;
    // Right Alt reports Ctrl with it: that is AltGr, not a Ctrl shortcut.
    if (layer && IsDown(*layer, kOSKeyRightAlt)) mods.Clear(kModKeyCtrl);
    if (mods.Test(kModKeyCtrl) && character != osCode && (character < 32 || character == 127) && osCode != 0)
      character = static_cast<unsigned short>(osCode);
  }
  if ((lParam & (std::uintptr_t(1) << 24)) && osCode != kOSKeyShift && osCode != kOSKeyControl &&
      osCode != kOSKeyAlt)
    osCode = -osCode;

  KeyboardEvent::Action action = KeyboardEvent::kActionKeyDown;
  bool repeat = false;
  const bool bit30 = (lParam & (std::uintptr_t(1) << 30)) != 0;
  switch (message) {
    case kOSMsgKeyDown:
    case kOSMsgSysKeyDown:
      action = KeyboardEvent::kActionKeyDown;
      repeat = bit30;
      break;
    case kOSMsgKeyUp:
    case kOSMsgSysKeyUp:
      action = KeyboardEvent::kActionKeyUp;
      break;
    case kOSMsgChar:
    case kOSMsgSysChar:
      action = KeyboardEvent::kActionKeyChar;
      repeat = bit30;
      break;
    default:
      action = KeyboardEvent::kActionKeyDeadChar;
      repeat = bit30;
      break;
  }
  if (keyMessage && layer && (layer->GetKeyState(kOSKeyNumLock) & 1)) {
    for (const KeypadRewrite& entry : kKeypadRewrites) {
      if (entry.code != osCode) continue;
      osCode = entry.newCode;
      character = entry.newCharacter;
      mods.Set(kModKeyShift);
      break;
    }
  }
  return KeyboardEvent(action, character, static_cast<short>(osCode), mods, repeat, inEvent);
}

bool OS_Window::UI_DispatchKeyboardEventFromOS(OS_Event* inEvent) {
  UI_NodeProtector protect(this);
  const KeyboardEvent event = UI_GetKeyboardEventFromOSEvent(*inEvent);
  UI_Node* focus = UI_GetKeyboardFocusLeafNode();
  return UI_DispatchKeyboardEvent(focus ? focus : this, event);
}

}  // namespace norvik::ui
