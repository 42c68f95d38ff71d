#include "editor/band_splt_listener.h"

#include "editor/band_display_interface.h"
#include "guikit/control_interface.h"

int BandSpltListener::count_bands(const std::array<double, 3>& splits) {
  int n = 1;
  for (double s : splits) {
    if (s >= 1.0 - 1e-9) break;
    ++n;
  }
  return n;
}

double BandSpltListener::split_value(int j) const {
  guikit::ControlInterface* knob = splits_[j] != nullptr ? splits_[j]->get_control() : nullptr;
  return knob != nullptr ? knob->get_value() : 1.0;
}

double BandSpltListener::filter_user_value(double value, int32_t origin) {
  if (enabled_) {
    for (int j = 0; j < 3; ++j) {
      BandSpltListener* other = splits_[j];
      guikit::ControlInterface* knob = other != nullptr ? other->get_control() : nullptr;
      if (j == split_ || knob == nullptr) continue;
      const double s = knob->get_value();
      if ((j < split_ && s > value) || (j > split_ && s < value)) {
        other->set_enabled(false);
        knob->set_value_by_user(value, guikit::kOriginMouse);
        other->set_enabled(true);
      }
    }
  }
  return NumParamListener::filter_user_value(value, origin);
}

double BandSpltListener::value_changed(double value, int32_t origin) {
  value = NumParamListener::value_changed(value, origin);
  if (display_ == nullptr) return value;
  // The slider stores the value after its listeners ran: take it from here.
  std::array<double, 3> splits{{split_value(0), split_value(1), split_value(2)}};
  splits[split_] = value;
  const int n = count_bands(splits);
  for (int b = 1; b < 4; ++b) display_->show_band(b, b < n);
  return value;
}
