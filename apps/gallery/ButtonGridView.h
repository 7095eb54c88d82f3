#pragma once
// A table of state samples: a row per kind of button, a column per state,
// with the kinds named down the left and the states across the top. A cell
// whose state the kind does not have stays empty.
#include <vector>

#include "ButtonSamples.h"
#include "ui/UI_SubView.h"

namespace norvik::gallery {

class ButtonGridView : public ui::UI_SubView {
 public:
  ButtonGridView();

  // The sample of inKind in inState, or null where the kind lacks the state.
  ui::UI_Node* GetSample(ButtonKind inKind, ShownState inState) const;
  // The cell of a kind and state, local to the grid.
  RectF GetCellRect(ButtonKind inKind, ShownState inState) const;
  int GetSampleCount() const;
  // The height at which the rows stand at their most generous spacing.
  static float GetPreferredHeight() { return kHeadingHeight + kButtonKindCount * kMaxRowHeight; }

  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  void UI_SizeChanged(const RectF& inLocalRect) override;

  // The column of the kinds' names takes a share of the width, within these.
  static constexpr float kMinLabelWidth = 110;
  static constexpr float kMaxLabelWidth = 150;
  static constexpr float kHeadingHeight = 22;
  static constexpr float kMinRowHeight = 22;
  static constexpr float kMaxRowHeight = 34;

 private:
  void Arrange();
  float LabelWidth() const;
  float RowHeight() const;
  float ColumnWidth() const;
  std::vector<std::vector<controls::UI_ControlViewP>> mSamples;  // [kind][state]
  ui::UI_NodeP mRadioGroup;                                  // holds the radio row
};

}  // namespace norvik::gallery
