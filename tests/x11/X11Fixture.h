#pragma once
// A fixture that opens the X11 native layer on a private Xvfb, records the
// messages that reach the window procedure, and plays a user through XTEST
// on a second connection.
#include <gtest/gtest.h>
#include <xcb/xcb.h>

#include <functional>
#include <map>
#include <memory>
#include <vector>

#include "ui/OS_NativeLayer.h"
#include "x11/XTestUser.h"

namespace norvik::test {

struct RecordedMessage {
  ui::OS_WindowHandle window;
  unsigned message;
  std::uintptr_t wParam;
  std::intptr_t lParam;
};

class X11Fixture : public ::testing::Test {
 protected:
  void SetUp() override;
  void TearDown() override;

  // A top-level window of the given style, shown, and painted once in inColor (0xRRGGBB).
  ui::OS_WindowHandle MakeShownWindow(const ui::OS_Rect& inRect, std::uint32_t inColor,
                                      std::uint32_t inStyle = ui::kOSStyleOverlappedWindow,
                                      std::uint32_t inExStyle = 0, ui::OS_WindowHandle inOwner = 0);
  // Pumps the layer until inCondition holds; false after inMilliseconds.
  bool WaitFor(const std::function<bool()>& inCondition, int inMilliseconds = 3000);
  // Pumps for a short while so that everything in flight arrives.
  void Settle(int inMilliseconds = 100);
  std::vector<RecordedMessage> MessagesOf(unsigned inMessage) const;
  bool Received(unsigned inMessage) const { return !MessagesOf(inMessage).empty(); }

  // The user, through XTEST.
  void MovePointer(int inX, int inY);
  void Button(int inButton, bool inPress);
  void Key(std::uint32_t inKeysym, bool inPress);
  // The pixel at a point of a window, read back from the server, as 0xRRGGBB.
  std::uint32_t ReadPixel(ui::OS_WindowHandle inWindow, int inX, int inY);

  static std::intptr_t Procedure(ui::OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                 std::intptr_t inLParam);

  std::unique_ptr<ui::OS_NativeLayer> mLayer;
  std::unique_ptr<XTestUser> mXTest;
  xcb_connection_t* mUser = nullptr;  // the user's connection, for requests of another client
  std::vector<RecordedMessage> mMessages;
  std::map<ui::OS_WindowHandle, std::uint32_t> mColors;
  // Runs for every message before the default handling; answers true to claim it.
  std::function<bool(const RecordedMessage&)> mHandler;
};

}  // namespace norvik::test
