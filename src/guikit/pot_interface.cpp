#include "guikit/pot_interface.h"

namespace guikit {

void PotInterface::halt() {
  behaviour_.stop();
  released_ = false;
  button_held_ = false;
}

void PotInterface::stop() {
  halt();
  if (active_) end_gesture();
}

bool PotInterface::send_value(double value, int32_t origin) {
  if (value == value_) return true;
  if (set_value_by_user(value, origin)) return true;
  stop();
  return false;
}

void PotInterface::button_released() {
  button_held_ = false;
  each_end_change(kOriginMouse);
  behaviour_.release();
  released_ = true;
  if (behaviour_.get_state() == PotBehaviour::kDragging) invalidate_self();
  if (active_) end_gesture();
}

int32_t PotInterface::on_notify(Notify& msg) {
  if (msg.timer_id != behaviour_.get_timer_id()) return -1;
  if (button_held_ && all_can_change(kOriginMouse)) each_hold_change(kOriginMouse);
  int32_t state = behaviour_.get_state();
  double value = value_;
  if (state == PotBehaviour::kDragging) {
    value = behaviour_.glide_step(msg.time);
  } else if (state == PotBehaviour::kSpinning) {
    value = behaviour_.spin_step(msg.time);
  }
  int32_t origin = (button_held_ || state == PotBehaviour::kSpinning) ? kOriginMouse : kOriginGlide;
  if (!send_value(value, origin)) return 0;
  if (released_ && !behaviour_.is_moving()) stop();
  return 0;
}

// Taken away mid-gesture (another program grabbed the mouse), the pot would
// never see its button go up: the loss ends the press, and the glide finishes.
int32_t PotInterface::on_mouse_capture_lost(MouseCaptureLost&) {
  behaviour_.capture_lost();
  if (button_held_ && behaviour_.get_state() != PotBehaviour::kIdle) button_released();
  return 0;
}

void PotInterface::draw_layer(Redraw& msg, const Picture& p, double x, double y) const {
  if (opacity_ >= 1.0f && x == static_cast<int32_t>(x) && y == static_cast<int32_t>(y)) {
    p.draw(msg, Point{static_cast<int32_t>(x), static_cast<int32_t>(y)});
  } else {
    p.draw_at(msg, static_cast<float>(x), static_cast<float>(y), opacity_);
  }
}

}  // namespace guikit
