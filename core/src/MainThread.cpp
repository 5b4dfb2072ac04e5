#include <velkcore/MainThread.h>

#include <atomic>
#include <thread>

namespace velkcore {
namespace {
std::atomic<std::thread::id> gMainThread{};
}

void RegisterMainThread() { gMainThread.store(std::this_thread::get_id()); }

bool IsMainThreadRegistered() { return gMainThread.load() != std::thread::id{}; }

bool IsMainThread() {
  const std::thread::id main = gMainThread.load();
  return main == std::thread::id{} || main == std::this_thread::get_id();
}

}  // namespace velkcore
