#include "guikit/alpha_pic_data24.h"

#include "guikit/alpha_drawing.h"
#include "guikit/apic_format.h"
#include "guikit/pixel_blend.h"

namespace guikit {

AlphaPicData24::AlphaPicData24(Size size, const uint8_t* pixels)
    : width_(size.width), height_(size.height), pixels_(pixels) {}

void AlphaPicData24::fetch(int32_t x, int32_t y, uint32_t* colour, int32_t* alpha) const {
  const uint8_t* pixel = pixels_ + 4 * (static_cast<size_t>(y) * width_ + x);
  *colour = load_le32(pixel);
  *alpha = pixel[3];
}

int AlphaPicData24::draw(const Rect& view, RenderingBufferInterface& buffer, const Rect& clip) const {
  DrawSpan span;
  if (!clip_draw_span(view, clip, width_, height_, buffer.get_width(), buffer.get_height(), &span)) return 0;
  const uint8_t* src = pixels_ + 4 * (static_cast<size_t>(span.src_y) * width_ + span.src_x);
  uint32_t* dst = buffer.get_pixels() + static_cast<size_t>(span.dst_y) * buffer.get_width() + span.dst_x;
  const size_t src_skip = 4 * static_cast<size_t>(width_ - span.width);
  const size_t dst_skip = static_cast<size_t>(buffer.get_width() - span.width);
  for (int32_t row = 0; row < span.height; ++row) {
    for (int32_t col = 0; col < span.width; ++col, src += 4, ++dst) {
      if (src[3] == 0) continue;
      *dst = blend::rule_b(*dst, load_le32(src), src[3]);
    }
    src += src_skip;
    dst += dst_skip;
  }
  return 0;
}

int AlphaPicData24::draw_rotated(float cx, float cy, float angle, RenderingBufferInterface& buffer,
                                const Rect& clip) const {
  return alpha_drawing::draw_turned(*this, width_, height_, cx, cy, angle, buffer, clip, 1.0f);
}

int AlphaPicData24::draw_rotated_faded(float cx, float cy, float angle, RenderingBufferInterface& buffer,
                                      const Rect& clip, float opacity) const {
  return alpha_drawing::draw_turned(*this, width_, height_, cx, cy, angle, buffer, clip, opacity);
}

int AlphaPicData24::draw_at(float x, float y, Size size, RenderingBufferInterface& buffer, const Rect& clip) const {
  return alpha_drawing::draw_subpixel(*this, width_, height_, x, y, size, buffer, clip, 1.0f);
}

int AlphaPicData24::draw_at_faded(float x, float y, Size size, RenderingBufferInterface& buffer, const Rect& clip,
                                 float opacity) const {
  return alpha_drawing::draw_subpixel(*this, width_, height_, x, y, size, buffer, clip, opacity);
}

}  // namespace guikit
