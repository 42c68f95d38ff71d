#include "guikit/pot_behaviour.h"

#include <atomic>
#include <cmath>

#include "guikit/control_interface.h"
#include "guikit/messages.h"
#include "guikit/toolkit_clock.h"

namespace guikit {

namespace {

std::atomic<int32_t> g_mouse_compatibility{0};

constexpr double kPi = 3.141592653589793238463;
constexpr float kTickPeriod = 0.03f;
// Movement magnitudes follow the mouse almost at once, enough to damp jitter.
constexpr float kMagnitudeSmoothing = 0.9f;
// Axis hysteresis: leave the secondary axis above 67.5 degrees, enter it below 22.5.
constexpr double kToPrimaryAngle = 0.375 * kPi;
constexpr double kToSecondaryAngle = 0.125 * kPi;
// Secondary travel beyond this many pixels lets the target follow the position freely.
constexpr int32_t kSecondaryTravelFree = 16;
constexpr double kGlideRate = 3.0;
constexpr double kGlideClosing = 1.5;
constexpr double kGlideDone = 1e-6;
constexpr double kNoMagnetDistance = 999999.0;
constexpr double kMagnetPull = 3.0;
constexpr double kSpinUpLag = 64.0;
constexpr double kSpinStopLag = 1.0;
constexpr double kSpinGain = 8.0;
// A spin slower than this (value units per second) counts as stopped.
constexpr double kSpinAtRest = 1e-4;

double clamp01(double v) { return v < 0.0 ? 0.0 : (v > 1.0 ? 1.0 : v); }

}  // namespace

void PotBehaviour::set_mouse_compatibility(int32_t mode) { g_mouse_compatibility.store(mode, std::memory_order_relaxed); }
int32_t PotBehaviour::get_mouse_compatibility() { return g_mouse_compatibility.load(std::memory_order_relaxed); }

bool PotBehaviour::acquire(int32_t mode) {
  MouseCapture capture(mode, &pot_);
  if (pot_.process_message(capture) == 0) {
    captured_ = true;
    previous_time_ = toolkit_now();
    int32_t id = -1;
    SetTimer timer(kTickPeriod, &pot_, &id);
    if (pot_.process_message(timer) == 0) {
      timer_id_ = id;
      return true;
    }
  }
  stop();
  return false;
}

bool PotBehaviour::begin_drag() {
  stop();
  pending_ = false;
  state_ = kDragging;
  first_move_ = true;
  axis_mode_ = 0;
  secondary_travel_ = 0;
  primary_magnitude_ = 0.0f;
  secondary_magnitude_ = 0.0f;
  previous_distance_ = 0.0;
  int32_t mode = get_mouse_compatibility() == 1 ? 0 : 2;
  relative_ = mode == 2;
  if (!acquire(mode)) return false;
  position_ = pot_.get_value();
  target_ = position_;
  moving_ = false;
  return true;
}

bool PotBehaviour::begin_spin(double velocity) {
  stop();
  pending_ = false;
  state_ = kSpinning;
  relative_ = false;
  spin_velocity_ = velocity;
  actual_velocity_ = 0.0;
  if (!acquire(0)) return false;
  moving_ = true;
  return true;
}

double PotBehaviour::snap(double position) const {
  if (!magnets_ || magnets_->empty()) return position;
  double p = clamp01(position);
  double t = target_;
  double reference = (t >= 0.0 && t <= 1.0) ? std::fabs(p - t) : kNoMagnetDistance;
  size_t nearest = 0;
  for (size_t i = 1; i < magnets_->size(); ++i) {
    if (std::fabs(p - (*magnets_)[i]) < std::fabs(p - (*magnets_)[nearest])) nearest = i;
  }
  double m = (*magnets_)[nearest];
  return kMagnetPull * std::fabs(p - m) < reference ? m : t;
}

double PotBehaviour::drag_move(Point raw, const AxisMatrix& axes, double range, double secondary_factor) {
  if (first_move_) {
    last_raw_ = raw;
    first_move_ = false;
  }
  double mx = raw.x;
  double my = raw.y;
  if (!relative_) {
    mx = raw.x - last_raw_.x;
    my = raw.y - last_raw_.y;
    last_raw_ = raw;
  }
  double primary = axes.m00 * mx + axes.m01 * my;
  double secondary = axes.m10 * mx + axes.m11 * my;

  primary_magnitude_ += (static_cast<float>(std::fabs(primary)) - primary_magnitude_) * kMagnitudeSmoothing;
  secondary_magnitude_ += (static_cast<float>(std::fabs(secondary)) - secondary_magnitude_) * kMagnitudeSmoothing;
  double theta = std::fabs(secondary_magnitude_) < 1e-9 ? kPi : std::atan(primary_magnitude_ / secondary_magnitude_);
  if (axis_mode_ == 1) {
    if (theta >= kToPrimaryAngle) {
      axis_mode_ = 0;
      secondary_travel_ = 0;
    }
  } else if (theta < kToSecondaryAngle) {
    axis_mode_ = 1;
  }

  double delta = primary;
  if (axis_mode_ == 1) {
    delta = secondary * secondary_factor;
    int32_t before = secondary_travel_;
    secondary_travel_ += static_cast<int32_t>(std::fabs(secondary));
    if (before <= kSecondaryTravelFree && secondary_travel_ > kSecondaryTravelFree) position_ = target_;
  }
  delta /= range;

  // Overshoot is kept while moving outwards and forgotten as soon as the movement turns back.
  if (position_ > 1.0 && delta < 0.0) {
    position_ = 1.0 + delta;
  } else if (position_ < 0.0 && delta > 0.0) {
    position_ = delta;
  } else {
    position_ += delta;
  }
  target_ = secondary_travel_ > kSecondaryTravelFree ? position_ : snap(position_);
  return glide_step(toolkit_now());
}

double PotBehaviour::glide_step(double now) {
  double value = pot_.get_value();
  double dt = now - previous_time_;
  double d = target_ - value;
  double distance = std::fabs(d);
  if (distance <= kGlideDone) {
    value = target_;
  } else {
    double k = kGlideRate;
    // The target is closing in fast: speed up so the value does not lag behind.
    if (kGlideClosing * distance < previous_distance_) k = kGlideRate * previous_distance_ / distance;
    value += d * (1.0 - std::exp(-2.0 * kPi * k * dt));
  }
  value = clamp01(value);
  previous_distance_ = distance;
  previous_time_ = now;
  moving_ = value != clamp01(target_);
  return value;
}

void PotBehaviour::request_spin(double velocity) {
  spin_velocity_ = velocity;
  pending_ = true;
}

double PotBehaviour::spin_step(double now) {
  double value = pot_.get_value();
  double dt = now - previous_time_;
  double r = spin_velocity_;
  if (pending_ && std::fabs(r) >= 1e-9) {
    actual_velocity_ = r;
  } else {
    double lag = r != 0.0 ? kSpinUpLag : kSpinStopLag;
    actual_velocity_ += (kSpinGain * r - kSpinGain * actual_velocity_) / lag * dt;
  }
  pending_ = false;
  double next = clamp01(value + actual_velocity_ * dt);
  previous_time_ = now;
  moving_ = next != value && std::fabs(actual_velocity_) >= kSpinAtRest;
  return next;
}

void PotBehaviour::release() {
  if (state_ == kSpinning) spin_velocity_ = 0.0;
  if (!captured_) return;
  captured_ = false;
  Point p = pot_.get_position();
  MouseRelease message(&pot_, Point{p.x + release_offset_.x, p.y + release_offset_.y});
  pot_.process_message(message);
}

void PotBehaviour::stop() {
  if (timer_id_ >= 0) {
    ClearTimer clear(timer_id_);
    timer_id_ = -1;
    pot_.process_message(clear);
  }
  release();
  state_ = kIdle;
  pending_ = false;
}

}  // namespace guikit
