#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "dsp/band_splitter.h"
#include "dsp/response_helpers.h"

using namespace dsp_test;

namespace {

const float kOffset = 9.313225746154785e-10f;

struct Bands {
  std::vector<float> storage[4];
  float* ptr[4];
  explicit Bands(int n) {
    for (int b = 0; b < 4; ++b) {
      storage[b].assign(n, 0.0f);
      ptr[b] = storage[b].data();
    }
  }
};

int count_for(float a, float b, float c, float rate) {
  BandSplitter s;
  const float split[3] = {a, b, c};
  s.recompute(split, rate);
  return s.get_band_count();
}

}  // namespace

TEST(BandSplitter, BandCountRules) {
  EXPECT_EQ(count_for(20480.0f, 20480.0f, 20480.0f, 44100.0f), 1);
  EXPECT_EQ(count_for(20480.0f, 100.0f, 300.0f, 44100.0f), 1);
  EXPECT_EQ(count_for(1000.0f, 20480.0f, 300.0f, 44100.0f), 2);
  EXPECT_EQ(count_for(1000.0f, 500.0f, 20480.0f, 44100.0f), 3);
  EXPECT_EQ(count_for(200.0f, 2000.0f, 16000.0f, 32000.0f), 3);
  EXPECT_EQ(count_for(200.0f, 2000.0f, 8000.0f, 44100.0f), 4);
  EXPECT_EQ(count_for(20000.0f, 20000.0f, 20000.0f, 96000.0f), 4);  // at the limit still counts
  EXPECT_EQ(count_for(15000.0f, 100.0f, 300.0f, 32000.0f), 4);      // all below 15200
  EXPECT_EQ(count_for(16000.0f, 100.0f, 300.0f, 32000.0f), 3);      // highest after sorting dropped
  EXPECT_EQ(count_for(15300.0f, 15400.0f, 100.0f, 32000.0f), 2);
  EXPECT_EQ(count_for(15300.0f, 20480.0f, 100.0f, 32000.0f), 1);    // two bands: no sorting
  EXPECT_EQ(count_for(15300.0f, 100.0f, 20480.0f, 32000.0f), 2);
}

TEST(BandSplitter, SplitPointsAreSorted) {
  BandSplitter s;
  const float split[3] = {1000.0f, 500.0f, 20480.0f};
  s.recompute(split, 44100.0f);
  ASSERT_EQ(s.get_band_count(), 3);
  EXPECT_EQ(s.section(0, 0).get_frequency(), 500.0f);
  EXPECT_EQ(s.section(0, 1).get_frequency(), 500.0f);
  EXPECT_EQ(s.section(1, 0).get_frequency(), 1000.0f);

  const float four[3] = {5000.0f, 300.0f, 1200.0f};
  s.recompute(four, 48000.0f);
  ASSERT_EQ(s.get_band_count(), 4);
  EXPECT_EQ(s.section(0, 1).get_frequency(), 300.0f);
  EXPECT_EQ(s.section(1, 1).get_frequency(), 1200.0f);
  EXPECT_EQ(s.section(2, 1).get_frequency(), 5000.0f);
  EXPECT_EQ(s.section(2, 1).get_sample_rate(), 48000.0f);
}

TEST(BandSplitter, CrossoverIsTwoLowPassSectionsInSeries) {
  BandSplitter s;
  const float split[3] = {800.0f, 20480.0f, 20480.0f};
  s.recompute(split, 44100.0f);
  // Denominators s^2 + s / (2 cos(pi/8)) + 1 and s^2 + s / (2 cos(3 pi/8)) + 1.
  const double d1a = 1.0 / (2.0 * std::cos(kPi / 8.0)), d1b = 1.0 / (2.0 * std::cos(3.0 * kPi / 8.0));
  auto reference = [&](double f) {
    const double w = warped(f, 800.0, 44100.0);
    return analog_magnitude(1, 0, 0, 1, d1a, 1, w) * analog_magnitude(1, 0, 0, 1, d1b, 1, w);
  };
  auto designed = [&](double f) {
    double g = 1.0;
    for (int i = 0; i < 2; ++i) {
      const BiquadSection& sec = s.section(0, i);
      g *= digital_magnitude(sec.b0(), sec.b1(), sec.b2(), sec.a1(), sec.a2(), f, 44100.0);
    }
    return g;
  };
  for (double f : {0.0, 50.0, 400.0, 800.0, 1600.0, 6400.0}) EXPECT_NEAR(designed(f), reference(f), 1e-5 * reference(f)) << f;

  // Low tone in band 0, high tone in band 1, and the chain runs as designed.
  std::vector<float> x = sine(100.0, 44100.0, 8192);
  const std::vector<float> hi = sine(8000.0, 44100.0, 8192);
  for (int i = 0; i < 8192; ++i) x[i] = 0.5f * x[i] + 0.5f * hi[i];
  Bands b(8192);
  s.split(x.data(), b.ptr, 8192);
  EXPECT_NEAR(amplitude_at(b.storage[0], 100.0, 44100.0, 2048), 0.5 * reference(100.0), 0.002);
  EXPECT_LT(amplitude_at(b.storage[0], 8000.0, 44100.0, 2048), 0.5e-3);
  EXPECT_NEAR(amplitude_at(b.storage[1], 8000.0, 44100.0, 2048), 0.5, 0.002);
}

