#pragma once

#include <cstddef>
#include <new>

namespace velkcore {

// Pooled allocation of small, short-lived blocks (events, messages). Blocks of
// up to kMaxPooledSize bytes come from per-size free lists; larger ones from
// the global heap. Under AddressSanitizer every block comes from the heap so
// that misuse is caught.
class SmallBlockAllocator {
 public:
  static constexpr std::size_t kMaxPooledSize = 256;

  static void* Allocate(std::size_t size);
  // `size` must be the size given to Allocate.
  static void Dispose(void* block, std::size_t size) noexcept;
};

// Base that routes a class's operator new/delete through SmallBlockAllocator.
struct SmallBlockObject {
  static void* operator new(std::size_t size) { return SmallBlockAllocator::Allocate(size); }
  static void operator delete(void* block, std::size_t size) noexcept {
    SmallBlockAllocator::Dispose(block, size);
  }
};

}  // namespace velkcore
