#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "dsp/brakmorph_dsp.h"
#include "guikit/headless/offscreen_window.h"
#include "guikit/platform_window.h"
#include "host/gui_interface.h"
#include "host/host_dsp_vst2_win.h"
#include "host/host_gui_interface.h"
#include "host/vst2_win_editor.h"
#include "host/vst2_win_plugin.h"
#include "presets/bank_manager.h"
#include "support/mock_host.h"

namespace {

// What the bridge asked of the editor object, kept beyond the object's life.
struct GuiLog {
  std::vector<std::string> calls;
  std::vector<float> tempos;
  void* parent = nullptr;
  guikit::WindowInterface* window = nullptr;
  bool window_cleared_before_delete = false;
};

class FakeHostGui : public plugcore::HostGuiInterface {
 public:
  double can_resize = 0.0;
  void init() override {}
  double get_property_num(const char* key) override {
    return std::string(key) == "can_resize_window" ? can_resize : 0.0;
  }
  std::string get_property_str(const char*) override { return {}; }
  bool can_set_param(int, int) override { return true; }
  bool lock_param(int, int) override { return true; }
  void release_param(int, int) override {}
  bool set_param_automated(int, float, int) override { return true; }
  void apply_program(const plugcore::ProgramSlot&, int) override {}
  int resize_window(int, int) override { return 0; }
  std::string get_setting_path() override { return {}; }
  plugcore::MidiMgr* use_midi_mgr() override { return nullptr; }
  plugcore::MidiDevSelectorInterface* use_midi_dev_selector() override { return nullptr; }
};

class FakeGui : public plugcore::GuiInterface {
 public:
  explicit FakeGui(GuiLog& log) : log_(log) {}
  ~FakeGui() override { log_.window_cleared_before_delete = log_.window == nullptr; }
  void init() override {}
  void set_default_state() override {}
  void close() override {}
  plugcore::HostGuiInterface* get_host_gui() override { return &host_gui; }
  void set_host_gui(plugcore::HostGuiInterface*) override {}
  plugcore::DspInterface* get_dsp() override { return nullptr; }
  void set_dsp(plugcore::DspInterface*) override {}
  void notify_param_change(int, float, int) override {}
  void set_window(guikit::WindowInterface* window) override { log_.window = window; }
  void get_size(int& width, int& height) override {
    width = 609;
    height = 282;
  }
  void get_resizable_size(int& width, int& height) override {
    width = 800;
    height = 400;
  }
  int open_window(void* parent) override {
    log_.calls.push_back("open");
    log_.parent = parent;
    return open_answer;
  }
  void close_window() override { log_.calls.push_back("close"); }
  void set_tempo(float bpm) override { log_.tempos.push_back(bpm); }
  void set_control_marker(int, int) override {}

  FakeHostGui host_gui;
  int open_answer = 0;

 private:
  GuiLog& log_;
};

std::unique_ptr<guikit::WindowInterface> offscreen_factory(guikit::Size size) {
  return std::make_unique<guikit::OffscreenWindow>(size);
}

class EditorBridge : public ::testing::Test {
 protected:
  void SetUp() override {
    guikit::set_window_factory(&offscreen_factory);
    bank_.resize(2);
    for (int p = 0; p < 2; ++p) bank_.use_program(p).set_nbr_values(BrakmorphDsp::kNbrParams);
  }
  void TearDown() override {
    delete plugin_;
    guikit::set_window_factory(nullptr);
  }
  void make(bool with_gui) {
    gui_ = with_gui ? new FakeGui(log_) : nullptr;
    auto* dsp = new BrakmorphDsp;
    plugin_ = new plugcore::Vst2WinPlugin(&MockHost::callback, dsp, gui_, nullptr, bank_, 0x56626D78);
    auto* host_dsp = new plugcore::HostDspVst2Win;  // the engine owns its adapter
    host_dsp->set_plugin(plugin_);
    dsp->set_host_dsp(host_dsp);
    effect_ = plugin_->getAeffect();
  }
  intptr_t call(int32_t opcode, int32_t index = 0, intptr_t value = 0, void* ptr = nullptr) {
    return effect_->dispatcher(effect_, opcode, index, value, ptr, 0.0f);
  }

