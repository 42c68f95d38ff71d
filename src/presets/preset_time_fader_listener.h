#pragma once

#include "presets/generic_preset_listener.h"

namespace plugcore {

// The fade-time knob: position p gives 100^p - 1 seconds (0 .. 99 s).
class PresetTimeFaderListener : public GenericPresetListener {
 public:
  static constexpr double kMaxFadeTime = 99.0;

  static double time_from_position(double position);
  static double position_from_time(double seconds);

  double value_changed(double value, int32_t origin) override;
  double get_fade_time() const { return fade_time_; }

 private:
  double fade_time_ = 0.0;
};

}  // namespace plugcore
