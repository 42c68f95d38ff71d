// The editor surface rendered off screen: panel pictures where the layout puts
// them, band pages that give way to their tip pages, and the preset and web panels.
#include <memory>
#include <string>

#include "editor/gui_presets.h"
#include "gui_test_support.h"
#include "guikit/memory_rendering_buffer.h"
#include "guikit/pic_data_factory.h"
#include "skin/skin_anchors.h"

using gui_test::EditorInstance;

namespace {

// A skin picture drawn on its own, its top-left corner at (0, 0).
class Reference {
 public:
  explicit Reference(const char* name)
      : pic_(guikit::PicDataFactory::instance().create_picture(name)),
        buffer_(pic_ ? pic_->get_width() : 1, pic_ ? pic_->get_height() : 1, 0) {
    if (pic_) pic_->draw(guikit::view_for_position(0, 0, {buffer_.get_width(), buffer_.get_height()}), buffer_,
                         guikit::Rect{0, 0, pic_->get_width(), pic_->get_height()});
  }
  bool valid() const { return pic_ != nullptr; }
  uint32_t at(int x, int y) const { return buffer_.pixel(x, y) & 0x00FFFFFFu; }

 private:
  std::unique_ptr<guikit::PicDataInterface> pic_;
  guikit::MemoryRenderingBuffer buffer_;
};

}  // namespace

TEST_F(EditorInstance, EveryPanelPictureLandsAtItsPlace) {
  ASSERT_TRUE(open_editor());
  for (int k = 0; k < 3; ++k) effect->setParameter(effect, 9 + k, 0.25f * (k + 1));  // every band in use
  window->paint_all();
  for (const SkinBackground& b : kSkinBackgrounds) {
    if (std::string(b.name).find("tip") != std::string::npos) continue;
    Reference pic(b.name);
    ASSERT_TRUE(pic.valid()) << b.name;
    // Corners no control covers.
    for (const guikit::Point p : {guikit::Point{1, 1}, guikit::Point{b.width - 2, b.height - 2}}) {
      EXPECT_EQ(window->pixel(b.left + p.x, b.top + p.y) & 0x00FFFFFFu, pic.at(p.x, p.y))
          << b.name << " at (" << p.x << ", " << p.y << ")";
    }
  }
  // A knob covers its panel: Tone Freq's centre is not the bare background.
  Reference master("bkg_24_master");
  EXPECT_NE(window->pixel(35, 72) & 0x00FFFFFFu, master.at(35, 72));
}

TEST_F(EditorInstance, SplitAtItsMaximumHidesTheBandsBehindIt) {
  ASSERT_TRUE(open_editor());
  effect->setParameter(effect, 9, 0.2f);
  effect->setParameter(effect, 11, 0.9f);
  effect->setParameter(effect, 10, 1.0f);  // bands 3 and 4 (indices 2 and 3) are off
  EXPECT_TRUE(gui->use_master().is_band_shown(1));
  EXPECT_FALSE(gui->use_master().is_band_shown(2));
  EXPECT_FALSE(gui->use_master().is_band_shown(3));
  EXPECT_EQ(gui->use_trees().band_group(1).get_control_count(), 7u);
  EXPECT_EQ(gui->use_trees().band_group(2).get_control_count(), 0u);
  EXPECT_EQ(gui->use_trees().band_group(3).get_control_count(), 0u);

  window->paint_all();
  Reference tip2("bkg_24_tip2pc"), tip3("bkg_24_tip3"), band3("bkg_24_band3");
  // Where band 3's Character knob and band 4's Volume knob were, the tip pages show.
  EXPECT_EQ(window->pixel(405, 136) & 0x00FFFFFFu, tip2.at(405 - 376, 136 - 36));
  EXPECT_EQ(window->pixel(572, 82) & 0x00FFFFFFu, tip3.at(572 - 490, 82 - 36));
  // A click there reaches no control.
  window->mouse_move(405, 136);
  window->button_down();
  EXPECT_FALSE(window->has_capture());
  window->button_up();

  effect->setParameter(effect, 10, 0.5f);
  EXPECT_TRUE(gui->use_master().is_band_shown(2));
  EXPECT_TRUE(gui->use_master().is_band_shown(3)) << "split 2 is below its maximum";
  window->paint_all();
  EXPECT_EQ(window->pixel(376 + 1, 36 + 1) & 0x00FFFFFFu, band3.at(1, 1));
  EXPECT_NE(window->pixel(405, 136) & 0x00FFFFFFu, band3.at(405 - 376, 136 - 36)) << "the knob is back";
  EXPECT_EQ(gui->use_trees().band_group(2).get_control_count(), 7u);
  EXPECT_TRUE(host.automations.empty());
}

