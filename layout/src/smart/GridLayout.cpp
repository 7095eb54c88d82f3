#include "layout/GridLayout.h"

#include <algorithm>
#include <cmath>

namespace norvik::layout {

GridLayout::GridLayout(unsigned long inColumns, unsigned long inRows)
    : mColumns(inColumns),
      mRows(inRows),
      mRowHeights(inRows, 0.0f),
      mColumnWidths(inColumns, 0.0f),
      mCells(inColumns * inRows, EmptyLayout::GetSharedPtr()) {}

void GridLayout::SetCellLayout(unsigned long inColumn, unsigned long inRow, SmartLayoutP inLayout) {
  if (inColumn >= mColumns || inRow >= mRows) return;
  mCells[inRow * mColumns + inColumn] = inLayout ? std::move(inLayout) : EmptyLayout::GetSharedPtr();
  mNeedsMeasure = true;
}

SmartLayoutP GridLayout::GetCellLayout(unsigned long inColumn, unsigned long inRow) const {
  if (inColumn >= mColumns || inRow >= mRows) return nullptr;
  return mCells[inRow * mColumns + inColumn];
}

void GridLayout::SetRowSpacing(float inSpacing) {
  mRowSpacing = SanitizeExtent(inSpacing);
  mNeedsMeasure = true;
}

void GridLayout::SetColumnSpacing(float inSpacing) {
  mColumnSpacing = SanitizeExtent(inSpacing);
  mNeedsMeasure = true;
}

void GridLayout::Measure() {
  std::fill(mColumnWidths.begin(), mColumnWidths.end(), 0.0f);
  std::fill(mRowHeights.begin(), mRowHeights.end(), 0.0f);
  for (unsigned long row = 0; row < mRows; ++row) {
    for (unsigned long column = 0; column < mColumns; ++column) {
      const PointF size = SanitizeSize(mCells[row * mColumns + column]->GetInitialSize());
      mColumnWidths[column] = std::max(mColumnWidths[column], size.x);
      mRowHeights[row] = std::max(mRowHeights[row], size.y);
    }
  }
  float width = 0, height = 0;
  for (float w : mColumnWidths) width += w;
  for (float h : mRowHeights) height += h;
  if (mColumns > 1) width += static_cast<float>(mColumns - 1) * mColumnSpacing;
  if (mRows > 1) height += static_cast<float>(mRows - 1) * mRowSpacing;
  SetInitialSizeField(PointF(width, height));
  mNeedsMeasure = false;
}

PointF GridLayout::GetInitialSize() {
  if (mNeedsMeasure) Measure();
  return SmartLayout::GetInitialSize();
}

void GridLayout::SetLocation(const RectF& inRect) {
  if (mNeedsMeasure) Measure();
  const RectF area = SanitizeRect(inRect);
  float y = area.top;
  for (unsigned long row = 0; row < mRows; ++row) {
    float x = area.left;
    for (unsigned long column = 0; column < mColumns; ++column) {
      RectF cell(std::ceil(x), std::ceil(y), std::floor(mColumnWidths[column]), std::floor(mRowHeights[row]));
      // A cell that does not wholly fit is not shown at all rather than cut.
      if (!area.Contains(cell)) cell = RectF();
      // Held across the call-out: a cell may replace itself in the table.
      const SmartLayoutP layout = mCells[row * mColumns + column];
      layout->SetLocation(cell);
      x += mColumnWidths[column] + mColumnSpacing;
    }
    y += mRowHeights[row] + mRowSpacing;
  }
}

}  // namespace norvik::layout
