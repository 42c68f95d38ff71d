#include "presets/preset_listener_ref_list.h"

#include <stdexcept>

#include "presets/preset_load_bank_listener.h"
#include "presets/preset_mem_listener.h"
#include "presets/preset_number_listener.h"
#include "presets/preset_save_bank_listener.h"
#include "presets/preset_time_display_listener.h"
#include "presets/preset_time_fader_listener.h"

namespace plugcore {

PresetListenerRefList::PresetListenerRefList(int nbr_programs)
    : PresetListenerRefBase(nbr_programs), numbers_(static_cast<size_t>(nbr_programs > 0 ? nbr_programs : 0)) {}

void PresetListenerRefList::stop_all_fades() {
  for (PresetNumberListener* listener : numbers_) {
    if (listener != nullptr) listener->stop_fade();
  }
}

void PresetListenerRefList::set_load_bank_listener(PresetLoadBankListener& listener) {
  load_bank_ = &listener;
  listener.set_hub(this);
}

void PresetListenerRefList::set_save_bank_listener(PresetSaveBankListener& listener) {
  save_bank_ = &listener;
  listener.set_hub(this);
}

void PresetListenerRefList::set_mem_listener(PresetMemListener& listener) {
  mem_ = &listener;
  listener.set_hub(this);
}

void PresetListenerRefList::set_time_display_listener(PresetTimeDisplayListener& listener) {
  time_display_ = &listener;
  listener.set_hub(this);
}

void PresetListenerRefList::set_time_fader_listener(PresetTimeFaderListener& listener) {
  time_fader_ = &listener;
  listener.set_hub(this);
}

void PresetListenerRefList::set_number_listener(int index, PresetNumberListener& listener) {
  if (index < 0 || index >= static_cast<int>(numbers_.size())) {
    throw std::runtime_error("plugcore::PresetListenerRefList::set_number_listener() : Index out of range.");
  }
  numbers_[static_cast<size_t>(index)] = &listener;
  listener.set_hub(this);
}

PresetNumberListener* PresetListenerRefList::use_number_listener(int index) const {
  if (index < 0 || index >= static_cast<int>(numbers_.size())) return nullptr;
  return numbers_[static_cast<size_t>(index)];
}

}  // namespace plugcore
