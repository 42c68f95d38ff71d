// The MIDI part of the setup menu: the auto-bind entry against the plug-in's
// learning, the port submenus against real device selections, and NRPN.
#include <memory>
#include <string>
#include <vector>

#include "midi/mci_midi_dev_sel_comp.h"
#include "midi/midi_dev_sel_dispatcher.h"
#include "midi/midi_mgr.h"
#include "midi/midi_port_driver_interface.h"
#include "setup_test_support.h"

namespace {

using guikit::MenuEntry;
using setup_test::SetupStage;

// One host MIDI message through processEvents.
void send_midi(AEffect* effect, int b0, int b1, int b2) {
  VstMidiEvent event{};
  event.type = kVstMidiType;
  event.byteSize = sizeof(VstMidiEvent);
  event.midiData[0] = static_cast<char>(b0);
  event.midiData[1] = static_cast<char>(b1);
  event.midiData[2] = static_cast<char>(b2);
  VstEvents list{};
  list.numEvents = 1;
  list.events[0] = reinterpret_cast<VstEvent*>(&event);
  dispatch(effect, effProcessEvents, 0, 0, &list);
}

// A system MIDI driver with named ports; opening input port fail_input fails.
class NamedPortsDriver : public sys::MidiPortDriverInterface {
 public:
  int list_inputs(std::vector<std::string>& names) override {
    names.insert(names.end(), {"Keys A", "Keys B"});
    return 0;
  }
  int list_outputs(std::vector<std::string>& names) override {
    names.push_back("Synth Out");
    return 0;
  }
  int open_input(int port, sys::MidiInputSinkInterface*) override { return port == fail_input ? -1 : 0; }
  int close_input() override { return 0; }
  int open_output(int) override { return 0; }
  int send_short(uint32_t) override { return 0; }
  int close_output() override { return 0; }
  int fail_input = 1;
};

class SetupMidi : public SetupStage {
 protected:
  void SetUp() override {
    SetupStage::SetUp();
    if (HasFatalFailure()) return;
    midi_ = plugin_->use_midi_mgr();
    ASSERT_NE(midi_, nullptr);
    saved_mode_ = midi_->use_settings().get_autobind_mode();
  }
  void TearDown() override {
    if (midi_ != nullptr) midi_->use_settings().set_autobind_mode(saved_mode_);
    SetupStage::TearDown();
  }

  // The items of one submenu as last shown.
  std::vector<MenuEntry> submenu(const std::string& label) {
    std::vector<MenuEntry> items;
    bool inside = false;
    for (const MenuEntry& e : shown()) {
      if (e.kind == MenuEntry::kSubMenuBegin && e.depth == 0) inside = e.text == label;
      if (inside && e.kind == MenuEntry::kItem) items.push_back(e);
      if (e.kind == MenuEntry::kSubMenuEnd && e.depth == 0) inside = false;
    }
    return items;
  }
  int32_t submenu_id(const std::string& label, const std::string& text) {
    for (const MenuEntry& e : submenu(label)) {
      if (e.text == text) return e.id;
    }
    return 0;
  }
  std::vector<std::string> texts(const std::vector<MenuEntry>& items) {
    std::vector<std::string> result;
    for (const MenuEntry& e : items) result.push_back(e.text);
    return result;
  }
  std::vector<std::string> ticked(const std::vector<MenuEntry>& items) {
    std::vector<std::string> result;
    for (const MenuEntry& e : items) {
      if (e.checked) result.push_back(e.text);
    }
    return result;
  }
  // The auto-bind line as last shown.
  const MenuEntry* auto_bind_line() {
    for (const MenuEntry& e : shown()) {
      if (e.kind == MenuEntry::kItem && e.text.rfind("Auto-bind", 0) == 0) return &e;
    }
    return nullptr;
  }
  float norm(int index) { return effect_->getParameter(effect_, index); }

  plugcore::MidiMgr* midi_ = nullptr;
  int saved_mode_ = 1;
};

}  // namespace

