// Mouse-over state: entering and leaving nodes as the mouse moves, the exit
// events that left nodes hear, the leaf changing while it stays on the chain,
// the mouse leaving a window, suspension, and hover invalidation.
#include <optional>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/ui/DispatchTestNodes.h"

namespace norvik::ui::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class MouseOverTest : public DispatchTest {
 protected:
  MouseOverTest() {
    a = View("a", 10, 10, 80, 80, root.get());
    a1 = View("a1", 10, 10, 20, 20, a.get());
    b = View("b", 100, 100, 50, 50, root.get());
  }
  void MoveTo(const PointF& inPoint) {
    root->UI_UpdateMouseOverState(MouseAt(MouseEvent::kActionMouseOver, inPoint, 0, 0));
  }
  static bool Over(const EventViewP& inView) { return inView->UI_IsMouseOver(); }

  EventViewP a, a1, b;
};

// Each row moves the mouse from one point (none: from outside) to another;
// the nodes on the chain from the root to the new leaf, and only they, are
// over, and only the leaf is over as the leaf.
TEST_F(MouseOverTest, TheChainEntersAndLeavesOnlyTheNodesThatChangeRootFirst) {
  struct Row {
    const char* name;
    std::optional<PointF> from;
    PointF to;
    const char* leaf;
    std::vector<std::string> log;
  };
  const Row rows[] = {
      {"onto a nested node", std::nullopt, PointF(25, 25), "a1", {"root.over+(-)", "a.over+(-)", "a1.over+(-)"}},
      {"to another branch", PointF(25, 25), PointF(110, 120), "b",
       {"a.mouse(a)", "a1.mouse(a1)", "a.over-(-)", "a1.over-(-)", "b.over+(-)"}},
      {"within the leaf", PointF(25, 25), PointF(26, 27), "a1", {}},
      {"from a child to its parent", PointF(25, 25), PointF(60, 60), "a", {"a1.mouse(a1)", "a1.over-(-)", "a.over+(-)"}},
      {"from a parent into its child", PointF(60, 60), PointF(25, 25), "a1", {"a.over-(-)", "a1.over+(-)"}},
  };
  for (const Row& row : rows) {
    SCOPED_TRACE(row.name);
    if (row.from) MoveTo(*row.from);
    log.Clear();
    MoveTo(row.to);
    EXPECT_EQ(log.Texts(), row.log);
    UI_Node* leaf = manager.GetMouseOverLeafNode();
    ASSERT_NE(leaf, nullptr);
    EXPECT_EQ(leaf->UI_GetNodeID(), row.leaf);
    EXPECT_EQ(manager.GetMouseOverRootNode(), root.get());
    for (const EventViewP& v : {root, a, a1, b}) {
      bool onChain = false;
      for (UI_Node* n = leaf; n; n = n->UI_GetParentNode()) onChain |= n == v.get();
      EXPECT_EQ(Over(v), onChain) << v->UI_GetNodeID();
      EXPECT_EQ(v->UI_IsMouseOver(true), v.get() == leaf) << v->UI_GetNodeID();
    }
    MoveTo(PointF(-5, -5));  // out of the root again
  }
}

TEST_F(MouseOverTest, NodesThatTheMouseLeavesHearAnUpdateEventInTheirOwnCoordinates) {
  MoveTo(PointF(25, 25));
  log.Clear();
  MoveTo(PointF(110, 120));
  EventRecord exitA = log.Find("a", "mouse");
  EventRecord exitA1 = log.Find("a1", "mouse");
  EXPECT_EQ(exitA.action, MouseEvent::kActionMouseOver);
  EXPECT_EQ(exitA.position, PointF(100, 110));
  EXPECT_EQ(exitA1.position, PointF(90, 100));
}

TEST_F(MouseOverTest, TheNotificationRunsOnlyOnceTheWholeChainIsConsistent) {
  MoveTo(PointF(25, 25));
  bool a1StillOverWhenATold = true;
  a->onMouseOverChanged = [&](bool) { a1StillOverWhenATold = a1->UI_IsMouseOver(); };
  MoveTo(PointF(110, 120));
  EXPECT_FALSE(a1StillOverWhenATold);
}

TEST_F(MouseOverTest, NodesThatAskForItAreInvalidatedWhenTheirHoverChanges) {
  a1->invalidateWhenLeaf = true;
  a->invalidateWhenOnChain = true;
  int a1Before = a1->invalidations, aBefore = a->invalidations, bBefore = b->invalidations;
  MoveTo(PointF(25, 25));
  EXPECT_GT(a1->invalidations, a1Before);
  EXPECT_GT(a->invalidations, aBefore);
  EXPECT_EQ(b->invalidations, bBefore);
}

