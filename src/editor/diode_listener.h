#pragma once

#include <cstdint>

#include "guikit/default_event_listener.h"

namespace guikit {
class ControlInterface;
}

// Attached to a knob or flip-flop: lights a lamp while the control's value is
// at or above a small threshold. Values pass through unchanged; a change by the
// user switches the lamp as a user change, one from outside as a set.
class DiodeListener : public guikit::DefaultEventListener {
 public:
  explicit DiodeListener(guikit::ControlInterface* diode = nullptr) : diode_(diode) {}
  void set_diode(guikit::ControlInterface* diode) { diode_ = diode; }
  void set_threshold(float threshold) { threshold_ = threshold; }
  float get_threshold() const { return threshold_; }

  double filter_user_value(double value, int32_t origin) override;
  double filter_set_value(double value, int32_t origin) override;

 private:
  // The lamp's new value, or a negative number when it keeps its state.
  double lamp_for(double value) const;

  guikit::ControlInterface* diode_ = nullptr;
  float threshold_ = 0.001f;
};
