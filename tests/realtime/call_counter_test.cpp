// The counter must see what it claims to see, or the plug-in checks are blind.
#include <gtest/gtest.h>

#include <pthread.h>
#include <unistd.h>

#include <atomic>
#include <cstdlib>
#include <memory>
#include <mutex>
#include <new>
#include <thread>
#include <vector>

#include "realtime/call_counter.h"

namespace {

// Keeps the optimiser from dropping a new/delete pair.
std::atomic<void*> g_sink{nullptr};

TEST(CallCounter, CountsEveryOperatorNewForm) {
  sys::arm_call_counter();
  auto* single = new int(7);
  g_sink = single;
  delete single;
  auto* array = new double[16];
  g_sink = array;
  delete[] array;
  auto* quiet = new (std::nothrow) char[3];
  g_sink = quiet;
  delete[] quiet;
  struct alignas(64) Wide {
    char bytes[64];
  };
  auto* wide = new Wide;
  g_sink = wide;
  delete wide;
  const sys::CallCounts counts = sys::disarm_call_counter();
  EXPECT_EQ(counts.operator_new, 4);
  EXPECT_EQ(counts.operator_delete, 4);
  EXPECT_EQ(counts.c_alloc, 0) << "operator new must not be counted twice";
}

TEST(CallCounter, CountsTheCAllocatorAndIgnoresFreeOfNull) {
  sys::arm_call_counter();
  void* block = std::malloc(100);
  g_sink = block;
  block = std::realloc(block, 4000);
  void* zeroed = std::calloc(10, 10);
  g_sink = zeroed;
  void* aligned = nullptr;
  const int status = posix_memalign(&aligned, 128, 256);
  std::free(block);
  std::free(zeroed);
  std::free(aligned);
  std::free(nullptr);
  const sys::CallCounts counts = sys::disarm_call_counter();
  EXPECT_EQ(status, 0);
  EXPECT_EQ(reinterpret_cast<uintptr_t>(aligned) % 128, 0u);
  EXPECT_EQ(counts.c_alloc, 4);
  EXPECT_EQ(counts.c_free, 3);
}

TEST(CallCounter, StandardContainersAreCaught) {
  sys::arm_call_counter();
  std::vector<float> grown;
  for (int i = 0; i < 100; ++i) {
    grown.push_back(static_cast<float>(i));
  }
  auto shared = std::make_shared<std::vector<int>>(5);
  shared.reset();
  const sys::CallCounts counts = sys::disarm_call_counter();
  EXPECT_GE(counts.operator_new, 3);
  EXPECT_EQ(counts.operator_delete + 1, counts.operator_new)
      << "all but the vector's last buffer are released inside the armed span";
}

TEST(CallCounter, CountsMutexLocksAndSystemCalls) {
  std::mutex mutex;
  sys::arm_call_counter();
  mutex.lock();
  mutex.unlock();
  {
    std::lock_guard<std::mutex> guard(mutex);
  }
  const ssize_t written = write(-1, "x", 1);  // fails with EBADF, but it is a system call
  const sys::CallCounts counts = sys::disarm_call_counter();
  EXPECT_EQ(written, -1);
  EXPECT_EQ(counts.mutex_lock, 2);
  EXPECT_EQ(counts.system_call, 1);
}

TEST(CallCounter, CountsOnlyWhileArmedAndOnlyOnTheArmedThread) {
  void* before = std::malloc(8);  // not armed: not counted
  g_sink = before;
  sys::arm_call_counter();
  long other_thread_allocations = 0;
  std::thread other([&other_thread_allocations] {
    // This thread was never armed; its allocations belong to nobody.
    for (int i = 0; i < 50; ++i) {
      auto* value = new long(i);
      other_thread_allocations += *value >= 0 ? 1 : 0;
      delete value;
    }
    sys::arm_call_counter();
    void* mine = std::malloc(16);
    g_sink = mine;
    std::free(mine);
    const sys::CallCounts own = sys::disarm_call_counter();
    other_thread_allocations = own.c_alloc == 1 && own.c_free == 1 ? 50 : -1;
  });
  other.join();
  const sys::CallCounts during_thread = sys::disarm_call_counter();
  std::free(before);
  sys::arm_call_counter();
  const sys::CallCounts quiet = sys::disarm_call_counter();
  EXPECT_EQ(other_thread_allocations, 50) << "the second thread counts its own armed span";
  EXPECT_EQ(quiet.total(), 0);
  // Starting the thread allocates its state on this thread; nothing the other
  // thread did may show up here, so the count stays small.
  EXPECT_LT(during_thread.allocations(), 10);
}

}  // namespace
