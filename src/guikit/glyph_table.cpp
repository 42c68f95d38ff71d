#include "guikit/glyph_table.h"

namespace guikit {

GlyphTable::GlyphTable(const uint8_t* marker, int32_t width, size_t stride) {
  int32_t start = 0;
  for (int32_t x = 1; x <= width; ++x) {
    if (x == width || marker[x * stride] != marker[start * stride]) {
      glyphs_.push_back(Glyph{x - start, start});
      start = x;
    }
  }
}

}  // namespace guikit
