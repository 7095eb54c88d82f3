#pragma once
// ThemeClient is the mixin by which a node reaches its theme. It always holds a
// supplier: a function that answers the theme in force. A new client's
// supplier calls UI_DefaultThemeSupplier, which a node overrides to ask the
// nearest theme owner up the tree. Custom colours and font sizes are added by
// the theme work.
#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>

#include "ui/Theme.h"

namespace norvik::ui {

using ThemeSupplier = boost::shared_ptr<boost::function<ThemeP()>>;

class ThemeClient {
 public:
  ThemeClient();
  ThemeClient(const ThemeClient&) = delete;
  ThemeClient& operator=(const ThemeClient&) = delete;
  virtual ~ThemeClient();

  virtual void UI_SetThemeSupplier(const ThemeSupplier& inSupplier);
  // Drops the stored supplier and installs one that calls UI_DefaultThemeSupplier.
  virtual void UI_ResetThemeSupplier();
  // The theme the supplier answers; raises "ThemeSupplier is empty" without one.
  virtual ThemeP UI_GetCurrentTheme() const;
  // Called when the supplier or a custom entry changed; flag 1 = supplier set.
  virtual void UI_ThemeUpdated(unsigned long inFlags);
  // The theme used when nobody supplies one: none until a registry exists.
  virtual ThemeP UI_DefaultThemeSupplier() const;

  const ThemeSupplier& UI_GetThemeSupplier() const { return mThemeSupplier; }

 private:
  ThemeSupplier mThemeSupplier;
  ThemeSupplier mDefaultThemeSupplier;
};

}  // namespace norvik::ui
