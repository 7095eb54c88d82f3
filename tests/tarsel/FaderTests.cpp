#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <random>
#include <vector>

#include "tarsel/FaderTranslator.h"
#include "tarsel/ThrowError.h"

using tarsel::utility::FaderTranslator;
using Fader = FaderTranslator<double>;

namespace {

const double kInf = std::numeric_limits<double>::infinity();

// Laws worth checking: the default, unity at the top, a loud top, a gentle
// and a steep curve.
std::vector<boost::intrusive_ptr<Fader>> Laws() {
  return {new Fader(), new Fader(0, 4), new Fader(12, 4), new Fader(6, 1), new Fader(6, 8)};
}

std::vector<double> SortedRandomPositions(unsigned inSeed, int inCount) {
  std::mt19937 random(inSeed);
  std::uniform_real_distribution<double> unit(0.0, 1.0);
  std::vector<double> positions{0.0, 1.0, 1e-12, 1 - 1e-12};
  for (int i = 0; i < inCount; ++i) positions.push_back(unit(random));
  std::sort(positions.begin(), positions.end());
  return positions;
}

}  // namespace

TEST(FaderTranslator, TheEndsAreExact) {
  for (const auto& law : Laws()) {
    EXPECT_EQ(law->GetDecibelValue(0.0), -kInf);
    EXPECT_EQ(law->GetDecibelValue(1.0), law->GetMaximumDecibels());
    EXPECT_EQ(law->GetNormalizedValue(-kInf), 0.0);
    EXPECT_EQ(law->GetNormalizedValue(law->GetMaximumDecibels()), 1.0);
  }
}

TEST(FaderTranslator, ZeroDecibelsSitsExactlyAtTheZeroPosition) {
  for (const auto& law : Laws()) {
    const double zero = law->GetZeroPosition();
    EXPECT_GT(zero, 0.0);
    EXPECT_LE(zero, 1.0);
    EXPECT_EQ(law->GetNormalizedValue(0.0), zero);
    EXPECT_EQ(law->GetDecibelValue(zero), 0.0);
  }
}

TEST(FaderTranslator, TheDefaultLawPutsUnityGainHighOnTheTravel) {
  Fader law;
  EXPECT_EQ(law.GetMaximumDecibels(), 6.0);
  EXPECT_NEAR(law.GetZeroPosition(), 0.841, 0.001);
  EXPECT_NEAR(law.GetNormalizedValue(-20), 0.473, 0.001);
  EXPECT_NEAR(law.GetNormalizedValue(-60), 0.150, 0.001);
  // Each halving of the position costs the same number of decibels.
  EXPECT_NEAR(law.GetDecibelValue(0.4) - law.GetDecibelValue(0.2), law.GetDecibelValue(0.8) - law.GetDecibelValue(0.4),
              1e-9);
}

TEST(FaderTranslator, BothDirectionsRiseMonotonicallyAndSurviveARoundTrip) {
  for (const auto& law : Laws()) {
    double previous = -kInf;
    for (double p : SortedRandomPositions(7, 5000)) {
      const double db = law->GetDecibelValue(p);
      ASSERT_GE(db, previous) << "at position " << p;
      ASSERT_LE(db, law->GetMaximumDecibels());
      if (p > 0.0) {
        ASSERT_NEAR(law->GetNormalizedValue(db), p, 1e-12) << "at position " << p;
      }
      previous = db;
    }
    std::mt19937 random(11);
    std::uniform_real_distribution<double> range(-200.0, law->GetMaximumDecibels() + 10);
    std::vector<double> values{-kInf, -1e300, 0.0, law->GetMaximumDecibels()};
    for (int i = 0; i < 5000; ++i) values.push_back(range(random));
    std::sort(values.begin(), values.end());
    double previousPosition = 0.0;
    for (double db : values) {
      const double p = law->GetNormalizedValue(db);
      ASSERT_GE(p, previousPosition) << "at " << db << " dB";
      ASSERT_LE(p, 1.0);
      if (db >= -120.0 && db <= law->GetMaximumDecibels()) {
        ASSERT_NEAR(law->GetDecibelValue(p), db, 1e-9) << "at " << db << " dB";
      }
      previousPosition = p;
    }
  }
}

TEST(FaderTranslator, ValuesOutsideTheRangeAreClampedToIt) {
  Fader law;
  EXPECT_EQ(law.GetDecibelValue(-0.5), -kInf);
  EXPECT_EQ(law.GetDecibelValue(7.0), 6.0);
  EXPECT_EQ(law.GetDecibelValue(kInf), 6.0);
  EXPECT_EQ(law.GetNormalizedValue(40.0), 1.0);
  EXPECT_EQ(law.GetNormalizedValue(kInf), 1.0);
  EXPECT_GT(law.GetNormalizedValue(-5000.0), 0.0);  // tiny, but still above silence
  EXPECT_LT(law.GetNormalizedValue(-5000.0), 1e-60);
  EXPECT_EQ(law.GetNormalizedValue(-1e6), 0.0);
}

TEST(FaderTranslator, NotANumberRaisesTheToolkitError) {
  Fader law;
  const double nan = std::numeric_limits<double>::quiet_NaN();
  try {
    law.GetDecibelValue(nan);
    FAIL() << "no exception";
  } catch (const tarsel::config::Exception& error) {
    EXPECT_EQ(error.GetKeyPath(), "tarsel/utility/Error/Fader/NotANumber");
  }
  EXPECT_THROW(law.GetNormalizedValue(nan), tarsel::config::Exception);
}

TEST(FaderTranslator, ALawThatCannotWorkIsRefused) {
  const double nan = std::numeric_limits<double>::quiet_NaN();
  EXPECT_THROW(Fader(-1, 4), tarsel::config::Exception);
  EXPECT_THROW(Fader(6, 0), tarsel::config::Exception);
  EXPECT_THROW(Fader(6, -2), tarsel::config::Exception);
  EXPECT_THROW(Fader(kInf, 4), tarsel::config::Exception);
  EXPECT_THROW(Fader(nan, 4), tarsel::config::Exception);
  EXPECT_THROW(Fader(6, nan), tarsel::config::Exception);
}

TEST(FaderTranslator, TheSinglePrecisionLawKeepsTheExactPoints) {
  FaderTranslator<float> law(10.0f, 3.0f);
  EXPECT_EQ(law.GetNormalizedValue(0.0f), law.GetZeroPosition());
  EXPECT_EQ(law.GetDecibelValue(law.GetZeroPosition()), 0.0f);
  EXPECT_EQ(law.GetDecibelValue(1.0f), 10.0f);
  EXPECT_EQ(law.GetDecibelValue(0.0f), -std::numeric_limits<float>::infinity());
}
