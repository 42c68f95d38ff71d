#pragma once

#include <cmath>
#include <cstdint>
#include <cstring>

// Bit-level base-2 logarithm and power for the dynamics stage: a quadratic
// on the mantissa, exact at powers of two, no library call per sample.

// For v > 0. Other inputs give a finite or NaN result, never undefined behaviour.
inline float fast_log2(float v) {
  std::uint32_t bits;
  std::memcpy(&bits, &v, sizeof bits);
  const int e = int((bits >> 23) & 0xffu);
  const std::uint32_t mbits = (bits & 0x007fffffu) | 0x3f800000u;
  float m;
  std::memcpy(&m, &mbits, sizeof m);
  const float third = 1.0f / 3.0f;
  const float two_thirds = 2.0f / 3.0f;
  // Mantissa polynomial first, exponent last: whole octaves then stay exact
  // instead of losing the polynomial's low bits to a large exponent.
  const float mantissa_part = (2.0f - m * third) * m - two_thirds;
  return mantissa_part + float(e - 128);
}

// Expected within -126..127. Below -126 (and NaN) gives 0; 128 and above give
// the largest finite float.
inline float fast_exp2(float t) {
  if (!(t >= -126.0f)) return 0.0f;
  if (t >= 128.0f) {
    const std::uint32_t max_bits = 0x7f7fffffu;
    float r;
    std::memcpy(&r, &max_bits, sizeof r);
    return r;
  }
  const float j = std::floor(t);
  const float u = 1.0f + (t - j);
  const float p = u * u * (1.0f / 3.0f) + 2.0f / 3.0f;
  // 2^j * p by adding j to the exponent of p: for 1 <= p < 2 this is p's
  // mantissa under the exponent j + 127, and it stays right when t - j rounds
  // up to 1 for a tiny negative t (p = 2, one octave up, not one down).
  std::uint32_t pbits;
  std::memcpy(&pbits, &p, sizeof pbits);
  const std::uint32_t bits = pbits + (std::uint32_t(int(j) + 127) << 23) - (127u << 23);
  float r;
  std::memcpy(&r, &bits, sizeof r);
  return r;
}
