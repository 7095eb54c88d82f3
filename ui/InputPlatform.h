#pragma once
// What event dispatch needs to ask the platform outside of a message: the
// modifier state and the removal of a pending message from the native queue.
// The platform layer installs its implementation at start-up; until it does,
// a quiet platform answers (no modifiers, an empty queue), which is also what
// tests without a window see.
#include "ui/ModifierKeys.h"
#include "ui/OS_Event.h"

namespace norvik::ui {

class InputPlatformInterface {
 public:
  virtual ~InputPlatformInterface() = default;

  // Shift, Ctrl and Alt as of the message being handled, and Caps Lock's toggle.
  virtual ModifierKeys GetRecentEventModKeys() const = 0;
  // Shift, Ctrl and Alt as the keyboard holds them now, and Caps Lock's toggle.
  virtual ModifierKeys GetCurrentModKeys() const = 0;
  // Removes the oldest pending message inMessage for inWindow from the native
  // queue; true when there was one.
  virtual bool RemovePendingMessage(OS_WindowHandle inWindow, unsigned inMessage) = 0;
};

// The installed platform, or the quiet one.
InputPlatformInterface& GetInputPlatform();
// Installs the platform; the caller keeps ownership and uninstalls it (null)
// before destroying it.
void SetInputPlatform(InputPlatformInterface* inPlatform);

}  // namespace norvik::ui

namespace norvik::utility {

ui::ModifierKeys GetRecentEventModKeys();
ui::ModifierKeys GetCurrentModKeys();

}  // namespace norvik::utility
