// Numbers to text and back: rounding, width, signs, grouping, locale marks and
// the errors of malformed text.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

#include "tarsel/Locale.h"
#include "tarsel/StringUtils.h"
#include "tarsel/ThrowError.h"

using namespace tarsel::utility;
using tarsel::Locale;
using tarsel::ScSetDefaultLocale;

namespace {

constexpr unsigned short kPlain = kNumberFormatNoLocalization;

UTF16String Format(double value, int width, int places, unsigned short flags) {
  return NumberToString(value, width, places, flags | kPlain, 31);
}

std::string KeyPathOfError(std::u16string_view text, unsigned short flags) {
  try {
    StringToNumber(text, flags);
  } catch (const tarsel::config::Exception& e) {
    return e.GetKeyPath();
  }
  return "no error";
}

const Locale kGerman("de_DE", u',', u'.');
const Locale kFrench("fr_FR", u',', u'\u202F');

}  // namespace

TEST(NumberToString, IntegersOfEveryTypeAreExactAndDoublesShortest) {
  EXPECT_EQ(NumberToString(-42L), u"-42");
  EXPECT_EQ(NumberToString(std::numeric_limits<long>::min()), u"-9223372036854775808");
  EXPECT_EQ(NumberToString(3), u"3");
  EXPECT_EQ(NumberToString(std::size_t{18446744073709551615u}), u"18446744073709551615");
  EXPECT_EQ(NumberToString(4000000000u), u"4000000000");
  EXPECT_EQ(NumberToString(-9007199254740993LL), u"-9007199254740993");
  EXPECT_EQ(NumberToString(0.1), u"0.1");
  EXPECT_EQ(NumberToString(1e300), u"1e+300");
  EXPECT_EQ(NumberToString(std::nan("")), u"NaN");
  EXPECT_EQ(NumberToString(-HUGE_VAL), u"-\u221E");
}

// Fixed-point formatting in the plain locale: each row is value, minimum
// width, decimal places, flags and the text.
struct FormatCase {
  double value;
  int width;
  int places;
  unsigned short flags;
  const char16_t* text;
};
constexpr unsigned short kSep = kNumberFormatUseSeparator, kSign = kNumberFormatAlwaysSign,
                         kPad = kNumberFormatPadSign, kNoZeros = kNumberFormatNoTrailingZeros;
const FormatCase kFormatCases[] = {
    // rounding half away from zero on the digits a reader sees
    {1.23456, 0, 2, 0, u"1.23"}, {1.005, 0, 2, 0, u"1.01"}, {2.675, 0, 2, 0, u"2.68"}, {-2.5, 0, 0, 0, u"-3"},
    {0.5, 0, 0, 0, u"1"}, {0.4999, 0, 0, 0, u"0"}, {9.999, 0, 2, 0, u"10.00"}, {99.96, 0, 1, 0, u"100.0"},
    // the fraction padded to the places; negative places round to tens and hundreds
    {1.5, 0, 3, 0, u"1.500"}, {0.001, 0, 4, 0, u"0.0010"}, {123, 0, 0, 0, u"123"}, {1e-7, 0, 2, 0, u"0.00"},
    {1234, 0, -1, 0, u"1230"}, {1250, 0, -2, 0, u"1300"}, {49, 0, -2, 0, u"0"},
    // zero after rounding has no minus sign
    {-0.001, 0, 2, 0, u"0.00"}, {-0.0, 0, 0, 0, u"0"}, {-0.006, 0, 2, 0, u"-0.01"},
    {1.5, 0, 4, kNoZeros, u"1.5"}, {2.0, 0, 4, kNoZeros, u"2"}, {100, 0, 2, kNoZeros, u"100"},
    // minimum width: zeros after the sign, or spaces before it
    {7.5, 6, 1, 0, u"0007.5"}, {-7.5, 6, 1, 0, u"-007.5"}, {-7.5, 6, 1, kNumberFormatLeadingSpaces, u"  -7.5"},
    {12345, 3, 0, 0, u"12345"}, {5, 1, 0, 0, u"5"}, {5, -10, 0, 0, u"5"},
    // signs of numbers that are not negative
    {3, 0, 0, kSign, u"+3"}, {0, 0, 1, kSign, u"+0.0"}, {-3, 0, 0, kSign, u"-3"}, {3, 0, 0, kPad, u" 3"},
    {-3, 0, 0, kPad, u"-3"}, {3, 0, 0, kPad | kSign, u"+3"}, {3, 4, 0, kSign, u"+003"},
    // grouping by three
    {1234567.891, 0, 2, kSep, u"1,234,567.89"}, {-999, 0, 0, kSep, u"-999"}, {-1000, 0, 0, kSep, u"-1,000"},
    {999.9999, 0, 2, kSep, u"1,000.00"},
    // too long for fixed point: scientific
    {1.5e300, 0, 2, 0, u"1.50e+300"}, {-1.5e300, 0, 1, kSep, u"-1.5e+300"}, {1e40, 0, 0, 0, u"1e+40"},
    {2.5e35, 0, 3, kNoZeros, u"2.5e+35"},
    // infinity and NaN as symbols
    {HUGE_VAL, 0, 2, 0, u"\u221E"}, {-HUGE_VAL, 0, 2, 0, u"-\u221E"}, {HUGE_VAL, 0, 2, kSign, u"+\u221E"},
    {std::nan(""), 0, 2, 0, u"NaN"},
};

