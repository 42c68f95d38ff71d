#include "guikit/linux/window_x11.h"

#include <X11/Xutil.h>

#include <atomic>
#include <functional>
#include <thread>

namespace guikit {

namespace {

// Process-wide, like a window class: how many editor windows are open, and the
// platform timer ids, unique across all of them as the shared timer records need.
std::atomic<int> g_open_windows{0};
std::atomic<uintptr_t> g_last_timer_id{0};

constexpr long kEventMask = ExposureMask | ButtonPressMask | ButtonReleaseMask | PointerMotionMask |
                            StructureNotifyMask | EnterWindowMask | LeaveWindowMask;
constexpr unsigned int kGrabMask = ButtonPressMask | ButtonReleaseMask | PointerMotionMask;

Rect unite(const Rect& a, const Rect& b) {
  if (a.empty()) return b;
  if (b.empty()) return a;
  return Rect{a.left < b.left ? a.left : b.left, a.top < b.top ? a.top : b.top,
              a.right > b.right ? a.right : b.right, a.bottom > b.bottom ? a.bottom : b.bottom};
}

uint32_t button_bit(unsigned int button) {
  switch (button) {
    case Button1:
      return kButtonLeft;
    case Button2:
      return kButtonMiddle;
    case Button3:
      return kButtonRight;
    default:
      return 0;  // wheel steps and extra buttons
  }
}

uint32_t held_from_state(unsigned int state) {
  return ((state & Button1Mask) ? kButtonLeft : 0u) | ((state & Button3Mask) ? kButtonRight : 0u) |
         ((state & Button2Mask) ? kButtonMiddle : 0u);
}

uint32_t double_code(uint32_t bit) {
  return bit == kButtonLeft ? kDoubleLeft : (bit == kButtonRight ? kDoubleRight : kDoubleMiddle);
}

Size at_least_one(Size s) { return Size{s.width > 0 ? s.width : 1, s.height > 0 ? s.height : 1}; }

}  // namespace

WindowX11::WindowX11(Size initial_size) : core_(*this), window_size_(initial_size) {
  core_.set_editor_size(initial_size);
  core_.set_line_editor(&line_editor_);
  core_.set_menu(&menu_);
  line_editor_.set_owner(this);
  menu_.set_owner(this);
}

WindowX11::~WindowX11() {
  // The controls may be gone before the window that showed them.
  if (captured_) {
    if (display_) XUngrabPointer(display_, CurrentTime);
    captured_ = false;
    core_.forget_capture();
  }
  close();
}

int WindowX11::get_open_count() { return g_open_windows.load(std::memory_order_relaxed); }

int32_t WindowX11::open(void* parent) {
  if (window_) return 0;
  // The editor lives inside the host's window; without one there is nowhere to show it.
  if (parent == nullptr) return -1;
  if (!display_) display_ = open_x_display();
  if (!display_) return -1;
  const int screen = DefaultScreen(display_);
  Visual* visual = DefaultVisual(display_, screen);
  const int depth = DefaultDepth(display_, screen);
  const Window parent_window = static_cast<Window>(reinterpret_cast<uintptr_t>(parent));
  const Size size = at_least_one(can_resize_ ? core_.get_editor_size() : window_size_);

  XSetWindowAttributes attributes{};
  attributes.background_pixmap = None;  // no erase before the paint: it covers everything
  attributes.border_pixel = 0;
  attributes.colormap = DefaultColormap(display_, screen);
  attributes.event_mask = kEventMask;
  Window window = 0;
  bool failed = false;
  {
    X11ErrorTrap trap(display_);
    window = XCreateWindow(display_, parent_window, 0, 0, static_cast<unsigned>(size.width),
                           static_cast<unsigned>(size.height), 0, depth, InputOutput, visual,
                           CWBackPixmap | CWBorderPixel | CWColormap | CWEventMask, &attributes);
    failed = trap.failed() || window == 0;
  }
  if (failed || !buffer_.create(display_, visual, depth, at_least_one(core_.get_editor_size()))) {
    if (!failed) XDestroyWindow(display_, window);
    buffer_.destroy();
    XCloseDisplay(display_);
    display_ = nullptr;
    return -1;
  }
  window_ = window;
  XStoreName(display_, window_, "Brakmorph");
  gc_ = XCreateGC(display_, window_, 0, nullptr);
  // A one-pixel cursor with nothing set hides the pointer in relative drags.
  char empty = 0;
  Pixmap blank = XCreateBitmapFromData(display_, window_, &empty, 1, 1);
  XColor black{};
  invisible_cursor_ = XCreatePixmapCursor(display_, blank, blank, &black, &black, 0, 0);
  XFreePixmap(display_, blank);
  XMapWindow(display_, window_);
  XSync(display_, False);
  open_size_ = size;
  held_buttons_ = 0;
  last_press_button_ = 0;
  g_open_windows.fetch_add(1, std::memory_order_relaxed);
  return 0;
}

void WindowX11::close() {
  if (!display_) return;
  core_.close_timers();
  timers_.clear();
  line_editor_.abandon();
  if (captured_) release_capture();
  core_.destroyed();
  destroy_window();
  if (invisible_cursor_) XFreeCursor(display_, invisible_cursor_);
  if (gc_) XFreeGC(display_, gc_);
  invisible_cursor_ = 0;
  gc_ = nullptr;
  buffer_.destroy();
  XCloseDisplay(display_);
  display_ = nullptr;
  pending_ = Rect{};
  cursor_hidden_ = false;
}

void WindowX11::destroy_window() {
  if (!window_) return;
  XDestroyWindow(display_, window_);
  XSync(display_, False);
  window_ = 0;
  g_open_windows.fetch_sub(1, std::memory_order_relaxed);
}

void WindowX11::resize() {
  if (!window_) return;
  open_size_ = at_least_one(can_resize_ ? core_.get_editor_size() : window_size_);
  XResizeWindow(display_, window_, static_cast<unsigned>(open_size_.width), static_cast<unsigned>(open_size_.height));
  pending_ = Rect{0, 0, open_size_.width, open_size_.height};
  XFlush(display_);
}

void WindowX11::set_roots(MessageHandlerInterface* background, MessageHandlerInterface* controls) {
  core_.set_background_root(background);
  core_.set_control_root(controls);
}

void WindowX11::set_editor_size(Size size) {
  core_.set_editor_size(size);
  if (window_ && (buffer_.get_width() != size.width || buffer_.get_height() != size.height)) {
    const int screen = DefaultScreen(display_);
    buffer_.create(display_, DefaultVisual(display_, screen), DefaultDepth(display_, screen), at_least_one(size));
  }
}

void WindowX11::idle() {
  if (!display_ || in_idle_) return;
  in_idle_ = true;
  while (display_ && XPending(display_) > 0) {
    XEvent event;
    XNextEvent(display_, &event);
    dispatch_event(event);
  }
  if (display_) service();
  in_idle_ = false;
}

void WindowX11::service() {
  if (!display_) return;
  run_timers();
  paint_pending();
  if (display_) XFlush(display_);
}

void WindowX11::dispatch_event(XEvent& event) {
  if (line_editor_.owns(event.xany.window)) {
    line_editor_.handle_event(event);
    return;
  }
  if (!window_ || event.xany.window != window_) return;
  switch (event.type) {
    case Expose: {
      const XExposeEvent& e = event.xexpose;
      pending_ = unite(pending_, Rect{e.x, e.y, e.x + e.width, e.y + e.height});
      break;
    }
    case MotionNotify:
      core_.mouse_move(event.xmotion.x, event.xmotion.y);
      break;
    case ButtonPress:
      on_button(event.xbutton, true);
      break;
    case ButtonRelease:
      on_button(event.xbutton, false);
      break;
    case EnterNotify:
    case LeaveNotify:
      // The server ended our grab (it was not us: release_capture clears the flag first).
      if (event.xcrossing.mode == NotifyUngrab && captured_) lose_grab();
      break;
    case UnmapNotify:
      if (captured_) lose_grab();
      break;
    case DestroyNotify:
      // The host destroyed its window and ours with it.
      if (event.xdestroywindow.window == window_) {
        line_editor_.abandon();
        captured_ = false;
        core_.forget_capture();
        core_.destroyed();
        window_ = 0;
        g_open_windows.fetch_sub(1, std::memory_order_relaxed);
      }
      break;
    default:
      break;
  }
}

void WindowX11::on_button(const XButtonEvent& event, bool press) {
  const uint32_t bit = button_bit(event.button);
  if (bit == 0) return;
  uint32_t held = held_from_state(event.state);
  held = press ? (held | bit) : (held & ~bit);
  held_buttons_ = held;
  const uint32_t modifiers =
      ((event.state & ControlMask) ? kModControl : 0u) | ((event.state & ShiftMask) ? kModShift : 0u);
  uint32_t double_click = 0;
  if (press) {
    const int dx = event.x - last_press_.x, dy = event.y - last_press_.y;
    if (event.button == last_press_button_ && event.time - last_press_time_ <= kDoubleClickMs &&
        dx <= kDoubleClickDistance && dx >= -kDoubleClickDistance && dy <= kDoubleClickDistance &&
        dy >= -kDoubleClickDistance) {
      double_click = double_code(bit);
      last_press_button_ = 0;  // a third press starts over
    } else {
      last_press_button_ = event.button;
      last_press_time_ = event.time;
      last_press_ = Point{event.x, event.y};
    }
    // A click beside the line editor takes its focus away, which accepts the text.
    if (line_editor_.is_active()) line_editor_.stop(true);
  }
  core_.mouse_button(event.x, event.y, held, modifiers, double_click);
}

void WindowX11::lose_grab() {
  captured_ = false;
  core_.capture_changed();
}

void WindowX11::paint_pending() {
  if (!window_ || pending_.empty()) return;
  Rect area = pending_;
  pending_ = Rect{};
  buffer_.set_target(window_, gc_);
  core_.paint(area, buffer_, open_size_);
}

void WindowX11::invalidate_area(const Rect& rect) { pending_ = unite(pending_, rect); }

bool WindowX11::take_capture() {
  if (!window_) return false;
  if (captured_) return true;
  const int result = XGrabPointer(display_, window_, False, kGrabMask, GrabModeAsync, GrabModeAsync, None,
                                  cursor_hidden_ ? invisible_cursor_ : None, CurrentTime);
  captured_ = result == GrabSuccess;
  return captured_;
}

void WindowX11::release_capture() {
  if (!captured_) return;
  captured_ = false;
  XUngrabPointer(display_, CurrentTime);
  XSync(display_, False);  // given back before anyone else asks for it
  core_.capture_changed();
}

void WindowX11::show_cursor(bool show) {
  cursor_hidden_ = !show;
  if (!window_) return;
  if (show) {
    XUndefineCursor(display_, window_);
  } else {
    XDefineCursor(display_, window_, invisible_cursor_);
  }
  if (captured_) XChangeActivePointerGrab(display_, kGrabMask, show ? None : invisible_cursor_, CurrentTime);
  XFlush(display_);
}

Point WindowX11::get_cursor() const {
  if (!window_) return Point{};
  Window root = 0, child = 0;
  int rx = 0, ry = 0, wx = 0, wy = 0;
  unsigned int mask = 0;
  XQueryPointer(display_, window_, &root, &child, &rx, &ry, &wx, &wy, &mask);
  return Point{wx, wy};
}

void WindowX11::set_cursor(Point position) {
  if (!window_) return;
  XWarpPointer(display_, None, window_, 0, 0, 0, 0, position.x, position.y);
  XFlush(display_);
}

uint64_t WindowX11::current_thread() const {
  return static_cast<uint64_t>(std::hash<std::thread::id>()(std::this_thread::get_id()));
}

uint32_t WindowX11::milliseconds() const { return static_cast<uint32_t>(toolkit_milliseconds()); }

bool WindowX11::start_timer(uint32_t period_ms, uintptr_t& platform_id) {
  if (!window_) return false;
  platform_id = g_last_timer_id.fetch_add(1, std::memory_order_relaxed) + 1;
  const unsigned long period = period_ms > 0 ? period_ms : 1;
  timers_.push_back(Timer{platform_id, period, milliseconds() + period});
  return true;
}

bool WindowX11::kill_timer(uintptr_t platform_id) {
  for (size_t i = 0; i < timers_.size(); ++i) {
    if (timers_[i].platform_id == platform_id) {
      timers_.erase(timers_.begin() + static_cast<std::ptrdiff_t>(i));
      return true;
    }
  }
  return false;
}

void WindowX11::run_timers() {
  // Each due timer ticks once per call, the most overdue first; a late tick is
  // not caught up on, as with the system timers of other platforms. Handlers may
  // start or kill timers, so the list is searched afresh each time.
  const uint32_t now = milliseconds();
  std::vector<uintptr_t> fired;
  for (;;) {
    size_t best = timers_.size();
    for (size_t i = 0; i < timers_.size(); ++i) {
      const Timer& t = timers_[i];
      const bool due = static_cast<int32_t>(now - static_cast<uint32_t>(t.due_ms)) >= 0;
      bool done = false;
      for (uintptr_t id : fired) done = done || id == t.platform_id;
      if (!due || done) continue;
      if (best == timers_.size() ||
          static_cast<int32_t>(static_cast<uint32_t>(t.due_ms) - static_cast<uint32_t>(timers_[best].due_ms)) < 0)
        best = i;
    }
    if (best == timers_.size()) break;
    timers_[best].due_ms = now + timers_[best].period_ms;
    const uintptr_t id = timers_[best].platform_id;
    fired.push_back(id);
    WindowCore::timer_tick(id);
    if (!display_) break;  // a handler closed the window
  }
}

void WindowX11::fill_face(const Rect& rect) {
  if (!window_ || rect.empty()) return;
  XSetForeground(display_, gc_, kFaceColour);
  XFillRectangle(display_, window_, gc_, rect.left, rect.top, static_cast<unsigned>(rect.width()),
                 static_cast<unsigned>(rect.height()));
}

}  // namespace guikit
