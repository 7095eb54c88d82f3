// The loop of the headless window system: nesting, quitting, the executor
// and waking from other threads, and the native seams it installs.
#include <chrono>
#include <thread>

#include <gmock/gmock.h>

#include "support/ui/HeadlessTestSupport.h"
#include "tarsel/Threads.h"
#include "ui/InputPlatform.h"
#include "ui/OS_FocusPlatform.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui::test {
namespace {

using ::testing::ElementsAre;

constexpr unsigned kStartInner = kOSMsgCommand;
constexpr std::uintptr_t kQuit = 1;
constexpr std::uintptr_t kNest = 2;

class HeadlessLoopTest : public HeadlessFixture {
 protected:
  void SetUp() override {
    mExecutor = tarsel::threads::RegisterCurrentThreadAsMainThread();
    mWindow = MakeWindow(OS_Rect(0, 0, 10, 10));
    mSystem.Pump();
    Clear();
  }

  tarsel::threads::AsyncEventLoopAdaptorPtr mExecutor;
  OS_WindowHandle mWindow = 0;
};

TEST_F(HeadlessLoopTest, TheLoopRunsUntilQuitAndAnswersTheExitCode) {
  mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message == kOSMsgCommand && inMessage.wParam == kQuit) mLayer.QuitLoop(42);
    return std::nullopt;
  };
  mLayer.PostMessage(mWindow, kOSMsgCommand, 0, 0);
  mLayer.PostMessage(mWindow, kOSMsgCommand, kQuit, 0);
  mLayer.PostMessage(mWindow, kOSMsgCommand, 3, 0);
  EXPECT_EQ(mLayer.RunLoop(), 42);
  // The message after the quit stays queued for the next loop.
  EXPECT_EQ(mSystem.GetQueueLength(), 1u);
}

TEST_F(HeadlessLoopTest, TwoQuitsInOneHandlerEndTheInnerLoopAndThenTheOuter) {
  std::vector<int> codes;
  mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message != kStartInner) return std::nullopt;
    if (inMessage.wParam == kNest) {
      mLayer.PostMessage(mWindow, kStartInner, kQuit, 0);
      codes.push_back(mLayer.RunLoop());
    } else {
      mLayer.QuitLoop(10);
      mLayer.QuitLoop(20);
    }
    return 0;
  };
  mLayer.PostMessage(mWindow, kStartInner, kNest, 0);
  codes.push_back(mLayer.RunLoop());
  EXPECT_THAT(codes, ElementsAre(10, 20));
}

TEST_F(HeadlessLoopTest, AnIdleLoopJumpsTheVirtualClockToTheNextTimer) {
  mLayer.SetTimer(mWindow, 9, 5000);
  mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message == kOSMsgTimer) mLayer.QuitLoop(0);
    return std::nullopt;
  };
  const auto start = std::chrono::steady_clock::now();
  EXPECT_EQ(mLayer.RunLoop(), 0);
  EXPECT_EQ(mLayer.GetTickCount(), 5000);
  EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(4));
}

TEST_F(HeadlessLoopTest, AnIdleLoopWithNothingToWaitForGivesUp) {
  mSystem.SetIdleWaitLimit(20);
  EXPECT_EQ(mLayer.RunLoop(), HeadlessWindowSystem::kIdleExitCode);
}

TEST_F(HeadlessLoopTest, APostFromAnotherThreadWakesTheWaitingLoop) {
  mSystem.SetIdleWaitLimit(10000);
  std::thread::id ranOn;
  std::thread poster([this, &ranOn] {
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    mExecutor->Post([this, &ranOn] {
      ranOn = std::this_thread::get_id();
      mLayer.QuitLoop(7);
    });
  });
  const auto start = std::chrono::steady_clock::now();
  const int code = mLayer.RunLoop();
  poster.join();
  EXPECT_EQ(code, 7);
  EXPECT_EQ(ranOn, std::this_thread::get_id());
  EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(5));
}

TEST_F(HeadlessLoopTest, PendingEventsRunTasksMessagesAndPaintsWithoutWaiting) {
  int tasks = 0;
  mExecutor->Post([&] { ++tasks; });
  mLayer.PostMessage(mWindow, kOSMsgCommand, 0, 0);
  mLayer.InvalidateRect(mWindow, nullptr);
  EXPECT_EQ(mLayer.ProcessPendingEvents(), 3);
  EXPECT_EQ(tasks, 1);
  EXPECT_THAT(NumbersOf(mWindow), ElementsAre(kOSMsgCommand));
  EXPECT_EQ(Messages(kOSMsgPaint).size(), 1u);
  EXPECT_EQ(mLayer.ProcessPendingEvents(), 0);
}

