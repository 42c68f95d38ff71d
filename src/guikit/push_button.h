#pragma once

#include "guikit/frame_control.h"

namespace guikit {

// Flashes through its frames when pressed: up to the last frame at half the
// flash time, back to the first at its end.
class PushButton : public FrameControl {
 public:
  PushButton() { frames_.resize(2); }
  void set_flash_duration(double seconds) { duration_ = seconds; }
  double get_flash_position() const { return flash_; }

  void stop() override { stop_timer(); }
  void set_active(bool) override { invalidate_self(); }
  int32_t on_mouse_click(MouseClick& msg) override;
  int32_t on_notify(Notify& msg) override;
  int32_t on_redraw(Redraw& msg) override { return draw_layers(msg, flash_); }

 private:
  double duration_ = 0.1;
  double press_time_ = 0.0;
  double flash_ = 0.0;
};

// A two-state switch that cross-fades between its frames over a transition time.
class FlipFlop : public FrameControl {
 public:
  FlipFlop() { frames_.resize(2); }
  void set_transition_time(double seconds) { transition_ = seconds; }
  // The displayed state: the value, or the fade position while a transition runs.
  double get_display_position() const;

  void stop() override { stop_timer(); }
  int32_t on_mouse_click(MouseClick& msg) override;
  int32_t on_notify(Notify& msg) override;
  int32_t on_redraw(Redraw& msg) override { return draw_layers(msg, get_display_position()); }

 private:
  double transition_ = 0.0;
  double start_time_ = 0.0;
  double fade_ = 0.0;
};

}  // namespace guikit
