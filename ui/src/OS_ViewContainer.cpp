// View containers: the float rectangle kept across native re-parenting, the
// popup-born window turning into a child, and the paint of the subtree.
#include "ui/OS_ViewContainer.h"

#include "drawbot/Drawbot.h"
#include "drawbot/SupplierInterface.h"
#include "drawbot/SurfaceInterface.h"
#include "ui/Theme.h"

namespace norvik::ui {

namespace {
constexpr std::uint64_t kPanelBackgroundColor = 277;
}

OS_ViewContainer::OS_ViewContainer(bool inDoubleBuffered) : mDoubleBuffered(inDoubleBuffered) {
  UI_SetNodeID("OS_ViewContainer");
  UI_CreateWindow(u"OS_ViewContainer", 0, RectL(), kOSStylePopup | kOSStyleClipChildren, kOSExStyleNoActivate);
}

OS_ViewContainer::~OS_ViewContainer() {
  // Hidden first, so that nothing of it shows while the tree goes down. The
  // messages that hiding sends (activation moving on) no longer reach this
  // node: it is half destroyed.
  if (GetRefCount() == 0) AddRef();
  if (OS_NativeLayer* layer = GetNativeLayer(); layer && mPlatformWindow) {
    layer->RemoveProperty(mPlatformWindow, kWindowProperty);
    layer->ShowWindow(mPlatformWindow, kOSShowHide);
  }
}

void OS_ViewContainer::UI_SetLocalRect(const RectL& inRect) {
  mRect = RectF(inRect);
  OS_Window::UI_SetLocalRect(inRect);
}

void OS_ViewContainer::UI_SetLocalRectF(const RectF& inRect) {
  mRect = inRect;
  OS_Window::UI_SetLocalRect(UI_EnclosingRect(inRect));
}

void OS_ViewContainer::UI_SetParent(UI_Container* inParent) {
  UI_NodeProtector protect(this);
  OS_Window::UI_SetParent(inParent);
  UI_SynchronizeParent();
}

void OS_ViewContainer::UI_SynchronizeParent() {
  UI_Node* recipient = UI_GetParentEventRecipientNode();
  UI_SynchronizeParentForPopupBornWindow();
  OS_Window::UI_SynchronizeParent();
  // The native origin moved with the parent: the same rectangle, applied again.
  if (recipient) OS_Window::UI_SetLocalRect(UI_EnclosingRect(mRect));
}

void OS_ViewContainer::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const drawbot::SupplierInterface* supplier = inDrawbot ? inDrawbot->GetSupplier() : nullptr;
  if (mDoubleBuffered && supplier && inDrawbot->GetSurface()) {
    drawbot::SurfaceInterfaceP buffered(supplier->NewReferenceSurface(inDrawbot->GetSurface(), true, nullptr));
    if (buffered) {
      drawbot::Drawbot bufferedDrawbot(supplier, buffered.get());
      UI_Node::UI_Draw(&bufferedDrawbot);
      buffered->Flush();
      return;
    }
  }
  UI_Node::UI_Draw(inDrawbot);
}

// ---- OS_TopLevelViewContainer ----

OS_TopLevelViewContainer::OS_TopLevelViewContainer(bool inDoubleBuffered) : OS_ViewContainer(inDoubleBuffered) {}

bool OS_TopLevelViewContainer::UI_AreAllParentsVisible() const {
  OS_NativeLayer* layer = GetNativeLayer();
  return layer && mPlatformWindow && layer->IsWindowVisible(mPlatformWindow) && UI_IsShown();
}

bool OS_TopLevelViewContainer::UI_DoKeyboardEvent(UI_Node* inTarget, const KeyboardEvent& inEvent) {
  return UI_DoAdvanceKeyboardFocus(this, inTarget, inEvent);
}

// ---- OS_PopupViewContainer ----

OS_PopupViewContainer::OS_PopupViewContainer(bool inNoBackground, bool inDoubleBuffered)
    : OS_ViewContainer(inDoubleBuffered), mNoBackground(inNoBackground) {}

void OS_PopupViewContainer::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const drawbot::ColorRGBA transparent{0.0f, 0.0f, 0.0f, 0.0f};
  const drawbot::ColorRGBA background = mNoBackground ? transparent : GetThemeColor(kPanelBackgroundColor);
  UI_DispatchDrawFromRoot(&background, inDrawbot, mDoubleBuffered);
}

}  // namespace norvik::ui
