// Injected input in the headless window system: which window receives it,
// with which parameters, and what the click does to activation.
#include <gmock/gmock.h>

#include "support/ui/HeadlessTestSupport.h"
#include "support/ui/KeyCodes.h"

namespace norvik::ui::test {
namespace {

using ::testing::ElementsAre;

constexpr int kKeyA = 'A';
constexpr int kKeyC = 'C';
constexpr int kKeyX = 'X';

class HeadlessInputTest : public HeadlessFixture {
 protected:
  // Two overlapping windows: front (created last, on top) over back.
  void SetUp() override {
    mBack = MakeWindow(OS_Rect(0, 0, 200, 200));
    mFront = MakeWindow(OS_Rect(100, 100, 200, 200));
    mSystem.Pump();
    Clear();
  }

  OS_WindowHandle mBack = 0;
  OS_WindowHandle mFront = 0;
};

// ---- pointer routing ----

TEST_F(HeadlessInputTest, APointerMoveGoesToTheTopmostWindowUnderItInClientCoordinates) {
  mSystem.MovePointer(OS_Point(150, 120));
  mSystem.Pump();
  ASSERT_EQ(Messages(kOSMsgMouseMove).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgMouseMove)[0].window, mFront);
  EXPECT_EQ(PointParamX(Messages(kOSMsgMouseMove)[0].lParam), 50);
  EXPECT_EQ(PointParamY(Messages(kOSMsgMouseMove)[0].lParam), 20);
  mSystem.MovePointer(OS_Point(50, 50));
  mSystem.Pump();
  EXPECT_EQ(Messages(kOSMsgMouseMove).back().window, mBack);
}

TEST_F(HeadlessInputTest, RaisingTheBackWindowChangesWhoGetsTheOverlap) {
  mLayer.SetActiveWindow(mBack);
  mSystem.MovePointer(OS_Point(150, 150));
  mSystem.Pump();
  EXPECT_EQ(Messages(kOSMsgMouseMove).back().window, mBack);
}

TEST_F(HeadlessInputTest, TheCaptureWindowGetsThePointerEvenOutsideItself) {
  mLayer.SetCapture(mBack);
  mSystem.MovePointer(OS_Point(250, 260));
  mSystem.PressButton(kHeadlessButtonLeft);
  mSystem.Pump();
  ASSERT_EQ(Messages(kOSMsgMouseMove).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgMouseMove)[0].window, mBack);
  EXPECT_EQ(PointParamX(Messages(kOSMsgMouseMove)[0].lParam), 250);
  ASSERT_EQ(Messages(kOSMsgLeftButtonDown).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgLeftButtonDown)[0].window, mBack);
  EXPECT_EQ(Messages(kOSMsgLeftButtonDown)[0].wParam & kOSMouseKeyLeft, std::uintptr_t(kOSMouseKeyLeft));
}

TEST_F(HeadlessInputTest, ADisabledTopWindowSwallowsTheClickInsteadOfPassingItDown) {
  mLayer.EnableWindow(mFront, false);
  mSystem.Click(OS_Point(150, 150));
  mSystem.Pump();
  EXPECT_TRUE(Messages(kOSMsgLeftButtonDown).empty());
  EXPECT_EQ(mLayer.WindowFromPoint(OS_Point(150, 150)), 0u);
}

TEST_F(HeadlessInputTest, ADisabledOrHiddenChildLetsThePointerFallToItsParent) {
  const OS_WindowHandle child = MakeChild(mFront, OS_Rect(10, 10, 50, 50));
  EXPECT_EQ(mLayer.WindowFromPoint(OS_Point(120, 120)), child);
  mLayer.EnableWindow(child, false);
  EXPECT_EQ(mLayer.WindowFromPoint(OS_Point(120, 120)), mFront);
  mLayer.EnableWindow(child, true);
  mLayer.ShowWindow(child, kOSShowHide);
  mSystem.Click(OS_Point(120, 120));
  mSystem.Pump();
  ASSERT_EQ(Messages(kOSMsgLeftButtonDown).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgLeftButtonDown)[0].window, mFront);
}

// ---- clicks ----

