// The editor's parent on an X server: a top-level window on a display
// connection of the host's own (the plug-in opens its own connection and
// makes its window a child of this one by id).
#include <X11/Xlib.h>
#include <X11/Xutil.h>

#include <chrono>
#include <cstdlib>
#include <stdexcept>
#include <thread>

#include "cli/editor_parent.h"

namespace plugcore {
namespace {

int g_x_errors = 0;

int count_x_error(Display*, XErrorEvent*) {
  ++g_x_errors;
  return 0;
}

// Position of the lowest set bit and the width of a colour mask.
void mask_shape(unsigned long mask, int& shift, int& bits) {
  shift = 0;
  bits = 0;
  if (mask == 0) return;
  while ((mask & 1ul) == 0) {
    mask >>= 1;
    ++shift;
  }
  while ((mask & 1ul) != 0) {
    mask >>= 1;
    ++bits;
  }
}

uint32_t channel_value(unsigned long pixel, unsigned long mask) {
  int shift = 0;
  int bits = 0;
  mask_shape(mask, shift, bits);
  if (bits == 0) return 0;
  const unsigned long value = (pixel & mask) >> shift;
  const unsigned long top = (1ul << bits) - 1;
  return static_cast<uint32_t>((value * 255 + top / 2) / top);
}

class EditorParentX11 : public EditorParentInterface {
 public:
  EditorParentX11(int width, int height, const std::string& title) : width_(width), height_(height) {
    // A busy server may refuse a connection opened right after another one: try a few times.
    for (int attempt = 0; attempt < 8 && display_ == nullptr; ++attempt) {
      if (attempt > 0) std::this_thread::sleep_for(std::chrono::milliseconds(10 * attempt));
      display_ = XOpenDisplay(nullptr);
    }
    if (display_ == nullptr) throw std::runtime_error("cannot open the X display");
    const int screen = DefaultScreen(display_);
    window_ = XCreateSimpleWindow(display_, RootWindow(display_, screen), 0, 0,
                                  static_cast<unsigned>(width), static_cast<unsigned>(height), 0,
                                  BlackPixel(display_, screen), BlackPixel(display_, screen));
    XStoreName(display_, window_, title.c_str());
    // A fixed size: the editor decides it, not the user.
    XSizeHints* hints = XAllocSizeHints();
    hints->flags = PMinSize | PMaxSize;
    hints->min_width = hints->max_width = width;
    hints->min_height = hints->max_height = height;
    XSetWMNormalHints(display_, window_, hints);
    XFree(hints);
    delete_atom_ = XInternAtom(display_, "WM_DELETE_WINDOW", False);
    XSetWMProtocols(display_, window_, &delete_atom_, 1);
    XSelectInput(display_, window_, StructureNotifyMask | ExposureMask);
    XMapWindow(display_, window_);
    wait_until_mapped();
  }

  ~EditorParentX11() override {
    XDestroyWindow(display_, window_);
    XCloseDisplay(display_);
  }

  void* native_handle() override { return reinterpret_cast<void*>(static_cast<uintptr_t>(window_)); }

  void resize(int width, int height) override {
    if (width == width_ && height == height_) return;
    width_ = width;
    height_ = height;
    XSizeHints* hints = XAllocSizeHints();
    hints->flags = PMinSize | PMaxSize;
    hints->min_width = hints->max_width = width;
    hints->min_height = hints->max_height = height;
    XSetWMNormalHints(display_, window_, hints);
    XFree(hints);
    XResizeWindow(display_, window_, static_cast<unsigned>(width), static_cast<unsigned>(height));
    XSync(display_, False);
  }

  void pump_events() override {
    while (XPending(display_) > 0) {
      XEvent event;
      XNextEvent(display_, &event);
      if (event.type == ClientMessage && static_cast<Atom>(event.xclient.data.l[0]) == delete_atom_) {
        close_requested_ = true;
      } else if (event.type == MapNotify) {
        mapped_ = true;
      } else if (event.type == UnmapNotify) {
        mapped_ = false;
      }
    }
  }

  bool close_requested() const override { return close_requested_; }

  int child_count() override {
    XSync(display_, False);
    Window root = 0;
    Window parent = 0;
    Window* children = nullptr;
    unsigned int count = 0;
    if (XQueryTree(display_, window_, &root, &parent, &children, &count) == 0) return 0;
    if (children != nullptr) XFree(children);
    return static_cast<int>(count);
  }

  PixelImage grab() override {
    XSync(display_, False);
    g_x_errors = 0;
    XErrorHandler previous = XSetErrorHandler(count_x_error);
    XImage* image = XGetImage(display_, window_, 0, 0, static_cast<unsigned>(width_),
                              static_cast<unsigned>(height_), AllPlanes, ZPixmap);
    XSync(display_, False);
    XSetErrorHandler(previous);
    if (image == nullptr || g_x_errors != 0) {
      if (image != nullptr) XDestroyImage(image);
      throw std::runtime_error("cannot read the window's pixels");
    }
    PixelImage out;
    out.width = width_;
    out.height = height_;
    out.pixels.resize(static_cast<size_t>(width_) * height_);
    for (int y = 0; y < height_; ++y) {
      for (int x = 0; x < width_; ++x) {
        const unsigned long pixel = XGetPixel(image, x, y);
        out.pixels[static_cast<size_t>(y) * width_ + x] =
            channel_value(pixel, image->red_mask) << 16 | channel_value(pixel, image->green_mask) << 8 |
            channel_value(pixel, image->blue_mask);
      }
    }
    XDestroyImage(image);
    return out;
  }

 private:
  // Pixels can be read only from a viewable window: wait for the map.
  void wait_until_mapped() {
    const auto give_up = std::chrono::steady_clock::now() + std::chrono::seconds(5);
    XSync(display_, False);
    while (!mapped_ && std::chrono::steady_clock::now() < give_up) {
      pump_events();
      if (!mapped_) std::this_thread::sleep_for(std::chrono::milliseconds(2));
    }
    if (!mapped_) throw std::runtime_error("the X server did not show the window");
  }

  Display* display_ = nullptr;
  Window window_ = 0;
  Atom delete_atom_ = 0;
  int width_;
  int height_;
  bool mapped_ = false;
  bool close_requested_ = false;
};

}  // namespace

std::string editor_desktop_unavailable() {
  const char* display = std::getenv("DISPLAY");
  if (display == nullptr || *display == '\0') return "DISPLAY is not set";
  return "";
}

std::unique_ptr<EditorParentInterface> create_editor_parent(int width, int height,
                                                            const std::string& title) {
  if (width <= 0 || height <= 0 || width > 8192 || height > 8192) {
    throw std::runtime_error("editor size " + std::to_string(width) + "x" + std::to_string(height) +
                             " out of range");
  }
  if (!editor_desktop_unavailable().empty()) throw std::runtime_error(editor_desktop_unavailable());
  return std::make_unique<EditorParentX11>(width, height, title);
}

}  // namespace plugcore
