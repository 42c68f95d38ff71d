// Counting what a plug-in's audio entries call that a real-time thread must
// not: allocation, locks, blocking system calls. Only some builds carry the
// counter (it replaces the allocator process-wide); the others report that
// they cannot count.
#pragma once

#include <string>

namespace sys {

struct AudioCallTally {
  long allocations = 0;  // operator new and the C allocator
  long frees = 0;
  long locks = 0;
  long system_calls = 0;
  long total() const { return allocations + frees + locks + system_calls; }
};

// Empty when this process can count, else why not. Implemented per platform.
std::string call_probe_missing();
// Starts counting on the calling thread.
void call_probe_arm();
// Stops counting on the calling thread and returns the counts since arming.
AudioCallTally call_probe_disarm();

}  // namespace sys
