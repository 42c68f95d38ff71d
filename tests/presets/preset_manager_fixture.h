#pragma once

// The preset manager on the real plug-in: an instance made by the entry point
// for a mock host, the real host-GUI adapter, a small editor object, and the
// preset controls in an off-screen window whose clock the test drives.

#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <filesystem>
#include <memory>
#include <random>
#include <string>
#include <vector>

#include "config/system_ui.h"
#include "guikit/ctrl_group_item.h"
#include "guikit/headless/offscreen_window.h"
#include "guikit/knob.h"
#include "guikit/messages.h"
#include "guikit/push_button.h"
#include "guikit/text_box.h"
#include "host/dsp_interface.h"
#include "host/gui_interface.h"
#include "host/host_gui_vst2_win.h"
#include "host/instance_factory.h"
#include "host/vst2_plugin.h"
#include "params/normalized_param_interface.h"
#include "presets/preset_manager.h"
#include "support/mock_host.h"

namespace preset_test {

// A desktop whose dialogs and boxes answer what the test scripted and keep what they were shown.
class ScriptedUi : public sys::SystemUiInterface {
 public:
  struct Box {
    std::string title;
    std::string text;
    int32_t buttons;
    int32_t default_button;
  };
  sys::FileDialogResult next;
  std::vector<sys::FileDialogRequest> dialogs;
  std::vector<Box> boxes;
  int32_t box_answer = 0;

  void choose(const std::string& path) {
    next.status = 0;
    next.path = path;
    next.filter_index = 0;
  }
  void cancel() {
    next.status = 1;
    next.path.clear();
  }
  sys::FileDialogResult run_file_dialog(const sys::FileDialogRequest& request) override {
    dialogs.push_back(request);
    return next;
  }
  int32_t show_message_box(const std::string& title, const std::string& text, int32_t buttons,
                           int32_t default_button) override {
    boxes.push_back(Box{title, text, buttons, default_button});
    return box_answer;
  }
  int32_t open_url(const std::string&) override { return -1; }
};

// Just enough editor object for the preset manager: the adapter and the engine.
class FakeEditor : public plugcore::GuiInterface {
 public:
  FakeEditor(plugcore::HostGuiInterface* host_gui, plugcore::DspInterface* dsp) : host_gui_(host_gui), dsp_(dsp) {}
  void init() override {}
  void set_default_state() override {}
  void close() override {}
  plugcore::HostGuiInterface* get_host_gui() override { return host_gui_; }
  void set_host_gui(plugcore::HostGuiInterface* host_gui) override { host_gui_ = host_gui; }
  plugcore::DspInterface* get_dsp() override { return dsp_; }
  void set_dsp(plugcore::DspInterface* dsp) override { dsp_ = dsp; }
  void notify_param_change(int, float, int) override {}
  void set_window(guikit::WindowInterface*) override {}
  void get_size(int& width, int& height) override { width = height = 0; }
  void get_resizable_size(int& width, int& height) override { width = height = 0; }
  int open_window(void*) override { return 0; }
  void close_window() override {}
  void set_tempo(float) override {}
  void set_control_marker(int, int) override {}

 private:
  plugcore::HostGuiInterface* host_gui_;
  plugcore::DspInterface* dsp_;
};

constexpr int kPrograms = 8;
constexpr int kParams = 40;

// Where the controls sit in the window (editor pixels).
inline guikit::Point button_point(int i) { return guikit::Point{10 + 20 * i + 5, 15}; }
constexpr guikit::Point kSwitchPoint{20, 55};
constexpr guikit::Point kLoadPoint{60, 55};
constexpr guikit::Point kSavePoint{100, 55};
constexpr guikit::Point kDisplayPoint{150, 55};
constexpr guikit::Point kSelectorPoint{200, 55};

class PresetStage {
 public:
  explicit PresetStage(int nbr_programs = kPrograms)
      : window(guikit::Size{300, 100}), buttons(new guikit::PushButton[static_cast<size_t>(nbr_programs)]),
        nbr_programs(nbr_programs) {
    group.set_parent(&window);
    group.set_position(guikit::Point{0, 0});
    window.set_roots(nullptr, &group);
    guikit::ShowObject show(true);
    group.process_message(show);
    for (int i = 0; i < nbr_programs; ++i) place(buttons[i], button_point(i), guikit::Rect{-5, -5, 8, 8});
    place(mode_switch, kSwitchPoint, guikit::Rect{-5, -5, 5, 5});
    place(load_button, kLoadPoint, guikit::Rect{-5, -5, 5, 5});
    place(save_button, kSavePoint, guikit::Rect{-5, -5, 5, 5});
    place(display, kDisplayPoint, guikit::Rect{-24, -5, 0, 10});
    place(knob, guikit::Point{250, 55}, guikit::Rect{-13, -13, 14, 14});
    place(selector_button, kSelectorPoint, guikit::Rect{-5, -5, 5, 5});
    display.set_editable(true);
  }

