#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <condition_variable>
#include <mutex>
#include <thread>
#include <vector>

#include "support/tarsel/TraceRecorder.h"
#include "tarsel/DebugTrace.h"

using namespace tarsel::debug;
using tarsel::testing::TraceRecorder;

namespace {

// Each test uses categories of its own, since volumes are process-wide.
std::string Cat(const char* name) { return std::string("test.trace.") + name; }

}  // namespace

TEST(Trace, APlainTraceReachesTheMasterHandlerVerbatim) {
  TraceRecorder trace;
  DebugTrace("hello trace");
  DebugTrace(UTF16String(u"gr\u00fc\u00dfe"));
  EXPECT_EQ(trace.Lines(), (std::vector<std::string>{"hello trace", "gr\xC3\xBC\xC3\x9F" "e"}));
}

TEST(Trace, ACategoryIsSilentUntilItsVolumeReachesTheLevelOfTheTrace) {
  TraceRecorder trace;
  const std::string cat = Cat("levels");
  EXPECT_EQ(GetTraceVolume(cat), 0);
  DebugTrace(cat, "not yet");
  EXPECT_FALSE(IsTraceEnabled(cat));
  SetTraceVolume(cat, 2);
  DebugTrace(cat, 1, "one");
  DebugTrace(cat, 2, "two");
  DebugTrace(cat, 3, "three");
  SetTraceVolume(cat, -5);
  EXPECT_EQ(GetTraceVolume(cat), 0) << "a negative volume counts as silent";
  DebugTrace(cat, "off again");
  EXPECT_EQ(trace.Lines(), (std::vector<std::string>{cat + ": one", cat + ": two"}));
}

TEST(Trace, TheMacroDoesNotBuildItsTextForASilentCategory) {
  TraceRecorder trace;
  const std::string cat = Cat("macro");
  SetTraceVolume(cat, 0);
  int built = 0;
  auto text = [&] { ++built; return std::string("expensive"); };
  NRK_TRACE(cat, text());
  EXPECT_EQ(built, 0);
  SetTraceVolume(cat, 1);
  NRK_TRACE(cat, text());
  EXPECT_EQ(built, 1);
  EXPECT_TRUE(trace.Contains("expensive"));
  SetTraceVolume(cat, 0);
}

TEST(Trace, CategoriesBecomeKnownWhenTracedOrSetAndAreListedSorted) {
  const std::string b = Cat("list.b"), a = Cat("list.a");
  DebugTrace(b, "x");
  SetTraceVolume(a, 3);
  std::vector<UTF8String> keys = GetTraceCategories();
  auto find = [&](const std::string& k) { return std::find(keys.begin(), keys.end(), UTF8String(k.c_str())); };
  ASSERT_NE(find(a), keys.end());
  ASSERT_NE(find(b), keys.end());
  EXPECT_LT(find(a), find(b));
  EXPECT_TRUE(std::is_sorted(keys.begin(), keys.end()));
  EXPECT_EQ(GetTraceVolume(a), 3);
  EXPECT_EQ(GetTraceVolume(b), 0);
}

TEST(Trace, VolumeSettingsTextAppliesWellFormedItemsAndSkipsTheRest) {
  const std::string a = Cat("settings.a"), b = Cat("settings.b"), c = Cat("settings.c");
  int applied = ApplyTraceVolumes(a + "=4;" + b + ", " + c + "=loud,=3,,");
  EXPECT_EQ(applied, 2);
  EXPECT_EQ(GetTraceVolume(a), 4);
  EXPECT_EQ(GetTraceVolume(b), 1);
  EXPECT_EQ(GetTraceVolume(c), 0);
}

TEST(Trace, WithoutAHandlerTextGoesToStandardError) {
  ASSERT_EQ(GetMasterTraceHandler(), nullptr);
  ::testing::internal::CaptureStderr();
  DebugTrace("to stderr");
  EXPECT_EQ(::testing::internal::GetCapturedStderr(), "to stderr\n");
}

namespace {
class EchoingHandler : public TraceHandler {
 public:
  void Trace(const UTF8String& inText) override {
    ++mCalls;
    DebugTrace("echo of " + tarsel::utility::ToStdString(inText));
  }
  int mCalls = 0;
};

class SelfRemovingHandler : public TraceHandler {
 public:
  void Trace(const UTF8String&) override {
    ++mCalls;
    RemoveMasterTraceHandler(this);
  }
  int mCalls = 0;
};
}  // namespace

