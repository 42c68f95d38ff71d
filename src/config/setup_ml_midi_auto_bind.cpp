#include "config/setup_ml_midi_auto_bind.h"

#include "config/setup_mgr.h"

namespace plugcore {

void SetupMLMidiAutoBind::on_select() {
  const bool on = get_item() != nullptr && get_item()->is_checked();
  MidiAutoBindMgr& auto_bind = mgr_.use_auto_bind_mgr();
  auto_bind.set_autobind(!on);
  if (get_item() != nullptr) {
    get_item()->set_checked(auto_bind.is_autobind_on());
    get_item()->set_label(auto_bind.get_menu_text());
  }
}

}  // namespace plugcore
