// Number data and units on the keystroke path: a step of a hot-text field
// goes through its text and back, every paint formats the value, and each
// keystroke in a unit field evaluates the typed expression once.
#include <benchmark/benchmark.h>

#include "controls/UI_NumberData.h"

using norvik::controls::UI_NumberData;

// Target: at most 1 microsecond per step.
static void BM_NumberDataIncrementValue(benchmark::State& state) {
  UI_NumberData data;
  data.SetMinMaxValue(-1e6, 1e6, 12.5);
  data.SetDecimalPlaces(2);
  data.SetIncrement(0.25);
  double direction = 1;
  for (auto _ : state) {
    data.IncrementValue(direction, UI_NumberData::kShiftModifier, true);
    if (data.GetValue() > 1000 || data.GetValue() < -1000) direction = -direction;
    benchmark::DoNotOptimize(data.GetValue());
  }
}
BENCHMARK(BM_NumberDataIncrementValue);

// Target: at most 0.5 microseconds per text.
static void BM_NumberDataGetText(benchmark::State& state) {
  UI_NumberData data;
  data.SetDecimalPlaces(2);
  double value = -1234.567;
  for (auto _ : state) {
    data.SetValue(value);
    benchmark::DoNotOptimize(data.GetText());
    value += 0.37;
  }
}
BENCHMARK(BM_NumberDataGetText);
