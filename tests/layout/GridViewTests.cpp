// The grid view: cells sized by their nodes, the view grown to fit without
// recursing, add-to-selected-cell, and size strings from archives.
#include <gtest/gtest.h>

#include "layout/UI_GridView.h"
#include "support/controls/ControlTestSupport.h"
#include "support/tarsel/ErrorText.h"

namespace norvik::layout::test {
namespace {

class GridViewTest : public controls::test::ControlTest {
 protected:
  UI_GridViewP view = Add(new UI_GridView(2, 2), RectF(0, 0, 10, 10));
  ui::UI_NodeP Box(float inWidth, float inHeight) {
    ui::UI_NodeP box(new ui::UI_SubView);
    box->UI_SetLocalRectF(RectF(0, 0, inWidth, inHeight));
    return box;
  }
};

// Counts the passes it makes, to show that growing the view does not re-enter.
class CountingFormatter : public UI_SimpleLayoutFormatter {
 public:
  int passes = 0;

 protected:
  void CalculateCellSizes(UI_GridView& ioView) override {
    ++passes;
    UI_SimpleLayoutFormatter::CalculateCellSizes(ioView);
  }
};

TEST_F(GridViewTest, CellsTakeTheirNodesSizesAndTheViewGrowsOnceToHoldThem) {
  boost::intrusive_ptr<CountingFormatter> formatter(new CountingFormatter);
  view->SetLayoutFormatter(formatter);
  view->SetMargins({2, 3, 4, 5});
  ui::UI_NodeP a = Box(30, 10), b = Box(20, 25);
  formatter->passes = 0;
  view->AddNodeToCell(a, 0, 0);
  view->AddNodeToCell(b, 1, 1, PointF(1, 1));
  EXPECT_EQ(formatter->passes, 2) << "one pass per addition, none from the resize it causes";
  EXPECT_EQ(a->UI_GetLocalRectF(true), RectF(2, 3, 30, 10));
  EXPECT_EQ(b->UI_GetLocalRectF(true), RectF(33, 14, 20, 25));
  EXPECT_EQ(view->UI_GetLocalRectF(false), RectF(0, 0, 58, 45)) << "cells, padded by their offsets, plus the right and bottom margins";
}

TEST_F(GridViewTest, ANodeAddedWhileACellIsSelectedGoesIntoThatCell) {
  view->AddNodeToCell(Box(10, 10), 0, 0);
  view->AddNodeToCell(Box(10, 10), 1, 1);
  view->SetEditMode(true);
  view->SetAddNodeToSelectedCell(true);
  const RectF target = view->GetGrid()->GetCell(1, 0)->GetLocalRectF();
  view->GetGrid()->SelectCell(target.Center(), false);
  ui::UI_NodeP added = Box(4, 4);
  view->ChildPushBack(added);
  EXPECT_TRUE(view->GetGrid()->GetCell(1, 0)->HasNode(added.get()));
  EXPECT_EQ(added->UI_GetLocalRectF(true).Origin(), target.Origin());
  view->ChildRemove(added.get());
  EXPECT_TRUE(view->GetGrid()->GetCell(1, 0)->IsEmpty()) << "a removed child leaves its cell";
}

TEST_F(GridViewTest, FlowFormatterFillsLinesToTheViewsWidth) {
  view->SetLayoutFormatter(new UI_FlowLayoutFormatter);
  view->UI_SetLocalRectF(RectF(0, 0, 50, 100));
  view->AddNodeToCell(Box(30, 10), 0, 0);
  view->AddNodeToCell(Box(15, 20), 0, 1);
  view->AddNodeToCell(Box(30, 5), 1, 0);
  EXPECT_EQ(view->GetGrid()->GetCell(0, 1)->GetLocalRectF(), RectF(30, 0, 15, 20));
  EXPECT_EQ(view->GetGrid()->GetCell(1, 0)->GetLocalRectF(), RectF(0, 20, 30, 5)) << "wrapped under the line";
  EXPECT_FALSE(view->GetGrid()->GetCell(1, 1)->IsVisible()) << "an empty cell takes no room";
}

TEST(GridSizeStrings, BadSizesLeaveTheGridUnchangedAndRaiseTheGridError) {
  UI_Grid grid(3, 2);
  grid.SetRowHeightsFromString(" 12, 0.5 ,30");
  EXPECT_EQ(grid.GetRowHeightsAsString(), "12,0.5,30");
  grid.SetColumnWidthsFromString("40");
  EXPECT_EQ(grid.GetColumnWidthsAsString(), "40,0");
  for (const char* bad : {"1,2,3,4", "12,,30", "-1", "nan", "inf,1", "1e999", "12px", "0x10", ","}) {
    EXPECT_EQ(norvik::test::ErrorOf([&] { grid.SetRowHeightsFromString(bad); }), "Bad row or column sizes.")
        << bad;
    EXPECT_EQ(grid.GetRowHeightsAsString(), "12,0.5,30") << bad;
  }
}

}  // namespace
}  // namespace norvik::layout::test
