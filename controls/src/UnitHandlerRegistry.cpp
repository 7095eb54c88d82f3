#include "controls/UnitHandlerRegistry.h"

#include <algorithm>

#include "tarsel/StringUtils.h"

namespace norvik::controls {

namespace tu = tarsel::utility;

namespace {

std::map<int, UnitIncrements> InchIncrements() {
  return {{1, {0.1, 10, 1, 1}}, {2, {0.1, 10, 0.6, 1}}, {3, {0.125, 8, 0.48, 1}}, {4, {0.125, 8, 0.5, 1}}};
}

std::map<int, UnitIncrements> CentimetreIncrements() {
  std::map<int, UnitIncrements> table = InchIncrements();
  table[2] = {0.1, 10, 0.5, 1};
  return table;
}

std::map<int, UnitIncrements> MillimetreIncrements() {
  std::map<int, UnitIncrements> table = CentimetreIncrements();
  table[1] = {1, 10, 0.5, 1};
  return table;
}

UnitHandlerData MakeData(std::vector<UTF16String> inMnemonics, const char16_t* inKey, const char16_t* inFormat,
                         const char16_t* inDescription, std::uint64_t inNumerator, std::uint64_t inDenominator,
                         NumberEditUnit inUnit, bool inCanConvert, std::map<int, UnitIncrements> inIncrements) {
  UnitHandlerData data;
  data.mnemonics = std::move(inMnemonics);
  const UTF16String prefix = UTF16String(u"$$$/norvik/controls/unithandler/") + inKey;
  data.placementFormat = prefix + u"/formatter=" + inFormat;
  data.description = prefix + u"/description=" + inDescription;
  data.numerator = inNumerator;
  data.denominator = inDenominator;
  data.unit = inUnit;
  data.canConvertFromBase = inCanConvert;
  data.increments = std::move(inIncrements);
  return data;
}

}  // namespace

UnitHandlerRegistry& UnitHandlerRegistry::Get() {
  static UnitHandlerRegistry registry;
  return registry;
}

UnitHandlerRegistry::UnitHandlerRegistry()
    : mUnitNames{{u"NumberEditUnit_NoUnit", kNumberEditUnit_NoUnit},   {u"NumberEditUnit_Point", kNumberEditUnit_Point},
                 {u"NumberEditUnit_Inch", kNumberEditUnit_Inch},       {u"NumberEditUnit_MM", kNumberEditUnit_MM},
                 {u"NumberEditUnit_CM", kNumberEditUnit_CM},           {u"NumberEditUnit_Percent", kNumberEditUnit_Percent},
                 {u"NumberEditUnit_Degree", kNumberEditUnit_Degree},   {u"NumberEditUnit_Q", kNumberEditUnit_Q},
                 {u"NumberEditUnit_Base16", kNumberEditUnit_Base16},   {u"NumberEditUnit_Pixel", kNumberEditUnit_Pixel},
                 {u"NumberEditUnit_Ha", kNumberEditUnit_Ha},           {u"NumberEditUnit_Time", kNumberEditUnit_Time}} {
  RegisterDefaultUnitHandlers();
}

void UnitHandlerRegistry::RegisterDefaultUnitHandlers() {
  const std::map<int, UnitIncrements> common{{1, {1, 10, 0.1, 1}}};
  const std::map<int, UnitIncrements> asian{{1, {1, 4, 0.5, 1}}};
  const auto add = [this](UnitHandlerP inHandler) { RegisterUnitHandler(std::move(inHandler)); };
  add(std::make_shared<CommonUnitHandler>(
      MakeData({u"pt", u"point", u"points"}, u"point", u"# $", u"point", 1, 1, kNumberEditUnit_Point, true, common)));
  add(std::make_shared<CommonUnitHandler>(MakeData({u"in", u"inch", u"inches", u"\""}, u"inch", u"# $", u"inch", 72,
                                                   1, kNumberEditUnit_Inch, true, InchIncrements())));
  add(std::make_shared<CommonUnitHandler>(
      MakeData({u"cm", u"centimeter", u"centimeters", u"centimetre", u"centimetres"}, u"cm", u"# $", u"centimeter",
               7200, 254, kNumberEditUnit_CM, true, CentimetreIncrements())));
  add(std::make_shared<CommonUnitHandler>(
      MakeData({u"mm", u"millimeter", u"millimeters", u"millimetre", u"millimetres"}, u"mm", u"# $", u"millimeter",
               720, 254, kNumberEditUnit_MM, true, MillimetreIncrements())));
  add(std::make_shared<AsianTypesUnitHandler>(
      MakeData({u"Q"}, u"q", u"# $", u"Kyu units", 720, 1016, kNumberEditUnit_Q, true, asian)));
  add(std::make_shared<AsianTypesUnitHandler>(
      MakeData({u"H", u"Ha"}, u"ha", u"# $", u"Ha units", 720, 1016, kNumberEditUnit_Ha, true, asian)));
  add(std::make_shared<CommonUnitHandler>(MakeData({u"px", u"pixel", u"pixels"}, u"pixel", u"# $", u"pixel", 72, 72,
                                                   kNumberEditUnit_Pixel, true, common)));
  add(std::make_shared<PercentUnitHandler>(
      MakeData({u"%"}, u"percent", u"#%", u"percent", 1, 1, kNumberEditUnit_Percent, false, common)));
  add(std::make_shared<PicaUnitHandler>(MakeData({u"p", u"pc", u"pi", u"pica", u"picas"}, u"pica", u"#$", u"pica",
                                                 12, 1, kNumberEditUnit_Pica, true, {{2, {1.0 / 12, 12, 1, 1}}})));
  add(std::make_shared<CommonUnitHandler>(
      MakeData({u"\u00B0"}, u"degree", u"#$", u"degree", 1, 1, kNumberEditUnit_Degree, false, common)));
}

void UnitHandlerRegistry::RegisterUnitHandler(UnitHandlerP inHandler) {
  if (inHandler) mHandlers.push_back(std::move(inHandler));
}

void UnitHandlerRegistry::Reset() { mHandlers.clear(); }

UnitHandlerP UnitHandlerRegistry::GetUnitHandler(NumberEditUnit inUnit) const {
  for (const UnitHandlerP& handler : mHandlers)
    if (handler->GetUnit() == inUnit) return handler;
  return nullptr;
}

UnitHandlerP UnitHandlerRegistry::GetUnitHandler(const UTF16String& inText) const {
  for (const UnitHandlerP& handler : mHandlers)
    if (handler->StringHasUnit(inText)) return handler;
  return nullptr;
}

NumberEditUnit UnitHandlerRegistry::GetNativeUnit(CustomNumberEditUnit inCustom) const {
  auto it = mNativeUnits.find(inCustom);
  return it == mNativeUnits.end() ? kNumberEditUnit_NoUnit : it->second;
}

NumberEditUnit UnitHandlerRegistry::GetNativeUnitFromString(const UTF16String& inName) const {
  if (auto it = mUnitNames.find(inName); it != mUnitNames.end()) return it->second;
  if (auto it = mCustomNames.find(inName); it != mCustomNames.end()) return GetNativeUnit(it->second);
  return kNumberEditUnit_NoUnit;
}

void UnitHandlerRegistry::SetNativeUnit(CustomNumberEditUnit inCustom, NumberEditUnit inUnit) {
  mNativeUnits[inCustom] = inUnit;
  SendUnitsChangeMessage(inCustom);
}

void UnitHandlerRegistry::SetCustomUnitFromString(CustomNumberEditUnit inCustom, const UTF16String& inName) {
  mCustomNames[inName] = inCustom;
}

void UnitHandlerRegistry::RegisterNotifyUnitsChange(const UnitsChangeFunction* inFunction,
                                                    CustomNumberEditUnit inCustom) {
  if (!inFunction || inFunction->empty()) return;
  std::vector<const UnitsChangeFunction*>& list = mNotify[inCustom];
  if (std::find(list.begin(), list.end(), inFunction) == list.end()) list.push_back(inFunction);
}

void UnitHandlerRegistry::DeregisterNotifyUnitsChange(const UnitsChangeFunction* inFunction,
                                                      CustomNumberEditUnit inCustom) {
  auto it = mNotify.find(inCustom);
  if (it == mNotify.end()) return;
  it->second.erase(std::remove(it->second.begin(), it->second.end(), inFunction), it->second.end());
}

void UnitHandlerRegistry::SendUnitsChangeMessage(CustomNumberEditUnit inCustom) const {
  auto it = mNotify.find(inCustom);
  if (it == mNotify.end()) return;
  // A copy: a listener may deregister itself, or others, while it is told.
  const std::vector<const UnitsChangeFunction*> listeners = it->second;
  for (const UnitsChangeFunction* listener : listeners) {
    const auto& current = mNotify.find(inCustom)->second;
    if (std::find(current.begin(), current.end(), listener) == current.end()) continue;
    (*listener)(inCustom);
  }
}

double UnitHandlerRegistry::ToBase(NumberEditUnit inUnit, double inValue) const {
  const UnitHandlerP handler = GetUnitHandler(inUnit);
  return handler ? handler->ToBaseUnit(inValue) : inValue;
}

UTF16String UnitHandlerRegistry::ConvertToBaseString(const UTF16String& inText, NumberEditUnit inUnit,
                                                     double& outValue) const {
  UnitHandlerP handler = GetUnitHandler(inText);
  if (!handler) handler = GetUnitHandler(inUnit);
  outValue = handler ? handler->ToBaseUnitFromString(inText) : tu::Calculate(inText, tu::kCalculateIgnoreUnitNames);
  return tu::NumberToString(outValue, 1, 4, tu::kNumberFormatNormal, 31);
}

}  // namespace norvik::controls
