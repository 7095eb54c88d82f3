// The message table of native windows: size and the minimise rule, closing
// through the parent container, the cursor under a modal window, focus put
// back on activation, keyboard translation, node timers on native timers, and
// the statics that find windows.
#include <gmock/gmock.h>

#include <boost/make_shared.hpp>

#include "tarsel/ErrorManager.h"
#include "support/ui/NativeWindowTestSupport.h"
#include "ui/OS_Window.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui::test {
namespace {

using NativeWindowMessageTest = NativeWindowTest;

int CountSizeChanges(UI_Node& inNode, int& outCount) {
  inNode.InstallSizeChangedFunction(boost::make_shared<boost::function<void()>>([&outCount] { ++outCount; }));
  return 0;
}

// ---- size ----

TEST_F(NativeWindowMessageTest, ResizingTheWindowTellsTheNodeItsNewSize) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 100));
  int changes = 0;
  CountSizeChanges(*window, changes);
  window->UI_SetLocalRect(UI_Node::RectL(0, 0, 300, 150));
  EXPECT_EQ(changes, 1);
  EXPECT_EQ(window->UI_GetLocalRect(), UI_Node::RectL(0, 0, 300, 150));
}

TEST_F(NativeWindowMessageTest, RestoringAMinimisedWindowToTheSameSizeSendsNoSizeChange) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 100));
  int changes = 0;
  CountSizeChanges(*window, changes);
  mLayer.SendMessage(window->GetHandle(), kOSMsgSysCommand, kOSSysCommandMinimize, 0);
  EXPECT_TRUE(window->UI_IsMinimized());
  mLayer.ShowWindow(window->GetHandle(), kOSShowRestore);
  EXPECT_FALSE(window->UI_IsMinimized());
  EXPECT_EQ(changes, 0);
  // The next real change is heard again.
  window->UI_SetLocalRect(UI_Node::RectL(0, 0, 250, 100));
  EXPECT_EQ(changes, 1);
}

// ---- close ----

// A parent that refuses, or accepts, to let its children go.
class GuardingView : public UI_SubView {
 public:
  bool ChildRequestRemove(UI_Node* inChild) override {
    ++requests;
    return allow && UI_SubView::ChildRequestRemove(inChild);
  }
  bool allow = false;
  int requests = 0;
};

TEST_F(NativeWindowMessageTest, ACloseThatTheParentContainerRefusesIsDropped) {
  auto top = MakeTopLevel(OS_Rect(0, 0, 300, 300));
  boost::intrusive_ptr<GuardingView> guard(new GuardingView);
  guard->UI_SetLocalRectF(UI_Node::RectF(0, 0, 300, 300));
  guard->UI_Show(true);
  top->ChildPushBack(guard);
  OS_ViewContainerP inner(new OS_ViewContainer(false));
  guard->ChildPushBack(inner);
  const OS_WindowHandle handle = inner->GetHandle();

  EXPECT_EQ(mLayer.SendMessage(handle, kOSMsgClose, 0, 0), 0);
  EXPECT_EQ(guard->requests, 1);
  EXPECT_TRUE(mLayer.IsWindow(handle));
  EXPECT_EQ(inner->UI_GetParentNode(), guard.get());

  guard->allow = true;
  mLayer.SendMessage(handle, kOSMsgClose, 0, 0);
  EXPECT_EQ(inner->UI_GetParentNode(), nullptr);
  EXPECT_FALSE(mLayer.IsWindow(handle));
  EXPECT_EQ(inner->GetHandle(), 0u);
}

TEST_F(NativeWindowMessageTest, AWindowDestroyedFromOutsideLeavesANodeWithoutAHandle) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 100, 100));
  mLayer.DestroyWindow(window->GetHandle());
  EXPECT_EQ(window->GetHandle(), 0u);
  EXPECT_FALSE(window->UI_IsShown());
  window->UI_Show(true);
  window->UI_SetLocalRect(UI_Node::RectL(0, 0, 10, 10));
  EXPECT_TRUE(window->UI_GetLocalRect().IsEmpty());
}

