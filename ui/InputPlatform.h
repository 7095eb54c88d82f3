#pragma once
// What event dispatch asks of the platform outside of a message: the
// modifier state, the removal of a pending message from the native queue, and
// the default cursor. By default these questions go to the installed native
// layer (and get quiet answers when there is none: no modifiers, an empty
// queue); a test can install its own answers instead.
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
  // Shows the platform's standard arrow.
  virtual void SetDefaultCursor() = 0;
};

// The installed answers, or those of the native layer.
InputPlatformInterface& GetInputPlatform();
// Installs other answers; the caller keeps ownership and uninstalls them
// (null) before destroying them.
void SetInputPlatform(InputPlatformInterface* inPlatform);

}  // namespace norvik::ui

namespace norvik::utility {

ui::ModifierKeys GetRecentEventModKeys();
ui::ModifierKeys GetCurrentModKeys();

}  // namespace norvik::utility
