// What the X server shows of the editor window equals the off-screen rendering of
// the same scene in the same state, every pixel (red, green and blue); the
// screenshots are kept as PNG files for people to look at.
#include "x11_screenshot_file.h"
#include "x11_test_support.h"

#include <png.h>

#include <cstdio>
#include <string>
#include <sys/stat.h>

#include "guikit/headless/offscreen_window.h"
#include "support/skin_test_scene.h"

using guikit::Size;
using guikit::WindowX11;
using scene_test::SceneLayout;
using scene_test::SkinTestScene;
using x11_test::HostWindow;
using x11_test::pump;
using x11_test::pump_until;
using x11_test::User;

namespace {

constexpr int kW = SceneLayout::kWidth;
constexpr int kH = SceneLayout::kHeight;

struct State {
  double knob_a, knob_b, fader, flip_flop;
  std::string text;
};

// The off-screen reference, in tiles unlike the real window's single buffer.
std::vector<uint32_t> offscreen_pixels(const State& s) {
  SkinTestScene scene;
  guikit::OffscreenWindow window(Size{kW, kH}, Size{128, 64});
  scene.attach(window);
  scene.set_state(s.knob_a, s.knob_b, s.fader, s.flip_flop, s.text);
  window.paint_all();
  std::vector<uint32_t> out(static_cast<size_t>(kW) * kH);
  for (int y = 0; y < kH; ++y) {
    for (int x = 0; x < kW; ++x) out[static_cast<size_t>(y) * kW + x] = window.pixel(x, y) & 0x00FFFFFFu;
  }
  scene.detach();
  return out;
}

using x11_test::screenshot_dir;

int count_differences(const std::vector<uint32_t>& a, const std::vector<uint32_t>& b) {
  if (a.size() != b.size()) return -1;
  int n = 0;
  for (size_t i = 0; i < a.size(); ++i) n += a[i] != b[i];
  return n;
}

}  // namespace

TEST(X11Screenshot, TheWindowShowsTheOffscreenPixels) {
  X11_REQUIRE_DISPLAY();
  HostWindow host;
  ASSERT_TRUE(host.ok());
  std::vector<uint32_t> shown_first, shown_after;
  State after{};
  {
    SkinTestScene scene;
    WindowX11 window(Size{100, 100});
    scene.attach(window);
    scene.set_state(0.25, 0.75, 0.4, 0.0, "Screenshot");
    ASSERT_EQ(0, window.open(host.handle()));
    pump(window, 60);
    shown_first = x11_test::grab_pixels(host.display(), window.get_x_window(), kW, kH);

    // The same after the user changed things: a click on the switch, a drag on
    // the second knob; the off-screen scene then takes the values they reached.
    User user(host.display());
    user.click(window.get_x_window(), SceneLayout::kFlipFlop.x + 8, SceneLayout::kFlipFlop.y + 8);
    ASSERT_TRUE(pump_until(window, [&] { return scene.flip_flop().get_value() == 1.0; }));
    user.move(window.get_x_window(), SceneLayout::kKnobB.x, SceneLayout::kKnobB.y);
    user.button(Button1, true);
    for (int i = 1; i <= 4; ++i) {
      user.move(window.get_x_window(), SceneLayout::kKnobB.x, SceneLayout::kKnobB.y + 4 * i);
      pump(window, 20);
    }
    user.button(Button1, false);
    ASSERT_TRUE(pump_until(window, [&] { return window.core().get_timer_count() == 0; }));
    pump(window, 40);
    shown_after = x11_test::grab_pixels(host.display(), window.get_x_window(), kW, kH);
    after = State{scene.knob_a().get_value(), scene.knob_b().get_value(), scene.fader().get_value(),
                  scene.flip_flop().get_value(), scene.text_box().get_text()};
    EXPECT_LT(after.knob_b, 0.75) << "dragged down";
    scene.detach();
  }
  const std::string dir = screenshot_dir();
  EXPECT_TRUE(x11_test::write_png(dir, "x11_editor_window.png", shown_first, kW, kH));
  EXPECT_TRUE(x11_test::write_png(dir, "x11_editor_window_after_input.png", shown_after, kW, kH));

  const std::vector<uint32_t> expected_first = offscreen_pixels(State{0.25, 0.75, 0.4, 0.0, "Screenshot"});
  const std::vector<uint32_t> expected_after = offscreen_pixels(after);
  EXPECT_EQ(0, count_differences(expected_first, shown_first));
  EXPECT_EQ(0, count_differences(expected_after, shown_after));
  EXPECT_GT(count_differences(shown_first, shown_after), 50) << "the two states look different";
}
