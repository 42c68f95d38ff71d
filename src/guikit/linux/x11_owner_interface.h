#pragma once

#include <X11/Xlib.h>

namespace guikit {

// What the line editor and the pop-up menu need of the editor window they open over.
class X11OwnerInterface {
 public:
  virtual ~X11OwnerInterface() = default;
  virtual Display* get_display() const = 0;
  virtual Window get_window() const = 0;
  // Runs due timers and pending repaints: a modal loop keeps the editor alive with it.
  virtual void service() = 0;
  // Hands on an event that a modal loop does not use itself.
  virtual void dispatch_event(XEvent& event) = 0;
};

// Traps X protocol errors between its construction and check(), so a bad window
// id from a host gives an error answer instead of ending the process.
class X11ErrorTrap {
 public:
  explicit X11ErrorTrap(Display* display);
  ~X11ErrorTrap();
  X11ErrorTrap(const X11ErrorTrap&) = delete;
  X11ErrorTrap& operator=(const X11ErrorTrap&) = delete;
  // Syncs with the server; true when a request failed since construction.
  bool failed();

 private:
  Display* display_;
  int (*previous_)(Display*, XErrorEvent*);
};

// XOpenDisplay(nullptr), tried a few times: a busy server may refuse a connection
// now and then. nullptr when there is no display.
Display* open_x_display();

// The core X font the toolkit's own widgets (line editor, menus) write with.
XFontStruct* load_ui_font(Display* display);

// Milliseconds of the toolkit's clock (the one the controls read).
unsigned long toolkit_milliseconds();

}  // namespace guikit
