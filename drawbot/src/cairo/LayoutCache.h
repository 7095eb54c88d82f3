#pragma once
// Shaped layouts kept by text, font, wrapping width, alignment and text
// policies, so that a label drawn or measured again is not itemized and shaped
// again. An entry holds a reference on its font: the font a key names cannot
// be freed and its address reused while the entry lives. The cache is emptied
// when it holds too many entries or too much text.
#include <pango/pangocairo.h>

#include <boost/intrusive_ptr.hpp>
#include <cstddef>
#include <map>
#include <string>
#include <tuple>

#include "drawbot/DrawbotTypes.h"

namespace norvik::drawbot::cairo {

class OSFontInterface;

class LayoutCache {
 public:
  static constexpr std::size_t kMaxEntries = 512;
  static constexpr std::size_t kMaxTextBytes = 64 * 1024;

  LayoutCache() = default;
  LayoutCache(const LayoutCache&) = delete;
  LayoutCache& operator=(const LayoutCache&) = delete;
  ~LayoutCache() { Clear(); }

  // The layout of inText, brought up to date with inContext's matrix. A width
  // of -1 is one line; otherwise the text wraps at inWidth Pango units.
  PangoLayout* Get(cairo_t* inContext, OSFontInterface const& inFont, std::string const& inText, int inWidth,
                   TextAlignment inAlignment, AntiAliasPolicy inAntiAlias, TextDisplayPolicy inDisplay);
  void Clear();
  std::size_t GetSize() const { return mEntries.size(); }

 private:
  using Key = std::tuple<std::string, OSFontInterface const*, int, int>;
  struct Entry {
    PangoLayout* layout;
    boost::intrusive_ptr<OSFontInterface> font;
    double scale[4];  // the context's matrix without its translation, when last laid out
  };
  std::map<Key, Entry> mEntries;
  std::size_t mTextBytes = 0;
};

}  // namespace norvik::drawbot::cairo
