// Reading key-frame documents: what the elements do, that a document replaces
// whole tracks, that bad documents leave the theme alone, and the toolkit's
// own key frames.
#include <string>

#include <gtest/gtest.h>

#include "support/ui/ThemeTestSupport.h"
#include "tarsel/ThrowError.h"
#include "tarsel/XmlParser.h"
#include "ui/KeyframeThemeEditor.h"
#include "ui/KeyframeThemeParser.h"

namespace norvik::ui::test {
namespace {

class KeyframeDocument : public ::testing::Test {
 protected:
  // Parses through the core XML parser, as an application does.
  void ParseDirectly(const std::string& inXml) {
    KeyframeThemeParser handler(editor.get());
    tarsel::xml::GetParser(handler)->Parse(inXml);
  }
  // Expects LoadKeyframes to refuse the document, naming inMention.
  void ExpectRefused(const std::string& inXml, const std::string& inMention) {
    try {
      editor->LoadKeyframes(inXml);
      ADD_FAILURE() << "accepted: " << inXml;
    } catch (const tarsel::config::Exception& e) {
      EXPECT_EQ(e.GetKeyPath(), "norvik/ui/Error/ThemeKeyframeDocument");
      EXPECT_NE(std::string(e.what()).find(inMention), std::string::npos) << e.what();
    }
  }
  KeyframeThemeEditorP editor{new KeyframeThemeEditor()};
};

TEST_F(KeyframeDocument, ReadsKeyFramesWithTheirOptionalAttributes) {
  ParseDirectly(R"(<ThemeColors>
      <KeyFrame name="5" t="0" v="0.2" h="30" s="0.5" a="0.75" hold="true"/>
      <KeyFrame name="5" t="1" v="0.8"/>
    </ThemeColors>)");
  const auto& track = editor->GetColorTrack(5);
  ASSERT_EQ(track.size(), 2u);
  EXPECT_EQ(track.at(0.0f), KeyValue(30, 0.5f, 0.2f, 0.75f, true));
  EXPECT_EQ(track.at(1.0f), KeyValue(0, 0, 0.8f, 1, false));
  ParseDirectly(R"(<ThemeColors><KeyFrame name="7" t="0" v="0.5" h="-1e38" s="1"/></ThemeColors>)");
  EXPECT_LE(editor->GetColor(7).red, 1.0f) << "a hue far beyond any integer still reduces to a colour";
}

TEST_F(KeyframeDocument, KeyFramesInsideAThemeGroupTakeTheGroupsT) {
  ParseDirectly(R"(<ThemeColors>
      <Theme t="0.5"><KeyFrame name="5" t="0.9" v="0.3"/></Theme>
      <KeyFrame name="5" t="0.7" v="0.6"/>
      <Theme><KeyFrame name="6" t="0.9" v="0.3"/></Theme>
    </ThemeColors>)");
  const auto& track = editor->GetColorTrack(5);
  ASSERT_EQ(track.size(), 2u);
  EXPECT_FLOAT_EQ(track.at(0.5f).mValue, 0.3f);
  EXPECT_FLOAT_EQ(track.at(0.7f).mValue, 0.6f);
  ASSERT_EQ(editor->GetColorTrack(6).count(0.0f), 1u) << "a group without t still groups, at t 0";
}

TEST_F(KeyframeDocument, ElementsLackingAnAttributeOrWithNumbersThatDoNotReadAreLeftOutAndUnknownIdsKept) {
  ParseDirectly(R"(<ThemeColors>
      <KeyFrame name="5" t="zero" v="0.9"/> <KeyFrame name="6" t="0" v="x"/>
      <KeyFrame name="400" t="0" v="0.5"/> <FontSize name="3" scheme="1" size="20"/>
      <KeyFrame t="0" v="0.2"/> <KeyFrame name="8" v="0.2"/> <KeyFrame name="9" t="0"/>
      <KeyFrame name="7" t="0" v="0.4" hold="yes"/>
      <FontSize name="1" size="15"/><FontSize scheme="1" size="15"/>
    </ThemeColors>)");
  for (std::uint64_t id : {5, 6, 8, 9}) EXPECT_FALSE(editor->HasColorTrack(id)) << id;
  EXPECT_TRUE(editor->HasColorTrack(400));
  ASSERT_TRUE(editor->HasColorTrack(7));
  EXPECT_FALSE(editor->GetColorTrack(7).at(0.0f).mHold);
  EXPECT_EQ(editor->GetFontSizeTracks().size(), 1u);
  EXPECT_TRUE(editor->HasFontSizeTrack(3));
}

TEST_F(KeyframeDocument, StrictModeRefusesIncompleteElements) {
  editor->SetStrictMode(true);
  ExpectRefused(R"(<ThemeColors><KeyFrame name="5" t="0"/></ThemeColors>)", "KeyFrame");
  ExpectRefused(R"(<ThemeColors><FontSize name="0" size="9"/></ThemeColors>)", "FontSize");
}

TEST_F(KeyframeDocument, ADocumentReplacesWholeTracksLeavingOthersAndALaterKeyAtTheSameTWins) {
  editor->SetColorKeyValue(5, 0.3f, KeyValue(0, 0, 0.9f, 1, false));
  editor->SetColorKeyValue(6, 0, KeyValue(0, 0, 0.1f, 1, false));
  editor->LoadKeyframes(R"(<ThemeColors>
      <KeyFrame name="5" t="0" v="0.2"/><KeyFrame name="5" t="0" v="0.6"/>
    </ThemeColors>)");
  ASSERT_EQ(editor->GetColorTrack(5).size(), 1u);
  EXPECT_FLOAT_EQ(editor->GetColorTrack(5).at(0.0f).mValue, 0.6f);
  EXPECT_TRUE(editor->HasColorTrack(6));
}

TEST_F(KeyframeDocument, LoadingTwiceGivesTheSameTracksAsOnce) {
  const std::string doc = R"(<ThemeColors>
      <KeyFrame name="5" t="0" v="0.2"/><KeyFrame name="5" t="1" v="0.7"/>
      <FontSize name="1" scheme="2" size="15"/>
    </ThemeColors>)";
  editor->LoadKeyframes(doc);
  const auto tracks = editor->GetColorTracks();
  const auto fonts = editor->GetFontSizeTracks();
  editor->LoadKeyframes(doc);
  EXPECT_EQ(editor->GetColorTracks(), tracks);
  EXPECT_EQ(editor->GetFontSizeTracks(), fonts);
}

TEST_F(KeyframeDocument, TheTracksTakeEffectAtTheEndOfTheDocument) {
  editor->SetBrightness(0.5f);
  editor->SetFontSizeScheme(2);
  editor->LoadKeyframes(R"(<ThemeColors>
      <KeyFrame name="5" t="0" v="0"/><KeyFrame name="5" t="1" v="1"/>
      <ThemeFonts><FontSize name="1" scheme="2" size="15"/></ThemeFonts>
    </ThemeColors>)");
  EXPECT_TRUE(ColorNear(editor->GetColor(5), Grey(0.5f)));
  EXPECT_FLOAT_EQ(editor->GetFontSize(1), 15);
}

class KeyframeDocumentRefusal : public KeyframeDocument {
 protected:
  void SetUp() override {
    editor->LoadKeyframes(R"(<ThemeColors><KeyFrame name="5" t="0" v="0.3"/></ThemeColors>)");
    tracksBefore = editor->GetColorTracks();
    colorBefore = editor->GetColor(5);
  }
  void TearDown() override {
    EXPECT_EQ(editor->GetColorTracks(), tracksBefore);
    EXPECT_EQ(editor->GetColor(5), colorBefore);
    EXPECT_TRUE(editor->GetFontSizeTracks().empty());
  }
  KeyframeThemeEditor::ColorTracks tracksBefore;
  drawbot::ColorRGBA colorBefore;
};

TEST_F(KeyframeDocumentRefusal, ADocumentThatIsNotWellFormedOrEmpty) {
  ExpectRefused(R"(<ThemeColors><KeyFrame name="5" t="0" v="0.9"/><FontSize name="0" scheme="1" size="20"/>)",
                "line");
  ExpectRefused("", "line");
}

class DefaultKeyframes : public ::testing::Test {
 protected:
  ScPrivateConfigDir config;
  KeyframeThemeEditorP theme = MakeDefaultKeyframeTheme();
};

TEST_F(DefaultKeyframes, LowBrightnessIsTheDarkLookAndHighTheLightWhileAccentsKeepThePalette) {
  theme->SetBrightness(0);
  EXPECT_LT(theme->GetColor(2).red, 0.2f);    // panel fill
  EXPECT_GT(theme->GetColor(1).red, 0.7f);    // text
  EXPECT_EQ(theme->GetIconType(), 0) << "light glyphs on the dark panels";
  ThemeP plain(new Theme(379, 3));
  EXPECT_EQ(theme->GetColor(18), plain->GetColor(18)) << "accent blue keeps its palette value";
  EXPECT_EQ(theme->GetColor(0), plain->GetColor(0)) << "so does the white overlay";
  EXPECT_FALSE(theme->HasColor(18));
  theme->SetBrightness(1);
  EXPECT_TRUE(ColorNear(theme->GetColor(2), Grey(1)));
  EXPECT_TRUE(ColorNear(theme->GetColor(1), Grey(0x26 / 255.0f)));
  EXPECT_EQ(theme->GetIconType(), 1) << "the dark \"_D\" glyphs on the light panels";
}

TEST_F(DefaultKeyframes, TheSchemesGiveSmallMediumAndLargeFonts) {
  theme->SetFontSizeScheme(0);
  const float small = theme->GetFontSize(0);
  theme->SetFontSizeScheme(2);
  const float large = theme->GetFontSize(0);
  theme->SetFontSizeScheme(1);
  EXPECT_LT(small, theme->GetFontSize(0));
  EXPECT_LT(theme->GetFontSize(0), large);
}

}  // namespace
}  // namespace norvik::ui::test
