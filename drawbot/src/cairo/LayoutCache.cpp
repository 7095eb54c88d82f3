#include "drawbot/src/cairo/LayoutCache.h"

#include <algorithm>

#include "drawbot/src/cairo/CairoObjects.h"

namespace norvik::drawbot::cairo {

PangoLayout* LayoutCache::Get(cairo_t* inContext, OSFontInterface const& inFont, std::string const& inText,
                              int inWidth, TextAlignment inAlignment, AntiAliasPolicy inAntiAlias,
                              TextDisplayPolicy inDisplay) {
  const int style = (static_cast<int>(inAntiAlias) * 4 + static_cast<int>(inDisplay)) * 4 + static_cast<int>(inAlignment);
  Key key(inText, &inFont, inWidth, style);
  auto found = mEntries.find(key);
  cairo_matrix_t matrix;
  cairo_get_matrix(inContext, &matrix);
  const double scale[4] = {matrix.xx, matrix.yx, matrix.xy, matrix.yy};
  if (found != mEntries.end()) {
    // Pango lays the text out again whenever it is told about the context, so
    // it is told only when the scale, the one thing that changes the shapes, did.
    Entry& entry = found->second;
    if (!std::equal(scale, scale + 4, entry.scale)) {
      pango_cairo_update_layout(inContext, entry.layout);
      std::copy(scale, scale + 4, entry.scale);
    }
    return entry.layout;
  }
  if (mEntries.size() >= kMaxEntries || mTextBytes + inText.size() > kMaxTextBytes) Clear();
  PangoLayout* layout = pango_cairo_create_layout(inContext);
  ApplyTextPolicies(layout, inAntiAlias, inDisplay);
  pango_layout_set_font_description(layout, inFont.GetDescription());
  if (inWidth >= 0) {
    pango_layout_set_wrap(layout, PANGO_WRAP_WORD_CHAR);
    pango_layout_set_width(layout, inWidth);
    pango_layout_set_alignment(layout, inAlignment == kTextAlignCenter  ? PANGO_ALIGN_CENTER
                                       : inAlignment == kTextAlignRight ? PANGO_ALIGN_RIGHT
                                                                        : PANGO_ALIGN_LEFT);
  }
  pango_layout_set_text(layout, inText.data(), static_cast<int>(inText.size()));
  mTextBytes += inText.size();
  Entry entry{layout, const_cast<OSFontInterface*>(&inFont), {}};
  std::copy(scale, scale + 4, entry.scale);
  mEntries.emplace(std::move(key), std::move(entry));
  return layout;
}

void LayoutCache::Clear() {
  for (auto& entry : mEntries) g_object_unref(entry.second.layout);
  mEntries.clear();
  mTextBytes = 0;
}

}  // namespace norvik::drawbot::cairo
