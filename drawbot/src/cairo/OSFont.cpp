// Fonts over Pango and fontconfig: lookup, the refusal of substitutes, and
// measurement on the supplier's measuring layout.
#include <fontconfig/fontconfig.h>

#include <strings.h>

#include "drawbot/FontFamilies.h"
#include "drawbot/src/cairo/CairoObjects.h"
#include "tarsel/ThrowError.h"

namespace norvik::drawbot::cairo {

std::string ToUTF8(unsigned short const* inText, long inLength) {
  if (inText == nullptr) return std::string();
  auto const* chars = reinterpret_cast<char16_t const*>(inText);
  // A length past the terminator stops at the terminator.
  size_t length = 0;
  while ((inLength < 0 || length < static_cast<size_t>(inLength)) && chars[length] != 0) ++length;
  return tarsel::utility::ToStdString(tarsel::utility::UTF16to8(std::u16string_view(chars, length)));
}

void ApplyTextPolicies(PangoLayout* inLayout, AntiAliasPolicy inAntiAlias, TextDisplayPolicy inDisplay) {
  PangoContext* context = pango_layout_get_context(inLayout);
  cairo_font_options_t* options = cairo_font_options_create();
  cairo_font_options_set_antialias(options,
                                   inAntiAlias == kAntiAliasNone ? CAIRO_ANTIALIAS_NONE : CAIRO_ANTIALIAS_GRAY);
  bool gridFitted = inAntiAlias == kAntiAliasNone || inDisplay == kTextDisplayGridFitted;
  cairo_font_options_set_hint_metrics(options, gridFitted ? CAIRO_HINT_METRICS_ON : CAIRO_HINT_METRICS_OFF);
  cairo_font_options_set_hint_style(options, gridFitted ? CAIRO_HINT_STYLE_SLIGHT : CAIRO_HINT_STYLE_NONE);
  pango_cairo_context_set_font_options(context, options);
  cairo_font_options_destroy(options);
#if PANGO_VERSION_CHECK(1, 44, 0)
  pango_context_set_round_glyph_positions(context, gridFitted);
#endif
  pango_layout_context_changed(inLayout);
}

namespace {

// The family names fontconfig resolves inFamily to.
bool FontconfigHasFamily(std::string const& inFamily) {
  FcPattern* pattern = FcPatternCreate();
  FcPatternAddString(pattern, FC_FAMILY, reinterpret_cast<FcChar8 const*>(inFamily.c_str()));
  FcConfigSubstitute(nullptr, pattern, FcMatchPattern);
  FcDefaultSubstitute(pattern);
  FcResult result = FcResultNoMatch;
  FcPattern* match = FcFontMatch(nullptr, pattern, &result);
  bool found = false;
  if (match) {
    FcChar8* name = nullptr;
    for (int i = 0; !found && FcPatternGetString(match, FC_FAMILY, i, &name) == FcResultMatch; ++i)
      found = strcasecmp(reinterpret_cast<char const*>(name), inFamily.c_str()) == 0;
    FcPatternDestroy(match);
  }
  FcPatternDestroy(pattern);
  return found;
}

std::string DefaultSansFamily() {
  FcPattern* pattern = FcNameParse(reinterpret_cast<FcChar8 const*>("sans-serif"));
  FcConfigSubstitute(nullptr, pattern, FcMatchPattern);
  FcDefaultSubstitute(pattern);
  FcResult result = FcResultNoMatch;
  FcPattern* match = FcFontMatch(nullptr, pattern, &result);
  std::string family;
  FcChar8* name = nullptr;
  if (match && FcPatternGetString(match, FC_FAMILY, 0, &name) == FcResultMatch)
    family = reinterpret_cast<char const*>(name);
  if (match) FcPatternDestroy(match);
  FcPatternDestroy(pattern);
  return family;
}

}  // namespace

OSFontInterface::OSFontInterface(OSSupplier const* inSupplier, PangoFontDescription* inDescription, float inSize)
    : mSupplier(inSupplier), mDescription(inDescription), mSize(inSize) {
  PangoContext* context = pango_layout_get_context(mSupplier->GetMeasuringLayout());
  PangoFontMetrics* metrics = pango_context_get_metrics(context, mDescription, nullptr);
  mAscent = static_cast<float>(pango_font_metrics_get_ascent(metrics)) / PANGO_SCALE;
  mDescent = static_cast<float>(pango_font_metrics_get_descent(metrics)) / PANGO_SCALE;
  pango_font_metrics_unref(metrics);
}

OSFontInterface::~OSFontInterface() { pango_font_description_free(mDescription); }

float OSFontInterface::MeasureStringWidth(unsigned short const* inText, long inLength) const {
  if (inText == nullptr || inLength == 0) return 0;
  PangoLayout* layout = mSupplier->GetMeasuringLayout();
  std::string text = ToUTF8(inText, inLength);
  pango_layout_set_font_description(layout, mDescription);
  pango_layout_set_width(layout, -1);
  pango_layout_set_text(layout, text.data(), static_cast<int>(text.size()));
  PangoRectangle logical;
  pango_layout_get_extents(layout, nullptr, &logical);
  return static_cast<float>(logical.width) / PANGO_SCALE;
}

float OSFontInterface::MeasureMultiLineStringHeight(unsigned short const* inText, float inWidth,
                                                     long inLength) const {
  if (inText == nullptr || inLength == 0) return 0;
  PangoLayout* layout = mSupplier->GetMeasuringLayout();
  std::string text = ToUTF8(inText, inLength);
  if (text.empty()) return 0;
  pango_layout_set_font_description(layout, mDescription);
  pango_layout_set_wrap(layout, PANGO_WRAP_WORD_CHAR);
  pango_layout_set_width(layout, inWidth > 0 ? static_cast<int>(inWidth * PANGO_SCALE) : -1);
  pango_layout_set_text(layout, text.data(), static_cast<int>(text.size()));
  PangoRectangle logical;
  pango_layout_get_extents(layout, nullptr, &logical);
  pango_layout_set_width(layout, -1);
  return static_cast<float>(logical.height) / PANGO_SCALE;
}

FontInterface* OSSupplier::NewFont(unsigned short const* inFamily, unsigned short const* inStyle,
                                   float inSize) const {
  std::u16string family(inFamily ? reinterpret_cast<char16_t const*>(inFamily) : u"");
  std::u16string style(inStyle ? reinterpret_cast<char16_t const*>(inStyle) : u"");
  int styleCode = style == u"Bold" ? 1 : style == u"Italic" ? 2 : style == u"Bold Italic" ? 3 : 0;
  FontKey key(family, styleCode, inSize);
  auto found = mFontCache.find(key);
  if (found != mFontCache.end()) return found->second.get();

  std::string familyUTF8 = ToUTF8(inFamily, -1);
  if (familyUTF8.empty() || !(inSize > 0) || !FontconfigHasFamily(familyUTF8))
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                               "$$$/norvik/drawbot/Error/OSSupplier/UnableToCreateFont=Unable to load font \"^0\" \"^1\"",
                               0, 0, false, UTF16String(style.begin(), style.end()),
                               UTF16String(family.begin(), family.end()));

