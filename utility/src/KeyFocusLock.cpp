#include "utility/KeyFocusLock.h"

#include "ui/UI_Node.h"

namespace norvik::utility {

KeyFocusLock::KeyFocusLock() : mNode(ui::UI_Node::UI_GetKeyboardFocusLeafNode()) {
  if (mNode) mRoot = mNode->UI_GetRootNode();
}

KeyFocusLock::~KeyFocusLock() {
  if (mNode && mNode->UI_GetRootNode() == mRoot.get()) mNode->UI_GainKeyboardFocus(ui::kFocusChangeRestore);
}

}  // namespace norvik::utility
