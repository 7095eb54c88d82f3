#include "layout/UI_Cell.h"

#include <algorithm>

namespace norvik::layout {

void UI_Cell::AddNode(NodeP inNode, const PointF& inOffset) {
  if (!inNode) return;
  const PointF offset = SanitizeSize(inOffset);
  for (Entry& entry : mNodes) {
    if (entry.node == inNode) {
      entry.offset = offset;
      return;
    }
  }
  mNodes.push_back({std::move(inNode), offset});
}

bool UI_Cell::RemoveNode(const ui::UI_Node* inNode) {
  auto it = std::find_if(mNodes.begin(), mNodes.end(), [&](const Entry& e) { return e.node.get() == inNode; });
  if (it == mNodes.end()) return false;
  mNodes.erase(it);
  return true;
}

bool UI_Cell::HasNode(const ui::UI_Node* inNode) const {
  return std::any_of(mNodes.begin(), mNodes.end(), [&](const Entry& e) { return e.node.get() == inNode; });
}

UI_Cell::NodeP UI_Cell::GetNode(long inIndex) const {
  return inIndex >= 0 && inIndex < GetNodeCount() ? mNodes[static_cast<std::size_t>(inIndex)].node : nullptr;
}

PointF UI_Cell::GetNodeOffset(long inIndex) const {
  return inIndex >= 0 && inIndex < GetNodeCount() ? mNodes[static_cast<std::size_t>(inIndex)].offset : PointF();
}

void UI_Cell::FetchNodes(ui::UI_SubView& inView) {
  // A snapshot: adopting a node calls out to the view, which may edit cells.
  const std::vector<Entry> nodes = mNodes;
  for (const Entry& entry : nodes)
    if (entry.node->UI_GetParentNode() != &inView) inView.ChildPushBack(entry.node);
}

PointF UI_Cell::NodeSize(const ui::UI_Node& inNode) {
  const PointF recommended = SanitizeSize(inNode.UI_GetRecommendedSize());
  const RectF current = SanitizeRect(inNode.UI_GetLocalRectF(false));
  return PointF(recommended.x > 0 ? recommended.x : current.width,
                recommended.y > 0 ? recommended.y : current.height);
}

PointF UI_Cell::RecalcCellSize(drawbot::Drawbot*) const {
  PointF need;
  for (const Entry& entry : mNodes) {
    const PointF size = NodeSize(*entry.node);
    need.x = std::max(need.x, 2 * entry.offset.x + size.x);
    need.y = std::max(need.y, 2 * entry.offset.y + size.y);
  }
  return need;
}

void UI_Cell::UpdateNodesPosition() {
  const std::vector<Entry> nodes = mNodes;
  for (const Entry& entry : nodes) {
    const PointF size = NodeSize(*entry.node);
    entry.node->UI_SetLocalRectF(
        RectF(mRect.left + entry.offset.x, mRect.top + entry.offset.y, size.x, size.y));
  }
}

}  // namespace norvik::layout
