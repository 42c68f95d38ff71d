#include <chrono>
#include <cmath>
#include <cstdlib>
#include <thread>

#include "guikit/linux/x11_owner_interface.h"
#include "guikit/toolkit_clock.h"

namespace guikit {

namespace {
// Only the user-interface thread talks to X, so one flag serves every trap.
bool g_trapped_error = false;
int trap_error(Display*, XErrorEvent*) {
  g_trapped_error = true;
  return 0;
}
}  // namespace

X11ErrorTrap::X11ErrorTrap(Display* display) : display_(display) {
  XSync(display_, False);
  g_trapped_error = false;
  previous_ = XSetErrorHandler(trap_error);
}

X11ErrorTrap::~X11ErrorTrap() {
  XSync(display_, False);
  XSetErrorHandler(previous_);
}

bool X11ErrorTrap::failed() {
  XSync(display_, False);
  return g_trapped_error;
}

Display* open_x_display() {
  const char* name = std::getenv("DISPLAY");
  if (name == nullptr || *name == '\0') return nullptr;
  for (int attempt = 0; attempt < 8; ++attempt) {
    if (Display* display = XOpenDisplay(nullptr)) return display;
    std::this_thread::sleep_for(std::chrono::milliseconds(5 * (attempt + 1)));
  }
  return nullptr;
}

XFontStruct* load_ui_font(Display* display) {
  // The server's built-in font is always there; the named one reads better.
  const char* names[] = {"-misc-fixed-medium-r-semicondensed--13-*-*-*-*-*-iso8859-1", "6x13", "fixed"};
  for (const char* name : names) {
    if (XFontStruct* font = XLoadQueryFont(display, name)) return font;
  }
  return nullptr;
}

unsigned long toolkit_milliseconds() {
  return static_cast<unsigned long>(std::floor(toolkit_now() * 1000.0 + 0.5));
}

}  // namespace guikit
