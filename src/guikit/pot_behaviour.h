#pragma once

#include <cstdint>
#include <vector>

#include "guikit/rect.h"

namespace guikit {

class ControlInterface;

// Turns a mouse movement (dx, dy) into (primary, secondary) movement along a pot's axes.
struct AxisMatrix {
  double m00, m01, m10, m11;
};

// The gesture engine of every pot: capture and timer, drag with axis
// hysteresis, magnets and edge restart, the first-order glide towards the
// target, spinning, and release. It computes values; the pot sends them.
class PotBehaviour {
 public:
  enum State : int32_t { kIdle = 0, kDragging = 1, kSpinning = 2 };

  explicit PotBehaviour(ControlInterface& pot) : pot_(pot) {}

  // Process-wide: 1 = the compatible mouse mode (visible cursor, absolute positions).
  static void set_mouse_compatibility(int32_t mode);
  static int32_t get_mouse_compatibility();

  // Both answer false, leaving nothing half-started, when capture or timer is refused.
  bool begin_drag();
  bool begin_spin(double velocity);

  // One mouse move while dragging; answers the value after the immediate glide step.
  double drag_move(Point raw, const AxisMatrix& axes, double range, double secondary_factor);
  // A new spin speed asked for by the mouse, applied at the next tick.
  void request_spin(double velocity);
  // One timer step of each motion; both answer the new value.
  double glide_step(double now);
  double spin_step(double now);

  // Gives the capture back, the cursor going to pot position + release offset.
  void release();
  void stop();
  void capture_lost() { captured_ = false; }

  void set_magnets(const std::vector<double>* magnets) { magnets_ = magnets; }
  void set_release_offset(Point offset) { release_offset_ = offset; }
  Point get_release_offset() const { return release_offset_; }

  int32_t get_state() const { return state_; }
  int32_t get_timer_id() const { return timer_id_; }
  bool is_captured() const { return captured_; }
  bool is_moving() const { return moving_; }
  bool is_relative() const { return relative_; }
  double get_target() const { return target_; }
  double get_position() const { return position_; }
  int32_t get_axis_mode() const { return axis_mode_; }
  double get_requested_velocity() const { return spin_velocity_; }
  double get_actual_velocity() const { return actual_velocity_; }

 private:
  bool acquire(int32_t mode);
  double snap(double position) const;

  ControlInterface& pot_;
  double previous_distance_ = 0.0;
  double position_ = 0.0;
  double target_ = 0.0;
  int32_t axis_mode_ = 0;
  float primary_magnitude_ = 0.0f;
  float secondary_magnitude_ = 0.0f;
  int32_t secondary_travel_ = 0;
  bool first_move_ = true;
  Point last_raw_;
  double spin_velocity_ = 0.0;
  double actual_velocity_ = 0.0;
  bool pending_ = false;
  double previous_time_ = 0.0;
  const std::vector<double>* magnets_ = nullptr;
  Point release_offset_;
  int32_t timer_id_ = -1;
  int32_t state_ = kIdle;
  bool captured_ = false;
  bool moving_ = false;
  bool relative_ = false;
};

}  // namespace guikit
