#include <stdexcept>

#include "config/persistent_key_list.h"
#include "config/system_services.h"

namespace sys {

int read_persistent_switch(const std::string& path, const std::string& name, int fallback) {
  try {
    PersistentKeyList key(path, true);
    std::string text;
    if (key.get_string(name, text) == 0 && (text == "0" || text == "1")) {
      return text == "1" ? 1 : 0;
    }
    key.set_string(name, fallback != 0 ? "1" : "0");
  } catch (const std::runtime_error& error) {
    debug_output(error.what());
    debug_output("\n");
  }
  return fallback != 0 ? 1 : 0;
}

bool write_persistent_switch(const std::string& path, const std::string& name, int value) {
  try {
    PersistentKeyList key(path, true);
    return key.set_string(name, value != 0 ? "1" : "0") == 0;
  } catch (const std::runtime_error& error) {
    debug_output(error.what());
    debug_output("\n");
    return false;
  }
}

}  // namespace sys
