// UI_Node: construction, the tree, identity, callbacks, tool tips and placement.
#include "ui/UI_Node.h"

#include <cmath>

#include "drawbot/CacheInterface.h"
#include "tarsel/ThrowError.h"
#include "ui/UI_NodeManager.h"
#include "ui/src/PlainViewGeometry.h"
#include "ui/src/UI_NodeExtras.h"

namespace norvik::ui {

UI_Node::UI_Node() {
  SetAsANode(this);
  UI_InvalidateDrawbotCache(false);
}

UI_Node::~UI_Node() {
  if (UI_NodeManager* manager = UI_NodeManager::Get()) manager->ForgetNode(this);
  // From here on the container half is no longer part of a node: the children
  // it still holds are detached without handing anything to this node.
  SetAsANode(nullptr);
}

// ---------------------------------------------------------------- tree walking

UI_Node* UI_Node::UI_GetRootNode() {
  UI_Node* node = this;
  while (UI_Node* parent = node->UI_GetParentNode()) node = parent;
  return node;
}

UI_Container* UI_Node::UI_GetRootContainer() {
  UI_Container* container = this;
  UI_Node* node = this;
  while (node && node->mParent) {
    container = node->mParent;
    node = container->GetAsANode();
  }
  return container;
}

UI_Node* UI_Node::UI_GetParentEventRecipientNode() const {
  for (UI_Node* p = UI_GetParentNode(); p; p = p->UI_GetParentNode()) {
    if (p->UI_ReceivesEventsFromOS()) return p;
  }
  return nullptr;
}

std::vector<UI_Node*> UI_Node::UI_GetNodeParents() {
  // Counted first, so that the chain is allocated once and filled from its end.
  std::size_t depth = 0;
  for (UI_Node* p = this; p; p = p->UI_GetParentNode()) ++depth;
  std::vector<UI_Node*> chain(depth);
  for (UI_Node* p = this; p; p = p->UI_GetParentNode()) chain[--depth] = p;
  return chain;
}

bool UI_Node::UI_IsChildOf(const UI_Node& inNode) const {
  for (const UI_Node* p = UI_GetParentNode(); p; p = p->UI_GetParentNode()) {
    if (p == &inNode) return true;
  }
  return false;
}

bool UI_Node::UI_IsChild(const UI_NodeP& inNode) const { return inNode && inNode->UI_IsChildOf(*this); }

UI_Container::iterator UI_Node::UI_ChildFindFromID(const UTF8String& inID) {
  return std::find_if(mChildren.begin(), mChildren.end(),
                      [&inID](const UI_NodeP& c) { return c->mNodeID == inID; });
}

UI_Node* UI_Node::UI_ChildGetFromID(const UTF8String& inID) {
  auto it = UI_ChildFindFromID(inID);
  return it == mChildren.end() ? nullptr : it->get();
}

void UI_Node::UI_SetParent(UI_Container* inParent) {
  if (mParent) UI_ResetThemeSupplier();
  mParent = inParent;
  if (UI_Node* parentNode = inParent ? inParent->GetAsANode() : nullptr) {
    UI_DispatchParentDisabledChange(false, parentNode->UI_IsDisabled());
    return;
  }
  if (mStateFlags.Test(kStateParentDisabled)) {
    UI_NodeProtector protect(this);
    mStateFlags.Clear(kStateParentDisabled);
    UI_DisabledStateChanged();
    if (!mStateFlags.Test(kStateSelfDisabled)) {
      const ChildList children(mChildren);
      for (const UI_NodeP& child : children) child->UI_DispatchParentDisabledChange(false, false);
    }
  }
}

void UI_Node::ChildAdded(UI_Node* inChild) {
  mTabOrderCache.clear();
  UI_NodeP protect(inChild);
  UI_Invalidate(nullptr, 0);
  inChild->UI_SetThemeSupplier(IsActiveThemeOwner() ? GetSharedThemeSupplier() : UI_GetThemeSupplier());
}

void UI_Node::ChildRemoved(UI_Node* inChild) {
  mTabOrderCache.clear();
  UI_NodeP protect(inChild);
  UI_Invalidate(nullptr, 0);
  inChild->UI_ResetThemeSupplier();
}

void UI_Node::ChildOrderChanged() {
  mTabOrderCache.clear();
  UI_Invalidate(nullptr, 0);
}

ThemeP UI_Node::UI_DefaultThemeSupplier() const {
  for (UI_Node* p = UI_GetParentNode(); p; p = p->UI_GetParentNode()) {
    if (p->IsActiveThemeOwner() && p->HasThemeName()) return p->GetTheme();
  }
  return ThemeClient::UI_DefaultThemeSupplier();
}

void UI_Node::UI_DispatchNodeChange(NodeChange inChange) {
  UI_NodeProtector protect(this);
  UI_NodeChanged(inChange);
  const ChildList children(mChildren);
  for (const UI_NodeP& child : children) child->UI_DispatchNodeChange(inChange);
}

// ------------------------------------------------------------------- callbacks

void UI_Node::NotifyFocusChanged(UI_Node* inNode, FocusChangeReason inReason) {
  UI_NodeProtector protect(this);
  UI_FireCallbackList(UI_ReadExtras().focusChangedFunctions, inNode, inReason);
}

void UI_Node::UI_FocusChanged(FocusChangeReason inReason) { NotifyFocusChanged(this, inReason); }

void UI_Node::UI_NotifyBeforeFocusChangeWithOS(bool inGaining, FocusChangeReason inReason) {
  UI_NodeProtector protect(this);
  UI_FireCallbackList(UI_ReadExtras().beforeFocusChangeFunctions, inGaining, inReason);
}

void UI_Node::UI_SizeChanged(const RectF&) {
  UI_NodeProtector protect(this);
  UI_FireCallbackList(UI_ReadExtras().sizeChangedFunctions);
}

void UI_Node::UI_DisabledStateChanged() {
  UI_NodeProtector protect(this);
  UI_Invalidate(nullptr, 0);
  UI_FireCallbackList(UI_ReadExtras().disabledChangedFunctions);
}

bool UI_Node::UI_DoTimerNotify(long inTimerID) {
  UI_NodeProtector protect(this);
  const std::vector<TimerFunction> copy(UI_ReadExtras().timerFunctions);
  for (const TimerFunction& f : copy) {
    if (f && (*f)(inTimerID)) return true;
  }
  return false;
}

// ------------------------------------------------------------ simple defaults

bool UI_Node::UI_HitTest(const PointF& inPoint) const {
  RectF r = UI_GetLocalRectF(false);
  return r.width > 0 && r.height > 0 && r.Contains(inPoint);
}

bool UI_Node::UI_AreAllParentsVisible() const {
  if (!UI_IsShown()) return false;
  UI_Node* parent = UI_GetParentNode();
  return parent && parent->UI_AreAllParentsVisible();
}

void UI_Node::UI_GetDrawSegments(std::vector<RectL>&) const {}

drawbot::SupplierInterface* UI_Node::UI_GetDrawSupplier() const {
  UI_Node* parent = UI_GetParentNode();
  return parent ? parent->UI_GetDrawSupplier() : nullptr;
}

UI_NodeTimerManager* UI_Node::UI_GetTimerManager(bool inFlag) {
  UI_Node* parent = UI_GetParentNode();
  return parent ? parent->UI_GetTimerManager(inFlag) : nullptr;
}

const UI_NodeTimerManager* UI_Node::UI_GetTimerManager(bool inFlag) const {
  const UI_Node* parent = UI_GetParentNode();
  return parent ? parent->UI_GetTimerManager(inFlag) : nullptr;
}

bool UI_Node::UI_HandleDragEnter(const PointF&, datatransfer::OS_ReceiveData*, unsigned long& outEffect) {
  outEffect = 0;
  return false;
}

bool UI_Node::UI_HandleDragOver(const PointF&, datatransfer::OS_ReceiveData*, unsigned long& outEffect) {
  outEffect = 0;
  return false;
}

bool UI_Node::UI_HandleDrop(const PointF&, datatransfer::OS_ReceiveData*, unsigned long& outEffect) {
  outEffect = 0;
  return false;
}

void UI_Node::UI_GetOSControlClipRects(OSControlClipRects& ioRects) const {
  // The size is read again at each step: a child's overriding code may change the list.
  for (std::size_t i = 0; i < mChildren.size(); ++i) {
    if (i + plainview::kPrefetchAhead < mChildren.size()) __builtin_prefetch(mChildren[i + plainview::kPrefetchAhead].get());
    // Every paint asks the whole tree; a leaf that keeps this walk adds nothing.
    const UI_Node& child = *mChildren[i];
    if (child.ChildSize() == 0 && plainview::KeepsNodeClipRects(child)) continue;
    child.UI_GetOSControlClipRects(ioRects);
  }
}

bool UI_Node::UI_PerformUserResizingDraw() {
  UI_NodeManager* manager = UI_NodeManager::Get();
  return manager && manager->InvalidateNodeAfterUserResize(this);
}

// ------------------------------------------------------------------- tool tips

UI_Node* UI_Node::UI_GetToolTipForDisplay(UI_Node* inNode) {
  if (!inNode) return nullptr;
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (manager && manager->GetActiveInputCapture(nullptr)) return nullptr;
  if (!inNode->UI_GetToolTip().empty()) return inNode;
  for (UI_Node* p = inNode->UI_GetParentNode(); p; p = p->UI_GetParentNode()) {
    if (!p->UI_GetToolTip().empty() && p->UI_DisplaysToolTipForChild(inNode)) return p;
  }
  return nullptr;
}

void UI_Node::UI_SetToolTip(const UTF16String& inText, long inWidth) {
  if (inText == UI_GetToolTip()) return;
  Extras& extras = UI_GetExtras();
  extras.toolTip = inText;
  extras.toolTipWidth = inWidth;
  UI_NodeManager* manager = UI_NodeManager::Get();
  UI_ToolTipManager* tips = manager ? manager->GetToolTipManager() : nullptr;
  if (!tips) return;
  UI_NodeProtector protect(this);
  if (tips->GetToolTipNode() == this || UI_GetToolTipForDisplay(manager->GetMouseOverLeafNode()) == this) {
    if (UI_ReadExtras().toolTip.empty()) {
      tips->DisposeToolTip();
    } else {
      tips->RefreshToolTip(this);
    }
  }
}

// ------------------------------------------------------------------ placement

void UI_Node::measure(halvorn::extents_t&) {
  tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                             "$$$/norvik/ui/Error/MeasureNotOverridden=You must override UI_Node::measure");
}

