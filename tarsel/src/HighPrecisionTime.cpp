#include "tarsel/HighPrecisionTime.h"

#include <chrono>

namespace tarsel::utility {
namespace {

using Clock = std::chrono::steady_clock;
static_assert(Clock::period::num == 1, "the tick frequency must be a whole number of ticks per second");
constexpr std::int64_t kNanosPerSecond = 1000000000;

// inValue * inMultiplier / inDivisor without overflowing in the middle:
// split inValue into whole divisors and a remainder.
std::int64_t Rescale(std::int64_t inValue, std::int64_t inMultiplier, std::int64_t inDivisor) {
  if (inMultiplier == inDivisor) return inValue;
  const std::int64_t whole = inValue / inDivisor;
  const std::int64_t rest = inValue % inDivisor;
  return whole * inMultiplier + rest * inMultiplier / inDivisor;
}

}  // namespace

HighPrecisionTime::Ticks HighPrecisionTime::GetTickCount() {
  return static_cast<Ticks>(Clock::now().time_since_epoch().count());
}

HighPrecisionTime::Ticks HighPrecisionTime::GetFrequency() { return static_cast<Ticks>(Clock::period::den); }

std::int64_t HighPrecisionTime::ConvertToNanos(Ticks inTicks) {
  return Rescale(inTicks, kNanosPerSecond, GetFrequency());
}

HighPrecisionTime::Ticks HighPrecisionTime::ConvertFromNanos(std::int64_t inNanos) {
  return Rescale(inNanos, GetFrequency(), kNanosPerSecond);
}

double HighPrecisionTime::ElapsedSeconds(Ticks inStart, Ticks inEnd) {
  return static_cast<double>(inEnd - inStart) / static_cast<double>(GetFrequency());
}

}  // namespace tarsel::utility
