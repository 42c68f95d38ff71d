// The MIDI manager: control map, controller writes, echo, learning, the "midi" section.
#include <gtest/gtest.h>

#include <cmath>
#include <memory>

#include "config/conf_key.h"
#include "config/conf_key_factory.h"
#include "dsp/brakmorph_dsp.h"
#include "midi/midi_auto_bind_mgr.h"
#include "midi/midi_controller_key.h"
#include "midi/midi_dev_sel_dispatcher.h"
#include "midi/midi_mgr.h"
#include "midi/vst2_midi_dev_sel_comp.h"
#include "midi_test_support.h"

using plugcore::make_midi_key;
using plugcore::MidiMgr;

namespace {

// A manager on the real engine's parameters with an output that records.
class Manager : public ::testing::Test {
 protected:
  void SetUp() override {
    dsp_.init();
    mgr_.init(&dsp_, &dsp_, &dispatcher_, &cmd_);
    mgr_.use_settings().set_values(1, 1);
    mgr_.reset_map();
    dispatcher_.add_component(&host_);
    ASSERT_EQ(dispatcher_.list_inputs(), 0);
    ASSERT_EQ(dispatcher_.list_outputs(), 0);
    mgr_.set_output_device(&out_);
  }
  void TearDown() override {
    mgr_.set_output_device(nullptr);
    dispatcher_.close_all();
  }
  std::unique_ptr<basic::ConfKeyMulti> parse(const std::string& text) {
    basic::ConfKeyFactory factory;
    auto key = factory.create_from_string(text);
    EXPECT_EQ(factory.get_status(), 0) << text;
    return std::unique_ptr<basic::ConfKeyMulti>(dynamic_cast<basic::ConfKeyMulti*>(key.release()));
  }

  BrakmorphDsp dsp_;
  RecordingCmd cmd_;
  MidiMgr mgr_;
  plugcore::MidiDevSelDispatcher dispatcher_{&mgr_};
  plugcore::Vst2MidiDevSelComp host_{&mgr_};
  PacketRecorder out_{&mgr_.use_settings()};
};

}  // namespace

TEST_F(Manager, DefaultMapIsNrpnOfEachParameter) {
  for (int i = 0; i < BrakmorphDsp::kNbrParams; ++i) {
    EXPECT_EQ(mgr_.get_key(i), make_midi_key(99, i));
  }
  EXPECT_EQ(mgr_.find_index(make_midi_key(99, 40)), -1);
  EXPECT_EQ(mgr_.use_map().list().size(), 40u);
}

TEST_F(Manager, ControllerStepWritesWithPriority125) {
  mgr_.controller_step(make_midi_key(99, 5), 16383);
  mgr_.bind(9, 7, 0);
  mgr_.controller_step(make_midi_key(7, 0), 64 * 128);
  mgr_.controller_step(make_midi_key(8, 0), 64 * 128);  // unbound: nothing
  ASSERT_EQ(cmd_.writes.size(), 2u);
  EXPECT_EQ(cmd_.writes[0].index, 5);
  EXPECT_FLOAT_EQ(cmd_.writes[0].norm, 1.0f);
  EXPECT_EQ(cmd_.writes[0].priority, 125);
  EXPECT_EQ(cmd_.writes[1].index, 9);
  EXPECT_NEAR(cmd_.writes[1].norm, 64.0 * 128.0 / 16383.0, 1e-7);
  EXPECT_EQ(mgr_.find_index(make_midi_key(99, 9)), -1);  // its NRPN key was removed
}

