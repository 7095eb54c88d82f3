// The two-tier bevel that every chromed control paints: an outer outline or
// outer gradient, a one-pixel outline, the inner gradient and a one-pixel
// inner bevel ring, all from theme colours passed through the colour change
// map. Corners are square in this version, so outlines use plain rectangles.
#include "controls/UI_Button.h"
#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"

namespace norvik::controls {

namespace {

using RectF = tarsel::geom::RectT<float>;
using PointF = tarsel::geom::PointT<float>;
using StateFlags = tarsel::utility::Flags<unsigned long>;

struct GradientColors {
  std::uint64_t a, b;
  float middle;
  bool upsideDown = false;
};

RectF Inset(const RectF& inRect, float inLeft, float inTop, float inRight, float inBottom) {
  return RectF(inRect.left + inLeft, inRect.top + inTop, inRect.width - inLeft - inRight,
               inRect.height - inTop - inBottom);
}

RectF Inset(const RectF& inRect, float inBy) { return Inset(inRect, inBy, inBy, inBy, inBy); }

bool IsEmpty(const RectF& inRect) { return inRect.width <= 0 || inRect.height <= 0; }

drawbot::ColorRGBA Mix(const drawbot::ColorRGBA& inA, const drawbot::ColorRGBA& inB, float inT) {
  return drawbot::ColorRGBA(inA.red + (inB.red - inA.red) * inT, inA.green + (inB.green - inA.green) * inT,
                            inA.blue + (inB.blue - inA.blue) * inT, inA.alpha + (inB.alpha - inA.alpha) * inT);
}

class BevelPainter {
 public:
  BevelPainter(const DrawButtonParameters& inParams, drawbot::Drawbot& inDrawbot)
      : mParams(inParams),
        mSupplier(inDrawbot.GetSupplier()),
        mSurface(inDrawbot.GetSurface()),
        mDrawbot(inDrawbot),
        mState(inParams.GetControlState()),
        mSelected(inParams.GetSelectedAppearance()) {}

  void Paint(const RectF& inRect);

 private:
  bool Has(unsigned long inBit) const { return mState.Test(inBit); }
  void Outline(const RectF& inRect, float inWidth, std::uint64_t inColor);
  void Gradient(const RectF& inRect, const GradientColors& inColors);
  void ClipToFrame(const RectF& inOuter, const RectF& inInner);
  GradientColors OuterGradient() const;
  GradientColors FillGradient() const;
  GradientColors RingGradient(bool inDown) const;
  std::uint64_t OutlineColor() const;

