// Timers of the headless window system on its virtual clock.
#include <gmock/gmock.h>

#include "support/ui/HeadlessTestSupport.h"

namespace norvik::ui::test {
namespace {

using ::testing::ElementsAre;

class HeadlessTimerTest : public HeadlessFixture {
 protected:
  void SetUp() override {
    mWindow = MakeWindow(OS_Rect(0, 0, 10, 10));
    mSystem.Pump();
    Clear();
  }

  // (id, time) of each timer message, in order.
  std::vector<std::pair<std::uintptr_t, OS_EventTime>> Fired() const {
    std::vector<std::pair<std::uintptr_t, OS_EventTime>> result;
    for (const RecordedMessage& m : Messages(kOSMsgTimer)) result.emplace_back(m.wParam, m.time);
    return result;
  }

  OS_WindowHandle mWindow = 0;
};

TEST_F(HeadlessTimerTest, TimersFireInTheOrderOfTheirDeadlines) {
  mLayer.SetTimer(mWindow, 1, 50);
  mLayer.SetTimer(mWindow, 2, 30);
  const OS_WindowHandle other = MakeWindow(OS_Rect(0, 0, 10, 10));
  mLayer.SetTimer(other, 3, 50);
  mSystem.AdvanceClock(100);
  std::vector<std::pair<std::uintptr_t, OS_EventTime>> fired = Fired();
  EXPECT_THAT(fired, ElementsAre(std::make_pair(std::uintptr_t(2), OS_EventTime(30)),
                                 std::make_pair(std::uintptr_t(1), OS_EventTime(50)),
                                 std::make_pair(std::uintptr_t(3), OS_EventTime(50)),
                                 std::make_pair(std::uintptr_t(2), OS_EventTime(60)),
                                 std::make_pair(std::uintptr_t(2), OS_EventTime(90)),
                                 std::make_pair(std::uintptr_t(1), OS_EventTime(100)),
                                 std::make_pair(std::uintptr_t(3), OS_EventTime(100))));
  EXPECT_EQ(Messages(kOSMsgTimer, other).size(), 2u);
}

TEST_F(HeadlessTimerTest, SettingATimerAgainStartsItsIntervalOver) {
  mLayer.SetTimer(mWindow, 1, 100);
  mSystem.AdvanceClock(80);
  mLayer.SetTimer(mWindow, 1, 100);
  mSystem.AdvanceClock(80);
  EXPECT_TRUE(Fired().empty());
  mSystem.AdvanceClock(20);
  ASSERT_EQ(Fired().size(), 1u);
  EXPECT_EQ(Fired()[0].second, 180);
}

TEST_F(HeadlessTimerTest, AKilledTimerStopsEvenFromInsideAnotherTimersHandler) {
  mLayer.SetTimer(mWindow, 1, 10);
  mLayer.SetTimer(mWindow, 2, 10);
  mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message == kOSMsgTimer && inMessage.wParam == 1) {
      mLayer.KillTimer(mWindow, 1);
      mLayer.KillTimer(mWindow, 2);
    }
    return std::nullopt;
  };
  mSystem.AdvanceClock(100);
  EXPECT_THAT(Fired(), ElementsAre(std::make_pair(std::uintptr_t(1), OS_EventTime(10))));
}

TEST_F(HeadlessTimerTest, DestroyingTheWindowFromItsTimerStopsItsTimers) {
  mLayer.SetTimer(mWindow, 1, 10);
  mLayer.SetTimer(mWindow, 2, 15);
  mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message == kOSMsgTimer) mLayer.DestroyWindow(inMessage.window);
    return std::nullopt;
  };
  mSystem.AdvanceClock(100);
  EXPECT_EQ(Fired().size(), 1u);
  EXPECT_FALSE(mLayer.IsWindow(mWindow));
}

TEST_F(HeadlessTimerTest, PostedMessagesAreDeliveredBeforeTheNextTimer) {
  mLayer.SetTimer(mWindow, 1, 10);
  mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message == kOSMsgTimer && inMessage.time == 10) mLayer.PostMessage(mWindow, kOSMsgCommand, 5, 0);
    return std::nullopt;
  };
  mSystem.AdvanceClock(20);
  EXPECT_THAT(NumbersOf(mWindow), ElementsAre(kOSMsgTimer, kOSMsgCommand, kOSMsgTimer));
  EXPECT_EQ(Messages(kOSMsgCommand)[0].time, 10);  // posted at the timer's instant
}

TEST_F(HeadlessTimerTest, TimersOfUnknownWindowsAreRefused) {
  mLayer.SetTimer(0xDEAD0, 1, 10);
  mSystem.AdvanceClock(100);
  EXPECT_TRUE(Fired().empty());
}

}  // namespace
}  // namespace norvik::ui::test
