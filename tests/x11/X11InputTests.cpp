// Real input through XTEST reaching the X11 native layer as the toolkit's messages.
#include <xkbcommon/xkbcommon-keysyms.h>

#include <cstdlib>

#include "x11/X11Fixture.h"

namespace norvik::test {
namespace {

using namespace norvik::ui;

class X11Input : public X11Fixture {
 protected:
  void SetUp() override {
    X11Fixture::SetUp();
    if (IsSkipped() || HasFatalFailure()) return;
    mWindow = MakeShownWindow(OS_Rect(100, 100, 200, 150), 0x336699);
    mLayer->SetActiveWindow(mWindow);
    MovePointer(10, 10);
    Settle(50);
    mMessages.clear();
  }
  void Click(int inX, int inY) {
    MovePointer(inX, inY);
    Button(1, true);
    Button(1, false);
  }
  OS_WindowHandle mWindow = 0;
};

TEST_F(X11Input, AQuickSecondClickArrivesAsADoubleClick) {
  Click(150, 150);
  Click(150, 150);
  ASSERT_TRUE(WaitFor([&] { return MessagesOf(kOSMsgLeftButtonUp).size() == 2; }));
  EXPECT_EQ(MessagesOf(kOSMsgLeftButtonDown).size(), 1u);
  EXPECT_EQ(MessagesOf(kOSMsgLeftButtonDoubleClick).size(), 1u);
}

TEST_F(X11Input, RealKeysArriveAsKeyAndCharacterMessages) {
  Key(XKB_KEY_a, true);
  Key(XKB_KEY_a, false);
  Key(XKB_KEY_Shift_L, true);
  Key(XKB_KEY_a, true);
  Key(XKB_KEY_a, false);
  Key(XKB_KEY_Shift_L, false);
  Key(XKB_KEY_Left, true);
  Key(XKB_KEY_Left, false);
  ASSERT_TRUE(WaitFor([&] { return MessagesOf(kOSMsgKeyUp).size() >= 4; }));
  const auto chars = MessagesOf(kOSMsgChar);
  ASSERT_EQ(chars.size(), 2u);
  EXPECT_EQ(chars[0].wParam, std::uintptr_t('a'));
  EXPECT_EQ(chars[1].wParam, std::uintptr_t('A'));
  const auto downs = MessagesOf(kOSMsgKeyDown);
  ASSERT_EQ(downs.size(), 4u);
  EXPECT_EQ(downs[0].wParam, 65u);
  EXPECT_EQ(downs[1].wParam, 16u);
  EXPECT_EQ(downs[3].wParam, 37u);
  EXPECT_TRUE(downs[3].lParam & (std::intptr_t(1) << 24)) << "arrow keys are extended";
  EXPECT_FALSE(downs[0].lParam & (std::intptr_t(1) << 24));
  EXPECT_EQ(downs[0].window, mWindow);
}

TEST_F(X11Input, ModifierStateIsReadAsOfTheMessage) {
  bool shiftSeen = false;
  mHandler = [&](const RecordedMessage& m) {
    if (m.message == kOSMsgKeyDown && m.wParam == 'B') shiftSeen = (mLayer->GetKeyState(16) & 0x8000) != 0;
    return false;
  };
  Key(XKB_KEY_Shift_L, true);
  Key(XKB_KEY_b, true);
  Key(XKB_KEY_b, false);
  Key(XKB_KEY_Shift_L, false);
  ASSERT_TRUE(WaitFor([&] { return MessagesOf(kOSMsgKeyUp).size() >= 2; }));
  EXPECT_TRUE(shiftSeen);
  EXPECT_FALSE(mLayer->GetKeyState(16) & 0x8000);
}

TEST_F(X11Input, ACaptureKeepsReceivingMotionOutsideTheWindowUntilReleased) {
  mLayer->SetCapture(mWindow);
  MovePointer(700, 600);
  ASSERT_TRUE(WaitFor([&] { return Received(kOSMsgMouseMove); }));
  const auto moves = MessagesOf(kOSMsgMouseMove);
  EXPECT_EQ(moves.back().window, mWindow);
  EXPECT_EQ(PointParamX(moves.back().lParam), 600);
  EXPECT_EQ(PointParamY(moves.back().lParam), 500);
  mLayer->ReleaseCapture();
  EXPECT_TRUE(Received(kOSMsgCaptureChanged));
  Settle(100);  // the release and the next motion travel on different connections
  mMessages.clear();
  MovePointer(720, 620);
  Settle(100);
  EXPECT_FALSE(Received(kOSMsgMouseMove)) << "without the capture, motion outside goes elsewhere";
}

TEST_F(X11Input, TheCursorPositionIsWhereThePointerIsOverOurWindowsAndElsewhere) {
  MovePointer(150, 160);
  ASSERT_TRUE(WaitFor([&] { return Received(kOSMsgMouseMove); }));
  EXPECT_EQ(mLayer->GetCursorPos(), OS_Point(150, 160));
  MovePointer(151, 161);
  ASSERT_TRUE(WaitFor([&] { return MessagesOf(kOSMsgMouseMove).size() >= 2; }));
  EXPECT_EQ(mLayer->GetCursorPos(), OS_Point(151, 161));
  // Outside our windows no motion is reported: the position comes from the server.
  MovePointer(900, 700);
  Settle(50);
  EXPECT_EQ(mLayer->GetCursorPos(), OS_Point(900, 700));
  MovePointer(910, 710);
  Settle(50);
  EXPECT_EQ(mLayer->GetCursorPos(), OS_Point(910, 710));
}

TEST_F(X11Input, MotionsWaitingTogetherArriveAsTheLastOne) {
  for (int i = 0; i < 20; ++i) MovePointer(120 + i, 150);
  // Everything has reached the server before the layer looks.
  std::free(xcb_get_input_focus_reply(mUser, xcb_get_input_focus(mUser), nullptr));
  Settle(30);
  const auto moves = MessagesOf(kOSMsgMouseMove);
  ASSERT_FALSE(moves.empty());
  EXPECT_LT(moves.size(), 20u);
  EXPECT_EQ(PointParamX(moves.back().lParam), 139 - 100);
}

TEST_F(X11Input, LeavingATrackedWindowSendsOneMouseLeave) {
  MovePointer(150, 150);
  ASSERT_TRUE(WaitFor([&] { return Received(kOSMsgMouseMove); }));
  mLayer->TrackMouseLeave(mWindow);
  MovePointer(800, 700);
  ASSERT_TRUE(WaitFor([&] { return Received(kOSMsgMouseLeave); }));
  MovePointer(150, 150);
  MovePointer(810, 710);
  Settle(100);
  EXPECT_EQ(MessagesOf(kOSMsgMouseLeave).size(), 1u);
}

}  // namespace
}  // namespace norvik::test
