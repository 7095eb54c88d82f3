// The mouse walk: towards the deepest hit node, back up through its
// ancestors, first-chance nodes, disabled nodes, overlapping siblings,
// coordinates per node, custom functions, proxies and native children.
#include <boost/make_shared.hpp>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/ui/DispatchTestNodes.h"

namespace norvik::ui::test {
namespace {

using ::testing::ElementsAre;

class MouseDispatchTest : public DispatchTest {
 protected:
  MouseDispatchTest() {
    panel = View("panel", 20, 20, 100, 100, root.get());
    button = View("button", 10, 10, 30, 30, panel.get());
  }
  bool Click(const PointF& inPoint) {
    return root->UI_DispatchMouseEvent(MouseAt(MouseEvent::kActionButtonDown, inPoint), true);
  }

  EventViewP panel;
  EventViewP button;
};

TEST_F(MouseDispatchTest, ScaledViewsGetTheirPointThroughTheInverseMatrix) {
  panel->UI_SetMatrix(tarsel::geom::ScaleMatrixF(2, 2, 0, 0));
  // The panel maps its point p to 2p + (40, 40) in the root.
  Click(PointF(70, 72));
  EXPECT_EQ(log.Find("panel", "mouse").position, PointF(15, 16));
  EXPECT_EQ(log.Find("button", "mouse").position, PointF(5, 6));
}

TEST_F(MouseDispatchTest, TheFirstNodeThatHandlesTheEventEndsTheWalk) {
  panel->handlesMouse = true;
  EXPECT_TRUE(Click(PointF(35, 35)));
  EXPECT_THAT(log.Texts(), ElementsAre("button.mouse(button)", "panel.mouse(button)"));
}

TEST_F(MouseDispatchTest, HiddenChildrenAreNotHit) {
  button->UI_Show(false);
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts(), ElementsAre("panel.mouse(panel)", "root.mouse(panel)"));
}

TEST_F(MouseDispatchTest, AFirstChanceNodeSeesTheEventBeforeItsChildrenWithNoTarget) {
  panel->UI_SetStateFlags(panel->UI_GetStateFlags().Set(UI_Node::kStateFirstChanceMouse));
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts(), ElementsAre("panel.mouse(-)", "button.mouse(button)", "panel.mouse(button)",
                                       "root.mouse(button)"));
}

TEST_F(MouseDispatchTest, AFirstChanceNodeThatHandlesTheEventKeepsItFromItsChildren) {
  panel->UI_SetStateFlags(panel->UI_GetStateFlags().Set(UI_Node::kStateFirstChanceMouse));
  panel->onMouse = [](UI_Node* inTarget, const MouseEvent&) { return inTarget == nullptr; };
  EXPECT_TRUE(Click(PointF(35, 35)));
  EXPECT_THAT(log.Texts(), ElementsAre("panel.mouse(-)"));
}

TEST_F(MouseDispatchTest, AChildOfASelfDisabledParentGetsTheClickAndTheGrandparentNextWithoutTheParent) {
  panel->UI_SetSelfDisabled(true);
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts(), ElementsAre("button.mouse(button)", "root.mouse(button)"));
}

TEST_F(MouseDispatchTest, NodesDisabledThroughAnAncestorSeeNothingWhileTheWalkGoesOn) {
  panel->UI_SetDisabled(true);
  EXPECT_FALSE(Click(PointF(35, 35)));
  EXPECT_THAT(log.Texts(), ElementsAre("root.mouse(button)"));
}

TEST_F(MouseDispatchTest, DispatchToATargetClimbsAboveItAfterTheLeafWalk) {
  // The event is in the panel's coordinates; the panel's ancestors hear of
  // it after the panel's own subtree, with the leaf as target.
  MouseEvent e = MouseAt(MouseEvent::kActionButtonDown, PointF(15, 15));
  EXPECT_FALSE(UI_Node::UI_DispatchMouseEventToTarget(panel.get(), e, true));
  EXPECT_THAT(log.Texts(), ElementsAre("button.mouse(button)", "panel.mouse(button)", "root.mouse(button)"));
  EXPECT_EQ(log.Records()[2].position, PointF(35, 35));
}

