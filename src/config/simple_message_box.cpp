#include "config/simple_message_box.h"

#include "config/system_ui.h"

namespace sys {

int32_t SimpleMessageBox::show(const std::string& title, const std::string& text, int32_t buttons,
                               int32_t default_button) {
  if (buttons < kOk || buttons > kYesNo || default_button < 0 || default_button > 3) {
    return -1;
  }
  return use_system_ui().show_message_box(title, text, buttons, default_button);
}

}  // namespace sys
