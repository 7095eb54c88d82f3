// Whether keyboard focus sits inside a hosted native text field.
#include "ui/UI_Node.h"

namespace norvik::ui {
namespace {
UI_Node::TextEditControlTest gTextEditControlTest = nullptr;
}

void UI_Node::SetTextEditControlTest(TextEditControlTest inTest) { gTextEditControlTest = inTest; }

bool UI_Node::UI_TextEditControlHasFocus() {
  const UI_Node* leaf = UI_GetKeyboardFocusLeafNode();
  if (!leaf || !gTextEditControlTest) return false;
  for (const UI_Node* node = leaf->UI_GetParentNode(); node; node = node->UI_GetParentNode())
    if (gTextEditControlTest(node)) return true;
  return false;
}

}  // namespace norvik::ui
