// MIDI through the plug-in's ABI with the in-process test host.
#include <gtest/gtest.h>

#include <cmath>
#include <cstring>
#include <string>
#include <vector>

#include "config/persistent_key_list.h"
#include "config/temp_dir.h"
#include "dsp/brakmorph_dsp.h"
#include "host/instance_factory.h"
#include "host/vst2_win_plugin.h"
#include "midi/midi_dev_sel_dispatcher.h"
#include "midi/midi_mgr.h"
#include "presets/bank_manager.h"
#include "support/mock_host.h"

namespace {

// A list of MIDI events as a host builds it.
class EventList {
 public:
  void add(int b0, int b1, int b2, int delta = 0) {
    VstMidiEvent event{};
    event.type = kVstMidiType;
    event.byteSize = sizeof(VstMidiEvent);
    event.deltaFrames = delta;
    event.midiData[0] = static_cast<char>(b0);
    event.midiData[1] = static_cast<char>(b1);
    event.midiData[2] = static_cast<char>(b2);
    events_.push_back(event);
  }
  void add_sysex() {
    VstMidiEvent event{};
    event.type = kVstSysExType;
    event.byteSize = sizeof(VstMidiEvent);
    event.midiData[0] = static_cast<char>(0xB0);
    event.midiData[1] = 7;
    event.midiData[2] = 127;
    events_.push_back(event);
  }
  VstEvents* list() {
    storage_.assign(sizeof(VstEvents) + events_.size() * sizeof(VstEvent*), 0);
    auto* list = reinterpret_cast<VstEvents*>(storage_.data());
    list->numEvents = static_cast<int32_t>(events_.size());
    for (size_t i = 0; i < events_.size(); ++i) list->events[i] = reinterpret_cast<VstEvent*>(&events_[i]);
    return list;
  }

 private:
  std::vector<VstMidiEvent> events_;
  std::vector<unsigned char> storage_;
};

class PluginMidi : public ::testing::Test {
 protected:
  void start(int nrpn_compatibility) {
    ASSERT_TRUE(sys::write_persistent_switch("Velmora/Brakmorph", "NRPN Compatibility", nrpn_compatibility));
    effect_ = plugcore::create_instance(&MockHost::callback);
    ASSERT_NE(effect_, nullptr);
    open_and_resume(effect_, 48000.0f, 256);
    plugin_ = dynamic_cast<plugcore::Vst2Plugin*>(static_cast<AudioEffect*>(effect_->object));
    ASSERT_NE(plugin_, nullptr);
  }
  void TearDown() override {
    if (effect_ != nullptr) {
      close_instance(effect_);  // effClose deletes the instance
    }
  }
  void send(EventList& events) { EXPECT_EQ(dispatch(effect_, effProcessEvents, 0, 0, events.list()), 1); }
  void run_block() {
    std::vector<float> in(64, 0.0f), out_l(64), out_r(64);
    float* inputs[2] = {in.data(), in.data()};
    float* outputs[2] = {out_l.data(), out_r.data()};
    effect_->processReplacing(effect_, inputs, outputs, 64);
  }
  float norm(int index) { return effect_->getParameter(effect_, index); }

  MockHost host_;
  AEffect* effect_ = nullptr;
  plugcore::Vst2Plugin* plugin_ = nullptr;
};

}  // namespace

TEST_F(PluginMidi, CanDoAndWantEventsWithMidi) {
  start(0);
  char text[64];
  for (const char* ability : {"sendVstEvents", "sendVstMidiEvent", "receiveVstEvents", "receiveVstMidiEvent"}) {
    std::strcpy(text, ability);
    EXPECT_EQ(dispatch(effect_, effCanDo, 0, 0, text), 1) << ability;
  }
  EXPECT_GE(host_.want_midi_calls.load(), 1);
  ASSERT_NE(plugin_->use_midi_mgr(), nullptr);
  EXPECT_TRUE(plugin_->use_midi_mgr()->is_active());
  // The host devices come first and are selected by default.
  const auto* dispatcher = plugin_->use_midi_dispatcher();
  EXPECT_EQ(dispatcher->get_input_name(0), "VST MIDI In interface");
  EXPECT_EQ(dispatcher->get_output_name(0), "VST MIDI Out interface");
  EXPECT_EQ(dispatcher->get_selected_input(), 0);
  EXPECT_EQ(dispatcher->get_selected_output(), 0);
}

