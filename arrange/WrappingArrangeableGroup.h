#pragma once
// Groups with many candidates: every way of breaking the children into lines
// (wrapping), and the candidates of two kinds of group one after the other
// (a row or a column, any wrapping either way).
#include "arrange/ArrangeableGroup.h"

namespace norvik::arrange {

namespace impl {

// Cuts beyond this many are not enumerated; the first ones, with the fewest
// lines, are kept. Twenty children fill it exactly.
inline constexpr std::size_t kMaxWrappingCuts = std::size_t{1} << 19;

// Adds a Stack of Lines for every cut of the children into consecutive
// lines, by line count from 1 to n. Lines over the same children are shared
// between cuts, so a cut costs one stack and no new lines.
void AddWrappingCandidates(AbstractArrangeableGroup& inGroup, std::vector<ArrangementPtr> const& inChildren,
                           LineAxis inLineAxis);

}  // namespace impl

template <class Line, class Stack>
class WrappingArrangeableGroup : public impl::AbstractArrangeableGroup {
 public:
  using AbstractArrangeableGroup::AbstractArrangeableGroup;
  static void AddCandidates(impl::AbstractArrangeableGroup& inGroup,
                            std::vector<impl::ArrangementPtr> const& inChildren) {
    impl::AddWrappingCandidates(inGroup, inChildren, impl::LineAxis{std::is_same_v<Line, impl::ColumnArrangement>});
  }
  void AddGroupArrangements(std::vector<impl::ArrangementPtr> const& inChildren) override {
    AddCandidates(*this, inChildren);
  }
};

class HorizontalWrapping : public WrappingArrangeableGroup<impl::RowArrangement, impl::ColumnArrangement> {
 public:
  using WrappingArrangeableGroup::WrappingArrangeableGroup;
};

class VerticalWrapping : public WrappingArrangeableGroup<impl::ColumnArrangement, impl::RowArrangement> {
 public:
  using WrappingArrangeableGroup::WrappingArrangeableGroup;
};

template <class First, class Second>
class BinaryArrangeableGroup : public impl::AbstractArrangeableGroup {
 public:
  using AbstractArrangeableGroup::AbstractArrangeableGroup;
  static void AddCandidates(impl::AbstractArrangeableGroup& inGroup,
                            std::vector<impl::ArrangementPtr> const& inChildren) {
    First::AddCandidates(inGroup, inChildren);
    Second::AddCandidates(inGroup, inChildren);
  }
  void AddGroupArrangements(std::vector<impl::ArrangementPtr> const& inChildren) override {
    AddCandidates(*this, inChildren);
  }
};

class Flipping : public BinaryArrangeableGroup<Row, Column> {
 public:
  using BinaryArrangeableGroup::BinaryArrangeableGroup;
};

class AutoLayout : public BinaryArrangeableGroup<HorizontalWrapping, VerticalWrapping> {
 public:
  using BinaryArrangeableGroup::BinaryArrangeableGroup;
};

}  // namespace norvik::arrange
