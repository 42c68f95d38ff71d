#pragma once

#include "config/setup_menu_listener.h"

namespace plugcore {

// "Auto-bind": switches learning to the opposite of the tick.
class SetupMLMidiAutoBind : public SetupMenuListener {
 public:
  explicit SetupMLMidiAutoBind(SetupMgr& mgr) : SetupMenuListener(mgr) {}
  void on_select() override;
};

}  // namespace plugcore
