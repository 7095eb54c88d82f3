#pragma once
// A view that is also an arrangement group: its child nodes are the group's
// children, placed by the candidate that fits the view best. Only a root
// arrangement view arranges when it is laid out; a nested one is placed by
// its root through Position and SetDimensions. Arrangement coordinates are
// global, so that nested views share one space.
#include <map>
#include <memory>
#include <vector>

#include "arrange/ArrangeableNodeBridge.h"
#include "arrange/DynamicGroup.h"
#include "ui/UI_SubView.h"

namespace norvik::ui {

class UI_ArrangementView : public UI_SubView, public arrange::DefaultGroup<arrange::DynamicGroup> {
 public:
  explicit UI_ArrangementView(arrange::GroupArrangementType inType = arrange::kGroupRow);
  ~UI_ArrangementView() override;

  void EnableSeparators(bool inEnable);
  bool HasSeparators() const { return mSeparatorsEnabled; }
  std::size_t SeparatorCount() const { return mSeparators.size(); }
  // No arrangement parent, a parent node, and shown.
  bool IsRootArrangement() const;

  // ---- nodes ----
  void ChildAdded(UI_Node* inChild) override;
  void ChildRemoved(UI_Node* inChild) override;
  void ChildOrderChanged() override;
  void UI_NodeChanged(NodeChange inChange) override;
  void UI_SetParent(UI_Container* inParent) override;
  void UI_LayoutChildren(const RectF& inOldSize, const RectF& inNewSize) override;
  // The minimum of the candidate nearest the golden ratio, for hosts that
  // place the view by its recommended size.
  PointF UI_GetRecommendedSize() const override { return Arrangeable().BestSize(); }

  // ---- the group ----
  bool VisitChildren(boost::function<bool(arrange::IArrangeable const&)> inVisitor) const override;
  bool VisitChildren(boost::function<bool(arrange::IArrangeable&)> inVisitor) override;
  arrange::ISeparator* BuildSeparator() override;
  void ClearSeparators() override;
  void Position(PointF const& inOrigin) override;
  void SetDimensions(PointF const& inSize) override;

 private:
  class UI_ArrangeableSeparator;

  arrange::IArrangeable* ArrangeableOf(UI_Node& inChild) const;
  bool IsOwnSeparator(UI_Node* inChild) const;

  bool mSeparatorsEnabled = false;
  bool mSettingDimensions = false;
  std::vector<boost::intrusive_ptr<UI_ArrangeableSeparator>> mSeparators;
  std::map<UI_Node*, std::unique_ptr<arrange::ArrangeableNodeBridge>> mBridges;
};

}  // namespace norvik::ui
