// Timers of the headless system, on a virtual clock that moves only when told
// to (AdvanceClock) or when an idle loop jumps to the next deadline.
#include <algorithm>

#include "ui/src/headless/OS_NativeLayer_Headless.h"

namespace norvik::ui::headless {

void OS_NativeLayer_Headless::SetTimer(OS_WindowHandle inWindow, std::uintptr_t inId, unsigned inMilliseconds) {
  if (!Find(inWindow)) return;
  const unsigned interval = std::max(1u, inMilliseconds);
  for (HeadlessTimer& timer : mTimers) {
    if (timer.window == inWindow && timer.id == inId) {
      // Setting a timer again starts its interval over.
      timer.interval = interval;
      timer.due = mNow + interval;
      return;
    }
  }
  HeadlessTimer timer;
  timer.window = inWindow;
  timer.id = inId;
  timer.interval = interval;
  timer.due = mNow + interval;
  timer.order = ++mTimerOrder;
  mTimers.push_back(timer);
}

void OS_NativeLayer_Headless::KillTimer(OS_WindowHandle inWindow, std::uintptr_t inId) {
  mTimers.erase(std::remove_if(mTimers.begin(), mTimers.end(),
                               [&](const HeadlessTimer& inTimer) {
                                 return inTimer.window == inWindow && inTimer.id == inId;
                               }),
                mTimers.end());
}

bool OS_NativeLayer_Headless::FireDueTimer(OS_EventTime inUntil) {
  auto next = mTimers.end();
  for (auto it = mTimers.begin(); it != mTimers.end(); ++it) {
    if (it->due > inUntil) continue;
    if (next == mTimers.end() || it->due < next->due || (it->due == next->due && it->order < next->order)) next = it;
  }
  if (next == mTimers.end()) return false;
  mNow = std::max(mNow, next->due);
  mMessageTime = next->due;
  next->due += next->interval;
  const OS_WindowHandle window = next->window;
  const std::uintptr_t id = next->id;
  CallProcedure(window, kOSMsgTimer, id, 0);
  return true;
}

void OS_NativeLayer_Headless::AdvanceClock(OS_EventTime inMilliseconds) {
  const OS_EventTime target = mNow + std::max<OS_EventTime>(0, inMilliseconds);
  ProcessPendingEvents();
  while (FireDueTimer(target)) ProcessPendingEvents();
  mNow = target;
}

}  // namespace norvik::ui::headless
