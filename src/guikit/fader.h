#pragma once

#include "guikit/pot_interface.h"

namespace guikit {

// A linear pot: a cap that travels along a track, vertical (1 at the top) or
// horizontal (1 at the right). Clicking the cap drags it one to one with the
// mouse; clicking the track elsewhere spins the value towards the click.
class Fader : public PotInterface {
 public:
  enum FaderFlags : uint32_t { kFlagDragOverlay = 8, kFlagOverlay = 16 };

  explicit Fader(bool vertical = true) { set_orientation(vertical); }

  void set_orientation(bool vertical);
  bool is_vertical() const { return vertical_; }
  void set_travel_length(int32_t pixels) { length_ = pixels; }
  // -1: the travel length, so the cap follows the mouse.
  void set_drag_range(double pixels) { drag_range_ = pixels; }
  void set_cap(const Picture& cap) { cap_ = cap; }
  void set_active_cap(const Picture& cap) { set_active_picture(cap); }
  void set_drag_overlay(const Picture& p) { drag_overlay_ = p; flags_ |= kFlagDragOverlay; }
  void set_overlay(const Picture& p) { overlay_ = p; flags_ |= kFlagOverlay; }

  // The cap's offset along the track for the current value (fractional pixels).
  double cap_offset_x() const;
  double cap_offset_y() const;
  const AxisMatrix& get_axes() const { return axes_; }

  int32_t on_mouse_click(MouseClick& msg) override;
  int32_t on_mouse_move(MouseMove& msg) override;
  int32_t on_notify(Notify& msg) override;
  int32_t on_redraw(Redraw& msg) override;

 private:
  void place_release_point();
  Rect cap_rect() const;

  bool vertical_ = true;
  int32_t length_ = 200;
  double drag_range_ = -1.0;
  AxisMatrix axes_{0.0, -1.0, 1.0, 0.0};
  Picture cap_;
  Picture drag_overlay_;
  Picture overlay_;
};

}  // namespace guikit
