// Placement of pieces beside a decorated layout, the sharing of surplus, the
// builder's runs and spacing, the grid, and bad sizes.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "layout/GridLayout.h"
#include "layout/SmartLayoutBuilder.h"
#include "support/layout/RecordingLayout.h"
#include "tarsel/ThrowError.h"

namespace norvik::layout::test {
namespace {

using Builder = SmartLayoutBuilder;

struct PlacementCase {
  const char* name;
  LayoutPlacementAlgorithmP placement;
  bool keep;
  RectF own, decorated;
};

TEST(SmartLayoutPlacement, EachSideHandsTheSurplusToTheStrategysPiece) {
  // Area 100 x 50; own piece 20 x 10, decorated 30 x 10.
  const PlacementCase cases[] = {
      {"left, pass", new LayoutPlacement_LeftOfDO, false, {0, 0, 20, 50}, {20, 0, 80, 50}},
      {"left, keep", new LayoutPlacement_LeftOfDO, true, {0, 0, 70, 50}, {70, 0, 30, 50}},
      {"right, pass", new LayoutPlacement_RightOfDO, false, {80, 0, 20, 50}, {0, 0, 80, 50}},
      {"right, keep", new LayoutPlacement_RightOfDO, true, {30, 0, 70, 50}, {0, 0, 30, 50}},
      {"above, pass", new LayoutPlacement_AboveDO, false, {0, 0, 100, 10}, {0, 10, 100, 40}},
      {"above, keep", new LayoutPlacement_AboveDO, true, {0, 0, 100, 40}, {0, 40, 100, 10}},
      {"below, pass", new LayoutPlacement_BelowDO, false, {0, 40, 100, 10}, {0, 0, 100, 40}},
      {"below, keep", new LayoutPlacement_BelowDO, true, {0, 10, 100, 40}, {0, 0, 100, 10}},
  };
  for (const auto& c : cases) {
    RectF own, decorated;
    c.placement->GetRects(RectF(0, 0, 100, 50), PointF(20, 10), PointF(30, 10), own, decorated,
                          c.keep ? ExtraSpace_Keep::GetSharedPtr() : ExtraSpace_Pass::GetSharedPtr());
    EXPECT_EQ(own, c.own) << c.name;
    EXPECT_EQ(decorated, c.decorated) << c.name;
  }
}

TEST(SmartLayoutPlacement, ANeighbourTooWideTakesTheWholeAreaAndTheRestGetsNothing) {
  RecordingLayoutP piece = Leaf(50, 10), inner = Leaf(10, 10);
  LayoutJoiner joiner(piece, inner, new LayoutPlacement_RightOfDO, ExtraSpace_Pass::GetSharedPtr());
  joiner.SetLocation(RectF(5, 5, 40, 20));
  EXPECT_EQ(piece->rect, RectF(5, 5, 40, 20));
  EXPECT_EQ(inner->rect, RectF());
  EXPECT_EQ(joiner.GetInitialSize(), PointF(60, 10));
}

TEST(SmartLayoutSharing, ThreeSharingPiecesSplitTenPixelsThreeThreeFourEveryTime) {
  RecordingLayoutP a = Leaf(10, 5), b = Leaf(10, 5), c = Leaf(10, 5);
  Builder builder;
  builder.AddLayout_Left(a, true);
  builder.AddLayout_Left(b, true);
  builder.AddLayout_Left(c, true);
  SmartLayoutP layout = builder.GetLayout();
  ASSERT_EQ(layout->GetInitialSize(), PointF(30, 5));
  for (int pass = 0; pass < 2; ++pass) {
    layout->SetLocation(RectF(0, 0, 40, 5));
    // Walked from the outside in: the last piece added is met first.
    EXPECT_EQ(c->rect, RectF(0, 0, 13, 5)) << "pass " << pass;
    EXPECT_EQ(b->rect, RectF(13, 0, 13, 5)) << "pass " << pass;
    EXPECT_EQ(a->rect, RectF(26, 0, 14, 5)) << "pass " << pass;
  }
}

TEST(SmartLayoutSharing, TheNotifierStartsEachPlacementWithAFreshCount) {
  boost::intrusive_ptr<SharedExtraSpace_Horizontal> space(new SharedExtraSpace_Horizontal);
  for (int i = 0; i < 3; ++i) space->AddParticipant();
  LayoutDecoratorP notifier = space->CreateNotifierLayout();
  auto nextShare = [&] {
    RectF own(0, 0, 0, 5), decorated(10, 0, 0, 5);
    space->AdjustRectsHorizontally(own, decorated);
    return own.width;
  };
  EXPECT_EQ(nextShare(), 3);
  notifier->SetLocation(RectF(0, 0, 10, 5));
  EXPECT_EQ(nextShare(), 3) << "without the reset the second participant's half would come out";
  EXPECT_EQ(nextShare(), 5);
  EXPECT_EQ(nextShare(), 10) << "the last participant takes all that is left";
}

TEST(SmartLayoutSharing, ASpaceWithoutParticipantsIsAContractViolationNotADivision) {
  SharedExtraSpace_Vertical space;
  RectF own(0, 0, 5, 0), decorated(0, 10, 5, 0);
  EXPECT_THROW(space.AdjustRectsVertically(own, decorated), tarsel::config::Exception);
}

TEST(SmartLayoutBuilderRuns, AChangeOfDirectionStartsAFreshRunOfSharing) {
  RecordingLayoutP a = Leaf(10, 10), side = Leaf(10, 0), d = Leaf(10, 10), e = Leaf(10, 10);
  Builder builder;
  builder.AddLayout_Top(a, true);
  builder.AddLayout_Left(side, false);
  builder.AddLayout_Top(d, true);
  builder.AddLayout_Top(e, true);
  SmartLayoutP layout = builder.GetLayout();
  ASSERT_EQ(layout->GetInitialSize(), PointF(20, 30));
  layout->SetLocation(RectF(0, 0, 20, 36));
  // The six spare pixels go to d and e alone; one run of three would give 2 each.
  EXPECT_EQ(e->rect.height, 13);
  EXPECT_EQ(d->rect.height, 13);
  EXPECT_EQ(a->rect.height, 10);
}

TEST(SmartLayoutBuilderRuns, CrossAxisSpacingCentresOrPinsThePiece) {
  const struct {
    Builder::LayoutSpacing spacing;
    RectF expected;
  } cases[] = {
      {Builder::kSpacingNone, {0, 0, 10, 30}},
      {Builder::kSpacingCentered, {0, 10, 10, 10}},
      {Builder::kSpacingNearEdge, {0, 0, 10, 10}},
      {Builder::kSpacingFarEdge, {0, 20, 10, 10}},
  };
  for (const auto& c : cases) {
    RecordingLayoutP piece = Leaf(10, 10);
    Builder builder;
    builder.AddLayout_Left(piece, false, c.spacing);
    builder.GetLayout()->SetLocation(RectF(0, 0, 10, 30));
    EXPECT_EQ(piece->rect, c.expected) << "spacing " << c.spacing;
  }
}

TEST(SmartLayoutBuilderRuns, MarginsAndCentringWrapEverythingBuiltSoFar) {
  RecordingLayoutP core = Leaf(20, 10);
  Builder builder(core);
  builder.AddSpacer_Right(4);
  builder.AddSpacer_AllSides(3);
  builder.HorizontallyCenter();
  SmartLayoutP layout = builder.GetLayout();
  EXPECT_EQ(layout->GetInitialSize(), PointF(30, 16));
  layout->SetLocation(RectF(0, 0, 50, 40));
  EXPECT_EQ(core->rect, RectF(13, 3, 20, 34));
  layout->SetLocation(RectF(0, 0, 20, 40));
  EXPECT_EQ(core->rect, RectF(3, 3, 10, 34)) << "an area narrower than the content is not centred";
}

TEST(SmartLayoutBadInput, NonFiniteAndNegativeSizesCountAsZero) {
  const float nan = std::numeric_limits<float>::quiet_NaN(), inf = std::numeric_limits<float>::infinity();
  RecordingLayoutP core = Leaf(nan, -4);
  EXPECT_EQ(core->GetInitialSize(), PointF(0, 0));
  Builder builder(core);
  builder.AddSpacer_Left(inf);
  builder.AddSpacer_Top(-7, true);
  builder.AddSpacer_AllSides(nan);
  SmartLayoutP layout = builder.GetLayout();
  EXPECT_EQ(layout->GetInitialSize(), PointF(0, 0));
  layout->SetLocation(RectF(nan, inf, -10, nan));
  EXPECT_EQ(core->rect, RectF(0, 0, 0, 0));
}

TEST(SmartLayoutGrid, ColumnsAndRowsTakeTheirLargestCellAndCellsThatOverflowAreHidden) {
  GridLayout grid(2, 2);
  RecordingLayoutP cells[] = {Leaf(10, 5), Leaf(20, 8), Leaf(15, 12), Leaf(5, 5)};
  for (unsigned long i = 0; i < 4; ++i) grid.SetCellLayout(i % 2, i / 2, cells[i]);
  grid.SetColumnSpacing(2);
  grid.SetRowSpacing(std::numeric_limits<float>::quiet_NaN());
  EXPECT_EQ(grid.GetInitialSize(), PointF(37, 20));
  grid.SetLocation(RectF(0.5f, 0, 37, 20));
  EXPECT_EQ(cells[0]->rect, RectF(1, 0, 15, 8));
  EXPECT_EQ(cells[1]->rect, RectF()) << "the last column overflows by half a pixel";
  EXPECT_EQ(cells[2]->rect, RectF(1, 8, 15, 12));
  grid.SetCellLayout(1, 1, Leaf(30, 30));
  EXPECT_EQ(grid.GetInitialSize(), PointF(47, 38)) << "a new cell is measured again";
}

TEST(SmartLayoutJoiners, AChildStandsInItsParentsCoordinates) {
  RecordingLayoutP parent = Leaf(40, 10), child = Leaf(20, 30);
  ParentChildLayoutJoiner joiner(parent, child);
  EXPECT_EQ(joiner.GetInitialSize(), PointF(40, 30));
  joiner.SetLocation(RectF(100, 50, 60, 40));
  EXPECT_EQ(parent->rect, RectF(100, 50, 60, 40));
  EXPECT_EQ(child->rect, RectF(0, 0, 60, 40));
}

}  // namespace
}  // namespace norvik::layout::test
