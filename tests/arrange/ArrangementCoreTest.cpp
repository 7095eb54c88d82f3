#include <cmath>
#include <memory>
#include <random>

#include <gtest/gtest.h>

#include "support/arrange/ArrangeTestDoubles.h"

namespace norvik::arrange {
namespace {

using test::FixedArrangement;
using test::LeafSizes;
using test::RecordingLeaf;
using test::TestRow;

LeafSizes Expanding(float inWidth, float inMaxWidth = -1.0f) {
  LeafSizes sizes;
  sizes.naturalWidth = inWidth;
  sizes.maxWidth = inMaxWidth;
  sizes.expandsHorizontally = true;
  return sizes;
}

TEST(RowDistribution, SharesExtraInProportionHandsOnCappedSharesAndStopsAtMinimums) {
  struct Case {
    const char* name;
    LeafSizes first, second;
    float width;
    float firstWidth, secondWidth;
  } cases[] = {
      {"20 extra over 10 and 30", Expanding(10), Expanding(30), 60, 15, 45},
      {"a child capped at 12", Expanding(10, 12), Expanding(30), 60, 12, 48},
      {"negative extra", Expanding(10), Expanding(30), 20, 10, 30},
      {"fixed children keep natural widths", LeafSizes{}, LeafSizes{}, 60, 10, 10},
  };
  for (const Case& c : cases) {
    TestRow row;
    RecordingLeaf first(c.first), second(c.second);
    row.AddChild(first);
    row.AddChild(second);
    row.Arrange(RectF(0, 0, c.width, 10));
    ASSERT_EQ(first.placed.size(), 1u) << c.name;
    EXPECT_FLOAT_EQ(first.placed.back().width, c.firstWidth) << c.name;
    EXPECT_FLOAT_EQ(second.placed.back().width, c.secondWidth) << c.name;
    EXPECT_FLOAT_EQ(second.placed.back().left, c.firstWidth) << c.name;
  }
}

TEST(RowDistribution, StopsAtThePassLimitAndLeavesTheRemainderUnused) {
  // At this magnitude one unit of extra is below float resolution, so the
  // child takes its "share" without ever growing.
  RecordingLeaf huge(Expanding(1.0e8f));
  impl::ArrangementPtr child = huge.Arrangements().front();
  const impl::LineResult result =
      impl::DistributeLine({child}, impl::LineAxis{false}, 1.0e8f + 1.0f, 10.0f, 1.0f);
  EXPECT_EQ(result.passes, impl::kMaxDistributionPasses);
  EXPECT_EQ(result.records[0].main, 1.0e8f);
}

TEST(RowArrangement, AlignsFixedChildrenAndSpansSeparatorsOverTheShorterNeighbour) {
  struct Aligned : TestRow {
    AlignmentHorizontal HorizontalAlignment() const override { return alignment; }
    float HorizontalSpacing() const override { return 4; }
    ISeparator* BuildSeparator() override { return &separator; }
    struct : ISeparator {
      void Arrange(RectF const& inRect) override { placed.push_back(inRect); }
      std::vector<RectF> placed;
    } separator;
    AlignmentHorizontal alignment = kAlignLeft;
  };
  LeafSizes tall;
  tall.naturalHeight = 30;
  for (auto [alignment, left] : {std::pair{kAlignLeft, 0.0f}, {kAlignHorizontalCenter, 38.0f}, {kAlignRight, 76.0f}}) {
    Aligned row;
    row.alignment = alignment;
    RecordingLeaf a, b(tall);
    row.AddChild(a);
    row.AddChild(b);
    row.Arrange(RectF(0, 0, 100, 40));
    EXPECT_FLOAT_EQ(a.placed.back().left, left) << alignment;
    EXPECT_FLOAT_EQ(b.placed.back().left, left + 14) << alignment;
    ASSERT_FALSE(row.separator.placed.empty());
    EXPECT_EQ(row.separator.placed.back(), RectF(left + 10, 0, 4, 10)) << alignment;
  }
}

TEST(ChoiceRule, PrefersFitThenOverflowThenWasteThenAreaThenGoldenRatioAndKeepsTheEarlierOnTies) {
  using M = FixedArrangement::Measures;
  struct Case {
    const char* name;
    M first, second;
    bool secondWins;
  } cases[] = {
      {"only the second fits", {200, 10, 0, 0, 0, 5}, {50, 10, 0, 0, 90, 0}, true},
      {"only the first fits", {50, 10, 0, 0, 90, 0}, {200, 10, 0, 0, 0, 5}, false},
      {"neither fits, less overflow", {200, 10, 0, 0, 0, 9}, {300, 10, 0, 0, 0, 5}, true},
      {"neither fits, equal overflow", {200, 10, 0, 0, 0, 5}, {300, 10, 0, 0, 0, 5}, false},
      {"both fit, less waste", {10, 10, 0, 0, 50, 0}, {10, 10, 0, 0, 40, 0}, true},
      {"equal waste, smaller minimum", {10, 10, 0, 0, 40, 0}, {5, 10, 0, 0, 40, 0}, true},
      {"equal area, nearer golden", {10, 10, 10, 10, 40, 0}, {10, 10, 16, 10, 40, 0}, true},
      {"all equal", {10, 10, 16, 10, 40, 0}, {10, 10, 16, 10, 40, 0}, false},
  };
  for (const Case& c : cases) {
    impl::ArrangementSet set;
    set.push_back(new FixedArrangement(c.first));
    set.push_back(new FixedArrangement(c.second));
    EXPECT_EQ(set.ChooseFor(PointF(100, 100)), set[c.secondWins ? 1 : 0].get()) << c.name;
  }
}

TEST(ChoiceRule, BestSizeIsTheMinimumOfTheCandidateNearestTheGoldenRatio) {
  test::CandidateElement element;
  EXPECT_EQ(element.BestSize(), PointF(0, 0));
  element.set.push_back(new FixedArrangement({40, 30, 100, 100, 0, 0}));
  element.set.push_back(new FixedArrangement({70, 20, 160, 100, 0, 0}));
  element.set.push_back(new FixedArrangement({90, 10, 170, 100, 0, 0}));
  EXPECT_EQ(element.BestSize(), PointF(70, 20));
}

// Candidates over a few shared leaves, so that equal ones come up often.
impl::ArrangementPtr RandomCandidate(std::mt19937& ioRandom, impl::AbstractArrangeableGroup& inGroup,
                                     std::vector<std::unique_ptr<RecordingLeaf>>& inLeaves) {
  std::vector<impl::ArrangementPtr> children;
  const int count = 1 + static_cast<int>(ioRandom() % 3);
  for (int i = 0; i < count; ++i) {
    RecordingLeaf& leaf = *inLeaves[ioRandom() % inLeaves.size()];
    children.push_back(new impl::SingleArrangement(leaf));
  }
  if (ioRandom() % 2) return new impl::RowArrangement(inGroup, children, {}, true);
  return new impl::ColumnArrangement(inGroup, children, {}, true);
}

TEST(ChoiceRule, PruningDominatedCandidatesNeverChangesTheMeritOfThePick) {
  std::mt19937 random(17);
  std::uniform_real_distribution<float> extent(1.0f, 60.0f);
  std::size_t pruned = 0;
  for (int round = 0; round < 200; ++round) {
    test::TestRow group;
    std::vector<std::unique_ptr<RecordingLeaf>> leaves;
    for (int i = 0; i < 3; ++i) {
      LeafSizes sizes;
      sizes.naturalWidth = extent(random);
      sizes.naturalHeight = extent(random);
      sizes.minWidth = sizes.naturalWidth * 0.5f;
      sizes.expandsHorizontally = random() % 2;
      leaves.push_back(std::make_unique<RecordingLeaf>(sizes));
    }
    impl::ArrangementSet kept, all;
    for (int i = 0; i < 12; ++i) {
      impl::ArrangementPtr candidate = RandomCandidate(random, group, leaves);
      kept.AddArrangement(candidate);
      all.push_back(candidate);
    }
    pruned += all.size() - kept.size();
    for (int probe = 0; probe < 10; ++probe) {
      const PointF size(extent(random) * 3, extent(random) * 3);
      impl::IArrangement* a = kept.ChooseFor(size);
      impl::IArrangement* b = all.ChooseFor(size);
      EXPECT_FALSE(impl::Beats(*a, *b, size) || impl::Beats(*b, *a, size)) << "round " << round;
    }
  }
  EXPECT_GT(pruned, 0u);
}

TEST(Arrangement, InvalidateWhileDisabledOnlyClearsFlagsAndEnablingPlacesOnce) {
  TestRow row;
  RecordingLeaf leaf;
  row.AddChild(leaf);
  row.Arrange(RectF(0, 0, 50, 20));
  ASSERT_EQ(leaf.placed.size(), 1u);
  row.EnableArrangement(false);
  leaf.Invalidate();
  row.InvalidateAll();
  EXPECT_EQ(leaf.placed.size(), 1u);
  EXPECT_FALSE(row.IsBuilt());
  row.EnableArrangement(true);
  EXPECT_EQ(leaf.placed.size(), 2u);
  EXPECT_TRUE(row.IsBuilt());
  leaf.Invalidate();
  EXPECT_EQ(leaf.placed.size(), 3u);
}

TEST(Arrangement, ArrangeOnAChildStartsAtTheRoot) {
  TestRow outer;
  test::TestColumn inner;
  RecordingLeaf a, b;
  outer.AddChild(a);
  outer.AddChild(inner);
  inner.AddChild(b);
  b.Arrange(RectF(5, 5, 100, 40));
  EXPECT_EQ(outer.LastRectangle(), RectF(5, 5, 100, 40));
  ASSERT_EQ(a.placed.size(), 1u);
  EXPECT_EQ(a.placed.back().left, 5.0f);
  EXPECT_EQ(b.placed.back().left, 15.0f);
}

TEST(Arrangement, AChildThatInvalidatesFromPlaceEveryTimeStopsAfterFiveRounds) {
  TestRow row;
  RecordingLeaf restless;
  restless.onPlace = [&restless] { restless.Invalidate(); };
  row.AddChild(restless);
  row.Arrange(RectF(0, 0, 50, 20));
  EXPECT_EQ(restless.placed.size(), 5u);
}

TEST(Arrangement, AChildThatDeletesItselfOrASiblingFromPlaceIsSurvived) {
  for (bool deleteSibling : {false, true}) {
    TestRow row;
    auto first = std::make_unique<RecordingLeaf>();
    auto second = std::make_unique<RecordingLeaf>();
    RecordingLeaf third;
    row.AddChild(*first);
    row.AddChild(*second);
    row.AddChild(third);
    if (deleteSibling)
      first->onPlace = [&second] { second.reset(); };
    else
      second->onPlace = [&second] { second.reset(); };
    row.Arrange(RectF(0, 0, 60, 20));
    EXPECT_EQ(row.ChildCount(), 2u) << deleteSibling;
    ASSERT_FALSE(third.placed.empty()) << deleteSibling;
    EXPECT_EQ(third.placed.back().left, 10.0f) << "the rebuilt row closes the gap";
  }
}

TEST(Arrangement, BadSizesAndMarginsCountAsZero) {
  const float nan = std::nanf(""), inf = INFINITY;
  LeafSizes bad;
  bad.naturalWidth = nan;
  bad.naturalHeight = inf;
  bad.left = -5;
  bad.top = nan;
  bad.expandsHorizontally = true;
  TestRow row;
  RecordingLeaf leaf(bad), next;
  row.AddChild(leaf);
  row.AddChild(next);
  row.Arrange(RectF(nan, 0, 100, 20));
  ASSERT_EQ(leaf.placed.size(), 1u);
  EXPECT_EQ(leaf.placed.back(), RectF(0, 0, 0, 0));
  EXPECT_EQ(next.placed.back(), RectF(0, 0, 10, 10));
  EXPECT_EQ(row.Arrange(RectF(0, 0, nan, 20)), PointF(0, 0));
}

}  // namespace
}  // namespace norvik::arrange