TEST_F(NativeWindowMessageTest, ADestroyedWindowLeavesNoFocusHoverOrFilterPointingIntoItsTree) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  InputRecorderViewP leaf;
  {
    auto panel = AddView(window.get(), "panel", 0, 0, 200, 200);
    leaf = AddView(panel.get(), "leaf", 10, 10, 50, 50);
  }
  leaf->wantsFocus = true;
  mSystem.MovePointer(OS_Point(20, 20));
  mSystem.Pump();
  ASSERT_EQ(mManager.GetMouseOverLeafNode(), leaf.get());
  ASSERT_TRUE(leaf->UI_GainKeyboardFocus(kFocusChangeMouse));
  mManager.AddMouseEventFilterNode(leaf.get());
  mManager.AddKeyboardEventFilterNode(leaf.get());
  window.reset();
  EXPECT_EQ(mManager.GetKeyboardFocusLeafNode(), nullptr);
  EXPECT_EQ(mManager.GetPreviousKeyboardFocusLeafNode(), nullptr);
  EXPECT_EQ(mManager.GetMouseOverLeafNode(), nullptr);
  EXPECT_EQ(mManager.GetMouseOverRootNode(), nullptr);
  EXPECT_EQ(mManager.GetMouseEventFiltersSize() + mManager.GetKeyboardEventFiltersSize(), 0u)
      << "a node kept alive outside the window no longer filters events";
}

// ---- cursor ----

TEST_F(NativeWindowMessageTest, WithAModalWindowUpTheCursorOverAnotherWindowStaysThePlatforms) {
  auto plain = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  auto plainView = AddView(plain.get(), "plain", 0, 0, 200, 200);
  auto modal = MakeTopLevel(OS_Rect(300, 0, 200, 200));
  auto modalView = AddView(modal.get(), "modal", 0, 0, 200, 200);
  int plainAsked = 0, modalAsked = 0;
  using CursorFn = boost::function<bool(UI_Node*, UI_Node::PointF const&, UI_Node::ModKeys, bool&)>;
  plainView->UI_SetCustomDoCursorFunction(boost::make_shared<CursorFn>(
      [&](UI_Node*, UI_Node::PointF const&, UI_Node::ModKeys, bool&) { return ++plainAsked, true; }));
  modalView->UI_SetCustomDoCursorFunction(boost::make_shared<CursorFn>(
      [&](UI_Node*, UI_Node::PointF const&, UI_Node::ModKeys, bool&) { return ++modalAsked, true; }));

  UI_NodeManager::SetModalWindow modalScope(&mManager, modal.get());
  mSystem.MovePointer(OS_Point(50, 50));
  mSystem.Pump();
  mLayer.SendMessage(plain->GetHandle(), kOSMsgSetCursor, plain->GetHandle(), 1);
  mSystem.MovePointer(OS_Point(350, 50));
  mSystem.Pump();
  mLayer.SendMessage(modal->GetHandle(), kOSMsgSetCursor, modal->GetHandle(), 1);
  EXPECT_EQ(plainAsked, 0);
  EXPECT_GE(modalAsked, 1);
}

TEST_F(NativeWindowMessageTest, WithoutAModalWindowTheViewUnderThePointerChoosesTheCursor) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  auto view = AddView(window.get(), "view", 0, 0, 200, 200);
  int asked = 0;
  using CursorFn = boost::function<bool(UI_Node*, UI_Node::PointF const&, UI_Node::ModKeys, bool&)>;
  view->UI_SetCustomDoCursorFunction(boost::make_shared<CursorFn>(
      [&](UI_Node*, UI_Node::PointF const&, UI_Node::ModKeys, bool&) { return ++asked, true; }));
  mSystem.MovePointer(OS_Point(50, 50));
  mSystem.Pump();
  asked = 0;
  EXPECT_EQ(mLayer.SendMessage(window->GetHandle(), kOSMsgSetCursor, window->GetHandle(), 1), 0);
  EXPECT_EQ(asked, 1);
}

