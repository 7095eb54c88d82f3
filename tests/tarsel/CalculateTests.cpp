// The arithmetic evaluator of number fields: precedence, signs, unit names,
// locale marks, and the errors of hostile input.
#include <gtest/gtest.h>

#include <cmath>

#include "tarsel/Locale.h"
#include "tarsel/StringUtils.h"
#include "tarsel/ThrowError.h"

using namespace tarsel::utility;

namespace {

double Calc(std::u16string_view text) { return Calculate(text, kCalculateNoLocalization); }

std::string ErrorOf(std::u16string_view text, unsigned short flags = kCalculateNoLocalization) {
  try {
    Calculate(text, flags);
  } catch (const tarsel::config::Exception& e) {
    return e.GetKeyPath();
  }
  return "no error";
}

}  // namespace

// Each row: the text, whether unit names are skipped, and the value.
struct ValueCase {
  const char16_t* text;
  bool units;
  double value;
};
const ValueCase kValueCases[] = {
    // precedence, left to right; power right-associative and tighter than a sign
    {u"1+2*3", false, 7}, {u"(1+2)*3", false, 9}, {u"10-4-3", false, 3}, {u"100/10/5", false, 2},
    {u"2*3-4/8", false, 5.5}, {u"2^3^2", false, 512}, {u"-2^2", false, -4}, {u"2^-1", false, 0.5},
    {u"(-2)^2", false, 4}, {u"4^0.5*3", false, 6},
    // signs, decimals, blanks, typographic operators, grouping, exponents
    {u"-3", false, -3}, {u"--3", false, 3}, {u"+-+3", false, -3}, {u"  1.5 *\t-2  ", false, -3},
    {u".25+.25", false, 0.5}, {u"4 \u00D7 2 \u00F7 8 \u2212 1", false, 0}, {u"1,000+1", false, 1001},
    {u"1.5e2/3", false, 50},
    // equals signs around the expression
    {u"=2*3", false, 6}, {u"2*3=", false, 6}, {u" = 2*3 = ", false, 6},
    // unit names, only when asked
    {u"12pt + 6pt", true, 18}, {u"p6", true, 6}, {u"50%", true, 50}, {u"90\u00B0 / 2", true, 45},
    {u"2em", true, 2}, {u"1e2mm", true, 100},
};

TEST(Calculate, EvaluatesEachRowWithPrecedenceSignsEqualsAndUnitNames) {
  for (const ValueCase& c : kValueCases) {
    const unsigned short flags = kCalculateNoLocalization | (c.units ? kCalculateIgnoreUnitNames : 0);
    EXPECT_DOUBLE_EQ(Calculate(c.text, flags), c.value) << ToStdString(UTF16to8(c.text));
  }
  EXPECT_EQ(ErrorOf(u"2=3"), "tarsel/utility/Error/CalculateSyntax");
  EXPECT_EQ(ErrorOf(u"12pt"), "tarsel/utility/Error/CalculateSyntax");
}

TEST(Calculate, BlankTextHoldsNoNumber) {
  EXPECT_TRUE(std::isnan(Calc(u"")));
  EXPECT_TRUE(std::isnan(Calc(u"   ")));
  EXPECT_TRUE(std::isnan(Calc(u"=")));
}

TEST(Calculate, LocalisedTextUsesTheDefaultLocaleMarks) {
  tarsel::ScSetDefaultLocale german(tarsel::Locale("de_DE", u',', u'.'));
  EXPECT_DOUBLE_EQ(Calculate(u"1,5 * 2", 0), 3);
  EXPECT_DOUBLE_EQ(Calculate(u"1.000,5 + 1", 0), 1001.5);
  EXPECT_DOUBLE_EQ(Calculate(u"1.5 * 2", kCalculateNoLocalization), 3);

  // A blank as grouping mark groups only between digits; blanks around
  // operators stay blanks.
  tarsel::ScSetDefaultLocale blankGroups(tarsel::Locale("xx", u',', u' '));
  EXPECT_DOUBLE_EQ(Calculate(u"1 000 + 2,5", 0), 1002.5);
}

TEST(Calculate, DivisionByZeroOverflowAndUndefinedPowersRaiseTheirOwnErrors) {
  const std::pair<const char16_t*, const char*> cases[] = {
      {u"1/0", "DivisionByZero"},          {u"1/(2-2)", "DivisionByZero"},    {u"0^-1", "DivisionByZero"},
      {u"1e308*10", "CalculateOverflow"},  {u"-1e308-1e308", "CalculateOverflow"},
      {u"10^400", "CalculateOverflow"},    {u"1e999", "NumberOutOfRange"},   {u"(-8)^0.5", "CalculateUndefined"},
  };
  for (const auto& [text, error] : cases) {
    EXPECT_EQ(ErrorOf(text), std::string("tarsel/utility/Error/") + error) << ToStdString(UTF16to8(text));
  }
  try {
    Calc(u"5/0");
    FAIL() << "no exception";
  } catch (const tarsel::config::Exception& e) {
    EXPECT_STREQ(e.what(), "Division by zero.");
  }
}

TEST(Calculate, MalformedTextRaisesASyntaxErrorWithItsPosition) {
  for (const char16_t* bad : {u"1+", u"*2", u"(1+2", u"1+2)", u"()", u"1 2", u"1..2", u"abc", u"1+*2", u"2^", u"1e",
                              u"\u221E", u"1,", u")("}) {
    EXPECT_EQ(ErrorOf(bad), "tarsel/utility/Error/CalculateSyntax") << ToStdString(UTF16to8(bad));
  }
  try {
    Calc(u"1 + x");
    FAIL() << "no exception";
  } catch (const tarsel::config::Exception& e) {
    EXPECT_STREQ(e.what(), "The expression \"1 + x\" cannot be read at position 5.");
  }
  EXPECT_EQ(ErrorOf(UTF16String(u"1+\0" u"2", 4)), "tarsel/utility/Error/CalculateSyntax") << "embedded nul";
}

TEST(Calculate, DeepNestingRaisesInsteadOfExhaustingTheStack) {
  const std::size_t deep = 100000;
  UTF16String parens = UTF16String(deep, u'(') + u"1" + UTF16String(deep, u')');
  EXPECT_EQ(ErrorOf(parens), "tarsel/utility/Error/CalculateTooDeep");
  EXPECT_EQ(ErrorOf(UTF16String(deep, u'-') + u"1"), "tarsel/utility/Error/CalculateTooDeep");
  UTF16String powers = u"1";
  for (int i = 0; i < 20000; ++i) powers += u"^1";
  EXPECT_EQ(ErrorOf(powers), "tarsel/utility/Error/CalculateTooDeep");

  // Nesting within the limit still evaluates.
  const std::size_t fine = kCalculateMaxDepth - 1;
  EXPECT_DOUBLE_EQ(Calc(UTF16String(fine, u'(') + u"7" + UTF16String(fine, u')')), 7);
}

TEST(Calculate, LongFlatExpressionsEvaluateWithoutDepth) {
  UTF16String sum = u"0";
  for (int i = 0; i < 50000; ++i) sum += u"+1";
  EXPECT_DOUBLE_EQ(Calc(sum), 50000);
}

