// Parameter listeners against the real plug-in: knob drags, host writes during
// a drag and during the glide, follow refreshes, typed values.
#include <gtest/gtest.h>

#include <chrono>
#include <cmath>
#include <string>

#include "guikit/text_box.h"
#include "params/listener_plugin_stage.h"
#include "params/num_param_mgr.h"
#include "params/num_val_listener_interface.h"
#include "params/num_val_tb_listener.h"

using guikit::Knob;
using guikit::Point;
using listener_test::PluginStage;

namespace {

constexpr int kToneFreq = 2;

// Tone Freq spans 2000..8000 Hz as 2000 x 4^norm.
double tone_norm(double hz) { return std::log2(hz / 2000.0) / 2.0; }

struct BoundKnob : PluginStage {
  Knob knob;
  plugcore::NumValListenerInterface listener;
  guikit_test::RecordingListener rec;
  BoundKnob() {
    listener.set_host_gui(&adapter);
    listener.bind_param(kToneFreq, &param(kToneFreq));
    knob.set_listener(&listener);
    knob.push_back_listener(&rec);
    add_knob(stage, knob, Point{35, 72});
  }
  void press() { stage.window.click_at(35, 60); }
};

}  // namespace

TEST(ListenerPlugin, DragReportsEveryValueAsAutomationWithTheParameterFollowing) {
  BoundKnob s;
  ASSERT_NE(s.effect, nullptr);
  ASSERT_TRUE(s.listener.refresh());
  const double start = s.knob.get_value();
  EXPECT_NEAR(start, tone_norm(5000.0), 1e-6) << "the default tone frequency";
  EXPECT_TRUE(s.host.automations.empty()) << "a refresh writes nothing";
  s.rec.changes.clear();

  s.press();
  for (int i = 0; i < 4; ++i) {
    s.stage.window.move_by(0, -10);
    s.stage.window.advance_ms(30);
  }
  s.stage.window.button_up();
  s.stage.window.advance_ms(2000);

  EXPECT_NEAR(s.knob.get_value(), start + 40.0 / 200.0, 1e-9);
  EXPECT_EQ(s.get(kToneFreq), static_cast<float>(s.knob.get_value()));
  const std::vector<float> automated = s.automated(kToneFreq);
  ASSERT_EQ(automated.size(), s.rec.changes.size());
  ASSERT_EQ(s.host.automations.size(), automated.size()) << "no other parameter was reported";
  bool glided = false;
  for (size_t i = 0; i < automated.size(); ++i) {
    EXPECT_EQ(automated[i], static_cast<float>(s.rec.changes[i].value)) << "change " << i;
    glided = glided || s.rec.changes[i].origin == guikit::kOriginGlide;
  }
  EXPECT_EQ(s.rec.changes.front().origin, guikit::kOriginMouse);
  EXPECT_TRUE(glided) << "the movement was finished by the glide after release";
  EXPECT_NEAR(s.param(kToneFreq).get_value(), 2000.0 * std::pow(4.0, static_cast<double>(s.get(kToneFreq))), 1e-6);
}

TEST(ListenerPlugin, HostWriteDuringAHeldDragIsRefusedForHalfASecond) {
  BoundKnob s;
  ASSERT_NE(s.effect, nullptr);
  ASSERT_TRUE(s.listener.refresh());
  s.press();
  s.stage.window.move_by(0, -20);
  s.stage.window.advance_ms(30);  // a tick while the button is held locks the parameter
  const auto locked = std::chrono::steady_clock::now();
  const double shown = s.knob.get_value();
  const float held = s.get(kToneFreq);
  ASSERT_EQ(held, static_cast<float>(shown));

  s.host_set(kToneFreq, 0.05f);
  EXPECT_EQ(s.get(kToneFreq), held);
  listener_test::sleep_ms(250);
  s.host_set(kToneFreq, 0.05f);
  if (std::chrono::steady_clock::now() - locked < std::chrono::milliseconds(450)) {
    EXPECT_EQ(s.get(kToneFreq), held) << "still inside the hold";
  }
  EXPECT_EQ(s.knob.get_value(), shown) << "the knob does not jump";

  listener_test::sleep_ms(400);
  s.host_set(kToneFreq, 0.05f);
  EXPECT_EQ(s.get(kToneFreq), 0.05f) << "the hold is over";

  // The mouse outranks the host: the next held tick takes the parameter back.
  s.stage.window.move_by(0, -10);
  s.stage.window.advance_ms(30);
  EXPECT_EQ(s.get(kToneFreq), static_cast<float>(s.knob.get_value()));
  EXPECT_GT(s.knob.get_value(), shown);
  s.stage.window.button_up();
}

