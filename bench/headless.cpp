// A pointer move injected into the headless window system and delivered to
// the window procedure: the cost of routing (capture, then hit testing
// through the z-order and into child windows), queueing, the cursor message
// that accompanies it, and the delivery itself. Measured over a desktop of
// twenty top-level windows, the one under the pointer holding eight nested
// children.
#include <cstdint>

#include <benchmark/benchmark.h>

#include "ui/HeadlessWindowSystem.h"

namespace {

using norvik::ui::HeadlessWindowSystem;
using norvik::ui::OS_Point;
using norvik::ui::OS_Rect;
using norvik::ui::OS_WindowCreateParams;
using norvik::ui::OS_WindowHandle;

std::uint64_t gMoves = 0;

std::intptr_t CountingProcedure(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                std::intptr_t inLParam) {
  if (inMessage == norvik::ui::kOSMsgMouseMove) {
    ++gMoves;
    return 0;
  }
  return norvik::ui::GetNativeLayer()->DefaultWindowProcedure(inWindow, inMessage, inWParam, inLParam);
}

void BuildDesktop(HeadlessWindowSystem& inSystem, int inTopLevels, int inDepth) {
  norvik::ui::OS_NativeLayer& layer = inSystem.GetLayer();
  layer.SetWindowProcedure(&CountingProcedure);
  OS_WindowCreateParams params;
  params.style = norvik::ui::kOSStyleVisible;
  for (int i = 0; i < inTopLevels; ++i) {
    params.rect = OS_Rect(20 * i, 20 * i, 300, 300);
    layer.CreateWindow(params);
  }
  // The last window is on top; nest children inside it.
  OS_WindowHandle parent = layer.GetTopWindow(0);
  params.style = norvik::ui::kOSStyleVisible | norvik::ui::kOSStyleChild;
  for (int d = 0; d < inDepth; ++d) {
    params.parent = parent;
    params.rect = OS_Rect(5, 5, 280 - 10 * d, 280 - 10 * d);
    parent = layer.CreateWindow(params);
  }
  inSystem.Pump();
}

void BM_PointerMoveDelivered(benchmark::State& state) {
  HeadlessWindowSystem system;
  system.Install();
  BuildDesktop(system, 20, static_cast<int>(state.range(0)));
  const OS_Rect top = system.GetLayer().GetWindowRect(system.GetLayer().GetTopWindow(0));
  long offset = 0;
  gMoves = 0;
  for (auto _ : state) {
    offset = (offset + 1) % 50;
    system.MovePointer(OS_Point(top.left + 100 + offset, top.top + 100));
    system.Pump();
  }
  if (gMoves != static_cast<std::uint64_t>(state.iterations())) state.SkipWithError("a move was not delivered");
  state.SetItemsProcessed(state.iterations());
  system.Uninstall();
}
BENCHMARK(BM_PointerMoveDelivered)->Arg(0)->Arg(8);

void BM_PointerMoveUnderCapture(benchmark::State& state) {
  HeadlessWindowSystem system;
  system.Install();
  BuildDesktop(system, 20, 8);
  norvik::ui::OS_NativeLayer& layer = system.GetLayer();
  layer.SetCapture(layer.GetTopWindow(0));
  long offset = 0;
  gMoves = 0;
  for (auto _ : state) {
    offset = (offset + 1) % 50;
    system.MovePointer(OS_Point(900 + offset, 900));
    system.Pump();
  }
  if (gMoves != static_cast<std::uint64_t>(state.iterations())) state.SkipWithError("a move was not delivered");
  state.SetItemsProcessed(state.iterations());
  system.Uninstall();
}
BENCHMARK(BM_PointerMoveUnderCapture);

}  // namespace
