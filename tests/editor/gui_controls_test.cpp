// Controls bound to parameters: mouse gestures write through the arbitration,
// writes from the host and programs move the controls without echo, and writes
// from other threads reach the controls on the editor's timer.
#include <atomic>
#include <cmath>
#include <thread>

#include "gui_test_support.h"

using gui_test::EditorInstance;

namespace {
constexpr int kToneFreq = 2;
constexpr int kSplit2 = 10;
}  // namespace

TEST_F(EditorInstance, DraggingToneFreqWritesTheParameterAndAutomatesTheHost) {
  ASSERT_TRUE(open_editor());
  const float before = norm(kToneFreq);
  window->mouse_move(35, 72);
  window->button_down();
  ASSERT_EQ(window->core().get_capture_handler(), gui->get_bound_control(kToneFreq)) << "the click grabs Tone Freq";
  for (int step = 0; step < 8; ++step) {
    window->move_by(0, -8);  // upward turns the knob up
    window->advance_ms(30);
  }
  window->button_up();
  window->advance_ms(400);  // the glide after release ends
  const float after = norm(kToneFreq);
  EXPECT_GT(after, before + 0.05f);
  ASSERT_GT(automations_of(kToneFreq), 1);
  EXPECT_FLOAT_EQ(host.automations.back().value, after) << "the host hears the last value";
  EXPECT_EQ(host.automations.back().index, kToneFreq);
  EXPECT_FLOAT_EQ(static_cast<float>(control_value(kToneFreq)), after);
  EXPECT_FLOAT_EQ(effect->getParameter(effect, kToneFreq), after);
  for (const MockHost::Automation& a : host.automations) EXPECT_EQ(a.index, kToneFreq) << "no other parameter moved";
}

TEST_F(EditorInstance, ClickOnTheMiddleSplitGrabsItsSlider) {
  ASSERT_TRUE(open_editor());
  window->mouse_move(162, 20);
  window->button_down();
  EXPECT_EQ(window->core().get_capture_handler(), gui->get_bound_control(kSplit2));
  window->button_up();
  window->advance_ms(100);
  window->mouse_move(162, 10);
  window->button_down();
  EXPECT_EQ(window->core().get_capture_handler(), gui->get_bound_control(9)) << "the first split, 10 pixels up";
  window->button_up();
}

TEST_F(EditorInstance, OpeningBringsEveryControlToItsParameter) {
  // Behind the controls' back, as a preset load inside the engine would.
  engine->use_param(kToneFreq).set_norm_and_notify(0.125f);
  engine->use_param(7).set_norm_and_notify(0.875f);
  EXPECT_NE(static_cast<float>(control_value(kToneFreq)), 0.125f);
  ASSERT_TRUE(open_editor());
  for (int i = 0; i < 40; ++i) {
    if (gui->get_bound_control(i) == nullptr) continue;
    EXPECT_EQ(static_cast<float>(control_value(i)), norm(i)) << "parameter " << i;
  }
  EXPECT_EQ(automations_of(kToneFreq), 0) << "a refresh never automates";
}

TEST_F(EditorInstance, HostProgramChangeMovesEveryControlWithoutEcho) {
  ASSERT_TRUE(open_editor());
  std::vector<float> before;
  for (int i = 0; i < 40; ++i) before.push_back(norm(i));
  call(effSetProgram, 0, 5);
  int moved = 0;
  for (int i = 0; i < 40; ++i) {
    if (gui->get_bound_control(i) == nullptr) continue;
    EXPECT_EQ(static_cast<float>(control_value(i)), norm(i)) << "parameter " << i;
    moved += norm(i) != before[static_cast<size_t>(i)] ? 1 : 0;
  }
  EXPECT_GT(moved, 5) << "program 5 differs from program 0 in many parameters";
  EXPECT_TRUE(host.automations.empty()) << "followed changes are not written again";
}

TEST_F(EditorInstance, HostWriteOnTheEditorThreadFollowsAtOnce) {
  ASSERT_TRUE(open_editor());
  effect->setParameter(effect, kToneFreq, 0.3f);
  EXPECT_FLOAT_EQ(static_cast<float>(control_value(kToneFreq)), 0.3f);
  EXPECT_FALSE(gui->use_follower().has_pending());
  EXPECT_EQ(automations_of(kToneFreq), 0);
}

TEST_F(EditorInstance, WritesFromOtherThreadsWaitForTheEditorTimer) {
  ASSERT_TRUE(open_editor());
  std::atomic<bool> done{false};
  // Another thread keeps writing while the editor thread collects.
  std::thread writer([&] {
    for (int i = 0; i < 2000; ++i) {
      effect->setParameter(effect, kToneFreq, static_cast<float>(i % 100) / 100.0f);
      effect->setParameter(effect, 7, 0.25f);
    }
    done.store(true);
  });
  while (!done.load()) window->advance_ms(20);
  writer.join();
  window->advance_ms(20);
  EXPECT_FALSE(gui->use_follower().has_pending());
  EXPECT_FLOAT_EQ(static_cast<float>(control_value(kToneFreq)), norm(kToneFreq)) << "the latest write is shown";
  EXPECT_FLOAT_EQ(static_cast<float>(control_value(7)), 0.25f);

  std::thread last([&] { effect->setParameter(effect, kToneFreq, 0.625f); });
  last.join();
  EXPECT_TRUE(gui->use_follower().has_pending());
  EXPECT_NE(static_cast<float>(control_value(kToneFreq)), 0.625f) << "not followed away from the editor thread";
  window->advance_ms(20);
  EXPECT_FALSE(gui->use_follower().has_pending());
  EXPECT_FLOAT_EQ(static_cast<float>(control_value(kToneFreq)), 0.625f);
  EXPECT_TRUE(host.automations.empty());
}

TEST_F(EditorInstance, WritesWhileClosedFollowOnTheEditorThreadOrWhenItOpens) {
  effect->setParameter(effect, 7, 0.375f);
  EXPECT_FLOAT_EQ(static_cast<float>(control_value(7)), 0.375f) << "the editor thread follows at once";
  std::thread writer([&] { effect->setParameter(effect, kToneFreq, 0.75f); });
  writer.join();
  EXPECT_TRUE(gui->use_follower().has_pending());
  EXPECT_NE(static_cast<float>(control_value(kToneFreq)), 0.75f);
  ASSERT_TRUE(open_editor());
  EXPECT_FALSE(gui->use_follower().has_pending());
  EXPECT_FLOAT_EQ(static_cast<float>(control_value(kToneFreq)), 0.75f);
  EXPECT_TRUE(host.automations.empty());
}

TEST_F(EditorInstance, MarkersShowBesideTheBoundControl) {
  guikit::ControlInterface* tone = gui->get_bound_control(kToneFreq);
  EXPECT_EQ(tone->get_marker(), -1);
  ASSERT_TRUE(open_editor());
  window->paint_all();
  // The lamp sits 3 pixels left of the control position, 11 x 11.
  const uint32_t plain = window->pixel(35 - 3 + 5, 72 + 5);
  gui->set_control_marker(kToneFreq, 2);
  EXPECT_EQ(tone->get_marker(), 2);
  window->paint_all();
  EXPECT_NE(window->pixel(35 - 3 + 5, 72 + 5), plain);
  gui->set_control_marker(kToneFreq, 0);
  window->paint_all();
  EXPECT_EQ(window->pixel(35 - 3 + 5, 72 + 5), plain) << "marker 0 is empty";
  gui->set_control_marker(39, 1);  // a reserved parameter without control: nothing happens
}
