// The editor as a host sees it: the record, the size, opening and closing the
// window, the resize flag, the start-up steps and the engine's metering.
#include <cmath>
#include <stdexcept>
#include <vector>
#include <string>

#include "gui_test_support.h"
#include "host/host_gui_interface.h"

using gui_test::EditorInstance;

TEST_F(EditorInstance, RecordAnnouncesTheEditorAndTheRectIsTheEditorSize) {
  EXPECT_TRUE(effect->flags & effFlagsHasEditor);
  ERect* rect = nullptr;
  ASSERT_EQ(call(effEditGetRect, 0, 0, &rect), 1);
  ASSERT_NE(rect, nullptr);
  EXPECT_EQ(rect->left, 0);
  EXPECT_EQ(rect->top, 0);
  EXPECT_EQ(rect->right, 609);
  EXPECT_EQ(rect->bottom, 282);
  host.can_size_window = 1;
  ASSERT_EQ(call(effEditGetRect, 0, 0, &rect), 1);
  EXPECT_EQ(rect->right, 609) << "the editor has one size";
  EXPECT_EQ(rect->bottom, 282);
}

TEST_F(EditorInstance, OpenCloseOpenSwitchesTheWindowAndItsTimers) {
  for (int k = 0; k < 3; ++k) effect->setParameter(effect, 9 + k, 0.25f * (k + 1));  // every band in use
  for (int round = 0; round < 2; ++round) {
    ASSERT_TRUE(open_editor()) << "round " << round;
    EXPECT_TRUE(window->is_open());
    EXPECT_TRUE(gui->is_window_open());
    EXPECT_TRUE(gui->use_follower().is_running());
    // Timers of the four meters, the clip lamp and the follower run only while open.
    EXPECT_EQ(window->get_running_timer_count(), 6u);
    call(effEditIdle);
    call(effEditClose);
    EXPECT_FALSE(window->is_open());
    EXPECT_FALSE(gui->is_window_open());
    EXPECT_EQ(window->get_running_timer_count(), 0u);
  }
}

TEST_F(EditorInstance, MetersFollowTheAudioOnlyWhileTheEditorIsOpen) {
  std::vector<float> left(256), right(256), out_l(256), out_r(256);
  float* in[2] = {left.data(), right.data()};
  float* out[2] = {out_l.data(), out_r.data()};
  auto play = [&](float amplitude) {
    for (int block = 0; block < 20; ++block) {
      for (size_t i = 0; i < left.size(); ++i) {
        left[i] = right[i] = amplitude * static_cast<float>(std::sin(0.05 * static_cast<double>(i + 256 * block)));
      }
      effect->processReplacing(effect, in, out, 256);
    }
  };
  play(0.5f);
  EXPECT_EQ(engine->get_band_level(0), 0.0f) << "no metering while the editor is closed";
  ASSERT_TRUE(open_editor());
  guikit::ControlInterface& needle = gui->use_master().needle(0);
  play(0.5f);
  EXPECT_GT(engine->get_band_level(0), 0.0f);
  window->advance_ms(100);
  EXPECT_GT(needle.get_value(), 0.0) << "the needle of band 1 moved";
  call(effEditClose);
  play(0.5f);
  const float frozen = engine->get_band_level(0);
  play(0.05f);
  EXPECT_EQ(engine->get_band_level(0), frozen) << "metering is off again";
}

TEST_F(EditorInstance, TheResizeAnswerChoosesBetweenWindowAndEditorSize) {
  // The window keeps its own fixed size unless the host can resize.
  window->set_window_size(guikit::Size{300, 200});
  host.can_size_window = 0;
  ASSERT_TRUE(open_editor());
  EXPECT_EQ(window->get_open_size().width, 300);
  EXPECT_EQ(window->get_open_size().height, 200);
  call(effEditClose);
  host.can_size_window = 1;
  ASSERT_TRUE(open_editor());
  EXPECT_EQ(window->get_open_size().width, 609);
  EXPECT_EQ(window->get_open_size().height, 282);
  call(effEditClose);
}

TEST_F(EditorInstance, SecondDefaultStateBuildsNothingMore) {
  ASSERT_TRUE(gui->is_built());
  const size_t master = gui->use_trees().master_group().get_control_count();
  const size_t presets = gui->use_trees().presets_group().get_control_count();
  guikit::ControlInterface* tone = gui->get_bound_control(2);
  gui->set_default_state();
  EXPECT_EQ(gui->use_trees().master_group().get_control_count(), master);
  EXPECT_EQ(gui->use_trees().presets_group().get_control_count(), presets);
  EXPECT_EQ(gui->get_bound_control(2), tone);
  // Master column: 2 switches, 6 knobs, 3 lamps and the clip lamp; "Reserved" is not placed.
  EXPECT_EQ(master, 12u);
  EXPECT_EQ(presets, 13u) << "8 programs, the mode switch, 2 bank buttons, the fade knob and display";
  EXPECT_EQ(gui->use_trees().top_group().get_control_count(), 3u);
  for (int b = 0; b < 4; ++b) EXPECT_EQ(gui->use_trees().band_group(b).get_control_count(), 7u) << b;
}

TEST_F(EditorInstance, EveryParameterExceptTheBandReservesHasItsControl) {
  for (int i = 0; i < 40; ++i) {
    const bool band_reserved = i >= 12 && (i - 12) % 7 == 6;
    EXPECT_EQ(gui->get_bound_control(i) == nullptr, band_reserved) << "parameter " << i;
  }
}

TEST_F(EditorInstance, ClosingTheInstanceWithTheEditorOpenClosesTheWindowFirst) {
  ASSERT_TRUE(open_editor());
  window->mouse_move(35, 72);
  window->button_down();  // a gesture in progress holds the capture and a timer
  window->move_by(0, -10);
  ASSERT_TRUE(window->has_capture());
  ASSERT_EQ(window->core().get_capture_handler(), gui->get_bound_control(2));
  // Deleting the instance must neither touch a destroyed control nor a destroyed
  // window (the address sanitizer tree runs this).
  close_instance(effect);
  effect = nullptr;
}

TEST(EditorStartUp, BuildingWithoutPicturesOrEngineFailsWithItsText) {
  BrakmorphGui gui;
  try {
    gui.set_default_state();
    FAIL() << "built without pictures";
  } catch (const std::runtime_error& error) {
    EXPECT_EQ(std::string(error.what()), "BrakmorphGui::set_default_state() : Cannot build GUI.");
  }
  EXPECT_FALSE(gui.is_built());
  gui.init();  // the module's pictures are there
  EXPECT_THROW(gui.set_default_state(), std::runtime_error) << "still no engine and no host adapter";
  int parent = 0;
  EXPECT_EQ(gui.open_window(&parent), -1) << "nothing to open";
}
