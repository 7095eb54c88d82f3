// Mouse dispatch: the walk towards the leaf with its first-chance passes, the
// filters at the leaf, the climb towards the root, and the cursor walk, which
// follows the same road.
//
// Every step holds a strong reference to the node it is on, and the leaf is
// carried as a strong reference too: a handler may remove or delete its own
// node, the leaf or an ancestor, and the rest of the pass must still only
// touch live nodes. Each reference is taken once, by the step that walks onto
// the node; the helpers below run on nodes their caller already holds, so
// they take none of their own (every count change is an atomic operation).
#include <utility>
#include <vector>

#include "ui/ActionRecorder.h"
#include "ui/MouseEvent.h"
#include "ui/UI_Node.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {
namespace {

constexpr unsigned long kStateDisabled = UI_Node::kStateSelfDisabled | UI_Node::kStateParentDisabled;

// The topmost shown child of inNode under ioPoint, with ioPoint brought into
// its coordinates; null when no child is hit.
UI_NodeP ChildUnder(UI_Node* inNode, bool inSkipOSChildren, UI_Node::PointF& ioPoint) {
  auto [hit, it] = inNode->GetChildHit(false, inSkipOSChildren, ioPoint);
  return hit ? *it : UI_NodeP();
}

// The custom mouse function, then UI_DoMouseEvent, on a node the caller holds.
bool MouseEventToHeldNode(UI_Node* inNode, UI_Node* inLeaf, const MouseEvent& inEvent) {
  // Held by copy: the function may replace itself while it runs.
  if (UI_Node::CustomMouseFunction custom = inNode->UI_GetCustomMouseEventFunction()) {
    bool tookOver = false;
    bool result = (*custom)(inLeaf, inEvent, tookOver);
    if (tookOver) return result;
  }
  return inNode->UI_DoMouseEvent(inLeaf, inEvent);
}

// Delivery of a mouse event to inNode (held by the caller) for target
// inTarget at inPoint, in inNode's coordinates. The filters run when the
// delivery is to the leaf itself; a disabled node never sees the event,
// though the walk goes on past it.
bool DeliverMouseEvent(UI_Node* inNode, UI_Node* inTarget, const MouseEvent& inEvent, const UI_Node::PointF& inPoint) {
  MouseEvent copy(inEvent);
  copy.SetPosition(inPoint);
  if (inNode == inTarget && UI_Node::UI_DispatchPreMouseEvent(inTarget, copy)) return true;
  if (inNode->UI_GetStateFlags().TestAny(kStateDisabled)) return false;
  return MouseEventToHeldNode(inNode, inTarget, copy);
}

// The cursor is delivered like a mouse event, but to disabled nodes too, and
// without filters; inNode is held by the caller.
bool DeliverCursor(UI_Node* inNode, UI_Node* inTarget, const UI_Node::PointF& inPoint, UI_Node::ModKeys inModKeys) {
  if (UI_Node::CustomCursorFunction custom = inNode->UI_GetCustomDoCursorFunction()) {
    bool tookOver = false;
    bool result = (*custom)(inTarget, inPoint, inModKeys, tookOver);
    if (tookOver) return result;
  }
  return inNode->UI_DoCursor(inTarget, inPoint, inModKeys);
}

// Climbs from inStart to the root, bringing inPoint into each ancestor's
// coordinates, until inDeliver answers true. The next ancestor is taken
// before each call, so a node that detaches itself in its handler does not
// cut the climb short.
template <typename Deliver>
bool ClimbTowardsRoot(UI_Node* inStart, UI_Node::PointF inPoint, Deliver&& inDeliver) {
  UI_NodeP node(inStart);
  UI_NodeP parent(node->UI_GetParentNode());
  while (parent) {
    inPoint = node->UI_GetSelfToParentMatrix().Transform(inPoint);
    UI_NodeP next(parent->UI_GetParentNode());
    if (inDeliver(parent.get(), inPoint)) return true;
    node = std::move(parent);
    parent = std::move(next);
  }
  return false;
}

// The walk towards the leaf below inSelf, which the caller holds; each child
// walked onto is held for the length of its own walk. Answers whether a node
// handled the event, and the leaf.
std::pair<bool, UI_NodeP> MouseTowardsLeaf(const UI_NodeP& inSelf, const MouseEvent& inEvent, bool inSkipOSChildren) {
  UI_Node* node = inSelf.get();
  const UI_Node::PointF& point = inEvent.GetPosition();
  const bool firstChance = node->UI_GetStateFlags().Test(UI_Node::kStateFirstChanceMouse);
  if (firstChance && DeliverMouseEvent(node, nullptr, inEvent, point)) return {true, inSelf};

  UI_Node::PointF childPoint = point;
  if (UI_NodeP child = ChildUnder(node, inSkipOSChildren, childPoint)) {
    MouseEvent childEvent(inEvent);
    childEvent.SetPosition(childPoint);
    std::pair<bool, UI_NodeP> result = MouseTowardsLeaf(child, childEvent, inSkipOSChildren);
    if (result.first) return result;
    // An unhandled event climbs to this node; it never falls through to a
    // sibling underneath the child that was hit.
    result.first = DeliverMouseEvent(node, result.second.get(), inEvent, point);
    return result;
  }
  return {DeliverMouseEvent(node, node, inEvent, point), inSelf};
}

// The cursor's walk towards the leaf, as MouseTowardsLeaf.
std::pair<bool, UI_NodeP> CursorTowardsLeaf(const UI_NodeP& inSelf, const UI_Node::PointF& inPoint,
                                            UI_Node::ModKeys inModKeys, bool inSkipOSChildren) {
  UI_Node* node = inSelf.get();
  const bool firstChance = node->UI_GetStateFlags().Test(UI_Node::kStateFirstChanceMouse);
  if (firstChance && DeliverCursor(node, nullptr, inPoint, inModKeys)) return {true, inSelf};

  UI_Node::PointF childPoint = inPoint;
  if (UI_NodeP child = ChildUnder(node, inSkipOSChildren, childPoint)) {
    std::pair<bool, UI_NodeP> result = CursorTowardsLeaf(child, childPoint, inModKeys, inSkipOSChildren);
    if (result.first) return result;
    result.first = DeliverCursor(node, result.second.get(), inPoint, inModKeys);
    return result;
  }
  return {DeliverCursor(node, node, inPoint, inModKeys), inSelf};
}

}  // namespace

