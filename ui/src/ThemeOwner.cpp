#include "ui/ThemeOwner.h"

#include <boost/make_shared.hpp>

namespace norvik::ui {

ThemeOwner::ThemeOwner()
    : mThemeName(GetDefaultThemeName()),
      mSharedSupplier(boost::make_shared<boost::function<ThemeP()>>([this] { return GetTheme(); })) {}

ThemeOwner::~ThemeOwner() {
  // Clients may still hold the shared supplier; after this owner is gone it
  // must not call back into it, and it answers what an owner of an unknown
  // name answers: the default theme.
  if (mSharedSupplier)
    *mSharedSupplier = boost::function<ThemeP()>([] { return Theme::GetTheme(GetDefaultThemeName()); });
}

void ThemeOwner::SetThemeName(const UTF16String& inName, bool) {
  mThemeName = inName;
  mThemeNameSet = true;
}

ThemeP ThemeOwner::GetTheme() const {
  ThemeP theme = Theme::GetTheme(mThemeName);
  return theme ? theme : Theme::GetTheme(GetDefaultThemeName());
}

}  // namespace norvik::ui
