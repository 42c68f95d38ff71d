#pragma once

#include <memory>
#include <string>

namespace sys {

// One key path of the current user's persistent values ("Velmora/Brakmorph"):
// the registry below HKEY_CURRENT_USER\Software on Windows, a small setting
// file per path below $XDG_CONFIG_HOME (default ~/.config) elsewhere.
class PersistentKeyList {
 public:
  // Components are separated by '/'. Throws std::runtime_error when the path
  // cannot be opened, or created when create is set.
  PersistentKeyList(const std::string& path, bool create);
  ~PersistentKeyList();
  PersistentKeyList(const PersistentKeyList&) = delete;
  PersistentKeyList& operator=(const PersistentKeyList&) = delete;

  // 0, or -1 with text emptied when the value cannot be read. At most 1022
  // bytes come back.
  int get_string(const std::string& name, std::string& text);
  // 0 or -1.
  int set_string(const std::string& name, const std::string& text);

  static constexpr size_t kValueCapacity = 1023;

 struct Handles;  // the platform's open path

 private:
  std::unique_ptr<Handles> handles_;
};

// The "0"/"1" convention of the per-user switches: the stored text is read
// without regard to case; a missing or unrecognised one is replaced by the
// text of fallback. Failures of the store keep fallback.
int read_persistent_switch(const std::string& path, const std::string& name, int fallback);
// Writes "0" or "1"; true when stored.
bool write_persistent_switch(const std::string& path, const std::string& name, int value);

}  // namespace sys
