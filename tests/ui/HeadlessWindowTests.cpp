// The headless window system's windows: creation and destruction, links,
// z-order, visibility, geometry, activation, focus and capture.
#include <algorithm>

#include <gmock/gmock.h>

#include "support/ui/HeadlessTestSupport.h"

namespace norvik::ui::test {
namespace {

using ::testing::ElementsAre;

using HeadlessWindowTest = HeadlessFixture;

// ---- creation and destruction ----

TEST_F(HeadlessWindowTest, CreationDeliversTheCreateParameterFirstAndThenTheSize) {
  int marker = 0;
  OS_WindowCreateParams params;
  params.rect = OS_Rect(10, 20, 300, 200);
  params.createParam = &marker;
  const OS_WindowHandle window = mLayer.CreateWindow(params);
  ASSERT_NE(window, 0u);
  ASSERT_GE(mMessages.size(), 2u);
  EXPECT_EQ(mMessages[0].message, kOSMsgNCCreate);
  EXPECT_EQ(mMessages[0].lParam, reinterpret_cast<std::intptr_t>(&marker));
  EXPECT_EQ(mMessages[1].message, kOSMsgSize);
  EXPECT_EQ(PointParamX(mMessages[1].lParam), 300);
  EXPECT_EQ(PointParamY(mMessages[1].lParam), 200);
  EXPECT_TRUE(mLayer.IsWindow(window));
  EXPECT_FALSE(mLayer.IsWindowVisible(window));
  EXPECT_EQ(mLayer.GetClassName(window), UTF16String(u"TolliverLord - Window Class"));
}

TEST_F(HeadlessWindowTest, AWindowWhoseProcedureRefusesCreationDoesNotExist) {
  mHandler = [](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message == kOSMsgNCCreate) return 0;
    return std::nullopt;
  };
  EXPECT_EQ(MakeWindow(OS_Rect(0, 0, 10, 10)), 0u);
  EXPECT_EQ(Messages(kOSMsgNCDestroy).size(), 1u);
  EXPECT_TRUE(mLayer.EnumerateWindows().empty());
}

TEST_F(HeadlessWindowTest, DestroyingSendsDestroyParentFirstAndFinalDestroyChildrenFirst) {
  const OS_WindowHandle parent = MakeWindow(OS_Rect(0, 0, 100, 100));
  const OS_WindowHandle child = MakeChild(parent, OS_Rect(0, 0, 10, 10));
  Clear();
  mLayer.DestroyWindow(parent);
  std::vector<std::pair<OS_WindowHandle, unsigned>> order;
  for (const RecordedMessage& m : mMessages)
    if (m.message == kOSMsgDestroy || m.message == kOSMsgNCDestroy) order.emplace_back(m.window, m.message);
  EXPECT_THAT(order, ElementsAre(std::make_pair(parent, unsigned(kOSMsgDestroy)),
                                 std::make_pair(child, unsigned(kOSMsgDestroy)),
                                 std::make_pair(child, unsigned(kOSMsgNCDestroy)),
                                 std::make_pair(parent, unsigned(kOSMsgNCDestroy))));
  EXPECT_FALSE(mLayer.IsWindow(parent));
  EXPECT_FALSE(mLayer.IsWindow(child));
}

TEST_F(HeadlessWindowTest, DestroyingAWindowAgainFromItsOwnDestroyHandlerIsHarmless) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(0, 0, 100, 100));
  const OS_WindowHandle other = MakeWindow(OS_Rect(0, 0, 100, 100));
  mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message == kOSMsgDestroy) {
      mLayer.DestroyWindow(window);
      mLayer.DestroyWindow(other);
    }
    return std::nullopt;
  };
  mLayer.DestroyWindow(window);
  EXPECT_FALSE(mLayer.IsWindow(window));
  EXPECT_FALSE(mLayer.IsWindow(other));
  EXPECT_EQ(Messages(kOSMsgNCDestroy, window).size(), 1u);
}

TEST_F(HeadlessWindowTest, CloseDestroysTheWindowByDefaultButNotWhenHandled) {
  const OS_WindowHandle kept = MakeWindow(OS_Rect(0, 0, 10, 10));
  const OS_WindowHandle closed = MakeWindow(OS_Rect(0, 0, 10, 10));
  mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message == kOSMsgClose && inMessage.window == kept) return 0;
    return std::nullopt;
  };
  mLayer.PostMessage(kept, kOSMsgClose, 0, 0);
  mLayer.PostMessage(closed, kOSMsgClose, 0, 0);
  mSystem.Pump();
  EXPECT_TRUE(mLayer.IsWindow(kept));
  EXPECT_FALSE(mLayer.IsWindow(closed));
}