  void click(guikit::Point p) {
    window.click_at(p.x, p.y);
    window.button_up();
  }
  // Types into the fade-time display and accepts, as the user does.
  void type_fade_time(const std::string& text) {
    click(guikit::Point{kDisplayPoint.x - 10, kDisplayPoint.y + 2});  // the box lies left of its position
    window.line_editor().type(text);
    window.line_editor().stop(true);
  }

  guikit::OffscreenWindow window;
  guikit::CtrlGroupItem group;
  std::unique_ptr<guikit::PushButton[]> buttons;
  int nbr_programs;
  guikit::FlipFlop mode_switch;
  guikit::PushButton load_button;
  guikit::PushButton save_button;
  guikit::Knob knob;
  guikit::TextBox display;
  guikit::PushButton selector_button;

 private:
  void place(guikit::ControlInterface& c, guikit::Point offset, guikit::Rect box) {
    c.set_offset(offset);
    c.set_bounding_box(box);
    c.set_placed(true);
    group.add_control(&c);
  }
};

// The whole set-up; `programs` and `bank` choose the manager's size and default bank.
class PresetRig {
 public:
  explicit PresetRig(int programs = kPrograms, const char* bank = "default_preset_bank")
      : stage(programs), manager(programs) {
    sys::set_system_ui(&ui);
    effect = plugcore::create_instance(&MockHost::callback);
    if (effect == nullptr) throw std::runtime_error("no instance");
    open_and_resume(effect, 44100.0f, 256);
    plugin = dynamic_cast<plugcore::Vst2Plugin*>(static_cast<AudioEffect*>(effect->object));
    host_gui.set_plugin(plugin);
    editor = std::make_unique<FakeEditor>(&host_gui, plugin->use_dsp());
    init_status = manager.init(*editor, nullptr, stage.buttons.get(), stage.mode_switch, stage.load_button,
                               stage.save_button, stage.knob, stage.display, bank);
  }
  ~PresetRig() {
    manager.deinit();
    close_instance(effect);
    sys::set_system_ui(nullptr);
  }

  float param(int i) const { return effect->getParameter(effect, i); }
  std::vector<float> params() const {
    std::vector<float> v;
    for (int i = 0; i < kParams; ++i) v.push_back(param(i));
    return v;
  }
  bool stepped(int i) const { return plugin->use_dsp()->use_param(i).get_type() != 0; }
  double fade_time() { return manager.use_time_fader_listener().get_fade_time(); }
  void set_fade_seconds(double t) { stage.knob.set_value_by_user(std::log10(1.0 + t) / 2.0, 200); }
  plugcore::PresetNumberListener& number(int i) { return *manager.use_number_listener(i); }
  void press(int i) { stage.click(button_point(i)); }
  // Ticks are 100 ms apart; a press just happened at the window's time.
  void tick() { stage.window.advance_ms(100); }
  // Lets every running fade end.
  void settle() {
    for (int i = 0; i < 2000 && any_fade(); ++i) tick();
  }
  bool any_fade() {
    for (int i = 0; i < manager.get_nbr_programs(); ++i) {
      if (number(i).is_fading()) return true;
    }
    return false;
  }

  ScriptedUi ui;
  MockHost host;
  PresetStage stage;
  AEffect* effect = nullptr;
  plugcore::Vst2Plugin* plugin = nullptr;
  plugcore::HostGuiVst2Win host_gui;
  std::unique_ptr<FakeEditor> editor;
  plugcore::PresetManager manager;
  int init_status = 0;
};

// A fresh folder for bank files, removed afterwards.
class BankDir {
 public:
  BankDir() {
    const ::testing::TestInfo* info = ::testing::UnitTest::GetInstance()->current_test_info();
    path_ = std::filesystem::temp_directory_path() /
            ("preset_manager_" + std::to_string(std::random_device{}()) + "_" + info->name());
    std::filesystem::create_directories(path_);
  }
  ~BankDir() {
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
  }
  std::string file(const std::string& name) const { return (path_ / name).string(); }

 private:
  std::filesystem::path path_;
};

}  // namespace preset_test
