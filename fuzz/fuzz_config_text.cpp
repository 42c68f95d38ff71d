// Fuzz target for the configuration text reader. Whatever it accepts must
// write out again, and that text must read back to a tree that writes the
// same text.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <stdexcept>
#include <string>

#include "config/conf_key.h"
#include "config/conf_key_factory.h"
#include "config/setting_mgr.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const std::string text(reinterpret_cast<const char*>(data), size);
  basic::ConfKeyFactory factory;
  auto key = factory.create_from_string(text);
  if (factory.get_status() == 0 && key == nullptr) std::abort();
  if (factory.get_status() == 0) {
    std::string first;
    try {
      if (key->write_to_string(first, 0) != 0) std::abort();
    } catch (const std::runtime_error&) {
      return 0;  // an empty name read from "" cannot be written: refused, not mangled
    }
    basic::ConfKeyFactory again;
    auto reread = again.create_from_string(first);
    std::string second;
    // Texts holding a double quote cannot be written faithfully; everything else must survive.
    if (text.find('"') == std::string::npos || first.find('"') == std::string::npos) {
      if (again.get_status() != 0 || reread == nullptr) std::abort();
      if (reread->write_to_string(second, 0) != 0 || second != first) std::abort();
    }
  }
  // The setting-file path over the same text: any status, never a crash.
  plugcore::SettingMgr mgr;
  mgr.set_section("Brakmorph_config_section", "1.24");
  mgr.load_text(text);
  return 0;
}
