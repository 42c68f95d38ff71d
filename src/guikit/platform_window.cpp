#include "guikit/platform_window.h"

#include <atomic>

namespace guikit {

namespace {
std::atomic<WindowFactory> installed_factory{nullptr};
}

std::unique_ptr<WindowInterface> create_platform_window(Size initial_size) {
  const WindowFactory factory = installed_factory.load(std::memory_order_acquire);
  return factory != nullptr ? factory(initial_size) : create_system_window(initial_size);
}

void set_window_factory(WindowFactory factory) { installed_factory.store(factory, std::memory_order_release); }

}  // namespace guikit
