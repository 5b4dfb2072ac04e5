#include <velkcore/SmallBlockAllocator.h>

#include <array>
#include <mutex>

#if defined(__SANITIZE_ADDRESS__)
#define VELKCORE_POOLING 0
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
#define VELKCORE_POOLING 0
#endif
#endif
#ifndef VELKCORE_POOLING
#define VELKCORE_POOLING 1
#endif

namespace velkcore {
namespace {

constexpr std::size_t kGranule = 16;
constexpr std::size_t kClassCount = SmallBlockAllocator::kMaxPooledSize / kGranule;
constexpr std::size_t kChunkSize = 64 * 1024;

struct FreeBlock {
  FreeBlock* next;
};

// Chunks live as long as the process: blocks may be disposed during static
// destruction, after any pool object would have gone.
class Pool {
 public:
  void* Allocate(std::size_t sizeClass) {
    const std::lock_guard lock(mutex_);
    FreeBlock*& head = free_[sizeClass];
    if (head == nullptr) Refill(sizeClass);
    FreeBlock* block = head;
    head = block->next;
    return block;
  }

  void Dispose(void* block, std::size_t sizeClass) {
    const std::lock_guard lock(mutex_);
    auto* freed = static_cast<FreeBlock*>(block);
    freed->next = free_[sizeClass];
    free_[sizeClass] = freed;
  }

 private:
  void Refill(std::size_t sizeClass) {
    const std::size_t blockSize = (sizeClass + 1) * kGranule;
    auto* chunk = static_cast<unsigned char*>(::operator new(kChunkSize, std::align_val_t{kGranule}));
    for (std::size_t offset = 0; offset + blockSize <= kChunkSize; offset += blockSize) {
      auto* block = reinterpret_cast<FreeBlock*>(chunk + offset);
      block->next = free_[sizeClass];
      free_[sizeClass] = block;
    }
  }

  std::mutex mutex_;
  std::array<FreeBlock*, kClassCount> free_{};
};

Pool& ThePool() {
  static Pool* pool = new Pool;  // never destroyed, see above
  return *pool;
}

std::size_t SizeClass(std::size_t size) { return size == 0 ? 0 : (size - 1) / kGranule; }

}  // namespace

void* SmallBlockAllocator::Allocate(std::size_t size) {
  if (VELKCORE_POOLING && size <= kMaxPooledSize) return ThePool().Allocate(SizeClass(size));
  return ::operator new(size == 0 ? 1 : size);
}

void SmallBlockAllocator::Dispose(void* block, std::size_t size) noexcept {
  if (block == nullptr) return;
  if (VELKCORE_POOLING && size <= kMaxPooledSize) {
    ThePool().Dispose(block, SizeClass(size));
    return;
  }
  ::operator delete(block);
}

}  // namespace velkcore
