// The counter is the allocator, lock and system-call interposer of the
// real-time tests, linked into the executable and exported from it. It is
// looked up at run time, so builds without it (sanitizer builds, the test
// binary) still link and say they cannot count.
#include <dlfcn.h>

#include "cli/validate/call_probe.h"
#include "tests/realtime/call_counter.h"

namespace sys {
namespace {

using ArmFunction = void (*)();
using DisarmFunction = CallCounts (*)();

struct Probe {
  ArmFunction arm = nullptr;
  DisarmFunction disarm = nullptr;
};

const Probe& probe() {
  static const Probe found = [] {
    Probe p;
    p.arm = reinterpret_cast<ArmFunction>(dlsym(RTLD_DEFAULT, "_ZN3sys16arm_call_counterEv"));
    p.disarm = reinterpret_cast<DisarmFunction>(dlsym(RTLD_DEFAULT, "_ZN3sys19disarm_call_counterEv"));
    return p;
  }();
  return found;
}

}  // namespace

std::string call_probe_missing() {
  if (probe().arm != nullptr && probe().disarm != nullptr) return "";
  return "this build of the host carries no allocation and lock counter";
}

void call_probe_arm() {
  if (probe().arm != nullptr) probe().arm();
}

AudioCallTally call_probe_disarm() {
  AudioCallTally tally;
  if (probe().disarm == nullptr) return tally;
  const CallCounts counts = probe().disarm();
  tally.allocations = counts.allocations();
  tally.frees = counts.operator_delete + counts.c_free;
  tally.locks = counts.mutex_lock;
  tally.system_calls = counts.system_call;
  return tally;
}

}  // namespace sys
