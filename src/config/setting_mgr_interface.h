#pragma once

#include <string>
#include <vector>

#include "config/conf_key.h"
#include "config/setting_client_interface.h"

namespace basic {

// Setting-file status codes beyond the parser's.
enum SettingFileStatus : int {
  kSettingClientTwice = -1023,
  kSettingNotMulti = -1016,
  kSettingCannotOpen = -1020,
  kSettingCannotCreate = -1018,
  kSettingWriteFailed = -1017,
  kSettingWriteThrew = -1015,
  kSettingParseOffset = -1024,
  kSettingWrongSection = -3071,
};

// Gathers the settings of its clients into one key tree and keeps it in a
// text file. The hooks run in the order load: check_settings, clients,
// end_load; save: begin_save, clients, end_save; each does nothing once the
// status is non-zero.
class SettingMgrInterface {
 public:
  virtual ~SettingMgrInterface() = default;
  virtual void check_settings(ConfKeyMulti& root, const std::string& path, int& status) {}
  virtual void end_load(ConfKeyMulti& root, const std::string& path, int& status) {}
  virtual void begin_save(ConfKeyMulti& root, const std::string& path, int& status) {}
  virtual void end_save(ConfKeyMulti& root, const std::string& path, int& status) {}

  // Clients are called in the order they were added; not owned.
  int add_client(SettingClientInterface* client);
  // A load that fails part-way gives the clients already loaded their
  // earlier settings back, so no half-applied state survives a bad file.
  int load_file(const std::string& path);
  // The file is written beside the target and moved onto it only when
  // complete, so a failing save leaves the existing file as it was.
  int save_file(const std::string& path);

  // The same two steps on text instead of a file.
  int load_text(const std::string& text);
  int save_text(std::string& text);

 private:
  int build_tree(ConfKeyMulti& root);
  std::vector<SettingClientInterface*> clients_;
};

}  // namespace basic
