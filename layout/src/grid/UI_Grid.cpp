#include "layout/UI_Grid.h"

#include <charconv>
#include <cmath>
#include <sstream>

#include "tarsel/ThrowError.h"

namespace norvik::layout {

namespace {

[[noreturn]] void BadSizes() {
  tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError, kBadGridSizesKey);
}

bool IsSpace(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\r'; }

float ParseOne(const char* inBegin, const char* inEnd) {
  while (inBegin < inEnd && IsSpace(*inBegin)) ++inBegin;
  while (inEnd > inBegin && IsSpace(inEnd[-1])) --inEnd;
  float value = 0;
  const auto [end, error] = std::from_chars(inBegin, inEnd, value, std::chars_format::general);
  if (inBegin == inEnd || error != std::errc() || end != inEnd || !std::isfinite(value) || value < 0) BadSizes();
  return value;
}

}  // namespace

std::vector<float> ParseGridSizes(const std::string& inText, std::size_t inMaxCount) {
  std::vector<float> sizes;
  const char* p = inText.data();
  const char* const end = p + inText.size();
  const char* q = p;
  while (q < end && IsSpace(*q)) ++q;
  if (q == end) return sizes;  // nothing written: no sizes
  while (true) {
    const char* comma = std::find(p, end, ',');
    if (sizes.size() == inMaxCount) BadSizes();
    sizes.push_back(ParseOne(p, comma));
    if (comma == end) break;
    p = comma + 1;
  }
  return sizes;
}

std::string FormatGridSizes(const std::vector<float>& inSizes) {
  std::ostringstream out;
  out.imbue(std::locale::classic());
  for (std::size_t i = 0; i < inSizes.size(); ++i) out << (i ? "," : "") << inSizes[i];
  return out.str();
}

UI_Grid::UI_Grid(unsigned long inRows, unsigned long inColumns) { SetGridSize(inRows, inColumns); }

void UI_Grid::SetGridSize(unsigned long inRows, unsigned long inColumns) {
  std::vector<UI_CellP> cells(inRows * inColumns);
  for (unsigned long row = 0; row < inRows; ++row)
    for (unsigned long column = 0; column < inColumns; ++column) {
      UI_CellP& cell = cells[row * inColumns + column];
      cell = row < mRows && column < mColumns ? mCells[row * mColumns + column] : UI_CellP(new UI_Cell);
    }
  mCells.swap(cells);
  mRows = inRows;
  mColumns = inColumns;
  mRowHeights.resize(inRows, 0.0f);
  mColumnWidths.resize(inColumns, 0.0f);
}

void UI_Grid::GetGridSize(unsigned long& outRows, unsigned long& outColumns) const {
  outRows = mRows;
  outColumns = mColumns;
}

float UI_Grid::GetRowHeight(unsigned long inRow) const { return inRow < mRows ? mRowHeights[inRow] : 0.0f; }

void UI_Grid::SetRowHeight(unsigned long inRow, float inHeight) {
  if (inRow < mRows) mRowHeights[inRow] = SanitizeExtent(inHeight);
}

float UI_Grid::GetColumnWidth(unsigned long inColumn) const {
  return inColumn < mColumns ? mColumnWidths[inColumn] : 0.0f;
}

void UI_Grid::SetColumnWidth(unsigned long inColumn, float inWidth) {
  if (inColumn < mColumns) mColumnWidths[inColumn] = SanitizeExtent(inWidth);
}

UI_CellP UI_Grid::GetCell(unsigned long inRow, unsigned long inColumn) const {
  return inRow < mRows && inColumn < mColumns ? mCells[inRow * mColumns + inColumn] : nullptr;
}

bool UI_Grid::GetCellForPoint(const PointF& inPoint, unsigned long& outRow, unsigned long& outColumn) const {
  for (unsigned long row = 0; row < mRows; ++row)
    for (unsigned long column = 0; column < mColumns; ++column)
      if (mCells[row * mColumns + column]->GetLocalRectF().Contains(inPoint)) {
        outRow = row;
        outColumn = column;
        return true;
      }
  return false;
}

void UI_Grid::SelectCell(const PointF& inPoint, bool inExtend) {
  unsigned long row = 0, column = 0;
  const bool hit = GetCellForPoint(inPoint, row, column);
  if (!inExtend)
    for (const UI_CellP& cell : mCells) cell->SetSelected(false);
  if (hit) GetCell(row, column)->SetSelected(true);
}

UI_CellP UI_Grid::GetSelectedCell() const {
  for (const UI_CellP& cell : mCells)
    if (cell->IsSelected()) return cell;
  return nullptr;
}

std::string UI_Grid::GetRowHeightsAsString() const { return FormatGridSizes(mRowHeights); }

void UI_Grid::SetRowHeightsFromString(const std::string& inText) {
  const std::vector<float> sizes = ParseGridSizes(inText, mRows);
  std::copy(sizes.begin(), sizes.end(), mRowHeights.begin());
}

std::string UI_Grid::GetColumnWidthsAsString() const { return FormatGridSizes(mColumnWidths); }

void UI_Grid::SetColumnWidthsFromString(const std::string& inText) {
  const std::vector<float> sizes = ParseGridSizes(inText, mColumns);
  std::copy(sizes.begin(), sizes.end(), mColumnWidths.begin());
}

}  // namespace norvik::layout