TEST_F(HeadlessWindowTest, OwnedWindowsAreDestroyedWithTheirOwner) {
  const OS_WindowHandle owner = MakeWindow(OS_Rect(0, 0, 100, 100));
  const OS_WindowHandle owned = MakeWindow(OS_Rect(0, 0, 50, 50), kOSStyleVisible | kOSStylePopup, 0, owner);
  EXPECT_EQ(mLayer.GetOwner(owned), owner);
  EXPECT_EQ(mLayer.GetParent(owned), 0u);
  mLayer.DestroyWindow(owner);
  EXPECT_FALSE(mLayer.IsWindow(owned));
}

// ---- properties, text, styles, foreign windows ----

TEST_F(HeadlessWindowTest, AForeignWindowGetsDefaultHandlingUntilSubclassed) {
  OS_WindowCreateParams params;
  params.rect = OS_Rect(0, 0, 10, 10);
  const OS_WindowHandle foreign = mSystem.CreateForeignWindow(params);
  ASSERT_NE(foreign, 0u);
  EXPECT_FALSE(mLayer.UsesOurProcedure(foreign));
  mLayer.SendMessage(foreign, kOSMsgCommand, 1, 0);
  EXPECT_TRUE(Messages(kOSMsgCommand).empty());
  EXPECT_TRUE(mLayer.SubclassWindow(foreign));
  EXPECT_TRUE(mLayer.UsesOurProcedure(foreign));
  mLayer.SendMessage(foreign, kOSMsgCommand, 1, 0);
  EXPECT_EQ(Messages(kOSMsgCommand, foreign).size(), 1u);
}

TEST_F(HeadlessWindowTest, AWindowOfAnotherThreadIsNotOursAndCannotBeSubclassed) {
  OS_WindowCreateParams params;
  const OS_WindowHandle foreign = mSystem.CreateForeignWindow(params, true);
  EXPECT_TRUE(mLayer.IsWindow(foreign));
  EXPECT_FALSE(mLayer.IsWindowOfThisThread(foreign));
  EXPECT_FALSE(mLayer.SubclassWindow(foreign));
  const std::vector<OS_WindowHandle> ours = mLayer.EnumerateWindows();
  EXPECT_EQ(std::find(ours.begin(), ours.end(), foreign), ours.end());
}

// ---- z-order ----

std::vector<OS_WindowHandle> TopLevelOrder(const OS_NativeLayer& inLayer) {
  std::vector<OS_WindowHandle> order;
  for (OS_WindowHandle w = inLayer.GetTopWindow(0); w != 0; w = inLayer.GetNextWindow(w, kOSWindowNext))
    order.push_back(w);
  return order;
}

TEST_F(HeadlessWindowTest, NewWindowsGoOnTopAndTopmostWindowsStayAboveOrdinaryOnes) {
  const OS_WindowHandle a = MakeWindow(OS_Rect(0, 0, 10, 10));
  const OS_WindowHandle topmost = MakeWindow(OS_Rect(0, 0, 10, 10), kOSStyleVisible, kOSExStyleTopmost);
  const OS_WindowHandle b = MakeWindow(OS_Rect(0, 0, 10, 10));
  EXPECT_THAT(TopLevelOrder(mLayer), ElementsAre(topmost, b, a));
  mLayer.SetWindowPos(a, kOSInsertTop, OS_Rect(), kOSPosNoMove | kOSPosNoSize);
  EXPECT_THAT(TopLevelOrder(mLayer), ElementsAre(topmost, a, b));
  mLayer.SetWindowPos(b, kOSInsertTopmost, OS_Rect(), kOSPosNoMove | kOSPosNoSize | kOSPosNoActivate);
  EXPECT_THAT(TopLevelOrder(mLayer), ElementsAre(b, topmost, a));
  mLayer.SetWindowPos(topmost, kOSInsertBottom, OS_Rect(), kOSPosNoMove | kOSPosNoSize | kOSPosNoActivate);
  EXPECT_THAT(TopLevelOrder(mLayer), ElementsAre(b, a, topmost));
  EXPECT_EQ(mLayer.GetExStyle(topmost) & kOSExStyleTopmost, 0u);
}

