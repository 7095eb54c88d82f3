// Node tree costs: coordinate mapping through a deep chain, hit-testing a wide
// container, a repeated invalidation cut short by the draw-cache seed, and the
// memory of a bare view.
#include <vector>

#include <benchmark/benchmark.h>

#include "ui/OS_NodeManager.h"
#include "ui/UI_SubView.h"
#include "support/HeapCounter.h"

using namespace norvik::ui;
using PointF = tarsel::geom::PointT<float>;
using RectF = tarsel::geom::RectT<float>;

namespace {

UI_SubViewP MakeShownView(float inX, float inY, float inW, float inH) {
  UI_SubViewP v(new UI_SubView);
  v->UI_SetLocalRectF(RectF(inX, inY, inW, inH));
  v->UI_Show(true);
  return v;
}

// A chain of inDepth views, each offset by one unit inside the previous one.
std::vector<UI_SubViewP> MakeChain(int inDepth) {
  std::vector<UI_SubViewP> chain{MakeShownView(0, 0, 1000, 1000)};
  for (int i = 1; i < inDepth; ++i) {
    chain.push_back(MakeShownView(1, 1, 1000.f - i, 1000.f - i));
    chain[i - 1]->ChildPushBack(chain.back());
  }
  return chain;
}

void BM_LocalToGlobalF_Depth32(benchmark::State& state) {
  OS_NodeManager manager;
  auto chain = MakeChain(32);
  PointF p(3, 4);
  for (auto _ : state) benchmark::DoNotOptimize(chain.back()->UI_LocalToGlobalF(p));
}
BENCHMARK(BM_LocalToGlobalF_Depth32);

void BM_GetChildHit_10000Children_FirstHit(benchmark::State& state) {
  OS_NodeManager manager;
  auto parent = MakeShownView(0, 0, 10000, 100);
  for (int i = 0; i < 10000; ++i) parent->ChildPushBack(MakeShownView(static_cast<float>(i), 0, 1, 10));
  for (auto _ : state) {
    PointF p(0.5f, 5);  // only the first child covers it: every other child is tested first
    auto hit = parent->GetChildHit(false, false, p);
    benchmark::DoNotOptimize(hit);
  }
}
BENCHMARK(BM_GetChildHit_10000Children_FirstHit)->Unit(benchmark::kMicrosecond);

// A hidden leaf only drops its own cache; after a first invalidation the seed
// stops the climb at once.
void BM_SecondInvalidate_Depth32_CutBySeed(benchmark::State& state) {
  OS_NodeManager manager;
  auto chain = MakeChain(32);
  chain.back()->UI_Show(false);
  manager.IncrementDrawbotCacheSeed();
  chain.back()->UI_Invalidate(nullptr, 0);
  for (auto _ : state) chain.back()->UI_Invalidate(nullptr, 0);
}
BENCHMARK(BM_SecondInvalidate_Depth32_CutBySeed);

// A shown leaf still reports its area to each ancestor (the window needs it),
// while the cache part of each step is cut short by the seed.
void BM_SecondInvalidate_Depth32_ShownChain(benchmark::State& state) {
  OS_NodeManager manager;
  auto chain = MakeChain(32);
  manager.IncrementDrawbotCacheSeed();
  chain.back()->UI_Invalidate(nullptr, 0);
  for (auto _ : state) chain.back()->UI_Invalidate(nullptr, 0);
}
BENCHMARK(BM_SecondInvalidate_Depth32_ShownChain);

void BM_SubViewMemory(benchmark::State& state) {
  OS_NodeManager manager;
  auto parent = MakeShownView(0, 0, 100, 100);
  std::size_t bytes = 0;
  for (auto _ : state) {
    norvik::bench::StartHeapCount();
    UI_SubViewP child(new UI_SubView);
    parent->ChildPushBack(child);
    bytes = norvik::bench::StopHeapCount();
    state.PauseTiming();
    parent->DeleteChildren();
    child.reset();
    state.ResumeTiming();
  }
  state.counters["sizeof_UI_SubView"] = sizeof(UI_SubView);
  state.counters["heap_bytes_bare_child"] = static_cast<double>(bytes);
}
BENCHMARK(BM_SubViewMemory);

}  // namespace
