#include <windows.h>
#include <mmsystem.h>

#include <string>

#include "config/resource_table.h"
#include "config/system_services.h"

namespace sys {

namespace {

HMODULE own_module() {
  HMODULE module = nullptr;
  GetModuleHandleExA(GET_MODULE_HANDLE_EX_FLAG_FROM_ADDRESS | GET_MODULE_HANDLE_EX_FLAG_UNCHANGED_REFCOUNT,
                     reinterpret_cast<LPCSTR>(&own_module), &module);
  return module;
}

}  // namespace

Resource get_resource(const char* type, const char* name) {
  Resource r;
  if (type == nullptr || name == nullptr) {
    return r;
  }
  HMODULE module = own_module();
  HRSRC info = FindResourceA(module, name, type);  // names and types are case-insensitive here
  HGLOBAL handle = info != nullptr ? LoadResource(module, info) : nullptr;
  const void* bytes = handle != nullptr ? LockResource(handle) : nullptr;
  if (bytes == nullptr) {
    report_missing_resource(type, name);
    return r;
  }
  r.data = static_cast<const uint8_t*>(bytes);
  r.size = SizeofResource(module, info);
  return r;
}

double get_time() { return static_cast<double>(static_cast<uint32_t>(timeGetTime())) * 0.001; }

std::string get_module_directory() {
  char path[MAX_PATH + 1] = {0};
  const DWORD n = GetModuleFileNameA(own_module(), path, MAX_PATH);
  std::string text(path, n);
  const size_t slash = text.find_last_of("\\/");
  return slash == std::string::npos ? std::string(".") : text.substr(0, slash);
}

void debug_output(const char* text) { OutputDebugStringA(text); }

}  // namespace sys
