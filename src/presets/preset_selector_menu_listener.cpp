#include "presets/preset_selector_menu_listener.h"

#include "presets/preset_selector_listener.h"

namespace plugcore {

void PresetSelectorMenuListener::on_select() {
  if (selector_ != nullptr && index_ >= 0) selector_->select_item(index_);
}

}  // namespace plugcore