TEST(ListenerPlugin, HostWriteDuringTheGlideTakesOverAndStopsTheKnob) {
  BoundKnob s;
  ASSERT_NE(s.effect, nullptr);
  ASSERT_TRUE(s.listener.refresh());
  s.press();
  s.stage.window.move_by(0, -60);
  s.stage.window.button_up();
  s.stage.window.advance_ms(30);
  ASSERT_EQ(s.rec.changes.back().origin, guikit::kOriginGlide);
  ASSERT_NE(s.knob.get_value(), s.knob.behaviour().get_target()) << "still gliding";

  s.host_set(kToneFreq, 0.05f);
  EXPECT_EQ(s.get(kToneFreq), 0.05f) << "the host outranks the glide";
  const size_t reported = s.host.automations.size();
  const double shown = s.knob.get_value();
  s.stage.window.advance_ms(30);
  EXPECT_EQ(s.knob.behaviour().get_state(), guikit::PotBehaviour::kIdle) << "the refused glide step ends it";
  s.stage.window.advance_ms(500);
  EXPECT_EQ(s.knob.get_value(), shown);
  EXPECT_EQ(s.get(kToneFreq), 0.05f);
  EXPECT_EQ(s.host.automations.size(), reported);

  // The editor follows the host's write as a change from outside with its priority.
  EXPECT_TRUE(s.knob.set_value(0.05f, 100));
  EXPECT_EQ(s.knob.get_value(), static_cast<double>(0.05f));
  EXPECT_EQ(s.host.automations.size(), reported) << "following never writes back";
}

TEST(ListenerPlugin, FollowAndRefreshNeverAutomateAndWeakerFollowsAreRefused) {
  BoundKnob s;
  ASSERT_NE(s.effect, nullptr);
  s.host_set(kToneFreq, 0.3f);
  // Right after the host's write a refresh still shows it: it is not arbitrated.
  ASSERT_TRUE(s.listener.refresh());
  EXPECT_EQ(s.knob.get_value(), static_cast<double>(0.3f));
  EXPECT_EQ(s.rec.changes.back().origin, guikit::kOriginSync);
  // Equal priority follows; a weaker one within the hold is refused and shows nothing.
  EXPECT_TRUE(s.knob.set_value(0.4, 100));
  EXPECT_FALSE(s.knob.set_value(0.9, guikit::kOriginGlide));
  EXPECT_EQ(s.knob.get_value(), 0.4);
  EXPECT_EQ(s.get(kToneFreq), 0.3f) << "a change from outside writes nothing";
  EXPECT_TRUE(s.host.automations.empty());

  // Unbound, the listener lets everything through and writes nothing.
  plugcore::NumValListenerInterface loose;
  Knob other;
  other.set_listener(&loose);
  EXPECT_TRUE(other.set_value_by_user(0.7, guikit::kOriginMouse));
  EXPECT_FALSE(loose.refresh()) << "no parameter to show";
  EXPECT_TRUE(s.host.automations.empty());
}

TEST(ListenerPlugin, TypedValuesGoThroughTheKnobAndBadTextRestoresTheValueText) {
  BoundKnob s;
  ASSERT_NE(s.effect, nullptr);
  guikit::TextBox name_box, value_box;
  plugcore::NumParamMgr group;
  group.set_param(&s.param(kToneFreq));
  group.set_knob(&s.knob);
  group.set_boxes(&name_box, nullptr, &value_box);
  s.listener.set_param_mgr(&group);
  plugcore::NumValTbListener typed;
  typed.set_host_gui(&s.adapter);
  typed.bind_param(kToneFreq, &s.param(kToneFreq));
  typed.set_param_mgr(&group);
  value_box.set_listener(&typed);
  value_box.set_editable(true);
  s.stage.add(value_box, Point{100, 150}, guikit::Rect{0, 0, 60, 12});

  auto value_text = [&](double hz) {
    char text[128];
    s.param(kToneFreq).conv_value_to_text(text, 128, hz);
    return std::string(text);
  };
  auto type = [&](const std::string& text) {
    s.stage.window.click_at(110, 155);
    s.stage.window.button_up();
    EXPECT_TRUE(value_box.is_editing());
    s.stage.window.line_editor().type(text);
    guikit::TextInputStop accept(true);
    s.stage.window.process_message(accept);
  };

  group.show_texts();
  EXPECT_EQ(name_box.get_text(), "Tone Freq");
  EXPECT_EQ(value_box.get_text(), value_text(5000.0));

  type("3000");
  const float norm = static_cast<float>(tone_norm(3000.0));
  EXPECT_NEAR(s.get(kToneFreq), norm, 1e-6);
  EXPECT_EQ(s.knob.get_value(), static_cast<double>(s.get(kToneFreq)));
  ASSERT_EQ(s.automated(kToneFreq).size(), 1u) << "a typed value is reported like a drag";
  EXPECT_EQ(s.automated(kToneFreq)[0], s.get(kToneFreq));
  EXPECT_EQ(value_box.get_text(), value_text(s.param(kToneFreq).get_value()));
  EXPECT_NEAR(s.param(kToneFreq).get_value(), 3000.0, 0.01);

  const float before = s.get(kToneFreq);
  const std::string shown = value_box.get_text();
  type("abc");
  EXPECT_EQ(value_box.get_text(), shown) << "unreadable text puts the value text back";
  EXPECT_EQ(s.get(kToneFreq), before);
  EXPECT_EQ(s.automated(kToneFreq).size(), 1u);

  type("99999");  // beyond the range: the parameter's reading limits it
  EXPECT_EQ(s.get(kToneFreq), 1.0f);
  EXPECT_EQ(value_box.get_text(), value_text(8000.0));

  // Without a knob in the group there is nothing to change.
  group.set_knob(nullptr);
  type("2500");
  EXPECT_EQ(s.get(kToneFreq), 1.0f);
}