// Each row clicks a sequence (button, clock advance before it, point) in a
// window whose class asks for double clicks, or in one whose class does not.
TEST_F(HeadlessInputTest, OnlyAQuickNearSecondClickOfTheSameButtonIsADoubleClick) {
  struct Click {
    int button;
    int wait;
    OS_Point at;
  };
  struct Row {
    const char* name;
    bool doubleClickClass;
    std::vector<Click> clicks;
    std::vector<unsigned> downs;
  };
  const OS_Point p(150, 150), q(450, 450);
  const int left = kHeadlessButtonLeft, right = kHeadlessButtonRight, middle = kHeadlessButtonMiddle;
  const Row rows[] = {
      {"a third click starts over", true, {{left, 0, p}, {left, 100, p}, {left, 100, p}},
       {kOSMsgLeftButtonDown, kOSMsgLeftButtonDoubleClick, kOSMsgLeftButtonDown}},
      {"slow, then beyond half of the 4-pixel rectangle, then within it", true,
       {{left, 0, p}, {left, 501, p}, {left, 100, OS_Point(153, 150)}, {left, 100, OS_Point(155, 152)}},
       {kOSMsgLeftButtonDown, kOSMsgLeftButtonDown, kOSMsgLeftButtonDown, kOSMsgLeftButtonDoubleClick}},
      {"different buttons", true, {{left, 0, p}, {right, 0, p}, {right, 0, p}, {middle, 0, p}},
       {kOSMsgLeftButtonDown, kOSMsgRightButtonDown, kOSMsgRightButtonDoubleClick, kOSMsgMiddleButtonDown}},
      {"a class that does not ask", false, {{left, 0, q}, {left, 0, q}}, {kOSMsgLeftButtonDown, kOSMsgLeftButtonDown}},
  };
  const OS_WindowHandle plain = MakeWindow(OS_Rect(400, 400, 100, 100), kOSStyleVisible, 0, 0, 0);
  for (const Row& row : rows) {
    mSystem.AdvanceClock(1000);
    mSystem.Pump();
    Clear();
    for (const Click& c : row.clicks) {
      mSystem.AdvanceClock(c.wait);
      mSystem.Click(c.at, c.button);
    }
    mSystem.Pump();
    std::vector<unsigned> downs;
    for (const RecordedMessage& m : mMessages)
      if (m.message >= kOSMsgLeftButtonDown && m.message <= kOSMsgMiddleButtonDoubleClick &&
          m.message != kOSMsgLeftButtonUp && m.message != kOSMsgRightButtonUp && m.message != kOSMsgMiddleButtonUp)
        downs.push_back(m.message);
    EXPECT_EQ(downs, row.downs) << row.name;
    EXPECT_EQ(Messages(kOSMsgLeftButtonDown, plain).size(), row.doubleClickClass ? 0u : 2u) << row.name;
  }
}

TEST_F(HeadlessInputTest, AClickInAnInactiveWindowAsksItAndActivatesItWithTheClickCode) {
  ASSERT_EQ(mLayer.GetActiveWindow(), mFront);
  mSystem.Click(OS_Point(50, 50));
  mSystem.Pump();
  ASSERT_EQ(Messages(kOSMsgMouseActivate).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgMouseActivate)[0].wParam, mBack);
  EXPECT_EQ(HighWord(static_cast<std::uintptr_t>(Messages(kOSMsgMouseActivate)[0].lParam)),
            unsigned(kOSMsgLeftButtonDown));
  EXPECT_EQ(mLayer.GetActiveWindow(), mBack);
  const auto activations = Messages(kOSMsgActivate, mBack);
  ASSERT_FALSE(activations.empty());
  EXPECT_EQ(LowWord(activations.back().wParam), unsigned(kOSActivationClickActive));
  EXPECT_EQ(Messages(kOSMsgLeftButtonDown, mBack).size(), 1u);
  // Clicking the now active window does not ask again.
  mSystem.AdvanceClock(1000);
  mSystem.Click(OS_Point(50, 50));
  mSystem.Pump();
  EXPECT_EQ(Messages(kOSMsgMouseActivate).size(), 1u);
}

TEST_F(HeadlessInputTest, TheMouseActivateAnswerIsObeyed) {
  struct Case {
    std::intptr_t answer;
    bool activates;
    bool delivers;
  };
  const Case cases[] = {{kOSMouseActivate, true, true},
                        {kOSMouseActivateAndEat, true, false},
                        {kOSMouseNoActivate, false, true},
                        {kOSMouseNoActivateAndEat, false, false}};
  for (const Case& c : cases) {
    mLayer.SetActiveWindow(mFront);
    mSystem.AdvanceClock(1000);
    Clear();
    mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
      if (inMessage.message == kOSMsgMouseActivate) return c.answer;
      return std::nullopt;
    };
    mSystem.Click(OS_Point(50, 50));
    mSystem.Pump();
    EXPECT_EQ(mLayer.GetActiveWindow() == mBack, c.activates) << "answer " << c.answer;
    EXPECT_EQ(Messages(kOSMsgLeftButtonDown, mBack).size(), c.delivers ? 1u : 0u) << "answer " << c.answer;
    EXPECT_EQ(Messages(kOSMsgLeftButtonUp, mBack).size(), 1u) << "answer " << c.answer;
  }
}

