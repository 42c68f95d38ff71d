#include "editor/vu_meter_listener.h"

#include <algorithm>
#include <cmath>

#include "dsp/brakmorph_dsp.h"
#include "guikit/control_interface.h"

void VuMeterListener::set_min_change(int steps) {
  min_change_ = steps > 0 ? 1.0f / static_cast<float>(steps) : 1e-9f;
}

float VuMeterListener::level_to_position(float level) {
  const double db = 20.0 * std::log10(std::max(static_cast<double>(level), 1e-6));
  const double position = (db + 30.0) * 0.025;
  return static_cast<float>(std::min(1.0, std::max(0.0, position)));
}

void VuMeterListener::on_event(int32_t code, int32_t argument) {
  if (code != kEventTick) return;
  guikit::ControlInterface* needle = get_control();
  if (needle == nullptr || engine_ == nullptr || band_ < 0) return;
  const float position = level_to_position(engine_->get_band_level(band_));
  if (std::fabs(position - last_position_) > min_change_) {
    needle->set_value_by_user(position, guikit::kOriginMeter);
    last_position_ = position;
  }
}
