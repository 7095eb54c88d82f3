// Feeds arbitrary bytes to the evaluator of measured entry fields. The first
// bytes pick the field's unit, the format flags, the decimal places and the
// bounds; the rest is UTF-8 text, broken sequences included. Nothing may be
// thrown, an answer without error must lie within the bounds and be finite,
// and the display text must evaluate again to the same value at its decimals.
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string_view>

#include "controls/UnitHandlerRegistry.h"
#include "tarsel/StringUtils.h"

using namespace norvik::controls;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* inData, std::size_t inSize) {
  if (inSize < 5) return 0;
  const auto unit = static_cast<NumberEditUnit>(inData[0] % 14);
  const unsigned short flags = inData[1] & 63;
  const int decimals = static_cast<int>(inData[2] % 12) - 2;
  static const double kBounds[] = {0, 1, -1, 10.005, -72.5, 1e6, -1e6, 1e300, -1e300, 0.5, 3.25, -0.125};
  const double bound1 = kBounds[inData[3] % 12];
  const double bound2 = kBounds[(inData[3] / 12) % 12];
  const double previous = static_cast<double>(static_cast<std::int8_t>(inData[4]));
  const bool showUnit = (inData[1] & 64) != 0;
  const double minValue = std::fmin(bound1, bound2);
  const double maxValue = std::fmax(bound1, bound2);
  const UTF16String text =
      tarsel::utility::UTF8to16(std::string_view(reinterpret_cast<const char*>(inData + 5), inSize - 5));

  UTF16String outText;
  double value = 0;
  bool error = false;
  EvaluateUnitExpression(text, unit, flags, decimals, previous, maxValue, minValue, showUnit, false, outText, value,
                         error);
  if (!std::isfinite(value)) std::abort();
  if (error) return 0;
  // Negative decimal places round to tens or hundreds: the step is that wide.
  const double step = std::pow(10.0, -decimals);
  // Bounds closer than one shown step cannot both be kept by the rounding.
  if (maxValue - minValue >= step && (value < minValue || value > maxValue)) std::abort();

  // A magnitude beyond the fixed-point text is written in scientific form
  // with fewer digits; only fixed-point texts must read back exactly.
  if (std::fabs(value) >= 1e15) return 0;
  UTF16String againText;
  double again = 0;
  bool againError = false;
  // Read back without bounds: the shown digits may round just past a bound.
  EvaluateUnitExpression(outText, unit, flags, decimals, value, 1e308, -1e308, showUnit, false, againText, again,
                         againError);
  if (againError) std::abort();
  // Picas show their fraction in points, and negative decimal places round to
  // tens: both keep the value to within one shown step. The trip through the
  // base unit and back may move a large value by a few units in the last place.
  const double tolerance =
      (unit == kNumberEditUnit_Pica ? 1.0 / 12 : 1) * std::pow(10.0, -decimals) * 1.0001 + std::fabs(value) * 1e-14;
  if (std::fabs(again - value) > tolerance) std::abort();
  return 0;
}
