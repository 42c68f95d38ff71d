// VU needles driven by the engine's band levels.
#include <gtest/gtest.h>

#include <cmath>

#include "editor/vu_meter_listener.h"
#include "guikit/text_box.h"
#include "params/listener_plugin_stage.h"

using guikit::Point;
using listener_test::PluginStage;

namespace {

// -30 dB at 0, +10 dB at 1, in double precision.
double reference_position(double level) {
  const double db = 20.0 * std::log10(std::max(level, 1e-6));
  return std::min(1.0, std::max(0.0, (db + 30.0) / 40.0));
}

struct NeedleStage : PluginStage {
  guikit::VuMeterNeedle needle;
  VuMeterListener meter;
  explicit NeedleStage(int band) {
    meter.set_engine(&engine());
    meter.set_band(band);
    needle.set_listener(&meter);
    needle.set_refresh_period(0.04f);
    stage.add(needle, Point{180, 118}, guikit::Rect{-23, -59, 23, -22});
    engine().set_metering(true);
  }
  void tick() { stage.window.advance_ms(40); }
};

}  // namespace

TEST(MeterVu, PositionOnTheDecibelScale) {
  EXPECT_EQ(VuMeterListener::level_to_position(0.0f), 0.0f) << "silence is forced to -120 dB and limited";
  EXPECT_EQ(VuMeterListener::level_to_position(-0.5f), 0.0f);
  EXPECT_FLOAT_EQ(VuMeterListener::level_to_position(1.0f), 0.75f);
  EXPECT_NEAR(VuMeterListener::level_to_position(static_cast<float>(std::pow(10.0, -0.5))), 0.5f, 1e-6);
  EXPECT_NEAR(VuMeterListener::level_to_position(static_cast<float>(std::pow(10.0, -1.5))), 0.0f, 1e-6);
  EXPECT_NEAR(VuMeterListener::level_to_position(static_cast<float>(std::pow(10.0, 0.5))), 1.0f, 1e-6);
  EXPECT_EQ(VuMeterListener::level_to_position(100.0f), 1.0f);
  for (double level : {0.002, 0.05, 0.3, 0.9, 2.0}) {
    EXPECT_NEAR(VuMeterListener::level_to_position(static_cast<float>(level)), reference_position(level), 1e-6);
  }
}

TEST(MeterVu, NeedleFollowsTheBandLevelOfProcessedAudio) {
  NeedleStage s(0);
  ASSERT_NE(s.effect, nullptr);
  s.tick();
  EXPECT_EQ(s.needle.get_value(), 0.0) << "no audio yet: level 0";
  EXPECT_EQ(s.meter.get_last_position(), 0.0f);

  // Metering through the engine (it has no level setter): a sine in one band.
  s.run(PluginStage::sine(22050, 300.0, 0.5));
  const float level = s.engine().get_band_level(0);
  ASSERT_GT(level, 0.01f);
  s.tick();
  EXPECT_NEAR(s.needle.get_value(), reference_position(level), 1e-6);
  EXPECT_GT(s.needle.get_value(), 0.3);

  // Bands beyond the band count (all splits at their maximum: one band) read 0.
  NeedleStage other(2);
  other.tick();
  EXPECT_EQ(other.needle.get_value(), 0.0);
}

TEST(MeterVu, SmallChangesLeaveTheNeedleAlone) {
  NeedleStage s(0);
  ASSERT_NE(s.effect, nullptr);
  s.meter.set_min_change(2);  // half the scale
  EXPECT_FLOAT_EQ(s.meter.get_min_change(), 0.5f);
  s.tick();
  ASSERT_EQ(s.needle.get_value(), 0.0);
  s.run(PluginStage::sine(22050, 300.0, 0.5));
  const double position = reference_position(s.engine().get_band_level(0));
  ASSERT_GT(position, 0.0);
  ASSERT_LT(position, 0.5);
  s.tick();
  EXPECT_EQ(s.needle.get_value(), 0.0) << "the change is below the minimum";

  s.meter.set_min_change(0);  // every change shows
  EXPECT_FLOAT_EQ(s.meter.get_min_change(), 1e-9f);
  s.tick();
  EXPECT_NEAR(s.needle.get_value(), position, 1e-6);
}
