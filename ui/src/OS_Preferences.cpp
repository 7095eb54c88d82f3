#include "ui/OS_Preferences.h"

#include "ui/CustomSettingsManager.h"
#include "ui/OS_NativeLayer.h"

namespace norvik::ui {

bool OS_NativePreferences::Get(const std::string& inName, bool& outValue) const {
  const OS_NativeLayer* layer = GetNativeLayer();
  return layer && layer->GetPreference(inName, outValue);
}

void CustomSettingsManager::ReloadOSPreferences() {
  if (!mOSPreferences) return;
  static const char* const kNames[] = {"apple.scrollbar.ArrowTogether", "windows.MnemonicsAlwaysOn"};
  for (const char* name : kNames) {
    bool value = false;
    // A name the platform does not answer keeps what the host set.
    if (mOSPreferences->Get(name, value)) Set(name, value);
  }
}

}  // namespace norvik::ui
