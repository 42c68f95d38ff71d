// Replaces, in the test executable, the allocator entry points, operator new
// and delete, the mutex locks and a few blocking system calls. A plug-in
// loaded with dlopen binds these names to the executable's definitions first,
// so its calls land here too, including those of the C++ runtime it carries
// statically linked. Each replacement counts when its thread is armed and then
// forwards to the C library.
#include "realtime/call_counter.h"

#include <dlfcn.h>
#include <fcntl.h>
#include <pthread.h>
#include <sched.h>
#include <semaphore.h>
#include <stdarg.h>
#include <stdio.h>
#include <time.h>
#include <unistd.h>

#include <atomic>
#include <cstddef>
#include <cstdlib>
#include <new>

extern "C" {
void* __libc_malloc(size_t size);
void* __libc_calloc(size_t count, size_t size);
void* __libc_realloc(void* pointer, size_t size);
void* __libc_memalign(size_t alignment, size_t size);
void __libc_free(void* pointer);
}

namespace {

// Plain counters: thread-local data of the executable needs no allocation
// to reach, which matters inside malloc itself.
struct RawCounts {
  long operator_new;
  long operator_delete;
  long c_alloc;
  long c_free;
  long mutex_lock;
  long system_call;
};

thread_local bool t_armed = false;
thread_local RawCounts t_counts = {0, 0, 0, 0, 0, 0};

inline void count(long RawCounts::*field) {
  if (t_armed) {
    ++(t_counts.*field);
  }
}

// The next definition of a C library function after ours, looked up on
// first use; dlsym only takes the loader's own lock and the C allocator.
template <typename Function>
Function next_definition(std::atomic<void*>& slot, const char* name) {
  void* address = slot.load(std::memory_order_acquire);
  if (address == nullptr) {
    address = dlsym(RTLD_NEXT, name);
    if (address == nullptr) {
      abort();
    }
    slot.store(address, std::memory_order_release);
  }
  return reinterpret_cast<Function>(address);
}

// One slot per forwarded function, all filled before main() so that the first
// armed call does not count the lookup.
enum Forwarded {
  kMutexLock,
  kMutexTrylock,
  kRwlockRdlock,
  kRwlockWrlock,
  kSemWait,
  kCondWait,
  kRead,
  kWrite,
  kOpen,
  kFopen,
  kNanosleep,
  kUsleep,
  kSchedYield,
  kForwardedCount
};

const char* const kForwardedNames[kForwardedCount] = {
    "pthread_mutex_lock", "pthread_mutex_trylock", "pthread_rwlock_rdlock",
    "pthread_rwlock_wrlock", "sem_wait", "pthread_cond_wait", "read", "write", "open",
    "fopen", "nanosleep", "usleep", "sched_yield"};

std::atomic<void*> g_slots[kForwardedCount];

__attribute__((constructor)) void resolve_forwarded() {
  for (int index = 0; index < kForwardedCount; ++index) {
    next_definition<void (*)()>(g_slots[index], kForwardedNames[index]);
  }
}

// The C library's definition of the function we replace, of the same type.
template <typename Function>
Function forward_to(Forwarded which) {
  return next_definition<Function>(g_slots[which], kForwardedNames[which]);
}

void* allocate_or_throw(size_t size) {
  count(&RawCounts::operator_new);
  void* pointer = __libc_malloc(size == 0 ? 1 : size);
  if (pointer == nullptr) {
    throw std::bad_alloc();
  }
  return pointer;
}

void* allocate_aligned_or_throw(size_t size, std::align_val_t alignment) {
  count(&RawCounts::operator_new);
  void* pointer = __libc_memalign(static_cast<size_t>(alignment), size == 0 ? 1 : size);
  if (pointer == nullptr) {
    throw std::bad_alloc();
  }
  return pointer;
}

void* allocate_nothrow(size_t size) noexcept {
  count(&RawCounts::operator_new);
  return __libc_malloc(size == 0 ? 1 : size);
}

void* allocate_aligned_nothrow(size_t size, std::align_val_t alignment) noexcept {
  count(&RawCounts::operator_new);
  return __libc_memalign(static_cast<size_t>(alignment), size == 0 ? 1 : size);
}

void release(void* pointer) noexcept {
  if (pointer != nullptr) {
    count(&RawCounts::operator_delete);
    __libc_free(pointer);
  }
}

}  // namespace

