// Activation, keyboard focus, pointer capture and mouse-leave tracking of the
// headless system.
#include "ui/src/headless/OS_NativeLayer_Headless.h"

namespace norvik::ui::headless {

bool OS_NativeLayer_Headless::CanActivate(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window && !window->destroying && window->parent == 0 && (window->style & kOSStyleVisible) != 0 &&
         (window->style & kOSStyleDisabled) == 0 && (window->exStyle & kOSExStyleNoActivate) == 0;
}

void OS_NativeLayer_Headless::SendActivateApp(int inApplication, bool inActive, OS_WindowHandle inOther) {
  std::vector<OS_WindowHandle> windows;
  for (OS_WindowHandle handle : mTopLevels) {
    const HeadlessWindow* window = Find(handle);
    if (window && window->application == inApplication && !window->destroying) windows.push_back(handle);
  }
  for (OS_WindowHandle handle : windows)
    if (Find(handle)) CallProcedure(handle, kOSMsgActivateApp, inActive ? 1 : 0, static_cast<std::intptr_t>(inOther));
}

void OS_NativeLayer_Headless::Activate(OS_WindowHandle inWindow, int inCode) {
  HeadlessWindow* window = Find(inWindow);
  if (!window) return;
  PlaceInZOrder(inWindow, kOSInsertTop);
  if (mActive == inWindow) return;
  const OS_WindowHandle previous = mActive;
  const int previousApplication = mActiveApplication;
  const int application = window->application;
  mActive = inWindow;
  if (previous != 0 && Find(previous))
    CallProcedure(previous, kOSMsgActivate, MakeWParam(kOSActivationInactive, IsMinimized(previous) ? 1 : 0),
                  static_cast<std::intptr_t>(inWindow));
  if (previousApplication != application) {
    mActiveApplication = application;
    if (previousApplication >= 0) SendActivateApp(previousApplication, false, inWindow);
    SendActivateApp(application, true, previous);
  }
  if (mActive != inWindow || !Find(inWindow)) return;  // a handler moved activation on
  CallProcedure(inWindow, kOSMsgActivate, MakeWParam(static_cast<unsigned>(inCode), IsMinimized(inWindow) ? 1 : 0),
                static_cast<std::intptr_t>(previous));
  // Focus left in a window that is no longer active does not stay there.
  if (mFocus != 0 && mActive != 0 && TopLevelOf(mFocus) != mActive) SetFocus(0);
}

void OS_NativeLayer_Headless::ActivateNextAfterLoss(OS_WindowHandle inLeaving) {
  const HeadlessWindow* leaving = Find(inLeaving);
  OS_WindowHandle next = 0;
  if (leaving && leaving->owner != 0 && CanActivate(leaving->owner) && !IsMinimized(leaving->owner))
    next = leaving->owner;
  for (auto it = mTopLevels.begin(); next == 0 && it != mTopLevels.end(); ++it)
    if (*it != inLeaving && CanActivate(*it) && !IsMinimized(*it)) next = *it;
  if (next != 0) {
    Activate(next, kOSActivationActive);
    return;
  }
  DeactivateApplication();
}

void OS_NativeLayer_Headless::DeactivateApplication() {
  const OS_WindowHandle previous = mActive;
  const int previousApplication = mActiveApplication;
  mActive = 0;
  mActiveApplication = -1;
  if (previous != 0 && Find(previous))
    CallProcedure(previous, kOSMsgActivate, MakeWParam(kOSActivationInactive, IsMinimized(previous) ? 1 : 0), 0);
  if (previousApplication >= 0) SendActivateApp(previousApplication, false, 0);
  if (mFocus != 0 && mActive == 0) SetFocus(0);
}

void OS_NativeLayer_Headless::SetActiveWindow(OS_WindowHandle inWindow) {
  const OS_WindowHandle topLevel = TopLevelOf(inWindow);
  if (CanActivate(topLevel)) Activate(topLevel, kOSActivationActive);
}

void OS_NativeLayer_Headless::SetForegroundWindow(OS_WindowHandle inWindow) { SetActiveWindow(inWindow); }

void OS_NativeLayer_Headless::SetFocus(OS_WindowHandle inWindow) {
  if (inWindow != 0) {
    const HeadlessWindow* window = Find(inWindow);
    if (!window || window->destroying) return;
    const OS_WindowHandle topLevel = TopLevelOf(inWindow);
    if (topLevel != mActive) {
      if (!CanActivate(topLevel)) return;
      Activate(topLevel, kOSActivationActive);
      if (mActive != topLevel || !Find(inWindow)) return;
    }
  }
  if (inWindow == mFocus) return;
  const OS_WindowHandle previous = mFocus;
  mFocus = inWindow;
  if (previous != 0 && Find(previous)) CallProcedure(previous, kOSMsgKillFocus, inWindow, 0);
  if (inWindow != 0 && mFocus == inWindow && Find(inWindow))
    CallProcedure(inWindow, kOSMsgSetFocus, previous, 0);
}

void OS_NativeLayer_Headless::SetCapture(OS_WindowHandle inWindow) {
  if (!Find(inWindow) || mCapture == inWindow) return;
  const OS_WindowHandle previous = mCapture;
  mCapture = inWindow;
  if (previous != 0 && Find(previous))
    CallProcedure(previous, kOSMsgCaptureChanged, 0, static_cast<std::intptr_t>(inWindow));
}

void OS_NativeLayer_Headless::ReleaseCapture() {
  if (mCapture == 0) return;
  const OS_WindowHandle previous = mCapture;
  mCapture = 0;
  if (Find(previous)) CallProcedure(previous, kOSMsgCaptureChanged, 0, 0);
  CheckMouseLeave();
}

void OS_NativeLayer_Headless::TrackMouseLeave(OS_WindowHandle inWindow) {
  if (!Find(inWindow)) return;
  mMouseLeaveWindow = inWindow;
  CheckMouseLeave();
}

void OS_NativeLayer_Headless::CheckMouseLeave() {
  // While the tracked window holds the capture the pointer still belongs to
  // it; the leave comes when the capture ends.
  if (mMouseLeaveWindow == 0 || mCapture == mMouseLeaveWindow) return;
  if (WindowFromPoint(mPointer) == mMouseLeaveWindow) return;
  const OS_WindowHandle left = mMouseLeaveWindow;
  mMouseLeaveWindow = 0;
  PostMessage(left, kOSMsgMouseLeave, 0, 0);
}

}  // namespace norvik::ui::headless
