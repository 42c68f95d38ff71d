#pragma once

#include <cmath>
#include <cstdint>

#include "guikit/pic_geometry.h"
#include "guikit/pixel_blend.h"
#include "guikit/rendering_buffer_interface.h"

// Sub-pixel and rotated drawing shared by the two alpha picture classes. A texel
// source provides fetch(x, y, &colour, &alpha) for 0 <= x < width, 0 <= y < height.
namespace guikit {
namespace alpha_drawing {

// Opacity 0..1 as an integer o = round(opacity x 256); anything else is held to the range.
inline int32_t opacity_units(float opacity) {
  if (!(opacity > 0.0f)) return 0;
  if (opacity >= 1.0f) return 256;
  return static_cast<int32_t>(round_half_up(static_cast<double>(opacity) * 256.0));
}

// Bilinear weights for a picture placed at fraction (fx, fy) of a pixel, summing to o:
// `self` for the texel under the pixel, `left` for the one left of it, `up` above it,
// `diagonal` above-left.
struct Weights {
  int32_t self, left, up, diagonal;
};

inline Weights placement_weights(int32_t o, double fx, double fy) {
  Weights w;
  w.diagonal = static_cast<int32_t>(round_half_up(o * fx * fy));
  w.left = static_cast<int32_t>(round_half_up(o * fx)) - w.diagonal;
  w.up = static_cast<int32_t>(round_half_up(o * fy)) - w.diagonal;
  w.self = o - w.diagonal - w.left - w.up;
  return w;
}

template <class Texels>
inline void add_texel(const Texels& texels, const WideRect& source, int64_t x, int64_t y, int32_t weight,
                      blend::TexelSum* sum) {
  if (weight == 0 || x < source.left || x >= source.right || y < source.top || y >= source.bottom) return;
  uint32_t colour = 0;
  int32_t alpha = 0;
  texels.fetch(static_cast<int32_t>(x), static_cast<int32_t>(y), &colour, &alpha);
  sum->add(colour, alpha, weight);
}

// The picture's origin lands at buffer (x, y). Texels outside the picture and the
// clip (picture coordinates) contribute nothing; the touched area is the source
// area widened by one pixel to the right and downwards, cut by the view of `size`
// and the buffer.
template <class Texels>
int draw_subpixel(const Texels& texels, int32_t width, int32_t height, float x, float y, Size size,
                  RenderingBufferInterface& buffer, const Rect& clip, float opacity) {
  int32_t ix = 0;
  int32_t iy = 0;
  double fx = 0.0;
  double fy = 0.0;
  if (!split_coordinate(x, &ix, &fx) || !split_coordinate(y, &iy, &fy)) return 0;
  const int32_t o = opacity_units(opacity);
  if (o == 0) return 0;
  const Weights w = placement_weights(o, fx, fy);

  const WideRect source = WideRect{0, 0, width, height}.intersect(WideRect::of(clip));
  if (source.empty()) return 0;
  const int32_t bw = buffer.get_width();
  const int32_t bh = buffer.get_height();
  // Everything below is in picture pixels; picture pixel (u, v) covers buffer pixel (ix + u, iy + v).
  const WideRect view{-int64_t{ix}, -int64_t{iy}, -int64_t{ix} + size.width, -int64_t{iy} + size.height};
  const WideRect on_buffer{-int64_t{ix}, -int64_t{iy}, -int64_t{ix} + bw, -int64_t{iy} + bh};
  const WideRect area =
      WideRect{source.left, source.top, source.right + 1, source.bottom + 1}.intersect(view).intersect(on_buffer);
  if (area.empty()) return 0;

  uint32_t* pixels = buffer.get_pixels();
  for (int64_t v = area.top; v < area.bottom; ++v) {
    uint32_t* row = pixels + static_cast<size_t>(iy + v) * static_cast<size_t>(bw);
    for (int64_t u = area.left; u < area.right; ++u) {
      blend::TexelSum sum;
      add_texel(texels, source, u, v, w.self, &sum);
      add_texel(texels, source, u - 1, v, w.left, &sum);
      add_texel(texels, source, u, v - 1, w.up, &sum);
      add_texel(texels, source, u - 1, v - 1, w.diagonal, &sum);
      uint32_t& d = row[ix + u];
      d = sum.apply(d);
    }
  }
  return 0;
}

// Source positions this close to a whole texel are taken as whole, so quarter
// turns given in single precision land exactly on texels.
constexpr double kSnap = 1e-4;

inline double snap(double v) {
  const double r = std::floor(v + 0.5);
  return std::fabs(v - r) < kSnap ? r : v;
}

// The picture turned by `angle` (counter-clockwise on screen) about its origin,
// which lands at buffer (cx, cy); `clip` is in buffer pixels.
template <class Texels>
int draw_turned(const Texels& texels, int32_t width, int32_t height, float cx, float cy, float angle,
                RenderingBufferInterface& buffer, const Rect& clip, float opacity) {
  int32_t whole = 0;
  double fraction = 0.0;
  if (!split_coordinate(cx, &whole, &fraction) || !split_coordinate(cy, &whole, &fraction)) return 0;
  if (!std::isfinite(angle) || width <= 0 || height <= 0) return 0;
  const int32_t o = opacity_units(opacity);
  if (o == 0) return 0;
  const double c = std::cos(static_cast<double>(angle));
  const double s = std::sin(static_cast<double>(angle));

  // Bounding box of the turned corners, widened by 1 on the near and 2 on the far sides.
  const double corners[4][2] = {{0.0, 0.0}, {double(width), 0.0}, {0.0, double(height)}, {double(width), double(height)}};
  double min_x = cx, max_x = cx, min_y = cy, max_y = cy;
  for (const auto& p : corners) {
    const double bx = cx + p[0] * c + p[1] * s;
    const double by = cy - p[0] * s + p[1] * c;
    min_x = bx < min_x ? bx : min_x;
    max_x = bx > max_x ? bx : max_x;
    min_y = by < min_y ? by : min_y;
    max_y = by > max_y ? by : max_y;
  }
  const WideRect box{static_cast<int64_t>(std::floor(min_x)) - 1, static_cast<int64_t>(std::floor(min_y)) - 1,
                     static_cast<int64_t>(std::floor(max_x)) + 2, static_cast<int64_t>(std::floor(max_y)) + 2};
  const int32_t bw = buffer.get_width();
  const WideRect area = box.intersect(WideRect::of(clip)).intersect(WideRect{0, 0, bw, buffer.get_height()});
  if (area.empty()) return 0;

  const WideRect source{0, 0, width, height};
  uint32_t* pixels = buffer.get_pixels();
  for (int64_t by = area.top; by < area.bottom; ++by) {
    uint32_t* row = pixels + static_cast<size_t>(by) * static_cast<size_t>(bw);
    const double dy = static_cast<double>(by) - cy;
    for (int64_t bx = area.left; bx < area.right; ++bx) {
      const double dx = static_cast<double>(bx) - cx;
      const double sx = snap(dx * c - dy * s);
      const double sy = snap(dx * s + dy * c);
      if (sx <= -1.0 || sy <= -1.0 || sx >= width || sy >= height) continue;
      const double fx0 = std::floor(sx);
      const double fy0 = std::floor(sy);
      const int64_t x0 = static_cast<int64_t>(fx0);
      const int64_t y0 = static_cast<int64_t>(fy0);
      int32_t tx = static_cast<int32_t>((sx - fx0) * 256.0);
      int32_t ty = static_cast<int32_t>((sy - fy0) * 256.0);
      tx = tx > 255 ? 255 : tx;
      ty = ty > 255 ? 255 : ty;
      // The same weights as sub-pixel placement, with the fractions in 1/256.
      const int32_t both = (o * tx * ty + 32768) >> 16;
      const int32_t along_x = ((o * tx + 128) >> 8) - both;
      const int32_t along_y = ((o * ty + 128) >> 8) - both;
      const int32_t neither = o - both - along_x - along_y;
      blend::TexelSum sum;
      add_texel(texels, source, x0, y0, neither, &sum);
      add_texel(texels, source, x0 + 1, y0, along_x, &sum);
      add_texel(texels, source, x0, y0 + 1, along_y, &sum);
      add_texel(texels, source, x0 + 1, y0 + 1, both, &sum);
      uint32_t& d = row[bx];
      d = sum.apply(d);
    }
  }
  return 0;
}

}  // namespace alpha_drawing
}  // namespace guikit
