#pragma once
// Strategies by which a grid view sizes and places its cells. Resizing the
// view to fit its cells makes the view lay out again; a formatter already at
// work ignores that call rather than recursing.
#include "layout/UI_Grid.h"

namespace norvik::drawbot {
class SupplierInterface;
}

namespace norvik::layout {

class UI_GridView;

class UI_LayoutFormatter : public tarsel::utility::RefCountedObject {
 public:
  ~UI_LayoutFormatter() override = default;

  // Sizes and places the cells, moves their nodes, and grows the view when the
  // cells need more room than it has.
  virtual void RecalcLayout(const drawbot::SupplierInterface* inSupplier, UI_GridView& ioView);
  bool IsFormatterInProgress() const { return mInProgress; }

 protected:
  // Gives each cell of the view's grid its rectangle.
  virtual void CalculateCellSizes(UI_GridView& ioView) = 0;
  // The size of all the cells (inCellsUnion) plus the view's margins.
  virtual void ResizeGridView(UI_GridView& ioView, const RectF& inCellsUnion);
  void SetFormatterProgressState(bool inInProgress) { mInProgress = inInProgress; }

 private:
  bool mInProgress = false;
};

using UI_LayoutFormatterP = boost::intrusive_ptr<UI_LayoutFormatter>;

// Rows and columns as the grid has them: each column as wide as its widest
// cell's need (and at least its set width), each row likewise.
class UI_SimpleLayoutFormatter : public UI_LayoutFormatter {
 protected:
  void CalculateCellSizes(UI_GridView& ioView) override;
};

// Cells in row order, each at its own need, filling lines to the view's
// width; a line as tall as its tallest cell. Cells without nodes are hidden.
class UI_FlowLayoutFormatter : public UI_LayoutFormatter {
 protected:
  void CalculateCellSizes(UI_GridView& ioView) override;
};

}  // namespace norvik::layout
