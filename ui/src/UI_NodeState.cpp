// UI_Node: the enable state and its propagation through the tree.
#include "ui/UI_Node.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {

void UI_Node::UI_SetSelfDisabled(bool inDisable) {
  if (mStateFlags.Test(kStateSelfDisabled) == inDisable) return;
  UI_NodeProtector protect(this);
  if (inDisable) {
    mStateFlags.Set(kStateSelfDisabled);
    // A disabled node may not keep focus: it goes on to the next node in tab
    // order, and only when nothing takes it does it climb to an ancestor.
    if (UI_HasKeyboardFocus(false)) {
      UI_Container* parent = UI_GetParentContainer();
      if (parent) UI_AdvanceFocus(true, mIndex, parent);
      if (!parent || UI_HasKeyboardFocus(false)) UI_LoseKeyboardFocus();
    }
  } else {
    mStateFlags.Clear(kStateSelfDisabled);
  }
  UI_DisabledStateChanged();
}

void UI_Node::UI_SetDisabled(bool inDisable) {
  if (mStateFlags.Test(kStateSelfDisabled) == inDisable) return;
  UI_NodeProtector protect(this);
  UI_SetSelfDisabled(inDisable);
  const bool disabled = UI_IsDisabled();
  const ChildList children(mChildren);
  for (const UI_NodeP& child : children) {
    if (child->mParent == this) child->UI_DispatchParentDisabledChange(false, disabled);
  }
}

void UI_Node::UI_SetParentDisabled(bool inDisabled) {
  if (mStateFlags.Test(kStateParentDisabled) == inDisabled) return;
  UI_NodeProtector protect(this);
  mStateFlags.Set(kStateParentDisabled, inDisabled);
  UI_DisabledStateChanged();
}

void UI_Node::UI_DispatchParentDisabledChange(bool inSkipSelf, bool inDisabled) {
  UI_NodeProtector protect(this);
  if (!inSkipSelf) {
    if (mStateFlags.Test(kStateParentDisabled) == inDisabled) return;
    mStateFlags.Set(kStateParentDisabled, inDisabled);
    UI_DisabledStateChanged();
    // A self-disabled node shields its subtree: its children see it disabled either way.
    if (mStateFlags.Test(kStateSelfDisabled)) return;
  }
  const ChildList children(mChildren);
  for (const UI_NodeP& child : children) {
    if (child->mParent == this) child->UI_DispatchParentDisabledChange(false, inDisabled);
  }
}

}  // namespace norvik::ui
