#include <dlfcn.h>
#include <time.h>

#include <cstdio>
#include <string>

#include "config/resource_table.h"
#include "config/system_services.h"

namespace sys {

Resource get_resource(const char* type, const char* name) {
  if (type == nullptr || name == nullptr) {
    return Resource();
  }
  Resource r = find_in_table(brakmorph_resource_table, brakmorph_resource_count, type, name);
  if (!r) {
    report_missing_resource(type, name);
  }
  return r;
}

double get_time() {
  timespec ts{};
  clock_gettime(CLOCK_MONOTONIC, &ts);
  // The same wrapping millisecond count as the Windows multimedia timer.
  const uint64_t ms = static_cast<uint64_t>(ts.tv_sec) * 1000u + static_cast<uint64_t>(ts.tv_nsec) / 1000000u;
  return static_cast<double>(static_cast<uint32_t>(ms)) * 0.001;
}

std::string get_module_directory() {
  Dl_info info{};
  if (dladdr(reinterpret_cast<void*>(&get_module_directory), &info) == 0 || info.dli_fname == nullptr) {
    return ".";
  }
  std::string path = info.dli_fname;
  const size_t slash = path.find_last_of('/');
  return slash == std::string::npos ? std::string(".") : path.substr(0, slash);
}

void debug_output(const char* text) { std::fputs(text, stderr); }

}  // namespace sys
