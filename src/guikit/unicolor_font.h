#pragma once

#include <cstdint>

#include "guikit/font_interface.h"
#include "guikit/glyph_table.h"

namespace guikit {

// A font of coverage bytes (0..255) drawn in the colour the caller gives:
// d + ((k - d) x c) >> 8 per channel.
class UnicolorFont : public FontInterface {
 public:
  // `size` is the whole font picture, marker row included (height at least 1).
  UnicolorFont(Size size, const uint8_t* coverage);

  int draw_glyph(const Rect& source, Point dest, RenderingBufferInterface& buffer, uint32_t colour) const override;
  int32_t get_glyph_count() const override { return glyphs_.count(); }
  Glyph get_glyph(int32_t index) const override { return glyphs_[index]; }
  int32_t get_glyph_height() const override { return height_ - 1; }

 private:
  int32_t width_;
  int32_t height_;
  const uint8_t* coverage_;
  GlyphTable glyphs_;
};

}  // namespace guikit
