#include <time.h>
#include <unistd.h>

#include <climits>

#include "cli/hosted_plugin.h"
#include "cli/platform_services.h"

namespace sys {

double thread_cpu_seconds() {
  timespec now{};
  clock_gettime(CLOCK_THREAD_CPUTIME_ID, &now);
  return static_cast<double>(now.tv_sec) + 1e-9 * static_cast<double>(now.tv_nsec);
}

bool stderr_is_terminal() { return isatty(STDERR_FILENO) != 0; }

std::string executable_directory() {
  char buffer[PATH_MAX + 1] = {0};
  const ssize_t length = readlink("/proc/self/exe", buffer, PATH_MAX);
  if (length <= 0) {
    return ".";
  }
  std::string path(buffer, static_cast<size_t>(length));
  const size_t slash = path.rfind('/');
  return slash == std::string::npos ? "." : path.substr(0, slash);
}

}  // namespace sys

namespace plugcore {

std::string default_plugin_path() { return sys::executable_directory() + "/../vst/Brakmorph.so"; }

}  // namespace plugcore