TEST_F(Manager, BindingMovesKeysBetweenParameters) {
  ASSERT_EQ(mgr_.bind(7, 20, 0), 0);
  ASSERT_EQ(mgr_.bind(3, 20, 0), 0);
  EXPECT_EQ(mgr_.find_index(make_midi_key(20, 0)), 3);
  EXPECT_EQ(mgr_.get_key(7), -1);
  EXPECT_EQ(mgr_.bind(3, 101, 300), 0);
  EXPECT_EQ(mgr_.get_key(3), make_midi_key(101, 300));
  EXPECT_EQ(mgr_.find_index(make_midi_key(20, 0)), -1);
  EXPECT_EQ(mgr_.unbind(3), 0);
  EXPECT_EQ(mgr_.get_key(3), -1);
  // Indices that are neither parameters nor extra controls, and impossible keys.
  EXPECT_EQ(mgr_.bind(40, 99, 40), -1);
  EXPECT_EQ(mgr_.bind(-1, 7, 0), -1);
  EXPECT_EQ(mgr_.bind(1, 128, 0), -1);
  EXPECT_EQ(mgr_.bind(1, 99, 16384), -1);
  mgr_.set_nbr_extra_controls(2);
  EXPECT_EQ(mgr_.bind(41, 99, 41), 0);
  mgr_.controller_step(make_midi_key(99, 41), 100);  // goes to the engine's extra control, not a parameter
  EXPECT_TRUE(cmd_.writes.empty());
}

TEST_F(Manager, FeedbackSendsTheBoundController) {
  // NRPN, standard order; value round(u × 16383).
  EXPECT_EQ(mgr_.send_feedback(0, 5, 0.5f), 0);
  const int v = static_cast<int>(std::floor(0.5 * 16383 + 0.5));
  ASSERT_EQ(out_.packets.size(), 4u);
  EXPECT_EQ(out_.packets[0], cc(0, 99, 0));
  EXPECT_EQ(out_.packets[1], cc(0, 98, 5));
  EXPECT_EQ(out_.packets[2], cc(0, 6, v >> 7));
  EXPECT_EQ(out_.packets[3], cc(0, 38, v & 127));
  // CC 1 is one of a 14-bit pair, CC 40 is not.
  out_.packets.clear();
  mgr_.bind(2, 1, 0);
  mgr_.bind(4, 40, 0);
  EXPECT_EQ(mgr_.send_feedback(0, 2, 1.0f), 0);
  EXPECT_EQ(mgr_.send_feedback(0, 4, 1.0f), 0);
  ASSERT_EQ(out_.packets.size(), 3u);
  EXPECT_EQ(out_.packets[0], cc(0, 1, 127));
  EXPECT_EQ(out_.packets[1], cc(0, 33, 127));
  EXPECT_EQ(out_.packets[2], cc(0, 40, 127));
  // RPN through the old order: CC 100 carries the high bits.
  out_.packets.clear();
  mgr_.use_settings().set_values(0, 1);
  mgr_.bind(6, 101, 300);
  EXPECT_EQ(mgr_.send_feedback(0, 6, 0.0f), 0);
  ASSERT_EQ(out_.packets.size(), 4u);
  EXPECT_EQ(out_.packets[0], cc(0, 100, 300 >> 7));
  EXPECT_EQ(out_.packets[1], cc(0, 101, 300 & 127));
  // No key, a refusing output, no output at all.
  mgr_.unbind(7);
  EXPECT_EQ(mgr_.send_feedback(0, 7, 0.5f), -2);
  out_.accept_limit = 0;
  EXPECT_EQ(mgr_.send_feedback(0, 5, 0.5f), -1);
  mgr_.set_output_device(nullptr);
  EXPECT_EQ(mgr_.send_feedback(0, 5, 0.5f), -1);
}

