#pragma once

#include "guikit/frame_control.h"

namespace guikit {

// A lamp: off/on from its value, or a display level while overridden; polls
// its listeners on a timer while visible.
class Diode : public FrameControl {
 public:
  void set_refresh_period(float seconds) { refresh_ = seconds; }
  void set_override(bool on) { override_ = on; }
  bool get_override() const { return override_; }
  void set_display_level(double level) { level_ = level; }
  double get_display_level() const { return level_; }
  double get_shown_level() const;

  void stop() override { stop_timer(); }
  void set_active(bool) override { invalidate_self(); }
  int32_t on_show_object(ShowObject& msg) override;
  int32_t on_notify(Notify& msg) override;
  int32_t on_redraw(Redraw& msg) override { return draw_layers(msg, get_shown_level()); }

 protected:
  // Recomputes the display level of an overridden lamp on each tick (the
  // meters fade it); nothing by default.
  virtual void update_level() {}

 private:
  float refresh_ = 0.05f;
  bool override_ = false;
  double level_ = 0.0;
};

}  // namespace guikit
