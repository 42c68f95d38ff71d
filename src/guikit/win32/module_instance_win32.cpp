#include "guikit/win32/module_instance_win32.h"

namespace guikit {

HINSTANCE module_instance() {
  HMODULE module = nullptr;
  GetModuleHandleExA(GET_MODULE_HANDLE_EX_FLAG_FROM_ADDRESS | GET_MODULE_HANDLE_EX_FLAG_UNCHANGED_REFCOUNT,
                     reinterpret_cast<LPCSTR>(&module_instance), &module);
  return module;
}

}  // namespace guikit