TEST_F(Manager, SectionRoundTripsTheMap) {
  mgr_.bind(3, 99, 300);
  mgr_.bind(9, 7, 0);
  mgr_.bind(11, 101, 2);
  basic::ConfKeyMulti root("Brakmorph_config_section");
  ASSERT_EQ(mgr_.save(root), 0);
  std::string text;
  ASSERT_EQ(root.write_to_string(text, 0), 0);
  EXPECT_NE(text.find("      // Bind param with cc_, rpn_ or nrpn_ as prefix + CC/(N)RPN #.\n      control_map =\n"),
            std::string::npos)
      << text;
  EXPECT_NE(text.find("         id_9 = cc_7\t// B1 Upper Freq\n"), std::string::npos) << text;
  EXPECT_NE(text.find("         id_3 = nrpn_300\t// Tone Shape\n"), std::string::npos) << text;
  EXPECT_NE(text.find("         id_11 = rpn_2\t// B3 Upper Freq\n"), std::string::npos) << text;
  EXPECT_NE(text.find("      port_in =\n      {\n         name = none\n      }"), std::string::npos) << text;
  // Keys in ascending order: CC 7 (7 << 16) first, NRPN 0.. next, RPN 2 last.
  EXPECT_LT(text.find("id_9 ="), text.find("id_0 ="));
  EXPECT_LT(text.find("id_39 ="), text.find("id_11 ="));

  MidiMgr other;
  BrakmorphDsp other_dsp;
  other_dsp.init();
  other.init(&other_dsp, &other_dsp, nullptr, nullptr);
  other.reset_map();
  auto reread = parse(text);
  ASSERT_NE(reread, nullptr);
  ASSERT_EQ(other.load(*reread), 0);
  EXPECT_EQ(other.use_map().list(), mgr_.use_map().list());
}

TEST_F(Manager, BadEntriesAreSkippedAndOthersApplied) {
  auto root = parse(
      "Brakmorph_config_section =\n{\n   midi =\n   {\n      control_map =\n      {\n"
      "         id_3 = nrpn_300\n"      // applied, NRPN 3 goes
      "         id_x = cc_5\n"          // bad name
      "         id_-1 = cc_5\n"         // negative index
      "         id_4 = cc_999\n"        // no such controller
      "         id_5 = nrpn_16384\n"    // out of range
      "         id_6 = xx_1\n"          // unknown prefix
      "         id_7 = cc_5x\n"         // trailing junk
      "         id_99999999999 = cc_5\n"  // overlong number
      "         id_40 = cc_5\n"         // no such parameter
      "         id_8 = { cc_5 }\n"      // a list
      "         id_12 = cc_21\n"
      "      }\n   }\n}");
  ASSERT_NE(root, nullptr);
  ASSERT_EQ(mgr_.load(*root), 0);
  EXPECT_EQ(mgr_.get_key(3), make_midi_key(99, 300));
  EXPECT_EQ(mgr_.find_index(make_midi_key(99, 3)), -1);
  EXPECT_EQ(mgr_.get_key(12), make_midi_key(21, 0));
  for (int i : {4, 5, 6, 7, 8}) EXPECT_EQ(mgr_.get_key(i), make_midi_key(99, i)) << i;
  EXPECT_EQ(mgr_.find_index(make_midi_key(5, 0)), -1);
  // A root without the section changes nothing.
  const auto before = mgr_.use_map().list();
  EXPECT_EQ(mgr_.load(basic::ConfKeyMulti("Brakmorph_config_section")), 0);
  EXPECT_EQ(mgr_.use_map().list(), before);
}

TEST_F(Manager, AFailedLoadKeepsThePreviousMapAndPorts) {
  const auto before = mgr_.use_map().list();
  ASSERT_EQ(dispatcher_.select_default(true), 0);
  // A component that cannot open what the file names makes the whole load fail.
  class Failing : public plugcore::MidiDevSelCompInterface {
   public:
    int init() override { return 0; }
    int list_inputs(int, std::vector<std::string>& names) override {
      names.push_back("Broken In");
      return 0;
    }
    int list_outputs(int, std::vector<std::string>& names) override {
      names.push_back("Broken Out");
      return 0;
    }
    int open_input(int, plugcore::MidiInInterface*&) override { return -5; }
    int open_output(int, plugcore::MidiOutInterface*&) override { return -6; }
    int close_input() override { return 0; }
    int close_output() override { return 0; }
  } failing;
  dispatcher_.add_component(&failing);
  dispatcher_.list_inputs();
  dispatcher_.list_outputs();
  auto root = parse(
      "S =\n{\n   midi =\n   {\n      control_map =\n      {\n         id_3 = cc_9\n      }\n"
      "      port_in =\n      {\n         name = \"VST MIDI In interface\"\n      }\n"
      "      port_out =\n      {\n         name = \"broken OUT\"\n      }\n   }\n}");
  ASSERT_NE(root, nullptr);
  EXPECT_EQ(mgr_.load(*root), -6);
  EXPECT_EQ(mgr_.use_map().list(), before);
  EXPECT_EQ(dispatcher_.get_selected_input(), 0);
  EXPECT_EQ(dispatcher_.get_selected_output(), 0);
}

