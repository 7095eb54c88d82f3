// Node timers: installing through the window, replacing by id, firing
// through UI_DispatchPossibleTimer, the capture that sees its node's timers
// first, the tool tip timer, and timers that end with their view's move.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/ui/FocusTestNodes.h"
#include "support/ui/NodeTestSupport.h"
#include "ui/InputCapture.h"
#include "ui/MessageT.h"
#include "ui/UI_NodeManager.h"
#include "ui/UI_ToolTipManager.h"

namespace norvik::ui {
namespace {

using test::AddView;
using test::FocusableViewP;

UI_Node::TimerFunction TimerNotification(std::function<bool(long)> inFunction) {
  return MakeNotification<bool(long)>(std::move(inFunction));
}

class NodeTimerTest : public ::testing::Test {
 protected:
  NodeTimerTest() : mWindow(new test::TestWindowNode), mView(AddView(*mWindow, "view")) {}

  // The key of the view's only timer.
  long OnlyKey() const {
    EXPECT_EQ(mView->UI_GetTimerIDs().size(), 1u);
    return mView->UI_GetTimerIDs().empty() ? 0 : mView->UI_GetTimerIDs().front();
  }

  UI_NodeManager mManager;
  boost::intrusive_ptr<test::TestWindowNode> mWindow;
  FocusableViewP mView;
};

TEST_F(NodeTimerTest, InstallingTheSameIDTwiceKeepsOneTimerWithTheLaterInterval) {
  mView->UI_InstallTimer(0.5f, 7);
  mView->UI_InstallTimer(0.25f, 7);
  EXPECT_EQ(mWindow->Timers().GetTimerCount(), 1u);
  EXPECT_FLOAT_EQ(mWindow->Timers().GetTimerData(OnlyKey())->GetSeconds(), 0.25f);
  EXPECT_EQ(mWindow->CreatedTimers().size(), 2u);
}

TEST_F(NodeTimerTest, ANodeOutsideAnyWindowInstallsNothing) {
  FocusableViewP loose(new test::FocusableView);
  loose->UI_InstallTimer(0.1f, 3);
  EXPECT_TRUE(loose->UI_GetTimerIDs().empty());
  EXPECT_FALSE(loose->UI_RemoveTimer(3, false));
  EXPECT_EQ(mWindow->Timers().GetTimerCount(), 0u);
}

TEST_F(NodeTimerTest, ATimerLivesWhileItsNotificationAnswersTrue) {
  int calls = 0;
  mView->UI_InstallTimerNotifyFunction(TimerNotification([&](long id) {
    EXPECT_EQ(id, 7);
    return ++calls < 3;
  }));
  mView->UI_InstallTimer(0.1f, 7);
  const long key = OnlyKey();
  EXPECT_TRUE(mWindow->UI_DispatchPossibleTimer(key));
  EXPECT_TRUE(mWindow->UI_DispatchPossibleTimer(key));
  EXPECT_EQ(mWindow->Timers().GetTimerCount(), 1u);
  EXPECT_TRUE(mWindow->UI_DispatchPossibleTimer(key));  // answers false: the timer ends
  EXPECT_FALSE(mWindow->UI_DispatchPossibleTimer(key));  // a late message is not ours
  EXPECT_EQ(calls, 3);
  EXPECT_TRUE(mView->UI_GetTimerIDs().empty());
}

TEST_F(NodeTimerTest, ATimerEndsAtItsFirstFiringWhenNoNotificationAnswersTrue) {
  int calls = 0;
  mView->UI_InstallTimerNotifyFunction(TimerNotification([&](long) { ++calls; return false; }));
  mView->UI_InstallTimer(0.1f, 7);
  const long key = OnlyKey();
  mWindow->UI_DispatchPossibleTimer(key);
  mWindow->UI_DispatchPossibleTimer(key);
  EXPECT_EQ(calls, 1);
  FocusableViewP silent = AddView(*mWindow, "silent");
  silent->UI_InstallTimer(0.1f, 8);
  EXPECT_TRUE(mWindow->UI_DispatchPossibleTimer(silent->UI_GetTimerIDs().front())) << "no notification at all";
  EXPECT_EQ(mWindow->Timers().GetTimerCount(), 0u);
}

TEST_F(NodeTimerTest, NotificationsAreAskedInOrderUntilOneAnswersTrue) {
  std::vector<std::string> calls;
  mView->UI_InstallTimerNotifyFunction(TimerNotification([&](long) { calls.push_back("a"); return false; }));
  mView->UI_InstallTimerNotifyFunction(nullptr);
  mView->UI_InstallTimerNotifyFunction(TimerNotification([&](long) { calls.push_back("b"); return true; }));
  mView->UI_InstallTimerNotifyFunction(TimerNotification([&](long) { calls.push_back("c"); return true; }));
  mView->UI_InstallTimer(0.1f, 7);
  mWindow->UI_DispatchPossibleTimer(OnlyKey());
  EXPECT_EQ(calls, (std::vector<std::string>{"a", "b"}));
  EXPECT_EQ(mWindow->Timers().GetTimerCount(), 1u);
}

TEST_F(NodeTimerTest, AnUnknownKeyOrAnotherWindowsNodeIsNotOurs) {
  EXPECT_FALSE(mWindow->UI_DispatchPossibleTimer(12345));
  boost::intrusive_ptr<test::TestWindowNode> other(new test::TestWindowNode);
  const long key = mWindow->Timers().CreateTimer(other.get(), 1, 0.1f);
  EXPECT_FALSE(mWindow->UI_DispatchPossibleTimer(key));
}

TEST_F(NodeTimerTest, AViewMovedToAnotherWindowLeavesItsTimersBehind) {
  mView->UI_InstallTimer(0.1f, 1);
  mView->UI_InstallTimer(0.1f, 2);
  FocusableViewP child = AddView(*mView, "child");
  child->UI_InstallTimer(0.1f, 3);
  const long key = child->UI_GetTimerIDs().front();
  ASSERT_EQ(mWindow->Timers().GetTimerCount(), 3u);

  boost::intrusive_ptr<test::TestWindowNode> other(new test::TestWindowNode);
  UI_NodeP keep = mWindow->ChildRemove(mView.get());
  other->ChildPushBack(keep);
  EXPECT_EQ(mWindow->Timers().GetTimerCount(), 0u);
  EXPECT_EQ(other->Timers().GetTimerCount(), 0u);
  EXPECT_TRUE(mView->UI_GetTimerIDs().empty());
  EXPECT_TRUE(child->UI_GetTimerIDs().empty());
  EXPECT_FALSE(mWindow->UI_DispatchPossibleTimer(key));
  child->UI_InstallTimer(0.1f, 3);
  EXPECT_EQ(other->Timers().GetTimerCount(), 1u);
}

TEST_F(NodeTimerTest, ANotificationThatRemovesItsOwnViewDoesNotCrash) {
  UI_Node* window = mWindow.get();
  UI_Node* view = mView.get();
  bool destroyed = false;
  struct Flag : test::FocusableView {
    bool* destroyed = nullptr;
    ~Flag() override { *destroyed = true; }
  };
  boost::intrusive_ptr<Flag> doomed(new Flag);
  doomed->destroyed = &destroyed;
  mWindow->ChildPushBack(doomed);
  doomed->UI_InstallTimerNotifyFunction(TimerNotification([window, raw = doomed.get()](long) {
    window->ChildRemove(raw);
    return false;
  }));
  doomed->UI_InstallTimer(0.1f, 9);
  const long key = doomed->UI_GetTimerIDs().front();
  doomed.reset();
  EXPECT_TRUE(mWindow->UI_DispatchPossibleTimer(key));
  EXPECT_TRUE(destroyed);
  EXPECT_EQ(mWindow->Timers().GetTimerCount(), 0u);
  EXPECT_EQ(mWindow->ChildSize(), 1u);
  EXPECT_EQ(mWindow->ChildGet(0), view);
}

TEST_F(NodeTimerTest, AViewDestroyedWithItsParentTakesItsTimersAlong) {
  FocusableViewP panel = AddView(*mWindow, "panel");
  FocusableViewP inner = AddView(*panel, "inner");
  inner->UI_InstallTimer(0.1f, 1);
  ASSERT_EQ(mWindow->Timers().GetTimerCount(), 1u);
  inner.reset();
  mWindow->ChildRemove(panel.get());
  panel.reset();
  EXPECT_EQ(mWindow->Timers().GetTimerCount(), 0u);
}

// ---------------------------------------------------------------- captures

class TimerCapture : public InputCapture {
 public:
  TimerCapture(UI_Node* inNode, bool inTakes) : InputCapture(UI_NodeP(inNode), MouseEvent()), mTakes(inTakes) {}
  bool DoTimerNotify(long inTimerID) override {
    seen.push_back(inTimerID);
    return mTakes;
  }
  std::vector<long> seen;

