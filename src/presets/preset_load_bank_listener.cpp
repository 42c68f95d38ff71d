#include "presets/preset_load_bank_listener.h"

#include <string>

#include "config/file_selector.h"
#include "config/simple_message_box.h"
#include "presets/bank_file.h"

namespace plugcore {

void PresetLoadBankListener::on_event(int32_t code, int32_t) {
  if (code != 0 || bank_ == nullptr || dialog_ == nullptr) return;
  dialog_->set_title("Load preset bank");
  if (dialog_->run_open() != sys::FileSelector::kChosen) return;
  const std::string path = dialog_->get_path();
  const int status = load_bank_file(path, *bank_, true);
  if (status != 0) {
    const std::string text = "Can't load bank file\n" + path + "\n\nCode " + std::to_string(status);
    sys::SimpleMessageBox::show("Error", text, sys::SimpleMessageBox::kOk, 0);
  }
}

}  // namespace plugcore