TEST_F(PluginMidi, StandardNrpnFiveSetsParameterFiveToOne) {
  start(1);
  const float before = norm(5);
  EventList events;
  events.add(0xB0, 99, 0);
  events.add(0xB0, 98, 5);
  events.add(0xB0, 6, 127);
  events.add(0xB0, 38, 127);
  send(events);
  EXPECT_NE(before, 1.0f);
  EXPECT_FLOAT_EQ(norm(5), 1.0f);
  EXPECT_TRUE(host_.automations.empty());  // MIDI writes are not reported back
  run_block();
  EXPECT_TRUE(host_.midi_out.empty());  // nor echoed
}

TEST_F(PluginMidi, OldOrderSelectsAnUnboundNumber) {
  start(0);
  std::vector<float> before;
  for (int i = 0; i < 40; ++i) before.push_back(norm(i));
  EventList events;
  events.add(0xB0, 99, 0);
  events.add(0xB0, 98, 5);
  events.add(0xB0, 6, 127);
  events.add(0xB0, 38, 127);
  send(events);
  for (int i = 0; i < 40; ++i) EXPECT_EQ(norm(i), before[static_cast<size_t>(i)]) << i;
  // The same NRPN in the old order: CC 98 high bits, CC 99 low bits.
  EventList old_order;
  old_order.add(0xB0, 98, 0);
  old_order.add(0xB0, 99, 5);
  old_order.add(0xB0, 6, 127);
  old_order.add(0xB0, 38, 127);
  send(old_order);
  EXPECT_FLOAT_EQ(norm(5), 1.0f);
}

TEST_F(PluginMidi, SettingFileBindsCc7) {
  start(0);
  TempDir dir;
  const std::string path = dir.file("map.cfg.txt");
  write_whole_file(path,
                   "Brakmorph_config_section =\n{\n   version = 1.24\n   midi =\n   {\n      control_map =\n"
                   "      {\n         id_7 = cc_7\n      }\n   }\n}\n");
  EXPECT_EQ(dispatch(effect_, effVendorSpecific, plugcore::kSettingsVendorIndex, plugcore::kSettingsLoadValue,
                     const_cast<char*>(path.c_str())),
            1);
  EventList events;
  events.add(0xB3, 7, 64);
  events.add_sysex();  // other event types are skipped
  send(events);
  EXPECT_NEAR(norm(7), 64.0 * 128.0 / 16383.0, 1e-6);
  // A file of another plug-in is refused and leaves the binding.
  write_whole_file(path, "Other_config_section =\n{\n   midi =\n   {\n   }\n}\n");
  EXPECT_EQ(dispatch(effect_, effVendorSpecific, plugcore::kSettingsVendorIndex, plugcore::kSettingsLoadValue,
                     const_cast<char*>(path.c_str())),
            0);
  EXPECT_EQ(plugin_->use_midi_mgr()->get_key(7), 7 << 16);
  EXPECT_EQ(dispatch(effect_, effVendorSpecific, 0, 0, nullptr), 0);
}

TEST_F(PluginMidi, SavedSettingsLoadIntoAnotherInstance) {
  start(0);
  TempDir dir;
  const std::string path = dir.file("saved.cfg.txt");
  plugin_->use_midi_mgr()->bind(12, 101, 7);
  ASSERT_EQ(plugin_->save_setting_file(path), 0);
  const std::string text = read_whole_file(path);
  EXPECT_EQ(text.rfind("Brakmorph_config_section =\n{\n   version = 1.24\n   midi =\n", 0), 0u) << text;
  EXPECT_NE(text.find("id_12 = rpn_7\t// B1 Character"), std::string::npos) << text;
  EXPECT_NE(text.find("name = \"VST MIDI Out interface\""), std::string::npos) << text;

  AEffect* second = plugcore::create_instance(&MockHost::callback);
  ASSERT_NE(second, nullptr);
  auto* other = dynamic_cast<plugcore::Vst2Plugin*>(static_cast<AudioEffect*>(second->object));
  EXPECT_EQ(other->use_midi_mgr()->get_key(12), (99 << 16) + 12);
  EXPECT_EQ(other->load_setting_file(path), 0);
  EXPECT_EQ(other->use_midi_mgr()->use_map().list(), plugin_->use_midi_mgr()->use_map().list());
  close_instance(second);
}

