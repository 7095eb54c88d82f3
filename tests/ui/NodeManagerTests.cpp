// The node manager: the single instance, timer ids, filters, scoped guards,
// the modal stack, notifications, user resizing, settings, and the rule that
// keeps every cached node pointer valid on removal and on destruction.
#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "support/ui/NodeTestSupport.h"
#include "tarsel/ThrowError.h"
#include "ui/InputCapture.h"

namespace norvik::ui::test {
namespace {

using NodeManager = ManagerTest;

TEST(NodeManagerLifetime, TheInstanceIsReachableOnlyWhileItLives) {
  EXPECT_EQ(UI_NodeManager::Get(), nullptr);
  {
    OS_NodeManager manager;
    EXPECT_EQ(UI_NodeManager::Get(), &manager);
    EXPECT_EQ(UI_NodeManager::GetConst(), &manager);
    EXPECT_TRUE(manager.IsApplicationFrontmost());
    EXPECT_FALSE(manager.IsMnemonicEnabled());
    EXPECT_EQ(manager.GetDrawbotCacheSeed(), 0u);
    ASSERT_NE(manager.GetExecutor(), nullptr);
    EXPECT_EQ(manager.GetExecutor(), tarsel::threads::GetMainThreadExecutor());
    EXPECT_TRUE(tarsel::threads::IsMainThread());
  }
  EXPECT_EQ(UI_NodeManager::Get(), nullptr);
}

class RecordingCapture : public InputCapture {
 public:
  explicit RecordingCapture(std::vector<std::string>* ioLog) : InputCapture(nullptr, MouseEvent()), mLog(ioLog) {}
  void Begin() override { mLog->push_back("begin"); }
  void End() override { mLog->push_back(HasBeenCancelled() ? "cancelled" : "ended"); }

