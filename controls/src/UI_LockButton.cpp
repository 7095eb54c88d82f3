#include "controls/UI_LockButton.h"

#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "tarsel/ThrowError.h"
#include "ui/UI_NodeManager.h"

namespace norvik::controls {

namespace {
constexpr std::uint64_t kGlyphColor = 1;

// The named resource image, or null when the resources do not have it.
const drawbot::ImageInterface* LoadImage(const UTF8String& inName) {
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst();
  if (!manager || !manager->GetDrawbotImageResourceCache() || !manager->GetOSDrawSupplier()) return nullptr;
  try {
    return manager->GetDrawbotImageResourceCache()
        ->GetImage(&manager->GetResourceManager(), manager->GetOSDrawSupplier(), inName, drawbot::kImageFileTypePNG)
        .get();
  } catch (const tarsel::config::Exception&) {
    return nullptr;
  }
}

// Two interlocking rings when linked, two apart when not; a shackle over a
// body for the lock, open when unlocked.
void DrawGlyph(const DrawParameters& inParams, bool inLock, bool inClosed, drawbot::Drawbot& inDrawbot) {
  const drawbot::SupplierInterface* supplier = inDrawbot.GetSupplier();
  drawbot::SurfaceInterface* surface = inDrawbot.GetSurface();
  drawbot::PenP pen(supplier, inParams.Color(kGlyphColor), 1.5f);
  drawbot::PathP path(supplier);
  if (!pen || !path || !surface) return;
  const auto& r = inParams.GetRectF();
  const float cx = r.left + r.width / 2, cy = r.top + r.height / 2;
  if (inLock) {
    path->AddRect(tarsel::geom::RectT<float>(cx - 4, cy - 1, 8, 6));
    path->MoveTo(tarsel::geom::PointT<float>(cx - 2.5f, cy - 1));
    path->LineTo(tarsel::geom::PointT<float>(cx - 2.5f, cy - 5));
    path->LineTo(tarsel::geom::PointT<float>(cx + 2.5f, cy - 5));
    path->LineTo(tarsel::geom::PointT<float>(cx + 2.5f, inClosed ? cy - 1 : cy - 3));
  } else {
    const float gap = inClosed ? 1.5f : 3.5f;
    path->AddArc(tarsel::geom::PointT<float>(cx, cy - gap), 2.5f, 0, 360);
    path->AddArc(tarsel::geom::PointT<float>(cx, cy + gap), 2.5f, 0, 360);
  }
  drawbot::ScSurfaceState state(surface);
  surface->SetAntiAliasPolicy(drawbot::kAntiAlias);
  surface->StrokePath(*pen, *path);
}

void DrawWithFallback(UI_PictureButton& inButton, bool inLock, drawbot::Drawbot* inDrawbot) {
  if (inButton.GetImage()) {
    inButton.UI_PictureButton::UI_Draw(inDrawbot);
    return;
  }
  DrawButtonParameters params(&inButton);
  params.SetDrawOutline(params.GetControlState().TestAny(UI_ControlView::kStateRollover));
  params.SetDrawContainer(params.GetDrawOutline());
  UI_Button::Draw(params, *inDrawbot);
  DrawGlyph(params, inLock, inButton.GetDownState(), *inDrawbot);
}
}  // namespace

UI_LockButton::UI_LockButton() {
  UI_SetNodeID("UI_LockButton");
  SetSpringLoaded(false);
  SetImageSupplyFunction([this](UI_PictureSupplyMessage* inMessage) {
    const auto state = inMessage->GetStateFlags();
    inMessage->SetImage(LoadImage(ImageName(state.Test(kStateDown), state.Test(kStateRollover),
                                            UI_GetCurrentTheme()->GetIconType())));
  });
}

UTF8String UI_LockButton::ImageName(bool inDown, bool inRollover, int inIconType) {
  UTF8String name = inDown ? "RV4_Locked_Sm_" : "RV4_Unlocked_Sm_";
  name += inRollover ? "R" : "N";
  if (inIconType == 1) name += "_D";
  return name;
}

void UI_LockButton::UI_Draw(drawbot::Drawbot* inDrawbot) { DrawWithFallback(*this, true, inDrawbot); }

UI_LinkButton::UI_LinkButton() {
  UI_SetNodeID("UI_LinkButton");
  SetSpringLoaded(false);
  SetImageSupplyFunction([this](UI_PictureSupplyMessage* inMessage) {
    inMessage->SetImage(
        LoadImage(ImageName(inMessage->GetStateFlags().Test(kStateDown), UI_GetCurrentTheme()->GetIconType())));
  });
}

UTF8String UI_LinkButton::ImageName(bool inDown, int inIconType) {
  UTF8String name = inDown ? "RV4_ConstrainedProportions" : "RV4_UnconstrainedProportions";
  if (inIconType == 1) name += "_D";
  return name;
}

void UI_LinkButton::UI_Draw(drawbot::Drawbot* inDrawbot) { DrawWithFallback(*this, false, inDrawbot); }

}  // namespace norvik::controls
