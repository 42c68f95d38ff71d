#pragma once

// Independent per-pixel references for the picture and font tests.

#include <cmath>
#include <cstdint>
#include <vector>

#include "guikit/memory_rendering_buffer.h"
#include "guikit/rect.h"

namespace apic_test {

// A buffer filled with a recognisable pattern (fourth byte set too, to see it kept).
inline guikit::MemoryRenderingBuffer patterned_buffer(int32_t width, int32_t height) {
  guikit::MemoryRenderingBuffer buffer(width, height);
  for (int32_t y = 0; y < height; ++y) {
    for (int32_t x = 0; x < width; ++x) {
      buffer.get_pixels()[y * width + x] =
          0xA5000000u | (static_cast<uint32_t>(x * 37 + y * 11) & 0xFF) << 16 |
          (static_cast<uint32_t>(x * 5 + y * 71) & 0xFF) << 8 | (static_cast<uint32_t>(x * 13 + y * 29 + 7) & 0xFF);
    }
  }
  return buffer;
}

inline std::vector<uint32_t> snapshot(const guikit::MemoryRenderingBuffer& buffer) {
  std::vector<uint32_t> out;
  for (int32_t y = 0; y < buffer.get_height(); ++y) {
    for (int32_t x = 0; x < buffer.get_width(); ++x) out.push_back(buffer.pixel(x, y));
  }
  return out;
}

inline int32_t byte_of(uint32_t word, int channel) { return static_cast<int32_t>((word >> (8 * channel)) & 0xFF); }

// d + floor((s - d) * a / 256), worked out in double.
inline uint32_t reference_toward(uint32_t d, uint32_t s, int32_t a) {
  uint32_t out = d & 0xFF000000u;
  for (int c = 0; c < 3; ++c) {
    const double dc = byte_of(d, c);
    const double v = dc + std::floor((byte_of(s, c) - dc) * a / 256.0);
    out |= static_cast<uint32_t>(v) << (8 * c);
  }
  return out;
}

// Picture pixel (x, y) shown at buffer (x - view.left, y - view.top) when it lies
// in the picture, view and clip.
inline bool shown(int32_t x, int32_t y, int32_t width, int32_t height, const guikit::Rect& view,
                  const guikit::Rect& clip) {
  return x >= 0 && y >= 0 && x < width && y < height && view.contains(x, y) && clip.contains(x, y);
}

}  // namespace apic_test
