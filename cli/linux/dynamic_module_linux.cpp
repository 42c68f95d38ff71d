// Shared objects through dlopen; RTLD_LOCAL keeps two plug-ins' symbols apart.
#include <dlfcn.h>

#include "cli/dynamic_module_interface.h"

namespace sys {
namespace {

class DynamicModuleLinux : public DynamicModuleInterface {
 public:
  explicit DynamicModuleLinux(void* handle) : handle_(handle) {}
  ~DynamicModuleLinux() override { dlclose(handle_); }
  void* find_symbol(const char* name) override { return dlsym(handle_, name); }

 private:
  void* handle_;
};

}  // namespace

std::unique_ptr<DynamicModuleInterface> open_dynamic_module(const std::string& path,
                                                            std::string& error) {
  void* handle = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
  if (handle == nullptr) {
    const char* reason = dlerror();
    error = reason != nullptr ? reason : "unknown loader error";
    return nullptr;
  }
  return std::make_unique<DynamicModuleLinux>(handle);
}

}  // namespace sys
