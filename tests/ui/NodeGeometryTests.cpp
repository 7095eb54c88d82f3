// Rectangles, layout binding, matrices, coordinate mapping with its rounding
// rule, and hit tests.
#include <gtest/gtest.h>

#include "support/ui/NodeTestSupport.h"
#include "tarsel/ThrowError.h"

namespace norvik::ui::test {
namespace {

using RectF = tarsel::geom::RectT<float>;
using RectL = tarsel::geom::RectT<long>;
using PointF = tarsel::geom::PointT<float>;
using PointL = tarsel::geom::PointT<long>;
using Matrix = tarsel::geom::ScaleMatrixT<float>;

using NodeRectangles = ManagerTest;

TEST_F(NodeRectangles, IntegerRectEnclosesTheFloatRect) {
  auto v = MakeView(5.5f, -1.25f, 10.25f, 2.5f);
  // floor(5.5)=5, ceil(15.75)=16; floor(-1.25)=-2, ceil(1.25)=2
  EXPECT_EQ(v->UI_GetLocalRect(), RectL(5, -2, 11, 4));
  v->UI_SetLocalRect(RectL(1, 2, 3, 4));
  EXPECT_EQ(v->UI_GetLocalRectF(true), RectF(1, 2, 3, 4));
}

TEST_F(NodeRectangles, ANewRectangleIsSeenBySizeCallbacksAndTheSameOneAgainFiresNothing) {
  auto v = MakeView(0, 0, 10, 10);
  int sizeChanges = 0;
  RectF seen;
  UI_Node* raw = v.get();
  v->InstallSizeChangedFunction(boost::make_shared<boost::function<void()>>([&] {
    ++sizeChanges;
    seen = raw->UI_GetLocalRectF(true);
  }));
  v->invalidations.clear();
  v->nodeChanges.clear();
  v->UI_SetLocalRectF(RectF(0, 0, 20, 10));
  EXPECT_EQ(sizeChanges, 1);
  EXPECT_EQ(seen, RectF(0, 0, 20, 10));
  EXPECT_EQ(v->invalidations.size(), 2u);  // the old area, then the new one
  EXPECT_EQ(v->nodeChanges, std::vector<UI_Node::NodeChange>{UI_Node::kNodeChangeGeometry});
  v->UI_SetLocalRectF(RectF(0, 0, 20, 10));
  EXPECT_EQ(sizeChanges, 1);
  EXPECT_EQ(v->invalidations.size(), 2u);
  EXPECT_EQ(v->nodeChanges.size(), 1u);
}

// ---------------------------------------------------------------------------

class LayoutBinding : public ManagerTest {
 protected:
  void SetUp() override {
    parent = RecordingViewP(new RecordingView("parent"));
    parent->UI_SetLayoutsChildren(true);
    parent->UI_Show(true);
    child = MakeView(10, 10, 20, 20, parent.get(), "child");
  }
  RecordingViewP parent;
  RecordingViewP child;
};

// Each row binds the child (10, 10, 20, 20), gives the parent its first
// size, which moves nothing, and then a second one.
TEST_F(LayoutBinding, TheSecondParentSizeMovesAndGrowsTheChildAsItsBindingSays) {
  const struct {
    const char* why;
    unsigned binding;
    RectF second, expected;
  } rows[] = {
      {"moving edges alone move and shrink by the same amount", UI_SubView::kBindLeftMoves | UI_SubView::kBindTopMoves,
       RectF(0, 0, 150, 120), RectF(60, 30, -30, 0)},
      {"moving and growing together move without resizing",
       UI_SubView::kBindLeftMoves | UI_SubView::kBindWidthGrows | UI_SubView::kBindTopMoves |
           UI_SubView::kBindHeightGrows,
       RectF(0, 0, 130, 90), RectF(40, 0, 20, 20)},
      {"growing follows the parent's size", UI_SubView::kBindWidthGrows | UI_SubView::kBindHeightGrows,
       RectF(0, 0, 110, 125), RectF(10, 10, 30, 45)},
      {"centring truncates and takes precedence",
       UI_SubView::kBindCenterHorizontally | UI_SubView::kBindLeftMoves | UI_SubView::kBindCenterVertically |
           UI_SubView::kBindHeightGrows,
       RectF(0, 0, 101, 51), RectF(40, 15, 20, 20)},
  };
  for (const auto& row : rows) {
    SetUp();
    child->UI_SetLayoutBinding(row.binding);
    parent->UI_SetLocalRectF(RectF(0, 0, 100, 100));
    EXPECT_EQ(child->UI_GetLocalRectF(true), RectF(10, 10, 20, 20)) << row.why;
    EXPECT_TRUE(parent->UI_GetViewFlags() & UI_SubView::kViewHasFirstSize);
    parent->UI_SetLocalRectF(row.second);
    EXPECT_EQ(child->UI_GetLocalRectF(true), row.expected) << row.why;
  }
}

TEST_F(LayoutBinding, AViewThatDoesNotLayOutStillRemembersItsFirstSize) {
  auto plain = RecordingViewP(new RecordingView("plain"));
  plain->UI_SetLocalRectF(RectF(0, 0, 0, 10));
  EXPECT_FALSE(plain->UI_GetViewFlags() & UI_SubView::kViewHasFirstSize);
  plain->UI_SetLocalRectF(RectF(0, 0, 5, 10));
  EXPECT_TRUE(plain->UI_GetViewFlags() & UI_SubView::kViewHasFirstSize);
}

// ---------------------------------------------------------------------------

using NodeMatrices = ManagerTest;

TEST_F(NodeMatrices, SelfToParentIsThePositionFollowedByTheViewsMatrix) {
  auto root = MakeView(0, 0, 200, 200, nullptr, "root");
  auto v = MakeView(10, 20, 50, 50, root.get());
  v->UI_SetMatrix(Matrix(2, 3, 1, 1));
  // (p + (10,20)) * (2,3) + (1,1)
  EXPECT_EQ(v->UI_GetSelfToParentMatrix(), Matrix(2, 3, 21, 61));
}

TEST_F(NodeMatrices, AMatrixOnlyForChildrenMovesTheChildrenButNotTheView) {
  auto root = MakeView(0, 0, 200, 200, nullptr, "root");
  auto scroller = MakeView(10, 10, 100, 100, root.get(), "scroller");
  auto content = MakeView(0, 0, 300, 300, scroller.get(), "content");
  scroller->UI_SetMatrix(Matrix::Translation(0, -50));
  scroller->UI_SetMatrixOnlyForChildren(true);
  EXPECT_EQ(scroller->UI_GetSelfToParentMatrix(), Matrix::Translation(10, 10));
  EXPECT_EQ(content->UI_GetSelfToParentMatrix(), Matrix::Translation(0, -50));
  EXPECT_EQ(content->UI_LocalToGlobalF(PointF(5, 60)), PointF(15, 20));
}

TEST_F(NodeMatrices, LocalAndGlobalFloatMappingsAreInverse) {
  auto root = MakeView(0, 0, 400, 400, nullptr, "root");
  auto mid = MakeView(10, 20, 200, 200, root.get(), "mid");
  mid->UI_SetMatrix(Matrix(2, 0.5f, 3, 4));
  auto leaf = MakeView(7, 9, 20, 20, mid.get(), "leaf");
  PointF global = leaf->UI_LocalToGlobalF(PointF(1, 2));
  // leaf to mid: (8, 11); mid to root: ((8+10)*2+3, (11+20)*0.5+4)
  EXPECT_EQ(global, PointF(39, 19.5f));
  EXPECT_EQ(leaf->UI_GlobalToLocalF(global), PointF(1, 2));
  RectF r = leaf->UI_LocalToGlobalF(RectF(0, 0, 10, 10));
  EXPECT_EQ(r, RectF(37, 18.5f, 20, 5));
  EXPECT_EQ(leaf->UI_GlobalToLocalF(r), RectF(0, 0, 10, 10));
}

TEST_F(NodeMatrices, IntegerMappingsRoundHalvesTowardsPositiveInfinity) {
  EXPECT_EQ(UI_Node::UI_RoundToLong(1.5f), 2);
  EXPECT_EQ(UI_Node::UI_RoundToLong(-1.5f), -1);
  EXPECT_EQ(UI_Node::UI_RoundToLong(-1.2f), -1);
  EXPECT_EQ(UI_Node::UI_RoundToLong(2.49f), 2);
  auto root = MakeView(0, 0, 400, 400, nullptr, "root");
  auto v = MakeView(0, 0, 100, 100, root.get());
  v->UI_SetMatrix(Matrix(0.5f, 0.5f, 0, 0));
  EXPECT_EQ(v->UI_LocalToGlobal(PointL(3, -3)), PointL(2, -1));  // 1.5 -> 2, -1.5 -> -1
  // Rectangle corners (3,-3) and (8,2) become (1.5,-1.5) and (4,1): rounded (2,-1) and (4,1).
  EXPECT_EQ(v->UI_LocalToGlobal(RectL(3, -3, 5, 5)), RectL(2, -1, 2, 2));
  EXPECT_EQ(v->UI_GlobalToLocal(PointL(2, -1)), PointL(4, -2));
}

TEST_F(NodeMatrices, SpecificParentMatrixStopsAtTheGivenAncestor) {
  auto root = MakeView(0, 0, 400, 400, nullptr, "root");
  auto mid = MakeView(10, 20, 200, 200, root.get(), "mid");
  auto leaf = MakeView(1, 2, 20, 20, mid.get(), "leaf");
  EXPECT_EQ(UI_Node::UI_GetSelfToSpecificParentMatrix(leaf.get(), mid.get()), Matrix::Translation(1, 2));
  EXPECT_EQ(UI_Node::UI_GetSelfToSpecificParentMatrix(leaf.get(), leaf.get()), Matrix());
  EXPECT_EQ(UI_Node::UI_GetSelfToRootMatrix(leaf.get()), Matrix::Translation(11, 22));
}

TEST_F(NodeMatrices, AStopNodeThatIsNotAnAncestorRaisesParentNotFound) {
  auto root = MakeView(0, 0, 400, 400, nullptr, "root");
  auto leaf = MakeView(1, 2, 20, 20, root.get(), "leaf");
  auto stranger = MakeView(0, 0, 5, 5);
  try {
    UI_Node::UI_GetSelfToSpecificParentMatrix(leaf.get(), stranger.get());
    FAIL() << "expected an error";
  } catch (const tarsel::config::Exception& e) {
    EXPECT_EQ(e.GetKeyPath(), "norvik/ui/Error/ParentNotFound");
    EXPECT_STREQ(e.what(), "Parent not found.");
  }
}

TEST_F(NodeMatrices, MappingIntoAViewScaledToNothingRaisesInsteadOfDividingByZero) {
  auto root = MakeView(0, 0, 400, 400, nullptr, "root");
  auto v = MakeView(0, 0, 100, 100, root.get());
  v->UI_SetMatrix(Matrix(0, 1, 0, 0));
  EXPECT_THROW(v->UI_GlobalToLocalF(PointF(1, 1)), tarsel::config::Exception);
}

// ---------------------------------------------------------------------------

using NodeHitTests = ManagerTest;

TEST_F(NodeHitTests, RightAndBottomEdgesAreOutsideAndAViewWithNoWidthIsNeitherShownNorHit) {
  auto v = MakeView(0, 0, 10, 20);
  EXPECT_TRUE(v->UI_HitTest(PointF(0, 0)));
  EXPECT_TRUE(v->UI_HitTest(PointF(9.99f, 19.99f)));
  EXPECT_FALSE(v->UI_HitTest(PointF(10, 5)));
  EXPECT_FALSE(v->UI_HitTest(PointF(5, 20)));
  EXPECT_FALSE(v->UI_HitTest(PointF(-0.01f, 5)));
  auto flat = MakeView(0, 0, 0, 20);
  EXPECT_FALSE(flat->UI_IsShown());
  EXPECT_FALSE(flat->UI_HitTest(PointF(0, 0)));
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  MakeView(0, 0, 10, 10, root.get(), "child");
  PointF p(10, 5);
  EXPECT_FALSE(root->GetChildHit(true, false, p).first) << "a child's far edge";
  EXPECT_EQ(p, PointF(10, 5));
}

TEST_F(NodeHitTests, TheTopmostShownChildIsHitAndThePointIsMovedIntoIt) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto below = MakeView(10, 10, 50, 50, root.get(), "below");
  auto above = MakeView(20, 20, 50, 50, root.get(), "above");
  PointF p(30, 30);
  auto hit = root->GetChildHit(false, false, p);
  ASSERT_TRUE(hit.first);
  EXPECT_EQ(hit.second->get(), above.get());
  EXPECT_EQ(p, PointF(10, 10));
  above->UI_Show(false);
  p = PointF(30, 30);
  hit = root->GetChildHit(false, false, p);
  ASSERT_TRUE(hit.first);
  EXPECT_EQ(hit.second->get(), below.get());
  EXPECT_EQ(p, PointF(20, 20));
}

TEST_F(NodeHitTests, RecursiveHitReturnsTheDeepestNodeInItsOwnCoordinates) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto mid = MakeView(10, 10, 80, 80, root.get(), "mid");
  mid->UI_SetMatrix(Matrix::Scale(2, 2));
  auto leaf = MakeView(5, 5, 10, 10, mid.get(), "leaf");
  // The view's matrix applies after its position: mid maps q to (q + 10) * 2.
  // Leaf point (2,3) is (7,8) in mid and (34,36) in root.
  PointF p(34, 36);
  auto hit = root->GetChildHit(true, false, p);
  ASSERT_TRUE(hit.first);
  EXPECT_EQ(hit.second->get(), leaf.get());
  EXPECT_EQ(p, PointF(2, 3));
  PointF miss(10 + 2 * 50, 10 + 2 * 50);
  hit = mid->GetChildHit(true, false, miss);
  EXPECT_FALSE(hit.first);
  EXPECT_EQ(miss, PointF(110, 110));
}

}  // namespace
}  // namespace norvik::ui::test
