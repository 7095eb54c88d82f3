#pragma once
// A trace handler that keeps every line it receives, installed for the
// lifetime of the object. Tests use it to see what was traced.
#include <algorithm>
#include <mutex>
#include <string>
#include <vector>

#include "tarsel/DebugTrace.h"

namespace tarsel::testing {

class TraceRecorder : public debug::TraceHandler {
 public:
  TraceRecorder() { mPrevious = debug::InstallMasterTraceHandler(this); }
  ~TraceRecorder() override {
    debug::RemoveMasterTraceHandler(this);
    if (mPrevious) debug::InstallMasterTraceHandler(mPrevious);
  }
  TraceRecorder(const TraceRecorder&) = delete;
  TraceRecorder& operator=(const TraceRecorder&) = delete;

  void Trace(const UTF8String& inText) override {
    std::lock_guard<std::mutex> lock(mMutex);
    mLines.emplace_back(inText.data(), inText.size());
  }

  std::vector<std::string> Lines() const {
    std::lock_guard<std::mutex> lock(mMutex);
    return mLines;
  }

  // True when some line contains inFragment.
  bool Contains(const std::string& inFragment) const {
    std::lock_guard<std::mutex> lock(mMutex);
    return std::any_of(mLines.begin(), mLines.end(),
                       [&](const std::string& line) { return line.find(inFragment) != std::string::npos; });
  }

 private:
  mutable std::mutex mMutex;
  std::vector<std::string> mLines;
  debug::TraceHandler* mPrevious = nullptr;
};

}  // namespace tarsel::testing
