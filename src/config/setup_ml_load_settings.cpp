#include "config/setup_ml_load_settings.h"

#include <string>

#include "config/setup_mgr.h"
#include "config/simple_message_box.h"

namespace plugcore {

void SetupMLLoadSettings::on_select() {
  sys::FileSelector& dialog = mgr_.use_file_selector();
  dialog.set_title("Load Setting File");
  const int32_t result = dialog.run_open();
  if (result == sys::FileSelector::kCancelled) return;
  int status = result;
  if (result == sys::FileSelector::kChosen) {
    status = mgr_.use_setting_mgr().load_file(dialog.get_path());
    if (status == 0) return;
  }
  const std::string text =
      "Can't load configuration file\n" + dialog.get_path() + "\n\nCode " + std::to_string(status);
  sys::SimpleMessageBox::show("Error", text, sys::SimpleMessageBox::kOk, 0);
}

}  // namespace plugcore