 private:
  std::vector<std::string>* mLog;
};

TEST(NodeManagerLifetime, DestroyingTheManagerCancelsTheRunningCapture) {
  std::vector<std::string> log;
  {
    OS_NodeManager manager;
    manager.BeginInputCapture(new RecordingCapture(&log));
    EXPECT_TRUE(manager.HasInputCapture());
  }
  EXPECT_EQ(log, (std::vector<std::string>{"begin", "cancelled"}));
}

TEST(NodeManagerLifetime, NodesMayBeRemovedAndDieAfterTheManagerIsGone) {
  RecordingViewP root, leaf;
  {
    OS_NodeManager manager;
    root = MakeView(0, 0, 100, 100, nullptr, "root");
    leaf = MakeView(0, 0, 10, 10, root.get(), "leaf");
    manager.SetMouseOverLeafNode(leaf.get());
  }
  EXPECT_EQ(root->ChildRemove(leaf.get()), leaf);
  leaf.reset();
  root.reset();
}

TEST_F(NodeManager, UniqueTimerIDsCountDownFromMinusTwoAndNeverGiveTheTipTimersID) {
  EXPECT_EQ(UI_NodeManager::GetTooltipTimerID(), -1);
  EXPECT_EQ(manager.GetUniqueTimerID(), -2);
  EXPECT_EQ(manager.GetUniqueTimerID(), -3);
  for (int i = 0; i < 100; ++i) EXPECT_LT(manager.GetUniqueTimerID(), -1);
}

TEST_F(NodeManager, FiltersAreKeptNewestFirstAndNullOrUnknownNodesAreIgnored) {
  auto a = MakeView(0, 0, 1, 1, nullptr, "a");
  auto b = MakeView(0, 0, 1, 1, nullptr, "b");
  manager.AddMouseEventFilterNode(a.get());
  manager.AddMouseEventFilterNode(nullptr);
  manager.AddMouseEventFilterNode(b.get());
  EXPECT_EQ(manager.GetMouseEventFilters(), (std::vector<UI_Node*>{b.get(), a.get()}));
  manager.RemoveMouseEventFilterNode(MakeView(0, 0, 1, 1).get());
  EXPECT_EQ(manager.GetMouseEventFiltersSize(), 2u);
  manager.RemoveMouseEventFilterNode(a.get());
  EXPECT_EQ(manager.GetMouseEventFilters(), (std::vector<UI_Node*>{b.get()}));
  {
    UI_NodeManager::AddAndRemoveKeyboardEventFilterNode guard(&manager, a.get());
    EXPECT_EQ(manager.GetKeyboardEventFiltersSize(), 1u);
  }
  EXPECT_EQ(manager.GetKeyboardEventFiltersSize(), 0u);
}

TEST_F(NodeManager, CountingGuardsRaiseTheirCounterForTheirLifetime) {
  {
    UI_NodeManager::SuspendOSFocusUpdates focus(&manager);
    UI_NodeManager::SuspendMouseOverUpdates mouse(&manager);
    EXPECT_TRUE(manager.IsSuspendingOSFocusChanges());
    EXPECT_TRUE(manager.IsSuspendingMouseOverUpdates());
    UI_NodeManager::SuspendOSFocusUpdates moved(std::move(focus));
    EXPECT_TRUE(manager.IsSuspendingOSFocusChanges());
  }
  EXPECT_FALSE(manager.IsSuspendingOSFocusChanges());
  EXPECT_FALSE(manager.IsSuspendingMouseOverUpdates());
}

TEST_F(NodeManager, MouseActivateSuspensionsPopTheTopWhateverWindowItIs) {
  int w1 = 0, w2 = 0;
  auto first = std::make_unique<UI_NodeManager::SuspendOSMouseActivates>(&manager, &w1);
  auto second = std::make_unique<UI_NodeManager::SuspendOSMouseActivates>(&manager, &w2);
  EXPECT_EQ(manager.GetSuspendOSMouseActivatePlatformWindow(), &w2);
  first.reset();  // ends out of order: takes the other guard's window off
  EXPECT_EQ(manager.GetSuspendOSMouseActivatePlatformWindow(), &w1);
  second.reset();
  EXPECT_FALSE(manager.IsSuspendingOSMouseActivates());
  EXPECT_EQ(manager.GetSuspendOSMouseActivatePlatformWindow(), nullptr);
}

// ---------------------------------------------------------------------------

using ModalStack = ManagerTest;

TEST_F(ModalStack, PushingTheSameWindowTwiceKeepsOneEntry) {
  auto w = MakeView(0, 0, 10, 10, nullptr, "w");
  manager.PushModalWindow(w.get());
  manager.PushModalWindow(w.get());
  EXPECT_EQ(manager.GetModalStack().size(), 1u);
  EXPECT_EQ(manager.GetModalWindow(), w.get());
}

TEST_F(ModalStack, PoppingAWindowThatIsNotOnTopChangesNothing) {
  auto a = MakeView(0, 0, 10, 10, nullptr, "a");
  auto b = MakeView(0, 0, 10, 10, nullptr, "b");
  manager.PushModalWindow(a.get());
  manager.PushModalWindow(b.get());
  manager.PopModalWindow(a.get());
  EXPECT_EQ(manager.GetModalStack().size(), 2u);
  EXPECT_EQ(manager.GetModalWindow(), b.get());
  manager.PopModalWindow(b.get());
  EXPECT_EQ(manager.GetModalWindow(), a.get());
}

TEST_F(ModalStack, PoppingRestoresTheFocusSavedWhenTheWindowWasPushed) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto field = MakeView(0, 0, 10, 10, root.get(), "field");
  field->wantsFocus = true;
  auto dialog = MakeView(0, 0, 50, 50, nullptr, "dialog");
  auto button = MakeView(0, 0, 10, 10, dialog.get(), "button");
  button->wantsFocus = true;
  field->UI_GainKeyboardFocus(kFocusChangeMouse);
  {
    UI_NodeManager::SetModalWindow modal(&manager, dialog.get());
    EXPECT_TRUE(manager.HasModalWindow());
    button->UI_GainKeyboardFocus(kFocusChangeMouse);
    EXPECT_EQ(manager.GetKeyboardFocusLeafNode(), button.get());
  }
  EXPECT_FALSE(manager.HasModalWindow());
  EXPECT_EQ(manager.GetKeyboardFocusLeafNode(), field.get());
  EXPECT_TRUE(field->UI_HasKeyboardFocus(true));
  EXPECT_FALSE(button->UI_HasKeyboardFocus(false));
}

// ---------------------------------------------------------------------------

class CachedNodes : public ManagerTest {
 protected:
  void SetUp() override {
    root = MakeView(0, 0, 100, 100, nullptr, "root");
    panel = MakeView(0, 0, 50, 50, root.get(), "panel");
    field = MakeView(0, 0, 10, 10, panel.get(), "field");
    sibling = MakeView(20, 0, 10, 10, root.get(), "sibling");
    panel->wantsFocus = true;
    field->wantsFocus = true;
    root->wantsFocus = true;
  }
  RecordingViewP root, panel, field, sibling;
};

TEST_F(CachedNodes, RemovingTheFocusedNodeHandsFocusToItsParent) {
  field->UI_GainKeyboardFocus(kFocusChangeMouse);
  manager.SetMouseOverLeafNode(field.get());
  manager.SetMouseOverRootNode(root.get());
  std::vector<FocusChangeReason> reasons;
  panel->InstallFocusChangedFunction(boost::make_shared<boost::function<void(UI_Node*, FocusChangeReason)>>(
      [&](UI_Node*, FocusChangeReason r) { reasons.push_back(r); }));
  panel->ChildRemove(field.get());
  EXPECT_EQ(manager.GetKeyboardFocusLeafNode(), panel.get());
  EXPECT_EQ(manager.GetMouseOverLeafNode(), panel.get());
  EXPECT_EQ(manager.GetMouseOverRootNode(), root.get());
  EXPECT_FALSE(field->UI_HasKeyboardFocus(false));
  EXPECT_EQ(reasons, std::vector<FocusChangeReason>{kFocusChangeHandOver});
}

TEST_F(CachedNodes, RequestRemoveLeavesTheCachedPointersAlone) {
  field->UI_GainKeyboardFocus(kFocusChangeMouse);
  EXPECT_TRUE(panel->ChildRequestRemove(field.get()));
  EXPECT_EQ(manager.GetKeyboardFocusLeafNode(), field.get());
}

TEST_F(CachedNodes, RemovingASubtreeReplacesPointersIntoItsDescendants) {
  field->UI_GainKeyboardFocus(kFocusChangeMouse);
  manager.SetMouseOverLeafNode(field.get());
  root->ChildRemove(panel.get());
  EXPECT_EQ(manager.GetMouseOverLeafNode(), root.get());
  EXPECT_EQ(manager.GetKeyboardFocusLeafNode(), root.get());
}

TEST_F(CachedNodes, ASavedModalFocusInsideTheRemovedNodeIsReplaced) {
  field->UI_GainKeyboardFocus(kFocusChangeMouse);
  auto dialog = MakeView(0, 0, 10, 10, nullptr, "dialog");
  manager.PushModalWindow(dialog.get());
  panel->ChildRemove(field.get());
  EXPECT_EQ(manager.GetModalStack().front().second, panel.get());
}

TEST_F(CachedNodes, DestroyingANodeClearsEveryPointerToIt) {
  auto lone = MakeView(0, 0, 10, 10, nullptr, "lone");
  lone->wantsFocus = true;
  lone->UI_GainKeyboardFocus(kFocusChangeMouse);
  manager.SetMouseOverLeafNode(lone.get());
  manager.SetMouseOverRootNode(lone.get());
  auto dialog = MakeView(0, 0, 10, 10, nullptr, "dialog");
  manager.PushModalWindow(dialog.get());
  manager.AddKeyboardEventFilterNode(lone.get());
  UI_Node* raw = lone.get();
  lone.reset();
  EXPECT_EQ(manager.GetMouseOverLeafNode(), nullptr);
  EXPECT_EQ(manager.GetMouseOverRootNode(), nullptr);
  EXPECT_EQ(manager.GetKeyboardFocusLeafNode(), nullptr);
  EXPECT_NE(manager.GetPreviousKeyboardFocusLeafNode(), raw);
  EXPECT_EQ(manager.GetModalStack().front().second, nullptr);
  EXPECT_EQ(manager.GetKeyboardEventFiltersSize(), 0u);
}

TEST_F(CachedNodes, DestroyingAParentDropsPointersIntoTheChildrenItOwnedAlone) {
  field->UI_GainKeyboardFocus(kFocusChangeMouse);
  manager.SetMouseOverLeafNode(field.get());
  panel.reset();
  field.reset();
  root.reset();  // takes panel and field with it
  EXPECT_EQ(manager.GetKeyboardFocusLeafNode(), nullptr);
  EXPECT_EQ(manager.GetMouseOverLeafNode(), nullptr);
  EXPECT_EQ(manager.GetPreviousKeyboardFocusLeafNode(), nullptr);
}

TEST_F(CachedNodes, AFocusHandlerThatDeletesTheParentDuringRemovalDoesNotCrash) {
  field->UI_GainKeyboardFocus(kFocusChangeMouse);
  UI_Node* rootRaw = root.get();
  UI_Node* panelRaw = panel.get();
  panel->InstallFocusChangedFunction(boost::make_shared<boost::function<void(UI_Node*, FocusChangeReason)>>(
      [rootRaw, panelRaw](UI_Node*, FocusChangeReason) { rootRaw->ChildRemove(panelRaw); }));
  panel.reset();  // only the tree holds the panel now
  RecordingView* fieldRaw = field.get();
  fieldRaw->UI_GetParentNode()->ChildRemove(fieldRaw);
  EXPECT_EQ(root->ChildSize(), 1u);  // only the sibling is left
  EXPECT_EQ(field->UI_GetParentContainer(), nullptr);
}

// ---------------------------------------------------------------------------

using Frontmost = ManagerTest;

TEST_F(Frontmost, GoingToTheBackgroundClearsTheFocusStateAndComingBackRestoresIt) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto field = MakeView(0, 0, 10, 10, root.get(), "field");
  field->wantsFocus = true;
  field->UI_GainKeyboardFocus(kFocusChangeMouse);
  std::vector<bool> notified;
  static std::vector<bool>* sink;
  sink = &notified;
  manager.InstallApplicationActivationChangedFunction(
      boost::make_shared<void (*)(bool)>([](bool front) { sink->push_back(front); }));
  manager.SetApplicationFrontmost(false);
  EXPECT_FALSE(field->UI_HasKeyboardFocus(false));
  EXPECT_EQ(manager.GetPreviousKeyboardFocusLeafNode(), field.get());
  manager.SetApplicationFrontmost(true);
  EXPECT_TRUE(field->UI_HasKeyboardFocus(true));
  EXPECT_EQ(notified, (std::vector<bool>{false, true}));
}

