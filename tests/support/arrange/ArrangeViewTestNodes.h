#pragma once
// Nodes for the arrangement views: a view with a fixed recommended size.
#include "ui/UI_SubView.h"

namespace norvik::arrange::test {

class SizedNode : public ui::UI_SubView {
 public:
  explicit SizedNode(PointF inSize) : size(inSize) { UI_Show(true); }
  PointF UI_GetRecommendedSize() const override { return size; }
  PointF size;
};

}  // namespace norvik::arrange::test
