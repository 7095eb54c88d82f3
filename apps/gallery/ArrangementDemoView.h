#pragma once
// The arrangement demo of the Layout page: a dozen buttons and check boxes in
// an arrangement view, and beside them the switches that drive it (the kind
// of group, picked by six radio buttons, separators, and alignment on both
// axes) stacked by a layout view. The view reflows at each new size: the
// candidate that fits best wins, so a wide page and a narrow one show
// different placements of the same children.
#include <functional>
#include <vector>

#include "arrange/UI_ArrangementView.h"
#include "controls/UI_Checkbox.h"
#include "controls/UI_RadioGroup.h"
#include "layout/UI_LayoutView.h"

namespace norvik::gallery {

class ArrangementDemoView : public ui::UI_SubView {
 public:
  ArrangementDemoView();

  // The height the demo needs at the given width: the switches' column, or
  // more when the children need it.
  float GetHeightForWidth(float inWidth);
  // Called after a switch changed the placement, so that the host can give
  // the demo the height it needs now.
  void SetHeightMayChangeFunction(std::function<void()> inF) { mHeightMayChange = std::move(inF); }

  ui::UI_ArrangementView* GetArrangementView() const { return mArrangement.get(); }
  layout::UI_LayoutView* GetSwitches() const { return mSwitches.get(); }
  controls::UI_RadioGroup* GetTypeGroup() const { return mTypeGroup.get(); }
  controls::UI_Checkbox* GetSeparatorSwitch() const { return mSeparators.get(); }
  controls::UI_Checkbox* GetCentreHorizontallySwitch() const { return mCentreHorizontally.get(); }
  controls::UI_Checkbox* GetCentreVerticallySwitch() const { return mCentreVertically.get(); }
  const std::vector<ui::UI_NodeP>& GetItems() const { return mItems; }

  void UI_SizeChanged(const RectF& inLocalRect) override;

  static constexpr float kGap = 16;
  static constexpr arrange::GroupArrangementType kFirstType = arrange::kGroupHorizontalWrapping;

 private:
  void MakeSwitches();
  void MakeItems();
  void ApplySwitches();
  void ApplySwitchesToArrangement();
  void Arrange();
  // The size the switches take, once they are laid out.
  PointF SwitchesSize();
  // The least height in which some placement of the children fits the width,
  // as a wrapping panel is given: the choice then falls among the placements
  // with the fewest lines that fit.
  float NeededHeight(float inWidth);

  layout::UI_LayoutViewP mSwitches;
  boost::intrusive_ptr<controls::UI_RadioGroup> mTypeGroup;
  boost::intrusive_ptr<controls::UI_Checkbox> mSeparators, mCentreHorizontally, mCentreVertically;
  boost::intrusive_ptr<ui::UI_ArrangementView> mArrangement;
  std::vector<ui::UI_NodeP> mItems;
  std::function<void()> mHeightMayChange;
};

}  // namespace norvik::gallery
