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

#include "support/PanelCells.h"

namespace {

using norvik::bench::CellResources;
using norvik::bench::kPanelColumns;
using norvik::bench::kPanelRows;
using norvik::ui::OS_Point;
using norvik::ui::OS_Rect;
using norvik::ui::UI_Node;
using tarsel::geom::RectT;

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
  norvik::bench::AddPanelCells(window.get(), &resources, supplier, UI_Node::kDrawCacheNever, [](UI_Node*) {});
  desktop.system.Pump();
  for (auto _ : state) {
    window->UI_Invalidate(nullptr, 0);
    window->UI_UpdateNow(norvik::ui::UI_Node::kUpdateNowImmediate);
  }
  state.SetItemsProcessed(state.iterations() * kPanelColumns * kPanelRows);
}
BENCHMARK(NativePaintOfLargePanel)->Unit(benchmark::kMillisecond);

}  // namespace
