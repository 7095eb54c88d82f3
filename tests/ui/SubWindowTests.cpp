// A native window floating in a view: placed over the view, shown with it,
// and handing its mouse and cursor events to the view.
#include <gtest/gtest.h>

#include <boost/make_shared.hpp>

#include "support/ui/NativeWindowTestSupport.h"
#include "ui/SubWindow.h"

namespace norvik::ui::test {
namespace {

using SubWindowTest = NativeWindowTest;

class ClickCountingSubWindowView : public UI_SubWindowView {
 public:
  bool UI_DoMouseEvent(UI_Node*, const MouseEvent& inEvent) override {
    positions.push_back(inEvent.GetPosition());
    return true;
  }
  bool UI_DoCursor(UI_Node*, const PointF& inPoint, ModKeys) override {
    cursorPoints.push_back(inPoint);
    return true;
  }
  std::vector<PointF> positions;
  std::vector<PointF> cursorPoints;
};

boost::intrusive_ptr<ClickCountingSubWindowView> AddSubWindowView(UI_Node* inParent, float inX, float inY) {
  boost::intrusive_ptr<ClickCountingSubWindowView> view(new ClickCountingSubWindowView);
  view->UI_SetLocalRectF(UI_Node::RectF(inX, inY, 100, 50));
  view->UI_Show(true);
  inParent->ChildPushBack(view);
  return view;
}

TEST_F(SubWindowTest, TheSubWindowIsANativeChildOverItsViewShownOnlyWithTheViewAndItsParents) {
  auto window = MakeTopLevel(OS_Rect(100, 100, 400, 300));
  auto parent = AddView(window.get(), "parent", 0, 0, 300, 200);
  auto view = AddSubWindowView(parent.get(), 30, 40);
  ASSERT_TRUE(view->GetSubWindow());
  const OS_WindowHandle handle = view->GetSubWindow()->GetHandle();
  ASSERT_NE(handle, 0u);
  EXPECT_EQ(mLayer.GetParent(handle), window->GetHandle());
  EXPECT_EQ(mLayer.GetWindowRect(handle), OS_Rect(130, 140, 100, 50));
  EXPECT_TRUE(mLayer.IsWindowVisible(handle));
  view->UI_SetLocalRectF(UI_Node::RectF(50, 40, 120, 60));
  EXPECT_EQ(mLayer.GetWindowRect(handle), OS_Rect(150, 140, 120, 60));
  parent->UI_Show(false);
  EXPECT_FALSE(mLayer.IsWindowVisible(handle));
  parent->UI_Show(true);
  EXPECT_TRUE(mLayer.IsWindowVisible(handle));
  view->UI_Show(false);
  EXPECT_FALSE(mLayer.IsWindowVisible(handle));
}

TEST_F(SubWindowTest, AClickOnTheNativeWindowReachesTheViewInItsCoordinates) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 400, 300));
  auto view = AddSubWindowView(window.get(), 30, 40);
  mSystem.Click(OS_Point(35, 47));
  mSystem.Pump();
  ASSERT_FALSE(view->positions.empty());
  EXPECT_FLOAT_EQ(view->positions[0].x, 5.0f);
  EXPECT_FLOAT_EQ(view->positions[0].y, 7.0f);
}

TEST_F(SubWindowTest, TheCursorOverTheNativeWindowIsTheViewsAndWithoutAProxyThereIsNone) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 400, 300));
  auto view = AddSubWindowView(window.get(), 30, 40);
  auto* sub = dynamic_cast<SubWindow*>(view->GetSubWindow().get());
  ASSERT_NE(sub, nullptr);
  EXPECT_TRUE(sub->UI_DoCursor(sub, UI_Node::PointF(2, 3), UI_Node::ModKeys()));
  ASSERT_EQ(view->cursorPoints.size(), 1u);
  EXPECT_FLOAT_EQ(view->cursorPoints[0].x, 2.0f);
  sub->SetProxy(nullptr);
  EXPECT_FALSE(sub->UI_DoCursor(sub, UI_Node::PointF(2, 3), UI_Node::ModKeys()));
  EXPECT_EQ(view->cursorPoints.size(), 1u);
}

TEST_F(SubWindowTest, AViewInATreeWhoseWindowGetsItsHandleLaterGetsItsNativeWindowThen) {
  boost::intrusive_ptr<OS_Window> window(new OS_Window);
  auto view = AddSubWindowView(window.get(), 30, 40);
  EXPECT_FALSE(view->GetSubWindow()) << "no handle to make a child of";
  window->UI_CreateWindow(u"late", 0, UI_Node::RectL(0, 0, 300, 200), kOSStylePopup | kOSStyleVisible, 0);
  ASSERT_TRUE(view->GetSubWindow());
  const OS_WindowHandle handle = view->GetSubWindow()->GetHandle();
  ASSERT_NE(handle, 0u);
  EXPECT_EQ(mLayer.GetParent(handle), window->GetHandle());
  EXPECT_EQ(mLayer.GetClientRect(handle), OS_Rect(0, 0, 100, 50));
}

}  // namespace
}  // namespace norvik::ui::test
