// The X11 window tests' side of the X server: a host-like parent window, XTest
// for the pointer and keys (the test plays the user on a connection of its own),
// and pumping the window's idle with real time as a host's timer would.
#pragma once

#include <gtest/gtest.h>

#include <X11/Xlib.h>
#include <X11/Xutil.h>
#include <X11/extensions/XTest.h>
#include <X11/keysym.h>

#include <chrono>
#include <cstdlib>
#include <functional>
#include <thread>

#include "guikit/linux/window_x11.h"

namespace x11_test {

inline bool display_available() {
  const char* name = std::getenv("DISPLAY");
  return name != nullptr && *name != '\0';
}

#define X11_REQUIRE_DISPLAY()                                                     \
  do {                                                                            \
    if (!x11_test::display_available()) GTEST_SKIP() << "DISPLAY is not set";     \
  } while (0)

// Windows come and go while a test's user looks for one: a vanished window is
// not a reason to end the process, as Xlib's own handler would.
inline int ignore_x_errors(Display*, XErrorEvent*) { return 0; }

// The test's connection and a plain top-level window standing in for the host's.
class HostWindow {
 public:
  explicit HostWindow(int x = 0, int y = 0, int width = 700, int height = 340) {
    XInitThreads();
    XSetErrorHandler(ignore_x_errors);
    display_ = guikit::open_x_display();
    if (!display_) return;
    const int screen = DefaultScreen(display_);
    window_ = XCreateSimpleWindow(display_, RootWindow(display_, screen), x, y, static_cast<unsigned>(width),
                                  static_cast<unsigned>(height), 0, BlackPixel(display_, screen),
                                  0x203040);
    XSetWindowAttributes a{};
    a.override_redirect = True;  // placed exactly where asked even if a window manager runs
    XChangeWindowAttributes(display_, window_, CWOverrideRedirect, &a);
    XSelectInput(display_, window_, StructureNotifyMask);
    XMapWindow(display_, window_);
    XEvent e;
    do XWindowEvent(display_, window_, StructureNotifyMask, &e);
    while (e.type != MapNotify);
  }
  ~HostWindow() {
    if (!display_) return;
    XDestroyWindow(display_, window_);
    XCloseDisplay(display_);
  }
  HostWindow(const HostWindow&) = delete;
  HostWindow& operator=(const HostWindow&) = delete;

  bool ok() const { return display_ != nullptr; }
  Display* display() const { return display_; }
  Window window() const { return window_; }
  void* handle() const { return reinterpret_cast<void*>(static_cast<uintptr_t>(window_)); }

 private:
  Display* display_ = nullptr;
  Window window_ = 0;
};

// Plays the user through XTest on a display connection.
class User {
 public:
  explicit User(Display* display) : display_(display) {}
  // Positions are in the given window's pixels.
  void move(Window window, int x, int y) {
    int rx = 0, ry = 0;
    Window child = 0;
    XTranslateCoordinates(display_, window, DefaultRootWindow(display_), x, y, &rx, &ry, &child);
    XTestFakeMotionEvent(display_, DefaultScreen(display_), rx, ry, CurrentTime);
    XSync(display_, False);
  }
  void button(unsigned int button, bool press) {
    XTestFakeButtonEvent(display_, button, press ? True : False, CurrentTime);
    XSync(display_, False);
  }
  void click(Window window, int x, int y, unsigned int b = Button1) {
    move(window, x, y);
    button(b, true);
    button(b, false);
  }
  void key(KeySym keysym, bool press) {
    XTestFakeKeyEvent(display_, XKeysymToKeycode(display_, keysym), press ? True : False, CurrentTime);
    XSync(display_, False);
  }
  void tap(KeySym keysym) {
    key(keysym, true);
    key(keysym, false);
  }
  // Printable ASCII, with Shift where the character needs it.
  void type(const std::string& text) {
    for (char c : text) {
      const KeySym sym = c == ' ' ? XK_space : static_cast<KeySym>(static_cast<unsigned char>(c));
      const KeyCode code = XKeysymToKeycode(display_, sym);
      const bool shifted = XkbKeycodeToKeysymShim(code, 0) != sym;
      if (shifted) key(XK_Shift_L, true);
      XTestFakeKeyEvent(display_, code, True, CurrentTime);
      XTestFakeKeyEvent(display_, code, False, CurrentTime);
      XSync(display_, False);
      if (shifted) key(XK_Shift_L, false);
    }
  }

 private:
  KeySym XkbKeycodeToKeysymShim(KeyCode code, int index) {
    int per = 0;
    KeySym* syms = XGetKeyboardMapping(display_, code, 1, &per);
    KeySym s = syms && per > index ? syms[index] : NoSymbol;
    if (syms) XFree(syms);
    return s;
  }
  Display* display_;
};

// Runs the window's idle about every 5 ms for the given real time.
inline void pump(guikit::WindowX11& window, int ms) {
  const auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(ms);
  do {
    window.idle();
    std::this_thread::sleep_for(std::chrono::milliseconds(5));
  } while (std::chrono::steady_clock::now() < end);
  window.idle();
}

// Pumps until the condition holds or the time is up; answers the condition.
inline bool pump_until(guikit::WindowX11& window, const std::function<bool()>& done, int timeout_ms = 2000) {
  const auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(timeout_ms);
  for (;;) {
    if (window.get_x_display()) XSync(window.get_x_display(), False);
    window.idle();
    if (done()) return true;
    if (std::chrono::steady_clock::now() >= end) return false;
    std::this_thread::sleep_for(std::chrono::milliseconds(5));
  }
}

// The window's pixels as the server shows them, 0x00RRGGBB, top row first.
inline std::vector<uint32_t> grab_pixels(Display* display, Window window, int width, int height) {
  std::vector<uint32_t> out;
  XSync(display, False);
  XImage* image = XGetImage(display, window, 0, 0, static_cast<unsigned>(width), static_cast<unsigned>(height),
                            AllPlanes, ZPixmap);
  if (!image) return out;
  out.resize(static_cast<size_t>(width) * static_cast<size_t>(height));
  for (int y = 0; y < height; ++y) {
    for (int x = 0; x < width; ++x) out[static_cast<size_t>(y) * width + x] = XGetPixel(image, x, y) & 0x00FFFFFFu;
  }
  XDestroyImage(image);
  return out;
}

// The first viewable top-level window with this name, or 0.
inline Window find_named_window(Display* display, const char* name) {
  Window root = 0, parent = 0, *children = nullptr;
  unsigned int count = 0;
  Window found = 0;
  if (!XQueryTree(display, DefaultRootWindow(display), &root, &parent, &children, &count)) return 0;
  for (unsigned int i = count; i-- > 0 && !found;) {
    XWindowAttributes a;
    char* title = nullptr;
    if (XGetWindowAttributes(display, children[i], &a) && a.map_state == IsViewable &&
        XFetchName(display, children[i], &title) && title) {
      if (std::string(title) == name) found = children[i];
      XFree(title);
    }
  }
  if (children) XFree(children);
  return found;
}

// Waits (real time) for a named window to be shown; 0 when it was not.
inline Window wait_for_window(Display* display, const char* name, int timeout_ms = 3000) {
  const auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(timeout_ms);
  while (std::chrono::steady_clock::now() < end) {
    if (Window w = find_named_window(display, name)) return w;
    std::this_thread::sleep_for(std::chrono::milliseconds(10));
  }
  return 0;
}

}  // namespace x11_test
