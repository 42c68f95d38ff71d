#include "editor/fading_diode.h"

#include <algorithm>

#include "guikit/toolkit_clock.h"

void FadingDiode::start_fade() {
  switch_time_ = guikit::toolkit_now();
  set_override(true);
  update_level();
  invalidate_self();
}

double FadingDiode::fade_level(double elapsed, double fade_seconds, bool switching_on) {
  if (!(elapsed < fade_seconds)) return -1.0;
  const double t = std::min(1.0, std::max(0.0, elapsed / fade_seconds));
  return switching_on ? t : 1.0 - t;
}

void FadingDiode::update_level() {
  const bool on = get_value() >= 0.5;
  const double level = fade_level(guikit::toolkit_now() - switch_time_, on ? fade_on_ : fade_off_, on);
  if (level >= 0.0) {
    set_display_level(level);
    return;
  }
  set_display_level(on ? 1.0 : 0.0);
  set_override(false);
}
