// Input capture: a gesture receives every mouse and keyboard event while it
// runs, ends itself on the release of its button or on Escape, is cancelled
// by a new gesture, and hears End exactly once. Also the platform's mouse
// capture and the tool tip suspension that it holds from begin to end.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/ui/DispatchTestNodes.h"
#include "support/ui/NodeTestSupport.h"
#include "ui/UI_SuspendToolTips.h"

namespace norvik::ui::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class InputCaptureTest : public DispatchTest {
 protected:
  InputCaptureTest() {
    panel = View("panel", 20, 20, 100, 100, root.get());
    thumb = View("thumb", 10, 10, 30, 30, panel.get());
  }
  LoggingCaptureP StartDrag(int inButton = MouseEvent::kButtonLeft) {
    LoggingCaptureP capture = Capture(thumb.get(), MouseAt(MouseEvent::kActionButtonDown, PointF(5, 5), inButton));
    manager.BeginInputCapture(capture);
    return capture;
  }
  bool Mouse(MouseEvent::Action inAction, const PointF& inPoint, int inButton = MouseEvent::kButtonLeft) {
    return root->UI_DispatchMouseEvent(MouseAt(inAction, inPoint, inButton), true);
  }

  EventViewP panel, thumb;
};

TEST_F(InputCaptureTest, DuringAGestureTheTreeSeesNoMouseEventsAndTheCaptureGetsThemInItsNodesCoordinates) {
  LoggingCaptureP capture = StartDrag();
  EXPECT_TRUE(Mouse(MouseEvent::kActionMove, PointF(180, 190)));
  EXPECT_THAT(log.Texts(), IsEmpty());
  ASSERT_EQ(capture->mousePositions.size(), 1u);
  EXPECT_EQ(capture->mousePositions[0], PointF(150, 160));
  EXPECT_EQ(capture->cursorPositions.size(), 1u) << "every mouse event refreshes the cursor";
}

TEST_F(InputCaptureTest, AGestureHoldsThePlatformsCaptureOnItsNodeUntilTheReleaseOfItsOwnButton) {
  LoggingCaptureP capture = StartDrag();
  EXPECT_EQ(thumb->setCaptureCount, 1);
  EXPECT_EQ(manager.GetActiveInputCapture(thumb.get()), capture.get());
  EXPECT_EQ(manager.GetActiveInputCapture(panel.get()), nullptr) << "not the capture's node";
  Mouse(MouseEvent::kActionButtonUp, PointF(35, 35), MouseEvent::kButtonRight);
  EXPECT_EQ(manager.GetActiveInputCapture(nullptr), capture.get()) << "another button's release";
  Mouse(MouseEvent::kActionButtonUp, PointF(50, 50));
  EXPECT_FALSE(manager.HasInputCapture());
  EXPECT_THAT(captureLog, ElementsAre("capture.Begin", "capture.Mouse2", "capture.Mouse2", "capture.End"));
  EXPECT_FALSE(capture->cancelledAtEnd);
  EXPECT_EQ(thumb->releaseCaptureCount, 1);
  EXPECT_EQ(capture->GetPreviousMouseEvent().GetPosition(), PointF(20, 20)) << "the ending release";
}

TEST_F(InputCaptureTest, ACaptureThatClaimsTheReleaseStaysActiveUntilItEndsItself) {
  LoggingCaptureP capture = StartDrag();
  capture->handlesMouse = true;
  Mouse(MouseEvent::kActionButtonUp, PointF(35, 35));
  EXPECT_EQ(manager.GetActiveInputCapture(nullptr), capture.get());
  capture->onMouse = [&](const MouseEvent&) {
    manager.EndInputCapture(false);
    return true;
  };
  Mouse(MouseEvent::kActionButtonDown, PointF(35, 35));
  EXPECT_FALSE(manager.HasInputCapture());
  EXPECT_EQ(capture->endCount, 1);
}

TEST_F(InputCaptureTest, ANewGestureCancelsTheRunningOneBeforeItBegins) {
  LoggingCaptureP first = StartDrag();
  LoggingCaptureP second = Capture(panel.get(), MouseAt(MouseEvent::kActionButtonDown, PointF(0, 0)), "second");
  manager.BeginInputCapture(second);
  EXPECT_THAT(captureLog, ElementsAre("capture.Begin", "capture.End(cancelled)", "second.Begin"));
  EXPECT_TRUE(first->HasBeenCancelled());
  EXPECT_EQ(manager.GetInputCapture(), second);
  EXPECT_EQ(thumb->releaseCaptureCount, 1);
}

TEST_F(InputCaptureTest, ACancelledCaptureIsKeptWhileEventsGoToTheTreeAndEndsOnceSeeingNoCapture) {
  LoggingCaptureP capture = StartDrag();
  capture->Cancel();
  EXPECT_TRUE(manager.HasInputCapture());
  EXPECT_EQ(manager.GetActiveInputCapture(nullptr), nullptr);
  EXPECT_FALSE(Mouse(MouseEvent::kActionButtonDown, PointF(35, 35)));
  EXPECT_THAT(log.Texts(), ElementsAre("thumb.mouse(thumb)", "panel.mouse(thumb)", "root.mouse(thumb)"));
  EXPECT_EQ(thumb->releaseCaptureCount, 0) << "the platform's capture is still held";
  bool sawCapture = true;
  capture->onEnd = [&] { sawCapture = manager.HasInputCapture(); };
  manager.EndInputCapture(false);
  manager.EndInputCapture(false);
  EXPECT_EQ(capture->endCount, 1);
  EXPECT_TRUE(capture->cancelledAtEnd);
  EXPECT_FALSE(sawCapture);
}

