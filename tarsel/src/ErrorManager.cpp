#include "tarsel/ErrorManager.h"

#include <atomic>
#include <cstdint>
#include <cstdlib>
#include <memory>

#include "tarsel/Contract.h"
#include "tarsel/DebugTrace.h"

namespace tarsel::config {
namespace {

// The innermost deferred reporter of this thread.
thread_local DeferredErrorReporter* tInnermostReporter = nullptr;

void TraceReport(const ErrorReport& inReport) {
  UTF8String message = utility::UTF16to8(inReport.mMessage);
  std::string text = "Error reported: ";
  text.append(message.data(), message.size());
  if (!inReport.mKeyPath.empty()) text.append(" [").append(inReport.mKeyPath).append("]");
  if (inReport.mGroup != 0 || inReport.mCode != 0)
    text.append(" (group ").append(std::to_string(inReport.mGroup)).append(", code ")
        .append(std::to_string(inReport.mCode)).append(")");
  debug::DebugTrace(text);
}

}  // namespace

ErrorReport ErrorReport::FromException(const Exception& inError) {
  ErrorReport report;
  report.mLevel = inError.GetLevel();
  report.mKeyPath = inError.GetKeyPath();
  report.mMessage = inError.GetMessage();
  report.mGroup = inError.GetGroup();
  report.mCode = inError.GetCode();
  return report;
}

ErrorReport ErrorReport::FromException(const std::exception& inError) {
  ErrorReport report;
  report.mMessage = utility::UTF8to16(inError.what());
  return report;
}

ErrorReport ErrorReport::Unknown() {
  ErrorReport report;
  report.mMessage = u"Unknown exception";
  return report;
}

ErrorManager* ErrorManager::Get(bool inCreate) {
  // Made once and never destroyed, so that guarded calls during static
  // destruction still find it.
  static std::atomic<ErrorManager*> instance{nullptr};
  static std::mutex creation;
  ErrorManager* manager = instance.load(std::memory_order_acquire);
  if (manager || !inCreate) return manager;
  std::lock_guard<std::mutex> lock(creation);
  manager = instance.load(std::memory_order_relaxed);
  if (!manager) {
    manager = new ErrorManager;
    instance.store(manager, std::memory_order_release);
  }
  return manager;
}

void ErrorManager::ReportError(const ErrorReport& inReport) noexcept {
  try {
    if (DeferredErrorReporter* reporter = tInnermostReporter) {
      reporter->mErrors.push_back(inReport);
      return;
    }
    {
      std::lock_guard<std::mutex> lock(mMutex);
      if (mPaintDepth > 0) {
        mHeldDuringPaint.push_back(inReport);
        return;
      }
    }
    DeliverToHandler(inReport);
  } catch (...) {
    // Out of memory while keeping a report: the report is lost, nothing else.
  }
}

void ErrorManager::DeliverToHandler(const ErrorReport& inReport) noexcept {
  ReportHandler handler;
  {
    std::lock_guard<std::mutex> lock(mMutex);
    handler = mReportHandler;
  }
  try {
    if (handler)
      handler(inReport);
    else
      TraceReport(inReport);
  } catch (...) {
    debug::DebugTrace("The error report handler failed; the report was dropped.");
  }
}

ErrorManager::ReportHandler ErrorManager::SetReportHandler(ReportHandler inHandler) {
  std::lock_guard<std::mutex> lock(mMutex);
  std::swap(mReportHandler, inHandler);
  return inHandler;
}

void ErrorManager::BeginPaint() {
  std::lock_guard<std::mutex> lock(mMutex);
  ++mPaintDepth;
}

void ErrorManager::EndPaint() {
  std::vector<ErrorReport> held;
  bool wasPainting;
  {
    std::lock_guard<std::mutex> lock(mMutex);
    wasPainting = mPaintDepth > 0;
    if (wasPainting && --mPaintDepth > 0) return;
    held.swap(mHeldDuringPaint);
  }
  // Checked outside the lock: the report traces, and a trace handler may
  // well ask the manager something.
  NRK_CONTRACT(wasPainting);
  for (const ErrorReport& report : held) ReportError(report);
}

int ErrorManager::GetPaintDepth() const {
  std::lock_guard<std::mutex> lock(mMutex);
  return mPaintDepth;
}

void* ErrorManager::AllocateWithRetries(std::size_t inSize, int inAttempts) {
  BlockAllocateFunction allocate;
  LowMemoryHandler lowMemory;
  {
    std::lock_guard<std::mutex> lock(mMutex);
    allocate = mAllocate;
    lowMemory = mLowMemoryHandler;
  }
  const std::size_t size = inSize == 0 ? 1 : inSize;
  // No object may be larger than half the address space; asking for more is
  // a computation gone wrong, and retrying cannot help.
  const bool possible = size <= static_cast<std::size_t>(PTRDIFF_MAX);
  const int attempts = inAttempts < 1 ? 1 : inAttempts;
  for (int attempt = 1; possible && attempt <= attempts; ++attempt) {
    void* block = allocate ? allocate(size) : std::malloc(size);
    if (block) return block;
    if (attempt < attempts && lowMemory) lowMemory(size, attempt);
  }
  ThrowError(ErrorLevel::kError, kOutOfMemoryKey, kErrorGroupMemory, kErrorCodeOutOfMemory, false,
             static_cast<unsigned long>(inSize));
}

void ErrorManager::Deallocate(void* inBlock) noexcept {
  if (!inBlock) return;
  BlockFreeFunction release;
  {
    std::lock_guard<std::mutex> lock(mMutex);
    release = mFree;
  }
  if (release)
    release(inBlock);
  else
    std::free(inBlock);
}

ErrorManager::LowMemoryHandler ErrorManager::SetLowMemoryHandler(LowMemoryHandler inHandler) {
  std::lock_guard<std::mutex> lock(mMutex);
  std::swap(mLowMemoryHandler, inHandler);
  return inHandler;
}

void ErrorManager::SetBlockFunctions(BlockAllocateFunction inAllocate, BlockFreeFunction inFree) {
  NRK_CONTRACT(static_cast<bool>(inAllocate) == static_cast<bool>(inFree));
  std::lock_guard<std::mutex> lock(mMutex);
  mAllocate = std::move(inAllocate);
  mFree = std::move(inFree);
}

DeferredErrorReporter::DeferredErrorReporter(bool inReportErrorWhenFinished)
    : mOuter(tInnermostReporter), mReportWhenFinished(inReportErrorWhenFinished) {
  tInnermostReporter = this;
}

DeferredErrorReporter::~DeferredErrorReporter() {
  tInnermostReporter = mOuter;
  if (!mReportWhenFinished) return;
  ErrorManager* manager = ErrorManager::Get(true);
  for (const ErrorReport& report : mErrors) manager->ReportError(report);
}

}  // namespace tarsel::config
