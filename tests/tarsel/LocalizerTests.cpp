// Localisation: key texts, escapes, slot filling, translations per locale.
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include "tarsel/Localizer.h"
#include "tarsel/StringUtils.h"
#include "tarsel/ThrowError.h"

using tarsel::config::Localizer;
using tarsel::utility::ReplaceInString;

namespace {

// Each test starts and ends with the process localiser holding no
// translations, and with its own folder of locale files.
class LocalizerTest : public ::testing::Test {
 protected:
  void SetUp() override {
    Localizer::Get().ClearTranslations();
    mPreviousLocale = Localizer::Get().GetLocaleName();
    mDir = std::filesystem::temp_directory_path() /
           ("norvik-locales-" + std::to_string(::testing::UnitTest::GetInstance()->random_seed()) + "-" +
            ::testing::UnitTest::GetInstance()->current_test_info()->name());
    std::filesystem::create_directories(mDir);
  }
  void TearDown() override {
    Localizer::Get().ClearTranslations();
    Localizer::Get().SetLocaleName(mPreviousLocale);
    std::filesystem::remove_all(mDir);
  }
  void WriteLocale(const std::string& name, const std::string& text) {
    std::ofstream(mDir / (name + ".txt"), std::ios::binary) << text;
  }
  std::string Dir() const { return mDir.string(); }

  std::filesystem::path mDir;
  std::string mPreviousLocale;
};

}  // namespace

TEST_F(LocalizerTest, AMissingKeyFallsBackToTheDefaultTextAndTextThatIsNoKeyComesBackUnchanged) {
  EXPECT_EQ(Localizer::Get().Localize("$$$/norvik/dialogs/OK=OK"), u"OK");
  EXPECT_EQ(tarsel::config::Localize("$$$/norvik/x/Empty="), u"");
  EXPECT_EQ(tarsel::config::Localize("$$$/norvik/x/Eq=a=b"), u"a=b") << "the default may itself contain '='";
  EXPECT_EQ(tarsel::config::Localize("plain text"), u"plain text");
  EXPECT_EQ(tarsel::config::Localize("$$$/no/equals"), u"$$$/no/equals");
}

TEST_F(LocalizerTest, LineEndAndApostropheEscapesExpand) {
  EXPECT_EQ(tarsel::config::Localize("$$$/norvik/x/Esc=Don^}t#{endl}stop"), u"Don't\nstop");
  // Translations expand their escapes too.
  Localizer::Get().SetTranslation("norvik/x/Esc", u"N^}arr\u00EAte pas#{endl}!");
  EXPECT_EQ(tarsel::config::Localize("$$$/norvik/x/Esc=Don^}t#{endl}stop"), u"N'arr\u00EAte pas\n!");
}

TEST_F(LocalizerTest, TranslationsOverrideDefaultsAndErrorMessages) {
  Localizer::Get().SetTranslation("tarsel/utility/Error/DivisionByZero", u"Division par z\u00E9ro.");
  try {
    tarsel::utility::Calculate(u"1/0", 1);
    FAIL() << "no exception";
  } catch (const tarsel::config::Exception& e) {
    EXPECT_EQ(e.GetMessage(), u"Division par z\u00E9ro.");
    EXPECT_EQ(e.GetKeyPath(), "tarsel/utility/Error/DivisionByZero");
  }
}

TEST_F(LocalizerTest, LoadLocaleReadsTheFileOfThatLocale) {
  WriteLocale("de_DE",
              "# comment line\n"
              "$$$/norvik/dialogs/OK=OK\n"
              "norvik/dialogs/Cancel = Abbrechen\r\n"
              "\n"
              "not an entry\n"
              "norvik/x/Frames=Bild @0 von @1\n");
  EXPECT_EQ(Localizer::Get().LoadLocale(Dir(), "de_DE"), 3u);
  EXPECT_EQ(Localizer::Get().GetLocaleName(), "de_DE");
  EXPECT_EQ(tarsel::config::Localize("$$$/norvik/dialogs/Cancel=Cancel"), u"Abbrechen");
  EXPECT_EQ(tarsel::config::Localize("$$$/norvik/other=Other"), u"Other");
}

TEST_F(LocalizerTest, LoadLocaleFallsBackToTheLanguageFile) {
  WriteLocale("fr", "\xEF\xBB\xBFnorvik/dialogs/Cancel=Annuler\n");
  EXPECT_EQ(Localizer::Get().LoadLocale(Dir(), "fr_CA.UTF-8"), 1u);
  EXPECT_EQ(Localizer::Get().GetLocaleName(), "fr_CA.UTF-8");
  EXPECT_EQ(tarsel::config::Localize("$$$/norvik/dialogs/Cancel=Cancel"), u"Annuler");
}

TEST_F(LocalizerTest, LoadingAnotherLocaleReplacesThePreviousTranslations) {
  WriteLocale("de", "norvik/a=A-de\nnorvik/b=B-de\n");
  WriteLocale("it", "norvik/a=A-it\n");
  Localizer::Get().LoadLocale(Dir(), "de");
  Localizer::Get().LoadLocale(Dir(), "it");
  EXPECT_EQ(tarsel::config::Localize("$$$/norvik/a=A"), u"A-it");
  EXPECT_EQ(tarsel::config::Localize("$$$/norvik/b=B"), u"B");
}

TEST_F(LocalizerTest, AMissingLocaleRaisesAndKeepsTheCurrentTranslations) {
  WriteLocale("de", "norvik/a=A-de\n");
  Localizer::Get().LoadLocale(Dir(), "de");
  try {
    Localizer::Get().LoadLocale(Dir(), "sv_SE");
    FAIL() << "no exception";
  } catch (const tarsel::config::Exception& e) {
    EXPECT_EQ(e.GetKeyPath(), "tarsel/config/Error/LocaleNotFound");
    EXPECT_NE(std::string(e.what()).find("sv_SE"), std::string::npos);
  }
  EXPECT_EQ(Localizer::Get().GetLocaleName(), "de");
  EXPECT_EQ(tarsel::config::Localize("$$$/norvik/a=A"), u"A-de");
}

TEST_F(LocalizerTest, LocaleNamesCannotReachOutsideTheFolder) {
  std::filesystem::create_directories(mDir / "sub");
  WriteLocale("sub/evil", "norvik/a=evil\n");
  EXPECT_THROW(Localizer::Get().LoadLocale(Dir(), "sub/evil"), tarsel::config::Exception);
  EXPECT_EQ(tarsel::config::Localize("$$$/norvik/a=A"), u"A");
}
