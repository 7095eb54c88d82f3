// View containers: a top-level container painting its tree into the native
// window, the rectangle applied again when a container gets a native parent,
// popup-born windows turning into children, and popup backgrounds.
#include <gmock/gmock.h>

#include "support/ui/NativeWindowTestSupport.h"
#include "ui/OS_PopupWindow.h"
#include "ui/Theme.h"

namespace norvik::ui::test {
namespace {

using ViewContainerTest = NativeWindowTest;

std::uint32_t Opaque(float inRed, float inGreen, float inBlue) {
  auto channel = [](float v) { return static_cast<std::uint32_t>(v * 255.0f + 0.5f); };
  return 0xFF000000u | (channel(inRed) << 16) | (channel(inGreen) << 8) | channel(inBlue);
}

TEST_F(ViewContainerTest, InvalidatingAViewRepaintsItWithItsNewColour) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 60, 60));
  auto view = AddView(window.get(), "view", 0, 0, 60, 60);
  view->paints = true;
  view->green = 1.0f;
  window->UI_Invalidate(nullptr, 0);
  mSystem.Pump();
  EXPECT_EQ(mSystem.ReadWindowPixels(window->GetHandle()).At(30, 30), Opaque(0, 1, 0));
  view->green = 0.0f;
  view->red = 1.0f;
  view->UI_Invalidate(nullptr, 0);
  window->UI_Invalidate(nullptr, 0);
  mSystem.Pump();
  EXPECT_EQ(mSystem.ReadWindowPixels(window->GetHandle()).At(30, 30), Opaque(1, 0, 0));

  view->red = 0.0f;
  view->blue = 1.0f;
  view->UI_Invalidate(nullptr, 0);
  view->UI_UpdateNow(0);
  EXPECT_EQ(mSystem.ReadWindowPixels(window->GetHandle()).At(30, 30), Opaque(1, 0, 0)) << "no flag: the loop paints";
  view->UI_UpdateNow(UI_Node::kUpdateNowImmediate);
  EXPECT_EQ(mSystem.ReadWindowPixels(window->GetHandle()).At(30, 30), Opaque(0, 0, 1));
}

TEST_F(ViewContainerTest, ARectangleSetBeforeTheContainerHadAParentIsAppliedAgainAfterItArrives) {
  auto top = MakeTopLevel(OS_Rect(100, 100, 400, 300));
  OS_ViewContainerP container(new OS_ViewContainer(false));
  container->UI_SetLocalRectF(UI_Node::RectF(10.5f, 20.0f, 50.0f, 40.0f));
  top->ChildPushBack(container);
  const OS_WindowHandle handle = container->GetHandle();
  EXPECT_EQ(mLayer.GetParent(handle), top->GetHandle());
  EXPECT_NE(mLayer.GetStyle(handle) & kOSStyleChild, 0u);
  EXPECT_EQ(mLayer.GetStyle(handle) & kOSStylePopup, 0u);
  // The enclosing integer rectangle, now in the parent's client coordinates.
  EXPECT_EQ(mLayer.GetWindowRect(handle), OS_Rect(110, 120, 51, 40));
}

TEST_F(ViewContainerTest, AViewInANestedContainerReceivesClicksInItsOwnCoordinates) {
  auto top = MakeTopLevel(OS_Rect(0, 0, 300, 300));
  OS_ViewContainerP container(new OS_ViewContainer(false));
  container->UI_SetLocalRect(UI_Node::RectL(100, 100, 100, 100));
  top->ChildPushBack(container);
  container->UI_Show(true);
  auto view = AddView(container.get(), "inner", 10, 10, 50, 50);
  mSystem.Click(OS_Point(120, 130));
  mSystem.Pump();
  ASSERT_FALSE(view->mouse.empty());
  EXPECT_FLOAT_EQ(view->mouse[0].GetPosition().x, 10.0f);
  EXPECT_FLOAT_EQ(view->mouse[0].GetPosition().y, 20.0f);
}

TEST_F(ViewContainerTest, PopupContainersPaintTheirOwnThemesPanelAndTheWindowFormAVisibleFrame) {
  const drawbot::ColorRGBA panel{0.2f, 0.6f, 0.4f, 1.0f};
  boost::intrusive_ptr<OS_PopupViewContainer> plain(new OS_PopupViewContainer(false, true));
  boost::intrusive_ptr<OS_PopupViewContainer> framed(new PopupWindowViewContainer);
  for (auto& popup : {plain, framed}) {
    popup->SetCustomThemeColor(277, panel);
    popup->UI_SetLocalRect(UI_Node::RectL(0, 0, 40, 40));
    popup->UI_Show(true);
    popup->UI_Invalidate(nullptr, 0);
  }
  mSystem.Pump();
  const HeadlessPixels plainPixels = mSystem.ReadWindowPixels(plain->GetHandle());
  const HeadlessPixels framedPixels = mSystem.ReadWindowPixels(framed->GetHandle());
  EXPECT_EQ(plainPixels.At(20, 20), Opaque(panel.red, panel.green, panel.blue));
  EXPECT_EQ(framedPixels.At(20, 20), plainPixels.At(20, 20));
  EXPECT_EQ(plainPixels.At(1, 20), plainPixels.At(20, 20));
  EXPECT_NE(framedPixels.At(1, 20), framedPixels.At(20, 20)) << "the frame one pixel in stands out";
}

TEST_F(ViewContainerTest, APopupWindowIsTopmostAndNeverActivates) {
  OS_PopupWindow popup(nullptr);
  const OS_WindowHandle handle = popup.GetHandle();
  ASSERT_NE(handle, 0u);
  EXPECT_NE(mLayer.GetExStyle(handle) & kOSExStyleTopmost, 0u);
  EXPECT_NE(mLayer.GetExStyle(handle) & kOSExStyleNoActivate, 0u);
  EXPECT_EQ(popup.UI_GetNodeID(), "OS_PopupWindow");
}

}  // namespace
}  // namespace norvik::ui::test
