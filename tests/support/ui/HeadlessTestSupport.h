#pragma once
// A fixture over the headless window system whose window procedure records
// every message it receives and then answers through a test's handler, or
// through the platform's default handling when the handler declines.
#include <cstdint>
#include <functional>
#include <optional>
#include <vector>

#include <gtest/gtest.h>

#include "ui/HeadlessWindowSystem.h"
#include "ui/OS_NativeLayer.h"

namespace norvik::ui::test {

struct RecordedMessage {
  OS_WindowHandle window = 0;
  unsigned message = 0;
  std::uintptr_t wParam = 0;
  std::intptr_t lParam = 0;
  OS_EventTime time = 0;  // GetMessageTime while it was handled
};

class HeadlessFixture : public ::testing::Test {
 protected:
  using Handler = std::function<std::optional<std::intptr_t>(const RecordedMessage&)>;

  HeadlessFixture();
  ~HeadlessFixture() override;

  // A window of the toolkit's kind; visible top levels activate.
  OS_WindowHandle MakeWindow(const OS_Rect& inRect, std::uint32_t inStyle = kOSStyleVisible,
                             std::uint32_t inExStyle = 0, OS_WindowHandle inParent = 0,
                             std::uint32_t inClassStyle = kOSClassStyleDoubleClicks);
  OS_WindowHandle MakeChild(OS_WindowHandle inParent, const OS_Rect& inRect,
                            std::uint32_t inStyle = kOSStyleVisible | kOSStyleChild);

  // The recorded messages of one number (and window, when given), in order.
  std::vector<RecordedMessage> Messages(unsigned inMessage, OS_WindowHandle inWindow = 0) const;
  // The numbers of the messages a window received, in order, leaving out
  // the cursor and paint messages that come with almost everything.
  std::vector<unsigned> NumbersOf(OS_WindowHandle inWindow) const;
  void Clear() { mMessages.clear(); }

  HeadlessWindowSystem mSystem;
  OS_NativeLayer& mLayer;
  std::vector<RecordedMessage> mMessages;
  // Answers a message, or declines (nullopt) so that the default handles it.
  Handler mHandler;

 private:
  static std::intptr_t Procedure(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                 std::intptr_t inLParam);
  static HeadlessFixture* sCurrent;
};

}  // namespace norvik::ui::test
