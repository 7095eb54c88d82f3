// The draw traversal over a large panel: 2,000 views in a 40 x 50 grid, each
// filling and stroking its rectangle and drawing a short label in theme
// colours, painted into 1920 x 1080 on the image back end. Measured: a full
// repaint without caches, a full repaint when every view's cache is valid,
// and the repaint of the damage left by invalidating one view.
#include <benchmark/benchmark.h>

#include <string>
#include <vector>

#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "tarsel/ThrowError.h"
#include "ui/OS_NodeManager.h"
#include "ui/Theme.h"
#include "ui/UI_SubView.h"

#include "support/PanelCells.h"

namespace {

using norvik::bench::CellResources;
using norvik::bench::kPanelColumns;
using norvik::bench::kPanelRows;
using norvik::drawbot::ColorRGBA;
using norvik::drawbot::PathP;
using norvik::drawbot::SurfaceP;
using norvik::ui::UI_Node;
using tarsel::geom::RectT;

class Panel {
 public:
  explicit Panel(UI_Node::DrawCachePolicy inCellPolicy)
      : mSupplier(norvik::drawbot::NewOSSupplier()),
        mSurface(mSupplier, 1920, 1080),
        mDrawbot(mSupplier, mSurface.Get()),
        mResources(mSupplier),
        mRoot(new norvik::ui::UI_SubView()) {
    mRoot->UI_SetLocalRectF(RectT<float>(0, 0, 1920, 1080));
    mRoot->UI_Show(true);
    mRoot->UI_SetDrawCachePolicy(UI_Node::kDrawCacheNever);
    norvik::bench::AddPanelCells(mRoot.get(), &mResources, mSupplier, inCellPolicy,
                                 [this](UI_Node* inCell) { mCells.push_back(inCell); });
  }

  void Paint() {
    const ColorRGBA background = norvik::ui::GetColor(2);
    mRoot->UI_DispatchDrawFromRoot(&background, &mDrawbot, false);
    mSurface->Flush();
  }

  // Invalidates one cell and repaints the damage it leaves, as the window's
  // paint after that invalidation does.
  void RepaintCell(size_t inIndex) {
    UI_Node* cell = mCells[inIndex % mCells.size()];
    cell->UI_Invalidate(nullptr, 0);
    mSurface->PushStateStack();
    PathP damage(mSupplier);
    damage->AddRect(cell->UI_GetLocalRectF(true));
    mSurface->Clip(*damage, norvik::drawbot::kFillWinding);
    Paint();
    mSurface->PopStateStack();
  }

 private:
  norvik::drawbot::SupplierInterface const* mSupplier;
  SurfaceP mSurface;
  norvik::drawbot::Drawbot mDrawbot;
  CellResources mResources;
  boost::intrusive_ptr<norvik::ui::UI_SubView> mRoot;
  std::vector<UI_Node*> mCells;
};

void FullRepaintWithoutCaches(benchmark::State& state) {
  norvik::ui::OS_NodeManager manager;
  Panel panel(UI_Node::kDrawCacheNever);
  for (auto _ : state) panel.Paint();
  state.SetItemsProcessed(state.iterations() * kPanelColumns * kPanelRows);
}
BENCHMARK(FullRepaintWithoutCaches)->Unit(benchmark::kMillisecond);

void FullRepaintWithValidCaches(benchmark::State& state) {
  norvik::ui::OS_NodeManager manager;
  Panel panel(UI_Node::kDrawCacheAlways);
  panel.Paint();  // fills every cache
  for (auto _ : state) panel.Paint();
  state.SetItemsProcessed(state.iterations() * kPanelColumns * kPanelRows);
}
BENCHMARK(FullRepaintWithValidCaches)->Unit(benchmark::kMillisecond);

void RepaintAfterOneViewInvalidated(benchmark::State& state) {
  norvik::ui::OS_NodeManager manager;
  Panel panel(UI_Node::kDrawCacheAlways);
  panel.Paint();
  size_t next = 0;
  for (auto _ : state) panel.RepaintCell(next++ * 37);
}
BENCHMARK(RepaintAfterOneViewInvalidated)->Unit(benchmark::kMicrosecond);

}  // namespace
