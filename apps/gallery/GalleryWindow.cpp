#include "GalleryWindow.h"

#include "GalleryStyle.h"
#include "ui/OS_WindowConstants.h"

namespace norvik::gallery {

GalleryWindow::GalleryWindow(GalleryPageP inPage, long inWidth, long inHeight) : mPage(std::move(inPage)) {
  UI_SetNodeID("gallery-window");
  ui::OS_NativeLayer* layer = ui::GetNativeLayer();
  const ui::OS_WindowHandle handle = GetHandle();
  if (layer && handle) {
    // A new container is a hidden popup that never takes activation; a main
    // window has a frame and a caption, and takes activation and keys. The
    // style changes while the window is still hidden, so that the platform
    // treats it as a managed window from its first showing.
    layer->SetStyle(handle, (layer->GetStyle(handle) & ~ui::kOSStylePopup) | ui::kOSStyleOverlappedWindow);
    layer->SetExStyle(handle, layer->GetExStyle(handle) & ~ui::kOSExStyleNoActivate);
  }
  UI_SetTitle(Text("$$$/norvik/gallery/Title=norvik gallery"));
  // Only the size: the window manager places the window.
  const RectF placed = UI_GetLocalRectF(true);
  UI_SetLocalRect(RectL(static_cast<long>(placed.left), static_cast<long>(placed.top), inWidth, inHeight));
  mPage->UI_Show(true);
  ChildPushBack(mPage);
  // The size message of the rectangle above has laid the page out already;
  // a layer that sent none leaves it to this.
  if (mPage->UI_GetLocalRectF(false).width != static_cast<float>(inWidth))
    mPage->UI_SetLocalRectF(RectF(0, 0, static_cast<float>(inWidth), static_cast<float>(inHeight)));
  UI_Show(true);
  UI_Activate();
  UI_Invalidate(nullptr, 0);
}

int GalleryWindow::Run() {
  ui::OS_NativeLayer* layer = ui::GetNativeLayer();
  return IsOpen() && layer ? layer->RunLoop() : 0;
}

bool GalleryWindow::UI_DispatchEvent(ui::OS_Event* inEvent) {
  // Below this size the pages do not fit.
  if (inEvent->GetMsg() == ui::kOSMsgGetMinMaxInfo && inEvent->GetLParam() != 0)
    reinterpret_cast<ui::OS_MinMaxInfo*>(inEvent->GetLParam())->minTrackSize =
        ui::OS_Point(GalleryPage::kMinWidth, GalleryPage::kMinHeight);
  return OS_TopLevelViewContainer::UI_DispatchEvent(inEvent);
}

void GalleryWindow::UI_SizeChanged(const RectF& inLocalRect) {
  OS_TopLevelViewContainer::UI_SizeChanged(inLocalRect);
  if (mPage) mPage->UI_SetLocalRectF(RectF(0, 0, inLocalRect.width, inLocalRect.height));
  UI_Invalidate(nullptr, 0);
}

bool GalleryWindow::UI_Paint(ui::OS_Event* inEvent) {
  const bool painted = OS_TopLevelViewContainer::UI_Paint(inEvent);
  if (painted && mFirstFrame && UI_AreAllParentsVisible()) {
    const std::function<void()> firstFrame = std::move(mFirstFrame);
    mFirstFrame = nullptr;
    firstFrame();
  }
  return painted;
}

void GalleryWindow::UI_PostClose() {
  OS_TopLevelViewContainer::UI_PostClose();
  if (ui::OS_NativeLayer* layer = ui::GetNativeLayer()) layer->QuitLoop(0);
}

}  // namespace norvik::gallery