  const DrawButtonParameters& mParams;
  const drawbot::SupplierInterface* mSupplier;
  drawbot::SurfaceInterface* mSurface;
  drawbot::Drawbot& mDrawbot;
  StateFlags mState;
  bool mSelected;
};

void BevelPainter::Outline(const RectF& inRect, float inWidth, std::uint64_t inColor) {
  if (IsEmpty(inRect)) return;
  drawbot::PathP path(mSupplier);
  drawbot::PenP pen(mSupplier, mParams.Color(inColor), inWidth);
  if (!path || !pen) return;
  path->AddRect(Inset(inRect, inWidth / 2));
  mSurface->StrokePath(*pen, *path);
}

void BevelPainter::Gradient(const RectF& inRect, const GradientColors& inColors) {
  if (IsEmpty(inRect)) return;
  const drawbot::ColorRGBA a = mParams.Color(inColors.a);
  const drawbot::ColorRGBA b = mParams.Color(inColors.b);
  if (!mSupplier->SupportsLinearShader()) {
    const float brightness = mParams.GetTheme() ? mParams.GetTheme()->GetBrightness() : 0.25f;
    mSurface->PaintRect(Mix(b, a, brightness), inRect);
    return;
  }
  PointF top(inRect.left, inRect.top), bottom(inRect.left, inRect.top + inRect.height);
  if (inColors.upsideDown) std::swap(top, bottom);
  drawbot::LinearShaderP shader(mSupplier, top, bottom,
                                {{0.0f, a}, {inColors.middle, Mix(a, b, 0.5f)}, {1.0f, b}});
  drawbot::PathP path(mSupplier);
  if (!shader || !path) return;
  path->AddRect(inRect);
  mSurface->ShadePath(*shader, *path, drawbot::kFillWinding);
}

void BevelPainter::ClipToFrame(const RectF& inOuter, const RectF& inInner) {
  drawbot::PathP path(mSupplier);
  if (!path) return;
  path->AddRect(inOuter);
  if (!IsEmpty(inInner)) path->AddRect(inInner);
  mSurface->Clip(*path, drawbot::kFillAlternate);
}

GradientColors BevelPainter::OuterGradient() const {
  const bool disabled = Has(UI_ControlView::kStateDisabled);
  if (mSelected) return disabled ? GradientColors{360, 361, 0.4121f} : GradientColors{358, 359, 0.4121f};
  return disabled ? GradientColors{16, 17, 0.4121f} : GradientColors{14, 15, 0.4121f};
}

GradientColors BevelPainter::FillGradient() const {
  const bool down = Has(UI_ControlView::kStateDown);
  const bool rollover = Has(UI_ControlView::kStateRollover);
  if (Has(UI_ControlView::kStateDisabled)) {
    if (mSelected) return {347, 348, 0.6293f, true};
    return down ? GradientColors{39, 40, 0.6293f, true} : GradientColors{37, 38, 0.7582f, true};
  }
  if (mSelected) {
    if (down) return {345, 346, 0.6293f, true};
    return rollover ? GradientColors{343, 344, 0.6293f, true} : GradientColors{341, 342, 0.6293f, true};
  }
  if (down) return rollover ? GradientColors{35, 36, 0.6293f, true} : GradientColors{31, 32, 0.7582f, true};
  return rollover ? GradientColors{33, 34, 0.4011f} : GradientColors{29, 30, 0.4011f};
}

GradientColors BevelPainter::RingGradient(bool inDown) const {
  const bool rollover = Has(UI_ControlView::kStateRollover);
  if (inDown) {
    if (mSelected) return {353, 354, 0.6293f};
    if (Has(UI_ControlView::kStateDisabled)) return {45, 46, 0.3901f};
    return rollover ? GradientColors{43, 44, 0.3901f} : GradientColors{41, 42, 0.3901f};
  }
  if (mSelected) return rollover ? GradientColors{351, 352, 0.6293f} : GradientColors{349, 350, 0.6293f};
  return rollover ? GradientColors{27, 28, 0.3901f} : GradientColors{25, 26, 0.3901f};
}

std::uint64_t BevelPainter::OutlineColor() const {
  const bool down = Has(UI_ControlView::kStateDown);
  if (mSelected) return Has(UI_ControlView::kStateDisabled) ? 357 : 356;
  if (Has(UI_ControlView::kStateDisabled)) return down ? 24 : 47;
  return (Has(UI_ControlView::kStateRollover) ? 22 : 20) + (down ? 1 : 0);
}

void BevelPainter::Paint(const RectF& inRect) {
  const bool inset = mParams.GetInsetUndrawnSpace();
  const bool down = Has(UI_ControlView::kStateDown);
  const bool disabled = Has(UI_ControlView::kStateDisabled);
  const RectF r0 = Inset(inRect, 0, 1, 0, 0);
  RectF r1 = r0, r2 = r0;
  if (inset) {
    r1 = Inset(r0, 2);
    r2 = Inset(r0, 1);
  }
  const bool container = mParams.GetDrawContainer();
  const bool outline = mParams.GetDrawOutline();
  if (container) {
    // Without the outer bevel nothing stands at the edge, so the inner parts
    // do not step inward for it either.
    bool edgeDrawn = true;
    if (!Has(UI_ControlView::kStateFocused) && !mParams.GetDefaultAppearance()) {
      edgeDrawn = outline && mParams.ShouldDrawOuterBevelOutline();
      if (edgeDrawn) Gradient(r0, OuterGradient());
    } else {
      Outline(r0, 2, Has(UI_ControlView::kStateFocused) ? 18 : disabled ? 309 : 19);
    }
    if (edgeDrawn && !inset) {
      r1 = Inset(r1, 1);
      r2 = Inset(r2, 1);
    }
  }
  if (container && outline) {
    Outline(r2, 1, OutlineColor());
    if (!inset) r1 = Inset(r1, 1);
  }
  const float fillInset = disabled && !down ? 0.0f : 1.0f;
  const RectF rf = Inset(r1, fillInset);
  // The inner gradient is the container's fill and its ring belongs with it:
  // a picture button whose container is hidden at rest shows its image alone,
  // whatever its inner-gradient and ring flags say.
  if (container && mParams.ShouldDrawInnerGradient()) Gradient(rf, FillGradient());
  if (container && mParams.ShouldDrawInnerBevelOutline()) {
    if (disabled && !down) {
      Outline(rf, 1, mSelected ? 355 : 48);
    } else {
      drawbot::ScSurfaceState state(mSurface);
      ClipToFrame(rf, Inset(rf, 1));
      Gradient(rf, RingGradient(down));
    }
  }
  if (const DrawButtonFace* face = mParams.GetDrawButtonFace()) {
    drawbot::ScSurfaceState state(mSurface);
    const RectF faceRect = container ? rf : inRect;
    ui::UI_Node::UI_ClipToRect(faceRect, &mDrawbot);
    const ui::ThemeP& theme = mParams.GetTheme();
    face->operator()(mState, faceRect, mParams.GetOffset(), mDrawbot, theme ? *theme : ui::Theme::Get(),
                     mParams.GetColorChangeMap());
  }
}

}  // namespace

void UI_Button::Draw(const DrawButtonParameters& inParams, drawbot::Drawbot& inDrawbot) {
  drawbot::SurfaceInterface* surface = inDrawbot.GetSurface();
  if (!surface) return;
  drawbot::ScSurfaceState state(surface);
  ui::UI_Node::UI_ClipToRect(inParams.GetRectF(), &inDrawbot);
  const float half = inParams.GetStrokeSize() / 2;
  const RectF& r = inParams.GetRectF();
  const RectF inner(r.left + half, r.top + half, r.width - 2 * half, r.height - 2 * half);
  if (inner.width > 0 && inner.height > 0) BevelPainter(inParams, inDrawbot).Paint(inner);
}

}  // namespace norvik::controls
