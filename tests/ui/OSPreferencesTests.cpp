// Platform preferences folded into the custom settings.
#include <gmock/gmock.h>

#include "ui/CustomSettingsManager.h"
#include "ui/HeadlessWindowSystem.h"
#include "ui/OS_Preferences.h"
#include "support/ui/NativeWindowTestSupport.h"

namespace norvik::ui {
namespace {

class ScriptedPreferences : public OS_Preferences {
 public:
  bool Get(const std::string& inName, bool& outValue) const override {
    asked.push_back(inName);
    if (inName != answeredName) return false;
    outValue = answer;
    return true;
  }
  std::string answeredName;
  bool answer = false;
  mutable std::vector<std::string> asked;
};

TEST(OSPreferencesTest, BothNamesAreAskedInOrderAndAnAnswerIsStored) {
  CustomSettingsManager settings;
  boost::intrusive_ptr<ScriptedPreferences> prefs(new ScriptedPreferences);
  prefs->answeredName = "windows.MnemonicsAlwaysOn";
  prefs->answer = true;
  settings.SetOSPreferences(prefs);
  settings.ReloadOSPreferences();
  EXPECT_THAT(prefs->asked, ::testing::ElementsAre("apple.scrollbar.ArrowTogether", "windows.MnemonicsAlwaysOn"));
  EXPECT_TRUE(settings.GetBool("windows.MnemonicsAlwaysOn", false));
  EXPECT_FALSE(settings.Find("apple.scrollbar.ArrowTogether").has_value());
}

TEST(OSPreferencesTest, APlatformThatAnswersNeitherLeavesTheHostsSettings) {
  CustomSettingsManager settings;
  settings.Set("windows.MnemonicsAlwaysOn", true);
  settings.Set("apple.scrollbar.ArrowTogether", false);
  settings.SetOSPreferences(new ScriptedPreferences);
  settings.ReloadOSPreferences();
  EXPECT_TRUE(settings.GetBool("windows.MnemonicsAlwaysOn", false));
  EXPECT_FALSE(settings.GetBool("apple.scrollbar.ArrowTogether", true));
}

TEST(OSPreferencesTest, ByDefaultTheNativeLayerAnswers) {
  HeadlessWindowSystem system;
  system.Install();
  CustomSettingsManager settings;
  settings.Set("windows.MnemonicsAlwaysOn", true);
  system.SetPreference("windows.MnemonicsAlwaysOn", false);
  settings.ReloadOSPreferences();
  EXPECT_FALSE(settings.GetBool("windows.MnemonicsAlwaysOn", true));
  system.Uninstall();
  // Without a layer nothing is answered and nothing changes.
  settings.Set("windows.MnemonicsAlwaysOn", true);
  settings.ReloadOSPreferences();
  EXPECT_TRUE(settings.GetBool("windows.MnemonicsAlwaysOn", false));
}

using OSPreferencesWindowTest = test::NativeWindowTest;

TEST_F(OSPreferencesWindowTest, AChangedDesktopSettingReachesTheManagersSettingsThroughItsWindows) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 100, 100));
  mSystem.SetPreference("windows.MnemonicsAlwaysOn", true);
  mSystem.Pump();
  EXPECT_TRUE(mManager.GetCustomSettingsManager()->GetBool("windows.MnemonicsAlwaysOn", false));
}

}  // namespace
}  // namespace norvik::ui
