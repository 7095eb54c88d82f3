// The gallery's Buttons page (every kind of button in every state, about 70
// buttons, with the row and column labels and the live row under them)
// painted into the window body of the program's default 1120 x 720 window on
// the image back end: a full repaint with no caches, and a full repaint when
// every button's cache is valid.
#include <benchmark/benchmark.h>

#include "ButtonsView.h"
#include "controls/UI_ControlView.h"
#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "ui/KeyframeThemeEditor.h"
#include "ui/OS_NodeManager.h"
#include "ui/Theme.h"

namespace {

using norvik::ui::UI_Node;
using RectF = tarsel::geom::RectT<float>;

constexpr float kWidth = 1092;
constexpr float kHeight = 624;

// Every control in the tree under inNode; the views around them (sections,
// the grid with its labels) draw afresh each time, as the page's own code
// leaves them.
int SetButtonCachePolicy(UI_Node* inNode, UI_Node::DrawCachePolicy inPolicy) {
  int count = 0;
  for (auto it = inNode->ChildBegin(); it != inNode->ChildEnd(); ++it) {
    if (dynamic_cast<norvik::controls::UI_ControlView*>(it->get())) {
      (*it)->UI_SetDrawCachePolicy(inPolicy);
      ++count;
    }
    count += SetButtonCachePolicy(it->get(), inPolicy);
  }
  return count;
}

class ButtonsPage {
 public:
  explicit ButtonsPage(UI_Node::DrawCachePolicy inPolicy)
      : mSupplier(norvik::drawbot::NewOSSupplier()),
        mSurface(mSupplier, static_cast<long>(kWidth), static_cast<long>(kHeight)),
        mDrawbot(mSupplier, mSurface.Get()),
        mPage(new norvik::gallery::ButtonsView()) {
    mPage->UI_SetLocalRectF(RectF(0, 0, kWidth, kHeight));
    mPage->UI_Show(true);
    mPage->UI_SetDrawCachePolicy(UI_Node::kDrawCacheNever);
    mControls = SetButtonCachePolicy(mPage.get(), inPolicy);
  }
  void Paint() {
    const norvik::drawbot::ColorRGBA background = norvik::gallery::CurrentColors().background;
    mPage->UI_DispatchDrawFromRoot(&background, &mDrawbot, false);
    mSurface->Flush();
  }
  int Controls() const { return mControls; }

 private:
  norvik::drawbot::SupplierInterface const* mSupplier;
  norvik::drawbot::SurfaceP mSurface;
  norvik::drawbot::Drawbot mDrawbot;
  boost::intrusive_ptr<norvik::gallery::ButtonsView> mPage;
  int mControls = 0;
};

// The node manager with the toolkit's pictures, and the gallery's dark look.
class Program {
 public:
  Program() : mTheme(norvik::ui::MakeDefaultKeyframeTheme()) {
    norvik::ui::Theme::Initialize(mTheme);
    mTheme->SetBrightness(0);
    mTheme->NotifyThemeChanged();
  }
  ~Program() { norvik::ui::Theme::Terminate(); }

 private:
  norvik::ui::OS_NodeManager mManager;
  norvik::ui::KeyframeThemeEditorP mTheme;
};

void ButtonPageRepaintFromScratch(benchmark::State& state) {
  Program program;
  ButtonsPage page(UI_Node::kDrawCacheNever);
  for (auto _ : state) page.Paint();
  state.SetItemsProcessed(state.iterations() * page.Controls());
  state.counters["controls"] = page.Controls();
}
BENCHMARK(ButtonPageRepaintFromScratch)->Unit(benchmark::kMillisecond);

void ButtonPageRepaintWithValidCaches(benchmark::State& state) {
  Program program;
  ButtonsPage page(UI_Node::kDrawCacheAlways);
  page.Paint();  // fills every cache
  for (auto _ : state) page.Paint();
  state.SetItemsProcessed(state.iterations() * page.Controls());
  state.counters["controls"] = page.Controls();
}
BENCHMARK(ButtonPageRepaintWithValidCaches)->Unit(benchmark::kMillisecond);

}  // namespace