TEST_F(HeadlessWindowTest, InsertingAfterAWindowPlacesDirectlyBelowIt) {
  const OS_WindowHandle a = MakeWindow(OS_Rect(0, 0, 10, 10));
  const OS_WindowHandle b = MakeWindow(OS_Rect(0, 0, 10, 10));
  const OS_WindowHandle c = MakeWindow(OS_Rect(0, 0, 10, 10));
  mLayer.SetWindowPos(a, c, OS_Rect(), kOSPosNoMove | kOSPosNoSize | kOSPosNoActivate);
  EXPECT_THAT(TopLevelOrder(mLayer), ElementsAre(c, a, b));
  EXPECT_EQ(mLayer.GetNextWindow(a, kOSWindowPrevious), c);
  EXPECT_EQ(mLayer.GetNextWindow(a, kOSWindowLast), b);
}

TEST_F(HeadlessWindowTest, OwnedWindowsStayAboveTheirOwnerWhenItIsRaised) {
  const OS_WindowHandle owner = MakeWindow(OS_Rect(0, 0, 10, 10));
  const OS_WindowHandle owned = MakeWindow(OS_Rect(0, 0, 10, 10), kOSStyleVisible, 0, owner);
  const OS_WindowHandle other = MakeWindow(OS_Rect(0, 0, 10, 10));
  EXPECT_THAT(TopLevelOrder(mLayer), ElementsAre(other, owned, owner));
  mLayer.SetActiveWindow(owner);
  EXPECT_THAT(TopLevelOrder(mLayer), ElementsAre(owned, owner, other));
}

TEST_F(HeadlessWindowTest, ChildrenHaveTheirOwnOrderAndReparentingMovesThem) {
  const OS_WindowHandle a = MakeWindow(OS_Rect(0, 0, 100, 100));
  const OS_WindowHandle b = MakeWindow(OS_Rect(0, 0, 100, 100));
  const OS_WindowHandle first = MakeChild(a, OS_Rect(0, 0, 10, 10));
  const OS_WindowHandle second = MakeChild(a, OS_Rect(0, 0, 10, 10));
  EXPECT_EQ(mLayer.GetTopWindow(a), second);
  EXPECT_EQ(mLayer.GetNextWindow(second, kOSWindowNext), first);
  mLayer.SetParent(first, b);
  EXPECT_EQ(mLayer.GetParent(first), b);
  EXPECT_TRUE(mLayer.IsChild(b, first));
  EXPECT_FALSE(mLayer.IsChild(a, first));
  EXPECT_EQ(mLayer.GetNextWindow(second, kOSWindowNext), 0u);
  mLayer.SetParent(a, second);  // a window cannot go under its own child
  EXPECT_EQ(mLayer.GetParent(a), 0u);
}

// ---- visibility and enable state ----

TEST_F(HeadlessWindowTest, VisibilityFollowsTheStyleBitOfTheWindowAndItsAncestors) {
  const OS_WindowHandle parent = MakeWindow(OS_Rect(0, 0, 100, 100));
  const OS_WindowHandle child = MakeChild(parent, OS_Rect(0, 0, 10, 10));
  EXPECT_TRUE(mLayer.IsWindowVisible(child));
  mLayer.ShowWindow(parent, kOSShowHide);
  EXPECT_EQ(mLayer.GetStyle(parent) & kOSStyleVisible, 0u);
  EXPECT_NE(mLayer.GetStyle(child) & kOSStyleVisible, 0u);
  EXPECT_FALSE(mLayer.IsWindowVisible(child));
  mLayer.ShowWindow(parent, kOSShowNA);
  EXPECT_TRUE(mLayer.IsWindowVisible(child));
}

TEST_F(HeadlessWindowTest, DisablingTracksTheStyleAndTakesFocusAway) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(0, 0, 100, 100));
  const OS_WindowHandle child = MakeChild(window, OS_Rect(0, 0, 10, 10));
  mLayer.SetFocus(child);
  ASSERT_EQ(mLayer.GetFocus(), child);
  mLayer.EnableWindow(child, false);
  EXPECT_NE(mLayer.GetStyle(child) & kOSStyleDisabled, 0u);
  EXPECT_FALSE(mLayer.IsWindowEnabled(child));
  EXPECT_EQ(mLayer.GetFocus(), 0u);
  mLayer.EnableWindow(child, true);
  EXPECT_TRUE(mLayer.IsWindowEnabled(child));
}

