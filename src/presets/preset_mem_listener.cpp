#include "presets/preset_mem_listener.h"

#include "guikit/control_interface.h"
#include "guikit/event_listener_interface.h"

namespace plugcore {

int PresetMemListener::get_mode() {
  const guikit::ControlInterface* control = get_control();
  return control != nullptr && control->get_value() >= 0.5 ? kStore : kLoad;
}

void PresetMemListener::set_mode(int mode) {
  guikit::ControlInterface* control = get_control();
  if (control == nullptr) return;
  control->set_value_by_user(mode == kStore ? 1.0 : 0.0, guikit::kOriginMouse);
}

}  // namespace plugcore
