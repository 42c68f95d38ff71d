#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

namespace sys {

// A resource compiled into the module: its bytes stay valid while the module is loaded.
struct Resource {
  const uint8_t* data = nullptr;
  size_t size = 0;
  explicit operator bool() const { return data != nullptr; }
};

// Finds a resource of the module by type and name (names without regard to case).
// A missing resource is reported to the debugger output and answers an empty Resource.
Resource get_resource(const char* type, const char* name);

// Seconds from the system millisecond clock (wrapping as an unsigned 32-bit count);
// any thread may read it.
double get_time();

// The folder that holds this module's file, without a trailing separator.
std::string get_module_directory();

// Diagnostics for developers (debugger output on Windows, standard error elsewhere).
void debug_output(const char* text);

}  // namespace sys
