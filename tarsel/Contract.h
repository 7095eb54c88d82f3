#pragma once
// Contract checks. A violated contract is a programming error of the caller:
// it is reported through the debug services (trace, and a break into the
// debugger when one is attached) and then raised as the toolkit's exception
// "$$$/tarsel/utility/Error/Contract/InputContractViolation=..." (group 105,
// code 25), so that a release build fails loudly but recoverably instead of
// running on with bad state.
//
//   NRK_CONTRACT(image != nullptr);
#include <string_view>

namespace tarsel::debug {

// The key text of every contract violation.
inline constexpr std::string_view kInputContractViolationKey =
    "$$$/tarsel/utility/Error/Contract/InputContractViolation=An input contract violation has occurred!";

// True when a tracer (a debugger) is attached to this process: reads the
// TracerPid line of /proc/self/status.
bool IsDebuggerAttached();

// Reports a violated contract: traces "Contract violation: <expression> at
// <file>:<line>" and, when a debugger is attached, stops in it (SIGTRAP).
// Returns normally; the caller decides what follows.
void BreakAfterContractDialog(std::string_view inExpression, std::string_view inFile, int inLine);

// BreakAfterContractDialog, then raises the contract exception.
[[noreturn]] void ReportContractViolation(std::string_view inExpression, std::string_view inFile, int inLine);

// Answers how many contract violations have been reported in this process;
// diagnostics and tests use it to see that a check fired.
long GetContractViolationCount();

}  // namespace tarsel::debug

#define NRK_CONTRACT(condition)                                                     \
  do {                                                                              \
    if (!(condition))                                                               \
      ::tarsel::debug::ReportContractViolation(#condition, __FILE__, __LINE__);     \
  } while (false)
