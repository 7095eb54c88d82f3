#pragma once
// Leaves of a smart layout that place one node each. A leaf sizes itself
// from the node (or is told its size) and, when placed, gives the node its
// rectangle in the node's parent's coordinates.
#include "layout/SmartLayout.h"
#include "tarsel/UTFString.h"
#include "ui/UI_Node.h"

namespace norvik::controls {
class UI_Checkbox;
class UI_RadioButton;
class UI_TextButton;
}  // namespace norvik::controls

namespace norvik::layout {

class UI_NodeLayout : public SmartLayout {
 public:
  using NodeP = boost::intrusive_ptr<ui::UI_Node>;
  UI_NodeLayout(NodeP inNode, const PointF& inInitialSize);

  void SetLocation(const RectF& inRect) override;
  NodeP GetNode() const { return mNode; }
  void SetNode(NodeP inNode) { mNode = std::move(inNode); }

 private:
  NodeP mNode;
};

// The check box's recommended size, each axis raised to a whole number.
class UI_CheckboxLayout : public UI_NodeLayout {
 public:
  explicit UI_CheckboxLayout(boost::intrusive_ptr<controls::UI_Checkbox> inCheckbox);
};

class UI_RadioButtonLayout : public UI_NodeLayout {
 public:
  explicit UI_RadioButtonLayout(boost::intrusive_ptr<controls::UI_RadioButton> inButton);
};

// Measured from the button's text on demand, and again only when the text has
// changed since: a dialog may rename its buttons before it is first placed.
class UI_TextButtonLayout : public UI_NodeLayout {
 public:
  // inMinimumSize is the least the button gets, whatever its text.
  UI_TextButtonLayout(boost::intrusive_ptr<controls::UI_TextButton> inButton, const PointF& inMinimumSize);

  PointF GetInitialSize() override;
  PointF GetButtonSize() const;

 private:
  PointF mMinimumSize;
  UTF16String mMeasuredText;
  bool mMeasured = false;
};

}  // namespace norvik::layout
