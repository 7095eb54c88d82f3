#include "support/ui/XvfbServer.h"

#include <fcntl.h>
#include <signal.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <memory>

namespace norvik::test {

XvfbServer* XvfbServer::Get() {
  static std::unique_ptr<XvfbServer> server;
  static bool tried = false;
  if (!tried) {
    tried = true;
    std::unique_ptr<XvfbServer> candidate(new XvfbServer());
    if (candidate->Start()) server = std::move(candidate);
  }
  return server.get();
}

bool XvfbServer::Start() {
  if (access("/usr/bin/Xvfb", X_OK) != 0) return false;
  int fds[2];
  if (pipe(fds) != 0) return false;
  const pid_t pid = fork();
  if (pid < 0) return false;
  if (pid == 0) {
    // The server must neither outlive the test program nor hold its output
    // open (a test runner waits for the output to close).
    prctl(PR_SET_PDEATHSIG, SIGTERM);
    const int null = open("/dev/null", O_RDWR);
    if (null >= 0) {
      dup2(null, 0);
      dup2(null, 1);
      dup2(null, 2);
    }
    close(fds[0]);
    const std::string fd = std::to_string(fds[1]);
    execl("/usr/bin/Xvfb", "Xvfb", "-displayfd", fd.c_str(), "-screen", "0", "1024x768x24", "-nolisten", "tcp",
          "-noreset", static_cast<char*>(nullptr));
    _exit(127);
  }
  close(fds[1]);
  mPid = pid;
  std::string number;
  char c;
  while (read(fds[0], &c, 1) == 1 && c != '\n') number.push_back(c);
  close(fds[0]);
  if (number.empty()) return false;
  mDisplay = ":" + number;
  return true;
}

XvfbServer::~XvfbServer() {
  if (mPid > 0) {
    kill(mPid, SIGTERM);
    waitpid(mPid, nullptr, 0);
  }
}

}  // namespace norvik::test
