#pragma once

// The setup menu on the real plug-in: an instance from the in-process host,
// its host-GUI adapter, an editor object that only hands those out, and the
// setup button in an off-screen window whose menu the test chooses from.
#include <gtest/gtest.h>

#include <deque>
#include <string>
#include <vector>

#include "config/setup_mgr.h"
#include "config/system_ui.h"
#include "config/web_site_jump.h"
#include "guikit/controls_test_support.h"
#include "guikit/menu_nodes.h"
#include "guikit/push_button.h"
#include "host/gui_interface.h"
#include "host/host_gui_vst2_win.h"
#include "host/instance_factory.h"
#include "host/vst2_plugin.h"
#include "midi/midi_dev_sel_dispatcher.h"
#include "support/mock_host.h"

namespace setup_test {

// Desktop services with scripted answers; records what was asked of them.
class ScriptedUi : public sys::SystemUiInterface {
 public:
  struct Box {
    std::string title;
    std::string text;
    int32_t buttons;
    int32_t default_button;
  };

  sys::FileDialogResult run_file_dialog(const sys::FileDialogRequest& request) override {
    dialogs.push_back(request);
    if (dialog_answers.empty()) return sys::FileDialogResult{1, "", 0};
    sys::FileDialogResult answer = dialog_answers.front();
    dialog_answers.pop_front();
    return answer;
  }
  int32_t show_message_box(const std::string& title, const std::string& text, int32_t buttons,
                           int32_t default_button) override {
    boxes.push_back(Box{title, text, buttons, default_button});
    if (box_answers.empty()) return 0;
    const int32_t answer = box_answers.front();
    box_answers.pop_front();
    return answer;
  }
  int32_t open_url(const std::string& address) override {
    urls.push_back(address);
    return url_answer;
  }

  void choose_file(const std::string& path) { dialog_answers.push_back(sys::FileDialogResult{0, path, 0}); }
  void cancel_dialog() { dialog_answers.push_back(sys::FileDialogResult{1, "", 0}); }
  void fail_dialog() { dialog_answers.push_back(sys::FileDialogResult{-1024, "", 0}); }

  std::deque<sys::FileDialogResult> dialog_answers;
  std::deque<int32_t> box_answers;
  int32_t url_answer = 0;
  std::vector<sys::FileDialogRequest> dialogs;
  std::vector<Box> boxes;
  std::vector<std::string> urls;
};

// The editor object as far as the setup menu uses it.
class FakeEditor : public plugcore::GuiInterface {
 public:
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
  plugcore::HostGuiInterface* host_gui_ = nullptr;
  plugcore::DspInterface* dsp_ = nullptr;
};

// One plug-in instance with the setup button placed at (181, 40).
class SetupStage : public ::testing::Test {
 protected:
  static constexpr int32_t kButtonX = 181;
  static constexpr int32_t kButtonY = 40;

  void SetUp() override {
    sys::set_system_ui(&ui_);
    effect_ = plugcore::create_instance(&MockHost::callback);
    ASSERT_NE(effect_, nullptr);
    open_and_resume(effect_, 48000.0f, 256);
    plugin_ = dynamic_cast<plugcore::Vst2Plugin*>(static_cast<AudioEffect*>(effect_->object));
    ASSERT_NE(plugin_, nullptr);
    host_gui_.set_plugin(plugin_);
    editor_.set_host_gui(&host_gui_);
    editor_.set_dsp(plugin_->use_dsp());
    stage_.add(button_, guikit::Point{kButtonX, kButtonY}, guikit::Rect{0, 0, 57, 14});
  }
  void TearDown() override {
    if (effect_ != nullptr) close_instance(effect_);
    sys::set_system_ui(nullptr);
  }

  // The whole menu set up as the editor's web panel does it.
  void init_setup(plugcore::SetupMgr& setup, bool with_midi = true) {
    ASSERT_EQ(setup.init(editor_, with_midi ? plugin_->use_midi_mgr() : nullptr, button_, &web_, 1), 0);
    setup.set_port_selection(plugin_->use_midi_dispatcher());
  }

  // Presses the setup button with the menu set to pick id (0: escape).
  void press_choosing(int32_t id) {
    stage_.window.menu().choose_next(id);
    stage_.window.click_at(kButtonX + 5, kButtonY + 5);
    stage_.window.button_up();
  }
  const std::vector<guikit::MenuEntry>& shown() { return stage_.window.menu().get_last_entries(); }
  int shows() { return stage_.window.menu().get_show_count(); }

  // The id of the shown line with this text (0 when there is none).
  int32_t shown_id(const std::string& text, int depth_at_least = 0) {
    for (const guikit::MenuEntry& entry : shown()) {
      if (entry.kind == guikit::MenuEntry::kItem && entry.text == text && entry.depth >= depth_at_least) {
        return entry.id;
      }
    }
    return 0;
  }
  const guikit::MenuEntry* shown_entry(int32_t id) {
    for (const guikit::MenuEntry& entry : shown()) {
      if (entry.kind == guikit::MenuEntry::kItem && entry.id == id) return &entry;
    }
    return nullptr;
  }
  // Opens the menu without choosing, then chooses the line with this text.
  void choose(const std::string& text) {
    press_choosing(0);
    const int32_t id = shown_id(text);
    ASSERT_NE(id, 0) << text;
    press_choosing(id);
  }

  ScriptedUi ui_;
  MockHost host_;
  AEffect* effect_ = nullptr;
  plugcore::Vst2Plugin* plugin_ = nullptr;
  plugcore::HostGuiVst2Win host_gui_;
  FakeEditor editor_;
  WebSiteJump web_;
  guikit_test::Stage stage_;
  guikit::PushButton button_;
};

}  // namespace setup_test
