#include "support/HeapCounter.h"

#include <cstdlib>
#include <new>

namespace {

std::size_t gHeapBytes = 0;
bool gCounting = false;

}  // namespace

namespace norvik::bench {

void StartHeapCount() {
  gHeapBytes = 0;
  gCounting = true;
}

std::size_t StopHeapCount() {
  gCounting = false;
  return gHeapBytes;
}

}  // namespace norvik::bench

// Replaces the plain and sized forms; the array forms forward to these by the
// library's default definitions.
void* operator new(std::size_t inSize) {
  if (gCounting) gHeapBytes += inSize;
  if (void* p = std::malloc(inSize ? inSize : 1)) return p;
  throw std::bad_alloc();
}
void operator delete(void* inPtr) noexcept { std::free(inPtr); }
void operator delete(void* inPtr, std::size_t) noexcept { std::free(inPtr); }
