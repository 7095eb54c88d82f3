#include "ui/UI_DialogHost.h"

#include "ui/UI_Node.h"

namespace norvik::ui {

const UI_DialogHost* UI_DialogHost::FindFor(const UI_Node* inNode) {
  for (const UI_Node* p = inNode ? inNode->UI_GetParentNode() : nullptr; p; p = p->UI_GetParentNode())
    if (const auto* host = dynamic_cast<const UI_DialogHost*>(p)) return host;
  return nullptr;
}

}  // namespace norvik::ui
