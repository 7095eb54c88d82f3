// Focus advance with Tab: order, nesting, wrapping, containers that keep Tab
// inside, hidden and disabled subtrees, tab weights, the Tab key itself, and
// host code that changes the tree during the walk.
#include <cctype>
#include <functional>
#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/ui/FocusTestNodes.h"
#include "tarsel/ThrowError.h"
#include "ui/KeyboardEvent.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {
namespace {

using test::AddPanel;
using test::AddView;
using test::FocusableViewP;
using test::FocusLeafID;
using test::FocusLog;

class FocusAdvanceTest : public ::testing::Test {
 protected:
  FocusAdvanceTest() : mWindow(new test::TestWindowNode) {
    mWindow->mWantsFocus = false;
    mManager.SetFocusPlatform(&mPlatform);
  }
  ~FocusAdvanceTest() override { mManager.SetFocusPlatform(nullptr); }

  // Tab (or Shift+Tab) from the current focus leaf.
  bool Tab(bool inForward = true) {
    UI_Node* leaf = mManager.GetKeyboardFocusLeafNode();
    return UI_Node::UI_AdvanceFocus(inForward, leaf->UI_GetIndex(), leaf->UI_GetParentContainer());
  }

  UI_NodeManager mManager;
  test::TableFocusPlatform mPlatform;
  boost::intrusive_ptr<test::TestWindowNode> mWindow;
};

// Builds children of inParent from a line such as "a b! panel[c d] e": a name
// is a focusable view; after it, "!" wants no focus, "~" refuses focus only
// from Tab and "-" disables the view itself once its children are in. Brackets
// give children: "[...]" to a panel that never takes focus, "{...}" to a panel
// that keeps Tab among its children.
void Build(UI_Node& inParent, const std::string& inSpec, std::size_t& ioAt) {
  auto at = [&](char inChar) { return ioAt < inSpec.size() && inSpec[ioAt] == inChar; };
  while (ioAt < inSpec.size() && !at(']') && !at('}')) {
    if (at(' ')) {
      ++ioAt;
      continue;
    }
    std::string name;
    while (ioAt < inSpec.size() && std::isalpha(static_cast<unsigned char>(inSpec[ioAt]))) name += inSpec[ioAt++];
    const bool panel = at('[') || at('{');
    FocusableViewP view = panel ? AddPanel(inParent, name) : AddView(inParent, name);
    if (at('!')) view->mWantsFocus = false;
    if (at('~')) view->mWantsFocusFromAdvance = false;
    const bool selfDisabled = at('-');
    if (at('{')) view->mAllowAdvanceFromChildren = false;
    if (at('!') || at('~') || at('-')) ++ioAt;
    if (at('[') || at('{')) {
      Build(*view, inSpec, ++ioAt);
      ++ioAt;
    }
    if (selfDisabled) view->UI_SetSelfDisabled(true);  // after the children, which stay enabled
  }
}

UI_Node* FindByID(UI_Node& inRoot, const std::string& inID);

struct WalkCase {
  const char* tree;
  const char* from;
  bool forward;
  const char* to;
};
const WalkCase kWalks[] = {
    {"a b! c", "a", true, "c"},                // a node that wants no focus is passed over
    {"a b~ c", "a", true, "c"},                // so is one that refuses it only from Tab
    {"a panel[b c] d", "c", true, "d"},        // out of a panel to its next sibling
    {"a panel[b c]", "b", false, "a"},         // backward out of a panel
    {"a panel[b] d", "d", true, "a"},          // wrapping at the top, both ways
    {"a panel[b] d", "a", false, "d"},
    {"a panel[b] d", "b", false, "a"},
    {"panel[b c] d", "d", false, "c"},         // backward into a panel lands on its last child
    {"a panel{b c} d", "c", true, "b"},        // a panel keeping Tab wraps inside itself
    {"a panel{b c} d", "b", false, "c"},
    {"a group-[b] d", "a", true, "b"},         // a self-disabled node's children are searched
};

TEST_F(FocusAdvanceTest, TabWalksTheTreeInDocumentOrderAsEachRowSays) {
  for (const WalkCase& c : kWalks) {
    mWindow->DeleteChildren();
    std::size_t at = 0;
    Build(*mWindow, c.tree, at);
    UI_Node* from = FindByID(*mWindow, c.from);
    ASSERT_TRUE(from && from->UI_GainKeyboardFocus(kFocusChangeMouse)) << c.tree;
    EXPECT_TRUE(Tab(c.forward)) << c.tree;
    EXPECT_EQ(FocusLeafID(), c.to) << c.tree << (c.forward ? " forward from " : " backward from ") << c.from;
    EXPECT_FALSE(from->UI_HasKeyboardFocus(false)) << c.tree;
  }
}

TEST_F(FocusAdvanceTest, AHiddenSubtreeIsSearchedButNothingInItGainsFocus) {
  AddView(*mWindow, "a");
  FocusableViewP panel = AddPanel(*mWindow, "panel");
  FocusableViewP b = AddView(*panel, "b");
  AddView(*mWindow, "d");
  panel->UI_Show(false);
  mWindow->ChildGet(0)->UI_GainKeyboardFocus(kFocusChangeMouse);
  Tab();
  EXPECT_EQ(FocusLeafID(), "d");
  EXPECT_EQ(b->mPrepareCalls, 1);
  EXPECT_FALSE(b->UI_HasKeyboardFocus(false));
}

TEST_F(FocusAdvanceTest, ChildrenDisabledThroughTheirAncestorDoNotGainFocus) {
  AddView(*mWindow, "a");
  FocusableViewP group = AddPanel(*mWindow, "group");
  FocusableViewP b = AddView(*group, "b");
  AddView(*mWindow, "d");
  group->UI_SetDisabled(true);
  ASSERT_TRUE(b->UI_IsDisabled());
  mWindow->ChildGet(0)->UI_GainKeyboardFocus(kFocusChangeMouse);
  Tab();
  EXPECT_EQ(FocusLeafID(), "d");
  EXPECT_EQ(b->mPrepareCalls, 0);
}

TEST_F(FocusAdvanceTest, WithOneFocusableNodeTabKeepsItAndSendsNothing) {
  FocusLog log;
  FocusableViewP panel = AddPanel(*mWindow, "panel", &log);
  FocusableViewP only = AddView(*panel, "only", &log);
  AddPanel(*mWindow, "empty", &log);
  only->UI_GainKeyboardFocus(kFocusChangeMouse);
  log.clear();
  EXPECT_TRUE(Tab());
  EXPECT_EQ(FocusLeafID(), "only");
  EXPECT_TRUE(Tab(false));
  EXPECT_EQ(FocusLeafID(), "only");
  EXPECT_TRUE(log.empty());
  EXPECT_TRUE(only->UI_HasKeyboardFocus(true));
}

TEST_F(FocusAdvanceTest, WhenNothingTakesFocusItStaysAndNoKeyIsRemoved) {
  FocusableViewP a = AddView(*mWindow, "a");
  a->mWantsFocusFromAdvance = false;
  AddPanel(*mWindow, "b");
  a->UI_GainKeyboardFocus(kFocusChangeMouse);
  EXPECT_FALSE(Tab());
  EXPECT_EQ(FocusLeafID(), "a");
  EXPECT_EQ(mPlatform.mKeyRemovals, 0);
}

TEST_F(FocusAdvanceTest, FocusMovedByTabIsReportedWithTheAdvanceReasonAndRemovesPendingKeys) {
  FocusLog log;
  FocusableViewP a = AddView(*mWindow, "a", &log);
  AddView(*mWindow, "b", &log);
  a->UI_GainKeyboardFocus(kFocusChangeMouse);
  log.clear();
  Tab();
  EXPECT_EQ(log, (FocusLog{{"a", kFocusChangeAdvance, false}, {"b", kFocusChangeAdvance, true}}));
  EXPECT_EQ(mPlatform.mKeyRemovals, 1);
}

TEST_F(FocusAdvanceTest, ANullParentIsAContractViolationAndAnEmptyWindowFindsNothing) {
  EXPECT_THROW(UI_Node::UI_AdvanceFocus(true, 0, nullptr), tarsel::config::Exception);
  EXPECT_FALSE(UI_Node::UI_AdvanceFocus(true, -1, mWindow.get()));
  EXPECT_FALSE(UI_Node::UI_AdvanceFocus(false, -1, mWindow.get()));
}

TEST_F(FocusAdvanceTest, TabWeightsOrderTheWalk) {
  FocusableViewP a = AddView(*mWindow, "a");
  FocusableViewP b = AddView(*mWindow, "b");
  FocusableViewP c = AddView(*mWindow, "c");
  a->UI_SetTabOrderWeight(2);
  b->UI_SetTabOrderWeight(1);
  c->UI_SetTabOrderWeight(0);
  EXPECT_TRUE(UI_Node::UI_AdvanceFocus(true, -1, mWindow.get()));
  EXPECT_EQ(FocusLeafID(), "c");
  EXPECT_TRUE(UI_Node::UI_AdvanceFocus(false, -1, mWindow.get()));
  EXPECT_EQ(FocusLeafID(), "a");
}

TEST_F(FocusAdvanceTest, NextFocusIndexSortsByWeightThenIndexAndReportsWraps) {
  FocusableViewP a = AddView(*mWindow, "a");
  FocusableViewP b = AddView(*mWindow, "b");
  FocusableViewP c = AddView(*mWindow, "c");
  FocusableViewP d = AddView(*mWindow, "d");
  a->UI_SetTabOrderWeight(5);
  c->UI_SetTabOrderWeight(5);
  // Sorted: b(0,1) d(0,3) a(5,0) c(5,2).
  EXPECT_EQ(mWindow->UI_GetNextFocusIndex(1, -1), std::make_pair(false, 1));
  EXPECT_EQ(mWindow->UI_GetNextFocusIndex(-1, -1), std::make_pair(false, 2));
  EXPECT_EQ(mWindow->UI_GetNextFocusIndex(1, 0), std::make_pair(false, 3));
  EXPECT_EQ(mWindow->UI_GetNextFocusIndex(1, 3), std::make_pair(true, 1));
  EXPECT_EQ(mWindow->UI_GetNextFocusIndex(-1, 0), std::make_pair(true, 2));
  // The index is used as a position in the sorted order, so it is not
  // symmetric once weights are in use: forward from b's index lands on d.
  EXPECT_EQ(mWindow->UI_GetNextFocusIndex(1, b->UI_GetIndex()), std::make_pair(false, 0));
}

TEST_F(FocusAdvanceTest, TheTabCacheFollowsChangesToTheChildren) {
  FocusableViewP a = AddView(*mWindow, "a");
  FocusableViewP b = AddView(*mWindow, "b");
  b->UI_SetTabOrderWeight(0);
  a->UI_SetTabOrderWeight(1);
  EXPECT_EQ(mWindow->UI_GetNextFocusIndex(1, -1), std::make_pair(false, 1));
  FocusableViewP c = AddView(*mWindow, "c");  // weight 0, after b
  EXPECT_EQ(mWindow->UI_GetNextFocusIndex(1, 0), std::make_pair(false, 2));
  mWindow->ChildRemove(b.get());
  EXPECT_EQ(mWindow->UI_GetNextFocusIndex(1, -1), std::make_pair(false, 1));  // c, now at index 1
}

TEST_F(FocusAdvanceTest, AnOutOfRangeIndexStillLandsOnAChild) {
  AddView(*mWindow, "a");
  AddView(*mWindow, "b");
  const auto next = mWindow->UI_GetNextFocusIndex(-1, -7);
  EXPECT_GE(next.second, 0);
  EXPECT_LT(next.second, 2);
  const auto far = mWindow->UI_GetNextFocusIndex(1, 12345);
  EXPECT_GE(far.second, 0);
  EXPECT_LT(far.second, 2);
}

TEST_F(FocusAdvanceTest, AHandlerThatRemovesThePanelDuringTheWalkDoesNotCrash) {
  AddView(*mWindow, "a");
  FocusableViewP panel = AddPanel(*mWindow, "panel");
  FocusableViewP b = AddView(*panel, "b");
  b->mWantsFocus = false;
  FocusableViewP c = AddView(*panel, "c");
  AddView(*mWindow, "d");
  UI_Node* window = mWindow.get();
  b->mOnPrepare = [window, raw = panel.get()] { window->ChildRemove(raw); };
  panel.reset();
  b.reset();
  c.reset();
  window->ChildGet(0)->UI_GainKeyboardFocus(kFocusChangeMouse);
  EXPECT_TRUE(Tab());
  EXPECT_EQ(mWindow->ChildSize(), 2u);
  // The panel left with b and c; the walk went on to what is still there.
  EXPECT_EQ(FocusLeafID(), "d");
}

TEST_F(FocusAdvanceTest, AHandlerThatEmptiesTheWindowEndsTheWalk) {
  FocusableViewP a = AddView(*mWindow, "a");
  FocusableViewP b = AddView(*mWindow, "b");
  b->mWantsFocus = false;
  UI_Node* window = mWindow.get();
  b->mOnPrepare = [window] { window->DeleteChildren(); };
  a->UI_GainKeyboardFocus(kFocusChangeMouse);
  a.reset();
  b.reset();
  EXPECT_FALSE(Tab());
  EXPECT_EQ(mWindow->ChildSize(), 0u);
}

// ---------------------------------------------------------------- the key

KeyboardEvent TabKey(KeyboardEvent::Action inAction, unsigned char inMods) {
  return KeyboardEvent(inAction, 9, 9, ModifierKeys(inMods), false, OS_Event());
}

// Each row sends one key to the window with "b" of "a b c" focused (or no
// target at all) and says whether it was taken and where focus is then.
TEST_F(FocusAdvanceTest, OnlyTabOrShiftTabKeyDownsAdvanceFromTheTargetIgnoringCapsLock) {
  AddView(*mWindow, "a");
  FocusableViewP b = AddView(*mWindow, "b");
  AddView(*mWindow, "c");
  const struct {
    KeyboardEvent key;
    bool withTarget, taken;
    const char* to;
  } rows[] = {
      {TabKey(KeyboardEvent::kActionKeyDown, 0), true, true, "c"},
      {TabKey(KeyboardEvent::kActionKeyDown, kModKeyShift | kModKeyCapsLock), true, true, "a"},
      {TabKey(KeyboardEvent::kActionKeyUp, 0), true, false, "b"},
      {TabKey(KeyboardEvent::kActionKeyDown, kModKeyCtrl), true, false, "b"},
      {TabKey(KeyboardEvent::kActionKeyDown, kModKeyShift | kModKeyAlt), true, false, "b"},
      {KeyboardEvent(KeyboardEvent::kActionKeyDown, 'A', 65, ModifierKeys(), false, OS_Event()), true, false, "b"},
      {TabKey(KeyboardEvent::kActionKeyDown, 0), false, true, "b"},  // from child 0 forward
  };
  for (const auto& row : rows) {
    b->UI_GainKeyboardFocus(kFocusChangeMouse);
    EXPECT_EQ(UI_Node::UI_DoAdvanceKeyboardFocus(mWindow.get(), row.withTarget ? b.get() : nullptr, row.key), row.taken)
        << row.to;
    EXPECT_EQ(FocusLeafID(), row.to);
  }
}

// ---------------------------------------------------------------- generated trees

// Builds a random tree of panels (which never take focus, and may be empty)
// and focusable leaves; returns the leaves in document order.
void BuildRandomTree(UI_Node& ioParent, std::mt19937& ioRandom, int inDepth, std::vector<std::string>& outLeaves,
                     int& ioCounter) {
  const int children = std::uniform_int_distribution<int>(0, 4)(ioRandom);
  for (int i = 0; i < children; ++i) {
    const std::string id = std::to_string(ioCounter++);
    if (inDepth < 4 && std::uniform_int_distribution<int>(0, 2)(ioRandom) == 0) {
      FocusableViewP panel = AddPanel(ioParent, "panel" + id);
      BuildRandomTree(*panel, ioRandom, inDepth + 1, outLeaves, ioCounter);
    } else {
      AddView(ioParent, "leaf" + id);
      outLeaves.push_back("leaf" + id);
    }
  }
}

UI_Node* FindByID(UI_Node& inRoot, const std::string& inID) {
  for (auto it = inRoot.ChildBegin(); it != inRoot.ChildEnd(); ++it) {
    if (std::string((*it)->UI_GetNodeID().c_str()) == inID) return it->get();
    if (UI_Node* found = FindByID(**it, inID)) return found;
  }
  return nullptr;
}

TEST_F(FocusAdvanceTest, InRandomTreesTabVisitsEveryLeafInDocumentOrderAndShiftTabInReverse) {
  std::mt19937 random(20261122);
  for (int round = 0; round < 40; ++round) {
    mWindow->DeleteChildren();
    std::vector<std::string> leaves;
    int counter = 0;
    BuildRandomTree(*mWindow, random, 0, leaves, counter);
    if (leaves.empty()) continue;
    FindByID(*mWindow, leaves.front())->UI_GainKeyboardFocus(kFocusChangeMouse);
    for (std::size_t step = 1; step <= leaves.size(); ++step) {
      ASSERT_TRUE(Tab()) << "round " << round;
      ASSERT_EQ(FocusLeafID(), leaves[step % leaves.size()]) << "round " << round << " step " << step;
    }
    for (std::size_t step = 1; step <= leaves.size(); ++step) {
      ASSERT_TRUE(Tab(false)) << "round " << round;
      ASSERT_EQ(FocusLeafID(), leaves[(leaves.size() * 2 - step) % leaves.size()])
          << "round " << round << " back step " << step;
    }
  }
}

}  // namespace
}  // namespace norvik::ui
