#pragma once

#include "config/setup_menu_listener.h"

namespace plugcore {

// "About...": the plug-in's name, version, maker and interface.
class SetupMLAbout : public SetupMenuListener {
 public:
  explicit SetupMLAbout(SetupMgr& mgr) : SetupMenuListener(mgr) {}
  void on_select() override;
};

}  // namespace plugcore
