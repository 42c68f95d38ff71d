#pragma once

#include <memory>

#include "guikit/rect.h"
#include "guikit/window_interface.h"

namespace guikit {

// The editor window of the platform being built (defined in its folder);
// null when the platform has none.
std::unique_ptr<WindowInterface> create_platform_window(Size initial_size);

}  // namespace guikit