TEST_F(NativeWindowMessageTest, AModifierChangeAsksForTheCursorWhereThePointerReallyIs) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  auto view = AddView(window.get(), "view", 0, 0, 200, 200);
  std::vector<UI_Node::PointF> asked;
  using CursorFn = boost::function<bool(UI_Node*, UI_Node::PointF const&, UI_Node::ModKeys, bool&)>;
  view->UI_SetCustomDoCursorFunction(boost::make_shared<CursorFn>(
      [&](UI_Node*, UI_Node::PointF const& inPoint, UI_Node::ModKeys, bool&) { return asked.push_back(inPoint), true; }));
  mSystem.MovePointer(OS_Point(50, 50));
  mSystem.Pump();
  mSystem.MovePointer(OS_Point(60, 70));  // not yet pumped: only the native layer knows
  asked.clear();
  ASSERT_EQ(mManager.GetMouseOverRootNode(), window.get());
  mManager.DispatchCursorToMouseOverRootNode(UI_Node::ModKeys(kModKeyShift));
  EXPECT_EQ(asked, std::vector<UI_Node::PointF>{UI_Node::PointF(60, 70)});
}

// ---- activation and focus ----

TEST_F(NativeWindowMessageTest, ActivationKeepsFocusOnTheViewInsideTheWindow) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  auto field = AddView(window.get(), "field", 10, 10, 50, 20);
  field->wantsFocus = true;
  window->UI_Activate();
  mSystem.Pump();
  ASSERT_TRUE(field->UI_GainKeyboardFocus(kFocusChangeMouse));
  // The platform's own activation moves native focus to the top window; the
  // focus inside the window is put back on the view.
  mLayer.SendMessage(window->GetHandle(), kOSMsgActivate, kOSActivationClickActive, 0);
  mSystem.Pump();
  EXPECT_EQ(UI_Node::UI_GetKeyboardFocusLeafNode(), field.get());
  EXPECT_EQ(mLayer.GetActiveWindow(), window->GetHandle());
}

TEST_F(NativeWindowMessageTest, EndingAModalWindowActivatesTheModalWindowBeneath) {
  auto lower = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  auto upper = MakeTopLevel(OS_Rect(300, 0, 200, 200));
  UI_NodeManager::SetModalWindow lowerScope(&mManager, lower.get());
  {
    UI_NodeManager::SetModalWindow upperScope(&mManager, upper.get());
    upper->UI_Activate();
    mSystem.Pump();
    ASSERT_EQ(mLayer.GetActiveWindow(), upper->GetHandle());
  }
  mSystem.Pump();
  EXPECT_EQ(mLayer.GetActiveWindow(), lower->GetHandle());
}

// ---- keyboard ----

TEST_F(NativeWindowMessageTest, CtrlWithALetterGivesTheLetterNotTheControlCode) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  window->UI_Activate();
  mLayer.SetFocus(window->GetHandle());
  // Scan code 0x2E is C; the character message carries control code 3.
  const OS_Event ctrlC(window->GetHandle(), kOSMsgChar, 3, 1 | (0x2E << 16));
  mSystem.PressKey(kOSKeyControl);
  mSystem.Pump();
  const KeyboardEvent event = window->UI_GetKeyboardEventFromOSEvent(ctrlC);
  mSystem.ReleaseKey(kOSKeyControl);
  EXPECT_EQ(event.GetCharacter(), u'C');
  EXPECT_EQ(event.GetOSCode(), 'C');
  EXPECT_EQ(event.GetAction(), KeyboardEvent::kActionKeyChar);
}

