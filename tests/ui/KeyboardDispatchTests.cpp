// The keyboard path: keyboard filters, then the focused node and each
// ancestor; disabled nodes are passed over, typed characters can be kept
// from climbing, and an active gesture takes every key. Also the keys that
// activate a focused control and the modifier notifier.
#include <memory>

#include <boost/make_shared.hpp>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/ui/DispatchTestNodes.h"
#include "ui/UI_ModKeyNotifier.h"

namespace norvik::ui::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class KeyboardDispatchTest : public DispatchTest {
 protected:
  KeyboardDispatchTest() {
    panel = View("panel", 20, 20, 100, 100, root.get());
    field = View("field", 10, 10, 30, 30, panel.get());
  }
  bool Send(UI_Node* inNode, const KeyboardEvent& inEvent) { return UI_Node::UI_DispatchKeyboardEvent(inNode, inEvent); }

  EventViewP panel, field;
};

// Each row sets the panel between the focused field and the root up, sends
// one event, and lists the nodes that saw it, in order.
TEST_F(KeyboardDispatchTest, AKeyClimbsFromTheFocusedNodeUntilHandledPassingOverDisabledNodes) {
  struct Row {
    const char* name;
    std::function<void(EventView&)> setUp;
    bool toRoot;  // sent with nothing focused: the window sends to itself
    KeyboardEvent event;
    std::vector<std::string> seen;
  };
  const KeyboardEvent a = KeyDownEvent('A', 'A');
  const auto keepChars = [](EventView& p) { p.passCharsToParent = false; };
  const Row rows[] = {
      {"unhandled", nullptr, false, a, {"field.key(field)", "panel.key(field)", "root.key(field)"}},
      {"handled by the panel", [](EventView& p) { p.handlesKey = true; }, false, a,
       {"field.key(field)", "panel.key(field)"}},
      {"self-disabled panel", [](EventView& p) { p.UI_SetSelfDisabled(true); }, false, a,
       {"field.key(field)", "root.key(field)"}},
      {"disabled panel", [](EventView& p) { p.UI_SetDisabled(true); }, false, a, {"root.key(field)"}},
      {"characters kept", keepChars, false, CharEvent('x'), {"field.key(field)", "panel.key(field)"}},
      {"key downs still climb", keepChars, false, KeyDownEvent('X', 'X'),
       {"field.key(field)", "panel.key(field)", "root.key(field)"}},
      {"characters kept by a disabled panel",
       [](EventView& p) { p.passCharsToParent = false, p.UI_SetSelfDisabled(true); }, false, CharEvent('x'),
       {"field.key(field)"}},
      {"nothing focused", nullptr, true, a, {"root.key(root)"}},
  };
  for (const Row& row : rows) {
    SCOPED_TRACE(row.name);
    EventViewP rowPanel = View("panel", 20, 20, 100, 100, root.get());
    EventViewP rowField = View("field", 10, 10, 30, 30, rowPanel.get());
    if (row.setUp) row.setUp(*rowPanel);
    log.Clear();
    const bool handled = Send(row.toRoot ? root.get() : rowField.get(), row.event);
    EXPECT_EQ(handled, rowPanel->handlesKey) << "only a handler ends the walk with a yes";
    EXPECT_EQ(log.Texts(), row.seen);
    root->ChildRemove(rowPanel.get());
  }
}

TEST_F(KeyboardDispatchTest, WithNoNodeAtAllOnlyTheFiltersSeeTheKey) {
  manager.AddKeyboardEventFilterNode(panel.get());
  EXPECT_FALSE(Send(nullptr, KeyDownEvent('A', 'A')));
  EXPECT_THAT(log.Texts(), ElementsAre("panel.prekey(-)"));
}

TEST_F(KeyboardDispatchTest, FiltersSeeTheKeyFirstNewestFirstAndCanClaimIt) {
  EventViewP older = View("older", 0, 0, 1, 1, nullptr);
  EventViewP newer = View("newer", 0, 0, 1, 1, nullptr);
  manager.AddKeyboardEventFilterNode(older.get());
  manager.AddKeyboardEventFilterNode(newer.get());
  Send(field.get(), KeyDownEvent('A', 'A'));
  EXPECT_THAT(log.Texts(), ElementsAre("newer.prekey(field)", "older.prekey(field)", "field.key(field)",
                                       "panel.key(field)", "root.key(field)"));
  log.Clear();
  newer->handlesPreKey = true;
  EXPECT_TRUE(Send(field.get(), KeyDownEvent('A', 'A')));
  EXPECT_THAT(log.Texts(), ElementsAre("newer.prekey(field)"));
}

