// Mouse filters: they run once per event, at the delivery to the leaf and in
// the leaf's coordinates, after the first-chance passes; a filter that claims
// the event keeps it from the leaf and its ancestors. The pass works on a
// copy of the list, so filters may remove themselves or each other.
#include <functional>

#include <boost/make_shared.hpp>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/ui/DispatchTestNodes.h"

namespace norvik::ui::test {
namespace {

using ::testing::ElementsAre;

class MouseFilterTest : public DispatchTest {
 protected:
  MouseFilterTest() {
    panel = View("panel", 20, 20, 100, 100, root.get());
    button = View("button", 10, 10, 30, 30, panel.get());
    popup = View("popup", 150, 150, 40, 40, root.get());
    other = View("other", 0, 0, 10, 10, nullptr);
  }
  bool Click(const PointF& inPoint) {
    return root->UI_DispatchMouseEvent(MouseAt(MouseEvent::kActionButtonDown, inPoint), true);
  }

  EventViewP panel, button, popup, other;
};

// Each row sets up filters on a fresh tree and clicks the button; the log
// lists every node that saw the click, in order.
TEST_F(MouseFilterTest, FiltersSeeTheClickFirstNewestFirstAndAClaimHidesItFromAllButFirstChanceNodes) {
  struct Row {
    const char* name;
    std::function<void()> setUp;
    bool claimed;
    std::vector<std::string> seen;
  };
  const Row rows[] = {
      {"one filter", [this] { manager.AddMouseEventFilterNode(popup.get()); }, false,
       {"popup.pre(button)", "button.mouse(button)", "panel.mouse(button)", "root.mouse(button)"}},
      {"a claiming filter and a first-chance panel",
       [this] {
         panel->UI_SetStateFlags(panel->UI_GetStateFlags().Set(UI_Node::kStateFirstChanceMouse));
         popup->handlesPreMouse = true;
         manager.AddMouseEventFilterNode(popup.get());
       },
       true, {"panel.mouse(-)", "popup.pre(button)"}},
      {"the newer filter claims",
       [this] {
         manager.AddMouseEventFilterNode(other.get());
         manager.AddMouseEventFilterNode(popup.get());
         popup->handlesPreMouse = true;
       },
       true, {"popup.pre(button)"}},
      {"a disabled leaf",
       [this] {
         button->UI_SetSelfDisabled(true);
         manager.AddMouseEventFilterNode(popup.get());
       },
       false, {"popup.pre(button)", "panel.mouse(button)", "root.mouse(button)"}},
  };
  for (const Row& row : rows) {
    SCOPED_TRACE(row.name);
    root->DeleteChildren();
    panel = View("panel", 20, 20, 100, 100, root.get());
    button = View("button", 10, 10, 30, 30, panel.get());
    popup = View("popup", 150, 150, 40, 40, root.get());
    other = View("other", 0, 0, 10, 10, nullptr);
    row.setUp();
    log.Clear();
    EXPECT_EQ(Click(PointF(35, 36)), row.claimed);
    EXPECT_EQ(log.Texts(), row.seen);
    EXPECT_EQ(log.Find("popup", "pre").position, PointF(5, 6)) << "in the leaf's coordinates";
    manager.RemoveMouseEventFilterNode(popup.get());
    manager.RemoveMouseEventFilterNode(other.get());
  }
}

TEST_F(MouseFilterTest, AFilterThatRemovesItselfLeavesTheOthersInThePass) {
  manager.AddMouseEventFilterNode(other.get());
  manager.AddMouseEventFilterNode(popup.get());
  popup->onPreMouse = [&](UI_Node*, const MouseEvent&) {
    manager.RemoveMouseEventFilterNode(popup.get());
    return false;
  };
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts("pre"), ElementsAre("popup.pre(button)", "other.pre(button)"));
  EXPECT_EQ(manager.GetMouseEventFiltersSize(), 1u);
  log.Clear();
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts("pre"), ElementsAre("other.pre(button)"));
}

TEST_F(MouseFilterTest, AFilterDestroyedByAnEarlierOneStaysAliveUntilThePassIsOver) {
  bool destroyed = false;
  other->destroyedFlag = &destroyed;
  manager.AddMouseEventFilterNode(other.get());
  manager.AddMouseEventFilterNode(popup.get());
  popup->onPreMouse = [&](UI_Node*, const MouseEvent&) {
    manager.RemoveMouseEventFilterNode(other.get());
    other.reset();
    return false;
  };
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts("pre"), ElementsAre("popup.pre(button)", "other.pre(button)"));
  EXPECT_TRUE(destroyed) << "the pass's reference is the last one";
}

TEST_F(MouseFilterTest, AFilterAddedDuringThePassWaitsForTheNextEvent) {
  manager.AddMouseEventFilterNode(popup.get());
  popup->onPreMouse = [&](UI_Node*, const MouseEvent&) {
    if (manager.GetMouseEventFiltersSize() == 1) manager.AddMouseEventFilterNode(other.get());
    return false;
  };
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts("pre"), ElementsAre("popup.pre(button)"));
  log.Clear();
  Click(PointF(35, 35));
  EXPECT_THAT(log.Texts("pre"), ElementsAre("other.pre(button)", "popup.pre(button)"));
}

TEST_F(MouseFilterTest, ACustomPreMouseFunctionCanAnswerForTheFilter) {
  manager.AddMouseEventFilterNode(popup.get());
  bool takeOver = true;
  popup->UI_SetCustomPreMouseEventFunction(boost::make_shared<boost::function<bool(UI_Node*, const MouseEvent&, bool&)>>(
      [&](UI_Node* inLeaf, const MouseEvent&, bool& outTookOver) {
        EXPECT_EQ(inLeaf, button.get());
        outTookOver = takeOver;
        return true;
      }));
  EXPECT_TRUE(Click(PointF(35, 35)));
  EXPECT_TRUE(log.Texts().empty());
  takeOver = false;
  EXPECT_FALSE(Click(PointF(35, 35)));
  EXPECT_THAT(log.Texts(), ElementsAre("popup.pre(button)", "button.mouse(button)", "panel.mouse(button)",
                                       "root.mouse(button)"));
}

}  // namespace
}  // namespace norvik::ui::test
