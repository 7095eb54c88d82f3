#pragma once
// The leaf by which a node that is no arrangement view takes part in an
// arrangement. Sizes come from the node's recommended size, rounded up to
// whole pixels; a node stretches across an axis when its layout binding asks
// it to follow its parent's size on that axis (width grows, height grows).
// Arrangement coordinates are global; Place maps them into the parent view's
// space and snaps to whole pixels once, at the node.
#include "arrange/Single.h"
#include "ui/UI_Node.h"

namespace norvik::arrange {

class ArrangeableNodeBridge : public Single {
 public:
  ArrangeableNodeBridge(ui::UI_Node& inNode, IArrangeable* inParent);

  float NaturalWidth() const override;
  float NaturalHeight() const override;
  bool HorizontallyExpandable() const override;
  bool VerticallyExpandable() const override;
  PointF Place(RectF const& inRect) override;

  ui::UI_Node& Node() const { return mNode; }

  // The local rectangle, in the parent node's space, of a global rectangle.
  static RectF ToParentSpace(ui::UI_Node& inNode, RectF const& inGlobal);

 private:
  ui::UI_Node& mNode;
};

}  // namespace norvik::arrange