TEST_F(PluginMidi, EditorWriteEchoesInTheNextBlock) {
  start(0);
  ASSERT_TRUE(plugin_->set_param_automated(5, 0.5f, 200));
  EXPECT_TRUE(host_.midi_out.empty());  // not before the block starts
  run_block();
  ASSERT_EQ(host_.process_events_calls.load(), 1);
  const int v = static_cast<int>(std::floor(0.5 * 16383.0 + 0.5));
  const std::vector<std::array<uint8_t, 4>> expected = {
      {0xB0, 98, 0, 0}, {0xB0, 99, 5, 0}, {0xB0, 6, static_cast<uint8_t>(v >> 7), 0},
      {0xB0, 38, static_cast<uint8_t>(v & 127), 0}};
  EXPECT_EQ(host_.midi_out, expected);
  ASSERT_EQ(host_.automations.size(), 1u);
  run_block();
  EXPECT_EQ(host_.process_events_calls.load(), 1);  // nothing new, nothing handed over
  // A CC binding echoes a 14-bit pair for controllers below 32.
  plugin_->use_midi_mgr()->bind(6, 1, 0);
  host_.midi_out.clear();
  plugin_->set_param_automated(6, 1.0f, 200);
  run_block();
  const std::vector<std::array<uint8_t, 4>> pair = {{0xB0, 1, 127, 0}, {0xB0, 33, 127, 0}};
  EXPECT_EQ(host_.midi_out, pair);
}

TEST_F(PluginMidi, HostProgramChangeEchoesEveryParameter) {
  start(1);
  dispatch(effect_, effSetProgram, 0, 2);
  run_block();
  ASSERT_EQ(host_.midi_out.size(), 40u * 4u);
  for (int i = 0; i < 40; ++i) {
    const int v = static_cast<int>(std::floor(static_cast<double>(norm(i)) * 16383.0 + 0.5));
    EXPECT_EQ(host_.midi_out[static_cast<size_t>(4 * i + 1)][2], i);
    EXPECT_EQ(host_.midi_out[static_cast<size_t>(4 * i + 2)][2], v >> 7) << i;
    EXPECT_EQ(host_.midi_out[static_cast<size_t>(4 * i + 3)][2], v & 127) << i;
  }
  EXPECT_TRUE(host_.automations.empty());
}

TEST(PluginWithoutMidi, AnswersNoAndNeverAsksForEvents) {
  MockHost host;
  plugcore::BankManager bank;
  bank.resize(2);
  for (int p = 0; p < 2; ++p) bank.use_program(p).set_nbr_values(BrakmorphDsp::kNbrParams);
  auto* dsp = new BrakmorphDsp;
  auto* plugin = new plugcore::Vst2WinPlugin(&MockHost::callback, dsp, nullptr, nullptr, bank, 0x56626D78);
  plugin->init_instance();
  plugin->set_default_state();
  EXPECT_EQ(plugin->use_midi_mgr(), nullptr);
  char text[64];
  std::strcpy(text, "receiveVstEvents");
  EXPECT_EQ(plugin->canDo(text), -1);
  std::strcpy(text, "receiveVstTimeInfo");
  EXPECT_EQ(plugin->canDo(text), 1);
  plugin->resume();
  EXPECT_EQ(host.want_midi_calls.load(), 0);
  EXPECT_TRUE(plugin->set_param_automated(3, 0.25f, 200));
  EXPECT_EQ(plugin->processEvents(nullptr), 1);
  EXPECT_EQ(plugin->load_setting_file("/nonexistent"), -1);
  delete plugin;
}
