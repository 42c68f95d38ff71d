#include "guikit/multicolor_font.h"

#include "guikit/apic_format.h"
#include "guikit/pic_geometry.h"
#include "guikit/pixel_blend.h"

namespace guikit {

MulticolorFont::MulticolorFont(Size size, const uint8_t* pairs, const uint8_t* palette)
    : width_(size.width),
      height_(size.height),
      pairs_(pairs),
      palette_(palette),
      glyphs_(pairs + 2 * static_cast<size_t>(size.height - 1) * size.width, size.width, 2) {}

int MulticolorFont::draw_glyph(const Rect& source, Point dest, RenderingBufferInterface& buffer, uint32_t) const {
  DrawSpan span;
  if (!clip_glyph_span(source, dest, width_, get_glyph_height(), buffer.get_width(), buffer.get_height(), &span)) {
    return 0;
  }
  const uint8_t* src = pairs_ + 2 * (static_cast<size_t>(span.src_y) * width_ + span.src_x);
  uint32_t* dst = buffer.get_pixels() + static_cast<size_t>(span.dst_y) * buffer.get_width() + span.dst_x;
  const size_t src_skip = 2 * static_cast<size_t>(width_ - span.width);
  const size_t dst_skip = static_cast<size_t>(buffer.get_width() - span.width);
  for (int32_t row = 0; row < span.height; ++row) {
    for (int32_t col = 0; col < span.width; ++col, src += 2, ++dst) {
      const int32_t weight = 255 - src[1];
      if (weight != 0) *dst = blend::toward(*dst, load_le32(palette_ + 4 * size_t{src[0]}), weight);
    }
    src += src_skip;
    dst += dst_skip;
  }
  return 0;
}

}  // namespace guikit
