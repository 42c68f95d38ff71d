#include "guikit/font_interface.h"

#include "guikit/pic_geometry.h"
#include "guikit/pixel_blend.h"

namespace guikit {

void Text::measure(const FontInterface& font) {
  pixel_width_ = font.get_text_width(chars_.data(), chars_.size());
  pixel_height_ = font.get_glyph_height();
}

int32_t FontInterface::get_text_width(const char* chars, size_t length) const {
  const int32_t count = get_glyph_count();
  int64_t width = 0;
  for (size_t i = 0; i < length; ++i) {
    const int32_t index = static_cast<unsigned char>(chars[i]);
    if (index < count) width += get_glyph(index).width;
  }
  return width > INT32_MAX ? INT32_MAX : static_cast<int32_t>(width);
}

int FontInterface::draw_text(const Rect& rect, uint32_t colour, const Text& text,
                             RenderingBufferInterface& buffer) const {
  const int64_t glyph_bottom = int64_t{rect.top} + get_glyph_height();
  WideRect area = WideRect::of(rect).intersect(WideRect{0, 0, buffer.get_width(), buffer.get_height()});
  if (glyph_bottom < area.bottom) area.bottom = glyph_bottom;
  if (area.empty()) return 0;

  // Alignment uses the whole rectangle, so a text cut by a repaint tile stays put.
  const int64_t slack = int64_t{rect.right} - rect.left - get_text_width(text.data(), text.length());
  int64_t pen = rect.left;
  if (text.get_alignment() == kAlignCentre) {
    pen += blend::floor_shift(slack, 1);
  } else if (text.get_alignment() != kAlignLeft) {
    pen += slack;
  }

  const int32_t count = get_glyph_count();
  const int32_t first_row = static_cast<int32_t>(area.top - rect.top);
  const int32_t last_row = static_cast<int32_t>(area.bottom - rect.top);
  for (size_t i = 0; i < text.length(); ++i) {
    const int32_t index = static_cast<unsigned char>(text.data()[i]);
    if (index >= count) continue;
    const Glyph glyph = get_glyph(index);
    const int64_t left = pen > area.left ? pen : area.left;
    const int64_t right = pen + glyph.width < area.right ? pen + glyph.width : area.right;
    if (left < right) {
      const Rect source{static_cast<int32_t>(glyph.x + (left - pen)), first_row,
                        static_cast<int32_t>(glyph.x + (right - pen)), last_row};
      draw_glyph(source, Point{static_cast<int32_t>(left), static_cast<int32_t>(area.top)}, buffer, colour);
    }
    pen += glyph.width;
  }
  return 0;
}

}  // namespace guikit
