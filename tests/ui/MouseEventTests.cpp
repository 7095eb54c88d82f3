// Mouse events as values: construction, the click predicates, the end of a
// drag, horizontal scrolling, and the native message they carry.
#include <gtest/gtest.h>

#include "ui/MouseEvent.h"

namespace norvik::ui {
namespace {

using Point = tarsel::geom::PointT<float>;

MouseEvent Make(MouseEvent::Action inAction, int inButton, int inClicks, ModifierKeys inMods = {},
                int inAxis = MouseEvent::kWheelAxisVertical) {
  return MouseEvent(inAction, inButton, inClicks, Point(3, 4), inMods, OS_Event(7, kOSMsgLeftButtonDown, 1, 2), 0,
                    inAxis);
}

TEST(MouseEventClicks, SingleDownNeedsADownWithOneClick) {
  EXPECT_TRUE(Make(MouseEvent::kActionButtonDown, 1, 1).IsButtonSingleDown(1));
  EXPECT_TRUE(Make(MouseEvent::kActionButtonDown, 1, 1).IsLeftButtonSingleDown());
  EXPECT_FALSE(Make(MouseEvent::kActionButtonDown, 1, 2).IsLeftButtonSingleDown());
  EXPECT_FALSE(Make(MouseEvent::kActionButtonUp, 1, 1).IsLeftButtonSingleDown());
  EXPECT_FALSE(Make(MouseEvent::kActionButtonDown, 2, 1).IsLeftButtonSingleDown());
  EXPECT_TRUE(Make(MouseEvent::kActionButtonDown, 2, 1).IsMiddleButtonSingleDown());
  EXPECT_TRUE(Make(MouseEvent::kActionButtonDown, 4, 1).IsRightButtonSingleDown());
  EXPECT_FALSE(Make(MouseEvent::kActionButtonDown, 4, 1).IsMiddleButtonSingleDown());
}

TEST(MouseEventClicks, DoubleClickIsRecognisedOnTheUpEventOnly) {
  EXPECT_TRUE(Make(MouseEvent::kActionButtonUp, 1, 2).IsLeftButtonDoubleClick());
  EXPECT_TRUE(Make(MouseEvent::kActionButtonUp, 1, 2).IsButtonDoubleClick(1));
  EXPECT_FALSE(Make(MouseEvent::kActionButtonDown, 1, 2).IsLeftButtonDoubleClick());
  EXPECT_FALSE(Make(MouseEvent::kActionButtonUp, 1, 3).IsLeftButtonDoubleClick());
  EXPECT_TRUE(Make(MouseEvent::kActionButtonUp, 2, 2).IsMiddleButtonDoubleClick());
  EXPECT_TRUE(Make(MouseEvent::kActionButtonUp, 4, 2).IsRightButtonDoubleClick());
  EXPECT_FALSE(Make(MouseEvent::kActionButtonUp, 4, 2).IsLeftButtonDoubleClick());
}

TEST(MouseEventClicks, ContextMenuClickIsASingleRightPress) {
  EXPECT_TRUE(Make(MouseEvent::kActionButtonDown, 4, 1).IsContextMenuClick());
  EXPECT_FALSE(Make(MouseEvent::kActionButtonDown, 4, 2).IsContextMenuClick());
  EXPECT_FALSE(Make(MouseEvent::kActionButtonUp, 4, 1).IsContextMenuClick());
  EXPECT_FALSE(Make(MouseEvent::kActionButtonDown, 1, 1).IsContextMenuClick());
}

TEST(MouseEventDrag, EndsOnTheReleaseOfTheSamePhysicalButtonAsRewrittenOnTheStart) {
  MouseEvent initial = Make(MouseEvent::kActionButtonDown, 4, 1);
  EXPECT_TRUE(Make(MouseEvent::kActionButtonUp, 4, 1).IsEndDragEvent(initial));
  EXPECT_FALSE(Make(MouseEvent::kActionButtonUp, 1, 1).IsEndDragEvent(initial));
  EXPECT_FALSE(Make(MouseEvent::kActionMove, 4, 0).IsEndDragEvent(initial));
  initial.SetPhysicalButton(MouseEvent::kButtonLeft);
  EXPECT_TRUE(Make(MouseEvent::kActionButtonUp, 1, 1).IsEndDragEvent(initial));
  EXPECT_FALSE(Make(MouseEvent::kActionButtonUp, 4, 1).IsEndDragEvent(initial));
}

TEST(MouseEventWheel, HorizontalOnTheHorizontalAxisOrWithShift) {
  EXPECT_TRUE(Make(MouseEvent::kActionWheel, 0, 0, {}, MouseEvent::kWheelAxisHorizontal).IsHorizontalScroll());
  EXPECT_FALSE(Make(MouseEvent::kActionWheel, 0, 0, {}, MouseEvent::kWheelAxisVertical).IsHorizontalScroll());
  EXPECT_TRUE(Make(MouseEvent::kActionWheel, 0, 0, ModifierKeys(kModKeyShift)).IsHorizontalScroll());
  EXPECT_FALSE(Make(MouseEvent::kActionWheel, 0, 0, ModifierKeys(kModKeyCtrl | kModKeyCapsLock)).IsHorizontalScroll());
}

TEST(OSEventRecord, CopyClonesEveryFieldIncludingTheResult) {
  OS_Event os(9, kOSMsgSysKeyDown, 18, -5, 777);
  os.SetResult(33);
  std::unique_ptr<OS_EventBase> copy = os.Copy();
  auto* asEvent = dynamic_cast<OS_Event*>(copy.get());
  ASSERT_NE(asEvent, nullptr);
  EXPECT_EQ(asEvent->GetHWnd(), 9u);
  EXPECT_EQ(asEvent->GetMsg(), 260u);
  EXPECT_EQ(asEvent->GetWParam(), 18u);
  EXPECT_EQ(asEvent->GetLParam(), -5);
  EXPECT_EQ(asEvent->GetResult(), 33);
  EXPECT_EQ(asEvent->GetTime(), 777);
  asEvent->SetResult(1);
  EXPECT_EQ(os.GetResult(), 33);
}

}  // namespace
}  // namespace norvik::ui
