#include "presets/preset_time_fader_listener.h"

#include <cmath>

#include "presets/preset_listener_ref_list.h"
#include "presets/preset_time_display_listener.h"

namespace plugcore {

double PresetTimeFaderListener::time_from_position(double position) {
  // 100^p - 1 written so that p = 1 gives 99 exactly.
  const double ln100 = 2.0 * std::log(10.0);
  return (std::exp(position * ln100) - 1.0) / (std::exp(ln100) - 1.0) * kMaxFadeTime;
}

double PresetTimeFaderListener::position_from_time(double seconds) { return std::log10(1.0 + seconds) / 2.0; }

double PresetTimeFaderListener::value_changed(double value, int32_t origin) {
  fade_time_ = time_from_position(value);
  if (hub_ != nullptr && hub_->use_time_display_listener() != nullptr) {
    hub_->use_time_display_listener()->show(fade_time_);
  }
  return guikit::DefaultEventListener::value_changed(value, origin);
}

}  // namespace plugcore
