#include "layout/UI_LayoutView.h"

#include <algorithm>
#include <cmath>
#include <vector>

#include "layout/SmartLayout.h"

namespace norvik::layout {

namespace {

// A child's rectangle seen along the stack (first) and across it (second).
struct Span {
  float near = 0, length = 0;
  float Far() const { return near + length; }
};

Span Along(const RectF& inRect, bool inHorizontal) {
  return inHorizontal ? Span{inRect.left, inRect.width} : Span{inRect.top, inRect.height};
}

Span Across(const RectF& inRect, bool inHorizontal) { return Along(inRect, !inHorizontal); }

RectF FromSpans(const Span& inAlong, const Span& inAcross, bool inHorizontal) {
  return inHorizontal ? RectF(inAlong.near, inAcross.near, inAlong.length, inAcross.length)
                      : RectF(inAcross.near, inAlong.near, inAcross.length, inAlong.length);
}

// A sub-view that is hidden only for want of a size still takes part: a child
// added a moment ago has no size until this lays it out.
bool MeantToShow(const ui::UI_Node& inNode) {
  if (!inNode.UI_IsSubView()) return inNode.UI_IsShown();
  return (static_cast<const ui::UI_SubView&>(inNode).UI_GetViewFlags() & ui::UI_SubView::kViewShown) != 0;
}

// Whole pixels, so that the stack's edges fall on pixel boundaries.
PointF ContentSizeOf(const ui::UI_Node& inNode, const RectF& inPresent) {
  PointF size = SanitizeSize(inNode.UI_GetRecommendedSize());
  if (size.x <= 0 && size.y <= 0) size = SanitizeSize(PointF(inPresent.width, inPresent.height));
  return PointF(std::ceil(size.x), std::ceil(size.y));
}

}  // namespace

UI_LayoutView::UI_LayoutView() {
  UI_SetSubViewLayoutFlags(kLayoutEnabled | kMaintainMargins);
  UI_SetLayoutsChildren(true);
}

void UI_LayoutView::SetFlag(std::uint8_t inFlag, bool inOn) {
  const std::uint8_t flags = UI_GetSubViewLayoutFlags();
  UI_SetSubViewLayoutFlags(inOn ? static_cast<std::uint8_t>(flags | inFlag)
                                : static_cast<std::uint8_t>(flags & ~inFlag));
}

void UI_LayoutView::SetLayoutMode(unsigned long inMode) {
  if (inMode == kLayoutModeVertical || inMode == kLayoutModeHorizontal)
    SetFlag(kLayoutHorizontal, inMode == kLayoutModeHorizontal);
}

unsigned long UI_LayoutView::GetLayoutMode() const {
  return HasFlag(kLayoutHorizontal) ? kLayoutModeHorizontal : kLayoutModeVertical;
}

void UI_LayoutView::AutoLayout(drawbot::Drawbot* inDrawbot) {
  if (!GetLayoutEnabled()) return;
  ui::UI_NodeP protector(this);
  std::vector<ui::UI_NodeP> children;
  for (auto it = ChildBegin(); it != ChildEnd(); ++it)
    if (MeantToShow(**it)) children.push_back(*it);
  for (const ui::UI_NodeP& child : children)
    if (auto nested = dynamic_cast<UI_LayoutView*>(child.get())) nested->AutoLayout(inDrawbot);

  const bool horizontal = HasFlag(kLayoutHorizontal);
  const bool keepMargins = HasFlag(kMaintainMargins);
  float oldFar = 0, newFar = 0, leading = 0, acrossLeading = 0, acrossFar = 0;
  for (std::size_t i = 0; i < children.size(); ++i) {
    ui::UI_Node& child = *children[i];
    // A child removed by a nested layout's call-outs no longer takes part.
    if (child.UI_GetParentContainer() != this) continue;
    const RectF present = SanitizeRect(child.UI_GetLocalRectF(true));
    const PointF size = ContentSizeOf(child, present);
    const Span oldAlong = Along(present, horizontal), oldAcross = Across(present, horizontal);
    const float gap = keepMargins ? std::max(0.0f, oldAlong.near - oldFar) : 0;
    const float offset = keepMargins ? std::max(0.0f, oldAcross.near) : 0;
    const Span along{newFar + gap, horizontal ? size.x : size.y};
    const Span across{offset, horizontal ? size.y : size.x};
    child.UI_SetLocalRectF(FromSpans(along, across, horizontal));
    acrossLeading = (i == 0) ? offset : std::min(acrossLeading, offset);
    if (i == 0) leading = gap;
    acrossFar = std::max(acrossFar, across.Far());
    oldFar = oldAlong.Far();
    newFar = along.Far();
  }
  const Span extentAlong{0, newFar + (keepMargins ? leading : 0)};
  const Span extentAcross{0, acrossFar + (keepMargins ? acrossLeading : 0)};
  const RectF extent = FromSpans(extentAlong, extentAcross, horizontal);
  mContentSize = PointF(extent.width, extent.height);
}

void UI_LayoutView::UI_LayoutChildren(const RectF& inOldSize, const RectF& inNewSize) {
  const bool scale = GetLayoutEnabled() && GetScaleChildren() && inOldSize.width > 0 && inOldSize.height > 0 &&
                     (UI_GetViewFlags() & kViewHasFirstSize);
  if (!scale) {
    UI_SubView::UI_LayoutChildren(inOldSize, inNewSize);
    return;
  }
  const float sx = inNewSize.width / inOldSize.width, sy = inNewSize.height / inOldSize.height;
  const std::vector<ui::UI_NodeP> children(ChildBegin(), ChildEnd());
  for (const ui::UI_NodeP& child : children) {
    if (child->UI_GetParentContainer() != this) continue;
    const RectF r = child->UI_GetLocalRectF(true);
    child->UI_SetLocalRectF(RectF(r.left * sx, r.top * sy, r.width * sx, r.height * sy));
  }
}

}  // namespace norvik::layout
