#pragma once
// ThemeClient is the mixin by which a node reaches its theme. It always holds a
// supplier: a function that answers the theme in force. A new client's
// supplier calls UI_DefaultThemeSupplier, which a node overrides to ask the
// nearest theme owner up the tree. A client may also override single colours
// and font sizes for itself; those win over the theme's.
#include <cstdint>
#include <map>
#include <memory>

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
  // Each change of a custom entry calls UI_ThemeUpdated; setting the colour or
  // size an entry already has does nothing.
  virtual void SetCustomThemeColor(std::uint64_t inID, const drawbot::ColorRGBA& inColor);
  virtual void ClearCustomThemeColor(std::uint64_t inID);
  virtual void SetCustomFontSize(std::uint64_t inID, float inSize);
  virtual void ClearCustomFontSize(std::uint64_t inID);
  // The custom entry when there is one, else the current theme's.
  virtual drawbot::ColorRGBA GetThemeColor(std::uint64_t inID) const;
  virtual UTF16String GetThemeFontName(std::uint64_t inID) const;
  virtual float GetThemeFontSize(std::uint64_t inID) const;
  // Drops the stored supplier and installs one that calls UI_DefaultThemeSupplier.
  virtual void UI_ResetThemeSupplier();
  // The theme the supplier answers; raises "ThemeSupplier is empty" without one.
  virtual ThemeP UI_GetCurrentTheme() const;
  // Called when the supplier or a custom entry changed; flag 1 = supplier set.
  virtual void UI_ThemeUpdated(unsigned long inFlags);
  // The theme used when nobody supplies one: the default theme.
  virtual ThemeP UI_DefaultThemeSupplier() const;

  const ThemeSupplier& UI_GetThemeSupplier() const { return mThemeSupplier; }

 private:
  // Few clients override entries: the maps are allocated on the first one.
  struct CustomEntries {
    std::map<std::uint64_t, drawbot::ColorRGBA> colors;
    std::map<std::uint64_t, float> fontSizes;
  };
  CustomEntries& Custom();

  ThemeSupplier mThemeSupplier;
  std::unique_ptr<CustomEntries> mCustom;
  ThemeSupplier mDefaultThemeSupplier;
};

}  // namespace norvik::ui
