#include "guikit/push_button.h"

#include <cmath>

#include "guikit/toolkit_clock.h"

namespace guikit {

namespace {
constexpr float kAnimationPeriod = 0.03f;
double clamp01(double v) { return v < 0.0 ? 0.0 : (v > 1.0 ? 1.0 : v); }
}  // namespace

int32_t PushButton::on_mouse_click(MouseClick& msg) {
  if (msg.buttons == 0) {
    if (active_) end_gesture();
    return 0;
  }
  if (!visible_) return 0;
  stop();
  each_event(0, 0);
  if (start_timer(kAnimationPeriod)) press_time_ = toolkit_now();
  return 0;
}

int32_t PushButton::on_notify(Notify& msg) {
  if (msg.timer_id != timer_id_) return -1;
  double e = msg.time - press_time_;
  if (e >= duration_) {
    flash_ = 0.0;
    stop();
  } else if (e >= duration_ / 2) {
    flash_ = 2.0 * (1.0 - e / duration_);
  } else {
    flash_ = 2.0 * e / duration_;
  }
  request_redraw();
  return 0;
}

double FlipFlop::get_display_position() const { return timer_id_ >= 0 ? fade_ : clamp01(value_); }

int32_t FlipFlop::on_mouse_click(MouseClick& msg) {
  if (msg.buttons == 0) {
    if (active_) end_gesture();
    return 0;
  }
  if (!visible_) return 0;
  stop();
  double next = 1.0 - std::floor(value_ + 0.5);
  if (!set_value_by_user(next, kOriginMouse)) return 0;
  if (transition_ < 1e-9) return 0;
  if (start_timer(kAnimationPeriod)) {
    start_time_ = toolkit_now();
    fade_ = value_ >= 0.5 ? 0.0 : 1.0;
  }
  return 0;
}

int32_t FlipFlop::on_notify(Notify& msg) {
  if (msg.timer_id != timer_id_) return -1;
  double e = msg.time - start_time_;
  if (e < transition_) {
    fade_ = value_ >= 0.5 ? e / transition_ : 1.0 - e / transition_;
  } else {
    stop();
  }
  request_redraw();
  return 0;
}

}  // namespace guikit