TEST_F(MouseOverTest, NothingChangesWhileMouseOverUpdatesAreSuspended) {
  MoveTo(PointF(25, 25));
  log.Clear();
  {
    UI_NodeManager::SuspendMouseOverUpdates suspend(&manager);
    MoveTo(PointF(110, 120));
    UI_Node::UI_MouseExited(nullptr, root.get());
  }
  EXPECT_EQ(manager.GetMouseOverLeafNode(), a1.get());
  EXPECT_THAT(log.Texts(), IsEmpty());
}

TEST_F(MouseOverTest, TheMouseLeavingTheWindowLeavesEveryNodeOfTheWindow) {
  MoveTo(PointF(25, 25));
  log.Clear();
  MouseEvent leave = MouseAt(MouseEvent::kActionMouseOver, PointF(250, 250), 0, 0);
  UI_Node::UI_MouseExited(&leave, root.get());
  EXPECT_EQ(manager.GetMouseOverLeafNode(), nullptr);
  EXPECT_FALSE(Over(root) || Over(a) || Over(a1));
  EXPECT_THAT(log.Texts("mouse"), ElementsAre("root.mouse(root)", "a.mouse(a)", "a1.mouse(a1)"));
  EXPECT_EQ(log.Find("a1", "mouse").position, PointF(230, 230));
}

TEST_F(MouseOverTest, LeavingASubtreeMakesItsParentTheLeaf) {
  MoveTo(PointF(25, 25));
  log.Clear();
  UI_Node::UI_MouseExited(nullptr, a.get());
  EXPECT_EQ(manager.GetMouseOverLeafNode(), root.get());
  EXPECT_TRUE(Over(root));
  EXPECT_FALSE(Over(a) || Over(a1));
  EXPECT_THAT(log.Texts("mouse"), IsEmpty()) << "without an event nobody hears an exit";
  EXPECT_THAT(log.Texts(), ElementsAre("a.over-(-)", "a1.over-(-)"));
}

TEST_F(MouseOverTest, LeavingAWindowThatIsNotUnderTheMouseChangesNothing) {
  MoveTo(PointF(25, 25));
  log.Clear();
  UI_Node::UI_MouseExited(nullptr, b.get());
  EXPECT_EQ(manager.GetMouseOverLeafNode(), a1.get());
  EXPECT_THAT(log.Texts(), IsEmpty());
}

TEST_F(MouseOverTest, InvalidatingHoverNodesWalksFromTheLeafUpToThoseThatAsk) {
  MoveTo(PointF(25, 25));
  a->invalidateWhenOnChain = true;
  b->invalidateWhenLeaf = true;
  int aBefore = a->invalidations, a1Before = a1->invalidations, bBefore = b->invalidations;
  UI_Node::UI_InvalidateMouseOverNodes();
  EXPECT_GT(a->invalidations, aBefore);
  EXPECT_EQ(a1->invalidations, a1Before);
  EXPECT_EQ(b->invalidations, bBefore) << "b is not under the mouse";
}

TEST_F(MouseOverTest, ANodeThatDeletesItselfInItsExitHandlerDoesNotStopTheOthersLeaving) {
  MoveTo(PointF(25, 25));
  bool destroyed = false;
  a1->destroyedFlag = &destroyed;
  EventView* raw = a1.get();
  a1.reset();
  raw->onMouse = [&](UI_Node*, const MouseEvent&) {
    a->ChildRemove(raw);
    return false;
  };
  MoveTo(PointF(110, 120));
  EXPECT_TRUE(destroyed);
  EXPECT_FALSE(Over(a));
  EXPECT_EQ(manager.GetMouseOverLeafNode(), b.get());
}

TEST_F(MouseOverTest, AnExitHandlerThatDeletesTheWholeOldBranchIsSafe) {
  MoveTo(PointF(25, 25));
  bool aDestroyed = false;
  a->destroyedFlag = &aDestroyed;
  EventView* raw = a.get();
  a.reset();
  a1.reset();
  raw->onMouse = [&](UI_Node*, const MouseEvent&) {
    root->ChildRemove(raw);
    return false;
  };
  MoveTo(PointF(110, 120));
  EXPECT_TRUE(aDestroyed);
  EXPECT_EQ(manager.GetMouseOverLeafNode(), b.get());
  EXPECT_TRUE(Over(b));
}

TEST_F(MouseOverTest, RemovingTheLeafFromTheTreeHandsTheStateToItsParent) {
  MoveTo(PointF(25, 25));
  a->ChildRemove(a1.get());
  EXPECT_EQ(manager.GetMouseOverLeafNode(), a.get());
  log.Clear();
  MoveTo(PointF(110, 120));
  EXPECT_THAT(log.Texts("over+"), ElementsAre("b.over+(-)"));
  EXPECT_FALSE(Over(a));
}

}  // namespace
}  // namespace norvik::ui::test
