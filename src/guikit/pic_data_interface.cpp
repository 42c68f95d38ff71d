#include "guikit/pic_data_interface.h"

#include "guikit/pic_geometry.h"

namespace guikit {

Rect view_for_position(int32_t x, int32_t y, Size size) { return Rect{-x, -y, -x + size.width, -y + size.height}; }

int PicDataInterface::draw_rotated(float, float, float, RenderingBufferInterface&, const Rect&) const { return 0; }

int PicDataInterface::draw_rotated_faded(float, float, float, RenderingBufferInterface&, const Rect&, float) const {
  return 0;
}

int PicDataInterface::draw_at(float x, float y, Size size, RenderingBufferInterface& buffer, const Rect& clip) const {
  int32_t ix = 0;
  int32_t iy = 0;
  double fx = 0.0;
  double fy = 0.0;
  if (!split_coordinate(x, &ix, &fx) || !split_coordinate(y, &iy, &fy)) return 0;
  return draw(view_for_position(ix, iy, size), buffer, clip);
}

int PicDataInterface::draw_at_faded(float x, float y, Size size, RenderingBufferInterface& buffer, const Rect& clip,
                                    float) const {
  int32_t ix = 0;
  int32_t iy = 0;
  double fx = 0.0;
  double fy = 0.0;
  if (!split_coordinate(x, &ix, &fx) || !split_coordinate(y, &iy, &fy)) return 0;
  if (!is_whole(x) || !is_whole(y)) return draw_at(x, y, size, buffer, clip);
  // A whole coordinate may lie just below its integer: round, not floor.
  ix = static_cast<int32_t>(round_half_up(x));
  iy = static_cast<int32_t>(round_half_up(y));
  return draw(view_for_position(ix, iy, size), buffer, clip);
}

}  // namespace guikit
