#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "dsp/response_helpers.h"
#include "dsp/tone_filter.h"

using namespace dsp_test;

namespace {

double chain_magnitude(const ToneFilter& t, double f, double rate) {
  double g = 1.0;
  for (int j = 0; j < ToneFilter::kSectionCount; ++j) {
    const BiquadSection& s = t.section(j);
    g *= digital_magnitude(s.b0(), s.b1(), s.b2(), s.a1(), s.a2(), f, rate);
  }
  return g;
}

// prod (1 + h B s + h^2 s^2)/(1 + B s + s^2) with B = 2 a cos(k theta), from the shape.
double prototype_magnitude(double shape, double w) {
  double g = 1.0, h = 0.0, width = 1.0;
  if (shape > 0.5) {
    g = std::pow(2.0, 2.0 * shape - 1.0);
  } else {
    h = std::pow(10.0, -shape / 2.0);
    width = 2.0 * shape;
  }
  const double a = std::pow(g, -0.25);
  double m = 1.0;
  for (int k = 1; k <= 7; k += 2) {
    const double b = 2.0 * a * std::cos(k * kPi / 16.0 * width);
    m *= analog_magnitude(1.0, h * b, h * h, 1.0, b, 1.0, w);
  }
  return m;
}

}  // namespace

TEST(ToneFilter, ShelfAtHalfShapeIsFortyDecibels) {
  ToneFilter t;
  t.recompute(2000.0f, 0.5f, 44100.0f);
  ASSERT_TRUE(t.is_active());
  EXPECT_NEAR(db(chain_magnitude(t, 30.0, 44100.0)), 0.0, 0.05);
  EXPECT_NEAR(db(chain_magnitude(t, 15000.0, 44100.0)), -40.0, 0.1);
  for (double f : {100.0, 1000.0, 2000.0, 4000.0, 8000.0, 12000.0, 20000.0})
    EXPECT_NEAR(chain_magnitude(t, f, 44100.0), prototype_magnitude(0.5, warped(f, 2000.0, 44100.0)),
                1e-4 * prototype_magnitude(0.5, warped(f, 2000.0, 44100.0)))
        << f;

  // The running filter agrees with its response.
  std::vector<float> buf = sine(9000.0, 44100.0, 22050);
  t.process(buf.data(), int(buf.size()));
  EXPECT_NEAR(amplitude_at(buf, 9000.0, 44100.0, 4410) / chain_magnitude(t, 9000.0, 44100.0), 1.0, 0.01);
}

TEST(ToneFilter, JustAboveHalfIsEighthOrderLowPass) {
  ToneFilter t;
  t.recompute(2000.0f, 0.51f, 44100.0f);
  ASSERT_TRUE(t.is_active());
  EXPECT_NEAR(chain_magnitude(t, 0.0, 44100.0), 1.0, 1e-5);
  for (double f : {500.0, 1500.0, 2000.0, 3000.0, 4000.0, 8000.0}) {
    const double w = warped(f, 2000.0, 44100.0);
    const double expected = prototype_magnitude(0.51, w);
    EXPECT_NEAR(chain_magnitude(t, f, 44100.0), expected, 1e-4 * expected + 1e-9) << f;
    // Close to Butterworth: 1/sqrt(1 + w^16).
    EXPECT_NEAR(db(expected), db(1.0 / std::sqrt(1.0 + std::pow(w, 16))), 0.2) << f;
  }
  // 48 dB per octave.
  const double w1 = warped(4000.0, 2000.0, 44100.0), w2 = warped(8000.0, 2000.0, 44100.0);
  EXPECT_NEAR(db(prototype_magnitude(0.51, w2)) - db(prototype_magnitude(0.51, w1)), -160.0 * std::log10(w2 / w1),
              0.5);
}

TEST(ToneFilter, FullShapeResonates) {
  ToneFilter t;
  t.recompute(1000.0f, 1.0f, 48000.0f);
  double peak = 0.0, peak_f = 0.0;
  for (double f = 500.0; f < 1500.0; f += 5.0) {
    const double g = chain_magnitude(t, f, 48000.0);
    EXPECT_NEAR(g, prototype_magnitude(1.0, warped(f, 1000.0, 48000.0)), 1e-4 * g) << f;
    if (g > peak) peak = g, peak_f = f;
  }
  EXPECT_GT(db(peak), 3.0);
  EXPECT_NEAR(peak_f, 1000.0, 150.0);
  EXPECT_NEAR(chain_magnitude(t, 0.0, 48000.0), 1.0, 1e-5);
}

TEST(ToneFilter, InactiveCases) {
  ToneFilter t;
  t.recompute(5000.0f, 0.0f, 44100.0f);
  EXPECT_FALSE(t.is_active());
  std::vector<float> buf = noise(256, 4);
  const std::vector<float> original = buf;
  t.process(buf.data(), 256);
  EXPECT_EQ(buf, original);

  t.recompute(5000.0f, 1e-9f, 44100.0f);
  EXPECT_TRUE(t.is_active());
  t.recompute(5000.0f, -0.3f, 44100.0f);
  EXPECT_TRUE(t.is_active());
  t.recompute(8000.0f, 0.7f, 16000.0f);  // above 0.475 times the rate
  EXPECT_FALSE(t.is_active());
  t.recompute(7599.0f, 0.7f, 16000.0f);
  EXPECT_TRUE(t.is_active());
}

TEST(ToneFilter, InactiveKeepsCoefficientsAndReactivationClearsState) {
  ToneFilter t;
  t.recompute(3000.0f, 0.7f, 44100.0f);
  const float b0 = t.section(2).b0(), a1 = t.section(2).a1();
  std::vector<float> buf = noise(300, 8);
  t.process(buf.data(), 300);

  t.recompute(30000.0f, 0.2f, 44100.0f);
  EXPECT_FALSE(t.is_active());
  EXPECT_EQ(t.section(2).b0(), b0);
  EXPECT_EQ(t.section(2).a1(), a1);

  // Back on: the sections start from silence.
  t.recompute(3000.0f, 0.7f, 44100.0f);
  std::vector<float> silence(64, 0.0f);
  t.process(silence.data(), 64);
  for (float v : silence) EXPECT_EQ(v, 0.0f);

  // Redesign while active keeps the state: a tail follows the signal.
  buf = noise(300, 8);
  t.process(buf.data(), 300);
  t.recompute(2500.0f, 0.8f, 44100.0f);
  std::vector<float> tail(8, 0.0f);
  t.process(tail.data(), 8);
  EXPECT_NE(tail[0], 0.0f);

  t.reset();
  std::vector<float> quiet(8, 0.0f);
  t.process(quiet.data(), 8);
  for (float v : quiet) EXPECT_EQ(v, 0.0f);
}
