// The X11 native layer against a real X server: windows, paint, activation,
// timers and monitors.
#include <xcb/xcb.h>

#include <chrono>
#include <cstdlib>

#include "x11/X11Fixture.h"

namespace norvik::test {
namespace {

using namespace norvik::ui;

class X11Windows : public X11Fixture {
 protected:
  // Requests of two connections reach the server in no fixed order, so a
  // pixel is read until it shows what the layer presented, for a while.
  std::uint32_t PixelSoon(OS_WindowHandle inWindow, int inX, int inY, std::uint32_t inExpected) {
    std::uint32_t pixel = 0;
    WaitFor([&] { return (pixel = ReadPixel(inWindow, inX, inY)) == inExpected; }, 1000);
    return pixel;
  }
};

TEST_F(X11Windows, APaintedWindowShowsItsPixelsOnTheServer) {
  const OS_WindowHandle red = MakeShownWindow(OS_Rect(50, 60, 120, 80), 0xC03020);
  const OS_WindowHandle blue = MakeShownWindow(OS_Rect(400, 60, 120, 80), 0x2040D0);
  EXPECT_EQ(PixelSoon(red, 5, 5, 0xC03020u), 0xC03020u);
  EXPECT_EQ(ReadPixel(red, 119, 79), 0xC03020u);
  EXPECT_EQ(PixelSoon(blue, 60, 40, 0x2040D0u), 0x2040D0u);
}

TEST_F(X11Windows, InvalidatingPartOfAWindowRepaintsOnlyThatPart) {
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(50, 60, 120, 80), 0x102030);
  mMessages.clear();
  mColors[window] = 0xF0E0D0;
  OS_Rect part(10, 10, 20, 20);
  mLayer->InvalidateRect(window, &part);
  ASSERT_TRUE(WaitFor([&] { return Received(kOSMsgPaint); }));
  EXPECT_EQ(PixelSoon(window, 15, 15, 0xF0E0D0u), 0xF0E0D0u);
  EXPECT_EQ(ReadPixel(window, 60, 60), 0x102030u) << "outside the damage the old pixels stay";
}

TEST_F(X11Windows, AWindowDestroyedByAnotherClientHearsItAndIsForgotten) {
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(30, 30, 80, 60), 0x556677);
  mMessages.clear();
  xcb_destroy_window(mUser, static_cast<xcb_window_t>(window));
  xcb_flush(mUser);
  ASSERT_TRUE(WaitFor([&] { return !mLayer->IsWindow(window); }));
  EXPECT_TRUE(Received(kOSMsgDestroy));
  EXPECT_TRUE(Received(kOSMsgNCDestroy));
  EXPECT_EQ(mLayer->GetActiveWindow(), 0u);
}

TEST_F(X11Windows, AWindowRefusingCreationIsNotMade) {
  mHandler = [](const RecordedMessage& m) { return m.message == kOSMsgNCCreate; };  // answers 0
  OS_WindowCreateParams params;
  params.rect = OS_Rect(0, 0, 10, 10);
  EXPECT_EQ(mLayer->CreateWindow(params), 0u);
  EXPECT_TRUE(mLayer->EnumerateWindows().empty());
}

TEST_F(X11Windows, ActivationMovesBetweenTopLevelsWithMessagesToBoth) {
  const OS_WindowHandle first = MakeShownWindow(OS_Rect(0, 0, 100, 100), 0x111111);
  const OS_WindowHandle second = MakeShownWindow(OS_Rect(200, 0, 100, 100), 0x222222);
  mLayer->SetActiveWindow(first);
  mMessages.clear();
  mLayer->SetActiveWindow(second);
  const auto activations = MessagesOf(kOSMsgActivate);
  ASSERT_EQ(activations.size(), 2u);
  EXPECT_EQ(activations[0].window, first);
  EXPECT_EQ(LowWord(activations[0].wParam), unsigned(kOSActivationInactive));
  EXPECT_EQ(activations[1].window, second);
  EXPECT_NE(LowWord(activations[1].wParam), unsigned(kOSActivationInactive));
  EXPECT_EQ(mLayer->GetFocus(), second) << "the default handling gives the activated window the focus";
}

TEST_F(X11Windows, ATimerFiresOnTheRealLoopAtItsInterval) {
  const OS_WindowHandle window = MakeShownWindow(OS_Rect(0, 0, 50, 50), 0x000000);
  int fired = 0;
  mHandler = [&](const RecordedMessage& m) {
    if (m.message == kOSMsgTimer && m.wParam == 7 && ++fired == 3) mLayer->QuitLoop(42);
    return m.message == kOSMsgTimer;
  };
  const auto start = std::chrono::steady_clock::now();
  mLayer->SetTimer(window, 7, 30);
  EXPECT_EQ(mLayer->RunLoop(), 42);
  const auto elapsed = std::chrono::steady_clock::now() - start;
  EXPECT_EQ(fired, 3);
  EXPECT_GE(std::chrono::duration_cast<std::chrono::milliseconds>(elapsed).count(), 85);
}

TEST_F(X11Windows, TheMonitorIsTheScreenOfTheServer) {
  const std::vector<OS_Monitor> monitors = mLayer->GetMonitors();
  ASSERT_FALSE(monitors.empty());
  EXPECT_EQ(monitors[0].bounds, OS_Rect(0, 0, 1024, 768));
  EXPECT_TRUE(monitors[0].bounds.Contains(monitors[0].workArea));
}

TEST_F(X11Windows, CursorsComeFromTheThemeAndFromPixels) {
  EXPECT_NE(mLayer->LoadSystemCursor(kOSCursorArrow), 0u);
  std::vector<std::uint32_t> pixels(16 * 16, 0xFF00FF00u);
  const OS_CursorHandle cursor = mLayer->CreateCursorFromPixels(pixels.data(), 16, 16, 3, 4);
  EXPECT_NE(cursor, 0u);
  mLayer->SetCursor(cursor);
  EXPECT_EQ(mLayer->GetCursor(), cursor);
  mLayer->DestroyCursor(cursor);
}

}  // namespace
}  // namespace norvik::test
