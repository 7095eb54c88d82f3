// The grammar of typed unit expressions, built at each call from the
// mnemonics registered at that moment: a number with an optional unit, and at
// most one operator with a second such operand. There is no precedence and no
// parenthesis, so a sum of three numbers does not parse.
#include <algorithm>
#include <cmath>
#include <cstddef>
#include <exception>
#include <string>

#include <boost/spirit/include/classic_core.hpp>
#include <boost/spirit/include/classic_functor_parser.hpp>

#include "controls/UnitHandlerRegistry.h"
#include "tarsel/StringUtils.h"

namespace norvik::controls {

namespace tu = tarsel::utility;
namespace sp = boost::spirit::classic;

namespace {

struct UnitName {
  std::string text;
  NumberEditUnit unit;
};

// Tries its names in order at the scan position; the first that matches wins.
struct NameMatcher {
  using result_t = NumberEditUnit;
  const std::vector<UnitName>* names;

  template <typename ScannerT>
  std::ptrdiff_t operator()(const ScannerT& scan, result_t& outUnit) const {
    for (const UnitName& name : *names) {
      auto it = scan.first;
      std::size_t matched = 0;
      while (matched < name.text.size() && it != scan.last && *it == name.text[matched]) {
        ++it;
        ++matched;
      }
      if (matched != name.text.size() || matched == 0) continue;
      scan.first = it;
      outUnit = name.unit;
      return static_cast<std::ptrdiff_t>(matched);
    }
    return -1;
  }
};

struct Operand {
  double number = 0;
  NumberEditUnit unit = kNumberEditUnit_NoUnit;
  double points = 0;
};

void AddNames(const UnitHandlerBase& inHandler, std::vector<UnitName>& ioNames) {
  for (const UTF16String& mnemonic : inHandler.GetUnitMnemonics())
    if (!mnemonic.empty()) ioNames.push_back({tu::UTF16to8(mnemonic).c_str(), inHandler.GetUnit()});
}

// Longer names that extend a shorter one ("centimeters", "centimeter") sort
// above it in descending order, so they are tried first.
void SortDescending(std::vector<UnitName>& ioNames) {
  std::stable_sort(ioNames.begin(), ioNames.end(),
                   [](const UnitName& a, const UnitName& b) { return a.text > b.text; });
}

UTF8String NormalisedText(const UTF16String& inText) {
  UTF16String text = inText;
  tu::DeInternationalizeNum(text);
  tu::ReplaceAllStringInString(text, u",", u"");
  const auto blank = [](char16_t c) { return c == u' ' || c == u'\t'; };
  std::size_t begin = 0, end = text.size();
  while (begin < end && blank(text[begin])) ++begin;
  while (end > begin && blank(text[end - 1])) --end;
  text = text.substr(begin, end - begin);
  tu::ToLowerCase(text);
  return tu::UTF16to8(text);
}

}  // namespace

bool UnitHandlerRegistry::CalculateToBaseUnit(const UTF16String& inText, NumberEditUnit inUnit,
                                              double inPreviousBase, double& outResult) const {
  try {
    const UTF8String text = NormalisedText(inText);
    std::vector<UnitName> names;
    std::vector<UnitName> picaNames;
    if (inUnit == kNumberEditUnit_Percent || inUnit == kNumberEditUnit_Degree) {
      if (const UnitHandlerP handler = GetUnitHandler(inUnit)) AddNames(*handler, names);
    } else if (inUnit != kNumberEditUnit_NoUnit) {
      for (const UnitHandlerP& handler : mHandlers) {
        if (handler->GetUnit() == kNumberEditUnit_NoUnit) continue;
        AddNames(*handler, handler->GetUnit() == kNumberEditUnit_Pica ? picaNames : names);
      }
      std::stable_sort(picaNames.begin(), picaNames.end(),
                       [](const UnitName& a, const UnitName& b) { return a.text.size() > b.text.size(); });
    }
    SortDescending(names);

    Operand first, second;
    char op = 0;
    const auto setOp = [&op](char c) { op = c; };
    const auto operation = sp::ch_p('+')[setOp] | sp::ch_p('-')[setOp] | sp::ch_p('*')[setOp] | sp::ch_p('/')[setOp];
    const sp::functor_parser<NameMatcher> unitName(NameMatcher{&names});
    const sp::functor_parser<NameMatcher> picaName(NameMatcher{&picaNames});
    const auto ws = *sp::blank_p;
    const auto number = [](Operand& o) { return sp::real_p[([&o](double v) { o.number = v; })]; };
    const auto unitOf = [](Operand& o) { return [&o](NumberEditUnit u) { o.unit = u; }; };
    const auto pointsOf = [](Operand& o) { return [&o](double v) { o.points = v; }; };

    const char* begin = text.data();
    const char* end = begin + text.size();
    bool parsed = false;
    if (inUnit == kNumberEditUnit_NoUnit) {
      parsed = sp::parse(begin, end, ws >> number(first) >> !(ws >> operation >> ws >> number(second)) >> ws).full;
    } else if (inUnit == kNumberEditUnit_Percent || inUnit == kNumberEditUnit_Degree) {
      parsed = sp::parse(begin, end,
                         ws >> number(first) >> ws >> !unitName[unitOf(first)] >>
                             !(ws >> operation >> ws >> number(second) >> ws >> !unitName[unitOf(second)]) >> ws)
                   .full;
    } else {
      parsed = sp::parse(begin, end,
                         ws >> number(first) >> ws >>
                             !(unitName[unitOf(first)] |
                               (picaName[unitOf(first)] >> ws >> !sp::ureal_p[pointsOf(first)])) >>
                             !(ws >> operation >> ws >> number(second) >> ws >>
                               !(unitName[unitOf(second)] |
                                 (picaName[unitOf(second)] >> ws >> !sp::ureal_p[pointsOf(second)]))) >>
                             ws)
                   .full;
    }
    if (!parsed) return false;

    for (Operand* operand : {&first, &second})
      if (operand->unit == kNumberEditUnit_NoUnit) operand->unit = mUnitForNumbersWithoutUnits;
    for (Operand* operand : {&first, &second}) {
      if (operand->unit != kNumberEditUnit_Pica) continue;
      const UnitHandlerP pica = GetUnitHandler(kNumberEditUnit_Pica);
      if (!pica) return false;
      // "-0p6" is six points below zero: the sign of a negative zero counts.
      const double points = std::signbit(operand->number) ? -operand->points : operand->points;
      operand->number = pica->ToBaseUnit(operand->number) + points;
      operand->unit = kNumberEditUnit_Point;
    }

    double value = first.number;
    NumberEditUnit unit = first.unit;
    bool ok = true;
    switch (op) {
      case '+': ok = AddNumbers(first.number, second.number, first.unit, second.unit, inUnit, value, unit); break;
      case '-': ok = SubtractNumbers(first.number, second.number, first.unit, second.unit, inUnit, value, unit); break;
      case '*': ok = MultiplyNumbers(first.number, second.number, first.unit, second.unit, inUnit, value, unit); break;
      case '/': ok = DivideNumbers(first.number, second.number, first.unit, second.unit, inUnit, value, unit); break;
      default: break;
    }
    if (!ok) return false;

    if (unit == kNumberEditUnit_NoUnit) unit = inUnit;
    if (unit == kNumberEditUnit_Percent && inUnit != kNumberEditUnit_Percent) {
      value = value * inPreviousBase / 100;
    } else if (const UnitHandlerP handler = GetUnitHandler(unit); handler && handler->CanConvertFromBase()) {
      value = handler->ToBaseUnit(value);
    }
    outResult = value;
    return true;
  } catch (const std::exception&) {
    // Text from a user never escapes as an exception: it simply does not parse.
    return false;
  }
}

void EvaluateUnitExpression(const UTF16String& inText, NumberEditUnit inUnit, tu::Flags<unsigned short> inFlags,
                            int inDecimals, double inPreviousValue, double inMaxValue, double inMinValue,
                            bool inShowUnit, bool inConvertOnError, UTF16String& outText, double& outValue,
                            bool& outError) {
  const UnitHandlerRegistry& registry = UnitHandlerRegistry::Get();
  const UnitHandlerP handler = registry.GetUnitHandler(inUnit);
  const NumberEditUnit unit = handler ? inUnit : kNumberEditUnit_NoUnit;
  const bool converts = handler && handler->CanConvertFromBase();
  const int decimals = std::clamp(inDecimals, -300, 300);
  const double previous = std::isfinite(inPreviousValue) ? inPreviousValue : 0;
  const double previousBase = converts && !inConvertOnError ? handler->ToBaseUnit(previous) : previous;
  // The previous value as the field shows it.
  const double fallback = converts && inConvertOnError ? handler->FromBaseUnit(previous) : previous;

  double value = previous;
  const bool parsed = registry.CalculateToBaseUnit(inText, unit, previousBase, value);
  outError = !parsed;
  if (!parsed) {
    value = fallback;
  } else if (converts) {
    value = handler->FromBaseUnit(value);
  }
  if (!std::isfinite(value)) {
    value = fallback;
    outError = true;
  }

  if (value > inMaxValue) {
    value = inMaxValue;
    outError = true;
  }
  if (value < inMinValue) {
    value = inMinValue;
    outError = true;
  }

  if (inUnit != kNumberEditUnit_Pica && inUnit != kNumberEditUnit_Percent) {
    // At a bound, round toward the inside so that the digits shown never
    // pass it.
    if (value >= inMaxValue) {
      const double f = std::pow(10.0, decimals);
      if (std::isfinite(f * value))
        value = value >= 0 ? std::trunc(f * value + 0.0001) / f : -std::trunc(-f * value + 0.9999) / f;
    }
    if (value <= inMinValue) {
      const double f = std::pow(10.0, std::max(decimals, 0));
      if (std::isfinite(f * value))
        value = value >= 0 ? std::trunc(f * value + 0.9999) / f : std::trunc(f * value) / f;
    }
  }
  if (!std::isfinite(value)) {
    value = 0;
    outError = true;
  }
  outValue = value;
  outText = handler ? handler->GetFormattedString(value, decimals, inFlags, inShowUnit)
                    : tu::NumberToString(value, 0, decimals, inFlags, 31);
}

}  // namespace norvik::controls
