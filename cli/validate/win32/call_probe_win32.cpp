// Windows has no way to interpose the C runtime's allocator from outside the
// plug-in; the Linux build of the same plug-in source is counted instead.
#include "cli/validate/call_probe.h"

namespace sys {

std::string call_probe_missing() {
  return "allocation and lock counting exists only in the Linux build of the host";
}

void call_probe_arm() {}

AudioCallTally call_probe_disarm() { return AudioCallTally{}; }

}  // namespace sys
