#pragma once
// Repeating timers of nodes.
//
// A node asks for a timer by an id of its own choosing; the nearest window owns
// a UI_NodeTimerManager, and each timer is one UI_NodeTimerData record held by
// that manager. The record's address is the timer's key: the native timer is
// created with it as native id, so that a timer message leads straight back to
// the record. A node keeps the keys of its own timers, and the manager's
// operations take that key list so that both sides stay in step.
//
// What a record does besides holding its values is up to the factory that the
// window gives its manager: the native windows make records that own a native
// timer (created with the record, killed when it dies); tests and headless
// windows may make plain records.
#include <algorithm>
#include <cstdint>
#include <map>

#include <boost/core/noncopyable.hpp>
#include <boost/function.hpp>
#include <boost/intrusive_ptr.hpp>

#include "tarsel/RefCountedObject.h"

namespace norvik::ui {

class UI_Node;

class UI_NodeTimerData : public tarsel::utility::RefCountedObject {
 public:
  UI_NodeTimerData(UI_Node* inNode, long inTimerID, float inSeconds)
      : mNode(inNode), mTimerID(inTimerID), mSeconds(inSeconds) {}
  ~UI_NodeTimerData() override = default;

  UI_Node* GetNode() const { return mNode; }
  long GetTimerID() const { return mTimerID; }
  float GetSeconds() const { return mSeconds; }

  // The interval as the native timer takes it: whole milliseconds, truncated.
  unsigned long GetMilliseconds() const;

 private:
  UI_Node* mNode;
  long mTimerID;
  float mSeconds;
};

using UI_NodeTimerDataP = boost::intrusive_ptr<UI_NodeTimerData>;

class UI_NodeTimerManager : private boost::noncopyable {
 public:
  // A timer's key is its record's address, carried as a long (the type of the
  // keys a node keeps).
  using TimerKey = long;
  static_assert(sizeof(TimerKey) >= sizeof(std::uintptr_t), "a timer key must hold an address");

  using Factory = boost::function<UI_NodeTimerDataP(UI_Node* node, long id, float seconds)>;
  using TimerMap = std::map<TimerKey, UI_NodeTimerDataP>;

  // inFactory creates the record of each new timer; without one, plain
  // UI_NodeTimerData records are made.
  explicit UI_NodeTimerManager(UI_Node* inManagerNode, Factory inFactory = Factory());
  ~UI_NodeTimerManager();

  // A factory that makes plain records with no native timer behind them.
  static UI_NodeTimerDataP MakePlainTimerData(UI_Node* inNode, long inTimerID, float inSeconds);

  static TimerKey KeyOf(const UI_NodeTimerData* inData) {
    return static_cast<TimerKey>(reinterpret_cast<std::uintptr_t>(inData));
  }

  // Creates the record through the factory and enters it under its key.
  TimerKey CreateTimer(UI_Node* inNode, long inTimerID, float inSeconds);

  // Removes the first timer of ioKeys whose record has inTimerID: every
  // occurrence of its key leaves ioKeys, and the record is dropped.
  template <class KeyList>
  bool RemoveTimer(UI_Node* inNode, long inTimerID, KeyList& ioKeys);

  // Drops every record named in ioKeys, emptying it from the front.
  template <class KeyList>
  void RemoveAllTimers(UI_Node* inNode, KeyList& ioKeys);

  UI_NodeTimerData* GetTimerData(TimerKey inKey) const;
  TimerMap::const_iterator GetTimerDataIter(TimerKey inKey) const { return mTimers.find(inKey); }
  TimerMap::const_iterator End() const { return mTimers.end(); }
  std::size_t GetTimerCount() const { return mTimers.size(); }

  UI_Node* GetManagerNode() const { return mManagerNode; }

 private:
  // Erasing the entry can run a record's destructor (a native kill); the
  // record is moved out first so that the map is consistent while it runs.
  void EraseTimer(TimerKey inKey);

  TimerMap mTimers;
  UI_Node* mManagerNode;
  Factory mFactory;
};

template <class KeyList>
bool UI_NodeTimerManager::RemoveTimer(UI_Node* /*inNode*/, long inTimerID, KeyList& ioKeys) {
  for (auto it = ioKeys.begin(); it != ioKeys.end(); ++it) {
    const TimerKey key = *it;
    UI_NodeTimerData* data = GetTimerData(key);
    if (data == nullptr || data->GetTimerID() != inTimerID) continue;
    ioKeys.erase(std::remove(ioKeys.begin(), ioKeys.end(), key), ioKeys.end());
    EraseTimer(key);
    return true;
  }
  return false;
}

template <class KeyList>
void UI_NodeTimerManager::RemoveAllTimers(UI_Node* /*inNode*/, KeyList& ioKeys) {
  while (!ioKeys.empty()) {
    const TimerKey key = ioKeys.front();
    ioKeys.erase(ioKeys.begin());
    EraseTimer(key);
  }
}

}  // namespace norvik::ui
