#include "guikit/fader.h"

#include <cmath>

namespace guikit {

namespace {
// Distance along the axis from the click point below which a spin keeps its speed.
constexpr double kSpinDeadZone = 5.0;
constexpr double kSpinScale = 65536.0;
}  // namespace

void Fader::set_orientation(bool vertical) {
  vertical_ = vertical;
  axes_ = vertical ? AxisMatrix{0.0, -1.0, 1.0, 0.0} : AxisMatrix{1.0, 0.0, 0.0, -1.0};
}

double Fader::cap_offset_x() const { return vertical_ ? 0.0 : length_ * value_; }
double Fader::cap_offset_y() const { return vertical_ ? length_ - length_ * value_ : 0.0; }

void Fader::place_release_point() {
  if (vertical_) {
    behaviour_.set_release_offset(Point{0, static_cast<int32_t>(std::floor(length_ - value_ * length_ + 0.5))});
  } else {
    behaviour_.set_release_offset(Point{static_cast<int32_t>(std::floor(value_ * length_ + 0.5)), 0});
  }
}

// The cap in editor pixels at its current offset, or an empty rectangle without a cap.
Rect Fader::cap_rect() const {
  if (!cap_.is_present()) return Rect{};
  Rect r = cap_.get_rect(position_);
  auto dx = static_cast<int32_t>(std::floor(cap_offset_x() + 0.5));
  auto dy = static_cast<int32_t>(std::floor(cap_offset_y() + 0.5));
  return Rect{r.left + dx, r.top + dy, r.right + dx, r.bottom + dy};
}

int32_t Fader::on_mouse_click(MouseClick& msg) {
  if (msg.buttons == 0) {
    if (button_held_) button_released();
    return 0;
  }
  if (!visible_ || !(behaviour_.get_state() == PotBehaviour::kIdle || released_)) return 0;
  halt();
  button_held_ = true;
  click_ = msg.position;
  Rect cap = cap_rect();
  bool started;
  if (cap.empty() || cap.contains(msg.position.x, msg.position.y)) {
    place_release_point();
    started = behaviour_.begin_drag();
  } else {
    // Towards the click: above a vertical cap or right of a horizontal one increases.
    double towards = vertical_ ? (msg.position.y < cap.top ? 1.0 : -1.0) : (msg.position.x >= cap.right ? 1.0 : -1.0);
    behaviour_.set_release_offset(Point{msg.position.x - position_.x, msg.position.y - position_.y});
    started = behaviour_.begin_spin(towards * spin_speed_);
  }
  if (!started) button_held_ = false;
  return 0;
}

int32_t Fader::on_mouse_move(MouseMove& msg) {
  if (!button_held_) return -1;
  if (behaviour_.get_state() == PotBehaviour::kDragging) {
    double range = drag_range_ == -1.0 ? static_cast<double>(length_) : drag_range_;
    double v = behaviour_.drag_move(msg.position, axes_, range, secondary_factor_);
    send_value(v, kOriginMouse);
    place_release_point();
    return 0;
  }
  if (behaviour_.get_state() == PotBehaviour::kSpinning) {
    double dx = msg.position.x - click_.x;
    double dy = msg.position.y - click_.y;
    double d = axes_.m00 * dx + axes_.m01 * dy;
    if (std::fabs(d) >= kSpinDeadZone) behaviour_.request_spin(std::fabs(d) * d * spin_speed_ / kSpinScale);
    return 0;
  }
  return -1;
}

// The glide moves the cap after the mouse has stopped; the cursor must
// reappear on the cap where it ends up.
int32_t Fader::on_notify(Notify& msg) {
  bool dragging = behaviour_.get_state() == PotBehaviour::kDragging && button_held_;
  int32_t answer = PotInterface::on_notify(msg);
  if (dragging) place_release_point();
  return answer;
}

int32_t Fader::on_redraw(Redraw& msg) {
  double px = position_.x;
  double py = position_.y;
  if (flags_ & kFlagBackground) draw_layer(msg, background_, px, py);
  double cx = px + cap_offset_x();
  double cy = py + cap_offset_y();
  bool active_cap = (flags_ & kFlagActive) && active_ && active_picture_.is_present();
  draw_layer(msg, active_cap ? active_picture_ : cap_, cx, cy);
  if ((flags_ & kFlagDragOverlay) && behaviour_.get_state() == PotBehaviour::kDragging)
    draw_layer(msg, drag_overlay_, cx, cy);
  if ((flags_ & kFlagOverlay)) draw_layer(msg, overlay_, px, py);
  if ((flags_ & kFlagHighlight) && highlighted_) draw_layer(msg, highlight_picture_, px, py);
  return 0;
}

}  // namespace guikit
