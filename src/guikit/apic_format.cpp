#include "guikit/apic_format.h"

namespace guikit {

namespace {

struct PixelLayout {
  int32_t kind;
  int32_t bits;
  int32_t bytes;
  bool indexed;  // first byte of each pixel is a palette index
};

const PixelLayout kLayouts[] = {
    {kApicOpaque, 8, 1, true},
    {kApicOpaque, 24, 4, false},
    {kApicAlpha, 8, 2, true},
    {kApicAlpha, 24, 4, false},
    {kApicUnicolorFont, 0, 1, false},
};

const PixelLayout* find_layout(int32_t kind, int32_t bits) {
  for (const PixelLayout& layout : kLayouts) {
    if (layout.kind == kind && layout.bits == bits) return &layout;
  }
  return nullptr;
}

int32_t field(const uint8_t* data, int index) { return static_cast<int32_t>(load_le32(data + 4 * index)); }

// True when [offset, offset + length) lies inside [0, size).
bool inside(int64_t offset, uint64_t length, size_t size) {
  if (offset < 0) return false;
  const uint64_t start = static_cast<uint64_t>(offset);
  return start <= size && length <= size - start;
}

}  // namespace

int32_t apic_bytes_per_pixel(int32_t kind, int32_t bits) {
  const PixelLayout* layout = find_layout(kind, bits);
  return layout ? layout->bytes : 0;
}

int read_apic_header(const uint8_t* data, size_t size, ApicHeader* header) {
  if (data == nullptr || size < kApicHeaderBytes) return kApicTruncatedHeader;
  ApicHeader h;
  h.flag = field(data, 0);
  h.header_size = field(data, 1);
  h.kind = field(data, 2);
  h.bits = field(data, 3);
  h.width = field(data, 4);
  h.height = field(data, 5);
  h.palette_count = field(data, 6);
  h.pixel_offset = field(data, 7);
  h.palette_offset = field(data, 8);

  if (h.flag == 0) return kApicZeroFlag;
  if (h.header_size < static_cast<int32_t>(kApicHeaderBytes) || static_cast<uint64_t>(h.header_size) > size) {
    return kApicShortHeaderSize;
  }
  if (h.width < 0 || h.height < 0) return kApicNegativeSize;
  if (h.bits == 8 && (h.palette_count < 0 || h.palette_count > kApicMaxPalette)) return kApicBadPaletteCount;
  const PixelLayout* layout = find_layout(h.kind, h.bits);
  if (layout == nullptr) return kApicBadBits;

  // Both factors are below 2^31, so the pixel count fits in 62 bits and the byte
  // count (at most 4 per pixel) in 64.
  const uint64_t pixel_count = static_cast<uint64_t>(h.width) * static_cast<uint64_t>(h.height);
  const uint64_t pixel_bytes = pixel_count * static_cast<uint64_t>(layout->bytes);
  if (!inside(h.pixel_offset, pixel_bytes, size)) return kApicPixelsOutside;

  if (layout->indexed && h.palette_count > 0) {
    if (h.palette_offset == 0) return kApicPaletteOutside;
    if (!inside(h.palette_offset, 4u * static_cast<uint64_t>(h.palette_count), size)) return kApicPaletteOutside;
  }
  if (layout->indexed) {
    // A palette lookup must never read past the stored entries.
    const uint8_t* pixels = data + h.pixel_offset;
    const size_t stride = static_cast<size_t>(layout->bytes);
    for (uint64_t i = 0; i < pixel_count; ++i) {
      if (pixels[i * stride] >= h.palette_count) return kApicIndexOutsidePalette;
    }
  }
  if (header) *header = h;
  return kApicOk;
}

}  // namespace guikit
