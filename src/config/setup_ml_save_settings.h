#pragma once

#include "config/setup_menu_listener.h"

namespace plugcore {

// "Save...": the settings into a file chosen in the save dialog, asking before overwriting.
class SetupMLSaveSettings : public SetupMenuListener {
 public:
  explicit SetupMLSaveSettings(SetupMgr& mgr) : SetupMenuListener(mgr) {}
  void on_select() override;
};

}  // namespace plugcore
