#pragma once
// Storage for the many small blocks of strings and little objects. Blocks up to
// kMaxSmallBlock bytes are kept on per-thread free lists by size class; larger
// ones go straight to the heap. A block must be given back with the size it was
// asked for. Under AddressSanitizer every block goes to the heap, so that the
// sanitizer sees each one.
#include <cstddef>
#include <limits>
#include <new>

namespace tarsel::utility {

class SmallBlockAllocator {
 public:
  static constexpr std::size_t kGranule = 16;
  static constexpr std::size_t kMaxSmallBlock = 256;

  static void* Allocate(std::size_t inSize);
  static void Dispose(void* inBlock, std::size_t inSize) noexcept;
};

// Standard-library allocator over SmallBlockAllocator, for the string types.
template <typename T>
struct SmallBlockStlAllocator {
  using value_type = T;

  SmallBlockStlAllocator() noexcept = default;
  template <typename U>
  SmallBlockStlAllocator(const SmallBlockStlAllocator<U>&) noexcept {}  // NOLINT

  T* allocate(std::size_t n) {
    if (n > std::numeric_limits<std::size_t>::max() / sizeof(T)) throw std::bad_array_new_length();
    return static_cast<T*>(SmallBlockAllocator::Allocate(n * sizeof(T)));
  }
  void deallocate(T* p, std::size_t n) noexcept { SmallBlockAllocator::Dispose(p, n * sizeof(T)); }

  template <typename U>
  bool operator==(const SmallBlockStlAllocator<U>&) const noexcept { return true; }
  template <typename U>
  bool operator!=(const SmallBlockStlAllocator<U>&) const noexcept { return false; }
};

}  // namespace tarsel::utility
