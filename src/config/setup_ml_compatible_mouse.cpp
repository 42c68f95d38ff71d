#include "config/setup_ml_compatible_mouse.h"

#include "config/mouse_compatibility.h"
#include "guikit/menu_nodes.h"
#include "guikit/pot_behaviour.h"

namespace plugcore {

void SetupMLCompatibleMouse::on_select() {
  const int mode = guikit::PotBehaviour::get_mouse_compatibility() == 1 ? 0 : 1;
  // The pots take the new mode only once the user's store holds it.
  if (sys::write_mouse_compatibility(mode)) guikit::PotBehaviour::set_mouse_compatibility(mode);
  if (get_item() != nullptr) get_item()->set_checked(guikit::PotBehaviour::get_mouse_compatibility() == 0);
}

}  // namespace plugcore