TEST_F(NativeWindowMessageTest, ExtendedKeysAreNegativeAndUnderNumLockAKeypadKeyBecomesItsDigitWithShift) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  const KeyboardEvent del =
      window->UI_GetKeyboardEventFromOSEvent(OS_Event(window->GetHandle(), kOSMsgKeyDown, 46, 1 | (1 << 24)));
  EXPECT_EQ(del.GetOSCode(), -46);
  const KeyboardEvent rightCtrl = window->UI_GetKeyboardEventFromOSEvent(
      OS_Event(window->GetHandle(), kOSMsgKeyDown, kOSKeyControl, 1 | (1 << 24)));
  EXPECT_EQ(rightCtrl.GetOSCode(), kOSKeyControl) << "modifiers stay positive";
  EXPECT_TRUE(window->UI_GetKeyboardEventFromOSEvent(OS_Event(window->GetHandle(), kOSMsgKeyDown, 'A', 1 | (1 << 30)))
                  .IsRepeat());
  mSystem.SetKeyToggled(kOSKeyNumLock, true);
  const KeyboardEvent home =
      window->UI_GetKeyboardEventFromOSEvent(OS_Event(window->GetHandle(), kOSMsgKeyDown, 36, 1));
  EXPECT_EQ(home.GetOSCode(), 103);
  EXPECT_EQ(home.GetCharacter(), u'7');
  EXPECT_TRUE(home.GetModKey().Test(kModKeyShift));
  // The navigation block's own Home key is extended and stays what it is.
  const KeyboardEvent extendedHome =
      window->UI_GetKeyboardEventFromOSEvent(OS_Event(window->GetHandle(), kOSMsgKeyDown, 36, 1 | (1 << 24)));
  EXPECT_EQ(extendedHome.GetOSCode(), -36);
  mSystem.SetKeyToggled(kOSKeyNumLock, false);
  const KeyboardEvent plain =
      window->UI_GetKeyboardEventFromOSEvent(OS_Event(window->GetHandle(), kOSMsgKeyDown, 36, 1));
  EXPECT_EQ(plain.GetOSCode(), 36);
}

// ---- timers ----

TEST_F(NativeWindowMessageTest, NodeTimersFireOnTheVirtualClockUntilRemovedAnsweredFalseOrTheirViewDies) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 200, 200));
  auto view = AddView(window.get(), "view", 0, 0, 10, 10);
  auto once = AddView(window.get(), "once", 0, 0, 10, 10);
  auto doomed = AddView(window.get(), "doomed", 0, 0, 10, 10);
  view->UI_InstallTimer(0.1f, 7);
  once->keepTimers = false;
  once->UI_InstallTimer(0.05f, 3);
  doomed->UI_InstallTimer(0.05f, 3);
  window->ChildRemove(doomed.get());
  doomed.reset();
  mSystem.AdvanceClock(99);
  EXPECT_TRUE(view->timerFirings.empty());
  mSystem.AdvanceClock(251);
  EXPECT_THAT(view->timerFirings, ::testing::ElementsAre(7, 7, 7));
  EXPECT_EQ(once->timerFirings.size(), 1u) << "its notification answered false";
  view->UI_RemoveTimer(7, false);
  mSystem.AdvanceClock(500);
  EXPECT_EQ(view->timerFirings.size(), 3u);
  EXPECT_EQ(window->UI_GetTimerManager(false)->GetTimerCount(), 0u);
}

// ---- finding windows, errors ----

TEST_F(NativeWindowMessageTest, WindowsAreFoundByHandleByIdAndUnderThePointer) {
  auto a = MakeTopLevel(OS_Rect(0, 0, 100, 100));
  auto b = MakeTopLevel(OS_Rect(200, 0, 100, 100));
  b->UI_SetNodeID("second");
  EXPECT_EQ(OS_Window::UI_GetWindow(a->GetHandle()), a.get());
  EXPECT_EQ(OS_Window::UI_FindWindowFromID("second"), b.get());
  EXPECT_EQ(OS_Window::UI_FindWindowFromID("nothing"), nullptr);
  EXPECT_EQ(OS_Window::GetWindowFromMouse(UI_Node::PointL(250, 50)), b.get());
  EXPECT_TRUE(OS_Window::UI_IsOSWindowType(a->GetHandle()));
  OS_WindowCreateParams foreign;
  foreign.rect = OS_Rect(0, 300, 10, 10);
  const OS_WindowHandle other = mSystem.CreateForeignWindow(foreign, true);
  EXPECT_EQ(OS_Window::UI_GetWindow(other), nullptr);
}

