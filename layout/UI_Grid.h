#pragma once
// The table behind a grid view: rows and columns of cells, the least height
// of each row and width of each column, and the selection. The sizes can be
// read and written as text ("24,24,30"), as archives keep them; text that does
// not describe this grid leaves it unchanged and raises
// "$$$/norvik/ui/Error/BadGridSizes".
#include <string>
#include <vector>

#include "layout/UI_Cell.h"

namespace norvik::layout {

inline constexpr const char* kBadGridSizesKey = "$$$/norvik/ui/Error/BadGridSizes=Bad row or column sizes.";

class UI_Grid : public tarsel::utility::RefCountedObject {
 public:
  UI_Grid(unsigned long inRows = 0, unsigned long inColumns = 0);

  // Keeps the cells (and sizes) that remain inside the new size.
  void SetGridSize(unsigned long inRows, unsigned long inColumns);
  void GetGridSize(unsigned long& outRows, unsigned long& outColumns) const;
  unsigned long GetNumberOfRows() const { return mRows; }
  unsigned long GetNumberOfColumns() const { return mColumns; }
  float GetRowHeight(unsigned long inRow) const;
  void SetRowHeight(unsigned long inRow, float inHeight);
  float GetColumnWidth(unsigned long inColumn) const;
  void SetColumnWidth(unsigned long inColumn, float inWidth);
  // Null outside the grid.
  UI_CellP GetCell(unsigned long inRow, unsigned long inColumn) const;
  bool GetCellForPoint(const PointF& inPoint, unsigned long& outRow, unsigned long& outColumn) const;
  // Selects the cell under inPoint; without inExtend every other cell is
  // deselected. A point on no cell deselects all (unless extending).
  void SelectCell(const PointF& inPoint, bool inExtend);
  // The first selected cell in row order, or null.
  UI_CellP GetSelectedCell() const;

  std::string GetRowHeightsAsString() const;
  void SetRowHeightsFromString(const std::string& inText);
  std::string GetColumnWidthsAsString() const;
  void SetColumnWidthsFromString(const std::string& inText);

 private:
  unsigned long mRows = 0;
  unsigned long mColumns = 0;
  std::vector<float> mRowHeights;
  std::vector<float> mColumnWidths;
  std::vector<UI_CellP> mCells;  // row by row
};

using UI_GridP = boost::intrusive_ptr<UI_Grid>;

// The sizes in inText, separated by commas: at most inMaxCount finite numbers
// of at least 0. Anything else raises the bad-sizes error.
std::vector<float> ParseGridSizes(const std::string& inText, std::size_t inMaxCount);
std::string FormatGridSizes(const std::vector<float>& inSizes);

}  // namespace norvik::layout
