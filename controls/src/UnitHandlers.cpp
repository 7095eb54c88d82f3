#include "controls/UnitHandlers.h"

#include <cmath>

#include "tarsel/Localizer.h"
#include "tarsel/StringUtils.h"

namespace norvik::controls {

namespace tu = tarsel::utility;

namespace {

constexpr int kMaxFixedLength = 31;

UTF16String Localized(const UTF16String& inText) {
  return tarsel::config::Localize(tu::UTF16to8(inText));
}

void ReplaceFirst(UTF16String& ioText, std::u16string_view inFrom, const UTF16String& inTo) {
  const std::size_t at = ioText.find(inFrom.data(), 0, inFrom.size());
  if (at != UTF16String::npos) ioText.replace(at, inFrom.size(), inTo);
}

// Blank text reads as nothing, so "p6" and "1p" are whole picas and points.
double CalculateOrZero(std::u16string_view inText) {
  const double value = tu::Calculate(inText, tu::kCalculateIgnoreUnitNames);
  return std::isnan(value) ? 0 : value;
}

}  // namespace

CommonUnitHandler::CommonUnitHandler(const UnitHandlerData& inData) : mData(inData) {
  for (UTF16String& mnemonic : mData.mnemonics) tu::ToLowerCase(mnemonic);
  mData.placementFormat = Localized(mData.placementFormat);
  mData.description = Localized(mData.description);
}

bool CommonUnitHandler::StringHasUnit(const UTF16String& inText) const {
  const UTF16String lower = tu::LowerCase(inText);
  for (const UTF16String& mnemonic : mData.mnemonics)
    if (!mnemonic.empty() && lower.find(mnemonic) != UTF16String::npos) return true;
  return false;
}

double CommonUnitHandler::ToBaseUnitFromString(const UTF16String& inText) const {
  return ToBaseUnit(tu::Calculate(inText, tu::kCalculateIgnoreUnitNames));
}

double CommonUnitHandler::ToBaseUnit(double inValue) const {
  return static_cast<double>(mData.numerator) * inValue / static_cast<double>(mData.denominator);
}

double CommonUnitHandler::FromBaseUnit(double inValue) const {
  return static_cast<double>(mData.denominator) * inValue / static_cast<double>(mData.numerator);
}

double CommonUnitHandler::ConvertValue(double, double b) const { return b; }

void CommonUnitHandler::GetUnitFormattedMnemonic(UTF16String& outMnemonic) const {
  outMnemonic = mData.mnemonics.empty() ? UTF16String() : mData.mnemonics.front();
}

UTF16String CommonUnitHandler::GetFormattedString(double inValue, int inDecimals, FormatFlags inFlags,
                                                  bool inShowUnit) const {
  UTF16String number = tu::NumberToString(inValue, 0, inDecimals, inFlags, kMaxFixedLength);
  if (!inShowUnit || mData.placementFormat.empty() || mData.mnemonics.empty()) return number;
  UTF16String text = mData.placementFormat;
  UTF16String mnemonic;
  GetUnitFormattedMnemonic(mnemonic);
  tu::InternationalizeNum(number);
  ReplaceFirst(text, u"#", number);
  ReplaceFirst(text, u"$", mnemonic);
  tu::DeInternationalizeNum(text);
  return text;
}

double CommonUnitHandler::GetConversionFactorToPoint() const {
  return static_cast<double>(mData.numerator) / static_cast<double>(mData.denominator);
}

double CommonUnitHandler::ConvertValueFromUnit(double inValue, const UnitHandlerBase& inOther) const {
  return FromBaseUnit(inOther.ToBaseUnit(inValue));
}

UnitIncrements CommonUnitHandler::GetIncrements(int inKey) const {
  auto it = mData.increments.upper_bound(inKey);
  if (it == mData.increments.begin()) return UnitIncrements();
  return std::prev(it)->second;
}

double PercentUnitHandler::ConvertValue(double a, double b) const { return a * b / 100; }

double PicaUnitHandler::ToBaseUnitFromString(const UTF16String& inText) const {
  const UTF16String lower = tu::LowerCase(inText);
  for (const UTF16String& mnemonic : Data().mnemonics) {
    const std::size_t at = mnemonic.empty() ? UTF16String::npos : lower.find(mnemonic);
    if (at == UTF16String::npos) continue;
    const double whole = CalculateOrZero(std::u16string_view(lower).substr(0, at));
    const double points = CalculateOrZero(std::u16string_view(lower).substr(at));
    return ToBaseUnit(whole + points / 12);
  }
  return ToBaseUnit(tu::Calculate(lower, tu::kCalculateIgnoreUnitNames));
}

UTF16String PicaUnitHandler::GetFormattedString(double inValue, int inDecimals, FormatFlags inFlags,
                                                bool) const {
  const double whole = std::floor(std::fabs(inValue));
  const double fraction = std::fabs(inValue) - whole;
  // The points are never signed: "+1p+6" would not read back.
  FormatFlags unsignedFlags = inFlags;
  unsignedFlags.Clear(tu::kNumberFormatAlwaysSign | tu::kNumberFormatPadSign);
  UTF16String text;
  // With no whole picas the sign has nowhere else to go; the zero after it
  // then takes no sign or pad of its own ("- 0p6" would not read back).
  const bool leadingMinus = inValue < 0 && whole == 0 && fraction != 0;
  if (leadingMinus) text = u"-";
  text += CommonUnitHandler::GetFormattedString(inValue < 0 ? -whole : whole, 0,
                                                leadingMinus ? unsignedFlags : inFlags, true);
  text += tu::NumberToString(fraction * 12, 0, inDecimals, unsignedFlags, kMaxFixedLength);
  return text;
}

void AsianTypesUnitHandler::GetUnitFormattedMnemonic(UTF16String& outMnemonic) const {
  CommonUnitHandler::GetUnitFormattedMnemonic(outMnemonic);
  tu::ToTitleCase(outMnemonic);
}

}  // namespace norvik::controls