TEST_F(Manager, AutoBindContinuousMode) {
  plugcore::MidiAutoBindMgr autobind;
  std::vector<plugcore::NormalizedParamInterface*> params;
  for (int i = 0; i < 40; ++i) params.push_back(&dsp_.use_param(i));
  autobind.init(40, &mgr_, params);
  autobind.set_autobind(true);
  EXPECT_EQ(autobind.get_menu_text(), "Auto-bind [now select a parameter]");
  mgr_.controller_step(make_midi_key(20, 0), 1000);  // no target yet: nothing learned
  EXPECT_TRUE(cmd_.writes.empty());
  autobind.use_listener(3).clicked();
  EXPECT_EQ(autobind.get_menu_text(), "Auto-bind [target : Tone Shape]");
  EXPECT_EQ(mgr_.get_autobind_target(), 3);
  mgr_.controller_step(make_midi_key(20, 0), 64 * 128);
  mgr_.controller_step(make_midi_key(21, 0), 32 * 128);
  EXPECT_EQ(mgr_.find_index(make_midi_key(21, 0)), 3);
  EXPECT_EQ(mgr_.find_index(make_midi_key(20, 0)), -1);
  ASSERT_EQ(cmd_.writes.size(), 2u);  // the learning movement already moved the parameter
  EXPECT_EQ(cmd_.writes[0].index, 3);
  // NRPN is never learned and still reaches its own parameter.
  mgr_.controller_step(make_midi_key(99, 8), 16383);
  EXPECT_EQ(cmd_.writes.back().index, 8);
  EXPECT_EQ(mgr_.get_key(3), make_midi_key(21, 0));
  EXPECT_TRUE(autobind.is_autobind_on());
  autobind.set_autobind(false);
  EXPECT_EQ(mgr_.get_autobind_target(), -1);
  EXPECT_EQ(mgr_.get_key(3), make_midi_key(21, 0));  // bindings stay
}

TEST_F(Manager, AutoBindOneShotMode) {
  mgr_.use_settings().set_values(1, 0);
  plugcore::MidiAutoBindMgr autobind;
  autobind.init(40, &mgr_, {});
  autobind.set_autobind(true);
  autobind.on_param_touched(7);
  mgr_.controller_step(make_midi_key(20, 0), 5);
  EXPECT_EQ(mgr_.find_index(make_midi_key(20, 0)), 7);
  EXPECT_EQ(mgr_.get_autobind_target(), -1);  // learning stopped at the first binding
  int index = -1;
  int32_t key = -1;
  EXPECT_TRUE(mgr_.get_last_binding(index, key));
  EXPECT_EQ(index, 7);
  EXPECT_EQ(key, make_midi_key(20, 0));
  EXPECT_FALSE(autobind.is_autobind_on());  // shows unchecked at the next refresh
  EXPECT_FALSE(mgr_.get_last_binding(index, key));
  mgr_.controller_step(make_midi_key(21, 0), 5);
  EXPECT_EQ(mgr_.find_index(make_midi_key(21, 0)), -1);
}

TEST(MidiAutoBind, WithoutAManagerOnlyItsOwnFieldsChange) {
  plugcore::MidiAutoBindMgr autobind;
  autobind.init(4, static_cast<plugcore::HostGuiInterface*>(nullptr));
  autobind.set_autobind(true);
  autobind.on_param_touched(2);
  EXPECT_TRUE(autobind.is_autobind_on());
  EXPECT_EQ(autobind.get_selected(), 2);
  EXPECT_EQ(autobind.get_target_param(), nullptr);
  EXPECT_EQ(autobind.get_menu_text(), "Auto-bind [now select a parameter]");
  autobind.set_autobind(false);
  EXPECT_EQ(autobind.get_menu_text(), "Auto-bind");
}
