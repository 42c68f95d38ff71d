#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "dsp/envelope_follower.h"
#include "dsp/meter_ballistics.h"
#include "dsp/response_helpers.h"
#include "dsp/ring_cursor.h"
#include "dsp/rms_detector.h"

using namespace dsp_test;

TEST(RmsDetector, ConvergesToLevelOfConstantAndSine) {
  for (float c : {0.5f, -0.3f, 2.0f}) {
    RmsDetector d;
    std::vector<float> x(44100, c);
    EXPECT_NEAR(d.process(x.data(), int(x.size())), std::fabs(c), 1e-4 * std::fabs(c));
  }
  RmsDetector d;
  d.set_sample_rate(48000.0f);
  d.set_time(0.05f);
  std::vector<float> x = sine(1000.0, 48000.0, 48000);
  for (float& v : x) v *= 0.8f;
  EXPECT_NEAR(d.process(x.data(), int(x.size())), 0.8 / std::sqrt(2.0), 0.005);
}

TEST(RmsDetector, IsTheBilinearOnePoleAtOneOverT) {
  RmsDetector d;
  d.set_sample_rate(44100.0f);
  d.set_time(0.01f);  // 100 Hz
  const double b = d.get_b(), a = d.get_a();
  // H(z) = b (1 + z^-1) / (1 + a z^-1)
  auto mag = [&](double f) {
    const std::complex<double> z1 = std::polar(1.0, -2.0 * kPi * f / 44100.0);
    return std::abs(b * (1.0 + z1) / (1.0 + a * z1));
  };
  EXPECT_NEAR(mag(0.0), 1.0, 1e-6);
  EXPECT_NEAR(mag(100.0), 1.0 / std::sqrt(2.0), 1e-5);
  EXPECT_NEAR(mag(22049.0), 0.0, 1e-3);
}

TEST(RmsDetector, StepMeanSquareIsOneSampleOfProcess) {
  RmsDetector block, single;
  const std::vector<float> x = noise(300, 9);
  const float level = block.process(x.data(), 300);
  float ms = 0.0f;
  for (float v : x) ms = single.step_mean_square(v);
  EXPECT_EQ(level, std::sqrt(std::fabs(ms)));
  block.reset();
  EXPECT_EQ(block.process(x.data(), 0), 0.0f);
}

TEST(MeterBallistics, ReleaseFallsToOneOverEAfterReleaseTime) {
  MeterBallistics m;
  m.set_sample_rate(44100.0f);
  m.set_release(0.25f);
  EXPECT_EQ(m.update(1.0f, 256), 1.0f);  // attack 0 jumps
  EXPECT_NEAR(m.update(0.0f, 11025), std::exp(-1.0), 1e-6);
}

TEST(MeterBallistics, AttackAndHoldCountSamples) {
  MeterBallistics m;
  m.set_sample_rate(44100.0f);
  m.set_attack(0.1f);
  m.set_hold(0.01f);  // 441 samples
  m.set_release(0.2f);
  EXPECT_NEAR(m.update(1.0f, 4410), 1.0 - std::exp(-1.0), 1e-6);
  const float peak = m.get_value();
  EXPECT_EQ(m.update(0.0f, 300), peak);  // 141 hold samples left
  // 141 samples still held, the remaining 159 release.
  EXPECT_NEAR(m.update(0.0f, 300), peak * std::exp(-159.0 / (0.2 * 44100.0)), 1e-6);
  m.reset();
  EXPECT_EQ(m.get_value(), 0.0f);
  EXPECT_EQ(m.update(-1.0f, 441), 0.0f);  // hold restarts after reset
}

TEST(EnvelopeFollower, AttackBelowOneSampleJumps) {
  EnvelopeFollower e;
  e.set_attack(1e-5f);
  EXPECT_EQ(e.get_attack_coef(), 1.0f);
  EXPECT_EQ(e.step(0.7f), 0.7f);
  EXPECT_EQ(e.step(0.9f), 0.9f);
}

TEST(EnvelopeFollower, HoldThenReleaseLikeDoubleReference) {
  EnvelopeFollower e;  // 5 ms attack, 20 ms hold, 250 ms release at 44100 Hz
  EXPECT_EQ(e.get_hold_length(), 882);
  const double att = 1.0 - std::exp(-1.0 / (0.005 * 44100.0));
  const double rel = 1.0 - std::exp(-1.0 / (0.25 * 44100.0));
  double env = 0.0;
  int hold = 882;
  for (int i = 0; i < 3000; ++i) {
    const float p = i < 1000 ? 1.0f : 0.1f;
    const double d = p - env;
    if (d > 0) {
      env += d * att;
      hold = 882;
    } else if (hold > 0) {
      --hold;
    } else {
      env += d * rel;
    }
    ASSERT_NEAR(e.step(p), env, 1e-5) << i;
  }
  EXPECT_LT(e.get_envelope(), 0.99f);
  e.scale_envelope(0.5f);
  EXPECT_NEAR(e.get_envelope(), 0.5 * env, 1e-5);
  e.reset();
  EXPECT_EQ(e.get_envelope(), 0.0f);
}

TEST(EnvelopeFollower, SampleRateChangeRecomputesEverything) {
  EnvelopeFollower e;
  e.set_sample_rate(96000.0f);
  EXPECT_EQ(e.get_hold_length(), 1920);
  EXPECT_NEAR(e.get_release_coef(), 1.0 - std::exp(-1.0 / (0.25 * 96000.0)), 1e-9);
  e.set_hold(0.0f);
  EXPECT_EQ(e.get_hold_length(), 0);
}

namespace {
std::vector<std::pair<int, int>> runs(int length, int position, int count) {
  std::vector<std::pair<int, int>> r;
  RingCursor c;
  for (c.start(length, position, count); !c.done(); c.next()) {
    r.emplace_back(c.position(), c.run_length());
    if (r.size() > 100) break;
  }
  return r;
}
}  // namespace

TEST(RingCursor, RunsNeverCrossTheEnd) {
  using R = std::vector<std::pair<int, int>>;
  EXPECT_EQ(runs(8, 6, 5), (R{{6, 2}, {0, 3}}));
  EXPECT_EQ(runs(8, 0, 3), (R{{0, 3}}));
  EXPECT_EQ(runs(8, 4, 4), (R{{4, 4}}));
  EXPECT_EQ(runs(8, 6, 20), (R{{6, 2}, {0, 8}, {0, 8}, {0, 2}}));
  EXPECT_TRUE(runs(8, 3, 0).empty());

  // Copying through the runs visits exactly the wrapped positions.
  const int length = 16;
  std::vector<int> visited;
  RingCursor c;
  for (c.start(length, 13, 37); !c.done(); c.next())
    for (int k = 0; k < c.run_length(); ++k) visited.push_back(c.position() + k);
  ASSERT_EQ(visited.size(), 37u);
  for (int i = 0; i < 37; ++i) EXPECT_EQ(visited[i], (13 + i) % length);
}
