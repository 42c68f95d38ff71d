#include "presets/preset_selection_listener_base.h"

#include <cmath>

#include "guikit/control_interface.h"
#include "guikit/messages.h"
#include "guikit/toolkit_clock.h"
#include "presets/preset_listener_ref_list.h"
#include "presets/preset_mem_listener.h"
#include "presets/preset_time_fader_listener.h"
#include "presets/prog_st_ld_interface.h"

namespace plugcore {

void PresetSelectionListenerBase::load_with_fade(int index) {
  if (hub_ == nullptr || hub_->use_strategy() == nullptr) return;
  ProgStLdInterface& strategy = *hub_->use_strategy();
  hub_->stop_all_fades();
  // A listener outside the hub's list (the selector) stops its own fade too,
  // so no timer of an abandoned fade keeps running.
  stop_fade();
  strategy.store_current(from_);
  strategy.read_from_bank(index, to_);
  // The window stamps its timer ticks with the toolkit clock: the start must
  // come from the same clock, or elapsed times would mix two time bases.
  fade_start_ = guikit::toolkit_now();
  guikit::ControlInterface* control = get_control();
  if (control == nullptr) return;
  int32_t id = -1;
  guikit::SetTimer set(kFadePeriod, this, &id);
  if (control->process_message(set) == 0) {
    timer_id_ = id;
  }
}

void PresetSelectionListenerBase::store(int index) {
  if (hub_ == nullptr || hub_->use_strategy() == nullptr) return;
  ProgStLdInterface& strategy = *hub_->use_strategy();
  ProgramSlot slot;
  strategy.store_current(slot);
  strategy.write_to_bank(index, slot);
}

void PresetSelectionListenerBase::stop_fade() {
  if (timer_id_ < 0) return;
  const int32_t id = timer_id_;
  timer_id_ = -1;
  if (guikit::ControlInterface* control = get_control()) {
    guikit::ClearTimer clear(id);
    control->process_message(clear);
  }
}

void PresetSelectionListenerBase::select_program(int index) {
  if (hub_ == nullptr) return;
  PresetMemListener* mem = hub_->use_mem_listener();
  if (mem != nullptr && mem->get_mode() == PresetMemListener::kStore) {
    store(index);
    mem->set_mode(PresetMemListener::kLoad);
  } else {
    load_with_fade(index);
  }
  hub_->set_current_program(index);
}

int32_t PresetSelectionListenerBase::process_message(guikit::MessageInterface& message) {
  auto* tick = dynamic_cast<guikit::Notify*>(&message);
  if (tick == nullptr || timer_id_ < 0 || tick->timer_id != timer_id_ || hub_ == nullptr ||
      hub_->use_strategy() == nullptr) {
    return 0;
  }
  const PresetTimeFaderListener* fader = hub_->use_time_fader_listener();
  const double fade = fader != nullptr ? fader->get_fade_time() : 0.0;
  const double elapsed = tick->time - fade_start_;
  double position = 1.0;
  if (std::fabs(fade) >= 1e-9) {
    position = elapsed / fade;
    if (position < 0.0) position = 0.0;
    if (position > 1.0) position = 1.0;
  }
  hub_->use_strategy()->apply_mix(from_, to_, position);
  if (elapsed >= fade) {
    stop_fade();
  }
  return 0;
}

}  // namespace plugcore
