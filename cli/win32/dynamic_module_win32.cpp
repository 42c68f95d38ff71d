// DLLs through LoadLibraryA; the error text comes from FormatMessageA.
#include <windows.h>

#include "cli/dynamic_module_interface.h"

namespace sys {
namespace {

class DynamicModuleWin32 : public DynamicModuleInterface {
 public:
  explicit DynamicModuleWin32(HMODULE handle) : handle_(handle) {}
  ~DynamicModuleWin32() override { FreeLibrary(handle_); }
  void* find_symbol(const char* name) override {
    return reinterpret_cast<void*>(GetProcAddress(handle_, name));
  }

 private:
  HMODULE handle_;
};

std::string last_error_text() {
  const DWORD code = GetLastError();
  char buffer[512] = {0};
  const DWORD length = FormatMessageA(FORMAT_MESSAGE_FROM_SYSTEM | FORMAT_MESSAGE_IGNORE_INSERTS,
                                      nullptr, code, 0, buffer, sizeof(buffer) - 1, nullptr);
  std::string text(buffer, length);
  while (!text.empty() && (text.back() == '\n' || text.back() == '\r' || text.back() == ' ')) {
    text.pop_back();
  }
  if (text.empty()) {
    text = "LoadLibrary error " + std::to_string(code);
  }
  return text;
}

}  // namespace

std::unique_ptr<DynamicModuleInterface> open_dynamic_module(const std::string& path,
                                                            std::string& error) {
  HMODULE handle = LoadLibraryA(path.c_str());
  if (handle == nullptr) {
    error = last_error_text();
    return nullptr;
  }
  return std::make_unique<DynamicModuleWin32>(handle);
}

}  // namespace sys
