#include "guikit/linux/text_line_editor_x11.h"

#include <X11/Xutil.h>
#include <X11/keysym.h>

#include "guikit/linux/x11_owner_interface.h"
#include "guikit/messages.h"

namespace guikit {

namespace {
constexpr unsigned long kFieldColour = 0xFFFFFF;
constexpr unsigned long kTextColour = 0x000000;
constexpr unsigned long kFrameColour = 0x606060;
constexpr unsigned long kSelectionColour = 0x30308C;
constexpr unsigned long kSelectedTextColour = 0xFFFFFF;
constexpr int kInnerMargin = 3;

int text_width(XFontStruct* font, const std::string& text, size_t count) {
  return font ? XTextWidth(font, text.data(), static_cast<int>(count)) : static_cast<int>(count) * 6;
}
}  // namespace

int32_t TextLineEditorX11::start(const TextInputRequest& request) {
  if (is_active()) stop(false);
  if (!owner_ || !owner_->get_display() || !owner_->get_window()) return -1;
  Display* display = owner_->get_display();
  const Rect& r = request.rect;
  if (r.width() <= 0 || r.height() <= 0) return -1;
  Window root = DefaultRootWindow(display);
  int screen_x = 0, screen_y = 0;
  Window child = 0;
  if (!XTranslateCoordinates(display, owner_->get_window(), root, r.left, r.top, &screen_x, &screen_y, &child))
    return -1;

  X11ErrorTrap trap(display);
  XSetWindowAttributes attributes{};
  attributes.override_redirect = True;
  attributes.background_pixel = kFieldColour;
  attributes.border_pixel = 0;
  attributes.event_mask = KeyPressMask | ExposureMask | FocusChangeMask | ButtonPressMask | StructureNotifyMask;
  Window window = XCreateWindow(display, root, screen_x, screen_y, static_cast<unsigned>(r.width()),
                                static_cast<unsigned>(r.height()), 0, CopyFromParent, InputOutput, CopyFromParent,
                                CWOverrideRedirect | CWBackPixel | CWBorderPixel | CWEventMask, &attributes);
  if (trap.failed() || window == 0) return -1;
  display_ = display;
  window_ = window;
  gc_ = XCreateGC(display_, window_, 0, nullptr);
  font_ = load_ui_font(display_);
  if (font_) XSetFont(display_, gc_, font_->fid);
  size_ = Size{r.width(), r.height()};
  text_ = request.text.substr(0, kMaxText);
  caret_ = text_.size();
  all_selected_ = true;
  requester_ = request.handler;

  XMapRaised(display_, window_);
  // Focus needs a viewable window: wait for the map, which an undecorated window gets at once.
  XEvent event;
  XWindowEvent(display_, window_, StructureNotifyMask, &event);
  while (event.type != MapNotify) XWindowEvent(display_, window_, StructureNotifyMask, &event);
  XSetInputFocus(display_, window_, RevertToParent, CurrentTime);
  if (trap.failed()) {
    destroy_window();
    requester_ = nullptr;
    return -1;
  }
  draw();
  XFlush(display_);
  return 0;
}

int32_t TextLineEditorX11::stop(bool accept) {
  if (!is_active()) return -1;
  destroy_window();
  MessageHandlerInterface* requester = requester_;
  requester_ = nullptr;
  if (requester) {
    TextInputFinished finished(text_, accept);
    requester->process_message(finished);
  }
  return 0;
}

void TextLineEditorX11::abandon() {
  destroy_window();
  requester_ = nullptr;
}

void TextLineEditorX11::destroy_window() {
  if (!window_) return;
  if (font_) XFreeFont(display_, font_);
  if (gc_) XFreeGC(display_, gc_);
  XDestroyWindow(display_, window_);
  XFlush(display_);
  font_ = nullptr;
  gc_ = nullptr;
  window_ = 0;
}

void TextLineEditorX11::handle_event(XEvent& event) {
  switch (event.type) {
    case Expose:
      if (event.xexpose.count == 0) draw();
      break;
    case KeyPress:
      key(event.xkey);
      break;
    case FocusOut:
      // Focus moving elsewhere accepts; grabs and moves inside the window do not.
      if (event.xfocus.mode == NotifyNormal && event.xfocus.detail != NotifyInferior &&
          event.xfocus.detail != NotifyPointer)
        stop(true);
      break;
    case ButtonPress:
      // A click in the field ends the selection and puts the caret at the end.
      all_selected_ = false;
      caret_ = text_.size();
      draw();
      break;
    default:
      break;
  }
}

void TextLineEditorX11::insert(char c) {
  if (all_selected_) {
    text_.clear();
    caret_ = 0;
    all_selected_ = false;
  }
  if (text_.size() >= kMaxText) return;
  text_.insert(caret_, 1, c);
  ++caret_;
}

void TextLineEditorX11::key(XKeyEvent& event) {
  char chars[16];
  KeySym keysym = 0;
  int count = XLookupString(&event, chars, sizeof chars, &keysym, nullptr);
  switch (keysym) {
    case XK_Return:
    case XK_KP_Enter:
      stop(true);
      return;
    case XK_Escape:
      stop(false);
      return;
    case XK_BackSpace:
      if (all_selected_) {
        text_.clear();
        caret_ = 0;
      } else if (caret_ > 0) {
        text_.erase(--caret_, 1);
      }
      all_selected_ = false;
      break;
    case XK_Delete:
    case XK_KP_Delete:
      if (all_selected_) {
        text_.clear();
        caret_ = 0;
      } else if (caret_ < text_.size()) {
        text_.erase(caret_, 1);
      }
      all_selected_ = false;
      break;
    case XK_Left:
    case XK_KP_Left:
      caret_ = all_selected_ ? 0 : (caret_ > 0 ? caret_ - 1 : 0);
      all_selected_ = false;
      break;
    case XK_Right:
    case XK_KP_Right:
      caret_ = all_selected_ ? text_.size() : (caret_ < text_.size() ? caret_ + 1 : caret_);
      all_selected_ = false;
      break;
    case XK_Home:
      caret_ = 0;
      all_selected_ = false;
      break;
    case XK_End:
      caret_ = text_.size();
      all_selected_ = false;
      break;
    default:
      for (int i = 0; i < count; ++i) {
        auto c = static_cast<unsigned char>(chars[i]);
        if (c >= 32 && c != 127) insert(static_cast<char>(c));
      }
      break;
  }
  draw();
}

void TextLineEditorX11::draw() {
  if (!window_) return;
  const int w = size_.width, h = size_.height;
  XSetForeground(display_, gc_, kFieldColour);
  XFillRectangle(display_, window_, gc_, 0, 0, static_cast<unsigned>(w), static_cast<unsigned>(h));
  XSetForeground(display_, gc_, kFrameColour);
  XDrawRectangle(display_, window_, gc_, 0, 0, static_cast<unsigned>(w - 1), static_cast<unsigned>(h - 1));

  const int ascent = font_ ? font_->ascent : 10;
  const int descent = font_ ? font_->descent : 3;
  const int baseline = (h - ascent - descent) / 2 + ascent;
  const int full = text_width(font_, text_, text_.size());
  const int caret_x = text_width(font_, text_, caret_);
  // Centred while it fits; otherwise scrolled so that the caret stays in view.
  int x0 = (w - full) / 2;
  if (full > w - 2 * kInnerMargin) {
    x0 = kInnerMargin;
    if (x0 + caret_x > w - kInnerMargin) x0 = w - kInnerMargin - caret_x;
  }
  if (all_selected_ && !text_.empty()) {
    XSetForeground(display_, gc_, kSelectionColour);
    XFillRectangle(display_, window_, gc_, x0, baseline - ascent, static_cast<unsigned>(full),
                   static_cast<unsigned>(ascent + descent));
    XSetForeground(display_, gc_, kSelectedTextColour);
  } else {
    XSetForeground(display_, gc_, kTextColour);
  }
  XDrawString(display_, window_, gc_, x0, baseline, text_.data(), static_cast<int>(text_.size()));
  if (!all_selected_) {
    XSetForeground(display_, gc_, kTextColour);
    XDrawLine(display_, window_, gc_, x0 + caret_x, baseline - ascent, x0 + caret_x, baseline + descent - 1);
  }
  XFlush(display_);
}

}  // namespace guikit
