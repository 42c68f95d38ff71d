#include "presets/preset_manager.h"

#include <algorithm>
#include <cmath>

#include "config/system_services.h"
#include "guikit/pot_interface.h"
#include "guikit/push_button.h"
#include "guikit/text_box.h"
#include "host/dsp_interface.h"
#include "host/gui_interface.h"
#include "presets/bank_file.h"

namespace plugcore {

namespace {
const char kBankExtension[] = "pbk";
// Knob position of a one-second fade: log10(1 + 1) / 2.
constexpr double kStartPosition = 0.150514997831991;
constexpr int32_t kStartOrigin = 255;
}  // namespace

PresetManager::PresetManager(int nbr_programs) : hub_(nbr_programs) {
  bank_dialog_.set_filters({sys::FileFilter{std::string("Velmora plug-in preset bank (*.") + kBankExtension + ")",
                                            std::string("*.") + kBankExtension}});
}

PresetManager::~PresetManager() {
  if (initialised_) hub_.stop_all_fades();
}

int PresetManager::init(GuiInterface& editor, ProgStLdInterface* strategy, guikit::PushButton program_buttons[],
                        guikit::FlipFlop& mode_switch, guikit::PushButton& load_button, guikit::PushButton& save_button,
                        guikit::PotInterface& fade_knob, guikit::TextBox& fade_display, const char* default_bank) {
  if (initialised_) return 0;
  editor_ = &editor;
  strategy_ = strategy != nullptr ? strategy : &default_strategy_;
  DspInterface* dsp = editor.get_dsp();

  const int n = get_nbr_programs();
  if (nbr_numbers_ != n) {
    numbers_.reset(n > 0 ? new PresetNumberListener[static_cast<size_t>(n)] : nullptr);
    nbr_numbers_ = n;
  }

  // Until a bank is read every program holds the sound the engine has now.
  bank_.resize(n);
  for (int i = 0; i < n; ++i) {
    ProgramSlot slot;
    if (dsp != nullptr) {
      slot.set_name(dsp->get_program_name());
      dsp->store_program(slot);
    }
    bank_.set_program(i, slot);
    numbers_[i].set_index(i);
  }

  strategy_->set_context(&bank_, editor.get_host_gui(), dsp);
  load_bank_.set_targets(&bank_, &bank_dialog_);
  save_bank_.set_targets(&bank_, &bank_dialog_);

  mode_switch.push_back_listener(&mem_);
  fade_display.push_back_listener(&time_display_);
  fade_knob.push_back_listener(&time_fader_);
  load_button.push_back_listener(&load_bank_);
  save_button.push_back_listener(&save_bank_);
  for (int i = 0; i < n; ++i) program_buttons[i].push_back_listener(&numbers_[i]);

  hub_.set_strategy(strategy_);
  hub_.set_mem_listener(mem_);
  hub_.set_time_display_listener(time_display_);
  hub_.set_time_fader_listener(time_fader_);
  hub_.set_load_bank_listener(load_bank_);
  hub_.set_save_bank_listener(save_bank_);
  for (int i = 0; i < n; ++i) hub_.set_number_listener(i, numbers_[i]);
  // Bound to no control here, but they reach the shared state like the others.
  selector_.set_hub(&hub_);
  name_.set_hub(&hub_);

  time_display_.show(time_fader_.get_fade_time());
  initialised_ = true;

  int status = 0;
  if (default_bank != nullptr) {
    const sys::Resource resource = sys::get_resource("VLPB", default_bank);
    BankManager loaded;
    if (!resource) {
      status = -1;
    } else {
      status = load_bank_mem(resource.data, static_cast<int>(resource.size), loaded, false);
    }
    if (status == 0) {
      const int count = std::min(loaded.get_nbr_programs(), n);
      for (int i = 0; i < count; ++i) bank_.set_program(i, loaded.use_program(i));
    }
  }

  fade_knob.set_value(kStartPosition, kStartOrigin);
  return status;
}

void PresetManager::deinit() {
  if (!initialised_) return;
  hub_.stop_all_fades();
  initialised_ = false;
}

void PresetManager::set_bank_directory(const std::string& directory) {
  const std::string name = sys::FileSelector::name_part(bank_dialog_.get_path());
  bank_dialog_.set_path(directory + "\\" + name);
}

PresetNumberListener* PresetManager::use_number_listener(int index) {
  if (index < 0 || index >= nbr_numbers_) return nullptr;
  return &numbers_[index];
}

}  // namespace plugcore
