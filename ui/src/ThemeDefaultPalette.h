#pragma once
// The fixed colours of a plain Theme, shared by the theme and its tests.
#include <cstddef>
#include <cstdint>

namespace norvik::ui::detail {

struct PaletteEntry {
  std::uint32_t rgb;  // 0xRRGGBB
  float alpha;
};

constexpr std::size_t kDefaultColorCount = 379;
extern const PaletteEntry kDefaultPalette[kDefaultColorCount];

}  // namespace norvik::ui::detail
