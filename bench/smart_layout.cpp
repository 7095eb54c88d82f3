// A dialog-sized smart layout of about 30 decorators (a message-box-like
// panel: icon beside a column of text lines, a row of sharing buttons,
// margins and centring): its initial size and a placement, as a dialog does
// once when it opens. The leaves keep their rectangles, so what is measured is
// the layout itself and not the nodes it would move.
#include <benchmark/benchmark.h>

#include "layout/SmartLayoutBuilder.h"

namespace {

using namespace norvik::layout;

class Leaf : public SmartLayout {
 public:
  Leaf(float inWidth, float inHeight) : SmartLayout(PointF(inWidth, inHeight)) {}
  void SetLocation(const RectF& inRect) override { mRect = inRect; }
  RectF mRect;
};

SmartLayoutP BuildPanel(int* outDecorators) {
  int count = 0;
  SmartLayoutBuilder text;
  for (int line = 0; line < 6; ++line) {
    text.AddLayout_Bottom(new Leaf(220, 16), false, SmartLayoutBuilder::kSpacingNearEdge);
    text.AddSpacer_Bottom(4, true);
    count += 3;  // the piece, its edge spacer and the gap
  }
  SmartLayoutBuilder buttons;
  for (int b = 0; b < 4; ++b) {
    buttons.AddLayout_Right(new Leaf(72, 22), false, SmartLayoutBuilder::kSpacingCentered);
    buttons.AddSpacer_Right(8, true);
    count += 3;
  }
  SmartLayoutBuilder panel(text.GetLayout());
  panel.AddLayout_Left(new Leaf(32, 32), false, SmartLayoutBuilder::kSpacingNearEdge);
  panel.AddSpacer_Left(12);
  panel.AddLayout_Bottom(buttons.GetLayout(), false, SmartLayoutBuilder::kSpacingNone);
  panel.AddSpacer_AllSides(10);
  panel.HorizontallyCenter();
  count += 4 + 4 + 1 + 2;  // margins are four spacers
  *outDecorators = count;
  return panel.GetLayout();
}

void BM_SmartLayoutInitialSizeAndPlacement(benchmark::State& state) {
  int decorators = 0;
  SmartLayoutP layout = BuildPanel(&decorators);
  float width = 520;
  for (auto _ : state) {
    const PointF size = layout->GetInitialSize();
    layout->SetLocation(RectF(0, 0, size.x + width - 500, size.y + 40));
    width = width == 520 ? 560 : 520;
    benchmark::ClobberMemory();
  }
  state.counters["decorators"] = decorators;
}
BENCHMARK(BM_SmartLayoutInitialSizeAndPlacement);

void BM_SmartLayoutBuildSizeAndPlace(benchmark::State& state) {
  for (auto _ : state) {
    int decorators = 0;
    SmartLayoutP layout = BuildPanel(&decorators);
    const PointF size = layout->GetInitialSize();
    layout->SetLocation(RectF(0, 0, size.x + 20, size.y + 40));
    benchmark::DoNotOptimize(layout.get());
  }
}
BENCHMARK(BM_SmartLayoutBuildSizeAndPlace);

}  // namespace
