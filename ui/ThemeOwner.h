#pragma once
// ThemeOwner names the theme that a sub-tree uses. Every container is an owner;
// an active owner hands its shared supplier to the children it receives, so a
// whole sub-tree follows one name.
#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>

#include "tarsel/UTFString.h"
#include "ui/ThemeClient.h"

namespace norvik::ui {

class ThemeOwner {
 public:
  ThemeOwner();
  ThemeOwner(const ThemeOwner&) = delete;
  ThemeOwner& operator=(const ThemeOwner&) = delete;

  virtual void SetThemeName(const UTF16String& inName, bool inNotify);
  // The theme registered under this owner's name, or the default theme when
  // the name is not registered.
  virtual ThemeP GetTheme() const;
  virtual ~ThemeOwner();

  const UTF16String& GetThemeName() const { return mThemeName; }
  bool HasThemeName() const { return mThemeNameSet; }
  // A supplier bound to this owner's GetTheme, shared by all its clients.
  const ThemeSupplier& GetSharedThemeSupplier() const { return mSharedSupplier; }
  bool IsActiveThemeOwner() const { return mActiveThemeOwner; }
  void SetActiveThemeOwner(bool inActive) { mActiveThemeOwner = inActive; }

 private:
  UTF16String mThemeName;
  bool mThemeNameSet = false;
  ThemeSupplier mSharedSupplier;
  bool mActiveThemeOwner = true;
};

}  // namespace norvik::ui