TEST_F(NativeWindowMessageTest, AnExceptionInAHandlerIsReportedAndDoesNotLeaveTheWindowProcedure) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 100, 100));
  auto view = AddView(window.get(), "view", 0, 0, 100, 100);
  view->onMouse = [](const MouseEvent&) { throw std::runtime_error("handler failed"); };
  std::vector<UTF16String> reports;
  auto* errors = tarsel::config::ErrorManager::Get(true);
  auto previous = errors->SetReportHandler(
      [&](const tarsel::config::ErrorReport& inReport) { reports.push_back(inReport.mMessage); });
  EXPECT_NO_THROW({
    mSystem.Click(OS_Point(10, 10));
    mSystem.Pump();
  });
  errors->SetReportHandler(previous);
  EXPECT_FALSE(reports.empty());
}

TEST_F(NativeWindowMessageTest, TheStructureRectangleIsTheWholeWindowOnTheScreen) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 100, 100));
  window->UI_SetGlobalStructureRect(UI_Node::RectL(50, 60, 300, 200));
  EXPECT_EQ(window->UI_GetGlobalStructureRect(), UI_Node::RectL(50, 60, 300, 200));
  EXPECT_EQ(mLayer.GetWindowRect(window->GetHandle()), OS_Rect(50, 60, 300, 200));
  window->UI_Move(UI_Node::PointL(70, 80));
  EXPECT_EQ(window->UI_GetGlobalStructureRect(), UI_Node::RectL(70, 80, 300, 200));
}

TEST_F(NativeWindowMessageTest, WhileMouseActivationIsSuspendedAClickBringsTheSuspendingWindowForward) {
  auto popup = MakeTopLevel(OS_Rect(0, 0, 100, 100));
  auto other = MakeTopLevel(OS_Rect(200, 0, 100, 100));
  UI_NodeManager::SuspendOSMouseActivates suspend(&mManager, reinterpret_cast<void*>(popup->GetHandle()));
  mSystem.DeactivateApplication();
  mManager.SetApplicationFrontmost(false);
  const std::intptr_t result = mLayer.SendMessage(other->GetHandle(), kOSMsgMouseActivate, other->GetHandle(), 0);
  EXPECT_EQ(result, kOSMouseNoActivateAndEat);
  EXPECT_EQ(mLayer.GetForegroundWindow(), popup->GetHandle());
  // Once the click's own window is in front, the click goes through as it is.
  EXPECT_EQ(mLayer.SendMessage(popup->GetHandle(), kOSMsgMouseActivate, popup->GetHandle(), 0), 0);
}

TEST_F(NativeWindowMessageTest, LayeredOpacityIsAppliedAndOneRemovesIt) {
  auto window = MakeTopLevel(OS_Rect(0, 0, 100, 100));
  window->UI_SetOpacity(0.5f);
  EXPECT_EQ(mSystem.GetOpacity(window->GetHandle()), 128);
  EXPECT_NE(mLayer.GetExStyle(window->GetHandle()) & kOSExStyleLayered, 0u);
  window->UI_SetOpacity(1.0f);
  EXPECT_EQ(mLayer.GetExStyle(window->GetHandle()) & kOSExStyleLayered, 0u);
  window->UI_SetOpacity(7.0f);  // out of range: nothing happens
  EXPECT_EQ(mLayer.GetExStyle(window->GetHandle()) & kOSExStyleLayered, 0u);
}

}  // namespace
}  // namespace norvik::ui::test
