// Handlers that tear the tree apart while an event is on its way: the walk
// must only touch live nodes and must still reach the nodes it had not yet
// visited. Run under the sanitizer build to catch use after free.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/ui/DispatchTestNodes.h"

namespace norvik::ui::test {
namespace {

using ::testing::ElementsAre;

class MouseDispatchSafetyTest : public DispatchTest {
 protected:
  MouseDispatchSafetyTest() {
    EventViewP panel = View("panel", 20, 20, 100, 100, root.get());
    EventViewP button = View("button", 10, 10, 30, 30, panel.get());
    panelPtr = panel.get();
    buttonPtr = button.get();
    panel->destroyedFlag = &panelDestroyed;
    button->destroyedFlag = &buttonDestroyed;
    // From here on only the tree holds them.
  }
  bool Click(const PointF& inPoint) {
    return root->UI_DispatchMouseEvent(MouseAt(MouseEvent::kActionButtonDown, inPoint), true);
  }

  EventView* panelPtr = nullptr;
  EventView* buttonPtr = nullptr;
  bool panelDestroyed = false;
  bool buttonDestroyed = false;
};

TEST_F(MouseDispatchSafetyTest, ALeafThatDeletesItselfStillLetsItsAncestorsSeeTheEvent) {
  buttonPtr->onMouse = [this](UI_Node*, const MouseEvent&) {
    panelPtr->ChildRemove(buttonPtr);
    return false;
  };
  EXPECT_FALSE(Click(PointF(35, 35)));
  EXPECT_THAT(log.Texts(), ElementsAre("button.mouse(button)", "panel.mouse(button)", "root.mouse(button)"));
  EXPECT_TRUE(buttonDestroyed);
  EXPECT_EQ(panelPtr->ChildSize(), 0u);
}

TEST_F(MouseDispatchSafetyTest, ALeafThatDeletesItsParentStillLetsTheParentAndTheRootSeeTheEvent) {
  buttonPtr->onMouse = [this](UI_Node*, const MouseEvent&) {
    root->ChildRemove(panelPtr);
    return false;
  };
  EXPECT_FALSE(Click(PointF(35, 35)));
  EXPECT_THAT(log.Texts(), ElementsAre("button.mouse(button)", "panel.mouse(button)", "root.mouse(button)"));
  EXPECT_TRUE(panelDestroyed);
  EXPECT_TRUE(buttonDestroyed);
}

TEST_F(MouseDispatchSafetyTest, AFirstChanceHandlerThatDeletesTheChildrenMakesItselfTheLeaf) {
  panelPtr->UI_SetStateFlags(panelPtr->UI_GetStateFlags().Set(UI_Node::kStateFirstChanceMouse));
  panelPtr->onMouse = [this](UI_Node* inTarget, const MouseEvent&) {
    if (!inTarget) panelPtr->DeleteChildren();
    return false;
  };
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts(), ElementsAre("panel.mouse(-)", "panel.mouse(panel)", "root.mouse(panel)"));
  EXPECT_TRUE(buttonDestroyed);
}

TEST_F(MouseDispatchSafetyTest, AFirstChanceNodeThatDetachesItselfStillWalksDownAndClimbsBack) {
  panelPtr->UI_SetStateFlags(panelPtr->UI_GetStateFlags().Set(UI_Node::kStateFirstChanceMouse));
  panelPtr->onMouse = [this](UI_Node* inTarget, const MouseEvent&) {
    if (!inTarget) root->ChildRemove(panelPtr);
    return false;
  };
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts(), ElementsAre("panel.mouse(-)", "button.mouse(button)", "panel.mouse(button)",
                                       "root.mouse(button)"));
  EXPECT_TRUE(panelDestroyed);
  EXPECT_TRUE(buttonDestroyed);
}

TEST_F(MouseDispatchSafetyTest, ACursorHandlerThatDeletesTheWholeBranchStillReachesTheRoot) {
  buttonPtr->onCursor = [this](UI_Node*, const PointF&, UI_Node::ModKeys) {
    root->DeleteChildren();
    return false;
  };
  EXPECT_FALSE(root->UI_DispatchCursor(PointF(35, 35), {}, true));
  EXPECT_THAT(log.Texts("cursor"), ElementsAre("button.cursor(button)", "panel.cursor(button)", "root.cursor(button)"));
  EXPECT_TRUE(panelDestroyed);
  EXPECT_TRUE(buttonDestroyed);
}

TEST_F(MouseDispatchSafetyTest, AnAncestorThatDetachesItselfOnTheWayUpDoesNotCutTheClimbShort) {
  panelPtr->onMouse = [this](UI_Node*, const MouseEvent&) {
    root->ChildRemove(panelPtr);
    return false;
  };
  MouseEvent e = MouseAt(MouseEvent::kActionButtonDown, PointF(5, 5));
  UI_Node::UI_DispatchMouseEventToTarget(buttonPtr, e, true);
  EXPECT_THAT(log.Texts(), ElementsAre("button.mouse(button)", "panel.mouse(button)", "root.mouse(button)"));
  EXPECT_TRUE(panelDestroyed);
}

TEST_F(MouseDispatchSafetyTest, AFilterThatDeletesTheLeafLeavesTheRestOfTheWalkIntact) {
  EventViewP filter = View("filter", 0, 0, 1, 1, nullptr);
  manager.AddMouseEventFilterNode(filter.get());
  filter->onPreMouse = [this](UI_Node*, const MouseEvent&) {
    panelPtr->ChildRemove(buttonPtr);
    return false;
  };
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts(), ElementsAre("filter.pre(button)", "button.mouse(button)", "panel.mouse(button)",
                                       "root.mouse(button)"));
  EXPECT_TRUE(buttonDestroyed);
}

TEST_F(MouseDispatchSafetyTest, AFilterNodeDeletedInItsOwnHandlerIsSafe) {
  bool filterDestroyed = false;
  EventViewP filter = View("filter", 0, 0, 1, 1, nullptr);
  filter->destroyedFlag = &filterDestroyed;
  manager.AddMouseEventFilterNode(filter.get());
  EventView* raw = filter.get();
  filter->onPreMouse = [&](UI_Node*, const MouseEvent&) {
    manager.RemoveMouseEventFilterNode(raw);
    filter.reset();
    return false;
  };
  Click(PointF(35, 35));
  EXPECT_TRUE(filterDestroyed);
  EXPECT_EQ(log.Texts("mouse").size(), 3u);
}

}  // namespace
}  // namespace norvik::ui::test
