#include <gtest/gtest.h>

#include <sys/ptrace.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstring>
#include <stdexcept>
#include <thread>
#include <vector>

#include "support/tarsel/TraceRecorder.h"
#include "tarsel/Contract.h"
#include "tarsel/ErrorManager.h"

using tarsel::config::DeferredErrorReporter;
using tarsel::config::ErrorManager;
using tarsel::config::ErrorReport;

namespace {

// Installs a report handler that records reports, and restores the previous
// handler afterwards.
class ErrorManagerTest : public ::testing::Test {
 protected:
  void SetUp() override {
    mManager = ErrorManager::Get(true);
    mPrevious = mManager->SetReportHandler([this](const ErrorReport& r) { mReports.push_back(r); });
  }
  void TearDown() override {
    mManager->SetReportHandler(mPrevious);
    mManager->SetLowMemoryHandler({});
    mManager->SetBlockFunctions({}, {});
  }

  [[noreturn]] static void ThrowParentNotFound() {
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                               "$$$/norvik/ui/Error/ParentNotFound=Parent not found.", 103, 2);
  }

  ErrorManager* mManager = nullptr;
  ErrorManager::ReportHandler mPrevious;
  std::vector<ErrorReport> mReports;
};

std::string Utf8(const UTF16String& s) { return tarsel::utility::ToStdString(tarsel::utility::UTF16to8(s)); }

}  // namespace

TEST_F(ErrorManagerTest, AToolkitErrorEscapingAGuardedCallIsReportedWithItsKeyGroupAndCode) {
  EXPECT_EQ(ErrorManager::Get(false), mManager);
  bool afterThrow = false;
  bool ok = mManager->GuardedCall([&] {
    ThrowParentNotFound();
    afterThrow = true;
  });
  EXPECT_FALSE(ok);
  EXPECT_FALSE(afterThrow);
  ASSERT_EQ(mReports.size(), 1u);
  EXPECT_EQ(mReports[0].mKeyPath, "norvik/ui/Error/ParentNotFound");
  EXPECT_EQ(Utf8(mReports[0].mMessage), "Parent not found.");
  EXPECT_EQ(mReports[0].mGroup, 103);
  EXPECT_EQ(mReports[0].mCode, 2);
}

TEST_F(ErrorManagerTest, StandardAndUnknownExceptionsAreReportedAndANormalReturnIsNot) {
  int calls = 0;
  EXPECT_TRUE(mManager->GuardedCall([&] { ++calls; }));
  EXPECT_EQ(mManager->GuardedCallOr(-1L, [] { return 7L; }), 7L);
  EXPECT_TRUE(mReports.empty());
  EXPECT_FALSE(mManager->GuardedCall([] { throw std::runtime_error("disk on fire"); }));
  EXPECT_FALSE(mManager->GuardedCall([] { throw 42; }));
  EXPECT_EQ(mManager->GuardedCallOr(-1L, []() -> long { throw std::logic_error("no"); }), -1L);
  ASSERT_EQ(mReports.size(), 3u);
  EXPECT_EQ(calls, 1);
  EXPECT_EQ(Utf8(mReports[0].mMessage), "disk on fire");
  EXPECT_TRUE(mReports[0].mKeyPath.empty());
  EXPECT_FALSE(mReports[1].mMessage.empty());
}

TEST_F(ErrorManagerTest, WithoutAHandlerReportsAreTraced) {
  mManager->SetReportHandler({});
  tarsel::testing::TraceRecorder trace;
  mManager->GuardedCall([] { ThrowParentNotFound(); });
  EXPECT_TRUE(trace.Contains("Parent not found."));
  EXPECT_TRUE(trace.Contains("norvik/ui/Error/ParentNotFound"));
  EXPECT_TRUE(mReports.empty());
}

TEST_F(ErrorManagerTest, AHandlerThatThrowsDoesNotLetTheErrorEscape) {
  mManager->SetReportHandler([](const ErrorReport&) { throw std::runtime_error("handler broke"); });
  tarsel::testing::TraceRecorder trace;
  EXPECT_NO_THROW(mManager->GuardedCall([] { ThrowParentNotFound(); }));
  EXPECT_TRUE(trace.Contains("handler failed"));
}

