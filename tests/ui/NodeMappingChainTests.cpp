// Coordinate mapping and hit tests through chains that mix views that are
// only moved with views that are scaled, a children-only matrix and a view
// scaled to nothing: the results must equal composing every level by hand.
#include <gtest/gtest.h>

#include <vector>

#include "support/ui/NodeTestSupport.h"

namespace norvik::ui::test {
namespace {

using RectF = tarsel::geom::RectT<float>;
using PointF = tarsel::geom::PointT<float>;
using Matrix = tarsel::geom::ScaleMatrixT<float>;

class MixedChain : public ManagerTest {
 protected:
  // root, then levels alternating moved-only and scaled, with one scroller
  // whose matrix applies to its children only.
  void SetUp() override {
    ManagerTest::SetUp();
    chain.push_back(MakeView(0, 0, 1000, 1000, nullptr, "root"));
    for (int i = 1; i <= 8; ++i) {
      chain.push_back(MakeView(1.5f * i, 2.0f * i, 900, 900, chain.back().get()));
      if (i % 3 == 0) chain.back()->UI_SetMatrix(Matrix(0.5f, 2.0f, 3, -1));
    }
    chain[4]->UI_SetMatrix(Matrix::Translation(-7, 11));
    chain[4]->UI_SetMatrixOnlyForChildren(true);
  }

  // Every level's own matrix composed after the previous ones.
  Matrix ComposedByHand(std::size_t inFrom, std::size_t inStop) const {
    Matrix m;
    for (std::size_t i = inFrom; i > inStop; --i) m = chain[i]->UI_GetSelfToParentMatrix().Concat(m);
    return m;
  }

  std::vector<RecordingViewP> chain;
};

TEST_F(MixedChain, RootAndSpecificParentMatricesEqualTheLevelsComposedOneByOne) {
  const std::size_t leaf = chain.size() - 1;
  EXPECT_EQ(UI_Node::UI_GetSelfToRootMatrix(chain[leaf].get()), ComposedByHand(leaf, 0));
  EXPECT_EQ(UI_Node::UI_GetSelfToSpecificParentMatrix(chain[leaf].get(), chain[2].get()), ComposedByHand(leaf, 2));
  EXPECT_EQ(UI_Node::UI_GetSelfToSpecificParentMatrix(chain[5].get(), chain[4].get()), ComposedByHand(5, 4));
  // The moved-only levels near the leaf: only offsets, scale untouched.
  EXPECT_EQ(UI_Node::UI_GetSelfToSpecificParentMatrix(chain[8].get(), chain[6].get()),
            Matrix::Translation(8 * 1.5f + 7 * 1.5f, 8 * 2.0f + 7 * 2.0f));
}

TEST_F(MixedChain, MappingToGlobalAndBackReturnsThePointAndTheRecursiveHitFindsTheLeafThere) {
  const PointF local(0.5f, 0.25f);
  const PointF global = chain.back()->UI_LocalToGlobalF(local);
  EXPECT_EQ(global, ComposedByHand(chain.size() - 1, 0).Transform(local));
  const PointF back = chain.back()->UI_GlobalToLocalF(global);
  EXPECT_NEAR(back.x, local.x, 1e-3);
  EXPECT_NEAR(back.y, local.y, 1e-3);
  PointF p = global;
  auto hit = chain.front()->GetChildHit(true, false, p);
  ASSERT_TRUE(hit.first);
  EXPECT_EQ(hit.second->get(), chain.back().get());
  EXPECT_NEAR(p.x, local.x, 1e-3);
  EXPECT_NEAR(p.y, local.y, 1e-3);
}

using HitThroughSiblings = ManagerTest;

TEST_F(HitThroughSiblings, MovedScaledAndCollapsedSiblingsAreEachTestedInTheirOwnSpace) {
  auto root = MakeView(0, 0, 200, 200, nullptr, "root");
  auto moved = MakeView(10, 10, 20, 20, root.get(), "moved");
  auto scaled = MakeView(50, 50, 10, 10, root.get(), "scaled");
  scaled->UI_SetMatrix(Matrix::Scale(4, 4));  // covers (200,200)..(240,240) in root
  auto collapsed = MakeView(0, 0, 200, 200, root.get(), "collapsed");
  collapsed->UI_SetMatrix(Matrix(0, 1, 0, 0));  // topmost, but covers no point

  PointF p(15, 18);
  auto hit = root->GetChildHit(false, false, p);
  ASSERT_TRUE(hit.first);
  EXPECT_EQ(hit.second->get(), moved.get());
  EXPECT_EQ(p, PointF(5, 8));

  p = PointF(220, 204);
  hit = root->GetChildHit(false, false, p);
  ASSERT_TRUE(hit.first);
  EXPECT_EQ(hit.second->get(), scaled.get());
  EXPECT_EQ(p, PointF(5, 1));

  p = PointF(30, 15);  // the moved child's right edge is outside it
  hit = root->GetChildHit(false, false, p);
  EXPECT_FALSE(hit.first);
  EXPECT_EQ(p, PointF(30, 15));
}

// A view whose class replaces what the walks read from a plain view's fields:
// it is moved by an extra offset, hit only in its left half, and hidden on
// request whatever its flag says.
class CustomGeometryView : public RecordingView {
 public:
  Matrix UI_GetSelfToParentMatrix() const override {
    ++matrixCalls;
    return Matrix::Translation(extra.x, extra.y).Concat(UI_SubView::UI_GetSelfToParentMatrix());
  }
  bool UI_HitTest(const PointF& inPoint) const override {
    ++hitCalls;
    return inPoint.x < UI_GetLocalRectF(false).width / 2 && UI_SubView::UI_HitTest(inPoint);
  }
  bool UI_IsShown() const override { return !forceHidden && UI_SubView::UI_IsShown(); }

