// Input of the headless system: pointer, buttons, wheel and keys injected at
// screen coordinates and routed as a desktop routes them (the capture first,
// then the topmost visible enabled window under the pointer; keys to the
// focus window), with double clicks, click activation and key parameters.
#include <cstdlib>

#include "ui/OS_DefaultWindowProcedure.h"
#include "ui/src/headless/OS_NativeLayer_Headless.h"

namespace norvik::ui::headless {
namespace {

constexpr int kButtonLeft = 1;
constexpr int kButtonMiddle = 2;
constexpr int kButtonRight = 4;
constexpr int kKeyF10 = 121;

int ButtonKey(int inButton) {
  switch (inButton) {
    case kButtonLeft: return kOSKeyLeftButton;
    case kButtonMiddle: return kOSKeyMiddleButton;
    case kButtonRight: return kOSKeyRightButton;
    default: return 0;
  }
}

unsigned ButtonDownMessage(int inButton) {
  switch (inButton) {
    case kButtonLeft: return kOSMsgLeftButtonDown;
    case kButtonMiddle: return kOSMsgMiddleButtonDown;
    default: return kOSMsgRightButtonDown;
  }
}

// The key that a side-specific modifier stands for, and back.
int GenericKey(int inVirtualKey) {
  switch (inVirtualKey) {
    case kOSKeyLeftShift:
    case kOSKeyRightShift: return kOSKeyShift;
    case kOSKeyLeftControl:
    case kOSKeyRightControl: return kOSKeyControl;
    case kOSKeyLeftAlt:
    case kOSKeyRightAlt: return kOSKeyAlt;
    default: return inVirtualKey;
  }
}

int SideKey(int inVirtualKey, bool inExtended) {
  switch (inVirtualKey) {
    case kOSKeyShift: return kOSKeyLeftShift;
    case kOSKeyControl: return inExtended ? kOSKeyRightControl : kOSKeyLeftControl;
    case kOSKeyAlt: return inExtended ? kOSKeyRightAlt : kOSKeyLeftAlt;
    case kOSKeyLeftShift:
    case kOSKeyRightShift:
    case kOSKeyLeftControl:
    case kOSKeyRightControl:
    case kOSKeyLeftAlt:
    case kOSKeyRightAlt: return inVirtualKey;
    default: return 0;
  }
}

bool IsHeld(const KeyStates& inKeys, int inKey) { return (inKeys[static_cast<std::size_t>(inKey)] & kKeyHeld) != 0; }

}  // namespace

OS_WindowHandle OS_NativeLayer_Headless::PointerTarget() const {
  return mCapture != 0 ? mCapture : WindowFromPoint(mPointer);
}

std::uintptr_t OS_NativeLayer_Headless::MouseKeyBits() const {
  std::uintptr_t bits = 0;
  if ((mButtons & kButtonLeft) != 0) bits |= kOSMouseKeyLeft;
  if ((mButtons & kButtonRight) != 0) bits |= kOSMouseKeyRight;
  if ((mButtons & kButtonMiddle) != 0) bits |= kOSMouseKeyMiddle;
  if (IsHeld(mKeys, kOSKeyShift)) bits |= kOSMouseKeyShift;
  if (IsHeld(mKeys, kOSKeyControl)) bits |= kOSMouseKeyControl;
  return bits;
}

void OS_NativeLayer_Headless::PostInput(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                        std::intptr_t inLParam, bool inClickInInactiveWindow) {
  QueuedMessage message;
  message.event = OS_Event(inWindow, inMessage, inWParam, inLParam, mNow);
  message.hasKeyStates = true;
  message.keyStates = mKeys;
  message.clickInInactiveWindow = inClickInInactiveWindow;
  mQueue.push_back(message);
}

void OS_NativeLayer_Headless::InjectPointerMove(OS_Point inScreenPoint) {
  mPointer = inScreenPoint;
  CheckMouseLeave();
  const OS_WindowHandle target = PointerTarget();
  if (target == 0) return;
  const OS_Point local = ScreenToClient(target, inScreenPoint);
  PostInput(target, kOSMsgMouseMove, MouseKeyBits(), MakePointParam(static_cast<int>(local.x), static_cast<int>(local.y)));
}

void OS_NativeLayer_Headless::InjectButton(int inButton, bool inDown) {
  const int key = ButtonKey(inButton);
  if (key == 0) return;
  if (inDown) {
    mButtons |= inButton;
    mKeys[static_cast<std::size_t>(key)] |= kKeyHeld;
  } else {
    mButtons &= ~inButton;
    mKeys[static_cast<std::size_t>(key)] &= static_cast<std::uint8_t>(~kKeyHeld);
  }
  const OS_WindowHandle target = PointerTarget();
  const HeadlessWindow* window = Find(target);
  if (!window) return;
  const OS_Point local = ScreenToClient(target, mPointer);
  const std::intptr_t where = MakePointParam(static_cast<int>(local.x), static_cast<int>(local.y));
  const unsigned down = ButtonDownMessage(inButton);
  if (!inDown) {
    PostInput(target, down + 1, MouseKeyBits(), where);
    return;
  }
  // A second press of the same button, soon enough and near enough, is a
  // double click for windows that ask for them; a third starts over.
  const OS_Point size = GetDoubleClickSize();
  const bool isDouble = (window->classStyle & kOSClassStyleDoubleClicks) != 0 && mLastClickWindow == target &&
                        mLastClickMessage == down && !mLastClickWasDouble &&
                        mNow - mLastClickTime <= static_cast<OS_EventTime>(GetDoubleClickTime()) &&
                        std::labs(mPointer.x - mLastClickPoint.x) <= size.x / 2 &&
                        std::labs(mPointer.y - mLastClickPoint.y) <= size.y / 2;
  mLastClickWasDouble = isDouble;
  mLastClickWindow = target;
  mLastClickMessage = down;
  mLastClickTime = mNow;
  mLastClickPoint = mPointer;
  const bool inactive = mCapture == 0 && TopLevelOf(target) != mActive;
  PostInput(target, isDouble ? down + 2 : down, MouseKeyBits(), where, inactive);
}

void OS_NativeLayer_Headless::InjectWheel(int inRawDelta, bool inHorizontal) {
  OS_WindowHandle target = PointerTarget();
  if (target == 0) target = mFocus;
  if (target == 0) return;
  PostInput(target, inHorizontal ? kOSMsgMouseHorizontalWheel : kOSMsgMouseWheel,
            MakeWParam(static_cast<unsigned>(MouseKeyBits()), static_cast<unsigned>(static_cast<std::uint16_t>(inRawDelta))),
            MakePointParam(static_cast<int>(mPointer.x), static_cast<int>(mPointer.y)));
}

void OS_NativeLayer_Headless::InjectKey(int inVirtualKey, bool inDown, bool inExtended) {
  if (inVirtualKey <= 0 || inVirtualKey > 254) return;
  const int generic = GenericKey(inVirtualKey);
  const bool extended = inExtended || IsExtendedByDefault(inVirtualKey);
  const int side = SideKey(inVirtualKey, extended);
  const bool wasDown = IsHeld(mKeys, side != 0 ? side : generic);
  auto key = [this](int inKey) -> std::uint8_t& { return mKeys[static_cast<std::size_t>(inKey)]; };
  if (inDown) {
    if (!wasDown) key(generic) ^= kKeyToggled;
    key(generic) |= kKeyHeld;
    if (side != 0) key(side) |= kKeyHeld;
  } else {
    if (side != 0) key(side) &= static_cast<std::uint8_t>(~kKeyHeld);
    if (side == 0 || generic == inVirtualKey) {
      key(generic) &= static_cast<std::uint8_t>(~kKeyHeld);
    } else {
      const bool otherSideHeld = generic == kOSKeyShift ? IsHeld(mKeys, kOSKeyLeftShift) || IsHeld(mKeys, kOSKeyRightShift)
                                 : generic == kOSKeyControl
                                     ? IsHeld(mKeys, kOSKeyLeftControl) || IsHeld(mKeys, kOSKeyRightControl)
                                     : IsHeld(mKeys, kOSKeyLeftAlt) || IsHeld(mKeys, kOSKeyRightAlt);
      if (!otherSideHeld) key(generic) &= static_cast<std::uint8_t>(~kKeyHeld);
    }
  }

  // Keys go to the focus window; with none, to the active window as system keys.
  OS_WindowHandle target = mFocus;
  bool system = false;
  if (target == 0) {
    target = mActive;
    system = true;
  }
  if (target == 0) return;
  const bool alt = IsHeld(mKeys, kOSKeyAlt) || (!inDown && generic == kOSKeyAlt);
  const bool ctrl = IsHeld(mKeys, kOSKeyControl);
  system = system || (alt && !ctrl) || generic == kKeyF10;

  std::intptr_t lParam = 1 | (static_cast<std::intptr_t>(ScanCodeOf(inVirtualKey)) << 16);
  if (extended) lParam |= std::intptr_t(1) << 24;
  if (alt && !ctrl) lParam |= std::intptr_t(1) << 29;
  if (!inDown || wasDown) lParam |= std::intptr_t(1) << 30;
  if (!inDown) lParam |= std::intptr_t(1) << 31;
  const unsigned message = inDown ? (system ? kOSMsgSysKeyDown : kOSMsgKeyDown) : (system ? kOSMsgSysKeyUp : kOSMsgKeyUp);
  PostInput(target, message, static_cast<std::uintptr_t>(generic), lParam);
  if (!inDown) return;
  const char16_t character = CharacterOf(generic, mKeys);
  if (character != 0) PostInput(target, system ? kOSMsgSysChar : kOSMsgChar, character, lParam);
}

void OS_NativeLayer_Headless::InjectCharacter(char16_t inCharacter) {
  const OS_WindowHandle target = mFocus != 0 ? mFocus : mActive;
  if (target == 0) return;
  PostInput(target, kOSMsgChar, inCharacter, 1);
}

void OS_NativeLayer_Headless::SetKeyToggled(int inVirtualKey, bool inToggled) {
  if (inVirtualKey <= 0 || inVirtualKey > 254) return;
  for (KeyStates* keys : {&mKeys, &mMessageKeys}) {
    auto& state = (*keys)[static_cast<std::size_t>(inVirtualKey)];
    state = static_cast<std::uint8_t>(inToggled ? state | kKeyToggled : state & ~kKeyToggled);
  }
}

short OS_NativeLayer_Headless::GetKeyState(int inVirtualKey) const {
  if (inVirtualKey <= 0 || inVirtualKey > 254) return 0;
  const std::uint8_t state = mMessageKeys[static_cast<std::size_t>(inVirtualKey)];
  return static_cast<short>(((state & kKeyHeld) != 0 ? 0x8000 : 0) | ((state & kKeyToggled) != 0 ? 1 : 0));
}

short OS_NativeLayer_Headless::GetAsyncKeyState(int inVirtualKey) const {
  if (inVirtualKey <= 0 || inVirtualKey > 254) return 0;
  const std::uint8_t state = mKeys[static_cast<std::size_t>(inVirtualKey)];
  return static_cast<short>(((state & kKeyHeld) != 0 ? 0x8000 : 0) | ((state & kKeyToggled) != 0 ? 1 : 0));
}

bool OS_NativeLayer_Headless::HandleClickActivation(const QueuedMessage& inMessage) {
  const OS_WindowHandle target = inMessage.event.GetHWnd();
  const OS_WindowHandle topLevel = TopLevelOf(target);
  const HeadlessWindow* top = Find(topLevel);
  if (!top || topLevel == mActive || (top->exStyle & kOSExStyleNoActivate) != 0) return true;
  const std::intptr_t answer = CallProcedure(target, kOSMsgMouseActivate, topLevel,
                                             static_cast<std::intptr_t>(MakeWParam(kOSHitClient, inMessage.event.GetMsg())));
  if (!Find(target)) return false;
  if (answer != kOSMouseNoActivate && answer != kOSMouseNoActivateAndEat && CanActivate(topLevel))
    Activate(topLevel, kOSActivationClickActive);
  return answer != kOSMouseActivateAndEat && answer != kOSMouseNoActivateAndEat && Find(target) != nullptr;
}

void OS_NativeLayer_Headless::SendSetCursor(OS_WindowHandle inWindow, unsigned inMouseMessage) {
  CallProcedure(inWindow, kOSMsgSetCursor, inWindow,
                static_cast<std::intptr_t>(MakeWParam(kOSHitClient, inMouseMessage)));
}

std::intptr_t OS_NativeLayer_Headless::DefaultWindowProcedure(OS_WindowHandle inWindow, unsigned inMessage,
                                                              std::uintptr_t inWParam, std::intptr_t inLParam) {
  return DefaultWindowProcedureOver(*this, inWindow, inMessage, inWParam, inLParam);
}

}  // namespace norvik::ui::headless
