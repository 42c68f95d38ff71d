#include "guikit/platform_window.h"

namespace guikit {

std::unique_ptr<WindowInterface> create_system_window(Size) { return nullptr; }

}  // namespace guikit
