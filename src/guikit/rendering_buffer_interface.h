#pragma once

#include <cstdint>

#include "guikit/rect.h"

namespace guikit {

// A 32-bit pixel buffer (blue, green, red, fourth byte ignored), top row first,
// rows of exactly width pixels.
class RenderingBufferInterface {
 public:
  virtual ~RenderingBufferInterface() = default;
  virtual int32_t get_width() const = 0;
  virtual int32_t get_height() const = 0;
  virtual uint32_t* get_pixels() = 0;
  // Shows the given area of the buffer on the platform surface (nothing off screen).
  virtual void blit(Point position, Size size) = 0;
};

}  // namespace guikit
