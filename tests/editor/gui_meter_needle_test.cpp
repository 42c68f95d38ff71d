// The band meters' needles: upright pictures that turn clockwise about their
// pivot on the control position, seen only through the meter's face.
#include <cmath>

#include "editor/skin_needle.h"
#include "gui_test_support.h"
#include "skin/skin_anchors.h"

using gui_test::EditorInstance;

TEST_F(EditorInstance, NeedleTurnsClockwiseAboutItsPivotWithTheLevel) {
  SkinNeedle& needle = gui->use_master().needle(1);
  const guikit::Point p = needle.get_position();
  EXPECT_EQ(p.x, 294);
  EXPECT_EQ(p.y, 118);
  const double pi = std::acos(-1.0);
  for (double v : {0.0, 0.25, 0.5, 0.75, 1.0}) {
    needle.set_value(v, 2);
    double x = 0.0, y = 0.0, a = 0.0;
    needle.get_needle_placement(x, y, a);
    const double c = std::cos(a), s = std::sin(a);
    // Picture points go to corner + (u c + v s, -u s + v c).
    const double px = kSkinNeedle.pivot_x, py = kSkinNeedle.pivot_y;
    EXPECT_NEAR(x + px * c + py * s, p.x, 1e-9) << v;
    EXPECT_NEAR(y - px * s + py * c, p.y, 1e-9) << v;
    // The tip (top row centre) lies 59 pixels out, turned clockwise from straight up.
    const double turn = 2 * pi * (0.3175 * v - 0.135);
    const double tip_x = x + px * c, tip_y = y - px * s;
    EXPECT_NEAR(tip_x, p.x + py * std::sin(turn), 1e-9) << v;
    EXPECT_NEAR(tip_y, p.y - py * std::cos(turn), 1e-9) << v;
  }
}

TEST_F(EditorInstance, NeedleIsDrawnOnlyThroughTheFace) {
  ASSERT_TRUE(open_editor());
  for (int k = 0; k < 3; ++k) effect->setParameter(effect, 9 + k, 0.25f * (k + 1));  // every band in use
  SkinNeedle& needle = gui->use_master().needle(0);
  const guikit::Point p = needle.get_position();
  const double pi = std::acos(-1.0);
  const double turn = 2 * pi * (0.3175 * 0.5 - 0.135);  // -10 dB
  // A point 40 pixels up the needle at -10 dB lies in the middle of the face.
  const int nx = static_cast<int>(std::lround(p.x + 40 * std::sin(turn)));
  const int ny = static_cast<int>(std::lround(p.y - 40 * std::cos(turn)));
  needle.set_value(0.25, 2);
  window->paint_all();
  const uint32_t away = window->pixel(nx, ny);
  const uint32_t below = window->pixel(p.x, p.y - 5);  // under the face: band page only
  needle.set_value(0.5, 2);
  window->paint_all();
  EXPECT_NE(window->pixel(nx, ny), away) << "the needle crosses (" << nx << ", " << ny << ")";
  EXPECT_EQ(window->pixel(p.x, p.y - 5), below) << "the needle's foot stays hidden below the face";
}
