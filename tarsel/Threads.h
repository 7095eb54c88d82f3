#pragma once
// Threads: which thread is the UI ("main") thread, and its executor.
//
// The UI thread registers itself once (the node manager does so when it is
// made) and keeps the AsyncEventLoopAdaptor it gets back. Any thread may Post
// work to it; the UI thread runs the work from its event loop with
// RunPending, in the order it was posted. The event loop can install a
// wake-up function that Post calls, so that a loop asleep in poll() can be
// woken through a pipe or eventfd of its own.
#include <cstddef>
#include <deque>
#include <functional>
#include <mutex>
#include <thread>

#include <boost/intrusive_ptr.hpp>

#include "tarsel/RefCountedObject.h"

namespace tarsel::threads {

using ThreadID = std::thread::id;

class AsyncEventLoopAdaptor : public utility::RefCountedObject {
 public:
  using Task = std::function<void()>;

  explicit AsyncEventLoopAdaptor(ThreadID inOwner);
  ~AsyncEventLoopAdaptor() override;

  // Queues a task; callable from any thread, including from a running task
  // (the new task runs in a later RunPending). An empty task is ignored.
  void Post(Task inTask);

  // On the owning thread: runs the tasks queued before this call, first in
  // first out, and answers how many ran. A task that throws is reported
  // through the error manager and the rest still run. Calling it from
  // another thread is a contract violation.
  std::size_t RunPending();

  std::size_t GetPendingCount() const;
  ThreadID GetOwnerThreadID() const { return mOwner; }

  // Called on the posting thread after each Post. It runs under a lock of
  // its own: once SetWakeUpFunction returns, the old function is not running
  // and will not run again, so its pipe may be closed. It must neither post
  // nor call SetWakeUpFunction itself: it only signals.
  void SetWakeUpFunction(std::function<void()> inWakeUp);

  // Drops the queued tasks without running them; answers how many.
  std::size_t DiscardPending();

 private:
  const ThreadID mOwner;
  mutable std::mutex mQueueMutex;
  std::deque<Task> mQueue;
  std::mutex mWakeMutex;
  std::function<void()> mWakeUp;
};

using AsyncEventLoopAdaptorPtr = boost::intrusive_ptr<AsyncEventLoopAdaptor>;

// Makes the calling thread the main thread and answers its executor. Called
// again on the same thread, answers the same executor; called on another
// thread, that thread becomes the main thread with a new executor.
AsyncEventLoopAdaptorPtr RegisterCurrentThreadAsMainThread();
// Forgets the main thread and releases the registry's hold on its executor.
void UnregisterMainThread();
// The main thread's executor, null when no thread is registered.
AsyncEventLoopAdaptorPtr GetMainThreadExecutor();

ThreadID GetCurrentThreadID();
// True on the registered main thread; false everywhere when none is.
bool IsMainThread();

}  // namespace tarsel::threads