void UI_Node::measure_vertical(halvorn::extents_t&, const halvorn::place_data_t&) {
  tarsel::config::ThrowError(
      tarsel::config::ErrorLevel::kError,
      "$$$/norvik/ui/Error/MeasureVerticalNotOverridden=You must override UI_Node::measure_vertical");
}

void UI_Node::place(const halvorn::place_data_t& inPlace) {
  Extras& extras = UI_GetExtras();
  extras.placementValid = true;
  extras.placement = inPlace;
  const auto& h = inPlace.horizontal();
  const auto& v = inPlace.vertical();
  UI_SetLocalRectF(RectF(h.position - h.outset_before, v.position - v.outset_before,
                         h.length + h.outset_before + h.outset_after, v.length + v.outset_before + v.outset_after));
}

const halvorn::place_data_t& UI_Node::get_placement() {
  Extras& extras = UI_GetExtras();
  if (!extras.placementValid) {
    RectF r = UI_GetLocalRectF(true);
    float left = std::floor(r.left), top = std::floor(r.top);
    extras.placement.horizontal().position = left;
    extras.placement.horizontal().length = std::ceil(r.Right()) - left;
    extras.placement.vertical().position = top;
    extras.placement.vertical().length = std::ceil(r.Bottom()) - top;
  }
  return extras.placement;
}

}  // namespace norvik::ui
