// How a client reaches its theme: suppliers, custom entries that win over the
// theme, and owners that name the theme of a sub-tree.
#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "support/ui/ThemeTestSupport.h"
#include "tarsel/ThrowError.h"
#include "ui/ThemeClient.h"
#include "ui/ThemeOwner.h"

namespace norvik::ui::test {
namespace {

class CountingClient : public ThemeClient {
 public:
  void UI_ThemeUpdated(unsigned long inFlags) override {
    ++updates;
    lastFlags = inFlags;
  }
  int updates = 0;
  unsigned long lastFlags = 0;
};

ThemeSupplier SupplierOf(ThemeP inTheme) {
  return boost::make_shared<boost::function<ThemeP()>>([inTheme] { return inTheme; });
}

using ThemeClientTest = ThemeRegistryTest;

TEST_F(ThemeClientTest, ASuppliedThemeGivesColoursAndFontNamesAndResetGoesBackToTheDefault) {
  ThemeP other(new Theme(379, 3));
  other->SetColor(19, drawbot::ColorRGBA(1, 0, 0, 1));
  other->SetFontName(2, u"DejaVu Sans");
  CountingClient client;
  client.UI_SetThemeSupplier(SupplierOf(other));
  EXPECT_EQ(client.updates, 1);
  EXPECT_EQ(client.lastFlags, 1u);
  EXPECT_EQ(client.GetThemeColor(19), drawbot::ColorRGBA(1, 0, 0, 1));
  EXPECT_EQ(client.GetThemeFontName(2), u"DejaVu Sans");
  client.UI_ResetThemeSupplier();
  EXPECT_EQ(client.UI_GetCurrentTheme(), Theme::GetTheme(GetDefaultThemeName()));
}

TEST_F(ThemeClientTest, AnEmptySupplierRaisesItsError) {
  CountingClient client;
  client.UI_SetThemeSupplier(boost::make_shared<boost::function<ThemeP()>>());
  try {
    client.UI_GetCurrentTheme();
    FAIL() << "no error";
  } catch (const tarsel::config::Exception& e) {
    EXPECT_EQ(e.GetKeyPath(), "norvik/ui/Error/ThemeSupplierAbsent");
    EXPECT_STREQ(e.what(), "ThemeSupplier is empty");
  }
}

TEST_F(ThemeClientTest, ACustomColourWinsAndClearingItReturnsToTheTheme) {
  CountingClient client;
  const drawbot::ColorRGBA themed = client.GetThemeColor(19);
  client.SetCustomThemeColor(19, drawbot::ColorRGBA(0, 1, 0, 1));
  EXPECT_EQ(client.GetThemeColor(19), drawbot::ColorRGBA(0, 1, 0, 1));
  EXPECT_EQ(client.GetThemeColor(20), Theme::Get().GetColor(20));
  client.ClearCustomThemeColor(19);
  EXPECT_EQ(client.GetThemeColor(19), themed);
}

TEST_F(ThemeClientTest, SettingTheSameCustomEntryAgainDoesNotNotify) {
  CountingClient client;
  client.updates = 0;
  client.SetCustomThemeColor(19, drawbot::ColorRGBA(0, 1, 0, 1));
  client.SetCustomThemeColor(19, drawbot::ColorRGBA(0, 1, 0, 1));
  EXPECT_EQ(client.updates, 1);
  client.SetCustomThemeColor(19, drawbot::ColorRGBA(0, 0, 1, 1));
  EXPECT_EQ(client.updates, 2);
  client.SetCustomFontSize(0, 14);
  client.SetCustomFontSize(0, 14);
  EXPECT_EQ(client.updates, 3);
  EXPECT_FLOAT_EQ(client.GetThemeFontSize(0), 14);
  EXPECT_FLOAT_EQ(client.GetThemeFontSize(1), 11);
  client.ClearCustomFontSize(0);
  EXPECT_EQ(client.updates, 4);
  EXPECT_FLOAT_EQ(client.GetThemeFontSize(0), 11);
}

TEST_F(ThemeClientTest, AClientWithoutCustomEntriesReadsTheThemeAndClearingStillNotifies) {
  CountingClient client;
  client.updates = 0;
  EXPECT_EQ(client.GetThemeColor(19), Theme::Get().GetColor(19));
  EXPECT_FLOAT_EQ(client.GetThemeFontSize(1), 11);
  client.ClearCustomThemeColor(19);
  client.ClearCustomFontSize(1);
  EXPECT_EQ(client.updates, 2);
  // A colour entry does not answer for a font size of the same id.
  client.SetCustomThemeColor(1, drawbot::ColorRGBA(1, 0, 0, 1));
  EXPECT_FLOAT_EQ(client.GetThemeFontSize(1), 11);
  EXPECT_EQ(client.GetThemeColor(1), drawbot::ColorRGBA(1, 0, 0, 1));
}

TEST_F(ThemeClientTest, AnOwnerGivesItsNamedThemeOrElseTheDefaultAndClientsOnItsSupplierFollow) {
  ThemeP studio(new Theme(379, 3));
  Theme::Initialize(ThemeP(new Theme(379, 3)));
  Theme::RegisterTheme(u"Studio", studio);
  ThemeOwner owner;
  CountingClient client;
  client.UI_SetThemeSupplier(owner.GetSharedThemeSupplier());
  EXPECT_EQ(owner.GetThemeName(), u"DefaultTolliverTheme");
  EXPECT_FALSE(owner.HasThemeName());
  EXPECT_EQ(client.UI_GetCurrentTheme(), Theme::GetTheme(GetDefaultThemeName()));
  owner.SetThemeName(u"Studio", true);
  EXPECT_EQ(owner.GetTheme(), studio);
  EXPECT_EQ(client.UI_GetCurrentTheme(), studio);
  owner.SetThemeName(u"Unknown", false);
  EXPECT_EQ(owner.GetTheme(), Theme::GetTheme(GetDefaultThemeName()));
}

TEST_F(ThemeClientTest, AClientWhoseOwnerIsGoneOrWhoseSupplierGivesNothingReadsTheDefaultTheme) {
  CountingClient client;
  {
    ThemeOwner owner;
    client.UI_SetThemeSupplier(owner.GetSharedThemeSupplier());
  }
  const ThemeP fallback = Theme::GetTheme(GetDefaultThemeName());
  EXPECT_EQ(client.UI_GetCurrentTheme(), fallback);
  client.UI_SetThemeSupplier(SupplierOf(nullptr));
  EXPECT_EQ(client.GetThemeColor(19), fallback->GetColor(19));
  EXPECT_EQ(client.GetThemeFontSize(0), fallback->GetFontSize(0));
  EXPECT_EQ(client.GetThemeFontName(0), fallback->GetFontName(0));
}

}  // namespace
}  // namespace norvik::ui::test
