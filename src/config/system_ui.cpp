#include "config/system_ui.h"

#include <atomic>

#include "config/system_services.h"

namespace sys {

namespace {
std::atomic<SystemUiInterface*> installed_ui{nullptr};
}

SystemUiInterface& use_system_ui() {
  SystemUiInterface* ui = installed_ui.load(std::memory_order_acquire);
  return ui != nullptr ? *ui : platform_system_ui();
}

void set_system_ui(SystemUiInterface* ui) { installed_ui.store(ui, std::memory_order_release); }

int open_url(const std::string& address) {
  if (use_system_ui().open_url(address) == 0) {
    return 0;
  }
  debug_output("sys::open_url: Error: couldn't open html browser.\n");
  return -1;
}

}  // namespace sys
