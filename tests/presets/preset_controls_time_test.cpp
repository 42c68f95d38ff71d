// The fade-time knob and its display, also used as an input.
#include <gtest/gtest.h>

#include <cmath>
#include <cstdio>
#include <string>

#include "presets/preset_manager_fixture.h"

namespace {

using preset_test::PresetRig;

std::string nearest_integer_text(double t) {
  char text[32];
  std::snprintf(text, sizeof(text), "%d", static_cast<int>(std::floor(t + 0.5)));
  return text;
}

TEST(PresetFadeTime, KnobPositionsGiveAHundredToThePowerMinusOneSeconds) {
  PresetRig rig;
  for (int k = 0; k <= 40; ++k) {
    const double p = k / 40.0;
    rig.stage.knob.set_value_by_user(p, 200);
    const double expected = std::pow(100.0, p) - 1.0;
    EXPECT_NEAR(rig.fade_time(), expected, 1e-9 * (1.0 + expected)) << "position " << p;
    EXPECT_EQ(rig.stage.display.get_text(), nearest_integer_text(expected)) << "position " << p;
  }
  rig.stage.knob.set_value_by_user(0.0, 200);
  EXPECT_EQ(rig.fade_time(), 0.0);
  EXPECT_EQ(rig.stage.display.get_text(), "0");
  rig.stage.knob.set_value_by_user(1.0, 200);
  EXPECT_NEAR(rig.fade_time(), 99.0, 1e-12);
  EXPECT_EQ(rig.stage.display.get_text(), "99");
  rig.stage.knob.set_value_by_user(0.5, 200);
  EXPECT_NEAR(rig.fade_time(), 9.0, 1e-12);
  EXPECT_EQ(rig.stage.display.get_text(), "9");
}

TEST(PresetFadeTime, TheMappingsAreInverse) {
  for (double t : {0.0, 0.001, 0.5, 1.0, 2.7, 9.0, 42.0, 99.0}) {
    const double p = plugcore::PresetTimeFaderListener::position_from_time(t);
    EXPECT_NEAR(p, std::log10(1.0 + t) / 2.0, 1e-15);
    EXPECT_NEAR(plugcore::PresetTimeFaderListener::time_from_position(p), t, 1e-12 * (1.0 + t));
  }
}

TEST(PresetFadeTime, TypedTimesAreClampedAndShownFormatted) {
  PresetRig rig;
  struct Case {
    const char* typed;
    double seconds;
    const char* shown;
  };
  const Case cases[] = {{"250", 99.0, "99"}, {"-3", 0.0, "0"},     {"abc", 0.0, "0"},  {"2.7", 2.7, "3"},
                        {"", 0.0, "0"},      {"  12.5s", 12.5, "13"}, {"1e1", 10.0, "10"}, {"99", 99.0, "99"},
                        {"0.49", 0.49, "0"}};
  for (const Case& c : cases) {
    rig.stage.type_fade_time(c.typed);
    EXPECT_NEAR(rig.fade_time(), c.seconds, 1e-9) << '"' << c.typed << '"';
    EXPECT_EQ(rig.stage.display.get_text(), c.shown) << '"' << c.typed << '"';
    EXPECT_NEAR(rig.stage.knob.get_value(), std::log10(1.0 + c.seconds) / 2.0, 1e-12) << '"' << c.typed << '"';
  }
  EXPECT_EQ(rig.stage.window.line_editor().get_start_count(), static_cast<int>(std::size(cases)));
}

TEST(PresetFadeTime, AnEditLeftWithEscapeChangesNothing) {
  PresetRig rig;
  rig.stage.click(guikit::Point{preset_test::kDisplayPoint.x - 10, preset_test::kDisplayPoint.y + 2});
  rig.stage.window.line_editor().type("50");
  rig.stage.window.line_editor().stop(false);
  EXPECT_NEAR(rig.fade_time(), 1.0, 1e-12);
  EXPECT_EQ(rig.stage.display.get_text(), "1");
}

TEST(PresetFadeTime, ATypedTimeIsTheNextFadesLength) {
  PresetRig rig;
  rig.stage.type_fade_time("0.3");
  rig.press(1);
  int ticks = 0;
  while (rig.number(1).is_fading() && ticks < 50) {
    rig.tick();
    ++ticks;
  }
  // 0.3 s: ticks at 0.1, 0.2 and 0.3 s (or one more when 0.3 s falls just short).
  EXPECT_GE(ticks, 3);
  EXPECT_LE(ticks, 4);
}

TEST(PresetFadeTime, DisplayPrecisionFormatsWithDecimals) {
  plugcore::PresetTimeDisplayListener display;
  EXPECT_EQ(display.format(2.5), "3");
  EXPECT_EQ(display.format(0.4999), "0");
  display.set_precision(2);
  EXPECT_EQ(display.format(2.5), "2.50");
  EXPECT_EQ(display.format(98.999), "99.00");
  display.set_precision(1);
  EXPECT_EQ(display.format(0.04), "0.0");
  display.show(3.0);  // unbound: nothing to write into, nothing breaks
}

}  // namespace
