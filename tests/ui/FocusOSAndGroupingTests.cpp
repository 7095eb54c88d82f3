// Focus as the native window system moves it (set-focus and kill-focus
// messages of a window), grouping of focus changes, and the plain focus
// accessors.
#include <string>

#include <gtest/gtest.h>

#include "support/ui/FocusTestNodes.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {
namespace {

using test::AddPanel;
using test::AddView;
using test::FocusableViewP;
using test::FocusLeafID;
using test::FocusLog;

class FocusOSTest : public ::testing::Test {
 protected:
  FocusOSTest() : mWindow(new test::TestWindowNode), mOther(new test::TestWindowNode) {
    mOther->UI_SetNodeID("other");
    mWindow->SetFocusLog(&mLog);
    mOther->SetFocusLog(&mLog);
    mManager.SetFocusPlatform(&mPlatform);
    mPlatform.mWindows[kWindowHandle] = {mWindow.get(), false, 0};
    mPlatform.mWindows[kOtherHandle] = {mOther.get(), false, 0};
  }
  ~FocusOSTest() override { mManager.SetFocusPlatform(nullptr); }

  static constexpr OS_WindowHandle kWindowHandle = 100;
  static constexpr OS_WindowHandle kOtherHandle = 200;

  UI_NodeManager mManager;
  test::TableFocusPlatform mPlatform;
  FocusLog mLog;
  boost::intrusive_ptr<test::TestWindowNode> mWindow;
  boost::intrusive_ptr<test::TestWindowNode> mOther;
};

// ---------------------------------------------------------------- set focus

TEST_F(FocusOSTest, SetFocusWithNoLeafGivesTheWindowFocusAsARestore) {
  UI_Node::UI_OSSetFocus(mWindow.get(), false);
  EXPECT_EQ(FocusLeafID(), "window");
  EXPECT_EQ(mLog, (FocusLog{{"window", kFocusChangeRestore, true}}));
  EXPECT_EQ(mWindow->mOSSetFocusCalls, 1);
}

TEST_F(FocusOSTest, SetFocusWithSuspendDoesNotTellThePlatformBack) {
  UI_Node::UI_OSSetFocus(mWindow.get(), true);
  EXPECT_EQ(FocusLeafID(), "window");
  EXPECT_EQ(mWindow->mOSSetFocusCalls, 0);
  EXPECT_FALSE(mManager.IsSuspendingOSFocusChanges());
}

TEST_F(FocusOSTest, SetFocusOnTheWindowThatHoldsFocusChangesNothing) {
  FocusableViewP field = AddView(*mWindow, "field", &mLog);
  field->UI_GainKeyboardFocus(kFocusChangeMouse);
  mLog.clear();
  UI_Node::UI_OSSetFocus(mWindow.get(), false);
  EXPECT_EQ(FocusLeafID(), "field");
  EXPECT_TRUE(mLog.empty());
}

TEST_F(FocusOSTest, SetFocusOnAnotherWindowMovesFocusThere) {
  FocusableViewP field = AddView(*mWindow, "field", &mLog);
  field->UI_GainKeyboardFocus(kFocusChangeMouse);
  mLog.clear();
  UI_Node::UI_OSSetFocus(mOther.get(), false);
  EXPECT_EQ(FocusLeafID(), "other");
  EXPECT_FALSE(field->UI_HasKeyboardFocus(false));
  EXPECT_FALSE(mWindow->UI_HasKeyboardFocus(false));
}

TEST_F(FocusOSTest, FocusMessagesWhileFocusIsBeingUpdatedAreIgnored) {
  UI_NodeManager::ScUpdatingFocus updating(&mManager);
  UI_Node::UI_OSSetFocus(mWindow.get(), false);
  EXPECT_EQ(FocusLeafID(), "");
  mManager.SetKeyboardFocusLeafNode(mWindow.get());
  UI_Node::UI_OSKillFocus(mWindow.get(), 0);
  EXPECT_EQ(FocusLeafID(), "window");
  EXPECT_TRUE(mLog.empty());
}

// ---------------------------------------------------------------- kill focus

// Each row loses the window's focus to another native window: one of ours
// (directly, or through foreign children) takes it over; anything else loses it.
TEST_F(FocusOSTest, KillFocusHandsFocusToOurWindowThatGetsItOrElseLosesIt) {
  mPlatform.mWindows[999] = {nullptr, false, 0};             // someone else's top level
  mPlatform.mWindows[300] = {nullptr, true, 301};            // a foreign child ...
  mPlatform.mWindows[301] = {nullptr, true, kOtherHandle};   // ... in a foreign child of ours
  mPlatform.mWindows[400] = {nullptr, true, 401};            // a child ...
  mPlatform.mWindows[401] = {nullptr, false, 0};             // ... of a foreign top level
  const struct {
    OS_WindowHandle to;
    test::FocusEvent last;
  } rows[] = {
      {999, {"field", kFocusChangeLoss, false}},
      {kOtherHandle, {"other", kFocusChangeHandOver, true}},
      {300, {"other", kFocusChangeHandOver, true}},
      {400, {"field", kFocusChangeLoss, false}},
  };
  for (const auto& row : rows) {
    SCOPED_TRACE(row.to);
    mWindow->DeleteChildren();
    FocusableViewP field = AddView(*mWindow, "field", &mLog);
    field->UI_GainKeyboardFocus(kFocusChangeMouse);
    mLog.clear();
    UI_Node::UI_OSKillFocus(mWindow.get(), row.to);
    const bool lost = row.last.reason == kFocusChangeLoss;
    EXPECT_EQ(FocusLeafID(), lost ? "" : "other");
    EXPECT_FALSE(field->UI_HasKeyboardFocus(false));
    EXPECT_FALSE(mWindow->UI_HasKeyboardFocus(false));
    ASSERT_FALSE(mLog.empty());
    EXPECT_EQ(mLog.back(), row.last);
    if (lost) {
      EXPECT_EQ(mManager.GetPreviousKeyboardFocusLeafNode(), field.get());
    }
  }
  EXPECT_EQ(mOther->mOSSetFocusCalls, 0) << "the platform already knows; it is not told again";
}

TEST_F(FocusOSTest, WithoutAFocusPlatformKillFocusIsALoss) {
  mManager.SetFocusPlatform(nullptr);
  mWindow->UI_GainKeyboardFocus(kFocusChangeMouse);
  UI_Node::UI_OSKillFocus(mWindow.get(), kOtherHandle);
  EXPECT_EQ(FocusLeafID(), "");
}

// ---------------------------------------------------------------- grouping

TEST_F(FocusOSTest, GroupingTakesFocusOutOfTheTreeAndThenMovesTheLeafButNoFlagTellingNobody) {
  FocusableViewP a = AddView(*mWindow, "a", &mLog);
  FocusableViewP b = AddView(*mWindow, "b", &mLog);
  a->UI_GainKeyboardFocus(kFocusChangeMouse);
  mLog.clear();
  {
    UI_NodeManager::GroupingFocusChanges group(&mManager, false);
    EXPECT_TRUE(mManager.IsGroupingFocusChanges());
    EXPECT_EQ(FocusLeafID(), "");
    EXPECT_FALSE(a->UI_HasKeyboardFocus(false));
    EXPECT_EQ(mLog, (FocusLog{{"window", kFocusChangeLoss, false}, {"a", kFocusChangeLoss, false}}));
    mLog.clear();
    EXPECT_TRUE(b->UI_GainKeyboardFocus(kFocusChangeMouse));
    EXPECT_EQ(FocusLeafID(), "b");
    EXPECT_FALSE(b->UI_HasKeyboardFocus(false));
    EXPECT_FALSE(mWindow->UI_HasKeyboardFocus(false));
    EXPECT_TRUE(mLog.empty());
  }
  EXPECT_FALSE(mManager.IsGroupingFocusChanges());
  EXPECT_EQ(FocusLeafID(), "b");
  EXPECT_TRUE(b->UI_HasKeyboardFocus(true));
  EXPECT_TRUE(mWindow->UI_HasKeyboardFocus(false));
  EXPECT_FALSE(a->UI_HasKeyboardFocus(false));
  EXPECT_EQ(mLog, (FocusLog{{"window", kFocusChangeRestore, true}, {"b", kFocusChangeRestore, true}}));
}

TEST_F(FocusOSTest, GroupingWithRestoreReturnsFocusToTheStartingLeafOrIfHiddenKeepsTheLast) {
  FocusableViewP a = AddView(*mWindow, "a", &mLog);
  FocusableViewP b = AddView(*mWindow, "b", &mLog);
  a->UI_GainKeyboardFocus(kFocusChangeMouse);
  {
    UI_NodeManager::GroupingFocusChanges group(&mManager, true);
    b->UI_GainKeyboardFocus(kFocusChangeMouse);
  }
  EXPECT_EQ(FocusLeafID(), "a");
  EXPECT_TRUE(a->UI_HasKeyboardFocus(true));
  EXPECT_FALSE(b->UI_HasKeyboardFocus(false));
  {
    UI_NodeManager::GroupingFocusChanges group(&mManager, true);
    b->UI_GainKeyboardFocus(kFocusChangeMouse);
    a->UI_Show(false);
  }
  EXPECT_EQ(FocusLeafID(), "b");
}

TEST_F(FocusOSTest, ANestedGroupIsInert) {
  FocusableViewP a = AddView(*mWindow, "a", &mLog);
  FocusableViewP b = AddView(*mWindow, "b", &mLog);
  a->UI_GainKeyboardFocus(kFocusChangeMouse);
  {
    UI_NodeManager::GroupingFocusChanges outer(&mManager, false);
    {
      UI_NodeManager::GroupingFocusChanges inner(&mManager, true);
      b->UI_GainKeyboardFocus(kFocusChangeMouse);
    }
    EXPECT_TRUE(mManager.IsGroupingFocusChanges());
    EXPECT_FALSE(b->UI_HasKeyboardFocus(false));
    EXPECT_EQ(FocusLeafID(), "b");
  }
  EXPECT_TRUE(b->UI_HasKeyboardFocus(true));
}

TEST_F(FocusOSTest, ANodeRemovedWhileGroupedIsNotRestored) {
  FocusableViewP panel = AddPanel(*mWindow, "panel", &mLog);
  FocusableViewP a = AddView(*panel, "a", &mLog);
  a->UI_GainKeyboardFocus(kFocusChangeMouse);
  {
    UI_NodeManager::GroupingFocusChanges group(&mManager, false);
    a->UI_GainKeyboardFocus(kFocusChangeMouse);
    mWindow->ChildRemove(panel.get());
    panel.reset();
    a.reset();
  }
  EXPECT_NE(FocusLeafID(), "a");
}

TEST_F(FocusOSTest, GroupingWithoutAnyFocusEndsWithoutFocus) {
  { UI_NodeManager::GroupingFocusChanges group(&mManager, true); }
  EXPECT_EQ(FocusLeafID(), "");
  EXPECT_TRUE(mLog.empty());
}

// ---------------------------------------------------------------- accessors

TEST_F(FocusOSTest, StaticAccessorsFollowTheManager) {
  FocusableViewP a = AddView(*mWindow, "a", &mLog);
  FocusableViewP b = AddView(*mWindow, "b", &mLog);
  a->UI_GainKeyboardFocus(kFocusChangeMouse);
  b->UI_GainKeyboardFocus(kFocusChangeMouse);
  EXPECT_EQ(UI_Node::UI_GetKeyboardFocusLeafNode(), b.get());
  EXPECT_EQ(UI_Node::UI_GetPreviousKeyboardFocusNode(), a.get());
  UI_Node::UI_ClearPreviousKeyboardFocus();
  EXPECT_EQ(UI_Node::UI_GetPreviousKeyboardFocusNode(), nullptr);
  EXPECT_EQ(UI_Node::UI_GetKeyboardFocusLeafNode(), b.get());
}

TEST_F(FocusOSTest, SettingTheLeafNodeTellsThePlatformThroughTheWindow) {
  FocusableViewP a = AddView(*mWindow, "a", &mLog);
  const int before = mWindow->mOSSetFocusCalls;
  UI_Node::UI_SetKeyboardFocusLeafNode(a.get());
  EXPECT_EQ(mWindow->mOSSetFocusCalls, before + 1);
  UI_Node::UI_SetKeyboardFocusLeafNode(nullptr);
  EXPECT_EQ(mWindow->mOSSetFocusCalls, before + 1);
}

TEST_F(FocusOSTest, FirstFocusableChildIsFoundDepthFirstInChildOrder) {
  FocusableViewP panel = AddPanel(*mWindow, "panel");
  FocusableViewP inner = AddPanel(*panel, "inner");
  FocusableViewP deep = AddView(*inner, "deep");
  AddView(*panel, "later");
  AddView(*mWindow, "sibling");
  EXPECT_EQ(mWindow->UI_GetFirstFocusableChildNode(), deep.get());
  deep->mWantsFocus = false;
  EXPECT_EQ(std::string(mWindow->UI_GetFirstFocusableChildNode()->UI_GetNodeID().c_str()), "later");
  EXPECT_EQ(deep->UI_GetFirstFocusableChildNode(), nullptr);
}

TEST(FocusWithoutManager, AccessorsAndNativeMessagesAnswerNothing) {
  ASSERT_EQ(UI_NodeManager::Get(), nullptr);
  EXPECT_EQ(UI_Node::UI_GetKeyboardFocusLeafNode(), nullptr);
  EXPECT_EQ(UI_Node::UI_GetPreviousKeyboardFocusNode(), nullptr);
  boost::intrusive_ptr<test::TestWindowNode> window(new test::TestWindowNode);
  UI_Node::UI_OSSetFocus(window.get(), true);
  UI_Node::UI_OSKillFocus(window.get(), 0);
  EXPECT_FALSE(window->UI_HasKeyboardFocus(false));
}

}  // namespace
}  // namespace norvik::ui
