// The boxes of check boxes and radio buttons: nested gradients from the
// theme, then the tick, mixed mark or dot as plain geometry scaled to the box.
#include <utility>

#include "controls/UI_Checkbox.h"
#include "controls/UI_RadioButton.h"
#include "drawbot/DrawHelpers.h"
#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"

namespace norvik::controls {

namespace {

using RectF = tarsel::geom::RectT<float>;
using PointF = tarsel::geom::PointT<float>;
constexpr float kLabelGap = 3;
constexpr float kStops[4] = {0.4121f, 0.5374f, 0.3901f, 0.4011f};
constexpr std::uint64_t kMarkColor = 1;
constexpr std::uint64_t kDisabledMarkColor = 7;

drawbot::ColorRGBA Mid(const drawbot::ColorRGBA& inA, const drawbot::ColorRGBA& inB) {
  return drawbot::ColorRGBA((inA.red + inB.red) / 2, (inA.green + inB.green) / 2, (inA.blue + inB.blue) / 2,
                            (inA.alpha + inB.alpha) / 2);
}

// The four colour pairs of the rings, outermost first, by state. Each state's
// set follows the last: the outer colour 2 further on, the inner three 8.
void RingColors(const DrawParameters& inParams, std::uint64_t (&outColors)[4][2]) {
  const auto state = inParams.GetControlState();
  std::uint64_t set[4] = {49, 77, 78, 79};
  if (state.Test(UI_ControlView::kStateDisabled)) {
    const std::uint64_t disabled[4] = {55, 101, 102, 103};
    std::copy(disabled, disabled + 4, set);
  } else if (state.Test(UI_ControlView::kStateDown)) {
    const std::uint64_t down[4] = {53, 93, 94, 95};
    std::copy(down, down + 4, set);
  } else if (state.Test(UI_ControlView::kStateRollover)) {
    const std::uint64_t rollover[4] = {51, 85, 86, 87};
    std::copy(rollover, rollover + 4, set);
  }
  for (int i = 0; i < 4; ++i) outColors[i][0] = outColors[i][1] = set[i];
  outColors[1][1] = set[2];
  outColors[2][1] = set[3];
  if (state.Test(UI_ControlView::kStateFocused)) outColors[0][0] = outColors[0][1] = 161;
}

// A circle for radio buttons; for check boxes a rectangle whose corners are
// rounded by inCornerRadius.
constexpr float kCircle = -1;
constexpr float kCheckboxCornerRadius = 3;

void AddShape(drawbot::PathInterface& ioPath, const RectF& inRect, bool inRound) {
  if (!inRound) {
    ioPath.AddRect(inRect);
    return;
  }
  const float radius = std::min(inRect.width, inRect.height) / 2;
  ioPath.AddArc(PointF(inRect.left + inRect.width / 2, inRect.top + inRect.height / 2), radius, 0, 360);
}

void PaintRings(const DrawParameters& inParams, const RectF& inBox, float inCornerRadius,
                drawbot::Drawbot& inDrawbot) {
  const drawbot::SupplierInterface* supplier = inDrawbot.GetSupplier();
  std::uint64_t colors[4][2];
  RingColors(inParams, colors);
  RectF r = inBox;
  for (int i = 0; i < 4 && r.width > 0 && r.height > 0; ++i) {
    const drawbot::ColorRGBA a = inParams.Color(colors[i][0]), b = inParams.Color(colors[i][1]);
    drawbot::LinearShaderP shader(supplier, PointF(r.left, r.top), PointF(r.left, r.top + r.height),
                                  {{0.0f, a}, {kStops[i], Mid(a, b)}, {1.0f, b}});
    drawbot::PathP path(supplier);
    if (inCornerRadius == kCircle)
      AddShape(*path, r, true);
    else
      GetRoundedRectPath(supplier, r, std::max(0.0f, inCornerRadius - static_cast<float>(i)), &path);
    if (!shader || !path) return;
    inDrawbot.GetSurface()->ShadePath(*shader, *path, drawbot::kFillWinding);
    r = RectF(r.left + 1, r.top + 1, r.width - 2, r.height - 2);
  }
}

drawbot::ColorRGBA MarkColor(const DrawParameters& inParams) {
  return inParams.Color(inParams.GetControlState().Test(UI_ControlView::kStateDisabled) ? kDisabledMarkColor
                                                                                        : kMarkColor);
}

RectF CentredBox(float inSize, const RectF& inColumn) {
  return RectF(inColumn.left, inColumn.top + std::floor((inColumn.height - inSize) / 2), inSize, inSize);
}

}  // namespace

std::pair<RectF, RectF> UI_Checkbox::GetButtonTextRects(float inCheckSize, const RectF& inRect) {
  const RectF box(inRect.left, inRect.top, std::min(inCheckSize, inRect.width), inRect.height);
  const float textLeft = inRect.left + inCheckSize + kLabelGap;
  return {box, RectF(textLeft, inRect.top, std::max(0.0f, inRect.left + inRect.width - textLeft), inRect.height)};
}

std::pair<RectF, RectF> UI_RadioButton::GetButtonTextRects(float inButtonSize, const RectF& inRect) {
  return UI_Checkbox::GetButtonTextRects(inButtonSize, inRect);
}

void DrawCheckbox::operator()(DrawParameters::StateFlags, const tarsel::geom::RectT<float>& inRect,
                              const tarsel::geom::PointT<float>& inOffset, drawbot::Drawbot& inDrawbot,
                              const ui::Theme&, const ColorChangeMap*) const {
  Paint(RectF(inRect.left + inOffset.x, inRect.top + inOffset.y, inRect.width, inRect.height), inDrawbot);
}

void DrawCheckbox::Paint(const tarsel::geom::RectT<float>& inBox, drawbot::Drawbot& inDrawbot) const {
  const drawbot::SupplierInterface* supplier = inDrawbot.GetSupplier();
  const bool mixed = mParams.GetValue() == UI_Checkbox::kMixed || mParams.GetValueUnknown();
  if ((mParams.GetValue() == UI_Checkbox::kOff && !mixed) || !supplier || !inDrawbot.GetSurface()) return;
  drawbot::PathP path(supplier);
  drawbot::PenP pen(supplier, MarkColor(mParams), std::max(1.5f, inBox.width / 7));
  if (!path || !pen) return;
  const RectF& box = inBox;
  auto at = [&](float inX, float inY) { return PointF(box.left + inX * box.width, box.top + inY * box.height); };
  if (mixed) {
    path->MoveTo(at(0.25f, 0.5f));
    path->LineTo(at(0.75f, 0.5f));
  } else {
    path->MoveTo(at(0.22f, 0.52f));
    path->LineTo(at(0.42f, 0.72f));
    path->LineTo(at(0.78f, 0.28f));
  }
  drawbot::ScSurfaceState state(inDrawbot.GetSurface());
  inDrawbot.GetSurface()->SetAntiAliasPolicy(drawbot::kAntiAlias);
  inDrawbot.GetSurface()->StrokePath(*pen, *path);
}

void UI_Checkbox::Draw(const DrawCheckBoxParams& inParams, drawbot::Drawbot& inDrawbot) {
  if (!inDrawbot.GetSurface()) return;
  drawbot::ScSurfaceState state(inDrawbot.GetSurface());
  ui::UI_Node::UI_ClipToRect(inParams.GetRectF(), &inDrawbot);
  DrawHelper(inParams, inDrawbot);
}

void UI_Checkbox::DrawHelper(const DrawCheckBoxParams& inParams, drawbot::Drawbot& inDrawbot) {
  if (!inDrawbot.GetSurface()) return;
  const auto [column, text] = GetButtonTextRects(inParams.GetCheckSize(), inParams.GetRectF());
  const RectF box = CentredBox(inParams.GetCheckSize(), column);
  PaintRings(inParams, box, kCheckboxCornerRadius, inDrawbot);
  DrawCheckbox(inParams).Paint(box, inDrawbot);
  DrawTextControlBaseParameters label(inParams);
  label.SetTextAlignment(drawbot::kTextAlignLeft);
  DrawControlLabel(inParams, label, text, inDrawbot);
}

void UI_RadioButton::Draw(const DrawRadioButtonParams& inParams, drawbot::Drawbot& inDrawbot) {
  if (!inDrawbot.GetSurface()) return;
  drawbot::ScSurfaceState state(inDrawbot.GetSurface());
  ui::UI_Node::UI_ClipToRect(inParams.GetRectF(), &inDrawbot);
  inDrawbot.GetSurface()->SetAntiAliasPolicy(drawbot::kAntiAlias);
  const auto [column, text] = GetButtonTextRects(inParams.GetButtonSize(), inParams.GetRectF());
  const RectF box = CentredBox(inParams.GetButtonSize(), column);
  PaintRings(inParams, box, kCircle, inDrawbot);
  if (inParams.GetOn()) {
    drawbot::PathP dot(inDrawbot.GetSupplier());
    drawbot::BrushP brush(inDrawbot.GetSupplier(), MarkColor(inParams));
    if (dot && brush) {
      const float inset = box.width * 0.32f;
      AddShape(*dot, RectF(box.left + inset, box.top + inset, box.width - 2 * inset, box.height - 2 * inset), true);
      inDrawbot.GetSurface()->FillPath(*brush, *dot, drawbot::kFillWinding);
    }
  }
  DrawTextControlBaseParameters label(inParams);
  label.SetTextAlignment(drawbot::kTextAlignLeft);
  DrawControlLabel(inParams, label, text, inDrawbot);
}

}  // namespace norvik::controls
