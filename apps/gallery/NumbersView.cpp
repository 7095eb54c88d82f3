#include "NumbersView.h"

#include <algorithm>
#include <cmath>
#include <string>

#include "controls/UI_NumberData.h"
#include "controls/UnitHandlerRegistry.h"
#include "tarsel/StringUtils.h"

namespace norvik::gallery {

namespace tu = tarsel::utility;
using controls::NumberEditUnit;
using controls::UI_NumberData;

namespace {

constexpr const char16_t* kInputs[] = {u"3in + 2cm", u"1p6", u"-1p6", u"50%", u"2in * 3", u"1,234.5", u"10 / 0",
                                       u"1 + 2 + 3"};

struct FieldColumn {
  NumberEditUnit unit;
  const char* titleKey;
};

const FieldColumn kFields[] = {
    {controls::kNumberEditUnit_Point, "$$$/norvik/gallery/Numbers/Point=Point"},
    {controls::kNumberEditUnit_Inch, "$$$/norvik/gallery/Numbers/Inch=Inch"},
    {controls::kNumberEditUnit_CM, "$$$/norvik/gallery/Numbers/CM=Centimetre"},
    {controls::kNumberEditUnit_Pica, "$$$/norvik/gallery/Numbers/Pica=Pica"},
    {controls::kNumberEditUnit_Percent, "$$$/norvik/gallery/Numbers/Percent=Percent"},
    {controls::kNumberEditUnit_Degree, "$$$/norvik/gallery/Numbers/Degree=Degree"},
};

// Every field starts from 20 of its own unit.
constexpr double kPreviousValue = 20;

ColorRGBA ErrorColor(const GalleryColors& inColors) { return Mix(inColors.text, ColorRGBA{0.9f, 0.2f, 0.15f, 1}, 0.7f); }

UTF16String Plain(double inValue, int inDecimals) {
  return tu::NumberToString(inValue, 0, inDecimals, tu::kNumberFormatNoLocalization | tu::kNumberFormatNoTrailingZeros,
                            31);
}

}  // namespace

ExpressionTableView::ExpressionTableView() { UI_SetNodeID("numbers-expressions"); }

void ExpressionTableView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  const float inputWidth = 96;
  const float columnWidth = std::max(60.0f, (r.width - inputWidth) / static_cast<float>(std::size(kFields)));
  DrawLabel(inDrawbot, Text("$$$/norvik/gallery/Numbers/Typed=Typed"), RectF(0, 0, inputWidth, 20), c.dimText,
            drawbot::kTextAlignLeft, 0, true);
  for (std::size_t col = 0; col < std::size(kFields); ++col)
    DrawLabel(inDrawbot, Text(kFields[col].titleKey), RectF(inputWidth + columnWidth * col, 0, columnWidth, 20),
              c.dimText, drawbot::kTextAlignLeft, 0, true);

  for (std::size_t row = 0; row < std::size(kInputs); ++row) {
    const float top = 24 + kRowHeight * row;
    if (row % 2 == 0) FillRect(inDrawbot, RectF(0, top, r.width, kRowHeight), Mix(c.panel, c.border, 0.25f));
    DrawLabel(inDrawbot, kInputs[row], RectF(6, top, inputWidth - 6, kRowHeight), c.text);
    for (std::size_t col = 0; col < std::size(kFields); ++col) {
      UTF16String text;
      double value = 0;
      bool error = false;
      controls::EvaluateUnitExpression(kInputs[row], kFields[col].unit, tu::kNumberFormatNoLocalization, 2,
                                       kPreviousValue, 1e6, -1e6, true, false, text, value, error);
      const float left = inputWidth + columnWidth * col;
      DrawLabel(inDrawbot, text, RectF(left, top + 2, columnWidth - 4, 18), error ? ErrorColor(c) : c.text);
      const UTF16String detail = error ? Text("$$$/norvik/gallery/Numbers/Error=error, kept ") + Plain(value, 4)
                                       : UTF16String(u"= ") + Plain(value, 4);
      DrawLabel(inDrawbot, detail, RectF(left, top + 20, columnWidth - 4, 16), error ? ErrorColor(c) : c.dimText,
                drawbot::kTextAlignLeft, 10);
    }
  }
}

NumberFormatsView::NumberFormatsView() { UI_SetNodeID("numbers-formats"); }

