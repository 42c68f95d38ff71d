#pragma once

#include <X11/Xlib.h>

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "guikit/font_interface.h"
#include "guikit/linux/rendering_buffer_x11.h"
#include "guikit/rect.h"

namespace sys {

class DialogWindowX11;

// What one of the built-in dialogs shows and how it answers the user.
class DialogContentInterface {
 public:
  virtual ~DialogContentInterface() = default;
  virtual void paint(DialogWindowX11& window) = 0;
  // keysym as XLookupString gives it, chars the text the key types (may be empty).
  virtual void key(unsigned long keysym, const std::string& chars) = 0;
  virtual void press(int x, int y) = 0;
  virtual void release(int x, int y) = 0;
  // The window manager's close button.
  virtual void close_requested() = 0;
  virtual bool finished() const = 0;
};

// Breaks text into lines no wider than max_width: line feeds always break, words
// move to the next line when they do not fit, a word wider than a line is cut
// between characters. Blanks at a break are dropped.
std::vector<std::string> wrap_text(const std::string& text, int max_width,
                                   const std::function<int(const std::string&)>& width);

// A centred top-level window of its own display connection, for the dialogs shown
// when the desktop has no dialog program. It paints with the skin's bitmap fonts
// into a pixel buffer, or with the server's core font where that cannot be had.
class DialogWindowX11 {
 public:
  DialogWindowX11() = default;
  ~DialogWindowX11();
  DialogWindowX11(const DialogWindowX11&) = delete;
  DialogWindowX11& operator=(const DialogWindowX11&) = delete;

  // Opens the display and the fonts; false when there is no display.
  bool connect();
  // Creates, centres, titles and shows the window, in front and with the focus.
  bool create(const std::string& title, guikit::Size size);
  // The modal loop: events until the content is finished.
  void run(DialogContentInterface& content);

  // Drawing, in window pixels; colours are 0x00RRGGBB.
  void fill(const guikit::Rect& r, uint32_t colour);
  void frame(const guikit::Rect& r, uint32_t colour, int thickness = 1);
  // One line, left-aligned from the box's top-left, cut to the box.
  void text(const guikit::Rect& box, const std::string& line, uint32_t colour, bool bold = false);
  int text_width(const std::string& line, bool bold = false) const;
  int line_height(bool bold = false) const;

 private:
  void paint(DialogContentInterface& content);
  void handle(XEvent& event, DialogContentInterface& content);
  void take_focus();

  Display* display_ = nullptr;
  Window window_ = 0;
  GC gc_ = nullptr;
  Atom delete_atom_ = 0;
  guikit::Size size_;
  bool pixels_ = false;  // drawing into buffer_ with fonts_, else straight to the window
  guikit::RenderingBufferX11 buffer_;
  std::unique_ptr<guikit::FontInterface> fonts_[2];  // regular, bold
  XFontStruct* core_font_ = nullptr;
};

}  // namespace sys
