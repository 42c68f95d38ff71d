#pragma once

#include <X11/Xlib.h>

#include <cstdint>
#include <memory>
#include <vector>

#include "guikit/linux/menu_x11.h"
#include "guikit/linux/rendering_buffer_x11.h"
#include "guikit/linux/text_line_editor_x11.h"
#include "guikit/linux/x11_owner_interface.h"
#include "guikit/window_core.h"
#include "guikit/window_interface.h"

namespace guikit {

// The editor window on an X server: a child of the host's window on a display
// connection of its own. Nothing runs by itself: the host's idle call pumps the
// X events, fires the timers and repaints, all on the user-interface thread.
class WindowX11 : public WindowInterface, private WindowPlatformInterface, private X11OwnerInterface {
 public:
  static constexpr uint32_t kFaceColour = 0x00D4D0C8;
  // Two presses of one button this close in time and space make a double-click.
  static constexpr unsigned long kDoubleClickMs = 400;
  static constexpr int kDoubleClickDistance = 4;

  explicit WindowX11(Size initial_size);
  ~WindowX11() override;
  WindowX11(const WindowX11&) = delete;
  WindowX11& operator=(const WindowX11&) = delete;

  // WindowInterface. parent: the host's X window id; null makes a top-level window.
  int32_t process_message(MessageInterface& message) override { return core_.process_message(message); }
  int32_t open(void* parent) override;
  void close() override;
  void resize() override;
  void set_roots(MessageHandlerInterface* background, MessageHandlerInterface* controls) override;
  void set_editor_size(Size size) override;
  void set_window_size(Size size) override { window_size_ = size; }
  void set_can_resize(bool can_resize) override { can_resize_ = can_resize; }
  void idle() override;

  bool is_open() const { return window_ != 0; }
  Window get_x_window() const { return window_; }
  Display* get_x_display() const { return display_; }
  Size get_open_size() const { return open_size_; }
  TextLineEditorX11& line_editor() { return line_editor_; }
  MenuX11& menu() { return menu_; }
  WindowCore& core() { return core_; }

  // Windows open in this process.
  static int get_open_count();

 private:
  struct Timer {
    uintptr_t platform_id;
    unsigned long period_ms;
    unsigned long due_ms;
  };

  // WindowPlatformInterface
  bool window_exists() const override { return window_ != 0; }
  void invalidate_area(const Rect& rect) override;
  bool take_capture() override;
  bool holds_capture() const override { return captured_; }
  void release_capture() override;
  void show_cursor(bool show) override;
  Point get_cursor() const override;
  void set_cursor(Point position) override;
  uint64_t current_thread() const override;
  uint32_t milliseconds() const override;
  bool start_timer(uint32_t period_ms, uintptr_t& platform_id) override;
  bool kill_timer(uintptr_t platform_id) override;
  void fill_face(const Rect& rect) override;

  // X11OwnerInterface
  Display* get_display() const override { return display_; }
  Window get_window() const override { return window_; }
  void service() override;
  void dispatch_event(XEvent& event) override;

  void on_button(const XButtonEvent& event, bool press);
  void paint_pending();
  void run_timers();
  void lose_grab();
  void destroy_window();

  WindowCore core_;
  TextLineEditorX11 line_editor_;
  MenuX11 menu_;
  RenderingBufferX11 buffer_;
  Display* display_ = nullptr;
  Window window_ = 0;
  GC gc_ = nullptr;
  Cursor invisible_cursor_ = 0;
  Size window_size_;
  Size open_size_;
  bool can_resize_ = false;
  bool captured_ = false;
  bool cursor_hidden_ = false;
  uint32_t held_buttons_ = 0;
  Rect pending_;
  std::vector<Timer> timers_;
  // The last press, for double-clicks.
  unsigned int last_press_button_ = 0;
  Time last_press_time_ = 0;
  Point last_press_;
  bool in_idle_ = false;
};

}  // namespace guikit
