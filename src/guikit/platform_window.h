#pragma once

#include <memory>

#include "guikit/rect.h"
#include "guikit/window_interface.h"

namespace guikit {

using WindowFactory = std::unique_ptr<WindowInterface> (*)(Size initial_size);

// The window an editor bridge shows its editor in: the system's, unless a
// test installed another factory (an off-screen window, say).
std::unique_ptr<WindowInterface> create_platform_window(Size initial_size);
// nullptr restores the system's windows.
void set_window_factory(WindowFactory factory);

// The window of the platform being built (defined in its folder); null when
// the platform has none.
std::unique_ptr<WindowInterface> create_system_window(Size initial_size);

}  // namespace guikit
