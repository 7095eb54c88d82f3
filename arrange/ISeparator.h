#pragma once
// Something drawn between two neighbours of a group, sized by the group's
// arrangement to the spacing between them.
#include "arrange/ArrangeTypes.h"

namespace norvik::arrange {

class ISeparator {
 public:
  virtual void Arrange(RectF const& inRect) = 0;
  virtual ~ISeparator() = default;
};

}  // namespace norvik::arrange
