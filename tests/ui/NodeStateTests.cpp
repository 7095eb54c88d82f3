// Enable and show state with their propagation, and the callback lists.
#include <boost/function/function_base.hpp>
#include <gtest/gtest.h>

#include "support/ui/FocusTestNodes.h"
#include "support/ui/NodeTestSupport.h"

namespace norvik::ui::test {
namespace {

constexpr unsigned long kSelf = UI_Node::kStateSelfDisabled;
constexpr unsigned long kInherited = UI_Node::kStateParentDisabled;

class DisablePropagation : public ManagerTest {
 protected:
  void SetUp() override {
    root = MakeView(0, 0, 100, 100, nullptr, "root");
    mid = MakeView(0, 0, 50, 50, root.get(), "mid");
    leaf = MakeView(0, 0, 10, 10, mid.get(), "leaf");
  }
  RecordingViewP root, mid, leaf;
};

TEST_F(DisablePropagation, DisablingAParentMarksTheWholeSubtreeAsInheritedDisabledOnce) {
  root->UI_SetDisabled(true);
  const int changes = mid->disabledChanges;
  root->UI_SetDisabled(true);
  EXPECT_EQ(mid->disabledChanges, changes) << "the same state again changes nothing";
  EXPECT_EQ(root->UI_GetStateFlags().Get(), kSelf);
  EXPECT_EQ(mid->UI_GetStateFlags().Get(), kInherited);
  EXPECT_EQ(leaf->UI_GetStateFlags().Get(), kInherited);
  EXPECT_TRUE(leaf->UI_IsDisabled());
  root->UI_SetEnabled(true);
  EXPECT_TRUE(mid->UI_GetStateFlags().IsEmpty());
  EXPECT_TRUE(leaf->UI_IsEnabled());
}

TEST_F(DisablePropagation, ASelfDisabledSubtreeShieldsItsChildrenFromTheAncestorsChange) {
  mid->UI_SetDisabled(true);
  EXPECT_EQ(leaf->UI_GetStateFlags().Get(), kInherited);
  leaf->disabledChanges = 0;
  root->UI_SetDisabled(true);
  EXPECT_EQ(mid->UI_GetStateFlags().Get(), kSelf | kInherited);
  EXPECT_EQ(leaf->UI_GetStateFlags().Get(), kInherited);
  EXPECT_EQ(leaf->disabledChanges, 0);
  root->UI_SetDisabled(false);
  EXPECT_EQ(mid->UI_GetStateFlags().Get(), kSelf);
  EXPECT_EQ(leaf->UI_GetStateFlags().Get(), kInherited);
}

TEST_F(DisablePropagation, SelfAndParentSettersLeaveTheChildrenAlone) {
  mid->UI_SetSelfDisabled(true);
  EXPECT_TRUE(mid->UI_IsDisabled());
  EXPECT_TRUE(leaf->UI_GetStateFlags().IsEmpty());
  leaf->UI_SetParentDisabled(true);
  EXPECT_EQ(leaf->UI_GetStateFlags().Get(), kInherited);
}

TEST_F(DisablePropagation, AChildAddedUnderADisabledParentInheritsAndLosesItWhenDetached) {
  root->UI_SetDisabled(true);
  auto late = MakeView(0, 0, 5, 5, root.get(), "late");
  auto lateChild = MakeView(0, 0, 5, 5, late.get(), "lateChild");
  EXPECT_EQ(late->UI_GetStateFlags().Get(), kInherited);
  EXPECT_EQ(lateChild->UI_GetStateFlags().Get(), kInherited);
  root->ChildRemove(late.get());
  EXPECT_TRUE(late->UI_IsEnabled());
  EXPECT_TRUE(lateChild->UI_IsEnabled());
}

TEST_F(DisablePropagation, DisablingTheFocusedNodeAdvancesFocusAndClimbsOnlyWhenNothingTakesIt) {
  boost::intrusive_ptr<TestWindowNode> window(new TestWindowNode);
  FocusableViewP panel = AddView(*window, "panel");
  FocusableViewP first = AddView(*panel, "first");
  FocusableViewP next = AddView(*panel, "next");
  ASSERT_TRUE(first->UI_GainKeyboardFocus(kFocusChangeMouse));
  first->UI_SetDisabled(true);
  EXPECT_EQ(FocusLeafID(), "next") << "the next node in tab order takes focus";
  next->UI_SetSelfDisabled(true);
  EXPECT_EQ(FocusLeafID(), "panel") << "with no enabled sibling left, focus climbs";
}

// ---------------------------------------------------------------------------

using ShowHide = ManagerTest;

TEST_F(ShowHide, ShowingInvalidatesTheNewAreaAndAnnouncesTheChange) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  RecordingViewP v(new RecordingView("v"));
  v->UI_SetLocalRectF(tarsel::geom::RectT<float>(10, 10, 20, 20));
  root->ChildPushBack(v);
  root->invalidations.clear();
  v->nodeChanges.clear();
  v->UI_Show(true);
  EXPECT_TRUE(v->UI_IsShown());
  ASSERT_EQ(root->invalidations.size(), 1u);
  EXPECT_EQ(root->invalidations[0].rect, tarsel::geom::RectT<long>(10, 10, 20, 20));
  EXPECT_EQ(v->nodeChanges, std::vector<UI_Node::NodeChange>{UI_Node::kNodeChangeVisibility});
}

TEST_F(ShowHide, HidingInvalidatesTheOldAreaOnceAndAHiddenViewInvalidatesNothingAbove) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto v = MakeView(10, 10, 20, 20, root.get(), "v");
  root->invalidations.clear();
  v->UI_Hide(true);
  EXPECT_TRUE(v->UI_IsHidden());
  EXPECT_EQ(root->invalidations.size(), 1u);
  v->UI_Invalidate(nullptr, 0);
  EXPECT_EQ(root->invalidations.size(), 1u);
  v->UI_Hide(true);
  EXPECT_EQ(v->nodeChanges.back(), UI_Node::kNodeChangeVisibility);
}

