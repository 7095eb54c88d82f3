#include "GalleryWindow.h"

#include <map>

#include "drawbot/DrawbotWrappers.h"
#include "ui/KeyboardEvent.h"
#include "ui/MouseEvent.h"
#include "ui/OS_Event.h"
#include "ui/OS_WindowConstants.h"

namespace norvik::gallery {

namespace {

// The gallery's windows by handle. A window procedure is shared by all the
// windows of a layer, so it finds its object here.
std::map<ui::OS_WindowHandle, GalleryWindow*>& Windows() {
  static std::map<ui::OS_WindowHandle, GalleryWindow*> sWindows;
  return sWindows;
}

constexpr int kVirtualKeyTab = 0x09;

}  // namespace

GalleryWindow::GalleryWindow(ui::OS_NativeLayer& inLayer, GalleryPageP inPage, long inWidth, long inHeight)
    : mLayer(inLayer), mPage(std::move(inPage)) {
  mLayer.SetWindowProcedure(&GalleryWindow::Procedure);
  ui::OS_WindowCreateParams params;
  params.title = Text("$$$/norvik/gallery/Title=norvik gallery");
  params.rect = ui::OS_Rect(60, 60, inWidth, inHeight);
  params.style = ui::kOSStyleOverlappedWindow | ui::kOSStyleClipChildren;
  params.createParam = this;
  mHandle = mLayer.CreateWindow(params);
  mPage->UI_SetLocalRectF(RectF(0, 0, static_cast<float>(inWidth), static_cast<float>(inHeight)));
  mPage->UI_Show(true);
  mPage->SetInvalidateFunction([this](const ui::UI_Node::RectL* inRect) {
    if (!mHandle) return;
    if (inRect) {
      const ui::OS_Rect r(inRect->left, inRect->top, inRect->width, inRect->height);
      mLayer.InvalidateRect(mHandle, &r);
    } else {
      mLayer.InvalidateRect(mHandle, nullptr);
    }
  });
  mLayer.ShowWindow(mHandle, ui::kOSShowNormal);
  mLayer.SetActiveWindow(mHandle);
  mLayer.SetFocus(mHandle);
  mLayer.InvalidateRect(mHandle, nullptr);
}

GalleryWindow::~GalleryWindow() {
  mPage->SetInvalidateFunction(nullptr);
  if (mHandle) mLayer.DestroyWindow(mHandle);
  // A window destroyed by the platform before this point has already left
  // the table in its destroy message.
  for (auto it = Windows().begin(); it != Windows().end();)
    it = it->second == this ? Windows().erase(it) : std::next(it);
}

void GalleryWindow::Update() {
  if (mHandle) mLayer.UpdateWindow(mHandle);
}

int GalleryWindow::Run() { return mHandle ? mLayer.RunLoop() : 0; }

std::intptr_t GalleryWindow::Procedure(ui::OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                       std::intptr_t inLParam) {
  if (inMessage == ui::kOSMsgNCCreate && inLParam != 0) {
    auto* self = reinterpret_cast<GalleryWindow*>(inLParam);
    self->mHandle = inWindow;
    Windows()[inWindow] = self;
  }
  auto it = Windows().find(inWindow);
  if (it == Windows().end()) {
    ui::OS_NativeLayer* layer = ui::GetNativeLayer();
    return layer ? layer->DefaultWindowProcedure(inWindow, inMessage, inWParam, inLParam) : 0;
  }
  return it->second->Handle(inMessage, inWParam, inLParam);
}

std::intptr_t GalleryWindow::Handle(unsigned inMessage, std::uintptr_t inWParam, std::intptr_t inLParam) {
  const ui::OS_WindowHandle handle = mHandle;
  switch (inMessage) {
    case ui::kOSMsgPaint:
      Paint();
      return 0;
    case ui::kOSMsgEraseBackground:
      return 1;  // the paint covers every pixel
    case ui::kOSMsgSize: {
      const ui::OS_Rect client = mLayer.GetClientRect(handle);
      mPage->UI_SetLocalRectF(RectF(0, 0, static_cast<float>(client.width), static_cast<float>(client.height)));
      mLayer.InvalidateRect(handle, nullptr);
      return 0;
    }
    case ui::kOSMsgMouseMove:
    case ui::kOSMsgLeftButtonDown:
    case ui::kOSMsgLeftButtonUp:
    case ui::kOSMsgMouseLeave:
      MouseMessage(inMessage, inWParam, inLParam);
      return 0;
    case ui::kOSMsgKeyDown:
    case ui::kOSMsgKeyUp:
      KeyMessage(inMessage, inWParam, inLParam);
      return 0;
    case ui::kOSMsgClose:
      mLayer.DestroyWindow(handle);
      return 0;
    case ui::kOSMsgDestroy:
      mLayer.QuitLoop(0);
      return 0;
    case ui::kOSMsgNCDestroy:
      Windows().erase(handle);
      mHandle = 0;
      return 0;
    default:
      return mLayer.DefaultWindowProcedure(handle, inMessage, inWParam, inLParam);
  }
}

void GalleryWindow::Paint() {
  ui::OS_PaintContext context = mLayer.BeginPaint(mHandle);
  const drawbot::SupplierInterface* supplier = mLayer.GetDrawSupplier();
  if (context.target && supplier) {
    std::unique_ptr<drawbot::OSSurfaceP> surface =
        drawbot::OSSurfaceP::New(supplier, context.target, context.updateRegion);
    if (surface && *surface) {
      drawbot::Drawbot bot(supplier, surface->Get());
      mPage->Paint(&bot);
      (*surface)->Flush();
    }
  }
  mLayer.EndPaint(mHandle, context);
}

void GalleryWindow::MouseMessage(unsigned inMessage, std::uintptr_t, std::intptr_t inLParam) {
  ui::UI_NodeP keep(mPage);  // a handler may drop the page's last other reference
  const ui::OS_Event osEvent(mHandle, inMessage, 0, inLParam);
  if (inMessage == ui::kOSMsgMouseLeave) {
    mTrackingLeave = false;
    // A point no node contains leaves every node the mouse was over.
    mPage->UI_UpdateMouseOverState(
        ui::MouseEvent(ui::MouseEvent::kActionMouseOver, 0, 0, PointF(-1e6f, -1e6f), {}, osEvent));
    return;
  }
  const PointF point(static_cast<float>(ui::PointParamX(inLParam)), static_cast<float>(ui::PointParamY(inLParam)));
  if (inMessage == ui::kOSMsgMouseMove) {
    if (!mTrackingLeave) {
      mLayer.TrackMouseLeave(mHandle);
      mTrackingLeave = true;
    }
    mPage->UI_UpdateMouseOverState(ui::MouseEvent(ui::MouseEvent::kActionMouseOver, 0, 0, point, {}, osEvent));
    mPage->UI_DispatchMouseEvent(ui::MouseEvent(ui::MouseEvent::kActionMove, 0, 0, point, {}, osEvent), false);
    return;
  }
  const auto action =
      inMessage == ui::kOSMsgLeftButtonDown ? ui::MouseEvent::kActionButtonDown : ui::MouseEvent::kActionButtonUp;
  mPage->UI_DispatchMouseEvent(ui::MouseEvent(action, ui::MouseEvent::kButtonLeft, 1, point, {}, osEvent), false);
}

void GalleryWindow::KeyMessage(unsigned inMessage, std::uintptr_t inWParam, std::intptr_t inLParam) {
  ui::UI_NodeP keep(mPage);
  const ui::KeyboardEvent event(ui::OS_Event(mHandle, inMessage, inWParam, inLParam));
  ui::UI_Node* focus = ui::UI_Node::UI_GetKeyboardFocusLeafNode();
  if (focus && (focus == mPage.get() || focus->UI_IsChildOf(*mPage)) &&
      ui::UI_Node::UI_DispatchKeyboardEvent(focus, event))
    return;
  if (inMessage == ui::kOSMsgKeyDown && static_cast<int>(inWParam) == kVirtualKeyTab)
    ui::UI_Node::UI_DoAdvanceKeyboardFocus(mPage.get(), focus ? focus : mPage.get(), event);
}

}  // namespace norvik::gallery