TEST_F(ErrorManagerTest, ErrorsInsideNestedPaintsAreHeldUntilTheOutermostPaintEnds) {
  mManager->BeginPaint();
  mManager->BeginPaint();
  EXPECT_EQ(mManager->GetPaintDepth(), 2);
  mManager->GuardedCall([] { throw std::runtime_error("first"); });
  mManager->EndPaint();
  mManager->GuardedCall([] { throw std::runtime_error("second"); });
  EXPECT_TRUE(mReports.empty());
  mManager->EndPaint();
  EXPECT_FALSE(mManager->IsPainting());
  ASSERT_EQ(mReports.size(), 2u);
  EXPECT_EQ(Utf8(mReports[0].mMessage), "first");
  EXPECT_EQ(Utf8(mReports[1].mMessage), "second");
}

TEST_F(ErrorManagerTest, ThePaintGuardClosesItsBracketWhenAnExceptionLeavesTheScope) {
  try {
    tarsel::config::ScErrorManagerPaint paint;
    EXPECT_TRUE(mManager->IsPainting());
    throw std::runtime_error("paint failed");
  } catch (const std::runtime_error&) {
  }
  EXPECT_EQ(mManager->GetPaintDepth(), 0);
}

TEST_F(ErrorManagerTest, EndingAPaintThatNeverBeganIsAContractViolation) {
  tarsel::testing::TraceRecorder trace;
  try {
    mManager->EndPaint();
    FAIL() << "no exception";
  } catch (const tarsel::config::Exception& error) {
    EXPECT_EQ(error.GetGroup(), 105);
    EXPECT_EQ(error.GetCode(), 25);
  }
  EXPECT_EQ(mManager->GetPaintDepth(), 0);
}

namespace {
// Asks the manager for its paint depth from inside every trace, as a console
// showing the state of the application might.
class InquisitiveTraceHandler : public tarsel::debug::TraceHandler {
 public:
  void Trace(const UTF8String&) override { mDepths.push_back(ErrorManager::Get(true)->GetPaintDepth()); }
  std::vector<int> mDepths;
};
}  // namespace

TEST_F(ErrorManagerTest, ATraceHandlerMayAskTheManagerWhileAPaintViolationIsReported) {
  InquisitiveTraceHandler handler;
  tarsel::debug::TraceHandler* previous = tarsel::debug::InstallMasterTraceHandler(&handler);
  EXPECT_THROW(mManager->EndPaint(), tarsel::config::Exception);
  tarsel::debug::InstallMasterTraceHandler(previous);
  EXPECT_EQ(handler.mDepths, (std::vector<int>{0}));
}

TEST_F(ErrorManagerTest, ADeferredReporterHoldsErrorsUntilItsScopeEndsOrDropsThemWhenToldTo) {
  {
    DeferredErrorReporter deferred;
    mManager->GuardedCall([] { ThrowParentNotFound(); });
    EXPECT_TRUE(mReports.empty());
    EXPECT_TRUE(deferred.HasErrors());
    EXPECT_EQ(deferred.GetErrors().size(), 1u);
  }
  ASSERT_EQ(mReports.size(), 1u);
  EXPECT_EQ(mReports[0].mKeyPath, "norvik/ui/Error/ParentNotFound");
  {
    DeferredErrorReporter deferred;
    deferred.SetReportErrorWhenFinished(false);
    mManager->GuardedCall([] { ThrowParentNotFound(); });
  }
  EXPECT_EQ(mReports.size(), 1u);
}

TEST_F(ErrorManagerTest, AnInnerDeferredReporterPassesItsErrorsToTheOuterOne) {
  {
    DeferredErrorReporter outer;
    {
      DeferredErrorReporter inner;
      mManager->GuardedCall([] { throw std::runtime_error("inner"); });
      EXPECT_EQ(outer.GetErrors().size(), 0u);
    }
    EXPECT_EQ(outer.GetErrors().size(), 1u);
    EXPECT_TRUE(mReports.empty());
  }
  EXPECT_EQ(mReports.size(), 1u);
}

TEST_F(ErrorManagerTest, ADeferredReporterOnlyCollectsTheErrorsOfItsOwnThread) {
  DeferredErrorReporter deferred;
  std::thread other([this] { mManager->GuardedCall([] { throw std::runtime_error("elsewhere"); }); });
  other.join();
  EXPECT_FALSE(deferred.HasErrors());
  EXPECT_EQ(mReports.size(), 1u);
  deferred.SetReportErrorWhenFinished(false);
}

