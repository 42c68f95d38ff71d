#include "guikit/picture.h"

#include "guikit/messages.h"
#include "guikit/pic_data_interface.h"

namespace guikit {

Picture::Picture(PicDataInterface* pic, Point placement) { set(pic, placement); }
Picture::Picture(PicDataInterface* pic, Point placement, const Rect& source) { set(pic, placement, source); }

void Picture::set(PicDataInterface* pic, Point placement) {
  set(pic, placement, pic ? Rect{0, 0, pic->get_width(), pic->get_height()} : Rect{});
}

void Picture::set(PicDataInterface* pic, Point placement, const Rect& source) {
  pic_ = pic;
  placement_ = placement;
  source_ = source;
  present_ = pic != nullptr;
  box_ = source;
}

void Picture::clear() {
  pic_ = nullptr;
  present_ = false;
}

int32_t Picture::get_width() const { return source_.width(); }
int32_t Picture::get_height() const { return source_.height(); }

Rect Picture::get_rect(Point origin) const {
  int32_t x = origin.x + placement_.x;
  int32_t y = origin.y + placement_.y;
  return Rect{x + source_.left, y + source_.top, x + source_.right, y + source_.bottom};
}

void Picture::draw(Redraw& redraw, Point origin) const {
  if (!present_) return;
  const Rect& tile = redraw.area;
  int32_t x = origin.x + placement_.x;
  int32_t y = origin.y + placement_.y;
  Rect view{tile.left - x, tile.top - y, tile.right - x, tile.bottom - y};
  pic_->draw(view, redraw.buffer, source_);
}

void Picture::draw_at(Redraw& redraw, float x, float y, float opacity) const {
  if (!present_) return;
  const Rect& tile = redraw.area;
  float bx = x + static_cast<float>(placement_.x - tile.left);
  float by = y + static_cast<float>(placement_.y - tile.top);
  Size size{tile.width(), tile.height()};
  if (opacity >= 1.0f) {
    pic_->draw_at(bx, by, size, redraw.buffer, source_);
  } else {
    pic_->draw_at_faded(bx, by, size, redraw.buffer, source_, opacity);
  }
}

void Picture::draw_rotated(Redraw& redraw, float x, float y, float angle, float opacity) const {
  if (!present_) return;
  const Rect& tile = redraw.area;
  float bx = x + static_cast<float>(placement_.x - tile.left);
  float by = y + static_cast<float>(placement_.y - tile.top);
  Rect clip{0, 0, tile.width(), tile.height()};
  if (opacity >= 1.0f) {
    pic_->draw_rotated(bx, by, angle, redraw.buffer, clip);
  } else {
    pic_->draw_rotated_faded(bx, by, angle, redraw.buffer, clip, opacity);
  }
}

}  // namespace guikit
