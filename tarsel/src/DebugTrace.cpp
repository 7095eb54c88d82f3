#include "tarsel/DebugTrace.h"

#include <algorithm>
#include <charconv>
#include <condition_variable>
#include <cstdio>
#include <cstdlib>
#include <map>
#include <mutex>

namespace tarsel::debug {
namespace {

struct TraceState {
  std::mutex mMutex;
  std::condition_variable mHandlerIdle;
  TraceHandler* mHandler = nullptr;
  // Per handler: the calls under way into it, and how many of those callers
  // are themselves waiting for it to become idle (they removed or replaced
  // the handler from inside its Trace). Entries go when both are 0.
  struct Calls {
    int mActive = 0;
    int mWaitingInside = 0;
  };
  std::map<TraceHandler*, Calls> mCalls;
  std::map<std::string, int, std::less<>> mVolumes;
};

// The handler this thread is inside, if any: nested traces go to standard
// error instead of back into a handler.
thread_local TraceHandler* tCurrentHandler = nullptr;

// Calls inApply(key, volume) for each well-formed "key=volume" or "key" item
// of a comma- or semicolon-separated list; answers how many there were.
template <typename Apply>
int ParseVolumeSettings(std::string_view inSettings, Apply&& inApply) {
  int applied = 0;
  std::size_t start = 0;
  while (start <= inSettings.size()) {
    std::size_t end = inSettings.find_first_of(",;", start);
    if (end == std::string_view::npos) end = inSettings.size();
    std::string_view item = inSettings.substr(start, end - start);
    std::size_t eq = item.find('=');
    std::string_view key = item.substr(0, eq);
    int volume = 1;
    bool ok = !key.empty();
    if (ok && eq != std::string_view::npos) {
      std::string_view number = item.substr(eq + 1);
      auto result = std::from_chars(number.data(), number.data() + number.size(), volume);
      ok = result.ec == std::errc() && result.ptr == number.data() + number.size();
    }
    if (ok) {
      inApply(key, volume);
      ++applied;
    }
    start = end + 1;
  }
  return applied;
}

TraceState& State() {
  // Never destroyed: threads and static destructors may trace during exit.
  static TraceState* state = [] {
    auto* s = new TraceState;
    if (const char* settings = std::getenv("NORVIK_TRACE")) {
      // Applied without the lock: nothing else can see the state yet.
      ParseVolumeSettings(settings, [s](std::string_view inKey, int inVolume) {
        s->mVolumes[std::string(inKey)] = std::max(inVolume, 0);
      });
    }
    return s;
  }();
  return *state;
}

void WriteToStandardError(std::string_view inText) {
  // One fwrite per line keeps lines of different threads from interleaving.
  std::string line(inText);
  line.push_back('\n');
  std::fwrite(line.data(), 1, line.size(), stderr);
}

void Deliver(std::string_view inText) {
  TraceState& state = State();
  TraceHandler* handler = nullptr;
  if (!tCurrentHandler) {
    std::lock_guard<std::mutex> lock(state.mMutex);
    handler = state.mHandler;
    if (handler) ++state.mCalls[handler].mActive;
  }
  if (!handler) {
    WriteToStandardError(inText);
    return;
  }
  tCurrentHandler = handler;
  try {
    handler->Trace(UTF8String(inText.data(), inText.size()));
  } catch (...) {
    // A failing handler must not turn a trace into an error of the caller.
  }
  tCurrentHandler = nullptr;
  {
    std::lock_guard<std::mutex> lock(state.mMutex);
    auto it = state.mCalls.find(handler);
    if (--it->second.mActive == 0 && it->second.mWaitingInside == 0) state.mCalls.erase(it);
  }
  state.mHandlerIdle.notify_all();
}

int VolumeLocked(TraceState& inState, std::string_view inCategory) {
  auto it = inState.mVolumes.find(inCategory);
  if (it == inState.mVolumes.end()) {
    inState.mVolumes.emplace(std::string(inCategory), 0);
    return 0;
  }
  return it->second;
}

}  // namespace

void DebugTrace(std::string_view inText) { Deliver(inText); }

void DebugTrace(const UTF16String& inText) {
  UTF8String text = utility::UTF16to8(inText);
  Deliver(std::string_view(text.data(), text.size()));
}

void DebugTrace(std::string_view inCategory, std::string_view inText) {
  DebugTrace(inCategory, 1, inText);
}

void DebugTrace(std::string_view inCategory, int inLevel, std::string_view inText) {
  if (!IsTraceEnabled(inCategory, inLevel)) return;
  std::string line;
  line.reserve(inCategory.size() + 2 + inText.size());
  line.append(inCategory).append(": ").append(inText);
  Deliver(line);
}

bool IsTraceEnabled(std::string_view inCategory, int inLevel) {
  TraceState& state = State();
  std::lock_guard<std::mutex> lock(state.mMutex);
  return VolumeLocked(state, inCategory) >= std::max(inLevel, 1);
}

namespace {
// Waits until no thread is inside inHandler, except threads that are inside
// it and waiting here themselves: two threads that remove a handler from
// inside it at once must not wait for each other.
void WaitUntilIdleLocked(TraceState& inState, TraceHandler* inHandler, std::unique_lock<std::mutex>& inLock) {
  if (!inHandler) return;
  auto found = inState.mCalls.find(inHandler);
  if (found == inState.mCalls.end()) return;
  const bool self = tCurrentHandler == inHandler;
  if (self) ++found->second.mWaitingInside;
  inState.mHandlerIdle.notify_all();
  inState.mHandlerIdle.wait(inLock, [&] {
    auto it = inState.mCalls.find(inHandler);
    return it == inState.mCalls.end() || it->second.mActive <= it->second.mWaitingInside;
  });
  if (self) {
    auto it = inState.mCalls.find(inHandler);
    if (--it->second.mWaitingInside == 0 && it->second.mActive == 0) inState.mCalls.erase(it);
  }
}
}  // namespace

TraceHandler* InstallMasterTraceHandler(TraceHandler* inHandler) {
  TraceState& state = State();
  std::unique_lock<std::mutex> lock(state.mMutex);
  TraceHandler* previous = state.mHandler;
  state.mHandler = inHandler;
  if (previous != inHandler) WaitUntilIdleLocked(state, previous, lock);
  return previous;
}

void RemoveMasterTraceHandler() {
  TraceState& state = State();
  std::unique_lock<std::mutex> lock(state.mMutex);
  TraceHandler* previous = state.mHandler;
  state.mHandler = nullptr;
  WaitUntilIdleLocked(state, previous, lock);
}

bool RemoveMasterTraceHandler(TraceHandler* inHandler) {
  TraceState& state = State();
  std::unique_lock<std::mutex> lock(state.mMutex);
  if (inHandler == nullptr || state.mHandler != inHandler) return false;
  state.mHandler = nullptr;
  WaitUntilIdleLocked(state, inHandler, lock);
  return true;
}

TraceHandler* GetMasterTraceHandler() {
  TraceState& state = State();
  std::lock_guard<std::mutex> lock(state.mMutex);
  return state.mHandler;
}

std::vector<UTF8String> GetTraceCategories() {
  TraceState& state = State();
  std::lock_guard<std::mutex> lock(state.mMutex);
  std::vector<UTF8String> keys;
  keys.reserve(state.mVolumes.size());
  for (const auto& entry : state.mVolumes) keys.emplace_back(entry.first.data(), entry.first.size());
  return keys;
}

int GetTraceVolume(std::string_view inKey) {
  TraceState& state = State();
  std::lock_guard<std::mutex> lock(state.mMutex);
  auto it = state.mVolumes.find(inKey);
  return it == state.mVolumes.end() ? 0 : it->second;
}

void SetTraceVolume(std::string_view inKey, int inVolume) {
  TraceState& state = State();
  std::lock_guard<std::mutex> lock(state.mMutex);
  auto it = state.mVolumes.find(inKey);
  if (it == state.mVolumes.end()) it = state.mVolumes.emplace(std::string(inKey), 0).first;
  it->second = std::max(inVolume, 0);
}

int ApplyTraceVolumes(std::string_view inSettings) {
  return ParseVolumeSettings(inSettings, [](std::string_view inKey, int inVolume) { SetTraceVolume(inKey, inVolume); });
}

}  // namespace tarsel::debug
