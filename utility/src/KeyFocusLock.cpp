#include "utility/KeyFocusLock.h"

#include "ui/UI_Node.h"

namespace norvik::utility {

KeyFocusLock::KeyFocusLock() : mNode(ui::UI_Node::UI_GetKeyboardFocusLeafNode()) {}

KeyFocusLock::~KeyFocusLock() {
  if (mNode) mNode->UI_GainKeyboardFocus(ui::kFocusChangeRestore);
}

}  // namespace norvik::utility