TEST_F(Frontmost, WhileFocusIsUpdatingOnlyTheNotificationHappens) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto field = MakeView(0, 0, 10, 10, root.get(), "field");
  field->wantsFocus = true;
  field->UI_GainKeyboardFocus(kFocusChangeMouse);
  static int notifications;
  notifications = 0;
  manager.InstallApplicationActivationChangedFunction(
      boost::make_shared<void (*)(bool)>([](bool) { ++notifications; }));
  manager.InstallApplicationActivationChangedFunction(UI_NodeManager::BoolFunction());
  {
    UI_NodeManager::ScUpdatingFocus updating(&manager);
    manager.SetApplicationFrontmost(false);
  }
  EXPECT_FALSE(manager.IsApplicationFrontmost());
  EXPECT_TRUE(field->UI_HasKeyboardFocus(true));
  EXPECT_EQ(notifications, 1);
  manager.UnregisterFunctions();
  manager.NotifyApplicationActivationChanged(true);
  EXPECT_EQ(notifications, 1);
}

// ---------------------------------------------------------------------------

using UserResizing = ManagerTest;

TEST_F(UserResizing, RepaintsAreDeferredToTheEndOfTheOutermostResize) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto view = MakeView(0, 0, 10, 10, root.get(), "view");
  static std::vector<std::pair<bool, bool>> calls;
  calls.clear();
  manager.InstallUserResizeFunction(boost::make_shared<void (*)(bool, UI_Node*, bool)>(
      [](bool starting, UI_Node*, bool fromOS) { calls.emplace_back(starting, fromOS); }));
  EXPECT_FALSE(view->UI_PerformUserResizingDraw());
  {
    UI_NodeManager::NotifyUserResizing outer(&manager, root.get());
    manager.BeginUserResizing(root.get(), true);
    EXPECT_TRUE(manager.IsUserResizing());
    EXPECT_TRUE(view->UI_PerformUserResizingDraw());
    view->invalidations.clear();
    manager.EndUserResizing(root.get(), true);
    EXPECT_TRUE(view->invalidations.empty());
  }
  EXPECT_FALSE(manager.IsUserResizing());
  EXPECT_EQ(view->invalidations.size(), 1u);
  EXPECT_EQ(calls, (std::vector<std::pair<bool, bool>>{{true, false}, {true, true}, {false, false}}));
}

