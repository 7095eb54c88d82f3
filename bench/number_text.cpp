// Number text in hot paths: every hot-text field formats its value on each
// paint and reads it back on each step, and number fields evaluate typed
// arithmetic on each keystroke.
#include <benchmark/benchmark.h>

#include "tarsel/StringUtils.h"

using namespace tarsel::utility;

static void BM_NumberToStringGrouped(benchmark::State& state) {
  double value = -1234567.891;
  for (auto _ : state) {
    benchmark::DoNotOptimize(NumberToString(value, 0, 2, kNumberFormatUseSeparator, 31));
    value += 0.37;
  }
}
BENCHMARK(BM_NumberToStringGrouped);

static void BM_StringToNumberPlain(benchmark::State& state) {
  const UTF16String text = u"-1,234,567.89";
  for (auto _ : state) benchmark::DoNotOptimize(StringToNumber(text, kNumberFormatNoLocalization));
}
BENCHMARK(BM_StringToNumberPlain);

static void BM_CalculateTypedExpression(benchmark::State& state) {
  const UTF16String text = u"=(12.5 + 3) * 4 / 2 - 0.25^2";
  for (auto _ : state) benchmark::DoNotOptimize(Calculate(text, kCalculateNoLocalization));
}
BENCHMARK(BM_CalculateTypedExpression);

// Evaluation cost grows linearly with the length of a flat expression.
static void BM_CalculateLongSum(benchmark::State& state) {
  UTF16String text = u"0";
  for (int i = 0; i < state.range(0); ++i) text += u"+1.5";
  for (auto _ : state) benchmark::DoNotOptimize(Calculate(text, kCalculateNoLocalization));
  state.SetComplexityN(state.range(0));
}
BENCHMARK(BM_CalculateLongSum)->RangeMultiplier(8)->Range(8, 4096)->Complexity(benchmark::oN);
