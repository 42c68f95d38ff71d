// Right-button band linking of the same control across the four bands.
#include <gtest/gtest.h>

#include <array>
#include <map>

#include "editor/param_control_finder_interface.h"
#include "editor/rc_mgr.h"
#include "params/listener_plugin_stage.h"
#include "params/num_val_listener_interface.h"

using guikit::Point;
using listener_test::PluginStage;

namespace {

constexpr int kDistAmnt = 2;  // slot of "Dist Amnt" within a band

struct LinkStage : PluginStage, ParamControlFinderInterface {
  std::array<guikit::Knob, 4> knobs;
  std::array<plugcore::NumValListenerInterface, 4> listeners;
  std::array<RcMgr, 4> links{{RcMgr(this, 14), RcMgr(this, 21), RcMgr(this, 28), RcMgr(this, 35)}};
  LinkStage() {
    for (int b = 0; b < 4; ++b) {
      const int index = RcMgr::param_of(b, kDistAmnt);
      listeners[b].set_host_gui(&adapter);
      listeners[b].bind_param(index, &param(index));
      listeners[b].set_next(&links[b]);
      knobs[b].set_listener(&listeners[b]);
      add_knob(stage, knobs[b], Point{177 + 114 * b, 197});
    }
  }
  guikit::ControlInterface* find_param_control(int index) override {
    for (int b = 0; b < 4; ++b) {
      if (RcMgr::param_of(b, kDistAmnt) == index) return &knobs[b];
    }
    return nullptr;
  }
  void start_at(const std::array<float, 4>& v) {
    for (int b = 0; b < 4; ++b) {
      host_set(RcMgr::param_of(b, kDistAmnt), v[b]);
      ASSERT_TRUE(listeners[b].refresh());
    }
  }
  // Band 2 (index 1) dragged by `pixels` upwards with the button and keys given, settled while held.
  void press(uint32_t button, uint32_t modifiers) {
    stage.window.mouse_move(291, 185);
    stage.window.button_down(button, modifiers);
  }
  void move(int pixels) {
    stage.window.move_by(0, -pixels);
    stage.window.advance_ms(3000);
  }
  void release(uint32_t button) {
    stage.window.button_up(button);
    stage.window.advance_ms(1000);
  }
  std::array<double, 4> values() const {
    return {{knobs[0].get_value(), knobs[1].get_value(), knobs[2].get_value(), knobs[3].get_value()}};
  }
  void expect_values(const std::array<double, 4>& expected) {
    for (int b = 0; b < 4; ++b) {
      EXPECT_NEAR(knobs[b].get_value(), expected[b], 1e-6) << "band " << b;
      EXPECT_EQ(get(RcMgr::param_of(b, kDistAmnt)), static_cast<float>(knobs[b].get_value())) << "band " << b;
    }
  }
};

}  // namespace

TEST(BandLink, SlotsAndIndicesOfTheFourBands) {
  EXPECT_EQ(RcMgr::slot_of(12), 0);
  EXPECT_EQ(RcMgr::slot_of(18), 6);
  EXPECT_EQ(RcMgr::slot_of(21), 2);
  EXPECT_EQ(RcMgr::slot_of(39), 6);
  EXPECT_EQ(RcMgr::band_of(39), 3);
  EXPECT_EQ(RcMgr::param_of(3, 2), 35);
}

TEST(BandLink, RightButtonSetsTheOtherBandsAbsoluteOrMirrored) {
  LinkStage s;
  ASSERT_NE(s.effect, nullptr);
  s.start_at({{0.1f, 0.0f, 0.5f, 0.9f}});
  s.press(guikit::kButtonRight, 0);
  s.move(140);
  s.release(guikit::kButtonRight);
  s.expect_values({{0.7, 0.7, 0.7, 0.7}});
  EXPECT_FALSE(s.automated(14).empty()) << "linked bands are reported to the host";

  s.start_at({{0.1f, 0.0f, 0.5f, 0.9f}});
  s.press(guikit::kButtonRight, guikit::kModControl);
  s.move(140);
  s.release(guikit::kButtonRight);
  s.expect_values({{0.3, 0.7, 0.3, 0.3}});
}

TEST(BandLink, LeftButtonMovesOnlyItsOwnBand) {
  LinkStage s;
  ASSERT_NE(s.effect, nullptr);
  s.start_at({{0.1f, 0.0f, 0.5f, 0.9f}});
  s.press(guikit::kButtonLeft, guikit::kModShift);
  s.move(100);
  s.release(guikit::kButtonLeft);
  s.expect_values({{0.1f, 0.5, 0.5f, 0.9f}});
}

TEST(BandLink, RelativeLinkKeepsDistancesAndBandsAtALimitComeBackInStep) {
  LinkStage s;
  ASSERT_NE(s.effect, nullptr);
  s.start_at({{0.2f, 0.4f, 0.5f, 0.9f}});
  s.press(guikit::kButtonRight, guikit::kModShift);
  const std::array<double, 2> pair = s.links[1].get_limits(3);
  EXPECT_NEAR(pair[0], 0.4, 1e-6);
  EXPECT_NEAR(pair[1], 0.9, 1e-6);
  EXPECT_EQ(s.links[1].get_limits(1)[0], -1.0) << "no pair for the dragged band itself";
  s.move(60);
  s.expect_values({{0.5, 0.7, 0.8, 1.0}});
  s.move(-20);
  s.expect_values({{0.4, 0.6, 0.7, 1.0}});  // band 4 still past its limit
  s.move(-40);
  s.expect_values({{0.2, 0.4, 0.5, 0.9}});  // back where they started, in step
  s.release(guikit::kButtonRight);

  s.start_at({{0.2f, 0.4f, 0.5f, 0.9f}});
  s.press(guikit::kButtonRight, guikit::kModShift | guikit::kModControl);
  s.move(60);
  s.expect_values({{0.0, 0.7, 0.2, 0.6}});
  s.move(-60);
  s.expect_values({{0.2, 0.4, 0.5, 0.9}});
  s.release(guikit::kButtonRight);
}

TEST(BandLink, AHostWriteDuringTheGlideIsNotCopiedToTheOtherBands) {
  LinkStage s;
  ASSERT_NE(s.effect, nullptr);
  s.start_at({{0.1f, 0.0f, 0.5f, 0.9f}});
  listener_test::sleep_ms(550);  // the glide yields to the host's writes of the set-up for 0.5 s
  s.press(guikit::kButtonRight, 0);
  s.stage.window.move_by(0, -100);
  s.stage.window.button_up(guikit::kButtonRight);
  s.stage.window.advance_ms(30);  // one glide step, still linked
  const double glided = s.knobs[1].get_value();
  ASSERT_GT(glided, 0.0);
  EXPECT_NEAR(s.knobs[0].get_value(), glided, 1e-12) << "the glide after release stays linked";

  s.host_set(21, 0.05f);
  ASSERT_TRUE(s.knobs[1].set_value(s.get(21), 100));  // the editor follows the host
  s.stage.window.advance_ms(1000);
  EXPECT_EQ(s.knobs[1].get_value(), static_cast<double>(0.05f));
  for (int b : {0, 2, 3}) EXPECT_NEAR(s.knobs[b].get_value(), glided, 1e-12) << "band " << b;
}
