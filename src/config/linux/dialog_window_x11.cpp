#include "config/linux/dialog_window_x11.h"

#include <X11/Xatom.h>
#include <X11/Xutil.h>
#include <poll.h>

#include <chrono>

#include "guikit/font_factory.h"
#include "guikit/linux/x11_owner_interface.h"
#include "guikit/text.h"

namespace sys {

namespace {

constexpr int kPollMs = 50;
constexpr long kEventMask =
    ExposureMask | KeyPressMask | ButtonPressMask | ButtonReleaseMask | StructureNotifyMask | FocusChangeMask;

// The longest prefix of word (at least one character) that fits max_width.
size_t fitting_prefix(const std::string& word, int max_width, const std::function<int(const std::string&)>& width) {
  size_t n = 1;
  while (n < word.size() && width(word.substr(0, n + 1)) <= max_width) ++n;
  return n;
}

void wrap_paragraph(const std::string& paragraph, int max_width, const std::function<int(const std::string&)>& width,
                    std::vector<std::string>& lines) {
  std::string line;
  size_t pos = 0;
  bool any = false;
  while (pos < paragraph.size()) {
    if (paragraph[pos] == ' ') {
      ++pos;
      continue;
    }
    size_t end = paragraph.find(' ', pos);
    if (end == std::string::npos) end = paragraph.size();
    std::string word = paragraph.substr(pos, end - pos);
    pos = end;
    std::string joined = line.empty() ? word : line + " " + word;
    if (width(joined) <= max_width) {
      line = joined;
      continue;
    }
    if (!line.empty()) {
      lines.push_back(line);
      any = true;
      line.clear();
    }
    while (width(word) > max_width && word.size() > 1) {
      const size_t n = fitting_prefix(word, max_width, width);
      lines.push_back(word.substr(0, n));
      any = true;
      word.erase(0, n);
    }
    line = word;
  }
  if (!line.empty() || !any) lines.push_back(line);
}

}  // namespace

std::vector<std::string> wrap_text(const std::string& text, int max_width,
                                   const std::function<int(const std::string&)>& width) {
  std::vector<std::string> lines;
  size_t start = 0;
  for (;;) {
    size_t end = text.find('\n', start);
    std::string paragraph = text.substr(start, end == std::string::npos ? std::string::npos : end - start);
    if (!paragraph.empty() && paragraph.back() == '\r') paragraph.pop_back();
    wrap_paragraph(paragraph, max_width, width, lines);
    if (end == std::string::npos) break;
    start = end + 1;
  }
  return lines;
}

DialogWindowX11::~DialogWindowX11() {
  if (!display_) return;
  buffer_.destroy();
  if (core_font_) XFreeFont(display_, core_font_);
  if (gc_) XFreeGC(display_, gc_);
  if (window_) XDestroyWindow(display_, window_);
  XCloseDisplay(display_);
}

bool DialogWindowX11::connect() {
  display_ = guikit::open_x_display();
  if (!display_) return false;
  fonts_[0] = guikit::FontFactory::instance().create_font("font_03");
  fonts_[1] = guikit::FontFactory::instance().create_font("font_04");
  // Our pixels need a true-colour visual with 8-bit fields; the core font path draws on any.
  const Visual* visual = DefaultVisual(display_, DefaultScreen(display_));
  const bool true_colour =
      visual->red_mask == 0xFF0000u && visual->green_mask == 0x00FF00u && visual->blue_mask == 0x0000FFu;
  pixels_ = fonts_[0] && fonts_[1] && true_colour;
  if (!pixels_) core_font_ = guikit::load_ui_font(display_);
  return true;
}

bool DialogWindowX11::create(const std::string& title, guikit::Size size) {
  if (!display_ || size.width <= 0 || size.height <= 0) return false;
  const int screen = DefaultScreen(display_);
  Visual* visual = DefaultVisual(display_, screen);
  const int depth = DefaultDepth(display_, screen);
  if (pixels_ && !buffer_.create(display_, visual, depth, size)) return false;
  const int x = (DisplayWidth(display_, screen) - size.width) / 2;
  const int y = (DisplayHeight(display_, screen) - size.height) / 2;
  guikit::X11ErrorTrap trap(display_);
  XSetWindowAttributes attributes{};
  attributes.background_pixel = WhitePixel(display_, screen);
  attributes.border_pixel = 0;
  attributes.event_mask = kEventMask;
  window_ = XCreateWindow(display_, RootWindow(display_, screen), x > 0 ? x : 0, y > 0 ? y : 0,
                          static_cast<unsigned>(size.width), static_cast<unsigned>(size.height), 0, CopyFromParent,
                          InputOutput, CopyFromParent, CWBackPixel | CWBorderPixel | CWEventMask, &attributes);
  if (trap.failed() || window_ == 0) {
    window_ = 0;
    return false;
  }
  size_ = size;
  gc_ = XCreateGC(display_, window_, 0, nullptr);
  if (core_font_) XSetFont(display_, gc_, core_font_->fid);
  buffer_.set_target(window_, gc_);

  XStoreName(display_, window_, title.c_str());
  const Atom utf8 = XInternAtom(display_, "UTF8_STRING", False);
  XChangeProperty(display_, window_, XInternAtom(display_, "_NET_WM_NAME", False), utf8, 8, PropModeReplace,
                  reinterpret_cast<const unsigned char*>(title.data()), static_cast<int>(title.size()));
  delete_atom_ = XInternAtom(display_, "WM_DELETE_WINDOW", False);
  XSetWMProtocols(display_, window_, &delete_atom_, 1);
  // A fixed-size dialog placed where we put it, asking for the keyboard.
  XSizeHints* hints = XAllocSizeHints();
  hints->flags = PPosition | PSize | PMinSize | PMaxSize;
  hints->x = x;
  hints->y = y;
  hints->width = hints->min_width = hints->max_width = size.width;
  hints->height = hints->min_height = hints->max_height = size.height;
  XSetWMNormalHints(display_, window_, hints);
  XFree(hints);
  XWMHints wm{};
  wm.flags = InputHint;
  wm.input = True;
  XSetWMHints(display_, window_, &wm);
  Atom type = XInternAtom(display_, "_NET_WM_WINDOW_TYPE_DIALOG", False);
  XChangeProperty(display_, window_, XInternAtom(display_, "_NET_WM_WINDOW_TYPE", False), XA_ATOM, 32,
                  PropModeReplace, reinterpret_cast<unsigned char*>(&type), 1);
  // No owner window to stack over: ask to be kept above the others, and raise.
  Atom above = XInternAtom(display_, "_NET_WM_STATE_ABOVE", False);
  XChangeProperty(display_, window_, XInternAtom(display_, "_NET_WM_STATE", False), XA_ATOM, 32, PropModeReplace,
                  reinterpret_cast<unsigned char*>(&above), 1);
  XMapRaised(display_, window_);

  // Focus needs a viewable window; a window manager may take a moment to map it.
  const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(2);
  XEvent event;
  bool mapped = false;
  while (!mapped && std::chrono::steady_clock::now() < end) {
    if (XCheckTypedWindowEvent(display_, window_, MapNotify, &event)) {
      mapped = true;
    } else {
      pollfd p{ConnectionNumber(display_), POLLIN, 0};
      poll(&p, 1, 10);
    }
  }
  take_focus();
  return true;
}

void DialogWindowX11::take_focus() {
  guikit::X11ErrorTrap trap(display_);
  XSetInputFocus(display_, window_, RevertToParent, CurrentTime);
  trap.failed();
}

void DialogWindowX11::run(DialogContentInterface& content) {
  if (!window_) return;
  paint(content);
  const int fd = ConnectionNumber(display_);
  while (!content.finished()) {
    bool dirty = false;
    while (XPending(display_) > 0 && !content.finished()) {
      XEvent event;
      XNextEvent(display_, &event);
      handle(event, content);
      dirty = true;
    }
    if (content.finished()) break;
    if (dirty) paint(content);
    pollfd p{fd, POLLIN, 0};
    poll(&p, 1, kPollMs);
  }
  XUnmapWindow(display_, window_);
  XFlush(display_);
}

void DialogWindowX11::handle(XEvent& event, DialogContentInterface& content) {
  switch (event.type) {
    case KeyPress: {
      char chars[16];
      KeySym keysym = 0;
      const int count = XLookupString(&event.xkey, chars, sizeof chars, &keysym, nullptr);
      content.key(keysym, std::string(chars, count > 0 ? static_cast<size_t>(count) : 0));
      break;
    }
    case ButtonPress:
      if (event.xbutton.button == Button1) content.press(event.xbutton.x, event.xbutton.y);
      break;
    case ButtonRelease:
      if (event.xbutton.button == Button1) content.release(event.xbutton.x, event.xbutton.y);
      break;
    case ClientMessage:
      if (event.xclient.format == 32 && static_cast<Atom>(event.xclient.data.l[0]) == delete_atom_)
        content.close_requested();
      break;
    case MapNotify:
      take_focus();
      break;
    case MappingNotify:
      XRefreshKeyboardMapping(&event.xmapping);
      break;
    default:
      break;
  }
}

void DialogWindowX11::paint(DialogContentInterface& content) {
  content.paint(*this);
  if (pixels_) buffer_.blit(guikit::Point{0, 0}, size_);
  XFlush(display_);
}

void DialogWindowX11::fill(const guikit::Rect& r, uint32_t colour) {
  if (!pixels_) {
    if (r.empty()) return;
    XSetForeground(display_, gc_, colour);
    XFillRectangle(display_, window_, gc_, r.left, r.top, static_cast<unsigned>(r.width()),
                   static_cast<unsigned>(r.height()));
    return;
  }
  const guikit::Rect c = r.intersect(guikit::Rect{0, 0, buffer_.get_width(), buffer_.get_height()});
  uint32_t* pixels = buffer_.get_pixels();
  for (int32_t y = c.top; y < c.bottom; ++y) {
    for (int32_t x = c.left; x < c.right; ++x) pixels[static_cast<size_t>(y) * buffer_.get_width() + x] = colour;
  }
}

void DialogWindowX11::frame(const guikit::Rect& r, uint32_t colour, int thickness) {
  for (int i = 0; i < thickness; ++i) {
    const guikit::Rect e{r.left + i, r.top + i, r.right - i, r.bottom - i};
    fill(guikit::Rect{e.left, e.top, e.right, e.top + 1}, colour);
    fill(guikit::Rect{e.left, e.bottom - 1, e.right, e.bottom}, colour);
    fill(guikit::Rect{e.left, e.top, e.left + 1, e.bottom}, colour);
    fill(guikit::Rect{e.right - 1, e.top, e.right, e.bottom}, colour);
  }
}

void DialogWindowX11::text(const guikit::Rect& box, const std::string& line, uint32_t colour, bool bold) {
  if (box.empty() || line.empty()) return;
  if (pixels_) {
    fonts_[bold ? 1 : 0]->draw_text(box, colour, guikit::Text(line), buffer_);
    return;
  }
  XRectangle clip{static_cast<short>(box.left), static_cast<short>(box.top), static_cast<unsigned short>(box.width()),
                  static_cast<unsigned short>(box.height())};
  XSetClipRectangles(display_, gc_, 0, 0, &clip, 1, Unsorted);
  XSetForeground(display_, gc_, colour);
  const int ascent = core_font_ ? core_font_->ascent : 10;
  XDrawString(display_, window_, gc_, box.left, box.top + ascent, line.data(), static_cast<int>(line.size()));
  XSetClipMask(display_, gc_, None);
}

int DialogWindowX11::text_width(const std::string& line, bool bold) const {
  if (pixels_) return fonts_[bold ? 1 : 0]->get_text_width(line.data(), line.size());
  if (core_font_) return XTextWidth(core_font_, line.data(), static_cast<int>(line.size()));
  return static_cast<int>(line.size()) * 6;
}

int DialogWindowX11::line_height(bool bold) const {
  if (pixels_) return fonts_[bold ? 1 : 0]->get_glyph_height();
  return core_font_ ? core_font_->ascent + core_font_->descent : 13;
}

}  // namespace sys
