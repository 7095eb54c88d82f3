// Number data and units on the keystroke path: a step of a hot-text field
// goes through its text and back, every paint formats the value, and each
// keystroke in a unit field evaluates the typed expression once.
#include <benchmark/benchmark.h>

#include <cmath>

#include "controls/UI_NumberData.h"
#include "controls/UnitHandlerRegistry.h"
#include "tarsel/StringUtils.h"

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

// Target: at most 10 microseconds, the grammar built from the registered
// mnemonics inside the call as every keystroke builds it.
static void BM_EvaluateUnitExpressionPointField(benchmark::State& state) {
  using namespace norvik::controls;
  const UTF16String text = u"3in + 2cm";
  UTF16String outText;
  double value = 0;
  bool error = false;
  for (auto _ : state) {
    EvaluateUnitExpression(text, kNumberEditUnit_Point, tarsel::utility::kNumberFormatNoLocalization, 2, 12, 1e6,
                           -1e6, true, false, outText, value, error);
    benchmark::DoNotOptimize(value);
  }
  if (error || std::fabs(value - (216 + 144 / 2.54)) > 1e-9) state.SkipWithError("3in + 2cm did not evaluate");
}
BENCHMARK(BM_EvaluateUnitExpressionPointField);
