#pragma once

#include "host/vst2_abi.h"

namespace plugcore {

// Builds and joins one instance for a host; null when the host is unusable or
// anything in the start-up fails.
AEffect* create_instance(Vst2HostCallback host);

}  // namespace plugcore
