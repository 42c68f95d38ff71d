#pragma once

#include <cstdint>

#include "guikit/pic_data_interface.h"

namespace guikit {

// Palette picture with opacity: pairs (palette index, opacity 0..255). Whole-pixel
// drawing uses d + ((s - d) x a) >> 8 per channel; fractional and rotated drawing
// blend four texels bilinearly.
class AlphaPicData8 : public PicDataInterface {
 public:
  AlphaPicData8(Size size, const uint8_t* pairs, const uint8_t* palette);

  int32_t get_width() const override { return width_; }
  int32_t get_height() const override { return height_; }
  int draw(const Rect& view, RenderingBufferInterface& buffer, const Rect& clip) const override;
  int draw_rotated(float cx, float cy, float angle, RenderingBufferInterface& buffer, const Rect& clip) const override;
  int draw_rotated_faded(float cx, float cy, float angle, RenderingBufferInterface& buffer, const Rect& clip,
                         float opacity) const override;
  int draw_at(float x, float y, Size size, RenderingBufferInterface& buffer, const Rect& clip) const override;
  int draw_at_faded(float x, float y, Size size, RenderingBufferInterface& buffer, const Rect& clip,
                    float opacity) const override;

  // Texel access for the shared blending code.
  void fetch(int32_t x, int32_t y, uint32_t* colour, int32_t* alpha) const;

 private:
  int32_t width_;
  int32_t height_;
  const uint8_t* pairs_;
  const uint8_t* palette_;
};

}  // namespace guikit
