#pragma once

#include <cstdint>

#include "config/setup_component.h"
#include "guikit/default_event_listener.h"

namespace plugcore {

// Sits on the setup button: a press (event 0) opens the setup menu.
class SetupCtrlListener : public guikit::DefaultEventListener, public SetupComponent {
 public:
  explicit SetupCtrlListener(SetupMgr& mgr) : SetupComponent(mgr) {}
  void on_event(int32_t code, int32_t argument) override;
};

}  // namespace plugcore
