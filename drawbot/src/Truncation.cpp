// Fitting strings to a width: cut at the end, cut with an ellipsis, or keep
// both ends of a path.
#include <algorithm>
#include <vector>

#include "drawbot/Drawbot.h"

namespace norvik::drawbot {

namespace {

float Measure(FontInterface const& inFont, UTF16String const& inText, long inLength = -1) {
  return inFont.MeasureStringWidth(reinterpret_cast<unsigned short const*>(inText.c_str()), inLength);
}

UTF16String TruncatePath(FontInterface const& inFont, UTF16String const& inText, float inMaxWidth) {
  if (Measure(inFont, inText) <= inMaxWidth) return inText;
  long lo = 0, hi = static_cast<long>(inText.size());
  UTF16String candidate;
  while (lo <= hi) {
    long mid = lo + (hi - lo) / 2;
    GeneratePathEllipsisString(inText, static_cast<unsigned long>(mid), candidate);
    if (Measure(inFont, candidate) < inMaxWidth)
      lo = mid + 1;
    else
      hi = mid - 1;
  }
  // lo is the first length that no longer fits.
  GeneratePathEllipsisString(inText, static_cast<unsigned long>(std::max(0L, lo - 1)), candidate);
  return candidate;
}

// Widths of the prefixes that end at each character, measured on demand.
class PrefixWidths {
 public:
  PrefixWidths(FontInterface const& inFont, UTF16String const& inText)
      : mFont(inFont), mText(inText), mWidths(inText.size(), -1.0f) {}
  float At(long inPosition) {
    float& w = mWidths[static_cast<size_t>(inPosition)];
    if (w < 0) w = Measure(mFont, mText, inPosition + 1);
    return w;
  }

 private:
  FontInterface const& mFont;
  UTF16String const& mText;
  std::vector<float> mWidths;
};

}  // namespace

UTF16String const& GetEllipsisString() {
  static const UTF16String kEllipsis(u"...");
  return kEllipsis;
}

void GeneratePathEllipsisString(UTF16String const& inSource, unsigned long inLength, UTF16String& outResult) {
  outResult.clear();
  if (inLength == 0) return;
  if (inLength == inSource.size()) {
    outResult = inSource;
    return;
  }
  if (inLength >= 8) outResult.append(inSource, 0, std::min<size_t>(7, inSource.size()));
  outResult += GetEllipsisString();
  if (inLength > outResult.size()) {
    size_t tail = std::min<size_t>(inLength - outResult.size(), inSource.size());
    outResult.append(inSource, inSource.size() - tail, tail);
  }
}

UTF16String TruncateString(FontInterface const& inFont, unsigned short const* inText, TextTruncation inMode,
                           float inMaxWidth) {
  if (inText == nullptr) return UTF16String();
  UTF16String text(reinterpret_cast<char16_t const*>(inText));
  if (inMode == kTextTruncationNone || text.empty()) return text;
  if (inMode == kTextTruncationPathEllipsis) return TruncatePath(inFont, text, inMaxWidth);
  if (inMaxWidth >= Measure(inFont, text)) return text;

  PrefixWidths widths(inFont, text);
  long lo = 0, hi = static_cast<long>(text.size()) - 1;
  while (lo < hi) {
    long mid = lo + (hi - lo) / 2;
    if (widths.At(mid) >= inMaxWidth)
      hi = mid;
    else
      lo = mid + 1;
  }
  long cut = lo;
  // Kerning can make a longer prefix narrower.
  if (cut + 1 < static_cast<long>(text.size()) && widths.At(cut + 1) < widths.At(cut)) ++cut;

  if (inMode == kTextTruncationEndWithEllipsis && cut > 0) {
    text.resize(static_cast<size_t>(cut - 1));
    text += GetEllipsisString();
  } else {
    text.resize(static_cast<size_t>(cut));
  }
  return text;
}

}  // namespace norvik::drawbot
