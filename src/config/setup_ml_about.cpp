#include "config/setup_ml_about.h"

#include "config/setup_mgr.h"
#include "config/simple_message_box.h"

namespace plugcore {

void SetupMLAbout::on_select() {
  sys::SimpleMessageBox::show("About...", mgr_.build_about_text(), sys::SimpleMessageBox::kOk, 0);
}

}  // namespace plugcore
