// Counts, per thread, the calls the audio path must never make: heap
// allocation (operator new and the C allocator), mutex locking and a few
// blocking system calls. Counting happens only while the calling thread has
// armed the counter, so the test harness itself may allocate freely.
#pragma once

#include <string>

namespace sys {

struct CallCounts {
  long operator_new = 0;     // every form of operator new and new[]
  long operator_delete = 0;  // every form of operator delete and delete[] (non-null)
  long c_alloc = 0;          // malloc, calloc, realloc, aligned forms
  long c_free = 0;           // free of a non-null pointer
  long mutex_lock = 0;       // pthread_mutex_lock / trylock, rwlock locks
  long system_call = 0;      // read, write, open, fopen, sleeps, yields

  long total() const {
    return operator_new + operator_delete + c_alloc + c_free + mutex_lock + system_call;
  }
  long allocations() const { return operator_new + c_alloc; }
};

// Starts counting on the calling thread from zero.
void arm_call_counter();

// Stops counting on the calling thread and returns what was counted since arm_call_counter().
CallCounts disarm_call_counter();

// "new 0, delete 0, malloc 0, free 0, mutex 0, syscall 0"
std::string describe_calls(const CallCounts& counts);

}  // namespace sys
