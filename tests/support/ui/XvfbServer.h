#pragma once
// A private X server for tests: Xvfb on a free display number, started on
// first use and stopped when the test program ends.
#include <string>

namespace norvik::test {

class XvfbServer {
 public:
  // The running server, or null when Xvfb is not installed or did not start
  // (the caller then skips).
  static XvfbServer* Get();
  const std::string& GetDisplayName() const { return mDisplay; }
  ~XvfbServer();

 private:
  XvfbServer() = default;
  bool Start();
  std::string mDisplay;
  int mPid = -1;
};

}  // namespace norvik::test
