#pragma once
// The label half of text-bearing controls: the display text (mnemonic
// markers already stripped), the theme font it is drawn in, its alignment,
// truncation and indent. The owning control fills a DrawTextControlBaseParameters
// record from it.
#include <cstdint>

#include "controls/DrawParameters.h"
#include "drawbot/DrawbotTypes.h"
#include "tarsel/UTFString.h"

namespace norvik::controls {

class UI_TextControlBase {
 public:
  virtual ~UI_TextControlBase() = default;

  const UTF16String& GetText() const { return mText; }
  std::uint64_t GetFontSizeId() const { return mFontSizeId; }
  void SetFontSizeId(std::uint64_t inId) { mFontSizeId = inId; }
  drawbot::TextAlignment GetTextAlignment() const { return mAlignment; }
  void SetTextAlignment(drawbot::TextAlignment inAlignment) { mAlignment = inAlignment; }
  drawbot::TextTruncation GetTextTruncation() const { return mTruncation; }
  void SetTextTruncation(drawbot::TextTruncation inTruncation) { mTruncation = inTruncation; }
  float GetTextIndent() const { return mTextIndent; }
  void SetTextIndent(float inIndent) { mTextIndent = inIndent; }

  // Fills the text record with the label and the theme's font for it.
  void FillTextParameters(DrawTextControlBaseParameters& ioParams, const ui::Theme* inTheme) const;

 protected:
  void StoreText(const UTF16String& inText) { mText = inText; }

 private:
  UTF16String mText;
  std::uint64_t mFontSizeId = 0;
  drawbot::TextAlignment mAlignment = drawbot::kTextAlignCenter;
  drawbot::TextTruncation mTruncation = drawbot::kTextTruncationEndWithEllipsis;
  float mTextIndent = 0;
};

// Draws a label centred vertically in inRect, aligned and truncated by the
// record, with the mnemonic underlined when the record says to show it.
void DrawControlLabel(const DrawParameters& inParams, const DrawTextControlBaseParameters& inText,
                      const tarsel::geom::RectT<float>& inRect, drawbot::Drawbot& inDrawbot);

// The width of inText in the record's font, or 0 without a font.
float MeasureControlLabel(const DrawTextControlBaseParameters& inText, const UTF16String& inLabel);

// The block inLabel fills: wrapped at inWidth (its width, and the height of
// the wrapped lines), or with inWidth not above 0 on one line (its width and
// that line's height). One line measures the same either way, so a caller can
// compare the two heights to learn whether the text wraps.
tarsel::geom::PointT<float> MeasureControlLabelBlock(const DrawTextControlBaseParameters& inText,
                                                     const UTF16String& inLabel, float inWidth);

// Draws the label wrapped at inRect's width from its top, clipped to it.
void DrawControlLabelLines(const DrawParameters& inParams, const DrawTextControlBaseParameters& inText,
                           const tarsel::geom::RectT<float>& inRect, drawbot::Drawbot& inDrawbot);

}  // namespace norvik::controls
