#pragma once
// A table of layouts: each column as wide as its widest cell, each row as
// tall as its tallest, with fixed gaps between them. Sizes are measured once
// and again only after a cell or a spacing changes.
#include <vector>

#include "layout/SmartLayout.h"

namespace norvik::layout {

class GridLayout : public SmartLayout {
 public:
  GridLayout(unsigned long inColumns, unsigned long inRows);

  void SetLocation(const RectF& inRect) override;
  PointF GetInitialSize() override;

  // A cell outside the table is ignored; a null layout empties the cell.
  void SetCellLayout(unsigned long inColumn, unsigned long inRow, SmartLayoutP inLayout);
  SmartLayoutP GetCellLayout(unsigned long inColumn, unsigned long inRow) const;
  void SetRowSpacing(float inSpacing);
  void SetColumnSpacing(float inSpacing);
  unsigned long GetColumnCount() const { return mColumns; }
  unsigned long GetRowCount() const { return mRows; }
  const std::vector<float>& GetColumnWidths() const { return mColumnWidths; }
  const std::vector<float>& GetRowHeights() const { return mRowHeights; }

 private:
  void Measure();

  unsigned long mColumns;
  unsigned long mRows;
  float mRowSpacing = 0;
  float mColumnSpacing = 0;
  bool mNeedsMeasure = true;
  std::vector<float> mRowHeights;
  std::vector<float> mColumnWidths;
  std::vector<SmartLayoutP> mCells;  // row by row
};

}  // namespace norvik::layout
