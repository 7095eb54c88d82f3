// Mouse messages of native windows reaching nodes: button presses on the
// node under the pointer, click counting past two, the wheel going to the
// window under the pointer, and the raw wheel deltas.
#include <gmock/gmock.h>

#include "support/ui/NativeWindowTestSupport.h"
#include "ui/OS_Window.h"

namespace norvik::ui::test {
namespace {

using NativeWindowMouseTest = NativeWindowTest;

std::vector<int> DownClickCounts(const InputRecorderView& inView) {
  std::vector<int> counts;
  for (const MouseEvent& e : inView.mouse)
    if (e.GetAction() == MouseEvent::kActionButtonDown) counts.push_back(e.GetClickCount());
  return counts;
}

TEST_F(NativeWindowMouseTest, ClicksReachTheNodeUnderThePointerWithTheirButtonCountingPastTwoUntilTheTimeIsUp) {
  auto window = MakeTopLevel(OS_Rect(100, 100, 300, 200));
  auto left = AddView(window.get(), "left", 0, 0, 100, 100);
  auto right = AddView(window.get(), "right", 150, 50, 100, 100);
  for (int i = 0; i < 4; ++i) {
    mSystem.Click(OS_Point(100 + 160, 100 + 65), kHeadlessButtonLeft);
    mSystem.AdvanceClock(50);
  }
  mSystem.AdvanceClock(mLayer.GetDoubleClickTime() + 100);
  mSystem.Click(OS_Point(100 + 160, 100 + 65));
  mSystem.AdvanceClock(2000);
  mSystem.Click(OS_Point(100 + 160, 100 + 65), kHeadlessButtonRight);
  mSystem.AdvanceClock(2000);
  mSystem.Click(OS_Point(100 + 160, 100 + 65), kHeadlessButtonMiddle);
  mSystem.Pump();

  EXPECT_TRUE(left->mouse.empty());
  EXPECT_THAT(DownClickCounts(*right), ::testing::ElementsAre(1, 2, 3, 4, 1, 1, 1));
  const auto downs = right->Actions(MouseEvent::kActionButtonDown);
  const auto ups = right->Actions(MouseEvent::kActionButtonUp);
  ASSERT_EQ(downs.size(), 7u);
  ASSERT_EQ(ups.size(), 7u);
  EXPECT_EQ(downs[0].GetButton(), MouseEvent::kButtonLeft);
  EXPECT_FLOAT_EQ(downs[0].GetPosition().x, 10.0f);
  EXPECT_FLOAT_EQ(downs[0].GetPosition().y, 15.0f);
  EXPECT_EQ(ups[0].GetButton(), MouseEvent::kButtonLeft);
  EXPECT_EQ(downs[5].GetButton(), MouseEvent::kButtonRight);
  EXPECT_EQ(downs[6].GetButton(), MouseEvent::kButtonMiddle);
}

TEST_F(NativeWindowMouseTest, AMoveNearATripleClickKeepsItsCountAndOneFarAwayGetsTheGivenCount) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  using F = UI_Node::PointF;
  EXPECT_EQ(window->UI_GetClickCount(1, MouseEvent::kActionButtonDown, 1, F(50, 50)), 1);
  EXPECT_EQ(window->UI_GetClickCount(1, MouseEvent::kActionButtonUp, 1, F(50, 50)), 1);
  EXPECT_EQ(window->UI_GetClickCount(2, MouseEvent::kActionButtonDown, 1, F(50, 50)), 2);
  EXPECT_EQ(window->UI_GetClickCount(1, MouseEvent::kActionButtonUp, 1, F(50, 50)), 2);
  EXPECT_EQ(window->UI_GetClickCount(1, MouseEvent::kActionButtonDown, 1, F(50, 50)), 3);
  const OS_Point size = mLayer.GetDoubleClickSize();
  EXPECT_EQ(window->UI_GetClickCount(0, MouseEvent::kActionMove, 1, F(50.0f + size.x / 2, 50)), 3);
  EXPECT_EQ(window->UI_GetClickCount(0, MouseEvent::kActionMove, 1, F(50.0f + size.x / 2 + 5, 50)), 0);
  // The far move left the stored click alone: a near move still counts 3.
  EXPECT_EQ(window->UI_GetClickCount(0, MouseEvent::kActionMove, 1, F(50, 51)), 3);
}

TEST_F(NativeWindowMouseTest, TheWheelOverAnotherEnabledWindowOfOursGoesThere) {
  auto focused = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  auto focusedView = AddView(focused.get(), "focused", 0, 0, 200, 200);
  auto other = MakeTopLevel(OS_Rect(300, 0, 200, 200));
  auto otherView = AddView(other.get(), "other", 0, 0, 200, 200);
  focused->UI_Activate();
  mLayer.SetFocus(focused->GetHandle());
  mSystem.MovePointer(OS_Point(350, 40));
  mSystem.TurnWheel(240);
  mSystem.Pump();

  EXPECT_TRUE(focusedView->Actions(MouseEvent::kActionWheel).empty());
  const auto wheels = otherView->Actions(MouseEvent::kActionWheel);
  ASSERT_EQ(wheels.size(), 1u);
  EXPECT_EQ(wheels[0].GetMouseWheelDelta(), 2);
  EXPECT_EQ(wheels[0].GetMouseWheelAxis(), MouseEvent::kWheelAxisVertical);
  EXPECT_FLOAT_EQ(wheels[0].GetPosition().x, 50.0f);
  EXPECT_FLOAT_EQ(wheels[0].GetPosition().y, 40.0f);
}

TEST_F(NativeWindowMouseTest, TheWheelOverADisabledWindowDoesNotGoThere) {
  auto focused = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  auto other = MakeTopLevel(OS_Rect(300, 0, 200, 200));
  auto otherView = AddView(other.get(), "other", 0, 0, 200, 200);
  other->UI_SetEnabled(false);
  focused->UI_Activate();
  mLayer.SetFocus(focused->GetHandle());
  mSystem.MovePointer(OS_Point(350, 40));
  mSystem.TurnWheel(120);
  mSystem.Pump();
  EXPECT_TRUE(otherView->Actions(MouseEvent::kActionWheel).empty());
}

class WheelDeltaTest : public NativeWindowTest, public ::testing::WithParamInterface<std::pair<int, int>> {};

TEST_P(WheelDeltaTest, RawDeltasBecomeNotchesAndAFractionStillMovesByOne) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  auto view = AddView(window.get(), "view", 0, 0, 200, 200);
  mLayer.SetFocus(window->GetHandle());
  mSystem.MovePointer(OS_Point(20, 20));
  mSystem.TurnWheel(GetParam().first);
  mSystem.Pump();
  const auto wheels = view->Actions(MouseEvent::kActionWheel);
  ASSERT_EQ(wheels.size(), 1u);
  EXPECT_EQ(wheels[0].GetMouseWheelDelta(), GetParam().second);
}

