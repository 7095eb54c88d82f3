#pragma once
// A native message as the tree sees it: the window it was sent to, the
// message number, its two parameters, the answer that goes back to the
// platform, and the time it was posted. The record is platform-neutral; each
// port translates its own events into these numbers, so that the code that
// reads messages is written once. Mouse and keyboard events carry a copy by
// value.
#include <cstdint>
#include <memory>

namespace norvik::ui {

// A native window as the platform names it (an X11 window id, a headless
// window's key). 0 is "no window".
using OS_WindowHandle = std::uintptr_t;
// Milliseconds of the platform's event clock.
using OS_EventTime = std::int64_t;

// Message numbers. The platform layers translate their native events into
// these; everything above them speaks only these numbers.
enum OS_Message : unsigned {
  kOSMsgNull = 0,
  kOSMsgDestroy = 2,
  kOSMsgSize = 5,
  kOSMsgActivate = 6,
  kOSMsgSetFocus = 7,
  kOSMsgKillFocus = 8,
  kOSMsgPaint = 15,
  kOSMsgClose = 16,
  kOSMsgEraseBackground = 20,
  kOSMsgSettingChange = 26,  // the desktop's settings changed; sent to top levels
  kOSMsgActivateApp = 28,
  kOSMsgSetCursor = 32,
  kOSMsgMouseActivate = 33,
  kOSMsgGetMinMaxInfo = 36,
  kOSMsgNCCreate = 129,
  kOSMsgNCDestroy = 130,
  kOSMsgNCHitTest = 132,
  kOSMsgKeyDown = 256,
  kOSMsgKeyUp = 257,
  kOSMsgChar = 258,
  kOSMsgDeadChar = 259,
  kOSMsgSysKeyDown = 260,
  kOSMsgSysKeyUp = 261,
  kOSMsgSysChar = 262,
  kOSMsgSysDeadChar = 263,
  kOSMsgCommand = 273,
  kOSMsgSysCommand = 274,
  kOSMsgTimer = 275,
  kOSMsgMouseMove = 512,
  kOSMsgLeftButtonDown = 513,
  kOSMsgLeftButtonUp = 514,
  kOSMsgLeftButtonDoubleClick = 515,
  kOSMsgRightButtonDown = 516,
  kOSMsgRightButtonUp = 517,
  kOSMsgRightButtonDoubleClick = 518,
  kOSMsgMiddleButtonDown = 519,
  kOSMsgMiddleButtonUp = 520,
  kOSMsgMiddleButtonDoubleClick = 521,
  kOSMsgMouseWheel = 522,
  kOSMsgMouseHorizontalWheel = 526,
  kOSMsgCaptureChanged = 533,
  kOSMsgEnterSizeMove = 561,
  kOSMsgExitSizeMove = 562,
  kOSMsgMouseLeave = 675,
  kOSMsgPrintClient = 792,
};

// Button and modifier bits of the first parameter of mouse-move and wheel
// messages.
enum OS_MouseKeyBits : std::uintptr_t {
  kOSMouseKeyLeft = 1,
  kOSMouseKeyRight = 2,
  kOSMouseKeyShift = 4,
  kOSMouseKeyControl = 8,
  kOSMouseKeyMiddle = 16,
};

// Polymorphic base of native events, so that a port can derive a richer
// record; the toolkit itself only ever makes OS_Event.
class OS_EventBase {
 public:
  virtual ~OS_EventBase() = default;
  virtual std::unique_ptr<OS_EventBase> Copy() const = 0;

 protected:
  OS_EventBase() = default;
  OS_EventBase(const OS_EventBase&) = default;
  OS_EventBase& operator=(const OS_EventBase&) = default;
};

class OS_Event : public OS_EventBase {
 public:
  OS_Event() = default;
  OS_Event(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam, std::intptr_t inLParam,
           OS_EventTime inTime = 0)
      : mHWnd(inWindow), mMsg(inMessage), mWParam(inWParam), mLParam(inLParam), mTime(inTime) {}
  OS_Event(const OS_Event&) = default;
  OS_Event& operator=(const OS_Event&) = default;

  OS_WindowHandle GetHWnd() const { return mHWnd; }
  unsigned GetMsg() const { return mMsg; }
  std::uintptr_t GetWParam() const { return mWParam; }
  std::intptr_t GetLParam() const { return mLParam; }
  std::intptr_t GetResult() const { return mResult; }
  void SetResult(std::intptr_t inResult) { mResult = inResult; }
  OS_EventTime GetTime() const { return mTime; }

  std::unique_ptr<OS_EventBase> Copy() const override { return std::make_unique<OS_Event>(*this); }

 private:
  OS_WindowHandle mHWnd = 0;
  unsigned mMsg = kOSMsgNull;
  std::uintptr_t mWParam = 0;
  std::intptr_t mLParam = 0;
  std::intptr_t mResult = 0;
  OS_EventTime mTime = 0;
};

}  // namespace norvik::ui
