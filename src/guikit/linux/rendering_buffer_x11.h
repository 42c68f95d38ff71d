#pragma once

#include <X11/Xlib.h>

#include <cstdint>
#include <vector>

#include "guikit/rendering_buffer_interface.h"

namespace guikit {

// The window's drawing surface: 32-bit pixels (blue, green, red, unused) in our
// memory, shown on the window through an XImage of the same layout.
class RenderingBufferX11 : public RenderingBufferInterface {
 public:
  RenderingBufferX11() = default;
  ~RenderingBufferX11() override { destroy(); }
  RenderingBufferX11(const RenderingBufferX11&) = delete;
  RenderingBufferX11& operator=(const RenderingBufferX11&) = delete;

  // false when the visual cannot show 32-bit BGRX pixels as they are.
  bool create(Display* display, Visual* visual, int depth, Size size);
  void destroy();
  // The window the paint in progress draws on.
  void set_target(Window window, GC gc) {
    window_ = window;
    gc_ = gc;
  }

  int32_t get_width() const override { return width_; }
  int32_t get_height() const override { return height_; }
  uint32_t* get_pixels() override { return pixels_.data(); }
  void blit(Point position, Size size) override;

 private:
  Display* display_ = nullptr;
  XImage* image_ = nullptr;
  Window window_ = 0;
  GC gc_ = nullptr;
  int32_t width_ = 0;
  int32_t height_ = 0;
  std::vector<uint32_t> pixels_;
};

}  // namespace guikit