 private:
  bool mTakes;
};

TEST_F(NodeTimerTest, ACaptureOnTheNodeSeesItsTimersFirstAndMayLeaveThemToTheNode) {
  for (bool takes : {true, false}) {
    FocusableViewP view = AddView(*mWindow, takes ? "taken" : "declined");
    int nodeCalls = 0;
    view->UI_InstallTimerNotifyFunction(TimerNotification([&](long) { ++nodeCalls; return true; }));
    view->UI_InstallTimer(0.1f, 4);
    boost::intrusive_ptr<TimerCapture> capture(new TimerCapture(view.get(), takes));
    mManager.BeginInputCapture(capture);
    EXPECT_TRUE(mWindow->UI_DispatchPossibleTimer(view->UI_GetTimerIDs().front()));
    EXPECT_EQ(capture->seen, (std::vector<long>{4}));
    EXPECT_EQ(nodeCalls, takes ? 0 : 1) << (takes ? "the capture takes it" : "the capture declines");
    mManager.EndInputCapture(false);
  }
}

TEST_F(NodeTimerTest, ACaptureOnAnotherNodeDoesNotSeeTheTimer) {
  FocusableViewP other = AddView(*mWindow, "other");
  mView->UI_InstallTimer(0.1f, 4);
  boost::intrusive_ptr<TimerCapture> capture(new TimerCapture(other.get(), true));
  mManager.BeginInputCapture(capture);
  mWindow->UI_DispatchPossibleTimer(OnlyKey());
  EXPECT_TRUE(capture->seen.empty());
  mManager.EndInputCapture(false);
}

// ---------------------------------------------------------------- tool tips

class ToolTipTimerTest : public NodeTimerTest {
 protected:
  ToolTipTimerTest() {
    mTips = test::RecordingToolTips::InstallIn(mManager);
    mView->UI_SetToolTip(u"Gain", 0);
    mManager.SetMouseOverLeafNode(mView.get());
  }
  test::RecordingToolTips* mTips = nullptr;
};

TEST_F(ToolTipTimerTest, TheFirstFiringShowsTheTipAndEndsTheTimerWithoutTheNodesNotifications) {
  int calls = 0;
  mView->UI_InstallTimerNotifyFunction(TimerNotification([&](long) { ++calls; return true; }));
  mView->UI_InstallTimer(0.5f, UI_NodeManager::GetTooltipTimerID());
  EXPECT_TRUE(mWindow->UI_DispatchPossibleTimer(OnlyKey()));
  EXPECT_EQ(mTips->calls, (std::vector<std::string>{"show"}));
  EXPECT_EQ(mTips->shown, mView.get());
  EXPECT_EQ(mWindow->Timers().GetTimerCount(), 0u);
  EXPECT_EQ(calls, 0);
}

TEST_F(ToolTipTimerTest, AFiringWhileTheTipShowsTakesItDown) {
  mTips->shown = mView.get();
  mView->UI_InstallTimer(5.0f, UI_NodeManager::GetTooltipTimerID());
  mWindow->UI_DispatchPossibleTimer(OnlyKey());
  EXPECT_EQ(mTips->calls, (std::vector<std::string>{"dispose"}));
}

TEST_F(ToolTipTimerTest, NothingShowsWhenTheMouseHasMovedToANodeWithAnotherTip) {
  FocusableViewP other = AddView(*mWindow, "other");
  other->UI_SetToolTip(u"Pan", 0);
  mManager.SetMouseOverLeafNode(other.get());
  mView->UI_InstallTimer(0.5f, UI_NodeManager::GetTooltipTimerID());
  EXPECT_TRUE(mWindow->UI_DispatchPossibleTimer(OnlyKey()));
  EXPECT_TRUE(mTips->calls.empty());
  EXPECT_EQ(mWindow->Timers().GetTimerCount(), 0u);
}

TEST_F(ToolTipTimerTest, TheMouseArrivingOnANodeWithATipShowsItOnlyWhenTheDelayRunsOut) {
  FocusableViewP other = AddView(*mWindow, "other");
  other->UI_SetToolTip(u"Pan", 0);
  mTips->calls.clear();
  other->UI_SetMouseOverLeafNode(nullptr);
  EXPECT_EQ(mTips->shown, nullptr);
  ASSERT_EQ(other->UI_GetTimerIDs().size(), 1u);
  mWindow->UI_DispatchPossibleTimer(other->UI_GetTimerIDs().front());
  EXPECT_EQ(mTips->shown, other.get());
}

}  // namespace
}  // namespace norvik::ui