// ---- geometry ----

TEST_F(HeadlessWindowTest, ChildCoordinatesAreRelativeToTheParentsClientArea) {
  const OS_WindowHandle parent = MakeWindow(OS_Rect(100, 50, 400, 300));
  const OS_WindowHandle child = MakeChild(parent, OS_Rect(10, 20, 50, 40));
  const OS_WindowHandle grandchild = MakeChild(child, OS_Rect(5, 5, 10, 10));
  EXPECT_EQ(mLayer.GetWindowRect(grandchild), OS_Rect(115, 75, 10, 10));
  EXPECT_EQ(mLayer.GetClientRect(grandchild), OS_Rect(0, 0, 10, 10));
  const OS_Point screen = mLayer.ClientToScreen(child, OS_Point(1, 2));
  EXPECT_EQ(screen.x, 111);
  EXPECT_EQ(screen.y, 72);
  const OS_Point back = mLayer.ScreenToClient(child, screen);
  EXPECT_EQ(back.x, 1);
  EXPECT_EQ(back.y, 2);
}

TEST_F(HeadlessWindowTest, MovingSendsNoSizeMessageButResizingDoes) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(0, 0, 100, 100));
  Clear();
  mLayer.SetWindowPos(window, 0, OS_Rect(30, 40, 0, 0), kOSPosNoSize | kOSPosNoZOrder | kOSPosNoActivate);
  EXPECT_TRUE(Messages(kOSMsgSize).empty());
  EXPECT_EQ(mLayer.GetWindowRect(window), OS_Rect(30, 40, 100, 100));
  mLayer.SetWindowPos(window, 0, OS_Rect(0, 0, 120, 80), kOSPosNoMove | kOSPosNoZOrder | kOSPosNoActivate);
  ASSERT_EQ(Messages(kOSMsgSize).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgSize)[0].wParam, std::uintptr_t(kOSSizeRestored));
  EXPECT_EQ(PointParamX(Messages(kOSMsgSize)[0].lParam), 120);
  EXPECT_EQ(PointParamY(Messages(kOSMsgSize)[0].lParam), 80);
  EXPECT_EQ(mLayer.GetWindowRect(window), OS_Rect(30, 40, 120, 80));
}

TEST_F(HeadlessWindowTest, MaximisingFillsTheWorkAreaOfTheWindowsMonitorAndRestoringReturns) {
  OS_Monitor left{OS_Rect(0, 0, 1000, 800), OS_Rect(0, 0, 1000, 760)};
  OS_Monitor right{OS_Rect(1000, 0, 800, 600), OS_Rect(1000, 30, 800, 570)};
  mSystem.SetMonitors({left, right});
  const OS_WindowHandle window = MakeWindow(OS_Rect(1100, 100, 200, 100));
  Clear();
  mLayer.ShowWindow(window, kOSShowMaximized);
  EXPECT_TRUE(mLayer.IsMaximized(window));
  EXPECT_EQ(mLayer.GetWindowRect(window), right.workArea);
  ASSERT_FALSE(Messages(kOSMsgSize).empty());
  EXPECT_EQ(Messages(kOSMsgSize).back().wParam, std::uintptr_t(kOSSizeMaximized));
  OS_WindowPlacement placement;
  ASSERT_TRUE(mLayer.GetWindowPlacement(window, placement));
  EXPECT_EQ(placement.showCommand, kOSShowMaximized);
  EXPECT_EQ(placement.normalRect, OS_Rect(1100, 100, 200, 100));
  mLayer.ShowWindow(window, kOSShowRestore);
  EXPECT_FALSE(mLayer.IsMaximized(window));
  EXPECT_EQ(mLayer.GetWindowRect(window), OS_Rect(1100, 100, 200, 100));
}