TEST_F(HeadlessInputTest, AClickOnAWindowThatMustNotActivateLeavesActivationAlone) {
  const OS_WindowHandle palette =
      MakeWindow(OS_Rect(500, 500, 50, 50), kOSStyleVisible | kOSStylePopup, kOSExStyleNoActivate);
  mSystem.Click(OS_Point(510, 510));
  mSystem.Pump();
  EXPECT_EQ(mLayer.GetActiveWindow(), mFront);
  EXPECT_TRUE(Messages(kOSMsgMouseActivate).empty());
  EXPECT_EQ(Messages(kOSMsgLeftButtonDown, palette).size(), 1u);
}

TEST_F(HeadlessInputTest, AWindowDestroyedByItsButtonDownGetsNothingMore) {
  mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message == kOSMsgLeftButtonDown) mLayer.DestroyWindow(inMessage.window);
    return std::nullopt;
  };
  mSystem.Click(OS_Point(150, 150));
  mSystem.MovePointer(OS_Point(160, 160));
  mSystem.Pump();
  EXPECT_FALSE(mLayer.IsWindow(mFront));
  EXPECT_TRUE(Messages(kOSMsgLeftButtonUp, mFront).empty());
  EXPECT_EQ(Messages(kOSMsgMouseMove).size(), 1u);  // only the move before the click
}

// ---- wheel ----

TEST_F(HeadlessInputTest, WheelTurnsCarryTheirRawDeltaAndTheScreenPoint) {
  mSystem.MovePointer(OS_Point(150, 160));
  mSystem.TurnWheel(-60);
  mSystem.TurnHorizontalWheel(240);
  mSystem.Pump();
  ASSERT_EQ(Messages(kOSMsgMouseWheel).size(), 1u);
  const RecordedMessage vertical = Messages(kOSMsgMouseWheel)[0];
  EXPECT_EQ(vertical.window, mFront);
  EXPECT_EQ(static_cast<std::int16_t>(HighWord(vertical.wParam)), -60);
  EXPECT_EQ(PointParamX(vertical.lParam), 150);
  EXPECT_EQ(PointParamY(vertical.lParam), 160);
  ASSERT_EQ(Messages(kOSMsgMouseHorizontalWheel).size(), 1u);
  EXPECT_EQ(static_cast<std::int16_t>(HighWord(Messages(kOSMsgMouseHorizontalWheel)[0].wParam)), 240);
}

TEST_F(HeadlessInputTest, AnUnhandledWheelInAChildReachesItsParent) {
  const OS_WindowHandle child = MakeChild(mFront, OS_Rect(0, 0, 50, 50));
  mSystem.MovePointer(OS_Point(110, 110));
  mSystem.TurnWheel(120);
  mSystem.Pump();
  const auto wheels = Messages(kOSMsgMouseWheel);
  ASSERT_EQ(wheels.size(), 2u);
  EXPECT_EQ(wheels[0].window, child);
  EXPECT_EQ(wheels[1].window, mFront);
}

// ---- mouse leave and cursor ----

TEST_F(HeadlessInputTest, TrackingTheLeaveGivesExactlyOneLeaveAtOnceWhenThePointerIsElsewhere) {
  mSystem.MovePointer(OS_Point(150, 150));
  mSystem.Pump();
  mLayer.TrackMouseLeave(mFront);
  mSystem.MovePointer(OS_Point(160, 160));
  mSystem.MovePointer(OS_Point(50, 50));
  mSystem.MovePointer(OS_Point(40, 40));
  mSystem.MovePointer(OS_Point(150, 150));
  mSystem.MovePointer(OS_Point(50, 50));
  mSystem.Pump();
  EXPECT_EQ(Messages(kOSMsgMouseLeave).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgMouseLeave, mFront).size(), 1u);
  mLayer.TrackMouseLeave(mFront);
  mSystem.Pump();
  EXPECT_EQ(Messages(kOSMsgMouseLeave, mFront).size(), 2u) << "tracking a window the pointer is not over";
}

TEST_F(HeadlessInputTest, TheLeaveWaitsForTheCaptureToEnd) {
  mSystem.MovePointer(OS_Point(150, 150));
  mLayer.TrackMouseLeave(mFront);
  mLayer.SetCapture(mFront);
  mSystem.MovePointer(OS_Point(50, 50));
  mSystem.Pump();
  EXPECT_TRUE(Messages(kOSMsgMouseLeave).empty());
  mLayer.ReleaseCapture();
  mSystem.Pump();
  EXPECT_EQ(Messages(kOSMsgMouseLeave, mFront).size(), 1u);
}

