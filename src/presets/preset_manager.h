#pragma once

#include <memory>
#include <string>

#include "config/file_selector.h"
#include "presets/bank_manager.h"
#include "presets/preset_listener_ref_list.h"
#include "presets/preset_load_bank_listener.h"
#include "presets/preset_mem_listener.h"
#include "presets/preset_name_tb_listener.h"
#include "presets/preset_number_listener.h"
#include "presets/preset_save_bank_listener.h"
#include "presets/preset_selector_listener.h"
#include "presets/preset_time_display_listener.h"
#include "presets/preset_time_fader_listener.h"
#include "presets/prog_st_ld_default.h"

namespace guikit {
class FlipFlop;
class PotInterface;
class PushButton;
class TextBox;
}  // namespace guikit

namespace plugcore {

class GuiInterface;

// The editor's presets: its own bank of programs, the program buttons with
// their cross-fades, the Load/Store switch, the fade time and the bank files.
class PresetManager {
 public:
  explicit PresetManager(int nbr_programs);
  PresetManager(const PresetManager&) = delete;
  PresetManager& operator=(const PresetManager&) = delete;
  ~PresetManager();

  // program_buttons points to get_nbr_programs() consecutive buttons. With
  // strategy nullptr the manager's own default one is used; with
  // default_bank nullptr no bank resource is read. Answers the status of the
  // default-bank load: 0, a bank status code, or -1 for a missing resource
  // (the bank then holds the engine's sound in every program). Does nothing
  // (and answers 0) when already initialised. None of the objects is owned;
  // they must outlive the manager or its deinit().
  int init(GuiInterface& editor, ProgStLdInterface* strategy, guikit::PushButton program_buttons[],
           guikit::FlipFlop& mode_switch, guikit::PushButton& load_button, guikit::PushButton& save_button,
           guikit::PotInterface& fade_knob, guikit::TextBox& fade_display, const char* default_bank);
  // Stops the fades; the editor calls it when it closes.
  void deinit();
  bool is_initialised() const { return initialised_; }

  int get_nbr_programs() const { return hub_.get_nbr_programs(); }
  // The bank dialog opens in `directory`, keeping the file name it had.
  void set_bank_directory(const std::string& directory);

  BankManager& use_bank() { return bank_; }
  PresetListenerRefList& use_hub() { return hub_; }
  sys::FileSelector& use_bank_dialog() { return bank_dialog_; }
  PresetMemListener& use_mem_listener() { return mem_; }
  PresetSelectorListener& use_selector_listener() { return selector_; }
  PresetNameTbListener& use_name_listener() { return name_; }
  PresetTimeFaderListener& use_time_fader_listener() { return time_fader_; }
  PresetTimeDisplayListener& use_time_display_listener() { return time_display_; }
  // nullptr before init or for an index outside the programs.
  PresetNumberListener* use_number_listener(int index);

 private:
  GuiInterface* editor_ = nullptr;
  PresetMemListener mem_;
  PresetSelectorListener selector_;
  std::unique_ptr<PresetNumberListener[]> numbers_;
  int nbr_numbers_ = 0;
  PresetNameTbListener name_;
  PresetTimeDisplayListener time_display_;
  PresetTimeFaderListener time_fader_;
  PresetLoadBankListener load_bank_;
  PresetSaveBankListener save_bank_;
  BankManager bank_;
  ProgStLdDefault default_strategy_;
  ProgStLdInterface* strategy_ = nullptr;
  PresetListenerRefList hub_;
  sys::FileSelector bank_dialog_;
  bool initialised_ = false;
};

}  // namespace plugcore
