#pragma once

#include <cstdint>

#include "guikit/pic_data_interface.h"

namespace guikit {

// Opaque true-colour picture: 4 bytes per pixel (blue, green, red, ignored),
// copied as whole words.
class PicData24 : public PicDataInterface {
 public:
  PicData24(Size size, const uint8_t* pixels);

  int32_t get_width() const override { return width_; }
  int32_t get_height() const override { return height_; }
  int draw(const Rect& view, RenderingBufferInterface& buffer, const Rect& clip) const override;

 private:
  int32_t width_;
  int32_t height_;
  const uint8_t* pixels_;
};

}  // namespace guikit