TEST_F(HeadlessLoopTest, PeekingFindsTheOldestMatchingMessageAndCanRemoveIt) {
  const OS_WindowHandle other = MakeWindow(OS_Rect(0, 0, 10, 10));
  mLayer.PostMessage(other, kOSMsgKeyDown, 1, 0);
  mLayer.PostMessage(mWindow, kOSMsgKeyDown, 2, 0);
  mLayer.PostMessage(mWindow, kOSMsgKeyUp, 3, 0);
  OS_Event event;
  ASSERT_TRUE(mLayer.PeekMessage(event, mWindow, kOSMsgKeyDown, kOSMsgKeyUp, false));
  EXPECT_EQ(event.GetWParam(), 2u);
  ASSERT_TRUE(mLayer.PeekMessage(event, 0, kOSMsgKeyUp, kOSMsgKeyUp, true));
  EXPECT_EQ(event.GetWParam(), 3u);
  EXPECT_FALSE(mLayer.PeekMessage(event, 0, kOSMsgKeyUp, kOSMsgKeyUp, false));
  EXPECT_FALSE(mLayer.PeekMessage(event, mWindow, kOSMsgMouseMove, kOSMsgMouseMove, false));
  EXPECT_EQ(mSystem.GetQueueLength(), 2u);
}

// ---- the seams installed with the layer ----

TEST_F(HeadlessLoopTest, InstallingTheLayerAnswersModifiersFromItsKeyboard) {
  mSystem.Install();
  EXPECT_EQ(GetNativeLayer(), &mLayer);
  mLayer.SetFocus(mWindow);
  std::vector<ModifierKeys> recent;
  mHandler = [&](const RecordedMessage& inMessage) -> std::optional<std::intptr_t> {
    if (inMessage.message == kOSMsgKeyDown && inMessage.wParam == 'A')
      recent.push_back(utility::GetRecentEventModKeys());
    return std::nullopt;
  };
  mSystem.PressKey(kOSKeyControl);
  mSystem.TypeKey('A');
  mSystem.ReleaseKey(kOSKeyControl);
  mSystem.SetKeyToggled(kOSKeyCapsLock, true);
  mSystem.PressKey(kOSKeyShift);
  ASSERT_TRUE(utility::GetCurrentModKeys().Test(kModKeyShift));
  EXPECT_TRUE(utility::GetCurrentModKeys().Test(kModKeyCapsLock));
  EXPECT_FALSE(utility::GetCurrentModKeys().Test(kModKeyCtrl));
  mSystem.Pump();
  ASSERT_EQ(recent.size(), 1u);
  EXPECT_TRUE(recent[0].Test(kModKeyCtrl));
  EXPECT_FALSE(recent[0].Test(kModKeyShift));
  mSystem.Uninstall();
  EXPECT_EQ(GetNativeLayer(), nullptr);
}

TEST_F(HeadlessLoopTest, TheFocusPlatformRecognisesOurWindowsAndDropsPendingKeys) {
  mSystem.Install();
  OS_FocusPlatform& focus = GetNativeFocusPlatform();
  const OS_WindowHandle child = MakeChild(mWindow, OS_Rect(0, 0, 5, 5));
  EXPECT_EQ(focus.GetOurWindowNode(mWindow), nullptr);  // no node tied to it yet
  int fakeNode = 0;
  mLayer.SetProperty(mWindow, "norvik::ui::OS_Window::property", &fakeNode);
  EXPECT_EQ(static_cast<void*>(focus.GetOurWindowNode(mWindow)), static_cast<void*>(&fakeNode));
  OS_WindowCreateParams params;
  const OS_WindowHandle foreign = mSystem.CreateForeignWindow(params, true);
  mLayer.SetProperty(foreign, "norvik::ui::OS_Window::property", &fakeNode);
  EXPECT_EQ(focus.GetOurWindowNode(foreign), nullptr);  // another thread's window is never ours
  EXPECT_TRUE(focus.IsChildWindow(child));
  EXPECT_FALSE(focus.IsChildWindow(mWindow));
  EXPECT_EQ(focus.GetParentWindow(child), mWindow);

  mLayer.SetFocus(mWindow);
  mSystem.TypeKey('A');
  mLayer.PostMessage(mWindow, kOSMsgCommand, 0, 0);
  focus.RemovePendingKeyMessages();
  mSystem.Pump();
  EXPECT_THAT(NumbersOf(mWindow), ElementsAre(kOSMsgCommand));
  mSystem.Uninstall();
}

TEST_F(HeadlessLoopTest, InstallingHandsTheFocusPlatformToTheManager) {
  UI_NodeManager* const before = UI_NodeManager::Get(true);
  {
    UI_NodeManager manager;
    mSystem.Install();
    EXPECT_EQ(manager.GetFocusPlatform(), &GetNativeFocusPlatform());
    mSystem.Uninstall();
    EXPECT_EQ(manager.GetFocusPlatform(), nullptr);
  }
  UI_NodeManager::Set(before);
}

}  // namespace
}  // namespace norvik::ui::test
