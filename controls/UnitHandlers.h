#pragma once
// Units of measured entry fields. A handler converts values of its unit to
// and from the base unit, the point (1/72 inch), formats them and names the
// mnemonics a user may type. The registry (UnitHandlerRegistry.h) keeps the
// handlers in force.
#include <cstdint>
#include <map>
#include <vector>

#include "tarsel/Flags.h"
#include "tarsel/UTFString.h"

namespace norvik::controls {

enum NumberEditUnit : int {
  kNumberEditUnit_NoUnit = 0,
  kNumberEditUnit_Point = 1,
  kNumberEditUnit_Inch = 2,
  kNumberEditUnit_MM = 3,
  kNumberEditUnit_CM = 4,
  kNumberEditUnit_Pica = 5,
  kNumberEditUnit_Percent = 6,
  kNumberEditUnit_Degree = 7,
  kNumberEditUnit_Q = 8,
  kNumberEditUnit_Base16 = 9,
  kNumberEditUnit_Pixel = 10,
  kNumberEditUnit_Ha = 11,
  kNumberEditUnit_Time = 12,
};

// Named by the application (a document's ruler unit, say); its native
// NumberEditUnit may change while the program runs.
enum CustomNumberEditUnit : int {};

struct UnitIncrements {
  UnitIncrements() = default;
  UnitIncrements(double inIncrement, double inShift, double inCmd, double inOption)
      : increment(inIncrement), shift(inShift), cmd(inCmd), option(inOption) {}
  bool operator==(const UnitIncrements& o) const {
    return increment == o.increment && shift == o.shift && cmd == o.cmd && option == o.option;
  }

  double increment = 1;
  double shift = 10;
  double cmd = 1;
  double option = 1;
};

struct UnitHandlerData {
  std::vector<UTF16String> mnemonics;
  UTF16String description;
  std::uint64_t numerator = 1;
  std::uint64_t denominator = 1;
  UTF16String placementFormat;
  NumberEditUnit unit = kNumberEditUnit_NoUnit;
  bool canConvertFromBase = true;
  // Keyed by the decimal places of the control that asks.
  std::map<int, UnitIncrements> increments;
};

class UnitHandlerBase {
 public:
  using FormatFlags = tarsel::utility::Flags<unsigned short>;

  virtual ~UnitHandlerBase() = default;

  // Whether any mnemonic occurs in the lower-cased text.
  virtual bool StringHasUnit(const UTF16String& inText) const = 0;
  virtual bool CanConvertFromBase() const = 0;
  // Raises what tarsel::utility::Calculate raises for text it cannot read.
  virtual double ToBaseUnitFromString(const UTF16String& inText) const = 0;
  virtual double ToBaseUnit(double inValue) const = 0;
  virtual double FromBaseUnit(double inValue) const = 0;
  // Applies an entered value b to a current value a.
  virtual double ConvertValue(double a, double b) const = 0;
  virtual void GetUnitFormattedMnemonic(UTF16String& outMnemonic) const = 0;
  virtual UTF16String GetFormattedString(double inValue, int inDecimals, FormatFlags inFlags,
                                         bool inShowUnit) const = 0;
  virtual const UTF16String& GetUnitDescription() const = 0;
  virtual const std::vector<UTF16String>& GetUnitMnemonics() const = 0;
  virtual const UTF16String& GetUnitPlacementFormat() const = 0;
  virtual NumberEditUnit GetUnit() const = 0;
  virtual double GetConversionFactorToPoint() const = 0;
  // inValue in inOther's unit, expressed in this handler's unit.
  virtual double ConvertValueFromUnit(double inValue, const UnitHandlerBase& inOther) const = 0;
  // The entry with the greatest key not above inKey; (1, 10, 1, 1) when none.
  virtual UnitIncrements GetIncrements(int inKey) const = 0;
};

class CommonUnitHandler : public UnitHandlerBase {
 public:
  // Mnemonics are lower-cased; the placement format and description may be
  // key texts, localised here once. In a format, "#" stands for the number
  // and "$" for the mnemonic.
  explicit CommonUnitHandler(const UnitHandlerData& inData);

  bool StringHasUnit(const UTF16String& inText) const override;
  bool CanConvertFromBase() const override { return mData.canConvertFromBase; }
  double ToBaseUnitFromString(const UTF16String& inText) const override;
  double ToBaseUnit(double inValue) const override;
  double FromBaseUnit(double inValue) const override;
  double ConvertValue(double a, double b) const override;
  void GetUnitFormattedMnemonic(UTF16String& outMnemonic) const override;
  UTF16String GetFormattedString(double inValue, int inDecimals, FormatFlags inFlags, bool inShowUnit) const override;
  const UTF16String& GetUnitDescription() const override { return mData.description; }
  const std::vector<UTF16String>& GetUnitMnemonics() const override { return mData.mnemonics; }
  const UTF16String& GetUnitPlacementFormat() const override { return mData.placementFormat; }
  NumberEditUnit GetUnit() const override { return mData.unit; }
  double GetConversionFactorToPoint() const override;
  double ConvertValueFromUnit(double inValue, const UnitHandlerBase& inOther) const override;
  UnitIncrements GetIncrements(int inKey) const override;

 protected:
  const UnitHandlerData& Data() const { return mData; }

 private:
  UnitHandlerData mData;
};

// A percentage is a share of the current value.
class PercentUnitHandler : public CommonUnitHandler {
 public:
  using CommonUnitHandler::CommonUnitHandler;
  double ConvertValue(double a, double b) const override;
};

// Picas and points: 1.5 picas read "1p6", and "1p6" reads 18 points.
class PicaUnitHandler : public CommonUnitHandler {
 public:
  using CommonUnitHandler::CommonUnitHandler;
  double ToBaseUnitFromString(const UTF16String& inText) const override;
  UTF16String GetFormattedString(double inValue, int inDecimals, FormatFlags inFlags, bool inShowUnit) const override;
};

// Q and Ha units of Japanese typesetting, shown in title case ("Q", "H").
class AsianTypesUnitHandler : public CommonUnitHandler {
 public:
  using CommonUnitHandler::CommonUnitHandler;
  void GetUnitFormattedMnemonic(UTF16String& outMnemonic) const override;
};

}  // namespace norvik::controls
