#include "arrange/UI_ArrangementView.h"

#include <algorithm>

#include "ui/UI_Divider.h"

namespace norvik::ui {

// A divider that the arrangement sizes to the gap between two children.
class UI_ArrangementView::UI_ArrangeableSeparator : public UI_Divider, public arrange::ISeparator {
 public:
  void Arrange(RectF const& inRect) override {
    UI_NodeP protector(this);
    UI_SetLocalRectF(arrange::ArrangeableNodeBridge::ToParentSpace(*this, inRect));
  }
};

UI_ArrangementView::UI_ArrangementView(arrange::GroupArrangementType inType) : DefaultGroup(nullptr, inType) {
  UI_Show(true);
  UI_SetLayoutsChildren(true);
}

UI_ArrangementView::~UI_ArrangementView() {
  // The children go with the container base; their bridges go first, with
  // the group that they would report their end to still whole.
  for (auto& entry : mBridges) entry.second->SetParent(nullptr);
  mBridges.clear();
}

bool UI_ArrangementView::IsRootArrangement() const {
  return !Arrangeable().Parent() && UI_GetParentNode() && UI_IsShown();
}

arrange::IArrangeable* UI_ArrangementView::ArrangeableOf(UI_Node& inChild) const {
  if (auto nested = dynamic_cast<UI_ArrangementView*>(&inChild)) return &nested->Arrangeable();
  auto it = mBridges.find(&inChild);
  return it == mBridges.end() ? nullptr : it->second.get();
}

bool UI_ArrangementView::IsOwnSeparator(UI_Node* inChild) const {
  return std::any_of(mSeparators.begin(), mSeparators.end(),
                     [inChild](const boost::intrusive_ptr<UI_ArrangeableSeparator>& s) { return s.get() == inChild; });
}

void UI_ArrangementView::ChildAdded(UI_Node* inChild) {
  UI_SubView::ChildAdded(inChild);
  if (!inChild || IsOwnSeparator(inChild)) return;
  if (!dynamic_cast<UI_ArrangementView*>(inChild))
    mBridges[inChild] = std::make_unique<arrange::ArrangeableNodeBridge>(*inChild, &Arrangeable());
  Invalidate();
}

void UI_ArrangementView::ChildRemoved(UI_Node* inChild) {
  UI_SubView::ChildRemoved(inChild);
  if (IsOwnSeparator(inChild)) return;
  auto it = mBridges.find(inChild);
  if (it != mBridges.end()) {
    std::unique_ptr<arrange::ArrangeableNodeBridge> bridge = std::move(it->second);
    mBridges.erase(it);
    bridge->SetParent(nullptr);
  }
  Invalidate();
}

void UI_ArrangementView::ChildOrderChanged() {
  UI_SubView::ChildOrderChanged();
  Invalidate();
}

void UI_ArrangementView::UI_NodeChanged(NodeChange inChange) {
  UI_SubView::UI_NodeChanged(inChange);
  // Our own geometry changes come from the arrangement or from the parent's
  // layout; a change of parent is handled in UI_SetParent.
  if (inChange == kNodeChangeVisibility) Invalidate();
  // A root that moves (or whose ancestors move) takes its children along in
  // its own space; its rectangle in global coordinates must follow, or the
  // next placement after an invalidation would use the old origin.
  const bool moved = inChange == kNodeChangeGeometry || inChange == kNodeChangeParent ||
                     inChange == kNodeChangeWindowMoved;
  if (moved && !Arrangeable().Parent()) Arrangeable().MoveLastRectangle(UI_LocalToGlobalF(PointF(0, 0)));
}

void UI_ArrangementView::UI_SetParent(UI_Container* inParent) {
  UI_SubView::UI_SetParent(inParent);
  auto outer = dynamic_cast<UI_ArrangementView*>(UI_GetParentNode());
  Arrangeable().SetParent(outer ? &outer->Arrangeable() : nullptr);
}

void UI_ArrangementView::UI_LayoutChildren(const RectF&, const RectF& inNewSize) {
  if (mSettingDimensions || !IsRootArrangement()) return;
  if (inNewSize.width < 0 || inNewSize.height < 0) return;
  Arrange(UI_LocalToGlobalF(UI_GetLocalRectF(false)));
}

bool UI_ArrangementView::VisitChildren(boost::function<bool(arrange::IArrangeable const&)> inVisitor) const {
  for (UI_NodeP child : std::vector<UI_NodeP>(ChildBegin(), ChildEnd())) {
    arrange::IArrangeable* element = ArrangeableOf(*child);
    if (element && !inVisitor(*element)) return false;
  }
  return true;
}

bool UI_ArrangementView::VisitChildren(boost::function<bool(arrange::IArrangeable&)> inVisitor) {
  for (UI_NodeP child : std::vector<UI_NodeP>(ChildBegin(), ChildEnd())) {
    arrange::IArrangeable* element = ArrangeableOf(*child);
    if (element && !inVisitor(*element)) return false;
  }
  return true;
}

arrange::ISeparator* UI_ArrangementView::BuildSeparator() {
  if (!mSeparatorsEnabled) return nullptr;
  boost::intrusive_ptr<UI_ArrangeableSeparator> separator(new UI_ArrangeableSeparator);
  mSeparators.push_back(separator);
  ChildPushBack(separator);
  return separator.get();
}

void UI_ArrangementView::ClearSeparators() {
  std::vector<boost::intrusive_ptr<UI_ArrangeableSeparator>> separators;
  separators.swap(mSeparators);
  // Still listed while they leave, so that their removal is not taken for a
  // child's.
  mSeparators = separators;
  for (const auto& separator : separators) ChildRemove(separator.get());
  mSeparators.clear();
}

void UI_ArrangementView::EnableSeparators(bool inEnable) {
  if (mSeparatorsEnabled == inEnable) return;
  mSeparatorsEnabled = inEnable;
  ForgetSeparators();
}

void UI_ArrangementView::Position(PointF const& inOrigin) {
  if (!Arrangeable().Parent()) return;  // a root stays where its parent put it
  UI_Node* parent = UI_GetParentNode();
  const PointF local = parent ? parent->UI_GlobalToLocalF(inOrigin) : inOrigin;
  const RectF rect = UI_GetLocalRectF(true);
  UI_SetLocalRectF(RectF(local.x, local.y, rect.width, rect.height));
}

void UI_ArrangementView::SetDimensions(PointF const& inSize) {
  if (!Arrangeable().Parent() || mSettingDimensions) return;
  mSettingDimensions = true;
  const RectF rect = UI_GetLocalRectF(true);
  UI_SetLocalRectF(RectF(rect.left, rect.top, inSize.x, inSize.y));
  mSettingDimensions = false;
}

}  // namespace norvik::ui
