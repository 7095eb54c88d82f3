#include "arrange/ArrangeableGroup.h"

namespace norvik::arrange::impl {

namespace {

// A product of candidate sets beyond this many combinations is cut short:
// a group of groups that each offer many placements would otherwise spend
// memory without bound on candidates that mostly lose to each other.
constexpr std::size_t kMaxCombinations = 4096;

}  // namespace

AbstractArrangeableGroup::AbstractArrangeableGroup(IArrangeable* inParent) : IArrangeable(inParent) {}

AbstractArrangeableGroup::~AbstractArrangeableGroup() = default;

void AbstractArrangeableGroup::ForgetSeparators() {
  ClearSeparators();
  mSeparators.clear();
}

void AbstractArrangeableGroup::RebuildSeparators(std::size_t inChildCount) {
  const std::size_t wanted = inChildCount > 0 ? inChildCount - 1 : 0;
  if (mSeparators.size() == wanted) return;
  ClearSeparators();
  mSeparators.clear();
  for (std::size_t i = 0; i < wanted; ++i) mSeparators.push_back(BuildSeparator());
}

void AbstractArrangeableGroup::RebuildSelf() {
  mSet.clear();
  std::vector<ArrangementSet*> childSets;
  VisitChildren([&childSets](IArrangeable& inChild) {
    childSets.push_back(&inChild.Arrangements());
    return true;
  });
  RebuildSeparators(childSets.size());
  if (childSets.empty()) return;
  for (ArrangementSet* set : childSets)
    if (set->empty()) return;  // a child with nothing to place makes no combination
  // Walk the product like an odometer, the last child turning fastest.
  std::vector<std::size_t> digits(childSets.size(), 0);
  std::vector<ArrangementPtr> combination(childSets.size());
  for (std::size_t count = 0; count < kMaxCombinations; ++count) {
    for (std::size_t i = 0; i < childSets.size(); ++i) combination[i] = (*childSets[i])[digits[i]];
    AddGroupArrangements(combination);
    std::size_t position = childSets.size();
    while (position > 0) {
      --position;
      if (++digits[position] < childSets[position]->size()) break;
      digits[position] = 0;
      if (position == 0) return;
    }
  }
}

}  // namespace norvik::arrange::impl
