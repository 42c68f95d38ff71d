#include "config/setting_mgr_interface.h"

#include <algorithm>
#include <cstdio>
#include <fstream>
#include <memory>
#include <stdexcept>

#include "config/conf_key_factory.h"
#include "presets/replace_file.h"

namespace basic {

int SettingMgrInterface::add_client(SettingClientInterface* client) {
  if (std::find(clients_.begin(), clients_.end(), client) != clients_.end()) {
    return kSettingClientTwice;
  }
  clients_.push_back(client);
  return 0;
}

int SettingMgrInterface::build_tree(ConfKeyMulti& root) {
  int status = 0;
  begin_save(root, std::string(), status);
  for (size_t i = 0; i < clients_.size() && status == 0; ++i) {
    status = clients_[i]->save_settings(root);
  }
  end_save(root, std::string(), status);
  return status;
}

int SettingMgrInterface::save_text(std::string& text) {
  ConfKeyMulti root("Default");
  int status = build_tree(root);
  if (status == 0) {
    try {
      text.clear();
      status = root.write_to_string(text, 0);
    } catch (const std::runtime_error&) {
      status = kSettingWriteThrew;
    }
  }
  return status;
}

int SettingMgrInterface::save_file(const std::string& path) {
  std::string text;
  const int status = save_text(text);
  if (status != 0) {
    return status;
  }
  const std::string temp_path = path + ".part";
  {
    std::ofstream out(temp_path, std::ios::out | std::ios::trunc);  // text mode: system line ends
    if (!out) {
      return kSettingCannotCreate;
    }
    out << text;
    out.flush();
    if (!out) {
      out.close();
      std::remove(temp_path.c_str());
      return kSettingWriteFailed;
    }
  }
  if (!plugcore::replace_file(temp_path, path)) {
    std::remove(temp_path.c_str());
    return kSettingCannotCreate;
  }
  return 0;
}

int SettingMgrInterface::load_file(const std::string& path) {
  std::ifstream in(path);
  if (!in) {
    return kSettingCannotOpen;
  }
  std::string text;
  std::string line;
  while (std::getline(in, line)) {
    text += line;
    text += '\n';
  }
  return load_text(text);
}

int SettingMgrInterface::load_text(const std::string& text) {
  ConfKeyFactory factory;
  std::unique_ptr<ConfKeyInterface> key = factory.create_from_string(text);
  if (!key) {
    return factory.get_status() + kSettingParseOffset;
  }
  if (factory.get_status() != 0) {
    return factory.get_status();
  }
  std::unique_ptr<ConfKeyMulti> root;
  if (auto* multi = dynamic_cast<ConfKeyMulti*>(key.get())) {
    root.reset(multi);
    key.release();
  } else {
    // "name = { }" reads as a data key holding an empty list: an empty section.
    const auto* data = dynamic_cast<const ConfKeyData*>(key.get());
    const auto* list = data != nullptr ? dynamic_cast<const ConfKeyContentMulti*>(&data->use_content()) : nullptr;
    if (list == nullptr || list->get_nbr_contents() != 0) {
      return kSettingNotMulti;
    }
    root = std::make_unique<ConfKeyMulti>(key->get_name());
  }
  int status = 0;
  check_settings(*root, std::string(), status);
  if (status != 0) {
    return status;
  }
  ConfKeyMulti snapshot(root->get_name());
  for (size_t i = 0; i < clients_.size() && status == 0; ++i) {
    if (clients_[i]->save_settings(snapshot) != 0) {
      return kSettingWriteFailed;  // nothing changed yet: a client that cannot save cannot be restored
    }
  }
  size_t loaded = 0;
  for (; loaded < clients_.size() && status == 0; ++loaded) {
    status = clients_[loaded]->load_settings(*root);
  }
  if (status != 0) {
    for (size_t i = 0; i + 1 < loaded; ++i) {
      clients_[i]->load_settings(snapshot);
    }
  }
  end_load(*root, std::string(), status);
  return status;
}

}  // namespace basic
