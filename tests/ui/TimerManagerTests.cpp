// The timer manager on its own: records made by its factory, keys, removal by
// id from a node's key list, and the end of every record with the manager.
#include <cmath>
#include <list>
#include <vector>

#include <gtest/gtest.h>

#include "ui/UI_NodeTimerManager.h"

namespace norvik::ui {
namespace {

// Nodes are only identities to the manager; two distinct addresses do.
int gNodeA, gNodeB;
UI_Node* const kNodeA = reinterpret_cast<UI_Node*>(&gNodeA);
UI_Node* const kNodeB = reinterpret_cast<UI_Node*>(&gNodeB);

// A record that reports its own end, as a native timer record kills its timer.
class TrackedTimerData : public UI_NodeTimerData {
 public:
  TrackedTimerData(UI_Node* inNode, long inID, float inSeconds, std::vector<long>* ioKilled)
      : UI_NodeTimerData(inNode, inID, inSeconds), mKilled(ioKilled) {}
  ~TrackedTimerData() override { mKilled->push_back(GetTimerID()); }

 private:
  std::vector<long>* mKilled;
};

class TimerManagerTest : public ::testing::Test {
 protected:
  UI_NodeTimerManager::Factory TrackingFactory() {
    return [this](UI_Node* node, long id, float seconds) {
      ++mCreated;
      return UI_NodeTimerDataP(new TrackedTimerData(node, id, seconds, &mKilled));
    };
  }

  std::vector<long> mKilled;
  int mCreated = 0;
};

TEST_F(TimerManagerTest, WithoutAFactoryPlainRecordsAreMadeAndAnUnknownKeyHasNone) {
  UI_NodeTimerManager manager(kNodeA);
  const auto key = manager.CreateTimer(kNodeA, 3, 1.0f);
  ASSERT_NE(manager.GetTimerData(key), nullptr);
  EXPECT_EQ(manager.GetTimerData(key)->GetTimerID(), 3);
  EXPECT_EQ(manager.GetTimerData(12345), nullptr);
  EXPECT_EQ(manager.GetTimerDataIter(12345), manager.End());
}

TEST_F(TimerManagerTest, AFactoryThatRefusesLeavesNoTimer) {
  UI_NodeTimerManager manager(kNodeA, [](UI_Node*, long, float) { return UI_NodeTimerDataP(); });
  const auto key = manager.CreateTimer(kNodeA, 3, 1.0f);
  EXPECT_EQ(manager.GetTimerData(key), nullptr);
  EXPECT_EQ(manager.GetTimerCount(), 0u);
}

TEST_F(TimerManagerTest, RemoveTimerDropsTheFirstMatchAndEveryCopyOfItsKeyOrAnswersFalse) {
  UI_NodeTimerManager manager(kNodeA, TrackingFactory());
  std::list<long> keys;
  const auto k1 = manager.CreateTimer(kNodeA, 1, 0.1f);
  const auto k2 = manager.CreateTimer(kNodeA, 2, 0.1f);
  keys = {k1, k2, k1};
  EXPECT_FALSE(manager.RemoveTimer(kNodeA, 9, keys)) << "no key carries the id";
  EXPECT_EQ(keys.size(), 3u);
  EXPECT_TRUE(manager.RemoveTimer(kNodeA, 1, keys));
  EXPECT_EQ(keys, (std::list<long>{k2}));
  EXPECT_EQ(manager.GetTimerData(k1), nullptr);
  EXPECT_NE(manager.GetTimerData(k2), nullptr);
  EXPECT_EQ(mKilled, (std::vector<long>{1}));
}

TEST_F(TimerManagerTest, RemoveTimerPassesOverKeysWhoseRecordIsAlreadyGone) {
  UI_NodeTimerManager manager(kNodeA, TrackingFactory());
  std::vector<long> stale{manager.CreateTimer(kNodeA, 5, 0.1f)};
  std::vector<long> keys = stale;
  ASSERT_TRUE(manager.RemoveTimer(kNodeA, 5, stale));
  const auto fresh = manager.CreateTimer(kNodeA, 5, 0.2f);
  keys.push_back(fresh);
  EXPECT_TRUE(manager.RemoveTimer(kNodeA, 5, keys));
  EXPECT_EQ(manager.GetTimerData(fresh), nullptr);
}

TEST_F(TimerManagerTest, RemoveAllTimersEndsTheNodesRecordsAndTheManagerEndsTheRestWhenItDies) {
  {
    UI_NodeTimerManager manager(kNodeA, TrackingFactory());
    std::list<long> keys{manager.CreateTimer(kNodeA, 1, 0.1f), manager.CreateTimer(kNodeA, 2, 0.1f)};
    const auto other = manager.CreateTimer(kNodeB, 3, 0.1f);
    manager.RemoveAllTimers(kNodeA, keys);
    EXPECT_TRUE(keys.empty());
    EXPECT_EQ(mKilled, (std::vector<long>{1, 2}));
    EXPECT_NE(manager.GetTimerData(other), nullptr);
  }
  EXPECT_EQ(mKilled, (std::vector<long>{1, 2, 3}));
}

TEST_F(TimerManagerTest, ARecordKeptElsewhereOutlivesItsRemovalButIsNoLongerFound) {
  UI_NodeTimerManager manager(kNodeA, TrackingFactory());
  std::vector<long> keys{manager.CreateTimer(kNodeA, 1, 0.1f)};
  UI_NodeTimerDataP held(manager.GetTimerData(keys.front()));
  const auto key = keys.front();
  manager.RemoveTimer(kNodeA, 1, keys);
  EXPECT_TRUE(mKilled.empty());
  EXPECT_EQ(manager.GetTimerData(key), nullptr);
  held.reset();
  EXPECT_EQ(mKilled, (std::vector<long>{1}));
}

TEST(UI_NodeTimerData, IntervalInMillisecondsIsTruncatedAndNegativeOrNonNumberIntervalsBecomeZero) {
  const struct {
    float seconds;
    unsigned milliseconds;
  } rows[] = {{0.0159f, 15u}, {2.0f, 2000u}, {0.0f, 0u}, {-1.0f, 0u}, {std::nanf(""), 0u}, {1e30f, 4294967295u}};
  for (const auto& row : rows)
    EXPECT_EQ(UI_NodeTimerData(nullptr, 1, row.seconds).GetMilliseconds(), row.milliseconds) << row.seconds;
}

}  // namespace
}  // namespace norvik::ui
