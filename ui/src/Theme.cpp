#include "ui/Theme.h"

#include <algorithm>

#include "tarsel/ThrowError.h"
#include "ui/CommonSettings.h"
#include "ui/src/ThemeDefaultPalette.h"

namespace norvik::ui {

Theme::Registry Theme::gThemeRegistry;

namespace {

constexpr float kInitialFontSize = 11;

// The gain applied to the opaque entries of the palette. It is 1 today; it
// stays as a step of its own so that a fixed gain can be put here without
// touching the palette, and it never pushes a channel past 1 nor touches alpha.
constexpr float kOpaqueEntryGain = 1;

Theme::FontProbe& FontProbeHook() {
  static Theme::FontProbe probe;
  return probe;
}

drawbot::ColorRGBA ColorFromEntry(const detail::PaletteEntry& inEntry) {
  return drawbot::ColorRGBA(static_cast<float>((inEntry.rgb >> 16) & 0xFF) / 255.0f,
                            static_cast<float>((inEntry.rgb >> 8) & 0xFF) / 255.0f,
                            static_cast<float>(inEntry.rgb & 0xFF) / 255.0f, inEntry.alpha);
}

void ApplyGain(drawbot::ColorRGBA& ioColor, float inGain) {
  ioColor.red = std::min(ioColor.red * inGain, 1.0f);
  ioColor.green = std::min(ioColor.green * inGain, 1.0f);
  ioColor.blue = std::min(ioColor.blue * inGain, 1.0f);
}

// The GB18030 font is wanted when the shared setting holds exactly "TRUE".
bool WantsGB18030Font() {
  UTF16String value;
  return ReadCommonSetting(u"GB18030 UI Support", value) && value == u"TRUE";
}

}  // namespace

Theme::Theme(std::uint64_t inColorCount, std::uint64_t inFontCount)
    : mColorCount(inColorCount),
      mFontNames(inFontCount),
      mFontSizes(inFontCount, kInitialFontSize),
      mBrightness(GetDefaultBrightness()),
      mFontSizeScheme(GetDefaultFontSizeScheme()) {
  // Runs the base version even for a subclass: its tracks do not exist yet.
  Theme::DoSetBrightness(mBrightness);
  DoSetFontNames();
}

Theme::~Theme() = default;

bool Theme::HasColor(std::uint64_t inID) const { return mColors.count(inID) != 0; }

const drawbot::ColorRGBA& Theme::GetColor(std::uint64_t inID) const {
  static const drawbot::ColorRGBA kUnknown;
  auto it = mColors.find(inID);
  return it != mColors.end() ? it->second : kUnknown;
}

const UTF16String& Theme::GetFontName(std::uint64_t inID) const { return mFontNames[inID]; }

float Theme::GetFontSize(std::uint64_t inID) const { return mFontSizes[inID]; }

float Theme::DoGetBrightness() const { return mBrightness; }

void Theme::DoSetBrightness(float inBrightness) {
  mBrightness = inBrightness;
  AssignDefaultPalette();
}

void Theme::DoSetTinting(drawbot::ColorRGBA inTint) { mTint = inTint; }

void Theme::DoSetFontSizeScheme(std::uint64_t inScheme) { mFontSizeScheme = inScheme; }

void Theme::AssignDefaultPalette() {
  const std::uint64_t count = std::min<std::uint64_t>(mColorCount, detail::kDefaultColorCount);
  for (std::uint64_t id = 0; id < count; ++id) {
    drawbot::ColorRGBA color = ColorFromEntry(detail::kDefaultPalette[id]);
    if (color.alpha >= 1) ApplyGain(color, kOpaqueEntryGain);
    mColors[id] = color;
  }
}

void Theme::DoSetFontNames() {
  // The first candidate is the one used; the others are kept for the font
  // layer, which falls back on the platform's own families when it lacks it.
  static const UTF16String kCandidates[] = {u"Tahoma", u"Tessaly Web", u"Tessaly Web Pro", u"Segoe UI"};
  UTF16String name = kCandidates[0];
  if (WantsGB18030Font()) {
    const FontProbe& probe = FontProbeHook();
    if (probe && probe(u"SimSun-18030", kInitialFontSize)) name = u"SimSun-18030";
  }
  for (std::uint64_t id : {1, 0, 2}) {
    if (id < mFontNames.size()) mFontNames[id] = name;
  }
}

void Theme::SetFontProbe(const FontProbe& inProbe) { FontProbeHook() = inProbe; }

int Theme::GetIconType() const {
  const drawbot::ColorRGBA& c = GetColor(282);
  return (c.red + c.green + c.blue) / 3 > 0.5f ? 1 : 0;
}

void Theme::InstallThemeChangedFunction(const ThemeChangedFunction& inFunction) {
  mThemeChangedFunctions.push_back(inFunction);
}

void Theme::NotifyThemeChanged() const {
  ++mThemeChangeCount;
  // A copy, so that a function may install another while the list is walked.
  const std::list<ThemeChangedFunction> functions(mThemeChangedFunctions);
  for (const ThemeChangedFunction& f : functions) {
    if (f) (*f)();
  }
}

// ---------------------------------------------------------------- registry

void Theme::Initialize(ThemeP inTheme) {
  gThemeRegistry.clear();
  gThemeRegistry[GetDefaultThemeName()] = std::move(inTheme);
}

void Theme::Terminate() { gThemeRegistry.clear(); }

Theme& Theme::Get() {
  ThemeP theme = GetTheme(GetDefaultThemeName());
  if (!theme) {
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                               "$$$/norvik/ui/Error/NoDefaultTheme=No theme is registered under the default name.");
  }
  // The registry keeps the theme alive after this local reference goes.
  return *theme;
}

ThemeP Theme::GetTheme(const UTF16String& inName, bool) {
  if (gThemeRegistry.empty()) Initialize(ThemeP(new Theme(detail::kDefaultColorCount, 3)));
  auto it = gThemeRegistry.find(inName);
  return it != gThemeRegistry.end() ? it->second : ThemeP();
}

bool Theme::RegisterTheme(const UTF16String& inName, ThemeP inTheme) {
  return gThemeRegistry.emplace(inName, std::move(inTheme)).second;
}

UTF16String Theme::GetThemeName(ThemeP inTheme, bool) {
  for (const auto& entry : gThemeRegistry) {
    if (entry.second == inTheme) return entry.first;
  }
  return UTF16String();
}

Theme::Registry::const_iterator Theme::ThemeRegistryBegin() { return gThemeRegistry.begin(); }

Theme::Registry::const_iterator Theme::ThemeRegistryEnd() { return gThemeRegistry.end(); }

// ---------------------------------------------------------------- free functions

const drawbot::ColorRGBA& GetColor(std::uint64_t inID) { return Theme::Get().GetColor(inID); }
const UTF16String& GetFontName(std::uint64_t inID) { return Theme::Get().GetFontName(inID); }
float GetFontSize(std::uint64_t inID) { return Theme::Get().GetFontSize(inID); }
int GetIconType() { return Theme::Get().GetIconType(); }
std::uint64_t GetThemeChangeCount() { return Theme::Get().GetThemeChangeCount(); }
void InstallThemeChangedFunction(const Theme::ThemeChangedFunction& inFunction) {
  Theme::Get().InstallThemeChangedFunction(inFunction);
}

const UTF16String& GetDefaultThemeName() {
  static const UTF16String kName(u"DefaultTolliverTheme");
  return kName;
}

float GetDefaultBrightness() { return 0.25f; }

std::uint64_t GetDefaultFontSizeScheme() { return 1; }

}  // namespace norvik::ui
