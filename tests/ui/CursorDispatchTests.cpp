// The cursor walk: the same road as the mouse, but disabled nodes may still
// choose the cursor and filters are not asked; a gesture or suspended hover
// takes the cursor away from the tree.
#include <boost/make_shared.hpp>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/ui/DispatchTestNodes.h"
#include "ui/HeadlessWindowSystem.h"

namespace norvik::ui::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class CursorDispatchTest : public DispatchTest {
 protected:
  CursorDispatchTest() {
    panel = View("panel", 20, 20, 100, 100, root.get());
    button = View("button", 10, 10, 30, 30, panel.get());
  }
  bool Cursor(const PointF& inPoint, ModifierKeys inMods = {}) {
    return root->UI_DispatchCursor(inPoint, inMods, true);
  }

  EventViewP panel, button;
};

TEST_F(CursorDispatchTest, TheLeafThenEachAncestorIsAskedUntilOneAnswersDisabledOrNotAndNoFilter) {
  EventViewP filter = View("filter", 0, 0, 1, 1, nullptr);
  filter->handlesPreMouse = true;
  manager.AddMouseEventFilterNode(filter.get());
  EXPECT_FALSE(Cursor(PointF(35, 36)));
  EXPECT_THAT(log.Texts(), ElementsAre("button.cursor(button)", "panel.cursor(button)", "root.cursor(button)"));
  EXPECT_EQ(log.Find("button", "cursor").position, PointF(5, 6));
  EXPECT_EQ(log.Find("panel", "cursor").position, PointF(15, 16));
  log.Clear();
  panel->handlesCursor = true;
  EXPECT_TRUE(Cursor(PointF(35, 36)));
  EXPECT_THAT(log.Texts(), ElementsAre("button.cursor(button)", "panel.cursor(button)"));
  log.Clear();
  panel->UI_SetDisabled(true);
  button->handlesCursor = true;
  EXPECT_TRUE(Cursor(PointF(35, 35)));
  EXPECT_THAT(log.Texts(), ElementsAre("button.cursor(button)")) << "a disabled node may still choose";
}

TEST_F(CursorDispatchTest, FirstChanceNodesAreAskedBeforeTheirChildren) {
  panel->UI_SetStateFlags(panel->UI_GetStateFlags().Set(UI_Node::kStateFirstChanceMouse));
  panel->onCursor = [](UI_Node* inTarget, const PointF&, UI_Node::ModKeys) { return inTarget == nullptr; };
  EXPECT_TRUE(Cursor(PointF(35, 35)));
  EXPECT_THAT(log.Texts(), ElementsAre("panel.cursor(-)"));
}

TEST_F(CursorDispatchTest, ACustomCursorFunctionThatTakesOverAnswersForTheNode) {
  using CursorFunction = boost::function<bool(UI_Node*, const PointF&, UI_Node::ModKeys, bool&)>;
  std::vector<UI_Node*> targets;
  panel->UI_SetCustomDoCursorFunction(boost::make_shared<CursorFunction>(
      [&](UI_Node* inTarget, const PointF&, UI_Node::ModKeys, bool& outTookOver) {
        targets.push_back(inTarget);
        outTookOver = true;
        return true;
      }));
  EXPECT_TRUE(Cursor(PointF(35, 35)));
  EXPECT_THAT(targets, ElementsAre(button.get()));
  EXPECT_THAT(log.Texts(), ElementsAre("button.cursor(button)"));
}

TEST_F(CursorDispatchTest, WhileHoverIsSuspendedNoNodeSeesTheCursorAndTheWalkCountsAsAnswered) {
  UI_NodeManager::SuspendMouseOverUpdates suspend(&manager);
  EXPECT_TRUE(Cursor(PointF(35, 35)));
  EXPECT_THAT(log.Texts(), IsEmpty());
}

TEST_F(CursorDispatchTest, DuringAGestureTheCaptureChoosesOrLeavesItToThePlatformUntilCancelled) {
  LoggingCaptureP capture = Capture(button.get(), MouseAt(MouseEvent::kActionButtonDown, PointF(5, 5)));
  capture->handlesCursor = true;
  manager.BeginInputCapture(capture);
  EXPECT_TRUE(Cursor(PointF(150, 160), ModifierKeys(kModKeyShift)));
  EXPECT_THAT(log.Texts(), IsEmpty());
  ASSERT_EQ(capture->cursorPositions.size(), 1u);
  EXPECT_EQ(capture->cursorPositions[0], PointF(120, 130));
  EXPECT_EQ(capture->cursorModKeys[0], ModifierKeys(kModKeyShift));
  EXPECT_EQ(platform.mDefaultCursorCount, 0);
  capture->handlesCursor = false;
  EXPECT_TRUE(Cursor(PointF(150, 160)));
  EXPECT_EQ(platform.mDefaultCursorCount, 1);
  capture->Cancel();
  Cursor(PointF(35, 35));
  EXPECT_EQ(log.Texts("cursor").size(), 3u);
  EXPECT_EQ(capture->cursorPositions.size(), 2u);
}

TEST_F(CursorDispatchTest, AHandlerThatDeletesItsOwnBranchLeavesTheRestOfTheWalkIntact) {
  bool destroyed = false;
  button->destroyedFlag = &destroyed;
  EventView* rawPanel = panel.get();
  panel.reset();
  button->onCursor = [&](UI_Node*, const PointF&, UI_Node::ModKeys) {
    root->ChildRemove(rawPanel);
    return false;
  };
  button.reset();
  EXPECT_FALSE(Cursor(PointF(35, 35)));
  EXPECT_THAT(log.Texts(), ElementsAre("button.cursor(button)", "panel.cursor(button)", "root.cursor(button)"));
  EXPECT_TRUE(destroyed);
}

TEST_F(CursorDispatchTest, AModifierChangeSeenByTheManagerRefreshesTheCursorUnderTheMouse) {
  root->UI_UpdateMouseOverState(MouseAt(MouseEvent::kActionMouseOver, PointF(35, 35), 0, 0));
  HeadlessWindowSystem system;
  system.Install();
  system.MovePointer(OS_Point(36, 37));
  log.Clear();
  EXPECT_FALSE(manager.DispatchPreKeyboardEvent(nullptr, KeyDownEvent(16, 0, ModifierKeys(kModKeyShift))));
  EXPECT_THAT(log.Texts("cursor"), ElementsAre("button.cursor(button)", "panel.cursor(button)", "root.cursor(button)"));
  EXPECT_EQ(log.Find("button", "cursor").position, PointF(6, 7));
  log.Clear();
  manager.DispatchPreKeyboardEvent(nullptr, KeyUpEvent('A', 'A', ModifierKeys(kModKeyShift)));
  EXPECT_THAT(log.Texts("cursor"), IsEmpty()) << "the modifiers did not change";
}

}  // namespace
}  // namespace norvik::ui::test
