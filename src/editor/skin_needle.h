#pragma once

#include "guikit/picture.h"
#include "guikit/text_box.h"

// A band's VU needle drawn the way the skin paints it: an upright needle
// picture that turns about its own pivot point, which sits on the control's
// position, clockwise as the level rises (2 pi x (span x value + offset)
// radians from straight up). The face and the cover are drawn unturned, and the
// needle is seen only through the face.
class SkinNeedle : public guikit::VuMeterNeedle {
 public:
  // face and cover: placed relative to the control; needle: the picture whose
  // point (pivot_x, pivot_y), in picture pixels, lies on the control's position.
  void set_skin(const guikit::Picture& face, const guikit::Picture& needle, const guikit::Picture& cover,
                float pivot_x, float pivot_y);
  int32_t on_redraw(guikit::Redraw& msg) override;

  // Where the needle picture's top-left corner goes, in editor pixels, and the
  // angle to turn it by (counter-clockwise, as the pictures turn).
  void get_needle_placement(double& x, double& y, double& angle) const;

 private:
  guikit::Picture face_;
  guikit::Picture needle_picture_;
  guikit::Picture cover_picture_;
  float pivot_x_ = 0.0f;
  float pivot_y_ = 0.0f;
};