INSTANTIATE_TEST_SUITE_P(RawDeltas, WheelDeltaTest,
                         ::testing::Values(std::make_pair(1, -1), std::make_pair(60, 1), std::make_pair(-60, -1),
                                           std::make_pair(120, 1), std::make_pair(-360, -3),
                                           std::make_pair(250, 2)));

TEST_F(NativeWindowMouseTest, TheHorizontalWheelIsNegatedOnTheHorizontalAxis) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  auto view = AddView(window.get(), "view", 0, 0, 200, 200);
  mLayer.SetFocus(window->GetHandle());
  mSystem.MovePointer(OS_Point(20, 20));
  mSystem.TurnHorizontalWheel(120);
  mSystem.Pump();
  const auto wheels = view->Actions(MouseEvent::kActionWheel);
  ASSERT_EQ(wheels.size(), 1u);
  EXPECT_EQ(wheels[0].GetMouseWheelDelta(), -1);
  EXPECT_EQ(wheels[0].GetMouseWheelAxis(), MouseEvent::kWheelAxisHorizontal);
}

TEST_F(NativeWindowMouseTest, MovingThePointerMakesTheViewUnderItTheMouseOverLeaf) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  auto a = AddView(window.get(), "a", 0, 0, 100, 200);
  auto b = AddView(window.get(), "b", 100, 0, 100, 200);
  mSystem.MovePointer(OS_Point(30, 30));
  mSystem.Pump();
  EXPECT_TRUE(a->UI_IsMouseOver(true));
  mSystem.MovePointer(OS_Point(130, 30));
  mSystem.Pump();
  EXPECT_FALSE(a->UI_IsMouseOver(false));
  EXPECT_TRUE(b->UI_IsMouseOver(true));
}

TEST_F(NativeWindowMouseTest, AViewThatDeletesItsWindowOnAClickDoesNotCrash) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  auto view = AddView(window.get(), "view", 0, 0, 200, 200);
  bool fired = false;
  view->onMouse = [&](const MouseEvent&) {
    if (fired) return;
    fired = true;
    window.reset();
  };
  OS_TopLevelViewContainer* raw = window.get();
  const OS_WindowHandle handle = raw->GetHandle();
  mSystem.Click(OS_Point(20, 20));
  mSystem.Pump();
  EXPECT_TRUE(fired);
  EXPECT_FALSE(mLayer.IsWindow(handle));
  EXPECT_EQ(OS_Window::UI_GetWindow(handle), nullptr);
}

}  // namespace
}  // namespace norvik::ui::test
