#include "ui/ThemeClient.h"

#include <boost/make_shared.hpp>

#include "tarsel/ThrowError.h"

namespace norvik::ui {

ThemeClient::ThemeClient() { UI_ResetThemeSupplier(); }

ThemeClient::~ThemeClient() = default;

ThemeClient::CustomEntries& ThemeClient::Custom() {
  if (!mCustom) mCustom = std::make_unique<CustomEntries>();
  return *mCustom;
}

void ThemeClient::UI_SetThemeSupplier(const ThemeSupplier& inSupplier) {
  mThemeSupplier = inSupplier;
  UI_ThemeUpdated(1);
}

void ThemeClient::SetCustomThemeColor(std::uint64_t inID, const drawbot::ColorRGBA& inColor) {
  auto inserted = Custom().colors.emplace(inID, inColor);
  if (!inserted.second) {
    if (inserted.first->second == inColor) return;
    inserted.first->second = inColor;
  }
  UI_ThemeUpdated(1);
}

void ThemeClient::ClearCustomThemeColor(std::uint64_t inID) {
  if (mCustom) mCustom->colors.erase(inID);
  UI_ThemeUpdated(1);
}

void ThemeClient::SetCustomFontSize(std::uint64_t inID, float inSize) {
  auto inserted = Custom().fontSizes.emplace(inID, inSize);
  if (!inserted.second) {
    if (inserted.first->second == inSize) return;
    inserted.first->second = inSize;
  }
  UI_ThemeUpdated(1);
}

void ThemeClient::ClearCustomFontSize(std::uint64_t inID) {
  if (mCustom) mCustom->fontSizes.erase(inID);
  UI_ThemeUpdated(1);
}

namespace {
// A supplier that gives no theme leaves the client on the default one, so
// that reading an entry never goes through a null theme.
ThemeP OrDefault(ThemeP inTheme) { return inTheme ? inTheme : Theme::GetTheme(GetDefaultThemeName()); }
}  // namespace

drawbot::ColorRGBA ThemeClient::GetThemeColor(std::uint64_t inID) const {
  if (mCustom) {
    auto it = mCustom->colors.find(inID);
    if (it != mCustom->colors.end()) return it->second;
  }
  return OrDefault(UI_GetCurrentTheme())->GetColor(inID);
}

UTF16String ThemeClient::GetThemeFontName(std::uint64_t inID) const {
  return OrDefault(UI_GetCurrentTheme())->GetFontName(inID);
}

float ThemeClient::GetThemeFontSize(std::uint64_t inID) const {
  if (mCustom) {
    auto it = mCustom->fontSizes.find(inID);
    if (it != mCustom->fontSizes.end()) return it->second;
  }
  return OrDefault(UI_GetCurrentTheme())->GetFontSize(inID);
}

void ThemeClient::UI_ResetThemeSupplier() {
  mThemeSupplier.reset();
  if (!mDefaultThemeSupplier) {
    // The function calls the virtual at call time, so a subclass's override is
    // used even though this runs from the base constructor.
    mDefaultThemeSupplier =
        boost::make_shared<boost::function<ThemeP()>>([this] { return UI_DefaultThemeSupplier(); });
  }
  UI_SetThemeSupplier(mDefaultThemeSupplier);
}

ThemeP ThemeClient::UI_GetCurrentTheme() const {
  if (!mThemeSupplier || mThemeSupplier->empty()) {
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                               "$$$/norvik/ui/Error/ThemeSupplierAbsent=ThemeSupplier is empty");
  }
  return (*mThemeSupplier)();
}

void ThemeClient::UI_ThemeUpdated(unsigned long) {}

ThemeP ThemeClient::UI_DefaultThemeSupplier() const { return Theme::GetTheme(GetDefaultThemeName()); }

}  // namespace norvik::ui
