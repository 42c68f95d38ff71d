#pragma once

#include <cstdint>
#include <vector>

#include "guikit/rendering_buffer_interface.h"

namespace guikit {

// A rendering buffer in memory: the off-screen window's surface and the tests'.
class MemoryRenderingBuffer : public RenderingBufferInterface {
 public:
  MemoryRenderingBuffer(int32_t width, int32_t height, uint32_t fill = 0)
      : width_(width > 0 ? width : 0),
        height_(height > 0 ? height : 0),
        pixels_(static_cast<size_t>(width_) * static_cast<size_t>(height_), fill) {}

  int32_t get_width() const override { return width_; }
  int32_t get_height() const override { return height_; }
  uint32_t* get_pixels() override { return pixels_.data(); }
  void blit(Point position, Size size) override { ++blit_count_; }

  uint32_t pixel(int32_t x, int32_t y) const { return pixels_[static_cast<size_t>(y) * width_ + x]; }
  int blit_count() const { return blit_count_; }

 private:
  int32_t width_;
  int32_t height_;
  std::vector<uint32_t> pixels_;
  int blit_count_ = 0;
};

}  // namespace guikit
