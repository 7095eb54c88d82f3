#include "tarsel/PropList.h"
#include "tarsel/StringUtils.h"
#include "tarsel/ThrowError.h"
#include "ui/UI_NodeAdapterBase.h"

namespace norvik::ui {

namespace {

namespace tu = tarsel::utility;

struct FormatFlagKey {
  const char* key;
  unsigned short bit;
};

constexpr FormatFlagKey kFormatFlagKeys[] = {
    {"formatNoLocalization", tu::kNumberFormatNoLocalization},
    {"formatLeadingSpaces", tu::kNumberFormatLeadingSpaces},
    {"formatNoTrailingZeros", tu::kNumberFormatNoTrailingZeros},
    {"formatUseSeparator", tu::kNumberFormatUseSeparator},
    {"formatAlwaysSign", tu::kNumberFormatAlwaysSign},
    {"formatPadSign", tu::kNumberFormatPadSign},
};

}  // namespace

void UI_NodeAdapterBase::NumberFormatFlagsToPropList(tu::Flags<unsigned short> inFlags,
                                                     tarsel::proplist::PropList& ioList) {
  ioList.SetValue("formatNormal", false);
  for (const FormatFlagKey& entry : kFormatFlagKeys) ioList.SetValue(entry.key, inFlags.Test(entry.bit));
}

tu::Flags<unsigned short> UI_NodeAdapterBase::NumberFormatFlagsFromPropList(const tarsel::proplist::PropList& inList) {
  tu::Flags<unsigned short> flags;
  for (const FormatFlagKey& entry : kFormatFlagKeys) {
    if (!inList.HasKey(entry.key)) continue;
    bool on = false;
    if (!inList.GetValue(entry.key, on))
      tarsel::config::ThrowError(
          tarsel::config::ErrorLevel::kError,
          "$$$/tarsel/proplist/Error/NotABoolean=Property list error: the value of ^0 is not a boolean.",
          tarsel::config::kErrorGroupContract, tarsel::config::kErrorCodeConversion, false, entry.key);
    flags.Set(entry.bit, on);
  }
  return flags;
}

}  // namespace norvik::ui
