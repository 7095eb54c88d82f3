#include "tarsel/Contract.h"

#include <atomic>
#include <csignal>
#include <fstream>
#include <string>

#include "tarsel/DebugTrace.h"
#include "tarsel/ThrowError.h"

namespace tarsel::debug {
namespace {
std::atomic<long> gViolationCount{0};
}

bool IsDebuggerAttached() {
  std::ifstream status("/proc/self/status");
  std::string line;
  const std::string key = "TracerPid:";
  while (std::getline(status, line)) {
    if (line.compare(0, key.size(), key) != 0) continue;
    std::size_t pos = line.find_first_not_of(" \t", key.size());
    return pos != std::string::npos && line[pos] != '0';
  }
  return false;
}

void BreakAfterContractDialog(std::string_view inExpression, std::string_view inFile, int inLine) {
  gViolationCount.fetch_add(1, std::memory_order_relaxed);
  std::string text = "Contract violation: ";
  text.append(inExpression).append(" at ").append(inFile).append(":").append(std::to_string(inLine));
  DebugTrace(text);
  if (IsDebuggerAttached()) std::raise(SIGTRAP);
}

void ReportContractViolation(std::string_view inExpression, std::string_view inFile, int inLine) {
  BreakAfterContractDialog(inExpression, inFile, inLine);
  config::ThrowError(config::ErrorLevel::kError, kInputContractViolationKey, config::kErrorGroupContract,
                     config::kErrorCodeContract);
}

long GetContractViolationCount() { return gViolationCount.load(std::memory_order_relaxed); }

}  // namespace tarsel::debug
