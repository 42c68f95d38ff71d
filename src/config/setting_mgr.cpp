#include "config/setting_mgr.h"

#include <cstdio>

#include "host/dsp_interface.h"

namespace plugcore {

int SettingMgr::init(DspInterface& dsp) {
  char version[64];
  std::snprintf(version, sizeof(version), "%.2lf", dsp.get_property_num("plugin_version"));
  set_section(basic::ConfKeyInterface::make_valid_name(dsp.get_property_str("plugin_name")) + "_config_section",
              version);
  return 0;
}

void SettingMgr::set_section(const std::string& section, const std::string& version) {
  section_ = section;
  version_ = version;
}

void SettingMgr::check_settings(basic::ConfKeyMulti& root, const std::string& path, int& status) {
  if (status == 0 && root.get_name() != section_) {
    status = basic::kSettingWrongSection;
  }
}

void SettingMgr::begin_save(basic::ConfKeyMulti& root, const std::string& path, int& status) {
  if (status != 0) {
    return;
  }
  root.set_name(section_);
  root.set_key(basic::ConfKeyData("version", version_));
}

}  // namespace plugcore
