#pragma once

#include <windows.h>

#include <cstdint>
#include <string>

#include "guikit/window_core.h"
#include "guikit/window_interface.h"
#include "guikit/win32/menu_win32.h"
#include "guikit/win32/rendering_buffer_win32.h"
#include "guikit/win32/text_line_editor_win32.h"

namespace guikit {

// The editor's Win32 child window inside the host's parent window. The window
// procedure turns system messages into WindowCore events; WindowCore carries
// out the toolkit's upward messages through the platform operations below.
// Everything runs on the thread that opened the window.
class WindowWin32 : public WindowInterface, private WindowPlatformInterface {
 public:
  explicit WindowWin32(Size initial_size);
  WindowWin32(const WindowWin32&) = delete;
  WindowWin32& operator=(const WindowWin32&) = delete;
  ~WindowWin32() override;

  // WindowInterface
  int32_t process_message(MessageInterface& message) override { return core_.process_message(message); }
  int32_t open(void* parent) override;
  void close() override;
  void resize() override;
  void set_roots(MessageHandlerInterface* background, MessageHandlerInterface* controls) override;
  void set_editor_size(Size size) override;
  void set_window_size(Size size) override { window_size_ = size; }
  void set_can_resize(bool can_resize) override { can_resize_ = can_resize; }
  // The system delivers messages and timer ticks itself.
  void idle() override {}

  HWND get_handle() const { return hwnd_; }
  TextLineEditorWin32& line_editor() { return line_editor_; }
  WindowCore& core() { return core_; }

  // Process-wide: the class name of this module copy, whether it is registered
  // and how many editor windows are open.
  static const std::string& window_class_name();
  static bool is_class_registered();
  static int get_open_count();

 private:
  static LRESULT CALLBACK window_procedure(HWND hwnd, UINT message, WPARAM wparam, LPARAM lparam);
  LRESULT on_message(HWND hwnd, UINT message, WPARAM wparam, LPARAM lparam);
  void on_paint();
  void on_button(LPARAM lparam, WPARAM wparam, uint32_t double_click);
  Size current_size() const { return can_resize_ ? core_.get_editor_size() : window_size_; }

  // WindowPlatformInterface
  bool window_exists() const override { return hwnd_ != nullptr; }
  void invalidate_area(const Rect& rect) override;
  bool take_capture() override;
  bool holds_capture() const override;
  void release_capture() override;
  void show_cursor(bool show) override { ShowCursor(show ? TRUE : FALSE); }
  Point get_cursor() const override;
  void set_cursor(Point position) override;
  uint64_t current_thread() const override { return GetCurrentThreadId(); }
  uint32_t milliseconds() const override;
  bool start_timer(uint32_t period_ms, uintptr_t& platform_id) override;
  bool kill_timer(uintptr_t platform_id) override;
  void fill_face(const Rect& rect) override;

  WindowCore core_;
  RenderingBufferWin32 buffer_;
  TextLineEditorWin32 line_editor_;
  MenuWin32 menu_;
  HWND hwnd_ = nullptr;
  HWND parent_ = nullptr;
  HDC paint_dc_ = nullptr;
  Size window_size_;
  bool can_resize_ = false;
};

}  // namespace guikit
