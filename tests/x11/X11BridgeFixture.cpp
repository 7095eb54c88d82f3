#include "x11/X11BridgeFixture.h"

#include <cstdlib>

#include "support/ui/XvfbServer.h"
#include "ui/NativeLayerFactory.h"

namespace norvik::test {

using namespace norvik::ui;

void X11BridgeTest::SetUp() {
  XvfbServer* server = XvfbServer::Get();
  if (!server) GTEST_SKIP() << "Xvfb is not available";
  mLayer = CreateX11NativeLayer(server->GetDisplayName().c_str());
  ASSERT_TRUE(mLayer) << "cannot open " << server->GetDisplayName();
  InstallNativeLayer(mLayer.get());
  mUser = std::make_unique<XTestUser>(server->GetDisplayName());
  ASSERT_TRUE(mUser->IsConnected());
  // Every test starts with the pointer away from the windows it makes.
  mUser->MovePointer(1000, 740);
  Settle(20);
}

void X11BridgeTest::TearDown() {
  mUser.reset();
  if (mLayer) {
    InstallNativeLayer(nullptr);
    mLayer.reset();
  }
}

OS_TopLevelViewContainerP X11BridgeTest::MakeMainWindow(const OS_Rect& inScreenRect) {
  OS_TopLevelViewContainerP window(new OS_TopLevelViewContainer(false));
  const OS_WindowHandle handle = window->GetHandle();
  mLayer->SetExStyle(handle, mLayer->GetExStyle(handle) & ~kOSExStyleNoActivate);
  window->UI_SetLocalRect(UI_Node::RectL(inScreenRect.left, inScreenRect.top, inScreenRect.width, inScreenRect.height));
  window->UI_Show(true);
  window->UI_Activate();
  // Mapped and exposed: the first paint has come back from the server.
  EXPECT_TRUE(WaitFor([&] { return mLayer->IsWindowVisible(handle) && mLayer->GetActiveWindow() == handle; }))
      << "the main window did not become active";
  Settle(30);
  return window;
}

OS_Point X11BridgeTest::ScreenPoint(const UI_Node* inNode, long inX, long inY) const {
  const UI_Node::PointL global = inNode->UI_LocalToGlobal(UI_Node::PointL(inX, inY));
  return OS_Point(global.x, global.y);
}

bool X11BridgeTest::WaitFor(const std::function<bool()>& inCondition, int inMilliseconds) {
  return PumpUntil(*mLayer, inCondition, inMilliseconds);
}

void X11BridgeTest::Settle(int inMilliseconds) {
  WaitFor([] { return false; }, inMilliseconds);
}

std::uint32_t X11BridgeTest::ScreenPixel(int inX, int inY) {
  return ReadServerPixel(mUser->GetConnection(), mUser->GetRoot(), inX, inY);
}

}  // namespace norvik::test
