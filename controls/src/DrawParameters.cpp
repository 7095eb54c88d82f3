#include "controls/DrawParameters.h"

#include "controls/UI_ControlView.h"
#include "ui/UI_NodeManager.h"

namespace norvik::controls {

DrawParameters::DrawParameters() { SetDefaults(); }

DrawParameters::DrawParameters(const UI_ControlView* inControl) {
  SetDefaults();
  if (!inControl) return;
  mControlState = inControl->GetControlState(true);
  mRect = inControl->UI_GetLocalRectF(false);
  if (const auto* colors = dynamic_cast<const UI_ColorChangeSupport*>(inControl))
    mColorChangeMap = &colors->GetColorChangeMap();
  mTheme = inControl->UI_GetCurrentTheme();
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst();
  mAllowMnemonics = manager && manager->IsMnemonicEnabled();
  mDisplayMnemonics = inControl->GetDisplayMnemonic();
  mMnemonicLocation = inControl->GetMnemonicLocation();
  mValueUnknown = inControl->IsValueUnknown();
}

void DrawParameters::SetDefaults() {
  mControlState = StateFlags();
  mRect = RectF();
  mColorChangeMap = nullptr;
  mTheme = ui::Theme::GetTheme(ui::GetDefaultThemeName());
  mAllowMnemonics = false;
  mDisplayMnemonics = false;
  mMnemonicLocation = 0;
  mValueUnknown = false;
}

drawbot::ColorRGBA DrawParameters::Color(std::uint64_t inIndex) const {
  const std::uint64_t index = UI_GetColorFromChangeMap(inIndex, mColorChangeMap);
  return mTheme ? mTheme->GetColor(index) : ui::GetColor(index);
}

DrawTextControlBaseParameters::DrawTextControlBaseParameters()
    : mFontName(ui::GetFontName(0)), mFontSize(ui::GetFontSize(0)) {}

DrawButtonParameters::DrawButtonParameters(const UI_ControlView* inControl) : DrawParameters(inControl) {}

DrawTextButtonParameters::DrawTextButtonParameters(const UI_ControlView* inControl)
    : DrawButtonParameters(inControl) {}

DrawPictureButtonParameters::DrawPictureButtonParameters(const UI_ControlView* inControl)
    : DrawButtonParameters(inControl) {}

DrawCheckBoxParams::DrawCheckBoxParams(const UI_ControlView* inControl) : DrawButtonParameters(inControl) {}

DrawRadioButtonParams::DrawRadioButtonParams(const UI_ControlView* inControl) : DrawButtonParameters(inControl) {}

}  // namespace norvik::controls
