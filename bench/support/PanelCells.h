#pragma once
// The 2,000-view panel that several benchmarks paint: a 40 x 50 grid of cells
// that fill and stroke their rectangle and draw a short label in theme colours.
#include <string>

#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "tarsel/ThrowError.h"
#include "ui/Theme.h"
#include "ui/UI_SubView.h"

namespace norvik::bench {

constexpr int kPanelColumns = 40;
constexpr int kPanelRows = 50;
constexpr float kCellWidth = 48;
constexpr float kCellHeight = 21;

// Drawing resources shared by all cells, as a control family shares them
// through its resource cache.
struct CellResources {
  explicit CellResources(drawbot::SupplierInterface const* inSupplier)
      : fill(inSupplier, ui::GetColor(7)),
        stroke(inSupplier, ui::GetColor(1), 1),
        text(inSupplier, ui::GetColor(1)),
        font(MakeFont(inSupplier)) {}

  // The theme's font when the platform has it, else the platform's own sans.
  static drawbot::FontP MakeFont(drawbot::SupplierInterface const* inSupplier) {
    try {
      return drawbot::FontP(inSupplier, ui::GetFontName(0), u"", ui::GetFontSize(0));
    } catch (const tarsel::config::Exception&) {
      return drawbot::FontP(inSupplier, u"DejaVu Sans", u"", ui::GetFontSize(0));
    }
  }
  drawbot::BrushP fill;
  drawbot::PenP stroke;
  drawbot::BrushP text;
  drawbot::FontP font;
};

class CellView : public ui::UI_SubView {
 public:
  CellView(const CellResources* inResources, int inIndex, drawbot::SupplierInterface const* inSupplier)
      : mResources(inResources), mPath(inSupplier) {
    const std::string digits = std::to_string(inIndex);
    mLabel = u"Ch " + std::u16string(digits.begin(), digits.end());
    mPath->AddRect(tarsel::geom::RectT<float>(0.5f, 0.5f, kCellWidth - 1, kCellHeight - 1));
  }

  void UI_Draw(drawbot::Drawbot* inDrawbot) override {
    drawbot::SurfaceInterface* surface = inDrawbot->GetSurface();
    surface->FillPath(*mResources->fill, *mPath, drawbot::kFillWinding);
    surface->StrokePath(*mResources->stroke, *mPath);
    surface->DrawString(*mResources->text, *mResources->font, reinterpret_cast<unsigned short const*>(mLabel.c_str()),
                        tarsel::geom::PointT<float>(4, 15), drawbot::kTextAlignLeft, drawbot::kTextTruncationNone, 0);
  }

 private:
  const CellResources* mResources;
  std::u16string mLabel;
  drawbot::PathP mPath;
};

// Fills inParent with the grid; inVisit sees each cell as it is added.
template <typename Visit>
void AddPanelCells(ui::UI_Node* inParent, const CellResources* inResources,
                   drawbot::SupplierInterface const* inSupplier, ui::UI_Node::DrawCachePolicy inPolicy, Visit inVisit) {
  for (int row = 0; row < kPanelRows; ++row) {
    for (int column = 0; column < kPanelColumns; ++column) {
      boost::intrusive_ptr<CellView> cell(new CellView(inResources, row * kPanelColumns + column, inSupplier));
      cell->UI_SetLocalRectF(
          tarsel::geom::RectT<float>(column * kCellWidth, row * kCellHeight, kCellWidth, kCellHeight));
      cell->UI_Show(true);
      cell->UI_SetDrawCachePolicy(inPolicy);
      inParent->ChildPushBack(cell);
      inVisit(cell.get());
    }
  }
}

}  // namespace norvik::bench