void NumberFormatsView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  const float labelWidth = std::min(230.0f, r.width * 0.62f);
  float top = 0;
  const auto line = [&](const UTF16String& inLabel, const UTF16String& inText) {
    DrawLabel(inDrawbot, inLabel, RectF(0, top, labelWidth, kRowHeight), c.dimText);
    FillRoundRect(inDrawbot, RectF(labelWidth, top + 2, r.width - labelWidth, kRowHeight - 4), 3,
                  Mix(c.panel, c.background, 0.6f));
    DrawLabel(inDrawbot, inText, RectF(labelWidth + 6, top, r.width - labelWidth - 8, kRowHeight), c.text);
    top += kRowHeight;
  };
  const auto heading = [&](const char* inKey) {
    DrawLabel(inDrawbot, Text(inKey), RectF(0, top, r.width, kRowHeight), c.text, drawbot::kTextAlignLeft, 0, true);
    top += kRowHeight;
  };

  heading("$$$/norvik/gallery/Numbers/Formats=-1234.5 with 2 decimal places");
  struct Format {
    unsigned short flags;
    const char* key;
  };
  const Format formats[] = {
      {tu::kNumberFormatNoLocalization, "$$$/norvik/gallery/Numbers/Plain=formatNoLocalization"},
      {tu::kNumberFormatNoLocalization | tu::kNumberFormatUseSeparator,
       "$$$/norvik/gallery/Numbers/Separator=formatUseSeparator"},
      {tu::kNumberFormatNoLocalization | tu::kNumberFormatNoTrailingZeros,
       "$$$/norvik/gallery/Numbers/NoZeros=formatNoTrailingZeros"},
  };
  UI_NumberData data;
  data.SetDecimalPlaces(2);
  data.SetValue(-1234.5);
  for (const Format& format : formats) {
    data.SetFormatFlags(format.flags);
    line(Text(format.key), data.GetText());
  }
  data.SetValue(1234.5);
  data.SetFormatFlags(tu::kNumberFormatNoLocalization | tu::kNumberFormatAlwaysSign);
  line(Text("$$$/norvik/gallery/Numbers/AlwaysSign=formatAlwaysSign, +1234.5"), data.GetText());
  data.SetFormatFlags(tu::kNumberFormatNoLocalization | tu::kNumberFormatPadSign);
  line(Text("$$$/norvik/gallery/Numbers/PadSign=formatPadSign, +1234.5"), u"[" + data.GetText() + u"]");
  data.SetFormatFlags(tu::kNumberFormatNoLocalization | tu::kNumberFormatAlwaysSign);
  data.SetCustomSignStrings(u"up ", u"down ");
  data.SetValue(-3.25);
  line(Text("$$$/norvik/gallery/Numbers/CustomSigns=Custom signs, -3.25"), data.GetText());
  UI_NumberData infinite;
  infinite.ShowNegativeInfinity(true);
  infinite.SetMinMaxValue(-100, 100, -100);
  line(Text("$$$/norvik/gallery/Numbers/MinusInfinity=At the minimum, -100"), infinite.GetText());

  top += 8;
  heading("$$$/norvik/gallery/Numbers/Steps=Steps up and down from 1.1, increment 0.25");
  struct Step {
    unsigned char mods;
    const char* key;
  };
  const Step steps[] = {
      {0, "$$$/norvik/gallery/Numbers/NoKey=No modifier"},
      {UI_NumberData::kShiftModifier, "$$$/norvik/gallery/Numbers/Shift=Shift (x10)"},
      {UI_NumberData::kCmdModifier, "$$$/norvik/gallery/Numbers/Ctrl=Ctrl (x0.1)"},
      {UI_NumberData::kOptionModifier, "$$$/norvik/gallery/Numbers/Alt=Alt (step 2)"},
      {UI_NumberData::kShiftModifier | UI_NumberData::kCmdModifier,
       "$$$/norvik/gallery/Numbers/ShiftCtrl=Shift+Ctrl"},
  };
  for (const Step& step : steps) {
    UTF16String text;
    for (double direction : {1.0, -1.0}) {
      UI_NumberData stepped;
      stepped.SetFormatFlags(tu::kNumberFormatNoLocalization);
      stepped.SetDecimalPlaces(2);
      stepped.SetValue(1.1);
      stepped.SetIncrement(0.25);
      stepped.SetOptionModifierIncrement(2);
      stepped.SetIsOptionModifierAFactor(false);
      stepped.IncrementValue(direction, step.mods, true);
      text += (direction > 0 ? u"up " : u"   down ") + stepped.GetText();
    }
    line(Text(step.key), text);
  }
}

NumbersView::NumbersView() {
  UI_SetNodeID("numbers-page");
  mExpressionSection.reset(new SectionView(
      "$$$/norvik/gallery/Numbers/ExpressionsTitle=Typed expressions in fields of six units, previous value 20, 2 decimal places"));
  mExpressionSection->UI_SetNodeID("numbers-expression-section");
  AddGalleryChild(this, mExpressionSection);
  mFormatSection.reset(new SectionView("$$$/norvik/gallery/Numbers/FormatsTitle=Number data"));
  mFormatSection->UI_SetNodeID("numbers-format-section");
  AddGalleryChild(this, mFormatSection);
  mExpressions.reset(new ExpressionTableView());
  AddGalleryChild(mExpressionSection.get(), mExpressions);
  mFormats.reset(new NumberFormatsView());
  AddGalleryChild(mFormatSection.get(), mFormats);
}

void NumbersView::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

void NumbersView::Arrange() {
  const RectF r = UI_GetLocalRectF(false);
  const float gap = 12;
  const float formatWidth = std::min(390.0f, std::floor(r.width * 0.36f));
  const float tableWidth = std::max(0.0f, r.width - formatWidth - gap);
  mExpressionSection->UI_SetLocalRectF(RectF(0, 0, tableWidth, r.height));
  mFormatSection->UI_SetLocalRectF(RectF(tableWidth + gap, 0, formatWidth, r.height));
  mExpressions->UI_SetLocalRectF(mExpressionSection->ContentRect());
  mFormats->UI_SetLocalRectF(mFormatSection->ContentRect());
}

}  // namespace norvik::gallery
