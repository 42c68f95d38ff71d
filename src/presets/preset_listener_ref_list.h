#pragma once

#include <vector>

#include "presets/preset_listener_ref_base.h"

namespace plugcore {

class PresetLoadBankListener;
class PresetMemListener;
class PresetNumberListener;
class PresetSaveBankListener;
class PresetTimeDisplayListener;
class PresetTimeFaderListener;

// The hub: the preset listeners find each other through it. Setting a
// listener also gives it its reference to the hub. Nothing here is owned.
class PresetListenerRefList : public PresetListenerRefBase {
 public:
  explicit PresetListenerRefList(int nbr_programs);

  // Stops the fade of every program-button listener.
  void stop_all_fades() override;

  void set_load_bank_listener(PresetLoadBankListener& listener);
  void set_save_bank_listener(PresetSaveBankListener& listener);
  void set_mem_listener(PresetMemListener& listener);
  void set_time_display_listener(PresetTimeDisplayListener& listener);
  void set_time_fader_listener(PresetTimeFaderListener& listener);
  // Throws std::runtime_error for an index outside the programs.
  void set_number_listener(int index, PresetNumberListener& listener);

  PresetLoadBankListener* use_load_bank_listener() const { return load_bank_; }
  PresetSaveBankListener* use_save_bank_listener() const { return save_bank_; }
  PresetMemListener* use_mem_listener() const { return mem_; }
  PresetTimeDisplayListener* use_time_display_listener() const { return time_display_; }
  PresetTimeFaderListener* use_time_fader_listener() const { return time_fader_; }
  // nullptr for an index outside the programs or not set yet.
  PresetNumberListener* use_number_listener(int index) const;

 private:
  PresetLoadBankListener* load_bank_ = nullptr;
  PresetSaveBankListener* save_bank_ = nullptr;
  PresetMemListener* mem_ = nullptr;
  PresetTimeDisplayListener* time_display_ = nullptr;
  PresetTimeFaderListener* time_fader_ = nullptr;
  std::vector<PresetNumberListener*> numbers_;
};

}  // namespace plugcore
