#include "ui/OS_PopupWindow.h"

#include "drawbot/DrawHelpers.h"
#include "drawbot/Drawbot.h"
#include "ui/Theme.h"

namespace norvik::ui {

namespace {
// The divider grey: it stands apart from the panel fill in the light and in
// the dark look, where the fill's own colour would leave the frame unseen.
constexpr std::uint64_t kPopupFrameColor = 20;
}

OS_PopupWindow::OS_PopupWindow(const drawbot::SupplierInterface* inSupplier) : mSupplier(inSupplier) {
  UI_SetNodeID("OS_PopupWindow");
  UI_CreateWindow(u"OS_PopupWindow", 0, RectL(), kOSStylePopup | kOSStyleClipChildren,
                  kOSExStyleNoActivate | kOSExStyleTopmost, kOSClassStyleDoubleClicks | kOSClassStyleDropShadow);
}

drawbot::SupplierInterface* OS_PopupWindow::UI_GetDrawSupplier() const {
  // Suppliers make objects without changing themselves; the tree's signature
  // predates const suppliers.
  return mSupplier ? const_cast<drawbot::SupplierInterface*>(mSupplier) : OS_Window::UI_GetDrawSupplier();
}

void PopupWindowViewContainer::UI_Draw(drawbot::Drawbot* inDrawbot) {
  OS_PopupViewContainer::UI_Draw(inDrawbot);
  if (!inDrawbot || !inDrawbot->GetSurface()) return;
  RectL frame = UI_GetLocalRect();
  frame.left += 1;
  frame.top += 1;
  frame.width -= 2;
  frame.height -= 2;
  if (frame.width > 0 && frame.height > 0) StrokeRect(*inDrawbot, frame, GetThemeColor(kPopupFrameColor), 1.0f);
}

}  // namespace norvik::ui
