#include "editor/diode_listener.h"

#include "guikit/control_interface.h"

double DiodeListener::lamp_for(double value) const {
  if (diode_ == nullptr) return -1.0;
  const bool lit = diode_->get_value() >= threshold_;
  if (value >= threshold_ && !lit) return 1.0;
  if (value < threshold_ && lit) return 0.0;
  return -1.0;
}

double DiodeListener::filter_user_value(double value, int32_t origin) {
  const double lamp = lamp_for(value);
  if (lamp >= 0.0) diode_->set_value_by_user(lamp, origin);
  return value;
}

double DiodeListener::filter_set_value(double value, int32_t origin) {
  const double lamp = lamp_for(value);
  if (lamp >= 0.0) diode_->set_value(lamp, origin);
  return value;
}
