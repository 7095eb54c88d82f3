#pragma once
// The look into a native message queue that every port shares: the oldest
// message for a window (0: any) whose number lies in a range (0, 0: any),
// optionally taken out. A queued message is a record with an `event`, and,
// for input, the keyboard as it was (`hasKeyStates`, `keyStates`): taking
// such a message out makes its keyboard the one "as of the message".
#include "ui/OS_Event.h"

namespace norvik::ui {

template <typename Queue, typename KeyStates>
bool PeekQueuedMessage(Queue& ioQueue, KeyStates& outMessageKeys, OS_Event& outEvent, OS_WindowHandle inWindow,
                       unsigned inFirst, unsigned inLast, bool inRemove) {
  const bool anyNumber = inFirst == 0 && inLast == 0;
  for (auto it = ioQueue.begin(); it != ioQueue.end(); ++it) {
    const OS_Event& event = it->event;
    if (inWindow != 0 && event.GetHWnd() != inWindow) continue;
    if (!anyNumber && (event.GetMsg() < inFirst || event.GetMsg() > inLast)) continue;
    outEvent = event;
    if (inRemove) {
      if (it->hasKeyStates) outMessageKeys = it->keyStates;
      ioQueue.erase(it);
    }
    return true;
  }
  return false;
}

}  // namespace norvik::ui