TEST_F(SetupMidi, AutoBindTextsTogglingAndLearningInContinuousMode) {
  ASSERT_TRUE(midi_->use_settings().set_autobind_mode(1));
  plugcore::SetupMgr setup(true, true);
  init_setup(setup);
  press_choosing(0);
  ASSERT_NE(auto_bind_line(), nullptr);
  EXPECT_EQ(auto_bind_line()->text, "Auto-bind");
  EXPECT_FALSE(auto_bind_line()->checked);
  const int32_t id = auto_bind_line()->id;

  // On, nothing touched: a prompt, and a controller moved binds nothing.
  press_choosing(id);
  press_choosing(0);
  EXPECT_EQ(auto_bind_line()->text, "Auto-bind [now select a parameter]");
  EXPECT_TRUE(auto_bind_line()->checked);
  send_midi(effect_, 0xB0, 20, 64);
  EXPECT_EQ(midi_->find_index(20 << 16), -1);

  // A click on parameter 12's control makes it the target.
  setup.use_auto_bind_mgr().use_listener(12).clicked();
  press_choosing(0);
  EXPECT_EQ(auto_bind_line()->text, "Auto-bind [target : B1 Character]");
  EXPECT_TRUE(auto_bind_line()->checked);

  // CC 20 is learned and already moves the parameter; CC 21 then takes its place.
  send_midi(effect_, 0xB0, 20, 64);
  EXPECT_EQ(midi_->find_index(20 << 16), 12);
  EXPECT_NEAR(norm(12), 64.0 * 128.0 / 16383.0, 1e-6);
  send_midi(effect_, 0xB0, 21, 32);
  EXPECT_EQ(midi_->find_index(21 << 16), 12);
  EXPECT_EQ(midi_->find_index(20 << 16), -1);
  EXPECT_NEAR(norm(12), 32.0 * 128.0 / 16383.0, 1e-6);
  press_choosing(0);
  EXPECT_TRUE(auto_bind_line()->checked);  // continuous mode stays on

  // Off: the target goes, the learned binding stays.
  press_choosing(id);
  EXPECT_EQ(midi_->get_autobind_target(), -1);
  press_choosing(0);
  EXPECT_FALSE(auto_bind_line()->checked);
  send_midi(effect_, 0xB0, 22, 1);
  EXPECT_EQ(midi_->find_index(22 << 16), -1);
  EXPECT_EQ(midi_->find_index(21 << 16), 12);
}

TEST_F(SetupMidi, AutoBindOneShotModeSwitchesItselfOff) {
  ASSERT_TRUE(midi_->use_settings().set_autobind_mode(0));
  plugcore::SetupMgr setup(true, true);
  init_setup(setup);
  setup.use_auto_bind_mgr().use_listener(3).clicked();
  press_choosing(0);
  const int32_t id = auto_bind_line()->id;
  press_choosing(id);
  press_choosing(0);
  EXPECT_TRUE(auto_bind_line()->checked);
  send_midi(effect_, 0xB0, 20, 100);
  EXPECT_EQ(midi_->find_index(20 << 16), 3);
  // The next opening shows it off; further controllers are not learned.
  press_choosing(0);
  EXPECT_FALSE(auto_bind_line()->checked);
  send_midi(effect_, 0xB0, 21, 100);
  EXPECT_EQ(midi_->find_index(21 << 16), -1);
  EXPECT_EQ(midi_->find_index(20 << 16), 3);
}

TEST_F(SetupMidi, AutoBindWithoutMidiManagerOnlyChangesTheEntry) {
  plugcore::SetupMgr setup(true, true);
  init_setup(setup, false);
  press_choosing(0);
  const int32_t id = auto_bind_line()->id;
  press_choosing(id);
  setup.use_auto_bind_mgr().use_listener(3).clicked();
  press_choosing(0);
  EXPECT_TRUE(auto_bind_line()->checked);
  EXPECT_EQ(midi_->get_autobind_target(), -1);
  send_midi(effect_, 0xB0, 20, 100);
  EXPECT_EQ(midi_->find_index(20 << 16), -1);
}

