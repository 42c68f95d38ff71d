#pragma once

#include "config/setup_component.h"
#include "guikit/menu_nodes.h"

namespace plugcore {

// Common ground of the setup menu's entries: the item it sits on.
class SetupMenuListener : public guikit::MenuListenerInterface, public SetupComponent {
 public:
  explicit SetupMenuListener(SetupMgr& mgr) : SetupComponent(mgr) {}
  void set_item(guikit::MenuItem* item) override { item_ = item; }
  guikit::MenuItem* get_item() const override { return item_; }

 private:
  guikit::MenuItem* item_ = nullptr;
};

}  // namespace plugcore
