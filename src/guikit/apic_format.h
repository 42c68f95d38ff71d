#pragma once

#include <cstddef>
#include <cstdint>

namespace guikit {

// Header of an "APIC" picture resource: nine little-endian 32-bit signed fields,
// then palette and pixel bytes at the offsets the header gives.
struct ApicHeader {
  int32_t flag = 0;
  int32_t header_size = 0;
  int32_t kind = 0;
  int32_t bits = 0;
  int32_t width = 0;
  int32_t height = 0;
  int32_t palette_count = 0;
  int32_t pixel_offset = 0;
  int32_t palette_offset = 0;
};

enum ApicKind : int32_t { kApicOpaque = 0, kApicAlpha = 1, kApicUnicolorFont = 2 };

constexpr size_t kApicHeaderBytes = 36;
constexpr int32_t kApicMaxPalette = 256;

// Status codes of read_apic_header; 0 means the resource may be read safely.
enum ApicStatus : int {
  kApicOk = 0,
  kApicTruncatedHeader = -1,
  kApicZeroFlag = -2,
  kApicShortHeaderSize = -3,
  kApicNegativeSize = -4,
  kApicBadPaletteCount = -5,
  kApicBadBits = -6,
  kApicPixelsOutside = -7,
  kApicPaletteOutside = -8,
  kApicIndexOutsidePalette = -9,
};

// Bytes per pixel for a kind and bit depth, 0 when the pair has no reader.
int32_t apic_bytes_per_pixel(int32_t kind, int32_t bits);

// Reads the header and checks every field against the resource size: the pixel
// block (width x height x bytes per pixel, computed without overflow) and the
// palette must lie wholly inside the data, and for 8-bit pictures every stored
// palette index must name an existing entry. A kind and bit depth without a
// reader is refused too; which classes a caller accepts is the caller's choice.
int read_apic_header(const uint8_t* data, size_t size, ApicHeader* header);

// Little-endian 32-bit word at p (no alignment needed).
inline uint32_t load_le32(const uint8_t* p) {
  return static_cast<uint32_t>(p[0]) | (static_cast<uint32_t>(p[1]) << 8) |
         (static_cast<uint32_t>(p[2]) << 16) | (static_cast<uint32_t>(p[3]) << 24);
}

}  // namespace guikit
