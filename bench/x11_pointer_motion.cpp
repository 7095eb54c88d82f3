// Pointer motion from a real X server to a node's handler. The benchmark
// starts a private Xvfb, puts a view 16 deep into a top-level container on
// the X11 native layer, and moves the pointer over it through XTEST.
//
// Measured is the toolkit's side only: each iteration queues the motions on
// the user's connection and waits, untimed, until the server has processed
// them (a round trip on that connection); the timed part is the loop reading
// the events from its connection and delivering them until the handler has
// seen the last one.
//
// MotionToNode: one motion per iteration, so no coalescing can happen; the
// time per iteration is the time per event.
// MotionBurst: 100 motions per iteration. The loop coalesces the motions that
// wait together, so the handler sees fewer than were sent; the counters give
// both rates (server events and handler deliveries per second).
#include <benchmark/benchmark.h>
#include <xcb/xcb.h>
#include <xcb/xtest.h>

#include <chrono>
#include <cstdlib>
#include <memory>

#include "support/ui/XvfbServer.h"
#include "ui/MouseEvent.h"
#include "ui/NativeLayerFactory.h"
#include "ui/OS_NativeLayer.h"
#include "ui/OS_NodeManager.h"
#include "ui/OS_ViewContainer.h"
#include "ui/UI_SubView.h"

namespace {

using norvik::ui::MouseEvent;
using norvik::ui::UI_Node;

// Counts the motions that reach it and remembers where the last one was.
class MotionCounter : public norvik::ui::UI_SubView {
 public:
  bool UI_DoMouseEvent(UI_Node*, const MouseEvent& inEvent) override {
    if (inEvent.GetAction() == MouseEvent::kActionMove) {
      ++moves;
      lastX = inEvent.GetPosition().x;
    }
    return true;
  }
  long moves = 0;
  float lastX = -1;
};

// A display, the layer installed on it, a window with the deep view, and the user.
class MotionDesk {
 public:
  bool Open(benchmark::State& ioState) {
    norvik::test::XvfbServer* server = norvik::test::XvfbServer::Get();
    if (!server) {
      ioState.SkipWithError("Xvfb is not available: install the xvfb package to run the X11 benchmarks");
      return false;
    }
    mLayer = norvik::ui::CreateX11NativeLayer(server->GetDisplayName().c_str());
    mUser = xcb_connect(server->GetDisplayName().c_str(), nullptr);
    if (!mLayer || xcb_connection_has_error(mUser)) {
      ioState.SkipWithError("cannot open the Xvfb display");
      return false;
    }
    norvik::ui::InstallNativeLayer(mLayer.get());
    MakeWindow();
    return true;
  }
  ~MotionDesk() {
    mWindow.reset();
    if (mLayer) norvik::ui::InstallNativeLayer(nullptr);
    mLayer.reset();
    if (mUser) xcb_disconnect(mUser);
  }

  void Move(int inX, int inY) {
    xcb_test_fake_input(mUser, XCB_MOTION_NOTIFY, 0, XCB_CURRENT_TIME, Root(), static_cast<int16_t>(inX),
                        static_cast<int16_t>(inY), 0);
  }
  // Returns once the server has handled everything sent so far.
  void Sync() { std::free(xcb_get_input_focus_reply(mUser, xcb_get_input_focus(mUser), nullptr)); }
  // Runs the loop until the handler has seen a motion at inLocalX; false if
  // that takes more than a second.
  bool DeliverUntil(float inLocalX) {
    const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(1);
    while (mLeaf->lastX != inLocalX) {
      mLayer->ProcessPendingEvents();
      if (std::chrono::steady_clock::now() > end) return false;
    }
    return true;
  }
  // The window's left edge is at 0 and each level is inset by 2.
  static constexpr float kLeafOrigin = 2.0f * 16;

  MotionCounter* mLeaf = nullptr;

 private:
  xcb_window_t Root() const { return xcb_setup_roots_iterator(xcb_get_setup(mUser)).data->root; }
  void MakeWindow() {
    mWindow.reset(new norvik::ui::OS_TopLevelViewContainer(false));
    const auto handle = mWindow->GetHandle();
    mLayer->SetExStyle(handle, mLayer->GetExStyle(handle) & ~norvik::ui::kOSExStyleNoActivate);
    mWindow->UI_SetLocalRect(UI_Node::RectL(0, 0, 800, 600));
    mWindow->UI_Show(true);
    mWindow->UI_Activate();
    UI_Node* parent = mWindow.get();
    for (int depth = 0; depth < 16; ++depth) {
      boost::intrusive_ptr<MotionCounter> view(new MotionCounter);
      view->UI_SetLocalRectF(UI_Node::RectF(2, 2, 700.0f - depth * 4, 500.0f - depth * 4));
      view->UI_Show(true);
      parent->ChildPushBack(view);
      parent = view.get();
      mLeaf = view.get();
    }
    Move(300, 300);
    Sync();
    DeliverUntil(300 - kLeafOrigin);
  }

  norvik::ui::OS_NodeManager mManager;
  std::unique_ptr<norvik::ui::OS_NativeLayer> mLayer;
  boost::intrusive_ptr<norvik::ui::OS_TopLevelViewContainer> mWindow;
  xcb_connection_t* mUser = nullptr;
};

void MotionToNode(benchmark::State& state) {
  MotionDesk desk;
  if (!desk.Open(state)) return;
  int x = 100;
  const long before = desk.mLeaf->moves;
  for (auto _ : state) {
    x = x == 100 ? 101 : 100;
    desk.Move(x, 200);
    desk.Sync();
    const auto start = std::chrono::steady_clock::now();
    if (!desk.DeliverUntil(x - MotionDesk::kLeafOrigin)) {
      state.SkipWithError("a motion never reached the node");
      return;
    }
    state.SetIterationTime(std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count());
  }
  state.counters["handled"] =
      benchmark::Counter(static_cast<double>(desk.mLeaf->moves - before), benchmark::Counter::kIsRate);
}
BENCHMARK(MotionToNode)->UseManualTime()->Unit(benchmark::kMicrosecond);

void MotionBurst(benchmark::State& state) {
  MotionDesk desk;
  if (!desk.Open(state)) return;
  constexpr int kBurst = 100;
  const long before = desk.mLeaf->moves;
  int round = 0;
  for (auto _ : state) {
    const int base = 100 + (round++ % 2) * 200;
    for (int i = 0; i < kBurst; ++i) desk.Move(base + i, 200 + (i % 3));
    desk.Sync();
    const auto start = std::chrono::steady_clock::now();
    if (!desk.DeliverUntil(base + kBurst - 1 - MotionDesk::kLeafOrigin)) {
      state.SkipWithError("the last motion never reached the node");
      return;
    }
    state.SetIterationTime(std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count());
  }
  state.SetItemsProcessed(state.iterations() * kBurst);
  state.counters["handled"] =
      benchmark::Counter(static_cast<double>(desk.mLeaf->moves - before), benchmark::Counter::kIsRate);
}
BENCHMARK(MotionBurst)->UseManualTime()->Unit(benchmark::kMicrosecond);

}  // namespace
