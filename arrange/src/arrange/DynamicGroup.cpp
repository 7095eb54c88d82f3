#include "arrange/DynamicGroup.h"

namespace norvik::arrange {

namespace {

boost::shared_ptr<impl::AbstractArrangeableGroup> MakeHosted(GroupArrangementType inType, DynamicGroup& inHost,
                                                            IArrangeable* inParent) {
  using Ptr = boost::shared_ptr<impl::AbstractArrangeableGroup>;
  switch (inType) {
    case kGroupColumn: return Ptr(new HostedGroup<Column>(inHost, inParent));
    case kGroupFlipping: return Ptr(new HostedGroup<Flipping>(inHost, inParent));
    case kGroupHorizontalWrapping: return Ptr(new HostedGroup<HorizontalWrapping>(inHost, inParent));
    case kGroupVerticalWrapping: return Ptr(new HostedGroup<VerticalWrapping>(inHost, inParent));
    case kGroupAutoLayout: return Ptr(new HostedGroup<AutoLayout>(inHost, inParent));
    case kGroupRow:
    default: return Ptr(new HostedGroup<Row>(inHost, inParent));
  }
}

}  // namespace

DynamicGroup::DynamicGroup(IArrangeable* inParent, GroupArrangementType inType) {
  SetArrangementType(inType, inParent);
}

DynamicGroup::~DynamicGroup() {
  // The children outlive this group in their own containers.
  mHosted->VisitChildren([](IArrangeable& inChild) {
    inChild.SetParent(nullptr);
    return true;
  });
  mHosted->SetParent(nullptr);
}

void DynamicGroup::SetArrangementType(GroupArrangementType inType, IArrangeable* inParent) {
  if (inType == mType && mHosted) return;
  if (!inParent && mHosted) inParent = mHosted->Parent();
  boost::shared_ptr<impl::AbstractArrangeableGroup> replaced = mHosted;
  mHosted = MakeHosted(inType, *this, inParent);
  mType = inType;
  mHosted->VisitChildren([this](IArrangeable& inChild) {
    inChild.SetParent(mHosted.get());
    return true;
  });
  if (!replaced) return;
  mHosted->TakeOverFrom(*replaced);
  replaced->SetParent(nullptr);  // its end must not reach the parent as a death of a child
  if (inParent)
    inParent->Invalidate();
  else
    mHosted->Rearrange();
}

bool DynamicGroup::VisitChildren(boost::function<bool(IArrangeable const&)>) const { return true; }
bool DynamicGroup::VisitChildren(boost::function<bool(IArrangeable&)>) { return true; }
void DynamicGroup::ChildDestroyed(IArrangeable&) {}

void DynamicGroup::ForgetSeparators() {
  mHosted->ForgetSeparators();
  mHosted->Invalidate();
}

}  // namespace norvik::arrange
