#pragma once
// Behaviour switches of the toolkit, read by dotted key
// ("norvik.controls.UI_Button.LoseFocusOnESC"). The table starts with the
// toolkit's defaults; the OS-preferences form subclasses this and overrides
// entries from the user's settings. A key with no entry answers the caller's
// fallback.
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <variant>

#include "ui/OS_Preferences.h"

namespace norvik::ui {

class CustomSettingsManager {
 public:
  using Value = std::variant<bool, long, double, std::string>;

  CustomSettingsManager();
  virtual ~CustomSettingsManager();

  // Re-reads the table; the base restores the defaults.
  virtual void Reload();
  virtual std::optional<Value> Find(std::string_view inKey) const;
  virtual void Set(std::string_view inKey, Value inValue);
  // Asks the platform for "apple.scrollbar.ArrowTogether" and
  // "windows.MnemonicsAlwaysOn", in that order, and stores each answer.
  void ReloadOSPreferences();
  // The platform's answers; the native layer's by default. Null asks nothing.
  void SetOSPreferences(OS_PreferencesP inPreferences) { mOSPreferences = std::move(inPreferences); }
  const OS_PreferencesP& GetOSPreferences() const { return mOSPreferences; }

  // Typed reads. A value of another type answers the fallback, except that a
  // number is read as the other kind of number.
  bool GetBool(std::string_view inKey, bool inFallback) const;
  long GetLong(std::string_view inKey, long inFallback) const;
  double GetDouble(std::string_view inKey, double inFallback) const;
  std::string GetString(std::string_view inKey, const std::string& inFallback) const;

 protected:
  std::map<std::string, Value, std::less<>> mTable;
  OS_PreferencesP mOSPreferences{new OS_NativePreferences};
};

}  // namespace norvik::ui
