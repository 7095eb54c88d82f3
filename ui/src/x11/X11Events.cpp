// X events in, toolkit messages out: translation, the queue, timers and the loop.
#include <poll.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>

#include "tarsel/ErrorManager.h"
#include "ui/OS_DefaultWindowProcedure.h"
#include "ui/src/NativeQueueScan.h"
#include "ui/src/x11/OS_NativeLayer_X11.h"

namespace norvik::ui::x11 {
namespace {

constexpr int kWheelNotch = 120;

bool IsMouseMessage(unsigned inMessage) {
  return (inMessage >= kOSMsgMouseMove && inMessage <= kOSMsgMouseWheel) || inMessage == kOSMsgMouseHorizontalWheel;
}

// The button and modifier bits of mouse messages, from the X state mask.
std::uintptr_t MouseKeys(std::uint16_t inState) {
  std::uintptr_t keys = 0;
  if (inState & XCB_BUTTON_MASK_1) keys |= kOSMouseKeyLeft;
  if (inState & XCB_BUTTON_MASK_2) keys |= kOSMouseKeyMiddle;
  if (inState & XCB_BUTTON_MASK_3) keys |= kOSMouseKeyRight;
  if (inState & XCB_MOD_MASK_SHIFT) keys |= kOSMouseKeyShift;
  if (inState & XCB_MOD_MASK_CONTROL) keys |= kOSMouseKeyControl;
  return keys;
}

std::uintptr_t ButtonBit(int inButton) {
  return inButton == 1 ? kOSMouseKeyLeft : inButton == 2 ? kOSMouseKeyMiddle : kOSMouseKeyRight;
}

unsigned DownMessage(int inButton) {
  return inButton == 1 ? kOSMsgLeftButtonDown : inButton == 2 ? kOSMsgMiddleButtonDown : kOSMsgRightButtonDown;
}

}  // namespace

OS_EventTime OS_NativeLayer_X11::GetTickCount() const {
  return std::chrono::duration_cast<std::chrono::milliseconds>(std::chrono::steady_clock::now() - mStart).count();
}

// While the pointer is over one of our windows, or grabbed, every motion is
// reported to us, so the last event tells where it is without a round trip to
// the server (which would cost more than the rest of a motion's handling).
OS_Point OS_NativeLayer_X11::GetCursorPos() const {
  if (mPointerInside || mCapture != 0) return mPointer;
  xcb_query_pointer_reply_t* reply =
      xcb_query_pointer_reply(mConnection, xcb_query_pointer(mConnection, mScreen->root), nullptr);
  if (!reply) return mPointer;
  OS_Point point(reply->root_x, reply->root_y);
  std::free(reply);
  return point;
}

void OS_NativeLayer_X11::Queue(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                               std::intptr_t inLParam, bool inWithKeys) {
  X11Message message;
  message.event = OS_Event(inWindow, inMessage, inWParam, inLParam, GetTickCount());
  if (inWithKeys) {
    message.keyStates = mKeyStates;
    message.hasKeyStates = true;
  }
  // Moves are coalesced: a newer position replaces one still waiting.
  if (inMessage == kOSMsgMouseMove && !mQueue.empty() && mQueue.back().event.GetMsg() == kOSMsgMouseMove &&
      mQueue.back().event.GetHWnd() == inWindow) {
    mQueue.back() = message;
    return;
  }
  mQueue.push_back(message);
}

OS_WindowHandle OS_NativeLayer_X11::MouseTarget(OS_WindowHandle inEventWindow, OS_Point inScreen) const {
  if (mCapture != 0) return mCapture;
  const OS_WindowHandle top = TopLevelOf(inEventWindow);
  if (!Find(top)) return 0;
  const OS_WindowHandle target = DeepestAt(top, inScreen);
  return IsWindowEnabled(target) ? target : 0;
}

void OS_NativeLayer_X11::NotifyPointerWindow(OS_WindowHandle inWindow) {
  if (inWindow == mPointerWindow) return;
  const OS_WindowHandle old = mPointerWindow;
  mPointerWindow = inWindow;
  if (X11Window* left = Find(old); left && left->trackLeave) {
    left->trackLeave = false;
    Queue(old, kOSMsgMouseLeave, 0, 0, true);
  }
}

// A click in a window whose top level is not active asks the window whether it
// activates and whether the click is eaten, as desktops do.
bool OS_NativeLayer_X11::ClickActivates(OS_WindowHandle inTarget, unsigned inMessage) {
  const OS_WindowHandle top = TopLevelOf(inTarget);
  const X11Window* window = Find(top);
  if (!window || top == mActive || window->overrideRedirect || (window->exStyle & kOSExStyleNoActivate)) return true;
  const std::intptr_t answer = CallProcedure(inTarget, kOSMsgMouseActivate, top,
                                             static_cast<std::intptr_t>(MakeWParam(kOSHitClient, inMessage)));
  if (!Find(inTarget)) return false;
  if (answer != kOSMouseNoActivate && answer != kOSMouseNoActivateAndEat) SetActiveWindow(top);
  return answer != kOSMouseActivateAndEat && answer != kOSMouseNoActivateAndEat && Find(inTarget);
}

// Where the layer places a pointer event on the screen. Taken from the
// position inside the window the event came to, so that a window manager's
// frame, or a screen position the layer has not heard of yet, never shifts
// the point inside our windows.
OS_Point OS_NativeLayer_X11::PointerOnScreen(xcb_window_t inEventWindow, std::int16_t inX, std::int16_t inY,
                                             std::int16_t inRootX, std::int16_t inRootY) const {
  if (!Find(inEventWindow)) return OS_Point(inRootX, inRootY);
  return ClientToScreen(inEventWindow, OS_Point(inX, inY));
}

void OS_NativeLayer_X11::TranslateButton(const xcb_button_press_event_t* inEvent, bool inPress) {
  const OS_Point screen = PointerOnScreen(inEvent->event, inEvent->event_x, inEvent->event_y, inEvent->root_x,
                                          inEvent->root_y);
  mPointer = screen;
  mPointerInside = inEvent->same_screen != 0;
  const OS_WindowHandle target = MouseTarget(inEvent->event, screen);
  if (!target) return;
  const int xButton = inEvent->detail;
  if (xButton >= 4 && xButton <= 7) {
    if (!inPress) return;
    const bool horizontal = xButton >= 6;
    const int delta = (xButton == 4 || xButton == 7) ? kWheelNotch : -kWheelNotch;
    Queue(target, horizontal ? kOSMsgMouseHorizontalWheel : kOSMsgMouseWheel,
          MakeWParam(static_cast<unsigned>(MouseKeys(inEvent->state)), static_cast<unsigned>(delta & 0xFFFF)),
          MakePointParam(static_cast<int>(screen.x), static_cast<int>(screen.y)), true);
    return;
  }
  if (xButton < 1 || xButton > 3) return;
  const int button = xButton == 1 ? 1 : xButton == 2 ? 2 : 3;  // left, middle, right
  const OS_Point client = ScreenToClient(target, screen);
  std::uintptr_t keys = MouseKeys(inEvent->state);
  const OS_EventTime now = static_cast<OS_EventTime>(inEvent->time);
  unsigned message;
  if (inPress) {
    keys |= ButtonBit(button);
    message = DownMessage(button);
    const X11Window* window = Find(target);
    const bool near = std::labs(screen.x - mLastClickPoint.x) <= mDoubleClickSize.x / 2 &&
                      std::labs(screen.y - mLastClickPoint.y) <= mDoubleClickSize.y / 2;
    const bool isDouble = window && (window->classStyle & kOSClassStyleDoubleClicks) && !mLastWasDoubleClick &&
                          target == mLastClickWindow && button == mLastClickButton &&
                          now - mLastClickTime <= static_cast<OS_EventTime>(mDoubleClickTime) && near;
    if (isDouble) message += 2;  // the double-click message follows the up message
    mLastWasDoubleClick = isDouble;
    mLastClickWindow = target;
    mLastClickButton = button;
    mLastClickTime = now;
    mLastClickPoint = screen;
    if (mCapture == 0 && !ClickActivates(target, message)) return;
  } else {
    keys &= ~ButtonBit(button);
    message = DownMessage(button) + 1;
  }
  if (!Find(target)) return;
  Queue(target, message, keys, MakePointParam(static_cast<int>(client.x), static_cast<int>(client.y)), true);
}

void OS_NativeLayer_X11::TranslateMotion(const xcb_motion_notify_event_t* inEvent) {
  const OS_Point screen = PointerOnScreen(inEvent->event, inEvent->event_x, inEvent->event_y, inEvent->root_x,
                                          inEvent->root_y);
  mPointer = screen;
  mPointerInside = inEvent->same_screen != 0;
  const OS_WindowHandle target = MouseTarget(inEvent->event, screen);
  if (mCapture == 0) NotifyPointerWindow(target);
  if (!target) return;
  const OS_Point client = ScreenToClient(target, screen);
  Queue(target, kOSMsgMouseMove, MouseKeys(inEvent->state),
        MakePointParam(static_cast<int>(client.x), static_cast<int>(client.y)), true);
}

void OS_NativeLayer_X11::TranslateCrossing(const xcb_enter_notify_event_t* inEvent, bool inEnter) {
  const OS_Point screen = PointerOnScreen(inEvent->event, inEvent->event_x, inEvent->event_y, inEvent->root_x,
                                          inEvent->root_y);
  mPointer = screen;
  NoticeGrabEnd(inEvent);
  const X11Window* window = Find(inEvent->event);
  if (inEnter)
    mPointerInside = true;
  else if (window && window->parent == 0 && inEvent->detail != XCB_NOTIFY_DETAIL_INFERIOR)
    mPointerInside = false;
  if (inEvent->mode != XCB_NOTIFY_MODE_NORMAL || mCapture != 0) return;
  if (inEnter) {
    NotifyPointerWindow(MouseTarget(inEvent->event, screen));
  } else if (inEvent->detail != XCB_NOTIFY_DETAIL_INFERIOR && window && window->parent == 0) {
    NotifyPointerWindow(0);  // left the top level altogether
  }
}

void OS_NativeLayer_X11::TranslateFocus(const xcb_focus_in_event_t* inEvent, bool inIn) {
  if (inEvent->detail == XCB_NOTIFY_DETAIL_POINTER || inEvent->detail == XCB_NOTIFY_DETAIL_INFERIOR) return;
  const X11Window* window = Find(inEvent->event);
  if (!window || window->parent != 0) return;
  if (inIn) {
    Activate(inEvent->event, kOSActivationActive);
    return;
  }
  // Focus left this top level, or left a window of ours that was hidden while
  // active: deactivate unless it went to another window of ours.
  if (mActive != inEvent->event && (mActive != 0 || !mApplicationActive)) return;
  xcb_get_input_focus_reply_t* reply =
      xcb_get_input_focus_reply(mConnection, xcb_get_input_focus(mConnection), nullptr);
  const OS_WindowHandle now = reply ? reply->focus : 0;
  std::free(reply);
  if (!Find(TopLevelOf(now))) Activate(0, kOSActivationInactive);
}

void OS_NativeLayer_X11::TranslateConfigure(const xcb_configure_notify_event_t* inEvent) {
  X11Window* window = Find(inEvent->window);
  if (!window) return;
  const OS_Rect old = window->rect;
  const bool synthetic = (inEvent->response_type & 0x80) != 0;
  if (window->parent != 0 || !window->reparented || synthetic) {
    window->rect.left = inEvent->x;
    window->rect.top = inEvent->y;
  } else {
    // A real one of a framed window is relative to the frame, and a window
    // manager that moves and resizes in one step may send no synthetic one
    // with the screen position: ask the server where the window is now.
    xcb_translate_coordinates_reply_t* reply = xcb_translate_coordinates_reply(
        mConnection, xcb_translate_coordinates(mConnection, window->id, mScreen->root, 0, 0), nullptr);
    window = Find(inEvent->window);
    if (reply && window) {
      window->rect.left = reply->dst_x;
      window->rect.top = reply->dst_y;
    }
    std::free(reply);
    if (!window) return;
  }
  window->rect.width = inEvent->width;
  window->rect.height = inEvent->height;
  if (window->parent == 0 && window->rect != old) NoticeUserSizeMove(inEvent->window);
  X11Window* still = Find(inEvent->window);
  if (still && (still->rect.width != old.width || still->rect.height != old.height)) {
    SendSize(inEvent->window);
    if (X11Window* sized = Find(inEvent->window)) Damage(*sized, nullptr);
  }
}

void OS_NativeLayer_X11::TranslateClientMessage(const xcb_client_message_event_t* inEvent) {
  if (inEvent->type != Atom("WM_PROTOCOLS") || !Find(inEvent->window)) return;
  const xcb_atom_t protocol = inEvent->data.data32[0];
  if (protocol == Atom("WM_DELETE_WINDOW")) {
    Queue(inEvent->window, kOSMsgClose, 0, 0, false);
  } else if (protocol == Atom("WM_TAKE_FOCUS")) {
    const X11Window* window = Find(inEvent->window);
    if (window->parent == 0 && (window->exStyle & kOSExStyleNoActivate) == 0 && window->viewable &&
        IsWindowEnabled(inEvent->window))
      xcb_set_input_focus(mConnection, XCB_INPUT_FOCUS_PARENT, window->id, inEvent->data.data32[1]);
  } else if (protocol == Atom("_NET_WM_PING")) {
    xcb_client_message_event_t reply = *inEvent;
    reply.window = mScreen->root;
    xcb_send_event(mConnection, 0, mScreen->root,
                   XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT | XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY,
                   reinterpret_cast<const char*>(&reply));
  }
}

void OS_NativeLayer_X11::TranslateEvent(xcb_generic_event_t* inEvent) {
  const std::uint8_t type = inEvent->response_type & 0x7F;
  if (mXSettingsWindow != 0 || type == XCB_CLIENT_MESSAGE)
    if (TranslateSettingsEvent(inEvent)) return;
  switch (type) {
    case 0:
      ReportXError(reinterpret_cast<xcb_generic_error_t*>(inEvent), "request");
      break;
    case XCB_KEY_PRESS:
    case XCB_KEY_RELEASE:
      TranslateKey(reinterpret_cast<xcb_key_press_event_t*>(inEvent), type == XCB_KEY_PRESS);
      break;
    case XCB_BUTTON_PRESS:
    case XCB_BUTTON_RELEASE:
      TranslateButton(reinterpret_cast<xcb_button_press_event_t*>(inEvent), type == XCB_BUTTON_PRESS);
      break;
    case XCB_MOTION_NOTIFY:
      TranslateMotion(reinterpret_cast<xcb_motion_notify_event_t*>(inEvent));
      break;
    case XCB_ENTER_NOTIFY:
    case XCB_LEAVE_NOTIFY:
      TranslateCrossing(reinterpret_cast<xcb_enter_notify_event_t*>(inEvent), type == XCB_ENTER_NOTIFY);
      break;
    case XCB_FOCUS_IN:
    case XCB_FOCUS_OUT:
      TranslateFocus(reinterpret_cast<xcb_focus_in_event_t*>(inEvent), type == XCB_FOCUS_IN);
      break;
    case XCB_EXPOSE: {
      auto* expose = reinterpret_cast<xcb_expose_event_t*>(inEvent);
      // A GL surface lies at the origin of its window and covers it: what
      // it uncovers is the window's to repaint.
      X11Window* window = Find(expose->window);
      if (!window) window = Find(GLSurfaceOwner(expose->window));
      if (window) {
        OS_Rect rect(expose->x, expose->y, expose->width, expose->height);
        Damage(*window, &rect);
        if (window->id == expose->window) ExposedFirst(*window);
      }
      break;
    }
    case XCB_CONFIGURE_NOTIFY:
      TranslateConfigure(reinterpret_cast<xcb_configure_notify_event_t*>(inEvent));
      break;
    case XCB_DESTROY_NOTIFY: {
      // Destroyed by someone else: the window hears it is gone, as if we had destroyed it.
      auto* destroyed = reinterpret_cast<xcb_destroy_notify_event_t*>(inEvent);
      if (X11Window* window = Find(destroyed->window); window && !window->destroying) ForgetDestroyedWindow(destroyed->window);
      break;
    }
    case XCB_UNMAP_NOTIFY:
      TranslateUnmap(reinterpret_cast<xcb_unmap_notify_event_t*>(inEvent));
      break;
    case XCB_MAP_NOTIFY:
      TranslateMap(reinterpret_cast<xcb_map_notify_event_t*>(inEvent));
      break;
    case XCB_REPARENT_NOTIFY: {
      auto* reparent = reinterpret_cast<xcb_reparent_notify_event_t*>(inEvent);
      if (X11Window* window = Find(reparent->window); window && window->parent == 0)
        window->reparented = reparent->parent != mScreen->root;
      break;
    }
    case XCB_CLIENT_MESSAGE:
      TranslateClientMessage(reinterpret_cast<xcb_client_message_event_t*>(inEvent));
      break;
    case XCB_MAPPING_NOTIFY:
      LoadKeymap();
      break;
    default:
      if (mXkbEventBase != 0 && type == mXkbEventBase) TranslateXkbEvent(inEvent);
      break;
  }
}

void OS_NativeLayer_X11::DrainConnection() {
  while (xcb_generic_event_t* event = xcb_poll_for_event(mConnection)) {
    TranslateEvent(event);
    std::free(event);
  }
}

std::intptr_t OS_NativeLayer_X11::SendMessage(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                              std::intptr_t inLParam) {
  return CallProcedure(inWindow, inMessage, inWParam, inLParam);
}

void OS_NativeLayer_X11::PostMessage(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                     std::intptr_t inLParam) {
  if (inWindow != 0 && !Find(inWindow)) return;
  X11Message message;
  message.event = OS_Event(inWindow, inMessage, inWParam, inLParam, GetTickCount());
  mQueue.push_back(message);
}

bool OS_NativeLayer_X11::PeekMessage(OS_Event& outEvent, OS_WindowHandle inWindow, unsigned inFirst, unsigned inLast,
                                     bool inRemove) {
  DrainConnection();
  return PeekQueuedMessage(mQueue, mMessageKeyStates, outEvent, inWindow, inFirst, inLast, inRemove);
}

bool OS_NativeLayer_X11::DeliverOne() {
  if (mQueue.empty()) return false;
  X11Message message = mQueue.front();
  mQueue.pop_front();
  if (message.hasKeyStates) mMessageKeyStates = message.keyStates;
  mMessageTime = message.event.GetTime();
  const OS_WindowHandle window = message.event.GetHWnd();
  if (!Find(window)) return true;
  const unsigned number = message.event.GetMsg();
  if (IsMouseMessage(number) && mCapture == 0) {
    CallProcedure(window, kOSMsgSetCursor, window, static_cast<std::intptr_t>(MakeWParam(kOSHitClient, number)));
    if (!Find(window)) return true;
  }
  CallProcedure(window, number, message.event.GetWParam(), message.event.GetLParam());
  return true;
}

void OS_NativeLayer_X11::SetTimer(OS_WindowHandle inWindow, std::uintptr_t inId, unsigned inMilliseconds) {
  if (!Find(inWindow)) return;
  X11Timer& timer = mTimers[{inWindow, inId}];
  timer.interval = std::max(1u, inMilliseconds);
  timer.due = std::chrono::steady_clock::now() + std::chrono::milliseconds(timer.interval);
}

void OS_NativeLayer_X11::KillTimer(OS_WindowHandle inWindow, std::uintptr_t inId) { mTimers.erase({inWindow, inId}); }

bool OS_NativeLayer_X11::FireDueTimers() {
  const auto now = std::chrono::steady_clock::now();
  auto earliest = mTimers.end();
  for (auto it = mTimers.begin(); it != mTimers.end(); ++it)
    if (it->second.due <= now && (earliest == mTimers.end() || it->second.due < earliest->second.due)) earliest = it;
  if (earliest == mTimers.end()) return false;
  const auto [window, id] = earliest->first;
  earliest->second.due = now + std::chrono::milliseconds(earliest->second.interval);
  mMessageTime = GetTickCount();
  CallProcedure(window, kOSMsgTimer, id, 0);
  return true;
}

int OS_NativeLayer_X11::NextTimeout() const {
  if (!mQueue.empty()) return 0;
  for (const auto& [handle, window] : mWindows)
    if (window->damage) return 0;
  if (mTimers.empty() && mSizeMoveWindow == 0) return -1;
  auto due = mSizeMoveWindow != 0 ? mSizeMoveCheck : mTimers.begin()->second.due;
  for (const auto& [key, timer] : mTimers) due = std::min(due, timer.due);
  const auto wait = std::chrono::duration_cast<std::chrono::milliseconds>(due - std::chrono::steady_clock::now());
  return static_cast<int>(std::max<long long>(0, wait.count() + 1));
}

int OS_NativeLayer_X11::ProcessPendingEvents() {
  int count = 0;
  for (;;) {
    xcb_flush(mConnection);
    DrainConnection();
    if (mExecutor) count += static_cast<int>(mExecutor->RunPending());
    if (DeliverOne() || DeliverPaint() || FireDueTimers()) {
      ++count;
      continue;
    }
    CheckUserSizeMoveEnd();
    return count;
  }
}

int OS_NativeLayer_X11::WaitAndProcess(int inMilliseconds) {
  xcb_flush(mConnection);
  const int timeout = std::min(inMilliseconds, NextTimeout() < 0 ? inMilliseconds : NextTimeout());
  pollfd fds[2] = {{xcb_get_file_descriptor(mConnection), POLLIN, 0}, {mWakePipe[0], POLLIN, 0}};
  if (timeout != 0) poll(fds, mWakePipe[0] >= 0 ? 2 : 1, timeout);
  if (fds[1].revents & POLLIN) {
    char buffer[64];
    while (read(mWakePipe[0], buffer, sizeof(buffer)) > 0) {
    }
  }
  return ProcessPendingEvents();
}

int OS_NativeLayer_X11::RunLoop() {
  mQuitRequests.push_back(false);
  mExitCodes.push_back(0);
  while (!mQuitRequests.back()) {
    if (xcb_connection_has_error(mConnection)) break;
    ProcessPendingEvents();
    if (mQuitRequests.back()) break;
    WaitAndProcess(NextTimeout() < 0 ? 1000 : NextTimeout());
  }
  const int code = mExitCodes.back();
  mQuitRequests.pop_back();
  mExitCodes.pop_back();
  return code;
}

void OS_NativeLayer_X11::QuitLoop(int inExitCode) {
  if (mQuitRequests.empty()) return;
  mQuitRequests.back() = true;
  mExitCodes.back() = inExitCode;
}

}  // namespace norvik::ui::x11