TEST(NumberToString, RoundsPadsSignsGroupsAndSwitchesToScientificAsEachRowSays) {
  for (const FormatCase& c : kFormatCases) {
    EXPECT_EQ(Format(c.value, c.width, c.places, c.flags), c.text)
        << c.value << " width " << c.width << " places " << c.places << " flags " << c.flags;
  }
  // A hostile width is bounded instead of allocating gigabytes.
  EXPECT_EQ(Format(5, 2000000000, 0, kNumberFormatLeadingSpaces).size(),
            static_cast<std::size_t>(kNumberMaxMinimumWidth));
  // The scientific limit is the caller's: a generous one keeps fixed point.
  EXPECT_EQ(NumberToString(1e40, 0, 0, kPlain, 100).size(), 41u);
  EXPECT_EQ(NumberToString(1e40, 0, 0, kPlain, 0).size(), 41u);
}

TEST(NumberToString, LocalisedFormUsesTheDefaultLocaleMarks) {
  ScSetDefaultLocale german(kGerman);
  EXPECT_EQ(NumberToString(1234.5, 0, 2, kNumberFormatUseSeparator, 31), u"1.234,50");
  EXPECT_EQ(NumberToString(1234.5, 0, 2, kNumberFormatUseSeparator | kPlain, 31), u"1,234.50");
  ScSetDefaultLocale french(kFrench);
  EXPECT_EQ(NumberToString(-1234567, 0, 1, kNumberFormatUseSeparator, 31), u"-1\u202F234\u202F567,0");
}

TEST(NumberToString, TheLargestDoublesKeepTheDigitsTheyNeedToReadBack) {
  // Rounding 1.797...e308 to "1.80e+308" would read back as out of range.
  const double max = std::numeric_limits<double>::max();
  UTF16String text = Format(max, 0, 2, 0);
  EXPECT_EQ(text, u"1.79769e+308");
  EXPECT_NEAR(StringToNumber(text, kPlain), max, max * 1e-5);
  EXPECT_NEAR(StringToNumber(Format(-max, 0, 0, kNumberFormatUseSeparator), kPlain), -max, max * 1e-5);
  EXPECT_EQ(StringToNumber(Format(1.797692920482154e308, 0, 0, 0), kPlain), 1.79769e308);
}

TEST(StringToNumber, ReadsPlainNumbersWithSignsBlanksGroupingAndExponents) {
  EXPECT_DOUBLE_EQ(StringToNumber(u"1.25", kPlain), 1.25);
  EXPECT_DOUBLE_EQ(StringToNumber(u"  -3 ", kPlain), -3);
  EXPECT_DOUBLE_EQ(StringToNumber(u"+.5", kPlain), 0.5);
  EXPECT_DOUBLE_EQ(StringToNumber(u"7.", kPlain), 7);
  EXPECT_DOUBLE_EQ(StringToNumber(u"1,234,567.5", kPlain), 1234567.5);
  EXPECT_DOUBLE_EQ(StringToNumber(u"1.5e3", kPlain), 1500);
  EXPECT_DOUBLE_EQ(StringToNumber(u"2E-2", kPlain), 0.02);
  EXPECT_DOUBLE_EQ(StringToNumber(u"\u22124", kPlain), -4);
  EXPECT_EQ(StringToNumber(u"-\u221E", kPlain), -HUGE_VAL);
}

