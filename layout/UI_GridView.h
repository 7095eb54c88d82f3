#pragma once
// A view that stands its child nodes in the cells of a grid, placed by a
// formatter. In edit mode a click selects a cell, and with add-to-selected-
// cell on, a node added to the view goes into the selected cell.
#include "layout/UI_LayoutFormatter.h"
#include "ui/UI_SubView.h"

namespace norvik::layout {

struct GridMargins {
  float left = 0, top = 0, right = 0, bottom = 0;
};

class UI_GridView : public ui::UI_SubView {
 public:
  UI_GridView(unsigned long inRows = 1, unsigned long inColumns = 1);
  ~UI_GridView() override;

  UI_GridP GetGrid() const { return mGrid; }
  UI_LayoutFormatterP GetLayoutFormatter() const { return mFormatter; }
  // Null restores the simple formatter.
  void SetLayoutFormatter(UI_LayoutFormatterP inFormatter);
  GridMargins GetMargins() const { return mMargins; }
  void SetMargins(const GridMargins& inMargins);
  bool IsEditMode() const { return mEditMode; }
  void SetEditMode(bool inEditMode);
  bool GetAddNodeToSelectedCell() const { return mAddNodeToSelectedCell; }
  void SetAddNodeToSelectedCell(bool inAdd) { mAddNodeToSelectedCell = inAdd; }

  // Makes inNode a child and puts it in the cell.
  void AddNodeToCell(ui::UI_NodeP inNode, unsigned long inRow, unsigned long inColumn, const PointF& inOffset = PointF());
  void RecalcLayout();

  static void SetDrawCellBordersState(bool inDraw) { sDrawCellBorders = inDraw; }
  static bool CanDrawCellBorders() { return sDrawCellBorders; }

  void UI_SetLocalRectF(const RectF& inRect) override;
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  bool UI_DoMouseEvent(ui::UI_Node* inTarget, const ui::MouseEvent& inEvent) override;
  void ChildAdded(ui::UI_Node* inChild) override;
  void ChildRemoved(ui::UI_Node* inChild) override;

 private:
  // Under the nodes; the selected cell stands out in edit mode.
  void DrawCellBorders(drawbot::Drawbot& inDrawbot);

  static bool sDrawCellBorders;
  UI_GridP mGrid;
  UI_LayoutFormatterP mFormatter;
  GridMargins mMargins;
  bool mInitialized = false;
  bool mEditMode = false;
  bool mAddNodeToSelectedCell = false;
  bool mAddingToCell = false;
};

using UI_GridViewP = boost::intrusive_ptr<UI_GridView>;

}  // namespace norvik::layout
