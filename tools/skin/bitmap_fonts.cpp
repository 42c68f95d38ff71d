// The editor's two bitmap fonts: 256 glyph cells side by side in one row, a marker
// row underneath that tells the cells apart (runs of 0 and 255). Byte values follow
// the Windows Western code page, so texts typed on either system look the same.
#include <ft2build.h>
#include FT_FREETYPE_H

#include <stdexcept>
#include <string>
#include <vector>

#include "pictures.h"

namespace skin {

namespace {

// Code points of bytes 0x80..0x9F; 0 where the code page leaves a byte unused.
constexpr uint32_t kHighControls[32] = {
    0x20AC, 0,      0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0,      0x017D, 0,      0,      0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0,      0x017E, 0x0178};

uint32_t code_point(int byte) {
  if (byte < 32 || byte == 127) {
    return 0;
  }
  if (byte >= 0x80 && byte < 0xA0) {
    return kHighControls[byte - 0x80];
  }
  return static_cast<uint32_t>(byte);
}

struct FontSpec {
  const char* name;
  Face face;
  int pixel_size;
  int glyph_rows;
  int total_width;  // the cells of unused bytes take up what the glyphs leave
};

constexpr FontSpec kSpecs[2] = {
    {"font_03", Face::kRegular, 10, 12, 1863},
    {"font_04", Face::kBold, 12, 14, 1946},
};

struct Glyph {
  int width = 0;
  int left = 0, top = 0;
  int rows = 0, cols = 0;
  std::vector<uint8_t> bitmap;
};

Picture render(FT_Library library, const FontSpec& font) {
  FT_Face face = nullptr;
  if (FT_New_Face(library, font_path(font.face).c_str(), 0, &face) != 0 ||
      FT_Set_Pixel_Sizes(face, 0, font.pixel_size) != 0) {
    throw std::runtime_error(std::string("make_skin: cannot size the font for ") + font.name);
  }
  const int baseline = static_cast<int>((face->size->metrics.ascender + 32) >> 6);
  std::vector<Glyph> glyphs(256);
  int used = 0;
  int unused_cells = 0;
  for (int byte = 0; byte < 256; ++byte) {
    const uint32_t cp = code_point(byte);
    if (cp == 0) {
      ++unused_cells;
      continue;
    }
    if (FT_Load_Char(face, cp, FT_LOAD_RENDER | FT_LOAD_TARGET_LIGHT) != 0) {
      throw std::runtime_error(std::string("make_skin: glyph missing in ") + font.name);
    }
    const FT_GlyphSlot slot = face->glyph;
    Glyph& g = glyphs[byte];
    g.width = static_cast<int>((slot->advance.x + 32) >> 6);
    if (g.width < 1) {
      g.width = 1;
    }
    g.left = slot->bitmap_left;
    g.top = slot->bitmap_top;
    g.rows = static_cast<int>(slot->bitmap.rows);
    g.cols = static_cast<int>(slot->bitmap.width);
    g.bitmap.resize(static_cast<size_t>(g.rows) * g.cols);
    for (int y = 0; y < g.rows; ++y) {
      for (int x = 0; x < g.cols; ++x) {
        g.bitmap[static_cast<size_t>(y) * g.cols + x] = slot->bitmap.buffer[y * slot->bitmap.pitch + x];
      }
    }
    used += g.width;
  }
  FT_Done_Face(face);
  const int slack = font.total_width - used;
  if (slack < unused_cells) {
    throw std::runtime_error(std::string("make_skin: glyphs too wide for ") + font.name);
  }
  int given = 0;
  for (int byte = 0; byte < 256; ++byte) {
    if (code_point(byte) == 0) {
      glyphs[byte].width = slack / unused_cells + (given < slack % unused_cells ? 1 : 0);
      ++given;
    }
  }
  Picture p;
  p.name = font.name;
  p.kind = kApicUnicolorFont;
  p.flag = kFlagOne;
  p.image.width = font.total_width;
  p.image.height = font.glyph_rows + 1;
  p.coverage.assign(static_cast<size_t>(p.image.width) * p.image.height, 0);
  int cell = 0;
  for (int byte = 0; byte < 256; ++byte) {
    const Glyph& g = glyphs[byte];
    for (int y = 0; y < g.rows; ++y) {
      const int row = baseline - g.top + y;
      if (row < 0 || row >= font.glyph_rows) {
        continue;
      }
      for (int x = 0; x < g.cols; ++x) {
        const int col = g.left + x;
        if (col < 0 || col >= g.width) {
          continue;
        }
        uint8_t& d = p.coverage[static_cast<size_t>(row) * p.image.width + cell + col];
        const uint8_t s = g.bitmap[static_cast<size_t>(y) * g.cols + x];
        d = s > d ? s : d;
      }
    }
    const uint8_t marker = (byte % 2) ? 255 : 0;
    for (int x = 0; x < g.width; ++x) {
      p.coverage[static_cast<size_t>(font.glyph_rows) * p.image.width + cell + x] = marker;
    }
    cell += g.width;
  }
  return p;
}

}  // namespace

void add_fonts(std::vector<Picture>& out) {
  FT_Library library = nullptr;
  if (FT_Init_FreeType(&library) != 0) {
    throw std::runtime_error("make_skin: cannot start FreeType");
  }
  for (const FontSpec& font : kSpecs) {
    out.push_back(render(library, font));
  }
  FT_Done_FreeType(library);
}

}  // namespace skin
