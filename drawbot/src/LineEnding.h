#pragma once
// The platform's line ending. Stands in for the core library's
// GetLineEnding until that exists; private to the drawing layer.
#include "tarsel/UTFString.h"

namespace norvik::drawbot::detail {

inline UTF16String const& GetLineEnding() {
  static const UTF16String kEnding(u"\n");
  return kEnding;
}

}  // namespace norvik::drawbot::detail
