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

namespace {

using norvik::drawbot::BrushP;
using norvik::drawbot::ColorRGBA;
using norvik::drawbot::FontP;
using norvik::drawbot::PathP;
using norvik::drawbot::PenP;
using norvik::drawbot::SurfaceP;
using norvik::ui::UI_Node;
using tarsel::geom::RectT;

constexpr int kColumns = 40;
constexpr int kRows = 50;
constexpr float kCellWidth = 48;
constexpr float kCellHeight = 21;

// Drawing resources shared by all cells, as a control family shares them
// through its resource cache.
struct CellResources {
  explicit CellResources(norvik::drawbot::SupplierInterface const* inSupplier)
      : fill(inSupplier, norvik::ui::GetColor(7)),
        stroke(inSupplier, norvik::ui::GetColor(1), 1),
        text(inSupplier, norvik::ui::GetColor(1)),
        font(MakeFont(inSupplier)) {}

  // The theme's font when the platform has it, else the platform's own sans.
  static FontP MakeFont(norvik::drawbot::SupplierInterface const* inSupplier) {
    try {
      return FontP(inSupplier, norvik::ui::GetFontName(0), u"", norvik::ui::GetFontSize(0));
    } catch (const tarsel::config::Exception&) {
      return FontP(inSupplier, u"DejaVu Sans", u"", norvik::ui::GetFontSize(0));
    }
  }
  BrushP fill;
  PenP stroke;
  BrushP text;
  FontP font;
};

std::u16string Digits(int inValue) {
  const std::string ascii = std::to_string(inValue);
  return std::u16string(ascii.begin(), ascii.end());
}

class CellView : public norvik::ui::UI_SubView {
 public:
  CellView(const CellResources* inResources, int inIndex, norvik::drawbot::SupplierInterface const* inSupplier)
      : mResources(inResources), mLabel(u"Ch " + Digits(inIndex)), mPath(inSupplier) {
    mPath->AddRect(RectT<float>(0.5f, 0.5f, kCellWidth - 1, kCellHeight - 1));
  }

  void UI_Draw(norvik::drawbot::Drawbot* inDrawbot) override {
    norvik::drawbot::SurfaceInterface* surface = inDrawbot->GetSurface();
    surface->FillPath(*mResources->fill, *mPath, norvik::drawbot::kFillWinding);
    surface->StrokePath(*mResources->stroke, *mPath);
    surface->DrawString(*mResources->text, *mResources->font,
                        reinterpret_cast<unsigned short const*>(mLabel.c_str()),
                        tarsel::geom::PointT<float>(4, 15), norvik::drawbot::kTextAlignLeft,
                        norvik::drawbot::kTextTruncationNone, 0);
  }

 private:
  const CellResources* mResources;
  std::u16string mLabel;
  PathP mPath;
};

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
    for (int row = 0; row < kRows; ++row) {
      for (int column = 0; column < kColumns; ++column) {
        boost::intrusive_ptr<CellView> cell(new CellView(&mResources, row * kColumns + column, mSupplier));
        cell->UI_SetLocalRectF(RectT<float>(column * kCellWidth, row * kCellHeight, kCellWidth, kCellHeight));
        cell->UI_Show(true);
        cell->UI_SetDrawCachePolicy(inCellPolicy);
        mRoot->ChildPushBack(cell);
        mCells.push_back(cell.get());
      }
    }
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
  state.SetItemsProcessed(state.iterations() * kColumns * kRows);
}
BENCHMARK(FullRepaintWithoutCaches)->Unit(benchmark::kMillisecond);

void FullRepaintWithValidCaches(benchmark::State& state) {
  norvik::ui::OS_NodeManager manager;
  Panel panel(UI_Node::kDrawCacheAlways);
  panel.Paint();  // fills every cache
  for (auto _ : state) panel.Paint();
  state.SetItemsProcessed(state.iterations() * kColumns * kRows);
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
