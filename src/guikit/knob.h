#pragma once

#include <vector>

#include "guikit/pot_interface.h"

namespace guikit {

// A rotary pot drawn from a strip of frames, with optional pointers. Value 0
// points to 225 degrees and value 1 to -45 degrees by default.
class Knob : public PotInterface {
 public:
  enum KnobFlags : uint32_t { kFlagPointerA = 1, kFlagDragging = 8, kFlagPointerB = 16, kFlagOverlay = 32 };

  void set_frames(const std::vector<Picture>& frames, double frame0_turns = 0.0, double turns_covered = 1.0);
  void set_rotate_frames(bool on) { rotate_frames_ = on; }
  void set_angles(double offset_turns, double span_turns) {
    angle_offset_ = offset_turns;
    angle_span_ = span_turns;
  }
  void set_drag_range(double pixels) { drag_range_ = pixels; }
  // Pointers ride on a circle of the radius about the centre (relative to the knob).
  void set_pointers(const Picture& a, const Picture& b, Point b_offset, Point centre, double radius, bool rotate);
  void set_overlay(const Picture& p) { overlay_ = p; flags_ |= kFlagOverlay; }
  void set_dragging_picture(const Picture& p) { dragging_ = p; flags_ |= kFlagDragging; }

  double get_angle() const;
  // The frame of the strip shown for the current value, and its sub-frame fraction.
  int32_t get_frame(double* fraction = nullptr) const;

  int32_t on_mouse_click(MouseClick& msg) override;
  int32_t on_mouse_move(MouseMove& msg) override;
  int32_t on_redraw(Redraw& msg) override;

 private:
  Rect zone_rect() const;

  std::vector<Picture> frames_;
  double frame0_turns_ = 0.0;
  double turns_covered_ = 1.0;
  bool rotate_frames_ = false;
  double angle_offset_ = 0.625;
  double angle_span_ = -0.75;
  double pointer_radius_ = 0.0;
  double drag_range_ = 200.0;
  Picture pointer_a_;
  Picture pointer_b_;
  Point pointer_b_offset_;
  Point centre_;
  bool rotate_pointers_ = false;
  Picture overlay_;
  Picture dragging_;
};

}  // namespace guikit
