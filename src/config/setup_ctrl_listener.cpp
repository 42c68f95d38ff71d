#include "config/setup_ctrl_listener.h"

#include "config/setup_mgr.h"

namespace plugcore {

void SetupCtrlListener::on_event(int32_t code, int32_t argument) {
  if (code == 0) mgr_.open_menu();
}

}  // namespace plugcore
