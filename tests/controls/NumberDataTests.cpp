// Number data: clamping, text round trips that keep hidden digits, steps by
// modifier with the grid snap, and the prop-list form of the format flags.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "controls/NumberRounding.h"
#include "controls/UI_NumberData.h"
#include "tarsel/PropList.h"
#include "tarsel/ThrowError.h"
#include "ui/UI_NodeAdapterBase.h"

namespace norvik::controls::test {
namespace {

namespace tu = tarsel::utility;

UI_NumberData Bounded(double inMin, double inMax, double inValue, int inDecimals = 0) {
  UI_NumberData data;
  data.SetMinMaxValue(inMin, inMax, inValue);
  data.SetDecimalPlaces(inDecimals);
  return data;
}

TEST(NumberDataTest, BoundsClampTheValueAndSetValueSaysWhenItHadTo) {
  UI_NumberData data = Bounded(0, 10, 5);
  data.SetMaxValue(3);
  EXPECT_EQ(data.GetValue(), 3);
  data.SetMaxValue(10);
  EXPECT_TRUE(data.SetValue(11));
  EXPECT_EQ(data.GetValue(), 10);
  EXPECT_FALSE(data.SetValue(-0.0));
  EXPECT_TRUE(data.SetValue(-1));
  EXPECT_EQ(data.GetValue(), 0);
  EXPECT_FALSE(data.SetValue(std::nan("")));
  EXPECT_TRUE(std::isnan(data.GetValue()));
  // A minimum above the maximum wins.
  data.SetMinMaxValue(5, 1, 3);
  EXPECT_EQ(data.GetValue(), 5);
}

TEST(NumberDataTest, RetypingTheShownTextKeepsHiddenDigitsButAnEmptyOldTextStores) {
  UI_NumberData data = Bounded(-100, 100, 1.23456, 2);
  ASSERT_EQ(data.GetText(), u"1.23");
  EXPECT_FALSE(data.SetText(u"1.23"));
  EXPECT_EQ(data.GetValue(), 1.23456);
  EXPECT_TRUE(data.SetText(u"1.5"));
  EXPECT_EQ(data.GetValue(), 1.5);
  EXPECT_TRUE(data.SetTextAndTestChange(u"500"));
  EXPECT_EQ(data.GetValue(), 100);

  UI_NumberData empty = Bounded(0, 10, std::nan(""), 0);
  empty.ShowEmptyForNan(true);
  ASSERT_EQ(empty.GetText(), u"");
  empty.SetText(u"4");
  EXPECT_EQ(empty.GetValue(), 4);
}

TEST(NumberDataTest, CustomSignsAndMinusInfinityReadBackAsTheyAreShown) {
  UI_NumberData data = Bounded(-50, 50, -7, 1);
  data.SetFormatFlags(tu::kNumberFormatAlwaysSign);
  data.SetCustomSignStrings(u"Up ", u"Down ");
  EXPECT_EQ(data.GetText(), u"Down 7.0");
  data.SetValue(7);
  EXPECT_EQ(data.GetText(), u"Up 7.0");
  data.SetText(u"down 3.5");
  EXPECT_EQ(data.GetValue(), -3.5);

  UI_NumberData infinite;
  infinite.ShowNegativeInfinity(true);
  infinite.SetValue(infinite.GetMinValue());
  EXPECT_EQ(infinite.GetText(), u"-\u221E");
  infinite.SetValue(0);
  infinite.SetText(u"-\u221E");
  EXPECT_EQ(infinite.GetValue(), infinite.GetMinValue());
  infinite.SetDecimalPlaces(1000);
  EXPECT_EQ(infinite.GetDecimalPlaces(), UI_NumberData::kMaxDecimalPlaces);
}

TEST(NumberDataTest, StepsStartFromTheShownValueAndLandOnTheNextGridMark) {
  struct Case {
    const char* name;
    double value;
    double steps;
    unsigned char mods;
    double expected;
  };
  const unsigned char shift = UI_NumberData::kShiftModifier, cmd = UI_NumberData::kCmdModifier,
                      option = UI_NumberData::kOptionModifier;
  const Case cases[] = {
      {"up to the next quarter", 1.1, 1, 0, 1.25},
      {"down to the previous quarter", 1.1, -1, 0, 1.0},
      {"shift is a factor of ten", 1, 1, shift, 2.5},
      {"ctrl is a factor of a tenth", 1, 2, cmd, 1.05},
      {"option replaces the step", 2, 1, option, 4},
      {"shift and ctrl combine", 1, 1, shift | cmd, 1.25},
      {"the step starts from the shown digits", 0.996, 1, 0, 1.25},
      {"the bound stops the step", 99.9, 4, shift, 100},
  };
  for (const Case& c : cases) {
    UI_NumberData data = Bounded(-100, 100, c.value, 2);
    data.SetIncrement(0.25);
    data.SetOptionModifierIncrement(2);
    data.SetIsOptionModifierAFactor(false);
    data.IncrementValue(c.steps, c.mods, false);
    EXPECT_NEAR(data.GetValue(), c.expected, 1e-12) << c.name;
  }
}

TEST(NumberDataTest, StepsRaiseDecimalPlacesButNeverLowerThem) {
  UI_NumberData data = Bounded(0, 10, 1, 2);
  data.SetIncrement(0.001);
  data.IncrementValue(1, 0, true);
  EXPECT_EQ(data.GetDecimalPlaces(), 3);
  EXPECT_DOUBLE_EQ(data.GetValue(), 1.001);
  data.SetIncrement(0.5);
  data.IncrementValue(1, 0, true);
  EXPECT_EQ(data.GetDecimalPlaces(), 3);
}

TEST(NumberDataTest, ValuesBeyondTheThirtyTwoBitRangeStillStep) {
  UI_NumberData data;
  data.SetValue(1e10);
  data.IncrementValue(1, 0, false);
  EXPECT_EQ(data.GetValue(), 1e10 + 1);
  data.SetValue(-5e12);
  data.IncrementValue(-3, 0, false);
  EXPECT_EQ(data.GetValue(), -5e12 - 3);
  const double outside[] = {std::nan(""), 3e9, -3e9, std::numeric_limits<double>::infinity()};
  for (double v : outside) EXPECT_EQ(TruncateToInt32(v), std::numeric_limits<std::int32_t>::min()) << v;
  EXPECT_EQ(RoundToInt32(-2.5), -3);
  EXPECT_EQ(TruncateToInt32(-2147483648.9), std::numeric_limits<std::int32_t>::min());
  EXPECT_EQ(TruncateToInt32(2147483647.9), 2147483647);
}

TEST(NumberDataTest, FormatFlagsRoundTripThroughAPropListAndRejectNonBooleans) {
  using ui::UI_NodeAdapterBase;
  tarsel::proplist::PropList list;
  const unsigned short flags = tu::kNumberFormatUseSeparator | tu::kNumberFormatPadSign;
  UI_NodeAdapterBase::NumberFormatFlagsToPropList(flags, list);
  bool normal = true;
  ASSERT_TRUE(list.GetValue("formatNormal", normal));
  EXPECT_FALSE(normal);
  list.SetValue("formatNormal", true);
  list.SetValue("formatUnknown", 7);
  EXPECT_EQ(UI_NodeAdapterBase::NumberFormatFlagsFromPropList(list).Get(), flags);
  list.SetValue("formatAlwaysSign", 1);
  EXPECT_THROW(UI_NodeAdapterBase::NumberFormatFlagsFromPropList(list), tarsel::config::Exception);
}

}  // namespace
}  // namespace norvik::controls::test
