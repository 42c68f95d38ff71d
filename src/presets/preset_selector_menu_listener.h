#pragma once

#include "guikit/menu_nodes.h"

namespace plugcore {

class PresetSelectorListener;

// One item of the selector menu: choosing it selects its program.
class PresetSelectorMenuListener : public guikit::MenuListenerInterface {
 public:
  void set_target(PresetSelectorListener* selector, int index) {
    selector_ = selector;
    index_ = index;
  }
  int get_index() const { return index_; }

  void on_select() override;
  void set_item(guikit::MenuItem* item) override { item_ = item; }
  guikit::MenuItem* get_item() const override { return item_; }

 private:
  PresetSelectorListener* selector_ = nullptr;
  int index_ = -1;
  guikit::MenuItem* item_ = nullptr;
};

}  // namespace plugcore
