#include "tarsel/Threads.h"

#include "tarsel/Contract.h"
#include "tarsel/ErrorManager.h"

namespace tarsel::threads {
namespace {

struct MainThreadRegistry {
  std::mutex mMutex;
  bool mRegistered = false;
  ThreadID mMainThread;
  AsyncEventLoopAdaptorPtr mExecutor;
};

MainThreadRegistry& Registry() {
  static MainThreadRegistry* registry = new MainThreadRegistry;  // outlives static destruction
  return *registry;
}

}  // namespace

AsyncEventLoopAdaptor::AsyncEventLoopAdaptor(ThreadID inOwner) : mOwner(inOwner) {}

AsyncEventLoopAdaptor::~AsyncEventLoopAdaptor() = default;

void AsyncEventLoopAdaptor::Post(Task inTask) {
  if (!inTask) return;
  {
    std::lock_guard<std::mutex> lock(mQueueMutex);
    mQueue.push_back(std::move(inTask));
  }
  std::lock_guard<std::mutex> lock(mWakeMutex);
  if (mWakeUp) mWakeUp();
}

std::size_t AsyncEventLoopAdaptor::RunPending() {
  NRK_CONTRACT(std::this_thread::get_id() == mOwner);
  std::deque<Task> batch;
  {
    std::lock_guard<std::mutex> lock(mQueueMutex);
    batch.swap(mQueue);
  }
  // Keeps the executor alive should a task drop the last reference to it.
  AsyncEventLoopAdaptorPtr protector(this);
  config::ErrorManager* errors = config::ErrorManager::Get(true);
  std::size_t ran = 0;
  for (Task& task : batch) {
    errors->GuardedCall(task);
    ++ran;
  }
  return ran;
}

std::size_t AsyncEventLoopAdaptor::GetPendingCount() const {
  std::lock_guard<std::mutex> lock(mQueueMutex);
  return mQueue.size();
}

void AsyncEventLoopAdaptor::SetWakeUpFunction(std::function<void()> inWakeUp) {
  std::function<void()> old;
  {
    std::lock_guard<std::mutex> lock(mWakeMutex);
    old.swap(mWakeUp);
    mWakeUp = std::move(inWakeUp);
  }
  // The old function (and what it holds) goes outside the lock.
}

std::size_t AsyncEventLoopAdaptor::DiscardPending() {
  std::deque<Task> dropped;
  {
    std::lock_guard<std::mutex> lock(mQueueMutex);
    dropped.swap(mQueue);
  }
  return dropped.size();  // tasks are destroyed outside the lock
}

AsyncEventLoopAdaptorPtr RegisterCurrentThreadAsMainThread() {
  MainThreadRegistry& registry = Registry();
  AsyncEventLoopAdaptorPtr replaced;
  std::lock_guard<std::mutex> lock(registry.mMutex);
  const ThreadID self = std::this_thread::get_id();
  if (registry.mRegistered && registry.mMainThread == self && registry.mExecutor) return registry.mExecutor;
  replaced.swap(registry.mExecutor);
  registry.mRegistered = true;
  registry.mMainThread = self;
  registry.mExecutor = new AsyncEventLoopAdaptor(self);
  return registry.mExecutor;
}

void UnregisterMainThread() {
  MainThreadRegistry& registry = Registry();
  AsyncEventLoopAdaptorPtr released;
  std::lock_guard<std::mutex> lock(registry.mMutex);
  registry.mRegistered = false;
  registry.mMainThread = ThreadID();
  released.swap(registry.mExecutor);
}

AsyncEventLoopAdaptorPtr GetMainThreadExecutor() {
  MainThreadRegistry& registry = Registry();
  std::lock_guard<std::mutex> lock(registry.mMutex);
  return registry.mExecutor;
}

ThreadID GetCurrentThreadID() { return std::this_thread::get_id(); }

bool IsMainThread() {
  MainThreadRegistry& registry = Registry();
  std::lock_guard<std::mutex> lock(registry.mMutex);
  return registry.mRegistered && registry.mMainThread == std::this_thread::get_id();
}

}  // namespace tarsel::threads
