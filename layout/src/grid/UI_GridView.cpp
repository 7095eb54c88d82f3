#include "layout/UI_GridView.h"

#include <cmath>

#include "drawbot/DrawHelpers.h"
#include "ui/MouseEvent.h"
#include "ui/UI_NodeManager.h"

namespace norvik::layout {

bool UI_GridView::sDrawCellBorders = false;

namespace {
constexpr std::uint64_t kBorderColor = 1;  // the theme's text colour, faded
constexpr float kBorderAlpha = 0.35f;
}  // namespace

UI_GridView::UI_GridView(unsigned long inRows, unsigned long inColumns)
    : mGrid(new UI_Grid(inRows, inColumns)), mFormatter(new UI_SimpleLayoutFormatter) {
  UI_SetNodeID("UI_GridView");
  mInitialized = true;
}

UI_GridView::~UI_GridView() = default;

void UI_GridView::SetLayoutFormatter(UI_LayoutFormatterP inFormatter) {
  mFormatter = inFormatter ? std::move(inFormatter) : UI_LayoutFormatterP(new UI_SimpleLayoutFormatter);
  RecalcLayout();
}

void UI_GridView::SetMargins(const GridMargins& inMargins) {
  mMargins = {SanitizeExtent(inMargins.left), SanitizeExtent(inMargins.top), SanitizeExtent(inMargins.right),
              SanitizeExtent(inMargins.bottom)};
  RecalcLayout();
}

void UI_GridView::SetEditMode(bool inEditMode) {
  if (inEditMode == mEditMode) return;
  mEditMode = inEditMode;
  UI_Invalidate(nullptr, 0);
}

void UI_GridView::AddNodeToCell(ui::UI_NodeP inNode, unsigned long inRow, unsigned long inColumn, const PointF& inOffset) {
  const UI_CellP cell = mGrid->GetCell(inRow, inColumn);
  if (!inNode || !cell) return;
  cell->AddNode(inNode, inOffset);
  mAddingToCell = true;
  cell->FetchNodes(*this);
  mAddingToCell = false;
  RecalcLayout();
}

void UI_GridView::RecalcLayout() {
  if (!mInitialized || !mFormatter) return;
  const UI_LayoutFormatterP formatter = mFormatter;
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst();
  formatter->RecalcLayout(manager ? manager->GetOSDrawSupplier() : nullptr, *this);
  UI_Invalidate(nullptr, 0);
}

void UI_GridView::UI_SetLocalRectF(const RectF& inRect) {
  const RectF old = UI_GetLocalRectF(false);
  UI_SubView::UI_SetLocalRectF(inRect);
  const RectF now = UI_GetLocalRectF(false);
  if (now.width != old.width || now.height != old.height) RecalcLayout();
}

void UI_GridView::ChildAdded(ui::UI_Node* inChild) {
  UI_SubView::ChildAdded(inChild);
  if (mAddingToCell || !mAddNodeToSelectedCell) return;
  const UI_CellP cell = mGrid->GetSelectedCell();
  if (!cell) return;
  cell->AddNode(inChild);
  RecalcLayout();
}

void UI_GridView::ChildRemoved(ui::UI_Node* inChild) {
  for (unsigned long row = 0; row < mGrid->GetNumberOfRows(); ++row)
    for (unsigned long column = 0; column < mGrid->GetNumberOfColumns(); ++column)
      mGrid->GetCell(row, column)->RemoveNode(inChild);
  UI_SubView::ChildRemoved(inChild);
}

bool UI_GridView::UI_DoMouseEvent(ui::UI_Node* inTarget, const ui::MouseEvent& inEvent) {
  if (!mEditMode || inTarget != this || !inEvent.IsLeftButtonSingleDown()) return false;
  mGrid->SelectCell(inEvent.GetPosition(), inEvent.GetModKey().Test(ui::kModKeyShift));
  UI_Invalidate(nullptr, 0);
  return true;
}

void UI_GridView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  if (inDrawbot && (sDrawCellBorders || mEditMode)) DrawCellBorders(*inDrawbot);
  UI_SubView::UI_Draw(inDrawbot);
}

void UI_GridView::DrawCellBorders(drawbot::Drawbot& inDrawbot) {
  const ui::ThemeP theme = UI_GetCurrentTheme();
  drawbot::ColorRGBA color = theme && theme->HasColor(kBorderColor) ? theme->GetColor(kBorderColor)
                                                                     : drawbot::ColorRGBA(0.5f, 0.5f, 0.5f);
  for (unsigned long row = 0; row < mGrid->GetNumberOfRows(); ++row)
    for (unsigned long column = 0; column < mGrid->GetNumberOfColumns(); ++column) {
      const UI_CellP cell = mGrid->GetCell(row, column);
      const RectF r = cell->GetLocalRectF();
      if (!cell->IsVisible() || r.IsEmpty()) continue;
      drawbot::ColorRGBA c = color;
      c.alpha *= mEditMode && cell->IsSelected() ? 1.0f : kBorderAlpha;
      StrokeRect(inDrawbot,
                 tarsel::geom::RectT<long>(std::lround(r.left), std::lround(r.top), std::lround(r.width),
                                           std::lround(r.height)),
                 c, 1);
    }
}

}  // namespace norvik::layout
