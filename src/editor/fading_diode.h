#pragma once

#include "guikit/diode.h"

// A lamp that fades between off and on: after each switch (start_fade) its
// display level runs linearly towards the value over the switch-on or
// switch-off time, then the fade stops and the lamp shows the value again.
class FadingDiode : public guikit::Diode {
 public:
  void set_fade_times(double on_seconds, double off_seconds) {
    fade_on_ = on_seconds;
    fade_off_ = off_seconds;
  }
  double get_switch_time() const { return switch_time_; }

  // Call after the value changed: starts a fade from now.
  void start_fade();

  // Level of a fade `elapsed` seconds after the switch; a negative answer
  // means the fade is over.
  static double fade_level(double elapsed, double fade_seconds, bool switching_on);

 protected:
  void update_level() override;

 private:
  double fade_on_ = 0.0;
  double fade_off_ = 0.5;
  double switch_time_ = 0.0;
};
