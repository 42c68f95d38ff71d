#include "guikit/pic_data8.h"

#include "guikit/apic_format.h"
#include "guikit/pic_geometry.h"

namespace guikit {

PicData8::PicData8(Size size, const uint8_t* pixels, const uint8_t* palette)
    : width_(size.width), height_(size.height), pixels_(pixels), palette_(palette) {}

int PicData8::draw(const Rect& view, RenderingBufferInterface& buffer, const Rect& clip) const {
  DrawSpan span;
  if (!clip_draw_span(view, clip, width_, height_, buffer.get_width(), buffer.get_height(), &span)) return 0;
  const uint8_t* src = pixels_ + static_cast<size_t>(span.src_y) * width_ + span.src_x;
  uint32_t* dst = buffer.get_pixels() + static_cast<size_t>(span.dst_y) * buffer.get_width() + span.dst_x;
  const size_t src_skip = static_cast<size_t>(width_ - span.width);
  const size_t dst_skip = static_cast<size_t>(buffer.get_width() - span.width);
  for (int32_t row = 0; row < span.height; ++row) {
    for (int32_t col = 0; col < span.width; ++col) *dst++ = load_le32(palette_ + 4 * size_t{*src++});
    src += src_skip;
    dst += dst_skip;
  }
  return 0;
}

}  // namespace guikit
