#pragma once
// The error manager stands between the toolkit and the platform. Entries from
// the platform (window messages, paints, posted tasks) run inside GuardedCall,
// so that an exception is reported instead of crossing into code that cannot
// handle it. Reports go to an installable handler; without one they are
// traced.
//
// Where a report goes, in order of precedence:
//   1. the innermost DeferredErrorReporter alive on the reporting thread,
//      which keeps it until the reporter's scope ends;
//   2. while a paint bracket is open, a queue that is reported when the
//      outermost paint ends (a handler may open a dialog, which must not
//      happen in the middle of a paint);
//   3. the report handler.
//
// The manager also hands out memory with retries: when an allocation fails
// the low-memory handler gets a chance to free something before the next
// attempt, and after the last attempt the toolkit's out-of-memory error is
// raised.
//
// The manager is meant for the UI thread; GuardedCall and the report path
// are also safe from other threads (deferred reporters are per thread).
#include <cstddef>
#include <exception>
#include <functional>
#include <mutex>
#include <string>
#include <string_view>
#include <vector>

#include "tarsel/ThrowError.h"
#include "tarsel/UTFString.h"

namespace tarsel::config {

constexpr int kErrorGroupMemory = 104;
constexpr int kErrorCodeOutOfMemory = 1;
inline constexpr std::string_view kOutOfMemoryKey =
    "$$$/tarsel/config/Error/OutOfMemory=Not enough memory for a block of ^0 bytes.";

// One reported error, as kept and handed to the report handler.
struct ErrorReport {
  ErrorLevel mLevel = ErrorLevel::kError;
  std::string mKeyPath;  // empty for exceptions that are not the toolkit's
  UTF16String mMessage;
  int mGroup = 0;
  int mCode = 0;

  static ErrorReport FromException(const Exception& inError);
  static ErrorReport FromException(const std::exception& inError);
  static ErrorReport Unknown();
};

class DeferredErrorReporter;

class ErrorManager {
 public:
  using ReportHandler = std::function<void(const ErrorReport&)>;
  // Called between failed attempts with the size asked for and the number of
  // the attempt that failed (1 for the first).
  using LowMemoryHandler = std::function<void(std::size_t, int)>;
  // Where blocks come from; the default is std::malloc / std::free. A host
  // with its own memory pools can put them here.
  using BlockAllocateFunction = std::function<void*(std::size_t)>;
  using BlockFreeFunction = std::function<void(void*)>;

  // The process's manager. Get(true) makes it on first use; Get(false)
  // answers null until then.
  static ErrorManager* Get(bool inCreate = true);

  // Runs inFunction; an escaping exception is reported, not propagated.
  // Answers true when inFunction returned normally.
  template <typename Function>
  bool GuardedCall(Function&& inFunction) noexcept {
    try {
      std::forward<Function>(inFunction)();
      return true;
    } catch (const Exception& error) {
      ReportError(ErrorReport::FromException(error));
    } catch (const std::exception& error) {
      ReportError(ErrorReport::FromException(error));
    } catch (...) {
      ReportError(ErrorReport::Unknown());
    }
    return false;
  }

  // Runs inFunction and answers its result, or inFallback when it threw (the
  // exception is reported).
  template <typename Result, typename Function>
  Result GuardedCallOr(Result inFallback, Function&& inFunction) noexcept {
    Result result = inFallback;
    if (!GuardedCall([&] { result = std::forward<Function>(inFunction)(); })) result = inFallback;
    return result;
  }

  // Routes one report as described above. Never throws: a failing handler is
  // traced and forgotten.
  void ReportError(const ErrorReport& inReport) noexcept;

  // Installs the report handler and answers the previous one. An empty
  // handler restores the default, which traces the report.
  ReportHandler SetReportHandler(ReportHandler inHandler);

  // Paint brackets, nested; errors reported inside are held until the
  // outermost EndPaint. EndPaint without BeginPaint is a contract violation.
  void BeginPaint();
  void EndPaint();
  int GetPaintDepth() const;
  bool IsPainting() const { return GetPaintDepth() > 0; }

  // A block of inSize bytes (at least one byte is reserved for a size of 0),
  // trying inAttempts times (at least once) and calling the low-memory
  // handler between failed attempts. Raises the out-of-memory error when
  // every attempt failed; a size no allocation could ever satisfy fails at
  // once. Give the block back with Deallocate.
  void* AllocateWithRetries(std::size_t inSize, int inAttempts);
  void Deallocate(void* inBlock) noexcept;

  LowMemoryHandler SetLowMemoryHandler(LowMemoryHandler inHandler);
  // Both or neither: empty functions restore malloc and free. Blocks must be
  // given back to the functions that made them.
  void SetBlockFunctions(BlockAllocateFunction inAllocate, BlockFreeFunction inFree);

 private:
  friend class DeferredErrorReporter;
  ErrorManager() = default;
  void DeliverToHandler(const ErrorReport& inReport) noexcept;

  mutable std::mutex mMutex;
  ReportHandler mReportHandler;
  LowMemoryHandler mLowMemoryHandler;
  BlockAllocateFunction mAllocate;
  BlockFreeFunction mFree;
  int mPaintDepth = 0;
  std::vector<ErrorReport> mHeldDuringPaint;
};

// Scoped bracket around a paint: BeginPaint now, EndPaint when it goes.
class ScErrorManagerPaint {
 public:
  ScErrorManagerPaint() : mManager(ErrorManager::Get(true)) { mManager->BeginPaint(); }
  ~ScErrorManagerPaint() { mManager->EndPaint(); }
  ScErrorManagerPaint(const ScErrorManagerPaint&) = delete;
  ScErrorManagerPaint& operator=(const ScErrorManagerPaint&) = delete;

 private:
  ErrorManager* mManager;
};

// Collects the errors reported on this thread while it lives. When it ends,
// it reports them (to the next reporter out, or onwards as usual) if
// SetReportErrorWhenFinished(true) is in force, which is the default; with
// false they are dropped, for a caller that has dealt with them itself.
// Reporters must end in the reverse order of their making, as scopes do.
class DeferredErrorReporter {
 public:
  explicit DeferredErrorReporter(bool inReportErrorWhenFinished = true);
  ~DeferredErrorReporter();
  DeferredErrorReporter(const DeferredErrorReporter&) = delete;
  DeferredErrorReporter& operator=(const DeferredErrorReporter&) = delete;

  void SetReportErrorWhenFinished(bool inReport) { mReportWhenFinished = inReport; }
  bool GetReportErrorWhenFinished() const { return mReportWhenFinished; }
  bool HasErrors() const { return !mErrors.empty(); }
  const std::vector<ErrorReport>& GetErrors() const { return mErrors; }

 private:
  friend class ErrorManager;
  std::vector<ErrorReport> mErrors;
  DeferredErrorReporter* mOuter;
  bool mReportWhenFinished;
};

}  // namespace tarsel::config
