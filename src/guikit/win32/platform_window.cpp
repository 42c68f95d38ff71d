#include "guikit/platform_window.h"

#include "guikit/win32/window_win32.h"

namespace guikit {

std::unique_ptr<WindowInterface> create_system_window(Size initial_size) {
  return std::make_unique<WindowWin32>(initial_size);
}

}  // namespace guikit
