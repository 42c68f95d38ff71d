#pragma once

#include <cstdint>
#include <string>

namespace sys {

// A modal message box without owner window, brought to the foreground.
class SimpleMessageBox {
 public:
  enum Buttons : int32_t { kOk = 0, kOkCancel = 1, kYesNo = 2 };
  // 0 for the first button (OK or Yes), 1 for the second, -1 when it cannot be shown.
  static int32_t show(const std::string& title, const std::string& text, int32_t buttons, int32_t default_button);
};

}  // namespace sys