TEST_F(HeadlessInputTest, PointerMessagesAskForTheCursorAndTheDefaultIsTheArrow) {
  mLayer.SetCursor(mLayer.LoadSystemCursor(kOSCursorWait));
  mSystem.MovePointer(OS_Point(150, 150));
  mSystem.Pump();
  ASSERT_EQ(Messages(kOSMsgSetCursor).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgSetCursor)[0].wParam, mFront);
  EXPECT_EQ(mLayer.GetCursor(), mLayer.LoadSystemCursor(kOSCursorArrow));
  mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message != kOSMsgSetCursor) return std::nullopt;
    mLayer.SetCursor(mLayer.LoadSystemCursor(kOSCursorHand));
    return 1;
  };
  mSystem.MovePointer(OS_Point(151, 150));
  mSystem.Pump();
  EXPECT_EQ(mLayer.GetCursor(), mLayer.LoadSystemCursor(kOSCursorHand));
}

// ---- keys ----

class HeadlessKeyTest : public HeadlessInputTest {
 protected:
  void SetUp() override {
    HeadlessInputTest::SetUp();
    mField = MakeChild(mFront, OS_Rect(0, 0, 50, 20));
    mLayer.SetFocus(mField);
    Clear();
  }

  // The messages of the keyboard block that reached the field.
  std::vector<RecordedMessage> Keys() const {
    std::vector<RecordedMessage> result;
    for (const RecordedMessage& m : mMessages)
      if (m.message >= kOSMsgKeyDown && m.message <= kOSMsgSysDeadChar) result.push_back(m);
    return result;
  }

  OS_WindowHandle mField = 0;
};

TEST_F(HeadlessKeyTest, AKeyDownCarriesItsScanCodeRepeatAndExtendedBitsAndIsFollowedByItsCharacter) {
  mSystem.TypeKey(kKeyA);
  mSystem.Pump();
  const auto keys = Keys();
  ASSERT_EQ(keys.size(), 3u);
  EXPECT_EQ(keys[0].window, mField);
  EXPECT_EQ(keys[0].message, kOSMsgKeyDown);
  EXPECT_EQ(keys[0].wParam, std::uintptr_t(kKeyA));
  EXPECT_EQ((keys[0].lParam >> 16) & 0xFF, 0x1E);
  EXPECT_EQ(keys[0].lParam & 0xFFFF, 1);
  EXPECT_EQ((keys[0].lParam >> 30) & 1, 0);
  EXPECT_EQ(keys[1].message, kOSMsgChar);
  EXPECT_EQ(keys[1].wParam, std::uintptr_t(u'a'));
  EXPECT_EQ(keys[2].message, kOSMsgKeyUp);
  EXPECT_EQ((keys[2].lParam >> 30) & 1, 1);
  EXPECT_EQ((keys[2].lParam >> 31) & 1, 1);
  Clear();
  mSystem.PressKey(kKeyA);
  mSystem.PressKey(kKeyA);
  mSystem.TypeKey(keys::kLeft, true);
  mSystem.TypeKey(keys::kLeft, false);
  mSystem.Pump();
  const auto downs = Messages(kOSMsgKeyDown);
  ASSERT_EQ(downs.size(), 4u);
  EXPECT_EQ((downs[1].lParam >> 30) & 1, 1) << "a held key repeats with the previous state bit";
  EXPECT_EQ((downs[2].lParam >> 24) & 1, 1) << "the extended flag";
  EXPECT_EQ((downs[3].lParam >> 24) & 1, 0);
  EXPECT_EQ(Messages(kOSMsgChar).size(), 2u) << "the held key types twice, the arrows nothing";
}

TEST_F(HeadlessKeyTest, ShiftAndCapsLockChooseTheCaseAndControlTypesControlCharacters) {
  mSystem.PressKey(kOSKeyShift);
  mSystem.TypeKey(kKeyA);
  mSystem.TypeKey('1');
  mSystem.ReleaseKey(kOSKeyShift);
  mSystem.TypeKey(kOSKeyCapsLock);
  mSystem.TypeKey(kKeyA);
  mSystem.PressKey(kOSKeyControl);
  mSystem.TypeKey(kKeyC);
  mSystem.ReleaseKey(kOSKeyControl);
  mSystem.Pump();
  const auto chars = Messages(kOSMsgChar);
  ASSERT_EQ(chars.size(), 4u);
  EXPECT_EQ(chars[0].wParam, std::uintptr_t(u'A'));
  EXPECT_EQ(chars[1].wParam, std::uintptr_t(u'!'));
  EXPECT_EQ(chars[2].wParam, std::uintptr_t(u'A'));
  EXPECT_EQ(chars[3].wParam, 3u);
  EXPECT_NE(mLayer.GetAsyncKeyState(kOSKeyCapsLock) & 1, 0);
}