TEST_F(ErrorManagerTest, AllocationCallsTheLowMemoryHandlerBetweenFailedAttemptsUntilOneSucceedsOrRaises) {
  int allocations = 0;
  mManager->SetBlockFunctions([&](std::size_t) -> void* { ++allocations; return nullptr; },
                              [](void*) {});
  std::vector<int> handlerAttempts;
  mManager->SetLowMemoryHandler([&](std::size_t size, int attempt) {
    EXPECT_EQ(size, 4096u);
    handlerAttempts.push_back(attempt);
  });
  try {
    mManager->AllocateWithRetries(4096, 3);
    FAIL() << "no exception";
  } catch (const tarsel::config::Exception& error) {
    EXPECT_EQ(error.GetKeyPath(), "tarsel/config/Error/OutOfMemory");
    EXPECT_NE(std::string(error.what()).find("4096"), std::string::npos);
  }
  EXPECT_EQ(allocations, 3);
  EXPECT_EQ(handlerAttempts, (std::vector<int>{1, 2}));

  static char arena[64];
  bool freed = false;
  mManager->SetBlockFunctions([&](std::size_t) -> void* { return freed ? arena : nullptr; }, [](void*) {});
  mManager->SetLowMemoryHandler([&](std::size_t, int) { freed = true; });
  EXPECT_EQ(mManager->AllocateWithRetries(32, 3), static_cast<void*>(arena));
}

TEST_F(ErrorManagerTest, AnImpossibleSizeFailsAtOnceAndBlockFunctionsMustComeInPairs) {
  tarsel::testing::TraceRecorder trace;
  int handlerCalls = 0;
  mManager->SetLowMemoryHandler([&](std::size_t, int) { ++handlerCalls; });
  EXPECT_THROW(mManager->AllocateWithRetries(static_cast<std::size_t>(-1), 3), tarsel::config::Exception);
  EXPECT_EQ(handlerCalls, 0);
  EXPECT_THROW(mManager->SetBlockFunctions([](std::size_t) -> void* { return nullptr; }, {}),
               tarsel::config::Exception);
}

TEST(Contract, AViolatedContractTracesTheExpressionAndRaisesTheContractErrorAndAKeptOneDoesNothing) {
  tarsel::testing::TraceRecorder trace;
  const long before = tarsel::debug::GetContractViolationCount();
  int* image = nullptr;
  try {
    NRK_CONTRACT(image != nullptr);
    FAIL() << "no exception";
  } catch (const tarsel::config::Exception& error) {
    EXPECT_EQ(error.GetKeyPath(), "tarsel/utility/Error/Contract/InputContractViolation");
    EXPECT_STREQ(error.what(), "An input contract violation has occurred!");
    EXPECT_EQ(error.GetGroup(), 105);
    EXPECT_EQ(error.GetCode(), 25);
  }
  EXPECT_EQ(tarsel::debug::GetContractViolationCount(), before + 1);
  EXPECT_TRUE(trace.Contains("image != nullptr"));
  EXPECT_TRUE(trace.Contains("ErrorManagerTests.cpp"));
  const size_t lines = trace.Lines().size();
  EXPECT_NO_THROW(NRK_CONTRACT(1 + 1 == 2));
  EXPECT_EQ(tarsel::debug::GetContractViolationCount(), before + 1);
  EXPECT_EQ(trace.Lines().size(), lines);
}

namespace {
// Runs IsDebuggerAttached in a child process, traced by this one or not, and
// answers the child's exit code: 1 attached, 0 not, 2 when tracing is not
// permitted here.
int DebuggerCheckInChild(bool inTraced) {
  pid_t child = ::fork();
  if (child == 0) {
    if (inTraced && ::ptrace(PTRACE_TRACEME, 0, nullptr, nullptr) != 0) ::_exit(2);
    ::_exit(tarsel::debug::IsDebuggerAttached() ? 1 : 0);
  }
  int status = 0;
  ::waitpid(child, &status, 0);
  return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}
}  // namespace

TEST(Contract, ADebuggerIsSeenOnlyWhenAProcessIsTraced) {
  EXPECT_EQ(DebuggerCheckInChild(false), 0);
  const int traced = DebuggerCheckInChild(true);
  if (traced == 2) GTEST_SKIP() << "tracing is not permitted in this environment";
  EXPECT_EQ(traced, 1);
}
