// The layout view: children stacked at their content size by the mode, with
// or without the margins found, scaled on resize when asked, and left to
// their bindings when layout is off.
#include <limits>

#include <gtest/gtest.h>

#include "layout/UI_LayoutView.h"
#include "support/arrange/ArrangeViewTestNodes.h"

namespace norvik::layout::test {
namespace {

using arrange::test::SizedNode;
using PointF = ui::UI_Node::PointF;
using RectF = ui::UI_Node::RectF;

struct Stack {
  UI_LayoutViewP view{new UI_LayoutView};
  boost::intrusive_ptr<SizedNode> a{new SizedNode(PointF(30.2f, 10))};
  boost::intrusive_ptr<SizedNode> b{new SizedNode(PointF(20, 15))};
  boost::intrusive_ptr<SizedNode> hidden{new SizedNode(PointF(50, 50))};
  Stack() {
    view->UI_Show(true);
    view->UI_SetLocalRectF(RectF(0, 0, 100, 50));
    a->UI_SetLocalRectF(RectF(3, 5, 0, 0));
    b->UI_SetLocalRectF(RectF(10, 20, 0, 0));
    hidden->UI_Show(false);
    hidden->UI_SetLocalRectF(RectF(1, 1, 2, 2));
    for (ui::UI_NodeP child : {ui::UI_NodeP(a), ui::UI_NodeP(hidden), ui::UI_NodeP(b)}) view->ChildPushBack(child);
  }
};

TEST(LayoutView, StacksChildrenAtTheirContentSizeByModeKeepingOrPackingTheMarginsFound) {
  struct Case { unsigned long mode; bool maintainMargins; RectF a, b; PointF recommended; };
  const Case cases[] = {
      // Vertical: b keeps the 15 between the old bottom of a and its top.
      {0, true, RectF(3, 5, 31, 10), RectF(10, 30, 20, 15), PointF(37, 50)},
      {0, false, RectF(0, 0, 31, 10), RectF(0, 10, 20, 15), PointF(31, 25)},
      // Horizontal: b keeps the 7 between the old right of a and its left.
      {1, true, RectF(3, 5, 31, 10), RectF(41, 20, 20, 15), PointF(64, 40)},
      {1, false, RectF(0, 0, 31, 10), RectF(31, 0, 20, 15), PointF(51, 15)},
  };
  for (const Case& c : cases) {
    Stack s;
    s.view->SetLayoutMode(c.mode);
    s.view->SetMaintainMargins(c.maintainMargins);
    for (int pass = 0; pass < 2; ++pass) {
      s.view->AutoLayout(nullptr);
      const std::string row = "mode " + std::to_string(c.mode) + " margins " + std::to_string(c.maintainMargins);
      EXPECT_EQ(s.a->UI_GetLocalRectF(true), c.a) << row;
      EXPECT_EQ(s.b->UI_GetLocalRectF(true), c.b) << row;
      EXPECT_EQ(s.view->UI_GetRecommendedSize(), c.recommended) << row;
      EXPECT_EQ(s.hidden->UI_GetLocalRectF(true), RectF(1, 1, 2, 2)) << row << ": a hidden child is left alone";
      EXPECT_EQ(s.view->UI_GetLocalRectF(false), RectF(0, 0, 100, 50)) << row << ": the view keeps its size";
    }
  }
}

TEST(LayoutView, TheSettersWriteTheSubViewLayoutFlagsAndWithLayoutOffNothingMoves) {
  Stack s;
  EXPECT_EQ(s.view->UI_GetSubViewLayoutFlags(), UI_LayoutView::kLayoutEnabled | UI_LayoutView::kMaintainMargins);
  s.view->SetLayoutMode(UI_LayoutView::kLayoutModeHorizontal);
  s.view->SetScaleChildren(true);
  s.view->SetMaintainMargins(false);
  s.view->SetLayoutMode(2);
  EXPECT_EQ(s.view->UI_GetSubViewLayoutFlags(), 1 | 2 | 8) << "a mode other than 0 and 1 is ignored";
  s.view->SetLayoutEnabled(false);
  s.view->AutoLayout(nullptr);
  s.view->UI_SetLocalRectF(RectF(0, 0, 200, 100));
  EXPECT_EQ(s.view->UI_GetSubViewLayoutFlags(), 2 | 8);
  EXPECT_EQ(s.a->UI_GetLocalRectF(true), RectF(3, 5, 0, 0)) << "neither laid out nor scaled";
}

TEST(LayoutView, AResizeScalesTheChildrenWhenAskedAndOtherwiseFollowsTheirBindings) {
  Stack s;
  s.view->AutoLayout(nullptr);
  s.b->UI_SetLayoutBinding(ui::UI_SubView::kBindWidthGrows);
  s.view->UI_SetLocalRectF(RectF(0, 0, 110, 50));
  EXPECT_EQ(s.a->UI_GetLocalRectF(true), RectF(3, 5, 31, 10));
  EXPECT_EQ(s.b->UI_GetLocalRectF(true), RectF(10, 30, 30, 15)) << "the binding grows it with the view";
  s.view->SetScaleChildren(true);
  s.view->UI_SetLocalRectF(RectF(0, 0, 220, 100));
  EXPECT_EQ(s.a->UI_GetLocalRectF(true), RectF(6, 10, 62, 20));
  EXPECT_EQ(s.b->UI_GetLocalRectF(true), RectF(20, 60, 60, 30));
}

TEST(LayoutView, ANestedLayoutIsLaidOutFirstAndChildrenWithoutASizeKeepTheirs) {
  UI_LayoutViewP outer(new UI_LayoutView), inner(new UI_LayoutView);
  outer->SetMaintainMargins(false);
  inner->SetMaintainMargins(false);
  inner->SetLayoutMode(UI_LayoutView::kLayoutModeHorizontal);
  const float nan = std::numeric_limits<float>::quiet_NaN();
  boost::intrusive_ptr<SizedNode> left(new SizedNode(PointF(12, 8))), bad(new SizedNode(PointF(nan, -4)));
  bad->UI_SetLocalRectF(RectF(0, 0, 9, 6));
  inner->UI_Show(true);
  inner->ChildPushBack(left);
  inner->ChildPushBack(bad);
  outer->ChildPushBack(inner);
  boost::intrusive_ptr<SizedNode> below(new SizedNode(PointF(5, 5)));
  outer->ChildPushBack(below);
  outer->AutoLayout(nullptr);
  EXPECT_EQ(bad->UI_GetLocalRectF(true), RectF(12, 0, 9, 6)) << "no usable size: it keeps its own";
  EXPECT_EQ(inner->UI_GetLocalRectF(true), RectF(0, 0, 21, 8));
  EXPECT_EQ(below->UI_GetLocalRectF(true), RectF(0, 8, 5, 5));
}

}  // namespace
}  // namespace norvik::layout::test
