#include "arrange/ArrangeableNodeBridge.h"

#include <cmath>

#include "ui/UI_SubView.h"

namespace norvik::arrange {

namespace {

std::uint8_t Binding(ui::UI_Node& inNode) {
  auto view = dynamic_cast<ui::UI_SubView*>(&inNode);
  return view ? view->UI_GetLayoutBinding() : 0;
}

}  // namespace

ArrangeableNodeBridge::ArrangeableNodeBridge(ui::UI_Node& inNode, IArrangeable* inParent)
    : Single(inParent), mNode(inNode) {}

// The node lands on whole pixels, so it asks for whole pixels. With fractions
// left in, candidates that cover the same area would waste amounts that differ
// by rounding alone, and the choice would fall to that noise instead of to the
// next rule (the smaller minimum area).
float ArrangeableNodeBridge::NaturalWidth() const { return std::ceil(mNode.UI_GetRecommendedSize().x); }
float ArrangeableNodeBridge::NaturalHeight() const { return std::ceil(mNode.UI_GetRecommendedSize().y); }

bool ArrangeableNodeBridge::HorizontallyExpandable() const {
  return (Binding(mNode) & ui::UI_SubView::kBindWidthGrows) != 0;
}

bool ArrangeableNodeBridge::VerticallyExpandable() const {
  return (Binding(mNode) & ui::UI_SubView::kBindHeightGrows) != 0;
}

RectF ArrangeableNodeBridge::ToParentSpace(ui::UI_Node& inNode, RectF const& inGlobal) {
  ui::UI_Node* parent = inNode.UI_GetParentNode();
  const RectF local = parent ? parent->UI_GlobalToLocalF(inGlobal) : inGlobal;
  const float left = std::round(local.left), top = std::round(local.top);
  return RectF(left, top, std::round(local.Right()) - left, std::round(local.Bottom()) - top);
}

PointF ArrangeableNodeBridge::Place(RectF const& inRect) {
  ui::UI_NodeP protector(&mNode);  // the node may be removed by its own size change
  mNode.UI_SetLocalRectF(ToParentSpace(mNode, inRect));
  return inRect.Size();
}

}  // namespace norvik::arrange
