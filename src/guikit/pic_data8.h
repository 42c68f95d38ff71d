#pragma once

#include <cstdint>

#include "guikit/pic_data_interface.h"

namespace guikit {

// Opaque palette picture: one index byte per pixel, 4-byte palette entries
// (blue, green, red, 0). Every index must name a stored entry (the reader checks).
class PicData8 : public PicDataInterface {
 public:
  PicData8(Size size, const uint8_t* pixels, const uint8_t* palette);

  int32_t get_width() const override { return width_; }
  int32_t get_height() const override { return height_; }
  int draw(const Rect& view, RenderingBufferInterface& buffer, const Rect& clip) const override;

 private:
  int32_t width_;
  int32_t height_;
  const uint8_t* pixels_;
  const uint8_t* palette_;
};

}  // namespace guikit
