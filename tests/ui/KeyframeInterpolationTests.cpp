// How a key-frame theme turns brightness into colours: interpolation at and
// between keys, holds, caps, hue reduction, the inverse look-up, tint and
// font size schemes.
#include <gtest/gtest.h>

#include "drawbot/Drawbot.h"
#include "support/ui/ThemeTestSupport.h"
#include "ui/KeyframeThemeEditor.h"

namespace norvik::ui::test {
namespace {

class KeyframeInterpolation : public ::testing::Test {
 protected:
  drawbot::ColorRGBA At(std::uint64_t inID, float inT) const {
    drawbot::ColorRGBA c(0, 0, 0, 1);
    editor->InterpolateColor(inID, inT, c);
    return c;
  }
  KeyframeThemeEditorP editor{new KeyframeThemeEditor()};
};

// Each row is one track of keys (at t) and the colour it gives at one
// brightness; a track id with no keys leaves the given colour alone.
TEST_F(KeyframeInterpolation, ATrackGivesItsKeysAndInterpolatesHoldsAndCapsBetweenThem) {
  struct Key {
    float t;
    KeyValue value;
  };
  struct Row {
    const char* why;
    std::vector<Key> keys;
    float t;
    drawbot::ColorRGBA expected;
  };
  const Row rows[] = {
      {"a key gives its own colour", {{0, KeyValue(0, 0, 0.2f, 1, false)}, {1, KeyValue(0, 0, 0.9f, 0.5f, false)}}, 1,
       Grey(0.9f, 0.5f)},
      {"on a unit ramp value, hue and saturation move together",
       {{0, KeyValue(0, 0, 0, 1, false)}, {1, KeyValue(120, 1, 1, 1, false)}}, 0.5f,
       drawbot::HSBtoRGB(60.0f, 0.5f, 0.5f, 1)},
      {"hue and saturation follow the interpolated value (0.3), not the brightness",
       {{0, KeyValue(0, 0, 0.2f, 1, false)}, {1, KeyValue(240, 1, 0.4f, 1, false)}}, 0.5f,
       drawbot::HSBtoRGB(72.0f, 0.3f, 0.3f, 1)},
      {"alpha moves linearly", {{0, KeyValue(0, 0, 0.5f, 0.2f, false)}, {1, KeyValue(0, 0, 0.5f, 1, false)}}, 0.25f,
       Grey(0.5f, 0.4f)},
      {"a held key lasts up to the next key",
       {{0, KeyValue(0, 0, 0.2f, 1, true)}, {0.5f, KeyValue(0, 0, 0.8f, 1, false)}}, 0.4999f, Grey(0.2f)},
      {"the next key after a hold", {{0, KeyValue(0, 0, 0.2f, 1, true)}, {0.5f, KeyValue(0, 0, 0.8f, 1, false)}},
       0.5f, Grey(0.8f)},
      {"between the keys after a hold",
       {{0, KeyValue(0, 0, 0.2f, 1, true)}, {0.5f, KeyValue(0, 0, 0.8f, 1, false)}, {1, KeyValue(0, 0, 1, 1, false)}},
       0.75f, Grey(0.9f)},
      {"above the last key its colour stands, capped",
       {{0, KeyValue(0, 0, 0.1f, 1, false)}, {0.5f, KeyValue(0, 0, 1.5f, 2.0f, false)}}, 0.9f, Grey(1.0f, 1.0f)},
      {"hue reduced modulo 360", {{0, KeyValue(370, 1, 1, 1, false)}}, 0.5f, drawbot::HSBtoRGB(10.0f, 1.0f, 1.0f, 1)},
      {"hue truncated", {{0, KeyValue(359.9f, 1, 1, 1, false)}}, 0.5f, drawbot::HSBtoRGB(359.0f, 1.0f, 1.0f, 1)},
      {"zero saturation is grey whatever the hue", {{0, KeyValue(200, 0, 0.4f, 1, false)}}, 0.7f, Grey(0.4f)},
      {"no track", {}, 0.5f, drawbot::ColorRGBA(0.3f, 0.6f, 0.9f, 0.5f)},
  };
  for (const Row& row : rows) {
    editor->ClearColorKeyValues();
    for (const Key& key : row.keys) editor->SetColorKeyValue(5, key.t, key.value);
    drawbot::ColorRGBA c(0.3f, 0.6f, 0.9f, 0.5f);
    editor->InterpolateColor(5, row.t, c);
    EXPECT_TRUE(ColorNear(c, row.expected)) << row.why;
  }
}

TEST_F(KeyframeInterpolation, BrightnessRecomputesTrackedColoursAndRestoresThePaletteElsewhere) {
  const drawbot::ColorRGBA palette19 = editor->GetColor(19);
  editor->SetColorKeyValue(5, 0, KeyValue(0, 0, 0, 1, false));
  editor->SetColorKeyValue(5, 1, KeyValue(0, 0, 1, 1, false));
  editor->SetColor(19, drawbot::ColorRGBA(1, 0, 0, 1));
  editor->SetBrightness(0.6f);
  EXPECT_TRUE(ColorNear(editor->GetColor(5), Grey(0.6f)));
  EXPECT_EQ(editor->GetColor(19), palette19);
  EXPECT_TRUE(editor->HasColor(5));
  EXPECT_FALSE(editor->HasColor(19));
}

TEST_F(KeyframeInterpolation, AnIndependentColourIsLeftOutOfBrightnessChanges) {
  editor->SetColorKeyValue(5, 0, KeyValue(0, 0, 0, 1, false));
  editor->SetColorKeyValue(5, 1, KeyValue(0, 0, 1, 1, false));
  editor->SetBrightness(0.5f);
  editor->SetIndependent(5, true);
  editor->SetBrightness(0.9f);
  EXPECT_TRUE(editor->GetIndependent(5));
  EXPECT_FALSE(editor->GetIndependent(6));
  // Independence skips the track; what the colour reads is the base palette
  // that the brightness change wrote.
  EXPECT_EQ(editor->GetColor(5), ThemeP(new Theme(379, 3))->GetColor(5));
  editor->SetIndependent(5, false);
  editor->SetBrightness(0.9f);
  EXPECT_TRUE(ColorNear(editor->GetColor(5), Grey(0.9f)));
}

TEST_F(KeyframeInterpolation, ClearingTracksRemovesThem) {
  editor->SetColorKeyValue(5, 0, KeyValue(0, 0, 0, 1, false));
  editor->SetColorKeyValue(6, 0, KeyValue(0, 0, 0, 1, false));
  editor->ClearColorKeyValue(5);
  EXPECT_FALSE(editor->HasColorTrack(5));
  EXPECT_TRUE(editor->HasColorTrack(6));
  editor->ClearColorKeyValues();
  EXPECT_FALSE(editor->HasColorTrack(6));
  EXPECT_TRUE(editor->GetColorTrack(6).empty());
}

TEST_F(KeyframeInterpolation, TheSourceBrightnessOfAColourInvertsItsTrack) {
  editor->SetColorKeyValue(5, 0, KeyValue(0, 0, 0.1f, 1, false));
  editor->SetColorKeyValue(5, 1, KeyValue(0, 0, 0.9f, 1, false));
  const struct {
    std::uint64_t id;
    float grey, expected;
    const char* why;
  } rows[] = {
      {5, 0.5f, 0.5f, "between keys"},     {5, 0.3f, 0.25f, "between keys"},
      {5, 0.9f, 1, "a matching frame"},    {5, 0.05f, 0, "below the first frame"},
      {5, 0.95f, 1, "beyond the brightest frame"}, {99, 0.7f, 0.25f, "no track: the default brightness"},
  };
  for (const auto& row : rows)
    EXPECT_NEAR(editor->GetSourceBrightness(row.id, Grey(row.grey)), row.expected, 1e-5f) << row.why;
}

TEST(KeyframeTint, DerivesHueSaturationAndGainFromTheTint) {
  KeyframeThemeEditorP editor(new KeyframeThemeEditor());
  editor->SetTinting(drawbot::ColorRGBA(1, 0, 0, 1));
  EXPECT_FLOAT_EQ(editor->GetTintHue(), 0);
  EXPECT_FLOAT_EQ(editor->GetTintSaturation(), 0.33f);
  EXPECT_FLOAT_EQ(editor->GetTintGain(), 0.5f);
  editor->SetTinting(drawbot::ColorRGBA(0, 0.25f, 0, 1));
  EXPECT_FLOAT_EQ(editor->GetTintHue(), 120);
  EXPECT_FLOAT_EQ(editor->GetTintSaturation(), 0.25f);
  EXPECT_NEAR(editor->GetTintGain(), std::sqrt(2.0f), 1e-5f);
  EXPECT_EQ(editor->GetTinting(), drawbot::ColorRGBA(0, 0.25f, 0, 1));
}

TEST(KeyframeTint, SettingATintRecomputesTheColours) {
  KeyframeThemeEditorP editor(new KeyframeThemeEditor());
  editor->SetColorKeyValue(5, 0, KeyValue(0, 0, 0.4f, 1, false));
  editor->SetColor(5, drawbot::ColorRGBA(1, 0, 0, 1));
  editor->SetTinting(drawbot::ColorRGBA(0, 0, 1, 1));
  EXPECT_TRUE(ColorNear(editor->GetColor(5), Grey(0.4f)));
}

TEST(KeyframeFontSizes, ASchemeWithASizeSetsItAndAMissingSchemeKeepsTheLastSize) {
  KeyframeThemeEditorP editor(new KeyframeThemeEditor());
  editor->SetFontSizeSchemeValue(0, 2, 14);
  editor->SetFontSizeSchemeValue(0, 1, 12);
  editor->SetFontSizeScheme(2);
  EXPECT_FLOAT_EQ(editor->GetFontSize(0), 14);
  EXPECT_FLOAT_EQ(editor->GetFontSize(1), 11);  // no track
  editor->SetFontSizeScheme(7);
  EXPECT_FLOAT_EQ(editor->GetFontSize(0), 14);
  editor->SetFontSizeScheme(1);
  EXPECT_FLOAT_EQ(editor->GetFontSize(0), 12);
  EXPECT_EQ(editor->GetFontSizeTrack(0).size(), 2u);
  editor->ClearFontSizeSchemeValue(0);
  EXPECT_FALSE(editor->HasFontSizeTrack(0));
}

TEST(KeyframeFontSizes, ATrackForAFontTheThemeLacksIsIgnored) {
  KeyframeThemeEditorP editor(new KeyframeThemeEditor());
  editor->SetFontSizeSchemeValue(9, 1, 30);
  EXPECT_NO_THROW(editor->SetFontSizeScheme(1));
  EXPECT_FLOAT_EQ(editor->GetFontSize(2), 11);
}

}  // namespace
}  // namespace norvik::ui::test