TEST_F(KeyboardDispatchTest, AKeyboardFilterThatRemovesItselfLeavesTheOthersInThePass) {
  EventViewP older = View("older", 0, 0, 1, 1, nullptr);
  EventViewP newer = View("newer", 0, 0, 1, 1, nullptr);
  manager.AddKeyboardEventFilterNode(older.get());
  manager.AddKeyboardEventFilterNode(newer.get());
  bool destroyed = false;
  newer->destroyedFlag = &destroyed;
  EventView* raw = newer.get();
  newer->onPreKey = [&](UI_Node*, const KeyboardEvent&) {
    manager.RemoveKeyboardEventFilterNode(raw);
    newer.reset();
    return false;
  };
  Send(field.get(), KeyDownEvent('A', 'A'));
  EXPECT_THAT(log.Texts("prekey"), ElementsAre("newer.prekey(field)", "older.prekey(field)"));
  EXPECT_TRUE(destroyed);
  EXPECT_EQ(manager.GetKeyboardEventFiltersSize(), 1u);
}

TEST_F(KeyboardDispatchTest, ACustomKeyboardFunctionCanTakeOverFromTheHandler) {
  using KeyFunction = boost::function<bool(UI_Node*, const KeyboardEvent&, bool&)>;
  std::vector<UI_Node*> targets;
  panel->UI_SetCustomKeyboardEventFunction(boost::make_shared<KeyFunction>(
      [&](UI_Node* inTarget, const KeyboardEvent& inEvent, bool& outTookOver) {
        targets.push_back(inTarget);
        outTookOver = inEvent.GetOSCode() == 'T';
        return true;
      }));
  EXPECT_TRUE(Send(field.get(), KeyDownEvent('T', 'T')));
  EXPECT_THAT(log.Texts(), ElementsAre("field.key(field)"));
  log.Clear();
  EXPECT_FALSE(Send(field.get(), KeyDownEvent('U', 'U')));
  EXPECT_THAT(log.Texts(), ElementsAre("field.key(field)", "panel.key(field)", "root.key(field)"));
  EXPECT_THAT(targets, ElementsAre(field.get(), field.get()));
}

TEST_F(KeyboardDispatchTest, AFocusedNodeThatDeletesItselfStillLetsItsFormerAncestorsSeeTheKey) {
  bool destroyed = false;
  field->destroyedFlag = &destroyed;
  EventView* raw = field.get();
  field.reset();
  raw->onKey = [&](UI_Node*, const KeyboardEvent&) {
    panel->ChildRemove(raw);
    return false;
  };
  EXPECT_FALSE(Send(raw, KeyDownEvent(27, 0)));
  EXPECT_TRUE(destroyed);
  EXPECT_THAT(log.Texts(), ElementsAre("field.key(field)", "panel.key(field)", "root.key(field)"));
}

TEST_F(KeyboardDispatchTest, AnAncestorThatDeletesTheFocusedBranchDoesNotBreakTheWalk) {
  bool destroyed = false;
  panel->destroyedFlag = &destroyed;
  EventView* rawPanel = panel.get();
  EventView* rawField = field.get();
  panel.reset();
  field.reset();
  rawPanel->onKey = [&](UI_Node*, const KeyboardEvent&) {
    root->ChildRemove(rawPanel);
    return false;
  };
  Send(rawField, KeyDownEvent(27, 0));
  EXPECT_TRUE(destroyed);
  EXPECT_THAT(log.Texts(), ElementsAre("field.key(field)", "panel.key(field)", "root.key(field)"));
}

TEST_F(KeyboardDispatchTest, DuringAGestureEveryKeyGoesToTheCaptureAndNoneToTheTree) {
  EventViewP filter = View("filter", 0, 0, 1, 1, nullptr);
  manager.AddKeyboardEventFilterNode(filter.get());
  manager.BeginInputCapture(Capture(field.get(), MouseAt(MouseEvent::kActionButtonDown, PointF(5, 5))));
  EXPECT_TRUE(Send(field.get(), KeyDownEvent('A', 'A')));
  EXPECT_TRUE(Send(nullptr, CharEvent('a')));
  EXPECT_THAT(log.Texts(), IsEmpty());
  EXPECT_THAT(captureLog, ElementsAre("capture.Begin", "capture.Key1", "capture.Key3"));
}

