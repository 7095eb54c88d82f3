#pragma once
// KeyframeThemeEditor is the theme that follows the brightness setting. Each
// tracked colour is a track of key frames in HSB, keyed by the brightness at
// which the frame stands; setting the brightness recomputes every tracked
// colour from its track, over the fixed palette of the base class. Font sizes
// follow the font size scheme through tracks of their own.
//
// Between two key frames, value and alpha move linearly with the brightness,
// while hue and saturation move with the interpolated value instead. A grey
// ramp with a tinted end therefore picks up its tint late, near the tinted
// end; the look of the shipped key frames relies on it.
#include <cstdint>
#include <map>
#include <string_view>

#include "ui/Theme.h"

namespace norvik::ui {

struct KeyValue {
  float mHue = 0;         // degrees
  float mSaturation = 0;  // 0 to 1
  float mValue = 0;       // HSB brightness, 0 to 1
  float mAlpha = 0;       // 0 to 1
  bool mHold = false;     // keep this frame's colour up to the next key

  KeyValue() = default;
  KeyValue(float inHue, float inSaturation, float inValue, float inAlpha, bool inHold)
      : mHue(inHue), mSaturation(inSaturation), mValue(inValue), mAlpha(inAlpha), mHold(inHold) {}

  bool operator==(const KeyValue& o) const {
    return mHue == o.mHue && mSaturation == o.mSaturation && mValue == o.mValue && mAlpha == o.mAlpha &&
           mHold == o.mHold;
  }
};

class KeyframeThemeEditor : public Theme {
 public:
  using ColorTrack = std::map<float, KeyValue>;
  using FontSizeTrack = std::map<std::uint64_t, float>;
  using ColorTracks = std::map<std::uint64_t, ColorTrack>;
  using FontSizeTracks = std::map<std::uint64_t, FontSizeTrack>;

  KeyframeThemeEditor(std::uint64_t inColorCount = 379, std::uint64_t inFontCount = 3);

  // True only for identifiers with a colour track.
  bool HasColor(std::uint64_t inID) const override;
  void DoSetBrightness(float inBrightness) override;
  void DoSetTinting(drawbot::ColorRGBA inTint) override;
  void DoSetFontSizeScheme(std::uint64_t inScheme) override;

  // ---- colour tracks ----
  void SetColorKeyValue(std::uint64_t inID, float inT, const KeyValue& inValue);
  void ClearColorKeyValue(std::uint64_t inID);
  void ClearColorKeyValues();
  // An empty track for an identifier without one.
  const ColorTrack& GetColorTrack(std::uint64_t inID) const;
  void SetColorTrack(std::uint64_t inID, const ColorTrack& inTrack);
  bool HasColorTrack(std::uint64_t inID) const;
  const ColorTracks& GetColorTracks() const { return mColorTracks; }

  // ---- font size tracks, from scheme to size ----
  void SetFontSizeSchemeValue(std::uint64_t inFontID, std::uint64_t inScheme, float inSize);
  void ClearFontSizeSchemeValue(std::uint64_t inFontID);
  void ClearFontSizeSchemeValues();
  const FontSizeTrack& GetFontSizeTrack(std::uint64_t inFontID) const;
  void SetFontSizeTrack(std::uint64_t inFontID, const FontSizeTrack& inTrack);
  bool HasFontSizeTrack(std::uint64_t inFontID) const;
  const FontSizeTracks& GetFontSizeTracks() const { return mFontSizeTracks; }

  // An independent colour is left out of brightness changes although it has a
  // track: it reads the base palette, or whatever is set on it afterwards.
  void SetIndependent(std::uint64_t inID, bool inIndependent);
  bool GetIndependent(std::uint64_t inID) const;

  void SetStrictMode(bool inStrict) { mStrictMode = inStrict; }
  bool GetStrictMode() const { return mStrictMode; }

  // The brightness at which the track of inID gives a colour of inColor's
  // HSB brightness; the default brightness without a track.
  float GetSourceBrightness(std::uint64_t inID, const drawbot::ColorRGBA& inColor) const;
  // The colour of the track of inID at brightness inT; outColor is left as it
  // is when there is no track.
  void InterpolateColor(std::uint64_t inID, float inT, drawbot::ColorRGBA& outColor) const;

  // State derived from the tint for subclasses that colour their tracks.
  float GetTintHue() const { return mTintHue; }
  float GetTintSaturation() const { return mTintSaturation; }
  float GetTintGain() const { return mTintGain; }

  // Reads a key-frame document into this theme. The document replaces the
  // tracks it names and leaves the others. A document that is not well formed
  // (or, in strict mode, an element that lacks an attribute) raises the
  // toolkit's exception and leaves the theme unchanged.
  void LoadKeyframes(std::string_view inXml);

 private:
  ColorTracks mColorTracks;
  std::map<std::uint64_t, bool> mIndependent;
  FontSizeTracks mFontSizeTracks;
  bool mStrictMode = false;
  float mTintHue = 0;
  float mTintSaturation = 0;
  float mTintGain = 1;
};

using KeyframeThemeEditorP = boost::intrusive_ptr<KeyframeThemeEditor>;

// A key-frame theme loaded with the toolkit's own key frames (the resource
// "DefaultThemeKeyframes", type "XML"): dark at low brightness, light at high
// brightness. Raises when the resource is missing.
KeyframeThemeEditorP MakeDefaultKeyframeTheme();

}  // namespace norvik::ui
