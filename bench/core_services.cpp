// Costs of the core services that sit on hot paths: a trace line whose
// category is off (left in code everywhere), a trace line delivered to a
// handler, posting work to the UI thread's executor, and the fader law that
// meters and rulers evaluate for every mark.
#include <benchmark/benchmark.h>

#include <string>

#include "tarsel/DebugStream.h"
#include "tarsel/DebugTrace.h"
#include "tarsel/FaderTranslator.h"
#include "tarsel/Threads.h"

namespace {

class NullHandler : public tarsel::debug::TraceHandler {
 public:
  void Trace(const UTF8String& inText) override { benchmark::DoNotOptimize(inText.data()); }
};

void BM_TraceSilentCategory(benchmark::State& state) {
  tarsel::debug::SetTraceVolume("bench.silent", 0);
  for (auto _ : state) NRK_TRACE("bench.silent", std::string("never built"));
}
BENCHMARK(BM_TraceSilentCategory);

void BM_TraceToHandler(benchmark::State& state) {
  NullHandler handler;
  tarsel::debug::TraceHandler* previous = tarsel::debug::InstallMasterTraceHandler(&handler);
  tarsel::debug::SetTraceVolume("bench.loud", 1);
  for (auto _ : state) tarsel::debug::DebugTrace("bench.loud", "a line of trace text");
  tarsel::debug::InstallMasterTraceHandler(previous);
}
BENCHMARK(BM_TraceToHandler);

// Posts a batch of tasks, then runs them: the cost per task of the UI
// thread's queue.
void BM_ExecutorPostAndRun(benchmark::State& state) {
  auto executor = tarsel::threads::RegisterCurrentThreadAsMainThread();
  const int batch = static_cast<int>(state.range(0));
  long sum = 0;
  for (auto _ : state) {
    for (int i = 0; i < batch; ++i) executor->Post([&sum, i] { sum += i; });
    benchmark::DoNotOptimize(executor->RunPending());
  }
  benchmark::DoNotOptimize(sum);
  state.SetItemsProcessed(state.iterations() * batch);
  tarsel::threads::UnregisterMainThread();
}
BENCHMARK(BM_ExecutorPostAndRun)->Arg(1)->Arg(1000);

void BM_FaderDecibelsToPosition(benchmark::State& state) {
  tarsel::utility::FaderTranslator<double> law;
  double db = -60;
  for (auto _ : state) {
    benchmark::DoNotOptimize(law.GetNormalizedValue(db));
    db = db > 6 ? -60 : db + 0.25;
  }
}
BENCHMARK(BM_FaderDecibelsToPosition);

}  // namespace