bool UI_Node::UI_DispatchMouseEvent(const MouseEvent& inEvent, bool inSkipOSChildren) {
  UI_NodeP protector(this);
  MouseEvent copy(inEvent);
  UI_NodeP target(UI_GetMouseProxy(&copy));
  if (!target) return false;
  return UI_DispatchMouseEventToTarget(target.get(), copy, inSkipOSChildren);
}

bool UI_Node::UI_DispatchMouseEventToTarget(UI_Node* inNode, const MouseEvent& inEvent, bool inSkipOSChildren) {
  if (!inNode) return false;
  UI_NodeP target(inNode);
  automateui::ActionRecorder::GetInstance().RecordMouseEvent(inNode, inEvent);
  if (UI_DispatchCapturedMouseEvent(inNode, inEvent)) return true;
  auto [handled, leaf] = target->UI_DispatchMouseEventTowardsLeaf(inEvent, inSkipOSChildren);
  if (handled) return true;
  return target->UI_DispatchMouseEventTowardsRoot(leaf.get(), inEvent);
}

std::pair<bool, UI_NodeP> UI_Node::UI_DispatchMouseEventTowardsLeaf(const MouseEvent& inEvent, bool inSkipOSChildren) {
  UI_NodeP self(this);
  return MouseTowardsLeaf(self, inEvent, inSkipOSChildren);
}

bool UI_Node::UI_DispatchMouseEventTowardsRoot(UI_Node* inLeaf, const MouseEvent& inEvent) {
  UI_NodeP leaf(inLeaf);
  return ClimbTowardsRoot(this, inEvent.GetPosition(), [&](UI_Node* inNode, const PointF& inPoint) {
    return DeliverMouseEvent(inNode, inLeaf, inEvent, inPoint);
  });
}

bool UI_Node::UI_DispatchMouseEventToLeaf(UI_Node* inNode, UI_Node* inLeaf, const MouseEvent& inEvent) {
  UI_NodeP protector(inNode);
  return MouseEventToHeldNode(inNode, inLeaf, inEvent);
}

bool UI_Node::UI_DispatchPreMouseEvent(UI_Node* inLeaf, const MouseEvent& inEvent) {
  UI_NodeManager* manager = UI_NodeManager::Get();
  if (!manager || manager->GetMouseEventFiltersSize() == 0) return false;
  // A copy, so that a filter may remove itself or another one; a filter added
  // now waits for the next event.
  const std::vector<UI_Node*>& live = manager->GetMouseEventFilters();
  std::vector<UI_NodeP> filters(live.begin(), live.end());
  for (const UI_NodeP& filter : filters) {
    if (CustomMouseFunction custom = filter->UI_GetCustomPreMouseEventFunction()) {
      bool tookOver = false;
      bool result = (*custom)(inLeaf, inEvent, tookOver);
      if (tookOver) return result;
    }
    if (filter->UI_DoPreMouseEvent(inLeaf, inEvent)) return true;
  }
  return false;
}

// ------------------------------------------------------------------------ cursor

bool UI_Node::UI_DispatchCursor(const PointF& inPoint, ModKeys inModKeys, bool inSkipOSChildren) {
  UI_NodeP protector(this);
  if (UI_DispatchCapturedCursor(this, inPoint, inModKeys)) return true;
  auto [handled, leaf] = UI_DispatchCursorTowardsLeaf(inPoint, inModKeys, inSkipOSChildren);
  if (handled) return true;
  return UI_DispatchCursorTowardsRoot(leaf.get(), inPoint, inModKeys);
}

std::pair<bool, UI_NodeP> UI_Node::UI_DispatchCursorTowardsLeaf(const PointF& inPoint, ModKeys inModKeys,
                                                                bool inSkipOSChildren) {
  UI_NodeP self(this);
  return CursorTowardsLeaf(self, inPoint, inModKeys, inSkipOSChildren);
}

bool UI_Node::UI_DispatchCursorTowardsRoot(UI_Node* inLeaf, const PointF& inPoint, ModKeys inModKeys) {
  UI_NodeP leaf(inLeaf);
  return ClimbTowardsRoot(this, inPoint, [&](UI_Node* inNode, const PointF& inNodePoint) {
    return DeliverCursor(inNode, inLeaf, inNodePoint, inModKeys);
  });
}

}  // namespace norvik::ui
