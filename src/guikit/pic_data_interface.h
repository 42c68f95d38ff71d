#pragma once

#include <cstdint>

#include "guikit/rect.h"
#include "guikit/rendering_buffer_interface.h"

namespace guikit {

// A picture read from an "APIC" resource. It points into the resource's bytes and
// never owns them. Every drawing operation answers 0 and allocates nothing.
//
// Coordinates: for `draw`, `view` and `clip` are in the picture's own pixels and
// picture pixel (x, y) lands on buffer pixel (x - view.left, y - view.top); to put
// the top-left corner at buffer (px, py) pass view = (-px, -py, -px + buffer width,
// -py + buffer height). Only pixels inside view, clip and the buffer are touched.
//
// `draw_at` and `draw_at_faded` put the picture's origin at buffer position (x, y);
// `size` completes the view rectangle (normally the buffer's size) and `clip` is
// again in picture pixels: the part of the picture shown, e.g. one frame of a strip.
//
// `draw_rotated` and `draw_rotated_faded` turn the picture by `angle` radians
// (counter-clockwise on screen) about its origin, which lands at buffer (cx, cy);
// there `clip` is in buffer pixels.
class PicDataInterface {
 public:
  virtual ~PicDataInterface() = default;

  virtual int32_t get_width() const = 0;
  virtual int32_t get_height() const = 0;

  virtual int draw(const Rect& view, RenderingBufferInterface& buffer, const Rect& clip) const = 0;

  // Opaque pictures cannot be turned: nothing is drawn.
  virtual int draw_rotated(float cx, float cy, float angle, RenderingBufferInterface& buffer,
                           const Rect& clip) const;
  virtual int draw_rotated_faded(float cx, float cy, float angle, RenderingBufferInterface& buffer,
                                 const Rect& clip, float opacity) const;

  // Opaque pictures snap to whole pixels: (floor(x), floor(y)).
  virtual int draw_at(float x, float y, Size size, RenderingBufferInterface& buffer, const Rect& clip) const;
  // Opaque pictures ignore the opacity: whole coordinates are rounded, others go to draw_at.
  virtual int draw_at_faded(float x, float y, Size size, RenderingBufferInterface& buffer, const Rect& clip,
                            float opacity) const;
};

// The view that puts a picture's origin at buffer position (x, y), for a buffer
// area of the given size.
Rect view_for_position(int32_t x, int32_t y, Size size);

}  // namespace guikit
