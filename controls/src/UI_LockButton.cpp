#include "controls/UI_LockButton.h"

#include "ui/Theme.h"

namespace norvik::controls {

UI_LockButton::UI_LockButton() {
  UI_SetNodeID("UI_LockButton");
  SetSpringLoaded(false);
  SetImageSupplyFunction([this](UI_PictureSupplyMessage* inMessage) {
    const auto state = inMessage->GetStateFlags();
    inMessage->SetImage(LoadImage(
        ImageName(state.Test(kStateDown), state.Test(kStateRollover), UI_GetCurrentTheme()->GetIconType()),
        GetDrawingSupplier()));
  });
}

UTF8String UI_LockButton::ImageName(bool inDown, bool inRollover, int inIconType) {
  UTF8String name = inDown ? "RV4_Locked_Sm_" : "RV4_Unlocked_Sm_";
  name += inRollover ? "R" : "N";
  if (inIconType == 1) name += "_D";
  return name;
}

UI_LinkButton::UI_LinkButton() {
  UI_SetNodeID("UI_LinkButton");
  SetSpringLoaded(false);
  SetImageSupplyFunction([this](UI_PictureSupplyMessage* inMessage) {
    inMessage->SetImage(LoadImage(
        ImageName(inMessage->GetStateFlags().Test(kStateDown), UI_GetCurrentTheme()->GetIconType()),
        GetDrawingSupplier()));
  });
}

UTF8String UI_LinkButton::ImageName(bool inDown, int inIconType) {
  UTF8String name = inDown ? "RV4_ConstrainedProportions" : "RV4_UnconstrainedProportions";
  if (inIconType == 1) name += "_D";
  return name;
}

}  // namespace norvik::controls
