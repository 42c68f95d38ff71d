// Running a few jobs at the same time, each on its own thread, the way a
// host's audio, automation and user-interface threads meet one instance.
#pragma once

#include <functional>
#include <vector>

namespace sys {

// Starts every job on a thread of its own and returns once all have ended.
// A job must not throw. Implemented once per platform.
void run_in_parallel(const std::vector<std::function<void()>>& jobs);

}  // namespace sys
