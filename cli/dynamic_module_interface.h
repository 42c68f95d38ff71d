// A loaded shared library as the host sees it: a handle that resolves exported
// symbols and unloads the library when destroyed.
#pragma once

#include <memory>
#include <string>

namespace sys {

class DynamicModuleInterface {
 public:
  virtual ~DynamicModuleInterface() = default;
  // Address of an exported symbol, or null when the module does not export it.
  virtual void* find_symbol(const char* name) = 0;
};

// Loads the library at path. Returns null and fills error with the system's
// reason when the library cannot be loaded. Implemented once per platform.
std::unique_ptr<DynamicModuleInterface> open_dynamic_module(const std::string& path,
                                                            std::string& error);

}  // namespace sys
