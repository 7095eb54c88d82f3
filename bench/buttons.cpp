// A page of 60 buttons (text buttons, check boxes, radio buttons and
// disclosure triangles, 15 of each in a 4 x 15 grid) painted into 800 x 600
// on the image back end: a full repaint with no caches, and a full repaint
// when every button's cache is valid.
#include <benchmark/benchmark.h>

#include "controls/UI_Checkbox.h"
#include "controls/UI_DisclosureTriangleButton.h"
#include "controls/UI_RadioButton.h"
#include "controls/UI_TextButton.h"
#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "ui/OS_NodeManager.h"
#include "ui/Theme.h"

namespace {

using norvik::ui::UI_Node;
using RectF = tarsel::geom::RectT<float>;

constexpr int kColumns = 4;
constexpr int kRows = 15;

UI_Node* MakeButton(int inColumn) {
  switch (inColumn) {
    case 0: return new norvik::controls::UI_TextButton(u"Render");
    case 1: return new norvik::controls::UI_Checkbox(u"Loop playback");
    case 2: return new norvik::controls::UI_RadioButton(u"Stereo");
    default: return new norvik::controls::UI_DisclosureTriangleButton(u"Effects");
  }
}

class ButtonPage {
 public:
  explicit ButtonPage(UI_Node::DrawCachePolicy inPolicy)
      : mSupplier(norvik::drawbot::NewOSSupplier()),
        mSurface(mSupplier, 800, 600),
        mDrawbot(mSupplier, mSurface.Get()),
        mRoot(new norvik::ui::UI_SubView()) {
    mRoot->UI_SetLocalRectF(RectF(0, 0, 800, 600));
    mRoot->UI_Show(true);
    mRoot->UI_SetDrawCachePolicy(UI_Node::kDrawCacheNever);
    for (int row = 0; row < kRows; ++row) {
      for (int column = 0; column < kColumns; ++column) {
        norvik::ui::UI_NodeP button(MakeButton(column));
        button->UI_SetLocalRectF(RectF(10 + column * 190.0f, 10 + row * 36.0f, 170, 24));
        button->UI_Show(true);
        button->UI_SetDrawCachePolicy(inPolicy);
        mRoot->ChildPushBack(button);
      }
    }
  }
  void Paint() {
    const norvik::drawbot::ColorRGBA background = norvik::ui::GetColor(4);
    mRoot->UI_DispatchDrawFromRoot(&background, &mDrawbot, false);
    mSurface->Flush();
  }

 private:
  norvik::drawbot::SupplierInterface const* mSupplier;
  norvik::drawbot::SurfaceP mSurface;
  norvik::drawbot::Drawbot mDrawbot;
  boost::intrusive_ptr<norvik::ui::UI_SubView> mRoot;
};

void ButtonPageRepaintFromScratch(benchmark::State& state) {
  norvik::ui::OS_NodeManager manager;
  ButtonPage page(UI_Node::kDrawCacheNever);
  for (auto _ : state) page.Paint();
  state.SetItemsProcessed(state.iterations() * kColumns * kRows);
}
BENCHMARK(ButtonPageRepaintFromScratch)->Unit(benchmark::kMillisecond);

void ButtonPageRepaintWithValidCaches(benchmark::State& state) {
  norvik::ui::OS_NodeManager manager;
  ButtonPage page(UI_Node::kDrawCacheAlways);
  page.Paint();  // fills every cache
  for (auto _ : state) page.Paint();
  state.SetItemsProcessed(state.iterations() * kColumns * kRows);
}
BENCHMARK(ButtonPageRepaintWithValidCaches)->Unit(benchmark::kMillisecond);

}  // namespace
