#pragma once

#include <cstdint>
#include <map>

#include "guikit/message_handler_interface.h"
#include "guikit/messages.h"
#include "guikit/rect.h"
#include "guikit/window_platform_interface.h"

namespace guikit {

class RenderingBufferInterface;
class TextLineEditorInterface;
class MenuInterface;

// The window's portable half: carries out upward messages (repaint requests,
// capture, timers, text input, menus), turns platform mouse events into
// messages and paints in tiles. Every platform window embeds one.
class WindowCore {
 public:
  explicit WindowCore(WindowPlatformInterface& platform) : platform_(platform) {}
  WindowCore(const WindowCore&) = delete;
  WindowCore& operator=(const WindowCore&) = delete;
  ~WindowCore();

  void set_background_root(MessageHandlerInterface* root) { background_root_ = root; }
  void set_control_root(MessageHandlerInterface* root) { control_root_ = root; }
  void set_editor_size(Size size) { editor_size_ = size; }
  Size get_editor_size() const { return editor_size_; }
  void set_line_editor(TextLineEditorInterface* editor) { line_editor_ = editor; }
  void set_menu(MenuInterface* menu) { menu_ = menu; }

  // Upward messages; everything else answers -1.
  int32_t process_message(MessageInterface& message);

  // Platform events.
  void mouse_move(int32_t x, int32_t y);
  void mouse_button(int32_t x, int32_t y, uint32_t buttons, uint32_t modifiers, uint32_t double_click);
  void capture_changed();
  // Drops the capture without telling its handler, which may already be gone.
  void forget_capture();
  void paint(const Rect& dirty, RenderingBufferInterface& buffer, Size window_size);
  void destroyed();
  // Stops and forgets every timer of this window.
  void close_timers();

  // The toolkit's timer procedure, for ticks of any window's platform timers.
  static void timer_tick(uintptr_t platform_id);

  MessageHandlerInterface* get_capture_handler() const { return capture_handler_; }
  int32_t get_capture_mode() const { return capture_mode_; }
  size_t get_timer_count() const { return timer_handlers_.size(); }

 private:
  int32_t on_capture(const MouseCapture& msg);
  int32_t on_release(const MouseRelease& msg);
  int32_t on_set_timer(const SetTimer& msg);
  int32_t on_clear_timer(const ClearTimer& msg);
  void notify_timer(int32_t toolkit_id);
  MessageHandlerInterface* mouse_target() const;
  void show_cursor_again();

  WindowPlatformInterface& platform_;
  MessageHandlerInterface* background_root_ = nullptr;
  MessageHandlerInterface* control_root_ = nullptr;
  Size editor_size_;
  TextLineEditorInterface* line_editor_ = nullptr;
  MenuInterface* menu_ = nullptr;

  MessageHandlerInterface* capture_handler_ = nullptr;
  int32_t capture_mode_ = 0;
  Point anchor_;
  Point last_raw_;
  uint64_t capture_thread_ = 0;
  uint32_t capture_start_ms_ = 0;
  uint32_t last_warp_ms_ = 0;
  bool cursor_hidden_ = false;
  std::map<int32_t, MessageHandlerInterface*> timer_handlers_;
};

}  // namespace guikit
