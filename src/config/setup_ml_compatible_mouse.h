#pragma once

#include "config/setup_menu_listener.h"

namespace plugcore {

// "Enhanced mouse mode": switches the pots' mouse-compatibility mode (ticked while it is off).
class SetupMLCompatibleMouse : public SetupMenuListener {
 public:
  explicit SetupMLCompatibleMouse(SetupMgr& mgr) : SetupMenuListener(mgr) {}
  void on_select() override;
};

}  // namespace plugcore