TEST_F(HeadlessWindowTest, MinimisingReportsAnEmptySizeAndRestoringBringsBackTheOldOne) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(10, 10, 200, 100));
  Clear();
  mLayer.ShowWindow(window, kOSShowMinimize);
  EXPECT_TRUE(mLayer.IsMinimized(window));
  EXPECT_NE(mLayer.GetStyle(window) & kOSStyleMinimize, 0u);
  ASSERT_EQ(Messages(kOSMsgSize).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgSize)[0].wParam, std::uintptr_t(kOSSizeMinimized));
  EXPECT_EQ(mLayer.GetActiveWindow(), 0u);  // a minimised window gives up activation
  mLayer.ShowWindow(window, kOSShowRestore);
  EXPECT_FALSE(mLayer.IsMinimized(window));
  EXPECT_EQ(mLayer.GetWindowRect(window), OS_Rect(10, 10, 200, 100));
  EXPECT_EQ(Messages(kOSMsgSize).back().wParam, std::uintptr_t(kOSSizeRestored));
  EXPECT_EQ(mLayer.GetActiveWindow(), window);
}

TEST_F(HeadlessWindowTest, PlacementWithAMaximisedWindowChangesOnlyItsRestoredRectangle) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(10, 10, 200, 100));
  mLayer.ShowWindow(window, kOSShowMaximized);
  const OS_Rect maximized = mLayer.GetWindowRect(window);
  OS_WindowPlacement placement;
  mLayer.GetWindowPlacement(window, placement);
  placement.normalRect = OS_Rect(50, 60, 300, 200);
  mLayer.SetWindowPlacement(window, placement);
  EXPECT_EQ(mLayer.GetWindowRect(window), maximized);
  mLayer.ShowWindow(window, kOSShowNormal);
  EXPECT_EQ(mLayer.GetWindowRect(window), OS_Rect(50, 60, 300, 200));
}

// ---- activation ----

TEST_F(HeadlessWindowTest, ActivationMovesWithCodesAndTheOtherWindowAsParameter) {
  const OS_WindowHandle a = MakeWindow(OS_Rect(0, 0, 10, 10));
  const OS_WindowHandle b = MakeWindow(OS_Rect(0, 0, 10, 10));
  EXPECT_EQ(mLayer.GetActiveWindow(), b);
  EXPECT_EQ(mLayer.GetForegroundWindow(), b);
  Clear();
  mLayer.SetActiveWindow(a);
  const auto activations = Messages(kOSMsgActivate);
  ASSERT_EQ(activations.size(), 2u);
  EXPECT_EQ(activations[0].window, b);
  EXPECT_EQ(LowWord(activations[0].wParam), unsigned(kOSActivationInactive));
  EXPECT_EQ(activations[0].lParam, static_cast<std::intptr_t>(a));
  EXPECT_EQ(activations[1].window, a);
  EXPECT_EQ(LowWord(activations[1].wParam), unsigned(kOSActivationActive));
  EXPECT_EQ(activations[1].lParam, static_cast<std::intptr_t>(b));
  EXPECT_TRUE(Messages(kOSMsgActivateApp).empty());  // one application throughout
  EXPECT_EQ(mLayer.GetFocus(), a);  // the default handling focuses the activated window
}

TEST_F(HeadlessWindowTest, ActivationBetweenApplicationsTellsBoth) {
  const OS_WindowHandle ours = MakeWindow(OS_Rect(0, 0, 10, 10));
  const OS_WindowHandle theirs = MakeWindow(OS_Rect(0, 0, 10, 10), 0);
  mSystem.SetApplication(theirs, 1);
  Clear();
  mLayer.ShowWindow(theirs, kOSShow);
  ASSERT_EQ(Messages(kOSMsgActivateApp).size(), 2u);
  EXPECT_EQ(Messages(kOSMsgActivateApp)[0].window, ours);
  EXPECT_EQ(Messages(kOSMsgActivateApp)[0].wParam, 0u);
  EXPECT_EQ(Messages(kOSMsgActivateApp)[1].window, theirs);
  EXPECT_EQ(Messages(kOSMsgActivateApp)[1].wParam, 1u);
  Clear();
  mSystem.DeactivateApplication();
  EXPECT_EQ(mLayer.GetActiveWindow(), 0u);
  EXPECT_EQ(mLayer.GetFocus(), 0u);
  ASSERT_EQ(Messages(kOSMsgActivateApp).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgActivateApp)[0].window, theirs);
}

