#pragma once
// Base of every shared object: an atomic reference count, held through
// boost::intrusive_ptr. The object deletes itself when its last reference goes.
// Copying an object gives the copy a fresh count of its own.
#include <atomic>

#include <boost/intrusive_ptr.hpp>

namespace tarsel::utility {

class RefCountedObject {
 public:
  RefCountedObject() = default;
  RefCountedObject(const RefCountedObject&) : mRefCount(0) {}
  RefCountedObject& operator=(const RefCountedObject&) { return *this; }
  virtual ~RefCountedObject() = default;

  void AddRef() const noexcept { mRefCount.fetch_add(1, std::memory_order_relaxed); }
  void Release() const noexcept {
    if (mRefCount.fetch_sub(1, std::memory_order_acq_rel) == 1) delete this;
  }
  int GetRefCount() const noexcept { return mRefCount.load(std::memory_order_relaxed); }

 private:
  mutable std::atomic<int> mRefCount{0};
};

inline void intrusive_ptr_add_ref(const RefCountedObject* p) noexcept { p->AddRef(); }
inline void intrusive_ptr_release(const RefCountedObject* p) noexcept { p->Release(); }

}  // namespace tarsel::utility
