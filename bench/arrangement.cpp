// Arrangement of large groups: a long row resized and placed again at the
// same size, and a wrapping group whose candidates grow as 2^(n-1).
#include <memory>
#include <vector>

#include <benchmark/benchmark.h>

#include "arrange/Single.h"
#include "arrange/WrappingArrangeableGroup.h"

namespace {

using namespace norvik::arrange;

class Leaf : public Single {
 public:
  Leaf(float inWidth, float inHeight, bool inExpands) : mWidth(inWidth), mHeight(inHeight), mExpands(inExpands) {}
  float NaturalWidth() const override { return mWidth; }
  float NaturalHeight() const override { return mHeight; }
  bool HorizontallyExpandable() const override { return mExpands; }
  PointF Place(RectF const& inRect) override {
    mPlaced = inRect;
    return inRect.Size();
  }

 private:
  float mWidth, mHeight;
  bool mExpands;
  RectF mPlaced;
};

template <class Group>
struct Tree {
  explicit Tree(int inCount) {
    for (int i = 0; i < inCount; ++i) {
      leaves.push_back(std::make_unique<Leaf>(20.0f + static_cast<float>(i % 7) * 5.0f, 10.0f + (i % 3), i % 2 == 0));
      group.AddChild(*leaves.back());
    }
  }
  WithChildren<Group> group;
  std::vector<std::unique_ptr<Leaf>> leaves;
};

void BM_RowOfLeavesResized(benchmark::State& state) {
  Tree<Row> tree(static_cast<int>(state.range(0)));
  float width = 40000.0f;
  for (auto _ : state) {
    width = width == 40000.0f ? 40100.0f : 40000.0f;
    benchmark::DoNotOptimize(tree.group.Arrange(RectF(0, 0, width, 30)));
  }
}
BENCHMARK(BM_RowOfLeavesResized)->Arg(1000)->Unit(benchmark::kMicrosecond);

void BM_RowOfLeavesAtTheSameSize(benchmark::State& state) {
  Tree<Row> tree(static_cast<int>(state.range(0)));
  tree.group.Arrange(RectF(0, 0, 40000, 30));
  for (auto _ : state) benchmark::DoNotOptimize(tree.group.Arrange(RectF(0, 0, 40000, 30)));
}
BENCHMARK(BM_RowOfLeavesAtTheSameSize)->Arg(1000)->Unit(benchmark::kMicrosecond);

void BM_HorizontalWrappingRebuiltAndArranged(benchmark::State& state) {
  Tree<HorizontalWrapping> tree(static_cast<int>(state.range(0)));
  tree.group.Arrange(RectF(0, 0, 200, 400));
  for (auto _ : state) {
    tree.group.Invalidate();  // rebuilds every candidate and places once
  }
  state.counters["candidates"] = static_cast<double>(tree.group.Arrangements().size());
}
BENCHMARK(BM_HorizontalWrappingRebuiltAndArranged)->Arg(12)->Arg(16)->Arg(20)->Unit(benchmark::kMillisecond);

}  // namespace