TEST_F(MouseDispatchTest, TheClimbTowardsTheRootGoesOnPastDisabledAncestors) {
  root->handlesMouse = true;
  panel->UI_SetSelfDisabled(true);
  MouseEvent e = MouseAt(MouseEvent::kActionButtonDown, PointF(5, 5));
  EXPECT_TRUE(button->UI_DispatchMouseEventTowardsRoot(button.get(), e));
  EXPECT_THAT(log.Texts(), ElementsAre("root.mouse(button)"));
}

TEST_F(MouseDispatchTest, ACustomFunctionThatTakesOverReplacesTheHandler) {
  std::vector<UI_Node*> targets;
  button->UI_SetCustomMouseEventFunction(boost::make_shared<boost::function<bool(UI_Node*, const MouseEvent&, bool&)>>(
      [&](UI_Node* inTarget, const MouseEvent&, bool& outTookOver) {
        targets.push_back(inTarget);
        outTookOver = true;
        return true;
      }));
  EXPECT_TRUE(Click(PointF(35, 35)));
  EXPECT_THAT(targets, ElementsAre(button.get()));
  EXPECT_TRUE(log.Texts().empty()) << "the virtual must not run";
}

TEST_F(MouseDispatchTest, ACustomFunctionThatDoesNotTakeOverLeavesTheAnswerToTheHandler) {
  int calls = 0;
  button->UI_SetCustomMouseEventFunction(boost::make_shared<boost::function<bool(UI_Node*, const MouseEvent&, bool&)>>(
      [&](UI_Node*, const MouseEvent&, bool& outTookOver) {
        ++calls;
        EXPECT_FALSE(outTookOver) << "the flag starts false";
        return true;  // ignored: it did not take over
      }));
  button->handlesMouse = false;
  EXPECT_FALSE(Click(PointF(35, 35)));
  EXPECT_EQ(calls, 1);
  EXPECT_THAT(log.Texts(), ElementsAre("button.mouse(button)", "panel.mouse(button)", "root.mouse(button)"));
}

TEST_F(MouseDispatchTest, TheMouseProxyReceivesTheEventWithTheRewrittenPosition) {
  EventViewP other = View("other", 0, 0, 100, 100, nullptr);
  EventViewP inner = View("inner", 50, 50, 10, 10, other.get());
  root->proxy = other.get();
  root->proxyOffset = PointF(20, 20);
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts(), ElementsAre("inner.mouse(inner)", "other.mouse(inner)"));
  EXPECT_EQ(log.Find("inner", "mouse").position, PointF(5, 5));
}

TEST_F(MouseDispatchTest, ChildrenWithTheirOwnNativeMessagesAreSkippedExceptForTheWheel) {
  panel->receivesEventsFromOS = true;
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts(), ElementsAre("root.mouse(root)"));
  log.Clear();
  MouseEvent wheel(MouseEvent::kActionWheel, 0, 0, PointF(35, 35), {}, OS_Event(1, kOSMsgMouseWheel, 0, 0), 1);
  root->UI_DispatchMouseEvent(wheel, false);
  EXPECT_THAT(log.Texts(), ElementsAre("button.mouse(button)", "panel.mouse(button)", "root.mouse(button)"));
}

TEST_F(MouseDispatchTest, AnEmptyCustomFunctionObjectRaisesTheStandardError) {
  button->UI_SetCustomMouseEventFunction(
      boost::make_shared<boost::function<bool(UI_Node*, const MouseEvent&, bool&)>>());
  EXPECT_THROW(Click(PointF(35, 35)), boost::bad_function_call);
}

}  // namespace
}  // namespace norvik::ui::test
