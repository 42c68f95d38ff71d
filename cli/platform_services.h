// The few operating-system services the command-line host needs beyond
// standard C++; implemented once per platform.
#pragma once

#include <string>

namespace sys {

// CPU seconds consumed by the calling thread.
double thread_cpu_seconds();

// True when standard error is an interactive terminal.
bool stderr_is_terminal();

// Directory holding the running executable, without a trailing slash.
std::string executable_directory();

}  // namespace sys
