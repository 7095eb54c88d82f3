#pragma once
// A monotonic tick counter for measuring intervals (animation, meter decay,
// timing of work), over std::chrono::steady_clock. Ticks have no fixed
// length: GetFrequency says how many make a second, and the conversions turn
// tick counts into nanoseconds and back without overflowing for any span a
// 64-bit count of nanoseconds can hold.
#include <cstdint>

namespace tarsel::utility {

class HighPrecisionTime {
 public:
  using Ticks = std::int64_t;

  // Ticks since an unspecified start; never goes backwards.
  static Ticks GetTickCount();
  // Ticks per second.
  static Ticks GetFrequency();
  // Rounded towards zero.
  static std::int64_t ConvertToNanos(Ticks inTicks);
  static Ticks ConvertFromNanos(std::int64_t inNanos);
  // Seconds between two tick counts.
  static double ElapsedSeconds(Ticks inStart, Ticks inEnd);
};

}  // namespace tarsel::utility
