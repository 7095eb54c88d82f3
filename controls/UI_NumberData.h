#pragma once
// The value behind every numeric entry control: one double with its bounds,
// decimal places, step sizes per modifier key and text form. It knows no
// units (the unit handlers convert around it) and draws nothing.
//
// Defined results for odd settings:
// - With the minimum above the maximum, clamping lets the minimum win.
// - NaN passes through SetValue unclamped (every comparison with a bound is
//   false); GetText shows it as "NaN", or empty with ShowEmptyForNan.
// - Decimal places are kept within -300..300; a negative count rounds to tens,
//   hundreds and so on.
// - Text that does not parse raises what StringToNumber raises.
#include <boost/intrusive_ptr.hpp>

#include "tarsel/Flags.h"
#include "tarsel/RefCountedObject.h"
#include "tarsel/StringUtils.h"
#include "tarsel/UTFString.h"

namespace norvik::controls {

class UI_NumberData : public tarsel::utility::RefCountedObject {
 public:
  using FormatFlags = tarsel::utility::Flags<unsigned short>;
  using ModifierKeys = tarsel::utility::Flags<unsigned char>;
  // Modifier bits of IncrementValue, as the keyboard layer numbers them.
  static constexpr unsigned char kShiftModifier = 2;
  static constexpr unsigned char kCmdModifier = 4;
  static constexpr unsigned char kOptionModifier = 16;
  static constexpr int kMaxDecimalPlaces = 300;

  UI_NumberData() = default;
  UI_NumberData(const UI_NumberData&) = default;
  UI_NumberData& operator=(const UI_NumberData&) = default;

  double GetValue() const { return mValue; }
  // Clamps to the bounds; true when the requested value lay outside them.
  bool SetValue(double inValue);
  double GetMinValue() const { return mMinValue; }
  double GetMaxValue() const { return mMaxValue; }
  void SetMinValue(double inMin);
  void SetMaxValue(double inMax);
  void SetMinMaxValue(double inMin, double inMax, double inValue);

  int GetDecimalPlaces() const { return mDecimalPlaces; }
  void SetDecimalPlaces(int inPlaces);
  FormatFlags GetFormatFlags() const { return mFormatFlags; }
  void SetFormatFlags(FormatFlags inFlags) { mFormatFlags = inFlags; }

  double GetIncrement() const { return mIncrement; }
  void SetIncrement(double inIncrement) { mIncrement = inIncrement; }
  double GetShiftModifierIncrement() const { return mShiftIncrement; }
  void SetShiftModifierIncrement(double inIncrement) { mShiftIncrement = inIncrement; }
  double GetCmdModifierIncrement() const { return mCmdIncrement; }
  void SetCmdModifierIncrement(double inIncrement) { mCmdIncrement = inIncrement; }
  double GetOptionModifierIncrement() const { return mOptionIncrement; }
  void SetOptionModifierIncrement(double inIncrement) { mOptionIncrement = inIncrement; }
  // A factor multiplies the step; otherwise the modifier's increment replaces it.
  void SetIsShiftModifierAFactor(bool inFactor) { mShiftIsFactor = inFactor; }
  void SetIsCmdModifierAFactor(bool inFactor) { mCmdIsFactor = inFactor; }
  void SetIsOptionModifierAFactor(bool inFactor) { mOptionIsFactor = inFactor; }
  void SetIsDropPercisionOnIncrement(bool inDrop) { mDropPrecision = inDrop; }
  bool GetIsDropPercisionOnIncrement() const { return mDropPrecision; }

  // At the bottom of its range the value reads as minus infinity.
  void ShowNegativeInfinity(bool inShow) { mShowNegativeInfinity = inShow; }
  bool IsShowNegativeInfinity() const { return mShowNegativeInfinity; }
  void ShowEmptyForNan(bool inShow) { mShowEmptyForNan = inShow; }
  bool IsShowEmptyForNan() const { return mShowEmptyForNan; }

  // Text of the value; -1 means the data's own decimal places.
  UTF16String GetText(int inDecimals = -1) const;
  // Parses the text (plain form). True when it means a number other than the
  // one shown now. Text meaning the number shown changes nothing, so digits
  // hidden by the display's rounding survive a retyped value.
  bool SetText(const UTF16String& inText);
  bool SetTextAndTestChange(const UTF16String& inText);

  // Moves the value by inSteps steps; the step comes from the increment and
  // the modifiers held, and starts from the value as shown.
  void IncrementValue(double inSteps, ModifierKeys inModKeys, bool inAdjustDecimals);

  // Signs shown in place of "+" and "-"; empty strings leave the plain signs.
  void SetCustomSignStrings(const UTF16String& inPlus, const UTF16String& inMinus);
  // Custom signs in inText back to plain signs.
  void ReplaceCustomSignStrings(UTF16String& ioText) const;
  // The minus-infinity text back to the text of the minimum.
  void ReplaceOtherCustomStrings(UTF16String& ioText) const;

 private:
  double GetPrecision() const;
  void ClipValue();
  // Clamped copy of inValue; the minimum wins over a maximum below it.
  double Clamped(double inValue) const;
  UTF16String PlainText(double inValue) const;

  FormatFlags mFormatFlags;
  int mDecimalPlaces = 0;
  double mIncrement = 1;
  double mShiftIncrement = 10;
  double mCmdIncrement = 0.1;
  double mOptionIncrement = 1;
  bool mShiftIsFactor = true;
  bool mCmdIsFactor = true;
  bool mOptionIsFactor = true;
  bool mDropPrecision = true;
  double mValue = 0;
  double mMinValue = -1.7976931348623157e308;
  double mMaxValue = 1.7976931348623157e308;
  UTF16String mCustomPlus;
  UTF16String mCustomMinus;
  bool mShowNegativeInfinity = false;
  bool mShowEmptyForNan = false;
};

using UI_NumberDataP = boost::intrusive_ptr<UI_NumberData>;

}  // namespace norvik::controls
