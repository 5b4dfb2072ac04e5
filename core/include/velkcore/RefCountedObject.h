#pragma once

#include <atomic>
#include <cstdint>
#include <utility>

#include <boost/intrusive_ptr.hpp>

namespace velkcore {

// Intrusive, atomically counted base for objects held through boost::intrusive_ptr.
class RefCountedObject {
 public:
  RefCountedObject() = default;
  // A copy is a new object: it starts with no references of its own.
  RefCountedObject(const RefCountedObject&) : count_(0) {}
  RefCountedObject& operator=(const RefCountedObject&) { return *this; }
  virtual ~RefCountedObject() = default;

  std::int32_t GetRefCount() const { return count_.load(std::memory_order_acquire); }

  friend void intrusive_ptr_add_ref(const RefCountedObject* p) {
    p->count_.fetch_add(1, std::memory_order_relaxed);
  }
  friend void intrusive_ptr_release(const RefCountedObject* p) {
    if (p->count_.fetch_sub(1, std::memory_order_acq_rel) == 1) delete p;
  }

 private:
  mutable std::atomic<std::int32_t> count_{0};
};

template <typename T>
using IntrusivePtr = boost::intrusive_ptr<T>;

template <typename T, typename... Args>
boost::intrusive_ptr<T> MakeIntrusive(Args&&... args) {
  return boost::intrusive_ptr<T>(new T(std::forward<Args>(args)...));
}

}  // namespace velkcore
