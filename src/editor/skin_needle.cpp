#include "editor/skin_needle.h"

#include <cmath>

#include "guikit/messages.h"
#include "guikit/pic_data_interface.h"

void SkinNeedle::set_skin(const guikit::Picture& face, const guikit::Picture& needle, const guikit::Picture& cover,
                          float pivot_x, float pivot_y) {
  face_ = face;
  needle_picture_ = needle;
  cover_picture_ = cover;
  pivot_x_ = pivot_x;
  pivot_y_ = pivot_y;
}

void SkinNeedle::get_needle_placement(double& x, double& y, double& angle) const {
  // Clockwise on screen is a negative turn for the picture rotation.
  angle = -get_angle();
  const double c = std::cos(angle);
  const double s = std::sin(angle);
  // A turned picture maps its point (u, v) to corner + (u c + v s, -u s + v c);
  // the corner is chosen so that the pivot lands on the control's position.
  x = position_.x - (pivot_x_ * c + pivot_y_ * s);
  y = position_.y - (-pivot_x_ * s + pivot_y_ * c);
}

int32_t SkinNeedle::on_redraw(guikit::Redraw& msg) {
  face_.draw(msg, position_);
  double x = 0.0, y = 0.0, angle = 0.0;
  get_needle_placement(x, y, angle);
  // Like a real meter, the needle shows only through the window of the face.
  guikit::PicDataInterface* pic = needle_picture_.get_picture();
  if (pic != nullptr && face_.is_present()) {
    const guikit::Rect& tile = msg.area;
    const guikit::Rect window = face_.get_rect(position_).intersect(tile);
    if (!window.empty()) {
      const guikit::Rect clip{window.left - tile.left, window.top - tile.top, window.right - tile.left,
                              window.bottom - tile.top};
      pic->draw_rotated(static_cast<float>(x - tile.left), static_cast<float>(y - tile.top),
                        static_cast<float>(angle), msg.buffer, clip);
    }
  }
  cover_picture_.draw(msg, position_);
  return 0;
}
