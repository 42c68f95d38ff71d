// The clip lamp and the threshold lamps.
#include <gtest/gtest.h>

#include "editor/diode_listener.h"
#include "editor/fading_diode.h"
#include "editor/peak_listener.h"
#include "params/listener_plugin_stage.h"

using guikit::Point;
using listener_test::PluginStage;

namespace {

constexpr int kMasterVol = 7;
constexpr int kB1DistAmnt = 14;
constexpr int kB1DistType = 15;

struct ClipStage : PluginStage {
  FadingDiode lamp;
  PeakListener peak;
  ClipStage() {
    peak.set_engine(&engine());
    lamp.set_listener(&peak);
    lamp.set_refresh_period(0.05f);
    lamp.set_fade_times(0.0, 0.5);
    stage.add(lamp, Point{126, 20}, guikit::Rect{-16, -5, 41, 28});
    // The hard clipper driven far in: its output sits at 0.8 x the master volume.
    set_natural(kB1DistType, 6.0);
    set_natural(kB1DistAmnt, 10.0);
    set_natural(kMasterVol, 2.0);
    engine().set_clip_detection(true);
  }
  void set_natural(int index, double value) { host_set(index, param(index).conv_value_to_norm(value)); }
  void tick() { stage.window.advance_ms(50); }
};

}  // namespace

TEST(MeterPeak, FadeLevels) {
  EXPECT_DOUBLE_EQ(FadingDiode::fade_level(0.25, 0.5, false), 0.5);
  EXPECT_DOUBLE_EQ(FadingDiode::fade_level(0.1, 0.5, true), 0.2);
  EXPECT_DOUBLE_EQ(FadingDiode::fade_level(0.0, 0.5, false), 1.0);
  EXPECT_LT(FadingDiode::fade_level(0.5, 0.5, false), 0.0) << "over at the fade time";
  EXPECT_LT(FadingDiode::fade_level(0.0, 0.0, true), 0.0) << "no fade: on at once";
}

TEST(MeterPeak, ClipLampLightsOnAClippingBlockAndFadesOutOverHalfASecond) {
  ClipStage s;
  ASSERT_NE(s.effect, nullptr);
  s.tick();
  EXPECT_EQ(s.lamp.get_shown_level(), 0.0);

  const std::vector<float> out = s.run(PluginStage::sine(4096, 200.0, 0.9));
  float peak = 0.0f;
  for (float v : out) peak = std::max(peak, std::fabs(v));
  ASSERT_GE(peak, 1.0f) << "the block clips";
  s.tick();
  EXPECT_TRUE(s.peak.get_last_clip());
  EXPECT_EQ(s.lamp.get_value(), 1.0);
  EXPECT_EQ(s.lamp.get_shown_level(), 1.0) << "switching on takes no time";

  s.set_natural(kMasterVol, 0.1);
  s.run(PluginStage::sine(1024, 200.0, 0.9));
  s.tick();  // the flag was read at the last tick, so this block alone counts
  EXPECT_FALSE(s.peak.get_last_clip());
  EXPECT_EQ(s.lamp.get_value(), 0.0);
  const double off_at = s.lamp.get_switch_time();
  EXPECT_EQ(s.lamp.get_shown_level(), 1.0);
  s.stage.window.advance_ms(250);
  EXPECT_DOUBLE_EQ(guikit::toolkit_now() - off_at, 0.25);
  EXPECT_NEAR(s.lamp.get_shown_level(), 0.5, 1e-9);
  s.stage.window.advance_ms(150);
  EXPECT_NEAR(s.lamp.get_shown_level(), 0.2, 1e-9);
  s.stage.window.advance_ms(100);
  EXPECT_EQ(s.lamp.get_shown_level(), 0.0);
  EXPECT_FALSE(s.lamp.get_override()) << "the fade is over";
}

TEST(MeterPeak, WithoutClipDetectionTheLampStaysOff) {
  ClipStage s;
  ASSERT_NE(s.effect, nullptr);
  s.engine().set_clip_detection(false);
  s.run(PluginStage::sine(4096, 200.0, 0.9));
  s.tick();
  EXPECT_FALSE(s.peak.get_last_clip());
  EXPECT_EQ(s.lamp.get_shown_level(), 0.0);
}

TEST(MeterDiode, LampFollowsTheThresholdOnBothPathsAndValuesPassUnchanged) {
  guikit_test::Stage s;
  guikit::Knob knob;
  guikit::Diode lamp;
  guikit_test::RecordingListener lamp_changes;
  lamp.set_listener(&lamp_changes);
  DiodeListener lit(&lamp);
  knob.set_listener(&lit);
  s.add(knob, Point{94, 72}, guikit::Rect{-19, -19, 20, 23});
  s.add(lamp, Point{68, 44}, guikit::Rect{-8, -8, 9, 9});

  ASSERT_TRUE(knob.set_value_by_user(0.25, guikit::kOriginMouse));
  EXPECT_EQ(knob.get_value(), 0.25);
  EXPECT_EQ(lamp.get_value(), 1.0);
  ASSERT_EQ(lamp_changes.changes.size(), 1u);
  EXPECT_EQ(lamp_changes.changes[0].origin, guikit::kOriginMouse);

  ASSERT_TRUE(knob.set_value_by_user(0.5, guikit::kOriginGlide));
  EXPECT_EQ(lamp_changes.changes.size(), 1u) << "already lit: nothing to switch";

  ASSERT_TRUE(knob.set_value(0.0005, 100));
  EXPECT_EQ(knob.get_value(), 0.0005);
  EXPECT_EQ(lamp.get_value(), 0.0);
  ASSERT_EQ(lamp_changes.changes.size(), 2u);
  EXPECT_EQ(lamp_changes.changes[1].origin, 100) << "the origin is passed on";

  // At the threshold itself the lamp is on; just below it, off.
  const double threshold = static_cast<double>(lit.get_threshold());
  ASSERT_TRUE(knob.set_value(threshold, 1));
  EXPECT_EQ(lamp.get_value(), 1.0);
  ASSERT_TRUE(knob.set_value(std::nextafter(threshold, 0.0), 1));
  EXPECT_EQ(lamp.get_value(), 0.0);
}
