#pragma once
// What keyboard focus needs to ask of the native window system.
//
// Focus handling is portable code; the few questions it has about native
// windows go through this interface, which each platform (X11, headless)
// implements and hands to the node manager (UI_NodeManager::SetFocusPlatform).
// Without one, focus works entirely inside the tree: no native window is
// recognised as ours and no pending key is removed.
#include "ui/OS_Event.h"

namespace norvik::ui {

class UI_Node;

class OS_FocusPlatform {
 public:
  virtual ~OS_FocusPlatform() = default;

  // The window node behind inHandle when the handle belongs to this thread
  // and carries the toolkit's window property; null when it is not ours.
  virtual UI_Node* GetOurWindowNode(OS_WindowHandle inHandle) const = 0;

  // Whether inHandle is a child window rather than a top level of its own.
  virtual bool IsChildWindow(OS_WindowHandle inHandle) const = 0;

  // The native parent of inHandle, or 0.
  virtual OS_WindowHandle GetParentWindow(OS_WindowHandle inHandle) const = 0;

  // Drops every key message (messages 256 to 265: key down and up,
  // characters, dead keys and their system forms) still waiting in the
  // native queue, so that the key that moved focus does not also reach the
  // new holder.
  virtual void RemovePendingKeyMessages() = 0;
};

}  // namespace norvik::ui
