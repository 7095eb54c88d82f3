#include <gtest/gtest.h>

#include <chrono>
#include <cstdint>
#include <limits>
#include <thread>

#include "tarsel/HighPrecisionTime.h"

using tarsel::utility::HighPrecisionTime;

TEST(HighPrecisionTime, ASleepMeasuresAtLeastItsLength) {
  const auto start = HighPrecisionTime::GetTickCount();
  std::this_thread::sleep_for(std::chrono::milliseconds(20));
  const auto end = HighPrecisionTime::GetTickCount();
  EXPECT_GE(HighPrecisionTime::ConvertToNanos(end - start), 20'000'000);
  EXPECT_GE(HighPrecisionTime::ElapsedSeconds(start, end), 0.020);
}

TEST(HighPrecisionTime, OneSecondOfTicksIsOneBillionNanoseconds) {
  const auto frequency = HighPrecisionTime::GetFrequency();
  EXPECT_GT(frequency, 0);
  EXPECT_EQ(HighPrecisionTime::ConvertToNanos(frequency), 1'000'000'000);
  EXPECT_EQ(HighPrecisionTime::ConvertFromNanos(1'000'000'000), frequency);
  EXPECT_EQ(HighPrecisionTime::ConvertToNanos(-3 * frequency), -3'000'000'000LL);
}

TEST(HighPrecisionTime, ConversionsRoundTripAndDoNotOverflowForLongSpans) {
  // A century of nanoseconds is near the top of what 64 bits hold.
  const std::int64_t century = 100LL * 365 * 24 * 3600 * 1'000'000'000LL;
  for (std::int64_t nanos : {std::int64_t(0), std::int64_t(1), std::int64_t(999'999'999), century, -century}) {
    const auto ticks = HighPrecisionTime::ConvertFromNanos(nanos);
    const auto back = HighPrecisionTime::ConvertToNanos(ticks);
    // One tick is the finest step: the round trip loses less than one.
    EXPECT_LE(std::llabs(back - nanos), 1'000'000'000LL / HighPrecisionTime::GetFrequency()) << nanos;
    EXPECT_EQ(nanos >= 0, back >= 0);
  }
}
