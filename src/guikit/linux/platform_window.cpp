#include "guikit/platform_window.h"

#include "guikit/linux/window_x11.h"

namespace guikit {

std::unique_ptr<WindowInterface> create_system_window(Size initial_size) {
  return std::make_unique<WindowX11>(initial_size);
}

}  // namespace guikit
