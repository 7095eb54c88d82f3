#include "controls/UI_DisclosureTriangleButton.h"

#include <algorithm>
#include <cmath>

#include "controls/ControlClock.h"
#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "ui/UI_NodeManager.h"

namespace norvik::controls {

namespace {
constexpr std::uint64_t kTriangleColor = 1;
constexpr std::uint64_t kDisabledTriangleColor = 7;
}  // namespace

UI_DisclosureTriangleButton::UI_DisclosureTriangleButton(const UTF16String& inText)
    : UI_PictureTextButton(inText) {
  UI_SetNodeID("UI_DisclosureTriangleButton");
  SetSpringLoaded(false);
  ui::UI_NodeManager* manager = ui::UI_NodeManager::Get();
  mTimerID = manager ? manager->GetUniqueTimerID() : -2;
}

UI_DisclosureTriangleButton::~UI_DisclosureTriangleButton() = default;

double UI_DisclosureTriangleButton::GetAnimationTime() const {
  if (mAnimationStart < 0) return -1;
  const double t = ControlClockNow() - mAnimationStart;
  return t >= 0 && t < mTwirlDuration ? t : -1;
}

// The change is held back until the twirl has run; the timer sends it.
void UI_DisclosureTriangleButton::SendButtonChangedMessage(ModKeys inModKeys) {
  mStoredModKeys = inModKeys;
  mAnimationStart = ControlClockNow();
  UI_InstallTimer(static_cast<float>(mTwirlDuration / 5), mTimerID);
  UI_Invalidate(nullptr, 0);
}

bool UI_DisclosureTriangleButton::UI_DoTimerNotify(long inTimerID) {
  if (inTimerID != mTimerID) return UI_PictureTextButton::UI_DoTimerNotify(inTimerID);
  ui::UI_NodeProtector protector(this);
  const double elapsed = ControlClockNow() - mAnimationStart;
  if (elapsed >= 0 && elapsed < mTwirlDuration) {
    UI_Invalidate(nullptr, 0);
    UI_UpdateNow(kUpdateNowImmediate);
    return true;
  }
  mAnimationStart = -1;
  UI_RemoveTimer(mTimerID, false);
  UI_Invalidate(nullptr, 0);
  UI_Button::SendButtonChangedMessage(mStoredModKeys);
  return true;
}

DrawTrianglePicture::DrawTrianglePicture(const DrawParameters& inParams, double inTime, double inDuration,
                                         bool inValue, bool inCaptured, float inScale)
    : mParams(inParams),
      mTime(inTime),
      mDuration(inDuration),
      mValue(inValue),
      mCaptured(inCaptured),
      mScale(inScale) {}

float DrawTrianglePicture::GetAngle(DrawParameters::StateFlags inState) const {
  const bool open = mCaptured ? inState.Test(UI_ControlView::kStateDown) : mValue;
  if (mTime < 0 || mDuration <= 0) return open ? 90.0f : 0.0f;
  const float progress = static_cast<float>(std::clamp(mTime / mDuration, 0.0, 1.0));
  return open ? 90.0f * progress : 90.0f * (1 - progress);
}

void DrawTrianglePicture::operator()(DrawParameters::StateFlags inState, const tarsel::geom::RectT<float>& inRect,
                                     const tarsel::geom::PointT<float>& inOffset, drawbot::Drawbot& inDrawbot,
                                     const ui::Theme&, const ColorChangeMap*) const {
  // The triangle keeps its scaled size however large the rectangle it is centred in.
  const float side = std::min({inRect.width, inRect.height, 12 * mScale});
  const tarsel::geom::RectT<float> square(inRect.left + inOffset.x + (inRect.width - side) / 2,
                                         inRect.top + inOffset.y + (inRect.height - side) / 2, side, side);
  UI_DisclosureTriangleButton::DrawTriangle(mParams, square, GetAngle(inState), inDrawbot);
}

void UI_DisclosureTriangleButton::DrawPicture(const DrawParameters& inParams, const RectF& inRect,
                                              drawbot::Drawbot& inDrawbot) {
  // The triangle turns towards the press look (the down state): the button's
  // value follows only when the twirl has ended.
  const DrawTrianglePicture face(inParams, GetAnimationTime(), mTwirlDuration, GetDownState(), IsButtonCaptured(),
                                 GetScale());
  if (!inParams.GetTheme()) return;
  face(inParams.GetControlState(), inRect, PointF(), inDrawbot, *inParams.GetTheme(), inParams.GetColorChangeMap());
}

void UI_DisclosureTriangleButton::DrawTriangle(const DrawParameters& inParams, const RectF& inRect, float inAngle,
                                               drawbot::Drawbot& inDrawbot) {
  const drawbot::SupplierInterface* supplier = inDrawbot.GetSupplier();
  drawbot::SurfaceInterface* surface = inDrawbot.GetSurface();
  if (!supplier || !surface || inRect.width <= 0 || inRect.height <= 0) return;
  const bool disabled = inParams.GetControlState().Test(UI_ControlView::kStateDisabled);
  drawbot::PathP path(supplier);
  drawbot::BrushP brush(supplier, inParams.Color(disabled ? kDisabledTriangleColor : kTriangleColor));
  if (!path || !brush) return;
  const float cx = inRect.left + inRect.width / 2, cy = inRect.top + inRect.height / 2;
  const float r = std::min(inRect.width, inRect.height) * 0.4f;
  const float radians = inAngle * 3.14159265f / 180.0f;
  const float c = std::cos(radians), s = std::sin(radians);
  // A triangle pointing right, turned about the centre.
  const float points[3][2] = {{-0.6f * r, -r}, {-0.6f * r, r}, {r, 0}};
  for (int i = 0; i < 3; ++i) {
    const tarsel::geom::PointT<float> p(cx + points[i][0] * c - points[i][1] * s,
                                       cy + points[i][0] * s + points[i][1] * c);
    if (i == 0)
      path->MoveTo(p);
    else
      path->LineTo(p);
  }
  path->ClosePath();
  drawbot::ScSurfaceState state(surface);
  surface->SetAntiAliasPolicy(drawbot::kAntiAlias);
  surface->FillPath(*brush, *path, drawbot::kFillWinding);
}

}  // namespace norvik::controls
