#include "controls/NumberRounding.h"

#include <cmath>
#include <algorithm>
#include <limits>

namespace norvik::controls {

std::int32_t TruncateToInt32(double inValue) {
  constexpr double kLow = -2147483649.0;  // truncates to the 32-bit minimum at most
  constexpr double kHigh = 2147483648.0;
  // Written so that NaN, which fails every comparison, takes the fallback.
  if (!(inValue > kLow && inValue < kHigh)) return std::numeric_limits<std::int32_t>::min();
  return static_cast<std::int32_t>(inValue);
}

std::int32_t RoundToInt32(double inValue) {
  return TruncateToInt32(inValue >= 0 ? inValue + 0.5 : inValue - 0.5);
}

bool NearlyEqual(double a, double b, double inTolerance) {
  if (a == b) return true;
  // Mirror both when the larger-magnitude value is negative, so that the
  // difference is taken from the side of the larger one.
  const double larger = std::fabs(a) >= std::fabs(b) ? a : b;
  const double smaller = larger == a ? b : a;
  const double hi = larger < 0 ? -larger : larger;
  const double lo = larger < 0 ? -smaller : smaller;
  if (inTolerance == 0) return hi - lo == 0;
  return hi - lo < hi * inTolerance;
}

}  // namespace norvik::controls