TEST_F(InputCaptureTest, OnlyAnUnusedEscapeKeyDownWithoutModifiersCancelsTheGesture) {
  LoggingCaptureP capture = StartDrag();
  UI_Node::UI_DispatchKeyboardEvent(thumb.get(), KeyDownEvent(27, 27, ModifierKeys(kModKeyShift)));
  UI_Node::UI_DispatchKeyboardEvent(thumb.get(), KeyUpEvent(27, 27));
  capture->handlesKey = true;
  UI_Node::UI_DispatchKeyboardEvent(thumb.get(), KeyDownEvent(27, 27));
  EXPECT_EQ(manager.GetActiveInputCapture(nullptr), capture.get());
  EXPECT_THAT(log.Texts(), IsEmpty());
  capture->handlesKey = false;
  EXPECT_TRUE(UI_Node::UI_DispatchKeyboardEvent(thumb.get(), KeyDownEvent(27, 27)));
  EXPECT_FALSE(manager.HasInputCapture());
  EXPECT_TRUE(capture->cancelledAtEnd);
}

TEST_F(InputCaptureTest, AModifierDuringAGestureRefreshesItsCursorAtTheLastMousePosition) {
  LoggingCaptureP capture = StartDrag();
  Mouse(MouseEvent::kActionMove, PointF(60, 70));
  UI_Node::UI_DispatchKeyboardEvent(thumb.get(), KeyDownEvent(17, 0, ModifierKeys(kModKeyCtrl)));
  ASSERT_EQ(capture->cursorPositions.size(), 2u);
  EXPECT_EQ(capture->cursorPositions[1], PointF(30, 40));
  EXPECT_EQ(capture->cursorModKeys[1], ModifierKeys(kModKeyCtrl));
}

TEST_F(InputCaptureTest, ThePreviousEventIsTheLastRealOneNotAHoverUpdate) {
  LoggingCaptureP capture = StartDrag();
  EXPECT_EQ(capture->GetPreviousMouseEvent().GetPosition(), PointF(5, 5)) << "it starts as the initial event";
  Mouse(MouseEvent::kActionMove, PointF(60, 70));
  UI_Node::UI_DispatchCapturedMouseEvent(root.get(), MouseAt(MouseEvent::kActionMouseOver, PointF(90, 90), 0, 0));
  EXPECT_EQ(capture->GetPreviousMouseEvent().GetPosition(), PointF(30, 40));
  EXPECT_EQ(capture->GetPreviousMouseEvent().GetAction(), MouseEvent::kActionMove);
}

TEST_F(InputCaptureTest, ToolTipsAreSuspendedFromBeginToEnd) {
  RecordingToolTips* tips = RecordingToolTips::InstallIn(manager);
  EXPECT_FALSE(UI_SuspendToolTips::IsSuspended());
  StartDrag();
  EXPECT_TRUE(UI_SuspendToolTips::IsSuspended());
  EXPECT_EQ(tips->calls, std::vector<std::string>{"dispose"}) << "the tip on screen goes away";
  manager.EndInputCapture(false);
  EXPECT_FALSE(UI_SuspendToolTips::IsSuspended());
}

TEST_F(InputCaptureTest, EndingAGestureInvalidatesTheHoverNodesThatAskForIt) {
  root->UI_UpdateMouseOverState(MouseAt(MouseEvent::kActionMouseOver, PointF(35, 35), 0, 0));
  panel->invalidateWhenOnChain = true;
  StartDrag();
  int before = panel->invalidations;
  manager.EndInputCapture(false);
  EXPECT_GT(panel->invalidations, before);
}

TEST_F(InputCaptureTest, ACaptureThatDiesWithoutAnEndReleasesThePlatformsCaptureAndTheTips) {
  {
    LoggingCaptureP capture = Capture(thumb.get(), MouseAt(MouseEvent::kActionButtonDown, PointF(5, 5)));
    capture->InvokeBegin();
    EXPECT_EQ(thumb->setCaptureCount, 1);
    EXPECT_TRUE(UI_SuspendToolTips::IsSuspended());
  }
  EXPECT_EQ(thumb->releaseCaptureCount, 1);
  EXPECT_FALSE(UI_SuspendToolTips::IsSuspended());
}

TEST_F(InputCaptureTest, AGestureThatDeletesItsNodeAndEndsItselfInsideTheEventIsSafe) {
  bool destroyed = false;
  thumb->destroyedFlag = &destroyed;
  LoggingCaptureP capture = StartDrag();
  EventView* raw = thumb.get();
  thumb.reset();
  capture->onMouse = [&](const MouseEvent&) {
    panel->ChildRemove(raw);
    manager.EndInputCapture(true);
    return false;
  };
  EXPECT_TRUE(Mouse(MouseEvent::kActionButtonUp, PointF(35, 35)));
  EXPECT_EQ(capture->endCount, 1);
  EXPECT_FALSE(destroyed) << "the capture still holds its node";
  capture.reset();
  EXPECT_TRUE(destroyed);
}

TEST_F(InputCaptureTest, AGestureThatStartsAnotherFromItsReleaseKeepsTheNewOne) {
  LoggingCaptureP first = StartDrag();
  LoggingCaptureP second = Capture(panel.get(), MouseAt(MouseEvent::kActionButtonDown, PointF(0, 0)), "second");
  first->onMouse = [&](const MouseEvent&) {
    manager.BeginInputCapture(second);
    return false;
  };
  Mouse(MouseEvent::kActionButtonUp, PointF(35, 35));
  EXPECT_EQ(manager.GetActiveInputCapture(nullptr), second.get());
  EXPECT_EQ(second->endCount, 0);
  EXPECT_EQ(first->endCount, 1);
}

}  // namespace
}  // namespace norvik::ui::test