TEST(BandSplitter, BandsSumToTheInput) {
  const float configs[][3] = {{20480.0f, 0.0f, 0.0f}, {700.0f, 20480.0f, 0.0f},
                              {3000.0f, 300.0f, 20480.0f}, {6000.0f, 150.0f, 1500.0f}};
  for (int c = 0; c < 4; ++c) {
    BandSplitter s;
    s.recompute(configs[c], 44100.0f);
    ASSERT_EQ(s.get_band_count(), c + 1);
    const int n = 256;
    Bands b(n);
    for (int chunk = 0; chunk < 4; ++chunk) {
      const std::vector<float> x = noise(n, 100 + chunk);
      s.split(x.data(), b.ptr, n);
      if (c == 0) {
        EXPECT_EQ(b.storage[0][0], x[0] + kOffset);
        for (int i = 1; i < n; ++i) ASSERT_EQ(b.storage[0][i], x[i]);
      }
      s.sum(b.ptr, n);
      for (int i = 0; i < n; ++i) {
        double expected = x[i];
        if (i == 0) expected += (c + 1) * double(kOffset);
        ASSERT_NEAR(b.storage[0][i], expected, 1e-6) << "bands " << c + 1 << " sample " << i;
      }
    }
  }
}

TEST(BandSplitter, OffsetsAndAdditionOrder) {
  BandSplitter s;
  const float split[3] = {200.0f, 2000.0f, 8000.0f};
  s.recompute(split, 44100.0f);
  Bands b(7);
  s.sum(b.ptr, 7);  // silence: only the offsets at sample 3
  for (int band = 0; band < 4; ++band)
    for (int i = 0; i < 7; ++i) EXPECT_EQ(b.storage[band][i], i == 3 ? 1e-20f : 0.0f);

  // band2 + band1 + band3 + band0, left to right; another order loses the 0.25.
  Bands o(2);
  o.storage[2][0] = 1e8f;
  o.storage[1][0] = -1e8f;
  o.storage[3][0] = 0.5f;
  o.storage[0][0] = 0.25f;
  s.sum(o.ptr, 2);
  EXPECT_EQ(o.storage[0][0], 0.75f);
  EXPECT_EQ(o.storage[0][1], 1e-20f);

  const float three[3] = {200.0f, 2000.0f, 20480.0f};
  s.recompute(three, 44100.0f);
  Bands t(1);
  t.storage[2][0] = 1e8f;
  t.storage[1][0] = -1e8f;
  t.storage[0][0] = 0.25f;
  t.storage[3][0] = 5.0f;  // not in use
  s.sum(t.ptr, 1);
  EXPECT_EQ(t.storage[0][0], 0.25f + 1e-20f);
  EXPECT_EQ(t.storage[3][0], 5.0f);
}

TEST(BandSplitter, CrossoversComingBackIntoUseStartFromSilence) {
  const float four[3] = {300.0f, 1200.0f, 5000.0f};
  const float one[3] = {20480.0f, 1200.0f, 5000.0f};
  const float two[3] = {300.0f, 20480.0f, 5000.0f};
  const int n = 128;
  const std::vector<float> x = noise(n, 55);

  BandSplitter used, fresh;
  Bands b(n), f(n);
  used.recompute(four, 44100.0f);
  used.split(x.data(), b.ptr, n);
  used.recompute(one, 44100.0f);
  used.split(x.data(), b.ptr, n);
  used.recompute(four, 44100.0f);  // all three crossovers re-used
  fresh.recompute(four, 44100.0f);
  used.split(x.data(), b.ptr, n);
  fresh.split(x.data(), f.ptr, n);
  for (int band = 0; band < 4; ++band) EXPECT_EQ(b.storage[band], f.storage[band]) << band;

  // Crossovers still in use keep their state: 4 -> 2 -> 4 clears 1 and 2 only,
  // so band 0 (through crossover 0) differs from a fresh start.
  BandSplitter kept;
  Bands k(n);
  kept.recompute(four, 44100.0f);
  kept.split(x.data(), k.ptr, n);
  kept.recompute(two, 44100.0f);
  kept.split(x.data(), k.ptr, n);
  kept.recompute(four, 44100.0f);
  BandSplitter fresh2;
  Bands f2(n);
  fresh2.recompute(four, 44100.0f);
  kept.split(x.data(), k.ptr, n);
  fresh2.split(x.data(), f2.ptr, n);
  EXPECT_NE(k.storage[0], f2.storage[0]);
  // Bands 2 and 3 come from crossovers 1 and 2 alone, which were cleared.
  EXPECT_EQ(k.storage[2], f2.storage[2]);
  EXPECT_EQ(k.storage[3], f2.storage[3]);

  // reset clears the crossovers in use.
  used.reset();
  BandSplitter fresh3;
  Bands f3(n);
  fresh3.recompute(four, 44100.0f);
  used.split(x.data(), b.ptr, n);
  fresh3.split(x.data(), f3.ptr, n);
  for (int band = 0; band < 4; ++band) EXPECT_EQ(b.storage[band], f3.storage[band]) << band;
}
