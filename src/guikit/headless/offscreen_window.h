#pragma once

#include <cstdint>
#include <vector>

#include "guikit/headless/manual_clock.h"
#include "guikit/headless/offscreen_line_editor.h"
#include "guikit/headless/offscreen_menu.h"
#include "guikit/memory_rendering_buffer.h"
#include "guikit/window_core.h"
#include "guikit/window_interface.h"

namespace guikit {

// An editor window without a display. It paints into memory, keeps time by
// hand (timers fire as the clock is advanced), simulates the cursor, mouse
// capture and relative mode, and takes synthetic mouse events. While it exists
// its clock is the toolkit's clock.
class OffscreenWindow : public WindowInterface, private WindowPlatformInterface {
 public:
  static constexpr uint32_t kFaceColour = 0x00D4D0C8;

  // tile: the rendering buffer's size (0 = the editor size); repaints go in tiles of it.
  explicit OffscreenWindow(Size editor_size, Size tile = Size{0, 0});
  ~OffscreenWindow() override;

  // WindowInterface
  int32_t process_message(MessageInterface& message) override { return core_.process_message(message); }
  int32_t open(void* parent) override;
  void close() override;
  void resize() override {}
  void set_roots(MessageHandlerInterface* background, MessageHandlerInterface* controls) override;
  void set_editor_size(Size size) override;
  void set_window_size(Size size) override { window_size_ = size; }
  void set_can_resize(bool can_resize) override { can_resize_ = can_resize; }
  void idle() override {}
  // The size the window took when it was last opened.
  Size get_open_size() const { return open_size_; }
  bool is_open() const { return open_; }

  // Synthetic mouse events, positions in window pixels.
  void mouse_move(int32_t x, int32_t y);
  void move_by(int32_t dx, int32_t dy) { mouse_move(cursor_.x + dx, cursor_.y + dy); }
  void button_down(uint32_t button = kButtonLeft, uint32_t modifiers = 0);
  void button_up(uint32_t button = kButtonLeft, uint32_t modifiers = 0);
  void double_click(uint32_t button = kButtonLeft);
  void click_at(int32_t x, int32_t y) {
    mouse_move(x, y);
    button_down();
  }
  // Another program takes the mouse.
  void lose_capture();

  // Time: timers due on the way fire in order, each at its own instant.
  void advance_ms(uint32_t ms);
  uint32_t now_ms() const { return clock_.now_ms(); }

  // Painting: the pending invalid area, or everything.
  void paint_pending();
  void paint_all();
  void paint(const Rect& area);
  uint32_t pixel(int32_t x, int32_t y) const;
  const std::vector<Rect>& get_invalidated() const { return invalidated_; }
  void clear_invalidated() { invalidated_.clear(); }
  int get_tile_count() const { return tile_buffer_.blit_count(); }

  // What the simulation shows.
  Point get_cursor() const override { return cursor_; }
  bool is_cursor_hidden() const { return cursor_hide_count_ > 0; }
  bool has_capture() const { return captured_; }
  uint32_t held_buttons() const { return buttons_; }
  size_t get_running_timer_count() const { return timers_.size(); }
  void refuse_capture(bool refuse) { refuse_capture_ = refuse; }
  void refuse_timers(bool refuse) { refuse_timers_ = refuse; }

  WindowCore& core() { return core_; }
  OffscreenLineEditor& line_editor() { return line_editor_; }
  OffscreenMenu& menu() { return menu_; }

 private:
  // The buffer's blit puts the tile on the simulated screen.
  class TileBuffer : public MemoryRenderingBuffer {
   public:
    TileBuffer(OffscreenWindow& owner, Size size) : MemoryRenderingBuffer(size.width, size.height), owner_(owner) {}
    void blit(Point position, Size size) override;

   private:
    OffscreenWindow& owner_;
  };
  struct Timer {
    uintptr_t platform_id;
    uint32_t period_ms;
    uint32_t due_ms;
  };

  // WindowPlatformInterface
  bool window_exists() const override { return open_; }
  void invalidate_area(const Rect& rect) override;
  bool take_capture() override;
  bool holds_capture() const override { return captured_; }
  void release_capture() override;
  void show_cursor(bool show) override { cursor_hide_count_ += show ? -1 : 1; }
  void set_cursor(Point position) override { cursor_ = position; }
  uint64_t current_thread() const override;
  uint32_t milliseconds() const override { return clock_.now_ms(); }
  bool start_timer(uint32_t period_ms, uintptr_t& platform_id) override;
  bool kill_timer(uintptr_t platform_id) override;
  void fill_face(const Rect& rect) override;

  ManualClock clock_;
  ClockInterface* previous_clock_;
  WindowCore core_;
  OffscreenLineEditor line_editor_;
  OffscreenMenu menu_;
  Size editor_size_;
  Size window_size_;
  Size tile_size_;
  TileBuffer tile_buffer_;
  std::vector<uint32_t> screen_;
  bool open_ = true;
  bool can_resize_ = false;
  Size open_size_;
  Point cursor_;
  int cursor_hide_count_ = 0;
  bool captured_ = false;
  bool refuse_capture_ = false;
  bool refuse_timers_ = false;
  uint32_t buttons_ = 0;
  std::vector<Timer> timers_;
  std::vector<Rect> invalidated_;
  Rect pending_;
};

}  // namespace guikit
