#pragma once

namespace basic {

class ConfKeyMulti;

// Implemented by every part that keeps settings in setting files.
class SettingClientInterface {
 public:
  virtual ~SettingClientInterface() = default;
  // Adds or replaces this client's keys in root.
  virtual int save_settings(ConfKeyMulti& root) = 0;
  // Reads this client's keys; keys that are missing leave its state as it is.
  virtual int load_settings(const ConfKeyMulti& root) = 0;
};

}  // namespace basic
