#include "guikit/linux/menu_x11.h"

#include <X11/Xutil.h>
#include <X11/keysym.h>
#include <poll.h>

#include "guikit/linux/x11_owner_interface.h"
#include "guikit/messages.h"

namespace guikit {

namespace {
constexpr unsigned long kFaceColour = 0xD4D0C8;
constexpr unsigned long kHoverColour = 0x30308C;
constexpr unsigned long kTextColour = 0x000000;
constexpr unsigned long kHoverTextColour = 0xFFFFFF;
constexpr unsigned long kGreyTextColour = 0x808080;
constexpr unsigned long kLightEdge = 0xFFFFFF;
constexpr unsigned long kDarkEdge = 0x404040;
constexpr int32_t kTextLeft = 20;   // room for the tick
constexpr int32_t kTextRight = 22;  // room for the sub-menu arrow
constexpr int32_t kMinWidth = 80;
// While nothing happens the loop still wakes this often for the editor's timers.
constexpr int kServiceMs = 10;

bool is_choosable(const MenuX11::Row& row) {
  return row.entry.kind == MenuEntry::kItem || row.entry.kind == MenuEntry::kSubMenuBegin;
}
}  // namespace

MenuX11::~MenuX11() { close_levels_from(0); }

std::vector<MenuX11::Row> MenuX11::layout(const MenuList& list) {
  // The texts follow the shared rules; sub-menu entries pair with the child lists in order.
  std::vector<MenuEntry> entries = flatten_menu(list);
  std::vector<Row> rows;
  size_t child = 0;
  int32_t top = kBorder;
  for (const MenuEntry& e : entries) {
    if (e.depth != 0 || e.kind == MenuEntry::kSubMenuEnd) continue;
    MenuList* sub = nullptr;
    while (child < list.get_child_count()) {
      MenuNodeInterface* node = list.get_child(child++);
      sub = dynamic_cast<MenuList*>(node);
      if (e.kind != MenuEntry::kSubMenuBegin || sub) break;
    }
    if (e.kind != MenuEntry::kSubMenuBegin) sub = nullptr;
    int32_t height = e.kind == MenuEntry::kSeparator ? kSeparatorHeight : kRowHeight;
    rows.push_back(Row{e, sub, top, height});
    top += height;
  }
  return rows;
}

int32_t MenuX11::show(const MenuRequest& request) {
  if (!request.root || !owner_ || !owner_->get_display() || !owner_->get_window() || shown_) return -1;
  display_ = owner_->get_display();
  Window owner_window = owner_->get_window();
  Window root = DefaultRootWindow(display_);
  Window root_return = 0, child = 0;
  int x = 0, y = 0, wx = 0, wy = 0;
  unsigned int mask = 0;
  XQueryPointer(display_, root, &root_return, &child, &x, &y, &wx, &wy, &mask);

  font_ = load_ui_font(display_);
  gc_ = XCreateGC(display_, owner_window, 0, nullptr);
  if (font_) XSetFont(display_, gc_, font_->fid);
  // Our own windows get their pointer events as usual; all else reaches the owner.
  XGrabPointer(display_, owner_window, True, ButtonPressMask | ButtonReleaseMask | PointerMotionMask, GrabModeAsync,
               GrabModeAsync, None, None, CurrentTime);
  XGrabKeyboard(display_, owner_window, False, GrabModeAsync, GrabModeAsync, CurrentTime);
  shown_ = true;
  done_ = false;
  chosen_ = 0;
  open_level(request.root, x, y);
  XSync(display_, False);

  const int fd = ConnectionNumber(display_);
  while (!done_) {
    if (XPending(display_) > 0) {
      XEvent event;
      XNextEvent(display_, &event);
      handle(event);
      continue;
    }
    owner_->service();
    if (done_) break;
    pollfd p{fd, POLLIN, 0};
    poll(&p, 1, kServiceMs);
  }

  close_levels_from(0);
  XUngrabKeyboard(display_, CurrentTime);
  XUngrabPointer(display_, CurrentTime);
  if (font_) XFreeFont(display_, font_);
  XFreeGC(display_, gc_);
  font_ = nullptr;
  gc_ = nullptr;
  XFlush(display_);
  shown_ = false;

  // The menu is gone before the listener runs: it may open another.
  if (chosen_ != 0) {
    MenuItem* item = find_menu_item(*request.root, chosen_);
    if (item && !item->is_grayed() && item->get_listener()) item->get_listener()->on_select();
  }
  return 0;
}

int32_t MenuX11::close() {
  if (shown_) done_ = true;
  return 0;
}

void MenuX11::open_level(MenuList* list, int32_t x, int32_t y) {
  Level level{list, layout(*list), 0, x, y, kMinWidth, 0, -1};
  for (const Row& row : level.rows) {
    int32_t text = font_ ? XTextWidth(font_, row.entry.text.data(), static_cast<int>(row.entry.text.size())) : 0;
    if (text + kTextLeft + kTextRight > level.width) level.width = text + kTextLeft + kTextRight;
  }
  level.height = level.rows.empty() ? kRowHeight / 2 : level.rows.back().top + level.rows.back().height;
  level.height += kBorder;
  // Kept on the screen: a level that would leave it opens to the other side.
  const int screen = DefaultScreen(display_);
  const int32_t sw = DisplayWidth(display_, screen), sh = DisplayHeight(display_, screen);
  if (level.x + level.width > sw) level.x = sw - level.width;
  if (level.y + level.height > sh) level.y = sh - level.height;
  if (level.x < 0) level.x = 0;
  if (level.y < 0) level.y = 0;

  XSetWindowAttributes attributes{};
  attributes.override_redirect = True;
  attributes.background_pixel = kFaceColour;
  attributes.save_under = True;
  attributes.event_mask =
      ExposureMask | ButtonPressMask | ButtonReleaseMask | PointerMotionMask | LeaveWindowMask | StructureNotifyMask;
  level.window = XCreateWindow(display_, DefaultRootWindow(display_), level.x, level.y,
                               static_cast<unsigned>(level.width), static_cast<unsigned>(level.height), 0,
                               CopyFromParent, InputOutput, CopyFromParent,
                               CWOverrideRedirect | CWBackPixel | CWSaveUnder | CWEventMask, &attributes);
  XStoreName(display_, level.window, kWindowName);
  XMapRaised(display_, level.window);
  levels_.push_back(level);
  draw(levels_.back());
}

void MenuX11::close_levels_from(size_t index) {
  while (levels_.size() > index) {
    if (display_ && levels_.back().window) XDestroyWindow(display_, levels_.back().window);
    levels_.pop_back();
  }
  if (levels_.empty() == false) {
    Level& last = levels_.back();
    draw(last);
  }
}

int MenuX11::level_of(Window window) const {
  for (size_t i = 0; i < levels_.size(); ++i) {
    if (levels_[i].window == window) return static_cast<int>(i);
  }
  return -1;
}

int MenuX11::row_at(const Level& level, int32_t y) const {
  for (size_t i = 0; i < level.rows.size(); ++i) {
    if (y >= level.rows[i].top && y < level.rows[i].top + level.rows[i].height) return static_cast<int>(i);
  }
  return -1;
}

void MenuX11::hover(size_t level, int row) {
  Level& l = levels_[level];
  if (row >= 0 && !is_choosable(l.rows[static_cast<size_t>(row)])) row = -1;
  if (l.hover != row) {
    l.hover = row;
    draw(l);
  }
}

bool MenuX11::activate(size_t level, int row) {
  if (row < 0) return false;
  const Row& r = levels_[level].rows[static_cast<size_t>(row)];
  if (r.entry.kind == MenuEntry::kItem) {
    if (r.entry.grayed) return false;
    chosen_ = r.entry.id;
    return true;
  }
  if (r.entry.kind == MenuEntry::kSubMenuBegin && r.sub_menu) {
    close_levels_from(level + 1);
    const Level& l = levels_[level];
    open_level(r.sub_menu, l.x + l.width - kBorder, l.y + r.top - kBorder);
  }
  return false;
}

void MenuX11::move_hover(int step) {
  Level& l = levels_.back();
  const int n = static_cast<int>(l.rows.size());
  if (n == 0) return;
  int row = l.hover;
  for (int tries = 0; tries < n; ++tries) {
    row = row < 0 ? (step > 0 ? 0 : n - 1) : (row + step + n) % n;
    if (is_choosable(l.rows[static_cast<size_t>(row)])) {
      hover(levels_.size() - 1, row);
      return;
    }
  }
}

void MenuX11::handle(XEvent& event) {
  switch (event.type) {
    case Expose: {
      int level = level_of(event.xexpose.window);
      if (level >= 0) {
        if (event.xexpose.count == 0) draw(levels_[static_cast<size_t>(level)]);
      } else {
        owner_->dispatch_event(event);
      }
      break;
    }
    case MotionNotify: {
      int level = level_of(event.xmotion.window);
      if (level < 0) break;
      Level& l = levels_[static_cast<size_t>(level)];
      int row = row_at(l, event.xmotion.y);
      hover(static_cast<size_t>(level), row);
      // Resting on a sub-menu opens it; anywhere else in this level closes deeper ones.
      if (row >= 0 && l.rows[static_cast<size_t>(row)].entry.kind == MenuEntry::kSubMenuBegin) {
        if (static_cast<size_t>(level) + 1 == levels_.size()) activate(static_cast<size_t>(level), row);
      } else if (row >= 0) {
        close_levels_from(static_cast<size_t>(level) + 1);
      }
      break;
    }
    case ButtonPress:
      // A press outside every level closes the menu without a choice.
      if (level_of(event.xbutton.window) < 0) done_ = true;
      break;
    case ButtonRelease: {
      if (event.xbutton.button > Button3) break;
      int level = level_of(event.xbutton.window);
      if (level < 0) break;
      int row = row_at(levels_[static_cast<size_t>(level)], event.xbutton.y);
      if (activate(static_cast<size_t>(level), row)) done_ = true;
      break;
    }
    case KeyPress: {
      KeySym keysym = XLookupKeysym(&event.xkey, 0);
      Level& l = levels_.back();
      switch (keysym) {
        case XK_Down:
        case XK_KP_Down:
          move_hover(1);
          break;
        case XK_Up:
        case XK_KP_Up:
          move_hover(-1);
          break;
        case XK_Return:
        case XK_KP_Enter:
        case XK_Right:
        case XK_KP_Right:
          if (l.hover >= 0) {
            const size_t level = levels_.size() - 1;
            const bool sub = l.rows[static_cast<size_t>(l.hover)].entry.kind == MenuEntry::kSubMenuBegin;
            if (keysym == XK_Right || keysym == XK_KP_Right) {
              if (!sub) break;
            }
            if (activate(level, l.hover)) {
              done_ = true;
            } else if (sub && levels_.size() > level + 1) {
              move_hover(1);
            }
          }
          break;
        case XK_Left:
        case XK_KP_Left:
          if (levels_.size() > 1) close_levels_from(levels_.size() - 1);
          break;
        case XK_Escape:
          if (levels_.size() > 1) {
            close_levels_from(levels_.size() - 1);
          } else {
            done_ = true;
          }
          break;
        default:
          break;
      }
      break;
    }
    case KeyRelease:
    case EnterNotify:
    case LeaveNotify:
      break;
    default:
      if (level_of(event.xany.window) < 0) owner_->dispatch_event(event);
      break;
  }
}

void MenuX11::draw(const Level& level) {
  if (!level.window || !gc_) return;
  Display* d = display_;
  Window w = level.window;
  XSetForeground(d, gc_, kFaceColour);
  XFillRectangle(d, w, gc_, 0, 0, static_cast<unsigned>(level.width), static_cast<unsigned>(level.height));
  XSetForeground(d, gc_, kLightEdge);
  XDrawLine(d, w, gc_, 0, 0, level.width - 1, 0);
  XDrawLine(d, w, gc_, 0, 0, 0, level.height - 1);
  XSetForeground(d, gc_, kDarkEdge);
  XDrawLine(d, w, gc_, level.width - 1, 0, level.width - 1, level.height - 1);
  XDrawLine(d, w, gc_, 0, level.height - 1, level.width - 1, level.height - 1);
  const int ascent = font_ ? font_->ascent : 10;
  const int descent = font_ ? font_->descent : 3;
  for (size_t i = 0; i < level.rows.size(); ++i) {
    const Row& row = level.rows[i];
    if (row.entry.kind == MenuEntry::kSeparator) {
      int32_t y = row.top + row.height / 2;
      XSetForeground(d, gc_, kGreyTextColour);
      XDrawLine(d, w, gc_, 4, y - 1, level.width - 5, y - 1);
      XSetForeground(d, gc_, kLightEdge);
      XDrawLine(d, w, gc_, 4, y, level.width - 5, y);
      continue;
    }
    const bool hovered = static_cast<int>(i) == level.hover;
    if (hovered) {
      XSetForeground(d, gc_, kHoverColour);
      XFillRectangle(d, w, gc_, kBorder, row.top, static_cast<unsigned>(level.width - 2 * kBorder),
                     static_cast<unsigned>(row.height));
    }
    unsigned long ink = row.entry.grayed ? kGreyTextColour : (hovered ? kHoverTextColour : kTextColour);
    XSetForeground(d, gc_, ink);
    const int baseline = row.top + (row.height - ascent - descent) / 2 + ascent;
    XDrawString(d, w, gc_, kTextLeft, baseline, row.entry.text.data(), static_cast<int>(row.entry.text.size()));
    const int mid = row.top + row.height / 2;
    if (row.entry.checked) {
      XPoint tick[3] = {{6, static_cast<short>(mid)}, {9, static_cast<short>(mid + 3)}, {14, static_cast<short>(mid - 4)}};
      XDrawLines(d, w, gc_, tick, 3, CoordModeOrigin);
      XPoint tick2[3] = {{6, static_cast<short>(mid + 1)}, {9, static_cast<short>(mid + 4)}, {14, static_cast<short>(mid - 3)}};
      XDrawLines(d, w, gc_, tick2, 3, CoordModeOrigin);
    }
    if (row.entry.kind == MenuEntry::kSubMenuBegin) {
      const short ax = static_cast<short>(level.width - 12);
      XPoint arrow[3] = {{ax, static_cast<short>(mid - 4)}, {static_cast<short>(ax + 4), static_cast<short>(mid)},
                         {ax, static_cast<short>(mid + 4)}};
      XFillPolygon(d, w, gc_, arrow, 3, Convex, CoordModeOrigin);
    }
  }
  XFlush(d);
}

}  // namespace guikit
