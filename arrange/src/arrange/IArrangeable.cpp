#include "arrange/IArrangeable.h"

#include "arrange/IArrangement.h"

namespace norvik::arrange {

namespace {

// Placing a child may invalidate the tree (a view that changes its content
// once it has a size); this many rounds settle every sane case.
constexpr int kMaxRounds = 5;

struct FlagScope {
  explicit FlagScope(bool& inFlag) : flag(inFlag) { flag = true; }
  ~FlagScope() { flag = false; }
  bool& flag;
};

void MarkSubtreeUnbuilt(IArrangeable& inElement, void (*inClear)(IArrangeable&)) {
  VisitChildren(inElement, [inClear](IArrangeable& inChild) {
    MarkSubtreeUnbuilt(inChild, inClear);
    return true;
  });
  inClear(inElement);
}

}  // namespace

IArrangeable::IArrangeable(IArrangeable* inParent) : mParent(inParent) {}

IArrangeable::~IArrangeable() {
  if (mParent) mParent->ChildDestroyed(*this);
}

bool IArrangeable::VisitChildren(boost::function<bool(IArrangeable const&)>) const { return true; }
bool IArrangeable::VisitChildren(boost::function<bool(IArrangeable&)>) { return true; }
void IArrangeable::RebuildSelf() {}
void IArrangeable::ChildDestroyed(IArrangeable&) {}

IArrangeable& IArrangeable::Root() {
  IArrangeable* node = this;
  while (node->mParent) node = node->mParent;
  return *node;
}

const IArrangeable& IArrangeable::Root() const {
  const IArrangeable* node = this;
  while (node->mParent) node = node->mParent;
  return *node;
}

void IArrangeable::RebuildIfNeeded() {
  if (mBuilt) return;
  RebuildSelf();
  mBuilt = true;
}

impl::ArrangementSet& IArrangeable::Arrangements() {
  RebuildIfNeeded();
  return ArrangementsSelf();
}

PointF IArrangeable::BestSize() {
  impl::IArrangement* best = Arrangements().MostBalanced();
  if (!best) return {0.0f, 0.0f};
  return {best->MinWidth(), best->MinHeight()};
}

PointF IArrangeable::Arrange(RectF const& inRect) {
  if (mParent) return mParent->Arrange(inRect);
  return ArrangeAtRoot(inRect);
}

PointF IArrangeable::ArrangeAtRoot(RectF const& inRect) {
  if (!(inRect.width > 0.0f) || !(inRect.height > 0.0f) || !mArrangementEnabled) return {0.0f, 0.0f};
  RectF rect(SaneCoordinate(inRect.left), SaneCoordinate(inRect.top), SaneExtent(inRect.width),
             SaneExtent(inRect.height));
  // Nothing has been invalidated since the same rectangle was placed.
  if (mBuilt && mPlaced && rect == mLastRect) return mLastUsed;
  mLastRect = rect;
  mPlaced = false;
  // A placement that re-enters (a child invalidating from its Place) is left
  // to the running loop, which sees the cleared flag and goes round again.
  if (mArranging) return {0.0f, 0.0f};
  FlagScope arranging(mArranging);
  PointF used(0.0f, 0.0f);
  for (int round = 0; round < kMaxRounds; ++round) {
    RebuildIfNeeded();
    impl::ArrangementPtr chosen = ArrangementsSelf().ChooseFor(rect.Size());
    if (!chosen) break;
    used = chosen->Arrange(rect);
    if (mBuilt) break;
  }
  mPlaced = mBuilt;
  mLastUsed = used;
  return used;
}

void IArrangeable::Rearrange() {
  IArrangeable& root = Root();
  root.Arrange(root.mLastRect);
}

void IArrangeable::Invalidate() {
  IArrangeable& root = Root();
  const bool wasOn = root.mArrangementEnabled;
  root.mArrangementEnabled = false;
  if (mBuilt && mParent) mParent->Invalidate();
  mBuilt = false;
  if (wasOn) root.EnableArrangement(true);
}

void IArrangeable::InvalidateAll() {
  if (!ArrangementEnabled()) return;
  // One placement for the whole subtree, not one for each element.
  IArrangeable& root = Root();
  root.mArrangementEnabled = false;
  MarkSubtreeUnbuilt(*this, [](IArrangeable& inElement) { inElement.mBuilt = false; });
  for (IArrangeable* up = mParent; up; up = up->mParent) up->mBuilt = false;
  root.EnableArrangement(true);
}

void IArrangeable::EnableArrangement(bool inEnable) {
  IArrangeable& root = Root();
  if (root.mArrangementEnabled == inEnable) return;
  root.mArrangementEnabled = inEnable;
  if (inEnable) root.Arrange(root.mLastRect);
}

void IArrangeable::MoveLastRectangle(PointF const& inOrigin) {
  IArrangeable& root = Root();
  root.mLastRect.left = SaneCoordinate(inOrigin.x);
  root.mLastRect.top = SaneCoordinate(inOrigin.y);
}

void IArrangeable::TakeOverFrom(IArrangeable const& inReplaced) {
  mLastRect = inReplaced.mLastRect;
  mArrangementEnabled = inReplaced.mArrangementEnabled;
}

bool IArrangeable::ArrangementEnabled() const { return Root().mArrangementEnabled; }

IArrangeable* Parent(IArrangeable& inElement) { return inElement.Parent(); }

bool VisitChildren(IArrangeable& inElement, boost::function<bool(IArrangeable&)> inVisitor) {
  return inElement.VisitChildren(std::move(inVisitor));
}

bool VisitChildren(IArrangeable const& inElement, boost::function<bool(IArrangeable const&)> inVisitor) {
  return inElement.VisitChildren(std::move(inVisitor));
}

}  // namespace norvik::arrange
