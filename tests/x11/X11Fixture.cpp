#include "x11/X11Fixture.h"

#include <cairo.h>

#include <cstdlib>

#include "support/ui/XvfbServer.h"
#include "ui/NativeLayerFactory.h"

namespace norvik::test {
namespace {
X11Fixture* gCurrent = nullptr;
}

void X11Fixture::SetUp() {
  XvfbServer* server = XvfbServer::Get();
  if (!server) GTEST_SKIP() << "Xvfb is not available";
  mLayer = ui::CreateX11NativeLayer(server->GetDisplayName().c_str());
  ASSERT_TRUE(mLayer) << "cannot open " << server->GetDisplayName();
  gCurrent = this;
  mLayer->SetWindowProcedure(&Procedure);
  mXTest = std::make_unique<XTestUser>(server->GetDisplayName());
  ASSERT_TRUE(mXTest->IsConnected());
  mUser = mXTest->GetConnection();
}

void X11Fixture::TearDown() {
  // Windows are destroyed with the layer; their last messages go nowhere.
  gCurrent = nullptr;
  mLayer.reset();
  mXTest.reset();
  mUser = nullptr;
}

std::intptr_t X11Fixture::Procedure(ui::OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                    std::intptr_t inLParam) {
  X11Fixture* self = gCurrent;
  if (!self) return 0;
  RecordedMessage record{inWindow, inMessage, inWParam, inLParam};
  self->mMessages.push_back(record);
  if (self->mHandler && self->mHandler(record)) return 0;
  if (inMessage == ui::kOSMsgPaint) {
    ui::OS_PaintContext context = self->mLayer->BeginPaint(inWindow);
    if (context.target) {
      cairo_t* cr = cairo_create(static_cast<cairo_surface_t*>(context.target));
      const std::uint32_t color = self->mColors[inWindow];
      cairo_set_source_rgb(cr, ((color >> 16) & 0xFF) / 255.0, ((color >> 8) & 0xFF) / 255.0, (color & 0xFF) / 255.0);
      cairo_paint(cr);
      cairo_destroy(cr);
    }
    self->mLayer->EndPaint(inWindow, context);
    return 0;
  }
  return self->mLayer->DefaultWindowProcedure(inWindow, inMessage, inWParam, inLParam);
}

ui::OS_WindowHandle X11Fixture::MakeShownWindow(const ui::OS_Rect& inRect, std::uint32_t inColor, std::uint32_t inStyle,
                                                std::uint32_t inExStyle, ui::OS_WindowHandle inOwner) {
  ui::OS_WindowCreateParams params;
  params.title = u"norvik test";
  params.rect = inRect;
  params.style = inStyle;
  params.exStyle = inExStyle;
  params.parent = inOwner;
  const ui::OS_WindowHandle window = mLayer->CreateWindow(params);
  mColors[window] = inColor;
  const std::size_t before = MessagesOf(ui::kOSMsgPaint).size();
  mLayer->ShowWindow(window, (inExStyle & ui::kOSExStyleNoActivate) ? ui::kOSShowNA : ui::kOSShow);
  WaitFor([&] { return MessagesOf(ui::kOSMsgPaint).size() > before; });
  Settle(50);
  return window;
}

bool X11Fixture::WaitFor(const std::function<bool()>& inCondition, int inMilliseconds) {
  return PumpUntil(*mLayer, inCondition, inMilliseconds);
}

void X11Fixture::Settle(int inMilliseconds) {
  WaitFor([] { return false; }, inMilliseconds);
}

std::vector<RecordedMessage> X11Fixture::MessagesOf(unsigned inMessage) const {
  std::vector<RecordedMessage> result;
  for (const RecordedMessage& m : mMessages)
    if (m.message == inMessage) result.push_back(m);
  return result;
}

void X11Fixture::MovePointer(int inX, int inY) { mXTest->MovePointer(inX, inY); }

void X11Fixture::Button(int inButton, bool inPress) { mXTest->Button(inButton, inPress); }

void X11Fixture::Key(std::uint32_t inKeysym, bool inPress) {
  ASSERT_TRUE(mXTest->Key(inKeysym, inPress)) << "no key types keysym " << inKeysym;
}

std::uint32_t X11Fixture::ReadPixel(ui::OS_WindowHandle inWindow, int inX, int inY) {
  return ReadServerPixel(mUser, static_cast<xcb_drawable_t>(inWindow), inX, inY);
}

}  // namespace norvik::test
