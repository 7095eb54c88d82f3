// Units and typed expressions: what a user may type into a measured field,
// the unit rules of the four operations, the toolkit's own units and an
// application's additions, and custom units that notify their fields.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "controls/UnitHandlerRegistry.h"
#include "tarsel/Locale.h"
#include "tarsel/StringUtils.h"

namespace norvik::controls::test {
namespace {

constexpr auto kNone = kNumberEditUnit_NoUnit, kPt = kNumberEditUnit_Point, kIn = kNumberEditUnit_Inch,
               kPica = kNumberEditUnit_Pica, kPct = kNumberEditUnit_Percent, kDeg = kNumberEditUnit_Degree;

struct Evaluated { UTF16String text; double value = 0; bool error = false; };

Evaluated Evaluate(const UTF16String& inText, NumberEditUnit inUnit, double inPrevious = 7, int inDecimals = 2,
                   double inMin = -1e6, double inMax = 1e6) {
  Evaluated result;
  EvaluateUnitExpression(inText, inUnit, tarsel::utility::kNumberFormatNoLocalization, inDecimals, inPrevious, inMax,
                         inMin, true, false, result.text, result.value, result.error);
  return result;
}

class UnitExpressionTest : public ::testing::Test {
 protected:
  // Tests that replace handlers put the toolkit's own back.
  ~UnitExpressionTest() override {
    UnitHandlerRegistry::Get().Reset(), UnitHandlerRegistry::Get().RegisterDefaultUnitHandlers();
  }
};

TEST_F(UnitExpressionTest, TypedTextEvaluatesByTheUnitsTheFieldKnows) {
  // The value is the previous one, 7, where the text is an error.
  struct Case { const char16_t* text; NumberEditUnit unit; double value; bool error; };
  const Case cases[] = {
      {u"50%", kPt, 3.5, false},           {u"1 + 2 + 3", kPt, 7, true},
      {u"1,234.5", kPt, 1234.5, false},     {u"1p6", kPt, 18, false},
      {u"-1p6", kPt, -18, false},           {u"-0p6", kPt, -6, false},
      {u"1 picas", kPt, 12, false},
      {u"10 / 0", kPt, 7, true},            {u"2in * 3", kPt, 432, false},
      {u"2in * 3in", kPt, 7, true},         {u"3in + 2cm", kPt, 216 + 144 / 2.54, false},
      {u"1 centimeters", kPt, 72 / 2.54, false}, {u"1cm", kDeg, 7, true},
      {u"45\u00B0", kDeg, 45, false},        {u"1cm", kNone, 7, true},
      {u"2 * 3", kNone, 6, false},           {u"  2 \"  ", kIn, 2, false},
      {u"36pt", kIn, 0.5, false},            {u"1.5", kPica, 1.5, false},
      {u"", kPt, 7, true},                   {u"1e999", kPt, 7, true},
      {u"nan", kPt, 7, true},                {u"inf", kPt, 7, true},
      {u"in", kPt, 7, true},                 {u"2 in in", kPt, 7, true},
      {u"+-+-5", kPt, 7, true},              {u"2 %%", kPt, 7, true},
      {u"1\xD800", kPt, 7, true},            {u"1e308 * 10", kPt, 7, true},
  };
  for (const Case& c : cases) {
    const Evaluated got = Evaluate(c.text, c.unit);
    const std::string row = tarsel::utility::UTF16to8(c.text).c_str();
    EXPECT_EQ(got.error, c.error) << row;
    EXPECT_NEAR(got.value, c.value, 1e-9) << row;
  }
  EXPECT_TRUE(Evaluate(UTF16String(100000, u'9'), kPt).error);
  EXPECT_TRUE(Evaluate(UTF16String{u'1', u'\0', u'2'}, kPt).error);
}

TEST_F(UnitExpressionTest, FiftyPercentIsHalfThePreviousValueAndCommasAreHarmlessInAnyLocale) {
  EXPECT_EQ(Evaluate(u"50%", kPt, 20).value, 10);
  tarsel::ScSetDefaultLocale german(tarsel::Locale("de_DE", u',', u'.'));
  EXPECT_EQ(Evaluate(u"1.234,5", kPt).value, 1234.5);
  EXPECT_EQ(Evaluate(u"2,5in", kPt).value, 180);
}

TEST_F(UnitExpressionTest, ValuesAtABoundAreRoundedTowardTheInsideAndFlagged) {
  const Evaluated high = Evaluate(u"20", kPt, 0, 2, -5, 10.005);
  EXPECT_TRUE(high.error);
  EXPECT_EQ(high.value, 10.0);
  EXPECT_EQ(high.text, u"10.00 pt");
  EXPECT_EQ(Evaluate(u"-20", kPt, 0, 1, -3.456, 10).value, -3.4);
  EXPECT_EQ(Evaluate(u"0", kPt, 0, 2, 1.234, 10).value, 1.24);
  EXPECT_EQ(Evaluate(u"5", kPt, 0, 2, -10, -1.005).value, -1.01);
  // A NaN previous value counts as zero.
  const Evaluated nan = Evaluate(u"junk", kPt, std::nan(""));
  EXPECT_TRUE(nan.error);
  EXPECT_EQ(nan.value, 0);
}

TEST_F(UnitExpressionTest, EachRowOfThePercentTableAppliesItsRule) {
  enum Op { kAdd, kSub, kMul, kDiv };
  struct Case { const char* name; Op op; double a, b; NumberEditUnit unitA, unitB, target;
                bool ok; double result; NumberEditUnit unit; };
  const Case cases[] = {
      {"dividing by zero fails", kDiv, 1, 0, kNone, kNone, kNone, false, 0, kNone},
      {"no target unit: plain sum", kAdd, 2, 3, kIn, kPct, kNone, true, 5, kNone},
      {"degree target: plain product", kMul, 2, 3, kIn, kIn, kDeg, true, 6, kDeg},
      {"percent target, both percent, sum", kSub, 10, 4, kPct, kPct, kPct, true, 6, kPct},
      {"percent target, both percent, product", kMul, 10, 4, kPct, kPct, kPct, false, 0, kNone},
      {"percent target, percent first, added", kAdd, 10, 100, kPct, kPt, kPct, true, 110, kPt},
      {"percent target, percent first, subtracted", kSub, 10, 100, kPct, kPt, kPct, true, -90, kPt},
      {"percent target, percent first, multiplied", kMul, 10, 100, kPct, kPt, kPct, true, 1000, kPct},
      {"percent target, percent first, divided", kDiv, 10, 100, kPct, kPt, kPct, true, 0.1, kPct},
      {"percent target otherwise", kAdd, 100, 10, kPt, kPct, kPct, true, 110, kPct},
      {"percent second, added", kAdd, 100, 10, kPt, kPct, kPt, true, 110, kPt},
      {"percent second, subtracted", kSub, 100, 10, kPt, kPct, kPt, true, 90, kPt},
      {"percent second, multiplied", kMul, 100, 10, kPt, kPct, kPt, true, 10, kPt},
      {"percent second, divided", kDiv, 100, 10, kPt, kPct, kPt, true, 1000, kPt},
      {"percent first, added", kAdd, 10, 100, kPct, kPt, kPt, true, 110, kPt},
      {"percent first, subtracted", kSub, 10, 100, kPct, kPt, kPt, true, -90, kPt},
      {"percent first, multiplied", kMul, 10, 100, kPct, kPt, kPt, true, 10, kPt},
      {"percent first, divided", kDiv, 10, 100, kPct, kPt, kPt, false, 0, kNone},
      {"both percent, added", kAdd, 10, 5, kPct, kPct, kPt, true, 15, kPct},
      {"both percent, divided", kDiv, 10, 5, kPct, kPct, kPt, false, 0, kNone},
      {"a bare number takes the other's unit", kAdd, 1, 1, kIn, kNone, kPt, true, 144, kPt},
      {"lengths add in points", kSub, 1, 36, kIn, kPt, kPt, true, 36, kPt},
      {"a length times a number", kMul, 2, 3, kIn, kNone, kPt, true, 432, kPt},
      {"a length times a length fails", kMul, 2, 3, kIn, kIn, kPt, false, 0, kNone},
      {"a length divided by a number", kDiv, 2, 2, kIn, kNone, kPt, true, 72, kPt},
      {"a number divided by a length stays bare", kDiv, 2, 4, kNone, kIn, kPt, true, 0.5, kNone},
      {"a length divided by a length fails", kDiv, 2, 1, kIn, kIn, kPt, false, 0, kNone},
  };
  using Operation = bool (UnitHandlerRegistry::*)(double, double, NumberEditUnit, NumberEditUnit, NumberEditUnit,
                                                   double&, NumberEditUnit&) const;
  const Operation operations[] = {&UnitHandlerRegistry::AddNumbers, &UnitHandlerRegistry::SubtractNumbers,
                                  &UnitHandlerRegistry::MultiplyNumbers, &UnitHandlerRegistry::DivideNumbers};
  for (const Case& c : cases) {
    double result = 0;
    NumberEditUnit unit = kNone;
    const bool ok = (UnitHandlerRegistry::Get().*operations[c.op])(c.a, c.b, c.unitA, c.unitB, c.target, result, unit);
    EXPECT_EQ(ok, c.ok) << c.name;
    if (!ok || !c.ok) continue;
    EXPECT_DOUBLE_EQ(result, c.result) << c.name;
    EXPECT_EQ(unit, c.unit) << c.name;
  }
}

TEST_F(UnitExpressionTest, DefaultUnitsFormatConvertAndStepAsTheirTablesSay) {
  UnitHandlerRegistry& registry = UnitHandlerRegistry::Get();
  std::vector<int> order;
  for (const UnitHandlerP& handler : registry.GetUnitHandlers()) order.push_back(handler->GetUnit());
  EXPECT_EQ(order, (std::vector<int>{1, 2, 4, 3, 8, 11, 10, 6, 5, 7}));
  const UnitHandlerP cm = registry.GetUnitHandler(u"3 Centimetres");
  ASSERT_TRUE(cm);
  EXPECT_EQ(cm->GetUnit(), kNumberEditUnit_CM);
  EXPECT_EQ(cm->GetUnitDescription(), u"centimeter");
  EXPECT_DOUBLE_EQ(cm->ToBaseUnit(2.54), 72);
  EXPECT_EQ(registry.GetNativeUnitFromString(u"NumberEditUnit_Ha"), kNumberEditUnit_Ha);

  const UnitHandlerP inch = registry.GetUnitHandler(kIn);
  EXPECT_EQ(inch->GetIncrements(0), UnitIncrements());
  EXPECT_EQ(inch->GetIncrements(2), UnitIncrements(0.1, 10, 0.6, 1));
  EXPECT_EQ(inch->GetIncrements(9), UnitIncrements(0.125, 8, 0.5, 1));
  EXPECT_EQ(registry.GetUnitHandler(kNumberEditUnit_MM)->GetIncrements(1), UnitIncrements(1, 10, 0.5, 1));

  EXPECT_EQ(inch->GetFormattedString(2, 1, 1, true), u"2.0 in");
  EXPECT_EQ(registry.GetUnitHandler(kNumberEditUnit_Q)->GetFormattedString(3, 0, 1, true), u"3 Q");
  EXPECT_EQ(registry.GetUnitHandler(kPct)->GetFormattedString(50, 0, 1, true), u"50%");
  const UnitHandlerP pica = registry.GetUnitHandler(kPica);
  const std::pair<double, const char16_t*> picas[] = {{1.5, u"1p6"}, {-1.5, u"-1p6"}, {-0.25, u"-0p3"}, {2, u"2p0"}};
  for (const auto& [value, text] : picas) EXPECT_EQ(pica->GetFormattedString(value, 0, 1, false), text) << value;
  EXPECT_EQ(pica->ToBaseUnitFromString(u"2pica3"), 27);
  double points = 0;
  EXPECT_EQ(registry.ConvertToBaseString(u"1in", kPt, points), u"72.0000");
}

TEST_F(UnitExpressionTest, AnApplicationsHandlerIsUnderstoodAtTheNextCall) {
  UnitHandlerData feet;
  feet.mnemonics = {u"FT", u"feet"}, feet.numerator = 864, feet.unit = static_cast<NumberEditUnit>(20);
  EXPECT_TRUE(Evaluate(u"2ft", kPt).error);
  UnitHandlerRegistry::Get().RegisterUnitHandler(std::make_shared<CommonUnitHandler>(feet));
  EXPECT_EQ(Evaluate(u"2ft + 1in", kPt).value, 1800);
  UnitHandlerRegistry::Get().Reset();
  EXPECT_EQ(Evaluate(u"1p6", kPt).text, u"7.00") << "no pica handler, no picas";
}

TEST_F(UnitExpressionTest, ACustomUnitsChangeNotifiesItsListenersInOrder) {
  UnitHandlerRegistry& registry = UnitHandlerRegistry::Get();
  const auto ruler = static_cast<CustomNumberEditUnit>(3);
  std::vector<std::string> heard;
  UnitsChangeFunction first = [&](CustomNumberEditUnit) { heard.push_back("first"); };
  UnitsChangeFunction second = [&](CustomNumberEditUnit inUnit) {
    heard.push_back("second " + std::to_string(registry.GetNativeUnit(inUnit)));
    registry.DeregisterNotifyUnitsChange(&first, ruler);
  };
  UnitsChangeFunction third = [&](CustomNumberEditUnit) { heard.push_back("third"); };
  UnitsChangeFunction empty;
  for (const UnitsChangeFunction* f : {&empty, &second, &first, &second, &third})
    registry.RegisterNotifyUnitsChange(f, ruler);
  registry.SetCustomUnitFromString(ruler, u"Ruler");
  registry.SetNativeUnit(ruler, kIn);
  EXPECT_EQ(heard, (std::vector<std::string>{"second 2", "third"}));
  EXPECT_EQ(registry.GetNativeUnitFromString(u"Ruler"), kIn);

  registry.DeregisterNotifyUnitsChange(&second, ruler), registry.DeregisterNotifyUnitsChange(&third, ruler);
  registry.RegisterNotifyUnitsChange(&first, ruler), first.clear();
  try {
    registry.SendUnitsChangeMessage(ruler);
    ADD_FAILURE() << "an emptied listener was called silently";
  } catch (const boost::bad_function_call& e) {
    EXPECT_STREQ(e.what(), "call to empty boost::function");
  }
  registry.DeregisterNotifyUnitsChange(&first, ruler);
}

}  // namespace
}  // namespace norvik::controls::test
