#include "controls/UI_TextControlBase.h"

#include <cmath>
#include <map>

#include "controls/UI_ControlView.h"
#include "drawbot/DrawHelpers.h"
#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "drawbot/FontFamilies.h"
#include "ui/UI_NodeManager.h"

namespace norvik::controls {

namespace {
// Label colours: the theme's text colour, and the same at half strength when
// disabled. A translucent text colour dims towards whatever lies under the
// label, so a disabled label reads on a panel and on a disabled bevel alike,
// in the dark and in the light look.
constexpr std::uint64_t kLabelColor = 1;
constexpr float kDisabledLabelAlpha = 0.5f;

drawbot::ColorRGBA LabelColor(const DrawParameters& inParams, bool inDisabled) {
  drawbot::ColorRGBA color = inParams.Color(kLabelColor);
  if (inDisabled) color.alpha *= kDisabledLabelAlpha;
  return color;
}

const unsigned short* Chars(const UTF16String& inText) {
  return reinterpret_cast<const unsigned short*>(inText.c_str());
}

// The theme names the fonts it would like; the platform may have another. The
// answer for each name is kept, because asking the font matcher on every
// paint of every label would dominate drawing. Used on the UI thread only.
const UTF16String& ResolvedFamily(const UTF16String& inName) {
  static std::map<UTF16String, UTF16String> resolved;
  auto it = resolved.find(inName);
  if (it == resolved.end()) it = resolved.emplace(inName, drawbot::ChooseFontFamily({inName})).first;
  return it->second;
}

drawbot::FontP LabelFont(const drawbot::SupplierInterface* inSupplier, const DrawTextControlBaseParameters& inText) {
  const float size = inText.GetFontSize() > 0 ? inText.GetFontSize() : 11.0f;
  return drawbot::FontP(inSupplier, ResolvedFamily(inText.GetFontName()), inText.GetFontStyleName(), size);
}
}  // namespace

void UI_TextControlBase::FillTextParameters(DrawTextControlBaseParameters& ioParams, const ui::Theme* inTheme) const {
  ioParams.SetText(mText);
  if (inTheme) {
    ioParams.SetFontName(inTheme->GetFontName(mFontSizeId));
    ioParams.SetFontSize(inTheme->GetFontSize(mFontSizeId));
  }
  ioParams.SetTextAlignment(mAlignment);
  ioParams.SetTextTruncation(mTruncation);
  ioParams.SetTextIndent(mTextIndent);
}

void DrawControlLabel(const DrawParameters& inParams, const DrawTextControlBaseParameters& inText,
                      const tarsel::geom::RectT<float>& inRect, drawbot::Drawbot& inDrawbot) {
  const UTF16String& text = inText.GetText();
  const drawbot::SupplierInterface* supplier = inDrawbot.GetSupplier();
  drawbot::SurfaceInterface* surface = inDrawbot.GetSurface();
  if (text.empty() || !supplier || !surface || inRect.width <= 0 || !supplier->SupportsFonts()) return;
  drawbot::FontP font = LabelFont(supplier, inText);
  const bool disabled = inParams.GetControlState().Test(UI_ControlView::kStateDisabled);
  drawbot::BrushP brush(supplier, LabelColor(inParams, disabled));
  if (!font || !brush) return;
  float x = inRect.left;
  if (inText.GetTextAlignment() == drawbot::kTextAlignCenter) x += inRect.width / 2;
  if (inText.GetTextAlignment() == drawbot::kTextAlignRight) x += inRect.width;
  const tarsel::geom::PointT<float> at(x, GetFontBaseline(font, inRect));
  const std::int64_t mnemonic = inParams.GetMnemonicLocation();
  if (inParams.GetAllowMnemonics() && inParams.GetDisplayMnemonics() && mnemonic >= 0 &&
      static_cast<std::size_t>(mnemonic) < text.size()) {
    drawbot::PenP pen(supplier, LabelColor(inParams, disabled), 1);
    surface->DrawStringWithUnderline(*brush, *font, *pen, Chars(text), at, inText.GetTextAlignment(),
                                     inText.GetTextTruncation(), inRect.width, static_cast<long>(mnemonic),
                                     static_cast<long>(mnemonic));
  } else {
    surface->DrawString(*brush, *font, Chars(text), at, inText.GetTextAlignment(), inText.GetTextTruncation(),
                        inRect.width);
  }
}

// Labels are measured before any window paints them (a layout asks for
// recommended sizes first), so without a supplier installed in the manager
// the platform back end's own one measures them.
namespace {
const drawbot::SupplierInterface* MeasuringSupplier() {
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst();
  const drawbot::SupplierInterface* supplier = manager ? manager->GetOSDrawSupplier() : nullptr;
  return supplier ? supplier : drawbot::NewOSSupplier();
}
}  // namespace

float MeasureControlLabel(const DrawTextControlBaseParameters& inText, const UTF16String& inLabel) {
  if (inLabel.empty()) return 0;
  const drawbot::SupplierInterface* supplier = MeasuringSupplier();
  if (!supplier) return 0;
  drawbot::FontP font = LabelFont(supplier, inText);
  return font ? font->MeasureStringWidth(Chars(inLabel), static_cast<long>(inLabel.size())) : 0;
}

tarsel::geom::PointT<float> MeasureControlLabelBlock(const DrawTextControlBaseParameters& inText,
                                                     const UTF16String& inLabel, float inWidth) {
  const bool wraps = std::isfinite(inWidth) && inWidth > 0;
  if (inLabel.empty()) return {wraps ? inWidth : 0.0f, 0.0f};
  const drawbot::SupplierInterface* supplier = MeasuringSupplier();
  drawbot::FontP font = supplier ? LabelFont(supplier, inText) : drawbot::FontP();
  if (!font) return {0.0f, 0.0f};
  const long length = static_cast<long>(inLabel.size());
  const float height = font->MeasureMultiLineStringHeight(Chars(inLabel), wraps ? inWidth : 0.0f, length);
  return {wraps ? inWidth : font->MeasureStringWidth(Chars(inLabel), length), height};
}

void DrawControlLabelLines(const DrawParameters& inParams, const DrawTextControlBaseParameters& inText,
                           const tarsel::geom::RectT<float>& inRect, drawbot::Drawbot& inDrawbot) {
  const UTF16String& text = inText.GetText();
  const drawbot::SupplierInterface* supplier = inDrawbot.GetSupplier();
  drawbot::SurfaceInterface* surface = inDrawbot.GetSurface();
  if (text.empty() || !supplier || !surface || inRect.IsEmpty() || !supplier->SupportsFonts()) return;
  drawbot::FontP font = LabelFont(supplier, inText);
  const bool disabled = inParams.GetControlState().Test(UI_ControlView::kStateDisabled);
  drawbot::BrushP brush(supplier, LabelColor(inParams, disabled));
  if (!font || !brush) return;
  surface->DrawMultiLineString(*brush, *font, Chars(text), inRect, inText.GetTextAlignment());
}

}  // namespace norvik::controls
