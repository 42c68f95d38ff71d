#include "config/setup_ml_save_settings.h"

#include <cstdio>
#include <string>

#include "config/setup_mgr.h"
#include "config/simple_message_box.h"

namespace plugcore {

namespace {

bool file_exists(const std::string& path) {
  std::FILE* file = std::fopen(path.c_str(), "rb");
  if (file == nullptr) return false;
  std::fclose(file);
  return true;
}

void show_error(const std::string& path, int status) {
  const std::string text = "Can't save configuration file\n" + path + "\n\nCode " + std::to_string(status);
  sys::SimpleMessageBox::show("Error", text, sys::SimpleMessageBox::kOk, 0);
}

}  // namespace

void SetupMLSaveSettings::on_select() {
  sys::FileSelector& dialog = mgr_.use_file_selector();
  dialog.set_title("Save Setting File");
  const int32_t result = dialog.run_save();
  if (result == sys::FileSelector::kCancelled) return;
  const std::string path = dialog.get_path();
  if (result != sys::FileSelector::kChosen) {
    show_error(path, result);
    return;
  }
  if (file_exists(path)) {
    const int32_t answer = sys::SimpleMessageBox::show("Conflict", path + "\nalready exists. Overwrite ?",
                                                       sys::SimpleMessageBox::kOkCancel, 1);
    if (answer != 0) return;
  }
  const int status = mgr_.use_setting_mgr().save_file(path);
  if (status != 0) show_error(path, status);
}

}  // namespace plugcore
