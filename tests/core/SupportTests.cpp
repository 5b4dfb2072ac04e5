#include <velkcore/HighPrecisionTime.h>
#include <velkcore/MainThread.h>
#include <velkcore/RefCountedObject.h>
#include <velkcore/SharedFunctions.h>
#include <velkcore/SmallBlockAllocator.h>

#include <gtest/gtest.h>

#include <cstring>
#include <memory>
#include <thread>
#include <vector>

using namespace velkcore;

TEST(SharedFunctions, CallsInOrderAndSkipsFunctionsRemovedDuringTheCall) {
  SharedFunctions<void(int)> list;
  std::vector<std::string> calls;
  SharedFunctions<void(int)>::FunctionPtr second;
  list.Add([&](int v) {
    calls.push_back("first " + std::to_string(v));
    list.Remove(second);
    list.Add([&](int) { calls.push_back("added"); });
  });
  second = list.Add([&](int) { calls.push_back("second"); });
  list.Call(1);
  EXPECT_EQ(calls, (std::vector<std::string>{"first 1"}));
  calls.clear();
  list.Call(2);  // "first" adds one more each time
  EXPECT_EQ(calls, (std::vector<std::string>{"first 2", "added"}));
  EXPECT_EQ(list.Size(), 3u);
}

TEST(SharedFunctions, ACallbackMayDestroyTheList) {
  auto list = std::make_unique<SharedFunctions<void()>>();
  int after = 0;
  list->Add([&] { list.reset(); });
  list->Add([&] { ++after; });  // the list is gone, and with it this subscription
  list->Call();
  EXPECT_EQ(list, nullptr);
  EXPECT_EQ(after, 0);
}

TEST(SharedFunctions, DuplicatesEmptyFunctionsAndCallUntilTrue) {
  SharedFunctions<bool()> list;
  int calls = 0;
  auto handler = std::make_shared<std::function<bool()>>([&] {
    ++calls;
    return true;
  });
  list.Add(handler);
  list.Add(handler);
  EXPECT_EQ(list.Size(), 1u);
  list.Add([&] {
    ++calls;
    return false;
  });
  EXPECT_TRUE(list.CallUntilTrue());
  EXPECT_EQ(calls, 1);
  EXPECT_THROW(list.Add(SharedFunctions<bool()>::FunctionPtr{}), Exception);
  SharedFunctions<bool()> copy = list;
  list.Clear();
  EXPECT_EQ(copy.Size(), 2u);
  copy.Add(std::function<bool()>{});
  copy.Remove(handler);
  EXPECT_THROW(copy.Call(), std::bad_function_call);
}

TEST(SmallBlockAllocator, BlocksAreDistinctWritableAndReused) {
  std::vector<std::pair<void*, std::size_t>> blocks;
  for (std::size_t size : {1u, 16u, 17u, 100u, 256u, 257u, 4096u}) {
    for (int i = 0; i < 50; ++i) {
      void* p = SmallBlockAllocator::Allocate(size);
      std::memset(p, 0xAB, size);
      blocks.emplace_back(p, size);
    }
  }
  std::vector<void*> pointers;
  for (const auto& b : blocks) pointers.push_back(b.first);
  std::sort(pointers.begin(), pointers.end());
  EXPECT_EQ(std::adjacent_find(pointers.begin(), pointers.end()), pointers.end());
  for (const auto& [p, size] : blocks) SmallBlockAllocator::Dispose(p, size);
  SmallBlockAllocator::Dispose(nullptr, 8);

  struct Event : SmallBlockObject {
    double a[5];
  };
  auto e = std::make_unique<Event>();
  e->a[4] = 1.0;
  EXPECT_EQ(e->a[4], 1.0);
}

TEST(RefCountedObject, IntrusivePointersShareOneAtomicCount) {
  struct Counted : RefCountedObject {
    explicit Counted(bool* d) : destroyed(d) {}
    ~Counted() override { *destroyed = true; }
    bool* destroyed;
  };
  bool destroyed = false;
  {
    auto p = MakeIntrusive<Counted>(&destroyed);
    std::vector<std::thread> threads;
    for (int t = 0; t < 4; ++t) {
      threads.emplace_back([p] {
        for (int i = 0; i < 10000; ++i) boost::intrusive_ptr<Counted> copy = p;
      });
    }
    for (auto& t : threads) t.join();
    EXPECT_EQ(p->GetRefCount(), 1);
    Counted copy = *p;  // a copy starts with its own count
    EXPECT_EQ(copy.GetRefCount(), 0);
    copy.destroyed = &destroyed;
  }
  EXPECT_TRUE(destroyed);
}

TEST(MainThread, RegisteredThreadIsTheOnlyMainThread) {
  RegisterMainThread();
  EXPECT_TRUE(IsMainThreadRegistered());
  EXPECT_TRUE(IsMainThread());
  bool other = true;
  std::thread([&] { other = IsMainThread(); }).join();
  EXPECT_FALSE(other);
}

TEST(HighPrecisionTime, MonotonicWithAKnownFrequency) {
  const auto a = HighPrecisionTime::GetTickCount();
  const auto b = HighPrecisionTime::GetTickCount();
  EXPECT_LE(a, b);
  EXPECT_EQ(HighPrecisionTime::GetFrequency(), 1'000'000'000u);
  EXPECT_DOUBLE_EQ(HighPrecisionTime::TicksToSeconds(1'500'000'000u), 1.5);
}

TEST(SharedFunctions, EmptiedFunctionsAreSkippedAndDroppedOnRequest) {
  SharedFunctions<void(int)> list;
  int total = 0;
  SharedFunctions<void(int)>::FunctionPtr self;
  // Empties itself while running, the usual way of unsubscribing from inside.
  self = list.Add([&](int v) {
    *self = nullptr;
    total += v;  // still safe: the running function is a copy
  });
  auto later = list.Add([&](int v) { total += 10 * v; });
  *later = nullptr;
  list.CallSkippingEmpty(1);
  EXPECT_EQ(total, 1);
  EXPECT_EQ(list.Size(), 2u);
  list.DropEmptyFunctions();
  EXPECT_TRUE(list.Empty());
}
