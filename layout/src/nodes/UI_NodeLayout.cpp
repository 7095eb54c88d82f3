#include "layout/UI_NodeLayout.h"

#include <algorithm>
#include <cmath>

#include "controls/UI_Checkbox.h"
#include "controls/UI_RadioButton.h"
#include "controls/UI_TextButton.h"
#include "ui/UI_Node.h"

namespace norvik::layout {

namespace {

PointF Ceiled(const PointF& inSize) {
  const PointF size = SanitizeSize(inSize);
  return PointF(std::ceil(size.x), std::ceil(size.y));
}

// Room that the label's text leaves at the button's sides.
constexpr float kTextButtonSidePad = 5;

}  // namespace

UI_NodeLayout::UI_NodeLayout(NodeP inNode, const PointF& inInitialSize)
    : SmartLayout(inInitialSize), mNode(std::move(inNode)) {}

void UI_NodeLayout::SetLocation(const RectF& inRect) {
  // The layout holds the node strongly, so it outlives its own call-out.
  const NodeP node = mNode;
  if (node) node->UI_SetLocalRectF(SanitizeRect(inRect));
}

UI_CheckboxLayout::UI_CheckboxLayout(boost::intrusive_ptr<controls::UI_Checkbox> inCheckbox)
    : UI_NodeLayout(inCheckbox, inCheckbox ? Ceiled(inCheckbox->UI_GetRecommendedSize()) : PointF()) {}

UI_RadioButtonLayout::UI_RadioButtonLayout(boost::intrusive_ptr<controls::UI_RadioButton> inButton)
    : UI_NodeLayout(inButton, inButton ? Ceiled(inButton->UI_GetRecommendedSize()) : PointF()) {}

UI_TextButtonLayout::UI_TextButtonLayout(boost::intrusive_ptr<controls::UI_TextButton> inButton,
                                         const PointF& inMinimumSize)
    : UI_NodeLayout(inButton, inMinimumSize), mMinimumSize(SanitizeSize(inMinimumSize)) {}

PointF UI_TextButtonLayout::GetInitialSize() {
  auto* button = dynamic_cast<controls::UI_TextButton*>(GetNode().get());
  if (!button) return mMinimumSize;
  if (!mMeasured || button->GetText() != mMeasuredText) {
    mMeasuredText = button->GetText();
    mMeasured = true;
    SetInitialSizeField(GetButtonSize());
  }
  return SmartLayout::GetInitialSize();
}

PointF UI_TextButtonLayout::GetButtonSize() const {
  auto* button = dynamic_cast<controls::UI_TextButton*>(GetNode().get());
  if (!button) return mMinimumSize;
  controls::DrawTextControlBaseParameters text;
  button->FillTextParameters(text, button->UI_GetCurrentTheme().get());
  const float textWidth = controls::MeasureControlLabel(text, button->GetText());
  const float textHeight = text.GetFontSize();
  return Ceiled(PointF(std::max(mMinimumSize.x, textWidth + kTextButtonSidePad),
                       std::max(mMinimumSize.y, textHeight)));
}

}  // namespace norvik::layout
