#include "ui/KeyframeThemeEditor.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <vector>

#include "drawbot/Drawbot.h"
#include "tarsel/ModuleResources.h"
#include "tarsel/ThrowError.h"
#include "ui/KeyframeThemeParser.h"

namespace norvik::ui {

namespace {

// Interpolating between extreme key frames can leave any float here: what is
// not a number counts as 0.
float Clamp01(float inValue) { return inValue > 0 ? std::min(inValue, 1.0f) : 0.0f; }

drawbot::ColorRGBA ColorFromKeyValue(const KeyValue& inValue) {
  const float s = Clamp01(inValue.mSaturation);
  const float v = Clamp01(inValue.mValue);
  const float a = Clamp01(inValue.mAlpha);
  // Hue is whole degrees, reduced like an integer remainder, but as a float
  // first: an interpolated hue can lie far beyond any integer.
  const float degrees = std::isfinite(inValue.mHue) ? std::fmod(std::trunc(inValue.mHue), 360.0f) : 0.0f;
  long hue = static_cast<long>(degrees);
  if (!(s > 0)) hue = 0;
  return drawbot::HSBtoRGB(static_cast<float>(hue), s, v, a);
}

}  // namespace

KeyframeThemeEditor::KeyframeThemeEditor(std::uint64_t inColorCount, std::uint64_t inFontCount)
    : Theme(inColorCount, inFontCount) {}

bool KeyframeThemeEditor::HasColor(std::uint64_t inID) const { return HasColorTrack(inID); }

void KeyframeThemeEditor::DoSetBrightness(float inBrightness) {
  Theme::DoSetBrightness(inBrightness);
  for (const auto& entry : mColorTracks) {
    if (GetIndependent(entry.first)) continue;
    drawbot::ColorRGBA color(0, 0, 0, 1);
    InterpolateColor(entry.first, inBrightness, color);
    SetColor(entry.first, color);
  }
}

void KeyframeThemeEditor::DoSetTinting(drawbot::ColorRGBA inTint) {
  Theme::DoSetTinting(inTint);
  float h = 0, s = 0, b = 0;
  drawbot::RGBtoHSB(inTint, h, s, b);
  mTintHue = h;
  mTintSaturation = s * std::min(b * b * 4.0f, 0.33f);
  mTintGain = std::pow(2.0f, 1.0f - 2.0f * b);
  DoSetBrightness(GetBrightness());
}

void KeyframeThemeEditor::DoSetFontSizeScheme(std::uint64_t inScheme) {
  Theme::DoSetFontSizeScheme(inScheme);
  for (const auto& entry : mFontSizeTracks) {
    if (entry.first >= GetFontCount()) continue;
    auto hit = entry.second.find(inScheme);
    if (hit != entry.second.end()) SetFontSize(entry.first, hit->second);
  }
}

// ---------------------------------------------------------------- colour tracks

void KeyframeThemeEditor::SetColorKeyValue(std::uint64_t inID, float inT, const KeyValue& inValue) {
  mColorTracks[inID][inT] = inValue;
}

void KeyframeThemeEditor::ClearColorKeyValue(std::uint64_t inID) { mColorTracks.erase(inID); }

void KeyframeThemeEditor::ClearColorKeyValues() { mColorTracks.clear(); }

const KeyframeThemeEditor::ColorTrack& KeyframeThemeEditor::GetColorTrack(std::uint64_t inID) const {
  static const ColorTrack kEmpty;
  auto it = mColorTracks.find(inID);
  return it != mColorTracks.end() ? it->second : kEmpty;
}

void KeyframeThemeEditor::SetColorTrack(std::uint64_t inID, const ColorTrack& inTrack) {
  mColorTracks[inID] = inTrack;
}

bool KeyframeThemeEditor::HasColorTrack(std::uint64_t inID) const { return mColorTracks.count(inID) != 0; }

// ---------------------------------------------------------------- font size tracks

void KeyframeThemeEditor::SetFontSizeSchemeValue(std::uint64_t inFontID, std::uint64_t inScheme, float inSize) {
  mFontSizeTracks[inFontID][inScheme] = inSize;
}

void KeyframeThemeEditor::ClearFontSizeSchemeValue(std::uint64_t inFontID) { mFontSizeTracks.erase(inFontID); }

void KeyframeThemeEditor::ClearFontSizeSchemeValues() { mFontSizeTracks.clear(); }

const KeyframeThemeEditor::FontSizeTrack& KeyframeThemeEditor::GetFontSizeTrack(std::uint64_t inFontID) const {
  static const FontSizeTrack kEmpty;
  auto it = mFontSizeTracks.find(inFontID);
  return it != mFontSizeTracks.end() ? it->second : kEmpty;
}

void KeyframeThemeEditor::SetFontSizeTrack(std::uint64_t inFontID, const FontSizeTrack& inTrack) {
  mFontSizeTracks[inFontID] = inTrack;
}

bool KeyframeThemeEditor::HasFontSizeTrack(std::uint64_t inFontID) const {
  return mFontSizeTracks.count(inFontID) != 0;
}

void KeyframeThemeEditor::SetIndependent(std::uint64_t inID, bool inIndependent) {
  mIndependent[inID] = inIndependent;
}

bool KeyframeThemeEditor::GetIndependent(std::uint64_t inID) const {
  auto it = mIndependent.find(inID);
  return it != mIndependent.end() && it->second;
}

// ---------------------------------------------------------------- evaluation

void KeyframeThemeEditor::InterpolateColor(std::uint64_t inID, float inT, drawbot::ColorRGBA& outColor) const {
  auto trackIt = mColorTracks.find(inID);
  if (trackIt == mColorTracks.end() || trackIt->second.empty()) return;
  const ColorTrack& track = trackIt->second;

  auto upper = track.upper_bound(inT);
  if (upper == track.end()) {
    outColor = ColorFromKeyValue(std::prev(track.end())->second);
    return;
  }
  // Below the first key a track has no meaning; its first frame stands in.
  if (upper == track.begin()) {
    outColor = ColorFromKeyValue(upper->second);
    return;
  }
  auto lower = std::prev(upper);
  const KeyValue& k0 = lower->second;
  const KeyValue& k1 = upper->second;
  if (k0.mHold) {
    outColor = ColorFromKeyValue(k0);
    return;
  }
  const float t0 = lower->first, t1 = upper->first;
  const float f = (inT - t0) / (t1 - t0);
  KeyValue result;
  result.mValue = k0.mValue + (k1.mValue - k0.mValue) * f;
  result.mAlpha = k0.mAlpha + (k1.mAlpha - k0.mAlpha) * f;
  // Hue and saturation follow the interpolated value, not the brightness.
  const float g = (result.mValue - t0) / (t1 - t0);
  result.mHue = k0.mHue + (k1.mHue - k0.mHue) * g;
  result.mSaturation = k0.mSaturation + (k1.mSaturation - k0.mSaturation) * g;
  outColor = ColorFromKeyValue(result);
}

float KeyframeThemeEditor::GetSourceBrightness(std::uint64_t inID, const drawbot::ColorRGBA& inColor) const {
  const float fallback = GetDefaultBrightness();
  auto trackIt = mColorTracks.find(inID);
  if (trackIt == mColorTracks.end() || trackIt->second.empty()) return fallback;
  const ColorTrack& track = trackIt->second;

  float h = 0, s = 0, b = 0;
  drawbot::RGBtoHSB(inColor, h, s, b);
  auto it = std::find_if(track.begin(), track.end(), [b](const auto& e) { return !(e.second.mValue < b); });
  if (it == track.end()) return std::prev(track.end())->first;
  if (std::fabs(it->second.mValue - b) <= 0.001f || it == track.begin()) return it->first;
  auto prev = std::prev(it);
  const float span = it->second.mValue - prev->second.mValue;
  return prev->first + (it->first - prev->first) * ((b - prev->second.mValue) / span);
}

// ---------------------------------------------------------------- documents

void KeyframeThemeEditor::LoadKeyframes(std::string_view inXml) {
  // Parse into a copy so that a failing document leaves this theme alone.
  KeyframeThemeEditorP staging(new KeyframeThemeEditor(GetColorCount(), GetFontCount()));
  staging->mColorTracks = mColorTracks;
  staging->mFontSizeTracks = mFontSizeTracks;
  staging->mStrictMode = mStrictMode;
  KeyframeThemeParser handler(staging.get());
  try {
    tarsel::xml::GetParser(handler)->Parse(inXml);
  } catch (const tarsel::config::Exception& e) {
    tarsel::config::ThrowError(
        tarsel::config::ErrorLevel::kError,
        "$$$/norvik/ui/Error/ThemeKeyframeDocument=The theme key-frame document could not be read: ^0", 0, 0,
        false, e.GetMessage());
  }
  mColorTracks.swap(staging->mColorTracks);
  mFontSizeTracks.swap(staging->mFontSizeTracks);
  SetBrightness(GetBrightness());
  SetFontSizeScheme(GetFontSizeScheme());
}

KeyframeThemeEditorP MakeDefaultKeyframeTheme() {
  std::vector<unsigned char> bytes;
  if (!tarsel::resources::GetBinaryFromModule(tarsel::resources::kThisModule, "DefaultThemeKeyframes", "XML",
                                              bytes)) {
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                               "$$$/norvik/ui/Error/ThemeResourceMissing=The theme resource ^0 is missing.", 0, 0,
                               false, "DefaultThemeKeyframes");
  }
  KeyframeThemeEditorP theme(new KeyframeThemeEditor());
  theme->LoadKeyframes(std::string_view(reinterpret_cast<const char*>(bytes.data()), bytes.size()));
  return theme;
}

}  // namespace norvik::ui
