#include "controls/UI_PictureButton.h"

#include <cmath>

#include "controls/DrawButtonFaces.h"
#include "drawbot/Drawbot.h"
#include "ui/KeyboardEvent.h"
#include "tarsel/ThrowError.h"
#include "ui/UI_NodeManager.h"

namespace norvik::controls {

namespace {
constexpr std::uint64_t kDisabledImageAlphaColor = 306;

// Sets the supplier of the drawing under way, and puts the outer one back.
class ScDrawingSupplier {
 public:
  ScDrawingSupplier(const drawbot::SupplierInterface*& ioSlot, const drawbot::SupplierInterface* inSupplier)
      : mSlot(ioSlot), mSaved(ioSlot) {
    mSlot = inSupplier;
  }
  ~ScDrawingSupplier() { mSlot = mSaved; }

 private:
  const drawbot::SupplierInterface*& mSlot;
  const drawbot::SupplierInterface* mSaved;
};
}  // namespace

UI_PictureButton::UI_PictureButton() { UI_SetNodeID("UI_PictureButton"); }

void UI_PictureButton::SetImageBaseName(const UTF8String& inName) {
  if (mImageBaseName == inName) return;
  mImageBaseName = inName;
  UI_Invalidate(nullptr, 0);
}

void UI_PictureButton::SetImageSupplyFunction(const ImageSupplyFunction& inFunction) {
  mSupply = inFunction;
  UI_Invalidate(nullptr, 0);
}

void UI_PictureButton::SetScale(float inScale) {
  if (mScale == inScale) return;
  mScale = inScale;
  UI_Invalidate(nullptr, 0);
}

void UI_PictureButton::SetImageBorder(float inBorder) {
  if (mImageBorder == inBorder) return;
  mImageBorder = inBorder;
  UI_Invalidate(nullptr, 0);
}

UI_PictureButton::PointF UI_PictureButton::UI_GetRecommendedSize() const {
  const drawbot::ImageInterface* image = FindImage();
  if (!image) return UI_Button::UI_GetRecommendedSize();
  return PointF(static_cast<float>(image->GetWidth()) * mScale + 2 * mImageBorder,
                static_cast<float>(image->GetHeight()) * mScale + 2 * mImageBorder);
}

void UI_PictureButton::SetAlpha(float inAlpha) {
  if (mAlpha == inAlpha) return;
  mAlpha = inAlpha;
  UI_Invalidate(nullptr, 0);
}

const drawbot::ImageInterface* UI_PictureButton::GetImage() const {
  if (!mSupply) return nullptr;
  UI_PictureSupplyMessage message(this, GetCurrentModKeys());
  message.SetStateFlags(GetControlState(true));
  mSupply(&message);
  return message.GetImage();
}

const drawbot::SupplierInterface* UI_PictureButton::GetDrawingSupplier() const {
  if (mDrawingSupplier) return mDrawingSupplier;
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst();
  return manager ? manager->GetOSDrawSupplier() : nullptr;
}

const drawbot::ImageInterface* UI_PictureButton::FindImage() const {
  return mSupply ? GetImage() : LoadImage(mImageBaseName, GetDrawingSupplier());
}

void UI_PictureButton::DrawPicture(const DrawParameters& inParams, const drawbot::ImageInterface& inImage,
                                   const RectF& inRect, float inScale, float inAlpha, drawbot::Drawbot& inDrawbot) {
  const float width = static_cast<float>(inImage.GetWidth()) * inScale;
  const float height = static_cast<float>(inImage.GetHeight()) * inScale;
  if (width < 0.01f || height < 0.01f || !inDrawbot.GetSurface() || !inDrawbot.GetSupplier()) return;
  float alpha = inAlpha;
  if (inParams.GetControlState().Test(UI_ControlView::kStateDisabled))
    alpha *= inParams.Color(kDisabledImageAlphaColor).alpha;
  const float left = std::trunc(inRect.left + (inRect.width - width) / 2);
  const float top = std::trunc(inRect.top + (inRect.height - height) / 2);
  inDrawbot.GetSurface()->DrawImage(*inDrawbot.GetSupplier(), inImage, RectF(left, top, width, height), nullptr,
                                    alpha);
}

bool UI_PictureButton::UI_DoKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) {
  if (mReturnActivates && !UI_IsDisabled() &&
      inEvent.CompareShortcut(ui::KeyboardCode::CreateFromControlCode(ui::kControlCodeReturn), ui::kModKeyNone))
    return HandleControlActivateViaKeyboard(inEvent);
  return UI_Button::UI_DoKeyboardEvent(inTarget, inEvent);
}

void UI_PictureButton::Draw(const DrawPictureButtonParameters& inParams, drawbot::Drawbot& inDrawbot) {
  if (!inParams.GetImage()) {
    UI_Button::Draw(inParams, inDrawbot);
    return;
  }
  const DrawButtonPicture face(inParams, *inParams.GetImage(), inParams.GetScale(), inParams.GetAlpha(),
                               inParams.GetImageBorder());
  DrawPictureButtonParameters withFace(inParams);
  withFace.SetDrawButtonFace(&face);
  UI_Button::Draw(withFace, inDrawbot);
}

void UI_PictureButton::UI_Draw(drawbot::Drawbot* inDrawbot) {
  DrawPictureButtonParameters params(this);
  FillButtonParameters(params);
  const auto state = params.GetControlState();
  // A disabled button that is up shows no border, whatever else its state says.
  const bool disabledUp = state.Test(kStateDisabled) && !state.Test(kStateDown);
  const bool border = ShouldDisplayBorderAlways() ||
                      (!ShouldDisplayBorderNever() && state != DrawParameters::StateFlags() && !disabledUp);
  params.SetDrawOutline(border);
  params.SetDrawContainer(ShouldDisplayContainerAlways() || (border && !ShouldDisplayContainerNever()));
  if (GetDownState()) params.SetOffset(params.GetOffset() + GetDownOffset());
  FillDefaultAppearance(params);
  {
    const ScDrawingSupplier drawing(mDrawingSupplier, inDrawbot->GetSupplier());
    params.SetImage(FindImage());
  }
  params.SetScale(mScale);
  params.SetAlpha(mAlpha);
  params.SetImageBorder(mImageBorder);
  Draw(params, *inDrawbot);
}

UI_OwnerDrawButton::UI_OwnerDrawButton() { UI_SetNodeID("UI_OwnerDrawButton"); }

void UI_OwnerDrawButton::UI_Draw(drawbot::Drawbot* inDrawbot) {
  if (mDraw && inDrawbot) mDraw(*this, *inDrawbot);
}

}  // namespace norvik::controls
