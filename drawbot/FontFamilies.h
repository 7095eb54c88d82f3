#pragma once
// Choosing a font family that the platform has. A supplier refuses a family
// that the font matcher would substitute, so a theme asks here first.
#include <vector>

#include "tarsel/UTFString.h"

namespace norvik::drawbot {

// True when the platform has inFamily itself, not a substitute for it.
bool IsFontFamilyAvailable(UTF16String const& inFamily);

// The first of inCandidates that the platform has, then "DejaVu Sans", then
// "Noto Sans", then the platform's default sans family.
UTF16String ChooseFontFamily(std::vector<UTF16String> const& inCandidates);

}  // namespace norvik::drawbot
