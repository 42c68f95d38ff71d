#include "presets/preset_selector_listener.h"

#include <cstdio>

#include "guikit/control_interface.h"
#include "guikit/messages.h"
#include "guikit/text_box.h"
#include "presets/bank_manager.h"
#include "presets/preset_listener_ref_list.h"
#include "presets/preset_mem_listener.h"
#include "presets/prog_st_ld_interface.h"

namespace plugcore {

void PresetSelectorListener::on_event(int32_t code, int32_t) {
  guikit::ControlInterface* control = get_control();
  if (code != 0 || hub_ == nullptr || control == nullptr) return;
  guikit::MenuStop stop;
  control->process_message(stop);
  rebuild_menu();
  guikit::MenuRequest request(&menu_);
  control->process_message(request);
}

void PresetSelectorListener::rebuild_menu() {
  PresetMemListener* mem = hub_->use_mem_listener();
  const int mode = mem != nullptr ? mem->get_mode() : PresetMemListener::kLoad;
  const char* title = kUnknownModeTitle;
  if (mode == PresetMemListener::kLoad) title = "Load preset";
  if (mode == PresetMemListener::kStore) title = "Store preset";
  title_.set_label(title);
  title_.set_grayed(true);

  const int n = hub_->get_nbr_programs();
  if (static_cast<int>(items_.size()) != n) {
    items_.clear();
    item_listeners_.clear();
    for (int i = 0; i < n; ++i) {
      items_.push_back(std::make_unique<guikit::MenuItem>());
      item_listeners_.push_back(std::make_unique<PresetSelectorMenuListener>());
      items_.back()->set_listener(item_listeners_.back().get());
    }
  }
  menu_.remove_all();
  menu_.add_child(&title_);
  menu_.add_child(&delimiter_);
  const ProgStLdInterface* strategy = hub_->use_strategy();
  const BankManager* bank = strategy != nullptr ? strategy->use_bank() : nullptr;
  for (int i = 0; i < n; ++i) {
    char number[16];
    std::snprintf(number, sizeof(number), "%2d - ", i + 1);
    std::string label = number;
    if (bank != nullptr && i < bank->get_nbr_programs()) label += bank->use_program(i).get_name();
    guikit::MenuItem& item = *items_[static_cast<size_t>(i)];
    item.set_label(label);
    item.set_checked(i == hub_->get_current_program());
    item_listeners_[static_cast<size_t>(i)]->set_target(this, i);
    menu_.add_child(&item);
  }
}

void PresetSelectorListener::select_item(int index) {
  if (hub_ == nullptr) return;
  hub_->set_current_program(index);
  select_program(index);
  ProgStLdInterface* strategy = hub_->use_strategy();
  if (name_box_ != nullptr && strategy != nullptr && strategy->use_bank() != nullptr) {
    name_box_->set_text(strategy->use_bank()->use_program(index).get_name());
    name_box_->request_redraw();
  }
}

}  // namespace plugcore