TEST_F(EditorInstance, FadeTimeDisplayShowsOneSecondAfterOpening) {
  ASSERT_TRUE(open_editor());
  EXPECT_EQ(gui->use_presets().fade_display().get_text(), "1");
  window->paint_all();
  // The digit is drawn in the display's box (editor x 228..252, y 257..272).
  Reference panel("bkg_24_presets");
  int drawn = 0;
  for (int y = 257; y < 272; ++y) {
    for (int x = 228; x < 252; ++x) drawn += (window->pixel(x, y) & 0x00FFFFFFu) != panel.at(x - 117, y - 229);
  }
  EXPECT_GT(drawn, 5);
}

TEST_F(EditorInstance, ProgramButtonsFormTwoRowsOfFourAndFlashWhenPressed) {
  ASSERT_TRUE(open_editor());
  for (int i = 0; i < 8; ++i) {
    const guikit::Point p = gui->use_presets().button(i).get_position();
    EXPECT_EQ(p.x, 117 + 14 + 16 * (i % 4)) << i;
    EXPECT_EQ(p.y, 229 + 16 + 16 * (i / 4)) << i;
  }
  EXPECT_EQ(gui->use_presets().get_nbr_buttons(), 10);
  guikit::PushButton& sixth = gui->use_presets().button(5);
  window->mouse_move(117 + 14 + 16 + 6, 229 + 32 + 6);
  window->button_down();
  window->button_up();
  window->advance_ms(300);
  EXPECT_GT(sixth.get_flash_position(), 0.3) << "the 1 s flash is under way";
  EXPECT_EQ(gui->use_presets().button(4).get_flash_position(), 0.0);
  window->advance_ms(1200);
  EXPECT_EQ(sixth.get_flash_position(), 0.0);
}

TEST(EditorPresetPanel, ProgramButtonFramesEaseThroughTheButtonsOwnPictures) {
  // Frame k of button i shows picture round(4 x 4u / (3u + 1)), u = k / 11, of "pb_<11+i>_*".
  struct Case {
    int button, frame;
    const char* picture;
  };
  const Case cases[] = {{0, 0, "pb_11_0"}, {0, 11, "pb_11_4"}, {2, 1, "pb_13_1"}, {3, 5, "pb_14_3"},
                        {7, 11, "pb_18_4"}, {7, 0, "pb_18_0"},  {5, 3, "pb_16_2"}};
  for (const Case& c : cases) {
    EXPECT_EQ(SkinPictures::name_at(GuiPresets::program_frame_index(c.button, c.frame)), c.picture)
        << "button " << c.button << " frame " << c.frame;
  }
}

TEST_F(EditorInstance, SetupButtonOpensTheSetupMenu) {
  ASSERT_TRUE(open_editor());
  const int shows = window->menu().get_show_count();
  window->menu().choose_next(0);  // escape
  window->mouse_move(356 + 181 + 20, 229 + 40 + 7);
  window->button_down();
  window->button_up();
  EXPECT_EQ(window->menu().get_show_count(), shows + 1);
  EXPECT_FALSE(window->menu().get_last_entries().empty());
}

// The editor hands the plug-in's MIDI port choice to the setup menu, so its
// device submenus list the host's ports after "None".
TEST_F(EditorInstance, SetupMenuListsThePluginsMidiPorts) {
  ASSERT_TRUE(open_editor());
  window->menu().choose_next(0);
  window->mouse_move(356 + 181 + 20, 229 + 40 + 7);
  window->button_down();
  window->button_up();
  const std::vector<guikit::MenuEntry>& entries = window->menu().get_last_entries();
  std::vector<std::string> inputs;
  bool in_inputs = false;
  for (const guikit::MenuEntry& entry : entries) {
    if (entry.kind == guikit::MenuEntry::kSubMenuBegin) in_inputs = entry.text == "Input device";
    else if (entry.kind == guikit::MenuEntry::kSubMenuEnd) in_inputs = false;
    else if (in_inputs && entry.kind == guikit::MenuEntry::kItem) inputs.push_back(entry.text);
  }
  ASSERT_GE(inputs.size(), 2u) << "None and at least the host's own input";
  EXPECT_EQ(inputs[0], "None");
  EXPECT_EQ(inputs[1], "VST MIDI In interface");
}
