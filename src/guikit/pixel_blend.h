#pragma once

#include <cstdint>

// Integer blending of 32-bit buffer words (blue in the low byte, then green and
// red; the fourth byte is kept unless a whole word is stored).
namespace guikit {
namespace blend {

inline int32_t channel(uint32_t word, int shift) { return static_cast<int32_t>((word >> shift) & 0xFFu); }

// floor(v / 2^bits), rounding toward minus infinity without relying on how
// signed values shift.
inline int64_t floor_shift(int64_t v, int bits) {
  return v >= 0 ? (v >> bits) : -((-v + ((int64_t{1} << bits) - 1)) >> bits);
}
inline int32_t floor_div256(int32_t v) { return static_cast<int32_t>(floor_shift(v, 8)); }
inline int32_t floor_div65536(int64_t v) { return static_cast<int32_t>(floor_shift(v, 16)); }

inline uint32_t clamp_byte(int32_t v) { return static_cast<uint32_t>(v < 0 ? 0 : (v > 255 ? 255 : v)); }

// d + floor((s - d) * a / 256) per colour channel: rule of the alpha pictures
// with a palette and of both fonts.
inline uint32_t toward(uint32_t dest, uint32_t source, int32_t a) {
  uint32_t out = dest & 0xFF000000u;
  for (int shift = 0; shift < 24; shift += 8) {
    const int32_t d = channel(dest, shift);
    const int32_t s = channel(source, shift);
    out |= static_cast<uint32_t>(d + floor_div256((s - d) * a)) << shift;
  }
  return out;
}

// (s * a + d * (255 - a)) / 256 per colour channel: rule of true-colour alpha pictures.
inline uint32_t mix(uint32_t dest, uint32_t source, int32_t a) {
  uint32_t out = dest & 0xFF000000u;
  for (int shift = 0; shift < 24; shift += 8) {
    const int32_t d = channel(dest, shift);
    const int32_t s = channel(source, shift);
    out |= static_cast<uint32_t>((s * a + d * (255 - a)) >> 8) << shift;
  }
  return out;
}

// Rule A, with the whole-word shortcuts for transparent and opaque pixels.
inline uint32_t rule_a(uint32_t dest, uint32_t source, int32_t a) {
  if (a == 0) return dest;
  if (a == 255) return source;
  return toward(dest, source, a);
}

// Rule B, the same shortcuts.
inline uint32_t rule_b(uint32_t dest, uint32_t source, int32_t a) {
  if (a == 0) return dest;
  if (a == 255) return source;
  return mix(dest, source, a);
}

// Up to four weighted texels for one destination pixel.
struct TexelSum {
  uint32_t colour[4];
  int32_t weight[4];  // opacity byte x bilinear weight, in 1/65536
  int count = 0;

  void add(uint32_t c, int32_t alpha, int32_t w) {
    const int32_t aw = alpha * w;
    if (aw == 0) return;
    colour[count] = c;
    weight[count] = aw;
    ++count;
  }

  // d + floor(sum_k (c_k - d) * aw_k / 65536) per colour channel, held to a byte
  // (rounded weights may overshoot by one step).
  uint32_t apply(uint32_t dest) const {
    if (count == 0) return dest;
    uint32_t out = dest & 0xFF000000u;
    for (int shift = 0; shift < 24; shift += 8) {
      const int32_t d = channel(dest, shift);
      int64_t acc = 0;
      for (int k = 0; k < count; ++k) acc += static_cast<int64_t>(channel(colour[k], shift) - d) * weight[k];
      out |= clamp_byte(d + floor_div65536(acc)) << shift;
    }
    return out;
  }
};

}  // namespace blend
}  // namespace guikit
