#include "config/system_ui.h"

namespace sys {

namespace {

// Until the desktop dialogs exist the services answer as if nothing could be shown.
class NoSystemUi : public SystemUiInterface {
 public:
  FileDialogResult run_file_dialog(const FileDialogRequest&) override {
    FileDialogResult result;
    result.status = -1024;
    return result;
  }
  int32_t show_message_box(const std::string&, const std::string&, int32_t, int32_t) override { return -1; }
  int32_t open_url(const std::string&) override { return -1; }
};

}  // namespace

SystemUiInterface& platform_system_ui() {
  static NoSystemUi ui;
  return ui;
}

}  // namespace sys
