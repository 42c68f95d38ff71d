#include "guikit/unicolor_font.h"

#include "guikit/pic_geometry.h"
#include "guikit/pixel_blend.h"

namespace guikit {

UnicolorFont::UnicolorFont(Size size, const uint8_t* coverage)
    : width_(size.width),
      height_(size.height),
      coverage_(coverage),
      glyphs_(coverage + static_cast<size_t>(size.height - 1) * size.width, size.width, 1) {}

int UnicolorFont::draw_glyph(const Rect& source, Point dest, RenderingBufferInterface& buffer,
                             uint32_t colour) const {
  DrawSpan span;
  if (!clip_glyph_span(source, dest, width_, get_glyph_height(), buffer.get_width(), buffer.get_height(), &span)) {
    return 0;
  }
  const uint8_t* src = coverage_ + static_cast<size_t>(span.src_y) * width_ + span.src_x;
  uint32_t* dst = buffer.get_pixels() + static_cast<size_t>(span.dst_y) * buffer.get_width() + span.dst_x;
  const size_t src_skip = static_cast<size_t>(width_ - span.width);
  const size_t dst_skip = static_cast<size_t>(buffer.get_width() - span.width);
  for (int32_t row = 0; row < span.height; ++row) {
    for (int32_t col = 0; col < span.width; ++col, ++src, ++dst) {
      if (*src != 0) *dst = blend::toward(*dst, colour, *src);
    }
    src += src_skip;
    dst += dst_skip;
  }
  return 0;
}

}  // namespace guikit
