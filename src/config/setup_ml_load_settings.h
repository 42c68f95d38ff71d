#pragma once

#include "config/setup_menu_listener.h"

namespace plugcore {

// "Load...": a setting file chosen in the open dialog.
class SetupMLLoadSettings : public SetupMenuListener {
 public:
  explicit SetupMLLoadSettings(SetupMgr& mgr) : SetupMenuListener(mgr) {}
  void on_select() override;
};

}  // namespace plugcore