  MockHost host_;
  plugcore::BankManager bank_;
  GuiLog log_;
  FakeGui* gui_ = nullptr;
  plugcore::Vst2WinPlugin* plugin_ = nullptr;
  AEffect* effect_ = nullptr;
};

TEST_F(EditorBridge, RectFollowsTheResizeAnswerAndStartsAtTheOrigin) {
  make(true);
  ASSERT_TRUE(effect_->flags & effFlagsHasEditor);
  ERect* rect = nullptr;
  ASSERT_EQ(call(effEditGetRect, 0, 0, &rect), 1);  // before any open
  ASSERT_NE(rect, nullptr);
  EXPECT_EQ(rect->top, 0);
  EXPECT_EQ(rect->left, 0);
  EXPECT_EQ(rect->right, 609);
  EXPECT_EQ(rect->bottom, 282);
  gui_->host_gui.can_resize = -1.0;  // any nonzero answer means resizable
  rect = nullptr;
  ASSERT_EQ(call(effEditGetRect, 0, 0, &rect), 1);
  EXPECT_EQ(rect->right, 800);
  EXPECT_EQ(rect->bottom, 400);
  EXPECT_EQ(call(effEditGetRect, 0, 0, nullptr), 0);
}

TEST_F(EditorBridge, OpenAnswersTheEditorsResultAndCloseReachesIt) {
  make(true);
  int parent_token = 0;
  EXPECT_EQ(call(effEditOpen, 0, 0, &parent_token), 1);
  EXPECT_EQ(log_.parent, &parent_token);
  call(effEditIdle);
  call(effEditClose);
  gui_->open_answer = -1;
  EXPECT_EQ(call(effEditOpen, 0, 0, &parent_token), 0);
  call(effEditClose);  // a failed open leaves nothing to close
  EXPECT_EQ(log_.calls, (std::vector<std::string>{"open", "close", "open"}));
}

TEST_F(EditorBridge, KeysStayWithTheHostAndKnobModeIsIgnored) {
  make(true);
  EXPECT_EQ(call(effEditKeyDown, 'a', 0), -1);
  EXPECT_EQ(call(effEditKeyUp, 'a', 0), -1);
  EXPECT_EQ(call(effSetEditKnobMode, 0, 2), 0);
}

TEST_F(EditorBridge, WithoutAnEditorObjectTheEditorOpcodesAnswerNothing) {
  make(false);
  EXPECT_FALSE(effect_->flags & effFlagsHasEditor);
  ERect* rect = nullptr;
  EXPECT_EQ(call(effEditGetRect, 0, 0, &rect), 0);
  EXPECT_EQ(call(effEditOpen, 0, 0, nullptr), 0);
  EXPECT_EQ(call(effEditKeyDown, 'a', 0), 0);
  call(effEditIdle);
  call(effEditClose);
}

TEST_F(EditorBridge, OnlyTheLastPositiveTempoReachesTheEditorAtIdle) {
  make(true);
  plugcore::Vst2WinEditor* bridge = plugin_->use_editor_bridge();
  ASSERT_NE(bridge, nullptr);
  bridge->set_tempo(100.0);
  bridge->set_tempo(131.5);
  EXPECT_TRUE(log_.tempos.empty());  // nothing before the user-interface thread's idle
  call(effEditIdle);
  call(effEditIdle);
  ASSERT_EQ(log_.tempos, std::vector<float>{131.5f});
  bridge->set_tempo(0.0);
  call(effEditIdle);
  bridge->set_tempo(-20.0);
  call(effEditIdle);
  EXPECT_EQ(log_.tempos.size(), 1u);
}

TEST_F(EditorBridge, TheHostsTempoGoesThroughTheBridge) {
  make(true);
  host_.tempo = 97.0;
  call(effMainsChanged, 0, 1);
  std::vector<float> in(64, 0.0f), out(64, 0.0f);
  float* inputs[2] = {in.data(), in.data()};
  float* outputs[2] = {out.data(), out.data()};
  effect_->processReplacing(effect_, inputs, outputs, 64);
  call(effEditIdle);
  ASSERT_FALSE(log_.tempos.empty());
  EXPECT_FLOAT_EQ(log_.tempos.back(), 97.0f);
}

TEST_F(EditorBridge, DeletingWithTheEditorOpenClosesItBeforeTheEditorObjectGoes) {
  make(true);
  ASSERT_EQ(call(effEditOpen, 0, 0, &log_), 1);
  delete plugin_;
  plugin_ = nullptr;
  EXPECT_EQ(log_.calls, (std::vector<std::string>{"open", "close"}));
  EXPECT_TRUE(log_.window_cleared_before_delete);
}

}  // namespace
