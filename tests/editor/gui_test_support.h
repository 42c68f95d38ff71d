// A whole plug-in instance made the way a host makes it, whose editor bridge
// gets an off-screen window of the editor's size.
#pragma once

#include <gtest/gtest.h>

#include <memory>

#include "dsp/brakmorph_dsp.h"
#include "editor/brakmorph_gui.h"
#include "guikit/control_interface.h"
#include "guikit/headless/offscreen_window.h"
#include "guikit/platform_window.h"
#include "host/audio_effect.h"
#include "host/instance_factory.h"
#include "host/vst2_plugin.h"
#include "support/mock_host.h"

namespace gui_test {

// The window the last instance got from the factory.
inline guikit::OffscreenWindow*& last_window() {
  static guikit::OffscreenWindow* window = nullptr;
  return window;
}

inline std::unique_ptr<guikit::WindowInterface> offscreen_editor_window(guikit::Size) {
  auto window = std::make_unique<guikit::OffscreenWindow>(guikit::Size{BrakmorphGui::kWidth, BrakmorphGui::kHeight});
  last_window() = window.get();
  return window;
}

class EditorInstance : public ::testing::Test {
 protected:
  void SetUp() override {
    guikit::set_window_factory(&offscreen_editor_window);
    last_window() = nullptr;
    effect = plugcore::create_instance(&MockHost::callback);
    ASSERT_NE(effect, nullptr);
    open_and_resume(effect, 44100.0f, 256);
    window = last_window();
    ASSERT_NE(window, nullptr);
    plugin = dynamic_cast<plugcore::Vst2Plugin*>(static_cast<AudioEffect*>(effect->object));
    ASSERT_NE(plugin, nullptr);
    engine = dynamic_cast<BrakmorphDsp*>(plugin->use_dsp());
    ASSERT_NE(engine, nullptr);
    gui = dynamic_cast<BrakmorphGui*>(engine->get_gui());
    ASSERT_NE(gui, nullptr);
  }
  void TearDown() override {
    if (effect != nullptr) close_instance(effect);
    guikit::set_window_factory(nullptr);
    last_window() = nullptr;
  }

  intptr_t call(int32_t opcode, int32_t index = 0, intptr_t value = 0, void* ptr = nullptr, float opt = 0.0f) {
    return effect->dispatcher(effect, opcode, index, value, ptr, opt);
  }
  bool open_editor() {
    int parent = 0;
    return call(effEditOpen, 0, 0, &parent) == 1;
  }
  float norm(int index) const { return engine->use_param(index).get_norm(); }
  double control_value(int index) const { return gui->get_bound_control(index)->get_value(); }
  int automations_of(int index) const {
    int n = 0;
    for (const MockHost::Automation& a : host.automations) n += a.index == index ? 1 : 0;
    return n;
  }

  MockHost host;
  AEffect* effect = nullptr;
  guikit::OffscreenWindow* window = nullptr;
  plugcore::Vst2Plugin* plugin = nullptr;
  BrakmorphDsp* engine = nullptr;
  BrakmorphGui* gui = nullptr;
};

}  // namespace gui_test
