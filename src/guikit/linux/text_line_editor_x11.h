#pragma once

#include <X11/Xlib.h>

#include <string>

#include "guikit/rect.h"
#include "guikit/text_line_editor_interface.h"

namespace guikit {

class MessageHandlerInterface;
class X11OwnerInterface;

// One line of text edited in an undecorated window laid over the text box: the
// whole text selected at first (typing replaces it), a caret, Left/Right, Home/End,
// BackSpace and Delete. Return or a loss of focus accepts, Escape drops; the
// requester then gets a TextInputFinished.
class TextLineEditorX11 : public TextLineEditorInterface {
 public:
  static constexpr size_t kMaxText = 1023;

  TextLineEditorX11() = default;
  ~TextLineEditorX11() override { abandon(); }
  TextLineEditorX11(const TextLineEditorX11&) = delete;
  TextLineEditorX11& operator=(const TextLineEditorX11&) = delete;

  void set_owner(X11OwnerInterface* owner) { owner_ = owner; }

  int32_t start(const TextInputRequest& request) override;
  int32_t stop(bool accept) override;
  bool is_active() const override { return window_ != 0; }

  // Ends without telling the requester (its window is going away).
  void abandon();
  bool owns(Window window) const { return window_ != 0 && window == window_; }
  void handle_event(XEvent& event);

  const std::string& get_text() const { return text_; }
  Window get_x_window() const { return window_; }
  size_t get_caret() const { return caret_; }
  bool is_all_selected() const { return all_selected_; }

 private:
  void draw();
  void key(XKeyEvent& event);
  void insert(char c);
  void destroy_window();

  X11OwnerInterface* owner_ = nullptr;
  Display* display_ = nullptr;
  Window window_ = 0;
  GC gc_ = nullptr;
  XFontStruct* font_ = nullptr;
  Size size_;
  std::string text_;
  size_t caret_ = 0;
  bool all_selected_ = false;
  MessageHandlerInterface* requester_ = nullptr;
};

}  // namespace guikit