TEST_F(ShowHide, AllParentsVisibleNeedsEveryAncestorShownAndIsFalseAtARoot) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto mid = MakeView(0, 0, 50, 50, root.get(), "mid");
  auto leaf = MakeView(0, 0, 10, 10, mid.get(), "leaf");
  // The portable base has no window to end the chain, so a bare root answers false.
  EXPECT_FALSE(root->UI_AreAllParentsVisible());
  EXPECT_FALSE(leaf->UI_AreAllParentsVisible());
}

// ---------------------------------------------------------------------------

using CallbackLists = ManagerTest;

TEST_F(CallbackLists, AnEntryHoldingAnEmptyFunctionRaisesTheStandardError) {
  auto v = MakeView(0, 0, 10, 10);
  v->InstallDisabledChangedFunction(boost::make_shared<boost::function<void()>>());
  EXPECT_THROW(v->UI_SetDisabled(true), boost::bad_function_call);
}

TEST_F(CallbackLists, TimerNotificationStopsAtTheFirstTrueAnswer) {
  auto v = MakeView(0, 0, 10, 10);
  std::vector<long> seen;
  v->InstallTimerFunction(
      boost::make_shared<boost::function<bool(long)>>([&](long id) { seen.push_back(id); return false; }));
  v->InstallTimerFunction(
      boost::make_shared<boost::function<bool(long)>>([&](long id) { seen.push_back(-id); return true; }));
  v->InstallTimerFunction(
      boost::make_shared<boost::function<bool(long)>>([&](long id) { seen.push_back(100 * id); return true; }));
  EXPECT_TRUE(v->UI_DoTimerNotify(7));
  EXPECT_EQ(seen, (std::vector<long>{7, -7}));
  auto quiet = MakeView(0, 0, 10, 10);
  EXPECT_FALSE(quiet->UI_DoTimerNotify(7));
}

TEST_F(CallbackLists, FocusNotificationsCarryTheNodeAndTheReason) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto leaf = MakeView(0, 0, 10, 10, root.get(), "leaf");
  leaf->wantsFocus = true;
  std::vector<std::pair<UI_Node*, FocusChangeReason>> seen;
  leaf->InstallFocusChangedFunction(
      boost::make_shared<boost::function<void(UI_Node*, FocusChangeReason)>>(
          [&](UI_Node* n, FocusChangeReason r) { seen.emplace_back(n, r); }));
  std::vector<bool> before;
  leaf->InstallBeforeFocusChangeFunction(
      boost::make_shared<boost::function<void(bool, FocusChangeReason)>>(
          [&](bool gaining, FocusChangeReason) { before.push_back(gaining); }));
  leaf->UI_GainKeyboardFocus(kFocusChangeMouse);
  ASSERT_EQ(seen.size(), 1u);
  EXPECT_EQ(seen[0].first, leaf.get());
  EXPECT_EQ(seen[0].second, kFocusChangeMouse);
  EXPECT_EQ(before, std::vector<bool>{true});
}

TEST_F(CallbackLists, UserDataIsACopyOfTheValue) {
  auto v = MakeView(0, 0, 10, 10);
  std::string text = "first";
  v->SetUserData(text);
  text = "changed";
  EXPECT_EQ(boost::any_cast<std::string>(v->GetUserData()), "first");
}

}  // namespace
}  // namespace norvik::ui::test