TEST(StringToNumber, BlankTextHoldsNoNumber) {
  EXPECT_TRUE(std::isnan(StringToNumber(u"", kPlain)));
  EXPECT_TRUE(std::isnan(StringToNumber(u" \t ", 0)));
}

TEST(StringToNumber, MalformedTextRaisesNotANumberWithTheTextInTheMessage) {
  for (const char16_t* bad : {u"abc", u"1.2.3", u"--1", u"+", u"1e", u"1,", u",1", u"1 2", u"0x10", u"inf", u"nan",
                              u"1e+", u"5%", u".", u"\u221E\u221E"}) {
    EXPECT_EQ(KeyPathOfError(bad, kPlain), "tarsel/utility/Error/NotANumber")
        << ToStdString(UTF16to8(bad));
  }
  try {
    StringToNumber(u"12ab", kPlain);
    FAIL() << "no exception";
  } catch (const tarsel::config::Exception& e) {
    EXPECT_STREQ(e.what(), "\"12ab\" is not a number.");
    EXPECT_EQ(e.GetGroup(), tarsel::config::kErrorGroupContract);
    EXPECT_EQ(e.GetCode(), tarsel::config::kErrorCodeConversion);
  }
}

TEST(StringToNumber, EmbeddedNulsAndHugeTextsAreRejectedWithAShortMessage) {
  UTF16String withNul(u"12\0" u"3", 4);
  EXPECT_EQ(KeyPathOfError(withNul, kPlain), "tarsel/utility/Error/NotANumber");
  UTF16String huge(100000, u'9');
  huge += u"x";
  try {
    StringToNumber(huge, kPlain);
    FAIL() << "no exception";
  } catch (const tarsel::config::Exception& e) {
    EXPECT_LT(e.GetMessage().size(), 80u);
  }
}

TEST(StringToNumber, OverflowRaisesOutOfRangeAndUnderflowReadsAsZero) {
  EXPECT_EQ(KeyPathOfError(u"1e400", kPlain), "tarsel/utility/Error/NumberOutOfRange");
  EXPECT_EQ(KeyPathOfError(u"-1e400", kPlain), "tarsel/utility/Error/NumberOutOfRange");
  EXPECT_EQ(StringToNumber(u"1e-400", kPlain), 0.0);
  // Three hundred and ten digits: a long but valid number.
  EXPECT_EQ(KeyPathOfError(UTF16String(310, u'9'), kPlain), "tarsel/utility/Error/NumberOutOfRange");
  EXPECT_DOUBLE_EQ(StringToNumber(UTF16String(300, u'1'), kPlain), 1.1111111111111111e299);
}

TEST(NumberRoundTrip, FormattedTextReadsBackAsTheRoundedValue) {
  std::mt19937 random(20261122);
  std::uniform_real_distribution<double> values(-1e7, 1e7);
  const unsigned short flagSets[] = {0, kNumberFormatUseSeparator, kNumberFormatAlwaysSign | kNumberFormatUseSeparator,
                                     kNumberFormatPadSign, kNumberFormatNoTrailingZeros};
  for (const Locale& locale : {Locale(), kGerman, kFrench}) {
    ScSetDefaultLocale scoped(locale);
    for (int i = 0; i < 300; ++i) {
      double value = values(random);
      int places = i % 5;
      for (unsigned short flags : flagSets) {
        UTF16String text = NumberToString(value, 0, places, flags, 31);
        double back = StringToNumber(text, 0);
        double scale = std::pow(10.0, places);
        ASSERT_NEAR(back, std::round(value * scale) / scale, 0.5 / scale + 1e-9)
            << ToStdString(UTF16to8(text)) << " from " << value;
      }
    }
  }
}

TEST(InternationalizeNum, SwapsMarksInOnePassAndDeInternationalizeUndoesItAndThePlainLocaleLeavesTextAlone) {
  {
    ScSetDefaultLocale german(kGerman);
    UTF16String text = u"1,234.5 + 2.5";
    InternationalizeNum(text);
    EXPECT_EQ(text, u"1.234,5 + 2,5");
    DeInternationalizeNum(text);
    EXPECT_EQ(text, u"1,234.5 + 2.5");
  }
  UTF16String text = u"1,234.5";
  InternationalizeNum(text);
  EXPECT_EQ(text, u"1,234.5") << "the scoped locale was put back";
}

