#include "ui/ThemeClient.h"

#include <boost/make_shared.hpp>

#include "tarsel/ThrowError.h"

namespace norvik::ui {

ThemeClient::ThemeClient() { UI_ResetThemeSupplier(); }

ThemeClient::~ThemeClient() = default;

void ThemeClient::UI_SetThemeSupplier(const ThemeSupplier& inSupplier) {
  mThemeSupplier = inSupplier;
  UI_ThemeUpdated(1);
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

ThemeP ThemeClient::UI_DefaultThemeSupplier() const { return ThemeP(); }

}  // namespace norvik::ui
