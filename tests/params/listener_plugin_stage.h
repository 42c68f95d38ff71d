#pragma once

// A real plug-in instance behind the mock host, its host-GUI adapter, and an
// off-screen window to put bound controls in.
#include <gtest/gtest.h>

#include <chrono>
#include <cmath>
#include <thread>
#include <vector>

#include "dsp/brakmorph_dsp.h"
#include "guikit/controls_test_support.h"
#include "guikit/knob.h"
#include "guikit/pot_behaviour.h"
#include "host/dsp_interface.h"
#include "host/host_gui_vst2_win.h"
#include "host/instance_factory.h"
#include "host/vst2_plugin.h"
#include "params/normalized_param_interface.h"
#include "support/mock_host.h"

namespace listener_test {

struct PluginStage {
  PluginStage() : stage(guikit::Size{640, 300}) {
    guikit::PotBehaviour::set_mouse_compatibility(0);
    effect = plugcore::create_instance(&MockHost::callback);
    if (effect == nullptr) return;
    open_and_resume(effect, 44100.0f, 512);
    adapter.set_plugin(&plugin());
  }
  ~PluginStage() {
    if (effect != nullptr) close_instance(effect);
  }
  plugcore::Vst2Plugin& plugin() {
    return *dynamic_cast<plugcore::Vst2Plugin*>(static_cast<AudioEffect*>(effect->object));
  }
  BrakmorphDsp& engine() { return *dynamic_cast<BrakmorphDsp*>(plugin().use_dsp()); }
  plugcore::NormalizedParamInterface& param(int index) { return plugin().use_dsp()->use_param(index); }
  float get(int index) { return effect->getParameter(effect, index); }
  void host_set(int index, float norm) { effect->setParameter(effect, index, norm); }
  // The automation the host recorded for one parameter, in order.
  std::vector<float> automated(int index) const {
    std::vector<float> values;
    for (const auto& a : host.automations) {
      if (a.index == index) values.push_back(a.value);
    }
    return values;
  }
  // A knob in the band set-up of the editor (drag range 200 pixels here).
  static void add_knob(guikit_test::Stage& s, guikit::Knob& knob, guikit::Point at) {
    s.add(knob, at, guikit::Rect{-19, -19, 20, 23});
  }
  // Mono blocks through the instance; answers the left output.
  std::vector<float> run(const std::vector<float>& input) {
    std::vector<float> in_l(input), in_r(input), out_l(input.size()), out_r(input.size());
    float* ins[2] = {in_l.data(), in_r.data()};
    float* outs[2] = {out_l.data(), out_r.data()};
    for (size_t pos = 0; pos < input.size(); pos += 512) {
      const int32_t n = static_cast<int32_t>(std::min<size_t>(512, input.size() - pos));
      float* bi[2] = {ins[0] + pos, ins[1] + pos};
      float* bo[2] = {outs[0] + pos, outs[1] + pos};
      effect->processReplacing(effect, bi, bo, n);
    }
    return out_l;
  }
  static std::vector<float> sine(size_t n, double freq, double amplitude) {
    std::vector<float> x(n);
    const double w = 2.0 * std::acos(-1.0) * freq / 44100.0;
    for (size_t i = 0; i < n; ++i) x[i] = static_cast<float>(amplitude * std::sin(w * static_cast<double>(i)));
    return x;
  }

  MockHost host;
  AEffect* effect = nullptr;
  plugcore::HostGuiVst2Win adapter;
  guikit_test::Stage stage;
};

inline void sleep_ms(int ms) { std::this_thread::sleep_for(std::chrono::milliseconds(ms)); }

}  // namespace listener_test
