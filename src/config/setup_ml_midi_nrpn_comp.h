#pragma once

#include "config/setup_menu_listener.h"

namespace plugcore {

// "Old erroneous nrpn behaviour": flips NRPN compatibility (ticked while the old byte order is in force).
class SetupMLMidiNrpnComp : public SetupMenuListener {
 public:
  explicit SetupMLMidiNrpnComp(SetupMgr& mgr) : SetupMenuListener(mgr) {}
  void on_select() override;
};

}  // namespace plugcore
