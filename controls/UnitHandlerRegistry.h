#pragma once
// The process-wide table of units. The first call to Get registers the
// toolkit's ten units; an application may add its own handlers, which the
// expression grammar understands from the next evaluation on. Used on the UI
// thread only.
#include <map>
#include <memory>
#include <vector>

#include <boost/function.hpp>

#include "controls/UnitHandlers.h"

namespace norvik::controls {

using UnitHandlerP = std::shared_ptr<UnitHandlerBase>;
using UnitsChangeFunction = boost::function<void(CustomNumberEditUnit)>;

class UnitHandlerRegistry {
 public:
  static UnitHandlerRegistry& Get();

  void RegisterUnitHandler(UnitHandlerP inHandler);
  // Forgets every handler, the toolkit's own included.
  void Reset();
  // The toolkit's ten units, appended in their usual order (after a Reset,
  // say, to put them back behind an application's own).
  void RegisterDefaultUnitHandlers();
  // The first handler, in registration order, of the unit, or whose
  // mnemonic occurs in the text; null when none answers.
  UnitHandlerP GetUnitHandler(NumberEditUnit inUnit) const;
  UnitHandlerP GetUnitHandler(const UTF16String& inText) const;
  const std::vector<UnitHandlerP>& GetUnitHandlers() const { return mHandlers; }

  // 0 (no unit) when unmapped or unknown.
  NumberEditUnit GetNativeUnit(CustomNumberEditUnit inCustom) const;
  // A unit's name string ("NumberEditUnit_Inch"), else a custom unit's name.
  NumberEditUnit GetNativeUnitFromString(const UTF16String& inName) const;
  // Maps the custom unit and tells its listeners.
  void SetNativeUnit(CustomNumberEditUnit inCustom, NumberEditUnit inUnit);
  void SetCustomUnitFromString(CustomNumberEditUnit inCustom, const UTF16String& inName);
  NumberEditUnit GetUnitForNumbersWithoutUnits() const { return mUnitForNumbersWithoutUnits; }
  void SetUnitForNumbersWithoutUnits(NumberEditUnit inUnit) { mUnitForNumbersWithoutUnits = inUnit; }

  // The registry keeps the address of the function, not a copy, so that its
  // owner may change or empty it while registered; an empty function is not
  // registered, and registering one already there keeps a single entry.
  // Calling an entry that was emptied later raises boost::bad_function_call
  // ("call to empty boost::function").
  void RegisterNotifyUnitsChange(const UnitsChangeFunction* inFunction, CustomNumberEditUnit inCustom);
  void DeregisterNotifyUnitsChange(const UnitsChangeFunction* inFunction, CustomNumberEditUnit inCustom);
  // Calls the custom unit's listeners in the order they registered.
  void SendUnitsChangeMessage(CustomNumberEditUnit inCustom) const;

  // Parses a typed expression into inUnit's base unit; false when the text
  // is not an expression of the units known to a field of inUnit.
  bool CalculateToBaseUnit(const UTF16String& inText, NumberEditUnit inUnit, double inPreviousBase,
                           double& outResult) const;
  // Binary arithmetic under the unit rules; false where the operation means
  // nothing (two lengths multiplied, a division by zero).
  bool AddNumbers(double a, double b, NumberEditUnit inUnitA, NumberEditUnit inUnitB, NumberEditUnit inTarget,
                  double& outResult, NumberEditUnit& outUnit) const;
  bool SubtractNumbers(double a, double b, NumberEditUnit inUnitA, NumberEditUnit inUnitB, NumberEditUnit inTarget,
                       double& outResult, NumberEditUnit& outUnit) const;
  bool MultiplyNumbers(double a, double b, NumberEditUnit inUnitA, NumberEditUnit inUnitB, NumberEditUnit inTarget,
                       double& outResult, NumberEditUnit& outUnit) const;
  bool DivideNumbers(double a, double b, NumberEditUnit inUnitA, NumberEditUnit inUnitB, NumberEditUnit inTarget,
                     double& outResult, NumberEditUnit& outUnit) const;
  // The text's value in points with four decimal places, read by the
  // handler of the text's unit, else of inUnit.
  UTF16String ConvertToBaseString(const UTF16String& inText, NumberEditUnit inUnit, double& outValue) const;

 private:
  UnitHandlerRegistry();
  double ToBase(NumberEditUnit inUnit, double inValue) const;

  std::vector<UnitHandlerP> mHandlers;
  std::map<CustomNumberEditUnit, NumberEditUnit> mNativeUnits;
  std::map<UTF16String, CustomNumberEditUnit> mCustomNames;
  std::map<UTF16String, NumberEditUnit> mUnitNames;
  std::map<CustomNumberEditUnit, std::vector<const UnitsChangeFunction*>> mNotify;
  NumberEditUnit mUnitForNumbersWithoutUnits = kNumberEditUnit_NoUnit;
};

// Evaluates what the user typed into a field of inUnit: the value in the
// field's unit and its display text. On any error outError is true, the
// previous value stands and nothing is thrown. Out-of-range values are
// clamped (and flagged), and a value at a bound is rounded toward the inside
// at inDecimals places so that the shown digits never pass the bound.
// inPreviousValue is in the field's unit, or in points when inConvertOnError
// is set; a previous value that is not finite counts as 0. With the minimum
// above the maximum the minimum wins. No infinite or NaN value comes out.
void EvaluateUnitExpression(const UTF16String& inText, NumberEditUnit inUnit,
                            tarsel::utility::Flags<unsigned short> inFlags, int inDecimals, double inPreviousValue,
                            double inMaxValue, double inMinValue, bool inShowUnit, bool inConvertOnError,
                            UTF16String& outText, double& outValue, bool& outError);

}  // namespace norvik::controls
