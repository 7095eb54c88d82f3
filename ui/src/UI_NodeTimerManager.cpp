#include "ui/UI_NodeTimerManager.h"

#include <utility>

namespace norvik::ui {

unsigned long UI_NodeTimerData::GetMilliseconds() const {
  if (!(mSeconds > 0.0f)) return 0;  // also catches NaN
  const double ms = static_cast<double>(mSeconds) * 1000.0;
  if (ms >= 4294967295.0) return 4294967295UL;
  return static_cast<unsigned long>(ms);
}

UI_NodeTimerManager::UI_NodeTimerManager(UI_Node* inManagerNode, Factory inFactory)
    : mManagerNode(inManagerNode), mFactory(std::move(inFactory)) {
  if (!mFactory) mFactory = &UI_NodeTimerManager::MakePlainTimerData;
}

UI_NodeTimerManager::~UI_NodeTimerManager() {
  // Records may kill native timers as they go; drop them one by one so that
  // each sees a manager that no longer lists it.
  while (!mTimers.empty()) EraseTimer(mTimers.begin()->first);
}

UI_NodeTimerDataP UI_NodeTimerManager::MakePlainTimerData(UI_Node* inNode, long inTimerID, float inSeconds) {
  return UI_NodeTimerDataP(new UI_NodeTimerData(inNode, inTimerID, inSeconds));
}

UI_NodeTimerManager::TimerKey UI_NodeTimerManager::CreateTimer(UI_Node* inNode, long inTimerID,
                                                               float inSeconds) {
  UI_NodeTimerDataP data = mFactory(inNode, inTimerID, inSeconds);
  if (!data) return 0;  // a factory that refuses leaves no timer; key 0 names no record
  const TimerKey key = KeyOf(data.get());
  mTimers[key] = std::move(data);
  return key;
}

UI_NodeTimerData* UI_NodeTimerManager::GetTimerData(TimerKey inKey) const {
  const auto it = mTimers.find(inKey);
  return it == mTimers.end() ? nullptr : it->second.get();
}

void UI_NodeTimerManager::EraseTimer(TimerKey inKey) {
  const auto it = mTimers.find(inKey);
  if (it == mTimers.end()) return;
  UI_NodeTimerDataP doomed = std::move(it->second);
  mTimers.erase(it);
  doomed.reset();
}

}  // namespace norvik::ui
