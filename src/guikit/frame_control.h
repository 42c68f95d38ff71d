#pragma once

#include <cstdint>
#include <vector>

#include "guikit/control_interface.h"

namespace guikit {

// Shared by the controls drawn as background, one frame of a strip, foreground:
// the slots, the flags word and a timer the control owns.
class FrameControl : public ControlInterface {
 public:
  enum Flags : uint32_t { kDrawBackground = 1, kDrawForeground = 2 };

  void set_background(const Picture& p) { background_ = p; flags_ |= kDrawBackground; }
  void set_foreground(const Picture& p) { foreground_ = p; flags_ |= kDrawForeground; }
  void set_frames(const std::vector<Picture>& frames) { frames_ = frames; }
  void set_flags(uint32_t flags) { flags_ = flags; }
  int32_t get_timer_id() const { return timer_id_; }
  // The frame shown for a position 0..1: round((count - 1) x position).
  int32_t frame_for(double position) const;

 protected:
  int32_t draw_layers(Redraw& msg, double position);
  // Starts a timer for this control; false (and no id) when refused.
  bool start_timer(float period);
  void stop_timer();

  Picture background_;
  Picture foreground_;
  std::vector<Picture> frames_;
  uint32_t flags_ = 0;
  int32_t timer_id_ = -1;
};

}  // namespace guikit
