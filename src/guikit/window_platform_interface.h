#pragma once

#include <cstdint>

#include "guikit/rect.h"

namespace guikit {

// What the portable window logic asks of a platform window. Positions are
// relative to the window's top-left corner.
class WindowPlatformInterface {
 public:
  virtual ~WindowPlatformInterface() = default;
  virtual bool window_exists() const = 0;
  // Repaint later, without erasing.
  virtual void invalidate_area(const Rect& rect) = 0;
  // Answers whether the window holds the capture afterwards.
  virtual bool take_capture() = 0;
  virtual bool holds_capture() const = 0;
  // Giving the capture back reports capture_changed to the window logic.
  virtual void release_capture() = 0;
  virtual void show_cursor(bool show) = 0;
  virtual Point get_cursor() const = 0;
  virtual void set_cursor(Point position) = 0;
  virtual uint64_t current_thread() const = 0;
  virtual uint32_t milliseconds() const = 0;
  // A timer whose ticks go to WindowCore::timer_tick(platform_id).
  virtual bool start_timer(uint32_t period_ms, uintptr_t& platform_id) = 0;
  virtual bool kill_timer(uintptr_t platform_id) = 0;
  // The window's area outside the editor, in the dialog-face colour.
  virtual void fill_face(const Rect& rect) = 0;
};

}  // namespace guikit
