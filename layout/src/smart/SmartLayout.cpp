#include "layout/SmartLayout.h"

#include <algorithm>
#include <cmath>

#include "layout/ExtraSpace.h"

namespace norvik::layout {

float SanitizeExtent(float inValue) { return std::isfinite(inValue) && inValue > 0 ? inValue : 0.0f; }

PointF SanitizeSize(const PointF& inSize) { return PointF(SanitizeExtent(inSize.x), SanitizeExtent(inSize.y)); }

RectF SanitizeRect(const RectF& inRect) {
  auto finite = [](float v) { return std::isfinite(v) ? v : 0.0f; };
  return RectF(finite(inRect.left), finite(inRect.top), SanitizeExtent(inRect.width),
               SanitizeExtent(inRect.height));
}

SmartLayoutP EmptyLayout::GetSharedPtr() {
  static const SmartLayoutP sEmpty(new EmptyLayout);
  return sEmpty;
}

LayoutDecorator::LayoutDecorator(SmartLayoutP inDecorated) { SetDecoratedObject(std::move(inDecorated)); }

void LayoutDecorator::SetLocation(const RectF& inRect) { mDecorated->SetLocation(inRect); }

PointF LayoutDecorator::GetInitialSize() { return mDecorated->GetInitialSize(); }

void LayoutDecorator::SetDecoratedObject(SmartLayoutP inDecorated) {
  mDecorated = inDecorated ? std::move(inDecorated) : EmptyLayout::GetSharedPtr();
}

void LayoutDecorator::InsertLayoutDecorator(LayoutDecoratorP inDecorator) {
  if (!inDecorator || inDecorator.get() == this) return;
  inDecorator->SetDecoratedObject(GetDecoratedObject());
  SetDecoratedObject(inDecorator);
}

void LayoutNotifier::SetLocation(const RectF& inRect) {
  const RectF rect = SanitizeRect(inRect);
  if (!mFunction.empty()) mFunction(rect);
  LayoutDecorator::SetLocation(rect);
}

ParentChildLayoutJoiner::ParentChildLayoutJoiner(SmartLayoutP inParent, SmartLayoutP inChild)
    : mParent(inParent ? std::move(inParent) : EmptyLayout::GetSharedPtr()),
      mChild(inChild ? std::move(inChild) : EmptyLayout::GetSharedPtr()) {}

void ParentChildLayoutJoiner::SetLocation(const RectF& inRect) {
  const RectF rect = SanitizeRect(inRect);
  mParent->SetLocation(rect);
  mChild->SetLocation(RectF(0, 0, rect.width, rect.height));
}

PointF ParentChildLayoutJoiner::GetInitialSize() {
  const PointF parent = mParent->GetInitialSize(), child = mChild->GetInitialSize();
  SetInitialSizeField(PointF(std::max(parent.x, child.x), std::max(parent.y, child.y)));
  return SmartLayout::GetInitialSize();
}

}  // namespace norvik::layout
