#pragma once

#include <string>

#include "config/setting_mgr_interface.h"

namespace plugcore {

class DspInterface;

// The plug-in's setting files: one section named after the plug-in, holding
// a "version" key and the clients' keys.
class SettingMgr : public basic::SettingMgrInterface {
 public:
  // Section "<valid plug-in name>_config_section", version "%.2lf" of the engine's version.
  int init(DspInterface& dsp);
  void set_section(const std::string& section, const std::string& version);
  const std::string& get_section() const { return section_; }
  const std::string& get_version() const { return version_; }

  void check_settings(basic::ConfKeyMulti& root, const std::string& path, int& status) override;
  void begin_save(basic::ConfKeyMulti& root, const std::string& path, int& status) override;

 private:
  std::string section_;
  std::string version_;
};

}  // namespace plugcore
