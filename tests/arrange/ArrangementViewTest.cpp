#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "arrange/UI_ArrangementView.h"
#include "support/arrange/ArrangeViewTestNodes.h"

namespace norvik::ui {
namespace {

using arrange::test::SizedNode;
using RectF = UI_Node::RectF;

struct Window {
  Window() {
    host->UI_Show(true);
    host->UI_SetLocalRectF(RectF(0, 0, 400, 300));
  }
  boost::intrusive_ptr<UI_SubView> host{new UI_SubView};
};

boost::intrusive_ptr<SizedNode> Sized(float inWidth, float inHeight) {
  return new SizedNode(UI_Node::PointF(inWidth, inHeight));
}

TEST(ArrangementView, OnlyTheRootArrangesAndNestedChildrenLandInTheirParentsSpace) {
  Window window;
  boost::intrusive_ptr<UI_ArrangementView> root(new UI_ArrangementView(arrange::kGroupRow));
  boost::intrusive_ptr<UI_ArrangementView> nested(new UI_ArrangementView(arrange::kGroupColumn));
  auto a = Sized(30, 20), b = Sized(40, 10), c = Sized(40, 10);
  nested->ChildPushBack(b);
  nested->ChildPushBack(c);
  root->ChildPushBack(a);
  root->ChildPushBack(nested);
  window.host->ChildPushBack(root);
  root->UI_SetLocalRectF(RectF(10, 10, 200, 50));
  EXPECT_TRUE(root->IsRootArrangement());
  EXPECT_FALSE(nested->IsRootArrangement());
  EXPECT_EQ(a->UI_GetLocalRectF(true), RectF(0, 0, 30, 20));
  EXPECT_EQ(nested->UI_GetLocalRectF(true), RectF(30, 0, 40, 20));
  EXPECT_EQ(c->UI_GetLocalRectF(true), RectF(0, 10, 40, 10));
  EXPECT_EQ(nested->UI_GetRecommendedSize(), UI_Node::PointF(40, 20));
  nested->UI_SetLocalRectF(RectF(30, 0, 60, 80));
  EXPECT_EQ(c->UI_GetLocalRectF(true), RectF(0, 10, 40, 10)) << "a nested view does not arrange itself";
}

TEST(ArrangementView, ARootMovedWithItsParentPlacesItsChildrenInItsOwnSpaceAfterAnInvalidation) {
  Window window;
  boost::intrusive_ptr<UI_SubView> panel(new UI_SubView);
  panel->UI_Show(true);
  window.host->ChildPushBack(panel);
  panel->UI_SetLocalRectF(RectF(0, 0, 300, 200));
  boost::intrusive_ptr<UI_ArrangementView> view(new UI_ArrangementView(arrange::kGroupRow));
  auto a = Sized(30, 20), b = Sized(40, 10);
  view->ChildPushBack(a);
  view->ChildPushBack(b);
  panel->ChildPushBack(view);
  view->UI_SetLocalRectF(RectF(10, 10, 200, 50));
  panel->UI_SetLocalRectF(RectF(50, 40, 300, 200));
  view->SetHorizontalSpacing(5);
  EXPECT_EQ(b->UI_GetLocalRectF(true), RectF(35, 0, 40, 10));
}

TEST(ArrangementView, SeparatorsOnThreeChildrenMakeTwoNodesBetweenThem) {
  Window window;
  boost::intrusive_ptr<UI_ArrangementView> view(new UI_ArrangementView(arrange::kGroupRow));
  view->SetHorizontalSpacing(6);
  for (int i = 0; i < 3; ++i) view->ChildPushBack(Sized(20, 20));
  window.host->ChildPushBack(view);
  view->UI_SetLocalRectF(RectF(0, 0, 100, 20));
  EXPECT_EQ(view->SeparatorCount(), 0u);
  view->EnableSeparators(true);
  EXPECT_EQ(view->SeparatorCount(), 2u);
  ASSERT_EQ(view->ChildSize(), 5u);
  EXPECT_EQ(view->ChildGet(3)->UI_GetLocalRectF(true), RectF(20, 0, 6, 20));
  EXPECT_EQ(view->ChildGet(1)->UI_GetLocalRectF(true), RectF(26, 0, 20, 20));
  view->EnableSeparators(false);
  EXPECT_EQ(view->ChildSize(), 3u);
}

TEST(ArrangementView, AChildRemovedFromItsOwnPlacementIsSurvived) {
  Window window;
  boost::intrusive_ptr<UI_ArrangementView> view(new UI_ArrangementView(arrange::kGroupRow));
  auto a = Sized(20, 20), b = Sized(20, 20);
  view->ChildPushBack(a);
  view->ChildPushBack(b);
  window.host->ChildPushBack(view);
  UI_ArrangementView* raw = view.get();
  UI_Node* second = b.get();
  a->InstallSizeChangedFunction(boost::make_shared<boost::function<void()>>([raw, second] {
    if (raw->ChildFind(second) != raw->ChildEnd()) raw->ChildRemove(second);
  }));
  view->UI_SetLocalRectF(RectF(0, 0, 100, 20));
  EXPECT_EQ(view->ChildSize(), 1u);
  EXPECT_EQ(a->UI_GetLocalRectF(true), RectF(0, 0, 20, 20));
}

}  // namespace
}  // namespace norvik::ui