  PointF extra;
  bool forceHidden = false;
  mutable int matrixCalls = 0;
  mutable int hitCalls = 0;
};

using OverridingViews = ManagerTest;

TEST_F(OverridingViews, MappingThroughAChainAsksTheOverriddenMatrixAtItsLevel) {
  auto root = MakeView(0, 0, 1000, 1000, nullptr, "root");
  auto plain = MakeView(10, 20, 900, 900, root.get());
  boost::intrusive_ptr<CustomGeometryView> custom(new CustomGeometryView);
  custom->UI_SetLocalRectF(RectF(1, 2, 800, 800));
  custom->UI_Show(true);
  custom->extra = PointF(100, 200);
  plain->ChildPushBack(custom);
  auto leaf = MakeView(3, 4, 10, 10, custom.get());
  custom->matrixCalls = 0;  // invalidations asked it while the chain was built

  EXPECT_EQ(leaf->UI_LocalToGlobalF(PointF(0.5f, 0.25f)), PointF(114.5f, 226.25f));
  EXPECT_EQ(UI_Node::UI_GetSelfToSpecificParentMatrix(leaf.get(), plain.get()), Matrix::Translation(104, 206));
  EXPECT_EQ(custom->matrixCalls, 2);
}

TEST_F(OverridingViews, ChildHitAsksTheOverriddenShowAndHitTestsAndFallsThroughToTheViewBelow) {
  auto root = MakeView(0, 0, 200, 200, nullptr, "root");
  auto below = MakeView(0, 0, 100, 100, root.get(), "below");
  boost::intrusive_ptr<CustomGeometryView> top(new CustomGeometryView);
  top->UI_SetLocalRectF(RectF(0, 0, 100, 100));
  top->UI_Show(true);
  root->ChildPushBack(top);
  top->hitCalls = 0;

  struct Case { PointF at; bool hidden; UI_Node* expected; } cases[] = {
      {PointF(25, 50), false, top.get()}, {PointF(75, 50), false, below.get()}, {PointF(25, 50), true, below.get()}};
  for (const Case& c : cases) {
    top->forceHidden = c.hidden;
    PointF p = c.at;
    auto hit = root->GetChildHit(false, true, p);
    ASSERT_TRUE(hit.first) << "at " << c.at.x << " hidden " << c.hidden;
    EXPECT_EQ(hit.second->get(), c.expected) << "at " << c.at.x << " hidden " << c.hidden;
  }
  EXPECT_EQ(top->hitCalls, 2);
}

}  // namespace
}  // namespace norvik::ui::test