// ---------------------------------------------------------------------------

using ManagerSeams = ManagerTest;

TEST_F(ManagerSeams, WithoutAResourceManagerAccessRaisesTheResourceError) {
  manager.SetResourceManager(nullptr);
  try {
    manager.GetResourceManager();
    FAIL() << "expected an error";
  } catch (const tarsel::config::Exception& e) {
    EXPECT_EQ(e.GetKeyPath(), "norvik/utility/Error/ResourceUtils/UnableToAccessResource");
    EXPECT_STREQ(e.what(), "Unable to access resource.");
  }
}

TEST_F(ManagerSeams, EditTextCreationUsesTheInstalledHookAlone) {
  auto parent = MakeView(0, 0, 100, 100, nullptr, "parent");
  EXPECT_THROW(
      {
        UI_NodeP host;
        OS_EditText* edit = nullptr;
        manager.CreateEditText(1, nullptr, parent.get(), host, edit);
      },
      tarsel::config::Exception);
  int seenType = 0;
  manager.InstallEditTextCreationFunction(
      [&](int type, UI_Node*, UI_Node* inParent, UI_NodeP& outHost, OS_EditText*&) {
        seenType = type;
        outHost = MakeView(0, 0, 5, 5, inParent, "host");
      });
  UI_NodeP host;
  OS_EditText* edit = nullptr;
  manager.CreateEditText(7, nullptr, parent.get(), host, edit);
  EXPECT_EQ(seenType, 7);
  ASSERT_NE(host, nullptr);
  EXPECT_EQ(host->UI_GetParentNode(), parent.get());
}

