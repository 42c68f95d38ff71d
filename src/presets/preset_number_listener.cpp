#include "presets/preset_number_listener.h"

#include "guikit/text_box.h"
#include "presets/bank_manager.h"
#include "presets/preset_listener_ref_list.h"
#include "presets/prog_st_ld_interface.h"

namespace plugcore {

void PresetNumberListener::on_event(int32_t code, int32_t) {
  if (code != 0 || index_ < 0 || hub_ == nullptr) return;
  select_program(index_);
  ProgStLdInterface* strategy = hub_->use_strategy();
  if (name_box_ != nullptr && strategy != nullptr && strategy->use_bank() != nullptr) {
    name_box_->set_text(strategy->use_bank()->use_program(index_).get_name());
    name_box_->request_redraw();
  }
}

}  // namespace plugcore
