#include "presets/preset_name_tb_listener.h"

#include "guikit/text_box.h"
#include "presets/bank_manager.h"
#include "presets/preset_listener_ref_list.h"
#include "presets/prog_st_ld_interface.h"

namespace plugcore {

void PresetNameTbListener::on_event(int32_t code, int32_t) {
  auto* box = dynamic_cast<guikit::TextBox*>(get_control());
  if (code != 2 || box == nullptr || hub_ == nullptr || hub_->use_strategy() == nullptr) return;
  ProgStLdInterface& strategy = *hub_->use_strategy();
  const std::string name = box->get_text();
  const int index = hub_->get_current_program();
  if (index >= 0) {
    if (strategy.use_bank() != nullptr) strategy.use_bank()->use_program(index).set_name(name);
    return;
  }
  ProgramSlot slot;
  strategy.store_current(slot);
  slot.set_name(name);
  strategy.apply(slot);
}

}  // namespace plugcore
