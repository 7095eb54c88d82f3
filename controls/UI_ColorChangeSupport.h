#pragma once
// A mixin for controls whose theme colours a client may substitute: every
// colour index that the control's drawing asks for goes through the map
// first.
#include <cstdint>
#include <map>

namespace norvik::controls {

using ColorChangeMap = std::map<std::uint64_t, std::uint64_t>;

class UI_ColorChangeSupport {
 public:
  virtual ~UI_ColorChangeSupport() = default;
  void ReplaceColor(std::uint64_t inFrom, std::uint64_t inTo) { mMap[inFrom] = inTo; }
  void ResetColors() { mMap.clear(); }
  const ColorChangeMap& GetColorChangeMap() const { return mMap; }

 private:
  ColorChangeMap mMap;
};

// The replacement of inIndex, or inIndex itself without a map or an entry.
inline std::uint64_t UI_GetColorFromChangeMap(std::uint64_t inIndex, const ColorChangeMap* inMap) {
  if (!inMap) return inIndex;
  auto it = inMap->find(inIndex);
  return it == inMap->end() ? inIndex : it->second;
}

}  // namespace norvik::controls
