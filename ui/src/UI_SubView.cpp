#include "ui/UI_SubView.h"

#include <deque>

#include "ui/UI_NodeManager.h"
#include "ui/UI_NodeTimerManager.h"
#include "ui/src/UI_NodeExtras.h"

namespace norvik::ui {

UI_SubView::UI_SubView() { mNodeID = "UI_SubView"; }

UI_SubView::~UI_SubView() { UI_RemoveSubViewTimers(); }

UI_Node::Matrix UI_SubView::UI_GetSelfToParentMatrix() const {
  Matrix m = Matrix::Translation(mRect.left, mRect.top);
  if (!mMatrixOnlyForChildren) m = mMatrix.Concat(m);
  UI_Node* parent = UI_GetParentNode();
  if (parent && parent->UI_IsSubView()) {
    const auto* parentView = static_cast<const UI_SubView*>(parent);
    if (parentView->mMatrixOnlyForChildren) m = parentView->mMatrix.Concat(m);
  }
  return m;
}

UI_Node::RectF UI_SubView::UI_GetLocalRectF(bool inInParent) const {
  return inInParent ? mRect : RectF(0, 0, mRect.width, mRect.height);
}

UI_Node::RectL UI_SubView::UI_GetLocalRect() const { return UI_EnclosingRect(mRect); }

void UI_SubView::UI_SetLocalRect(const RectL& inRect) { UI_SetLocalRectF(RectF(inRect)); }

void UI_SubView::UI_SetLocalRectF(const RectF& inRect) {
  if (inRect == mRect) return;
  UI_NodeProtector protect(this);
  const RectF oldSize = UI_GetLocalRectF(false);
  UI_Invalidate(nullptr, 0);
  mRect = inRect;
  UI_Invalidate(nullptr, 0);
  const RectF newSize = UI_GetLocalRectF(false);
  UI_SizeChanged(newSize);
  UI_DispatchNodeChange(kNodeChangeGeometry);
  if (mViewFlags & kViewLaysOutChildren) {
    UI_LayoutChildren(oldSize, newSize);
  } else if (newSize.width > 0 && newSize.height > 0) {
    mViewFlags |= kViewHasFirstSize;
  }
}

void UI_SubView::UI_LayoutChildren(const RectF& inOldSize, const RectF& inNewSize) {
  if (!(mViewFlags & kViewHasFirstSize)) {
    mViewFlags |= kViewHasFirstSize;
    return;
  }
  const float dw = inNewSize.width - inOldSize.width;
  const float dh = inNewSize.height - inOldSize.height;
  const ChildList children(mChildren);
  for (const UI_NodeP& child : children) {
    if (child->UI_GetParentContainer() != this || !child->UI_IsSubView()) continue;
    auto* view = static_cast<UI_SubView*>(child.get());
    const std::uint8_t b = view->mLayoutBinding;
    RectF r = view->UI_GetLocalRectF(true);
    if (b & kBindCenterHorizontally) {
      r.left = static_cast<float>(static_cast<long>((inNewSize.width - r.width) * 0.5f));
    } else {
      if (b & kBindLeftMoves) { r.left += dw; r.width -= dw; }
      if (b & kBindWidthGrows) r.width += dw;
    }
    if (b & kBindCenterVertically) {
      r.top = static_cast<float>(static_cast<long>((inNewSize.height - r.height) * 0.5f));
    } else {
      if (b & kBindTopMoves) { r.top += dh; r.height -= dh; }
      if (b & kBindHeightGrows) r.height += dh;
    }
    view->UI_SetLocalRectF(r);
  }
}

void UI_SubView::UI_SetLayoutsChildren(bool inLayouts) {
  if (inLayouts) {
    mViewFlags |= kViewLaysOutChildren;
  } else {
    mViewFlags &= static_cast<std::uint8_t>(~kViewLaysOutChildren);
  }
}

bool UI_SubView::UI_IsShown() const {
  return (mViewFlags & kViewShown) && mRect.width > 0 && mRect.height > 0;
}

void UI_SubView::UI_Show(bool inShow) {
  const bool wasShown = (mViewFlags & kViewShown) != 0;
  if (wasShown == inShow) return;
  UI_NodeProtector protect(this);
  if (wasShown) UI_Invalidate(nullptr, 0);
  if (inShow) {
    mViewFlags |= kViewShown;
    UI_Invalidate(nullptr, 0);
  } else {
    mViewFlags &= static_cast<std::uint8_t>(~kViewShown);
  }
  UI_InvalidateDrawbotCache(true);
  UI_DispatchNodeChange(kNodeChangeVisibility);
}

void UI_SubView::UI_Invalidate(const RectL* inRect, unsigned long inFlags) {
  UI_Node* parent = UI_GetParentNode();
  if ((mViewFlags & kViewShown) && parent) {
    RectL area = UI_EnclosingRect(UI_GetLocalRectF(false));
    if (inRect) area = area.Intersection(*inRect);
    if (area.width > 0 && area.height > 0) {
      RectF inParent = UI_GetSelfToParentMatrix().Transform(RectF(area));
      RectL parentArea = UI_EnclosingRect(inParent);
      parent->UI_Invalidate(&parentArea, inFlags);
    }
  }
  // The node's own cache goes whatever the caller said; only the ancestors see the flags.
  UI_Node::UI_Invalidate(inRect, 0);
}

void UI_SubView::UI_SetMatrix(const Matrix& inMatrix) {
  if (inMatrix == mMatrix) return;
  UI_NodeProtector protect(this);
  UI_Invalidate(nullptr, kInvalidateKeepRendering);
  mMatrix = inMatrix;
  UI_Invalidate(nullptr, kInvalidateKeepRendering);
  UI_DispatchNodeChange(kNodeChangeGeometry);
}

void UI_SubView::UI_SetMatrixOnlyForChildren(bool inOnly) {
  if (inOnly == mMatrixOnlyForChildren) return;
  UI_NodeProtector protect(this);
  UI_Invalidate(nullptr, kInvalidateKeepRendering);
  mMatrixOnlyForChildren = inOnly;
  UI_Invalidate(nullptr, kInvalidateKeepRendering);
}

void UI_SubView::UI_UpdateNow(unsigned long inFlags) {
  if (UI_Node* parent = UI_GetParentNode()) parent->UI_UpdateNow(inFlags);
}

void UI_SubView::UI_SetCapture() {
  if (UI_Node* parent = UI_GetParentNode()) parent->UI_SetCapture();
}

void UI_SubView::UI_ReleaseCapture() {
  if (UI_Node* parent = UI_GetParentNode()) parent->UI_ReleaseCapture();
}

void UI_SubView::UI_SetKeyboardFocusWithOS() {
  if (UI_Node* parent = UI_GetParentNode()) parent->UI_SetKeyboardFocusWithOS();
}

void UI_SubView::UI_SetParent(UI_Container* inParent) {
  UI_NodeProtector protect(this);
  UI_RemoveSubViewTimers();
  UI_Node::UI_SetParent(inParent);
  UI_DispatchNodeChange(kNodeChangeParent);
}

void UI_SubView::UI_RemoveSubViewTimers() {
  if (UI_NodeTimerManager* timers = UI_GetTimerManager(false)) {
    std::list<long> none;
    timers->RemoveAllTimers(this, mExtras ? mExtras->timerIDs : none);
  } else if (mExtras) {
    mExtras->timerIDs.clear();  // no window above: no timer can be installed anywhere
  }
  for (const UI_NodeP& child : mChildren) {
    if (child->UI_IsSubView()) static_cast<UI_SubView*>(child.get())->UI_RemoveSubViewTimers();
  }
}

void UI_SubView::UI_TurnMnemonicsOnOffForAllChildren(bool inOn) {
  std::deque<UI_NodeP> work;
  for (const UI_NodeP& child : mChildren) work.push_back(child);
  while (!work.empty()) {
    UI_NodeP node = work.front();
    work.pop_front();
    if (node->UI_IsSubView()) static_cast<UI_SubView*>(node.get())->UI_SetMnemonicsShown(inOn);
    for (auto it = node->ChildBegin(); it != node->ChildEnd(); ++it) work.push_back(*it);
  }
}

}  // namespace norvik::ui
