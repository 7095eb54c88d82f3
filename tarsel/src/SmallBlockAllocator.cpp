#include "tarsel/SmallBlockAllocator.h"

#include <cstdlib>

namespace tarsel::utility {
namespace {

#if defined(__SANITIZE_ADDRESS__)
constexpr bool kUsePools = false;
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
constexpr bool kUsePools = false;
#else
constexpr bool kUsePools = true;
#endif
#else
constexpr bool kUsePools = true;
#endif

constexpr std::size_t kClassCount = SmallBlockAllocator::kMaxSmallBlock / SmallBlockAllocator::kGranule;
constexpr std::size_t kMaxCachedPerClass = 256;

struct FreeBlock {
  FreeBlock* next;
};

// Each block is its own heap allocation, so a block freed on another thread
// simply joins that thread's list; lists are bounded and emptied at thread exit.
struct ThreadPools {
  FreeBlock* head[kClassCount] = {};
  std::size_t count[kClassCount] = {};

  ~ThreadPools() {
    for (std::size_t i = 0; i < kClassCount; ++i) {
      while (head[i]) {
        FreeBlock* b = head[i];
        head[i] = b->next;
        std::free(b);
      }
    }
  }
};

ThreadPools& Pools() {
  thread_local ThreadPools pools;
  return pools;
}

std::size_t ClassOf(std::size_t inSize) {
  return (inSize + SmallBlockAllocator::kGranule - 1) / SmallBlockAllocator::kGranule - 1;
}

}  // namespace

void* SmallBlockAllocator::Allocate(std::size_t inSize) {
  if (inSize == 0) inSize = 1;
  if (!kUsePools || inSize > kMaxSmallBlock) {
    void* p = std::malloc(inSize);
    if (!p) throw std::bad_alloc();
    return p;
  }
  std::size_t c = ClassOf(inSize);
  ThreadPools& pools = Pools();
  if (FreeBlock* b = pools.head[c]) {
    pools.head[c] = b->next;
    --pools.count[c];
    return b;
  }
  void* p = std::malloc((c + 1) * kGranule);
  if (!p) throw std::bad_alloc();
  return p;
}

void SmallBlockAllocator::Dispose(void* inBlock, std::size_t inSize) noexcept {
  if (!inBlock) return;
  if (inSize == 0) inSize = 1;
  if (!kUsePools || inSize > kMaxSmallBlock) {
    std::free(inBlock);
    return;
  }
  std::size_t c = ClassOf(inSize);
  ThreadPools& pools = Pools();
  if (pools.count[c] >= kMaxCachedPerClass) {
    std::free(inBlock);
    return;
  }
  auto* b = static_cast<FreeBlock*>(inBlock);
  b->next = pools.head[c];
  pools.head[c] = b;
  ++pools.count[c];
}

}  // namespace tarsel::utility
