#pragma once

#include <windows.h>

#include <cstdint>
#include <string>

#include "guikit/rect.h"
#include "guikit/text_line_editor_interface.h"

namespace guikit {

class MessageHandlerInterface;

// The one-line editor over the editor window: a borderless system "EDIT"
// pop-up whose procedure we take over to end it on Return, Escape or loss of
// focus. Its destruction hands the text to the control that asked.
class TextLineEditorWin32 : public TextLineEditorInterface {
 public:
  static constexpr int kMaxText = 1023;

  TextLineEditorWin32() = default;
  TextLineEditorWin32(const TextLineEditorWin32&) = delete;
  TextLineEditorWin32& operator=(const TextLineEditorWin32&) = delete;
  ~TextLineEditorWin32() override;

  void set_owner(HWND owner) { owner_ = owner; }
  int32_t start(const TextInputRequest& request) override;
  int32_t stop(bool accept) override;
  bool is_active() const override { return active_; }

  const std::string& get_text() const { return text_; }
  // The edit window while active (tests type into it).
  HWND get_edit_window() const { return edit_; }

 private:
  static LRESULT CALLBACK edit_procedure(HWND hwnd, UINT message, WPARAM wparam, LPARAM lparam);
  LRESULT on_message(HWND hwnd, UINT message, WPARAM wparam, LPARAM lparam);
  // Return, Escape and focus loss end the edit once.
  bool end_once(bool accept);
  void finish(HWND hwnd);
  void fail_cleanup();

  std::string text_;
  HWND edit_ = nullptr;
  WNDPROC previous_procedure_ = nullptr;
  HFONT font_ = nullptr;
  HWND owner_ = nullptr;
  bool accept_ = false;
  bool ending_ = false;
  bool active_ = false;
  MessageHandlerInterface* requester_ = nullptr;
};

}  // namespace guikit
