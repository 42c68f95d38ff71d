#pragma once

// Hand-made "APIC" pictures in memory for the toolkit tests: header, palette and
// pixels laid out as the stored resources are (palette right after the header,
// pixels right after the palette).

#include <cstdint>
#include <cstring>
#include <utility>
#include <vector>

namespace apic_test {

enum Field { kFlag = 0, kHeaderSize, kKind, kBits, kWidth, kHeight, kPaletteCount, kPixelOffset, kPaletteOffset };

struct ApicBuilder {
  int32_t flag = -1;
  int32_t kind = 0;
  int32_t bits = 8;
  int32_t width = 0;
  int32_t height = 0;
  std::vector<uint32_t> palette;  // 0x00RRGGBB, written blue, green, red, 0
  std::vector<uint8_t> pixels;    // raw pixel bytes, rows top to bottom

  std::vector<uint8_t> build() const {
    std::vector<uint8_t> out(36 + 4 * palette.size() + pixels.size());
    const int32_t fields[9] = {flag,
                               36,
                               kind,
                               bits,
                               width,
                               height,
                               static_cast<int32_t>(palette.size()),
                               static_cast<int32_t>(36 + 4 * palette.size()),
                               palette.empty() ? 0 : 36};
    for (int i = 0; i < 9; ++i) put(&out, i, fields[i]);
    for (size_t i = 0; i < palette.size(); ++i) {
      for (int b = 0; b < 4; ++b) out[36 + 4 * i + b] = static_cast<uint8_t>(palette[i] >> (8 * b));
    }
    if (!pixels.empty()) std::memcpy(out.data() + 36 + 4 * palette.size(), pixels.data(), pixels.size());
    return out;
  }

  // Overwrites one header field (little-endian) of a built resource.
  static void put(std::vector<uint8_t>* bytes, int field, int32_t value) {
    const uint32_t v = static_cast<uint32_t>(value);
    for (int b = 0; b < 4; ++b) (*bytes)[4 * field + b] = static_cast<uint8_t>(v >> (8 * b));
  }
};

// Opaque palette picture from one index per pixel.
inline ApicBuilder opaque8(int32_t width, int32_t height, std::vector<uint32_t> palette, std::vector<uint8_t> indices) {
  ApicBuilder b;
  b.kind = 0;
  b.bits = 8;
  b.width = width;
  b.height = height;
  b.palette = std::move(palette);
  b.pixels = std::move(indices);
  return b;
}

// Palette picture with opacity from (index, opacity) pairs.
inline ApicBuilder alpha8(int32_t width, int32_t height, std::vector<uint32_t> palette,
                          const std::vector<std::pair<uint8_t, uint8_t>>& pairs) {
  ApicBuilder b;
  b.kind = 1;
  b.bits = 8;
  b.width = width;
  b.height = height;
  b.palette = std::move(palette);
  for (const auto& p : pairs) {
    b.pixels.push_back(p.first);
    b.pixels.push_back(p.second);
  }
  return b;
}

// True-colour picture (kind 0 or 1) from words 0xAARRGGBB (AA is the opacity for kind 1).
inline ApicBuilder true_colour(int32_t kind, int32_t width, int32_t height, const std::vector<uint32_t>& words) {
  ApicBuilder b;
  b.kind = kind;
  b.bits = 24;
  b.width = width;
  b.height = height;
  for (uint32_t w : words) {
    for (int i = 0; i < 4; ++i) b.pixels.push_back(static_cast<uint8_t>(w >> (8 * i)));
  }
  return b;
}

// Unicolour font from coverage rows; the marker row is made of cells of the given
// widths, alternating 0 and 255.
inline ApicBuilder unicolor_font(const std::vector<int32_t>& cell_widths, int32_t glyph_height,
                                 const std::vector<uint8_t>& coverage) {
  ApicBuilder b;
  b.kind = 2;
  b.bits = 0;
  b.flag = 1;
  int32_t width = 0;
  for (int32_t w : cell_widths) width += w;
  b.width = width;
  b.height = glyph_height + 1;
  const size_t glyph_bytes = static_cast<size_t>(width) * static_cast<size_t>(glyph_height);
  b.pixels.assign(glyph_bytes + static_cast<size_t>(width), 0);
  for (size_t i = 0; i < coverage.size() && i < glyph_bytes; ++i) b.pixels[i] = coverage[i];
  size_t x = glyph_bytes;
  uint8_t marker = 0;
  for (int32_t w : cell_widths) {
    for (int32_t i = 0; i < w; ++i) b.pixels[x++] = marker;
    marker = static_cast<uint8_t>(255 - marker);
  }
  return b;
}

}  // namespace apic_test
