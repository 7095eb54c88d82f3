#include "layout/UI_LayoutFormatter.h"

#include <algorithm>
#include <vector>

#include "layout/UI_GridView.h"

namespace norvik::layout {

void UI_LayoutFormatter::RecalcLayout(const drawbot::SupplierInterface*, UI_GridView& ioView) {
  if (IsFormatterInProgress()) return;
  // Held through the call-outs: a node moved by its cell may drop the view.
  ui::UI_NodeProtector protector(&ioView);
  const UI_GridP grid = ioView.GetGrid();
  CalculateCellSizes(ioView);
  const RectF bounds = ioView.UI_GetLocalRectF(false);
  RectF cells;
  for (unsigned long row = 0; row < grid->GetNumberOfRows(); ++row) {
    for (unsigned long column = 0; column < grid->GetNumberOfColumns(); ++column) {
      const UI_CellP cell = grid->GetCell(row, column);
      cell->UpdateNodesPosition();
      if (cell->IsEmpty()) continue;
      cells = cells.IsEmpty() ? cell->GetLocalRectF() : cells.Union(cell->GetLocalRectF());
    }
  }
  const GridMargins margins = ioView.GetMargins();
  if (cells.Right() + margins.right > bounds.width || cells.Bottom() + margins.bottom > bounds.height) {
    SetFormatterProgressState(true);
    ResizeGridView(ioView, cells);
    SetFormatterProgressState(false);
  }
}

void UI_LayoutFormatter::ResizeGridView(UI_GridView& ioView, const RectF& inCellsUnion) {
  const GridMargins margins = ioView.GetMargins();
  RectF rect = ioView.UI_GetLocalRectF(true);
  rect.width = std::max(rect.width, inCellsUnion.Right() + margins.right);
  rect.height = std::max(rect.height, inCellsUnion.Bottom() + margins.bottom);
  ioView.UI_SetLocalRectF(rect);
}

void UI_SimpleLayoutFormatter::CalculateCellSizes(UI_GridView& ioView) {
  const UI_GridP grid = ioView.GetGrid();
  const unsigned long rows = grid->GetNumberOfRows(), columns = grid->GetNumberOfColumns();
  std::vector<float> widths(columns), heights(rows);
  for (unsigned long column = 0; column < columns; ++column) widths[column] = grid->GetColumnWidth(column);
  for (unsigned long row = 0; row < rows; ++row) heights[row] = grid->GetRowHeight(row);
  for (unsigned long row = 0; row < rows; ++row)
    for (unsigned long column = 0; column < columns; ++column) {
      const PointF need = grid->GetCell(row, column)->RecalcCellSize(nullptr);
      widths[column] = std::max(widths[column], need.x);
      heights[row] = std::max(heights[row], need.y);
    }
  const GridMargins margins = ioView.GetMargins();
  float y = margins.top;
  for (unsigned long row = 0; row < rows; ++row) {
    float x = margins.left;
    for (unsigned long column = 0; column < columns; ++column) {
      const UI_CellP cell = grid->GetCell(row, column);
      cell->SetLocalRectF(RectF(x, y, widths[column], heights[row]));
      cell->SetVisible(true);
      x += widths[column];
    }
    y += heights[row];
  }
}

void UI_FlowLayoutFormatter::CalculateCellSizes(UI_GridView& ioView) {
  const UI_GridP grid = ioView.GetGrid();
  const GridMargins margins = ioView.GetMargins();
  const float right = ioView.UI_GetLocalRectF(false).width - margins.right;
  float x = margins.left, y = margins.top, lineHeight = 0;
  for (unsigned long row = 0; row < grid->GetNumberOfRows(); ++row) {
    for (unsigned long column = 0; column < grid->GetNumberOfColumns(); ++column) {
      const UI_CellP cell = grid->GetCell(row, column);
      cell->SetVisible(!cell->IsEmpty());
      if (cell->IsEmpty()) {
        cell->SetLocalRectF(RectF());
        continue;
      }
      const PointF need = cell->RecalcCellSize(nullptr);
      // A cell wider than a whole line still starts one of its own.
      if (x > margins.left && x + need.x > right) {
        x = margins.left;
        y += lineHeight;
        lineHeight = 0;
      }
      cell->SetLocalRectF(RectF(x, y, need.x, need.y));
      x += need.x;
      lineHeight = std::max(lineHeight, need.y);
    }
  }
}

}  // namespace norvik::layout