TEST_F(HeadlessKeyTest, AltMakesSystemKeysAndSystemCharacters) {
  mSystem.PressKey(kOSKeyAlt);
  mSystem.TypeKey(kKeyX);
  mSystem.ReleaseKey(kOSKeyAlt);
  mSystem.Pump();
  std::vector<unsigned> numbers;
  for (const RecordedMessage& m : Keys()) numbers.push_back(m.message);
  EXPECT_THAT(numbers, ElementsAre(kOSMsgSysKeyDown, kOSMsgSysKeyDown, kOSMsgSysChar, kOSMsgSysKeyUp,
                                   kOSMsgSysKeyUp));
  EXPECT_EQ(Messages(kOSMsgSysChar)[0].wParam, std::uintptr_t(u'x'));
  EXPECT_EQ((Messages(kOSMsgSysKeyDown)[1].lParam >> 29) & 1, 1);
}

TEST_F(HeadlessKeyTest, ControlWithAltIsAltGrAndTypesNothingOnThisLayout) {
  mSystem.PressKey(kOSKeyControl);
  mSystem.PressKey(kOSKeyRightAlt);
  mSystem.TypeKey('Q');
  mSystem.Pump();
  EXPECT_EQ(Messages(kOSMsgKeyDown).back().wParam, std::uintptr_t('Q'));
  EXPECT_TRUE(Messages(kOSMsgChar).empty());
  EXPECT_TRUE(Messages(kOSMsgSysChar).empty());
  // The right Alt key is reported as Alt, extended.
  const auto downs = Messages(kOSMsgKeyDown);
  ASSERT_GE(downs.size(), 2u);
  EXPECT_EQ(downs[1].wParam, std::uintptr_t(kOSKeyAlt));
  EXPECT_EQ((downs[1].lParam >> 24) & 1, 1);
  EXPECT_NE(mLayer.GetAsyncKeyState(kOSKeyRightAlt) & 0x8000, 0);
}

TEST_F(HeadlessKeyTest, KeyStateIsThatOfTheMessageBeingHandled) {
  std::vector<bool> shiftDuringChar;
  mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message == kOSMsgChar) shiftDuringChar.push_back((mLayer.GetKeyState(kOSKeyShift) & 0x8000) != 0);
    return std::nullopt;
  };
  mSystem.PressKey(kOSKeyShift);
  mSystem.TypeKey(kKeyA);
  mSystem.ReleaseKey(kOSKeyShift);
  mSystem.TypeKey(kKeyA);
  // Nothing delivered yet: the keyboard now has Shift up.
  EXPECT_EQ(mLayer.GetAsyncKeyState(kOSKeyShift) & 0x8000, 0);
  mSystem.Pump();
  EXPECT_THAT(shiftDuringChar, ElementsAre(true, false));
}

TEST_F(HeadlessKeyTest, WithoutAFocusWindowKeysGoToTheActiveWindowAsSystemKeys) {
  mLayer.SetFocus(0);
  mSystem.TypeKey(kKeyA);
  mSystem.Pump();
  ASSERT_EQ(Messages(kOSMsgSysKeyDown).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgSysKeyDown)[0].window, mFront);
}

TEST_F(HeadlessKeyTest, AltF4ClosesTheTopLevelByDefault) {
  mSystem.PressKey(kOSKeyAlt);
  mSystem.TypeKey(115);
  mSystem.ReleaseKey(kOSKeyAlt);
  mSystem.Pump();
  EXPECT_FALSE(mLayer.IsWindow(mFront));
  EXPECT_EQ(Messages(kOSMsgClose).size(), 1u);
}

TEST_F(HeadlessKeyTest, TypedCharactersGoToTheFocusWindow) {
  mSystem.TypeCharacter(u'\u00e9');
  mSystem.Pump();
  ASSERT_EQ(Messages(kOSMsgChar).size(), 1u);
  EXPECT_EQ(Messages(kOSMsgChar)[0].window, mField);
  EXPECT_EQ(Messages(kOSMsgChar)[0].wParam, std::uintptr_t(0xE9));
}

}  // namespace
}  // namespace norvik::ui::test