TEST_F(ManagerSeams, ChangingTheTipOfTheDisplayedNodeRefreshesOrDisposesIt) {
  RecordingToolTips* t = RecordingToolTips::InstallIn(manager);
  auto v = MakeView(0, 0, 10, 10);
  v->UI_SetToolTip(u"first", 100);
  EXPECT_TRUE(t->refreshed.empty());  // not on screen, not under the mouse
  t->shown = v.get();
  v->UI_SetToolTip(u"second", 120);
  EXPECT_EQ(t->refreshed, std::vector<UI_Node*>{v.get()});
  EXPECT_EQ(v->UI_GetToolTipWidth(), 120);
  v->UI_SetToolTip(u"second", 300);
  EXPECT_EQ(v->UI_GetToolTipWidth(), 120);  // same text: the width is not taken either
  v->UI_SetToolTip(u"", 0);
  EXPECT_EQ(t->calls, (std::vector<std::string>{"show", "dispose"}));
}

TEST_F(ManagerSeams, TheTipOfTheMouseOverLeafIsDisposedWhenTheLeafIsDestroyed) {
  RecordingToolTips* t = RecordingToolTips::InstallIn(manager);
  auto v = MakeView(0, 0, 10, 10);
  t->shown = v.get();
  manager.SetMouseOverLeafNode(v.get());
  v.reset();
  EXPECT_EQ(t->calls, std::vector<std::string>{"dispose"});
  EXPECT_EQ(t->shown, nullptr);
}

TEST_F(ManagerSeams, TheTipForDisplayClimbsToAnAncestorThatShowsTipsForItsChildren) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto group = MakeView(0, 0, 50, 50, root.get(), "group");
  auto leaf = MakeView(0, 0, 10, 10, group.get(), "leaf");
  root->UI_SetToolTip(u"root tip", 0);
  group->UI_SetToolTip(u"group tip", 0);
  EXPECT_EQ(UI_Node::UI_GetToolTipForDisplay(leaf.get()), nullptr);
  root->displaysTipsForChildren = true;
  EXPECT_EQ(UI_Node::UI_GetToolTipForDisplay(leaf.get()), root.get());
  leaf->UI_SetToolTip(u"own", 0);
  EXPECT_EQ(UI_Node::UI_GetToolTipForDisplay(leaf.get()), leaf.get());
  EXPECT_EQ(UI_Node::UI_GetToolTipForDisplay(nullptr), nullptr);
  std::vector<std::string> log;
  InputCaptureP capture(new RecordingCapture(&log));
  manager.BeginInputCapture(capture);
  EXPECT_EQ(UI_Node::UI_GetToolTipForDisplay(leaf.get()), nullptr);
  capture->Cancel();
  EXPECT_EQ(UI_Node::UI_GetToolTipForDisplay(leaf.get()), leaf.get()) << "a cancelled capture is no longer active";
  manager.EndInputCapture(true);
}

// ---------------------------------------------------------------------------

TEST(CustomSettings, AValueOfAnotherTypeAnswersTheFallbackAndReloadRestoresDefaults) {
  CustomSettingsManager settings;
  settings.Set("norvik.controls.UI_SliderCenterTick_Height", 20.0);
  EXPECT_EQ(settings.GetLong("norvik.controls.UI_SliderCenterTick_Height", 0), 20);
  EXPECT_TRUE(settings.GetBool("norvik.controls.UI_SliderCenterTick_Height", true));
  EXPECT_EQ(settings.GetString("norvik.controls.UI_SliderGap", "x"), "x");
  settings.Reload();
  EXPECT_EQ(settings.GetLong("norvik.controls.UI_SliderCenterTick_Height", 0), 12);
}

}  // namespace
}  // namespace norvik::ui::test
