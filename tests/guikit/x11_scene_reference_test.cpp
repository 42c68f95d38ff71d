// The skin scene the X11 window tests show, checked on the off-screen window: it
// is the reference those tests compare the real window against, so it must paint
// the real skin where the editor puts it and react to the same gestures.
#include <gtest/gtest.h>

#include <string>

#include "guikit/headless/offscreen_window.h"
#include "guikit/memory_rendering_buffer.h"
#include "guikit/pic_data_factory.h"
#include "skin/skin_anchors.h"
#include "support/skin_test_scene.h"

using guikit::OffscreenWindow;
using guikit::Size;
using scene_test::SceneLayout;
using scene_test::SkinTestScene;

namespace {

// A background picture drawn alone, straight from its resource.
uint32_t background_pixel(const SkinBackground& bg, int x, int y) {
  auto pic = guikit::PicDataFactory::instance().create_picture(bg.name);
  guikit::MemoryRenderingBuffer buffer(bg.width, bg.height);
  pic->draw(guikit::view_for_position(0, 0, {bg.width, bg.height}), buffer, guikit::Rect{0, 0, bg.width, bg.height});
  return buffer.pixel(x, y) & 0x00FFFFFFu;
}

}  // namespace

TEST(X11SceneReference, BackgroundsLandWhereTheEditorShowsThem) {
  SkinTestScene scene;
  OffscreenWindow window(Size{SceneLayout::kWidth, SceneLayout::kHeight}, Size{64, 48});
  scene.attach(window);
  window.paint_all();
  // Every panel but the tip pages, probed at corners away from the controls.
  const char* shown[] = {"bkg_24_master", "bkg_24_top",  "bkg_24_band1",   "bkg_24_band2", "bkg_24_band3",
                         "bkg_24_band4",  "bkg_24_edit", "bkg_24_presets", "bkg_24_info"};
  int checked = 0;
  for (const SkinBackground& bg : kSkinBackgrounds) {
    bool wanted = false;
    for (const char* s : shown) wanted = wanted || std::string(s) == bg.name;
    if (!wanted) continue;
    for (auto [x, y] : {std::pair<int, int>{1, bg.height - 2}, {bg.width - 2, bg.height - 2}}) {
      EXPECT_EQ(background_pixel(bg, x, y), window.pixel(bg.left + x, bg.top + y) & 0x00FFFFFFu)
          << bg.name << " at " << x << "," << y;
    }
    ++checked;
  }
  EXPECT_EQ(9, checked);
  scene.detach();
}

TEST(X11SceneReference, GesturesReachTheControls) {
  SkinTestScene scene;
  OffscreenWindow window(Size{SceneLayout::kWidth, SceneLayout::kHeight});
  scene.attach(window);
  window.paint_all();
  const uint32_t switch_before = window.pixel(SceneLayout::kFlipFlop.x + 8, SceneLayout::kFlipFlop.y + 8);

  window.click_at(SceneLayout::kFlipFlop.x + 8, SceneLayout::kFlipFlop.y + 8);
  window.button_up();
  EXPECT_EQ(1.0, scene.flip_flop().get_value());
  window.paint_pending();
  EXPECT_NE(switch_before, window.pixel(SceneLayout::kFlipFlop.x + 8, SceneLayout::kFlipFlop.y + 8))
      << "the switch shows its other frame";

  // A drag upwards turns the knob up; the glide gets there on the 30 ms timer.
  window.click_at(SceneLayout::kKnobA.x, SceneLayout::kKnobA.y);
  for (int i = 1; i <= 10; ++i) {
    window.mouse_move(SceneLayout::kKnobA.x, SceneLayout::kKnobA.y - 3 * i);
    window.advance_ms(20);
  }
  window.button_up();
  window.advance_ms(300);
  EXPECT_GT(scene.knob_a().get_value(), 0.1);
  EXPECT_EQ(0.0, scene.knob_b().get_value()) << "only the dragged knob moves";

  // The text box edits through the window's line editor.
  window.click_at(SceneLayout::kTextBox.left + 5, SceneLayout::kTextBox.top + 5);
  window.button_up();
  ASSERT_TRUE(window.line_editor().is_active());
  EXPECT_EQ("Brakmorph", window.line_editor().get_text());
  window.line_editor().type("Edited");
  window.line_editor().stop(true);
  EXPECT_EQ("Edited", scene.text_box().get_text());

  // The push button asks for the menu; the chosen item's listener hears it.
  window.menu().choose_next(scene.item("Beta").get_id());
  window.click_at(SceneLayout::kMenuButton.x + 20, SceneLayout::kMenuButton.y + 7);
  window.button_up();
  EXPECT_EQ(1, scene.get_menu_requests());
  EXPECT_EQ(0, scene.get_last_menu_answer());
  ASSERT_EQ(1u, scene.get_chosen().size());
  EXPECT_EQ("Beta", scene.get_chosen()[0]);
  scene.detach();
}

TEST(X11SceneReference, TheSameStatePaintsTheSamePixelsWhateverTheTiles) {
  SkinTestScene a, b;
  OffscreenWindow whole(Size{SceneLayout::kWidth, SceneLayout::kHeight});
  OffscreenWindow tiled(Size{SceneLayout::kWidth, SceneLayout::kHeight}, Size{37, 23});
  a.attach(whole);
  b.attach(tiled);
  a.set_state(0.3, 0.8, 0.5, 1.0, "Same");
  b.set_state(0.3, 0.8, 0.5, 1.0, "Same");
  whole.paint_all();
  tiled.paint_all();
  int differing = 0;
  for (int y = 0; y < SceneLayout::kHeight; ++y) {
    for (int x = 0; x < SceneLayout::kWidth; ++x) differing += whole.pixel(x, y) != tiled.pixel(x, y);
  }
  EXPECT_EQ(0, differing);
  // A different knob value changes the knob's pixels and nothing far from it.
  b.set_state(0.9, 0.8, 0.5, 1.0, "Same");
  tiled.paint_all();
  int near_knob = 0, elsewhere = 0;
  for (int y = 0; y < SceneLayout::kHeight; ++y) {
    for (int x = 0; x < SceneLayout::kWidth; ++x) {
      if (whole.pixel(x, y) == tiled.pixel(x, y)) continue;
      bool near = std::abs(x - SceneLayout::kKnobA.x) <= 20 && std::abs(y - SceneLayout::kKnobA.y) <= 20;
      (near ? near_knob : elsewhere)++;
    }
  }
  EXPECT_GT(near_knob, 20);
  EXPECT_EQ(0, elsewhere);
  a.detach();
  b.detach();
}
