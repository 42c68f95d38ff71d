// Program selection and the cross-fade, through the real plug-in: every tick
// goes through the host-GUI adapter's arbitration and shows up as automation.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "presets/preset_manager_fixture.h"

namespace {

using preset_test::kParams;
using preset_test::PresetRig;

std::vector<float> bank_values(PresetRig& rig, int program) {
  std::vector<float> v;
  const plugcore::ProgramSlot& slot = rig.manager.use_bank().use_program(program);
  for (int i = 0; i < kParams; ++i) v.push_back(slot.get_value(i));
  return v;
}

// Two bank programs that differ in at least one stepped and one continuous parameter.
bool find_pair(PresetRig& rig, int& from, int& to) {
  for (from = 0; from < rig.manager.get_nbr_programs(); ++from) {
    for (to = 0; to < rig.manager.get_nbr_programs(); ++to) {
      const std::vector<float> a = bank_values(rig, from);
      const std::vector<float> b = bank_values(rig, to);
      bool stepped = false;
      bool continuous = false;
      for (int i = 0; i < kParams; ++i) {
        if (a[i] == b[i]) continue;
        (rig.stepped(i) ? stepped : continuous) = true;
      }
      if (stepped && continuous) return true;
    }
  }
  return false;
}

// Applies a program at once (zero fade time) and lets the fade end.
void jump_to(PresetRig& rig, int program) {
  rig.set_fade_seconds(0.0);
  rig.press(program);
  rig.settle();
}

TEST(PresetFade, ZeroFadeAppliesTheTargetAtTheFirstTickAndStops) {
  PresetRig rig;
  rig.set_fade_seconds(0.0);
  EXPECT_EQ(rig.fade_time(), 0.0);
  const std::vector<float> before = rig.params();
  const std::vector<float> target = bank_values(rig, 2);
  ASSERT_NE(before, target);

  rig.press(2);
  EXPECT_TRUE(rig.number(2).is_fading());
  EXPECT_EQ(rig.manager.use_hub().get_current_program(), 2);
  EXPECT_EQ(rig.params(), before) << "nothing changes before the first tick";
  EXPECT_TRUE(rig.host.automations.empty());

  rig.tick();
  EXPECT_EQ(rig.params(), target);
  EXPECT_FALSE(rig.number(2).is_fading());
  ASSERT_EQ(rig.host.automations.size(), static_cast<size_t>(kParams)) << "one automation per parameter";
  for (int i = 0; i < kParams; ++i) {
    EXPECT_EQ(rig.host.automations[i].index, i);
    EXPECT_EQ(rig.host.automations[i].value, target[i]);
  }
  // The host's current program follows what the editor applied.
  const plugcore::ProgramSlot& host_program = rig.plugin->use_bank().use_program(0);
  EXPECT_EQ(host_program.get_name(), rig.manager.use_bank().use_program(2).get_name());
  EXPECT_EQ(rig.plugin->use_dsp()->get_program_name(), rig.manager.use_bank().use_program(2).get_name());

  for (int k = 0; k < 5; ++k) rig.tick();
  EXPECT_EQ(rig.host.automations.size(), static_cast<size_t>(kParams)) << "the timer was stopped";
}

TEST(PresetFade, TwoSecondFadeFollowsTheStraightLineAndLandsOnTheTarget) {
  PresetRig rig;
  int from = 0;
  int to = 0;
  ASSERT_TRUE(find_pair(rig, from, to));
  jump_to(rig, from);
  const std::vector<float> a = rig.params();
  ASSERT_EQ(a, bank_values(rig, from));
  const std::vector<float> b = bank_values(rig, to);

  rig.set_fade_seconds(2.0);
  const double fade = rig.fade_time();
  ASSERT_NEAR(fade, 2.0, 1e-9);
  rig.host.automations.clear();
  const uint32_t start_ms = rig.stage.window.now_ms();
  rig.press(to);

  int ticks = 0;
  double last_position = 0.0;
  while (rig.number(to).is_fading() && ticks < 100) {
    rig.tick();
    ++ticks;
    const double elapsed = (rig.stage.window.now_ms() - start_ms) / 1000.0;
    const double position = std::min(1.0, std::max(0.0, elapsed / fade));
    last_position = position;
    const std::vector<float> now = rig.params();
    for (int i = 0; i < kParams; ++i) {
      const double expected = rig.stepped(i) ? b[i] : (static_cast<double>(b[i]) - a[i]) * position + a[i];
      ASSERT_NEAR(now[i], expected, 1e-6) << "parameter " << i << " at tick " << ticks;
    }
    // Each tick reports all parameters to the host, with the values the engine took.
    ASSERT_EQ(rig.host.automations.size(), static_cast<size_t>(kParams * ticks));
    for (int i = 0; i < kParams; ++i) {
      EXPECT_EQ(rig.host.automations[kParams * (ticks - 1) + i].value, now[i]);
    }
  }
  EXPECT_GE(ticks, 20);
  EXPECT_LE(ticks, 21);
  EXPECT_EQ(last_position, 1.0);
  EXPECT_EQ(rig.params(), b) << "the last tick lands exactly on the target";
  EXPECT_EQ(rig.plugin->use_bank().use_program(0).get_value(5), b[5]);
}

TEST(PresetFade, SteppedParametersJumpAtTheFirstTickContinuousOnesMoveALittle) {
  PresetRig rig;
  int from = 0;
  int to = 0;
  ASSERT_TRUE(find_pair(rig, from, to));
  jump_to(rig, from);
  const std::vector<float> a = rig.params();
  const std::vector<float> b = bank_values(rig, to);
  rig.set_fade_seconds(99.0);  // the knob's end: positions of 0.1 / 99 per tick
  ASSERT_NEAR(rig.fade_time(), 99.0, 1e-9);
  rig.press(to);
  rig.tick();
  const std::vector<float> now = rig.params();
  for (int i = 0; i < kParams; ++i) {
    if (rig.stepped(i)) {
      EXPECT_EQ(now[i], b[i]) << "stepped parameter " << i;
    } else if (a[i] != b[i]) {
      EXPECT_NEAR(now[i], a[i] + (b[i] - a[i]) * (0.1 / 99.0), 1e-6) << "continuous parameter " << i;
      EXPECT_NE(now[i], b[i]);
    }
  }
  EXPECT_TRUE(rig.number(to).is_fading());
}

TEST(PresetFade, PressingAnotherProgramRestartsFromTheSoundReached) {
  PresetRig rig;
  jump_to(rig, 0);
  rig.set_fade_seconds(2.0);
  const double fade = rig.fade_time();
  rig.press(5);
  for (int k = 0; k < 5; ++k) rig.tick();
  const int32_t old_timer = rig.number(5).get_timer_id();
  ASSERT_GE(old_timer, 0);
  const std::vector<float> reached = rig.params();
  ASSERT_NE(reached, bank_values(rig, 0));
  ASSERT_NE(reached, bank_values(rig, 5));

  const uint32_t start_ms = rig.stage.window.now_ms();
  rig.press(3);
  EXPECT_FALSE(rig.number(5).is_fading()) << "the fade to 5 stopped";
  EXPECT_TRUE(rig.number(3).is_fading());
  EXPECT_EQ(rig.manager.use_hub().get_current_program(), 3);

  // A late tick of the old timer is ignored.
  rig.host.automations.clear();
  guikit::Notify stale(old_timer, rig.stage.window.now_ms() * 0.001);
  EXPECT_EQ(rig.number(5).process_message(stale), 0);
  EXPECT_TRUE(rig.host.automations.empty());
  EXPECT_EQ(rig.params(), reached);

  const std::vector<float> c = bank_values(rig, 3);
  for (int k = 0; k < 3; ++k) {
    rig.tick();
    const double position = (rig.stage.window.now_ms() - start_ms) / 1000.0 / fade;
    const std::vector<float> now = rig.params();
    for (int i = 0; i < kParams; ++i) {
      const double expected =
          rig.stepped(i) ? c[i] : (static_cast<double>(c[i]) - reached[i]) * position + reached[i];
      ASSERT_NEAR(now[i], expected, 1e-6) << "parameter " << i;
    }
  }
  rig.settle();
  EXPECT_EQ(rig.params(), c);
}

TEST(PresetFade, StoreModeStoresWithoutAFadeAndGoesBackToLoad) {
  PresetRig rig;
  jump_to(rig, 1);
  // A sound of our own: the host moves two parameters.
  rig.effect->setParameter(rig.effect, 7, 0.123f);
  rig.effect->setParameter(rig.effect, 21, 0.875f);
  const std::vector<float> sound = rig.params();
  ASSERT_NE(sound, bank_values(rig, 4));

  rig.stage.click(preset_test::kSwitchPoint);
  EXPECT_EQ(rig.stage.mode_switch.get_value(), 1.0);
  EXPECT_EQ(rig.manager.use_mem_listener().get_mode(), plugcore::PresetMemListener::kStore);
  rig.host.automations.clear();

  rig.press(4);
  EXPECT_EQ(bank_values(rig, 4), sound);
  EXPECT_EQ(rig.manager.use_bank().use_program(4).get_name(), rig.plugin->use_dsp()->get_program_name());
  EXPECT_EQ(rig.stage.mode_switch.get_value(), 0.0);
  EXPECT_EQ(rig.manager.use_mem_listener().get_mode(), plugcore::PresetMemListener::kLoad);
  EXPECT_FALSE(rig.number(4).is_fading());
  EXPECT_EQ(rig.manager.use_hub().get_current_program(), 4);
  for (int k = 0; k < 5; ++k) rig.tick();
  EXPECT_EQ(rig.params(), sound);
  EXPECT_TRUE(rig.host.automations.empty());

  // The next press loads again.
  rig.press(2);
  EXPECT_TRUE(rig.number(2).is_fading());
  rig.settle();
  EXPECT_EQ(rig.params(), bank_values(rig, 2));
}

TEST(PresetFade, ARefusedTimerChangesNothing) {
  PresetRig rig;
  rig.set_fade_seconds(0.0);
  const std::vector<float> before = rig.params();
  rig.stage.window.refuse_timers(true);
  rig.press(6);
  EXPECT_EQ(rig.number(6).get_timer_id(), -1);
  EXPECT_EQ(rig.manager.use_hub().get_current_program(), 6);
  for (int k = 0; k < 5; ++k) rig.tick();
  EXPECT_EQ(rig.params(), before);
  EXPECT_TRUE(rig.host.automations.empty());

  // Once the window runs timers again a press works.
  rig.stage.window.refuse_timers(false);
  rig.press(6);
  rig.tick();
  EXPECT_EQ(rig.params(), bank_values(rig, 6));
}

TEST(PresetFade, DeinitStopsARunningFadeAndGivesBackItsTimer) {
  PresetRig rig;
  rig.set_fade_seconds(5.0);
  rig.press(3);
  rig.tick();
  ASSERT_TRUE(rig.number(3).is_fading());
  const size_t timers = rig.stage.window.get_running_timer_count();
  rig.manager.deinit();
  EXPECT_FALSE(rig.manager.is_initialised());
  EXPECT_FALSE(rig.number(3).is_fading());
  EXPECT_EQ(rig.stage.window.get_running_timer_count(), timers - 1);
  const size_t automations = rig.host.automations.size();
  for (int k = 0; k < 5; ++k) rig.tick();
  EXPECT_EQ(rig.host.automations.size(), automations);
}

TEST(PresetFade, TicksAreWrittenAboveHostAutomationAndBelowProgramChanges) {
  PresetRig rig;
  jump_to(rig, 0);
  rig.set_fade_seconds(2.0);
  rig.press(5);
  // Host automation (priority 100) does not stop the preset ticks.
  rig.effect->setParameter(rig.effect, 3, 0.5f);
  rig.host.automations.clear();
  rig.tick();
  EXPECT_EQ(rig.host.automations.size(), static_cast<size_t>(kParams));
  // A knob held with the mouse (priority 200) keeps its parameter: the
  // tick reports every other one.
  ASSERT_TRUE(rig.host_gui.lock_param(3, 200));
  rig.host.automations.clear();
  rig.tick();
  EXPECT_EQ(rig.host.automations.size(), static_cast<size_t>(kParams - 1));
  for (const MockHost::Automation& a : rig.host.automations) EXPECT_NE(a.index, 3);
  rig.host_gui.release_param(3, 200);
}

}  // namespace
