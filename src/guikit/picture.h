#pragma once

#include <cstdint>

#include "guikit/bounding_box_checker.h"
#include "guikit/rect.h"

namespace guikit {

class PicDataInterface;
class Redraw;

// One picture slot: a picture (not owned), where its origin goes (relative to
// the origin its user passes, the control's or the node's position) and the part
// of it shown. A slot that was never set draws nothing.
class Picture : public BoundingBoxDefaultChecker {
 public:
  Picture() = default;
  Picture(PicDataInterface* pic, Point placement);
  Picture(PicDataInterface* pic, Point placement, const Rect& source);

  void set(PicDataInterface* pic, Point placement);
  void set(PicDataInterface* pic, Point placement, const Rect& source);
  void clear();
  bool is_present() const { return present_; }
  PicDataInterface* get_picture() const { return pic_; }
  Point get_placement() const { return placement_; }
  const Rect& get_source() const { return source_; }
  int32_t get_width() const;
  int32_t get_height() const;
  // The shown part in editor pixels, its origin at origin + placement.
  Rect get_rect(Point origin) const;

  // Whole-pixel drawing into the redraw tile.
  void draw(Redraw& redraw, Point origin) const;
  // Fractional position (editor pixels) of the picture's origin, with an opacity 0..1.
  void draw_at(Redraw& redraw, float x, float y, float opacity = 1.0f) const;
  // Rotated about its origin, which lands at (x, y) in editor pixels.
  void draw_rotated(Redraw& redraw, float x, float y, float angle, float opacity = 1.0f) const;

 private:
  PicDataInterface* pic_ = nullptr;
  Point placement_;
  Rect source_;
  bool present_ = false;
};

}  // namespace guikit
