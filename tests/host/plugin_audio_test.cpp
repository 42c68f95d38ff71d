// Audio through the host boundary: both processing entries, pins, odd block sizes,
// sample-rate changes and many instances at once.
#include <gtest/gtest.h>

#include <cmath>
#include <thread>
#include <vector>

#include "host/instance_factory.h"
#include "support/mock_host.h"

namespace {

std::vector<float> test_signal(int frames, float rate, int channel) {
  std::vector<float> x(static_cast<size_t>(frames));
  for (int i = 0; i < frames; ++i) {
    const double t = i / static_cast<double>(rate);
    x[i] = static_cast<float>(0.5 * std::sin(2 * M_PI * (110.0 + 20 * channel) * t) +
                              0.2 * std::sin(2 * M_PI * 2750.0 * t));
  }
  return x;
}

struct Stereo {
  std::vector<float> left, right;
};

// Renders a signal in blocks of the given size through one entry point.
Stereo render(AEffect* effect, const Stereo& in, int block, bool adding, float preset = 0.0f) {
  Stereo out{std::vector<float>(in.left.size(), preset), std::vector<float>(in.left.size(), preset)};
  for (size_t pos = 0; pos < in.left.size(); pos += static_cast<size_t>(block)) {
    const int n = static_cast<int>(std::min<size_t>(static_cast<size_t>(block), in.left.size() - pos));
    float* inputs[2] = {const_cast<float*>(in.left.data() + pos), const_cast<float*>(in.right.data() + pos)};
    float* outputs[2] = {out.left.data() + pos, out.right.data() + pos};
    if (adding) {
      effect->process(effect, inputs, outputs, n);
    } else {
      effect->processReplacing(effect, inputs, outputs, n);
    }
  }
  return out;
}

AEffect* make(float rate, int program) {
  AEffect* effect = plugcore::create_instance(&MockHost::callback);
  if (effect != nullptr) {
    open_and_resume(effect, rate, 512);
    dispatch(effect, effSetProgram, 0, program);
  }
  return effect;
}

double max_difference(const std::vector<float>& a, const std::vector<float>& b, float offset = 0.0f) {
  double worst = 0.0;
  for (size_t i = 0; i < a.size(); ++i) {
    worst = std::max(worst, std::fabs(static_cast<double>(a[i]) - b[i] - offset));
  }
  return worst;
}

TEST(PluginAudio, AddingAddsWhatReplacingWrites) {
  MockHost host;
  const Stereo in{test_signal(6000, 44100, 0), test_signal(6000, 44100, 1)};
  AEffect* a = make(44100, 1);
  AEffect* b = make(44100, 1);
  ASSERT_TRUE(a && b);
  const Stereo replaced = render(a, in, 512, false, 7.0f);
  const Stereo added = render(b, in, 512, true, 0.25f);
  EXPECT_LT(max_difference(added.left, replaced.left, 0.25f), 1e-6);
  EXPECT_LT(max_difference(added.right, replaced.right, 0.25f), 1e-6);
  double energy = 0;
  for (float v : replaced.left) {
    energy += v * v;
  }
  EXPECT_GT(energy, 1.0);  // the program really produced sound
  close_instance(a);
  close_instance(b);
}

TEST(PluginAudio, OutputDoesNotDependOnTheBlockSize) {
  MockHost host;
  const Stereo in{test_signal(9000, 48000, 0), test_signal(9000, 48000, 1)};
  for (int program : {0, 3, 4, 7}) {
    AEffect* reference = make(48000, program);
    const Stereo expected = render(reference, in, 4096, false);
    close_instance(reference);
    for (int block : {1, 255, 256, 257, 1000}) {
      AEffect* effect = make(48000, program);
      const Stereo got = render(effect, in, block, false);
      // Chunk boundaries move the tiny anti-denormal offsets only.
      EXPECT_LT(max_difference(got.left, expected.left), 1e-5) << "program " << program << " block " << block;
      EXPECT_LT(max_difference(got.right, expected.right), 1e-5) << "program " << program << " block " << block;
      close_instance(effect);
    }
  }
}

TEST(PluginAudio, UnconnectedSecondOutputIsLeftAlone) {
  MockHost host;
  host.second_output_connected = false;
  const Stereo in{test_signal(3000, 44100, 0), test_signal(3000, 44100, 1)};
  for (bool adding : {false, true}) {
    AEffect* effect = make(44100, 0);
    const Stereo out = render(effect, in, 300, adding, 3.0f);
    for (float v : out.right) {
      ASSERT_EQ(v, 3.0f);
    }
    EXPECT_GT(max_difference(out.left, std::vector<float>(out.left.size(), 3.0f)), 0.01);
    close_instance(effect);
  }
}

TEST(PluginAudio, MonoHostFeedsTheLeftInputAlone) {
  const Stereo left_only{test_signal(4000, 44100, 0), std::vector<float>(4000, 0.0f)};
  const Stereo doubled{test_signal(4000, 44100, 0), test_signal(4000, 44100, 0)};
  Stereo mono_out;
  {
    MockHost host;
    host.second_input_connected = false;
    AEffect* effect = make(44100, 0);
    mono_out = render(effect, left_only, 512, false);
    close_instance(effect);
  }
  MockHost host;
  AEffect* effect = make(44100, 0);
  // With both inputs connected, equal inputs average to the same mono signal.
  const Stereo stereo_out = render(effect, doubled, 512, false);
  close_instance(effect);
  EXPECT_LT(max_difference(mono_out.left, stereo_out.left), 1e-7);
}

TEST(PluginAudio, HostEdgeCasesDoNotCrash) {
  MockHost host;
  AEffect* effect = make(44100, 3);
  float buffer[8] = {0};
  float* io[2] = {buffer, buffer + 4};
  effect->processReplacing(effect, io, io, 0);
  effect->processReplacing(effect, io, io, -5);
  effect->processReplacing(effect, nullptr, io, 4);
  effect->processReplacing(effect, io, nullptr, 4);
  dispatch(effect, effSetSampleRate, 0, 0, nullptr, 0.0f);  // ignored
  dispatch(effect, effSetSampleRate, 0, 0, nullptr, std::nanf(""));
  effect->processReplacing(effect, io, io, 4);
  for (float v : buffer) {
    EXPECT_TRUE(std::isfinite(v));
  }
  // Suspend and resume in any order.
  dispatch(effect, effMainsChanged, 0, 0);
  dispatch(effect, effMainsChanged, 0, 0);
  dispatch(effect, effMainsChanged, 0, 1);
  dispatch(effect, effMainsChanged, 0, 1);
  close_instance(effect);
}

TEST(PluginAudio, RateChangesBetweenBlocksStayFinite) {
  MockHost host;
  AEffect* effect = make(44100, 4);
  const Stereo in{test_signal(2048, 44100, 0), test_signal(2048, 44100, 1)};
  for (float rate : {8000.0f, 22050.0f, 96000.0f, 192000.0f, 384000.0f, 44100.0f}) {
    dispatch(effect, effSetSampleRate, 0, 0, nullptr, rate);
    const Stereo out = render(effect, in, 333, false);
    for (size_t i = 0; i < out.left.size(); ++i) {
      ASSERT_TRUE(std::isfinite(out.left[i]) && std::isfinite(out.right[i])) << rate;
      ASSERT_LT(std::fabs(out.left[i]), 100.0f) << rate;
    }
  }
  close_instance(effect);
}

TEST(PluginAudio, ManyInstancesRunConcurrently) {
  MockHost host;
  const Stereo in{test_signal(20000, 48000, 0), test_signal(20000, 48000, 1)};
  AEffect* reference = make(48000, 5);
  const Stereo expected = render(reference, in, 512, false);
  close_instance(reference);

  std::vector<AEffect*> effects;
  for (int i = 0; i < 8; ++i) {
    effects.push_back(make(48000, 5));
    ASSERT_NE(effects.back(), nullptr);
  }
  std::vector<Stereo> results(effects.size());
  std::vector<std::thread> threads;
  for (size_t i = 0; i < effects.size(); ++i) {
    threads.emplace_back([&, i] { results[i] = render(effects[i], in, 256 + static_cast<int>(i), false); });
  }
  for (auto& t : threads) {
    t.join();
  }
  for (size_t i = 0; i < effects.size(); ++i) {
    EXPECT_LT(max_difference(results[i].left, expected.left), 1e-5) << i;
    close_instance(effects[i]);
  }
}

}  // namespace
