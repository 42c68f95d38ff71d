#pragma once

#include <memory>
#include <vector>

#include "guikit/menu_nodes.h"
#include "presets/preset_selection_listener_base.h"
#include "presets/preset_selector_menu_listener.h"

namespace guikit {
class TextBox;
}

namespace plugcore {

// A button that opens a menu of the bank's programs; choosing one selects it.
class PresetSelectorListener : public PresetSelectionListenerBase {
 public:
  static constexpr const char* kUnknownModeTitle = "!!! Run-time error !!! Unknown preset mode";

  void set_name_box(guikit::TextBox* box) { name_box_ = box; }
  void on_event(int32_t code, int32_t argument) override;
  // A menu item was chosen.
  void select_item(int index);

  // The menu as last built, for the window's menu and for inspection.
  const guikit::MenuList& get_menu() const { return menu_; }

 private:
  void rebuild_menu();

  guikit::MenuList menu_;
  guikit::MenuDelimiter delimiter_;
  guikit::MenuItem title_;  // greyed: a heading, not a choice
  std::vector<std::unique_ptr<guikit::MenuItem>> items_;
  std::vector<std::unique_ptr<PresetSelectorMenuListener>> item_listeners_;
  guikit::TextBox* name_box_ = nullptr;
};

}  // namespace plugcore
