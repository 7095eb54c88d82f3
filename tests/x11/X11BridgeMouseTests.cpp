// Real pointer input through the X server reaching nodes in a window: the
// node under a click with its local position, button and click count, and
// the wheel.
#include <gmock/gmock.h>

#include "x11/X11BridgeFixture.h"

namespace norvik::test {
namespace {

using namespace norvik::ui;
using ::testing::ElementsAre;
using X11BridgeMouse = X11BridgeTest;

std::vector<int> DownCounts(const ui::test::InputRecorderView& inView, int inButton) {
  std::vector<int> counts;
  for (const MouseEvent& e : inView.Actions(MouseEvent::kActionButtonDown))
    if (e.GetButton() == inButton) counts.push_back(e.GetClickCount());
  return counts;
}

TEST_F(X11BridgeMouse, AClickReachesTheNodeUnderItAtItsLocalPosition) {
  auto window = MakeMainWindow(OS_Rect(100, 100, 300, 200));
  auto left = AddRecorder(window.get(), "left", 0, 0, 100, 100);
  auto right = AddRecorder(window.get(), "right", 150, 50, 100, 100);
  auto inner = AddRecorder(right.get(), "inner", 40, 40, 50, 50);
  mUser->Click(100 + 160, 100 + 65);
  ASSERT_TRUE(WaitFor([&] { return !right->Actions(MouseEvent::kActionButtonUp).empty(); }));

  EXPECT_TRUE(left->Actions(MouseEvent::kActionButtonDown).empty());
  EXPECT_TRUE(inner->Actions(MouseEvent::kActionButtonDown).empty());
  const auto downs = right->Actions(MouseEvent::kActionButtonDown);
  ASSERT_EQ(downs.size(), 1u);
  EXPECT_EQ(downs[0].GetButton(), MouseEvent::kButtonLeft);
  EXPECT_EQ(downs[0].GetClickCount(), 1);
  EXPECT_FLOAT_EQ(downs[0].GetPosition().x, 10.0f);
  EXPECT_FLOAT_EQ(downs[0].GetPosition().y, 15.0f);
  EXPECT_EQ(right->Actions(MouseEvent::kActionButtonUp)[0].GetButton(), MouseEvent::kButtonLeft);

  // The same screen arithmetic one level deeper: the nested view gets its own coordinates.
  const OS_Point deep = ScreenPoint(inner.get(), 7, 9);
  mUser->Click(static_cast<int>(deep.x), static_cast<int>(deep.y));
  ASSERT_TRUE(WaitFor([&] { return !inner->Actions(MouseEvent::kActionButtonUp).empty(); }));
  EXPECT_FLOAT_EQ(inner->Actions(MouseEvent::kActionButtonDown)[0].GetPosition().x, 7.0f);
  EXPECT_FLOAT_EQ(inner->Actions(MouseEvent::kActionButtonDown)[0].GetPosition().y, 9.0f);
}

TEST_F(X11BridgeMouse, TheRightButtonArrivesAsTheRightButtonAndCountsItsOwnClicks) {
  auto window = MakeMainWindow(OS_Rect(50, 50, 200, 200));
  auto view = AddRecorder(window.get(), "view", 20, 20, 100, 100);
  mUser->Click(100, 110, 3);
  mUser->Click(100, 110, 3);
  ASSERT_TRUE(WaitFor([&] { return view->Actions(MouseEvent::kActionButtonUp).size() == 2; }));
  EXPECT_THAT(DownCounts(*view, MouseEvent::kButtonRight), ElementsAre(1, 2));
  EXPECT_TRUE(DownCounts(*view, MouseEvent::kButtonLeft).empty());
  const MouseEvent down = view->Actions(MouseEvent::kActionButtonDown)[0];
  EXPECT_FLOAT_EQ(down.GetPosition().x, 30.0f);
  EXPECT_FLOAT_EQ(down.GetPosition().y, 40.0f);
  EXPECT_EQ(view->Actions(MouseEvent::kActionButtonUp)[0].GetButton(), MouseEvent::kButtonRight);
}

TEST_F(X11BridgeMouse, ALeftClickAfterARightClickStartsItsOwnCount) {
  auto window = MakeMainWindow(OS_Rect(50, 50, 200, 200));
  auto view = AddRecorder(window.get(), "view", 0, 0, 200, 200);
  mUser->Click(100, 100, 3);
  mUser->Click(100, 100, 1);
  ASSERT_TRUE(WaitFor([&] { return view->Actions(MouseEvent::kActionButtonUp).size() == 2; }));
  EXPECT_THAT(DownCounts(*view, MouseEvent::kButtonLeft), ElementsAre(1));
}

TEST_F(X11BridgeMouse, WheelButtonsTurnTheWheelOnTheNodeUnderThePointer) {
  auto window = MakeMainWindow(OS_Rect(50, 50, 200, 200));
  auto view = AddRecorder(window.get(), "view", 10, 10, 150, 150);
  mUser->MovePointer(90, 80);
  for (int button : {4, 5, 6, 7}) {
    mUser->Button(button, true);
    mUser->Button(button, false);
  }
  ASSERT_TRUE(WaitFor([&] { return view->Actions(MouseEvent::kActionWheel).size() == 4; }));
  const auto wheels = view->Actions(MouseEvent::kActionWheel);
  EXPECT_EQ(wheels[0].GetMouseWheelDelta(), 1);
  EXPECT_EQ(wheels[0].GetMouseWheelAxis(), MouseEvent::kWheelAxisVertical);
  EXPECT_EQ(wheels[1].GetMouseWheelDelta(), -1);
  EXPECT_EQ(wheels[2].GetMouseWheelAxis(), MouseEvent::kWheelAxisHorizontal);
  EXPECT_EQ(wheels[3].GetMouseWheelAxis(), MouseEvent::kWheelAxisHorizontal);
  EXPECT_EQ(wheels[2].GetMouseWheelDelta(), -wheels[3].GetMouseWheelDelta());
  EXPECT_FLOAT_EQ(wheels[0].GetPosition().x, 30.0f);
  EXPECT_FLOAT_EQ(wheels[0].GetPosition().y, 20.0f);
}

}  // namespace
}  // namespace norvik::test
