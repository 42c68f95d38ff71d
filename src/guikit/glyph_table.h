#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "guikit/font_interface.h"

namespace guikit {

// The glyph cells of a font picture, read from its marker row: each maximal run of
// equal marker bytes is one cell, the n-th run from the left glyph n.
class GlyphTable {
 public:
  GlyphTable() = default;
  // `marker` points at the first marker byte; successive bytes are `stride` apart.
  GlyphTable(const uint8_t* marker, int32_t width, size_t stride);

  int32_t count() const { return static_cast<int32_t>(glyphs_.size()); }
  const Glyph& operator[](int32_t index) const { return glyphs_[static_cast<size_t>(index)]; }

 private:
  std::vector<Glyph> glyphs_;
};

}  // namespace guikit
