// Event dispatch costs: a button press entering at the window root and
// walking to a leaf 32 deep where only the root answers; mouse-over updates
// while moving across a container of 100 x 100 leaves; a key travelling up a
// 32-deep focus chain after 4 keyboard filters.
#include <vector>

#include <benchmark/benchmark.h>

#include "ui/KeyboardEvent.h"
#include "ui/MouseEvent.h"
#include "ui/OS_NodeManager.h"
#include "ui/UI_SubView.h"

using namespace norvik::ui;
using PointF = tarsel::geom::PointT<float>;
using RectF = tarsel::geom::RectT<float>;

namespace {

// A view that answers mouse and key events as told, and counts what it sees.
class AnsweringView : public UI_SubView {
 public:
  bool UI_DoMouseEvent(UI_Node*, const MouseEvent&) override {
    ++seen;
    return answers;
  }
  bool UI_DoKeyboardEvent(UI_Node*, const KeyboardEvent&) override {
    ++seen;
    return answers;
  }
  bool UI_DoPreKeyboardEvent(UI_Node*, const KeyboardEvent&) override {
    ++seen;
    return false;
  }

  bool answers = false;
  long seen = 0;
};
using AnsweringViewP = boost::intrusive_ptr<AnsweringView>;

AnsweringViewP MakeView(float inX, float inY, float inW, float inH, UI_Node* inParent) {
  AnsweringViewP v(new AnsweringView);
  v->UI_SetLocalRectF(RectF(inX, inY, inW, inH));
  v->UI_Show(true);
  if (inParent) inParent->ChildPushBack(v);
  return v;
}

// inDepth nested views, each one unit inside the previous one; [0] is the root.
std::vector<AnsweringViewP> MakeChain(int inDepth) {
  std::vector<AnsweringViewP> chain{MakeView(0, 0, 1000, 1000, nullptr)};
  for (int i = 1; i < inDepth; ++i) chain.push_back(MakeView(1, 1, 1000.f - 2 * i, 1000.f - 2 * i, chain.back().get()));
  return chain;
}

void BM_ButtonPressAtRootOverLeaf32Deep(benchmark::State& state) {
  OS_NodeManager manager;
  std::vector<AnsweringViewP> chain = MakeChain(32);
  chain.front()->answers = true;
  MouseEvent press(MouseEvent::kActionButtonDown, MouseEvent::kButtonLeft, 1, PointF(500, 500), {},
                   OS_Event(1, kOSMsgLeftButtonDown, 1, 0));
  for (auto _ : state) benchmark::DoNotOptimize(chain.front()->UI_DispatchMouseEvent(press, true));
  if (chain.back()->seen == 0) state.SkipWithError("the leaf never saw the press");
}
BENCHMARK(BM_ButtonPressAtRootOverLeaf32Deep);

void BM_MouseOverMoveAcross100x100Leaves(benchmark::State& state) {
  OS_NodeManager manager;
  AnsweringViewP window = MakeView(0, 0, 1000, 1000, nullptr);
  AnsweringViewP grid = MakeView(0, 0, 1000, 1000, window.get());
  for (int y = 0; y < 100; ++y) {
    for (int x = 0; x < 100; ++x) MakeView(x * 10.f, y * 10.f, 10, 10, grid.get());
  }
  int cell = 0;
  for (auto _ : state) {
    // Each move lands on the next leaf, so the leaf changes every time.
    cell = (cell + 101) % 10000;
    MouseEvent move(MouseEvent::kActionMouseOver, 0, 0, PointF((cell % 100) * 10.f + 5, (cell / 100) * 10.f + 5), {},
                    OS_Event(1, kOSMsgMouseMove, 0, 0));
    window->UI_UpdateMouseOverState(move);
  }
  if (!manager.GetMouseOverLeafNode() || manager.GetMouseOverLeafNode() == grid.get())
    state.SkipWithError("no leaf under the mouse");
}
BENCHMARK(BM_MouseOverMoveAcross100x100Leaves);

void BM_KeyThroughFocusChain32DeepWith4Filters(benchmark::State& state) {
  OS_NodeManager manager;
  std::vector<AnsweringViewP> chain = MakeChain(32);
  std::vector<AnsweringViewP> filters;
  for (int i = 0; i < 4; ++i) {
    filters.push_back(MakeView(0, 0, 1, 1, nullptr));
    manager.AddKeyboardEventFilterNode(filters.back().get());
  }
  KeyboardEvent key(KeyboardEvent::kActionKeyDown, 'K', 'K', {}, false, OS_Event(1, kOSMsgKeyDown, 'K', 0));
  for (auto _ : state) benchmark::DoNotOptimize(UI_Node::UI_DispatchKeyboardEvent(chain.back().get(), key));
  if (chain.front()->seen == 0 || filters.front()->seen == 0) state.SkipWithError("the key did not reach the root");
}
BENCHMARK(BM_KeyThroughFocusChain32DeepWith4Filters);

}  // namespace
