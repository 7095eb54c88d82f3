// Messages and notification lists: order, skipped and emptied entries, and
// callbacks that change the list or destroy its owner while it fires.
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "ui/MessageT.h"

namespace norvik::ui {
namespace {

struct Subject {
  int value = 0;
};

class ValueChangedMessage : public MessageT<Subject> {
 public:
  ValueChangedMessage(Subject* inSubject, int inOld) : MessageT<Subject>(inSubject), mOld(inOld) {}
  int mOld;
};

TEST(NotificationList, FiresEntriesInInstallationOrderWithTheArgumentsSkippingNullOnes) {
  NotificationList<void(int, const std::string&)> list;
  std::vector<std::string> calls;
  list.Install(MakeNotification<void(int, const std::string&)>(
      [&](int n, const std::string& s) { calls.push_back("a" + std::to_string(n) + s); }));
  list.Install(nullptr);
  list.Install(MakeNotification<void(int, const std::string&)>(
      [&](int n, const std::string& s) { calls.push_back("b" + std::to_string(n) + s); }));
  list.Notify(7, std::string("x"));
  EXPECT_EQ(calls, (std::vector<std::string>{"a7x", "b7x"}));
}

TEST(NotificationList, AnEntryEmptiedByItsOwnerThrowsTheStandardErrorAfterEarlierEntriesRan) {
  NotificationList<void()> list;
  std::vector<int> calls;
  list.Install(MakeNotification<void()>([&] { calls.push_back(1); }));
  auto kept = MakeNotification<void()>([&] { calls.push_back(2); });
  list.Install(kept);
  list.Install(MakeNotification<void()>([&] { calls.push_back(3); }));

  list.Notify();
  EXPECT_EQ(calls, (std::vector<int>{1, 2, 3}));

  kept->clear();
  calls.clear();
  try {
    list.Notify();
    FAIL() << "an empty function was called without error";
  } catch (const boost::bad_function_call& error) {
    EXPECT_STREQ(error.what(), "call to empty boost::function");
  }
  EXPECT_EQ(calls, (std::vector<int>{1}));
}

TEST(NotificationList, UntilTrueStopsAtTheFirstTrueAnswerAndIsFalseWhenNoneAnswersTrue) {
  NotificationList<bool(long)> list;
  EXPECT_FALSE(list.NotifyUntilTrue(5L));
  std::vector<int> calls;
  list.Install(MakeNotification<bool(long)>([&](long) { calls.push_back(1); return false; }));
  list.Install(MakeNotification<bool(long)>([&](long id) { calls.push_back(2); return id == 5; }));
  list.Install(MakeNotification<bool(long)>([&](long) { calls.push_back(3); return true; }));
  EXPECT_TRUE(list.NotifyUntilTrue(5L));
  EXPECT_EQ(calls, (std::vector<int>{1, 2}));
  calls.clear();
  EXPECT_TRUE(list.NotifyUntilTrue(6L));
  EXPECT_EQ(calls, (std::vector<int>{1, 2, 3}));
}

TEST(NotificationList, AnEntryInstalledWhileFiringIsCalledFromTheNextPassOn) {
  NotificationList<void()> list;
  int late = 0;
  bool installed = false;
  list.Install(MakeNotification<void()>([&] {
    if (installed) return;
    installed = true;
    list.Install(MakeNotification<void()>([&] { ++late; }));
  }));
  list.Notify();
  EXPECT_EQ(late, 0);
  list.Notify();
  EXPECT_EQ(late, 1);
}

TEST(NotificationList, SurvivesACallbackThatDestroysTheListsOwner) {
  struct Owner {
    NotificationList<void()> changed;
  };
  auto owner = std::make_unique<Owner>();
  std::vector<int> calls;
  owner->changed.Install(MakeNotification<void()>([&] {
    calls.push_back(1);
    owner.reset();
  }));
  owner->changed.Install(MakeNotification<void()>([&] { calls.push_back(2); }));
  Owner* raw = owner.get();
  raw->changed.Notify();
  EXPECT_EQ(owner, nullptr);
  EXPECT_EQ(calls, (std::vector<int>{1, 2}));
}

}  // namespace
}  // namespace norvik::ui
