// The native window bridge on the headless window system. Measured: a pointer
// move injected into the system and routed through the window procedure to a
// view 16 deep, with the mouse-over state updated; and the native paint of a
// 1920 x 1080 top-level container holding the 2,000-view panel of the draw
// traversal benchmark (a 40 x 50 grid of cells that fill, stroke and label
// themselves), through invalidation, the paint message and read-back surface.
#include <benchmark/benchmark.h>

#include <string>
#include <vector>

#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "ui/HeadlessWindowSystem.h"
#include "ui/MouseEvent.h"
#include "ui/OS_NodeManager.h"
#include "ui/OS_ViewContainer.h"
#include "ui/Theme.h"
#include "ui/UI_SubView.h"

namespace {

using norvik::drawbot::BrushP;
using norvik::drawbot::FontP;
using norvik::drawbot::PathP;
using norvik::drawbot::PenP;
using norvik::ui::OS_Point;
using norvik::ui::OS_Rect;
using norvik::ui::UI_Node;
using tarsel::geom::RectT;

constexpr int kColumns = 40;
constexpr int kRows = 50;
constexpr float kCellWidth = 48;
constexpr float kCellHeight = 21;

struct CellResources {
  explicit CellResources(norvik::drawbot::SupplierInterface const* inSupplier)
      : fill(inSupplier, norvik::ui::GetColor(7)),
        stroke(inSupplier, norvik::ui::GetColor(1), 1),
        text(inSupplier, norvik::ui::GetColor(1)),
        font(inSupplier, u"DejaVu Sans", u"", norvik::ui::GetFontSize(0)) {}
  BrushP fill;
  PenP stroke;
  BrushP text;
  FontP font;
};

class CellView : public norvik::ui::UI_SubView {
 public:
  CellView(const CellResources* inResources, int inIndex, norvik::drawbot::SupplierInterface const* inSupplier)
      : mResources(inResources), mPath(inSupplier) {
    const std::string digits = std::to_string(inIndex);
    mLabel = u"Ch " + std::u16string(digits.begin(), digits.end());
    mPath->AddRect(RectT<float>(0.5f, 0.5f, kCellWidth - 1, kCellHeight - 1));
    UI_SetDrawCachePolicy(kDrawCacheNever);
  }

  void UI_Draw(norvik::drawbot::Drawbot* inDrawbot) override {
    norvik::drawbot::SurfaceInterface* surface = inDrawbot->GetSurface();
    surface->FillPath(*mResources->fill, *mPath, norvik::drawbot::kFillWinding);
    surface->StrokePath(*mResources->stroke, *mPath);
    surface->DrawString(*mResources->text, *mResources->font, reinterpret_cast<unsigned short const*>(mLabel.c_str()),
                        tarsel::geom::PointT<float>(4, 15), norvik::drawbot::kTextAlignLeft,
                        norvik::drawbot::kTextTruncationNone, 0);
  }

 private:
  const CellResources* mResources;
  std::u16string mLabel;
  PathP mPath;
};

// A view that answers mouse events, so that a move is handled at the leaf.
class HoverView : public norvik::ui::UI_SubView {
 public:
  bool UI_DoMouseEvent(UI_Node*, const norvik::ui::MouseEvent&) override { return true; }
};

struct Desktop {
  Desktop() { system.Install(); }
  norvik::ui::OS_NodeManager manager;
  norvik::ui::HeadlessWindowSystem system;
};

void PointerMoveToDeepView(benchmark::State& state) {
  Desktop desktop;
  norvik::ui::OS_TopLevelViewContainerP window(new norvik::ui::OS_TopLevelViewContainer(false));
  window->UI_SetLocalRect(UI_Node::RectL(0, 0, 800, 600));
  window->UI_Show(true);
  UI_Node* parent = window.get();
  for (int depth = 0; depth < 16; ++depth) {
    boost::intrusive_ptr<HoverView> view(new HoverView);
    view->UI_SetLocalRectF(RectT<float>(2, 2, 700.0f - depth * 4, 500.0f - depth * 4));
    view->UI_Show(true);
    parent->ChildPushBack(view);
    parent = view.get();
  }
  desktop.system.Pump();
  long x = 100;
  for (auto _ : state) {
    x = x == 100 ? 101 : 100;
    desktop.system.MovePointer(OS_Point(x, 200));
    desktop.system.Pump();
  }
  if (!parent->UI_IsMouseOver(true)) state.SkipWithError("the deepest view never became the mouse-over leaf");
}
BENCHMARK(PointerMoveToDeepView)->Unit(benchmark::kMicrosecond);

void NativePaintOfLargePanel(benchmark::State& state) {
  Desktop desktop;
  norvik::ui::OS_TopLevelViewContainerP window(new norvik::ui::OS_TopLevelViewContainer(false));
  window->UI_SetLocalRect(UI_Node::RectL(0, 0, 1920, 1080));
  window->UI_Show(true);
  auto* supplier = window->UI_GetDrawSupplier();
  CellResources resources(supplier);
  for (int row = 0; row < kRows; ++row) {
    for (int column = 0; column < kColumns; ++column) {
      boost::intrusive_ptr<CellView> cell(new CellView(&resources, row * kColumns + column, supplier));
      cell->UI_SetLocalRectF(RectT<float>(column * kCellWidth, row * kCellHeight, kCellWidth, kCellHeight));
      cell->UI_Show(true);
      window->ChildPushBack(cell);
    }
  }
  desktop.system.Pump();
  for (auto _ : state) {
    window->UI_Invalidate(nullptr, 0);
    window->UI_UpdateNow();
  }
  state.SetItemsProcessed(state.iterations() * kColumns * kRows);
}
BENCHMARK(NativePaintOfLargePanel)->Unit(benchmark::kMillisecond);

}  // namespace
