#pragma once
// One cell of a grid view: a rectangle in the view's coordinates and the
// nodes that stand in it, each at an offset from the cell's corner.
#include <vector>

#include "layout/SmartLayout.h"
#include "ui/UI_SubView.h"

namespace norvik::drawbot {
class Drawbot;
}

namespace norvik::layout {

class UI_Cell : public tarsel::utility::RefCountedObject {
 public:
  using NodeP = boost::intrusive_ptr<ui::UI_Node>;

  RectF GetLocalRectF() const { return mRect; }
  void SetLocalRectF(const RectF& inRect) { mRect = SanitizeRect(inRect); }
  bool IsVisible() const { return mVisible; }
  void SetVisible(bool inVisible) { mVisible = inVisible; }
  bool IsSelected() const { return mSelected; }
  void SetSelected(bool inSelected) { mSelected = inSelected; }
  bool IsEmpty() const { return mNodes.empty(); }
  long GetNodeCount() const { return static_cast<long>(mNodes.size()); }

  // A node already in the cell only moves to the new offset.
  void AddNode(NodeP inNode, const PointF& inOffset = PointF());
  bool RemoveNode(const ui::UI_Node* inNode);
  bool HasNode(const ui::UI_Node* inNode) const;
  // Null (and the origin) outside 0 .. count - 1.
  NodeP GetNode(long inIndex) const;
  PointF GetNodeOffset(long inIndex) const;
  // Makes each of the cell's nodes a child of inView, if it is not one yet.
  void FetchNodes(ui::UI_SubView& inView);
  // The room the nodes need: each at its recommended size (or its current
  // size when it recommends none), with its offset as padding on both sides.
  PointF RecalcCellSize(drawbot::Drawbot* inDrawbot) const;
  // Moves the nodes to the cell's corner plus their offsets, at the sizes
  // that RecalcCellSize counted.
  void UpdateNodesPosition();

 private:
  struct Entry {
    NodeP node;
    PointF offset;
  };
  static PointF NodeSize(const ui::UI_Node& inNode);

  RectF mRect;
  bool mVisible = true;
  bool mSelected = false;
  std::vector<Entry> mNodes;
};

using UI_CellP = boost::intrusive_ptr<UI_Cell>;

}  // namespace norvik::layout
