#include "controls/UI_NumberData.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>

#include "controls/NumberRounding.h"
#include "tarsel/ThrowError.h"

namespace norvik::controls {

namespace tu = tarsel::utility;

namespace {

constexpr char16_t kMinusInfinity[] = u"-\u221E";
constexpr int kMaxFixedLength = 31;
constexpr double kGridTolerance = 1e-12;

}  // namespace

double UI_NumberData::Clamped(double inValue) const {
  double value = inValue;
  if (value > mMaxValue) value = mMaxValue;
  if (value < mMinValue) value = mMinValue;
  return value;
}

void UI_NumberData::ClipValue() { mValue = Clamped(mValue); }

bool UI_NumberData::SetValue(double inValue) {
  mValue = Clamped(inValue);
  return inValue > mMaxValue || inValue < mMinValue;
}

void UI_NumberData::SetMinValue(double inMin) {
  mMinValue = inMin;
  ClipValue();
}

void UI_NumberData::SetMaxValue(double inMax) {
  mMaxValue = inMax;
  ClipValue();
}

void UI_NumberData::SetMinMaxValue(double inMin, double inMax, double inValue) {
  mMinValue = inMin;
  mMaxValue = inMax;
  mValue = inValue;
  ClipValue();
}

void UI_NumberData::SetDecimalPlaces(int inPlaces) {
  mDecimalPlaces = std::clamp(inPlaces, -kMaxDecimalPlaces, kMaxDecimalPlaces);
}

double UI_NumberData::GetPrecision() const {
  const int exponent = -mDecimalPlaces;
  unsigned remaining = static_cast<unsigned>(std::abs(exponent));
  double base = 10;
  double result = 1;
  while (remaining != 0) {
    if (remaining & 1U) result *= base;
    base *= base;
    remaining >>= 1U;
  }
  return exponent < 0 ? 1 / result : result;
}

UTF16String UI_NumberData::PlainText(double inValue) const {
  return tu::NumberToString(inValue, 0, mDecimalPlaces, mFormatFlags, kMaxFixedLength);
}

UTF16String UI_NumberData::GetText(int inDecimals) const {
  const int decimals = inDecimals == -1 ? mDecimalPlaces : inDecimals;
  if (mShowEmptyForNan && std::isnan(mValue)) return UTF16String();
  if (mShowNegativeInfinity && std::fabs(mValue - mMinValue) < GetPrecision()) return UTF16String(kMinusInfinity);
  UTF16String text = tu::NumberToString(mValue, 0, decimals, mFormatFlags, kMaxFixedLength);
  if (!mCustomPlus.empty()) tu::ReplaceAllStringInString(text, u"+", mCustomPlus);
  if (!mCustomMinus.empty()) tu::ReplaceAllStringInString(text, u"-", mCustomMinus);
  return text;
}

void UI_NumberData::SetCustomSignStrings(const UTF16String& inPlus, const UTF16String& inMinus) {
  mCustomPlus = inPlus;
  mCustomMinus = inMinus;
}

void UI_NumberData::ReplaceCustomSignStrings(UTF16String& ioText) const {
  const auto replace = [&ioText](const UTF16String& inCustom, std::u16string_view inSign) {
    if (inCustom.empty()) return;
    tu::ReplaceAllStringInString(ioText, tu::LowerCase(inCustom), inSign);
    tu::ReplaceAllStringInString(ioText, inCustom, inSign);
  };
  replace(mCustomPlus, u"+");
  replace(mCustomMinus, u"-");
}

void UI_NumberData::ReplaceOtherCustomStrings(UTF16String& ioText) const {
  if (mShowNegativeInfinity && ioText == kMinusInfinity) ioText = tu::NumberToString(mMinValue);
}

bool UI_NumberData::SetText(const UTF16String& inText) {
  UTF16String oldText = GetText(-1);
  UTF16String newText = inText;
  ReplaceCustomSignStrings(oldText);
  ReplaceOtherCustomStrings(oldText);
  ReplaceCustomSignStrings(newText);
  ReplaceOtherCustomStrings(newText);
  double oldNumber = std::nan("");
  try {
    oldNumber = tu::StringToNumber(oldText, tu::kNumberFormatNoLocalization);
  } catch (const tarsel::config::Exception&) {
    // The shown text may be a localised form that the plain reading rejects;
    // then nothing typed can mean it, and the new number is taken.
  }
  const double newNumber = tu::StringToNumber(newText, tu::kNumberFormatNoLocalization);
  if (newNumber == oldNumber && !oldText.empty()) return false;
  mValue = Clamped(newNumber);
  return newNumber != oldNumber;
}

bool UI_NumberData::SetTextAndTestChange(const UTF16String& inText) { return SetText(inText); }

void UI_NumberData::IncrementValue(double inSteps, ModifierKeys inModKeys, bool inAdjustDecimals) {
  double step = mIncrement;
  const auto apply = [&step, inModKeys](unsigned char inKey, bool inFactor, double inIncrement) {
    if (!inModKeys.Test(inKey)) return;
    step = inFactor ? step * inIncrement : inIncrement;
  };
  apply(kShiftModifier, mShiftIsFactor, mShiftIncrement);
  apply(kCmdModifier, mCmdIsFactor, mCmdIncrement);
  apply(kOptionModifier, mOptionIsFactor, mOptionIncrement);

  if (inAdjustDecimals && std::log10(step) < 0) {
    const int needed = RoundToInt32(-std::log10(step));
    if (needed > mDecimalPlaces) SetDecimalPlaces(needed);
  }

  double shown = mValue;
  try {
    shown = tu::StringToNumber(PlainText(mValue), tu::kNumberFormatNoLocalization);
  } catch (const tarsel::config::Exception&) {
    // NaN and localised forms the plain reading rejects: step from the value.
  }
  double result = shown + step * inSteps;

  if (mDropPrecision && step != 0) {
    const double k = RoundToInt32(result / step);
    const double snapped = std::fabs(k * step - result) < GetPrecision() * 0.5 ? k * step : result;
    const double grid = RoundToInt32(snapped / step) * step;
    if (NearlyEqual(snapped, grid, kGridTolerance)) {
      result = grid;
    } else {
      // Off the grid: land on the nearest grid point that the move passed,
      // so that a step never overshoots the next mark.
      result = step * inSteps >= 0 ? std::floor(snapped / step) * step : std::ceil(snapped / step) * step;
    }
  }
  mValue = Clamped(result);
}

}  // namespace norvik::controls
