#include "presets/preset_save_bank_listener.h"

#include <fstream>
#include <string>

#include "config/file_selector.h"
#include "config/simple_message_box.h"
#include "presets/bank_file.h"

namespace plugcore {

namespace {
bool file_exists(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  return file.is_open();
}
}  // namespace

void PresetSaveBankListener::on_event(int32_t code, int32_t) {
  if (code != 0 || bank_ == nullptr || dialog_ == nullptr) return;
  dialog_->set_title("Save preset bank");
  if (dialog_->run_save() != sys::FileSelector::kChosen) return;
  const std::string path = dialog_->get_path();
  if (file_exists(path)) {
    const int answer = sys::SimpleMessageBox::show("Conflict", path + "\nalready exists. Overwrite ?",
                                                   sys::SimpleMessageBox::kOkCancel, 1);
    if (answer != 0) return;
  }
  const int status = save_bank_file(path, *bank_);
  if (status != 0) {
    const std::string text = "Can't save bank file\n" + path + "\n\nCode " + std::to_string(status);
    sys::SimpleMessageBox::show("Error", text, sys::SimpleMessageBox::kOk, 0);
  }
}

}  // namespace plugcore
