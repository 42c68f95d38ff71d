#pragma once

#include <string>

#include "config/system_ui_interface.h"

namespace sys {

// The desktop services in use: the platform's, unless a test installed its own.
SystemUiInterface& use_system_ui();
// Installs ui (not owned) in place of the platform's; nullptr restores the platform's.
void set_system_ui(SystemUiInterface* ui);
// The platform's own services (defined in the platform folder).
SystemUiInterface& platform_system_ui();

// Opens the address in the system's browser: 0, or -1 (reported to the debugger output).
int open_url(const std::string& address);

}  // namespace sys
