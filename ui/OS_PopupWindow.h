#pragma once
// Popup windows: a native window above everything, never activated, with a
// drop shadow, that draws with the supplier it was given. The view-container
// form paints the panel background and a one-pixel frame around its tree.
#include "ui/OS_ViewContainer.h"

namespace norvik::ui {

class OS_PopupWindow : public OS_Window {
 public:
  explicit OS_PopupWindow(const drawbot::SupplierInterface* inSupplier);

  drawbot::SupplierInterface* UI_GetDrawSupplier() const override;
  void UI_Show(bool inShow) override { OS_Window::UI_Show(inShow); }
  bool UI_SupportsDrawbot() const override { return true; }

 protected:
  const drawbot::SupplierInterface* mSupplier;
};

class PopupWindowViewContainer : public OS_PopupViewContainer {
 public:
  PopupWindowViewContainer() : OS_PopupViewContainer(false, true) {}

  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
};

}  // namespace norvik::ui
