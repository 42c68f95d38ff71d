// Per-user values in the registry below HKEY_CURRENT_USER\Software.
#include <windows.h>

#include <sstream>
#include <stdexcept>
#include <vector>

#include "config/persistent_key_list.h"

namespace sys {

struct PersistentKeyList::Handles {
  std::vector<HKEY> keys;  // Software first, the path's last component last
  ~Handles() {
    for (auto it = keys.rbegin(); it != keys.rend(); ++it) {
      RegCloseKey(*it);
    }
  }
};

namespace {
const char kOpenError[] = "sys::PersistentKeyList::PersistentKeyList () : Cannot open path.";
const char kCreateError[] = "sys::PersistentKeyList::PersistentKeyList () : Cannot create path.";
}  // namespace

PersistentKeyList::PersistentKeyList(const std::string& path, bool create) : handles_(new Handles) {
  HKEY software = nullptr;
  if (RegOpenKeyExA(HKEY_CURRENT_USER, "Software", 0, KEY_READ | KEY_WRITE, &software) != ERROR_SUCCESS) {
    throw std::runtime_error(kOpenError);
  }
  handles_->keys.push_back(software);
  std::stringstream stream(path);
  std::string part;
  while (std::getline(stream, part, '/')) {
    if (part.empty()) {
      throw std::runtime_error(kOpenError);
    }
    HKEY parent = handles_->keys.back();
    HKEY child = nullptr;
    if (RegOpenKeyExA(parent, part.c_str(), 0, KEY_READ | KEY_WRITE, &child) != ERROR_SUCCESS) {
      if (!create) {
        throw std::runtime_error(kOpenError);
      }
      if (RegCreateKeyExA(parent, part.c_str(), 0, nullptr, REG_OPTION_NON_VOLATILE, KEY_READ | KEY_WRITE, nullptr,
                          &child, nullptr) != ERROR_SUCCESS) {
        throw std::runtime_error(kCreateError);
      }
    }
    handles_->keys.push_back(child);
  }
}

PersistentKeyList::~PersistentKeyList() = default;

int PersistentKeyList::get_string(const std::string& name, std::string& text) {
  text.clear();
  char buffer[kValueCapacity + 1] = {};
  DWORD type = 0;
  DWORD size = kValueCapacity;
  if (RegQueryValueExA(handles_->keys.back(), name.c_str(), nullptr, &type, reinterpret_cast<BYTE*>(buffer), &size) !=
          ERROR_SUCCESS ||
      (type != REG_SZ && type != REG_EXPAND_SZ)) {
    return -1;
  }
  buffer[size < kValueCapacity ? size : kValueCapacity - 1] = 0;  // a stored value need not be terminated
  text = buffer;
  return 0;
}

int PersistentKeyList::set_string(const std::string& name, const std::string& text) {
  const LONG result = RegSetValueExA(handles_->keys.back(), name.c_str(), 0, REG_SZ,
                                     reinterpret_cast<const BYTE*>(text.c_str()), static_cast<DWORD>(text.size() + 1));
  return result == ERROR_SUCCESS ? 0 : -1;
}

}  // namespace sys
