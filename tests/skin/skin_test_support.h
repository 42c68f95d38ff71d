// Reading the embedded skin back through the toolkit's own readers, and finding which
// editor pixels a picture really touches.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "guikit/memory_rendering_buffer.h"
#include "guikit/pic_data_factory.h"
#include "guikit/pic_data_interface.h"
#include "guikit/rect.h"

namespace skin_test {

constexpr int kEditorWidth = 609;
constexpr int kEditorHeight = 282;

inline std::unique_ptr<guikit::PicDataInterface> picture(const std::string& name) {
  return guikit::PicDataFactory::instance().create_picture(name.c_str());
}

// Pixels a control draws, on the editor surface plus a margin all round, so that a
// picture spilling off the surface is seen too.
class Footprint {
 public:
  static constexpr int kMargin = 64;
  Footprint() : touched_(static_cast<size_t>(width()) * height(), 0) {}

  static int width() { return kEditorWidth + 2 * kMargin; }
  static int height() { return kEditorHeight + 2 * kMargin; }

  // Draws the picture with its top-left corner at editor (x, y) onto a black and a
  // white surface; a pixel counts when either surface changed. The surfaces are the
  // picture's own size, which keeps this quick for long frame strips.
  void add(const guikit::PicDataInterface& pic, int x, int y) {
    const int w = pic.get_width(), h = pic.get_height();
    for (uint32_t fill : {0x00000000u, 0x00FFFFFFu}) {
      guikit::MemoryRenderingBuffer buffer(w, h, fill);
      pic.draw(guikit::view_for_position(0, 0, {w, h}), buffer, guikit::Rect{0, 0, w, h});
      for (int py = 0; py < h; ++py) {
        for (int px = 0; px < w; ++px) {
          if ((buffer.pixel(px, py) & 0x00FFFFFFu) != fill) {
            mark(x + px, y + py);
          }
        }
      }
    }
  }

  bool touched(int editor_x, int editor_y) const {
    const int px = editor_x + kMargin, py = editor_y + kMargin;
    if (px < 0 || py < 0 || px >= width() || py >= height()) return false;
    return touched_[static_cast<size_t>(py) * width() + px] != 0;
  }

  // Bounding box of everything drawn, in editor pixels; empty when nothing was.
  guikit::Rect bounds() const {
    guikit::Rect r{1 << 20, 1 << 20, -(1 << 20), -(1 << 20)};
    for (int py = 0; py < height(); ++py) {
      for (int px = 0; px < width(); ++px) {
        if (touched_[static_cast<size_t>(py) * width() + px] == 0) continue;
        const int x = px - kMargin, y = py - kMargin;
        r.left = x < r.left ? x : r.left;
        r.top = y < r.top ? y : r.top;
        r.right = x + 1 > r.right ? x + 1 : r.right;
        r.bottom = y + 1 > r.bottom ? y + 1 : r.bottom;
      }
    }
    return r;
  }

 private:
  void mark(int editor_x, int editor_y) {
    const int px = editor_x + kMargin, py = editor_y + kMargin;
    if (px < 0 || py < 0 || px >= width() || py >= height()) {
      off_canvas_ = true;
      return;
    }
    touched_[static_cast<size_t>(py) * width() + px] = 1;
  }

 public:
  // True when something landed beyond the margin around the editor.
  bool off_canvas() const { return off_canvas_; }

 private:
  std::vector<uint8_t> touched_;
  bool off_canvas_ = false;
};

inline bool inside(const guikit::Rect& inner, const guikit::Rect& outer) {
  return inner.left >= outer.left && inner.top >= outer.top && inner.right <= outer.right &&
         inner.bottom <= outer.bottom;
}

}  // namespace skin_test
