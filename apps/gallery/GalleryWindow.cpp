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
std::map<ui::OS_WindowHandle, GalleryWindow*>& OpenGalleryWindows() {
  static std::map<ui::OS_WindowHandle, GalleryWindow*> sWindows;
  return sWindows;
}

constexpr int kVirtualKeyShift = 0x10;
constexpr int kVirtualKeyControl = 0x11;
constexpr int kVirtualKeyAlt = 0x12;

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
  for (auto it = OpenGalleryWindows().begin(); it != OpenGalleryWindows().end();)
    it = it->second == this ? OpenGalleryWindows().erase(it) : std::next(it);
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
    OpenGalleryWindows()[inWindow] = self;
  }
  auto it = OpenGalleryWindows().find(inWindow);
  if (it == OpenGalleryWindows().end()) {
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
    case ui::kOSMsgLeftButtonDoubleClick:
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
      OpenGalleryWindows().erase(handle);
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
  // A double click is a second press: views that count clicks see 2.
  const bool up = inMessage == ui::kOSMsgLeftButtonUp;
  const int clicks = inMessage == ui::kOSMsgLeftButtonDoubleClick ? 2 : 1;
  mPage->UI_DispatchMouseEvent(ui::MouseEvent(up ? ui::MouseEvent::kActionButtonUp : ui::MouseEvent::kActionButtonDown,
                                              ui::MouseEvent::kButtonLeft, clicks, point, {}, osEvent),
                               false);
}

ui::ModifierKeys GalleryWindow::CurrentModifiers() const {
  ui::ModifierKeys mods;
  auto held = [this](int inKey) { return (mLayer.GetKeyState(inKey) & 0x8000) != 0; };
  if (held(kVirtualKeyShift)) mods.Set(ui::kModKeyShift);
  if (held(kVirtualKeyControl)) mods.Set(ui::kModKeyCtrl);
  if (held(kVirtualKeyAlt)) mods.Set(ui::kModKeyAlt);
  return mods;
}

void GalleryWindow::KeyMessage(unsigned inMessage, std::uintptr_t inWParam, std::intptr_t inLParam) {
  ui::UI_NodeP keep(mPage);
  // The key's code is the virtual key, negated for keys of the extended
  // block (bit 24 of the second parameter).
  const bool extended = (static_cast<std::uintptr_t>(inLParam) >> 24) & 1;
  const short code = static_cast<short>(extended ? -static_cast<int>(inWParam) : static_cast<int>(inWParam));
  const bool repeat = inMessage == ui::kOSMsgKeyDown && ((static_cast<std::uintptr_t>(inLParam) >> 30) & 1);
  const ui::KeyboardEvent event(
      inMessage == ui::kOSMsgKeyDown ? ui::KeyboardEvent::kActionKeyDown : ui::KeyboardEvent::kActionKeyUp, 0, code,
      CurrentModifiers(), repeat, ui::OS_Event(mHandle, inMessage, inWParam, inLParam));
  ui::UI_Node* focus = ui::UI_Node::UI_GetKeyboardFocusLeafNode();
  if (focus && (focus == mPage.get() || focus->UI_IsChildOf(*mPage)) &&
      ui::UI_Node::UI_DispatchKeyboardEvent(focus, event))
    return;
  // Nothing took the key: Tab and Shift+Tab move the focus through the page.
  ui::UI_Node::UI_DoAdvanceKeyboardFocus(mPage.get(), focus ? focus : mPage.get(), event);
}

}  // namespace norvik::gallery