  PangoFontDescription* description = pango_font_description_new();
  pango_font_description_set_family(description, familyUTF8.c_str());
  pango_font_description_set_weight(description, (styleCode & 1) ? PANGO_WEIGHT_BOLD : PANGO_WEIGHT_NORMAL);
  pango_font_description_set_style(description, (styleCode & 2) ? PANGO_STYLE_ITALIC : PANGO_STYLE_NORMAL);
  pango_font_description_set_absolute_size(description, static_cast<double>(inSize) * PANGO_SCALE);
  boost::intrusive_ptr<OSFontInterface> font(new OSFontInterface(this, description, inSize));
  mFontCache.emplace(key, font);
  return font.get();
}

}  // namespace norvik::drawbot::cairo

namespace norvik::drawbot {

bool IsFontFamilyAvailable(UTF16String const& inFamily) {
  std::string family = tarsel::utility::ToStdString(tarsel::utility::UTF16to8(inFamily));
  return !family.empty() && cairo::FontconfigHasFamily(family);
}

UTF16String ChooseFontFamily(std::vector<UTF16String> const& inCandidates) {
  for (auto const& candidate : inCandidates)
    if (IsFontFamilyAvailable(candidate)) return candidate;
  for (char const* platform : {"DejaVu Sans", "Noto Sans"}) {
    UTF16String family = tarsel::utility::AsciiToUTF16(platform);
    if (IsFontFamilyAvailable(family)) return family;
  }
  return tarsel::utility::UTF8to16(cairo::DefaultSansFamily());
}

}  // namespace norvik::drawbot
