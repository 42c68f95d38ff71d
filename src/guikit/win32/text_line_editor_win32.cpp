#include "guikit/win32/text_line_editor_win32.h"

#include "guikit/messages.h"
#include "guikit/win32/module_instance_win32.h"

namespace guikit {

TextLineEditorWin32::~TextLineEditorWin32() {
  // Nobody is left to tell: destroy the field without a message.
  requester_ = nullptr;
  if (edit_) stop(false);
}

int32_t TextLineEditorWin32::start(const TextInputRequest& request) {
  if (edit_) stop(false);
  RECT owner_rect;
  if (!owner_ || !GetWindowRect(owner_, &owner_rect)) return -1;
  const int width = request.rect.width();
  const int height = request.rect.height();
  edit_ = CreateWindowExA(0, "EDIT", "", WS_POPUP | ES_AUTOHSCROLL | ES_CENTER, owner_rect.left + request.rect.left,
                          owner_rect.top + request.rect.top, width, height, owner_, nullptr, module_instance(),
                          nullptr);
  if (!edit_) return -1;
  // A character cell as high as the field (logical units are pixels here).
  font_ = CreateFontA(-height, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, nullptr);
  if (!font_) {
    fail_cleanup();
    return -1;
  }
  previous_procedure_ = reinterpret_cast<WNDPROC>(
      SetWindowLongPtrA(edit_, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(&TextLineEditorWin32::edit_procedure)));
  if (!previous_procedure_) {
    fail_cleanup();
    return -1;
  }
  SetWindowLongPtrA(edit_, GWLP_USERDATA, reinterpret_cast<LONG_PTR>(this));
  SendMessageA(edit_, WM_SETFONT, reinterpret_cast<WPARAM>(font_), FALSE);
  SetWindowTextA(edit_, request.text.c_str());
  SendMessageA(edit_, EM_SETSEL, 0, -1);
  requester_ = request.handler;
  accept_ = false;
  ending_ = false;
  active_ = true;
  ShowWindow(edit_, SW_SHOW);
  SetFocus(edit_);
  return 0;
}

void TextLineEditorWin32::fail_cleanup() {
  HWND edit = edit_;
  edit_ = nullptr;
  if (previous_procedure_) {
    SetWindowLongPtrA(edit, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(previous_procedure_));
    previous_procedure_ = nullptr;
  }
  SetWindowLongPtrA(edit, GWLP_USERDATA, 0);
  DestroyWindow(edit);
  if (font_) DeleteObject(font_);
  font_ = nullptr;
}

int32_t TextLineEditorWin32::stop(bool accept) {
  if (!edit_) {
    active_ = false;
    return -1;
  }
  accept_ = accept;
  ending_ = true;
  // Destruction reads the text and tells the requester (see finish).
  DestroyWindow(edit_);
  active_ = false;
  return 0;
}

bool TextLineEditorWin32::end_once(bool accept) {
  if (ending_) return false;
  stop(accept);
  return true;
}

void TextLineEditorWin32::finish(HWND hwnd) {
  char buffer[kMaxText + 1] = {0};
  const int n = GetWindowTextA(hwnd, buffer, kMaxText + 1);
  text_.assign(buffer, n > 0 ? static_cast<size_t>(n) : 0);
  if (font_) DeleteObject(font_);
  font_ = nullptr;
  // The control's own procedure sees the rest of its destruction.
  SetWindowLongPtrA(hwnd, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(previous_procedure_));
  SetWindowLongPtrA(hwnd, GWLP_USERDATA, 0);
  edit_ = nullptr;
  active_ = false;
  MessageHandlerInterface* requester = requester_;
  requester_ = nullptr;
  if (requester) {
    TextInputFinished finished(text_, accept_);
    requester->process_message(finished);
  }
}

LRESULT CALLBACK TextLineEditorWin32::edit_procedure(HWND hwnd, UINT message, WPARAM wparam, LPARAM lparam) {
  auto* editor = reinterpret_cast<TextLineEditorWin32*>(GetWindowLongPtrA(hwnd, GWLP_USERDATA));
  if (!editor) return DefWindowProcA(hwnd, message, wparam, lparam);
  return editor->on_message(hwnd, message, wparam, lparam);
}

LRESULT TextLineEditorWin32::on_message(HWND hwnd, UINT message, WPARAM wparam, LPARAM lparam) {
  const WNDPROC previous = previous_procedure_;
  switch (message) {
    case WM_CHAR:
      if (wparam == VK_RETURN && end_once(true)) return 0;
      if (wparam == VK_ESCAPE && end_once(false)) return 0;
      break;
    case WM_KILLFOCUS:
      if (end_once(true)) return 0;
      break;
    case WM_DESTROY:
      finish(hwnd);
      break;
    default:
      break;
  }
  return CallWindowProcA(previous, hwnd, message, wparam, lparam);
}

}  // namespace guikit
