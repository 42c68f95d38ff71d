#pragma once

#include <cstddef>
#include <cstdint>

#include "guikit/rect.h"
#include "guikit/rendering_buffer_interface.h"
#include "guikit/text.h"

namespace guikit {

// One glyph cell of a font picture: its width and the x of its first column.
struct Glyph {
  int32_t width = 0;
  int32_t x = 0;
};

// A bitmap font: glyph cells side by side in one picture row, the picture's last
// row marking the cells. Byte value n of a text draws glyph n. Drawing allocates
// nothing and answers 0.
class FontInterface {
 public:
  virtual ~FontInterface() = default;

  // Blends the glyph pixels of `source` (font picture coordinates, cut to the glyph
  // rows) into the buffer with the source's top-left at `dest`; cut to the buffer.
  // `colour` is 0x00RRGGBB (fonts with their own colours ignore it).
  virtual int draw_glyph(const Rect& source, Point dest, RenderingBufferInterface& buffer, uint32_t colour) const = 0;

  virtual int32_t get_glyph_count() const = 0;
  // The glyph of an index below get_glyph_count().
  virtual Glyph get_glyph(int32_t index) const = 0;
  virtual int32_t get_glyph_height() const = 0;

  // Sum of the widths of the bytes' glyphs; bytes without a glyph add nothing.
  virtual int32_t get_text_width(const char* chars, size_t length) const;

  // Draws one line into `rect` (buffer pixels): aligned inside the whole rectangle,
  // cut to the rectangle, the buffer and the glyph height; glyphs straddling an
  // edge lose their outside columns, bytes without a glyph are skipped.
  virtual int draw_text(const Rect& rect, uint32_t colour, const Text& text, RenderingBufferInterface& buffer) const;
};

}  // namespace guikit