TEST_F(SetupMidi, HostPortSubmenusTickTheSelectionAndNoneClosesThePort) {
  plugcore::SetupMgr setup(true, true);
  init_setup(setup);
  plugcore::MidiDevSelDispatcher* ports = plugin_->use_midi_dispatcher();
  press_choosing(0);
  std::vector<std::string> inputs = texts(submenu("Input device"));
  ASSERT_GE(inputs.size(), 2u);
  EXPECT_EQ(inputs[0], "None");
  EXPECT_EQ(inputs[1], "VST MIDI In interface");
  ASSERT_EQ(inputs.size(), static_cast<size_t>(ports->get_nbr_inputs()) + 1);
  for (int i = 0; i < ports->get_nbr_inputs(); ++i) EXPECT_EQ(inputs[static_cast<size_t>(i) + 1], ports->get_input_name(i));
  EXPECT_EQ(ticked(submenu("Input device")), std::vector<std::string>{"VST MIDI In interface"});
  EXPECT_EQ(texts(submenu("Output device"))[1], "VST MIDI Out interface");
  EXPECT_EQ(ticked(submenu("Output device")), std::vector<std::string>{"VST MIDI Out interface"});

  // Host MIDI reaches the parameters while the host input is selected.
  ASSERT_EQ(midi_->bind(7, 7, 0), 0);
  send_midi(effect_, 0xB0, 7, 64);
  EXPECT_NEAR(norm(7), 64.0 * 128.0 / 16383.0, 1e-6);

  press_choosing(submenu_id("Input device", "None"));
  EXPECT_EQ(ports->get_selected_input(), -1);
  EXPECT_TRUE(ui_.boxes.empty());
  press_choosing(0);
  EXPECT_EQ(ticked(submenu("Input device")), std::vector<std::string>{"None"});
  send_midi(effect_, 0xB0, 7, 100);
  EXPECT_NEAR(norm(7), 64.0 * 128.0 / 16383.0, 1e-6);  // closed: nothing arrives

  press_choosing(submenu_id("Input device", "VST MIDI In interface"));
  EXPECT_EQ(ports->get_selected_input(), 0);
  send_midi(effect_, 0xB0, 7, 100);
  EXPECT_NEAR(norm(7), 100.0 * 128.0 / 16383.0, 1e-6);

  // Without an output the editor's changes are no longer echoed to the host.
  press_choosing(submenu_id("Output device", "None"));
  EXPECT_EQ(ports->get_selected_output(), -1);
  ASSERT_TRUE(plugin_->set_param_automated(5, 0.25f, 200));
  std::vector<float> in(64, 0.0f), out_l(64), out_r(64);
  float* inputs_ptr[2] = {in.data(), in.data()};
  float* outputs_ptr[2] = {out_l.data(), out_r.data()};
  effect_->processReplacing(effect_, inputs_ptr, outputs_ptr, 64);
  EXPECT_TRUE(host_.midi_out.empty());
  press_choosing(0);
  EXPECT_EQ(ticked(submenu("Output device")), std::vector<std::string>{"None"});
}

TEST_F(SetupMidi, SystemPortsListedAndAFailingOpenShowsTheCode) {
  plugcore::MidiReceiverInterface receiver;  // answers every event with 0
  plugcore::MidiMgr mgr;
  plugcore::MciMidiDevSelComp component(&mgr, std::make_unique<NamedPortsDriver>());
  plugcore::MidiDevSelDispatcher ports(&mgr);
  mgr.init(&receiver, nullptr, &ports, nullptr);
  ports.add_component(&component);
  ASSERT_EQ(ports.list_inputs(), 0);
  ASSERT_EQ(ports.list_outputs(), 0);
  ASSERT_EQ(ports.select_default(true), 0);

  plugcore::SetupMgr setup(true, true);
  init_setup(setup);
  setup.set_port_selection(&ports);
  press_choosing(0);
  EXPECT_EQ(texts(submenu("Input device")), (std::vector<std::string>{"None", "Keys A", "Keys B"}));
  EXPECT_EQ(texts(submenu("Output device")), (std::vector<std::string>{"None", "Synth Out"}));
  EXPECT_EQ(ticked(submenu("Input device")), std::vector<std::string>{"Keys A"});

  press_choosing(submenu_id("Input device", "Keys B"));
  ASSERT_EQ(ui_.boxes.size(), 1u);
  EXPECT_EQ(ui_.boxes[0].title, "Error");
  EXPECT_EQ(ui_.boxes[0].text, "Can't change MIDI device.\n\n\nCode -1");
  EXPECT_EQ(ui_.boxes[0].buttons, 0);
  // The failed port leaves the direction without a device.
  EXPECT_EQ(ports.get_selected_input(), -1);
  press_choosing(0);
  EXPECT_EQ(ticked(submenu("Input device")), std::vector<std::string>{"None"});

  press_choosing(submenu_id("Input device", "Keys A"));
  EXPECT_EQ(ui_.boxes.size(), 1u);
  EXPECT_EQ(ports.get_selected_input(), 0);
  press_choosing(0);
  EXPECT_EQ(ticked(submenu("Input device")), std::vector<std::string>{"Keys A"});
}

TEST_F(SetupMidi, PortSubmenusStayEmptyWhenTheHostOffersNoPorts) {
  plugcore::SetupMgr setup(true, true);
  ASSERT_EQ(setup.init(editor_, midi_, button_, &web_, 0), 0);
  setup.set_port_selection(plugin_->use_midi_dispatcher());
  press_choosing(0);
  EXPECT_TRUE(submenu("Input device").empty());
  EXPECT_TRUE(submenu("Output device").empty());
}
