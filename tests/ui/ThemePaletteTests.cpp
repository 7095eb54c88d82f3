// The plain theme: its fixed palette, fonts and the settings that do not
// change its colours.
#include <gtest/gtest.h>

#include "support/ui/ThemeTestSupport.h"
#include "ui/Theme.h"

namespace norvik::ui::test {
namespace {

drawbot::ColorRGBA Bytes(int r, int g, int b, float a = 1) {
  return drawbot::ColorRGBA(r / 255.0f, g / 255.0f, b / 255.0f, a);
}

TEST(ThemePalette, HasEveryColourFromZeroTo378AndAnswersADefaultForOthersWithoutFailing) {
  ThemeP theme(new Theme(379, 3));
  for (std::uint64_t id = 0; id < 379; ++id) EXPECT_TRUE(theme->HasColor(id)) << id;
  EXPECT_FALSE(theme->HasColor(379));
  EXPECT_FALSE(theme->HasColor(5000));
  EXPECT_NO_THROW(theme->GetColor(5000));
}

TEST(ThemePalette, AnswersThePaletteValuesIncludingTranslucentEntries) {
  ThemeP theme(new Theme(379, 3));
  EXPECT_TRUE(ColorNear(theme->GetColor(0), Bytes(255, 255, 255, 0.75f)));
  EXPECT_TRUE(ColorNear(theme->GetColor(1), Bytes(0x26, 0x26, 0x26)));
  EXPECT_TRUE(ColorNear(theme->GetColor(8), Bytes(0x00, 0x98, 0xFF, 0.74f)));
  EXPECT_TRUE(ColorNear(theme->GetColor(11), Bytes(0x85, 0x86, 0x85)));
  EXPECT_TRUE(ColorNear(theme->GetColor(202), Bytes(0, 0, 0, 0.02f)));
  EXPECT_TRUE(ColorNear(theme->GetColor(264), Bytes(0xFF, 0x2E, 0x1C)));
  EXPECT_TRUE(ColorNear(theme->GetColor(290), Bytes(0xFF, 0xBB, 0x00)));
  EXPECT_TRUE(ColorNear(theme->GetColor(337), Bytes(0xFF, 0, 0)));
  EXPECT_TRUE(ColorNear(theme->GetColor(378), Bytes(0xB4, 0xB4, 0xB4)));
}

TEST(ThemePalette, BrightnessIsStoredButLeavesEveryColourAndUpdateRestoresAnOverwrittenOne) {
  ThemeP theme(new Theme(379, 3));
  std::vector<drawbot::ColorRGBA> before;
  for (std::uint64_t id = 0; id < 379; ++id) before.push_back(theme->GetColor(id));
  theme->SetBrightness(0.9f);
  EXPECT_FLOAT_EQ(theme->GetBrightness(), 0.9f);
  for (std::uint64_t id = 0; id < 379; ++id) EXPECT_EQ(theme->GetColor(id), before[id]) << id;
  theme->SetColor(19, drawbot::ColorRGBA(1, 0, 0, 1));
  EXPECT_EQ(theme->GetColor(19), drawbot::ColorRGBA(1, 0, 0, 1));
  theme->Update();
  EXPECT_EQ(theme->GetColor(19), before[19]);
}

TEST(ThemeFonts, ThreeFontsShareTheFirstCandidateAtSizeElevenWhateverTheSizeScheme) {
  ScPrivateConfigDir config;
  ThemeP theme(new Theme(379, 3));
  theme->SetFontSizeScheme(2);
  EXPECT_EQ(theme->GetFontSizeScheme(), 2u);
  for (std::uint64_t id = 0; id < 3; ++id) {
    EXPECT_EQ(theme->GetFontName(id), u"Tahoma") << id;
    EXPECT_FLOAT_EQ(theme->GetFontSize(id), 11) << id;
  }
}

class GB18030Setting : public ::testing::Test {
 protected:
  void TearDown() override { Theme::SetFontProbe(Theme::FontProbe()); }
  ScPrivateConfigDir config;
};

TEST_F(GB18030Setting, TheSettingAndAnAvailableFontSelectTheGB18030Font) {
  config.WriteCommonSettings("# shared settings\nGB18030 UI Support=TRUE\n");
  Theme::SetFontProbe([](const UTF16String& inName, float) { return inName == u"SimSun-18030"; });
  ThemeP theme(new Theme(379, 3));
  EXPECT_EQ(theme->GetFontName(0), u"SimSun-18030");
  EXPECT_EQ(theme->GetFontName(2), u"SimSun-18030");
}

TEST_F(GB18030Setting, AFontThePlatformCannotMakeKeepsTheDefaultFont) {
  config.WriteCommonSettings("GB18030 UI Support=TRUE\r\n");
  Theme::SetFontProbe([](const UTF16String&, float) { return false; });
  EXPECT_EQ(ThemeP(new Theme(379, 3))->GetFontName(1), u"Tahoma");
}

TEST(ThemeIconType, FollowsTheLightnessOfColour282) {
  ThemeP theme(new Theme(379, 3));
  EXPECT_EQ(theme->GetIconType(), 0);  // 262626 is dark
  theme->SetColor(282, drawbot::ColorRGBA(0.6f, 0.6f, 0.6f, 1));
  EXPECT_EQ(theme->GetIconType(), 1);
  theme->SetColor(282, drawbot::ColorRGBA(0.5f, 0.5f, 0.5f, 1));
  EXPECT_EQ(theme->GetIconType(), 0);  // the mean must be above one half
}

}  // namespace
}  // namespace norvik::ui::test
