// The message queue and the loop of the headless system.
//
// Posted messages are delivered oldest first; damage turns into paint
// messages only when the queue is otherwise empty, and due timers fire after
// that. The loop also drains the main thread's executor on every turn.
//
// The loop never waits on the real clock for timers: when it is idle and a
// timer is pending, it moves the virtual clock straight to that timer's
// deadline. When idle with no timer, it waits for a task posted to the
// executor from another thread; if none comes within the idle wait limit (or
// there is no executor to post to), RunLoop returns kIdleExitCode, since
// nothing could ever wake it.
#include <algorithm>
#include <chrono>

#include "ui/src/NativeQueueScan.h"
#include "ui/src/headless/OS_NativeLayer_Headless.h"

namespace norvik::ui::headless {
namespace {

bool IsMouseMessage(unsigned inMessage) {
  return inMessage >= kOSMsgMouseMove && inMessage <= kOSMsgMiddleButtonDoubleClick;
}

bool IsButtonDown(unsigned inMessage) {
  return inMessage == kOSMsgLeftButtonDown || inMessage == kOSMsgRightButtonDown ||
         inMessage == kOSMsgMiddleButtonDown || inMessage == kOSMsgLeftButtonDoubleClick ||
         inMessage == kOSMsgRightButtonDoubleClick || inMessage == kOSMsgMiddleButtonDoubleClick;
}

}  // namespace

std::intptr_t OS_NativeLayer_Headless::CallProcedure(OS_WindowHandle inWindow, unsigned inMessage,
                                                     std::uintptr_t inWParam, std::intptr_t inLParam) {
  const HeadlessWindow* window = Find(inWindow);
  if (!window) return 0;
  if (window->ours && mProcedure) return mProcedure(inWindow, inMessage, inWParam, inLParam);
  return DefaultWindowProcedure(inWindow, inMessage, inWParam, inLParam);
}

std::intptr_t OS_NativeLayer_Headless::SendMessage(OS_WindowHandle inWindow, unsigned inMessage,
                                                   std::uintptr_t inWParam, std::intptr_t inLParam) {
  return CallProcedure(inWindow, inMessage, inWParam, inLParam);
}

void OS_NativeLayer_Headless::PostMessage(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                          std::intptr_t inLParam) {
  if (inWindow != 0 && !Find(inWindow)) return;
  QueuedMessage message;
  message.event = OS_Event(inWindow, inMessage, inWParam, inLParam, mNow);
  mQueue.push_back(message);
}

bool OS_NativeLayer_Headless::PeekMessage(OS_Event& outEvent, OS_WindowHandle inWindow, unsigned inFirst,
                                          unsigned inLast, bool inRemove) {
  return PeekQueuedMessage(mQueue, mMessageKeys, outEvent, inWindow, inFirst, inLast, inRemove);
}

bool OS_NativeLayer_Headless::DeliverOne() {
  if (mQueue.empty()) return false;
  QueuedMessage message = mQueue.front();
  mQueue.pop_front();
  if (message.hasKeyStates) mMessageKeys = message.keyStates;
  mMessageTime = message.event.GetTime();
  const OS_WindowHandle window = message.event.GetHWnd();
  if (!Find(window)) return true;  // thread messages and messages of gone windows are dropped
  const unsigned number = message.event.GetMsg();
  if (message.clickInInactiveWindow && IsButtonDown(number) && !HandleClickActivation(message)) return true;
  if (IsMouseMessage(number) && mCapture == 0) {
    SendSetCursor(window, number);
    if (!Find(window)) return true;
  }
  CallProcedure(window, number, message.event.GetWParam(), message.event.GetLParam());
  return true;
}

int OS_NativeLayer_Headless::RunTasksAndMessages() {
  int count = 0;
  tarsel::threads::AsyncEventLoopAdaptorPtr executor = tarsel::threads::GetMainThreadExecutor();
  if (executor && executor->GetOwnerThreadID() == std::this_thread::get_id())
    count += static_cast<int>(executor->RunPending());
  if (DeliverOne()) return count + 1;
  count += DeliverPaints();
  if (count == 0 && FireDueTimer(mNow)) ++count;
  return count;
}

int OS_NativeLayer_Headless::ProcessPendingEvents() {
  int total = 0;
  for (;;) {
    const int count = RunTasksAndMessages();
    if (count == 0) return total;
    total += count;
  }
}

int OS_NativeLayer_Headless::PumpUntilIdle() { return ProcessPendingEvents(); }

bool OS_NativeLayer_Headless::WaitForWakeUp() {
  std::unique_lock<std::mutex> lock(mWakeMutex);
  const bool woken =
      mWakeCondition.wait_for(lock, std::chrono::milliseconds(mIdleWaitLimit), [this] { return mWoken; });
  mWoken = false;
  return woken;
}

int OS_NativeLayer_Headless::RunLoop() {
  mLoops.push_back(LoopLevel());
  const std::size_t depth = mLoops.size();
  if (depth == 1) {
    mExecutor = tarsel::threads::GetMainThreadExecutor();
    if (mExecutor)
      mExecutor->SetWakeUpFunction([this] {
        std::lock_guard<std::mutex> lock(mWakeMutex);
        mWoken = true;
        mWakeCondition.notify_all();
      });
  }
  bool idleExit = false;
  while (!mLoops[depth - 1].quit) {
    if (RunTasksAndMessages() > 0) continue;
    if (!mTimers.empty()) {
      const auto next = std::min_element(mTimers.begin(), mTimers.end(),
                                         [](const HeadlessTimer& inA, const HeadlessTimer& inB) {
                                           return inA.due < inB.due;
                                         });
      FireDueTimer(std::max(mNow, next->due));
      continue;
    }
    if (!mExecutor || !WaitForWakeUp()) {
      idleExit = true;
      break;
    }
  }
  const int result = idleExit ? kIdleExitCode : mLoops[depth - 1].exitCode;
  mLoops.pop_back();
  if (depth == 1 && mExecutor) {
    mExecutor->SetWakeUpFunction(nullptr);
    mExecutor.reset();
  }
  return result;
}

void OS_NativeLayer_Headless::QuitLoop(int inExitCode) {
  // The innermost loop that has not been told to quit yet stops next.
  for (auto it = mLoops.rbegin(); it != mLoops.rend(); ++it) {
    if (!it->quit) {
      it->quit = true;
      it->exitCode = inExitCode;
      return;
    }
  }
}

}  // namespace norvik::ui::headless