namespace sys {

void arm_call_counter() {
  t_counts = RawCounts{0, 0, 0, 0, 0, 0};
  t_armed = true;
}

CallCounts disarm_call_counter() {
  t_armed = false;
  CallCounts counts;
  counts.operator_new = t_counts.operator_new;
  counts.operator_delete = t_counts.operator_delete;
  counts.c_alloc = t_counts.c_alloc;
  counts.c_free = t_counts.c_free;
  counts.mutex_lock = t_counts.mutex_lock;
  counts.system_call = t_counts.system_call;
  return counts;
}

std::string describe_calls(const CallCounts& counts) {
  return "new " + std::to_string(counts.operator_new) + ", delete " +
         std::to_string(counts.operator_delete) + ", malloc " + std::to_string(counts.c_alloc) +
         ", free " + std::to_string(counts.c_free) + ", mutex " +
         std::to_string(counts.mutex_lock) + ", syscall " + std::to_string(counts.system_call);
}

}  // namespace sys

// operator new and delete, every replaceable form.
void* operator new(size_t size) { return allocate_or_throw(size); }
void* operator new[](size_t size) { return allocate_or_throw(size); }
void* operator new(size_t size, const std::nothrow_t&) noexcept { return allocate_nothrow(size); }
void* operator new[](size_t size, const std::nothrow_t&) noexcept { return allocate_nothrow(size); }
void* operator new(size_t size, std::align_val_t alignment) {
  return allocate_aligned_or_throw(size, alignment);
}
void* operator new[](size_t size, std::align_val_t alignment) {
  return allocate_aligned_or_throw(size, alignment);
}
void* operator new(size_t size, std::align_val_t alignment, const std::nothrow_t&) noexcept {
  return allocate_aligned_nothrow(size, alignment);
}
void* operator new[](size_t size, std::align_val_t alignment, const std::nothrow_t&) noexcept {
  return allocate_aligned_nothrow(size, alignment);
}

void operator delete(void* pointer) noexcept { release(pointer); }
void operator delete[](void* pointer) noexcept { release(pointer); }
void operator delete(void* pointer, const std::nothrow_t&) noexcept { release(pointer); }
void operator delete[](void* pointer, const std::nothrow_t&) noexcept { release(pointer); }
void operator delete(void* pointer, size_t) noexcept { release(pointer); }
void operator delete[](void* pointer, size_t) noexcept { release(pointer); }
void operator delete(void* pointer, std::align_val_t) noexcept { release(pointer); }
void operator delete[](void* pointer, std::align_val_t) noexcept { release(pointer); }
void operator delete(void* pointer, size_t, std::align_val_t) noexcept { release(pointer); }
void operator delete[](void* pointer, size_t, std::align_val_t) noexcept { release(pointer); }
void operator delete(void* pointer, std::align_val_t, const std::nothrow_t&) noexcept {
  release(pointer);
}
void operator delete[](void* pointer, std::align_val_t, const std::nothrow_t&) noexcept {
  release(pointer);
}

