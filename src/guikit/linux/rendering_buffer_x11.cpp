#include "guikit/linux/rendering_buffer_x11.h"

#include <X11/Xutil.h>

namespace guikit {

bool RenderingBufferX11::create(Display* display, Visual* visual, int depth, Size size) {
  destroy();
  if (size.width <= 0 || size.height <= 0) return false;
  // Our pixels are the visual's pixels only for 8-bit red, green and blue fields.
  if (visual->red_mask != 0xFF0000u || visual->green_mask != 0x00FF00u || visual->blue_mask != 0x0000FFu) return false;
  pixels_.assign(static_cast<size_t>(size.width) * static_cast<size_t>(size.height), 0);
  image_ = XCreateImage(display, visual, static_cast<unsigned>(depth), ZPixmap, 0,
                        reinterpret_cast<char*>(pixels_.data()), static_cast<unsigned>(size.width),
                        static_cast<unsigned>(size.height), 32, size.width * 4);
  if (!image_) {
    pixels_.clear();
    return false;
  }
  // The bytes in memory are blue, green, red, unused: least significant first.
  image_->byte_order = LSBFirst;
  image_->bitmap_bit_order = LSBFirst;
  display_ = display;
  width_ = size.width;
  height_ = size.height;
  return true;
}

void RenderingBufferX11::destroy() {
  if (image_) {
    image_->data = nullptr;  // the pixels are ours, not Xlib's to free
    XDestroyImage(image_);
    image_ = nullptr;
  }
  pixels_.clear();
  width_ = height_ = 0;
  display_ = nullptr;
}

void RenderingBufferX11::blit(Point position, Size size) {
  if (!image_ || !window_ || !gc_) return;
  int w = size.width < width_ ? size.width : width_;
  int h = size.height < height_ ? size.height : height_;
  if (w <= 0 || h <= 0) return;
  XPutImage(display_, window_, gc_, image_, 0, 0, position.x, position.y, static_cast<unsigned>(w),
            static_cast<unsigned>(h));
}

}  // namespace guikit