struct ActivateCase {
  const char* name;
  KeyboardEvent event;
  bool activates;
};

TEST(ControlActivateShortcut, SpaceOrCtrlEnterGoingDownAndSpaceReturnOrEnterComingUp) {
  const ModifierKeys ctrl(kModKeyCtrl), shift(kModKeyShift), none;
  const ActivateCase cases[] = {
      {"Space down", KeyDownEvent(32, ' '), true},
      {"Space down with Shift", KeyDownEvent(32, ' ', shift), false},
      {"Space down repeated", KeyDownEvent(32, ' ', none, true), false},
      {"Return down", KeyDownEvent(13, 13), false},
      {"Ctrl+Return down", KeyDownEvent(13, 13, ctrl), true},
      {"Ctrl+Return down repeated", KeyDownEvent(13, 13, ctrl, true), false},
      {"Ctrl+Enter down", KeyDownEvent(-13, 13, ctrl), true},
      {"Enter down", KeyDownEvent(-13, 13), false},
      {"Ctrl+Shift+Return down", KeyDownEvent(13, 13, ctrl | shift), false},
      {"Ctrl+Return down with Caps Lock on", KeyDownEvent(13, 13, ctrl | ModifierKeys(kModKeyCapsLock)), true},
      {"Space up", KeyUpEvent(32, ' '), true},
      {"Space up with Ctrl", KeyUpEvent(32, ' ', ctrl), false},
      {"Return up", KeyUpEvent(13, 13), true},
      {"Ctrl+Return up", KeyUpEvent(13, 13, ctrl), true},
      {"Shift+Enter up", KeyUpEvent(-13, 13, shift), true},
      {"Escape down", KeyDownEvent(27, 27), false},
      {"A up", KeyUpEvent('A', 'A'), false},
      {"Space typed", CharEvent(' '), false},
  };
  for (const ActivateCase& c : cases) {
    EXPECT_EQ(UI_NodeManager::CompareControlActivateShortcut(c.event), c.activates) << c.name;
  }
}

class ModKeyNotifierTest : public DispatchTest {
 protected:
  ModKeyNotifierTest() {
    // Start every case from a known state, whatever earlier cases left.
    UI_ModKeyNotifier::Get().DispatchModKeyEvent(ModifierKeys());
  }
  // The notifier outlives the test, and so do the functions installed in it:
  // they write into a list that they share with the test.
  UI_ModKeyNotifier::ModKeyChangedFunction Recorder(const char* inName) {
    std::shared_ptr<std::vector<std::string>> sink = calls;
    return boost::make_shared<boost::function<void(ModifierKeys)>>([sink, inName](ModifierKeys inKeys) {
      sink->push_back(std::string(inName) + ":" + std::to_string(inKeys.Get()) + ":stored" +
                      std::to_string(UI_ModKeyNotifier::GetConst().GetModKeys().Get()));
    });
  }
  std::shared_ptr<std::vector<std::string>> calls = std::make_shared<std::vector<std::string>>();
};

TEST_F(ModKeyNotifierTest, FunctionsRunInOrderOnlyWhenTheModifiersChangeAndTheNewOnesAreStoredAfterwards) {
  UI_ModKeyNotifier& notifier = UI_ModKeyNotifier::Get();
  notifier.InstallModKeyChangedFunction(Recorder("first"));
  notifier.InstallModKeyChangedFunction(UI_ModKeyNotifier::ModKeyChangedFunction());
  notifier.InstallModKeyChangedFunction(Recorder("second"));
  notifier.DispatchModKeyEvent(ModifierKeys(kModKeyShift));
  notifier.DispatchModKeyEvent(ModifierKeys(kModKeyShift));
  EXPECT_THAT(*calls, ElementsAre("first:2:stored0", "second:2:stored0"));
  EXPECT_EQ(notifier.GetModKeys(), ModifierKeys(kModKeyShift));
}

TEST_F(ModKeyNotifierTest, ComingToTheFrontDispatchesTheKeyboardsCurrentState) {
  UI_ModKeyNotifier::Get().InstallModKeyChangedFunction(Recorder("n"));
  platform.mCurrentModKeys = ModifierKeys(kModKeyAlt);
  manager.NotifyApplicationActivationChanged(false);
  EXPECT_THAT(*calls, IsEmpty()) << "going to the background tells nothing";
  manager.NotifyApplicationActivationChanged(true);
  EXPECT_THAT(*calls, ElementsAre("n:16:stored0"));
}

}  // namespace
}  // namespace norvik::ui::test
