#include "drawbot/SupplierInterface.h"

namespace norvik::drawbot {

using tarsel::geom::PointT;

LinearShaderInterface* SupplierInterface::NewLinearShader(PointT<float> const& inStart, PointT<float> const& inEnd,
                                                          ColorRGBA const& inFirst, ColorRGBA const& inLast) const {
  ColorRGBA colors[2] = {inFirst, inLast};
  float positions[2] = {0, 1};
  return NewLinearShader(inStart, inEnd, colors, positions, 2);
}

LinearShaderInterface* SupplierInterface::NewLinearShader(
    PointT<float> const& inStart, PointT<float> const& inEnd,
    std::vector<std::pair<float, ColorRGBA>> const& inStops) const {
  std::vector<ColorRGBA> colors;
  std::vector<float> positions;
  colors.reserve(inStops.size() + 2);
  positions.reserve(inStops.size() + 2);
  if (!inStops.empty() && inStops.front().first != 0) {
    positions.push_back(0);
    colors.push_back(inStops.front().second);
  }
  for (auto const& stop : inStops) {
    positions.push_back(stop.first);
    colors.push_back(stop.second);
  }
  if (!inStops.empty() && inStops.back().first != 1) {
    positions.push_back(1);
    colors.push_back(inStops.back().second);
  }
  return NewLinearShader(inStart, inEnd, colors.data(), positions.data(), static_cast<unsigned long>(colors.size()));
}

}  // namespace norvik::drawbot
