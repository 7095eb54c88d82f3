#include "ui/UI_Divider.h"

#include <cmath>

#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "ui/Theme.h"

namespace norvik::ui {

namespace {
// The theme's outline colour of controls at rest.
constexpr std::uint64_t kDividerColor = 20;
}  // namespace

UI_Divider::UI_Divider() { UI_Show(true); }

UI_Node::RectF UI_Divider::LineRect(PointF const& inSize) {
  if (inSize.x >= inSize.y) return RectF(0, std::floor(inSize.y * 0.5f), inSize.x, 1);
  return RectF(std::floor(inSize.x * 0.5f), 0, 1, inSize.y);
}

void UI_Divider::UI_Draw(drawbot::Drawbot* inDrawbot) {
  if (!inDrawbot || !inDrawbot->GetSurface() || !inDrawbot->GetSupplier()) return;
  const RectF local = UI_GetLocalRectF(false);
  drawbot::PathP path(inDrawbot->GetSupplier());
  path->AddRect(LineRect(local.Size()));
  ThemeP theme = UI_GetCurrentTheme();
  drawbot::BrushP brush(inDrawbot->GetSupplier(), theme ? theme->GetColor(kDividerColor) : GetColor(kDividerColor));
  inDrawbot->GetSurface()->FillPath(*brush, *path, drawbot::kFillWinding);
}

}  // namespace norvik::ui
