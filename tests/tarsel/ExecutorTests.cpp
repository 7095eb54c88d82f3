#include <gtest/gtest.h>

#include <poll.h>
#include <unistd.h>

#include <atomic>
#include <map>
#include <stdexcept>
#include <thread>
#include <vector>

#include "support/tarsel/TraceRecorder.h"
#include "tarsel/ErrorManager.h"
#include "tarsel/Threads.h"

using namespace tarsel::threads;

namespace {

class ExecutorTest : public ::testing::Test {
 protected:
  void SetUp() override { mExecutor = RegisterCurrentThreadAsMainThread(); }
  void TearDown() override { UnregisterMainThread(); }

  AsyncEventLoopAdaptorPtr mExecutor;
};

}  // namespace

TEST_F(ExecutorTest, OnlyTheRegisteredThreadIsTheMainThreadAndRegisteringAnotherMovesItThere) {
  EXPECT_EQ(RegisterCurrentThreadAsMainThread(), mExecutor) << "registering again answers the same executor";
  EXPECT_EQ(mExecutor->GetOwnerThreadID(), GetCurrentThreadID());
  EXPECT_TRUE(IsMainThread());
  bool otherWasMain = true;
  AsyncEventLoopAdaptorPtr otherExecutor;
  std::thread other([&] {
    otherWasMain = IsMainThread();
    otherExecutor = RegisterCurrentThreadAsMainThread();
  });
  other.join();
  EXPECT_FALSE(otherWasMain);
  ASSERT_NE(otherExecutor, nullptr);
  EXPECT_NE(otherExecutor, mExecutor);
  EXPECT_FALSE(IsMainThread());
  EXPECT_EQ(GetMainThreadExecutor(), otherExecutor);
  UnregisterMainThread();
  EXPECT_EQ(GetMainThreadExecutor(), nullptr);
}

TEST_F(ExecutorTest, TasksPostedFromManyThreadsAllRunOnTheMainThreadInPostingOrder) {
  constexpr int kThreads = 4, kTasks = 250;
  std::vector<std::vector<int>> seen(kThreads);
  std::atomic<int> offMainThread{0};
  std::vector<std::thread> posters;
  for (int t = 0; t < kThreads; ++t)
    posters.emplace_back([&, t] {
      for (int i = 0; i < kTasks; ++i)
        mExecutor->Post([&, t, i] {
          if (!IsMainThread()) ++offMainThread;
          seen[t].push_back(i);  // only the main thread touches seen
        });
    });
  std::size_t ran = 0;
  // Run while the posters are still posting, then drain.
  while (ran < static_cast<std::size_t>(kThreads * kTasks)) {
    ran += mExecutor->RunPending();
    std::this_thread::yield();
  }
  for (auto& poster : posters) poster.join();
  EXPECT_EQ(mExecutor->RunPending(), 0u);
  EXPECT_EQ(offMainThread.load(), 0);
  for (int t = 0; t < kThreads; ++t) {
    ASSERT_EQ(seen[t].size(), static_cast<std::size_t>(kTasks));
    for (int i = 0; i < kTasks; ++i) ASSERT_EQ(seen[t][i], i);
  }
}

TEST_F(ExecutorTest, ATaskPostedByATaskRunsInTheNextRound) {
  std::vector<std::string> order;
  mExecutor->Post([&] {
    order.push_back("first");
    mExecutor->Post([&] { order.push_back("posted by first"); });
  });
  mExecutor->Post([&] { order.push_back("second"); });
  EXPECT_EQ(mExecutor->RunPending(), 2u);
  EXPECT_EQ(order, (std::vector<std::string>{"first", "second"}));
  EXPECT_EQ(mExecutor->GetPendingCount(), 1u);
  EXPECT_EQ(mExecutor->RunPending(), 1u);
  EXPECT_EQ(order.back(), "posted by first");
}

TEST_F(ExecutorTest, AThrowingTaskIsReportedAndTheOthersStillRun) {
  auto* errors = tarsel::config::ErrorManager::Get(true);
  std::vector<std::string> reports;
  auto previous = errors->SetReportHandler([&](const tarsel::config::ErrorReport& r) {
    reports.push_back(tarsel::utility::ToStdString(tarsel::utility::UTF16to8(r.mMessage)));
  });
  int after = 0;
  mExecutor->Post([] { throw std::runtime_error("task failed"); });
  mExecutor->Post([&] { ++after; });
  EXPECT_EQ(mExecutor->RunPending(), 2u);
  errors->SetReportHandler(previous);
  EXPECT_EQ(after, 1);
  EXPECT_EQ(reports, (std::vector<std::string>{"task failed"}));
}

TEST_F(ExecutorTest, RunningTheQueueFromAnotherThreadIsAContractViolation) {
  tarsel::testing::TraceRecorder trace;
  int ran = 0;
  mExecutor->Post([&] { ++ran; });
  bool threw = false;
  std::thread other([&] {
    try {
      mExecutor->RunPending();
    } catch (const tarsel::config::Exception& error) {
      threw = error.GetCode() == 25;
    }
  });
  other.join();
  EXPECT_TRUE(threw);
  EXPECT_EQ(ran, 0);
  EXPECT_EQ(mExecutor->RunPending(), 1u);
}

TEST_F(ExecutorTest, ATaskMayDropTheLastReferenceToItsExecutor) {
  AsyncEventLoopAdaptorPtr own(new AsyncEventLoopAdaptor(GetCurrentThreadID()));
  AsyncEventLoopAdaptor* raw = own.get();
  int ran = 0;
  raw->Post([&] {
    ++ran;
    own.reset();
  });
  raw->Post([&] { ++ran; });
  // The executor keeps itself alive until the round ends.
  EXPECT_EQ(raw->RunPending(), 2u);
  EXPECT_EQ(ran, 2);
}

TEST_F(ExecutorTest, DiscardedTasksNeverRunAndEmptyTasksAreIgnored) {
  int ran = 0;
  mExecutor->Post([&] { ++ran; });
  mExecutor->Post([&] { ++ran; });
  mExecutor->Post(AsyncEventLoopAdaptor::Task());
  EXPECT_EQ(mExecutor->DiscardPending(), 2u);
  EXPECT_EQ(mExecutor->RunPending(), 0u);
  EXPECT_EQ(ran, 0);
}

TEST_F(ExecutorTest, APostFromAnotherThreadCallsTheWakeUpFunctionUntilItIsCleared) {
  std::atomic<int> wakeUps{0};
  mExecutor->SetWakeUpFunction([&] { ++wakeUps; });
  std::thread poster([&] { mExecutor->Post([] {}); });
  poster.join();
  EXPECT_EQ(wakeUps.load(), 1);
  EXPECT_EQ(mExecutor->RunPending(), 1u);
  mExecutor->SetWakeUpFunction({});
  mExecutor->Post([] {});
  EXPECT_EQ(wakeUps.load(), 1);
  mExecutor->RunPending();
}

TEST_F(ExecutorTest, ReplacingTheWakeUpFunctionWaitsForOneStillRunning) {
  std::atomic<bool> inside{false}, oldFinished{false};
  mExecutor->SetWakeUpFunction([&] {
    inside = true;
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    oldFinished = true;
  });
  std::thread poster([&] { mExecutor->Post([] {}); });
  while (!inside) std::this_thread::yield();
  mExecutor->SetWakeUpFunction({});
  EXPECT_TRUE(oldFinished.load());
  poster.join();
  mExecutor->RunPending();
}
