// Focus advance with Tab across a large panel: 1,000 focusable controls in 10
// nested containers (each container holds 100 controls and the next
// container). The tab-order caches are built by a first full cycle; the
// benchmark then measures one Tab step at a time, forward and backward.
#include <vector>

#include <benchmark/benchmark.h>

#include "ui/UI_NodeManager.h"
#include "ui/UI_SubView.h"

namespace {

using norvik::ui::UI_Node;
using norvik::ui::UI_NodeP;
using norvik::ui::UI_SubView;

class Window : public UI_SubView {
 public:
  bool UI_AreAllParentsVisible() const override { return UI_IsShown(); }
};

class Control : public UI_SubView {
 public:
  bool UI_WantsKeyboardFocus() const override { return true; }
  bool UI_WantsKeyboardFocusFromAdvance() const override { return true; }
};

constexpr int kContainers = 10;
constexpr int kControlsPerContainer = 100;

template <class T>
boost::intrusive_ptr<T> AddShown(UI_Node& inParent) {
  boost::intrusive_ptr<T> node(new T);
  node->UI_SetLocalRectF(UI_Node::RectF(0, 0, 10, 10));
  node->UI_Show(true);
  inParent.ChildPushBack(node);
  return node;
}

struct Panel {
  Panel() : window(new Window) {
    window->UI_SetLocalRectF(UI_Node::RectF(0, 0, 1000, 1000));
    window->UI_Show(true);
    UI_Node* container = window.get();
    for (int c = 0; c < kContainers; ++c) {
      for (int i = 0; i < kControlsPerContainer; ++i) {
        UI_NodeP control = AddShown<Control>(*container);
        if (!first) first = control;
      }
      if (c + 1 < kContainers) container = AddShown<UI_SubView>(*container).get();
    }
  }

  bool Tab(bool inForward) {
    UI_Node* leaf = manager.GetKeyboardFocusLeafNode();
    return UI_Node::UI_AdvanceFocus(inForward, leaf->UI_GetIndex(), leaf->UI_GetParentContainer());
  }

  norvik::ui::UI_NodeManager manager;
  boost::intrusive_ptr<Window> window;
  UI_NodeP first;
};

void RunTabSteps(benchmark::State& state, bool inForward) {
  Panel panel;
  panel.first->UI_GainKeyboardFocus(norvik::ui::kFocusChangeMouse);
  // One full cycle builds every container's tab-order cache.
  for (int i = 0; i < kContainers * kControlsPerContainer; ++i) panel.Tab(inForward);
  for (auto _ : state) {
    benchmark::DoNotOptimize(panel.Tab(inForward));
  }
  state.counters["controls"] = kContainers * kControlsPerContainer;
  state.counters["steps_per_s"] = benchmark::Counter(static_cast<double>(state.iterations()),
                                                     benchmark::Counter::kIsRate);
}

void BM_TabForwardAcrossNestedPanel(benchmark::State& state) { RunTabSteps(state, true); }
void BM_TabBackwardAcrossNestedPanel(benchmark::State& state) { RunTabSteps(state, false); }

BENCHMARK(BM_TabForwardAcrossNestedPanel)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_TabBackwardAcrossNestedPanel)->Unit(benchmark::kMicrosecond);

}  // namespace
