#pragma once

#include <windows.h>

namespace guikit {

// The module this code is linked into (the plug-in DLL, or a test program),
// which owns the window classes.
HINSTANCE module_instance();

}  // namespace guikit
