#pragma once

#include <cstdint>

#include "guikit/rect.h"

namespace guikit {

// round(v) = floor(v + 0.5), halves upward.
int64_t round_half_up(double v);

// A coordinate counts as whole when it is within 1e-9 x |round(v)| of round(v).
bool is_whole(double v);

// Integer part (floor) and fraction of a drawing coordinate. Answers false for
// values that are not finite or lie far outside any buffer, which draw nothing.
bool split_coordinate(double v, int32_t* whole, double* fraction);

// The part of a picture that one draw touches: `width` x `height` pixels from
// picture position (src_x, src_y) to buffer position (dst_x, dst_y).
struct DrawSpan {
  int32_t src_x = 0;
  int32_t src_y = 0;
  int32_t dst_x = 0;
  int32_t dst_y = 0;
  int32_t width = 0;
  int32_t height = 0;
};

// Picture (0, 0, width, height) cut by the view, the clip and the buffer's extent
// (view and clip in picture coordinates; picture pixel (x, y) lands on buffer pixel
// (x - view.left, y - view.top)). False when nothing remains.
bool clip_draw_span(const Rect& view, const Rect& clip, int32_t width, int32_t height, int32_t buffer_width,
                    int32_t buffer_height, DrawSpan* span);

// A glyph's source rectangle (font picture coordinates, cut to the picture's
// width and the glyph rows) placed with its top-left at `dest`, cut to the buffer.
bool clip_glyph_span(const Rect& source, Point dest, int32_t width, int32_t glyph_height, int32_t buffer_width,
                     int32_t buffer_height, DrawSpan* span);

// Intersection of rectangles in 64-bit coordinates, so sums near the 32-bit
// limits cannot wrap.
struct WideRect {
  int64_t left, top, right, bottom;
  bool empty() const { return right <= left || bottom <= top; }
  WideRect intersect(const WideRect& o) const {
    return WideRect{left > o.left ? left : o.left, top > o.top ? top : o.top, right < o.right ? right : o.right,
                    bottom < o.bottom ? bottom : o.bottom};
  }
  static WideRect of(const Rect& r) { return WideRect{r.left, r.top, r.right, r.bottom}; }
};

}  // namespace guikit
