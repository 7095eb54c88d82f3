// The registry of named themes, the default theme behind the free functions,
// and the change count with its notifications.
#include <vector>

#include <boost/function.hpp>
#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "support/ui/ThemeTestSupport.h"
#include "ui/Theme.h"

namespace norvik::ui::test {
namespace {

// A theme that reports its own destruction.
class TrackedTheme : public Theme {
 public:
  explicit TrackedTheme(bool* outDestroyed) : Theme(379, 3), mDestroyed(outDestroyed) {}
  ~TrackedTheme() override { *mDestroyed = true; }

 private:
  bool* mDestroyed;
};

using ThemeRegistry = ThemeRegistryTest;

TEST_F(ThemeRegistry, TheFirstLookUpCreatesAPlainDefaultTheme) {
  EXPECT_EQ(Theme::ThemeRegistryBegin(), Theme::ThemeRegistryEnd());
  ThemeP theme = Theme::GetTheme(u"DefaultTolliverTheme");
  ASSERT_TRUE(theme);
  EXPECT_EQ(std::distance(Theme::ThemeRegistryBegin(), Theme::ThemeRegistryEnd()), 1);
  EXPECT_EQ(&Theme::Get(), theme.get());
  EXPECT_EQ(theme->GetColorCount(), 379u);
}

TEST_F(ThemeRegistry, InitializeReplacesEverythingWithTheGivenDefault) {
  ThemeP other(new Theme(379, 3));
  Theme::GetTheme(GetDefaultThemeName());
  Theme::RegisterTheme(u"Other", other);
  ThemeP mine(new Theme(379, 3));
  Theme::Initialize(mine);
  EXPECT_EQ(&Theme::Get(), mine.get());
  EXPECT_FALSE(Theme::GetTheme(u"Other"));
}

TEST_F(ThemeRegistry, RegisteringATakenNameFailsAndReleasesTheRefusedTheme) {
  Theme::Initialize(ThemeP(new Theme(379, 3)));
  bool destroyed = false;
  EXPECT_TRUE(Theme::RegisterTheme(u"Studio", ThemeP(new Theme(379, 3))));
  ThemeP kept = Theme::GetTheme(u"Studio");
  EXPECT_FALSE(Theme::RegisterTheme(u"Studio", ThemeP(new TrackedTheme(&destroyed))));
  EXPECT_TRUE(destroyed);
  EXPECT_EQ(Theme::GetTheme(u"Studio"), kept);
}

TEST_F(ThemeRegistry, FindsTheNameOfARegisteredThemeAndNothingForAStranger) {
  ThemeP studio(new Theme(379, 3));
  Theme::Initialize(ThemeP(new Theme(379, 3)));
  Theme::RegisterTheme(u"Studio", studio);
  EXPECT_EQ(Theme::GetThemeName(studio), u"Studio");
  EXPECT_EQ(Theme::GetThemeName(ThemeP(new Theme(379, 3))), u"");
}

TEST_F(ThemeRegistry, TerminateReleasesTheThemes) {
  bool destroyed = false;
  Theme::Initialize(ThemeP(new TrackedTheme(&destroyed)));
  EXPECT_FALSE(destroyed);
  Theme::Terminate();
  EXPECT_TRUE(destroyed);
}

TEST_F(ThemeRegistry, FreeFunctionsReadTheDefaultTheme) {
  ThemeP theme(new Theme(379, 3));
  theme->SetColor(19, drawbot::ColorRGBA(0.1f, 0.2f, 0.3f, 1));
  theme->SetFontSize(2, 15);
  theme->SetFontName(1, u"DejaVu Sans");
  Theme::Initialize(theme);
  EXPECT_EQ(GetColor(19), drawbot::ColorRGBA(0.1f, 0.2f, 0.3f, 1));
  EXPECT_FLOAT_EQ(GetFontSize(2), 15);
  EXPECT_EQ(GetFontName(1), u"DejaVu Sans");
  EXPECT_EQ(GetIconType(), 0);
  theme->NotifyThemeChanged();
  EXPECT_EQ(GetThemeChangeCount(), 1u);
}

TEST(ThemeChangeNotification, CountsEachNotificationAndCallsFunctionsInInstallOrder) {
  ThemeP theme(new Theme(379, 3));
  std::vector<int> calls;
  theme->InstallThemeChangedFunction(boost::make_shared<boost::function<void()>>([&] { calls.push_back(1); }));
  theme->InstallThemeChangedFunction(Theme::ThemeChangedFunction());
  theme->InstallThemeChangedFunction(boost::make_shared<boost::function<void()>>([&] { calls.push_back(2); }));
  theme->NotifyThemeChanged();
  theme->NotifyThemeChanged();
  EXPECT_EQ(theme->GetThemeChangeCount(), 2u);
  EXPECT_EQ(calls, (std::vector<int>{1, 2, 1, 2}));
}

TEST(ThemeChangeNotification, SettersAloneDoNotCountAChange) {
  ThemeP theme(new Theme(379, 3));
  theme->SetBrightness(0.8f);
  theme->SetFontSizeScheme(0);
  theme->SetTinting(drawbot::ColorRGBA(1, 0, 0, 1));
  EXPECT_EQ(theme->GetThemeChangeCount(), 0u);
}

TEST(ThemeChangeNotification, AnEntryHoldingAnEmptyFunctionRaisesAfterCounting) {
  ThemeP theme(new Theme(379, 3));
  theme->InstallThemeChangedFunction(boost::make_shared<boost::function<void()>>());
  try {
    theme->NotifyThemeChanged();
    FAIL() << "an empty function was called without error";
  } catch (const boost::bad_function_call& e) {
    EXPECT_STREQ(e.what(), "call to empty boost::function");
  }
  EXPECT_EQ(theme->GetThemeChangeCount(), 1u);
}

TEST(ThemeChangeNotification, AFunctionMayInstallAnotherDuringNotification) {
  ThemeP theme(new Theme(379, 3));
  int later = 0;
  theme->InstallThemeChangedFunction(boost::make_shared<boost::function<void()>>([&] {
    theme->InstallThemeChangedFunction(boost::make_shared<boost::function<void()>>([&] { ++later; }));
  }));
  theme->NotifyThemeChanged();
  EXPECT_EQ(later, 0);
  theme->NotifyThemeChanged();
  EXPECT_EQ(later, 1);
}

}  // namespace
}  // namespace norvik::ui::test