TEST_F(HeadlessWindowTest, HidingTheActiveWindowActivatesItsOwnerOrTheNextWindow) {
  const OS_WindowHandle back = MakeWindow(OS_Rect(0, 0, 10, 10));
  const OS_WindowHandle owner = MakeWindow(OS_Rect(0, 0, 10, 10));
  const OS_WindowHandle dialog = MakeWindow(OS_Rect(0, 0, 10, 10), kOSStyleVisible, 0, owner);
  mLayer.SetActiveWindow(back);
  mLayer.SetActiveWindow(dialog);
  mLayer.ShowWindow(dialog, kOSShowHide);
  EXPECT_EQ(mLayer.GetActiveWindow(), owner);
  mLayer.DestroyWindow(owner);
  EXPECT_EQ(mLayer.GetActiveWindow(), back);
}

// ---- focus and capture ----

TEST_F(HeadlessWindowTest, FocusChangesTellBothWindowsAboutEachOtherAndActivateAnInactiveWindow) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(0, 0, 100, 100));
  const OS_WindowHandle a = MakeChild(window, OS_Rect(0, 0, 10, 10));
  const OS_WindowHandle b = MakeChild(window, OS_Rect(20, 0, 10, 10));
  mLayer.SetFocus(a);
  Clear();
  mLayer.SetFocus(b);
  ASSERT_EQ(mMessages.size(), 2u);
  EXPECT_EQ(mMessages[0].window, a);
  EXPECT_EQ(mMessages[0].message, kOSMsgKillFocus);
  EXPECT_EQ(mMessages[0].wParam, b);
  EXPECT_EQ(mMessages[1].window, b);
  EXPECT_EQ(mMessages[1].message, kOSMsgSetFocus);
  EXPECT_EQ(mMessages[1].wParam, a);
  EXPECT_EQ(mLayer.GetFocus(), b);
  MakeWindow(OS_Rect(0, 0, 100, 100));
  mLayer.SetFocus(a);
  EXPECT_EQ(mLayer.GetActiveWindow(), window) << "focus in an inactive window activates it first";
  EXPECT_EQ(mLayer.GetFocus(), a);
}

TEST_F(HeadlessWindowTest, TheWindowThatLosesTheCaptureIsToldAndADestroyedOneHoldsNothing) {
  const OS_WindowHandle a = MakeWindow(OS_Rect(0, 0, 10, 10));
  const OS_WindowHandle b = MakeWindow(OS_Rect(0, 0, 10, 10));
  mLayer.SetCapture(a);
  Clear();
  mLayer.SetCapture(b);
  ASSERT_EQ(Messages(kOSMsgCaptureChanged).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgCaptureChanged)[0].window, a);
  EXPECT_EQ(Messages(kOSMsgCaptureChanged)[0].lParam, static_cast<std::intptr_t>(b));
  mLayer.ReleaseCapture();
  ASSERT_EQ(Messages(kOSMsgCaptureChanged).size(), 2u);
  EXPECT_EQ(Messages(kOSMsgCaptureChanged)[1].window, b);
  EXPECT_EQ(mLayer.GetCapture(), 0u);
  const OS_WindowHandle child = MakeChild(a, OS_Rect(0, 0, 5, 5));
  mLayer.SetFocus(child);
  mLayer.SetCapture(child);
  mLayer.DestroyWindow(child);
  EXPECT_EQ(mLayer.GetFocus(), 0u) << "destroying the focus and capture window clears both";
  EXPECT_EQ(mLayer.GetCapture(), 0u);
}

TEST_F(HeadlessWindowTest, CaretAndOpacityAreRecorded) {
  const OS_WindowHandle window = MakeWindow(OS_Rect(0, 0, 10, 10), kOSStyleVisible, kOSExStyleLayered);
  mLayer.ShowCaret(window, true);
  EXPECT_EQ(mSystem.GetCaretCount(window), 1);
  mLayer.ShowCaret(window, false);
  EXPECT_EQ(mSystem.GetCaretCount(window), 0);
  EXPECT_EQ(mSystem.GetOpacity(window), 255);
  mLayer.SetLayeredAttributes(window, 0, 128, kOSLayeredAlpha);
  EXPECT_EQ(mSystem.GetOpacity(window), 128);
  mLayer.SetExStyle(window, 0);  // no longer layered: opaque again
  EXPECT_EQ(mSystem.GetOpacity(window), 255);
}

}  // namespace
}  // namespace norvik::ui::test
