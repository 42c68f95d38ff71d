#include "guikit/knob.h"

#include <cmath>

namespace guikit {

namespace {
constexpr double kTwoPi = 6.283185307179586476925;
// The knob reads upward motion as increase and sideways motion as secondary.
constexpr AxisMatrix kKnobAxes{0.0, -1.0, 1.0, 0.0};
// Sideways distance from the click point below which a spin keeps its speed.
constexpr int32_t kSpinDeadZone = 4;
constexpr double kSpinScale = 65536.0;
}  // namespace

void Knob::set_frames(const std::vector<Picture>& frames, double frame0_turns, double turns_covered) {
  frames_ = frames;
  frame0_turns_ = frame0_turns;
  turns_covered_ = turns_covered;
}

void Knob::set_pointers(const Picture& a, const Picture& b, Point b_offset, Point centre, double radius, bool rotate) {
  pointer_a_ = a;
  pointer_b_ = b;
  pointer_b_offset_ = b_offset;
  centre_ = centre;
  pointer_radius_ = radius;
  rotate_pointers_ = rotate;
  if (a.is_present()) flags_ |= kFlagPointerA;
  if (b.is_present()) flags_ |= kFlagPointerB;
}

double Knob::get_angle() const { return kTwoPi * (value_ * angle_span_ + angle_offset_); }

int32_t Knob::get_frame(double* fraction) const {
  if (frames_.empty() || turns_covered_ == 0.0) return frames_.empty() ? -1 : 0;
  double count = static_cast<double>(frames_.size());
  double x = (get_angle() / kTwoPi - frame0_turns_) / turns_covered_ + 0.5 / count;
  double scaled = (x - std::floor(x)) * count;
  auto frame = static_cast<int32_t>(std::floor(scaled));
  if (frame >= static_cast<int32_t>(frames_.size())) frame = static_cast<int32_t>(frames_.size()) - 1;
  if (frame < 0) frame = 0;
  if (fraction) *fraction = scaled - frame;
  return frame;
}

// The knob picture's rectangle, else the hit rectangle, in editor pixels.
Rect Knob::zone_rect() const {
  if (!frames_.empty() && frames_[0].is_present()) return frames_[0].get_rect(position_);
  return Rect{box_.left + position_.x, box_.top + position_.y, box_.right + position_.x, box_.bottom + position_.y};
}

int32_t Knob::on_mouse_click(MouseClick& msg) {
  if (msg.buttons == 0) {
    if (button_held_) button_released();
    return 0;
  }
  if (!visible_ || !(behaviour_.get_state() == PotBehaviour::kIdle || released_)) return 0;
  halt();
  button_held_ = true;
  click_ = msg.position;
  Rect zone = zone_rect();
  // 64-bit: the zone products of large boxes exceed 32 bits.
  int64_t w = zone.width();
  int64_t h = zone.height();
  int64_t px = msg.position.x - zone.left;
  int64_t py = msg.position.y - zone.top;
  double s = angle_span_ > 0.0 ? 1.0 : (angle_span_ < 0.0 ? -1.0 : 0.0);
  behaviour_.set_release_offset(Point{msg.position.x - position_.x, msg.position.y - position_.y});
  bool started;
  if (s != 0.0 && 3 * py * w > (3 * px + 2 * w) * h) {
    started = behaviour_.begin_spin(s * spin_speed_);
  } else if (s != 0.0 && 3 * py * w > (5 * w - 3 * px) * h) {
    started = behaviour_.begin_spin(-s * spin_speed_);
  } else {
    started = behaviour_.begin_drag();
  }
  if (!started) button_held_ = false;
  return 0;
}

int32_t Knob::on_mouse_move(MouseMove& msg) {
  if (!button_held_) return -1;
  if (behaviour_.get_state() == PotBehaviour::kDragging) {
    double v = behaviour_.drag_move(msg.position, kKnobAxes, drag_range_, secondary_factor_);
    send_value(v, kOriginMouse);
    return 0;
  }
  if (behaviour_.get_state() == PotBehaviour::kSpinning) {
    int32_t dx = msg.position.x - click_.x;
    if (dx > kSpinDeadZone || dx < -kSpinDeadZone)
      behaviour_.request_spin(std::fabs(static_cast<double>(dx)) * dx * spin_speed_ / kSpinScale);
    return 0;
  }
  return -1;
}

int32_t Knob::on_redraw(Redraw& msg) {
  double px = position_.x;
  double py = position_.y;
  if (flags_ & kFlagBackground) draw_layer(msg, background_, px, py);
  double a = get_angle();
  double fraction = 0.0;
  int32_t frame = get_frame(&fraction);
  if (frame >= 0) {
    const Picture& f = frames_[static_cast<size_t>(frame)];
    if (rotate_frames_) {
      double turn = kTwoPi * (fraction - 0.5) * turns_covered_ / static_cast<double>(frames_.size());
      f.draw_rotated(msg, static_cast<float>(px), static_cast<float>(py), static_cast<float>(turn), opacity_);
    } else {
      draw_layer(msg, f, px, py);
    }
  }
  double cx = px + centre_.x + pointer_radius_ * std::cos(a);
  double cy = py + centre_.y - pointer_radius_ * std::sin(a);
  if (flags_ & kFlagPointerB) {
    double bx = cx - pointer_b_offset_.x;
    double by = cy - pointer_b_offset_.y;
    if (rotate_pointers_) {
      pointer_b_.draw_rotated(msg, static_cast<float>(bx), static_cast<float>(by), static_cast<float>(a), opacity_);
    } else {
      pointer_b_.draw_at(msg, static_cast<float>(bx), static_cast<float>(by), opacity_);
    }
  }
  if (flags_ & kFlagPointerA) {
    if (rotate_pointers_) {
      pointer_a_.draw_rotated(msg, static_cast<float>(cx), static_cast<float>(cy), static_cast<float>(a), opacity_);
    } else {
      pointer_a_.draw_at(msg, static_cast<float>(cx), static_cast<float>(cy), opacity_);
    }
  }
  if (flags_ & kFlagOverlay) draw_layer(msg, overlay_, px, py);
  if ((flags_ & kFlagHighlight) && highlighted_) draw_layer(msg, highlight_picture_, px, py);
  if ((flags_ & kFlagActive) && active_) draw_layer(msg, active_picture_, px, py);
  if ((flags_ & kFlagDragging) && behaviour_.get_state() == PotBehaviour::kDragging && button_held_)
    draw_layer(msg, dragging_, px, py);
  return 0;
}

}  // namespace guikit