TEST(Trace, AHandlerThatTracesDoesNotRecurseIntoItself) {
  EchoingHandler handler;
  InstallMasterTraceHandler(&handler);
  ::testing::internal::CaptureStderr();
  DebugTrace("line");
  std::string err = ::testing::internal::GetCapturedStderr();
  RemoveMasterTraceHandler(&handler);
  EXPECT_EQ(handler.mCalls, 1);
  EXPECT_EQ(err, "echo of line\n");
}

TEST(Trace, AHandlerMayRemoveItselfFromInsideATrace) {
  SelfRemovingHandler handler;
  InstallMasterTraceHandler(&handler);
  DebugTrace("first");
  EXPECT_EQ(GetMasterTraceHandler(), nullptr);
  ::testing::internal::CaptureStderr();
  DebugTrace("second");
  EXPECT_EQ(::testing::internal::GetCapturedStderr(), "second\n");
  EXPECT_EQ(handler.mCalls, 1);
}

namespace {
// Blocks inside Trace until released, recording when it leaves.
class BlockingHandler : public TraceHandler {
 public:
  void Trace(const UTF8String&) override {
    std::unique_lock<std::mutex> lock(mMutex);
    mEntered = true;
    mChanged.notify_all();
    mChanged.wait(lock, [&] { return mReleased; });
    mEvents.push_back("handler left");
  }
  void WaitUntilEntered() {
    std::unique_lock<std::mutex> lock(mMutex);
    mChanged.wait(lock, [&] { return mEntered; });
  }
  void Release() {
    std::lock_guard<std::mutex> lock(mMutex);
    mReleased = true;
    mChanged.notify_all();
  }
  void Record(const char* inEvent) {
    std::lock_guard<std::mutex> lock(mMutex);
    mEvents.push_back(inEvent);
  }
  std::vector<std::string> Events() {
    std::lock_guard<std::mutex> lock(mMutex);
    return mEvents;
  }

 private:
  std::mutex mMutex;
  std::condition_variable mChanged;
  bool mEntered = false;
  bool mReleased = false;
  std::vector<std::string> mEvents;
};
}  // namespace

TEST(Trace, RemovingAHandlerWaitsForACallUnderWayOnAnotherThread) {
  BlockingHandler handler;
  InstallMasterTraceHandler(&handler);
  std::thread tracer([] { DebugTrace("slow"); });
  handler.WaitUntilEntered();
  std::thread remover([&] {
    RemoveMasterTraceHandler(&handler);
    handler.Record("removed");
  });
  std::this_thread::sleep_for(std::chrono::milliseconds(50));
  handler.Record("released");
  handler.Release();
  tracer.join();
  remover.join();
  EXPECT_EQ(handler.Events(), (std::vector<std::string>{"released", "handler left", "removed"}));
}

namespace {
// Counts into a shared total; installs itself for its lifetime.
class CountingHandler : public TraceHandler {
 public:
  explicit CountingHandler(std::atomic<int>& inTotal) : mTotal(inTotal) {
    mPrevious = InstallMasterTraceHandler(this);
  }
  ~CountingHandler() override {
    // Putting the previous one back waits for calls still inside this one.
    InstallMasterTraceHandler(mPrevious);
    mAlive = false;
  }
  void Trace(const UTF8String&) override {
    EXPECT_TRUE(mAlive);
    ++mTotal;
  }

 private:
  std::atomic<int>& mTotal;
  TraceHandler* mPrevious = nullptr;
  std::atomic<bool> mAlive{true};
};
}  // namespace

TEST(Trace, HandlersComingAndGoingWhileOtherThreadsTraceLoseNothingAndCrashNothing) {
  std::atomic<int> received{0};
  CountingHandler outer(received);
  std::atomic<bool> stop{false};
  std::atomic<int> sent{0};
  std::vector<std::thread> threads;
  for (int t = 0; t < 3; ++t)
    threads.emplace_back([&] {
      while (!stop.load()) {
        DebugTrace("background");
        ++sent;
      }
    });
  for (int i = 0; i < 200; ++i) {
    // Each inner handler dies right after removing itself: a call still
    // inside it would touch a dead object (and AddressSanitizer would say so).
    CountingHandler inner(received);
    DebugTrace("foreground");
    ++sent;
  }
  stop = true;
  for (auto& thread : threads) thread.join();
  EXPECT_EQ(received.load(), sent.load());
}
