// Row and column sizes from archives: arbitrary text either sets the grid's
// sizes (each finite and at least 0, no more than the grid has) or raises the
// bad-sizes error and leaves the grid as it was; whatever was set writes out
// as text that reads back to the same sizes.
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "layout/UI_Grid.h"
#include "tarsel/ThrowError.h"

namespace {

using norvik::layout::UI_Grid;

void Check(bool inCondition) {
  if (!inCondition) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* inData, std::size_t inSize) {
  const std::string text(reinterpret_cast<const char*>(inData), inSize);
  UI_Grid grid(4, 3);
  grid.SetRowHeight(2, 7);
  const std::string rowsBefore = grid.GetRowHeightsAsString(), columnsBefore = grid.GetColumnWidthsAsString();
  try {
    grid.SetRowHeightsFromString(text);
  } catch (const tarsel::config::Exception&) {
    Check(grid.GetRowHeightsAsString() == rowsBefore);
  }
  try {
    grid.SetColumnWidthsFromString(text);
  } catch (const tarsel::config::Exception&) {
    Check(grid.GetColumnWidthsAsString() == columnsBefore);
  }
  for (unsigned long row = 0; row < 4; ++row)
    Check(std::isfinite(grid.GetRowHeight(row)) && grid.GetRowHeight(row) >= 0);
  UI_Grid copy(4, 3);
  copy.SetRowHeightsFromString(grid.GetRowHeightsAsString());
  for (unsigned long row = 0; row < 4; ++row) {
    const float a = grid.GetRowHeight(row), b = copy.GetRowHeight(row);
    Check(std::fabs(a - b) <= 1e-5f * std::fmax(1.0f, std::fabs(a)));
  }
  return 0;
}
