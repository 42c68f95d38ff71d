#include "guikit/pic_geometry.h"

#include <cmath>

namespace guikit {

namespace {
// Far beyond any buffer, yet small enough that sums of it stay in 32 bits.
constexpr double kCoordinateLimit = 1 << 29;
}  // namespace

int64_t round_half_up(double v) { return static_cast<int64_t>(std::floor(v + 0.5)); }

bool is_whole(double v) {
  const double r = std::floor(v + 0.5);
  return std::fabs(v - r) <= 1e-9 * std::fabs(r);
}

bool split_coordinate(double v, int32_t* whole, double* fraction) {
  if (!std::isfinite(v) || std::fabs(v) > kCoordinateLimit) return false;
  const double f = std::floor(v);
  *whole = static_cast<int32_t>(f);
  *fraction = v - f;
  return true;
}

bool clip_draw_span(const Rect& view, const Rect& clip, int32_t width, int32_t height, int32_t buffer_width,
                    int32_t buffer_height, DrawSpan* span) {
  const WideRect picture{0, 0, width, height};
  const WideRect on_buffer{view.left, view.top, int64_t{view.left} + buffer_width, int64_t{view.top} + buffer_height};
  const WideRect area = picture.intersect(WideRect::of(view)).intersect(WideRect::of(clip)).intersect(on_buffer);
  if (area.empty()) return false;
  span->src_x = static_cast<int32_t>(area.left);
  span->src_y = static_cast<int32_t>(area.top);
  span->dst_x = static_cast<int32_t>(area.left - view.left);
  span->dst_y = static_cast<int32_t>(area.top - view.top);
  span->width = static_cast<int32_t>(area.right - area.left);
  span->height = static_cast<int32_t>(area.bottom - area.top);
  return true;
}

bool clip_glyph_span(const Rect& source, Point dest, int32_t width, int32_t glyph_height, int32_t buffer_width,
                     int32_t buffer_height, DrawSpan* span) {
  const WideRect cells = WideRect{0, 0, width, glyph_height}.intersect(WideRect::of(source));
  if (cells.empty()) return false;
  // Picture pixel (x, y) lands on dest + (x - source.left, y - source.top).
  const int64_t shift_x = int64_t{source.left} - dest.x;
  const int64_t shift_y = int64_t{source.top} - dest.y;
  const WideRect on_buffer{shift_x, shift_y, shift_x + buffer_width, shift_y + buffer_height};
  const WideRect area = cells.intersect(on_buffer);
  if (area.empty()) return false;
  span->src_x = static_cast<int32_t>(area.left);
  span->src_y = static_cast<int32_t>(area.top);
  span->dst_x = static_cast<int32_t>(area.left - shift_x);
  span->dst_y = static_cast<int32_t>(area.top - shift_y);
  span->width = static_cast<int32_t>(area.right - area.left);
  span->height = static_cast<int32_t>(area.bottom - area.top);
  return true;
}

}  // namespace guikit
