#pragma once
// A Theme answers which colour belongs to a numeric colour identifier and which
// font name and size belong to a numeric font identifier. Themes are shared
// objects kept by name in one process-wide registry; the default name holds
// the theme that code without a node at hand asks through the free functions
// at the bottom of this file.
//
// The base class is a fixed palette: brightness is stored but does not change
// a colour. KeyframeThemeEditor layers brightness-dependent tracks over it.
//
// Drawing caches compare GetThemeChangeCount with the count they were made at,
// so the application calls NotifyThemeChanged after it changes brightness,
// tint or fonts; the setters alone do not notify.
#include <cstdint>
#include <list>
#include <map>
#include <vector>

#include <boost/function.hpp>
#include <boost/intrusive_ptr.hpp>
#include <boost/shared_ptr.hpp>

#include "drawbot/DrawbotTypes.h"
#include "tarsel/RefCountedObject.h"
#include "tarsel/UTFString.h"

namespace norvik::ui {

class Theme;
using ThemeP = boost::intrusive_ptr<Theme>;

class Theme : public tarsel::utility::RefCountedObject {
 public:
  using ThemeChangedFunction = boost::shared_ptr<boost::function<void()>>;
  using Registry = std::map<UTF16String, ThemeP>;
  // Whether the platform can make a font of this name and size without
  // substituting another; used only for the GB18030 font choice.
  using FontProbe = boost::function<bool(const UTF16String&, float)>;

  Theme(std::uint64_t inColorCount, std::uint64_t inFontCount);
  ~Theme() override;

  // ---- virtual operations, in slot order ----
  virtual bool HasColor(std::uint64_t inID) const;
  // An identifier outside the map answers a shared default entry.
  virtual const drawbot::ColorRGBA& GetColor(std::uint64_t inID) const;
  // Neither font accessor checks its index: identifiers come from the table.
  virtual const UTF16String& GetFontName(std::uint64_t inID) const;
  virtual float GetFontSize(std::uint64_t inID) const;
  virtual float DoGetBrightness() const;
  virtual void DoSetBrightness(float inBrightness);
  virtual void DoSetTinting(drawbot::ColorRGBA inTint);
  virtual void DoSetFontSizeScheme(std::uint64_t inScheme);

  // ---- the registry ----
  // Empties the registry and registers inTheme under the default name.
  static void Initialize(ThemeP inTheme);
  static void Terminate();
  // The default theme; made on first use when nothing was registered.
  static Theme& Get();
  // Null for an unknown name. An empty registry is first initialised with a
  // plain Theme(379, 3).
  static ThemeP GetTheme(const UTF16String& inName, bool inUnused = false);
  // False, changing nothing, when the name is taken.
  static bool RegisterTheme(const UTF16String& inName, ThemeP inTheme);
  // The name a theme is registered under, or empty.
  static UTF16String GetThemeName(ThemeP inTheme, bool inUnused = false);
  static Registry::const_iterator ThemeRegistryBegin();
  static Registry::const_iterator ThemeRegistryEnd();

  // The hook that decides whether the GB18030 font can be used; without one it
  // is not used.
  static void SetFontProbe(const FontProbe& inProbe);

  // ---- members ----
  float GetBrightness() const { return DoGetBrightness(); }
  void SetBrightness(float inBrightness) { DoSetBrightness(inBrightness); }
  // Recomputes every colour at the current brightness.
  void Update() { DoSetBrightness(DoGetBrightness()); }
  std::uint64_t GetFontSizeScheme() const { return mFontSizeScheme; }
  void SetFontSizeScheme(std::uint64_t inScheme) { DoSetFontSizeScheme(inScheme); }
  void SetTinting(drawbot::ColorRGBA inTint) { DoSetTinting(inTint); }
  const drawbot::ColorRGBA& GetTinting() const { return mTint; }
  void SetColor(std::uint64_t inID, const drawbot::ColorRGBA& inColor) { mColors[inID] = inColor; }
  void SetFontName(std::uint64_t inID, const UTF16String& inName) { mFontNames[inID] = inName; }
  void SetFontSize(std::uint64_t inID, float inSize) { mFontSizes[inID] = inSize; }
  std::uint64_t GetColorCount() const { return mColorCount; }
  std::uint64_t GetFontCount() const { return mFontNames.size(); }
  std::uint64_t GetThemeChangeCount() const { return mThemeChangeCount; }
  // 1 when colour 282 is light (icons for light backgrounds are not to be used), else 0.
  int GetIconType() const;
  void InstallThemeChangedFunction(const ThemeChangedFunction& inFunction);
  // Counts one change, then calls the installed functions in order. A null
  // entry is skipped; an entry holding an empty function raises
  // boost::bad_function_call.
  void NotifyThemeChanged() const;

 protected:
  // Writes the fixed palette over every colour below the colour count.
  void AssignDefaultPalette();

 private:
  void DoSetFontNames();

  std::uint64_t mColorCount;
  std::vector<UTF16String> mFontNames;
  std::vector<float> mFontSizes;
  std::list<ThemeChangedFunction> mThemeChangedFunctions;
  std::map<std::uint64_t, drawbot::ColorRGBA> mColors;
  float mBrightness = 0;
  drawbot::ColorRGBA mTint{0, 0, 0, 1};
  std::uint64_t mFontSizeScheme = 0;

 protected:
  mutable std::uint64_t mThemeChangeCount = 0;

 private:
  static Registry gThemeRegistry;
};

// ---- the default theme, for code without a theme client at hand ----
const drawbot::ColorRGBA& GetColor(std::uint64_t inID);
const UTF16String& GetFontName(std::uint64_t inID);
float GetFontSize(std::uint64_t inID);
int GetIconType();
std::uint64_t GetThemeChangeCount();
void InstallThemeChangedFunction(const Theme::ThemeChangedFunction& inFunction);

const UTF16String& GetDefaultThemeName();  // "DefaultTolliverTheme"
float GetDefaultBrightness();              // 0.25
std::uint64_t GetDefaultFontSizeScheme();  // 1

}  // namespace norvik::ui
