#pragma once

#include <cstdint>

#include "guikit/message_handler_interface.h"
#include "presets/generic_preset_listener.h"
#include "presets/program_slot.h"

namespace plugcore {

// A listener that selects programs: stores one, or cross-fades to one on a
// 0.1 s toolkit timer of its control's window.
class PresetSelectionListenerBase : public GenericPresetListener, public guikit::MessageHandlerInterface {
 public:
  static constexpr float kFadePeriod = 0.1f;

  PresetSelectionListenerBase() = default;
  PresetSelectionListenerBase(const PresetSelectionListenerBase&) = delete;
  PresetSelectionListenerBase& operator=(const PresetSelectionListenerBase&) = delete;

  // Stops every program-button fade, then fades from the current sound to
  // bank program `index`. Without a window to run the timer nothing changes.
  void load_with_fade(int index);
  // The current sound into bank program `index`; the sound does not change.
  void store(int index);
  void stop_fade();
  // Store mode: store and switch back to Load; else fade. Then `index` is
  // the current program.
  void select_program(int index);

  // The fade timer's handler.
  int32_t process_message(guikit::MessageInterface& message) override;

  int32_t get_timer_id() const { return timer_id_; }
  bool is_fading() const { return timer_id_ >= 0; }
  double get_fade_start() const { return fade_start_; }

 private:
  int32_t timer_id_ = -1;
  double fade_start_ = 0.0;
  ProgramSlot from_;
  ProgramSlot to_;
};

}  // namespace plugcore