extern "C" {

// The C allocator.
void* malloc(size_t size) noexcept {
  count(&RawCounts::c_alloc);
  return __libc_malloc(size);
}

void* calloc(size_t number, size_t size) noexcept {
  count(&RawCounts::c_alloc);
  return __libc_calloc(number, size);
}

void* realloc(void* pointer, size_t size) noexcept {
  count(&RawCounts::c_alloc);
  return __libc_realloc(pointer, size);
}

void free(void* pointer) noexcept {
  if (pointer != nullptr) {
    count(&RawCounts::c_free);
  }
  __libc_free(pointer);
}

void* memalign(size_t alignment, size_t size) noexcept {
  count(&RawCounts::c_alloc);
  return __libc_memalign(alignment, size);
}

void* aligned_alloc(size_t alignment, size_t size) noexcept {
  count(&RawCounts::c_alloc);
  return __libc_memalign(alignment, size);
}

int posix_memalign(void** result, size_t alignment, size_t size) noexcept {
  count(&RawCounts::c_alloc);
  if (alignment < sizeof(void*) || (alignment & (alignment - 1)) != 0) {
    return 22;  // EINVAL
  }
  void* pointer = __libc_memalign(alignment, size);
  if (pointer == nullptr) {
    return 12;  // ENOMEM
  }
  *result = pointer;
  return 0;
}

// Locks.
int pthread_mutex_lock(pthread_mutex_t* mutex) noexcept {
  count(&RawCounts::mutex_lock);
  const auto real_pthread_mutex_lock = forward_to<decltype(&pthread_mutex_lock)>(kMutexLock);
  return real_pthread_mutex_lock(mutex);
}

int pthread_mutex_trylock(pthread_mutex_t* mutex) noexcept {
  count(&RawCounts::mutex_lock);
  const auto real_pthread_mutex_trylock = forward_to<decltype(&pthread_mutex_trylock)>(kMutexTrylock);
  return real_pthread_mutex_trylock(mutex);
}

int pthread_rwlock_rdlock(pthread_rwlock_t* lock) noexcept {
  count(&RawCounts::mutex_lock);
  const auto real_pthread_rwlock_rdlock = forward_to<decltype(&pthread_rwlock_rdlock)>(kRwlockRdlock);
  return real_pthread_rwlock_rdlock(lock);
}

int pthread_rwlock_wrlock(pthread_rwlock_t* lock) noexcept {
  count(&RawCounts::mutex_lock);
  const auto real_pthread_rwlock_wrlock = forward_to<decltype(&pthread_rwlock_wrlock)>(kRwlockWrlock);
  return real_pthread_rwlock_wrlock(lock);
}

int sem_wait(sem_t* semaphore) {
  count(&RawCounts::mutex_lock);
  const auto real_sem_wait = forward_to<decltype(&sem_wait)>(kSemWait);
  return real_sem_wait(semaphore);
}

int pthread_cond_wait(pthread_cond_t* condition, pthread_mutex_t* mutex) {
  count(&RawCounts::mutex_lock);
  const auto real_pthread_cond_wait = forward_to<decltype(&pthread_cond_wait)>(kCondWait);
  return real_pthread_cond_wait(condition, mutex);
}

// Blocking system calls.
ssize_t read(int descriptor, void* buffer, size_t size) {
  count(&RawCounts::system_call);
  const auto real_read = forward_to<decltype(&read)>(kRead);
  return real_read(descriptor, buffer, size);
}

ssize_t write(int descriptor, const void* buffer, size_t size) {
  count(&RawCounts::system_call);
  const auto real_write = forward_to<decltype(&write)>(kWrite);
  return real_write(descriptor, buffer, size);
}

int open(const char* path, int flags, ...) {
  count(&RawCounts::system_call);
  mode_t mode = 0;
  if ((flags & O_CREAT) != 0) {
    va_list arguments;
    va_start(arguments, flags);
    mode = static_cast<mode_t>(va_arg(arguments, int));
    va_end(arguments);
  }
  const auto real_open = forward_to<decltype(&open)>(kOpen);
  return real_open(path, flags, mode);
}

FILE* fopen(const char* path, const char* mode) {
  count(&RawCounts::system_call);
  const auto real_fopen = forward_to<decltype(&fopen)>(kFopen);
  return real_fopen(path, mode);
}

int nanosleep(const struct timespec* duration, struct timespec* remaining) {
  count(&RawCounts::system_call);
  const auto real_nanosleep = forward_to<decltype(&nanosleep)>(kNanosleep);
  return real_nanosleep(duration, remaining);
}

int usleep(useconds_t microseconds) {
  count(&RawCounts::system_call);
  const auto real_usleep = forward_to<decltype(&usleep)>(kUsleep);
  return real_usleep(microseconds);
}

int sched_yield() noexcept {
  count(&RawCounts::system_call);
  const auto real_sched_yield = forward_to<decltype(&sched_yield)>(kSchedYield);
  return real_sched_yield();
}

}  // extern "C"
